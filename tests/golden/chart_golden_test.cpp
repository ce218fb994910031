#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iterator>

#include "chart/composer.h"
#include "chartwindow/tools/saved_marks.h"
#include "indicators/oscillators.h"
#include "indicators/price_overlays.h"
#include "platform/headless/headless_surface.h"
#include "platform/qt/picture.h"
#include "tests/golden/market.h"
#include "tests/support/places.h"
#include "tests/support/scripted_dialogs.h"

// Whole scripts of charts, looked at as pictures once and since then held byte for byte.
//
// With KORA_GOLDEN_PICTURES=<folder> each chart is also drawn there, and with
// KORA_GOLDEN_WRITE=1 the scripts are written anew: look at every picture before keeping them.

using namespace kora;
using kora::test::GoldenMarket;

namespace {

struct GoldenChart {
  const char* file;
  const char* code;
  char style;
  const char* period;
  int spacing;
  double width, height;
  std::function<void(ChartRequest&)> options;
  double panel = 0;
  bool twoCharts = false;
  const char* osc = "";
  bool slow = false;
  bool mma = false;
  bool saved = false;  // lines and texts are kept with the security
  bool over = false;   // PENNY is laid over it
};

// As in the easing of labels; the rest as `options` has it.
GoldenChart Legible(GoldenChart chart) {
  chart.options = [options = chart.options](ChartRequest& r) {
    options(r);
    r.Legible = true;
  };
  return chart;
}

TrendlineRec Kept(const char* period, const char* from, float price, const char* to, float end) {
  TrendlineRec rec = EmptyTrendline();
  rec.TLSpacing = 3;
  rec.TLPeriod.set(period);
  rec.TLStartDate.set(from);
  rec.TLStartPrice = price;
  rec.TLEndDate.set(to);
  rec.TLEndPrice = end;
  return rec;
}

// Three lines of days, one of them into the blank space and one of a price that is off the chart,
// an empty slot, a record that says nothing, a line of weeks; two texts.
const SavedMarks& KeptMarks() {
  static const SavedMarks marks{
      {Kept("A", "20240401", 14.5f, "20240701", 18.25f), EmptyTrendline(),
       Kept("A", "20240610", 16, "X60", 20.5f), Kept("W", "20230301", 14, "20240301", 19),
       Kept("A", "20240401", 99, "20240701", 18.25f), Kept("A", "letters", 15, "20240701", 18)},
      {MakeNoteLine("20240506", 15.25, "Bought here", 65535), ParseNoteLine("nonsense"),
       MakeNoteLine("20240715", 19.5, "sold", 255)}};
  return marks;
}

// A chart of SHARE or another with an oscillator.
GoldenChart Panel(const char* file, const char* osc, const char* code = "SHARE",
                  const char* period = "A", bool slow = false) {
  GoldenChart chart{file, code, 'B', period, 5, 638, 308, [](ChartRequest&) {}};
  chart.panel = HasPanel(osc) ? 144 : 0;
  chart.osc = osc;
  chart.slow = slow;
  return chart;
}

void PrintTo(const GoldenChart& chart, std::ostream* out) { *out << chart.file; }

const auto kPlain = [](ChartRequest&) {};
const auto kGrid = [](ChartRequest& r) { r.GridLines = true; };
const auto kLog = [](ChartRequest& r) {
  r.LogBars = r.LogLines = r.LogVolume = true;
  r.GridLines = r.HalfGrid = true;
};
const auto kManual = [](ChartRequest& r) { r.AutoScale = false; };

// Point and figure; the spacing is the reversal.
GoldenChart Boxes(const char* file, const char* code, int reversal,
                  std::function<void(ChartRequest&)> options = kGrid, double width = 638) {
  return {file, code, 'P', "A", reversal, width, 452, std::move(options)};
}

GoldenChart Swing(const char* file, SwingKind kind, const char* period, double size = 0,
                  const char* code = "SHARE") {
  return {file, code, 'B', period, 3, 638, 452, [kind, size](ChartRequest& r) {
            r.GridLines = true;
            r.Swing = kind;
            r.SwingSize = size;
          }};
}

const GoldenChart
    kCharts
        [] =
            {
                {"bar_daily_2", "SHARE", 'B', "A", 2, 638, 452, kGrid},
                {"bar_daily_5_marks", "SHARE", 'B', "A", 5, 638, 452,
                 [](ChartRequest& r) { r.ColourMarks = true; }},
                {"bar_daily_4_stop", "SHARE", 'B', "A", 4, 638, 452,
                 [](ChartRequest& r) {
                   r.OutsideMarks = r.StopLossShown = true;
                   r.StopLossPct = 4;
                   r.VolumeOption = false;
                 }},
                {"bar_weekly_3_log", "SHARE", 'B', "W", 3, 638, 452, kLog},
                {"bar_monthly_9_manual", "SHARE", 'B', "M", 9, 800, 600, kManual},
                {"bar_daily_2_panel", "SHARE", 'B', "A", 2, 638, 308, kGrid, 144},
                {"bar_daily_8_finish", "SHARE", 'B', "A", 8, 638, 452,
                 [](ChartRequest& r) {
                   r.FinishDateOn = true;
                   r.FinishDate = "20220601";
                   r.GridLines = true;
                   r.MovingGrid = false;
                   r.GridSpace = 10;
                 }},
                {"bar_daily_4_print", "SHARE", 'B', "A", 4, 638, 452,
                 [](ChartRequest& r) { r.ScriptPrintMode = true; }},
                {"bar_two_charts", "SHARE", 'B', "A", 4, 638, 452, kPlain, 0, true},
                {"candle_daily_4", "SHARE", 'C', "A", 4, 638, 452,
                 [](ChartRequest& r) {
                   r.GridLines = r.CutVols = true;
                   r.Ma1On = true;
                   r.Ma1Days = 20;
                 }},
                {"candle_daily_6_log", "SHARE", 'C', "A", 6, 1000, 500, kLog},
                {"candle_weekly_6", "SHARE", 'C', "W", 6, 638, 452,
                 [](ChartRequest& r) { r.VolumeOption = false; }},
                {"candle_monthly_12", "SHARE", 'C', "M", 12, 638, 452, kGrid},
                {"line_daily_1", "SHARE", 'L', "A", 1, 638, 452, kGrid},
                {"line_weekly_3_log_averages", "SHARE", 'L', "W", 3, 638, 452,
                 [](ChartRequest& r) {
                   kLog(r);
                   r.Ma1On = r.Ma2On = r.MaExp = true;
                   r.Ma1Weeks = 5;
                   r.Ma2Weeks = 20;
                 }},
                {"line_monthly_10_manual", "SHARE", 'L', "M", 10, 638, 452, kManual},
                {"penny_bar_daily_3", "PENNY", 'B', "A", 3, 638, 452, kGrid},
                {"penny_candle_daily_5", "PENNY", 'C', "A", 5, 638, 452, kLog},
                {"index_bar_daily_4", "INDEX", 'B', "A", 4, 1200, 700, kGrid},
                {"index_line_weekly_4_log", "INDEX", 'L', "W", 4, 638, 452, kLog},
                {"advance_decline_daily_2", "ADVDEC", 'B', "A", 2, 638, 452, kGrid},
                {"advance_decline_monthly_8", "ADVDEC", 'L', "M", 8, 638, 452, kPlain},
                {"fund_daily_3", "FUND", 'B', "A", 3, 638, 452, kGrid},
                {"bands_percentage", "SHARE", 'B', "A", 5, 638, 452,
                 [](ChartRequest& r) { r.BandKind = 1; }},
                {"bands_bollinger", "SHARE", 'C', "A", 5, 638, 452,
                 [](ChartRequest& r) { r.BandKind = 2; }},
                {"mma_weekly", "SHARE", 'L', "W", 5, 638, 452, kPlain, 0, false, "", false, true},
                Boxes("pf_share_2", "SHARE", 2),
                Boxes("pf_share_3", "SHARE", 3),
                Boxes("pf_share_4", "SHARE", 4),
                Boxes("pf_share_5", "SHARE", 5),
                Boxes("pf_share_6", "SHARE", 6),
                Boxes("pf_share_3_manual", "SHARE", 3, kManual),
                Boxes("pf_share_3_record_box", "SHARE", 3,
                      [](ChartRequest& r) {
                        r.AutoScale = r.PFAutoBox = false;
                        r.Name.PFInc = 0.5f;
                      }),
                Boxes("pf_share_2_own_box", "SHARE", 2,
                      [](ChartRequest& r) {
                        r.GridLines = true;
                        r.PFAutoBox = false;
                        r.PFBoxSize = 0.2f;
                        r.BlankSpace = 60;
                      }),
                Boxes("pf_share_3_print", "SHARE", 3,
                      [](ChartRequest& r) { r.ScriptPrintMode = true; }),
                Boxes("pf_share_3_log", "SHARE", 3, kLog),
                Boxes("pf_share_2_narrow", "SHARE", 2, kGrid, 260),
                Boxes("pf_penny_3", "PENNY", 3),
                Boxes("pf_index_3", "INDEX", 3),
                Boxes("pf_fund_2", "FUND", 2),
                Boxes(
                    "pf_wrap_3", "WRAP", 3,
                    [](ChartRequest& r) {
                      r.GridLines = true;
                      r.PFAutoBox = false;
                      r.PFBoxSize = 1;
                    },
                    200),
                Swing("swing_norm_daily", SwingKind::kStandard, "A"),
                Swing("swing_norm_weekly", SwingKind::kStandard, "W"),
                Swing("swing_norm_monthly", SwingKind::kStandard, "M"),
                Swing("swing_xday_daily", SwingKind::kDays, "A", 3),
                Swing("swing_xday_weekly", SwingKind::kDays, "W", 2),
                Swing("swing_xday_monthly", SwingKind::kDays, "M", 2),
                Swing("swing_xpoint_daily", SwingKind::kPoints, "A", 60),
                Swing("swing_xpoint_weekly", SwingKind::kPoints, "W", 120),
                Swing("swing_xpoint_monthly", SwingKind::kPoints, "M", 200),
                Swing("swing_xpointauto_daily", SwingKind::kPointsAuto, "A"),
                Swing("swing_xpointauto_weekly", SwingKind::kPointsAuto, "W"),
                Swing("swing_xpointauto_monthly", SwingKind::kPointsAuto, "M"),
                Swing("swing_xpoint_index", SwingKind::kPoints, "A", 90, "INDEX"),
                Swing("swing_norm_penny", SwingKind::kStandard, "A", 0, "PENNY"),
                {"saved_marks_daily_2", "SHARE", 'B', "A", 2, 638, 452, kGrid, 0, false, "", false,
                 false, true},
                {"saved_marks_daily_5_log", "SHARE", 'C', "A", 5, 1000, 500,
                 [](ChartRequest& r) {
                   kLog(r);
                   r.BlankSpace = 100;
                 },
                 0, false, "", false, false, true},
                {"saved_marks_weekly_6", "SHARE", 'L', "W", 6, 638, 308, kPlain, 144, false, "RSI",
                 false, false, true},
                Panel("osc_sto", "STO"),
                Panel("osc_sto_slow", "STO", "SHARE", "A", true),
                Panel("osc_fx", "FX"),
                Panel("osc_rf", "R/F"),
                Panel("osc_roc", "ROC"),
                Panel("osc_mom", "MOM"),
                Panel("osc_wms", "WMS"),
                Panel("osc_rmo", "RMO"),
                Panel("osc_rmx", "RMX"),
                Panel("osc_rsi", "RSI"),
                Panel("osc_vty", "VTY"),
                Panel("osc_macd", "MACD"),
                Panel("osc_dm", "DM"),
                Panel("osc_ery", "ERY"),
                Panel("osc_cop", "COP"),
                Panel("osc_jhg", "JHG"),
                Panel("osc_obv", "OBV"),
                Panel("osc_para", "PARA"),
                Panel("osc_parav", "PARAV"),
                Panel("osc_sto_penny", "STO", "PENNY"),
                Panel("osc_macd_index_weekly", "MACD", "INDEX", "W"),
                Panel("osc_dm_fund", "DM", "FUND"),
                Panel("osc_roc_advance_decline", "ROC", "ADVDEC"),
                Panel("osc_obv_penny", "OBV", "PENNY"),
                Legible({"legible_penny_bar_daily_3", "PENNY", 'B', "A", 3, 638, 452, kGrid}),
                Legible({"legible_volumes_of_millions", "BLUE", 'B', "A", 2, 638, 452,
                         [](ChartRequest& r) {
                           kGrid(r);
                           r.FinishDateOn = true;
                           r.FinishDate = "20220103";
                         }}),
                Legible({"legible_prices_over_1000", "BLUE", 'C', "W", 5, 638, 452, kGrid}),
                Legible({"legible_prices_over_1000_log", "BLUE", 'C', "A", 4, 638, 452, kLog}),
                Legible(Panel("legible_prices_over_1000_panel", "RSI", "BLUE")),
                Legible(Boxes("legible_pf_prices_over_1000", "BLUE", 3)),
                Legible({"legible_two_charts", "BLUE", 'B', "A", 4, 638, 452, kPlain, 0, true}),
                Legible({"legible_index_24000", "HEIGHT", 'B', "A", 4, 638, 452,
                         [](ChartRequest& r) {
                           kGrid(r);
                           r.FinishDateOn = true;
                           r.FinishDate = "20210802";
                         }}),
                Legible({"legible_twenty_years_of_months", "AGES", 'L', "M", 2, 638, 452, kGrid}),
                Legible({"legible_months_of_days", "SHARE", 'B', "A", 1, 638, 452, kGrid}),
                Legible({"legible_second_chart", "SHARE", 'B', "A", 4, 638, 452, kGrid, 0, false,
                         "", false, false, false, true}),
};

class ChartGoldenTest : public testing::TestWithParam<GoldenChart> {
 protected:
  static void SetUpTestSuite() { market_ = new GoldenMarket; }
  static void TearDownTestSuite() {
    delete market_;
    market_ = nullptr;
  }

