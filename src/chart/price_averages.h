#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "platform/surface.h"

namespace kora {

class ChartPen;

// The smoothing line of the price chart, over the y of ten closes. Simple: the mean of the last
// ten, half to even. Exponential: seeded with the mean of the first ten, then
// y * 2/11 + previous * (1 - 2/11), half to even at each step.
class CloseSmoother {
 public:
  explicit CloseSmoother(bool exponential) : exponential_(exponential) {}
  // Nothing until ten closes were seen.
  std::optional<std::int16_t> Add(std::int16_t y);

 private:
  static constexpr int kLength = 10;
  bool exponential_;
  std::int16_t table_[kLength] = {};
  int count_ = 0;
  std::int16_t state_ = 0;
};

// An average of the y values of the closes as a line on the price picture, one point a bar from
// `firstX` in steps of `spacing`; from its second point on. A point follows a previous y of 0
// with no line. `averageIndex` 1 writes `L`, any other `H`. A period below 1, or above the
// number of closes, draws nothing.
//
// Simple: the mean of the last `period` values, half to even.
void SimpleAverageLine(ChartPen& pen, std::int16_t period, std::span<const std::int16_t> closeY,
                       Colour colour, std::int16_t firstX, std::int16_t spacing, int averageIndex);
// Exponential: k = 2 / (period + 1); seeded with the mean of the first `period` values, then
// y * k + (1 - k) * previous; half to even at each step.
void ExpAverageLine(ChartPen& pen, std::int16_t period, std::span<const std::int16_t> closeY,
                    Colour colour, std::int16_t firstX, std::int16_t spacing, int averageIndex);

}  // namespace kora
