#pragma once

#include <cstdint>
#include <vector>

#include "indicators/osc_panel.h"
#include "store/chart_bars.h"

namespace kora {

// The high and the low of each bar against the exponential average of the close.
//
//   Bull = High - EMA   Bear = Low - EMA, from bar `period` on
//
// - The average starts a bar earlier, at period - 1; that bar has no ray.
// - A record type below 4 has no real range: the close stands for both.
// - Each range starts from -1000 and 1000 and is made symmetric about zero.
struct ElderRaySeries {
  std::vector<float> ema, bull, bear;
  float bullHigh = -1000.0f, bullLow = 1000.0f;
  float bearHigh = -1000.0f, bearLow = 1000.0f;
};
// A period of at least 1. Error 6 where a value leaves 32-bit floats.
ElderRaySeries ElderRay(const ChartBars& bars, int period, std::int16_t recType);

inline constexpr OscKey kERA{"ERA", "ERW", 14, 14, "Elder Ray  period"};

void ShowElderRay(OscHost& host);

}  // namespace kora
