#include "chart/chart_layout.h"

#include <algorithm>
#include <array>
#include <span>

#include "base/numbers.h"
#include "store/price_rec.h"

namespace kora {
namespace {

// `percent` of `height`: rounded to a whole product, then truncated.
std::int16_t PercentOf(double height, int percent) { return CInt(CLng(height * percent) / 100); }

// The first record not before `date`; the last of the file where there is none.
std::int16_t FinishRecord(const PriceFile& file, std::string_view date) {
  constexpr std::int32_t kRun = 512;
  std::array<PriceRec, kRun> run;
  for (std::int32_t first = 1; first <= file.count(); first += kRun) {
    const auto n = static_cast<size_t>(std::min(kRun, file.count() - first + 1));
    file.ReadRun(first, std::span(run.data(), n));
    for (size_t i = 0; i < n; ++i)
      if (!(run[i].RecDate.raw() < date)) return CInt(double(first) + double(i));
  }
  return CInt(file.count());
}

double DaysToBar(const ChartRequest& request) {
  if (request.ChartPeriod == Period::kMonthly) return 20;
  if (request.ChartPeriod != Period::kWeekly) return 1;
  return request.WeekFactor >= 4 && request.WeekFactor <= 5.25 ? request.WeekFactor : 4.75;
}

}  // namespace

ChartLayout LayOutChart(const ChartRequest& request, double width, double height, bool panelBelow,
                        std::int16_t left) {
  ChartLayout layout;
  switch (request.Place) {
    default:
      layout.ChartTop = PercentOf(height, panelBelow ? 13 : 10);
      layout.ChartBottom = PercentOf(height, 95);
      break;
    case ChartPlace::kUpper:
      layout.ChartTop = 2;
      layout.ChartBottom = PercentOf(height, 46);
      break;
    case ChartPlace::kLower:
      layout.ChartTop = PercentOf(height, 51);
      layout.ChartBottom = PercentOf(height, 95);
      break;
  }
  layout.ChartLeft = left;
  layout.FirstBarX = layout.ChartLeft;
  layout.ChartRight = PercentOf(width, 99);
  layout.ChartMiddle = CInt((layout.ChartRight - layout.ChartLeft) / 2.0 + 36);
  layout.BarSpacing = request.BarSpacing > 0 ? request.BarSpacing : std::int16_t{2};
  const double plot = double(layout.ChartRight) - layout.ChartLeft;
  // The multi-oscillator view scrolls over a surface as wide as its bars. A swing line has an x
  // of its own, up to two steps a bar: it needs room that bars do not take.
  if (request.Place == ChartPlace::kWide)
    layout.PlotWidth = 2100;
  else if (!ShowsSwing(request))
    layout.PlotWidth = plot - request.BlankSpace;
  else if (request.Swing == SwingKind::kPointsAuto)
    layout.PlotWidth = 0.65 * plot;
  else
    layout.PlotWidth = plot / 2 - request.BlankSpace;
  return layout;
}

std::int32_t RecordsWanted(const ChartRequest& request, const ChartLayout& layout) {
  return CLng(layout.PlotWidth / layout.BarSpacing * DaysToBar(request));
}

RecordWindow ChooseWindow(const PriceFile& file, const ChartRequest& request,
                          const ChartLayout& layout, bool wholeFile) {
  RecordWindow window;
  window.LastDataRec = CInt(file.count());
  if (wholeFile) {
    window.FirstDataRec = 1;
    return window;
  }
  const std::int32_t wanted = RecordsWanted(request, layout);
  if (request.FinishDateOn) window.LastDataRec = FinishRecord(file, request.FinishDate);
  window.FirstDataRec =
      CInt(std::clamp<double>(double(window.LastDataRec) - wanted, 1, window.LastDataRec));
  return window;
}

}  // namespace kora
