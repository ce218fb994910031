#include "adjust/adjust_options.h"

#include "base/numbers.h"

namespace kora {

std::int16_t ShownDivs(const Settings& settings) {
  return settings.AdjDivs >= 1 && settings.AdjDivs <= 4 ? settings.AdjDivs : std::int16_t(3);
}

void SaveAdjustOptions(SettingsFile& ini, Settings& settings, std::int16_t divs,
                       bool noShortNames) {
  settings.AdjDivs = divs;
  settings.NoShortNames = noShortNames;
  const SettingsFile::Batch batch(ini);
  ini.PutSetting("Adjustments", "Divs", Str(std::int32_t(divs)));
  ini.PutSetting("Adjustments", "NoShortNames", noShortNames ? "True" : "False");
}

}  // namespace kora
