#include "indicators/volatility.h"

#include <algorithm>
#include <cmath>

#include "indicators/osc_series.h"

namespace kora {

VolatilitySeries Volatility(const ChartBars& bars, int period) {
  VolatilitySeries out;
  out.rows.resize(static_cast<size_t>(bars.BarCount) + 1);
  float v = 0;
  int filled = 0;
  for (int i = 0; i <= bars.BarCount; ++i) {
    const ChartBar& bar = At(bars, i);
    VolatilitySeries::Row& row = At(out.rows, i);
    if (bar.Close > 0) {
      const auto fresh = static_cast<float>((double(bar.High) - bar.Low) / bar.Close * 100.0);
      if (std::isfinite(fresh)) v = fresh;
    }
    if (v > 0) {
      row.value = v;
      out.highest = std::max(out.highest, v);
      out.lowest = std::min(out.lowest, v);
    } else if (i > 0) {
      row.value = 1.0f;
    }

    if (row.value == 0) continue;
    if (filled < period) ++filled;
    if (filled < period) continue;
    double sum = 0;
    for (int j = 1; j <= period; ++j) sum += At(out.rows, i - (period - j)).value;
    row.average = CSng(sum / period);
  }
  return out;
}

void ShowVolatility(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    const std::int16_t P = host.Period(kVtyD);
    if (P < 1) return;
    OscPanel panel(host);
    panel.Frame();
    const double height = panel.PanelBottom - panel.PanelTop - 20;
    const double top = panel.PanelTop + 10;
    const double base = panel.PanelBottom - 10;
    if (height == 0) return;

    // Places on the panel; the values have a scale of their own.
    panel.Title("Volatility (" + Str(P) + " Period)");
    panel.Guide(CInt(height * 0.2 + top), "80%");
    panel.Guide(CInt(height * 0.8 + top), "20%");
    panel.Guide(CInt(height * 0.5 + top), "50%");

    const ChartBars& bars = host.chart.Bars;
    const VolatilitySeries series = Volatility(bars, P);
    const double scale = ScaleOf(double(series.highest) - series.lowest, base - top);
    if (scale == 0) return;
    const auto yOf = [&](float v) { return base - (double(v) - series.lowest) / scale; };

    if (bars.BarCount >= 0) host.LastValues = {At(series.rows, bars.BarCount).value};
    OscTrace average(panel.pen, 'L');
    for (int i = 0; i <= bars.BarCount; ++i) {
      const VolatilitySeries::Row& row = At(series.rows, i);
      if (row.value == 0) continue;
      const double x = panel.BarX(i);
      const double y = yOf(row.value);
      if (y <= base) panel.Line('H', x, base, x, y, kVolatility1);
      if (row.average != 0) average.To(x, yOf(row.average), panel.colour(kVolatility2));
    }
  });
}

}  // namespace kora
