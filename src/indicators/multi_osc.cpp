#include "indicators/multi_osc.h"

#include <algorithm>

#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr char kSeparator = '|';

std::string KeyOf(int set) { return "Multi-Osc " + std::to_string(set); }

std::vector<MultiOscName> Names() {
  std::vector<MultiOscName> names{{kNoOscillator}};
  for (const Oscillator& oscillator : Oscillators())
    for (const OscEntry& entry : oscillator.entries)
      if (entry.multiName) names.push_back({entry.multiName, &oscillator, entry.slow});
  return names;
}

}  // namespace

std::span<const MultiOscName> MultiOscNames() {
  static const std::vector<MultiOscName> names = Names();
  return names;
}

const MultiOscName* FindMultiOscName(std::string_view name) {
  for (const MultiOscName& each : MultiOscNames())
    if (EqualNoCase(each.name, Trim(name))) return &each;
  return nullptr;
}

MultiOscSet MultiOscSetOf(std::string_view text, char separator) {
  MultiOscSet set;
  set.fill(std::string(kNoOscillator));
  const std::vector<std::string_view> parts = Split(text, separator);
  for (size_t slot = 0; slot < std::min(parts.size(), set.size()); ++slot)
    if (const MultiOscName* name = FindMultiOscName(parts[slot])) set[slot] = name->name;
  return set;
}

MultiOscSet ReadMOSet(const SettingsFile& user, int set) {
  return MultiOscSetOf(user.GetSetting(kUserSection, KeyOf(set)), kSeparator);
}

bool SaveMOSets(SettingsFile& user, int set, const MultiOscSet& names) {
  std::string text;
  for (const std::string& name : names) text += (text.empty() ? "" : "|") + name;
  return user.PutSetting(kUserSection, KeyOf(set), text);
}

int PanelCount(const MultiOscSet& names) {
  return int(std::count_if(names.begin(), names.end(), [](const std::string& name) {
    const MultiOscName* found = FindMultiOscName(name);
    return found && found->oscillator;
  }));
}

double MultiOscPanelHeight(double priceHeight, int panelCount) { return priceHeight / panelCount; }

std::string MultiOscCaption(std::string_view code, int set) {
  return std::string(Trim(code)) + "        Multi-Oscillator " + std::to_string(set);
}

bool DrawMultiOsc(ChartServices services, const Settings& settings, const ChartRequest& request,
                  Composition& chart, const MultiOscSet& names, std::span<Surface* const> panels) {
  const int count = PanelCount(names);
  if (count == 0) return false;
  services.panel = panels[0];
  if (!ComposeChart(services, request, chart)) return false;

  const double height = MultiOscPanelHeight(services.price.ScaleHeight(), count);
  double offset = services.price.ScaleHeight();
  size_t place = 0;
  for (const std::string& slot : names) {
    const MultiOscName* name = FindMultiOscName(slot);
    if (!name || !name->oscillator) continue;
    Surface& panel = *panels[place++];
    panel.SetScale(0, 0, services.price.ScaleWidth(), height);
    panel.SetBackColour(services.colours[kBackground]);
    panel.Cls();
    OscHost host{.files = services.files,
                 .dialogs = services.dialogs,
                 .settings = settings,
                 .colours = services.colours,
                 .request = request,
                 .chart = chart,
                 .price = services.price,
                 .panel = panel,
                 .script = services.script,
                 .OscCode = std::string(name->oscillator->code),
                 .OscCaller = "ANAL",
                 .SlowStochastic = name->slow,
                 .PanelOffsetY = offset};
    name->oscillator->show(host);
    // One that draws nothing keeps its place.
    offset += 3 + (host.PanelBottom > 0 ? host.PanelBottom : CInt(0.98 * height));
  }
  return true;
}

}  // namespace kora
