#include "indicators/directional_movement.h"

#include <gtest/gtest.h>

#include <cmath>

#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

DmSeries Dm(const std::vector<Bar>& bars, int N, int M = 14) {
  OscFixture f;
  SetBars(f, bars);
  return DirectionalMovement(f.chart.Bars, N, M);
}

// Steps of 2 up and down, each with its whole range ahead of the close before, so that the
// ratio of each bar is 1 for its side and 0 for the other. 'u' up, 'd' down.
std::vector<Bar> Steps(const std::string& steps) {
  std::vector<Bar> bars;
  float low = 1000;
  for (size_t i = 0; i <= steps.size(); ++i) {
    if (i > 0) low += steps[i - 1] == 'u' ? 2.0f : -2.0f;
    const bool nextUp = i < steps.size() && steps[i] == 'u';
    bars.push_back({low + 2, low, nextUp ? low + 2 : low});
  }
  return bars;
}

// Three up, one down, over and over: over any four bars plus DI is 75, minus DI 25, DX 50.
std::vector<Bar> ConstantDx(int count) {
  std::string steps;
  for (int i = 0; i < count; ++i) steps += i % 4 == 3 ? 'd' : 'u';
  return Steps(steps);
}

}  // namespace

TEST(DirectionalMovementTest, EqualMovesOfBothSidesAreNone) {
  const DmSeries s = Dm({{10, 8, 9}, {11, 7, 9}}, 1);
  EXPECT_EQ(s.rows[1].plusDI, 0);
  EXPECT_EQ(s.rows[1].minusDI, 0);
}

TEST(DirectionalMovementTest, TheLargerMoveAloneCounts) {
  // Up 3, down 1 on a range of 13 - 7 = 6: 50 and nothing.
  const DmSeries s = Dm({{10, 8, 9}, {13, 7, 9}}, 1);
  EXPECT_EQ(s.rows[1].plusDI, 50);
  EXPECT_EQ(s.rows[1].minusDI, 0);
}

TEST(DirectionalMovementTest, ABarWithoutRangeHasTheOneFromTheCloseBefore) {
  // Up 2 on a range of 12 - 9 = 3.
  EXPECT_EQ(Dm({{10, 8, 9}, {12, 12, 12}}, 1).rows[1].plusDI, 66);
  // The same high and low as before are no move, whatever the close was.
  EXPECT_EQ(Dm({{10, 8, 5}, {10, 8, 9}}, 1).rows[1].plusDI, 0);
}

TEST(DirectionalMovementTest, ABarThatDoesNotMoveAtAllIsNothing) {
  EXPECT_EQ(Dm({{9, 9, 9}, {9, 9, 9}}, 1).rows[1].plusDI, 0);
}

TEST(DirectionalMovementTest, RatiosAreAveragedBarByBar) {
  // 1 / 2 and then 8 / 8: the mean is 75%. Summed before division it would be 9 / 10.
  const DmSeries s = Dm({{10, 8, 9}, {11, 9, 11}, {19, 11, 15}}, 2);
  EXPECT_EQ(s.rows[2].plusDI, 75);
}

TEST(DirectionalMovementTest, UntilTheWindowIsFullThereIsNoIndicator) {
  const DmSeries s = Dm(Steps("uuu"), 3);
  EXPECT_EQ(s.rows[1].plusDI, 0);
  EXPECT_EQ(s.rows[2].plusDI, 0);
  EXPECT_EQ(s.rows[3].plusDI, 100);
}

TEST(DirectionalMovementTest, TheDifferenceIsRoundedDownBeforeItLosesItsSign) {
  // 0.5 up, then 1 down, over two: 25 and 50, -33.3, so 34.
  EXPECT_EQ(Dm({{10, 8, 9}, {11, 9, 9}, {9, 7, 8}}, 2).rows[2].DX, 34);
  // Its mirror: 50 and 25, 33.3, so 33.
  EXPECT_EQ(Dm({{10, 8, 9}, {9, 7, 9}, {11, 9, 10}}, 2).rows[2].DX, 33);
}

TEST(DirectionalMovementTest, BothTermsOfAdxCarryTheRest) {
  const DmSeries s = Dm(ConstantDx(60), 4, 14);
  // k = 2 / 15. The seed of 13/15 * 50 = 43.33 at bar 18 is stored nowhere.
  EXPECT_EQ(s.rows[18].DX, 50);
  EXPECT_EQ(s.rows[18].ADX, 0);
  // 13/15 * 50 + 13/15 * 43.33 = 80.9; then 43.33 + 13/15 * 80.89 = 113.4.
  EXPECT_EQ(s.rows[19].ADX, 81);
  EXPECT_EQ(s.rows[20].ADX, 113);
}

TEST(DirectionalMovementTest, AdxOfAConstantDxOf50RisesToward325AndStops) {
  const DmSeries s = Dm(ConstantDx(300), 4, 14);
  for (size_t i = 20; i < s.rows.size(); ++i) EXPECT_GE(s.rows[i].ADX, s.rows[i - 1].ADX);
  EXPECT_EQ(s.rows.back().ADX, 325);  // (1 - k) / k = 6.5
  EXPECT_EQ(s.adxHigh, 325);
  EXPECT_EQ(s.adxLow, 81);
}

