#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "chart/composition.h"

// What the pointer reads from a chart: the one mapping between chart units and data, and the
// texts of the status bar. All of it works on what the composition left; a mouse move composes
// nothing and reads no script.

namespace kora {

// ---- The mapping

// The column nearest to `x`, half to even, never beyond the last bar; below 0 left of the chart.
std::int32_t ColumnOf(const Composition& chart, double x);
// Where column `c` stands.
double XOfColumn(const Composition& chart, std::int32_t column);

// The price at `y` of a bar, candle or line chart, to two decimals, below 0.30 to three. 0 for
// what can't be computed.
double PixelToPrice(const Composition& chart, double y);
// The y of a price there; 0 for what can't be computed, such as a price of 0 on a logarithmic
// scale or a y beyond 16 bits.
std::int16_t PriceToPixel(const Composition& chart, double price);

// The price of the row at `y`, and the y of the row nearest to a price; 0 for what can't be
// computed.
double PFPixelToPrice(const Composition& chart, const PFBoxes& boxes, double y);
std::int16_t PFPriceToPixel(const Composition& chart, const PFBoxes& boxes, double price);

// ---- The status bar

// The format of a price read from a point-and-figure chart.
std::string_view ReadoutFormat(std::int16_t RecType);

// Texts of the status panels 3 to 8.
using ReadoutTexts = std::array<std::string, 6>;
// What the panels show for a column. Nothing where its bar has no date, or is not there: the
// panels keep what they have.
std::optional<ReadoutTexts> BarReadout(const Composition& chart, std::int16_t RecType,
                                       std::int32_t column);

}  // namespace kora
