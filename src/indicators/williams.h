#pragma once

#include <cstdint>
#include <vector>

#include "indicators/osc_panel.h"

namespace kora {

// Williams %R.
//
//   W = (highest - close) / (highest - lowest) * 100, over the last P bars
//
// - The positive form: 0 at the high and 100 at the low, drawn downward from the top, so that a
//   close at the high lies above "O/B".
// - The first value is that of bar P, over bars 1 to P; bar 0 never counts.
// - RecType 1 to 3 stand with their close. A zero High, Low or Close does not count, and no
//   close stands in for a zero High or Low. Where nothing in the window counts, the start
//   values -100000 and 100000 stand and W is about 50.
// - A bar is passed over when its highest is 0 or its range is 0.
// - Drawn is the mean of the last 3 y values alone, from its fourth point on: two lines fewer
//   than there are means.
// - A step that fails is passed over: the value it was to give keeps its last state. Bad data
//   thus never ends this panel.
//
// The differences of prices are 32-bit floats; their ratio is 64-bit and W again 32-bit.
struct WilliamsPoint {
  int Bar;
  float W;
};

// The bars that are not passed over, in order.
std::vector<WilliamsPoint> WilliamsSeries(const ChartBars& bars, std::int16_t recType, int P);

inline constexpr OscKey kWmsA{"WmsA", "WmsW", 7, 7, "Williams %R period"};

void ShowWilliams(OscHost& host);

}  // namespace kora
