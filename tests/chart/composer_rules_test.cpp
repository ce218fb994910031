#include <gtest/gtest.h>

#include "chart/chart_state.h"
#include "tests/chart/composer_fixture.h"

// Rules of composition that show in single lines of the script. The surface is 638 x 452: top
// 45, bottom 429, right 631; with volume the plot ends at 386 (0.9 * 429 = 386.1) and the panel
// lies from there to 429.

using namespace kora;
using kora::test::ComposerFixture;
using Lines = std::vector<std::string>;

namespace {

// Days from Monday 1 January 2024, each flat at 10 with a range of 9 to 11, with these volumes.
void SetVolumes(ComposerFixture& f, std::initializer_list<std::int32_t> volumes) {
  f.days.clear();
  f.Days("20240101", int(volumes.size()));
  size_t i = 0;
  for (const std::int32_t volume : volumes) f.days[i++].Volume = volume;
}

// The values of the volume panel, from the bottom up.
Lines PanelValues(const ComposerFixture& f) {
  Lines out;
  for (const std::string& line : f.Lines('S')) {
    const auto fields = Split(line, ',');
    for (const char* y : {"425", "414", "403", "392"})  // 4 above 429, 418, 407 and 396
      if (fields[3] == y && fields[4].find_first_not_of("0123456789") == std::string_view::npos)
        out.emplace_back(fields[4]);
  }
  return out;
}

}  // namespace

// ---- logarithmic volumes

// ln 1 is 0; 43 units for ln 10000. 100 lies half-way: 429 - 21.5 = 407.5, down to 407.
TEST(LogVolumeTest, VolumesStandByTheirLogarithmsFromTheLeastToTheLargest) {
  ComposerFixture f;
  f.request.LogBars = f.request.LogVolume = true;
  SetVolumes(f, {1, 100, 1000, 10000});
  ASSERT_TRUE(f.Compose());
  EXPECT_FLOAT_EQ(f.chart.Volume.VolLogBase, 0);
  EXPECT_TRUE(f.Wrote("H,42,429,42,429,22"));
  EXPECT_TRUE(f.Wrote("H,44,429,44,407,22"));
  EXPECT_TRUE(f.Wrote("H,46,429,46,396,22"));  // 429 - 32.25
  // Each 11 units up, e ^ (11 / 43 * 9.21034) = 10.55 times as much: 1, 10.55, 111.3, 1174.3.
  EXPECT_EQ(PanelValues(f), (Lines{"1", "11", "110", "1200"}));
}

// VolHeight and the factor of 3 of a line belong to the arithmetic panel.
TEST(LogVolumeTest, MultipleOfTheMeanHasNoPartInIt) {
  for (const Style style : {Style::kBar, Style::kCandlestick, Style::kLine}) {
    ComposerFixture f;
    f.request.ChartStyle = style;
    f.request.LogBars = f.request.LogLines = f.request.LogVolume = true;
    f.request.VolHeight = 3;
    SetVolumes(f, {1, 100, 1000, 10000});
    ASSERT_TRUE(f.Compose());
    EXPECT_TRUE(f.Wrote("H,44,429,44,407,22")) << TextOf(style);
    EXPECT_TRUE(f.Wrote("H,46,429,46,396,22")) << TextOf(style);
  }
}

// The base stays ln 100 = 4.605170 from the first chart. 43 units are then ln 1000, and
// 1000 is 429 - 14.33, 10000 is 429 - 28.67. With ln 1000 it would stand at 429, with 0 at 403.
TEST(LogVolumeTest, ArithmeticPricesKeepTheBaseOfTheChartBefore) {
  ComposerFixture f;
  f.request.LogBars = f.request.LogVolume = true;
  SetVolumes(f, {100, 1000, 10000});
  ASSERT_TRUE(f.Compose());
  EXPECT_FLOAT_EQ(f.chart.Volume.VolLogBase, 4.6051702f);
  f.request.LogBars = false;
  SetVolumes(f, {1000, 10000, 100000});
  ASSERT_TRUE(f.Compose());
  EXPECT_FLOAT_EQ(f.chart.Volume.VolLogBase, 4.6051702f);
  EXPECT_TRUE(f.Wrote("H,42,429,42,414,22"));
  EXPECT_TRUE(f.Wrote("H,44,429,44,400,22"));
  // The values are turned back from the least volume itself: 1000 * e ^ (11 / 43 * 6.907755) =
  // 5854, 34268 and 200597.
  EXPECT_EQ(PanelValues(f), (Lines{"1000", "5900", "34300", "200600"}));
  f.request.LogBars = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_FLOAT_EQ(f.chart.Volume.VolLogBase, 6.9077553f);  // ln 1000
}

