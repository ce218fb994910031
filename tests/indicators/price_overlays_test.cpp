#include "indicators/price_overlays.h"

#include <gtest/gtest.h>

#include <limits>

#include "tests/chart/composer_fixture.h"
#include "tests/support/recording_surface.h"

using namespace kora;
using kora::test::ComposerFixture;
using kora::test::RecordingSurface;
using Lines = std::vector<std::string>;

namespace {

// Bars by their closes, 4 apart from x 42 on; y = 400 - 2 * price. Colour entry n is n.
struct OverlayFixture {
  RecordingSurface surface{638, 452};
  ChartScript script;
  ChartPen pen{surface, &script};
  ChartRequest request;
  FontSettings fonts;
  ChartColours colours{};
  Composition chart;
  ChartCanvas canvas{pen, request, fonts, colours, chart};

  explicit OverlayFixture(const std::vector<float>& closes = {}) {
    for (size_t i = 0; i < colours.size(); ++i) colours[i] = std::int32_t(i);
    chart.FirstBarX = 42;
    chart.BarSpacing = 4;
    chart.Price.PricePerY = 0.5f;
    chart.Price.ChartBottom = 400;
    chart.Bars.BarCount = std::int16_t(int(closes.size()) - 1);
    for (const float close : closes) {
      ChartBar bar{};
      bar.Close = close;
      chart.Bars.bars.push_back(bar);
      chart.CloseY.push_back(1);
    }
    script.Open(false);
  }

  Lines Script() const {
    Lines out;
    LineReader reader(script.text());
    std::string_view line;
    while (reader.Next(line)) out.emplace_back(line);
    return out;
  }
};

std::vector<float> Repeat(float value, size_t count) { return std::vector<float>(count, value); }

// 21 closes with the mean 10 and a mean square of 80/21 about it, and two more that leave both
// as they are: upper 10 + 2 * 1.9518 = 13.9036, lower 6.0964.
std::vector<float> Swinging() {
  std::vector<float> closes{10};
  for (int i = 0; i < 10; ++i) closes.insert(closes.end(), {8, 12});
  closes.insert(closes.end(), {10, 8});
  return closes;
}

}  // namespace

TEST(PercentBandsTest, StandAboveAndBelowTheMeanOfTenCloses) {
  std::vector<float> closes = Repeat(10, 10);
  closes.push_back(20);
  OverlayFixture f(closes);
  f.request.Name.BandUp = 10;
  f.request.Name.BandDown = 20;
  ShowPercentBands(f.canvas);
  // Means 10 and 11: upper 11 and 12.1, lower 8 and 8.8.
  EXPECT_EQ(f.Script(), (Lines{"L,78,378,82,376,41", "L,78,384,82,382,41"}));
  EXPECT_EQ(f.surface.ops, (Lines{"line solid 78,378,82,376 41", "line solid 78,384,82,382 41"}));
}

TEST(PercentBandsTest, WidthsOutsideOneToAHundredAreFive) {
  std::vector<float> closes = Repeat(10, 10);
  closes.push_back(20);
  for (const int width : {0, -5, 101}) {
    OverlayFixture f(closes);
    f.request.Name.BandUp = f.request.Name.BandDown = std::int16_t(width);
    ShowPercentBands(f.canvas);
    // 10.5 and 11.55; 9.5 and 10.45.
    EXPECT_EQ(f.Script(), (Lines{"L,78,379,82,377,41", "L,78,381,82,379,41"})) << width;
  }
}

// ln 11 is 2.3979, ln 12.1 2.4932, ln 8 2.0794 and ln 8.8 2.1748; 100 units for each 1, downward.
TEST(PercentBandsTest, LogarithmicChartPlacesThemByTheirLogarithms) {
  std::vector<float> closes = Repeat(10, 10);
  closes.push_back(20);
  OverlayFixture f(closes);
  f.chart.Price.Logarithmic = true;
  f.chart.Price.LogBase = 0;
  f.chart.Price.LogFactor = -100;
  f.request.Name.BandUp = 10;
  f.request.Name.BandDown = 20;
  ShowPercentBands(f.canvas);
  EXPECT_EQ(f.Script(), (Lines{"L,78,160,82,150,41", "L,78,192,82,182,41"}));
}

TEST(PercentBandsTest, ChartThatStartsFurtherRightTakesThemAlong) {
  OverlayFixture f(Repeat(10, 11));
  f.chart.FirstBarX = 72;
  ShowPercentBands(f.canvas);
  EXPECT_EQ(f.Script(), (Lines{"L,108,379,112,379,41", "L,108,381,112,381,41"}));
}

