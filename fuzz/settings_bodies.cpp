#include <vector>

#include "base/text.h"
#include "chart/chart_printing.h"
#include "chart/chart_request.h"
#include "chart/chart_state.h"
#include "fuzz/drawing.h"
#include "fuzz/readers.h"
#include "fuzz/small_home.h"
#include "indicators/chart_defaults.h"
#include "indicators/multi_osc.h"
#include "indicators/oscillators.h"
#include "lists/chart_list.h"
#include "looks/colours.h"
#include "looks/look_settings.h"
#include "scans/chart_scan1.h"
#include "scans/chart_scan2.h"
#include "scans/chart_scan3.h"
#include "shell/session.h"
#include "update/download_settings.h"

namespace kora::test {
namespace {

// A value as a key keeps it.
std::string OnOneLine(std::string_view value) {
  std::string out(value);
  for (char& c : out)
    if (c == '\r' || c == '\n' || c == '\0') c = ' ';
  return std::string(Trim(out));
}

// The value of a key comes back, and nothing else has changed.
void CheckPut(const Files& files, const std::string& path, std::string_view section,
              std::string_view key, std::string_view value) {
  SettingsFile file(files, path);
  const std::string other = file.GetSetting("Charts", "Type");
  if (!file.PutSetting(section, key, value)) {
    Promise(SettingsFile(files, path).GetSetting("Charts", "Type") == other, "no key has changed");
    return;
  }
  std::string wanted = OnOneLine(value);
  if (wanted.empty()) wanted = kUnknown;
  const SettingsFile fresh(files, path);
  Promise(fresh.GetSetting(section, key) == wanted, "what was written reads back");
  const bool same = EqualNoCase(Trim(section), "Charts") && EqualNoCase(Trim(key), "Type");
  if (!same) Promise(fresh.GetSetting("Charts", "Type") == other, "other keys stay");
}

// A chart by these settings, and one of the oscillators.
void DrawWith(SmallHome& home, Settings settings, size_t which) {
  SetDefaultPaths(settings.paths, "c:");
  ChartRequest request = RequestFromSettings(settings);
  request.Name = NewNameRec("ORE");
  request.ChartStyle = ParseStyle(settings.charts.Type).value_or(Style::kBar);
  request.ChartPeriod = ParsePeriod(settings.charts.Period).value_or(Period::kDaily);
  request.BandKind = settings.charts.Bands;
  const auto oscillators = Oscillators();
  if (request.ChartStyle != Style::kPointFigure)
    request.OscName = oscillators[which % oscillators.size()].code;
  DrawChart(home, settings, request, settings.charts.AvCalc, false);
}

}  // namespace

// The file, and behind a mark a section, a key and a value to write.
void ReadSettingsBody(std::string_view bytes) {
  Input input(bytes);
  const std::string_view text = input.Part();
  const std::string_view section = input.Part(), key = input.Part(), value = input.Rest();
  SmallHome home;
  home.io.confined = false;  // folders are where the settings say
  home.io.Put("home/Kora.ini", text);
  home.io.Put("home/KoraUser.ini", text);
  home.PutMarket();
  home.Put("data/ORE.WDT", ManyDays());
  const FixedClock clock;
  Session session("home", home.dialogs, home.io, clock);
  if (ReadAllSettings(session, "XT N", false)) {
    const Settings& s = session.settings;
    Promise(s.Zoom >= kLeastZoom && s.Zoom <= kMostZoom, "a zoom in its range");
    DrawWith(home, s, text.size());
    MakeRequest(session.charts, s, NewNameRec("ORE"));
    PrintSetupFrom(s, session.printer);
    PrintedLineWidth(s);
    ChartDefaults typed = DefaultsFromSettings(s);
    {
      const SettingsFile::Batch batch(session.ini);  // sixty writes are one
      SaveChartDefaults(session.ini, session.files, session.dialogs, typed, session.settings);
    }
    UpdateChoiceOf(s.download);
    FormatToStore(s.download.InternetDLfmt);
    WizardTicks(session.ini);
    SavePaths(session.ini, session.settings);
    const std::string data = session.settings.paths.CurrentDataPath;
    Settings again;
    again.paths.WindowsPath = "C:\\WINDOWS\\";
    SettingsFile fresh(session.files, session.ini.path());
    Promise(ReadSettings(fresh, session.files, session.dialogs, again), "settings read back");
    if (WhyNotKept(data).empty())
      Promise(again.paths.CurrentDataPath == OnOneLine(data), "folders read back");
  }
  for (const std::string& name : GetSubLists(session.user))
    Promise(!name.empty(), "a list has a name");
  for (int set = 1; set <= kMultiOscSets; ++set) ReadMOSet(session.user, set);
  Scan1Choices one;
  Scan2Choices two;
  Scan3Choices three;
  TakeKeptScan1(text, one);
  TakeKeptScan2(text, two);
  TakeKeptScan3(text, three);
  Scan1Choices oneAgain;
  TakeKeptScan1(KeptScan1(one), oneAgain);
  Promise(KeptScan1(oneAgain) == KeptScan1(one), "choices read back");

  const std::string path = session.ini.path();
  CheckPut(session.files, path, "Charts", "Period", "\r\n[x]\r\nW");
  CheckPut(session.files, path, section, key, value);
  CheckPut(session.files, path, "KoraPaths", key, value);
}

void ReadColoursBody(std::string_view bytes) {
  SmallHome home;
  for (const char* name : {"Koraclr.dat", "Koraclr.BLK", "Koraclr.WHT", "koraprn.dat"})
    home.Put(name, bytes);
  const auto before = home.io.Store();
  ChartColours colours{};
  LoadColours(home.files, home.system, "White", colours);
  LoadUserColours(home.files, home.system, colours);
  for (size_t i = 0; i < StandardColours().size(); ++i)
    Promise(colours[i] == StandardColours()[i], "the standard colours stand");
  SaveColours(home.files, home.system, colours);
  ChartColours again{};
  Promise(LoadUserColours(home.files, home.system, again), "a saved table is whole");
  again[50] = colours[50];
  Promise(again == colours, "colours read back");
  for (const std::int32_t colour : colours) ForWhitePaper(colour);
  WriteColourVariants(home.files, home.system);

  const PrinterColours printer = ReadPrinterColours(home.files, home.system);
  Promise(printer.asked == (bytes.size() >= 4), "a record is an answer");
  WritePrinterColours(home.files, home.system, printer);
  const PrinterColours kept = ReadPrinterColours(home.files, home.system);
  Promise(kept.asked && kept.ColourPrinter == printer.ColourPrinter &&
              kept.WhiteAsBlack == printer.WhiteAsBlack,
          "answers read back");
  home.OnlyChanged(before, {"Koraclr.dat", "Koraclr.BLU", "koraprn.dat"});
}

}  // namespace kora::test
