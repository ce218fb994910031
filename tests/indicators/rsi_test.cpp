#include "indicators/rsi.h"

#include <gtest/gtest.h>

#include <limits>

#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

double Rsi(const std::vector<float>& closes, int i, int period) {
  OscFixture f;
  f.Closes(closes);
  return RsiAt(f.chart.Bars, i, period);
}

}  // namespace

TEST(RsiTest, TheBarsOwnCloseTakesNoPart) {
  // One pair, 10 to 11: G = 1 / 2, L = 1, 100 - 100 / 1.5.
  EXPECT_NEAR(Rsi({10, 11, 50}, 2, 2), 33.33333, 1e-4);
  EXPECT_NEAR(Rsi({10, 11, 1}, 2, 2), 33.33333, 1e-4);
}

TEST(RsiTest, OnePairLessThanThePeriodIsDividedByThePeriod) {
  // Rises of 1 and 1: G = 2 / 3, L = 1, 100 - 100 / (5 / 3). Over two it would be 50.
  EXPECT_NEAR(Rsi({10, 11, 12, 12}, 3, 3), 40, 1e-6);
}

TEST(RsiTest, GainsAndLossesAreSetAgainstEachOther) {
  // +2 and -1: RS = 2.
  EXPECT_NEAR(Rsi({10, 12, 11, 11}, 3, 3), 66.66667, 1e-4);
}

TEST(RsiTest, ASteadyRiseShowsAsALowFigure) {
  // Thirteen rises of 0.02: G = 0.26 / 14 = 0.0185714, 100 * G / (1 + G) = 1.8233.
  std::vector<float> closes;
  for (int i = 0; i < 15; ++i) closes.push_back(1.0f + 0.02f * float(i));
  EXPECT_NEAR(Rsi(closes, 14, 14), 1.8233, 1e-3);
}

TEST(RsiTest, APairThatBeginsWithAnEmptyBarIsPassedOver) {
  // +5, then a fall of 10 to the empty bar; the way out of it is no rise. RS = 5 / 10.
  EXPECT_NEAR(Rsi({5, 10, 0, 20, 20}, 4, 4), 33.33333, 1e-4);
}

TEST(RsiTest, EqualClosesAndTheBarBeforeTheWindowAreNothing) {
  EXPECT_EQ(Rsi({10, 10, 10, 10}, 3, 3), 0);
  EXPECT_EQ(Rsi({10, 11, 12, 13}, 2, 3), 0);  // i = P - 1
}

TEST(RsiTest, ThePlacesOfTitleAndGuides) {
  OscFixture f;
  f.settings.osc[kRsiP].daily = 14;
  f.Closes({1, 2, 3});
  ShowRSI(f.host);
  // Height 118 from 13 on: 48.4, 95.6, 72. Labels are 22 wide.
  EXPECT_EQ(f.Lines('L'), (std::vector<std::string>{"L,42,356,630,356,16", "L,42,404,630,404,16",
                                                    "L,42,380,630,380,16"}));
  EXPECT_EQ(f.Lines('T'),
            (std::vector<std::string>{
                "T,8.25,44,313,Relative Strength Index Oscillator (14 Period),27",
                "T,8.25,15,350,70%,27", "T,8.25,15,398,30%,27", "T,8.25,15,374,50%,27"}));
  EXPECT_EQ(f.Lines('B'), std::vector<std::string>{"B,42,311,630,449,16"});
}

TEST(RsiTest, TheFirstThreeValuesHaveNoLine) {
  OscFixture f;
  f.settings.osc[kRsiP].daily = 2;
  f.Closes({10, 11, 12, 11, 10});
  ShowRSI(f.host);
  // Values 0, 33.3, 33.3 and 0 at bars 1 to 4; the line is the one to the fourth.
  const auto lines = Drawn(f, 'H', 45);
  ASSERT_EQ(lines.size(), 1u);
  EXPECT_SEGMENT(lines[0], 48, 131 - 33.33333 * 1.18, 50, 131);
}

TEST(RsiTest, WeeklyChartsReadTheTwin) {
  OscFixture f;
  f.settings.osc[kRsiP] = {14, 9};
  f.request.ChartPeriod = Period::kWeekly;
  f.Closes({1, 2, 3});
  ShowRSI(f.host);
  EXPECT_EQ(f.Lines('T')[0], "T,8.25,44,313,Relative Strength Index Oscillator (9 Period),27");
}

TEST(RsiTest, APriceWithoutBoundsEndsInTheMessage) {
  OscFixture f;
  f.settings.osc[kRsiP].daily = 3;
  const float inf = std::numeric_limits<float>::infinity();
  f.Closes({10, inf, 10, 10, 10});
  ShowRSI(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "Chart Display");
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
}

TEST(RsiTest, RealPricesAgreeWithRunningSums) {
  OscFixture f;
  if (!SetRealBars(f, "AAPL")) GTEST_SKIP() << "no real prices here";
  const int P = 14;
  // up[n] and down[n]: all moves up to the one that ends at bar n.
  std::vector<double> up{0}, down{0};
  for (int i = 1; i <= f.chart.Bars.BarCount; ++i) {
    const double move = double(f.chart.Bars[size_t(i)].Close) - f.chart.Bars[size_t(i) - 1].Close;
    up.push_back(up.back() + (move > 0 ? move : 0));
    down.push_back(down.back() + (move < 0 ? -move : 0));
    if (i < P) continue;
    const double gain = (up[size_t(i) - 1] - up[size_t(i - P)]) / P;
    const double loss = (down[size_t(i) - 1] - down[size_t(i - P)]) / P;
    const double expected = 100 * gain / (gain + (loss < 1e-9 ? 1 : loss));
    ASSERT_NEAR(RsiAt(f.chart.Bars, i, P), expected, 1e-4) << "bar " << i;
  }
}
