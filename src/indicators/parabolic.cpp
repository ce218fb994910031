#include "indicators/parabolic.h"

#include "chart/chart_canvas.h"
#include "indicators/osc_series.h"

namespace kora {
namespace {

constexpr float kNoHigh = 0.0f;
constexpr float kNoLow = 100000.0f;

// Finds the first trend. False when the data end before there is one.
bool FindTrend(std::span<const HighLow> bars, ParabolicTrail& trail) {
  float high = kNoHigh, low = kNoLow;
  int ups = 0, downs = 0;
  int lastUp = 0, lastDown = 0;
  for (int i = 0; i < static_cast<int>(bars.size()); ++i) {
    const HighLow& bar = At(bars, i);
    char direction = 'N';
    if (bar.high > high) {
      high = bar.high;
      ++ups;
      lastUp = i;
      direction = 'U';
    }
    if (bar.low < low) {
      low = bar.low;
      ++downs;
      lastDown = i;
      direction = 'D';
    }
    if (i == 0) continue;
    if (direction == 'U' && ups > 1) {
      downs = 0;
      if (ups > 3) {
        trail.trend = 'U';
        trail.startBar = lastDown;
        trail.startStop = At(bars, lastDown).low;
        return true;
      }
    } else if (direction == 'D' && downs > 1) {
      ups = 0;
      if (downs > 3) {
        trail.trend = 'D';
        trail.startBar = lastUp;
        trail.startStop = At(bars, lastUp).high;
        return true;
      }
    }
  }
  return false;
}

class Stop {
 public:
  explicit Stop(const ParabolicTrail& trail)
      : trend_(trail.trend), stop_(trail.startStop), previous_(stop_), high_(stop_), low_(stop_) {}

  ParabolicStep Next(const HighLow& bar, const HighLow& before) {
    const bool point = trend_ == 'U' ? Up(bar, before) : Down(bar, before);
    previous_ = stop_;
    return {stop_, trend_, point};
  }

 private:
  bool Up(const HighLow& bar, const HighLow& before) {
    if (bar.high < stop_) {
      TurnDown();
      return true;
    }
    if (bar.high > high_) high_ = bar.high;
    Grow();
    MoveTo(bar.high);
    bool turned = stop_ > bar.high;
    if (!turned && stop_ > bar.low) {
      MoveTo(bar.low < before.low ? bar.low : before.low);
      turned = stop_ < previous_;
    }
    if (!turned) return true;
    TurnDown();
    high_ = kNoHigh;
    return false;
  }

  bool Down(const HighLow& bar, const HighLow& before) {
    if (bar.low > stop_) {
      TurnUp();
      return true;
    }
    if (bar.low < low_) low_ = bar.low;
    Grow();
    MoveTo(bar.low);
    bool turned = stop_ < bar.low;
    if (!turned && stop_ < bar.high) {
      MoveTo(bar.high > before.high ? bar.high : before.high);
      turned = stop_ > previous_;
    }
    if (!turned) return true;
    TurnUp();
    low_ = kNoLow;
    return false;
  }

  void TurnDown() {
    trend_ = 'D';
    stop_ = low_ = high_;
    factor_ = 0.0f;
  }
  void TurnUp() {
    trend_ = 'U';
    stop_ = high_ = low_;
    factor_ = 0.0f;
  }
  void Grow() {
    if (0.18 > factor_) factor_ = CSng(factor_ + 0.02);
  }
  void MoveTo(float target) { stop_ = CSng((double(target) - stop_) * factor_ + stop_); }

  char trend_;
  float stop_, previous_;
  float high_, low_;  // extremes since the last reversal
  float factor_ = 0.0f;
};

// The price picture as the trails draw on it: the script goes on behind the chart, and points
// are two units wide until the trail ends, whatever ends it.
class TrailPen {
 public:
  explicit TrailPen(OscHost& host)
      : host_(host), pen_(host.price, host.request.SuppressScript ? nullptr : host.script) {
    ResumeScript(host);
    host.price.SetDrawStyle(DrawStyle::kSolid);
    host.price.SetDrawWidth(2);
  }
  ~TrailPen() { host_.price.SetDrawWidth(1); }
  TrailPen(const TrailPen&) = delete;
  TrailPen& operator=(const TrailPen&) = delete;

