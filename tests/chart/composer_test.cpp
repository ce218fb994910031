#include "chart/composer.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "base/runtime_error.h"
#include "tests/chart/composer_fixture.h"

using namespace kora;
using kora::test::ComposerFixture;
using Lines = std::vector<std::string>;

// 638 x 452 without volume or panel: top 45 (45.2), bottom 429 (429.4), right 631 (631.62).
// High 11, Low 9: the scale runs from 8.8 to 11.4, 384 units, 0.0067708 a unit. So
// y(11) = 429 - 324.92, y(9) = 429 - 29.54, y(10) = 429 - 177.23, y(10.5) = 429 - 251.08.

TEST(ComposerTest, OneRecordDrawsItsBarAndShowsItselfInTheBrackets) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10.5f);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.BarCount, 0);
  EXPECT_TRUE(f.Wrote("H,42,104,42,399,18"));
  EXPECT_EQ(f.Lines('P'), (Lines{"P,41,252,18", "P,43,178,18"}));
  EXPECT_TRUE(f.Wrote("T,8.25,380,2,Last date processed 15-03-24,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,380,20,Closing Price : 10.50  (10.50),27"));
  EXPECT_EQ(f.chart.CloseY, std::vector<std::int16_t>{178});
  EXPECT_FLOAT_EQ(f.chart.LastClose, 10.5f);
  EXPECT_TRUE(f.chart.ChartDrawn);
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(ComposerTest, OrderOfThePartsOfAChart) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10.5f, 500);
  f.Day("20240318", 10, 11, 9, 10.5f, 900);
  f.request.GridLines = true;
  f.request.MovingGrid = false;
  f.request.GridSpace = 100;
  f.request.Ma1On = true;
  f.request.Ma1Days = 1;
  ASSERT_TRUE(f.Compose());
  // With volume the plot ends at 386: 0.0076246 a unit, y(10.5) = 386 - 222.96.
  // The first line of each kind, in the order in which they must come.
  const Lines order = {"T,8,20,2,TEST    Test Holdings,26",     // title
                       "L,42,429,42,434,27",                    // date tick at the first bar
                       "H,42,429,42,",                          // volume bar
                       "B,42,386,631,429,16",                   // volume panel
                       "B,42,45,631,386,16",                    // frame of the scale
                       "S,8.25,44,33,DAILY - ARITHMETIC -,27",  // mode line
                       "V,242,45,242,386,35",                   // fixed grid, 100 bars on
                       "T,8.25,380,2,Last date",                // end texts
                       "T,8.25,380,20,Closing",
                       "Z,7,601,35,KORA,27",   // stamp
                       "L,42,163,44,163,20"};  // first average
  const Lines script = f.Script();
  size_t at = 0;
  for (const std::string& want : order) {
    while (at < script.size() && script[at].rfind(want, 0) != 0) ++at;
    EXPECT_LT(at, script.size()) << "not found in order: " << want;
  }
}

TEST(ComposerTest, FewerRecordsThanWantedStartAtTheFirst) {
  ComposerFixture f;
  f.Days("20240101", 20);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 1);
  EXPECT_EQ(f.chart.Bars.BarCount, 19);
  EXPECT_EQ(f.chart.LastBarX, 42 + 20 * 2);
}

TEST(ComposerTest, WantedRecordsFillThePlot) {
  ComposerFixture f;
  f.Days("20200101", 1000);
  // Plot width 631 - 42 - 9 = 580: 290 records back from the last, 291 bars.
  f.request.BlankSpace = 9;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 710);
  EXPECT_EQ(f.chart.Bars.BarCount, 290);
  EXPECT_EQ(f.chart.LastBarX, 42 + 291 * 2);
  // Weekly: 290 * 4.75 = 1377.5, more than there are.
  f.request.ChartPeriod = Period::kWeekly;
  f.request.BarSpacing = 10;
  // 58 * 4.75 = 275.5, half to even 276.
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 724);
  f.request.ChartPeriod = Period::kMonthly;
  f.request.BarSpacing = 20;
  // 29 * 20 = 580.
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 420);
}

TEST(ComposerTest, WeekFactorOf6ChartsWith475AndOneOf525AsItIs) {
  ComposerFixture f;
  f.Days("20200101", 1000);
  f.request.ChartPeriod = Period::kWeekly;
  f.request.BarSpacing = 10;
  f.request.BlankSpace = 9;
  f.request.WeekFactor = 6;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 724);
  f.request.WeekFactor = 5.25;  // 58 * 5.25 = 304.5, half to even 304
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 696);
}

