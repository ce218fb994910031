#include "indicators/elder_ray.h"

#include <gtest/gtest.h>

#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

// The average stands at 10 throughout. Over two bars: Bull 3 and 2, Bear -1 and -4.
const std::vector<Bar> kFour{{11, 9, 10}, {12, 8, 10}, {13, 9, 10}, {12, 6, 10}};

}  // namespace

TEST(ElderRayTest, RaysStartABarBehindTheAverage) {
  OscFixture f;
  SetBars(f, kFour);
  const ElderRaySeries s = ElderRay(f.chart.Bars, 2, kShare);
  EXPECT_EQ(s.ema, (std::vector<float>{0, 10, 10, 10}));
  EXPECT_EQ(s.bull, (std::vector<float>{0, 0, 3, 2}));
  EXPECT_EQ(s.bear, (std::vector<float>{0, 0, -1, -4}));
}

TEST(ElderRayTest, EachRangeIsMadeSymmetricByItself) {
  OscFixture f;
  SetBars(f, kFour);
  const ElderRaySeries s = ElderRay(f.chart.Bars, 2, kShare);
  EXPECT_EQ(s.bullHigh, 3);
  EXPECT_EQ(s.bullLow, -3);
  EXPECT_EQ(s.bearHigh, 4);
  EXPECT_EQ(s.bearLow, -4);
}

TEST(ElderRayTest, RecordsWithoutARangeUseTheClose) {
  OscFixture f;
  SetBars(f, {{0, 0, 10}, {0, 0, 20}, {0, 0, 30}});
  for (const RecTypeValue recType : {kCloseVolume, kCloseOnly, kAdvanceDecline}) {
    const ElderRaySeries s = ElderRay(f.chart.Bars, 2, recType);
    // 15, then 30 * 2/3 + 15 / 3 = 25.
    EXPECT_FLOAT_EQ(s.bull[2], 5);
    EXPECT_FLOAT_EQ(s.bear[2], 5);
  }
  EXPECT_FLOAT_EQ(ElderRay(f.chart.Bars, 2, kIndex).bull[2], -25);
}

TEST(ElderRayTest, TitleAndZeroLines) {
  OscFixture f;
  f.settings.osc[kERA].daily = 2;
  SetBars(f, kFour);
  ShowElderRay(f.host);
  // 138 * 0.3 = 41.4 and 138 * 0.75 = 103.5, half to even.
  EXPECT_EQ(f.Lines('T'),
            (std::vector<std::string>{"T,8.25,44,313,Elder Ray ( 2  Period )  ,27",
                                      "T,8.25,22,343,0.0,27", "T,8.25,22,406,0.0,27",
                                      "T,8.25,43,343,Bull,27", "T,8.25,43,406,Bear,27"}));
  const auto zero = Drawn(f, 'L', 16);
  ASSERT_EQ(zero.size(), 2u);
  EXPECT_SEGMENT(zero[0], 42, 41, 630, 41);
  EXPECT_SEGMENT(zero[1], 42, 104, 630, 104);
}

TEST(ElderRayTest, RaysStandOnTheirZeroLines) {
  OscFixture f;
  f.settings.osc[kERA].daily = 2;
  SetBars(f, kFour);
  ShowElderRay(f.host);
  // 69 units hold 6 of Bull and 8 of Bear.
  const auto bull = Drawn(f, 'L', 38);
  ASSERT_EQ(bull.size(), 2u);
  EXPECT_SEGMENT(bull[0], 46, 41, 46, 6.5);
  EXPECT_SEGMENT(bull[1], 48, 41, 48, 18);
  const auto bear = Drawn(f, 'L', 40);
  ASSERT_EQ(bear.size(), 2u);
  EXPECT_SEGMENT(bear[0], 46, 104, 46, 112.625);
  EXPECT_SEGMENT(bear[1], 48, 104, 48, 138.5);
}

TEST(ElderRayTest, NoRaysAtAllKeepTheStartingRangesAndShowTheEmptyPanel) {
  OscFixture f;
  f.settings.osc[kERA].daily = 200;
  SetBars(f, kFour);
  ShowElderRay(f.host);
  EXPECT_EQ(f.Lines('L').size(), 2u);
  EXPECT_EQ(f.Lines('T').size(), 5u);
}

TEST(ElderRayTest, ARangeOfZeroOnEitherSideLeavesTheFrame) {
  OscFixture f;
  f.settings.osc[kERA].daily = 2;
  SetBars(f, {{10, 9, 10}, {10, 9, 10}, {10, 9, 10}});  // no Bull
  ShowElderRay(f.host);
  EXPECT_EQ(f.script.text(), "B,42,311,630,449,16\r\n");
}

TEST(ElderRayTest, RealPricesAgreeWithTheAverageWrittenOut) {
  OscFixture f;
  if (!SetRealBars(f, "ORCL")) GTEST_SKIP() << "no real prices here";
  const int P = 14;
  const ElderRaySeries s = ElderRay(f.chart.Bars, P, kShare);
  double ema = 0;
  for (int i = 0; i <= f.chart.Bars.BarCount; ++i) {
    const ChartBar& bar = f.chart.Bars[size_t(i)];
    if (i < P) {
      ema += double(bar.Close) / P;
      continue;
    }
    ema += (bar.Close - ema) * 2 / (P + 1.0);
    ASSERT_NEAR(s.bull[size_t(i)], bar.High - ema, 1e-3) << "bar " << i;
    ASSERT_NEAR(s.bear[size_t(i)], bar.Low - ema, 1e-3) << "bar " << i;
  }
}
