#pragma once

#include <functional>
#include <string>

#include "chart/chart_canvas.h"
#include "store/price_rec.h"

// The styles of charts. The composer settles layout and records and loads the bars; one drawer
// then sets the scale and draws them, and the composer goes on by what the style says of itself.

namespace kora {

// What a drawer works with.
struct StyleWork {
  const ChartCanvas& canvas;
  const PriceFile& file;
  std::string& barDate;  // of the bar being drawn, for the message where it fails
  // Asks for the box value of a point-and-figure chart, proposing one. May be empty.
  const std::function<float(float)>& AskBoxValue;
};

struct ChartStyle {
  bool readsWholeFile = false;  // whatever fits on the plot
  bool hasVolumes = true;       // room for the volumes, and their panel
  bool lineScale = false;       // scaled as lines are
  bool ownScale = false;        // draws its scale itself
  bool takesOverlays = true;    // averages, bands, trendlines

  // Sets Scale, Price and Volume of the chart, draws the loaded bars with their date axis and
  // leaves CloseY and LastBarX. Throws ChartRefusal where the data or scale have no such chart.
  void (*Draw)(const StyleWork& work);
};

// The style of a request. Securities whose data has no bars (RecType 1 to 3) are lines.
const ChartStyle& StyleOf(const ChartRequest& request);

// One function a style.
void DrawBars(const StyleWork& work);
void DrawCandles(const StyleWork& work);
void DrawLine(const StyleWork& work);
// Boxes in columns; see point_figure.h. The box value is worked out from the range, or it is the
// request's, that of the name record on a manual scale, or the one that AskBoxValue gives; never
// below kLeastBoxValue.
void DrawPointFigure(const StyleWork& work);
// A line that follows the market where it turns by enough; see swing_line.h.
void DrawSwing(const StyleWork& work);

}  // namespace kora
