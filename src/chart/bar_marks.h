#pragma once

#include <cstdint>

#include "store/chart_bars.h"

namespace kora {

// Screen y of a bar's prices. A smaller y is a higher price.
struct BarY {
  std::int16_t High = 0, Low = 0, Open = 0, Close = 0;
};

// The reversal mark of a bar as a colour entry: each test that holds overrides the one before,
// starting from kChartLines:
//
//   kKeyReversal   higher high and lower low, close beyond the previous bar
//   kReversal      higher high, close below the previous close but above the previous low
//   kHookReversal  inside bar whose close turned from one half of its bar to the other
//   kOpenCloseRev  a gap with the close against it
//   kPivotPoint    the previous bar stands out, and the close lies beyond it on the far side
//
// `previous` is null for the first bar, `beforePrevious` for the first two: tests that need a
// bar which is not there do not hold.
int ReversalMark(const BarY& bar, const BarY* previous, const BarY* beforePrevious);

// Outside bars and the stop that they set, bar by bar.
class StopLossTracker {
 public:
  // `shown`: a stop is kept. `percent` below the low of an outside bar; outside 1 to 100 no
  // stop is set.
  StopLossTracker(bool shown, float percent) : shown_(shown), percent_(percent) {}

  // The colour entry of this bar: 11 where it breaks the stop, kCandleDown for an outside bar,
  // else kChartLines.
  int Next(const ChartBar& bar, const ChartBar& previous, std::int16_t x);

  bool broken() const { return broken_; }        // the stop was broken by the bar last seen
  float stop() const { return stop_; }           // price, 0 none
  std::int16_t stopX() const { return stopX_; }  // where it was set

 private:
  bool shown_;
  float percent_;
  bool broken_ = false;
  float stop_ = 0;
  std::int16_t stopX_ = 0;
};

}  // namespace kora