  void Compose(Surface& price, Surface* panel) {
    const GoldenChart& golden = GetParam();
    ChartRequest request;
    request.Name = market_->name(golden.code);
    request.ChartStyle = ParseStyle({&golden.style, 1}).value();
    request.ChartPeriod = ParsePeriod(golden.period).value();
    request.BarSpacing = static_cast<std::int16_t>(golden.spacing);
    request.VolHeight = 2;
    golden.options(request);
    Paths paths;
    paths.SystemPath = "c:\\korawin\\";
    paths.CurrentDataPath = "c:\\korawin\\data\\";
    FontSettings fonts;
    fonts.TitleSize = 9.75;
    fonts.Font2Size = 6;
    ChartColours colours;
    LoadColours(market_->home().files(), paths.SystemPath, "Black", colours);
    Composition chart;
    Settings settings;
    settings.paths = paths;
    settings.fonts = fonts;
    for (const OscKey& key : OscKeys()) settings.osc[key] = {key.defaultDaily, key.defaultTwin};
    settings.osc.MMASet = kDefaultMMASet;
    settings.osc.FillIn = settings.osc.RFAve = true;
    settings.osc.CompFile = "c:\\korawin\\data\\INDEX.WDT";
    request.OscName = golden.osc;
    ChartServices services{market_->home().files(),
                           dialogs_,
                           paths,
                           fonts,
                           colours,
                           price,
                           panel,
                           &script_,
                           PriceOverlays(golden.mma, settings.osc.MMASet)};
    if (golden.saved)
      services.overlays.push_back([](const ChartCanvas& canvas) {
        std::vector<TrendlineRow> rows;
        DrawSavedMarks(canvas, KeptMarks(), rows);
      });
    if (golden.twoCharts) {
      request.Place = ChartPlace::kUpper;
      ASSERT_TRUE(ComposeChart(services, request, chart));
      request.Name = market_->name("PENNY");
      request.ChartStyle = Style::kCandlestick;
      request.Place = ChartPlace::kLower;
    }
    if (golden.over) {
      request.Place = ChartPlace::kUnder;
      ASSERT_TRUE(ComposeChart(services, request, chart));
      request.Name = market_->name("PENNY");
      request.ChartStyle = Style::kLine;
      request.Place = ChartPlace::kOver;
    }
    ASSERT_TRUE(ComposeChart(services, request, chart)) << dialogs_.said.back().text;
    OscHost host{market_->home().files(), dialogs_, settings, colours, request, chart, price,
                 panel ? *panel : price,  &script_};
    host.OscCode = golden.osc;
    host.SlowStochastic = golden.slow;
    ShowOscillatorPanel(host);
    ASSERT_TRUE(dialogs_.said.empty()) << dialogs_.said.back().text;
  }

