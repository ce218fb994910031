#pragma once

#include <algorithm>
#include <array>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "base/files.h"
#include "chart/chart_request.h"
#include "chart/composition.h"
#include "chartwindow/tools/arrangement.h"
#include "chartwindow/tools/band.h"
#include "chartwindow/tools/read_out.h"
#include "chartwindow/tools/trendline_places.h"
#include "looks/colours.h"
#include "platform/dialogs.h"
#include "platform/surface.h"
#include "settings/settings.h"

namespace kora {

// The tools of the mouse. Each is one file of this folder; it gets what the user does in chart
// units, keeps its own state, and says when it is done. The window keeps which one is on.

enum class Pane { kPrice, kPanel };
enum class MouseButton { kLeft, kRight };
enum class ToolState { kOn, kDone };

// A place on one of the two pictures, in its chart units.
struct ToolPoint {
  double x = 0, y = 0;
  Pane pane = Pane::kPrice;
};

// The plot of the oscillator picture, its chart units.
struct PanelFrame {
  std::int16_t Left = 0, Right = 0, Top = 0, Bottom = 0;
};

// What the mouse has drawn on this chart: a line of the script, "H" a trendline, "D" a level, "M" a
// line of the oscillator picture (its y below the price picture), "T" a text at (x1, y1).
struct DrawnMark {
  char letter;
  double x1 = 0, y1 = 0, x2 = 0, y2 = 0;
  Colour colour = 0;
  std::string text = {};
};
// Its line in the script, with its end.
std::string LineOf(const DrawnMark& mark);

using StatusPanels = std::array<std::string, 8>;

// What a tool sees of the chart window. Nothing is owned; it stands as long as the window.
struct ToolView {
  // The chart on show.
  const Composition& chart;
  const ChartRequest& request;
  const Arrangement& arrangement;
  const PFBoxes& boxes;
  const PanelFrame& panelFrame;
  const bool& chartFromFile;

  // What is drawn on, and with.
  Surface& price;
  Surface& panel;
  const ChartColours& colours;
  const Settings& settings;

  // What is told and kept.
  Dialogs& dialogs;
  const Files& files;
  StatusPanels& panels;  // panels[0] is panel 1
  std::string& title;    // of the window; it comes back as the tool is left
  const bool& SwingOn;
  std::vector<TrendlineRow>& rows;  // where the saved lines stand; row i is record i + 1

  TouchedFn Touched;
  // Adds a mark to what was drawn on this chart, so that it is saved and printed with it. What
  // can't be written is told.
  std::function<void(const DrawnMark&)> Keep;

  // A chart stands that was composed: its tables can be read.
  bool Readable() const { return chart.ChartDrawn && !chartFromFile; }
  // Panels 3 to the last.
  void ClearPanels() const { std::fill(panels.begin() + 2, panels.end(), std::string()); }
};

class ChartTool {
 public:
  virtual ~ChartTool() = default;

  virtual ToolState Move(const ToolPoint&) { return ToolState::kOn; }
  virtual ToolState Press(const ToolPoint&, MouseButton) { return ToolState::kOn; }
  virtual ToolState Release(const ToolPoint&, MouseButton) { return ToolState::kOn; }
  // Enter at the point that the keys have moved: a press and its release.
  virtual ToolState Click(const ToolPoint& at) {
    if (Press(at, MouseButton::kLeft) == ToolState::kDone) return ToolState::kDone;
    return Release(at, MouseButton::kLeft);
  }
  // A typed character, Backspace (8) and Enter (13); only while it takes text.
  virtual ToolState Type(char32_t) { return ToolState::kOn; }
  virtual bool TakesText() const { return false; }
  // The pointer is a cross.
  virtual bool Cross() const { return false; }
  // The keys go from close to close.
  virtual bool FollowsCloses() const { return false; }

  // Another composition is about to stand on the pictures.
  virtual void Recomposed() { Forget(); }
  // Takes away what stands only while the tool is on, and brings it back: for those who read
  // the pictures.
  virtual void Hide() {}
  virtual void Show() {}
  // The pictures are blank: there is nothing to take away.
  virtual void Forget() {}
  // The tool is left, done or not.
  virtual void Leave() {}
  // What the window does once the tool is done and has left. May be empty.
  virtual std::function<void()> Afterwards() { return {}; }
};

}  // namespace kora
