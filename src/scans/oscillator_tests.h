#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

#include "store/chart_bars.h"

// The oscillators of a scan, each a pure function from daily bars to rows of a panel, and the
// rule that makes a signal of them. A row is a whole number of chart units from the top of a
// panel 144 units high: the smaller the row, the higher the value.
//
// Signals are defined on rows because charts show rows. They are this scan's own nonetheless: where
// a panel of the chart is worked differently, the scan keeps its own way (docs/scans.md).

namespace kora {

struct OscRows {
  std::int32_t y = 0;                 // of the last bar
  std::int32_t p = 0;                 // of the one before
  std::int32_t oblin = 0, oslin = 0;  // the lines of "over bought" and "over sold"

  friend bool operator==(const OscRows&, const OscRows&) = default;
};

// Each gives nothing where the bars are too few for two rows, where the oscillator's own rule
// ends it, and where a row leaves 32 bits. Differences of two prices are 32-bit floats, ratios and
// sums 64-bit; values are not rounded before they become rows unless told.
using Rows = std::optional<OscRows>;

//   k = (close - low) / (high - low) * 100, rounded to a whole number
//   row = 121 - k / (100 / 99); lines at 75 and 25
// high and low over K + 1 bars: the bar and the K before it, zero Highs and Lows among them.
// Where high and low are equal k is (close - low) * 100, as it is. The first row is that of bar K + 1.
Rows StochasticRows(std::span<const ChartBar> bars, int K);

//   r = (high - close) / (high - low) * 100
//   row = r * 1.18 + 13, then the mean of the last 3 rows; lines at 10 and 90
// high and low of the closes of the last P bars that are not 0. Bars before bar P, those without
// such closes, and those whose high is 0 or equals their low have no row.
Rows WilliamsRows(std::span<const ChartBar> bars, int P);

//   d = close - close P bars before
//   value = d / close * 100 (ROC), d * 100 (Momentum)
//   row = 131 - (value - min) * 118 / (max - min); lines at 0.8 of max and of min
// over the bars above bar P. A bar with a zero close at either end keeps the value before it, 0 at first.
// max and min start at -100 and 10000 and are made symmetric about 0. Nothing where the lines lie
// outside -32766 to 32766.
Rows RocRows(std::span<const ChartBar> bars, int P);
Rows MomentumRows(std::span<const ChartBar> bars, int P);

//   rsi = 100 - 100 / (1 + up / down); row = 131 - rsi * 1.19; lines at 70 and 30
// up and down: the sums of the rises and of the falls among the last P - 1 changes from close to
// close, divided by P; down 0 stands as 1. A change from a close of 0 is passed over. No smoothing
// from bar to bar. P of 0 stands as 21.
Rows RsiRows(std::span<const ChartBar> bars, int P);

enum class Signal { kNone, kOb, kCutObUp, kCutObDown, kOs, kCutOsUp, kCutOsDown };

// Where the value stands to the lines, and where it came from. On a line counts as beyond it.
Signal SignalOf(const OscRows& rows);

// "OB", "Cut OB UP", "Cut OB DN", "OS", "Cut OS UP", "Cut OS DN"; empty for none.
std::string_view SignalText(Signal signal);

// The signals that are asked for.
struct SignalBoxes {
  bool ob = false;     // Check9
  bool cutOb = false;  // Check12
  bool os = false;     // Check10
  bool cutOs = false;  // Check11

  bool any() const { return ob || cutOb || os || cutOs; }
  // The two crossings that go beyond a line are reported for either of its boxes.
  bool Report(Signal signal) const;
};

}  // namespace kora
