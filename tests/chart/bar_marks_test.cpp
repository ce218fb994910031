#include "chart/bar_marks.h"

#include <gtest/gtest.h>

#include "looks/colours.h"

using namespace kora;

namespace {

// Screen y: a smaller value is a higher price.
BarY Bar(int high, int low, int open, int close) {
  return {std::int16_t(high), std::int16_t(low), std::int16_t(open), std::int16_t(close)};
}

const BarY kPrevious = Bar(100, 120, 110, 110);

ChartBar Prices(float high, float low, float close) {
  ChartBar bar{};
  bar.High = high;
  bar.Low = low;
  bar.Open = bar.Close = close;
  return bar;
}

}  // namespace

TEST(ReversalMarkTest, OutsideBarThatClosesBeyondIsAKeyReversal) {
  EXPECT_EQ(ReversalMark(Bar(95, 130, 110, 125), &kPrevious, nullptr), kKeyReversal);
  EXPECT_EQ(ReversalMark(Bar(95, 130, 110, 96), &kPrevious, nullptr), kKeyReversal);
}

TEST(ReversalMarkTest, HigherHighWithALowerCloseIsAReversalAndOverridesTheKeyReversal) {
  EXPECT_EQ(ReversalMark(Bar(95, 118, 100, 115), &kPrevious, nullptr), kReversal);
  // Closes at 120, the previous low, are not above it.
  EXPECT_EQ(ReversalMark(Bar(95, 120, 100, 120), &kPrevious, nullptr), kChartLines);
}

TEST(ReversalMarkTest, InsideBarWithATurnOfTheCloseIsAHookReversal) {
  const BarY closedLow = Bar(100, 120, 110, 115);
  const BarY closedHigh = Bar(100, 120, 110, 105);
  // Inside bar 105 to 115, middle 110.
  EXPECT_EQ(ReversalMark(Bar(105, 115, 110, 106), &closedLow, nullptr), kHookReversal);
  EXPECT_EQ(ReversalMark(Bar(105, 115, 110, 114), &closedHigh, nullptr), kHookReversal);
  EXPECT_EQ(ReversalMark(Bar(105, 115, 110, 114), &closedLow, nullptr), kChartLines);
}

TEST(ReversalMarkTest, HalvesOfAnInsideBarAreFoundWithTruncation) {
  // 105 to 116: the middle is 105 + 11 \ 2 = 110, so a close of 110 lies in neither half.
  const BarY closedLow = Bar(100, 120, 110, 115);
  EXPECT_EQ(ReversalMark(Bar(105, 116, 112, 110), &closedLow, nullptr), kChartLines);
  EXPECT_EQ(ReversalMark(Bar(105, 116, 112, 109), &closedLow, nullptr), kHookReversal);
}

TEST(ReversalMarkTest, GapWithTheCloseAgainstItIsAnOpenCloseReversal) {
  EXPECT_EQ(ReversalMark(Bar(80, 95, 82, 90), &kPrevious, nullptr), kOpenCloseRev);
  EXPECT_EQ(ReversalMark(Bar(125, 140, 138, 130), &kPrevious, nullptr), kOpenCloseRev);
}

TEST(ReversalMarkTest, StandingOutPreviousBarIsAPivot) {
  const BarY before = Bar(110, 130, 120, 120);
  EXPECT_EQ(ReversalMark(Bar(105, 128, 110, 125), &kPrevious, &before), kPivotPoint);
  const BarY lowPivot = Bar(100, 140, 120, 120);
  EXPECT_EQ(ReversalMark(Bar(95, 130, 110, 98), &lowPivot, &before), kPivotPoint);
}

TEST(ReversalMarkTest, FirstBarsHaveNothingToBeComparedWith) {
  EXPECT_EQ(ReversalMark(Bar(95, 130, 110, 125), nullptr, nullptr), kChartLines);
  EXPECT_EQ(ReversalMark(Bar(105, 128, 110, 125), &kPrevious, nullptr), kChartLines);
}

TEST(StopLossTest, OutsideBarSetsTheStopBelowItsLow) {
  StopLossTracker stop(true, 10);
  EXPECT_EQ(stop.Next(Prices(12, 8, 11), Prices(11, 9, 10), 50), kCandleDown);
  EXPECT_FLOAT_EQ(stop.stop(), 7.2f);
  EXPECT_EQ(stop.stopX(), 50);
  EXPECT_FALSE(stop.broken());
}

TEST(StopLossTest, CloseBelowTheStopBreaksItOnceAndClearsIt) {
  StopLossTracker stop(true, 10);
  stop.Next(Prices(12, 8, 11), Prices(11, 9, 10), 50);
  EXPECT_EQ(stop.Next(Prices(8, 7, 7), Prices(12, 8, 11), 52), 11);
  EXPECT_TRUE(stop.broken());
  EXPECT_EQ(stop.stop(), 0);
  EXPECT_EQ(stop.Next(Prices(8, 7, 7), Prices(8, 7, 7), 54), kChartLines);
  EXPECT_FALSE(stop.broken());
}

TEST(StopLossTest, CloseAtTheStopDoesNotBreakIt) {
  StopLossTracker stop(true, 50);
  stop.Next(Prices(12, 8, 11), Prices(11, 9, 10), 50);
  EXPECT_EQ(stop.Next(Prices(8, 4, 4), Prices(12, 8, 11), 52), kChartLines);
  EXPECT_FLOAT_EQ(stop.stop(), 4);
}

TEST(StopLossTest, PercentOutside1To100OrNotShownSetsNoStop) {
  for (const float percent : {0.0f, 0.5f, 100.5f, -5.0f}) {
    StopLossTracker stop(true, percent);
    EXPECT_EQ(stop.Next(Prices(12, 8, 11), Prices(11, 9, 10), 50), kCandleDown);
    EXPECT_EQ(stop.stop(), 0) << percent;
  }
  StopLossTracker hidden(false, 10);
  hidden.Next(Prices(12, 8, 11), Prices(11, 9, 10), 50);
  EXPECT_EQ(hidden.stop(), 0);
}
