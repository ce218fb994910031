#include "base/numbers.h"
#include "chart/styles/price_plot.h"
#include "chart/styles/swing_line.h"

namespace kora {
namespace {

constexpr double kSizedStep = 4;  // x of a turn of the kinds with a size

SwingRule RuleOf(const ChartRequest& request, const Composition& chart) {
  SwingRule rule{request.Swing, request.SwingSize};
  rule.divisor = request.Name.RecType == kIndex ? 1 : 100;
  rule.step = request.Swing == SwingKind::kStandard ? chart.BarSpacing : kSizedStep;
  if (request.Swing == SwingKind::kPointsAuto) {
    const auto bars = std::span(chart.Bars.bars).first(size_t(chart.Bars.BarCount) + 1);
    rule.size = Int(0.75 * Int(AverageSwing(bars)));
  }
  return rule;
}

std::string Title(const ChartRequest& request, const SwingRule& rule) {
  std::string text = request.ChartPeriod == Period::kWeekly    ? "Weekly Swing "
                     : request.ChartPeriod == Period::kMonthly ? "Monthly Swing "
                                                               : "Daily Swing ";
  switch (rule.kind) {
    case SwingKind::kDays: return text + Str(rule.size) + " - DAY";
    case SwingKind::kPoints: return text + Str(rule.size) + " - POINT";
    case SwingKind::kPointsAuto: return text + Str(rule.size) + " - Point(Auto)";
    default: return text + " -  Standard";
  }
}

}  // namespace

void DrawSwing(const StyleWork& work) {
  const ChartCanvas& canvas = work.canvas;
  Composition& chart = canvas.chart;
  PricePlot plot(work, false);
  const SwingRule rule = RuleOf(canvas.request, chart);
  SwingLine line(rule, [&](const SwingStroke& s) {
    // Coordinates have 16 bits.
    canvas.pen.Line('H', {s.x1, s.y1, double(CInt(s.x2)), s.y2, canvas.colour(s.entry)});
  });
  bool titled = false;
  std::int16_t x = chart.FirstBarX;
  for (int i = 0; i <= chart.Bars.BarCount; ++i, x = CInt(double(x) + chart.BarSpacing)) {
    const ChartBar& bar = chart.Bars[static_cast<size_t>(i)];
    work.barDate = bar.date();
    if (bar.High == 0) {
      chart.CloseY.push_back(chart.CloseY.empty() ? std::int16_t{0} : chart.CloseY.back());
      continue;
    }
    const double high = chart.Price.Y(bar.High), low = chart.Price.Y(bar.Low);
    chart.CloseY.push_back(chart.Price.Y(bar.Close));
    const auto volumeY = plot.VolumeY(bar);
    plot.DrawAdjustment(bar, x);
    plot.DrawDate(bar, x);
    plot.DrawVolume(x, volumeY);
    if (!titled)
      canvas.SmallText(x, chart.ChartTop + 4.0, Title(canvas.request, rule),
                       canvas.colour(kScalesText));
    titled = true;
    line.Add({double(x), high, low, bar.High, bar.Low});
  }
  chart.LastBarX = x;
}

}  // namespace kora
