#include <gtest/gtest.h>

#include "chart/scale_drawing.h"
#include "tests/chart/composer_fixture.h"

// Labels that would not fit, made to; and labels that do, left alone. Texts of 8.25 points: a digit is
// 6.12 units wide, a point 3.06.

namespace kora {
namespace {

using test::ComposerFixture;
using Lines = std::vector<std::string>;

TEST(LegibleLabels, AVolumeInFewCharacters) {
  EXPECT_EQ(ShortVolume(0), "0");
  EXPECT_EQ(ShortVolume(999), "999");
  EXPECT_EQ(ShortVolume(1000), "1K");
  EXPECT_EQ(ShortVolume(1240), "1.2K");
  EXPECT_EQ(ShortVolume(9949), "9.9K");
  EXPECT_EQ(ShortVolume(9960), "10K");
  EXPECT_EQ(ShortVolume(670000), "670K");
  EXPECT_EQ(ShortVolume(999400), "999K");
  EXPECT_EQ(ShortVolume(999600), "1M");
  EXPECT_EQ(ShortVolume(1800000), "1.8M");
  EXPECT_EQ(ShortVolume(12345600), "12M");
  EXPECT_EQ(ShortVolume(2147483647), "2.1B");
}

// 638 x 452: the panel from 386 to 429, its steps 11, its usable height 31. From 100,000 to the mean
// of 500,000: 12,903 a unit, so that the values are 100,000, 241,900, 383,900 and 525,800.
TEST(LegibleLabels, VolumesThatReachTheWordAreShortenedTogether) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10, 100000);
  f.Day("20240318", 10, 11, 9, 10, 900000);
  ASSERT_TRUE(f.Compose());
  EXPECT_TRUE(f.Wrote("S,8,1,425,100000,27"));
  EXPECT_TRUE(f.Wrote("S,8,1,392,525800,27"));
  f.request.Legible = true;
  ASSERT_TRUE(f.Compose());
  const Lines all = f.Lines('S');
  Lines values;
  for (const std::string& line : all)
    if (line.find("K,") != std::string::npos) values.push_back(line);
  EXPECT_EQ(values, (Lines{"S,8,12,425,100K,27", "S,8,12,414,242K,27", "S,8,12,403,384K,27",
                           "S,8,12,392,526K,27"}));
}

TEST(LegibleLabels, VolumesThatFitStayAsTheyAre) {
  ComposerFixture f;
  f.Day("20240315", 10, 11, 9, 10, 100);
  f.Day("20240318", 10, 11, 9, 10, 900);
  ASSERT_TRUE(f.Compose());
  const Lines before = f.Script();
  f.request.Legible = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Script(), before);
}

// "1000.00" in bold is 40 wide: with the gap of 5 it begins at -3.
TEST(LegibleLabels, TheScaleIsAsWideAsItsLongestPrice) {
  ComposerFixture f;
  f.Day("20240315", 1000, 1010, 990, 1000);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.ChartLeft, 42);
  EXPECT_TRUE(f.Wrote("S,8.25,-3,231,1000.00,27"));
  f.request.Legible = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.ChartLeft, 46);
  EXPECT_EQ(f.chart.FirstBarX, 46);
  EXPECT_TRUE(f.Wrote("S,8.25,1,231,1000.00,27"));
  EXPECT_TRUE(f.Wrote("B,46,45,631,429,16"));
}

TEST(LegibleLabels, TheRoomIsTakenFromTheOldestBars) {
  ComposerFixture f;
  for (int i = 0; i < 400; ++i)
    f.Day(FormatFileDate(DateOfDayNumber(DayNumber({2023, 1, 1}) + i)), 1000, 1010, 990, 1000);
  ASSERT_TRUE(f.Compose());
  const int first = f.chart.Bars.FirstDataRec;
  f.request.Legible = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, first + 2) << "four units, two a bar";
  EXPECT_EQ(f.chart.Bars.LastDataRec, 400);
  EXPECT_LE(f.chart.LastBarX, f.chart.ChartRight + 2);
}

