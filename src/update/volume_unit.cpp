#include "update/volume_unit.h"

#include <optional>

#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "update/download_settings.h"

namespace kora {
namespace {

#pragma pack(push, 1)
// One security or market of a definition file, 61 bytes of text.
struct MainfileRec {
  FixedText<22> Unused1;
  FixedText<6> Code;
  FixedText<26> Unused2;
  FixedText<2> PricePower;
  FixedText<2> VolumePower;
  FixedText<3> Unused3;
};
#pragma pack(pop)
static_assert(sizeof(MainfileRec) == 61);

using Power = std::optional<int>;

Power PowerOf(std::string_view text) {
  const double value = Val(text);
  if (Trim(text).empty() || value < -4 || value > 4) return std::nullopt;
  return CInt(value);
}

// Of the first record with this code. True when there is one, whatever its power.
bool SearchFile(const Files& files, const std::string& path, std::string_view code,
                Power& power) {
  if (!files.CheckFile(path)) return false;
  for (const MainfileRec& rec : RecordFile<MainfileRec>(files, path).ReadAll()) {
    if (UCase(Trim(rec.Code.trimmed())) != code) continue;
    power = PowerOf(rec.VolumePower.raw());
    return true;
  }
  return false;
}

// The third field of a line of WMDef.Lst, from 0.
Power DefinedPower(const Files& files, const std::string& folder, int number) {
  const std::string text = files.ReadAll(folder + "WMDef.Lst", 1u << 20);
  LineReader lines(text);
  std::string_view line;
  while (lines.Next(line)) {
    if (lines.number() != number + 1) continue;
    const auto fields = Split(line, ',');
    return fields.size() > 2 ? PowerOf(fields[2]) : std::nullopt;
  }
  return std::nullopt;
}

Power PowerFor(const Files& files, const Settings& settings, std::string_view code) {
  const std::string folder = WithBackslash(Trim(settings.download.ServiceSystem));
  const auto find = [&](const char* name, std::string_view wanted) {
    Power power;
    SearchFile(files, folder + name, wanted, power);
    return power;
  };
  if (settings.download.DataService == 1) {
    Power power;
    for (const char* name : {"Mainfile.ASX", "Mainfile.OVS", "Mainfile.SFE"})
      if (SearchFile(files, folder + name, code, power)) break;
    return power;
  }
  if (settings.download.DataService != 3) return std::nullopt;
  const WmPaths lines = ReadWmPaths(files, settings.paths.SystemPath);
  const std::string current = UCase(settings.paths.CurrentDataPath);
  for (const size_t i : {kWmAsx, kWmIndices, kWmFutures, kWmOverseas, kWmOptions, kWmSum}) {
    if (UCase(WithBackslash(Trim(lines[i]))) != current) continue;
    switch (i) {
      case kWmAsx: return DefinedPower(files, folder, 0);
      case kWmIndices: return DefinedPower(files, folder, 1);
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
