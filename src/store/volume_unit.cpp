#include "store/volume_unit.h"

#include <optional>

#include "base/runtime_error.h"
#include "base/text.h"
#include "store/definition_file.h"
#include "store/market_folders.h"

namespace kora {
namespace {

using Power = std::optional<int>;

Power PowerFor(const Files& files, const Settings& settings, std::string_view code) {
  const std::string folder = WithBackslash(Trim(settings.download.ServiceSystem));
  const auto find = [&](const char* name, std::string_view wanted) {
    const auto defined = FindDefinition(files, folder + name, wanted);
    return defined ? defined->volumePower : Power();
  };
  if (settings.download.DataService == 1) {
    for (const char* name : {"Mainfile.ASX", "Mainfile.OVS", "Mainfile.SFE"})
      if (const auto defined = FindDefinition(files, folder + name, code))
        return defined->volumePower;
    return std::nullopt;
  }
  if (settings.download.DataService != 3) return std::nullopt;
  const WmPaths lines = ReadWmPaths(files, settings.paths.SystemPath);
  const std::string current = UCase(settings.paths.CurrentDataPath);
  for (const size_t i : {kWmAsx, kWmIndices, kWmFutures, kWmOverseas, kWmOptions, kWmSum}) {
    if (UCase(WithBackslash(Trim(lines[i]))) != current) continue;
    switch (i) {
      case kWmAsx: return ReadMarketDefinitions(files, folder).first.volumePower;
      case kWmIndices: return ReadMarketDefinitions(files, folder).second.volumePower;
      case kWmFutures: return find("WMMain.SFE", code.substr(0, 2));
      case kWmOverseas: return find("WMMain.OVS", code);
      case kWmOptions: return find("WMMain.OPT", code.substr(0, 3));
      default: return find("Mainfile.ASX", code);
    }
  }
  return std::nullopt;
}

}  // namespace

std::string VolumeUnitOfPower(int power) {
  // Powers 0 and 2 have the same text.
  constexpr const char* texts[] = {"'000000", "'00000", "'0000", "'000", "'00",
                                   "'0",      "'00",    "x000",  "x0000"};
  return power >= -4 && power <= 4 ? texts[power + 4] : "";
}

std::string VolumeUnitText(const Files& files, const Settings& settings, std::string_view code) {
  const std::string_view folder = Trim(settings.download.ServiceSystem);
  if (folder.empty() || folder == kUnknown) return {};
  try {
    const Power power = PowerFor(files, settings, UCase(Trim(code)));
    return power ? VolumeUnitOfPower(*power) : std::string();
  } catch (const RunTimeError&) {
    return {};  // a chart does without the unit
  }
}

}  // namespace kora
