#include "chart/chart_scale.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "base/runtime_error.h"

using namespace kora;

namespace {

ChartScale Automatic(float high, float low) {
  ChartScale scale;
  SetChartScaleAutomatic(high, low, scale);
  return scale;
}

}  // namespace

// 30 * 1.02 = 30.6, n = 306, 30.6; 30.6 * 1.02 = 31.212 -> 31.2.
// 25 * 0.99 = 24.75, n = 248 (247.5 to even), 24.8 < 25; 24.8 * 0.99 = 24.552 -> 24.6.
TEST(SetChartScaleTest, FactorActsTwiceBetween1And100) {
  const ChartScale s = Automatic(30, 25);
  EXPECT_FLOAT_EQ(s.ScaleHigh, 31.2f);
  EXPECT_FLOAT_EQ(s.ScaleLow, 24.6f);
  EXPECT_DOUBLE_EQ(s.Range, 6.6);
  EXPECT_FLOAT_EQ(s.GridStep, 0.5f);
  EXPECT_EQ(s.GridCount, 13);
}

TEST(SetChartScaleTest, NearParKeepsTheTopAndTakesTheBottomThroughItsStepsWithFactor1) {
  // H 99.5, L 96: the top stays; L: n = 960, 96.0 is not below 96, so n = 959.
  const ChartScale s = Automatic(99.5f, 96);
  EXPECT_FLOAT_EQ(s.ScaleHigh, 99.5f);
  EXPECT_FLOAT_EQ(s.ScaleLow, 95.9f);
  EXPECT_DOUBLE_EQ(s.Range, 3.6);
  EXPECT_FLOAT_EQ(s.GridStep, 0.3f);
}

TEST(SetChartScaleTest, TightRangeOfAPennyShareWidensBothEnds) {
  // 0.18 * 1.05 = 0.189, at most 0.19, so * 1.2 = 0.2268 -> 0.227.
  // 0.17 * 0.95 = 0.1615 * 0.9 = 0.14535 -> 0.145; then 29 steps of 0.005.
  const ChartScale s = Automatic(0.18f, 0.17f);
  EXPECT_FLOAT_EQ(s.ScaleHigh, 0.227f);
  EXPECT_FLOAT_EQ(s.ScaleLow, 0.145f);
  EXPECT_DOUBLE_EQ(s.Range, 0.08);
  EXPECT_FLOAT_EQ(s.GridStep, 0.005f);
  EXPECT_EQ(s.GridCount, 16);
}

TEST(SetChartScaleTest, AllClosesEqualWidensByFivePercentEachWay) {
  // 10.5 * 1.02 = 10.71, n = 107, 10.7 > 10.5; 10.7 * 1.02 = 10.914 -> 10.9.
  // 9.5 * 0.99 = 9.405, n = 94, 9.4 < 9.5; 9.4 * 0.99 = 9.306 -> 9.3.
  const ChartScale s = Automatic(10, 10);
  EXPECT_FLOAT_EQ(s.ScaleHigh, 10.9f);
  EXPECT_FLOAT_EQ(s.ScaleLow, 9.3f);
}

TEST(SetChartScaleTest, IndexRoundsOutwardToHundreds) {
  // 4200 * 1.02 = 4284, n = 428, 4280. 3900 * 0.99 = 3861, n = 386, 3860.
  // L above 600: 3800; H at or above 100: 4300. R 500: tens 500, / 10 = 50.
  const ChartScale s = Automatic(4200, 3900);
  EXPECT_FLOAT_EQ(s.ScaleHigh, 4300);
  EXPECT_FLOAT_EQ(s.ScaleLow, 3800);
  EXPECT_FLOAT_EQ(s.GridStep, 50);
  EXPECT_EQ(s.GridCount, 10);
}

TEST(SetChartScaleTest, LowFrom0To600IsNotRoundedOutward) {
  // 610 * 1.02 = 622.2, n = 62, 620. 500 * 0.99 = 495, n = 50 (49.5 to even), 500 <= 500, 490.
  const ChartScale s = Automatic(610, 500);
  EXPECT_FLOAT_EQ(s.ScaleHigh, 620);
  EXPECT_FLOAT_EQ(s.ScaleLow, 490);
  EXPECT_FLOAT_EQ(s.GridStep, 13);  // 130: tens 130, / 10
}

TEST(SetChartScaleTest, NegativeLowsGoDownToTensAndHundreds) {
  // -35 * 1.01 = -35.35 -> -35.35 through the pattern; below -10: -40.
  // 20 * 1.02 = 20.4 -> 20.4 * 1.02 = 20.808 -> 20.8; between 0.5 and 100: 20.
  ChartScale s = Automatic(20, -35);
  EXPECT_FLOAT_EQ(s.ScaleLow, -40);
  EXPECT_FLOAT_EQ(s.ScaleHigh, 20);
  // -250 * 1.01 = -252.5 -> -300. -120 * 0.99 = -118.8; at or below -100: (-2 + 1) * 100.
  s = Automatic(-120, -250);
  EXPECT_FLOAT_EQ(s.ScaleLow, -300);
  EXPECT_FLOAT_EQ(s.ScaleHigh, -100);
  // -5 * 1.01 = -5.05 stays, to the 0.005: -5.05.
  s = Automatic(20, -5);
  EXPECT_FLOAT_EQ(s.ScaleLow, -5.05f);
}

