#include "indicators/rmx.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <string>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "indicators/compare_file.h"
#include "indicators/osc_series.h"

namespace kora {
namespace {

constexpr double kPanelUnits = 144;

// Where values lie in the panel.
struct Plot {
  double floor, height;

  double Scale(float highest, float lowest) const {
    return Divide(double(highest) - lowest, height);
  }
  double Y(double value, float lowest, double scale) const {
    return floor - (value - lowest) / scale;
  }
  // The y of zero at a point, if it has one.
  std::optional<std::int16_t> Centre(const RmxPoint& point) const {
    if (!point.Stored) return std::nullopt;
    const double scale = Scale(point.Highest, point.Lowest);
    if (scale == 0) return std::nullopt;
    const double y = RoundHalfEven(Y(0.0, point.Lowest, scale));
    if (!(std::fabs(y) <= 32767)) return std::nullopt;
    return CInt(y);
  }
};

struct Form {
  std::int16_t P, A;
  std::string CompareName;
};

void Lines(OscHost& host, OscPanel& panel, const Form& form, const RmxSeries& series,
           const Plot& plot, double scale, int middle) {
  std::vector<std::int16_t> slots(form.A > 0 ? size_t(form.A) : 0);
  RollingWindow<std::int16_t, std::int32_t> window(slots.data(), form.A);
  const double spacing = host.chart.BarSpacing;
  panel.PlotX = panel.PanelLeft - spacing;
  std::int16_t lastY = 0, previousY = 0, previousAverageY = 0;
  std::optional<std::int16_t> previousCentre;
  int values = 0, averages = 0;
  for (int b = 0; b < int(series.Points.size()); ++b) {
    panel.PlotX = CInt(panel.PlotX + spacing);
    const RmxPoint& point = series.Points[size_t(b)];
    if (point.Value == 0) continue;
    const double from = panel.PlotX - spacing;
    const bool line = values++ > 0 && b >= form.P;
    host.LastValues = {point.Value};

    const std::int16_t y = CInt(plot.Y(point.Value, series.Lowest, scale));
    if (line) panel.Line('L', from, lastY, panel.PlotX, y, kOscLine1);
    previousY = lastY;
    lastY = y;

    if (form.A > 0 && window.Add(y)) {
      const std::int16_t averageY = AverageY(window);
      if (averages++ > 0 && line)
        panel.Line('L', from, previousAverageY, panel.PlotX, averageY, kOscLine2);
      previousAverageY = averageY;
    }

    const auto centre = plot.Centre(point);
    if (line && b >= 3 && centre && previousCentre)
      panel.Line('L', from, *previousCentre, panel.PlotX, *centre, kOscLine3);
    previousCentre = centre;
  }
  panel.Text(panel.PanelLeft + 390, panel.PanelBottom + 14,
             "RMX   " + Str(std::int32_t(middle - lastY)) + " (" +
                 Str(std::int32_t(middle - previousY)) + ")");
}

void Draw(OscHost& host, const Form& form) {
  OscPanel panel(host, kPanelUnits, true);
  const RmxPlace place = host.PlaceRmx(kPanelUnits);
  panel.PanelTop = place.PanelTop;
  panel.PanelBottom = place.PanelBottom;
  panel.Frame();

  const auto compare = OpenCompareFile(host.files, host.settings.osc.CompFile);
  if (!compare) return;
  const ChartBars& bars = host.chart.Bars;
  const std::int32_t first = std::max<std::int32_t>(compare->count() - bars.BarCount, 1);
  const RmxSeries series =
      RmxValues(bars, ReadCloses(*compare, first, compare->count() - first + 1), form.P);

  const double floor = panel.PanelBottom - place.inset;
  const Plot plot{floor, floor - (panel.PanelTop + place.inset)};
  const double scale = plot.Scale(series.Highest, series.Lowest);
  if (scale == 0) return;
  const auto yOf = [&](double v) { return CInt(plot.Y(v, series.Lowest, scale)); };
  const int middle = place.middle;

  std::int16_t lastCentre = 0;
  for (const RmxPoint& point : series.Points) lastCentre = plot.Centre(point).value_or(lastCentre);
  panel.Text(panel.PanelLeft + 2, panel.PanelBottom + 2,
             "RMX Oscillator (" + Str(std::int32_t(form.P)) + " Period)   Compared to " +
                 form.CompareName + "   " + Str(std::int32_t(form.A)) +
                 " Ave           CenterLine = " + Str(std::int32_t(middle - yOf(0.0))) + "  (" +
                 Str(std::int32_t(middle - lastCentre)) + ")");
  panel.Guide(yOf(0.0), "");
  panel.Guide(yOf(series.Lowest), "");
  panel.Guide(yOf(series.Highest * 0.8), "O/B");
  panel.Guide(yOf(series.Lowest * 0.8), "O/S");
  for (const double end : {double(series.Highest), double(series.Lowest)})
    for (const double part : {0.2, 0.4, 0.6, 1.0}) {
      const double y = yOf(end * part);
      panel.Line('L', panel.PanelLeft - 4, y, panel.PanelLeft, y, kBorder);
    }

  Lines(host, panel, form, series, plot, scale, middle);
}

}  // namespace

RmxSeries RmxValues(const ChartBars& bars, std::span<const float> compare, int P) {
  if (P < 1) throw RunTimeError(kIndexOutOfRange);
  RmxSeries series;
  series.Points.resize(size_t(LastBar(bars) + 1));
  std::vector<float> slots(static_cast<size_t>(P));
  RollingWindow<float, double> window(slots.data(), P);
  const size_t pairs = std::min(series.Points.size(), compare.size());
  for (size_t b = 0; b < pairs; ++b) {
    if (bars[b].Close == 0) continue;
    const float ratio = CompareRatio(compare[b], bars[b].Close);
    if (!window.Add(ratio)) continue;
    RmxPoint& point = series.Points[b];
    point.Stored = true;
    point.Value = CSng(window.Total() / P - ratio);
    series.Highest = std::max(series.Highest, point.Value);
    series.Lowest = std::min(series.Lowest, point.Value);
    point.Highest = series.Highest;
    point.Lowest = series.Lowest;
  }
  return series;
}

void ShowRMX(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&] {
    const std::int16_t P = host.Period(kRmxP);
    if (P == 0) return;
    const std::string CompareName =
        ValidateCompareFile(host.files, host.dialogs, host.settings.osc.CompFile);
    if (CompareName.empty()) return;
    Draw(host, {P, host.Period(kRmxA), CompareName});
  });
}

}  // namespace kora
