#include "indicators/parabolic.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

ParabolicTrail Trail(const std::vector<HighLow>& bars) { return Parabolic(bars); }

// Four new highs. The stop: 9, 9.04, 9.1584 (0.04 of 12 - 9.04), 9.388896 (0.06 of 13 - ...).
const std::vector<HighLow> kRise{{10, 9}, {11, 10}, {12, 11}, {13, 12}};

std::vector<HighLow> RiseThen(std::initializer_list<HighLow> more) {
  std::vector<HighLow> bars = kRise;
  bars.insert(bars.end(), more);
  return bars;
}

// A price picture that keeps the widths of its pen.
struct WidthSurface : RecordingSurface {
  using RecordingSurface::RecordingSurface;
  std::vector<double> widths;
  void SetDrawWidth(double width) override { widths.push_back(width); }
};

void SetHighLows(OscFixture& f, const std::vector<HighLow>& prices) {
  std::vector<Bar> bars;
  for (const HighLow& p : prices) bars.push_back({p.high, p.low, p.low});
  SetBars(f, bars);
}

}  // namespace

TEST(ParabolicTest, FewerThanFourNewHighsOrLowsGiveNoTrend) {
  EXPECT_EQ(Trail({{10, 9}, {11, 10}, {12, 11}}).trend, 'N');
  EXPECT_EQ(Trail({{10, 9}, {9, 8}, {8, 7}}).trend, 'N');
  EXPECT_EQ(Trail({{10, 9}, {10, 9}, {10, 9}, {10, 9}, {10, 9}}).trend, 'N');
  EXPECT_EQ(Trail({}).trend, 'N');
}

TEST(ParabolicTest, BarZeroCountsForBothSides) {
  const ParabolicTrail up = Trail(kRise);
  EXPECT_EQ(up.trend, 'U');
  EXPECT_EQ(up.startBar, 0);  // the last new low
  EXPECT_EQ(up.startStop, 9);
  const ParabolicTrail down = Trail({{20, 19}, {19, 18}, {18, 17}, {17, 16}});
  EXPECT_EQ(down.trend, 'D');
  EXPECT_EQ(down.startBar, 0);
  EXPECT_EQ(down.startStop, 20);
}

TEST(ParabolicTest, ABarWithBothANewHighAndANewLowIsADownBar) {
  // The second low clears the highs; three more are not enough, the fourth is.
  std::vector<HighLow> bars{{10, 9}, {11, 8}, {12, 9}, {13, 10}, {14, 11}};
  EXPECT_EQ(Trail(bars).trend, 'N');
  bars.push_back({15, 12});
  EXPECT_EQ(Trail(bars).trend, 'U');
  EXPECT_EQ(Trail(bars).startBar, 1);
  EXPECT_EQ(Trail(bars).startStop, 8);
}

TEST(ParabolicTest, TheStopMovesTowardTheBarsHighAndNotTheExtreme) {
  const ParabolicTrail t = Trail(RiseThen({{12.5f, 12}}));
  EXPECT_NEAR(t.steps[1].stop, 9.04, 1e-5);
  EXPECT_NEAR(t.steps[2].stop, 9.1584, 1e-5);
  EXPECT_NEAR(t.steps[3].stop, 9.388896, 1e-5);
  // 0.08 of 12.5 - 9.388896; toward 13 it would be 9.6778.
  EXPECT_NEAR(t.steps[4].stop, 9.637784, 1e-5);
  for (size_t i = 1; i < 5; ++i) EXPECT_TRUE(t.steps[i].point) << i;
}

TEST(ParabolicTest, TheFactorStopsAt20BecauseTheNinthSumFallsUnder18In32Bits) {
  std::vector<HighLow> bars;
  for (int i = 0; i < 14; ++i)
    bars.push_back({100.0f + 10.0f * float(i), 99.0f + 10.0f * float(i)});
  const ParabolicTrail t = Trail(bars);
  const auto factor = [&](size_t i) {
    const double before = i == 1 ? t.startStop : t.steps[i - 1].stop;
    return (t.steps[i].stop - before) / (bars[i].high - before);
  };
  EXPECT_NEAR(factor(1), 0.02, 1e-5);
  EXPECT_NEAR(factor(8), 0.16, 1e-5);
  EXPECT_NEAR(factor(9), 0.18, 1e-5);
  EXPECT_NEAR(factor(10), 0.20, 1e-5);
  EXPECT_NEAR(factor(11), 0.20, 1e-5);
  EXPECT_NEAR(factor(13), 0.20, 1e-5);
}

TEST(ParabolicTest, AReversalByTheFirstTestDrawsTheNewStop) {
  const ParabolicTrail t = Trail(RiseThen({{8, 7}, {8, 7.5f}}));
  EXPECT_EQ(t.steps[4].trend, 'D');
  EXPECT_EQ(t.steps[4].stop, 13);  // the highest high
  EXPECT_TRUE(t.steps[4].point);
  EXPECT_NEAR(t.steps[5].stop, 12.89, 1e-5);  // 0.02 of 7.5 - 13
  EXPECT_TRUE(t.steps[5].point);
}

