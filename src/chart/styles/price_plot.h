#pragma once

#include <cstdint>
#include <optional>

#include "chart/price_averages.h"
#include "chart/scale_drawing.h"
#include "chart/styles/style_drawer.h"

namespace kora {

// Sets ScaleLow, ScaleHigh and the grid from the bars, or from the name record where the scale
// is manual. A scale that is not there sets ScaleMissing and is refused; `whole`: one with a 0 at
// one end too.
void SetUpRange(const ChartCanvas& canvas, bool whole);
// The same, and then the way from prices to y; `line`: as the settings have it for lines. A
// logarithmic scale of negative prices is refused.
void SetUpScale(const ChartCanvas& canvas, bool line);

// What stands with the prices bar by bar, whatever they are drawn as: volumes, notes of
// adjustments, the smoothing line, the date axis.
class PricePlot {
 public:
  // Sets up price scale and volume scale.
  PricePlot(const StyleWork& work, bool line);

  std::optional<std::int16_t> VolumeY(const ChartBar& bar) const;
  void DrawVolume(double x, std::optional<std::int16_t> y);
  // Where the bar has an adjustment.
  void DrawAdjustment(const ChartBar& bar, double x);
  void DrawDate(const ChartBar& bar, double x) { axis_.Bar(bar.date(), x); }
  void Smooth(std::int16_t closeY, double x);

 private:
  const StyleWork& work_;
  const ChartCanvas& canvas_;
  const ChartRequest& request_;
  Composition& chart_;
  DateAxis axis_;
  CloseSmoother smoother_;
  int smoothed_ = 0;
};

}  // namespace kora
