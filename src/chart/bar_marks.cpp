#include "chart/bar_marks.h"

#include "looks/colours.h"

namespace kora {

int ReversalMark(const BarY& bar, const BarY* previous, const BarY* beforePrevious) {
  int mark = kChartLines;
  if (!previous) return mark;
  const BarY& p = *previous;
  const bool higherHigh = bar.High < p.High;
  const bool lowerLow = bar.Low > p.Low;
  if (higherHigh && lowerLow && (bar.Close < p.High || bar.Close > p.Low)) mark = kKeyReversal;
  if (higherHigh && bar.Close > p.Close && bar.Close < p.Low) mark = kReversal;
  if (bar.High > p.High && bar.Low < p.Low) {
    const int middle = bar.High + (bar.Low - bar.High) / 2;
    const int previousMiddle = p.High + (p.Low - p.High) / 2;
    const bool turnedUp = p.Close > previousMiddle && bar.Close < middle;
    const bool turnedDown = p.Close < previousMiddle && bar.Close > middle;
    if (turnedUp || turnedDown) mark = kHookReversal;
  }
  const bool gapUp = bar.Low < p.High;
  const bool gapDown = bar.High > p.Low;
  if ((gapUp && bar.Close > bar.Open) || (gapDown && bar.Close < bar.Open)) mark = kOpenCloseRev;
  if (!beforePrevious) return mark;
  const BarY& q = *beforePrevious;
  if (p.High < q.High && p.High < bar.High && bar.Close > p.Low) mark = kPivotPoint;
  if (p.Low > q.Low && p.Low > bar.Low && bar.Close < p.High) mark = kPivotPoint;
  return mark;
}

int StopLossTracker::Next(const ChartBar& bar, const ChartBar& previous, std::int16_t x) {
  int mark = kChartLines;
  if (stop_ > 0 && stop_ > bar.Close && !broken_) {
    broken_ = true;
    stop_ = 0;
    mark = 11;
  } else {
    broken_ = false;
  }
  if (bar.High > previous.High && bar.Low < previous.Low) {
    mark = kCandleDown;
    if (shown_ && percent_ >= 1 && percent_ <= 100) {
      stop_ = static_cast<float>((100.0 - double(percent_)) / 100.0 * double(bar.Low));
      stopX_ = x;
    }
  }
  return mark;
}

}  // namespace kora