TEST(SetChartScaleTest, TopAroundZeroTakesItsOwnRow) {
  // H 0, L -35: 0 * 0.99 is 0; exactly 0 goes to 100.
  EXPECT_FLOAT_EQ(Automatic(0, -35).ScaleHigh, 100);
  // H 0.3 with L -2: 0.3 * 1.02 = 0.306, at most 0.5 unchanged.
  EXPECT_FLOAT_EQ(Automatic(0.3f, -2).ScaleHigh, 0.306f);
}

TEST(SetChartScaleTest, BottomOfZeroIsNeverZero) {
  // L 0: 0.005 after its steps, and 1 step of 0.005.
  EXPECT_FLOAT_EQ(Automatic(5, 0).ScaleLow, 0.005f);
  // L 0.002 * 0.9 = 0.0018 -> 0.002 -> round(0.4) = 0 steps -> 0.001.
  EXPECT_FLOAT_EQ(Automatic(5, 0.002f).ScaleLow, 0.001f);
}

TEST(SetChartScaleTest, BelowOneCentTheTopBecomesFiveCents) {
  // H 0.004 -> 0.05 * 1.05 = 0.0525 * 1.2 = 0.063.
  EXPECT_FLOAT_EQ(Automatic(0.004f, 0.003f).ScaleHigh, 0.063f);
}

TEST(GridStepTest, EachRowOfTheTable) {
  struct Row {
    float top;
    double step;
    int count;
  };
  // A base of 1000 keeps the ranges exact to two decimals. The step is a 32-bit float and the
  // division is done in 64 bits: 0.05, 0.1 and 0.2 are a little above their decimals as floats,
  // so that 1 / 0.05 counts 19 whole steps and not 20.
  const Row rows[] = {{1000.0625f, 0.005, 12}, {1000.5f, 0.02, 25}, {1001, 0.05, 19},
                      {1002, 0.1, 19},         {1003, 0.2, 14},     {1004, 0.3, 13},
                      {1005, 0.4, 12},         {1010, 0.5, 20},     {1020, 1, 20},
                      {1050, 5, 10},           {1080, 10, 8},       {1100, 15, 6},
                      {1155, 15, 10},          {2000, 100, 10},     {2234, 120, 10}};
  for (const Row& row : rows) {
    ChartScale s;
    SetChartScaleManual(1000, row.top, s);
    EXPECT_FLOAT_EQ(s.GridStep, float(row.step)) << row.top;
    EXPECT_EQ(s.GridCount, row.count) << row.top;
  }
}

TEST(GridStepTest, RangeThatNoRowCoversKeepsThePreviousStep) {
  ChartScale s;
  SetChartScaleManual(10, 12, s);
  EXPECT_FLOAT_EQ(s.GridStep, 0.1f);
  SetChartScaleManual(1, 1.11f, s);  // 0.11 lies between the first two rows
  EXPECT_FLOAT_EQ(s.GridStep, 0.1f);
  EXPECT_EQ(s.GridCount, 1);
}

TEST(GridStepTest, RangeThatNoRowCoversStartsWithTwoHundredthsInAFreshRun) {
  ChartScale s;
  SetChartScaleManual(1, 1.11f, s);
  EXPECT_FLOAT_EQ(s.GridStep, 0.02f);
  EXPECT_EQ(s.GridCount, 5);
}

TEST(ManualScaleTest, ZeroOnEitherSideClearsBoth) {
  for (const auto& [base, top] : {std::pair{0.0f, 5.0f}, {5.0f, 0.0f}, {0.0f, 0.0f}}) {
    ChartScale s;
    SetChartScaleManual(base, top, s);
    EXPECT_EQ(s.ScaleLow, 0);
    EXPECT_EQ(s.ScaleHigh, 0);
  }
}

TEST(SetChartScaleTest, InfiniteAndNotANumberAreOverflows) {
  const float inf = std::numeric_limits<float>::infinity();
  for (const auto& [h, l] : {std::pair{inf, 1.0f}, {1.0f, -inf}, {std::nanf(""), 1.0f}}) {
    try {
      Automatic(h, l);
      FAIL() << "no error";
    } catch (const RunTimeError& e) {
      EXPECT_EQ(e.number(), 6);
    }
  }
}

TEST(PriceMapTest, ArithmeticRoundsHalfToEven) {
  PriceMap map;
  map.ScaleLow = 10;
  map.PricePerY = 0.5f;
  map.ChartBottom = 400;
  EXPECT_EQ(map.Y(10), 400);
  EXPECT_EQ(map.Y(20), 380);
  EXPECT_EQ(map.Y(10.25), 400);  // 399.5 to even
  EXPECT_EQ(map.Y(10.75), 398);  // 398.5 to even
  EXPECT_DOUBLE_EQ(map.Price(380), 20);
}

TEST(PriceMapTest, LeavingSixteenBitsIsError6) {
  PriceMap map;
  map.ScaleLow = 10;
  map.PricePerY = 0.001f;
  map.ChartBottom = 400;
  EXPECT_THROW(map.Y(100), RunTimeError);
}

TEST(PriceMapTest, LogarithmicTakesTheFloor) {
  PriceMap map;
  map.Logarithmic = true;
  map.LogBase = 0;  // bottom at 1
  map.LogFactor = -100;
  map.ChartBottom = 400;
  EXPECT_EQ(map.Y(1), 400);
  EXPECT_EQ(map.Y(2), 330);  // 400 - 69.31 = 330.69
  EXPECT_EQ(map.Y(0), 169);  // as if ln v were ln 10: 400 - 230.26
  // ln 10 / ln 2 = 3.3219: 400 - 332.19 = 67.81
  EXPECT_EQ(map.Y(-2), 67);
  EXPECT_THROW(map.Y(-1), RunTimeError);
}
