#pragma once

#include <vector>

#include "indicators/osc_panel.h"
#include "store/chart_bars.h"

namespace kora {

// The close less its average of three bars, averaged twice over `period` bars.
//
//   detrended[i] = C[i] - (C[i - 2] + C[i - 1] + C[i]) / 3, from bar 3 on; bar 0 takes no part
//   first[i]  = mean of the last P detrended, from bar P + 2 on
//   second[i] = mean of the last P first averages, from bar 2 P + 4 on
//
// - Highest starts at 0, lowest at 200000, over the first average alone; a first average of
//   exactly 0 takes no part in them.
// - The second average waits for P + 3 first ones, though it is made from the last P.
struct HolyGrailSeries {
  std::vector<double> detrended;  // the close itself before bar 3
  std::vector<double> first;      // the three-bar average before bar P + 2, 0 before bar 3
  std::vector<double> second;     // 0 before bar 2 P + 4
  double highest = 0.0;
  double lowest = 200000.0;
};
// A period of at least 1.
HolyGrailSeries HolyGrail(const ChartBars& bars, int period);

inline constexpr OscKey kHolyD{"HolyD", "HolyW", 50, 50, "Jones Holy Grail"};

void ShowHolyGrail(OscHost& host);

}  // namespace kora
