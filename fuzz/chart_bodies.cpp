#include <cmath>

#include "base/runtime_error.h"
#include "chart/chart_printing.h"
#include "chart/composer.h"
#include "chart/script_player.h"
#include "chart/script_reading.h"
#include "chartwindow/tools/saved_marks.h"
#include "fuzz/drawing.h"
#include "fuzz/readers.h"
#include "fuzz/small_home.h"
#include "indicators/oscillators.h"
#include "indicators/price_overlays.h"
#include "platform/headless/headless_surface.h"
#include "scans/chart_scan1.h"
#include "scans/chart_scan2.h"
#include "scans/chart_scan3.h"
#include "scans/market_statistics.h"
#include "tests/support/error_of.h"
#include "tests/support/recording_printer.h"

namespace kora::test {
namespace {

// Where charts come to lie; what is drawn is a number each time.
class CheckedSurface : public HeadlessSurface {
 public:
  using HeadlessSurface::HeadlessSurface;
  void Line(double x1, double y1, double x2, double y2, Colour) override { At(x1, y1, x2, y2); }
  void Box(double x1, double y1, double x2, double y2, Colour) override { At(x1, y1, x2, y2); }
  void FilledBox(double x1, double y1, double x2, double y2, Colour) override {
    At(x1, y1, x2, y2);
  }
  void PSet(double x, double y, Colour) override { At(x, y, 0, 0); }
  void Print(std::string_view text) override {
    At(CurrentX(), CurrentY(), 0, 0);
    Promise(Font().size > 0 && Font().size <= 500, "a font has a size");
    HeadlessSurface::Print(text);
  }

