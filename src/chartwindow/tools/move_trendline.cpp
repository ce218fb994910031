#include "chartwindow/tools/move_trendline.h"

#include "chartwindow/tools/trendline.h"

namespace kora {

MoveTrendlineTool::MoveTrendlineTool(ToolView& view, const TrendlineRow& row, const ToolPoint& from)
    : view_(view),
      band_(DrawStyle::kSolid, view.colours[kTrendlines]),
      offsets_{row.x1 - from.x, row.y1 - from.y, row.x2 - from.x, row.y2 - from.y} {
  band_.Touched = view.Touched;
}

ToolState MoveTrendlineTool::Move(const ToolPoint& at) {
  if (at.pane == Pane::kPrice)
    band_.Draw({{&view_.price, at.x + offsets_.x1, at.y + offsets_.y1, at.x + offsets_.x2,
                 at.y + offsets_.y2}});
  return ToolState::kOn;
}

ToolState MoveTrendlineTool::Release(const ToolPoint& at, MouseButton button) {
  if (button != MouseButton::kLeft || at.pane != Pane::kPrice) return ToolState::kOn;
  band_.Erase();
  if (view_.Readable())
    FinishTrendline(
        view_, {at.x + offsets_.x1, at.y + offsets_.y1, at.x + offsets_.x2, at.y + offsets_.y2});
  return ToolState::kDone;
}

}  // namespace kora
