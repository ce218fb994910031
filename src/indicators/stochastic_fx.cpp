#include "indicators/stochastic_fx.h"

#include <algorithm>
#include <optional>
#include <string>
#include <vector>

#include "base/numbers.h"
#include "indicators/osc_series.h"

namespace kora {
namespace {

constexpr double kPanelUnits = 144;

struct Form {
  std::int16_t K, D;
  bool stochastic, slow, reversed;
  bool average;  // the %D line of the fast form
  int line1, line2, line3;
  std::string title;
};

Form FormOf(OscHost& host) {
  Form form{};
  form.stochastic = host.OscCode == "STO";
  const bool overRoc = host.OscCode == "R/F";
  if (!form.stochastic) host.SlowStochastic = false;
  form.slow = host.SlowStochastic;
  form.K = host.Period(form.stochastic ? kStochK : kFXF);
  form.D = host.Period(form.stochastic ? kStochD : kFXX);
  form.reversed = !form.stochastic && host.settings.osc.FXRev;
  form.average = form.D > 0 && (!overRoc || host.settings.osc.RFAve);
  form.line1 = overRoc ? kOscLine3 : kOscLine1;
  form.line2 = overRoc ? kOscLine4 : kOscLine2;
  form.line3 = kOscLine3;
  const std::string k = Str(std::int32_t(form.K)), d = Str(std::int32_t(form.D));
  if (form.stochastic)
    form.title = (form.slow ? "SLOW " : "") + ("Stochastic Oscillator (K=" + k) +
                 " Period  D=" + d + " Period)";
  else
    form.title = "FX Oscillator (F=" + k + " Period  X=" + d + " Period)";
  return form;
}

// The last D values of a column, zeros at the start.
template <typename T>
class Rows {
 public:
  Rows(int D, int bars) : D_(D > 0 ? size_t(D) : 0) {
    values_.reserve(D_ + size_t(bars));
    values_.resize(D_);
  }
  void Shift(T value) { values_.push_back(value); }
  double Sum() const {
    double sum = 0;
    for (size_t i = values_.size() - D_; i < values_.size(); ++i) sum += values_[i];
    return sum;
  }

