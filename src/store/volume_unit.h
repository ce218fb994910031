#pragma once

#include <string>
#include <string_view>

#include "base/files.h"
#include "settings/settings.h"

namespace kora {

// The text that stands for the unit of a security's volumes on a chart: "'00" for hundreds. It
// comes from the market definition files of services 1 and 3; empty where the download system
// folder is not set, the security is not in them, or they can't be read.
std::string VolumeUnitText(const Files& files, const Settings& settings, std::string_view code);

// The text of a power of ten from -4 to 4, else empty.
std::string VolumeUnitOfPower(int power);

}  // namespace kora
