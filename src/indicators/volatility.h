#pragma once

#include <vector>

#include "indicators/osc_panel.h"
#include "store/chart_bars.h"

namespace kora {

// A bar's range as a percentage of its close, and the average of it over `period` bars.
//
//   V = (High - Low) / Close * 100
//
// - A bar whose close is not above 0, or whose V is no number, repeats the V before it.
// - A V of 0 or less is stored as 1.0, except for bar 0, which then has no value. Such a 1.0 is
//   drawn and averaged, but takes no part in highest and lowest.
// - The average ends at its bar and is there once `period` bars had a value.
struct VolatilitySeries {
  struct Row {
    float value = 0;    // 0: none
    float average = 0;  // 0: none
  };
  std::vector<Row> rows;
  float highest = -100000.0f;
  float lowest = 100000.0f;
};
VolatilitySeries Volatility(const ChartBars& bars, int period);

inline constexpr OscKey kVtyD{"VtyD", "VtyW", 3, 3, "Volatility"};

void ShowVolatility(OscHost& host);

}  // namespace kora
