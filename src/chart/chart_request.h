#pragma once

#include <cstdint>
#include <string>

#include "settings/settings.h"
#include "store/name_rec.h"

namespace kora {

// What the user asked for. A composition only reads it.
struct ChartRequest {
  NameRec Name{};                 // the security
  char ChartStyle = 'B';          // B bar, C candlestick, L line, P point and figure
  std::string ChartPeriod = "A";  // A daily, W weekly, M monthly
  std::int16_t BarSpacing = 2;    // chart units from bar to bar, 2 when 0; for P the reversal
  std::int16_t BlankSpace = 0;    // chart units kept free at the right
  double WeekFactor = 4.75;       // days to a week when wanted records are counted

  bool FinishDateOn = false;
  std::string FinishDate;         // "yyyymmdd": the chart ends at the first date not before it

  bool VolumeOption = true;
  std::int16_t VolHeight = 1;     // 1 to 3, multiple of the mean at the top of the panel
  bool CutVols = false;           // bars above the panel are held at its top

  bool AutoScale = true;          // false: Base and Top of the name record
  bool LogBars = false, LogLines = false, LogVolume = false;

  bool GridLines = false;         // horizontal grid
  bool HalfGrid = false;          // and half-step lines
  bool MovingGrid = true;         // vertical grid by date; otherwise every GridSpace bars
  std::int16_t GridSpace = 0;

  bool Ma1On = false, Ma2On = false, MaExp = false;
  std::int16_t Ma1Days = 0, Ma2Days = 0;    // daily charts
  std::int16_t Ma1Weeks = 0, Ma2Weeks = 0;  // weekly and monthly charts
  std::int16_t BandKind = 0;                // 0 none, 1 percentage, 2 Bollinger

  bool ColourMarks = false;       // reversal marks
  bool OutsideMarks = false;      // outside bars
  bool StopLossShown = false;
  float StopLossPct = 0;          // percent below the low, 1 to 100

  std::string OscName;            // oscillator on show: "MACD", "PARA", "PARAV" change the chart
  std::int16_t MultiOscOn = 0;    // -1: the multi-oscillator view lays out the whole file
  bool SuppressScript = false;
  bool ScriptPrintMode = false;
};

// The request that the settings stand for, as charts open with.
ChartRequest RequestFromSettings(const Settings& settings);

}  // namespace kora