TEST(PercentBandsTest, FewerClosesThanTenDrawNothing) {
  OverlayFixture none, nine(Repeat(10, 9)), ten(Repeat(10, 10));
  for (OverlayFixture* f : {&none, &nine, &ten}) {
    ShowPercentBands(f->canvas);
    EXPECT_TRUE(f->Script().empty());
  }
}

TEST(PercentBandsTest, ZeroCloseIsFilledInTheBarsForWhatFollows) {
  std::vector<float> closes = Repeat(10, 11);
  closes[5] = closes[6] = 0;
  OverlayFixture f(closes);
  ShowPercentBands(f.canvas);
  EXPECT_EQ(f.chart.Bars[5].Close, 10);
  EXPECT_EQ(f.chart.Bars[6].Close, 10);
  EXPECT_EQ(f.Script(), (Lines{"L,78,379,82,379,41", "L,78,381,82,381,41"}));
}

TEST(PercentBandsTest, ZeroInTheFirstBarStays) {
  std::vector<float> closes = Repeat(10, 11);
  closes[0] = 0;
  OverlayFixture f(closes);
  ShowPercentBands(f.canvas);
  EXPECT_EQ(f.chart.Bars[0].Close, 0);
  // Means 9 and 10: 9.45 and 10.5; 8.55 and 9.5.
  EXPECT_EQ(f.Script(), (Lines{"L,78,381,82,379,41", "L,78,383,82,381,41"}));
}

TEST(PercentBandsTest, BandAtZeroHasNoPlace) {
  OverlayFixture f(Repeat(10, 11));
  f.request.Name.BandUp = 10;
  f.request.Name.BandDown = 100;
  ShowPercentBands(f.canvas);
  EXPECT_EQ(f.Script(), (Lines{"L,78,378,82,378,41"}));
  OverlayFixture zeros(Repeat(0, 30));
  ShowPercentBands(zeros.canvas);
  EXPECT_TRUE(zeros.Script().empty());
}

TEST(PercentBandsTest, PricesWithoutAPlaceEndTheBandsQuietly) {
  std::vector<float> closes = Repeat(10, 11);
  closes.push_back(1e9f);
  closes.push_back(10);
  OverlayFixture f(closes);
  EXPECT_NO_THROW(ShowPercentBands(f.canvas));
  EXPECT_EQ(f.Script(), (Lines{"L,78,379,82,379,41", "L,78,381,82,381,41"}));
  OverlayFixture nan(Repeat(std::numeric_limits<float>::quiet_NaN(), 30));
  EXPECT_NO_THROW(ShowPercentBands(nan.canvas));
  EXPECT_NO_THROW(ShowBollinger(nan.canvas));
  EXPECT_TRUE(nan.Script().empty());
}

TEST(BollingerTest, TwoDeviationsAboutTheMeanAndTheFirstPointOneBarToTheLeft) {
  OverlayFixture f(Swinging());
  ShowBollinger(f.canvas);
  // Bars 20, 21 and 22 stand at 122, 126 and 130.
  EXPECT_EQ(f.Script(), (Lines{"L,118,372,126,372,41", "L,118,388,126,388,41",
                               "L,126,372,130,372,41", "L,126,388,130,388,41"}));
}

TEST(BollingerTest, TakesNoNoticeOfBollPeriodsAndBollWidth) {
  OverlayFixture plain(Swinging()), set(Swinging());
  set.request.Name.BollPeriods = 5;
  set.request.Name.BollWidth = 1;
  ShowBollinger(plain.canvas);
  ShowBollinger(set.canvas);
  EXPECT_EQ(set.Script(), plain.Script());
  EXPECT_EQ(set.Script().size(), 4u);
}

TEST(BollingerTest, FewerClosesThanTwentyOneDrawNothing) {
  OverlayFixture f(Repeat(10, 21));
  ShowBollinger(f.canvas);
  EXPECT_TRUE(f.Script().empty());
}

TEST(BollingerTest, ZeroCloseCountsAsTheOneBeforeAndStaysInTheBars) {
  std::vector<float> closes = Repeat(10, 22);
  closes[3] = 0;
  OverlayFixture f(closes);
  ShowBollinger(f.canvas);
  EXPECT_EQ(f.chart.Bars[3].Close, 0);
  EXPECT_EQ(f.Script(), (Lines{"L,118,380,126,380,41", "L,118,380,126,380,41"}));
}

