#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "chart/chart_canvas.h"
#include "platform/surface.h"

// What is drawn over a finished price chart: multiple averages, bands, and the legend of the
// reversal marks; and the checks of what the user sets for them.

namespace kora {

// ---- Overlays, each with its line in the script (letter L)

// Twelve averages of the y of the closes, periods 1 to 6 in one colour and 7 to 12 in another;
// exponential as the request says. A period below 1 or above 500 is passed over.
using MmaPeriods = std::array<std::int16_t, 12>;
void AddMMA(const ChartCanvas& canvas, const MmaPeriods& MMASet);

// Bands at percentages above and below the mean of ten closes: BandUp and BandDown of the name
// record, 5 where they are outside 1 to 100. A close of 0 takes the close before it, and stays
// so in the chart's bars: what is drawn later finds it filled.
void ShowPercentBands(const ChartCanvas& canvas);

// Bands two standard deviations above and below the mean of 21 closes. Both figures are fixed;
// BollPeriods and BollWidth of the name record have no part in it. A close of 0 counts as the
// close before it; the bars stay as they are. The first point stands one bar to the left.
void ShowBollinger(const ChartCanvas& canvas);

// The bands of the request's BandKind. In all of these a run-time error, as of a price that has
// no place on the surface, ends the bands and nothing else.
void ShowBands(const ChartCanvas& canvas);

// What the composer draws over every price chart, in order.
std::vector<std::function<void(const ChartCanvas&)>> PriceOverlays(bool MMAOn,
                                                                   const MmaPeriods& MMASet);

// ---- The legend of the reversal marks

inline constexpr double kLegendWidth = 113, kLegendHeight = 77;
// A text and a short bar in the colour of each mark, on a surface of that size.
void DrawReversalLegend(Surface& surface, const FontSettings& fonts, const ChartColours& colours);

// ---- Checks of what is typed

inline constexpr MmaPeriods kDefaultMMASet{3, 5, 8, 10, 12, 15, 30, 35, 40, 45, 50, 60};

// The twelve boxes as periods: a blank one is 0. Nothing where one is below 0 or above 600;
// `refused` then tells which, from 0.
std::optional<MmaPeriods> ReadMMABoxes(std::span<const std::string, 12> boxes, size_t& refused);
// The value of the key MMASet: "3,5,8,...".
std::string MMASetText(const MmaPeriods& periods);

// Two band values from 0 to 100, or nothing, which is told as kBandsMessage.
struct BandValues {
  std::int16_t first = 0, second = 0;
};
std::optional<BandValues> ReadBandBoxes(std::string_view first, std::string_view second);
inline constexpr std::string_view kBandsMessage = "Values must be between 0 - 100";
inline constexpr std::string_view kBandsTitle = "Bands";

// The percent of the stop loss, a number from 0 to 100, or nothing, which is told as
// kStopLossMessage.
std::optional<float> ReadStopLossPercent(std::string_view text);
inline constexpr std::string_view kStopLossMessage = "Invalid value - must be between 0 and 100";
inline constexpr std::string_view kStopLossTitle = "Stop Loss";

}  // namespace kora