TEST(LegibleLabels, PricesOfThreeDigitsHaveTheRoomThatTheyHad) {
  ComposerFixture f;
  f.Day("20240315", 700, 710, 690, 700);
  ASSERT_TRUE(f.Compose());
  const Lines before = f.Script();
  f.request.Legible = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Script(), before);
}

// The frame of a chart 200 high begins at 20: the line above it at 2, in the script at 8, where the
// title stands.
TEST(LegibleLabels, OnALowChartTheTitleStandsAlone) {
  ComposerFixture f;
  f.Days("20240315", 20);
  f.price = test::RecordingSurface(638, 200);
  const auto modes = [&f] {
    Lines found;
    for (const std::string& line : f.Lines('S'))
      if (line.find(",DAILY") != std::string::npos) found.push_back(line);
    return found;
  };
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(modes(), Lines{"S,8.25,44,8,DAILY - ARITHMETIC -,27"});
  f.request.Legible = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(modes(), Lines{});
  f.price = test::RecordingSurface(638, 452);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(modes().size(), 1u);
}

// Months 2 units apart: a year is 24, and as wide is its text.
TEST(LegibleLabels, AYearThatWouldTouchTheOneBeforeIsLeftOut) {
  ComposerFixture f;
  for (int year = 2004; year < 2010; ++year)
    for (int month = 1; month <= 12; ++month)
      f.Day(FormatFileDate({year, month, 15}), 10, 11, 9, 10);
  f.request.ChartPeriod = Period::kMonthly;
  ASSERT_TRUE(f.Compose());
  const auto years = [&f] {
    Lines found;
    for (const std::string& line : f.Lines('T'))
      if (line.find(",431,20") != std::string::npos) found.push_back(line);
    return found;
  };
  EXPECT_EQ(years().size(), 5u);
  EXPECT_EQ(f.Lines('D').size(), 5u);
  f.request.Legible = true;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(years(),
            (Lines{"T,8.25,66,431,2005,27", "T,8.25,114,431,2007,27", "T,8.25,162,431,2009,27"}));
  EXPECT_EQ(f.Lines('D').size(), 5u) << "each year keeps its line";
}

TEST(LegibleLabels, TheSecondOfTwoChartsInOneFrameTakesTheColourOfItsCode) {
  ComposerFixture f;
  f.Days("20240101", 20);
  f.request.ChartStyle = Style::kLine;
  for (const bool legible : {false, true}) {
    f.request.Legible = legible;
    f.request.Place = ChartPlace::kUnder;
    ASSERT_TRUE(f.Compose());
    for (const std::string& line : f.Lines('H')) EXPECT_TRUE(line.ends_with(",18")) << line;
    const size_t first = f.Lines('H').size();
    f.request.Place = ChartPlace::kOver;
    ASSERT_TRUE(f.Compose());
    EXPECT_TRUE(f.Wrote("T,9.75,60,2,TEST,22"));
    const Lines lines = f.Lines('H');
    ASSERT_EQ(lines.size(), 2 * first);
    for (size_t i = first; i < lines.size(); ++i)
      EXPECT_TRUE(lines[i].ends_with(legible ? ",22" : ",18")) << lines[i];
  }
}

TEST(LegibleLabels, TheLastBarsOfTwoChartsStandBelowEachOther) {
  for (const bool upperIsDear : {true, false}) {
    ComposerFixture f;
    f.request.Legible = true;
    const auto fill = [&f](float price, int days) {
      f.days.clear();
      for (int i = 0; i < days; ++i)
        f.Day(FormatFileDate(DateOfDayNumber(DayNumber({2023, 1, 1}) + i)), price, price + 10,
              price - 5, price);
    };
    fill(upperIsDear ? 1000.0f : 20.0f, 400);
    f.request.Place = ChartPlace::kUpper;
    ASSERT_TRUE(f.Compose());
    const int last = f.chart.LastBarX;
    fill(upperIsDear ? 20.0f : 1000.0f, 60);
    f.request.Place = ChartPlace::kLower;
    ASSERT_TRUE(f.Compose());
    EXPECT_EQ(f.chart.LastBarX, last) << upperIsDear;
    EXPECT_EQ(f.chart.ChartLeft, 46);
  }
}

}  // namespace
}  // namespace kora
