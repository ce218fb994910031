#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

// Dates have three text forms: "yyyymmdd" in files (compared as text), "dd/mm/yyyy" and
// "d/m/yy" for the user.

namespace kora {

// Months and days from 1. What the calls here give is a real date, and what they take must be.
struct CalendarDate {
  int year = 0, month = 0, day = 0;
  friend bool operator==(const CalendarDate&, const CalendarDate&) = default;
};

// "yyyymmdd" to "dd/mm/yyyy". Substring work: nothing is checked.
std::string DateToDisplay(std::string_view yyyymmdd);
// "dd/mm/yyyy" to "yyyymmdd", unchecked too.
std::string DateToFile(std::string_view ddmmyyyy);
// "yyyymmdd" to "dd-mm-yy", unchecked too.
std::string DateToShort(std::string_view yyyymmdd);

// A real calendar date of eight digits, or nothing.
std::optional<CalendarDate> ParseFileDate(std::string_view yyyymmdd);
// A date as a user types it: "d/m/yy" or "dd/mm/yyyy"; years 30 to 99 are of the 1900s,
// 0 to 29 of the 2000s. Nothing when it is no calendar date.
std::optional<CalendarDate> ParseUserDate(std::string_view text);

std::string FormatFileDate(const CalendarDate& date);     // "yyyymmdd"
std::string FormatDisplayDate(const CalendarDate& date);  // "dd/mm/yyyy"
std::string FormatUserDate(const CalendarDate& date);     // "d/m/yy"

// Days since 1 January 1970, proleptic Gregorian, and back.
std::int32_t DayNumber(const CalendarDate& date);
CalendarDate DateOfDayNumber(std::int32_t days);
// Calendar month added; the day is held to the month's last: 31 January + 1 is 28 or 29 February.
CalendarDate AddMonths(const CalendarDate& date, int months);

// 1 Sunday to 7 Saturday.
int Weekday(const CalendarDate& date);
// The same of "yyyymmdd". Error 5 when the text is no calendar date.
int WeekdayOf(std::string_view yyyymmdd);

}  // namespace kora