TEST(ComposerTest, SpacingOf0Becomes2) {
  ComposerFixture f;
  f.Days("20200101", 1000);
  f.request.BarSpacing = 0;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.BarSpacing, 2);
}

TEST(ComposerTest, FinishDateEndsTheChartAtTheFirstDateNotBeforeIt) {
  ComposerFixture f;
  f.Day("20240102", 10, 11, 9, 10);
  f.Day("20240104", 10, 11, 9, 10);
  f.Day("20240105", 10, 11, 9, 10);
  f.request.FinishDateOn = true;
  f.request.FinishDate = "20240103";
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.LastDataRec, 2);
  f.request.FinishDate = "20991231";  // none: the file's end
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.LastDataRec, 3);
}

TEST(ComposerTest, SpacingAbove2DrawsOpenAndCloseAsTicks) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10.5f);
  f.request.BarSpacing = 3;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Lines('H'),
            (Lines{"H,42,104,42,399,18", "H,40.5,252,42,252,18", "H,42,178,43.5,178,18"}));
  EXPECT_TRUE(f.Lines('P').empty());
}

TEST(ComposerTest, FallingCandleIsFilledAndARisingOneAnOutlineInTheScriptAlone) {
  ComposerFixture f;
  f.Day("20240314", 10.5f, 11, 9, 10);
  f.Day("20240315", 10, 11, 9, 10.5f);
  f.request.ChartStyle = Style::kCandlestick;
  f.request.BarSpacing = 4;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Lines('C'), Lines{"C,40.5,178,43.5,252,28"});
  EXPECT_TRUE(f.Wrote("B,44.5,252,47.5,178,18"));
  EXPECT_TRUE(f.price.Has("fill 41,178,43,252 28"));
  EXPECT_TRUE(f.price.Has("fill 45,252,47,178 18"));
  EXPECT_EQ(f.Lines('H'), (Lines{"H,42,104,42,399,18", "H,46,104,46,399,18"}));
}

TEST(ComposerTest, BarWithHigh0LeavesAGapAndRepeatsTheCloseForOverlays) {
  ComposerFixture f;
  f.request.Name.RecType = kShare;
  f.Day("20240313", 10, 11, 9, 10.5f);
  f.Day("20240314", 0, 0, 0, 0);  // bar 1 is not above FirstDataRec: copied as it stands
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.CloseY, (std::vector<std::int16_t>{178, 178, 252}));
  EXPECT_EQ(f.Lines('H'), (Lines{"H,42,104,42,399,18", "H,46,104,46,399,18"}));
}

TEST(ComposerTest, LineChartPassesOverAZeroCloseAndGoesOnFromItsPlace) {
  ComposerFixture f;
  f.request.Name.RecType = kCloseOnly;
  f.Day("20240313", 9, 9, 9, 9);
  f.Day("20240314", 0, 0, 0, 0);
  f.Day("20240315", 11, 11, 11, 11);
  f.Day("20240318", 9, 9, 9, 9);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Lines('H'), (Lines{"H,44,399,46,104,18", "H,46,104,48,399,18"}));
  EXPECT_EQ(f.chart.CloseY, (std::vector<std::int16_t>{399, 399, 104, 399}));
}

TEST(ComposerTest, DataWithNoBarsIsALineWhateverTheStyle) {
  ComposerFixture f;
  f.request.Name.RecType = kAdvanceDecline;
  f.Day("20240313", 0, 500, 300, 9);
  f.Day("20240314", 0, 400, 300, 11);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Lines('H'), Lines{"H,42,399,44,104,18"});
}

