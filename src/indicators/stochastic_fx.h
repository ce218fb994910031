#pragma once

#include <cstdint>
#include <vector>

#include "indicators/osc_panel.h"
#include "indicators/sliding_range.h"

namespace kora {

// Stochastic fast and slow ("STO"), FX ("FX", the same with long periods) and the FX half of
// "R/F", drawn over the panel of ROC.
//
//   %K  = (close - lowest) / (highest - lowest) * 100, a whole number
//   %D  = (sum of D values of close - lowest) / (sum of D values of highest - lowest) * 100
//   third (slow form) = sum of the last D values of %D / D
//
// - highest and lowest are taken over K + 1 bars: the bar and K before it, so that the range
//   holds the close that the period is counted from. Bar K is the last with no value.
// - Securities without a real range (RecType 1 to 3) and bars with a zero High or Low stand
//   with their close; a zero close counts for neither. The search starts at 0 and 100000.
// - %D is a ratio of sums and no average of %K, so that days of a wide range weigh more.
// - The rows of %D and of the third value start at zero and are divided as they stand: there is
//   no warming up, and the first third values rise from zero.
// - A range of 0 divides by 1.
// - A y of 0 means "no point yet": the line that would begin there is left out.
//
// A difference of two prices is a 32-bit float as prices are; sums, ratios and percents are
// 64-bit.
//
// Reversed orientation (FX and R/F with FXRev) draws 100 - v and swaps the guide labels.

// For each bar the range of bars bar - K to bar; up to bar K, and where K is below 0, the start
// values.
std::vector<PriceRange> StochasticRanges(const ChartBars& bars, std::int16_t recType, int K);

inline constexpr OscKey kStochK{"StochK", "StochKW", 10, 10, "Stochastic K"};
inline constexpr OscKey kStochD{"StochD", "StochDW", 5, 5, "Stochastic D"};
inline constexpr OscKey kFXF{"FXF", "FXFW", 50, 50, "FX periods"};
inline constexpr OscKey kFXX{"FXX", "FXXW", 25, 25, "FX average"};

void ShowStochasticFX(OscHost& host);

}  // namespace kora
