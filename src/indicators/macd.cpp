#include "indicators/macd.h"

#include <algorithm>

#include "indicators/ema_column.h"
#include "indicators/osc_series.h"

namespace kora {
namespace {

// The two averages on the price picture. One that starts from a y of 0 has no line yet.
class PriceAverages {
 public:
  PriceAverages(OscHost& host, const MacdSeries& series)
      : host_(host),
        series_(series),
        pen_(host.price, host.request.SuppressScript ? nullptr : host.script) {}

  void Bar(int i) {
    const Composition& chart = host_.chart;
    if (i < series_.firstEma1) return;
    const double x = CInt(chart.FirstBarX + double(i) * chart.BarSpacing);
    const std::int16_t y1 = chart.Price.Y(At(series_.ema1, i));
    ema1_.To(x, y1, host_.colour(kOscUp), ema1_.y() != 0);
    if (i < series_.firstDifference) return;
    const std::int16_t y2 = chart.Price.Y(At(series_.ema2, i));
    // Judged by the place on the screen, where a smaller y is higher.
    ema2_.To(x, y2, host_.colour(y2 >= y1 ? kOscUp : kOscDown), ema2_.y() != 0);
  }

 private:
  OscHost& host_;
  const MacdSeries& series_;
  ChartPen pen_;
  OscTrace ema1_{pen_, 'L'}, ema2_{pen_, 'L'};
};

}  // namespace

MacdSeries Macd(const ChartBars& bars, int n1, int n2, int n3) {
  MacdSeries out;
  const std::vector<float> closes = CloseColumn(bars);
  for (auto column : {&out.ema1, &out.ema2, &out.difference, &out.signal})
    column->resize(closes.size());
  out.firstEma1 = n1 - 1;
  out.firstDifference = n1 + n2 - 1;
  out.firstSignal = n1 + n2 + n3 - 1;

  EmaColumn(n1, -1, 0, closes, out.ema1);
  EmaColumn(n2, n1 - 1, n1, closes, out.ema2);
  for (int i = out.firstDifference; i <= bars.BarCount; ++i)
    At(out.difference, i) = CSng(double(At(out.ema1, i)) - At(out.ema2, i));
  EmaColumn(n3, out.firstDifference, out.firstDifference, out.difference, out.signal);

  for (int i = out.firstSignal; i <= bars.BarCount; ++i) {
    const float v = CSng(double(At(out.difference, i)) - At(out.signal, i));
    out.highest = std::max(out.highest, v);
    out.lowest = std::min(out.lowest, v);
  }
  MakeSymmetric(out.highest, out.lowest);
  return out;
}

void ShowMACD(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    const std::int16_t n1 = host.Period(kMd1);
    const std::int16_t n2 = host.Period(kMd2);
    const std::int16_t n3 = host.Period(kMd3);
    const ChartBars& bars = host.chart.Bars;
    if (n1 < 1 || n2 < 1 || n3 < 1 || bars.BarCount < 1) return;
    OscPanel panel(host);
    panel.Frame();

    const MacdSeries series = Macd(bars, n1, n2, n3);
    const double base = panel.PanelBottom - 10;
    const double scale =
        ScaleOf(double(series.highest) - series.lowest, base - (panel.PanelTop + 10));
    if (scale == 0) return;
    const auto yOf = [&](double v) { return base - (v - series.lowest) / scale; };

    panel.Title("MACD ( " + Str(n1) + " / " + Str(n2) + " / " + Str(n3) + "  Period )  ");
    // The middle of the frame's height, counted from the top of the panel and not of the frame.
    const std::int16_t zeroY = CInt((panel.PanelBottom - panel.PanelTop) / 2.0);
    panel.Guide(zeroY, "0.0");
    for (const double v :
         {double(series.highest), series.highest * 0.5, double(series.lowest), series.lowest * 0.5})
      panel.Guide(yOf(v), Format(v, "####.00"));

    if (bars.BarCount > series.firstSignal)
      host.LastValues = {double(At(series.difference, bars.BarCount)) -
                         At(series.signal, bars.BarCount)};
    PriceAverages averages(host, series);
    const bool onPrice = host.OscCaller != "ANAL";
    for (int i = 0; i <= bars.BarCount; ++i) {
      if (onPrice) averages.Bar(i);
      // The first signal's own bar has no histogram.
      if (i <= series.firstSignal) continue;
      const double x = panel.BarX(i);
      const double d = (double(At(series.difference, i)) - At(series.signal, i)) / scale;
      panel.Line('H', x, zeroY, x, base - ((zeroY + d) - 10), kMacdColour);
    }
  });
}

}  // namespace kora
