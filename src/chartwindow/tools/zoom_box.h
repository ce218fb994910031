#pragma once

#include <optional>

#include "chartwindow/tools/chart_tool.h"

namespace kora {

// A rectangle of the price picture, x1 below x2 and y1 below y2.
struct ZoomBox {
  double x1 = 0, y1 = 0, x2 = 0, y2 = 0;
};
// The rectangle between two corners; nothing where it has no width or no height.
std::optional<ZoomBox> ZoomBoxOf(double x1, double y1, double x2, double y2);

// Drags a box over the part of the chart that is to be enlarged: from where the button goes down
// to where it goes up.
class ZoomBoxTool : public ChartTool {
 public:
  ZoomBoxTool(ToolView& view, std::function<void(const ZoomBox&)> zoom);

  ToolState Move(const ToolPoint& at) override;
  ToolState Press(const ToolPoint& at, MouseButton button) override;
  ToolState Release(const ToolPoint& at, MouseButton button) override;
  // The first puts one corner down, the second the other.
  ToolState Click(const ToolPoint& at) override;
  void Recomposed() override;
  void Hide() override { band_.Flip(); }
  void Show() override { band_.Flip(); }
  void Forget() override { band_.Forget(); }
  void Leave() override { band_.Erase(); }
  std::function<void()> Afterwards() override;

 private:
  ToolView& view_;
  Band band_;
  std::function<void(const ZoomBox&)> zoom_;
  bool AwaitFirstPoint_ = true;
  ToolPoint first_;
  std::optional<ZoomBox> box_;
};

}  // namespace kora
