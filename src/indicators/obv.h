#pragma once

#include <cstdint>
#include <vector>

#include "indicators/osc_panel.h"
#include "store/chart_bars.h"

namespace kora {

// Volume summed up by the sign of the close's change.
//
// - The total starts at 100000, whatever the title says of its base.
// - A bar with a zero close, or a zero close before it, stores no total; the total stays.
// - Highest starts at 0, lowest at 200000. A chart of one bar or two has no totals at all.
struct ObvSeries {
  std::vector<std::int32_t> totals;  // 0: no value
  std::int32_t total = 100000;       // the last
  std::int32_t highest = 0;
  std::int32_t lowest = 200000;
};
// `bar` is the bar in hand, for the message of a failure. Error 6 where the total leaves 32 bits.
ObvSeries OnBalanceVolume(const ChartBars& bars, int& bar);

void ShowOBV(OscHost& host);

}  // namespace kora
