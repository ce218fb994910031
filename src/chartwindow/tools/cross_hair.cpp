#include "chartwindow/tools/cross_hair.h"

#include <algorithm>

#include "base/numbers.h"
#include "chartwindow/tools/read_out.h"

namespace kora {

CrossLimits LimitsOf(const Composition& chart, Style ChartStyle, bool split, std::int16_t panelTop,
                     std::int16_t panelBottom) {
  CrossLimits limits;
  limits.Left = chart.ChartLeft;
  limits.Right = chart.ChartRight;
  limits.Top = split ? panelTop : chart.ChartTop;
  limits.Bottom = chart.VolBottom;
  limits.Columns = ChartStyle != Style::kPointFigure;
  limits.PanelTop = panelTop;
  limits.PanelBottom = panelBottom;
  return limits;
}

bool CrossHair::Move(double x, double y, const CrossLimits& limits) {
  if (!limits.Holds(x, y)) {
    Erase();
    return false;
  }
  std::vector<Band::Shape> lines;
  lines.reserve(3);
  if (limits.Columns) {
    lines.push_back({&price_, x, y, x, double(limits.Bottom)});
    if (panel_ && panel_->Visible())
      lines.push_back({panel_, x, double(limits.PanelTop), x, double(limits.PanelBottom)});
  }
  lines.push_back({&price_, double(limits.Left), y, x, y});
  band_.Draw(lines);
  x_ = x;
  y_ = y;
  return true;
}

void CrossHair::Erase() {
  band_.Erase();
  x_ = y_ = 0;
}

CrossHairTool::CrossHairTool(ToolView& view)
    : view_(view), cross_(view.price, &view.panel, view.colours[kMovingGrid]) {
  cross_.SetTouched(view.Touched);
}

ToolState CrossHairTool::Move(const ToolPoint& at) {
  if (at.pane != Pane::kPrice) return ToolState::kOn;
  // What the pointer reads are the tables of a composition, not what a saved chart shows.
  if (!view_.Readable()) {
    view_.ClearPanels();
    return ToolState::kOn;
  }
  const Composition& chart = view_.chart;
  const ChartRequest& request = view_.request;
  if (!cross_.Move(at.x, at.y,
                   LimitsOf(chart, request.ChartStyle, IsSplit(view_.arrangement),
                            view_.panelFrame.Top, view_.panelFrame.Bottom))) {
    view_.ClearPanels();
    return ToolState::kOn;
  }
  const std::int16_t type = request.Name.RecType;
  if (request.ChartStyle == Style::kPointFigure) {
    view_.panels[3] = Format(PFPixelToPrice(chart, view_.boxes, at.y), ReadoutFormat(type));
  } else if (!IsPair(view_.arrangement)) {
    if (const auto texts = BarReadout(chart, type, ColumnOf(chart, at.x)))
      std::copy(texts->begin(), texts->end(), view_.panels.begin() + 2);
  }
  return ToolState::kOn;
}

ToolState CrossHairTool::Release(const ToolPoint&, MouseButton button) {
  return button == MouseButton::kLeft ? ToolState::kDone : ToolState::kOn;
}

// What it read is of the chart before, and must not stand under this one.
void CrossHairTool::Recomposed() {
  cross_.Erase();
  view_.ClearPanels();
}

}  // namespace kora
