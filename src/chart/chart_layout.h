#pragma once

#include <cstdint>

#include "chart/chart_request.h"
#include "store/price_rec.h"

namespace kora {

// Where a chart stands on its surface, in chart units; settled before anything is drawn.
struct ChartLayout {
  std::int16_t ChartLeft = 0, ChartRight = 0, ChartTop = 0, ChartBottom = 0;
  std::int16_t ChartMiddle = 0;
  std::int16_t FirstBarX = 0;
  std::int16_t BarSpacing = 2;  // as used, never 0
  double PlotWidth = 0;         // for the bars; what is kept free at the right is off it
};

constexpr std::int16_t kChartLeft = 42;  // the room for the scale

// The layout on a surface of `width` x `height`, from `left` to 99% of the width:
//   the upper of two: 2 to 46% of the height; the lower: 51% to 95%; any other: 10% to 95%, from
//   13% with a panel below. A percentage of a height is cut to whole units.
ChartLayout LayOutChart(const ChartRequest& request, double width, double height, bool panelBelow,
                        std::int16_t left = kChartLeft);

// The records that a chart shows, from 1; both ends are included.
struct RecordWindow {
  std::int16_t FirstDataRec = 0, LastDataRec = 0;
};

// Records that fill the plot's width: a week counts WeekFactor of them (4.75 where that is outside 4
// to 5.25), a month 20.
std::int32_t RecordsWanted(const ChartRequest& request, const ChartLayout& layout);

// The last records of `file` that fill the plot's width, up to the finish date where the request
// has one; all of it for `wholeFile`. A week counts WeekFactor records (4.75 where that is
// outside 4 to 5.25), a month 20. Error 6 for a file of more than 32,767 records.
RecordWindow ChooseWindow(const PriceFile& file, const ChartRequest& request,
                          const ChartLayout& layout, bool wholeFile);

}  // namespace kora
