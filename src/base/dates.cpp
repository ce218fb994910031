#include "base/dates.h"

#include <charconv>

#include "base/runtime_error.h"

namespace kora {
namespace {

bool IsLeap(int year) { return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0; }

int DaysIn(int year, int month) {
  constexpr int days[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
  return month == 2 && IsLeap(year) ? 29 : days[month - 1];
}

bool IsCalendarDate(const CalendarDate& d) {
  return d.year >= 1 && d.year <= 9999 && d.month >= 1 && d.month <= 12 && d.day >= 1 &&
         d.day <= DaysIn(d.year, d.month);
}

void AppendDigits(std::string& out, int value, int digits) {
  for (int scale = digits == 4 ? 1000 : digits == 2 ? 10 : 1; scale > 0; scale /= 10)
    out += char('0' + value / scale % 10);
}

std::string Sub(std::string_view text, size_t from, size_t count) {
  return from < text.size() ? std::string(text.substr(from, count)) : std::string();
}

}  // namespace

std::string DateToDisplay(std::string_view d) {
  return Sub(d, 6, 2) + "/" + Sub(d, 4, 2) + "/" + Sub(d, 0, 4);
}

std::string DateToFile(std::string_view d) { return Sub(d, 6, 4) + Sub(d, 3, 2) + Sub(d, 0, 2); }

std::string DateToShort(std::string_view d) {
  return Sub(d, 6, 2) + "-" + Sub(d, 4, 2) + "-" + Sub(d, 2, 2);
}

std::optional<CalendarDate> ParseFileDate(std::string_view text) {
  if (text.size() != 8) return std::nullopt;
  int value = 0;
  for (const char c : text) {
    if (c < '0' || c > '9') return std::nullopt;
    value = value * 10 + (c - '0');
  }
  const CalendarDate date{value / 10000, value / 100 % 100, value % 100};
  if (!IsCalendarDate(date)) return std::nullopt;
  return date;
}

std::optional<CalendarDate> ParseUserDate(std::string_view text) {
  int part[3] = {0, 0, 0};
  const char* p = text.data();
  const char* end = p + text.size();
  size_t yearDigits = 0;
  for (int i = 0; i < 3; ++i) {
    if (p == end || *p < '0' || *p > '9') return std::nullopt;
    const auto r = std::from_chars(p, end, part[i]);
    if (r.ec != std::errc()) return std::nullopt;
    if (i == 2)
      yearDigits = size_t(r.ptr - p);
    else if (r.ptr - p > 2)
      return std::nullopt;
    p = r.ptr;
    if (i < 2) {
      if (p == end || *p != '/') return std::nullopt;
      ++p;
    }
  }
  if (p != end || (yearDigits > 2 && yearDigits != 4)) return std::nullopt;
  if (yearDigits <= 2) part[2] += part[2] < 30 ? 2000 : 1900;
  const CalendarDate date{part[2], part[1], part[0]};
  if (!IsCalendarDate(date)) return std::nullopt;
  return date;
}

std::string FormatFileDate(const CalendarDate& d) {
  std::string out;
  AppendDigits(out, d.year, 4);
  AppendDigits(out, d.month, 2);
  AppendDigits(out, d.day, 2);
  return out;
}

std::string FormatDisplayDate(const CalendarDate& d) {
  std::string out;
  AppendDigits(out, d.day, 2);
  out += '/';
  AppendDigits(out, d.month, 2);
  out += '/';
  AppendDigits(out, d.year, 4);
  return out;
}

std::string FormatUserDate(const CalendarDate& d) {
  std::string out = std::to_string(d.day) + "/" + std::to_string(d.month) + "/";
  AppendDigits(out, d.year % 100, 2);
  return out;
}

std::int32_t DayNumber(const CalendarDate& d) {
  // Years that begin in March put the leap day last.
  const int y = d.month <= 2 ? d.year - 1 : d.year;
  const int era = (y >= 0 ? y : y - 399) / 400;
  const int yearOfEra = y - era * 400;
  const int dayOfYear = (153 * (d.month + (d.month > 2 ? -3 : 9)) + 2) / 5 + d.day - 1;
  const int dayOfEra = yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear;
  return era * 146097 + dayOfEra - 719468;
}

CalendarDate DateOfDayNumber(std::int32_t days) {
  days += 719468;
  const int era = (days >= 0 ? days : days - 146096) / 146097;
  const int dayOfEra = days - era * 146097;
  const int yearOfEra = (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
  const int dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
  const int m = (5 * dayOfYear + 2) / 153;
  const int month = m < 10 ? m + 3 : m - 9;
  return {yearOfEra + era * 400 + (month <= 2 ? 1 : 0), month, dayOfYear - (153 * m + 2) / 5 + 1};
}

CalendarDate AddMonths(const CalendarDate& d, int months) {
  const std::int64_t total = std::int64_t(d.year) * 12 + d.month - 1 + months;
  const std::int64_t year = total >= 0 ? total / 12 : (total - 11) / 12;
  CalendarDate out{int(year), int(total - year * 12) + 1, d.day};
  const int last = DaysIn(out.year, out.month);
  if (out.day > last) out.day = last;
  return out;
}

int Weekday(const CalendarDate& d) {
  // Day 0, 1 January 1970, was a Thursday, the fifth day.
  const int w = (DayNumber(d) + 4) % 7;
  return (w < 0 ? w + 7 : w) + 1;
}

int WeekdayOf(std::string_view text) {
  const auto date = ParseFileDate(text);
  if (!date) throw RunTimeError(kBadCall);
  return Weekday(*date);
}

}  // namespace kora