 private:
  size_t D_;
  std::vector<T> values_;
};

// A signal on the price picture: screen only.
void Arrow(OscHost& host, double x, bool buy) {
  const Colour colour = host.colour(buy ? 10 : 12);
  const double tail = buy ? 48 : 40, tip = buy ? 40 : 48, head = buy ? 43 : 45;
  host.price.SetDrawWidth(3);
  host.price.Line(x, tail, x, tip, colour);
  host.price.Line(x, tip, x - 3, head, colour);
  host.price.Line(x, tip, x + 3, head, colour);
  host.price.SetDrawWidth(1);
}

void Draw(OscHost& host, int& bar) {
  const Form form = FormOf(host);
  if (form.K == 0) return;
  const ChartBars& bars = host.chart.Bars;
  const int last = LastBar(bars);
  Rows<float> aboveLow(form.D, last + 1), range(form.D, last + 1);
  Rows<std::int32_t> slow(form.D, last + 1);

  OscPanel panel(host, kPanelUnits);
  panel.Frame();
  panel.Title(form.title);

  const double floor = panel.PanelBottom - 20;
  const double percentPerY = Divide(100, floor - (panel.PanelTop + 20));
  const auto yOf = [&](double v) { return floor - Divide(v, percentPerY); };
  panel.Guide(CInt(yOf(25)), form.reversed ? " 75%" : " 25%");
  panel.Guide(CInt(yOf(75)), form.reversed ? " 25%" : " 75%");
  const bool signals = host.settings.words.StochSignals;
  const std::int16_t y20 = CInt(yOf(20)), y90 = CInt(yOf(90));
  if (signals && !host.SecondPass) {
    for (const double y : {double(CInt(yOf(10))), double(y90)})
      host.panel.Line(panel.PanelLeft, y, panel.PanelRight, y, host.colour(kBorder));
  }

  const std::vector<PriceRange> ranges = StochasticRanges(bars, host.request.Name.RecType, form.K);
  const auto plotY = [&](double v) { return CLng(yOf(form.reversed ? 100 - v : v)); };
  double previousX = 0;
  std::int32_t previousKY = 0, previousDY = 0, previousThirdY = 0;
  std::optional<std::int32_t> lastValue;
  int zone = 0, previousZone = 0;  // 1 above the 90% line, 2 between, 3 below the 20% line
  for (bar = std::max(0, form.K + 1); bar <= last; ++bar) {
    const double x = CInt(panel.PanelLeft + double(bar) * host.chart.BarSpacing);
    const PriceRange window = ranges[size_t(bar)];
    const float above = bars[size_t(bar)].Close - window.Lowest;
    const float height = window.Highest - window.Lowest;
    const std::int32_t percentK = CLng((height != 0 ? double(above) / height : above) * 100.0);

    lastValue = percentK;
    std::int32_t kY = plotY(percentK), dY = 0, thirdY = 0;
    if (form.D > 0) {
      aboveLow.Shift(above);
      range.Shift(height);
      const double a = aboveLow.Sum(), b = range.Sum();
      const std::int32_t percentD = CLng((b != 0 ? a / b : a) * 100.0);
      if (form.slow) lastValue = percentD;
      dY = plotY(percentD);
      if (form.slow) {
        slow.Shift(percentD);
        thirdY = plotY(CLng(slow.Sum() / form.D));
      }
    }

    const auto dotted = [&](double fromY, double toY, int entry) {
      const Segment s{previousX, fromY, x, toY, host.colour(entry)};
      panel.pen.LineStyled(DrawStyle::kDot, s, 'D', s);
    };
    if (form.slow) {
      if (previousDY != 0) panel.Line('L', previousX, previousDY, x, dY, form.line1);
      if (form.D > 0 && bar > form.K + form.D) dotted(previousThirdY, thirdY, form.line3);
    } else {
      if (previousKY != 0) panel.Line('L', previousX, previousKY, x, kY, form.line1);
      if (form.average && previousDY != 0) dotted(previousDY, dY, form.line2);
    }

    if (signals && form.stochastic) {
      zone = dY > y20 + 3 ? 3 : dY < y90 ? 1 : 2;
      if (zone == 2 && (previousZone == 1 || previousZone == 3))
        Arrow(host, previousX, previousZone == 3);
      previousZone = zone;
    }
    previousX = x;
    previousKY = kY;
    previousDY = dY;
    previousThirdY = thirdY;
  }
  if (lastValue) host.LastValues.push_back(*lastValue);
}

}  // namespace

std::vector<PriceRange> StochasticRanges(const ChartBars& bars, std::int16_t recType, int K) {
  constexpr PriceRange kStart{0.0f, 100000.0f};
  const int last = LastBar(bars);
  std::vector<PriceRange> ranges(size_t(last + 1), kStart);
  if (K < 0) return ranges;
  const bool ranged = recType > kAdvanceDecline;
  SlidingRange window(last + 1);
  for (int i = 0; i <= last; ++i) {
    const ChartBar& bar = bars[size_t(i)];
    window.Add(i, ranged && bar.High != 0 ? bar.High : bar.Close,
               ranged && bar.Low != 0 ? bar.Low : bar.Close);
    if (i > K) ranges[size_t(i)] = window.Since(i - K, kStart);
  }
  return ranges;
}

void ShowStochasticFX(OscHost& host) {
  int bar = -1;
  RunOscillator(
      host, "FX", true, [&] { Draw(host, bar); },
      [&] {
        const ChartBars& bars = host.chart.Bars;
        return bar >= 0 && bar <= LastBar(bars) ? std::string(bars[size_t(bar)].date())
                                                : std::string();
      });
}

}  // namespace kora
