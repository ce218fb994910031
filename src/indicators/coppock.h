#pragma once

#include <cstdint>
#include <vector>

#include "indicators/osc_panel.h"
#include "store/chart_bars.h"

namespace kora {

// Two rates of change, over P and over P - 1 bars, summed and smoothed.
//
//   raw   = (C - C[P]) / C[P] * 100 + (C - C[P - 1]) / C[P - 1] * 100   (C[n]: n bars ago)
//   state = CInt(raw * k + (1 - k) * state), k = 2 / (P + 1), from bar P + 1 on; 0 at bar P
//
// - The state is a 16-bit integer, rounded half to even at every step. Fine moves die out where
//   a step is under half a unit: that rounding is the smoothing.
// - A bar where one of the three closes is zero is 0 and leaves the state as it was.
// - Highest starts at 0, lowest at 100000, over all bars from P on.
struct CoppockSeries {
  std::vector<std::int16_t> smoothed;  // 0: none, or not drawn
  std::int32_t highest = 0;
  std::int32_t lowest = 100000;
};
// A period of at least 1. Error 6 where the state leaves 16 bits.
CoppockSeries Coppock(const ChartBars& bars, int period);

inline constexpr OscKey kCopD{"CopD", "CopW", 14, 14, "Coppock"};

void ShowCoppock(OscHost& host);

}  // namespace kora