TEST(ComposerTest, VolumeTakesATenthOfTheHeightAndScalesByAMultipleOfTheMean) {
  ComposerFixture f;
  f.Day("20240314", 10, 11, 9, 10, 1000);
  f.Day("20240315", 10, 11, 9, 10, 3000);
  f.request.VolHeight = 2;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.VolBottom, 429);
  EXPECT_EQ(f.chart.ChartBottom, 386);  // 386.1
  EXPECT_EQ(f.chart.VolTop, 386);
  // Mean 2000 * 2 = 4000 at the top of round(429 - 386 * 1.03) = 31 units: 3000 / 31 = 96.774.
  // 3000: 429 - 2000 / 96.774 = 408.33.
  EXPECT_TRUE(f.Wrote("H,42,429,42,429,22"));
  EXPECT_TRUE(f.Wrote("H,44,429,44,408,22"));
  // D = round(43 / 4) = 11. Volumes back from y: 1000, 2064.5, 3129, 4193.5, to the hundred.
  const Lines s = f.Lines('S');
  ASSERT_GE(s.size(), 7u);
  EXPECT_EQ(s[0].substr(s[0].rfind("425")), "425,1000,27");
  EXPECT_EQ(s[2].substr(s[2].rfind("414")), "414,2100,27");
  EXPECT_EQ(s[4].substr(s[4].rfind("403")), "403,3100,27");
  EXPECT_EQ(s[6].substr(s[6].rfind("392")), "392,4200,27");
  // "L": 556 / 1000 * 10.67 = 5.93, 6 wide, centred on 14.
  EXPECT_EQ(s[1], "S,8,11,414,L,27");
  EXPECT_EQ(s[3].substr(0, 4), "S,8,");
  EXPECT_NE(s[3].find(",O,27"), std::string::npos);
  EXPECT_NE(s[5].find(",V,27"), std::string::npos);
}

TEST(ComposerTest, VolumeUnitComesFromAboveAndStandsUnderTheLetters) {
  ComposerFixture f;
  f.Days("19990101", 30, 500);
  f.services.VolumeUnitText = [](const NameRec& name) {
    return name.Code.trimmed() == "TEST" ? "'000" : "";
  };
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.VolLabel, "'000");
  bool shown = false;
  for (const std::string& op : f.price.ops) shown |= op.find(" '000 ") != std::string::npos;
  EXPECT_TRUE(shown);
  f.services.VolumeUnitText = {};
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.VolLabel, "");
}

TEST(ComposerTest, VolumeUnitIsNotAskedForWithoutVolumes) {
  ComposerFixture f;
  f.Days("19990101", 30);
  bool asked = false;
  f.services.VolumeUnitText = [&asked](const NameRec&) {
    asked = true;
    return std::string("'000");
  };
  ASSERT_TRUE(f.Compose());
  EXPECT_FALSE(asked);
}

TEST(ComposerTest, HighVolumesRunIntoThePriceAreaUnlessTheyAreCut) {
  ComposerFixture f;
  f.Days("20240101", 10, 1000);
  f.days.back().Volume = 20000;
  // Mean 2900, 1900 / 31 = 61.29 a unit; 19000 / 61.29 = 310 units: y 119.
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("H,60,429,60,119,22"));
  f.request.CutVols = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("H,60,429,60,386,22"));
}

TEST(ComposerTest, MeanNoLargerThanTheLeastVolumeScalesByTheLargest) {
  ComposerFixture f;
  f.Days("20240101", 10, 1000);
  f.days.back().Volume = 1001;  // the mean rounds to 1000
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.dialogs.said.empty());
  EXPECT_TRUE(f.Wrote("H,60,429,60,398,22"));  // 31 units up
}

TEST(ComposerTest, AdjustmentIsADashedLineOnTheScreenADottedOneInTheScriptAndItsText) {
  ComposerFixture f;
  f.Day("20240314", 10, 11, 9, 10);
  PriceRec& day = f.Day("20240315", 10, 11, 9, 10);
  day.AdjFactor = 0.5f;
  day.AdjDesc.set("1:2 SPLIT");
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("V,44,45,44,429,24"));
  EXPECT_TRUE(f.Wrote("T,8.25,44,47,1:2 SPLIT,24"));
  EXPECT_TRUE(f.price.Has("line dash 44,45,44,429 24"));
}

TEST(ComposerTest, OutsideBarSetsAStopThatShowsOnTheLastBar) {
  ComposerFixture f;
  f.request.OutsideMarks = true;
  f.request.StopLossShown = true;
  f.request.StopLossPct = 5;
  f.Day("20240313", 10, 10.5f, 9.5f, 10);
  f.Day("20240314", 10, 11, 9, 10);  // outside: stop 8.55
  f.Day("20240315", 10, 10.5f, 9.5f, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("H,44,104,44,399,28"));
  // 429 + (8.8 - 8.55) / 0.0067708 = 465.92
  EXPECT_TRUE(f.Wrote("L,44,466,631,466,10"));
  const Lines t = f.Lines('T');
  bool found = false;
  for (const std::string& line : t)
    found = found || line.find(",30,Current Stop Loss : 8.55,10") != std::string::npos;
  EXPECT_TRUE(found);
}

