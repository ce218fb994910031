#pragma once

#include <cmath>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "base/numbers.h"

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
  if (lowest >= -highest) lowest = -highest;
  else highest = -lowest;
}

}  // namespace kora
