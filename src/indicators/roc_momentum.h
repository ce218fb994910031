#pragma once

#include <cstdint>
#include <vector>

#include "indicators/osc_panel.h"

namespace kora {

// Rate of change and Momentum, one design.
//
//   ROC      = (close - close P bars before) / close * 100, a whole number of 16 bits
//   Momentum = (close - close P bars before) * 100, a whole number of 32 bits
//
// - The divisor of ROC is the newer close: a fall to a half is -100 and a rise to the double is
//   50, so that falls stand out.
// - Momentum is a price difference in hundredths and no percentage; the labels "+80%" and
//   "-80%" of both are 0.8 of the range on show.
// - The first value is that of bar P + 1. Bars up to P carry 0, and a bar with a zero close at
//   either end carries the value before it.
// - The range is made symmetric about zero, so that the zero line lies in the middle.
// - ROC's average is one of y values and runs over all bars, those up to P too. The first full
//   average draws no line. Momentum has no average: its title always ends in "0 Ave".
//
// The difference of two prices is a 32-bit float as prices are; ratio and percent are 64-bit.
struct ChangeSeries {
  std::vector<std::int32_t> V;            // one a bar
  double Highest = -100, Lowest = 10000;  // symmetric about zero; wider than V so that -V fits
};

// P is not 0. Error 6 where a value leaves its range, 9 where a negative P looks past the bars.
ChangeSeries RocSeries(const ChartBars& bars, int P);
ChangeSeries MomentumSeries(const ChartBars& bars, int P);

inline constexpr OscKey kRocP{"RocP", "RocPW", 21, 21, "ROC periods"};
inline constexpr OscKey kRocA{"RocA", "RocAW", 10, 10, "ROC average"};
inline constexpr OscKey kMMA{"MMA", "MMW", 14, 14, "Momentum  period"};

void ShowROC(OscHost& host);
void ShowMomentum(OscHost& host);

}  // namespace kora
