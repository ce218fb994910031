#pragma once

#include <cstdint>
#include <string>

#include "chart/chart_request.h"

namespace kora {

// What the chart window is doing; a code, since forms ask for it by number.
enum ChartTaskCode : std::int16_t {
  kTaskNone = 0,
  kTaskColours = 3,
  kTaskNewChart = 4,
  kTaskTrendline = 7,
  kTaskGrid = 8,
  kTaskZoom = 10,
  kTaskAutoScroll = 14,
  kTaskPrinting = 15,
  kTaskSaving = 16,
  kTaskSuperimpose = 20,
  kTaskFibonacciOrSplit = 22,
  kTaskSelectionDefaults = 777,
  kTaskChartDefaults = 888,
};

// The shared values of chart selection and chart window: which chart is asked for, and how.
// They live as long as the program; both forms read and write them.
struct ChartState {
  // Which security.
  std::int16_t ChartIndex = 0;      // place in the list, from 1; 0 no chart shown
  std::int16_t ChartListNo = 1;     // 1 all of Names.dat, 2 to 12 chart lists
  std::int16_t ChartListCount = 0;  // records in the open chart list
  std::int16_t ChartDirection = 1;  // 1 forward, 0 backward
  std::string ChartListName;        // as shown
  bool ChartListChanged = false;    // set by the list chooser, taken by chart selection
  bool ICFilterOn = false;          // only securities of one industry class or group
  std::string ICFilter;

  // How it is drawn.
  Style ChartStyle = Style::kBar;
  Period ChartPeriod = Period::kDaily;
  std::int16_t BarSpacing = 2;
  std::int16_t BandKind = 0;
  bool Ma1On = false, Ma2On = false;
  bool VolumeOption = true;
  bool OscShown = false;    // an oscillator pane is requested
  std::string OscCode;      // the oscillator on show, empty none
  std::string OscSelected;  // the one chosen in chart selection, or kept from the menu
  bool KeepOsc = false;     // one picked from the menu stays for the charts that follow
  bool SlowStochastic = false;
  bool ReversalsOn = false;
  bool OutsideDaysOn = false;
  bool MMAOn = false;
  bool PFAutoBox = true;
  float PFBoxSize = 0;  // the box value given for the chart on show; 0: computed or asked for
  bool SwingOn = false;
  SwingChoice Swing;  // what it is shown with

  // Until when.
  bool DateLimitOn = false;
  std::string DateLimitText, DateLimitDate;      // the limit: date text, "yyyymmdd"
  std::string ChosenLimitText, ChosenLimitDate;  // as chosen in chart selection
  bool DateLimitMoved = false;  // stepped: the next chart must not go back to the chosen one
  bool ScrollInUse = false;

  // Modes.
  std::int16_t ChartTask = kTaskNone;
  bool SuppressScript = false;
  bool ChartStartup = false;    // chart selection is starting the window
  bool ChartSelLoaded = false;  // chart selection was opened before in this run
};

// The request for `name` that the state and the settings stand for. RecType 1 to 3 turns the
// styles B and C into L, in the state too: such data has no bars, and the style stays so for
// the charts that follow.
ChartRequest MakeRequest(ChartState& state, const Settings& settings, const NameRec& name);

}  // namespace kora
