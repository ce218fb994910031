#pragma once

#include <charconv>
#include <cmath>
#include <limits>
#include <optional>
#include <string_view>

#include "base/text.h"

namespace kora {

inline constexpr std::string_view kDataMustBeNumeric = "Data must be numeric";
inline constexpr std::string_view kNumberTooLarge = "The number is too large";

// A typed text as a number; nothing where it is empty or anything else. One beyond the range of
// numbers is infinite, which no field takes.
inline std::optional<double> TypedNumber(std::string_view text) {
  text = Trim(text);
  if (text.starts_with('+')) text.remove_prefix(1);
  double value = 0;
  const auto end = std::from_chars(text.data(), text.data() + text.size(), value);
  if (end.ptr != text.data() + text.size()) return std::nullopt;
  if (end.ec == std::errc::result_out_of_range)
    return text.find('-', 1) != text.npos ? 0.0 : std::numeric_limits<double>::infinity();
  if (end.ec != std::errc() || !std::isfinite(value)) return std::nullopt;  // "inf", "nan"
  return value;
}

}  // namespace kora
