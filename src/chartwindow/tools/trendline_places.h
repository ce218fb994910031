#pragma once

#include <cstdint>
#include <optional>

#include "chart/chart_request.h"
#include "chart/composition.h"
#include "store/chart_notes.h"
#include "store/trendline_file.h"

// Where saved lines and texts stand on a chart, and what is kept of a line that was drawn. No
// surface is needed for any of it.

namespace kora {

// A line on the price picture, chart units.
struct ScreenLine {
  double x1 = 0, y1 = 0, x2 = 0, y2 = 0;
};
// The ends of a line as it was drawn; x 0 for one that was not.
struct TrendlineRow {
  std::int16_t x1 = 0, y1 = 0, x2 = 0, y2 = 0;
};

// What is kept of a line from one point to another:
// - the end with the smaller x is the left one;
// - prices are those at the two y, unrounded, as 32-bit floats;
// - the start is the date of the column at x1, the end that at x2; beyond the last bar it is "X"
//   and the columns between, half to even.
// Nothing where the left end is not on the columns 1 to BarCount, where a date is blank, or where
// a price can't be computed.
std::optional<TrendlineRec> TrendlineOf(const Composition& chart, const ChartRequest& request,
                                        const ScreenLine& line);

// Where a kept line stands on this chart. A date that has no bar stands at the next bar. Nothing
// for a line of another period, one that starts before bar 1 or ends off the chart, one whose
// price is 0 or stands more than 20 units outside the frame, and for a record that can't be read.
std::optional<ScreenLine> PlaceTrendline(const Composition& chart, const ChartRequest& request,
                                         const TrendlineRec& rec);

// Whether the pointer is within 2 units above or below the line, which goes on without end.
bool HitsLine(const TrendlineRow& row, double x, double y);

// The upper left corner of a kept text, placed as a line's start is, but from bar 0 on.
struct NotePlace {
  double x = 0, y = 0;
};
std::optional<NotePlace> PlaceNote(const Composition& chart, const NoteLine& note);

}  // namespace kora