TEST(ParabolicTest, AStopAboveTheLowIsMovedBackTowardTheLowerOfTwoLows) {
  const ParabolicTrail t = Trail(RiseThen({{14, 9}, {14, 9.5f}}));
  // 9.388896 + 0.08 * (14 - ...) = 9.757785; then 0.08 of 9 - 9.757785.
  EXPECT_NEAR(t.steps[4].stop, 9.697162, 1e-5);
  EXPECT_TRUE(t.steps[4].point);
  // 9.697162 + 0.1 * (14 - ...) = 10.127446; its own low is not below 9: 0.1 of 9 - 10.127446.
  EXPECT_NEAR(t.steps[5].stop, 10.014701, 1e-5);
}

TEST(ParabolicTest, AReversalByTheTestAfterTheStepDrawsNoPoint) {
  const ParabolicTrail t = Trail(RiseThen({{9.5f, 5}, {6, 5}}));
  // 9.397784, moved back to 9.045961: below the 9.388896 of the bar before.
  EXPECT_EQ(t.steps[4].trend, 'D');
  EXPECT_EQ(t.steps[4].stop, 13);
  EXPECT_FALSE(t.steps[4].point);
  EXPECT_NEAR(t.steps[5].stop, 12.84, 1e-5);  // 0.02 of 5 - 13
  EXPECT_TRUE(t.steps[5].point);
}

TEST(ParabolicTest, TheFallIsTheMirrorOfTheRise) {
  // Prices of 30 less the rising ones: every stop is 30 less its like.
  const std::vector<HighLow> bars =
      RiseThen({{14, 9}, {14, 9.5f}, {11, 5}, {8, 7}, {8, 7.5f}, {16, 14}, {17, 15}});
  std::vector<HighLow> mirror;
  for (const HighLow& b : bars) mirror.push_back({30 - b.low, 30 - b.high});
  const ParabolicTrail up = Trail(bars), down = Trail(mirror);
  ASSERT_EQ(up.trend, 'U');
  ASSERT_EQ(down.trend, 'D');
  for (size_t i = 1; i < bars.size(); ++i) {
    EXPECT_NEAR(down.steps[i].stop, 30 - up.steps[i].stop, 1e-4) << i;
    EXPECT_EQ(down.steps[i].point, up.steps[i].point) << i;
    EXPECT_EQ(down.steps[i].trend, up.steps[i].trend == 'U' ? 'D' : 'U') << i;
  }
}

TEST(ParabolicTest, PointsHaveAColourOfTheirOwnInTheScript) {
  OscFixture f;
  SetPriceMap(f, 0.1f);
  SetHighLows(f, RiseThen({{8, 7}}));
  ShowParabolic(f.host);
  // 290 - 90.4, 290 - 91.584, 290 - 93.889, and after the turn 290 - 130.
  EXPECT_EQ(f.Lines('K'),
            (std::vector<std::string>{"K,44,200,45", "K,46,198,45", "K,48,196,45", "K,50,160,46"}));
  EXPECT_TRUE(f.price.Has("point 44,200 38"));
  EXPECT_TRUE(f.price.Has("point 50,160 40"));
  EXPECT_TRUE(f.panel.ops.empty());
}

TEST(ParabolicTest, TheLastStopIsPrintedAtTheRightEdge) {
  OscFixture f;
  SetPriceMap(f, 0.1f);
  SetHighLows(f, kRise);
  ShowParabolic(f.host);
  const std::string text = "Parabolic last stop : 9.39";
  const double x = 630 - f.price.TextWidth(text);
  EXPECT_EQ(f.Lines('T'), std::vector<std::string>{"T,8.25," + Str(x) + ",50," + text + ",27"});
}

TEST(ParabolicTest, AStopUnder20CentsHasThreeDecimals) {
  OscFixture f;
  SetPriceMap(f, 0.001f);
  SetHighLows(f, {{0.10f, 0.09f}, {0.11f, 0.10f}, {0.12f, 0.11f}, {0.13f, 0.12f}});
  ShowParabolic(f.host);
  EXPECT_NE(f.Lines('T').at(0).find("Parabolic last stop : 0.094,"), std::string::npos);
}

TEST(ParabolicTest, AYOfZeroAndAStopBelowZeroAreNotPlotted) {
  OscFixture f;
  SetPriceMap(f, 0.1f, 90);  // 9.04 stands at 90 - 90.4
  SetHighLows(f, kRise);
  ShowParabolic(f.host);
  EXPECT_EQ(f.Lines('K').size(), 2u);

  OscFixture g;
  SetPriceMap(g, 0.1f);
  SetHighLows(g, {{-1, -2}, {-2, -3}, {-3, -4}, {-4, -5}, {-5, -6}});
  ShowParabolic(g.host);
  EXPECT_TRUE(g.Lines('K').empty());
  EXPECT_TRUE(g.dialogs.said.empty());
}

