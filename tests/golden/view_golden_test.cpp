#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <string>
#include <vector>

#include "indicators/multi_osc.h"
#include "platform/headless/headless_surface.h"
#include "platform/qt/picture.h"
#include "platform/surface_part.h"
#include "tests/golden/market.h"
#include "tests/support/places.h"
#include "tests/support/scripted_dialogs.h"

// Whole views of several oscillators, held byte for byte, from a headless surface and from the one
// that draws pictures. KORA_GOLDEN_PICTURES and KORA_GOLDEN_WRITE as for charts.

namespace kora {
namespace {

using test::GoldenMarket;

struct GoldenView {
  const char* file;
  const char* code;
  char style;
  const char* period;
  const char* oscillators;  // with commas
};

void PrintTo(const GoldenView& view, std::ostream* out) { *out << view.file; }

constexpr double kWidth = 800, kHeight = 480;  // of the price picture

const GoldenView kViews[] = {
    {"view_1_macd", "SHARE", 'B', "A", "MACD"},
    {"view_2_rsi_dm_weekly", "SHARE", 'C', "W", "RSI,Directional Movement"},
    {"view_3_of_four", "INDEX", 'L', "A", "Stochastic (Fast),None,ROC and FX,Coppock"},
    {"view_4_rmx_obv", "SHARE", 'B', "A", "RMX,Stochastic (Slow),OBV,Williams %R"},
    {"view_4_monthly", "SHARE", 'L', "M", "Momentum,Volatility,Jones Holy Grail,Elder Ray"},
};

class ViewGoldenTest : public testing::TestWithParam<GoldenView> {
 protected:
  static void SetUpTestSuite() { market_ = new GoldenMarket; }
  static void TearDownTestSuite() {
    delete market_;
    market_ = nullptr;
  }

  void Draw(Surface& price, Surface& below) {
    const GoldenView& golden = GetParam();
    Settings settings;
    settings.paths.SystemPath = "c:\\korawin\\";
    settings.paths.CurrentDataPath = "c:\\korawin\\data\\";
    settings.fonts.TitleSize = 9.75;
    settings.fonts.Font2Size = 6;
    // Shorter than the defaults, so that months have values too.
    for (const OscKey& key : OscKeys()) settings.osc[key] = {key.defaultDaily, 5};
    settings.osc.FillIn = settings.osc.RFAve = true;
    settings.osc.CompFile = "c:\\korawin\\data\\INDEX.WDT";
    ChartColours colours;
    LoadColours(market_->home().files(), settings.paths.SystemPath, "Black", colours);
    ChartRequest request;
    request.Name = market_->name(golden.code);
    request.ChartStyle = ParseStyle({&golden.style, 1}).value();
    request.ChartPeriod = ParsePeriod(golden.period).value();
    request.BarSpacing = 4;
    request.GridLines = true;
    const MultiOscSet names = MultiOscSetOf(golden.oscillators, ',');
    const int count = PanelCount(names);
    const double height = MultiOscPanelHeight(below.Height(), count);
    std::vector<SurfacePart> parts;
    for (int i = 0; i < count; ++i) parts.emplace_back(below, i * height, height);
    std::vector<Surface*> panels;
    for (SurfacePart& part : parts) panels.push_back(&part);
    Composition chart;
    const ChartServices services{.files = market_->home().files(),
                                 .dialogs = dialogs_,
                                 .paths = settings.paths,
                                 .fonts = settings.fonts,
                                 .colours = colours,
                                 .price = price,
                                 .script = &script_};
    ASSERT_TRUE(DrawMultiOsc(services, settings, request, chart, names, panels));
    ASSERT_TRUE(dialogs_.said.empty()) << dialogs_.said.back().text;
  }

  std::string Held() const {
    const std::string path = SourceDir() + "/tests/golden/views/" + GetParam().file + ".cht";
    if (std::getenv("KORA_GOLDEN_WRITE")) std::ofstream(path, std::ios::binary) << script_.text();
    std::ifstream in(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
  }

  static GoldenMarket* market_;
  test::ScriptedDialogs dialogs_;
  ChartScript script_;
};

GoldenMarket* ViewGoldenTest::market_ = nullptr;

TEST_P(ViewGoldenTest, ScriptIsTheOneThatWasLookedAt) {
  HeadlessSurface price(kWidth, kHeight), below(kWidth, kHeight);
  Draw(price, below);
  EXPECT_EQ(script_.text(), Held());
}

TEST_P(ViewGoldenTest, APictureWritesTheSameScript) {
  PictureSize size;
  size.width = kWidth;
  size.height = size.panel = kHeight;
  const std::string png = MakePicture(
      PictureKind::kPng, size, [this](Surface& price, Surface* panel) { Draw(price, *panel); });
  if (const char* folder = std::getenv("KORA_GOLDEN_PICTURES"))
    std::ofstream(std::string(folder) + "/" + GetParam().file + ".png", std::ios::binary) << png;
  EXPECT_EQ(script_.text(), Held());
}

INSTANTIATE_TEST_SUITE_P(Views, ViewGoldenTest, testing::ValuesIn(kViews),
                         [](const auto& info) { return std::string(info.param.file); });

}  // namespace
}  // namespace kora