TEST(ComposerTest, BarWithHigh0TakesNoPartInOutsideBars) {
  ComposerFixture f;
  f.request.OutsideMarks = true;
  f.Day("20240312", 10, 10.5f, 9.5f, 10);
  f.Day("20240313", 0, 0, 0, 0);
  f.Day("20240314", 10, 11, 9, 10);  // outside the bar before the hole
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("H,46,104,46,399,28"));
}

TEST(ComposerTest, BrokenStopIsToldOnlyWhereTheLastBarBreaksIt) {
  ComposerFixture f;
  f.request.OutsideMarks = true;
  f.request.StopLossShown = true;
  f.request.StopLossPct = 1;
  f.Day("20240313", 10, 10.5f, 9.5f, 10);
  f.Day("20240314", 10, 11, 9.2f, 10);      // stop 9.108
  f.Day("20240315", 9.5f, 9.5f, 9, 9.05f);  // breaks it
  ASSERT_TRUE(f.Compose());
  EXPECT_NE(f.script.text().find("PREVIOUS STOP BROKEN,13"), std::string::npos);
  EXPECT_TRUE(f.Wrote("H,46,326,46,399,11"));  // y(9.5) = 429 - 103.38
  f.Day("20240318", 9.5f, 9.5f, 9.1f, 9.2f);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.script.text().find("PREVIOUS STOP BROKEN"), std::string::npos);
}

TEST(ComposerTest, SmoothingStartsWithTheEleventhClose) {
  ComposerFixture f;
  f.Days("20240101", 12);
  f.request.Ma1On = true;
  f.request.Ma1Days = 200;
  f.request.BarSpacing = 3;  // so that opens and closes are no points
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Lines('P'), (Lines{"P,72,252,19", "P,75,252,19"}));
  f.request.OscName = "PARA";
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Lines('P').empty());
}

TEST(ComposerTest, SecondAverageIsWrittenAtThePrintWeightAndWeeklyChartsTakeTheWeeklyPeriods) {
  ComposerFixture f;
  f.Days("20240101", 30);
  f.request.Ma1On = f.request.Ma2On = true;
  f.request.Ma1Days = 30;
  f.request.Ma2Days = 29;
  f.request.Ma1Weeks = 4;
  f.request.Ma2Weeks = 5;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("H,98,252,100,252,21"));
  EXPECT_FALSE(f.Wrote("L,98,252,100,252,20"));
  f.request.ChartPeriod = Period::kWeekly;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("L,48,252,50,252,20"));
}

TEST(DateAxisTest, MonthsHaveTheirLettersAndJanuaryItsYear) {
  ComposerFixture f;
  f.Days("20231115", 100);  // to 22 February 2024
  f.request.BarSpacing = 5;
  ASSERT_TRUE(f.Compose());
  // x = 42 + 5 * days since 15 November: December 16, January 47, February 78.
  EXPECT_TRUE(f.Wrote("L,42,429,42,434,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,42,431,N,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,122,431,D,27"));
  EXPECT_TRUE(f.Wrote("D,277,431,277,45,27"));
  EXPECT_TRUE(f.price.Has("line dash 277,431,277,45 34"));
  EXPECT_TRUE(f.Wrote("T,8.25,277,431,2024,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,432,431,F,27"));
}

TEST(DateAxisTest, JanuaryAtTheLeftEdgeHasNoYearLine) {
  ComposerFixture f;
  f.Days("20231225", 30);  // 1 January at x 42 + 7 * 3 = 63
  f.request.BarSpacing = 3;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Lines('D').empty());
  EXPECT_TRUE(f.Wrote("T,8.25,63,431,J,27"));
}

TEST(DateAxisTest, CrowdedMonthsAreSkippedButForANewYear) {
  ComposerFixture f;
  f.Days("20231025", 80);
  f.request.BarSpacing = 1;
  ASSERT_TRUE(f.Compose());
  // October 42 (s 5); November 49 (s 6) skipped; December 79 (s 10); January 110 by its year.
  EXPECT_TRUE(f.Wrote("T,8.25,42,431,O,27"));
  EXPECT_FALSE(f.Wrote("T,8.25,49,431,N,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,79,431,D,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,110,431,2024,27"));
}

