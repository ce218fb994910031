#pragma once

#include "chartwindow/tools/chart_tool.h"

namespace kora {

// Retracement levels of a rise: the first click its start, the second its end, each at the price
// of the pointer. Falls have none. The levels belong to this chart alone.
class FibonacciTool : public ChartTool {
 public:
  explicit FibonacciTool(ToolView& view) : view_(view) {}

  ToolState Press(const ToolPoint& at, MouseButton button) override;
  void Recomposed() override { FibStep_ = 0; }

 private:
  double PriceAt(double y) const;
  double YOf(double price) const;
  void ShowPrice(int panel, std::string_view word, double price) const;

  ToolView& view_;
  int FibStep_ = 0;  // 1 after the first click
  float FibStart_ = 0;
};

}  // namespace kora
