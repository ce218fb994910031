#pragma once

#include <functional>
#include <span>

#include "chart/swing_kind.h"
#include "store/chart_bars.h"

// The line of a swing chart, as figures: a staircase of verticals with the market and of short
// horizontals where it turns. A smaller y is a higher price.

namespace kora {

struct SwingBar {
  double x;
  double yHigh, yLow;
  float High, Low;
};

// A piece of the line, in a colour entry.
struct SwingStroke {
  double x1, y1, x2, y2;
  int entry;
};

struct SwingRule {
  SwingKind kind = SwingKind::kStandard;
  double size = 0;     // days, or points
  double divisor = 1;  // points to one unit of price
  double step = 2;     // x of a turn
};

// Takes bars one by one and gives the line in strokes. The first two bars, and bars whose High or
// Low has a y of 0, are remembered only. The line begins at the bar before the first one that
// stands higher, or lower, with both its ends: at that bar's x, at its High for a rise and at its
// Low for a fall.
//
// Its x is its own from there: each turn moves it by the rule's step, whatever the bars' x.
//
// kStandard: rises with higher highs and falls with lower lows of neighbouring bars. An outside
//   or inside bar is held until a later one tells which way it went.
// kDays: follows new highs; `size` lower lows with no new high between turn it. A turn counts as
//   the first of them for the next.
// kPoints, kPointsAuto: follows new highs; a lower low at size / divisor or more below the
//   highest High turns it.
// The same downward, with highs and lows changed over.
class SwingLine {
 public:
  SwingLine(const SwingRule& rule, std::function<void(const SwingStroke&)> draw)
      : rule_(rule), draw_(std::move(draw)) {}

  void Add(const SwingBar& bar);

 private:
  // High and Low of a bar, or y turned about, so that a fall reads as a rise.
  struct Ends {
    double high, low;
  };
  enum class Hold { kNone, kOutside, kInside };

  // How a bar stands to another, in prices.
  struct Comparison {
    bool higherHigh, lowerHigh, higherLow, lowerLow;
  };

  static Comparison Compare(const Ends& bar, const Ends& other) {
    return {.higherHigh = bar.high<other.high, .lowerHigh = bar.high> other.high,
            .higherLow = bar.low<other.low, .lowerLow = bar.low> other.low};
  }
  static Ends Seen(const Ends& y, bool rising) { return rising ? y : Ends{-y.low, -y.high}; }
  bool Begin(const SwingBar& bar);
  void AddStandard(const Ends& bar);
  void FollowTrend(const Ends& bar);
  void SettleOutside(const Ends& bar);
  void SettleInside(const Ends& bar);
  void AddSized(const SwingBar& bar);
  void Turn();
  void LineTo(double y, bool up);
  // To a y seen in the line's way; `with`: in its way, otherwise against it.
  void Go(double seenY, bool with);

  SwingRule rule_;
  std::function<void(const SwingStroke&)> draw_;
  int stored_ = 0;  // bars remembered, up to 2
  double lastX_ = 0;
  Ends last_{};  // of the bar before
  bool begun_ = false;
  bool rising_ = true;
  double x_ = 0, y_ = 0;  // the end of the line
  int colour_ = 0;

  Hold hold_ = Hold::kNone;
  Ends held_{};

  double count_ = 0;    // of kDays
  double extreme_ = 0;  // price, of the kinds by points
};

// The average swing of bars with High, Low and Open, in hundredths: the mean difference of the
// prices between which the standard line turned, times 100. 5 where it did not turn twice.
double AverageSwing(std::span<const ChartBar> bars);

}  // namespace kora