// Lines have their own switch: LogBars makes no logarithmic line chart.
TEST(LogVolumeTest, LineTakesTheBaseWhereLinesAreLogarithmic) {
  ComposerFixture f;
  f.request.ChartStyle = Style::kLine;
  f.request.LogBars = f.request.LogVolume = true;
  SetVolumes(f, {100, 1000, 10000});
  ASSERT_TRUE(f.Compose());
  // Base 0: 100 is half-way to 10000.
  EXPECT_EQ(f.chart.Volume.VolLogBase, 0);
  EXPECT_TRUE(f.Wrote("H,42,429,42,407,22"));
  f.request.LogLines = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_FLOAT_EQ(f.chart.Volume.VolLogBase, 4.6051702f);
  // 43 units are ln 100: 1000 is half-way.
  EXPECT_TRUE(f.Wrote("H,44,429,44,407,22"));
}

// ---- the wide surface of the multi-oscillator view

// 2100 / 2 = 1050 records back from 2000. 1050 * 2 + 120.
TEST(MultiOscTest, PlotIs2100WideAndTheSurfaceHoldsItsRecordsAnd120More) {
  ComposerFixture f;
  f.request.Place = ChartPlace::kWide;
  f.Days("20180101", 2000);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.PlotWidth, 2100);
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 950);
  EXPECT_EQ(f.chart.Bars.BarCount, 1050);
  EXPECT_EQ(f.price.Width(), 2220);
  EXPECT_EQ(f.chart.LastBarX, 42 + 1051 * 2);
  // The frame was laid out before the surface grew.
  EXPECT_EQ(f.chart.ChartRight, 631);
}

TEST(MultiOscTest, BlankSpaceTakesNothingFromIt) {
  ComposerFixture f;
  f.request.Place = ChartPlace::kWide;
  f.request.BlankSpace = 300;
  f.Days("20180101", 2000);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.PlotWidth, 2100);
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 950);
  EXPECT_EQ(f.price.Width(), 2220);
}

TEST(MultiOscTest, FewRecordsMakeANarrowSurface) {
  ComposerFixture f;
  f.request.Place = ChartPlace::kWide;
  f.request.BarSpacing = 4;
  f.Days("20240101", 30);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 1);
  EXPECT_EQ(f.price.Width(), 29 * 4 + 120);
}

// The surface counts records, not bars: 2100 / 10 * 4.75 = 997.5, half to even 998.
TEST(MultiOscTest, WeeklyChartStillCountsRecords) {
  ComposerFixture f;
  f.request.Place = ChartPlace::kWide;
  f.request.ChartPeriod = Period::kWeekly;
  f.request.BarSpacing = 10;
  f.Days("20180101", 2000);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 1002);
  EXPECT_EQ(f.price.Width(), 998 * 10 + 120);
}

TEST(MultiOscTest, SurfaceOfANormalChartKeepsItsWidth) {
  ComposerFixture f;
  f.Days("20180101", 2000);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.PlotWidth, 589);
  EXPECT_EQ(f.price.Width(), 638);
}

// ---- the script in print mode

