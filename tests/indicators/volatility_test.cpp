#include "indicators/volatility.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

// 20%, no range, 30%, an empty bar.
const std::vector<Bar> kFour{{11, 9, 10}, {10, 10, 10}, {12, 9, 10}, {0, 0, 0}};

}  // namespace

TEST(VolatilityTest, ABarWithoutRangeIsOneAndJoinsNoRange) {
  OscFixture f;
  SetBars(f, kFour);
  const VolatilitySeries s = Volatility(f.chart.Bars, 2);
  EXPECT_FLOAT_EQ(s.rows[0].value, 20);
  EXPECT_FLOAT_EQ(s.rows[1].value, 1);
  EXPECT_FLOAT_EQ(s.rows[2].value, 30);
  EXPECT_FLOAT_EQ(s.lowest, 20);
  EXPECT_FLOAT_EQ(s.highest, 30);
}

TEST(VolatilityTest, AZeroCloseRepeatsTheValueBefore) {
  OscFixture f;
  SetBars(f, kFour);
  EXPECT_FLOAT_EQ(Volatility(f.chart.Bars, 2).rows[3].value, 30);
  SetBars(f, {{11, 9, 10}, {5, 1, -2}});  // nor is a negative one divided by
  EXPECT_FLOAT_EQ(Volatility(f.chart.Bars, 2).rows[1].value, 20);
}

TEST(VolatilityTest, ABarWhoseRangeIsNoNumberRepeatsTheValueBefore) {
  OscFixture f;
  SetBars(f, {{11, 9, 10}, {std::numeric_limits<float>::infinity(), 1, 2}, {NAN, 1, 2}});
  const VolatilitySeries s = Volatility(f.chart.Bars, 2);
  EXPECT_FLOAT_EQ(s.rows[1].value, 20);
  EXPECT_FLOAT_EQ(s.rows[2].value, 20);
}

TEST(VolatilityTest, TheFirstBarWithoutRangeHasNoValue) {
  OscFixture f;
  SetBars(f, {{10, 10, 10}, {10, 10, 10}, {11, 9, 10}});
  const VolatilitySeries s = Volatility(f.chart.Bars, 2);
  EXPECT_EQ(s.rows[0].value, 0);
  EXPECT_EQ(s.rows[1].value, 1);
  EXPECT_EQ(s.rows[1].average, 0);            // one value so far
  EXPECT_FLOAT_EQ(s.rows[2].average, 10.5f);  // 1 and 20
}

TEST(VolatilityTest, TheAverageEndsAtItsBar) {
  OscFixture f;
  SetBars(f, kFour);
  const VolatilitySeries s = Volatility(f.chart.Bars, 2);
  EXPECT_EQ(s.rows[0].average, 0);
  EXPECT_FLOAT_EQ(s.rows[1].average, 10.5f);
  EXPECT_FLOAT_EQ(s.rows[2].average, 15.5f);
  EXPECT_FLOAT_EQ(s.rows[3].average, 30);
}

TEST(VolatilityTest, BarsStandOnTheBaseAndAveragesMayLeaveThePanel) {
  OscFixture f;
  f.settings.osc[kVtyD].daily = 2;
  SetBars(f, kFour);
  ShowVolatility(f.host);
  // 10% to 118 units from 131 up: 20 lies on the base, 30 at 13; 1 would lie below: no bar.
  const auto bars = Drawn(f, 'H', 37);
  ASSERT_EQ(bars.size(), 3u);
  EXPECT_SEGMENT(bars[0], 42, 131, 42, 131);
  EXPECT_SEGMENT(bars[1], 46, 131, 46, 13);
  EXPECT_SEGMENT(bars[2], 48, 131, 48, 13);
  // 10.5: 131 + 9.5 * 11.8; 15.5: 131 + 4.5 * 11.8.
  const auto average = Drawn(f, 'L', 39);
  ASSERT_EQ(average.size(), 2u);
  EXPECT_SEGMENT(average[0], 44, 243.1, 46, 184.1);
  EXPECT_SEGMENT(average[1], 46, 184.1, 48, 13);
}

TEST(VolatilityTest, GuidesArePlacesOnThePanelAndNoValues) {
  OscFixture f;
  f.settings.osc[kVtyD].daily = 3;
  SetBars(f, kFour);
  ShowVolatility(f.host);
  // 36.6, 107.4 and 72, though the values run from 20 to 30.
  EXPECT_EQ(f.Lines('T'), (std::vector<std::string>{"T,8.25,44,313,Volatility (3 Period),27",
                                                    "T,8.25,15,339,80%,27", "T,8.25,15,409,20%,27",
                                                    "T,8.25,15,374,50%,27"}));
  const auto guides = Drawn(f, 'L', 16);
  ASSERT_EQ(guides.size(), 3u);
  EXPECT_SEGMENT(guides[0], 42, 37, 630, 37);
  EXPECT_SEGMENT(guides[1], 42, 107, 630, 107);
  EXPECT_SEGMENT(guides[2], 42, 72, 630, 72);
}

TEST(VolatilityTest, ASecurityWithoutAnyRangeStandsAtHalfHeight) {
  OscFixture f;
  f.settings.osc[kVtyD].daily = 3;
  f.Closes({5, 5, 6});
  ShowVolatility(f.host);
  // Nothing joined the range, which stays 100000 down to -100000: 131 - 99999 * 118 / 200000.
  const auto bars = Drawn(f, 'H', 37);
  ASSERT_EQ(bars.size(), 2u);
  EXPECT_SEGMENT(bars[0], 44, 131, 44, 131 - 99999 * 118 / 200000.0);
}

TEST(VolatilityTest, OneValueThroughoutLeavesTheFrame) {
  OscFixture f;
  f.settings.osc[kVtyD].daily = 1;
  SetBars(f, {{11, 9, 10}, {11, 9, 10}, {11, 9, 10}});
  ShowVolatility(f.host);
  EXPECT_EQ(f.Lines('B').size(), 1u);
  EXPECT_EQ(f.Lines('L').size(), 3u);  // guides
  EXPECT_TRUE(f.Lines('H').empty());
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(VolatilityTest, RealPricesAgreeWithRunningSums) {
  OscFixture f;
  if (!SetRealBars(f, "ORCL")) GTEST_SKIP() << "no real prices here";
  const int P = 3;
  const VolatilitySeries s = Volatility(f.chart.Bars, P);
  std::vector<double> sum{0};
  for (size_t i = 0; i < s.rows.size(); ++i) {
    const ChartBar& bar = f.chart.Bars[i];
    double v = 100 * (1.0 * bar.High - bar.Low) / bar.Close;
    if (v == 0) v = 1;
    sum.push_back(sum.back() + v);
    ASSERT_NEAR(s.rows[i].value, v, 1e-4) << "bar " << i;
    if (i + 1 >= size_t(P)) {
      ASSERT_NEAR(s.rows[i].average, (sum[i + 1] - sum[i + 1 - P]) / P, 1e-4) << "bar " << i;
    }
  }
}
