#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "store/chart_bars.h"

namespace kora {

// Small steps that several panels share.

// Makes a range symmetric about zero: where `lowest` is at or above minus `highest`, it becomes
// minus `highest`; otherwise `highest` becomes minus `lowest`.
template <typename T>
void MakeSymmetric(T& highest, T& lowest) {
  if (lowest >= -highest) lowest = -highest;
  else highest = -lowest;
}

// Index of the last bar on show, -1 when there is none.
inline int LastBar(const ChartBars& bars) {
  return std::clamp<int>(bars.BarCount, -1, static_cast<int>(bars.bars.size()) - 1);
}

// A value kept as a 32-bit float. Error 6 when it is too large for one; a NaN and an infinity
// stay.
inline float CSng(double value) {
  const float kept = static_cast<float>(value);
  if (std::isinf(kept) && !std::isinf(value)) throw RunTimeError(kOverflow);
  return kept;
}

// The mean of a full window of y values. They are 16-bit and so is their sum: error 6 where it
// leaves that range, as 200 values of a panel over 163 units high can.
template <typename Window>
std::int16_t AverageY(const Window& window) {
  const std::int16_t sum = CInt(window.Total());
  return CInt(double(sum) / window.size());
}

}  // namespace kora
