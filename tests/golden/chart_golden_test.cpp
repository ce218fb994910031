#include <QGuiApplication>

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iterator>

#include "chart/composer.h"
#include "indicators/oscillators.h"
#include "indicators/price_overlays.h"
#include "platform/headless/headless_surface.h"
#include "platform/qt/picture.h"
#include "tests/golden/market.h"
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
};

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

const GoldenChart kCharts[] = {
    {"bar_daily_2", "SHARE", 'B', "A", 2, 638, 452, kGrid},
    {"bar_daily_5_marks", "SHARE", 'B', "A", 5, 638, 452, [](ChartRequest& r) { r.ColourMarks = true; }},
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
    {"bands_percentage", "SHARE", 'B', "A", 5, 638, 452, [](ChartRequest& r) { r.BandKind = 1; }},
    {"bands_bollinger", "SHARE", 'C', "A", 5, 638, 452, [](ChartRequest& r) { r.BandKind = 2; }},
    {"mma_weekly", "SHARE", 'L', "W", 5, 638, 452, kPlain, 0, false, "", false, true},
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
    request.ChartStyle = golden.style;
    request.ChartPeriod = golden.period;
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
    for (const OscKey& key : OscKeys())
      settings.osc.*key.value = {key.defaultDaily, key.defaultTwin};
    settings.osc.MMASet = kDefaultMMASet;
    settings.osc.FillIn = settings.osc.RFAve = true;
    settings.osc.CompFile = "c:\\korawin\\data\\INDEX.WDT";
    request.OscName = golden.osc;
    const ChartServices services{market_->home().files(),
                                 dialogs_,
                                 paths,
                                 fonts,
                                 colours,
                                 price,
                                 panel,
                                 &script_,
                                 PriceOverlays(golden.mma, settings.osc.MMASet)};
    if (golden.twoCharts) {
      chart.TwoCharts = true;
      chart.ChartSlot = 1;
      ASSERT_TRUE(ComposeChart(services, request, chart));
      request.Name = market_->name("PENNY");
      request.ChartStyle = 'C';
    }
    ASSERT_TRUE(ComposeChart(services, request, chart)) << dialogs_.said.back().text;
    OscHost host{market_->home().files(), dialogs_, settings,
                 colours,                 request,  chart,
                 price,                   panel ? *panel : price, &script_};
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
  const std::string file =
      std::string(KORA_SOURCE_DIR) + "/tests/golden/charts/" + golden.file + ".cht";
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
  const std::string png = MakePicture(PictureKind::kPng, size, [this](Surface& price, Surface* panel) {
    Compose(price, panel);
  });
  if (const char* folder = std::getenv("KORA_GOLDEN_PICTURES"))
    WriteFile(std::string(folder) + "/" + golden.file + ".png", png);
  EXPECT_EQ(script_.text(),
            ReadFile(std::string(KORA_SOURCE_DIR) + "/tests/golden/charts/" + golden.file + ".cht"));
}

INSTANTIATE_TEST_SUITE_P(Charts, ChartGoldenTest, testing::ValuesIn(kCharts),
                         [](const auto& info) { return std::string(info.param.file); });

}  // namespace

int main(int argc, char** argv) {
  QGuiApplication app(argc, argv);
  testing::InitGoogleTest(&argc, argv);
  return RUN_ALL_TESTS();
}
