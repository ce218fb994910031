#pragma once

#include "chartwindow/tools/chart_tool.h"

namespace kora {

// Takes a saved line along with the pointer; the next click puts it down. What is put down is a
// line of its own: the saved one stays where it is until it is deleted.
class MoveTrendlineTool : public ChartTool {
 public:
  // `from`: where the pointer took hold of the line.
  MoveTrendlineTool(ToolView& view, const TrendlineRow& row, const ToolPoint& from);

  ToolState Move(const ToolPoint& at) override;
  ToolState Release(const ToolPoint& at, MouseButton button) override;
  ToolState Click(const ToolPoint& at) override { return Release(at, MouseButton::kLeft); }
  void Hide() override { band_.Flip(); }
  void Show() override { band_.Flip(); }
  void Forget() override { band_.Forget(); }
  void Recomposed() override { band_.Erase(); }
  void Leave() override { band_.Erase(); }
  bool Cross() const override { return true; }

 private:
  ToolView& view_;
  Band band_;
  ScreenLine offsets_;  // of both ends from the pointer
};

}  // namespace kora
