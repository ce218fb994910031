#include "chartwindow/tools/trendline_places.h"

#include <gtest/gtest.h>

#include <cstring>
#include <limits>
#include <set>

#include "base/dates.h"
#include "base/numbers.h"
#include "tests/chartwindow/tools/small_chart.h"

namespace kora {
namespace {

// With a hundred bars of every second day from 1 January 2026.
Composition Chart() {
  Composition chart = test::EmptyChart();
  const std::int32_t first = DayNumber({2026, 1, 1});
  for (int i = 0; i < 100; ++i) {
    ChartBar bar{};
    const std::string date = FormatFileDate(DateOfDayNumber(first + 2 * i));
    std::memcpy(bar.Date, date.data(), 8);
    bar.Open = bar.High = bar.Low = bar.Close = 15;
    chart.Bars.bars.push_back(bar);
  }
  chart.Bars.BarCount = 99;
  chart.ChartDrawn = true;
  return chart;
}
ChartRequest Daily() {
  ChartRequest request;
  request.ChartPeriod = Period::kDaily;
  return request;
}
std::string DateOf(const Composition& chart, int column) {
  return std::string(chart.Bars[size_t(column)].date());
}
TrendlineRec Line(std::string_view start, float from, std::string_view end, float to) {
  TrendlineRec rec = EmptyTrendline();
  rec.TLSpacing = 5;
  rec.TLPeriod.set("A");
  rec.TLStartDate.set(start);
  rec.TLStartPrice = from;
  rec.TLEndDate.set(end);
  rec.TLEndPrice = to;
  return rec;
}

// Columns 10 and 20; 100 units are 5.00, 200 are 10.00.
TEST(TrendlineOfTest, KeepsDatesAndPricesOfBothEndsTheLeftOneFirst) {
  const Composition chart = Chart();
  for (const ScreenLine line : {ScreenLine{82, 330, 122, 230}, ScreenLine{122, 230, 82, 330}}) {
    const auto rec = TrendlineOf(chart, Daily(), line);
    ASSERT_TRUE(rec);
    EXPECT_EQ(std::int16_t(rec->TLSpacing), 5);
    EXPECT_EQ(rec->TLPeriod.raw(), "A");
    EXPECT_EQ(rec->TLStartDate.raw(), DateOf(chart, 10));
    EXPECT_EQ(rec->TLEndDate.raw(), DateOf(chart, 20));
    EXPECT_FLOAT_EQ(rec->TLStartPrice, 15);
    EXPECT_FLOAT_EQ(rec->TLEndPrice, 20);
  }
}

TEST(TrendlineOfTest, ARightEndInTheBlankSpaceIsXAndTheColumns) {
  const Composition chart = Chart();
  const auto rec = TrendlineOf(chart, Daily(), {402, 330, 482, 330});
  ASSERT_TRUE(rec);
  EXPECT_EQ(rec->TLEndDate.trimmed(), "X20");
}

TEST(TrendlineOfTest, ALeftEndOnColumnZeroOrBeyondTheLastBarIsNotKept) {
  const Composition chart = Chart();
  EXPECT_FALSE(TrendlineOf(chart, Daily(), {43, 330, 122, 330}));
  EXPECT_FALSE(TrendlineOf(chart, Daily(), {20, 330, 122, 330}));
  EXPECT_FALSE(TrendlineOf(chart, Daily(), {450, 330, 482, 330}));
  EXPECT_TRUE(TrendlineOf(chart, Daily(), {46, 330, 122, 330}));
}

TEST(TrendlineOfTest, ABlankDateAtAnEndIsNotKept) {
  Composition chart = Chart();
  std::memset(chart.Bars.bars[10].Date, ' ', 8);
  EXPECT_FALSE(TrendlineOf(chart, Daily(), {82, 330, 122, 330}));
  EXPECT_FALSE(TrendlineOf(chart, Daily(), {62, 330, 82, 330}));
}

TEST(PlaceTrendlineTest, StandsOneUnitRightOfItsColumnsAtItsPrices) {
  const Composition chart = Chart();
  const auto line =
      PlaceTrendline(chart, Daily(), Line(DateOf(chart, 10), 15, DateOf(chart, 20), 20));
  ASSERT_TRUE(line);
  EXPECT_EQ(line->x1, 42 + 1 + 40);
  EXPECT_EQ(line->x2, 42 + 1 + 80);
  EXPECT_NEAR(line->y1, 330, 0.001);
  EXPECT_NEAR(line->y2, 230, 0.001);
}

TEST(PlaceTrendlineTest, AnEndInTheBlankSpaceGrowsWithTheSpacing) {
  Composition chart = Chart();
  const TrendlineRec rec = Line(DateOf(chart, 50), 15, "X20", 15);
  EXPECT_EQ(PlaceTrendline(chart, Daily(), rec)->x2, 43 + 200 + 80);
  chart.BarSpacing = 6;
  EXPECT_EQ(PlaceTrendline(chart, Daily(), rec)->x1, 43 + 300);
  EXPECT_EQ(PlaceTrendline(chart, Daily(), rec)->x2, 43 + 300 + 120);
  chart.BarSpacing = 9;  // 43 + 450 + 180 is beyond the frame
  EXPECT_FALSE(PlaceTrendline(chart, Daily(), rec));
}

TEST(PlaceTrendlineTest, ADateWithoutABarSnapsForwardToTheNext) {
  const Composition chart = Chart();
  const auto line = PlaceTrendline(chart, Daily(), Line("20260102", 15, "20260110", 15));
  ASSERT_FALSE(line) << "the second of January is before bar 1";
  const auto snapped = PlaceTrendline(chart, Daily(), Line("20260104", 15, "20260110", 15));
  ASSERT_TRUE(snapped);
  EXPECT_EQ(snapped->x1, 43 + 2 * 4) << "5 January";
  EXPECT_EQ(snapped->x2, 43 + 5 * 4) << "11 January";
}

TEST(PlaceTrendlineTest, AStartBeforeBarOneHidesTheLineEvenIfItsEndIsOnTheChart) {
  const Composition chart = Chart();
  EXPECT_FALSE(PlaceTrendline(chart, Daily(), Line("20251231", 15, DateOf(chart, 20), 15)));
  EXPECT_FALSE(PlaceTrendline(chart, Daily(), Line(DateOf(chart, 0), 15, DateOf(chart, 20), 15)));
  EXPECT_TRUE(PlaceTrendline(chart, Daily(), Line(DateOf(chart, 1), 15, DateOf(chart, 20), 15)));
}

TEST(PlaceTrendlineTest, DailyLinesDoNotShowOnWeeklyCharts) {
  const Composition chart = Chart();
  const TrendlineRec rec = Line(DateOf(chart, 10), 15, DateOf(chart, 20), 15);
  ChartRequest weekly = Daily();
  weekly.ChartPeriod = Period::kWeekly;
  EXPECT_TRUE(PlaceTrendline(chart, Daily(), rec));
  EXPECT_FALSE(PlaceTrendline(chart, weekly, rec));
}

TEST(PlaceTrendlineTest, LinesMoreThanTwentyUnitsOutsideTheFrameAreLeftOut) {
  const Composition chart = Chart();
  const auto at = [&](float price) {
    return PlaceTrendline(chart, Daily(), Line(DateOf(chart, 10), price, DateOf(chart, 20), 15))
        .has_value();
  };
  EXPECT_TRUE(at(9.05f));   // y 449
  EXPECT_FALSE(at(8.95f));  // y 451
  EXPECT_TRUE(at(30.20f));  // y 26
  EXPECT_FALSE(at(30.30f));
  EXPECT_FALSE(at(0));
}

TEST(PlaceTrendlineTest, WhatCannotBeReadIsPassedOver) {
  const Composition chart = Chart();
  const float nan = std::numeric_limits<float>::quiet_NaN();
  const std::string good = DateOf(chart, 10), end = DateOf(chart, 20);
  for (const TrendlineRec& rec :
       {Line(good, nan, end, 15), Line(good, 15, end, std::numeric_limits<float>::infinity()),
        Line("ABCDEFGH", 15, end, 15), Line(good, 15, "ABCDEFGH", 15), Line(good, 15, "", 15),
        Line("", 15, end, 15), Line(good, 15, "X99999", 15), Line(good, 15, "99999999", 15),
        EmptyTrendline()})
    EXPECT_FALSE(PlaceTrendline(chart, Daily(), rec));
  // Without a count the line ends in the column that it starts in.
  EXPECT_EQ(PlaceTrendline(chart, Daily(), Line(good, 15, "X", 15))->x2, 83);
  EXPECT_FALSE(PlaceTrendline(Composition{}, Daily(), Line(good, 15, end, 15)));
}

TEST(PlaceTrendlineTest, OnALogarithmicScaleThePriceStandsWhereThePointerReadsIt) {
  Composition chart = Chart();
  chart.Price.Logarithmic = true;
  chart.Price.LogBase = 2.302585f;
  chart.Price.LogFactor = -385 / 1.0986123f;  // 10 to 30 over the frame
  const auto line =
      PlaceTrendline(chart, Daily(), Line(DateOf(chart, 10), 10, DateOf(chart, 20), 17.320508f));
  ASSERT_TRUE(line);
  EXPECT_NEAR(line->y1, 430, 1);
  EXPECT_NEAR(line->y2, 430 - 385 / 2.0, 1);
}

TEST(HitTest, TwoUnitsOffALineDoesNotHitAndOnePointNineDoes) {
  const TrendlineRow level{100, 200, 300, 200};
  EXPECT_TRUE(HitsLine(level, 150, 201.9));
  EXPECT_TRUE(HitsLine(level, 150, 198.1));
  EXPECT_FALSE(HitsLine(level, 150, 202));
  EXPECT_FALSE(HitsLine(level, 150, 198));
  const TrendlineRow slope{100, 200, 300, 100};
  EXPECT_TRUE(HitsLine(slope, 200, 151));
  EXPECT_FALSE(HitsLine(slope, 200, 155));
}

TEST(HitTest, TheLineGoesOnBeyondItsEnds) {
  EXPECT_TRUE(HitsLine({100, 200, 300, 100}, 500, 0));
  EXPECT_FALSE(HitsLine({0, 0, 0, 0}, 0, 0)) << "a line that was not drawn";
}

// Slope 60 - 50, intercept 100 * 50 - 100 * 60.
TEST(HitTest, AVerticalLineIsTakenByTheSameFormulaWithoutTheDivision) {
  EXPECT_TRUE(HitsLine({100, 50, 100, 60}, 100, 1));
  EXPECT_FALSE(HitsLine({100, 50, 100, 60}, 100, 55));
}

TEST(PlaceNoteTest, StandsAtTheBarOfItsDateAndItsPrice) {
  const Composition chart = Chart();
  const auto at = [&](std::string_view date, double price) {
    return PlaceNote(chart, MakeNoteLine(date, price, "x", 1));
  };
  ASSERT_TRUE(at("20260104", 15));
  EXPECT_EQ(at("20260104", 15)->x, 43 + 2 * 4);
  EXPECT_EQ(at("20260104", 15)->y, 330);
  EXPECT_EQ(at("20260101", 15)->x, 43) << "the first bar too";
  EXPECT_FALSE(at("20251231", 15));
  EXPECT_FALSE(at("20270101", 15)) << "not on the chart yet";
  EXPECT_FALSE(at("20260104", 99));
  EXPECT_FALSE(at("20260104", 0));
  EXPECT_EQ(at("120", 15)->x, 120) << "kept by its place where the bar had no date";
  EXPECT_FALSE(PlaceNote(chart, ParseNoteLine("nonsense")));
}

}  // namespace
}  // namespace kora
