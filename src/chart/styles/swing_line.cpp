#include "chart/styles/swing_line.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace kora {
namespace {

// Colour entries, up and down.
constexpr int kStandardUp = 38, kStandardDown = 40;
constexpr int kSizedUp = 20, kSizedDown = 21;

}  // namespace

void SwingLine::Turn() {
  draw_({x_, y_, x_ + rule_.step, y_, colour_});
  x_ += rule_.step;
}

void SwingLine::LineTo(double y, bool up) {
  const bool standard = rule_.kind == SwingKind::kStandard;
  colour_ = up ? (standard ? kStandardUp : kSizedUp) : (standard ? kStandardDown : kSizedDown);
  draw_({x_, y_, x_, y, colour_});
  y_ = y;
}

void SwingLine::Go(double seenY, bool with) { LineTo(rising_ ? seenY : -seenY, with == rising_); }

void SwingLine::Add(const SwingBar& bar) {
  const Ends y{bar.yHigh, bar.yLow};
  const bool known = bar.yHigh != 0 && bar.yLow != 0;
  if (stored_ < 2)
    ++stored_;
  else if (known && (begun_ || Begin(bar))) {
    if (rule_.kind == SwingKind::kStandard)
      AddStandard(y);
    else
      AddSized(bar);
  }
  lastX_ = bar.x;
  last_ = y;
}

bool SwingLine::Begin(const SwingBar& bar) {
  const bool rise = bar.yHigh < last_.high && bar.yLow < last_.low;
  const bool fall = bar.yHigh > last_.high && bar.yLow > last_.low;
  if (!rise && !fall) return false;
  begun_ = true;
  rising_ = rise;
  x_ = lastX_;
  y_ = rise ? last_.high : last_.low;
  extreme_ = rise ? bar.High : bar.Low;
  return true;
}

void SwingLine::AddStandard(const Ends& bar) {
  switch (hold_) {
    case Hold::kNone: FollowTrend(bar); break;
    case Hold::kOutside: SettleOutside(Seen(bar, rising_)); break;
    case Hold::kInside: SettleInside(Seen(bar, rising_)); break;
  }
}

void SwingLine::FollowTrend(const Ends& bar) {
  const auto [higherHigh, lowerHigh, higherLow, lowerLow] = Compare(bar, last_);
  if (higherHigh != lowerLow) {
    const bool up = higherHigh;
    if (up != rising_) Turn();
    rising_ = up;
    LineTo(up ? bar.high : bar.low, up);
  } else if (higherHigh) {
    held_ = bar;
    hold_ = Hold::kOutside;
  } else if (lowerHigh && higherLow) {
    held_ = bar;
    hold_ = Hold::kInside;
  }
}

void SwingLine::SettleOutside(const Ends& bar) {
  const Ends held = Seen(held_, rising_);
  const auto [higherHigh, lowerHigh, higherLow, lowerLow] = Compare(bar, held);
  const Ends own = Seen(bar, rising_);  // seeing twice gives the bar as it is
  if (higherHigh && higherLow) {
    Turn();
    Go(held.low, false);
    Turn();
    hold_ = Hold::kNone;
    Go(bar.high, true);
  } else if (lowerHigh && lowerLow) {
    Go(held.high, true);
    hold_ = Hold::kNone;
    Go(bar.low, false);
    rising_ = !rising_;
  } else if (lowerHigh && higherLow) {
    Turn();
    Go(held.low, false);
    Turn();
    Go(held.high, true);
    held_ = own;
    hold_ = Hold::kInside;
  } else if (higherHigh && lowerLow) {
    held_ = own;
  }
}

void SwingLine::SettleInside(const Ends& bar) {
  const Ends held = Seen(held_, rising_);
  const auto [higherHigh, lowerHigh, higherLow, lowerLow] = Compare(bar, held);
  const Ends own = Seen(bar, rising_);
  if (higherHigh && higherLow) {
    Turn();
    Go(held.low, false);
    Turn();
    hold_ = Hold::kNone;
    Go(bar.high, true);
  } else if (lowerHigh && lowerLow) {
    Turn();
    hold_ = Hold::kNone;
    Go(bar.low, false);
    rising_ = !rising_;
  } else if ((higherHigh && lowerLow) || (lowerHigh && higherLow)) {
    Turn();
    Go(held.low, false);
    hold_ = higherHigh ? Hold::kOutside : Hold::kInside;
    rising_ = !rising_;
  } else {
    return;
  }
  held_ = own;
}

void SwingLine::AddSized(const SwingBar& bar) {
  const Ends seen = Seen({bar.yHigh, bar.yLow}, rising_);
  const Ends last = Seen(last_, rising_);
  if (seen.high < (rising_ ? y_ : -y_)) {
    Go(seen.high, true);
    count_ = 0;
  }
  extreme_ = rising_ ? std::max(extreme_, double(bar.High)) : std::min(extreme_, double(bar.Low));
  if (!(seen.low > last.low)) return;

  bool turns = false;
  if (rule_.kind == SwingKind::kDays) {
    turns = count_ == rule_.size - 1;
    if (!turns && (count_ == 0 || count_ < rule_.size - 1)) ++count_;
  } else {
    const double move = rising_ ? extreme_ - double(bar.Low) : double(bar.High) - extreme_;
    turns = rule_.size / rule_.divisor <= move;
  }
  if (!turns) return;
  Turn();
  Go(seen.low, false);
  rising_ = !rising_;
  extreme_ = rising_ ? bar.High : bar.Low;
  count_ = 1;
}

double AverageSwing(std::span<const ChartBar> bars) {
  std::optional<double> lastEnd;
  int lastEntry = 0;
  double sum = 0;
  int count = 0;
  // Prices upside down are y: the line's own tests tell the ends of the swings.
  SwingLine line({}, [&](const SwingStroke& stroke) {
    if (stroke.x1 != stroke.x2 || stroke.entry == lastEntry) return;
    if (lastEntry != 0) {
      if (lastEnd && *lastEnd != stroke.y1) {
        sum += std::abs(*lastEnd - stroke.y1);
        ++count;
      }
      lastEnd = stroke.y1;
    }
    lastEntry = stroke.entry;
  });
  for (const ChartBar& bar : bars)
    if (bar.High != 0 && bar.Low != 0 && bar.Open != 0)
      line.Add({0, -double(bar.High), -double(bar.Low), bar.High, bar.Low});
  return count == 0 ? 5 : sum / count * 100.0;
}

}  // namespace kora
