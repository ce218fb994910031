#pragma once

#include "chartwindow/tools/chart_tool.h"

namespace kora {

// A line between two clicks, with a band from the first to the pointer. On the price picture it
// is offered for saving and ends the tool; lines of the oscillator picture are of this chart
// alone, and the tool stays on.
class TrendlineTool : public ChartTool {
 public:
  explicit TrendlineTool(ToolView& view);

  ToolState Move(const ToolPoint& at) override;
  ToolState Release(const ToolPoint& at, MouseButton button) override;
  ToolState Click(const ToolPoint& at) override { return Release(at, MouseButton::kLeft); }
  void Recomposed() override;
  void Hide() override { band_.Flip(); }
  void Show() override { band_.Flip(); }
  void Forget() override { band_.Forget(); }
  void Leave() override { band_.Erase(); }

 private:
  Surface& surface() { return first_.pane == Pane::kPrice ? view_.price : view_.panel; }
  bool Inside(const ToolPoint& at) const;

  ToolView& view_;
  Band band_;
  bool AwaitFirstPoint_ = true;
  ToolPoint first_, second_;
};

// Draws the finished line, adds it to what the mouse has drawn on this chart, and offers to save
// it with the security unless a swing chart is on show.
void FinishTrendline(ToolView& view, const ScreenLine& line);
// "Save Trendline", Yes and No. A line that has no dates on this chart is not kept, in silence. A
// file that can't be written is told; it stays as it was, and the line on the picture.
void OfferTrendline(ToolView& view, const ScreenLine& line);

}  // namespace kora
