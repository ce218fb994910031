#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace kora {

// One line of a downloaded file: "code,date,open,high,low,close,vol,spare", or in the options
// layout "code,date,open,high,low,close,vol,days,OptType".
struct DayLine {
  std::string
      code;  // at most 6 characters in the case that they have, can name a file; may be empty
  std::string date;  // "yyyymmdd"
  float Open = 0, High = 0, Low = 0, Close = 0;
  std::int32_t Volume = 0;
  bool hasSpare = false;   // the spare field is not 0
  std::int32_t spare = 0;  // final volume of the trading day before
  std::int32_t days = 0;   // to the expiry of an option
  std::string OptType;     // "P" or "C"
};

// Commas that a line has.
inline constexpr int kDayCommas = 7;
inline constexpr int kOptionCommas = 8;

// Reads a line that has the right number of commas. Empty when it can be taken, else what is
// wrong with it. A line with a blank code is not looked at further: it is skipped.
std::string ReadDayLine(std::string_view line, bool options, DayLine& day);

// The fields of a line that could be taken which are no numbers, and what they were read as:
// `Close "1.2x" read as 1.2`. A field left empty is 0 and no mistake, but for the close.
std::vector<std::string> MisreadFields(std::string_view line, bool options);

// A line of a file as it may be shown in a message: UTF-8, no control characters, not endless.
std::string ShownLine(std::string_view line);

}  // namespace kora
