#pragma once

#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "base/dates.h"
#include "base/numbers.h"
#include "indicators/oscillators.h"
#include "tests/support/places.h"
#include "tests/support/recording_surface.h"
#include "tests/support/script_lines.h"
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
  std::vector<std::string> Lines(char letter) const { return LinesOf(script, letter); }
};

struct Bar {
  float high, low, close;
  std::int32_t volume = 0;
};

// Bars of days with a range; the open is the close.
inline void SetBars(OscFixture& f, const std::vector<Bar>& bars) {
  f.chart.Bars.bars.clear();
  f.chart.Bars.BarCount = -1;
  for (const Bar& b : bars) {
    ChartBar bar{};
    bar.Open = bar.Close = b.close;
    bar.High = b.high;
    bar.Low = b.low;
    bar.Volume = b.volume;
    f.AddBar(bar);
  }
}

// Every oscillator period at one value.
inline void SetAllPeriods(OscFixture& f, std::int16_t period) {
  for (const OscKey& key : OscKeys()) f.settings.osc[key] = {period, period};
}

// A price map of `perY` a unit above `bottom`, from 0 up.
inline void SetPriceMap(OscFixture& f, float perY, std::int16_t bottom = 290) {
  f.chart.Price = PriceMap{};
  f.chart.Price.PricePerY = perY;
  f.chart.Price.ChartBottom = bottom;
}

// The days of a file of real prices ("code,yyyymmdd,open,high,low,close,volume,..."), nothing
// where there are no such files on this machine.
inline std::vector<ChartBar> RealBars(const std::string& code) {
  std::vector<ChartBar> bars;
  std::ifstream file(DataDir() + "/" + code + ".csv");
  std::string line;
  while (std::getline(file, line)) {
    std::istringstream fields(line);
    std::string name, date;
    std::getline(fields, name, ',');
    std::getline(fields, date, ',');
    ChartBar bar{};
    char comma;
    if (date.size() != 8 || !(fields >> bar.Open >> comma >> bar.High >> comma >> bar.Low >>
                              comma >> bar.Close >> comma >> bar.Volume))
      continue;
    date.copy(bar.Date, 8);
    bars.push_back(bar);
  }
  return bars;
}

// Real prices, volumes in thousands. False where there are none on this machine.
inline bool SetRealBars(OscFixture& f, const std::string& code) {
  const std::vector<ChartBar> days = RealBars(code);
  std::vector<Bar> bars;
  for (const ChartBar& day : days)
    bars.push_back({day.High, day.Low, day.Close, day.Volume / 1000});
  SetBars(f, bars);
  return !bars.empty();
}

// The numbers of a script line behind its letter.
inline std::vector<double> Numbers(const std::string& line) {
  std::vector<double> out;
  std::stringstream fields(line.substr(line.find(',') + 1));
  for (std::string field; std::getline(fields, field, ',');) out.push_back(Val(field));
  return out;
}

// The script's lines of a letter in a colour, as x1, y1, x2, y2 with y on the panel.
inline std::vector<std::vector<double>> Drawn(const OscFixture& f, char letter, int colour,
                                              double offset = 308) {
  std::vector<std::vector<double>> out;
  for (const std::string& line : f.Lines(letter)) {
    std::vector<double> n = Numbers(line);
    if (int(n.back()) != colour) continue;
    n.pop_back();
    for (size_t i = 1; i < n.size(); i += 2) n[i] -= offset;
    out.push_back(n);
  }
  return out;
}

}  // namespace kora::test

#define EXPECT_SEGMENT(actual, x1, y1, x2, y2)     \
  do {                                             \
    const std::vector<double> segment_ = (actual); \
    ASSERT_EQ(segment_.size(), 4u);                \
    EXPECT_NEAR(segment_[0], x1, 1e-3);            \
    EXPECT_NEAR(segment_[1], y1, 1e-3);            \
    EXPECT_NEAR(segment_[2], x2, 1e-3);            \
    EXPECT_NEAR(segment_[3], y2, 1e-3);            \
  } while (false)
