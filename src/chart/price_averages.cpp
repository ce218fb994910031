#include "chart/price_averages.h"

#include "base/numbers.h"
#include "chart/chart_pen.h"

namespace kora {
namespace {

// Draws from point to point as the values come.
class AverageTrace {
 public:
  AverageTrace(ChartPen& pen, Colour colour, int averageIndex)
      : pen_(pen), colour_(colour), letter_(averageIndex == 1 ? 'L' : 'H') {}
  void To(double x, std::int16_t y) {
    if (lastY_ != 0) pen_.Line(letter_, {lastX_, double(lastY_), x, double(y), colour_});
    lastX_ = x;
    lastY_ = y;
  }

 private:
  ChartPen& pen_;
  Colour colour_;
  char letter_;
  double lastX_ = 0;
  std::int16_t lastY_ = 0;
};

}  // namespace

std::optional<std::int16_t> CloseSmoother::Add(std::int16_t y) {
  if (exponential_ && count_ == kLength) {
    state_ = CInt(y * (2.0 / 11.0) + state_ * (1.0 - 2.0 / 11.0));
    return state_;
  }
  if (count_ == kLength) {
    for (int i = 1; i < kLength; ++i) table_[i - 1] = table_[i];
    --count_;
  }
  table_[count_++] = y;
  if (count_ < kLength) return std::nullopt;
  std::int32_t sum = 0;
  for (const std::int16_t v : table_) sum += v;
  state_ = CInt(sum / double(kLength));
  return state_;
}

void SimpleAverageLine(ChartPen& pen, std::int16_t period, std::span<const std::int16_t> closeY,
                       Colour colour, std::int16_t firstX, std::int16_t spacing, int averageIndex) {
  if (period < 1) return;
  AverageTrace trace(pen, colour, averageIndex);
  const auto n = static_cast<size_t>(period);
  std::int64_t sum = 0;
  for (size_t i = 0; i < closeY.size(); ++i) {
    sum += closeY[i];
    if (i >= n) sum -= closeY[i - n];
    if (i + 1 >= n) trace.To(firstX + double(i) * spacing, CInt(double(sum) / period));
  }
}

void ExpAverageLine(ChartPen& pen, std::int16_t period, std::span<const std::int16_t> closeY,
                    Colour colour, std::int16_t firstX, std::int16_t spacing, int averageIndex) {
  if (period < 1) return;
  AverageTrace trace(pen, colour, averageIndex);
  const auto n = static_cast<size_t>(period);
  const double k = 2.0 / (period + 1);
  std::int64_t sum = 0;
  std::int16_t state = 0;
  for (size_t i = 0; i < closeY.size(); ++i) {
    if (i < n) {
      sum += closeY[i];
      if (i + 1 < n) continue;
      state = CInt(double(sum) / period);
    } else {
      state = CInt(closeY[i] * k + (1 - k) * state);
    }
    trace.To(firstX + double(i) * spacing, state);
  }
}

}  // namespace kora
