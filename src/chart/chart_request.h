#pragma once

#include <cstdint>
#include <string>

#include "chart/swing_kind.h"
#include "settings/settings.h"
#include "settings/style_period.h"
#include "store/name_rec.h"

namespace kora {

// Where a chart stands on its surface.
enum class ChartPlace {
  kAlone,
  kUpper,  // of two charts, one below the other
  kLower,
  kUnder,  // of two charts in one frame: the first
  kOver,   // and the second, drawn over it
  kWide,   // alone, on a surface as wide as its bars need: the multi-oscillator view
};
// It goes on in the picture and the script of another chart.
constexpr bool IsSecond(ChartPlace place) {
  return place == ChartPlace::kLower || place == ChartPlace::kOver;
}
constexpr bool IsSplit(ChartPlace place) {
  return place == ChartPlace::kUpper || place == ChartPlace::kLower;
}
constexpr bool IsSuperimposed(ChartPlace place) {
  return place == ChartPlace::kUnder || place == ChartPlace::kOver;
}

// What the user asked for. A composition only reads it.
struct ChartRequest {
  NameRec Name{};  // the security
  Style ChartStyle = Style::kBar;
  Period ChartPeriod = Period::kDaily;
  std::int16_t BarSpacing = 2;  // chart units from bar to bar, 2 when 0; for P the reversal
  std::int16_t BlankSpace = 0;  // chart units kept free at the right
  double WeekFactor = 4.75;     // days to a week when wanted records are counted

  bool FinishDateOn = false;
  std::string FinishDate;  // "yyyymmdd": the chart ends at the first date not before it

  bool VolumeOption = true;
  std::int16_t VolHeight = 1;  // 1 to 3, multiple of the mean at the top of the panel
  bool CutVols = false;        // bars above the panel are held at its top

  bool AutoScale = true;  // false: Base and Top of the name record
  bool LogBars = false, LogLines = false, LogVolume = false;

  bool GridLines = false;  // horizontal grid
  bool HalfGrid = false;   // and half-step lines
  bool MovingGrid = true;  // vertical grid by date; otherwise every GridSpace bars
  std::int16_t GridSpace = 0;

  // Where a label would not fit: volumes are shortened (670K, 1.8M), ChartLeft moves right until the
  // longest price has room, a text of the date axis that would touch the one before is left out,
  // and the second of two charts in one frame is drawn in the colour of its code.
  bool Legible = false;

  bool Ma1On = false, Ma2On = false, MaExp = false;
  std::int16_t Ma1Days = 0, Ma2Days = 0;    // daily charts
  std::int16_t Ma1Weeks = 0, Ma2Weeks = 0;  // weekly and monthly charts
  std::int16_t BandKind = 0;                // 0 none, 1 percentage, 2 Bollinger

  bool ColourMarks = false;   // reversal marks
  bool OutsideMarks = false;  // outside bars
  bool StopLossShown = false;
  float StopLossPct = 0;  // percent below the low, 1 to 100

  bool PFAutoBox = true;  // the box value of P is worked out; otherwise:
  float PFBoxSize = 0;    // this one; 0 takes PFInc on a manual scale, or asks

  SwingKind Swing = SwingKind::kNone;  // in place of the bars
  double SwingSize = 0;                // days or points of its kind

  std::string OscName;  // oscillator on show: "MACD", "PARA", "PARAV" change the chart
  ChartPlace Place = ChartPlace::kAlone;
  bool SuppressScript = false;
  bool ScriptPrintMode = false;
};

// A swing chart stands in place of bars; data that has none shows its line.
inline bool ShowsSwing(const ChartRequest& request) {
  return request.Swing != SwingKind::kNone && request.ChartStyle == Style::kBar &&
         request.Name.RecType >= kShare;
}

// The request that the settings stand for, as charts open with.
ChartRequest RequestFromSettings(const Settings& settings);

}  // namespace kora
