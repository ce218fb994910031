#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "base/files.h"
#include "platform/progress.h"
#include "store/name_rec.h"

// What the scans share: how they are asked for, what they refuse, which securities they pass over
// by their name records.

namespace kora {

// What a scan runs on.
struct ScanRun {
  const Files& files;
  std::string dataPath;
  Progress& progress;
};

// Why a selection can't be run, and the control that is to be corrected.
struct ScanFault {
  std::string text, title;
  std::string field;
};

// Securities that a scan looks at, by their name records alone.
struct SecurityFilter {
  std::optional<std::int16_t> category;
  std::optional<std::string> industry;  // a class "121", or a group "120"
  bool noWarrants = false;              // no codes of exactly six characters

  bool Wants(const NameRec& name) const;
};

// Closing prices within these, both inclusive, as 32-bit floats.
struct ClosingRange {
  float min = 0, max = 0;

  bool Holds(float close) const { return !(close < min || close > max); }
};
// The closing price range of scans 2 and 3: a minimum not above 0 becomes 0.005; a maximum of 0,
// or below the minimum, is no range.
std::optional<ClosingRange> ReadClosingRange(std::string_view min, std::string_view max);

// A class id as its box leaves it: a number in three digits, a blank text as it is; nothing for
// a text that is no whole number without a sign.
std::optional<std::string> PaddedIndustry(std::string_view typed);

// The boxes that scans 2 and 3 have alike: min and max (`Text1`, `Text2`), class (`Text6`). The
// fault, or nothing with the value filled in.
std::optional<ScanFault> ReadRangeBoxes(std::string_view min, std::string_view max,
                                        std::optional<ClosingRange>& range);
std::optional<ScanFault> ReadClassBox(std::string_view typed, std::optional<std::string>& industry);
// What scan 1 tells then, under "Chart Scan".
inline constexpr std::string_view kIndustryNotNumeric =
    "Industry Classification ID must be numeric   eg 010";

// Val of the text as the nearest 32-bit float; nothing beyond all floats.
std::optional<float> FloatOf(std::string_view typed);

// Whether a change of price from `before` to `last` is one of `percent` or more. The product that
// `last` is held against is a 32-bit float. A product beyond all floats is never reached.
bool RisesBy(double percent, float before,
             float last);  // last at or above (percent/100 + 1) before
bool FallsBy(double percent, float before,
             float last);  // last at or below (100 - percent)/100 before

// (last - before) / before in percent, rounded half to even: "12", "-3".
std::string PercentText(float before, float last);

// A price as the lists of hits show it, "####.00".
std::string PriceText(float price);

}  // namespace kora
