#pragma once

#include <cstdint>

#include "chart/chart_request.h"
#include "chart/composition.h"
#include "chartwindow/tools/zoom_box.h"
#include "looks/colours.h"
#include "platform/surface.h"
#include "settings/settings.h"

namespace kora {

// How many bars a zoom shows decides how it draws them.
struct ZoomColumns {
  std::int32_t first = 1, last = 1;  // columns of the chart
  std::int32_t step = 1;             // chart units from bar to bar: plot width \ (n + 2)
  int markEvery = 1;                 // a date at every so many bars
  double lineWidth = 8;
};
// n = last - first: up to 10 a date at each bar, lines 8 wide; to 20 at every third, 6; to 40 at
// every fifth, 4; above at every tenth, 3.
ZoomColumns ZoomColumnsOf(const Composition& chart, const ZoomBox& box, double plotWidth);

// Draws the part of a bar or candle chart within the box over the whole surface: the bars between
// its sides, the prices between top and bottom, year lines, volumes along the foot where the
// chart has them, the averages that are on. Error 7 where memory runs out.
void ZoomChart(Surface& surface, const Composition& chart, const ChartRequest& request,
               const ChartColours& colours, const FontSettings& fonts, const ZoomBox& box);

}  // namespace kora
