#pragma once

#include <cstdint>

#include "chart/composition.h"
#include "chartwindow/tools/band.h"
#include "chartwindow/tools/chart_tool.h"

namespace kora {

// Where a cross hair may stand, and how far its lines reach.
struct CrossLimits {
  std::int16_t Left = 0, Right = 0, Top = 0, Bottom = 0;
  bool Columns = true;  // false on point-and-figure charts: no vertical lines
  std::int16_t PanelTop = 0, PanelBottom = 0;

  bool Holds(double x, double y) const {
    return x >= Left && x <= Right && y >= Top && y <= Bottom;
  }
};
// The limits of a chart. The lower one is VolBottom, the lowest y of the whole plot with its
// volume panel. Two charts one below the other (`split`) begin at `panelTop`; that is also where
// the lines of an oscillator picture begin.
CrossLimits LimitsOf(const Composition& chart, Style ChartStyle, bool split = false,
                     std::int16_t panelTop = 0, std::int16_t panelBottom = 0);

// A line from the left edge to the pointer, one from there down, and one over the whole height
// of the oscillator picture.
class CrossHair {
 public:
  // `panel` is null where no oscillator shows. Neither is owned.
  CrossHair(Surface& price, Surface* panel, Colour colour)
      : price_(price), panel_(panel), band_(DrawStyle::kDot, colour) {}

  // Takes the cross hair from where it stands to (x, y). Outside the limits there is none;
  // false then.
  bool Move(double x, double y, const CrossLimits& limits);
  void Erase();
  void Forget() { band_.Forget(); }
  bool Drawn() const { return band_.Drawn(); }
  void Flip() const { band_.Flip(); }
  void SetTouched(TouchedFn touched) { band_.Touched = std::move(touched); }

  double GridX() const { return x_; }
  double GridY() const { return y_; }

 private:
  Surface& price_;
  Surface* panel_;
  Band band_;
  double x_ = 0, y_ = 0;  // 0: none drawn
};

// The tool: the cross hair at the pointer, and the bar or price under it in the status panels.
class CrossHairTool : public ChartTool {
 public:
  explicit CrossHairTool(ToolView& view);

  ToolState Move(const ToolPoint& at) override;
  ToolState Release(const ToolPoint& at, MouseButton button) override;
  // Along the closes.
  bool FollowsCloses() const override { return true; }
  void Recomposed() override;
  void Hide() override { cross_.Flip(); }
  void Show() override { cross_.Flip(); }
  void Forget() override { cross_.Forget(); }
  void Leave() override { cross_.Erase(); }

 private:
  ToolView& view_;
  CrossHair cross_;
};

}  // namespace kora
