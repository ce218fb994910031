#include "indicators/holy_grail.h"

#include <algorithm>

#include "base/runtime_error.h"
#include "indicators/osc_series.h"
#include "indicators/value_frame.h"

namespace kora {
namespace {

constexpr int kTrend = 3;  // bars of the average that is taken off

double MeanOfLast(const std::vector<double>& column, int i, int period) {
  double sum = 0;
  for (int j = 1; j <= period; ++j) sum += At(column, i - (period - j));
  return sum / period;
}

// A bar whose y can't be had keeps the last one.
void TakeY(const ValueFrame& frame, double value, std::int16_t& y) {
  try {
    y = frame.Y(value);
  } catch (const RunTimeError& e) {
    if (e.number() != kOverflow) throw;
  }
}

}  // namespace

HolyGrailSeries HolyGrail(const ChartBars& bars, int period) {
  HolyGrailSeries out;
  const auto count = static_cast<size_t>(bars.BarCount) + 1;
  for (auto column : {&out.detrended, &out.first, &out.second}) column->resize(count);
  for (int i = 0; i <= bars.BarCount; ++i) At(out.detrended, i) = At(bars, i).Close;
  for (int i = kTrend; i <= bars.BarCount; ++i)
    At(out.first, i) = MeanOfLast(out.detrended, i, kTrend);
  for (int i = kTrend; i <= bars.BarCount; ++i) At(out.detrended, i) -= At(out.first, i);

  const int firstAverage = period + kTrend - 1;
  for (int i = firstAverage; i <= bars.BarCount; ++i) {
    const double mean = MeanOfLast(out.detrended, i, period);
    At(out.first, i) = mean;
    if (mean == 0) continue;
    out.highest = std::max(out.highest, mean);
    out.lowest = std::min(out.lowest, mean);
  }
  for (int i = firstAverage + period + kTrend - 1; i <= bars.BarCount; ++i)
    At(out.second, i) = MeanOfLast(out.first, i, period);
  return out;
}

void ShowHolyGrail(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&host] {
    const std::int16_t P = host.Period(kHolyD);
    const ChartBars& bars = host.chart.Bars;
    if (P < 1 || bars.BarCount <= P) return;
    OscPanel panel(host);
    panel.Frame();

    const HolyGrailSeries series = HolyGrail(bars, P);
    const ValueFrame frame(panel, series.highest, series.lowest);
    if (frame.Empty()) return;

    panel.Title("Jones Holy Grail    " + Str(P) + " Period");
    frame.DrawLines(panel, Format(series.highest, "0.000"), Format(series.lowest, "0.000"));

    host.LastValues = {At(series.first, bars.BarCount)};
    OscTrace first(panel.pen, 'H'), second(panel.pen, 'L');
    std::int16_t firstY = 0, secondY = 0;
    double previousX = panel.PlotX;
    // PlotX grows from here on only, so that the lines stand P bars left of the prices.
    for (int i = P + 1; i <= bars.BarCount; ++i) {
      panel.PlotX = CInt(panel.PlotX + host.chart.BarSpacing);
      if (At(series.detrended, i) != 0) {
        TakeY(frame, At(series.first, i), firstY);
        TakeY(frame, At(series.second, i), secondY);
      }
      // A y of 0: none was had so far.
      first.To(panel.PlotX, firstY, panel.colour(kOscLine1),
               i > P + kTrend + 2 && previousX > panel.PanelLeft && first.y() != 0);
      second.To(panel.PlotX, secondY, panel.colour(kOscLine2),
                i > 2 * P + kTrend + 2 && second.y() != 0);
      previousX = panel.PlotX;
    }
  });
}

}  // namespace kora
