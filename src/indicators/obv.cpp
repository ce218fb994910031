#include "indicators/obv.h"

#include <algorithm>

#include "indicators/osc_series.h"

namespace kora {
namespace {

constexpr std::int32_t kStart = 100000;

// Lines at the quarters of the height with the totals that stand there, from the lowest at the
// bottom up. The line at the top stops short of its text.
void DrawScale(OscPanel& panel, const ObvSeries& series, double top, double unit) {
  if (panel.host.SecondPass) return;
  for (int level = 100; level >= 0; level -= 25) {
    const double y = top + unit * level;
    const double total = series.highest - (double(series.highest) - series.lowest) * level / 100.0;
    const std::string label = Format(total / 1000.0, "##.#") + "k";
    const double x = panel.PanelLeft + (level == 0 ? panel.TextWidth(label) + 10 : 0);
    panel.Line(level % 50 == 0 ? 'L' : 'E', x, y, panel.PanelRight, y, kBorder);
    panel.Label(y, label);
  }
}

void DrawNoVolume(OscPanel& panel) {
  const double x = panel.PanelLeft + 2, y = panel.PanelTop + 30;
  panel.TextPair(x, panel.host.SecondPass ? x + 250 : x, y, "No Volume Data");
}

}  // namespace

ObvSeries OnBalanceVolume(const ChartBars& bars, int& bar) {
  ObvSeries out;
  out.totals.resize(static_cast<size_t>(bars.BarCount) + 1);
  if (bars.BarCount <= 1) return out;
  for (bar = 1; bar <= bars.BarCount; ++bar) {
    const ChartBar& now = At(bars, bar);
    const ChartBar& before = At(bars, bar - 1);
    if (now.Close == 0 || before.Close == 0) continue;
    if (now.Close > before.Close)
      out.total = CLng(double(out.total) + now.Volume);
    else if (now.Close < before.Close)
      out.total = CLng(double(out.total) - now.Volume);
    out.highest = std::max(out.highest, out.total);
    out.lowest = std::min(out.lowest, out.total);
    At(out.totals, bar) = out.total;
  }
  return out;
}

void ShowOBV(OscHost& host) {
  int bar = 0;
  const ChartBars& bars = host.chart.Bars;
  const auto draw = [&] {
    OscPanel panel(host);
    panel.Frame();
    panel.Title("On-Balance Volume (base 10000)");

    const ObvSeries series = OnBalanceVolume(bars, bar);
    if (series.total == kStart && series.highest == kStart && series.lowest == kStart) {
      DrawNoVolume(panel);
      return;
    }
    const double margin = ((panel.PanelBottom - panel.PanelTop) / 100.0) * 10.0;
    const double top = panel.PanelTop + margin;
    const double base = panel.PanelBottom - margin;
    DrawScale(panel, series, top, (base - top) / 100.0);
    const double scale = ScaleOf(double(series.highest) - series.lowest, CInt(base - top));
    if (scale == 0) return;

    host.LastValues = {double(series.total)};
    OscTrace line(panel.pen, 'H');
    int points = 0;
    for (bar = 1; bar <= bars.BarCount; ++bar) {
      const std::int32_t total = At(series.totals, bar);
      if (total == 0) continue;
      const double y = CInt(base - (double(total) - series.lowest) / scale);
      line.To(panel.BarX(bar), y, panel.colour(y < line.y() ? kOscUp : kOscDown), ++points > 2);
    }
  };
  const auto date = [&] {
    return bar <= bars.BarCount ? std::string(At(bars, bar).date()) : std::string();
  };
  RunOscillator(host, "OBV", true, draw, date, "FX");
}

}  // namespace kora