TEST(DateAxisTest, MovingGridTakesThePlaceOfTheTicksWithinAYear) {
  ComposerFixture f;
  f.Days("20240115", 60);
  f.request.GridLines = true;
  f.request.BarSpacing = 5;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("L,42,429,42,434,27"));   // the first year differs from none
  EXPECT_TRUE(f.Wrote("V,127,45,127,434,35"));  // 1 February
  EXPECT_TRUE(f.price.Has("line dot 127,50,127,429 35"));
}

TEST(DateAxisTest, WeeklyChartsShowYearsAlone) {
  ComposerFixture f;
  f.Days("20231101", 120);
  f.request.ChartPeriod = Period::kWeekly;
  f.request.BarSpacing = 5;
  ASSERT_TRUE(f.Compose());
  int texts = 0;
  for (const std::string& line : f.Lines('T'))
    if (line.find(",431,") != std::string::npos) {
      ++texts;
      EXPECT_NE(line.find(",431,2024,27"), std::string::npos) << line;
    }
  EXPECT_EQ(texts, 1);
}

TEST(DateAxisTest, SuperimposedSecondChartStandsOnTheAxisOfTheFirst) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10);
  f.request.Place = ChartPlace::kUnder;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("T,8.25,42,431,M,27"));
  f.script.Open(false);
  f.request.Place = ChartPlace::kOver;
  ASSERT_TRUE(f.Compose());
  EXPECT_FALSE(f.Wrote("T,8.25,42,431,M,27"));
}

TEST(ScaleTest, LabelsOfThirteenStepsAndMoreThinFromTheSeventhOn) {
  ComposerFixture f;
  f.request.AutoScale = false;
  f.request.Name.Base = 8;
  f.request.Name.Top = 15;  // step 0.5, 14 steps
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Scale.GridCount, 14);
  std::string labels;
  for (const std::string& line : f.Lines('S')) {
    const auto fields = Split(line, ',');
    if (fields[4].find('.') != std::string_view::npos) labels += std::string(fields[4]) + " ";
  }
  EXPECT_EQ(labels, "8.00 8.50 9.00 9.50 10.00 10.50 11.00 12.00 13.00 14.00 15.00 ");
}

TEST(ScaleTest, TickIsLongerInTheScriptThanOnTheScreen) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("L,42,429,35,429,16"));
  EXPECT_TRUE(f.price.Has("line solid 42,429,37,429 16"));
}

TEST(ScaleTest, HalfGridAddsALineBetweenTheSteps) {
  ComposerFixture f;
  f.request.AutoScale = false;
  f.request.Name.Base = 8;
  f.request.Name.Top = 12;  // step 0.3, 13 steps; 0.010417 a unit
  f.request.GridLines = f.request.HalfGrid = true;
  f.request.MovingGrid = false;
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  // 8.3: 429 - 28.8; 8.15: 429 - 14.4.
  EXPECT_TRUE(f.Wrote("V,42,400,631,400,35"));
  EXPECT_TRUE(f.Wrote("V,42,415,631,415,35"));
  EXPECT_EQ(f.Lines('V').size(), 26u);
}

TEST(ScaleTest, PercentageBandsAreNamedInTheModeLineWithTheDefault5) {
  ComposerFixture f;
  f.request.BandKind = 1;
  f.request.Name.BandUp = 0;
  f.request.Name.BandDown = 101;
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("S,8.25,44,33,DAILY - ARITHMETIC -      Percentage Bands  &5%    -5%,27"));
  EXPECT_TRUE(
      f.price.Has("text 8.25 44,27 DAILY - ARITHMETIC -      Percentage Bands  &5%    -5% 27"));
}

TEST(ScaleTest, ClassTextFollowsTheModeUnlessItIsUnknown) {
  ComposerFixture f;
  f.home.Put("drive_c/korawin/IndClass.dat", "010,Gold\r\n020,unknown\r\n");
  f.request.Name.IndClass.set("10");
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("S,8.25,44,33,DAILY - ARITHMETIC -      Gold,27"));
  f.request.Name.IndClass.set("020");
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("S,8.25,44,33,DAILY - ARITHMETIC -,27"));
}

TEST(ScaleTest, LogarithmicLineHasAFurtherBlankInItsModeText) {
  ComposerFixture f;
  f.request.LogBars = f.request.LogLines = true;
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("S,8.25,44,33,DAILY - LOGARITHMIC -,27"));
  f.request.ChartStyle = Style::kLine;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("S,8.25,44,33,DAILY - LOGARITHMIC - ,27"));
}

