#include <cmath>
#include <cstring>
#include <limits>

#include "adjust/adjust_list.h"
#include "adjust/issue_figures.h"
#include "base/currency.h"
#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "companies/stock_details.h"
#include "fuzz/readers.h"
#include "fuzz/small_home.h"
#include "looks/look_settings.h"
#include "maintenance/typed_number.h"
#include "scans/scan_filter.h"
#include "tests/support/error_of.h"
#include "update/day_line.h"
#include "update/download_list.h"

namespace kora::test {
namespace {

void OnlyOverflow(int error) { Promise(error == 0 || error == kOverflow, "error 6 alone"); }

// The number that a pattern makes of a value lies within half of its last place.
void CheckFormatted(const std::string& text, double value, std::string_view pattern) {
  Promise(text.size() < 400 + pattern.size(), "a formatted number has an end");
  // Fifteen digits of the largest numbers of all may be one more than those are.
  if (!(std::fabs(value) < 1e308)) return;
  const size_t dot = pattern.find('.');
  const double places = dot == std::string_view::npos ? 0 : double(pattern.size() - dot - 1);
  const double half = 0.5 * std::pow(10.0, -places);
  const double slack = std::fabs(value) * 1e-13 + 1e-300;
  Promise(std::fabs(Val(text) - value) <= half * 1.0001 + slack, "Format is near its value");
}

}  // namespace

void ReadNumbersBody(std::string_view bytes) {
  const double value = Val(bytes);
  Promise(!std::isnan(value), "Val gives a number");
  if (std::isfinite(value)) {
    const std::string text = Str(value);
    Promise(text.find_first_not_of("-.0123456789") == std::string::npos, "no exponent");
    Promise(Val(text) == value, "Str reads back");
    std::string appended = "x";
    AppendStr(appended, value);
    Promise(appended == "x" + text, "AppendStr is Str");
  }
  OnlyOverflow(ErrorOf([&] { Promise(std::fabs(CInt(value) - value) <= 0.5, "CInt is near"); }));
  OnlyOverflow(ErrorOf([&] { Promise(std::fabs(CLng(value) - value) <= 0.5, "CLng is near"); }));
  OnlyOverflow(ErrorOf([&] {
    const float single = CSng(value);
    Promise(Val(Str(single)) == double(single) || float(Val(Str(single))) == single,
            "a float reads back");
  }));
  OnlyOverflow(ErrorOf([&] {
    const Currency money(value);
    Currency sum = money;
    sum += money;
  }));
  if (const auto single = ParseFloat(bytes)) {
    Promise(std::isfinite(*single), "a float is a number");
    Promise(ParseFloat(Str(*single)) == *single, "a float in plain form reads back");
  }
  for (const char* pattern : {"0.00", "#.##", "######", "#####0.000", ".00#"})
    CheckFormatted(Format(value, pattern), value, pattern);
  FieldNumber(bytes);
  FloatOf(bytes);
  PaddedIndustry(bytes);
  const std::string text(bytes);
  SettingCInt(text);
  SettingCLng(text);
  SettingBool(text);
  ParseCommandWords(bytes);
}

void ReadFormatsBody(std::string_view bytes) {
  double value = 0;
  std::memcpy(&value, bytes.data(), std::min(bytes.size(), sizeof value));
  if (bytes.size() > sizeof value) bytes.remove_prefix(sizeof value);
  // Only the characters that patterns have.
  std::string pattern;
  for (const char c : bytes.substr(0, 40)) {
    if (c == '.' && pattern.find('.') != std::string::npos) continue;
    pattern += c == '.' ? '.' : c & 1 ? '0' : '#';
  }
  CheckFormatted(Format(value, pattern), value, pattern);
  const auto single = static_cast<float>(
      std::fabs(value) <= double(std::numeric_limits<float>::max()) ? value : 1.5);
  const std::string text = Format(single, pattern);
  Promise(text.size() < 100 + pattern.size(), "a formatted float has an end");
  if (std::isfinite(single)) {
    Promise(Format(Val(Str(single)), pattern) == Format(std::stod(Str(single)), pattern),
            "a pattern gives one text of one number");
  }
  Promise(Format(value, pattern) == Format(value, pattern), "the same text each time");
}

void ReadDatesBody(std::string_view bytes) {
  if (const auto date = ParseFileDate(bytes)) {
    Promise(FormatFileDate(*date) == bytes, "a date reads back");
    Promise(DateOfDayNumber(DayNumber(*date)) == *date, "a day number reads back");
    const int weekday = WeekdayOf(bytes);
    Promise(weekday >= 1 && weekday <= 7 && weekday == Weekday(*date), "a weekday");
    Promise(DateToFile(DateToDisplay(bytes)) == bytes, "a shown date reads back");
    const std::string shown = FinishDateText(bytes);
    Promise(ReadFinishDate(shown) == std::string(bytes), "a finish date reads back");
  } else {
    Promise(ErrorOf([&] { WeekdayOf(bytes); }) == kBadCall, "error 5 for what is no date");
  }
  if (const auto date = ParseUserDate(bytes)) {
    Promise(ParseFileDate(FormatFileDate(*date)) == *date, "a typed date is a date");
    Promise(ParseUserDate(FormatDisplayDate(*date)) == *date || date->year < 1000,
            "a long date reads back");
  }
  DateToDisplay(bytes);
  DateToFile(bytes);
  DateToShort(bytes);
  if (const auto date = AdjWantedDateOf(bytes))
    Promise(ParseFileDate(*date).has_value(), "a wanted date is a date");
  if (const auto date = ReadFinishDate(bytes))
    Promise(ParseFileDate(*date).has_value(), "a finish date is a date");
  if (const std::string date = BulletinDate(bytes); !date.empty())
    Promise(ParseFileDate(date).has_value(), "a bulletin's date is a date");
  Promise(ParseUserDate(UpdateDateOf(bytes, {1998, 9, 20})).has_value(),
          "the date of an entry is a date");

  // Texts of any kind go to the files and come back.
  const std::string utf = FromAnsi(bytes);
  Promise(utf.size() >= bytes.size(), "ANSI to UTF-8 loses no byte");
  const std::string ansi = ToAnsi(bytes);
  Promise(ansi.size() <= bytes.size(), "UTF-8 to ANSI grows nothing");
  Promise(ToAnsi(FromAnsi(ansi)) == ansi ||
              ansi.find_first_of("\x81\x8D\x8F\x90\x9D") != std::string::npos,
          "what is in the file's alphabet stays");
  Promise(Trim(LCase(UCase(bytes))).size() == Trim(bytes).size(), "case changes no length");
  if (IsFileCode(bytes)) {
    const std::string name = CodeFileName(bytes, ".WDT");
    Promise(name.find_first_of(std::string_view("/\\:*?\"<>|\0", 10)) == std::string::npos &&
                name[0] != '.' && name.size() <= 10,
            "a code names a file of its folder");
    Promise(IsFileCode(KeptCode(std::string(Trim(bytes)))), "a code is kept as a code");
  }
  Promise(AsOtherDetails(bytes).size() <= 15, "details fit their field");
  ShownLine(bytes);
}

void ReadDayLinesBody(std::string_view bytes) {
  Input input(bytes);
  const bool options = (input.Byte() & 1) != 0;
  LineReader lines(input.Rest());
  std::string_view line;
  while (lines.Next(line)) {
    DayLine day;
    const std::string fault = ReadDayLine(line, options, day);
    for (const std::string& text : MisreadFields(line, options))
      Promise(text.size() < 8000, "what is told has an end");
    const std::string shown = ShownLine(line);
    Promise(shown.size() <= 640 &&
                shown.find_first_of(std::string_view("\n\r\0", 3)) == std::string::npos,
            "a shown line is one line");
    if (!fault.empty() || day.code.empty()) continue;
    Promise(IsFileCode(day.code) && day.code.size() <= 6, "a line's code names a file");
    Promise(ParseFileDate(day.date).has_value(), "a line's date is a date");
    for (const float price : {day.Open, day.High, day.Low, day.Close})
      Promise(std::isfinite(price), "prices are numbers");
    if (!options) continue;
    const CalendarDate expiry = DateOfDayNumber(DayNumber(*ParseFileDate(day.date)) + day.days);
    Promise(expiry.year >= 1 && expiry.year <= 9999, "an expiry is a date");
  }
}

}  // namespace kora::test
