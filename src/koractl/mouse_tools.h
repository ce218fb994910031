#pragma once

#include <string>
#include <vector>

#include "chart/chart_script.h"
#include "chartwindow/tools/chart_tool.h"
#include "koractl/run.h"

// The tools of the mouse on a chart that was composed without a window.

namespace kora {

// "100,200,150,180" as so many numbers. Usage error for anything else.
std::vector<double> ReadPlaces(const std::string& option, const std::string& text, size_t count);

// What a tool sees of a chart on a surface. What it keeps goes behind the script.
class ToolStage {
 public:
  // Nothing is owned. `script` is in memory.
  ToolStage(Run& run, const Composition& chart, const ChartRequest& request, Surface& price,
            ChartScript& script);
  ToolView& view() { return view_; }
  const StatusPanels& panels() const { return panels_; }

 private:
  Arrangement arrangement_ = Arrangement::kOne;
  PanelFrame panelFrame_;
  bool fromFile_ = false, swing_ = false;
  StatusPanels panels_;
  std::string title_;
  std::vector<TrendlineRow> rows_;
  ToolView view_;
};

// Two clicks of the Fibonacci tool at x1, y1, x2, y2; the texts of its panels go to standard
// error, one a line.
void AddLevels(Run& run, const Composition& chart, const ChartRequest& request, Surface& price,
               ChartScript& script, const std::vector<double>& places);

}  // namespace kora