TEST(MmaTest, SixAveragesInEachColour) {
  OverlayFixture f;
  f.chart.CloseY = {100, 200, 301};
  AddMMA(f.canvas, {2, 0, -1, 501, 4, 3, 1, 0, 0, 0, 0, 2});
  // 150 and 250.5; a period above the closes, and one with a single point, draw nothing.
  EXPECT_EQ(f.Script(), (Lines{"L,46,150,50,250,43", "L,42,100,46,200,44", "L,46,200,50,301,44",
                               "L,46,150,50,250,44"}));
}

TEST(MmaTest, ExponentialByTheRequest) {
  OverlayFixture f;
  f.chart.CloseY = {100, 200, 301};
  f.request.MaExp = true;
  AddMMA(f.canvas, {2});
  // Seed 150, then 301 * 2/3 + 150 / 3 = 250.67.
  EXPECT_EQ(f.Script(), (Lines{"L,46,150,50,251,43"}));
}

TEST(MmaTest, FiveHundredIsTheLongestThatIsDrawn) {
  OverlayFixture f;
  f.chart.CloseY.assign(700, 100);
  AddMMA(f.canvas, {501, 600, 32767});
  EXPECT_TRUE(f.Script().empty());
  AddMMA(f.canvas, {500});
  EXPECT_EQ(f.Script().size(), 200u);  // points of bars 499 to 699
}

TEST(PriceOverlaysTest, ComposerDrawsBandsThenAverages) {
  ComposerFixture f;
  f.Days("20240101", 30);
  f.request.BandKind = 1;
  f.services.overlays = PriceOverlays(true, {2, 0, 0, 0, 0, 0, 3});
  ASSERT_TRUE(f.Compose());
  const Lines script = f.Script();
  ASSERT_GT(script.size(), 95u);
  // 20 bars with two bands, 28 lines of the average of 2 and 27 of that of 3, at the very end.
  const size_t first = script.size() - 40 - 28 - 27;
  const auto colourOf = [&](size_t i) { return script[i].substr(script[i].rfind(',') + 1); };
  for (size_t i = first; i < script.size(); ++i) {
    EXPECT_EQ(script[i][0], 'L');
    EXPECT_EQ(colourOf(i), i < first + 40 ? "41" : i < first + 68 ? "43" : "44");
  }
  EXPECT_NE(colourOf(first - 1), "41");
}

// 8.8 to 11.4 on 384 units: 1483.4 for each 1 of ln. 9 stands at 429 - 33.34, down to 395, and 11
// at 429 - 331.02, down to 97; half-way is 246, where the mean of the prices, 10, stands at 239.
TEST(PriceOverlaysTest, AveragesOfALogarithmicChartAreThoseOfItsPlaces) {
  ComposerFixture f;
  f.Day("20240102", 10, 11, 9, 9);
  f.Day("20240103", 10, 11, 9, 11);
  f.Day("20240104", 10, 11, 9, 9);
  f.request.LogBars = true;
  f.request.Ma1On = true;
  f.request.Ma1Days = 2;
  f.services.overlays = PriceOverlays(true, {2});
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("L,44,246,46,246,20"));
  EXPECT_TRUE(f.Wrote("L,44,246,46,246,43"));
}

// The lower chart lacks 4 bars: it starts at 42 + 8. 230 to 429 has 199 units: 10 stands at
// 429 - 91.85.
TEST(PriceOverlaysTest, LowerOfTwoChartsDrawsThemWhereItsBarsStand) {
  ComposerFixture f;
  f.services.overlays = PriceOverlays(true, {3});
  f.request.Ma1On = true;
  f.request.Ma1Days = 2;
  f.request.Place = ChartPlace::kUpper;
  f.Days("20240101", 8);
  ASSERT_TRUE(f.Compose());
  f.days.resize(4);
  f.request.Place = ChartPlace::kLower;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("L,52,337,54,337,20"));
  EXPECT_TRUE(f.Wrote("L,54,337,56,337,20"));
  EXPECT_TRUE(f.Wrote("L,54,337,56,337,43"));
}

