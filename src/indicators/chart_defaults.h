#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "base/files.h"
#include "indicators/oscillators.h"
#include "looks/colours.h"
#include "platform/dialogs.h"
#include "settings/settings.h"

// What the form of chart defaults keeps.

namespace kora {

// What stands in the form's controls.
struct ChartDefaults {
  struct Twin {
    std::string daily, twin;  // as typed
  };
  std::vector<Twin> periods;  // in the order of OscKeys()
  std::string CompFile;
  bool BCCalTp = false, LCalTp = false, VCalTp = false;  // logarithmic
  bool CutVols = false;
  bool ShowOsc = false;
  bool FXReversed = false;  // the box as ticked: FXRev is kept the other way round
  bool FillIn = false;
  bool RFAve = false;
  Twin average1, average2;  // Av1D and Av1W, Av2D and Av2W
  bool AvOne = false, AvTwo = false;
  bool AvCalc = false;   // exponential
  bool ScMethod = true;  // automatic scales
};

ChartDefaults DefaultsFromSettings(const Settings& settings);

enum class DefaultsSaved {
  kAll,          // or all but those that the user was told of
  kCompareFile,  // stopped at the compare file, which he was told of; what stands before it is
                 // kept
};
// Writes each key and sets the value that this run goes by: the periods in the order of
// OscKeys(), then, where the compare file is there, the rest. A text that is no 16-bit number is
// 0. Keys that can't be written are told together at the end.
DefaultsSaved SaveChartDefaults(SettingsFile& ini, const Files& files, Dialogs& dialogs,
                                const ChartDefaults& typed, Settings& settings);

}  // namespace kora
