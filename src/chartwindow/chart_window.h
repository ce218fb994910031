#pragma once

#include <cstdint>
#include <string>

#include "chart/chart_request.h"
#include "chart/composer.h"
#include "chart/composition.h"
#include "store/name_file.h"

namespace kora {

// What the chart window works with. Nothing is owned.
struct ChartWindowServices {
  const Files& files;
  Dialogs& dialogs;
  const Settings& settings;
  const ChartColours& colours;
  CurrentName& current;
  Surface& price;
  Surface* panel = nullptr;
};

// The rules of the chart window: which security comes next, and when it is composed. The form
// shows the surfaces and passes on what the user does.
class ChartWindow {
 public:
  explicit ChartWindow(const ChartWindowServices& services);

  // Moves on to the next chart with wrap and draws it. False when nothing was composed: the
  // reason was told, and `ChartIndex` is 0 when there is no chart to show.
  bool NextChart();
  // One chart forward or backward by ChartDirection, with wrap.
  bool StepChart();
  // The current chart once more: one back, then the next.
  bool Redraw();
  // Composes the security in hand.
  bool DrawChart();

  // The window's title: "KORA Charting 7F   -  CHARTS  c:\korawin\data\".
  std::string Title() const;

  bool Loading = true;             // no handler composes while it is true
  std::int16_t ChartIndex = 0;     // place in the list, from 1; 0 no chart
  std::int16_t ChartListNo = 1;    // 1 all names
  std::int16_t ChartDirection = 1; // 1 forward, 0 backward
  bool SplitScreen = false;

  ChartRequest Request;
  Composition Chart;

 private:
  // Moves ChartIndex by `step`, loads that record and draws.
  bool Move(int step);
  bool LoadRecord(int step);
  void EmptyDrawnLines();

  ChartWindowServices services_;
};

}  // namespace kora
