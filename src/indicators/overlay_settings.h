#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

#include "settings/settings.h"
#include "store/name_file.h"

// What the forms of the overlays keep. A refused entry changes nothing.

namespace kora {

inline constexpr std::string_view kMMASetMessage = "Values must be between 0 - 600";
inline constexpr std::string_view kMMASetTitle = "MMA Settings";
// Keeps the twelve boxes under MMASet. False when one is refused, with its number from 0.
bool SaveMMASet(SettingsFile& ini, Settings& settings, const std::array<std::string, 12>& boxes,
                size_t& refused);

// Keeps the switch and the percent of the stop loss. False when the percent is refused.
bool SaveStopLoss(SettingsFile& ini, Settings& settings, bool on, std::string_view percent);

// Which bands: the values that a chart request takes for them.
enum class BandForm : std::int16_t { kPercentage = 1, kBollinger = 2 };
const char* BandFormTitle(BandForm form);
struct BandTexts {
  std::string first, second;
};
BandTexts StandingBands(BandForm form, const NameRec& record);
// Writes both values into the current security's record. False when one is refused. Errors as
// RewriteCurrentName.
bool SaveBands(const Files& files, const std::string& dataPath, CurrentName& current, BandForm form,
               std::string_view first, std::string_view second);

}  // namespace kora