// 8.8 to 11.4 in steps of 0.2. In bold 8.25, 11 units, "8.80" is 1.946 * 11 = 21.4 wide and
// "10.00" 2.502 * 11 = 27.5: 21 and 28. 10 stands at 252.
TEST(ScriptPrintModeTest, TickLabelsStandWiderApartInTheScriptAlone) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("S,8.25,16,423,8.80,27"));  // 42 - 5 - 21, 429 - 6
  EXPECT_TRUE(f.Wrote("S,8.25,9,246,10.00,27"));
  f.request.ScriptPrintMode = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("S,8.25,1,417,8.80,27"));  // 42 - 20 - 21, 429 - 12
  EXPECT_TRUE(f.Wrote("S,8.25,-6,240,10.00,27"));
  EXPECT_FALSE(f.Wrote("S,8.25,16,423,8.80,27"));
  EXPECT_TRUE(f.price.Has("text 8.25 b 16,423 8.80 27"));
  EXPECT_TRUE(f.price.Has("text 8.25 b 9,246 10.00 27"));
  EXPECT_TRUE(f.Wrote("L,42,429,35,429,16"));  // the tick stays
}

// x = 42 + 5 * days since 15 November: December 16, January 47.
TEST(ScriptPrintModeTest, LettersOfTheMonthsTakeTheSizeOfFont2AndYearsDoNot) {
  ComposerFixture f;
  f.fonts.Font2Size = 9.75;
  f.request.BarSpacing = 5;
  f.Days("20231115", 60);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("T,8.25,122,431,D,27"));
  f.request.ScriptPrintMode = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("T,9.75,122,431,D,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,277,431,2024,27"));
  EXPECT_TRUE(f.price.Has("text 8.25 122,431 D 27"));
}

// ---- a scale from nothing

// High 0.08, Low 0.002, closer than 0.15: 0.084 * 1.2 = 0.1008, 0.101; 0.0019 * 0.9 = 0.00171,
// 0.002, no step of 0.005, so 0.001. Steps of 0.005 over 0.1 on 384 units, 0.000260417 a unit.
// Ticks stand at 0.005 and 0.01: 429 - 15.36 and 429 - 34.56 (0.006 would be 429 - 19.2). The
// half steps are counted from 0.001: 0.0035 and 0.0085, 429 - 9.6 and 429 - 28.8.
TEST(ScaleFromNothingTest, TicksAreMultiplesOfTheStepAndHalfStepsCountFromTheBottom) {
  ComposerFixture f;
  f.request.GridLines = f.request.HalfGrid = true;
  f.request.MovingGrid = false;
  f.Day("20240315", 0.05f, 0.08f, 0.002f, 0.05f);
  ASSERT_TRUE(f.Compose());
  EXPECT_FLOAT_EQ(f.chart.Scale.ScaleLow, 0.001f);
  EXPECT_FLOAT_EQ(f.chart.Scale.GridStep, 0.005f);
  EXPECT_TRUE(f.Wrote("L,42,429,35,429,16"));
  EXPECT_TRUE(f.Wrote("L,42,414,35,414,16"));
  EXPECT_TRUE(f.Wrote("L,42,394,35,394,16"));
  const Lines grid = f.Lines('V');
  ASSERT_GE(grid.size(), 4u);
  EXPECT_EQ(grid[0], "V,42,414,631,414,35");
  EXPECT_EQ(grid[1], "V,42,419,631,419,35");
  EXPECT_EQ(grid[2], "V,42,394,631,394,35");
  EXPECT_EQ(grid[3], "V,42,400,631,400,35");
  // The bottom keeps its own value; 20 steps thin from the seventh on.
  std::string labels;
  for (const std::string& line : f.Lines('S'))
    if (const auto fields = Split(line, ','); fields[4].starts_with('.'))
      labels += std::string(fields[4]) + " ";
  EXPECT_EQ(labels.substr(0, 25), ".001 .005 .01 .015 .02 .0");
}

// ---- the lower of two charts

