#include "base/numbers.h"

#include <charconv>
#include <cmath>
#include <cstring>

#include "base/runtime_error.h"

namespace kora {
namespace {

bool IsDigit(char c) { return c >= '0' && c <= '9'; }

// Decimal digits of a finite, non-negative number: value = 0.d1d2d3... * 10^point.
struct Decimal {
  char digits[40];
  int count = 0;
  int point = 0;
};

// Reads the "d.ddde+XX" form that to_chars writes.
Decimal ParseScientific(const char* first, const char* last) {
  Decimal d;
  const char* p = first;
  for (; p != last && *p != 'e'; ++p) {
    if (IsDigit(*p)) d.digits[d.count++] = *p;
  }
  int exponent = 0;
  if (p != last) {
    ++p;
    if (p != last && *p == '+') ++p;
    std::from_chars(p, last, exponent);
  }
  d.point = exponent + 1;
  while (d.count > 0 && d.digits[d.count - 1] == '0') --d.count;
  if (d.count == 0) d.point = 0;
  return d;
}

std::string FormatDecimal(const Decimal& value, bool negative, std::string_view pattern) {
  const size_t dot = pattern.find('.');
  const std::string_view whole = pattern.substr(0, dot);
  const std::string_view part =
      dot == std::string_view::npos ? std::string_view() : pattern.substr(dot + 1);
  const size_t firstZero = whole.find('0');
  const int minWhole = firstZero == std::string_view::npos ? 0 : int(whole.size() - firstZero);
  const size_t lastZero = part.rfind('0');
  const int minPart = lastZero == std::string_view::npos ? 0 : int(lastZero) + 1;
  const int maxPart = int(part.size());

  // All digits up to the last shown place, as one row: [whole digits][maxPart digits].
  const int wholeDigits = value.point > 0 ? value.point : 0;
  const int total = wholeDigits + maxPart;
  std::string row(size_t(total) + 1, '0');  // one place in front for a carry
  for (int i = 0; i < total; ++i) {
    const int source = i - wholeDigits + value.point;
    if (source >= 0 && source < value.count) row[size_t(i) + 1] = value.digits[source];
  }
  const int next = total - wholeDigits + value.point;
  if (next >= 0 && next < value.count && value.digits[next] >= '5') {
    size_t i = size_t(total);
    while (row[i] == '9') row[i--] = '0';
    ++row[i];
  }

  std::string_view shownWhole(row.data(), size_t(wholeDigits) + 1);
  while (!shownWhole.empty() && shownWhole.front() == '0') shownWhole.remove_prefix(1);
  std::string_view shownPart(row.data() + wholeDigits + 1, size_t(maxPart));
  const bool zero =
      shownWhole.empty() && shownPart.find_first_not_of('0') == std::string_view::npos;
  while (int(shownPart.size()) > minPart && shownPart.back() == '0') shownPart.remove_suffix(1);

  std::string out;
  if (negative && !zero) out += '-';
  if (int(shownWhole.size()) < minWhole) out.append(size_t(minWhole) - shownWhole.size(), '0');
  out += shownWhole;
  if (dot != std::string_view::npos) {
    out += '.';
    out += shownPart;
  }
  return out;
}

template <typename T>
std::string StrShortest(T value) {
  if (std::isnan(value)) return "nan";
  if (std::isinf(value)) return value > 0 ? "inf" : "-inf";
  if (value == 0) return "0";
  char buffer[512];
  const auto end = std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed);
  return std::string(buffer, end.ptr);
}

template <typename T>
void AppendShortest(std::string& out, T value) {
  // Nearly every coordinate is a whole number, or one of moderate size.
  if (value >= T(-1e9) && value <= T(1e9)) {
    const auto whole = static_cast<std::int32_t>(value);
    if (T(whole) == value) {
      AppendStr(out, whole);
      return;
    }
    char buffer[512];
    const auto end = std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed);
    out.append(buffer, end.ptr);
    return;
  }
  out += StrShortest(value);
}

}  // namespace

float CSng(double value) {
  const auto single = static_cast<float>(value);
  if (!std::isfinite(single)) throw RunTimeError(kOverflow);
  return single;
}

double RoundHalfEven(double value) { return std::nearbyint(value); }

std::int16_t CInt(double value) {
  // 32767.5 rounds to 32768 and is out; -32768.5 rounds to -32768 and is in.
  if (!(value >= -32768.5 && value < 32767.5)) throw RunTimeError(kOverflow);
  return static_cast<std::int16_t>(std::nearbyint(value));
}

std::int32_t CLng(double value) {
  if (!(value >= -2147483648.5 && value < 2147483647.5)) throw RunTimeError(kOverflow);
  return static_cast<std::int32_t>(std::nearbyint(value));
}

double Int(double value) { return std::floor(value); }

double Fix(double value) { return std::trunc(value); }

double Divide(double a, double b) {
  if (b == 0) throw RunTimeError(kDivisionByZero);
  return a / b;
}

std::optional<float> ParseFloat(std::string_view text) {
  float value = 0;
  const char* end = text.data() + text.size();
  const auto r = std::from_chars(text.data(), end, value);
  if (r.ec != std::errc() || r.ptr != end || !std::isfinite(value)) return std::nullopt;
  return value;
}

double Val(std::string_view text) {
  size_t i = 0;
  while (i < text.size() && (text[i] == ' ' || text[i] == '\t')) ++i;
  const size_t start = i;
  if (i < text.size() && (text[i] == '-' || text[i] == '+')) ++i;
  const size_t digits = i;
  while (i < text.size() && IsDigit(text[i])) ++i;
  if (i < text.size() && text[i] == '.') {
    ++i;
    while (i < text.size() && IsDigit(text[i])) ++i;
  }
  // from_chars knows no leading plus.
  if (digits == i) return 0;
  const size_t first = text[start] == '+' ? digits : start;
  double value = 0;
  const auto result =
      std::from_chars(text.data() + first, text.data() + i, value, std::chars_format::fixed);
  if (result.ec == std::errc::result_out_of_range) {
    // More than 308 digits before the point, or a fraction too small to hold.
    const std::string_view body = text.substr(digits, i - digits);
    const bool large = body.find_first_of("123456789") < body.find('.');
    return large ? (text[start] == '-' ? -HUGE_VAL : HUGE_VAL) : 0;
  }
  return result.ec == std::errc() ? value : 0;
}

std::string Str(double value) { return StrShortest(value); }
std::string Str(float value) { return StrShortest(value); }
std::string Str(std::int32_t value) { return std::to_string(value); }

void AppendStr(std::string& out, std::int32_t value) {
  char buffer[16];
  out.append(buffer, std::to_chars(buffer, buffer + sizeof buffer, value).ptr);
}

void AppendStr(std::string& out, double value) { AppendShortest(out, value); }
void AppendStr(std::string& out, float value) { AppendShortest(out, value); }

std::string Format(double value, std::string_view pattern) {
  if (!std::isfinite(value)) return Str(value);
  char buffer[64];
  const auto end = std::to_chars(buffer, buffer + sizeof buffer, std::fabs(value),
                                 std::chars_format::scientific, 14);
  return FormatDecimal(ParseScientific(buffer, end.ptr), value < 0, pattern);
}

std::string Format(float value, std::string_view pattern) {
  if (!std::isfinite(value)) return Str(value);
  char buffer[64];
  const auto end = std::to_chars(buffer, buffer + sizeof buffer, std::fabs(value),
                                 std::chars_format::scientific);
  return FormatDecimal(ParseScientific(buffer, end.ptr), value < 0, pattern);
}

}  // namespace kora
