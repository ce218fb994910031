#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "indicators/osc_panel.h"

namespace kora {

// RMX: RMO's value over the bars on show.
//
//   ratio = close of compare / (close of security * 100)
//   value = mean of the last P ratios - ratio
//
// - The bars on show are paired with the last records of the compare file, whatever their dates
//   and on weekly and monthly charts too. Where the compare file is shorter than the chart, its
//   record 1 goes with bar 0.
// - A bar with a zero close of the security is passed over; a zero close of the compare file is
//   a ratio like any other.
// - The scale is that of all values, with a highest of at least 0. With no value at all the
//   start values stand, 0 and 100000, and only guides and texts are drawn.
// - The centre path is the y of zero in the range of the values seen so far, so that the zero
//   line visibly wanders as the range grew. While that range is 0, or so small that zero lies
//   beyond 16 bits, it has no point.
// - A value of 0 is passed over when the lines are drawn. They begin where the line before had
//   its end, one spacing left.
// - "Offset": how many units a y lies above the panel's middle, negative below.
//
// Sums are 64-bit, so that the mean of equal ratios is that ratio; ratio and value are 32-bit.

struct RmxPoint {
  bool Stored = false;
  float Value = 0;
  float Highest = 0, Lowest = 100000.0f;  // of the values up to here; set where Stored
};

struct RmxSeries {
  std::vector<RmxPoint> Points;  // one a bar
  float Highest = 0, Lowest = 100000.0f;
};

// `compare` holds the compare file's closes from the record that goes with bar 0 on; bars beyond
// it have no value. Error 9 when P is below 1.
RmxSeries RmxValues(const ChartBars& bars, std::span<const float> compare, int P);

inline constexpr OscKey kRmxP{"RmxP", "RmxPW", 100, 50, "RMX periods"};
inline constexpr OscKey kRmxA{"RmxA", "RmxAW", 20, 20, "RMX average"};

void ShowRMX(OscHost& host);

}  // namespace kora
