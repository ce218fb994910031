#include "indicators/roc_momentum.h"

#include <algorithm>
#include <string>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "indicators/osc_series.h"

namespace kora {
namespace {

template <typename Value>
ChangeSeries SeriesOf(const ChartBars& bars, int P, Value value) {
  ChangeSeries series;
  const int last = LastBar(bars);
  series.V.resize(size_t(last + 1));
  std::int32_t v = 0;
  for (int i = 0; i <= last; ++i) {
    if (i > P) {
      if (i - P > last) throw RunTimeError(kIndexOutOfRange);
      const float close = bars[size_t(i)].Close, before = bars[size_t(i - P)].Close;
      if (close != 0 && before != 0) v = value(close, before);
    }
    series.Highest = std::max<double>(series.Highest, v);
    series.Lowest = std::min<double>(series.Lowest, v);
    series.V[size_t(i)] = v;
  }
  MakeSymmetric(series.Highest, series.Lowest);
  return series;
}

struct Form {
  std::int16_t P;
  ChangeSeries (*values)(const ChartBars& bars, int P);
  std::string title, zeroLabel;
  std::int16_t A;    // slots of the average, 0 none
  bool averageLine;  // the average is drawn
};

void Draw(OscHost& host, const Form& form) {
  OscPanel panel(host);
  panel.Frame();

  const ChangeSeries series = form.values(host.chart.Bars, form.P);
  const double floor = panel.PanelBottom - 10;
  const double height = floor - (panel.PanelTop + 10);
  const double scale = Divide(series.Highest - series.Lowest, height);
  if (scale == 0) return;
  const auto yOf = [&](double v) { return CInt(floor - (v - series.Lowest) / scale); };

  panel.Title(form.title);
  const auto guide = [&](double v, const std::string& label) {
    const double y = yOf(v);
    const Segment s{double(panel.PanelLeft), y, double(panel.PanelRight), y, host.colour(kBorder)};
    panel.pen.LineStyled(DrawStyle::kDot, s, 'L', s);
    panel.Label(y, label);
  };
  guide(0, form.zeroLabel);
  guide(CLng(series.Highest * 0.8), "+80%");
  guide(CLng(series.Lowest * 0.8), "-80%");

  if (!series.V.empty()) host.LastValues.push_back(series.V.back());
  std::vector<std::int16_t> slots(size_t(form.A));
  RollingWindow<std::int16_t, std::int32_t> window(slots.data(), form.A);
  const double spacing = host.chart.BarSpacing;
  std::int16_t previousY = 0, previousAverageY = 0;
  panel.PlotX = panel.PanelLeft - spacing;
  for (int i = 0; i < int(series.V.size()); ++i) {
    panel.PlotX = CInt(panel.PlotX + spacing);
    const std::int16_t y = yOf(series.V[size_t(i)]);
    if (i > form.P) panel.Line('H', panel.PlotX - spacing, previousY, panel.PlotX, y, kOscLine1);
    if (form.A > 0 && window.Add(y)) {
      const std::int16_t averageY = AverageY(window);
      if (form.averageLine && i >= form.A)
        panel.Line('L', panel.PlotX - spacing, previousAverageY, panel.PlotX, averageY, kOscLine2);
      previousAverageY = averageY;
    }
    previousY = y;
  }
}

}  // namespace

ChangeSeries RocSeries(const ChartBars& bars, int P) {
  return SeriesOf(bars, P, [](float close, float before) {
    return std::int32_t(CInt(double(close - before) / close * 100.0));
  });
}

ChangeSeries MomentumSeries(const ChartBars& bars, int P) {
  return SeriesOf(bars, P,
                  [](float close, float before) { return CLng((close - before) * 100.0); });
}

void ShowROC(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&] {
    const std::int16_t P = host.Period(kRocP);
    if (P == 0) return;
    const std::int16_t A = host.Period(kRocA);
    const bool plain = host.OscCode == "R/F" && !host.settings.osc.RFAve;
    std::string title = "Rate of Change Oscillator (" + Str(std::int32_t(P)) + " Period)";
    if (!plain) title += "  " + Str(std::int32_t(A)) + " Ave";
    Draw(host, {P, RocSeries, title, "  0%", std::max<std::int16_t>(A, 0), !plain});
  });
}

void ShowMomentum(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&] {
    const std::int16_t P = host.Period(kMMA);
    if (P == 0) return;
    const std::string title = "Momentum Oscillator (" + Str(std::int32_t(P)) + " Period)  0 Ave";
    Draw(host, {P, MomentumSeries, title, "0%", 0, false});
  });
}

}  // namespace kora
