#include "indicators/overlay_settings.h"

#include "base/numbers.h"
#include "indicators/price_overlays.h"

namespace kora {

bool SaveMMASet(SettingsFile& ini, Settings& settings, const std::array<std::string, 12>& boxes,
                size_t& refused) {
  const auto periods = ReadMMABoxes(boxes, refused);
  if (!periods) return false;
  settings.osc.MMASet = *periods;
  ini.PutSetting("OscDef", "MMASet", MMASetText(*periods));
  return true;
}

bool SaveStopLoss(SettingsFile& ini, Settings& settings, bool on, std::string_view percent) {
  const auto value = ReadStopLossPercent(percent);
  if (!value) return false;
  settings.charts.StopLoss = on;
  settings.charts.StopLossPct = *value;
  const SettingsFile::Batch batch(ini);
  ini.PutSetting("Charts", "StopLoss", on ? "True" : "False");
  ini.PutSetting("Charts", "SL Percent", Str(*value));
  return true;
}

const char* BandFormTitle(BandForm form) {
  return form == BandForm::kPercentage ? "Percentage Bands" : "Bollinger Bands";
}

BandTexts StandingBands(BandForm form, const NameRec& record) {
  const auto text = [](std::int16_t value) { return Str(std::int32_t(value)); };
  return form == BandForm::kPercentage
             ? BandTexts{text(record.BandUp), text(record.BandDown)}
             : BandTexts{text(record.BollPeriods), text(record.BollWidth)};
}

bool SaveBands(const Files& files, const std::string& dataPath, CurrentName& current, BandForm form,
               std::string_view first, std::string_view second) {
  const auto values = ReadBandBoxes(first, second);
  if (!values) return false;
  RewriteCurrentName(files, dataPath, current, [&](NameRec& record) {
    (form == BandForm::kPercentage ? record.BandUp : record.BollPeriods) = values->first;
    (form == BandForm::kPercentage ? record.BandDown : record.BollWidth) = values->second;
  });
  return true;
}

}  // namespace kora
