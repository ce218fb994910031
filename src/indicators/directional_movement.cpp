#include "indicators/directional_movement.h"

#include <algorithm>
#include <cmath>

#include "indicators/osc_series.h"

namespace kora {
namespace {

double TrueRange(const ChartBar& bar, const ChartBar& before) {
  const double a = std::fabs(double(bar.High) - bar.Low);
  const double b = std::fabs(double(bar.High) - before.Close);
  const double c = std::fabs(double(bar.Low) - before.Close);
  if (a >= b && a >= c) return a;
  return b >= c ? b : c;
}

std::int16_t Percent(double ratio) { return CInt(Int(ratio * 100.0)); }

}  // namespace

DmSeries DirectionalMovement(const ChartBars& bars, int N, int M) {
  DmSeries out;
  out.rows.resize(static_cast<size_t>(bars.BarCount) + 1);
  const auto slots = static_cast<size_t>(std::max(N, 1));
  std::vector<double> plusSlots(slots), minusSlots(slots);
  RollingWindow<double, double> plusWindow(plusSlots.data(), N), minusWindow(minusSlots.data(), N);
  const double k = M > 0 ? 2.0 / (M + 1) : 0;
  double state = 0, seed = 0;
  int counted = 0;

  for (int i = 1; i <= bars.BarCount; ++i) {
    const ChartBar& bar = At(bars, i);
    const ChartBar& before = At(bars, i - 1);
    DmSeries::Row& row = At(out.rows, i);

    const double up = double(bar.High) - before.High;
    const double down = double(before.Low) - bar.Low;
    const double plus = up > 0 && up > down ? up : 0;
    const double minus = down > 0 && down > up ? down : 0;
    const double range = TrueRange(bar, before);
    const double p = range != 0 ? plus / range : 0;
    const double m = range != 0 ? minus / range : 0;

    if (N > 0) {
      minusWindow.Add(m);
      if (plusWindow.Add(p)) {
        row.plusDI = Percent(plusWindow.Total() / N);
        row.minusDI = Percent(minusWindow.Total() / N);
      }
    } else {
      row.plusDI = Percent(p);
      row.minusDI = Percent(m);
    }
    out.diTop = std::max({out.diTop, row.plusDI, row.minusDI});

    if (i >= N) {
      const double difference = double(row.plusDI) - row.minusDI;
      const double sum = double(row.plusDI) + row.minusDI;
      row.DX = CInt(std::fabs(Int((sum != 0 ? difference / sum : difference) * 100.0)));
    }
    if (i > N && M > 0) {
      if (counted < M) {
        seed += row.DX;
        if (++counted == M) state = (1 - k) * (seed / M);
      } else {
        state = (1 - k) * row.DX + (1 - k) * state;
        row.ADX = CInt(state);
      }
    }
    if (row.ADX != 0) {
      out.adxHigh = std::max(out.adxHigh, row.ADX);
      out.adxLow = std::min(out.adxLow, row.ADX);
    }
  }
  return out;
}

void ShowDirectionalMovement(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    // This panel alone has a period of its own where there is none in the settings.
    const auto orTen = [](std::int16_t period) { return period == 0 ? std::int16_t{10} : period; };
    const std::int16_t N = orTen(host.Period(kDMA));
    const std::int16_t M = orTen(host.Period(kDMXA));
    OscPanel panel(host);
    panel.Frame();

    const ChartBars& bars = host.chart.Bars;
    const DmSeries series = DirectionalMovement(bars, N, M);
    const double base = panel.PanelBottom - 10;
    const double height = base - (panel.PanelTop + 10);
    const double diScale = ScaleOf(series.diTop, height);
    if (diScale == 0) return;
    double adxScale = ScaleOf(double(series.adxHigh) - series.adxLow, height);
    if (adxScale == 0) adxScale = 1.0;

    panel.Title("Directional Movement ( " + Str(N) + " period )    ADX " + Str(M) + " period");

    if (bars.BarCount >= 0) host.LastValues = {double(At(series.rows, bars.BarCount).ADX)};
    OscTrace plus(panel.pen, 'H'), minus(panel.pen, 'L'), adx(panel.pen, 'H');
    for (int i = 0; i <= bars.BarCount; ++i) {
      const DmSeries::Row& row = At(series.rows, i);
      const double x = panel.BarX(i);
      const double plusY = base - row.plusDI / diScale;
      const double minusY = base - row.minusDI / diScale;
      plus.To(x, plusY, panel.colour(kOscUp), i > N + 1);
      minus.To(x, minusY, panel.colour(kOscDown), i > N + 1);
      if (host.settings.osc.FillIn && i > N + 1) {
        const bool plusAbove = plusY < minusY;
        panel.Line(plusAbove ? 'L' : 'V', x, minusY, x, plusY, plusAbove ? kOscUp : kOscDown);
      }
      adx.To(x, base - (double(row.ADX) - series.adxLow) / adxScale, panel.colour(kOscLine1),
             i > N + 1 + M);
    }
  });
}

}  // namespace kora
