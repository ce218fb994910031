#include "indicators/osc_settings.h"

#include <algorithm>
#include <vector>

#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr std::string_view kSection = "OscDef";

int Least(OscRange range) { return range == OscRange::kPeriod ? 1 : 0; }

std::int16_t& PeriodOnShow(PeriodPair& pair, Period chartPeriod) {
  return chartPeriod == Period::kDaily ? pair.daily : pair.twin;
}

}  // namespace

void ReadOscPeriods(const SettingsFile& ini, OscSettings& osc) {
  const auto period = [&ini](const char* key) {
    return SettingCInt(ini.GetSetting(kSection, key));
  };
  for (const OscKey& key : OscKeys()) osc[key] = {period(key.daily), period(key.twin)};
}

void WriteDefaultOscPeriods(SettingsFile& ini) {
  const SettingsFile::Batch batch(ini);
  for (const OscKey& key : OscKeys()) {
    ini.PutSetting(kSection, key.daily, Str(std::int32_t(key.defaultDaily)));
    ini.PutSetting(kSection, key.twin, Str(std::int32_t(key.defaultTwin)));
  }
}

const Oscillator* FindOscBox(std::string_view oscCode) {
  const Oscillator* oscillator = FindOscillator(oscCode);
  return oscillator && oscillator->boxCaption ? oscillator : nullptr;
}

void FillOscDefaults(OscSettings& osc, Period chartPeriod) {
  for (const OscKey& key : OscKeys()) {
    std::int16_t& period = PeriodOnShow(osc[key], chartPeriod);
    if (period == 0) period = chartPeriod == Period::kDaily ? key.defaultDaily : key.defaultTwin;
  }
}

bool ReadOscFields(const Oscillator& box, std::span<const std::string> typed, Period chartPeriod,
                   OscSettings& osc, size_t& refused) {
  std::vector<std::int16_t> periods;
  for (size_t i = 0; i < box.fields.size(); ++i) {
    const double value = RoundHalfEven(Val(typed[i]));
    if (value < Least(box.fields[i].range) || value > kMostOscPeriod) {
      refused = i;
      return false;
    }
    periods.push_back(CInt(value));
  }
  for (size_t i = 0; i < periods.size(); ++i)
    PeriodOnShow(osc[box.fields[i].key], chartPeriod) = periods[i];
  return true;
}

bool PeriodsInRange(const Oscillator& oscillator, const OscSettings& osc, Period chartPeriod) {
  if (oscillator.checksDaily) chartPeriod = Period::kDaily;
  return std::all_of(oscillator.fields.begin(), oscillator.fields.end(),
                     [&](const OscField& field) {
                       const std::int16_t value = osc[field.key].For(chartPeriod);
                       return field.range == OscRange::kBoxAverage ||
                              (value >= Least(field.range) && value <= kMostOscPeriod);
                     });
}

CompareFileAnswer TestCompareFile(const Files& files, Dialogs& dialogs, std::string_view typed) {
  const std::string path(Trim(typed));
  if (!path.empty() && files.CheckFile(path)) return CompareFileAnswer::kThere;
  const Answer answer =
      dialogs.Ask(path + " is not available. Use your code for the All Ordinaries Index",
                  "RMX Compare ", Buttons::kOkCancel);
  return answer == Answer::kOk ? CompareFileAnswer::kCorrect : CompareFileAnswer::kGiveUp;
}

std::optional<float> ReadBoxValue(Dialogs& dialogs, std::string_view typed) {
  typed = Trim(typed);
  const std::optional<float> value = ParseFloat(typed);
  if (typed.empty() || value == 0.0f) {
    dialogs.Message("Box value must have a value. eg 0.20", kBoxValueTitle);
    return std::nullopt;
  }
  if (!value) dialogs.Message("Box value must be numeric eg 0.20", kBoxValueTitle);
  return value;
}

}  // namespace kora
