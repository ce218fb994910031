#pragma once

#include <string>
#include <string_view>

#include "chart/chart_canvas.h"

namespace kora {

// Sets `chart.Volume` from the loaded bars: the volume at the top of the panel is a multiple of
// the mean (VolHeight for bars and candles, 3 for lines), so that one large day does not flatten
// the rest.
//   arithmetic: y = VolBottom - (v - VolBase) / VolPerY
//   log:        y = Int(VolLogFactor * (ln v - VolLogBase) + VolBottom)
// VolLogBase is taken on a logarithmic price chart alone and otherwise stays as it was.
void SetVolumeMap(const ChartRequest& request, bool lineChart, bool logarithmicPrices,
                  Composition& chart);

// Copies the volume figures and sets VolLabel, the unit of the volumes; empty for none.
void SetVolumeLabel(Composition& chart, std::string unit);

// A volume in as few characters as may be: 670K, 1.8M, 2.1B; below 1000 as it is.
std::string ShortVolume(std::int32_t volume);

// Frame, three dotted lines, "VOL" reading downward and the values of the volume panel.
void DrawVolumePanel(const ChartCanvas& canvas);

// Frame, the period and mode line (single charts), ticks, labels and horizontal grid.
// `classText` is the industry class, "unknown" for none.
void DrawScale(const ChartCanvas& canvas, bool lineChart, std::string_view classText);

// The ChartLeft at which the longest label of the price scale has room; ChartLeft as it is where it
// has room already. Price and Scale of the chart are set.
std::int16_t LeftOfLabels(const ChartCanvas& canvas);
// The same for the widest label, in chart units.
std::int16_t LeftOfLabel(const ChartCanvas& canvas, double width);

// Vertical grid lines every GridSpace bars.
void DrawFixedGrid(const ChartCanvas& canvas);

// The date axis below the plot, called at each bar with a new month key.
class DateAxis {
 public:
  // `ticksAlone`: months get a tick below the plot even where the grid has a line for them.
  explicit DateAxis(const ChartCanvas& canvas, bool ticksAlone = false)
      : canvas_(canvas), ticksAlone_(ticksAlone) {}

  // Takes a bar's date at `x`; marks it where its month key is above the last one seen. True
  // where that was the line at the end of a year.
  bool Bar(std::string_view yyyymmdd, double x);

 private:
  bool NewMonth(std::string_view yyyymmdd, double x);

  bool HasRoom(double x, std::string_view text);

  const ChartCanvas& canvas_;
  bool ticksAlone_;
  double textEnd_ = -1;    // of the last text, where labels are legible
  std::string lastMonth_;  // "yyyymm"
  std::string lastYear_;
  int lastMark_ = 0;  // x in eighths where a month was last marked
  bool monthSkipped_ = false;
};

}  // namespace kora
