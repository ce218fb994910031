#pragma once

#include <span>
#include <vector>

#include "store/chart_bars.h"

namespace kora {

// Exponential average of a column, written into `out` from bar period + offset on; what stands
// before stays. Both columns hold all bars. A period below 1 and one that needs more bars than
// there are leave `out` as it is.
//
//   k = 2 / (period + 1)
//   at period + offset: the sum of the source from `seedFrom` to this bar, over period
//   after it:           x * k + (1 - k) * the value before
//
// Each value is a 32-bit float, and the next is made from it. Over closes the seed begins at
// offset + 1 and is a plain average. Over the difference column it begins at offset: period + 1
// values over period, one too many on purpose.
// Error 6 where a value leaves 32-bit floats.
void EmaColumn(int period, int offset, int seedFrom, std::span<const float> source,
               std::span<float> out);

// The closes of all bars as a column.
std::vector<float> CloseColumn(const ChartBars& bars);

}  // namespace kora
