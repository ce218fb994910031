#include "indicators/elder_ray.h"

#include <algorithm>

#include "indicators/ema_column.h"
#include "indicators/osc_series.h"

namespace kora {

ElderRaySeries ElderRay(const ChartBars& bars, int period, std::int16_t recType) {
  ElderRaySeries out;
  const std::vector<float> closes = CloseColumn(bars);
  for (auto column : {&out.ema, &out.bull, &out.bear}) column->resize(closes.size());
  EmaColumn(period, -1, 0, closes, out.ema);

  const bool closeOnly = recType >= 1 && recType <= 3;
  for (int i = period; i <= bars.BarCount; ++i) {
    const ChartBar& bar = At(bars, i);
    const double ema = At(out.ema, i);
    const float bull = CSng((closeOnly ? bar.Close : bar.High) - ema);
    const float bear = CSng((closeOnly ? bar.Close : bar.Low) - ema);
    At(out.bull, i) = bull;
    At(out.bear, i) = bear;
    out.bullHigh = std::max(out.bullHigh, bull);
    out.bullLow = std::min(out.bullLow, bull);
    out.bearHigh = std::max(out.bearHigh, bear);
    out.bearLow = std::min(out.bearLow, bear);
  }
  MakeSymmetric(out.bullHigh, out.bullLow);
  MakeSymmetric(out.bearHigh, out.bearLow);
  return out;
}

void ShowElderRay(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    const std::int16_t P = host.Period(kERA);
    if (P < 1) return;
    OscPanel panel(host);
    panel.Frame();

    const ChartBars& bars = host.chart.Bars;
    const ElderRaySeries series = ElderRay(bars, P, host.request.Name.RecType);
    const double height = panel.PanelBottom - panel.PanelTop;
    const double bullScale = ScaleOf(double(series.bullHigh) - series.bullLow, height / 2.0);
    const double bearScale = ScaleOf(double(series.bearHigh) - series.bearLow, height / 2.0);
    if (bullScale == 0 || bearScale == 0) return;

    panel.Title("Elder Ray ( " + Str(P) + "  Period )  ");
    // Parts of the frame's height, counted from the top of the panel and not of the frame.
    const std::int16_t bullY = CInt(height * 0.3);
    const std::int16_t bearY = CInt(height * 0.75);
    panel.Guide(bullY, "0.0");
    panel.Guide(bearY, "0.0");
    if (!host.SecondPass) {
      panel.Text(panel.PanelLeft + 1, bullY - 6, "Bull");
      panel.Text(panel.PanelLeft + 1, bearY - 6, "Bear");
    }

    if (bars.BarCount >= P)
      host.LastValues = {At(series.bull, bars.BarCount), At(series.bear, bars.BarCount)};
    for (int i = P; i <= bars.BarCount; ++i) {
      const double x = panel.BarX(i);
      panel.Line('L', x, bullY, x, bullY - At(series.bull, i) / bullScale, kOscUp);
      panel.Line('L', x, bearY, x, bearY - At(series.bear, i) / bearScale, kOscDown);
    }
  });
}

}  // namespace kora
