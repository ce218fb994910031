#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "base/numbers.h"
#include "store/chart_bars.h"

namespace kora {

// Small steps that several panels share.

// Element i of bars or of a column; the routines count bars in int.
template <typename Column>
auto& At(Column& column, int i) {
  return column[static_cast<size_t>(i)];
}

// Units of value to a unit of height. 0, which ends a panel at its frame, also where there is no
// height.
inline double ScaleOf(double range, double height) { return height == 0 ? 0 : range / height; }

// Makes a range symmetric about zero: where `lowest` is at or above minus `highest`, it becomes
// minus `highest`; otherwise `highest` becomes minus `lowest`.
template <typename T>
void MakeSymmetric(T& highest, T& lowest) {
  if (lowest >= -highest)
    lowest = -highest;
  else
    highest = -lowest;
}

// Index of the last bar on show, -1 when there is none.
inline int LastBar(const ChartBars& bars) {
  return std::clamp<int>(bars.BarCount, -1, static_cast<int>(bars.bars.size()) - 1);
}

// The mean of a full window of y values. They are 16-bit and so is their sum: error 6 where it
// leaves that range, as 200 values of a panel over 163 units high can.
template <typename Window>
std::int16_t AverageY(const Window& window) {
  const std::int16_t sum = CInt(window.Total());
  return CInt(double(sum) / window.size());
}

}  // namespace kora
