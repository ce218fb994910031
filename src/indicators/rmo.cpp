#include "indicators/rmo.h"

#include <algorithm>
#include <string>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "indicators/compare_file.h"
#include "indicators/osc_series.h"

namespace kora {
namespace {

constexpr std::int32_t kMostRecords = 30000;

std::vector<RelRec> RelSeriesOf(OscHost& host, const PriceFile& compare) {
  const PriceFile security(host.files, host.settings.paths.CurrentDataPath + host.chart.DataFile);
  const std::int32_t n = std::min(security.count(), kMostRecords);
  const std::int32_t pairs = std::min(n, compare.count());
  return PairFromEnd(ReadCloses(security, security.count() - n + 1, n),
                     ReadCloses(compare, compare.count() - pairs + 1, pairs));
}

void Draw(OscHost& host, std::int16_t P, std::int16_t A, const std::string& CompareName,
          const PriceFile& compare) {
  OscPanel panel(host);
  const double floor = panel.PanelBottom - 20;
  const double height = floor - (panel.PanelTop + 20);
  panel.Frame();
  panel.Title("RMO Oscillator (" + Str(std::int32_t(P)) + " Period)   Compared to " + CompareName +
              "   " + Str(std::int32_t(A)) + " Ave");
  const auto guide = [&](double y, std::string_view label) {
    panel.Guide(y, "");
    if (!label.empty()) panel.Text(2, y - 6, label);
  };
  guide((panel.PanelBottom - panel.PanelTop) / 2 + 1, "");
  guide(panel.PanelTop + 25, " +80");
  guide(panel.PanelBottom - 25, " -80");

  std::vector<RelRec> RelSeries = RelSeriesOf(host, compare);
  SetRmoValues(RelSeries, P);

  std::vector<std::int16_t> slots(A > 0 ? size_t(A) : 0);
  RollingWindow<std::int16_t, std::int32_t> window(slots.data(), A);
  const double spacing = host.chart.BarSpacing;
  panel.PlotX = CInt(panel.PanelLeft - 2 * spacing);
  float highest = -100000.0f, lowest = 100000.0f;
  std::int32_t seen = 0;
  int drawn = 0, averages = 0;
  std::int16_t previousY = 0, previousAverageY = 0;
  for (const RelRec& bar : RelSeries) {
    ++seen;
    if (bar.Value == 0) continue;
    highest = std::max(highest, bar.Value);
    lowest = std::min(lowest, bar.Value);
    const double scale = Divide(double(highest) - lowest, height);
    if (highest == 0 || lowest == 0 || scale == 0) {
      ++seen;
      continue;
    }
    if (seen < host.chart.Bars.FirstDataRec) continue;

    panel.PlotX = CInt(panel.PlotX + spacing);
    ++drawn;
    const std::int16_t y = CInt(floor - (double(bar.Value) - lowest) / scale);
    if (A > 0 && window.Add(y)) {
      const std::int16_t averageY = AverageY(window);
      if (averages++ > 0 && drawn >= 3)
        panel.Line('L', panel.PlotX - spacing, previousAverageY, panel.PlotX, averageY, kOscLine2);
      previousAverageY = averageY;
    }
    host.LastValues = {bar.Value};
    if (drawn >= 3) panel.Line('H', panel.PlotX - spacing, previousY, panel.PlotX, y, kOscLine1);
    previousY = y;
  }
}

}  // namespace

std::vector<RelRec> PairFromEnd(std::span<const float> security, std::span<const float> compare) {
  std::vector<RelRec> series(security.size());
  const size_t pairs = std::min(security.size(), compare.size());
  for (size_t back = 1; back <= pairs; ++back)
    series[series.size() - back].Ratio =
        CompareRatio(compare[compare.size() - back], security[security.size() - back]);
  return series;
}

void SetRmoValues(std::vector<RelRec>& series, int P) {
  if (P < 1) throw RunTimeError(kIndexOutOfRange);
  std::vector<float> slots(static_cast<size_t>(P));
  RollingWindow<float, double> window(slots.data(), P);
  for (RelRec& bar : series) {
    if (bar.Ratio == 0) continue;
    if (window.Add(bar.Ratio)) bar.Value = CSng(window.Total() / P - bar.Ratio);
  }
}

void ShowRMO(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&] {
    const std::int16_t P = host.Period(kRmoP);
    if (P == 0 || host.request.ChartPeriod != Period::kDaily) return;
    const std::string& compFile = host.settings.osc.CompFile;
    const std::string CompareName = ValidateCompareFile(host.files, host.dialogs, compFile);
    if (CompareName.empty()) return;
    if (const auto compare = OpenCompareFile(host.files, compFile))
      Draw(host, P, host.Period(kRmoA), CompareName, *compare);
  });
}

}  // namespace kora
