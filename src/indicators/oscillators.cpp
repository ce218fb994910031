#include "indicators/oscillators.h"

#include <algorithm>

#include "indicators/coppock.h"
#include "indicators/directional_movement.h"
#include "indicators/elder_ray.h"
#include "indicators/holy_grail.h"
#include "indicators/macd.h"
#include "indicators/obv.h"
#include "indicators/parabolic.h"
#include "indicators/rmo.h"
#include "indicators/rmx.h"
#include "indicators/roc_momentum.h"
#include "indicators/rsi.h"
#include "indicators/stochastic_fx.h"
#include "indicators/volatility.h"
#include "indicators/williams.h"

namespace kora {
namespace {

// ROC with FX as a second pass over its panel.
void ShowRocAndFx(OscHost& host) {
  ShowROC(host);
  host.SecondPass = true;
  ShowStochasticFX(host);
  host.SecondPass = false;
}

std::vector<Oscillator> Table() {
  constexpr OscRange kAverage = OscRange::kAverage, kBoxAverage = OscRange::kBoxAverage;
  return {
      {.code = "DM",
       .show = ShowDirectionalMovement,
       .entries = {{"cmDirect", "&Directional Movement", "Directional Movement"}},
       .choice = "Directional Movement",
       .boxCaption = "Dir.Mvmt",
       .fields = {{"Period", kDMA}, {"AveDX", kDMXA, kBoxAverage}},
       .defaultsPlace = 10},
      {.code = "COP",
       .show = ShowCoppock,
       .entries = {{"cmCoppock", "&Coppock Indicator", "Coppock"}},
       .choice = "Coppock",
       .boxCaption = "Coppock",
       .fields = {{"Period ", kCopD}},
       .defaultsPlace = 12},
      {.code = "ERY",
       .show = ShowElderRay,
       .entries = {{"cmElderRay", "&Elder Ray", "Elder Ray"}},
       .choice = "ElderRay",
       .boxCaption = "Elder Ray",
       .fields = {{"Period", kERA}},
       .defaultsPlace = 9},
      {.code = "FX",
       .show = ShowStochasticFX,
       .entries = {{"cmFX", "&FX", "FX"}},
       .choice = "FX",
       .boxCaption = "FX",
       .fields = {{"Period F", kFXF}, {"Period X", kFXX, kAverage}},
       .defaultsPlace = 2},
      {.code = "JHG",
       .show = ShowHolyGrail,
       .entries = {{"cmJHGrail", "Jones Holy Grail", "Jones Holy Grail"}},
       .choice = "Jones Holy Grail",
       .boxCaption = "Jones Holy Grail",
       .fields = {{"Period ", kHolyD}},
       .defaultsPlace = 13},
      {.code = "MACD",
       .show = ShowMACD,
       .entries = {{"cmMacD", "&MACD Histogram and Classic", "MACD"}},
       .choice = "MACD",
       .boxCaption = "MACD",
       .fields = {{"EMA 1", kMd1}, {"EMA 2", kMd2}, {"EMA 3 signal", kMd3}},
       .defaultsPlace = 7},
      {.code = "MOM",
       .show = ShowMomentum,
       .entries = {{"cmMomentum", "Momen&tum", "Momentum"}},
       .choice = "Momentum",
       .boxCaption = "Momentum",
       .fields = {{"Period ", kMMA}},
       .defaultsPlace = 11},
      {.code = "OBV",
       .show = ShowOBV,
       .entries = {{"cmOBV", "OB&V (On Balance Volume)", "OBV"}},
       .choice = "On-Balance Volume",
       .needsVolume = true},
      {.code = "PARA",
       .show = ShowParabolic,
       .panel = false,
       .entries = {{"cmPara", "&Parabolic"}},
       .choice = "Parabolic"},
      {.code = "PARAV",
       .show = ShowParabolicOnAverage,
       .panel = false,
       .entries = {{"cmParaAve", "Parabolic on Average 1"}},
       .switchXT = true},
      {.code = "ROC",
       .show = ShowROC,
       .entries = {{"cmROC", "&ROC (Rate of Change)", "ROC"}},
       .choice = "ROC",
       .boxCaption = "ROC",
       .fields = {{"Period ROC", kRocP}, {"ROC Ave", kRocA, kBoxAverage}},
       .defaultsPlace = 3},
      {.code = "R/F",
       .show = ShowRocAndFx,
       .entries = {{"cmROCFX", "RO&C and  FX", "ROC and FX"}},
       .choice = "ROC & FX",
       .boxCaption = "ROC & FX",
       .fields = {{"Period F", kFXF},
                  {"Period X", kFXX, kAverage},
                  {"Period ROC", kRocP},
                  {"ROC Ave", kRocA, kBoxAverage}}},
      {.code = "RMO",
       .show = ShowRMO,
       .entries = {{"cmRMO", "RM&O (Relative Movement - all data)"}},
       .choice = "RMO",
       .boxCaption = "RMO",
       .fields = {{"Period RMO", kRmoP}, {"RMO Ave", kRmoA, kBoxAverage}},
       .defaultsPlace = 5,
       .compares = true,
       .dailyOnly = true},
      {.code = "RMX",
       .show = ShowRMX,
       .entries = {{"cmRMX", "RM&X (Relative Movement - chart data)", "RMX"}},
       .choice = "RMX",
       .boxCaption = "RMX",
       .fields = {{"Period RMX", kRmxP}, {"RMX Ave", kRmxA, kBoxAverage}},
       .defaultsPlace = 6,
       .compares = true,
       .checksDaily = true},
      {.code = "RSI",
       .show = ShowRSI,
       .entries = {{"cmRelStrength", "RS&I (Relative Strength Index)", "RSI"}},
       .choice = "RSI",
       .boxCaption = "RSI",
       .fields = {{"RSI period", kRsiP}},
       .defaultsPlace = 4},
      {.code = "STO",
       .show = ShowStochasticFX,
       .entries = {{"cmStochastic", "&Stochastic (Fast)", "Stochastic (Fast)"},
                   {"cmSlowStoch", "Stoc&hastic (Slow)", "Stochastic (Slow)", true}},
       .choice = "Stochastic",
       .boxCaption = "Stochastic",
       .fields = {{"Period K", kStochK}, {"Period D", kStochD, kAverage}},
       .defaultsPlace = 1},
      {.code = "VTY",
       .show = ShowVolatility,
       .entries = {{"cmVolt", "Volatility", "Volatility"}},
       .choice = "Volatility",
       .boxCaption = "Volatility",
       .fields = {{"Period ", kVtyD}},
       .defaultsPlace = 14},
      {.code = "WMS",
       .show = ShowWilliams,
       .entries = {{"cmWilliams", "&Williams %R", "Williams %R"}},
       .choice = "Williams %R",
       .boxCaption = "Williams %R",
       .fields = {{"Period", kWmsA}},
       .defaultsPlace = 8},
  };
}

// Each key once: ROC with FX has none of its own.
std::vector<OscKey> Keys() {
  std::vector<const Oscillator*> rows;
  for (const Oscillator& row : Oscillators()) rows.push_back(&row);
  std::stable_sort(rows.begin(), rows.end(), [](const Oscillator* a, const Oscillator* b) {
    return a->defaultsPlace < b->defaultsPlace;
  });
  std::vector<OscKey> keys;
  for (const Oscillator* row : rows)
    for (const OscField& field : row->fields)
      if (std::find(keys.begin(), keys.end(), field.key) == keys.end()) keys.push_back(field.key);
  return keys;
}

}  // namespace

std::span<const Oscillator> Oscillators() {
  static const std::vector<Oscillator> table = Table();
  return table;
}

const Oscillator* FindOscillator(std::string_view code) {
  for (const Oscillator& row : Oscillators())
    if (row.code == code) return &row;
  return nullptr;
}

std::span<const OscKey> OscKeys() {
  static const std::vector<OscKey> keys = Keys();
  return keys;
}

bool HasPanel(std::string_view oscCode) {
  const Oscillator* row = FindOscillator(oscCode);
  return row && row->panel;
}

void ShowOscillatorPanel(OscHost& host) {
  if (const Oscillator* row = FindOscillator(host.OscCode)) row->show(host);
}

}  // namespace kora