TEST(DirectionalMovementTest, ANegativePeriodTakesEachBarAsItIs) {
  const DmSeries s = Dm(Steps("ud"), -1, -1);
  EXPECT_EQ(s.rows[1].plusDI, 100);
  EXPECT_EQ(s.rows[2].minusDI, 100);
  EXPECT_EQ(s.rows[2].DX, 100);
  EXPECT_EQ(s.rows[2].ADX, 0);
}

TEST(DirectionalMovementTest, APeriodOfZeroBecomesTen) {
  OscFixture f;
  SetBars(f, ConstantDx(40));
  ShowDirectionalMovement(f.host);
  EXPECT_EQ(f.Lines('T'),
            std::vector<std::string>{
                "T,8.25,44,313,Directional Movement ( 10 period )    ADX 10 period,27"});
}

TEST(DirectionalMovementTest, FewerBarsThanThePeriodLeaveTheFrame) {
  OscFixture f;
  f.settings.osc[kDMA].daily = 201;
  f.settings.osc[kDMXA].daily = 14;
  SetBars(f, ConstantDx(40));
  ShowDirectionalMovement(f.host);
  EXPECT_EQ(f.script.text(), "B,42,311,630,449,16\r\n");
}

TEST(DirectionalMovementTest, LinesStartBehindTheirWindows) {
  OscFixture f;
  f.settings.osc[kDMA].daily = 4;
  f.settings.osc[kDMXA].daily = 2;
  SetBars(f, ConstantDx(12));
  ShowDirectionalMovement(f.host);
  // Bars 6 to 12. The scale ends at 75: plus at 13, minus at 131 - 25 * 118 / 75.
  const auto plus = Drawn(f, 'H', 38);
  ASSERT_EQ(plus.size(), 7u);
  EXPECT_SEGMENT(plus[0], 52, 13, 54, 13);
  const auto minus = Drawn(f, 'L', 40);
  ASSERT_EQ(minus.size(), 7u);
  EXPECT_SEGMENT(minus[0], 52, 91.66667, 54, 91.66667);
  // k = 2 / 3: seed 16.67, then 16.67 + 5.56 = 22.2 at bar 7, 24.07 at bar 8, then 24.69, ...
  // on a scale from 22 to 25. The first line is the one to bar 8.
  const auto adx = Drawn(f, 'H', 45);
  ASSERT_EQ(adx.size(), 5u);
  EXPECT_SEGMENT(adx[0], 56, 131, 58, 131 - 2 * 118 / 3.0);
  EXPECT_TRUE(Drawn(f, 'L', 38).empty());  // no fill
}

TEST(DirectionalMovementTest, TheFillIsSolidUnderPlusAndDottedOtherwise) {
  OscFixture f;
  f.settings.osc.FillIn = true;
  f.settings.osc[kDMA].daily = 2;
  f.settings.osc[kDMXA].daily = 2;
  SetBars(f, Steps("uuuuuddd"));
  ShowDirectionalMovement(f.host);
  // Bars 4 to 8: 100 and 0 twice, 50 and 50, 0 and 100 twice.
  const auto above = Drawn(f, 'L', 38);
  ASSERT_EQ(above.size(), 2u);
  EXPECT_SEGMENT(above[0], 50, 131, 50, 13);
  const auto below = Drawn(f, 'V', 40);
  ASSERT_EQ(below.size(), 3u);
  EXPECT_SEGMENT(below[0], 54, 72, 54, 72);
  EXPECT_SEGMENT(below[1], 56, 13, 56, 131);
  EXPECT_TRUE(f.panel.Has("line dot 56,13,56,131 40"));
}

TEST(DirectionalMovementTest, RealPricesAgreeWithTheRatiosKeptWhole) {
  OscFixture f;
  if (!SetRealBars(f, "INTC")) GTEST_SKIP() << "no real prices here";
  const int N = 14, M = 14;
  const DmSeries s = DirectionalMovement(f.chart.Bars, N, M);
  std::vector<double> plus{0}, minus{0};
  double adx = 0;
  for (int i = 1; i <= f.chart.Bars.BarCount; ++i) {
    const ChartBar& b = f.chart.Bars[size_t(i)];
    const ChartBar& p = f.chart.Bars[size_t(i) - 1];
    const double up = double(b.High) - p.High, down = double(p.Low) - b.Low;
    const double range = std::fmax(b.High, p.Close) - double(std::fmin(b.Low, p.Close));
    plus.push_back(up > std::fmax(down, 0) && range > 0 ? up / range : 0);
    minus.push_back(down > std::fmax(up, 0) && range > 0 ? down / range : 0);
    if (i < N) continue;
    double sums[2] = {0, 0};
    for (int j = i - N + 1; j <= i; ++j) {
      sums[0] += plus[size_t(j)];
      sums[1] += minus[size_t(j)];
    }
    const DmSeries::Row& row = s.rows[size_t(i)];
    ASSERT_EQ(row.plusDI, int(std::floor(sums[0] / N * 100))) << "bar " << i;
    ASSERT_EQ(row.minusDI, int(std::floor(sums[1] / N * 100))) << "bar " << i;
    if (i == N + M) {
      for (int j = N + 1; j <= N + M; ++j) adx += 13.0 / 15 * s.rows[size_t(j)].DX / M;
    } else if (i > N + M) {
      adx = (row.DX + adx) * 13 / 15;
      ASSERT_NEAR(row.ADX, adx, 0.5 + 1e-6) << "bar " << i;
    }
  }
}