TEST(ScaleTest, IndexOfZeroHasAnEmptyLabelWhichWritesNoLine) {
  ComposerFixture f;
  f.request.AutoScale = false;
  f.request.Name.RecType = kIndex;
  f.request.Name.Base = -10;
  f.request.Name.Top = 10;  // step 1: -10 .. 10, 0 among them
  f.Day("20240315", 5, 6, 4, 5);
  ASSERT_TRUE(f.Compose());
  for (const std::string& line : f.Lines('S'))
    EXPECT_EQ(line.find(",,"), std::string::npos) << line;
}

TEST(ComposerTitleTest, OtherDetailsStandOnTheNextLineBehindFifteenBlanks) {
  ComposerFixture f;
  f.request.Name.OtherDetails.set("ORDINARY");
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  // A line of 8 points is 10.67 * 1.149 = 12.26 units high, 13.
  EXPECT_TRUE(f.Wrote("T,8.25,20,15,               ORDINARY,26"));
}

TEST(ComposerTitleTest, PrintModeOfTheScriptHasTwoBlanksAndALargerStamp) {
  ComposerFixture f;
  f.request.ScriptPrintMode = true;
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("T,8,20,2,TEST  Test Holdings,26"));
  EXPECT_TRUE(f.Wrote("Z,8,581,25,KORA,27"));
}

TEST(ComposerTitleTest, PanelChartsShowTheirCodesSideBySideInTheirOwnColours) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10);
  f.request.Place = ChartPlace::kUnder;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("T,9.75,0,2,TEST,21"));
  f.request.Place = ChartPlace::kOver;
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("T,9.75,60,2,TEST,22"));
  EXPECT_TRUE(f.Wrote("T,9.75,0,2,TEST,21"));  // the script went on
}

TEST(TwoChartsTest, UpperAndLowerHalfWithTheLastBarsBelowEachOther) {
  ComposerFixture f;
  f.Days("20240101", 20);
  f.request.Place = ChartPlace::kUpper;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.ChartTop, 2);
  EXPECT_EQ(f.chart.ChartBottom, 207);  // 46 percent of 452
  const std::int16_t lastX = f.chart.LastBarX;
  const size_t upper = f.Script().size();

  f.days.resize(5);
  f.request.Place = ChartPlace::kLower;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.ChartTop, 230);  // 51 percent
  EXPECT_EQ(f.chart.ChartBottom, 429);
  EXPECT_EQ(f.chart.FirstBarX, 42 + 15 * 2);
  EXPECT_EQ(f.chart.LastBarX, lastX);
  EXPECT_GT(f.Script().size(), upper);
  EXPECT_EQ(f.price.ops.front().rfind("cls", 0), std::string::npos);
  EXPECT_TRUE(f.Wrote("T,9.75,168,232,TEST,26"));
  EXPECT_TRUE(f.Wrote("T,8.25,380,232,Last date processed 05-01-24,27"));
}

TEST(ComposerFailureTest, EmptyFileIsToldAndNothingIsCharted) {
  ComposerFixture f;
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "Chart Display");
  EXPECT_EQ(f.dialogs.said[0].text, "No Data for TEST.WDT");
  EXPECT_FALSE(f.chart.ChartDrawn);
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(ComposerFailureTest, TornRecordAloneIsNoData) {
  ComposerFixture f;
  f.home.Put("drive_c/korawin/data/TEST.WDT", std::string(49, ' '));
  EXPECT_FALSE(ComposeChart(f.services, f.request, f.chart));
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "No Data for TEST.WDT");
}

TEST(ComposerFailureTest, MissingFileOrFolderInItsPlaceIsTold) {
  ComposerFixture f;
  EXPECT_FALSE(ComposeChart(f.services, f.request, f.chart));
  f.home.Put("drive_c/korawin/data/TEST.WDT/x", "");
  EXPECT_FALSE(ComposeChart(f.services, f.request, f.chart));
  ASSERT_EQ(f.dialogs.said.size(), 2u);
  for (const auto& said : f.dialogs.said)
    EXPECT_EQ(said.text, "There is a problem with TEST.WDT Cannot find or open");
}

TEST(ComposerFailureTest, CodeThatWouldLeaveTheFolderOpensNothing) {
  for (const char* code : {"..\\X", "A/B", "C:", "NUL", "A*"}) {
    ComposerFixture f;
    f.request.Name.Code.set(code);
    EXPECT_FALSE(ComposeChart(f.services, f.request, f.chart));
    ASSERT_EQ(f.dialogs.said.size(), 1u) << code;
    EXPECT_EQ(f.dialogs.said[0].text,
              "There is a problem with " + std::string(code) + ".WDT Cannot find or open");
  }
}

