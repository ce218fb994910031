#pragma once

#include <optional>
#include <string>
#include <string_view>

// How a chart is drawn and what a bar of it stands for. Settings, files and command lines hold
// the letters; inside they are these.

namespace kora {

enum class Style : char {
  kBar = 'B',
  kCandlestick = 'C',
  kLine = 'L',
  kPointFigure = 'P',
};

enum class Period : char {
  kDaily = 'A',
  kWeekly = 'W',
  kMonthly = 'M',
};

inline std::string TextOf(Style style) { return {static_cast<char>(style)}; }
inline std::string TextOf(Period period) { return {static_cast<char>(period)}; }

// Nothing for a text that is none of the letters, in upper case.
inline std::optional<Style> ParseStyle(std::string_view text) {
  for (const Style style : {Style::kBar, Style::kCandlestick, Style::kLine, Style::kPointFigure})
    if (text == TextOf(style)) return style;
  return std::nullopt;
}
inline std::optional<Period> ParsePeriod(std::string_view text) {
  for (const Period period : {Period::kDaily, Period::kWeekly, Period::kMonthly})
    if (text == TextOf(period)) return period;
  return std::nullopt;
}

// Bars and candlesticks need a high and a low, which series of closes alone do not have.
inline bool NeedsRange(Style style) { return style == Style::kBar || style == Style::kCandlestick; }

}  // namespace kora
