#pragma once

#include <string>
#include <vector>

#include "base/dates.h"
#include "indicators/osc_panel.h"
#include "tests/support/recording_surface.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {

// A price picture of 638 x 308 with a panel of 144 below it, plot from 42 to 630, and bars that
// a test sets.
struct OscFixture {
  TempHome home;
  ScriptedDialogs dialogs;
  Settings settings;
  ChartColours colours{};
  ChartRequest request;
  Composition chart;
  RecordingSurface price{638, 308};
  RecordingSurface panel{638, 144};
  ChartScript script;
  OscHost host{home.files(), dialogs, settings, colours, request, chart, price, panel, &script};

  OscFixture() {
    // Entry n has the colour n, so that a test reads entries.
    for (size_t i = 0; i < colours.size(); ++i) colours[i] = std::int32_t(i);
    request.Name = NewNameRec("TEST");
    request.BarSpacing = 2;
    chart.BarSpacing = 2;
    chart.ChartLeft = chart.FirstBarX = 42;
    chart.ChartRight = 630;
    chart.ChartTop = 40;
    chart.ChartBottom = 290;
    chart.DataFile = "TEST.WDT";
  }

  // Bars of days from 3 January 2000 on, all four prices equal to the close.
  void Closes(const std::vector<float>& closes) {
    chart.Bars.bars.clear();
    for (const float c : closes) {
      ChartBar bar{};
      bar.Open = bar.High = bar.Low = bar.Close = c;
      AddBar(bar);
    }
  }
  void AddBar(ChartBar bar) {
    const std::string date =
        FormatFileDate(DateOfDayNumber(10959 + std::int32_t(chart.Bars.bars.size())));
    date.copy(bar.Date, 8);
    chart.Bars.bars.push_back(bar);
    chart.Bars.BarCount = static_cast<std::int16_t>(chart.Bars.bars.size() - 1);
    chart.Bars.FirstDataRec = 1;
    chart.Bars.LastDataRec = static_cast<std::int16_t>(chart.Bars.bars.size());
  }
  // The script's lines that begin with `letter`, without line ends.
  std::vector<std::string> Lines(char letter) const {
    std::vector<std::string> out;
    LineReader reader(script.text());
    std::string_view line;
    while (reader.Next(line))
      if (!line.empty() && line[0] == letter) out.emplace_back(line);
    return out;
  }
};

}  // namespace kora::test
