#include "chartwindow/tools/fibonacci.h"

#include <algorithm>

#include "base/numbers.h"

namespace kora {
namespace {

constexpr double kLevelWidth = 150;
struct Level {
  double factor;
  int panel;
  const char* label;
  int colour;
};
constexpr Level kLevels[] = {{0.38, 6, "38%    ", kAverage2},
                             {0.5, 7, "50%    ", kAverage3},
                             {0.62, 8, "62%    ", kAverage2}};

}  // namespace

double FibonacciTool::PriceAt(double y) const {
  return view_.request.ChartStyle == Style::kPointFigure
             ? PFPixelToPrice(view_.chart, view_.boxes, y)
             : PixelToPrice(view_.chart, y);
}

double FibonacciTool::YOf(double price) const {
  return view_.request.ChartStyle == Style::kPointFigure
             ? PFPriceToPixel(view_.chart, view_.boxes, price)
             : PriceToPixel(view_.chart, price);
}

void FibonacciTool::ShowPrice(int panel, std::string_view word, double price) const {
  view_.panels[size_t(panel) - 1] = std::string(word) + Format(price, "#####.00#");
}

ToolState FibonacciTool::Press(const ToolPoint& at, MouseButton button) {
  if (button != MouseButton::kLeft || at.pane != Pane::kPrice || !view_.Readable())
    return ToolState::kOn;
  const double price = PriceAt(at.y);
  if (FibStep_ == 0) {
    view_.ClearPanels();
    if (price == 0) return ToolState::kOn;
    FibStart_ = CSng(price);
    ShowPrice(3, "Start  ", double(FibStart_));
    FibStep_ = 1;
    return ToolState::kOn;
  }
  if (price == 0) {
    FibStep_ = 0;
    return ToolState::kOn;
  }
  const double end = double(CSng(price)), rise = end - double(FibStart_);
  ShowPrice(3, "Start  ", double(FibStart_));
  ShowPrice(4, "End   ", end);
  ShowPrice(5, "Rise   ", rise);
  if (rise < 0) return ToolState::kOn;  // a fall has no levels
  const double x1 = RoundHalfEven(at.x);
  const double x2 = std::min(x1 + kLevelWidth, double(view_.chart.ChartRight));
  for (const Level& level : kLevels) {
    const double value = end - rise * level.factor;
    ShowPrice(level.panel, level.label, value);
    const double y = YOf(value);
    if (y == 0) return ToolState::kOn;
    const Colour colour = view_.colours[size_t(level.colour)];
    view_.price.SetDrawStyle(DrawStyle::kDot);
    view_.price.Line(x1, y, x2, y, colour);
    view_.price.SetDrawStyle(DrawStyle::kSolid);
    view_.Touched(view_.price, x1, y, x2, y);
    view_.Keep({'D', x1, y, x2, y, colour});
  }
  FibStep_ = 0;
  return ToolState::kOn;
}

}  // namespace kora
