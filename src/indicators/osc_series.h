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

// Makes a range symmetric about zero: where `lowest` is at or above minus `highest`, it becomes
// minus `highest`; otherwise `highest` becomes minus `lowest`.
template <typename T>
void MakeSymmetric(T& highest, T& lowest) {
  if (lowest >= -highest) lowest = -highest;
  else highest = -lowest;
}

}  // namespace kora
