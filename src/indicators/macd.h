#pragma once

#include <vector>

#include "indicators/osc_panel.h"
#include "store/chart_bars.h"

namespace kora {

// Two exponential averages of the close, their difference and its signal average.
//
// - The second average starts n1 bars later than a plain average of n2 bars would, at bar
//   n1 + n2 - 1, which is also the first difference.
// - The signal's seed is n3 + 1 differences over n3 (see EmaColumn), at bar n1 + n2 + n3 - 1.
// - The range of the histogram is that of difference - signal, made symmetric about zero. It
//   starts from 0 and 10000.
struct MacdSeries {
  std::vector<float> ema1, ema2, difference, signal;  // 0 where there is no value yet
  int firstEma1, firstDifference, firstSignal;        // bars
  float highest = 0.0f;
  float lowest = 10000.0f;
};
// Periods of at least 1. Error 6 where a value leaves 32-bit floats.
MacdSeries Macd(const ChartBars& bars, int n1, int n2, int n3);

inline constexpr OscKey kMd1{"Md1", "Md1W", 12, 12, "MACD EMA 1"};
inline constexpr OscKey kMd2{"Md2", "Md2W", 26, 26, "MACD EMA 2"};
inline constexpr OscKey kMd3{"Md3", "Md3W", 9, 9, "MACD EMA 3 signal"};

void ShowMACD(OscHost& host);

}  // namespace kora
