#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

// Every conversion between numbers, and between numbers and text, is one of these, so that
// rounding is said where it happens and never left to a cast.

namespace kora {

// Rounds half to even to 16 bits. Error 6 when the result leaves -32768..32767, or for NaN.
std::int16_t CInt(double value);

// Rounds half to even to 32 bits. Error 6 when the result leaves the range, or for NaN.
std::int32_t CLng(double value);

// To a 32-bit float. Error 6 when the result leaves the range of floats, or for NaN: an overflow
// is an overflow, never an infinity.
float CSng(double value);

// Rounds half to even, staying a double. For sums that are held to a range later.
double RoundHalfEven(double value);

// The largest whole number not above `value`: Int(-1.5) is -2.
double Int(double value);

// The whole part towards zero: Fix(-1.5) is -1.
double Fix(double value);

// a / b with error 11 where b is 0.
double Divide(double a, double b);

// The leading numeric part of a text: blanks, a sign, digits and one point; 0 where there is
// none. Stops at the first other character, so that "12abc" is 12 and "1E5" is 1.
double Val(std::string_view text);

// The whole text as a finite number, nearest 32-bit float; nothing where it is anything else
// or leaves the range. For text that must be a number, where Val would make it 0.
std::optional<float> ParseFloat(std::string_view text);

// The shortest decimal form that reads back to the same value; never with an exponent, never
// with a leading blank. A NaN is "nan", an infinity "inf" or "-inf".
std::string Str(double value);
std::string Str(float value);
std::string Str(std::int32_t value);

// Appends Str(value) to `out`, without a text in between.
void AppendStr(std::string& out, double value);
void AppendStr(std::string& out, float value);
void AppendStr(std::string& out, std::int32_t value);

// Writes a number by a pattern of "#", "0" and one ".":
// - before the point, each "0" is a digit that always shows, and "#" shows digits only where
//   there are some. A number with more digits than places shows them all;
// - after the point, the number is rounded to as many places as there are "#" and "0",
//   half away from zero; trailing zeros are cut back as far as the pattern has "#";
// - a point in the pattern always shows: Format(5, "#.##") is "5.", Format(0, "######") is "".
// Rounding works on the decimal form of the value (15 digits; the shortest form of a float),
// so that 2.1935 rounds to 2.194 whatever its binary neighbours are.
std::string Format(double value, std::string_view pattern);
std::string Format(float value, std::string_view pattern);

}  // namespace kora
