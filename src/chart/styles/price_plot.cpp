#include "chart/styles/price_plot.h"

#include <cmath>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/chart_failure.h"

namespace kora {

void SetUpRange(const ChartCanvas& canvas, bool whole) {
  Composition& chart = canvas.chart;
  const NameRec& name = canvas.request.Name;
  ChartScale& scale = chart.Scale;
  if (canvas.request.AutoScale)
    SetChartScaleAutomatic(chart.Bars.ChartHigh, chart.Bars.ChartLow, scale);
  else
    SetChartScaleManual(name.Base, name.Top, scale);
  const bool noLow = scale.ScaleLow == 0, noHigh = scale.ScaleHigh == 0;
  if (whole ? noLow || noHigh : noLow && noHigh) {
    chart.ScaleMissing = true;
    throw ChartRefusal{
        " MANUAL SCALING has been selected but there are no chart scale definitions in "
        "the Name File for " +
            FromAnsi(name.Code.trimmed()) +
            "\nUse <Change Scales> in the Set Defaults window or add these scales "
            "directly to the Name File\nDo not use 0(zero) as chart base or ceiling\n"
            "OTHERWISE USE AUTOMATIC SCALING",
        kChartDisplay};
  }
}

void SetUpScale(const ChartCanvas& canvas, bool line) {
  SetUpRange(canvas, false);
  Composition& chart = canvas.chart;
  const ChartScale& scale = chart.Scale;
  PriceMap& map = chart.Price;
  map.Logarithmic = line ? canvas.request.LogLines : canvas.request.LogBars;
  map.ScaleLow = scale.ScaleLow;
  map.ChartBottom = chart.ChartBottom;
  if (map.Logarithmic) {
    // With one end at 0 the chart goes on with the logarithms it has.
    if (scale.ScaleLow == 0 || scale.ScaleHigh == 0) return;
    if (scale.ScaleLow < 0)
      throw ChartRefusal{
          "You cannot display a Logarithmic chart when there are NEGATIVE values. "
          "Display the chart as an Arithmetic chart.",
          "Negative Values"};
    map.LogBase = static_cast<float>(std::log(double(scale.ScaleLow)));
    double logHigh;
    if (scale.ScaleHigh > 0)
      logHigh = std::log(double(scale.ScaleHigh));
    else if (line)
      logHigh = Divide(std::log(10.0), std::log(-double(scale.ScaleHigh)));
    else
      throw RunTimeError(kBadCall);
    map.LogFactor = static_cast<float>(
        Divide(double(chart.ChartTop) - chart.ChartBottom, logHigh - double(map.LogBase)));
  } else {
    map.PricePerY = static_cast<float>(Divide(double(scale.ScaleHigh) - double(scale.ScaleLow),
                                              double(chart.ChartBottom) - chart.ChartTop));
  }
}

PricePlot::PricePlot(const StyleWork& work, bool line)
    : work_(work),
      canvas_(work.canvas),
      request_(canvas_.request),
      chart_(canvas_.chart),
      axis_(canvas_),
      smoother_(request_.MaExp) {
  SetUpScale(canvas_, line);
  if (chart_.Bars.VolumeShown) SetVolumeMap(request_, line, chart_.Price.Logarithmic, chart_);
}

std::optional<std::int16_t> PricePlot::VolumeY(const ChartBar& bar) const {
  if (!chart_.Bars.VolumeShown || bar.Volume <= 0) return std::nullopt;
  const double y = chart_.Volume.RawY(bar.Volume);
  if (request_.CutVols && y < chart_.VolTop) return chart_.VolTop;
  return CInt(y);
}

void PricePlot::DrawVolume(double x, std::optional<std::int16_t> y) {
  if (!y || *y > chart_.VolBottom) return;
  canvas_.pen.Line('H', {x, double(chart_.VolBottom), x, double(*y), canvas_.colour(kVolumeBars)});
}

void PricePlot::Smooth(std::int16_t closeY, double x) {
  const auto y = smoother_.Add(closeY);
  if (!y) return;
  ++smoothed_;
  if (!IsSuperimposed(request_.Place) && request_.OscName != "MACD" &&
      (request_.Ma1On || request_.Ma2On) && smoothed_ >= 2)
    canvas_.pen.Point('P', x, *y, canvas_.colour(kAverage1));
}

void PricePlot::DrawAdjustment(const ChartBar& bar, double x) {
  if (bar.SourceRec == 0 || IsSuperimposed(request_.Place)) return;
  const PriceRec record = work_.file.Read(bar.SourceRec);
  const Colour colour = canvas_.colour(kAdjustments);
  const Segment line{x, double(chart_.ChartTop), x, double(chart_.ChartBottom), colour};
  canvas_.pen.LineStyled(DrawStyle::kDash, line, 'V', line);
  canvas_.SmallText(x, chart_.ChartTop + 2.0, FromAnsi(record.AdjDesc.trimmed()), colour);
}

}  // namespace kora
