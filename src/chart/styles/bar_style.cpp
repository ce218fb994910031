#include "base/numbers.h"
#include "chart/bar_marks.h"
#include "chart/styles/price_plot.h"

namespace kora {
namespace {

// One bar at x in a colour; the y of its prices are known.
using BarShape = void (*)(const ChartCanvas&, const BarY&, double x, Colour);

void Bar(const ChartCanvas& canvas, const BarY& y, double x, Colour colour) {
  ChartPen& pen = canvas.pen;
  pen.Line('H', {x, double(y.High), x, double(y.Low), colour});
  if (canvas.chart.BarSpacing > 2) {
    pen.Line('H', {x - 2, double(y.Open), x, double(y.Open), colour},
             {x - 1.5, double(y.Open), x, double(y.Open), colour});
    pen.Line('H', {x, double(y.Close), x + 2, double(y.Close), colour},
             {x, double(y.Close), x + 1.5, double(y.Close), colour});
  } else if (canvas.chart.BarSpacing == 2) {
    pen.Point('P', x - 1, y.Open, colour);
    pen.Point('P', x + 1, y.Close, colour);
  }
}

void Candle(const ChartCanvas& canvas, const BarY& y, double x, Colour) {
  const Colour lines = canvas.LineColour();
  canvas.pen.Line('H', {x, double(y.High), x, double(y.Low), lines});
  const bool fall = y.Close > y.Open;
  const Colour body = fall ? canvas.colour(kCandleDown) : lines;
  // A rising body is an outline in the script: hollow on paper.
  canvas.pen.FilledBox(fall ? 'C' : 'B', {x - 1, double(y.Open), x + 1, double(y.Close), body},
                       {x - 1.5, double(y.Open), x + 1.5, double(y.Close), body});
}

void DrawStop(const ChartCanvas& canvas, const StopLossTracker& stop) {
  const double chartRight = canvas.chart.ChartRight;
  const auto right = [&](std::string_view text, int entry) {
    const SurfaceFont font = canvas.Font1(ChartCanvas::kSmallText);
    canvas.SmallText(chartRight - canvas.TextWidth(font, text), 30, text, canvas.colour(entry));
  };
  if (stop.broken()) right("PREVIOUS STOP BROKEN", 13);
  if (stop.stop() > 0) {
    const double y = canvas.chart.Price.Y(stop.stop());
    canvas.pen.Line('L', {double(stop.stopX()), y, chartRight, y, canvas.colour(10)});
    right("Current Stop Loss : " + Format(stop.stop(), "0.00#"), 10);
  }
}

// `marked`: reversals and outside days are told by colours.
void DrawShapes(const StyleWork& work, BarShape shape, bool marked) {
  const ChartCanvas& canvas = work.canvas;
  const ChartRequest& request = canvas.request;
  Composition& chart = canvas.chart;
  PricePlot plot(work, false);
  StopLossTracker stop(request.StopLossShown, request.StopLossPct);
  const bool smooths =
      request.OscName != "MACD" && request.OscName != "PARA" && request.OscName != "PARAV";
  const bool outside = marked && request.OutsideMarks;
  BarY previous, beforePrevious;
  const ChartBar* previousBar = nullptr;  // the last one that was drawn
  int seen = 0;
  std::int16_t x = chart.FirstBarX;
  for (int i = 0; i <= chart.Bars.BarCount; ++i, x = CInt(double(x) + chart.BarSpacing)) {
    const ChartBar& bar = chart.Bars[static_cast<size_t>(i)];
    work.barDate = bar.date();
    if (bar.High == 0) {
      chart.CloseY.push_back(chart.CloseY.empty() ? std::int16_t{0} : chart.CloseY.back());
      continue;
    }
    BarY y;
    y.High = chart.Price.Y(bar.High);
    y.Open = chart.Price.Y(bar.Open);
    y.Low = chart.Price.Y(bar.Low);
    y.Close = chart.Price.Y(bar.Close);
    chart.CloseY.push_back(y.Close);
    const auto volumeY = plot.VolumeY(bar);
    int entry = kChartLines;
    if (outside && previousBar) entry = stop.Next(bar, *previousBar, x);
    if (outside && i == chart.Bars.BarCount && request.StopLossShown) DrawStop(canvas, stop);
    plot.DrawAdjustment(bar, x);
    plot.DrawDate(bar, x);
    plot.DrawVolume(x, volumeY);
    if (marked && request.ColourMarks)
      entry = ReversalMark(y, seen > 0 ? &previous : nullptr, seen > 1 ? &beforePrevious : nullptr);
    shape(canvas, y, x, entry == kChartLines ? canvas.LineColour() : canvas.colour(entry));
    if (smooths) plot.Smooth(y.Close, x);
    beforePrevious = previous;
    previous = y;
    previousBar = &bar;
    ++seen;
  }
  chart.LastBarX = x;
}

}  // namespace

void DrawBars(const StyleWork& work) { DrawShapes(work, Bar, true); }
void DrawCandles(const StyleWork& work) { DrawShapes(work, Candle, false); }

}  // namespace kora