// Upper: top 2, bottom 207; with volume 186 (186.3). P = round(207 - 186 * 1.03) = 15, 3000 / 15
// = 200 a unit, so 3000 stands at 207 - 10. 2.6 on 184 units: y(11) = 186 - 155.69, y(9) =
// 186 - 14.15.
// Lower: top 230, bottom 429; with volume 386. P = 31, 96.774 a unit, so 6000 stands at
// 429 - 51.67, above the panel. 2.6 on 156 units: y(11) = 386 - 132, y(9) = 386 - 12.
TEST(TwoChartsVolumeTest, EachHalfHasItsVolumePanelAndALongerLowerChartStartsAtTheLeft) {
  ComposerFixture f;
  f.request.VolHeight = 2;
  SetVolumes(f, {1000, 3000});
  f.request.Place = ChartPlace::kUpper;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.UpperBarCount, 1);
  EXPECT_TRUE(f.Wrote("B,42,186,631,207,16"));
  EXPECT_TRUE(f.Wrote("B,42,2,631,186,16"));
  EXPECT_TRUE(f.Wrote("H,44,207,44,197,22"));
  EXPECT_TRUE(f.Wrote("H,42,30,42,172,18"));
  EXPECT_TRUE(f.Wrote("L,42,207,42,212,27"));  // the date tick hangs from the panel

  SetVolumes(f, {1000, 1000, 1000, 1000, 6000});
  f.request.Place = ChartPlace::kLower;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.FirstBarX, 42);
  EXPECT_EQ(f.chart.LastBarX, 42 + 5 * 2);
  EXPECT_EQ(f.chart.UpperBarCount, 1);
  EXPECT_EQ(f.chart.VolTop, 386);
  EXPECT_EQ(f.chart.VolBottom, 429);
  EXPECT_TRUE(f.Wrote("B,42,386,631,429,16"));
  EXPECT_TRUE(f.Wrote("B,42,230,631,386,16"));
  EXPECT_TRUE(f.Wrote("H,50,429,50,377,22"));
  EXPECT_TRUE(f.Wrote("H,42,254,42,374,18"));
  EXPECT_TRUE(f.Wrote("L,42,429,42,434,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,380,250,Closing Price : 10.00  (10.00),27"));
  EXPECT_TRUE(f.Wrote("Z,7,601,220,KORA,27"));
  EXPECT_EQ(f.script.text().find("ARITHMETIC"), std::string::npos);  // single charts alone
}

// The first starts at the left whatever came before; the second moves by the bars it lacks and
// stays where it has more.
TEST(SuperimposedTest, SecondIsAlignedAndNeitherHasAVolumePanel) {
  ComposerFixture f;
  const auto compose = [&f](ChartPlace place, int days) {
    f.days.clear();
    f.Days("20240101", days, 500);
    f.request.Place = place;
    return f.Compose();
  };
  ASSERT_TRUE(compose(ChartPlace::kUnder, 5));
  EXPECT_EQ(f.chart.UpperBarCount, 4);
  EXPECT_EQ(f.chart.ChartBottom, 429);
  EXPECT_FALSE(f.chart.Bars.VolumeShown);
  ASSERT_TRUE(compose(ChartPlace::kOver, 2));
  EXPECT_EQ(f.chart.FirstBarX, 42 + 3 * 2);
  EXPECT_EQ(f.chart.UpperBarCount, 4);
  ASSERT_TRUE(compose(ChartPlace::kOver, 9));
  EXPECT_EQ(f.chart.FirstBarX, 42);
  ASSERT_TRUE(compose(ChartPlace::kUnder, 2));
  EXPECT_EQ(f.chart.FirstBarX, 42);
  EXPECT_EQ(f.chart.UpperBarCount, 1);
  for (const std::string& line : f.Lines('H')) EXPECT_FALSE(line.ends_with(",22")) << line;
}

// ---- the oscillator on show

