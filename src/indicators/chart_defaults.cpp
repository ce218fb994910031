#include "indicators/chart_defaults.h"

#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

std::string Text(std::int16_t value) { return Str(std::int32_t(value)); }

// Writes keys, together at the end, and gathers those that were refused.
class KeyWriter {
 public:
  KeyWriter(SettingsFile& ini, const char* section) : ini_(ini), section_(section), batch_(ini) {}

  void Section(const char* section) { section_ = section; }
  void Put(const char* key, const std::string& value) {
    const std::string named = std::string("; ") + key;
    all_ += named;
    if (!ini_.PutSetting(section_, key, value)) failed_ += named;
  }
  void Put(const char* key, const std::string& typed, std::int16_t& live) {
    live = SettingCInt(typed);
    Put(key, Text(live));
  }
  void Put(const char* key, bool value, bool& live) {
    live = value;
    Put(key, value ? "True" : "False");
  }
  // Those that could not be written: where the file can't be, all.
  std::string End() { return batch_.End() ? failed_ : all_; }

 private:
  SettingsFile& ini_;
  const char* section_;
  SettingsFile::Batch batch_;
  std::string failed_, all_;
};

}  // namespace

ChartDefaults DefaultsFromSettings(const Settings& settings) {
  const OscSettings& osc = settings.osc;
  const ChartSettings& charts = settings.charts;
  ChartDefaults form;
  for (const OscKey& key : OscKeys()) {
    const PeriodPair pair = osc[key];
    form.periods.push_back({Text(pair.daily), Text(pair.twin)});
  }
  form.CompFile = osc.CompFile;
  form.BCCalTp = osc.BCCalTp;
  form.LCalTp = osc.LCalTp;
  form.VCalTp = osc.VCalTp;
  form.CutVols = osc.CutVols;
  form.ShowOsc = osc.ShowOsc;
  form.FXReversed = !osc.FXRev;
  form.FillIn = osc.FillIn;
  form.RFAve = osc.RFAve;
  form.average1 = {Text(charts.Av1D), Text(charts.Av1W)};
  form.average2 = {Text(charts.Av2D), Text(charts.Av2W)};
  form.AvOne = charts.AvOne;
  form.AvTwo = charts.AvTwo;
  form.AvCalc = charts.AvCalc;
  form.ScMethod = charts.ScMethod;
  return form;
}

DefaultsSaved SaveChartDefaults(SettingsFile& ini, const Files& files, Dialogs& dialogs,
                                const ChartDefaults& typed, Settings& settings) {
  OscSettings& osc = settings.osc;
  ChartSettings& charts = settings.charts;
  KeyWriter keys(ini, "OscDef");
  for (size_t i = 0; i < OscKeys().size(); ++i) {
    const OscKey& key = OscKeys()[i];
    PeriodPair& live = osc[key];
    keys.Put(key.daily, typed.periods[i].daily, live.daily);
    keys.Put(key.twin, typed.periods[i].twin, live.twin);
  }

  const std::string compareFile(Trim(typed.CompFile));
  if (compareFile.empty() || !files.CheckFile(compareFile) || files.IsFolder(compareFile)) {
    dialogs.Message(
        "RMO/RMX compare file not found.\nEnter path and file details\n"
        "Example   c:\\korawin\\data\\ALODB.WDT",
        "RMO/RMX Compare File");
    return DefaultsSaved::kCompareFile;
  }
  osc.CompFile = compareFile;
  keys.Put("CompFile", compareFile);
  keys.Put("BCCalTp", typed.BCCalTp, osc.BCCalTp);
  keys.Put("LCalTp", typed.LCalTp, osc.LCalTp);
  keys.Put("VCalTp", typed.VCalTp, osc.VCalTp);
  keys.Put("CutVols", typed.CutVols, osc.CutVols);
  keys.Put("ShowOsc", typed.ShowOsc, osc.ShowOsc);
  keys.Put("FXRev", !typed.FXReversed, osc.FXRev);
  keys.Put("FillIn", typed.FillIn, osc.FillIn);
  keys.Put("RFAve", typed.RFAve, osc.RFAve);

  keys.Section("Charts");
  keys.Put("Av1D", typed.average1.daily, charts.Av1D);
  keys.Put("Av2D", typed.average2.daily, charts.Av2D);
  keys.Put("Av1W", typed.average1.twin, charts.Av1W);
  keys.Put("Av2W", typed.average2.twin, charts.Av2W);
  keys.Put("AvOne", typed.AvOne, charts.AvOne);
  keys.Put("AvTwo", typed.AvTwo, charts.AvTwo);
  keys.Put("AvCalc", typed.AvCalc, charts.AvCalc);
  keys.Put("ScMethod", typed.ScMethod, charts.ScMethod);

  if (const std::string failed = keys.End(); !failed.empty())
    dialogs.Message(failed, "Chart Defaults");
  return DefaultsSaved::kAll;
}

}  // namespace kora
