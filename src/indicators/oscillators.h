#pragma once

#include <span>
#include <string_view>
#include <vector>

#include "indicators/osc_panel.h"

// The table of oscillators. The menu of the chart window, chart selection, the settings box, the
// chart defaults, the checks before drawing, the keys of section OscDef, the multi-oscillator
// view and the command line are made from it: a new oscillator is a file with its routine and
// its periods, and a row of this table.

namespace kora {

enum class OscRange {
  kPeriod,      // 1 to 200
  kAverage,     // 0 to 200; 0 draws no average
  kBoxAverage,  // the same, but held to it in the settings box alone
};
// A period in the settings box.
struct OscField {
  const char* label;
  OscKey key;
  OscRange range = OscRange::kPeriod;
};

// An entry of the menu of oscillators, and the same one's name in the multi-oscillator view.
struct OscEntry {
  const char* menu;  // name of the entry
  const char* caption;
  const char* multiName = nullptr;  // null: the view does not offer it
  bool slow = false;                // the slow form
};

// One oscillator. Captions and labels stand on the forms as they are here.
struct Oscillator {
  std::string_view code;
  void (*show)(OscHost& host);  // a period of 0 draws and writes nothing
  bool panel = true;            // a panel of its own; otherwise it is drawn over the price chart
  std::vector<OscEntry> entries = {};
  const char* choice = nullptr;       // in chart selection; null: not offered there
  const char* boxCaption = nullptr;   // of the settings box; null: it has no settings
  std::vector<OscField> fields = {};  // of the box, from the top
  int defaultsPlace = kNoPlace;       // of its keys among the chart defaults, from 1
  bool compares = false;              // held against the compare file, which the box asks for too
  bool checksDaily = false;           // its daily periods are checked for every chart period
  bool dailyOnly = false;             // drawn on daily charts alone
  bool needsVolume = false;           // drawn where volumes are shown alone
  bool switchXT = false;              // its entry is for the switch XT alone

  static constexpr int kNoPlace = 1000;  // behind all others
};

// In the order of the menu, which is that of every list.
std::span<const Oscillator> Oscillators();
// Null for a code that names none.
const Oscillator* FindOscillator(std::string_view code);

// The keys of all periods, in the order in which the chart defaults show and save them.
std::span<const OscKey> OscKeys();

// True for the codes that have a panel of their own ("PARA" and "PARAV" have none).
bool HasPanel(std::string_view oscCode);

// Draws the oscillator of host.OscCode. A code that names no oscillator draws nothing.
void ShowOscillatorPanel(OscHost& host);

}  // namespace kora