// Twelve closes at 252, 3 apart: smoothing points at the eleventh and twelfth, an average of
// eleven from the one to the other.
TEST(OscNameTest, DecidesOverSmoothingAndAverages) {
  struct Row {
    Style style;
    const char* name;
    bool smoothing, averages;
  };
  for (const Row& row :
       {Row{Style::kBar, "", true, true}, Row{Style::kCandlestick, "", true, true},
        Row{Style::kLine, "", true, true}, Row{Style::kBar, "RSI", true, true},
        Row{Style::kBar, "PARA", false, false}, Row{Style::kCandlestick, "PARA", false, false},
        Row{Style::kLine, "PARA", true, false}, Row{Style::kBar, "PARAV", false, true},
        Row{Style::kCandlestick, "PARAV", false, true}, Row{Style::kLine, "PARAV", true, true},
        Row{Style::kBar, "MACD", false, false}, Row{Style::kCandlestick, "MACD", false, false},
        Row{Style::kLine, "MACD", false, false}}) {
    ComposerFixture f;
    f.request.ChartStyle = row.style;
    f.request.OscName = row.name;
    f.request.BarSpacing = 3;  // so that opens and closes are no points
    f.request.Ma1On = f.request.Ma2On = true;
    f.request.Ma1Days = f.request.Ma2Days = 11;
    f.Days("20240101", 12);
    ASSERT_TRUE(f.Compose());
    EXPECT_EQ(f.Lines('P'), row.smoothing ? (Lines{"P,72,252,19", "P,75,252,19"}) : Lines{})
        << TextOf(row.style) << row.name;
    EXPECT_EQ(f.Wrote("L,72,252,75,252,20"), row.averages) << TextOf(row.style) << row.name;
    EXPECT_EQ(f.Wrote("H,72,252,75,252,21"), row.averages) << TextOf(row.style) << row.name;
  }
}

TEST(OscNameTest, SmoothingNeedsOneOfTheAveragesOn) {
  ComposerFixture f;
  f.request.BarSpacing = 3;
  f.Days("20240101", 12);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Lines('P').empty());
  f.request.Ma2On = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Lines('P').size(), 2u);
}

// ---- places that 16 bits don't hold

// 384 units for 0.05: 90 would stand 614,400 units above 10.
TEST(PixelOverflowTest, EndsTheScriptWithTheBarBeforeInEveryStyle) {
  for (const Style style : {Style::kBar, Style::kCandlestick, Style::kLine}) {
    ComposerFixture f;
    f.request.ChartStyle = style;
    f.request.AutoScale = false;
    f.request.Name.Base = 10;
    f.request.Name.Top = 10.05f;
    f.Day("20240314", 10, 10, 10, 10);
    f.Day("20240315", 10, 10, 10, 10);
    f.Day("20240318", 90, 90, 90, 90);
    f.Day("20240319", 10, 10, 10, 10);
    EXPECT_FALSE(f.Compose());
    ASSERT_EQ(f.dialogs.said.size(), 1u) << TextOf(style);
    EXPECT_EQ(f.dialogs.said[0].title, "Chart Display");
    EXPECT_EQ(f.dialogs.said[0].text,
              "There is a problem with the data for TEST.WDT\n at date (20240318) "
              "\nUse View/Modify Data procedure to correct.")
        << TextOf(style);
    EXPECT_FALSE(f.chart.ChartDrawn);
    EXPECT_FALSE(f.script.IsOpen());
    const Lines bars = f.Lines('H');
    ASSERT_FALSE(bars.empty()) << TextOf(style);
    EXPECT_EQ(bars.back(), style == Style::kLine ? "H,42,429,44,429,18" : "H,44,429,44,429,18");
    EXPECT_EQ(f.script.text().find(",46,"), std::string::npos) << TextOf(style);
    EXPECT_TRUE(f.Lines('Z').empty()) << TextOf(style);  // nothing that follows the bars
    EXPECT_FALSE(f.Wrote("B,42,45,631,429,16")) << TextOf(style);

    // The next chart is none the worse.
    f.request.AutoScale = true;
    f.days.resize(2);
    ASSERT_TRUE(f.Compose());
    ComposerFixture fresh;
    fresh.request.ChartStyle = style;
    fresh.days = f.days;
    ASSERT_TRUE(fresh.Compose());
    EXPECT_EQ(f.script.text(), fresh.script.text()) << TextOf(style);
  }
}

