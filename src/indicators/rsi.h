#pragma once

#include "indicators/osc_panel.h"
#include "store/chart_bars.h"

namespace kora {

// Relative strength at bar i, 0 to 100, over `period` bars (at least 1).
//
//   gains  = the sum of the rises of the pairs (i - P, i - P + 1) to (i - 2, i - 1)
//   losses = the sum of the falls of the same pairs
//   G = gains / P   L = losses / P, or 1 when there was none   RSI = 100 - 100 / (1 + G / L)
//
// - The bar's own close takes no part: the newest pair ends at the bar before it.
// - P - 1 pairs are summed and divided by P.
// - A pair that begins with an empty bar (close 0) is passed over.
// - With no fall in the window L is 1, in money, so that a pure rise does not give 100 but a
//   figure that follows the price level: a very steady rise shows as a low RSI.
// - Before bar P there is nothing to sum and the value is 0.
double RsiAt(const ChartBars& bars, int i, int period);

inline constexpr OscKey kRsiP{"RsiP", "RsiPW", 14, 14, "RSI periods"};

void ShowRSI(OscHost& host);

}  // namespace kora