TEST(ComposerFailureTest, ManualScaleWithAZeroTellsItsFourLinesAndDrawsNoChart) {
  ComposerFixture f;
  f.request.AutoScale = false;
  f.request.Name.Top = 20;
  f.Day("20240315", 10, 11, 9, 10);
  EXPECT_FALSE(f.Compose());
  EXPECT_TRUE(f.chart.ScaleMissing);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text,
            " MANUAL SCALING has been selected but there are no chart scale definitions in the "
            "Name File for TEST\n"
            "Use <Change Scales> in the Set Defaults window or add these scales directly to the "
            "Name File\n"
            "Do not use 0(zero) as chart base or ceiling\n"
            "OTHERWISE USE AUTOMATIC SCALING");
  EXPECT_TRUE(f.Lines('H').empty());
}

TEST(ComposerFailureTest, NegativeValuesUnderLogarithmsAreToldUnderTheirOwnTitle) {
  ComposerFixture f;
  f.request.LogBars = true;
  f.Day("20240315", 10, 11, -9, 10);
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "Negative Values");
  EXPECT_EQ(f.dialogs.said[0].text,
            "You cannot display a Logarithmic chart when there are NEGATIVE values. Display the "
            "chart as an Arithmetic chart.");
}

TEST(ComposerFailureTest, PixelOutOfSixteenBitsNamesTheDateOfTheBar) {
  ComposerFixture f;
  f.request.AutoScale = false;
  f.request.Name.Base = 10;
  f.request.Name.Top = 10.05f;
  f.Day("20240314", 10, 10.01f, 10, 10);
  f.Day("20240315", 10, 90, 10, 10);
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text,
            "There is a problem with the data for TEST.WDT\n at date (20240315) "
            "\nUse View/Modify Data procedure to correct.");
}

TEST(ComposerFailureTest, AdvanceDeclineSeriesHasItsOwnAdvice) {
  ComposerFixture f;
  f.request.Name.RecType = kAdvanceDecline;
  f.request.AutoScale = false;
  f.request.Name.Base = 10;
  f.request.Name.Top = 10.05f;
  f.Day("20240314", 0, 1, 1, 90);
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_NE(f.dialogs.said[0].text.find("Use Check advance/decline totals procedure to adjust base "
                                        "to a higher positive number."),
            std::string::npos);
}

TEST(ComposerFailureTest, BadWeeklyDateNamesTheRecord) {
  ComposerFixture f;
  f.request.ChartPeriod = Period::kWeekly;
  f.Day("20240314", 10, 11, 9, 10);
  f.Day("2024xx15", 10, 11, 9, 10);
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text,
            "There is a problem with the data for TEST.WDT\n at Rec Number (2) 2024xx15"
            "\nUse View/Modify Data procedure to correct.");
}

TEST(ComposerFailureTest, WeekWhoseVolumeLeaves32BitsNamesTheRecordAtWhichItLeft) {
  ComposerFixture f;
  f.request.ChartPeriod = Period::kWeekly;
  f.Day("20240101", 10, 11, 9, 10, 2000000000);
  f.Day("20240102", 10, 11, 9, 10, 2000000000);
  f.Day("20240103", 10, 11, 9, 10, 1);
  f.Day("20240108", 10, 11, 9, 10, 1);
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text,
            "There is a problem with the data for TEST.WDT\n at Rec Number (2) 20240102"
            "\nUse View/Modify Data procedure to correct.");
}

TEST(ComposerFailureTest, NotANumberAndInfinityInTheFileAreToldAndNoCrash) {
  for (const float bad : {std::nanf(""), std::numeric_limits<float>::infinity(),
                          -std::numeric_limits<float>::infinity()}) {
    for (const Style style : {Style::kBar, Style::kCandlestick, Style::kLine}) {
      ComposerFixture f;
      f.request.ChartStyle = style;
      f.Day("20240313", 10, 11, 9, 10);
      f.Day("20240314", bad, bad, bad, bad);
      f.Day("20240315", 10, 11, 9, 10);
      EXPECT_FALSE(f.Compose());
      EXPECT_EQ(f.dialogs.said.size(), 1u);
    }
  }
}