 private:
  static void At(double x1, double y1, double x2, double y2) {
    for (const double value : {x1, y1, x2, y2})
      Promise(std::isfinite(value), "what is drawn has a place");
  }
};

// A new installation's, with periods for all oscillators.
const Settings& ChartDefaults() {
  static const Settings settings = [] {
    SmallHome home;
    SettingsFile ini(home.files, "C:\\WINDOWS\\Kora.ini");
    WriteDefaultSettings(ini);
    ReadSettings(ini, home.files, home.dialogs, home.settings);
    for (const OscKey& key : OscKeys())
      home.settings.osc[key] = {key.defaultDaily, key.defaultTwin};
    home.settings.osc.CompFile = "c:\\korawin\\data\\IDX.WDT";
    return home.settings;
  }();
  return settings;
}

// A player that draws what takes seconds is stopped by its budget; that is too slow for here.
bool IsLong(std::string_view script) { return script.size() > 20'000; }

}  // namespace

void DrawChart(SmallHome& home, const Settings& settings, const ChartRequest& request, bool slow,
               bool plays) {
  ChartColours colours{};
  LoadColours(home.files, home.system, "Black", colours);
  CheckedSurface price(638, 452), panel(638, 144);
  ChartScript script;
  ChartServices services{
      home.files,     home.dialogs, settings.paths,
      settings.fonts, colours,      price,
      &panel,         &script,      PriceOverlays(request.Ma1On, settings.osc.MMASet)};
  services.overlays.push_back(SavedMarksOverlay(home.files, settings.paths.ChartMiscPath));
  Composition chart;
  home.dialogs.said.clear();
  if (!ComposeChart(services, request, chart)) {
    Promise(!home.dialogs.said.empty(), "a chart that fails is told");
    return;
  }
  if (!request.OscName.empty()) {
    OscHost host{home.files, home.dialogs, settings, colours, request,
                 chart,      price,        panel,    &script};
    host.OscCode = request.OscName;
    host.SlowStochastic = slow;
    ShowOscillatorPanel(host);
  }
  if (!plays) return;
  CheckedSurface again(638, 600);
  Promise(PlayChartScript(script.text(), again, settings.fonts, colours),
          "a chart that was drawn can be played");
}

void ReadScriptBody(std::string_view bytes) {
  LineReader lines(bytes);
  std::string_view line;
  while (lines.Next(line)) {
    ScriptLine fields;
    const int error = ErrorOf([&] { SplitScriptLine(line, fields); });
    Promise(error == 0 || error == kIndexOutOfRange || error == kOutOfTextSpace, "error 9 or 14");
    if (error != 0) continue;
    size_t size = 0;
    for (const std::string& text : fields.text) {
      size += text.size();
      Promise(text.find(',') == std::string::npos, "no comma within a field");
    }
    Promise(size <= line.size(), "fields are no longer than their line");
    for (int field = 1; field <= 6; ++field) {
      Promise(!std::isnan(fields.number(field)), "a field is a number");
      const int whole = ErrorOf([&] { fields.whole(field); });
      Promise(whole == 0 || whole == kOverflow, "error 6 where a number leaves 32 bits");
    }
  }
  if (IsLong(bytes)) return;
  SmallHome home;
  home.Put("chtsave/x.cht", bytes);
  const auto before = home.io.Store();
  const Settings& settings = ChartDefaults();
  ChartColours colours{};
  LoadColours(home.files, home.system, "Black", colours);
  CheckedSurface surface(638, 452);
  const bool played = PlayChartScript(bytes, surface, settings.fonts, colours);
  const bool shown = ShowSavedChart(home.files, home.dialogs, surface, settings.fonts, colours,
                                    "c:\\korawin\\chtsave\\x.cht");
  Promise(played == shown, "a saved chart shows as it plays");
  Promise(shown == home.dialogs.said.empty(), "what can't be shown is told");

  RecordingPrinter printer;
  PrintSetup setup = PrintSetupFrom(settings, {});
  SetPageDefaults(printer, {638, 452}, setup);
  PrintChart({home.files, home.dialogs, printer, settings.fonts, colours, {}}, setup, {638, 452},
             "c:\\korawin\\chtsave\\x.cht");
  Promise(printer.started == int(printer.sent.size()) + printer.killed, "a page is sent or not");
  home.OnlyChanged(before, {});
}

// Four bytes of choices, and the price file.
void DrawPricesBody(std::string_view bytes) {
  Input input(bytes);
  const unsigned style = input.Byte(), osc = input.Byte(), switches = input.Byte();
  const unsigned kind = input.Byte();
  SmallHome home;
  home.PutMarket();
  home.Put("data/ORE.WDT", input.Rest());
  home.Put("chtmisc/ORE.Txt", "T,8.25,19980911,1.50,Text,255\r\n");
  const auto before = home.io.Store();
  Settings settings = ChartDefaults();
  settings.osc.BCCalTp = settings.osc.LCalTp = settings.osc.VCalTp = (switches & 1) != 0;

  ChartRequest request = RequestFromSettings(settings);
  request.Name = NewNameRec("ORE");
  request.Name.RecType = std::int16_t(kind % 5 + 1);
  request.Name.Base = kind & 8 ? 1.0f : 0.0f;
  request.Name.Top = kind & 8 ? 2.0f : 0.0f;
  request.AutoScale = (kind & 8) == 0;
  constexpr Style kStyles[] = {Style::kBar, Style::kCandlestick, Style::kLine, Style::kPointFigure};
  constexpr Period kPeriods[] = {Period::kDaily, Period::kWeekly, Period::kMonthly};
  request.ChartStyle = kStyles[style & 3];
  request.ChartPeriod = kPeriods[(style >> 2) % 3];
  request.BarSpacing = std::int16_t((style >> 4) + 1);
  request.LogBars = request.LogLines = request.LogVolume = (switches & 1) != 0;
  request.MovingGrid = (switches & 2) != 0;
  request.GridSpace = 5;
  request.Ma1On = request.Ma2On = (switches & 4) != 0;
  request.MaExp = (switches & 8) != 0;
  request.BandKind = std::int16_t((switches >> 4) % 3);
  request.ColourMarks = request.OutsideMarks = (switches & 64) != 0;
  request.Legible = (switches & 128) != 0;
  if (kind & 16) {
    request.Swing = SwingKind((kind >> 5) % 5);
    request.SwingSize = 3;
  }
  const auto oscillators = Oscillators();
  const size_t at = osc % (oscillators.size() + 1);
  if (at < oscillators.size() && request.ChartStyle != Style::kPointFigure)
    request.OscName = oscillators[at].code;

  // A script has no way to write the comma of a note.
  const bool plays = input.Rest().find(',') == std::string_view::npos;
  DrawChart(home, settings, request, (osc & 128) != 0, plays);
  home.OnlyChanged(before, {});
}

// A byte of choices, and the price file.
void ScanPricesBody(std::string_view bytes) {
  Input input(bytes);
  const unsigned choice = input.Byte();
  SmallHome home;
  home.PutMarket();
  home.Put("data/ORE.WDT", input.Rest());
  const auto before = home.io.Store();
  const Settings& settings = ChartDefaults();
  const ScanRun run{home.files, home.data, home.progress};

  Scan1Choices one;
  one.Check1 = (choice & 1) != 0;
  one.Text1 = "5";
  one.Check15 = (choice & 2) != 0;
  one.Text6 = "5";
  one.Check7 = (choice & 4) != 0;
  one.oscillators.fill((choice & 8) != 0);
  one.Check9 = one.Check10 = one.Check11 = one.Check12 = true;
  Scan1Criteria first;
  if (!ReadScan1(one, settings.osc, first))
    for (const Scan1Hit& hit : RunScan1(run, first).hits) CellsOf(hit);

  Scan2Choices two;
  two.Check1 = (choice & 4) != 0;
  two.Check2 = (choice & 16) != 0;
  two.Text5 = "5";
  two.Check3 = (choice & 32) != 0;
  two.Text4 = "5";
  Scan2Criteria second;
  if (!ReadScan2(two, second))
    for (const Scan2Hit& hit : RunScan2(run, second).hits) CellsOf(hit);

  Scan3Choices three;
  three.Check3 = three.Check5 = true;
  Scan3Criteria third;
  if (!ReadScan3(three, third))
    for (const Scan3Hit& hit : RunScan3(run, third).hits) CellsOf(hit);

  const MarketStats statistics = ShowStats(run, StatsMode::kAll, 10);
  const auto texts = StatsTexts(statistics);
  home.OnlyChanged(before, {});
  KeepStats(home.files, home.data, texts);
  KeptStats(home.files, home.data);
}

}  // namespace kora::test