// 2000 bars: mean (1999 + 2000000) / 2000 = 1001, 1000 / 31 a unit; the last volume would stand
// 62,000 units up.
TEST(PixelOverflowTest, VolumeFarAboveTheMeanIsToldUnlessVolumesAreCut) {
  for (const Style style : {Style::kBar, Style::kCandlestick}) {
    ComposerFixture f;
    f.request.ChartStyle = style;
    f.request.Place = ChartPlace::kWide;  // the one surface that holds so many bars
    f.request.BarSpacing = 1;
    f.Days("20180101", 2000, 1);
    f.days.back().Volume = 2000000;
    EXPECT_FALSE(f.Compose());
    ASSERT_EQ(f.dialogs.said.size(), 1u);
    // 1999 days after 1 January 2018: 2018 to 2022 are 1826, and 173 days on from 1 January
    // 2023 is 23 June.
    EXPECT_NE(f.dialogs.said[0].text.find(" at date (20230623) "), std::string::npos);
    f.request.CutVols = true;
    ASSERT_TRUE(f.Compose());
    EXPECT_TRUE(f.Wrote("H,2041,429,2041,386,22"));
  }
}

// A picture one unit high has its top where its bottom is; one of 5 has 4 units for a plot and
// none for the panel: round(4 - 4 * 1.03).
TEST(PixelOverflowTest, PictureTooLowForAScaleIsToldInEveryStyle) {
  for (const Style style : {Style::kBar, Style::kCandlestick, Style::kLine}) {
    for (const int height : {1, 5}) {
      ComposerFixture f;
      test::RecordingSurface low(638, height);
      f.request.ChartStyle = style;
      SetVolumes(f, {1000, 3000});
      f.Save();
      ChartServices services{f.home.files(), f.dialogs, f.paths, f.fonts, f.colours, low,
                             nullptr,        &f.script, {}};
      EXPECT_FALSE(ComposeChart(services, f.request, f.chart));
      ASSERT_EQ(f.dialogs.said.size(), 1u) << TextOf(style) << height;
      EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 11\nDivision by zero");
      EXPECT_FALSE(f.script.IsOpen());
      EXPECT_TRUE(f.Lines('H').empty()) << TextOf(style) << height;
    }
  }
}

// 99 percent of 40 lies left of the plot: no bar is asked for, and the last one is there.
TEST(PixelOverflowTest, PictureNarrowerThanItsScaleShowsTheLastBar) {
  for (const Style style : {Style::kBar, Style::kCandlestick, Style::kLine}) {
    ComposerFixture f;
    test::RecordingSurface narrow(40, 452);
    f.request.ChartStyle = style;
    f.Days("20240101", 30);
    f.Save();
    ChartServices services{f.home.files(), f.dialogs, f.paths,   f.fonts, f.colours,
                           narrow,         nullptr,   &f.script, {}};
    ASSERT_TRUE(ComposeChart(services, f.request, f.chart));
    EXPECT_EQ(f.chart.Bars.FirstDataRec, 30);
    EXPECT_EQ(f.chart.Bars.BarCount, 0);
    EXPECT_EQ(f.chart.CloseY, std::vector<std::int16_t>{252});
  }
}

// ---- the stop loss

namespace {

// The settings' StopLoss, and the middle one of three days an outside bar: stop 9 * 0.95 = 8.55.
struct StopFixture : ComposerFixture {
  Settings settings;
  ChartState state;
  StopFixture() {
    settings.charts.StopLoss = true;
    settings.charts.StopLossPct = 5;
    Day("20240313", 10, 10.5f, 9.5f, 10);
    Day("20240314", 10, 11, 9, 10);
    Day("20240315", 10, 10.5f, 9.5f, 10);
  }
  bool ComposeAsSet() {
    request = MakeRequest(state, settings, request.Name);
    return Compose();
  }
  bool ToldOfStop() const { return script.text().find("Stop Loss") != std::string::npos; }
};

}  // namespace

TEST(StopLossChartTest, WithoutTheOutsideMarksThereIsNeitherMarkNorStop) {
  StopFixture f;
  ASSERT_TRUE(f.ComposeAsSet());
  EXPECT_TRUE(f.Wrote("H,44,104,44,399,18"));
  EXPECT_FALSE(f.ToldOfStop());
  for (const std::string& line : f.Lines('L')) EXPECT_FALSE(line.ends_with(",10")) << line;
}