  // The script has a colour of its own: paper shows the trails as oscillator lines.
  void Point(double x, double y, int screenEntry, int scriptEntry) {
    host_.price.PSet(x, y, host_.colour(screenEntry));
    pen_.ScriptPoint('K', x, y, host_.colour(scriptEntry));
  }

  void LastStop(float stop) {
    const ChartCanvas canvas{pen_, host_.request, host_.settings.fonts, host_.colours, host_.chart};
    const std::string text =
        "Parabolic last stop : " + Format(stop, stop < 0.20 ? "0.000" : "0.00");
    const double width = canvas.TextWidth(canvas.Font1(ChartCanvas::kSmallText), text);
    canvas.SmallText(host_.chart.ChartRight - width, 50, text, host_.colour(kScalesText));
  }

 private:
  OscHost& host_;
  ChartPen pen_;
};

double PriceX(const Composition& chart, int bar) {
  return CInt(chart.FirstBarX + double(bar) * chart.BarSpacing);
}

}  // namespace

ParabolicTrail Parabolic(std::span<const HighLow> bars) {
  ParabolicTrail trail;
  if (!FindTrend(bars, trail)) return trail;
  trail.steps.resize(bars.size());
  Stop stop(trail);
  for (int i = trail.startBar + 1; i < static_cast<int>(bars.size()); ++i)
    At(trail.steps, i) = stop.Next(At(bars, i), At(bars, i - 1));
  return trail;
}

void ShowParabolic(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    const ChartBars& bars = host.chart.Bars;
    std::vector<HighLow> prices(static_cast<size_t>(bars.BarCount) + 1);
    for (int i = 0; i <= bars.BarCount; ++i) At(prices, i) = {At(bars, i).High, At(bars, i).Low};
    const ParabolicTrail trail = Parabolic(prices);
    if (trail.trend == 'N') return;

    TrailPen pen(host);
    for (int i = trail.startBar + 1; i <= bars.BarCount; ++i) {
      const ParabolicStep& step = At(trail.steps, i);
      if (step.point && step.stop > 0) {
        const std::int16_t y = host.chart.Price.Y(step.stop);
        const bool up = step.trend == 'U';
        if (y != 0)
          pen.Point(PriceX(host.chart, i), y, up ? kOscUp : kOscDown, up ? kOscLine1 : kOscLine2);
      }
      if (i == bars.BarCount) pen.LastStop(step.stop);
    }
  });
}

void ShowParabolicOnAverage(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    constexpr int kLength = 21;
    const std::vector<std::int16_t>& closeY = host.chart.CloseY;
    const int count = host.chart.CloseYCount();
    if (count < kLength) return;
    // y grows downward: trend "U" of the trail is a falling price.
    std::vector<HighLow> averages;
    averages.reserve(closeY.size());
    std::int16_t slots[kLength];
    RollingWindow<std::int16_t, std::int32_t> window(slots, kLength);
    for (int i = 0; i < count; ++i) {
      if (!window.Add(At(closeY, i))) continue;
      const std::int16_t average = CInt(window.Total() / double(kLength));
      averages.push_back({float(average), float(average)});
    }
    const ParabolicTrail trail = Parabolic(averages);
    if (trail.trend == 'N') return;

    TrailPen pen(host);
    for (int i = trail.startBar + 1; i < static_cast<int>(averages.size()); ++i) {
      const ParabolicStep& step = At(trail.steps, i);
      if (step.point)
        pen.Point(PriceX(host.chart, i + kLength - 1), step.stop, kOscLine1, kOscLine1);
    }
  });
}

}  // namespace kora
