#pragma once

#include <string>

#include "chartwindow/tools/chart_tool.h"

namespace kora {

// Text typed onto the chart: a click says where, Enter keeps it with the security under the date
// and the price of that place.
class TextNoteTool : public ChartTool {
 public:
  explicit TextNoteTool(ToolView& view) : view_(view) {}

  ToolState Press(const ToolPoint& at, MouseButton button) override;
  ToolState Type(char32_t character) override;
  bool TakesText() const override { return !TextPending_; }
  bool Cross() const override { return true; }
  void Recomposed() override;
  void Forget() override { TextBuffer_.clear(); }
  void Leave() override;

 private:
  void Print(int entry) const;
  ToolState Save();

  ToolView& view_;
  bool TextPending_ = true;  // its place is not known yet
  std::string TextBuffer_;
  double TextX_ = 0, TextY_ = 0;
};

}  // namespace kora
