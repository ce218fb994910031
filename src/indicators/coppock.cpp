#include "indicators/coppock.h"

#include <algorithm>

#include "indicators/osc_series.h"
#include "indicators/value_frame.h"

namespace kora {

CoppockSeries Coppock(const ChartBars& bars, int period) {
  CoppockSeries out;
  out.smoothed.resize(static_cast<size_t>(bars.BarCount) + 1);
  const double k = 2.0 / (period + 1);
  std::int16_t state = 0;
  for (int i = period; i <= bars.BarCount; ++i) {
    std::int16_t& value = At(out.smoothed, i);
    const double close = At(bars, i).Close;
    const double longAgo = At(bars, i - period).Close;
    const double lessLongAgo = At(bars, i - (period - 1)).Close;
    if (i > period && close != 0 && longAgo != 0 && lessLongAgo != 0) {
      const double raw =
          (close - longAgo) / longAgo * 100.0 + (close - lessLongAgo) / lessLongAgo * 100.0;
      state = CInt(raw * k + (1 - k) * state);
      value = state;
    }
    out.highest = std::max<std::int32_t>(out.highest, value);
    out.lowest = std::min<std::int32_t>(out.lowest, value);
  }
  return out;
}

void ShowCoppock(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    const std::int16_t P = host.Period(kCopD);
    const ChartBars& bars = host.chart.Bars;
    if (P < 1 || bars.BarCount <= 1) return;
    OscPanel panel(host);
    panel.Frame();

    const CoppockSeries series = Coppock(bars, P);
    const ValueFrame frame(panel, series.highest, series.lowest);
    if (frame.Empty()) return;

    panel.Title("Coppock    " + Str(P) + " Period");
    frame.DrawLines(panel, Str(series.highest), Str(series.lowest));

    host.LastValues = {double(At(series.smoothed, bars.BarCount))};
    OscTrace line(panel.pen, 'H');
    for (int i = 1; i <= bars.BarCount; ++i) {
      const std::int16_t value = At(series.smoothed, i);
      if (value != 0) line.To(panel.BarX(i), frame.Y(value), panel.colour(kOscLine1), i > P + 2);
    }
  });
}

}  // namespace kora
