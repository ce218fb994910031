#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "chart/chart_layout.h"
#include "chart/chart_scale.h"
#include "store/chart_bars.h"

namespace kora {

// The boxes of a point-and-figure chart.
struct PFBoxes {
  float PFBoxSize = 0;           // price
  std::int16_t PFBoxPixels = 0;  // chart units
};

// What stands on the chart. Each composition fills it anew; what must survive from one to the
// next does so because the same object is filled again. The mouse tools, overlays and
// oscillators read it, never the script.
struct Composition : ChartLayout {
  ChartBars Bars;

  std::int16_t VolTop = 0, VolBottom = 0;  // VolBottom is the lower edge of the whole plot
  std::int16_t LastBarX = 0;               // x after the last bar

  ChartScale Scale;
  PriceMap Price;
  VolumeMap Volume;
  PFBoxes Boxes;         // of a point-and-figure chart
  std::string VolLabel;  // unit of the volumes: "'000", empty none

  std::vector<std::int16_t> CloseY;  // y of each bar's close, in order from index 0
  std::int16_t CloseYCount() const { return static_cast<std::int16_t>(CloseY.size()); }

  float LastClose = 0;
  std::int16_t UpperBarCount = 0;  // BarCount of the first of two charts
  std::int16_t UpperLeft = 0;      // and its ChartLeft
  bool ScaleMissing = false;       // a manual scale was asked for and there is none
  bool ChartDrawn = false;         // the composition ended without a failure
  std::string DataFile;            // "ORE.WDT", for messages
  double SurfaceHeight = 0;
  double TitleBottom = 0;  // below the line of code and name
};

}  // namespace kora
