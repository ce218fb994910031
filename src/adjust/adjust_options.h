#pragma once

#include <cstdint>

#include "settings/settings.h"

namespace kora {

// What the form of the options shows for the setting Divs: 1 leave dividends out, 2, 3 and 4 set
// ADJ to Y, N and D; 3 for any other value.
std::int16_t ShownDivs(const Settings& settings);
// Keeps the options. A key that can't be written is passed over: the value holds for this run.
void SaveAdjustOptions(SettingsFile& ini, Settings& settings, std::int16_t divs, bool noShortNames);

}  // namespace kora
