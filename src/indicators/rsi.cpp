#include "indicators/rsi.h"

#include "indicators/osc_series.h"

namespace kora {

double RsiAt(const ChartBars& bars, int i, int period) {
  double gains = 0, losses = 0;
  bool fell = false;
  if (i >= period) {
    for (int k = period; k >= 2; --k) {
      const double a = At(bars, i - k).Close;
      const double b = At(bars, i - k + 1).Close;
      if (a == 0) continue;
      if (a < b) {
        gains += b - a;
      } else if (a > b) {
        losses += a - b;
        fell = true;
      }
    }
  }
  const double averageGain = gains / period;
  double averageLoss = fell ? losses / period : 0;
  if (averageLoss == 0) averageLoss = 1;
  // Neither sum is ever negative, so that 1 + RS is never 0.
  return 100 - 100 / (1 + averageGain / averageLoss);
}

void ShowRSI(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    const std::int16_t P = host.Period(kRsiP);
    if (P < 1) return;
    OscPanel panel(host);
    panel.Frame();
    const double height = panel.PanelBottom - panel.PanelTop - 20;
    const double top = panel.PanelTop + 10;
    const double unit = height / 100.0;
    if (unit == 0) return;

    panel.Title("Relative Strength Index Oscillator (" + Str(P) + " Period)");
    panel.Guide(CInt(height * 0.3 + top), "70%");
    panel.Guide(CInt(height * 0.7 + top), "30%");
    panel.Guide(CInt(height * 0.5 + top), "50%");

    const ChartBars& bars = host.chart.Bars;
    OscTrace line(panel.pen, 'H');
    int values = 0;
    if (bars.BarCount >= P) host.LastValues = {RsiAt(bars, bars.BarCount, P)};
    for (int i = P - 1; i <= bars.BarCount; ++i) {
      const float y = CSng((panel.PanelBottom - 10) - RsiAt(bars, i, P) * unit);
      // The line ends for the first time at the fourth value: the first has no window yet.
      line.To(panel.BarX(i), y, panel.colour(kOscLine1), ++values > 3);
    }
  });
}

}  // namespace kora
