#include "indicators/oscillators.h"

namespace kora {
namespace {

void ShowRocAndFx(OscHost& host) {
  ShowROC(host);
  host.chart.OscPanel = -1;
  ShowStochasticFX(host);
  host.chart.OscPanel = 0;
}

struct Entry {
  std::string_view code;
  void (*show)(OscHost&);
  bool panel;
};

constexpr Entry kEntries[] = {
    {"STO", ShowStochasticFX, true}, {"FX", ShowStochasticFX, true},
    {"R/F", ShowRocAndFx, true},     {"ROC", ShowROC, true},
    {"MOM", ShowMomentum, true},     {"WMS", ShowWilliams, true},
    {"RMO", ShowRMO, true},          {"RMX", ShowRMX, true},
    {"RSI", ShowRSI, true},          {"VTY", ShowVolatility, true},
    {"MACD", ShowMACD, true},        {"DM", ShowDirectionalMovement, true},
    {"ERY", ShowElderRay, true},     {"COP", ShowCoppock, true},
    {"JHG", ShowHolyGrail, true},    {"OBV", ShowOBV, true},
    {"PARA", ShowParabolic, false},  {"PARAV", ShowParabolicOnAverage, false},
};

const Entry* Find(std::string_view code) {
  for (const Entry& entry : kEntries)
    if (entry.code == code) return &entry;
  return nullptr;
}

}  // namespace

bool HasPanel(std::string_view oscCode) {
  const Entry* entry = Find(oscCode);
  return entry && entry->panel;
}

void ShowOscillatorPanel(OscHost& host) {
  if (const Entry* entry = Find(host.OscCode)) entry->show(host);
}

}  // namespace kora