TEST(ParabolicTest, PointsAreTwoWideUntilTheEndWhateverEndsIt) {
  for (const float perY : {0.1f, 0.00001f}) {
    OscFixture f;
    WidthSurface price(638, 308);
    OscHost host{f.home.files(), f.dialogs, f.settings, f.colours, f.request,
                 f.chart,        price,     f.panel,    &f.script};
    SetPriceMap(f, perY);
    SetHighLows(f, kRise);
    ShowParabolic(host);
    EXPECT_EQ(price.widths, (std::vector<double>{2, 1}));
    EXPECT_EQ(f.dialogs.said.size(), perY == 0.1f ? 0u : 1u);
  }
}

TEST(ParabolicTest, NoTrendLeavesScriptAndPictureAlone) {
  OscFixture f;
  SetPriceMap(f, 0.1f);
  f.Closes({1, 1, 1, 1, 1});
  ShowParabolic(f.host);
  EXPECT_EQ(f.script.text(), "");
  EXPECT_TRUE(f.price.ops.empty());
}

TEST(ParabolicTest, RealPricesAgreeWithTheRuleWrittenAsOneLoop) {
  OscFixture f;
  if (!SetRealBars(f, "ORCL")) GTEST_SKIP() << "no real prices here";
  std::vector<HighLow> bars;
  for (const ChartBar& bar : f.chart.Bars.bars) bars.push_back({bar.High, bar.Low});
  const ParabolicTrail t = Parabolic(bars);
  ASSERT_NE(t.trend, 'N');
  // Signed prices: with s = -1 a fall is a rise, so that one branch does for both.
  int s = t.trend == 'U' ? 1 : -1;
  float stop = t.startStop, before = stop, factor = 0;
  float extreme = stop;
  int points = 0;
  for (size_t i = size_t(t.startBar) + 1; i < bars.size(); ++i) {
    const auto far = [&](const HighLow& b) { return s > 0 ? b.high : b.low; };
    const auto near = [&](const HighLow& b) { return s > 0 ? b.low : b.high; };
    const auto above = [&](float a, float b) { return s > 0 ? a > b : a < b; };
    bool point = true, turn = false;
    if (above(stop, far(bars[i]))) {
      turn = true;
    } else {
      if (above(far(bars[i]), extreme)) extreme = far(bars[i]);
      if (factor < 0.18) factor = float(factor + 0.02);
      stop = float((double(far(bars[i])) - stop) * factor + stop);
      if (above(stop, near(bars[i]))) {
        const float back =
            above(near(bars[i - 1]), near(bars[i])) ? near(bars[i]) : near(bars[i - 1]);
        stop = float((double(back) - stop) * factor + stop);
        if (above(before, stop)) {
          turn = true;
          point = false;
        }
      }
    }
    if (turn) {
      s = -s;
      stop = extreme;
      factor = 0;
    }
    ASSERT_EQ(t.steps[i].stop, stop) << "bar " << i;
    ASSERT_EQ(t.steps[i].trend, s > 0 ? 'U' : 'D') << "bar " << i;
    ASSERT_EQ(t.steps[i].point, point) << "bar " << i;
    points += point;
    before = stop;
  }
  EXPECT_GT(points, 1000);
}

TEST(ParabolicOnAverageTest, StartsWithThe21stCloseAndIsNotRounded) {
  OscFixture f;
  f.chart.CloseY.assign(21, 100);
  for (int i = 0; i < 3; ++i) f.chart.CloseY.push_back(121);  // averages 101, 102, 103
  ShowParabolicOnAverage(f.host);
  const auto lines = f.Lines('K');
  ASSERT_EQ(lines.size(), 3u);
  // From 100 at bar 20: 0.02 of 1, 0.04 of 1.98, 0.06 of 2.9008.
  const double stops[] = {100.02, 100.0992, 100.273248};
  for (size_t i = 0; i < 3; ++i) {
    const auto n = Numbers(lines[i]);
    EXPECT_EQ(n[0], 84 + 2 * double(i));
    EXPECT_NEAR(n[1], stops[i], 1e-4);
    EXPECT_EQ(n[2], 45);
  }
  EXPECT_TRUE(f.Lines('T').empty());
}

TEST(ParabolicOnAverageTest, TheAverageIsRoundedHalfToEven) {
  OscFixture f;
  // 100, then 100.48, 100.95, 101.43, 101.90, 102.38 are 100, 101, 101, 102, 102.
  f.chart.CloseY.assign(21, 100);
  for (int i = 0; i < 5; ++i) f.chart.CloseY.push_back(110);
  ShowParabolicOnAverage(f.host);
  EXPECT_TRUE(f.Lines('K').empty());  // three new highs
  f.chart.CloseY.push_back(110);      // 102.86 is 103: the fourth
  ShowParabolicOnAverage(f.host);
  EXPECT_EQ(f.Lines('K').size(), 6u);
}

TEST(ParabolicOnAverageTest, FewerThan21ClosesDrawNothing) {
  OscFixture f;
  f.chart.CloseY.assign(20, 100);
  ShowParabolicOnAverage(f.host);
  f.chart.CloseY.clear();
  ShowParabolicOnAverage(f.host);
  EXPECT_EQ(f.script.text(), "");
  EXPECT_TRUE(f.price.ops.empty());
}