  static GoldenMarket* market_;
  test::ScriptedDialogs dialogs_;
  ChartScript script_;
};

GoldenMarket* ChartGoldenTest::market_ = nullptr;

std::string ReadFile(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

void WriteFile(const std::string& path, const std::string& bytes) {
  std::ofstream(path, std::ios::binary) << bytes;
}

TEST_P(ChartGoldenTest, ScriptIsTheOneThatWasLookedAt) {
  const GoldenChart& golden = GetParam();
  HeadlessSurface price(golden.width, golden.height);
  HeadlessSurface panel(golden.width, golden.panel > 0 ? golden.panel : 1);
  panel.SetVisible(golden.panel > 0);
  Compose(price, &panel);
  const std::string file = SourceDir() + "/tests/golden/charts/" + golden.file + ".cht";
  if (std::getenv("KORA_GOLDEN_WRITE")) WriteFile(file, script_.text());
  const std::string held = ReadFile(file);
  ASSERT_FALSE(held.empty()) << file;
  // Whole texts of 30,000 bytes say little: name the first line that differs.
  LineReader want(held), got(script_.text());
  std::string_view wantLine, gotLine;
  while (want.Next(wantLine)) {
    ASSERT_TRUE(got.Next(gotLine)) << "ends before line " << want.number();
    ASSERT_EQ(gotLine, wantLine) << "line " << want.number();
  }
  EXPECT_EQ(script_.text(), held);
}

TEST_P(ChartGoldenTest, WindowAndCommandWriteTheSameScript) {
  const GoldenChart& golden = GetParam();
  PictureSize size;
  size.width = golden.width;
  size.height = golden.height;
  size.panel = golden.panel;
  const std::string png = MakePicture(
      PictureKind::kPng, size, [this](Surface& price, Surface* panel) { Compose(price, panel); });
  if (const char* folder = std::getenv("KORA_GOLDEN_PICTURES"))
    WriteFile(std::string(folder) + "/" + golden.file + ".png", png);
  EXPECT_EQ(script_.text(), ReadFile(SourceDir() + "/tests/golden/charts/" + golden.file + ".cht"));
}

INSTANTIATE_TEST_SUITE_P(Charts, ChartGoldenTest, testing::ValuesIn(kCharts),
                         [](const auto& info) { return std::string(info.param.file); });

}  // namespace