// 429 + (8.8 - 8.55) / 0.0067708 = 465.92.
TEST(StopLossChartTest, WithTheOutsideMarksItRunsFromItsBarToTheRight) {
  StopFixture f;
  f.state.OutsideDaysOn = true;
  ASSERT_TRUE(f.ComposeAsSet());
  EXPECT_TRUE(f.Wrote("H,44,104,44,399,28"));
  EXPECT_TRUE(f.Wrote("H,42,178,42,326,18"));  // y(10.5), y(9.5) = 429 - 103.38
  EXPECT_TRUE(f.Wrote("L,44,466,631,466,10"));
  EXPECT_TRUE(f.ToldOfStop());
}

TEST(StopLossChartTest, OutsideMarksAloneMarkTheBarAndSetNoStop) {
  StopFixture f;
  f.state.OutsideDaysOn = true;
  f.settings.charts.StopLoss = false;
  ASSERT_TRUE(f.ComposeAsSet());
  EXPECT_TRUE(f.Wrote("H,44,104,44,399,28"));
  EXPECT_FALSE(f.ToldOfStop());
}

TEST(StopLossChartTest, PercentOutside1To100SetsNone) {
  for (const double percent : {0.0, 0.9, 100.5}) {
    StopFixture f;
    f.state.OutsideDaysOn = true;
    f.settings.charts.StopLossPct = float(percent);
    ASSERT_TRUE(f.ComposeAsSet());
    EXPECT_TRUE(f.Wrote("H,44,104,44,399,28")) << percent;
    EXPECT_FALSE(f.ToldOfStop()) << percent;
  }
}

TEST(StopLossChartTest, BarsAloneHaveIt) {
  for (const Style style : {Style::kCandlestick, Style::kLine}) {
    StopFixture f;
    f.state.OutsideDaysOn = true;
    f.state.ChartStyle = style;
    ASSERT_TRUE(f.ComposeAsSet());
    EXPECT_FALSE(f.ToldOfStop()) << TextOf(style);
    for (const std::string& line : f.Lines('H')) EXPECT_TRUE(line.ends_with(",18")) << line;
  }
}

// ---- the letters of the two averages

// Closes at 252, 178, 252, 178. Of two: 215 throughout. Of three: 227 (227.33) and 203 (202.67).
TEST(AverageLettersTest, FirstIsWrittenAsAThinLineAndTheSecondAtThePrintWeight) {
  ComposerFixture f;
  for (const char* date : {"20240102", "20240104"}) {
    f.Day(date, 10, 11, 9, 10);
    f.Day(std::string(date, 7) + char(date[7] + 1), 10, 11, 9, 10.5f);
  }
  f.request.Ma1On = f.request.Ma2On = true;
  f.request.Ma1Days = 2;
  f.request.Ma2Days = 3;
  const auto averages = [&f] {
    Lines out;
    for (const std::string& line : f.Script())
      if (line.ends_with(",20") || line.ends_with(",21")) out.push_back(line);
    return out;
  };
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(averages(), (Lines{"L,44,215,46,215,20", "L,46,215,48,215,20", "H,46,227,48,203,21"}));
  // Of two, k = 2/3: 215, 239.67 -> 240, 198.67 -> 199. Of three, k = 1/2: 227, 202.5 -> 202.
  f.request.MaExp = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(averages(), (Lines{"L,44,215,46,240,20", "L,46,240,48,199,20", "H,46,227,48,202,21"}));
}

TEST(AverageLettersTest, SecondAloneKeepsItsLetter) {
  ComposerFixture f;
  f.Days("20240101", 4);
  f.request.Ma2On = true;
  f.request.Ma2Days = 3;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("H,46,252,48,252,21"));
  for (const std::string& line : f.Lines('L')) EXPECT_FALSE(line.ends_with(",20")) << line;
}
