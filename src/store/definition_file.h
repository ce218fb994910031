#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "base/files.h"

// The files in which the download service tells in which units a market's prices and volumes
// come: Mainfile.*, WMMain.*, WMDef.Lst.

namespace kora {

// Powers of ten, -4 to 4; nothing for any other text.
struct Definition {
  std::optional<int> pricePower, volumePower;
};

// Of the first record with this code, in upper case; nothing where there is none, or no file.
std::optional<Definition> FindDefinition(const Files& files, const std::string& path,
                                         std::string_view code);

// A line of WMDef.Lst: a flag, a text and the power of volumes.
struct MarketDefinition {
  bool used = false;  // the flag is 1
  std::optional<int> volumePower;
};
// The lines for the market in general and for indices; what is missing has no power. Errors of
// reading where there is no file.
std::pair<MarketDefinition, MarketDefinition> ReadMarketDefinitions(const Files& files,
                                                                    const std::string& folder);
// By what volumes of the market in general and of indices are multiplied: 0 for a line that is
// not used, and where the file can't be read.
std::pair<double, double> ReadMarketVolumeFactors(const Files& files, const std::string& folder);

// 10 to a power from -4 to 4.
double PowerOfTen(int power);

}  // namespace kora
