#include "base/numbers.h"
#include "chart/styles/price_plot.h"

namespace kora {

void DrawLine(const StyleWork& work) {
  const ChartCanvas& canvas = work.canvas;
  Composition& chart = canvas.chart;
  PricePlot plot(work, true);
  const bool smooths = canvas.request.OscName != "MACD";
  std::int16_t x = chart.FirstBarX;
  for (int i = 0; i <= chart.Bars.BarCount; ++i, x = CInt(double(x) + chart.BarSpacing)) {
    const ChartBar& bar = chart.Bars[static_cast<size_t>(i)];
    work.barDate = bar.date();
    const bool hasClose = bar.Close != 0;
    const std::int16_t lastY = i == 0 ? std::int16_t{0} : chart.CloseY.back();
    const std::int16_t y = hasClose ? chart.Price.Y(bar.Close) : lastY;
    chart.CloseY.push_back(y);
    const auto volumeY = plot.VolumeY(bar);
    plot.DrawAdjustment(bar, x);
    plot.DrawDate(bar, x);
    if (i > 0 && hasClose)
      canvas.pen.Line('H', {double(x) - chart.BarSpacing, double(lastY), double(x), double(y),
                            canvas.LineColour()});
    if (smooths) plot.Smooth(y, x);
    plot.DrawVolume(x, volumeY);
  }
  chart.LastBarX = x;
}

}  // namespace kora