TEST(ComposerFailureTest, DiskNotReadyIsTriedAgainAsLongAsTheUserWants) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10);
  f.dialogs.answers = {Answer::kOk, Answer::kOk, Answer::kCancel};
  f.services.overlays.push_back([](const ChartCanvas&) { throw RunTimeError(kDiskNotReady); });
  EXPECT_FALSE(f.Compose());
  EXPECT_EQ(f.dialogs.said.size(), 3u);
  EXPECT_EQ(f.dialogs.said[0].text, "Disk Not ready. Close drive door");
}

TEST(ComposerFailureTest, SecondTryAfterTheDiskWasNotReadyWritesTheScriptOnce) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10);
  f.request.Place = ChartPlace::kUnder;
  ASSERT_TRUE(f.Compose());
  f.request.Place = ChartPlace::kOver;  // goes on behind the first
  ASSERT_TRUE(f.Compose());
  const std::string once = f.script.text();

  ComposerFixture g;
  g.Day("20240315", 10, 11, 9, 10);
  g.request.Place = ChartPlace::kUnder;
  ASSERT_TRUE(g.Compose());
  struct Slow : test::RecordingSurface {
    using RecordingSurface::RecordingSurface;
    int left = 0;
    void Line(double a, double b, double c, double d, Colour e) override {
      if (--left == 0) throw RunTimeError(kDiskNotReady);
      RecordingSurface::Line(a, b, c, d, e);
    }
  };
  Slow slow(638, 452);
  g.dialogs.answers = {Answer::kOk};
  g.request.Place = ChartPlace::kOver;
  slow.left = 1;
  ChartServices services{g.home.files(), g.dialogs, g.paths,   g.fonts, g.colours,
                         slow,           nullptr,   &g.script, {}};
  EXPECT_TRUE(ComposeChart(services, g.request, g.chart));
  EXPECT_EQ(g.dialogs.said.size(), 1u);
  EXPECT_EQ(g.script.text(), once);
}

TEST(ComposerFailureTest, ScriptThatCanNotBeWrittenHidesNoMessage) {
  ComposerFixture f;
  f.home.Put("drive_c/korawin/data/TCht.Tmp/x", "");  // a folder in its place
  ChartScript file(f.home.files(), "c:\\korawin\\data\\TCht.Tmp");
  f.services.script = &file;
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "No Data for TEST.WDT");
}

TEST(ComposerFailureTest, RefusedFontIsNamedInUpperCase) {
  struct Picky : test::RecordingSurface {
    using RecordingSurface::RecordingSurface;
    void SetFont(const SurfaceFont& font) override {
      RecordingSurface::SetFont(font);
      throw RunTimeError(kInvalidValue);
    }
  };
  ComposerFixture f;
  Picky picky(638, 452);
  f.fonts.Font1Name = "Odd Face";
  f.Day("20240315", 10, 11, 9, 10);
  f.Save();
  ChartServices services{f.home.files(), f.dialogs, f.paths,   f.fonts, f.colours,
                         picky,          nullptr,   &f.script, {}};
  EXPECT_FALSE(ComposeChart(services, f.request, f.chart));
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text,
            "There is a problem with the Font you have selected for ODD FACE. Select another Font "
            "and try again - Try MS Sans Serif or MS Serif if available");
}

TEST(ComposerFailureTest, UnexpectedErrorShowsItsNumberAndText) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10);
  f.services.overlays.push_back([](const ChartCanvas&) { throw RunTimeError(kDivisionByZero); });
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 11\nDivision by zero");
}

TEST(ComposerTest, SuppressedScriptStaysTheRecordOfTheChart) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  const std::string before = f.script.text();
  f.request.SuppressScript = true;
  f.request.ChartStyle = Style::kLine;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.script.text(), before);
  EXPECT_FALSE(f.price.ops.empty());
}

TEST(ComposerTest, SameChartComposedTwiceIsTheSame) {
  ComposerFixture f;
  f.Days("20231115", 300, 5000);
  f.request.GridLines = true;
  ASSERT_TRUE(f.Compose());
  const std::string script = f.script.text();
  const auto ops = f.price.ops;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.script.text(), script);
  EXPECT_EQ(f.price.ops, ops);
}

TEST(ComposerTest, CommaOrLineEndInANameCanNotBeMoreThanAText) {
  ComposerFixture f;
  f.request.Name.Name.set("A\r\nL,1,2,3,4,5");
  f.Day("20240315", 10, 11, 9, 10);
  ASSERT_TRUE(f.Compose());
  EXPECT_FALSE(f.Wrote("L,1,2,3,4,5"));
}
