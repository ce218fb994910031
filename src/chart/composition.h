#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "chart/chart_scale.h"
#include "store/chart_bars.h"

namespace kora {

// What stands on the chart. Each composition fills it anew; what must survive from one to the
// next does so because the same object is filled again. The mouse tools, overlays and
// oscillators read it, never the script.
struct Composition {
  // Set by the window before composing.
  std::int16_t OscPanel = 0;       // 0 price chart; 1, 2 superimposed charts; -1 second pass
  bool TwoCharts = false;
  std::int16_t ChartSlot = 0;      // with TwoCharts 1 upper, 2 lower; the composer moves it on

  ChartBars Bars;

  // Plot frame, chart units.
  std::int16_t ChartLeft = 0, ChartRight = 0, ChartTop = 0, ChartBottom = 0;
  std::int16_t VolTop = 0, VolBottom = 0;  // VolBottom is the lower edge of the whole plot
  std::int16_t ChartMiddle = 0;
  std::int16_t FirstBarX = 0;
  std::int16_t LastBarX = 0;       // x after the last bar
  std::int16_t BarSpacing = 2;     // as used, never 0
  double PlotWidth = 0;

  ChartScale Scale;
  PriceMap Price;
  VolumeMap Volume;
  std::string VolLabel;            // unit of the volumes: "'000", empty none

  std::vector<std::int16_t> CloseY;  // y of each bar's close, in order from index 0
  std::int16_t CloseYCount() const { return static_cast<std::int16_t>(CloseY.size()); }

  float LastClose = 0;
  std::int16_t UpperBarCount = 0;  // BarCount of the first of two charts
  bool ScaleMissing = false;       // a manual scale was asked for and there is none
  bool ChartDrawn = false;         // the composition ended without a failure
  std::string DataFile;            // "ORE.WDT", for messages
  double SurfaceHeight = 0;
};

}  // namespace kora
