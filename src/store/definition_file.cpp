#include "store/definition_file.h"

#include <array>

#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "base/text.h"

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

std::optional<int> PowerOf(std::string_view text) {
  const double value = Val(text);
  if (Trim(text).empty() || value < -4 || value > 4) return std::nullopt;
  return CInt(value);
}

}  // namespace

std::optional<Definition> FindDefinition(const Files& files, const std::string& path,
                                         std::string_view code) {
  if (!files.CheckFile(path)) return std::nullopt;
  for (const MainfileRec& rec : RecordFile<MainfileRec>(files, path).ReadAll())
    if (UCase(Trim(rec.Code.trimmed())) == code)
      return Definition{PowerOf(rec.PricePower.raw()), PowerOf(rec.VolumePower.raw())};
  return std::nullopt;
}

std::pair<MarketDefinition, MarketDefinition> ReadMarketDefinitions(const Files& files,
                                                                    const std::string& folder) {
  const std::string text = files.ReadAll(folder + "WMDef.Lst", 1u << 20);
  std::array<MarketDefinition, 2> found;
  LineReader lines(text);
  std::string_view line;
  for (MarketDefinition& one : found) {
    if (!lines.Next(line)) break;
    const auto fields = Split(line, ',');
    one.used = Val(fields[0]) == 1;
    if (fields.size() > 2) one.volumePower = PowerOf(fields[2]);
  }
  return {found[0], found[1]};
}

std::pair<double, double> ReadMarketVolumeFactors(const Files& files, const std::string& folder) {
  const auto factor = [](const MarketDefinition& one) {
    return one.used && one.volumePower ? PowerOfTen(*one.volumePower) : 0.0;
  };
  try {
    const auto [general, index] = ReadMarketDefinitions(files, folder);
    return {factor(general), factor(index)};
  } catch (const RunTimeError&) {
    return {0, 0};
  }
}

double PowerOfTen(int power) {
  constexpr std::array<double, 9> kPowers{1e-4, 1e-3, 1e-2, 1e-1, 1, 1e1, 1e2, 1e3, 1e4};
  return kPowers[size_t(power + 4)];
}

}  // namespace kora
