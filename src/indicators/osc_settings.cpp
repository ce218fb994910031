#include "indicators/osc_settings.h"

#include <vector>

#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

using O = OscSettings;

constexpr OscField kStochastic[] = {{"Period K", &O::StochK, false},
                                    {"Period D", &O::StochD, true}};
constexpr OscField kFX[] = {{"Period F", &O::FXF, false}, {"Period X", &O::FXX, true}};
constexpr OscField kRMX[] = {{"Period RMX", &O::RmxP, false}, {"RMX Ave", &O::RmxA, true}};
constexpr OscField kRMO[] = {{"Period RMO", &O::RmoP, false}, {"RMO Ave", &O::RmoA, true}};
constexpr OscField kROC[] = {{"Period ROC", &O::RocP, false}, {"ROC Ave", &O::RocA, true}};
constexpr OscField kROCFX[] = {{"Period F", &O::FXF, false},
                               {"Period X", &O::FXX, true},
                               {"Period ROC", &O::RocP, false},
                               {"ROC Ave", &O::RocA, true}};
constexpr OscField kRSI[] = {{"RSI period", &O::RsiP, false}};
// All three are periods, none may be left out.
constexpr OscField kMACD[] = {{"EMA 1", &O::Md1, false},
                              {"EMA 2", &O::Md2, false},
                              {"EMA 3 signal", &O::Md3, false}};
constexpr OscField kWilliams[] = {{"Period", &O::WmsA, false}};
constexpr OscField kDirectional[] = {{"Period", &O::DMA, false}, {"AveDX", &O::DMXA, true}};
constexpr OscField kMomentum[] = {{"Period ", &O::MMA, false}};
constexpr OscField kElderRay[] = {{"Period", &O::ERA, false}};
constexpr OscField kCoppock[] = {{"Period ", &O::CopD, false}};
constexpr OscField kHolyGrail[] = {{"Period ", &O::HolyD, false}};
constexpr OscField kVolatility[] = {{"Period ", &O::VtyD, false}};

constexpr OscBox kBoxes[] = {
    {"STO", "Stochastic", kStochastic, false},
    {"FX", "FX", kFX, false},
    {"RMX", "RMX", kRMX, true},
    {"RMO", "RMO", kRMO, true},
    {"ROC", "ROC", kROC, false},
    {"R/F", "ROC & FX", kROCFX, false},
    {"RSI", "RSI", kRSI, false},
    {"MACD", "MACD", kMACD, false},
    {"WMS", "Williams %R", kWilliams, false},
    {"DM", "Dir.Mvmt", kDirectional, false},
    {"MOM", "Momentum", kMomentum, false},
    {"ERY", "Elder Ray", kElderRay, false},
    {"COP", "Coppock", kCoppock, false},
    {"JHG", "Jones Holy Grail", kHolyGrail, false},
    {"VTY", "Volatility", kVolatility, false},
};

std::int16_t& PeriodOnShow(PeriodPair& pair, const std::string& chartPeriod) {
  return chartPeriod == "A" ? pair.daily : pair.twin;
}

}  // namespace

const OscBox* FindOscBox(std::string_view oscCode) {
  for (const OscBox& box : kBoxes)
    if (oscCode == box.code) return &box;
  return nullptr;
}

void FillOscDefaults(OscSettings& osc, const std::string& chartPeriod) {
  for (const OscKey& key : OscKeys()) {
    std::int16_t& period = PeriodOnShow(osc.*key.value, chartPeriod);
    if (period == 0) period = chartPeriod == "A" ? key.defaultDaily : key.defaultTwin;
  }
}

bool ReadOscFields(const OscBox& box, std::span<const std::string> typed,
                   const std::string& chartPeriod, OscSettings& osc, size_t& refused) {
  std::vector<std::int16_t> periods;
  for (size_t i = 0; i < box.fields.size(); ++i) {
    const double value = RoundHalfEven(Val(typed[i]));
    if (value < (box.fields[i].average ? 0 : 1) || value > kMostOscPeriod) {
      refused = i;
      return false;
    }
    periods.push_back(CInt(value));
  }
  for (size_t i = 0; i < periods.size(); ++i)
    PeriodOnShow(osc.*box.fields[i].value, chartPeriod) = periods[i];
  return true;
}

CompareFileAnswer TestCompareFile(const Files& files, Dialogs& dialogs, std::string_view typed) {
  const std::string path(Trim(typed));
  if (!path.empty() && files.CheckFile(path)) return CompareFileAnswer::kThere;
  const Answer answer = dialogs.Ask(
      path + " is not available. Use your code for the All Ordinaries Index", "RMX Compare ",
      Buttons::kOkCancel);
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
