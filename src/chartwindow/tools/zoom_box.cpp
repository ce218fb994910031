#include "chartwindow/tools/zoom_box.h"

#include <algorithm>
#include <utility>

namespace kora {

std::optional<ZoomBox> ZoomBoxOf(double x1, double y1, double x2, double y2) {
  if (x1 == x2 || y1 == y2) return std::nullopt;
  return ZoomBox{std::min(x1, x2), std::min(y1, y2), std::max(x1, x2), std::max(y1, y2)};
}

ZoomBoxTool::ZoomBoxTool(ToolView& view, std::function<void(const ZoomBox&)> zoom)
    : view_(view), band_(DrawStyle::kDot, view.colours[kMovingGrid]), zoom_(std::move(zoom)) {
  band_.Touched = view.Touched;
}

ToolState ZoomBoxTool::Move(const ToolPoint& at) {
  const Composition& c = view_.chart;
  if (AwaitFirstPoint_ || at.pane != Pane::kPrice || at.x < c.ChartLeft || at.x > c.ChartRight ||
      at.y < c.ChartTop || at.y > c.ChartBottom)
    return ToolState::kOn;
  band_.Draw({{&view_.price, first_.x, first_.y, at.x, at.y, true}});
  return ToolState::kOn;
}

ToolState ZoomBoxTool::Press(const ToolPoint& at, MouseButton button) {
  // The right button gives it up.
  if (button == MouseButton::kRight) return ToolState::kDone;
  if (!view_.Readable() || at.pane != Pane::kPrice) return ToolState::kOn;
  if (AwaitFirstPoint_) first_ = at;
  AwaitFirstPoint_ = !AwaitFirstPoint_;
  return ToolState::kOn;
}

ToolState ZoomBoxTool::Release(const ToolPoint& at, MouseButton button) {
  if (button != MouseButton::kLeft || AwaitFirstPoint_) return ToolState::kOn;
  AwaitFirstPoint_ = true;
  band_.Erase();
  // What lies outside the frame shows nothing.
  const Composition& c = view_.chart;
  const auto x = [&](double v) { return std::clamp<double>(v, c.ChartLeft, c.ChartRight); };
  const auto y = [&](double v) { return std::clamp<double>(v, c.ChartTop, c.ChartBottom); };
  box_ = ZoomBoxOf(x(first_.x), y(first_.y), x(at.x), y(at.y));
  return ToolState::kDone;
}

ToolState ZoomBoxTool::Click(const ToolPoint& at) {
  return AwaitFirstPoint_ ? Press(at, MouseButton::kLeft) : Release(at, MouseButton::kLeft);
}

void ZoomBoxTool::Recomposed() {
  band_.Erase();
  AwaitFirstPoint_ = true;
}

std::function<void()> ZoomBoxTool::Afterwards() {
  if (!box_) return {};
  return [zoom = zoom_, box = *box_] { zoom(box); };
}

}  // namespace kora
