#pragma once

#include "chart/composition.h"

namespace kora::test {

// A chart without bars: left 42, spacing 4; 430 is the price 10, each unit up 0.05.
inline Composition EmptyChart() {
  Composition chart;
  chart.ChartLeft = 42;
  chart.ChartRight = 631;
  chart.ChartTop = 45;
  chart.ChartBottom = 430;
  chart.VolTop = 430;
  chart.VolBottom = 450;
  chart.BarSpacing = 4;
  chart.Scale.ScaleLow = 10;
  chart.Scale.ScaleHigh = 0.05f;
  chart.Price.ScaleLow = 10;
  chart.Price.PricePerY = 0.05f;
  chart.Price.ChartBottom = 430;
  return chart;
}

}  // namespace kora::test