// Twelve closes at 10: 10.5 stands at 178, 9.5 at 326; the window fills with the tenth bar, at 60.
TEST(PriceOverlaysTest, BandsAndMultipleAveragesStayWhereTheTwoAveragesGoForAnOscillator) {
  for (const char* name : {"PARA", "MACD"}) {
    ComposerFixture f;
    f.request.OscName = name;
    f.request.BandKind = 1;
    f.request.Ma1On = f.request.Ma2On = true;
    f.request.Ma1Days = f.request.Ma2Days = 2;
    f.services.overlays = PriceOverlays(true, {11});
    f.Days("20240101", 12);
    ASSERT_TRUE(f.Compose());
    EXPECT_TRUE(f.Wrote("L,60,178,62,178,41")) << name;
    EXPECT_TRUE(f.Wrote("L,62,326,64,326,41")) << name;
    EXPECT_TRUE(f.Wrote("L,62,252,64,252,43")) << name;
    for (const std::string& line : f.Script())
      EXPECT_FALSE(line.ends_with(",20") || line.ends_with(",21")) << name << " " << line;
  }
}

TEST(PriceOverlaysTest, SuperimposedChartHasNone) {
  ComposerFixture f;
  f.request.BandKind = 1;
  f.request.Ma1On = f.request.Ma2On = true;
  f.request.Ma1Days = f.request.Ma2Days = 2;
  f.services.overlays = PriceOverlays(true, {2});
  f.request.Place = ChartPlace::kUnder;
  f.Days("20240101", 30);
  ASSERT_TRUE(f.Compose());
  for (const std::string& line : f.Script())
    for (const char* entry : {",19", ",20", ",41", ",43"})
      EXPECT_FALSE(line.ends_with(entry)) << line;
}

TEST(PriceOverlaysTest, NoBandsUnlessAskedFor) {
  ComposerFixture f;
  f.Days("20240101", 30);
  ASSERT_TRUE(f.Compose());
  const Lines plain = f.Script();
  f.services.overlays = PriceOverlays(false, kDefaultMMASet);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Script(), plain);
}

TEST(ReversalLegendTest, FiveMarksInTheirColours) {
  OverlayFixture f;
  RecordingSurface legend(kLegendWidth, kLegendHeight);
  DrawReversalLegend(legend, f.fonts, f.colours);
  EXPECT_EQ(legend.ops, (Lines{"cls", "box 0,0,112,70 16", "text 8.25 2,1  Reversal 27",
                               "line solid 105,3,105,12 29", "text 8.25 2,15  Key Reversal 27",
                               "line solid 105,17,105,26 30", "text 8.25 2,29  Hook Reversal 27",
                               "line solid 105,31,105,40 31", "text 8.25 2,43  Open-Close Rev. 27",
                               "line solid 105,45,105,54 32", "text 8.25 2,57  Pivot Point 27",
                               "line solid 105,59,105,68 33"}));
}

TEST(MmaBoxesTest, BlankIsZeroAndTheRangeEndsAtSixHundred) {
  std::array<std::string, 12> boxes{"3",    "",  "600", " 10 ", "0", "abc",
                                    "12.5", "7", "",    "",     "",  ""};
  size_t refused = 99;
  EXPECT_EQ(ReadMMABoxes(boxes, refused), (MmaPeriods{3, 0, 600, 10, 0, 0, 12, 7, 0, 0, 0, 0}));
  EXPECT_EQ(refused, 99u);
  for (const char* bad : {"-1", "601", "600.1", "99999999999999999999"}) {
    boxes[4] = bad;
    EXPECT_EQ(ReadMMABoxes(boxes, refused), std::nullopt) << bad;
    EXPECT_EQ(refused, 4u);
  }
}

TEST(MmaBoxesTest, ListIsJoinedWithCommas) {
  EXPECT_EQ(MMASetText(kDefaultMMASet), "3,5,8,10,12,15,30,35,40,45,50,60");
}

TEST(BandBoxesTest, BothMustBeFromZeroToAHundred) {
  const auto read = ReadBandBoxes("0", "100");
  ASSERT_TRUE(read);
  EXPECT_EQ(read->first, 0);
  EXPECT_EQ(read->second, 100);
  EXPECT_FALSE(ReadBandBoxes("101", "5"));
  EXPECT_FALSE(ReadBandBoxes("5", "-1"));
  EXPECT_FALSE(ReadBandBoxes("5", "100.5"));
}

TEST(StopLossBoxTest, NumbersFromZeroToAHundredAlone) {
  EXPECT_EQ(ReadStopLossPercent("0"), 0.0f);
  EXPECT_EQ(ReadStopLossPercent(" 7.5 "), 7.5f);
  EXPECT_EQ(ReadStopLossPercent("+100"), 100.0f);
  EXPECT_EQ(ReadStopLossPercent(".5"), 0.5f);
  for (const char* bad : {"", " ", "-1", "100.01", "abc", "5%", "1.2.3", ".", "5 5", "1e1"})
    EXPECT_FALSE(ReadStopLossPercent(bad)) << bad;
}
