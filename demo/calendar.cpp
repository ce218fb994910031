#include "demo/calendar.h"

namespace kora::demo {
namespace {

enum Day { kSunday = 1, kMonday = 2, kTuesday = 3, kSaturday = 7 };

// Day number of Easter Sunday by the Gregorian rule.
std::int32_t Easter(int year) {
  const int a = year % 19, b = year / 100, c = year % 100;
  const int d = b / 4, e = b % 4, g = (8 * b + 13) / 25;
  const int h = (19 * a + b - d - g + 15) % 30;
  const int i = c / 4, k = c % 4;
  const int l = (32 + 2 * e + 2 * i - h - k) % 7;
  const int m = (a + 11 * h + 22 * l) / 451;
  const int n = h + l - 7 * m + 114;
  return DayNumber({year, n / 31, n % 31 + 1});
}

// `day` of the month, or the Monday after it where it falls on a weekend.
bool IsMovedHoliday(const CalendarDate& date, int weekday, int day) {
  return date.day == day || (weekday == kMonday && (date.day == day + 1 || date.day == day + 2));
}

bool IsHoliday(const CalendarDate& date, int weekday) {
  switch (date.month) {
    case 1: return IsMovedHoliday(date, weekday, 1) || IsMovedHoliday(date, weekday, 26);
    case 3:
    case 4: {
      if (date.month == 4 && date.day == 25) return true;
      const std::int32_t fromEaster = DayNumber(date) - Easter(date.year);
      return fromEaster == -2 || fromEaster == 1;
    }
    case 6: return weekday == kMonday && date.day >= 8 && date.day <= 14;
    case 12:
      // 25 and 26, and the Monday or Tuesday that makes up for a weekend among them.
      if (date.day == 25 || date.day == 26) return true;
      return (date.day == 27 || date.day == 28) && (weekday == kMonday || weekday == kTuesday);
    default: return false;
  }
}

}  // namespace

bool IsTradingDay(const CalendarDate& date) {
  const int weekday = Weekday(date);
  return weekday != kSunday && weekday != kSaturday && !IsHoliday(date, weekday);
}

std::vector<CalendarDate> TradingDays(const CalendarDate& after, const CalendarDate& last) {
  std::vector<CalendarDate> days;
  const std::int32_t end = DayNumber(last);
  for (std::int32_t n = DayNumber(after) + 1; n <= end; ++n) {
    const CalendarDate date = DateOfDayNumber(n);
    if (IsTradingDay(date)) days.push_back(date);
  }
  return days;
}

std::vector<CalendarDate> NextTradingDays(const CalendarDate& date, int count) {
  std::vector<CalendarDate> days;
  for (std::int32_t n = DayNumber(date) + 1; int(days.size()) < count; ++n) {
    const CalendarDate next = DateOfDayNumber(n);
    if (IsTradingDay(next)) days.push_back(next);
  }
  return days;
}

}  // namespace kora::demo
