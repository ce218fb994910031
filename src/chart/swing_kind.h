#pragma once

#include <optional>
#include <string_view>

namespace kora {

// What a swing chart takes for a turn of the market.
enum class SwingKind {
  kNone,       // the chart has its bars
  kStandard,   // highs and lows of neighbouring bars, "NORM"
  kDays,       // so many lower lows or higher highs, "XDay"
  kPoints,     // a move of so many points, of cents for shares, "XPoint"
  kPointsAuto  // the same by the average swing of the bars on show, "XPointAuto"
};

// The kind of a word in any case; nothing for other words.
std::optional<SwingKind> SwingKindOf(std::string_view word);
// "NORM", "XDay", ...; empty for none.
std::string_view SwingWord(SwingKind kind);

struct SwingChoice {
  SwingKind kind = SwingKind::kNone;
  double size = 0;  // days or points; of no meaning to the kinds without one
};

}  // namespace kora
