#include "indicators/williams.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>

#include "tests/indicators/osc_fixture.h"

using namespace kora;
using kora::test::OscFixture;

using Texts = std::vector<std::string>;

namespace {

// In a panel of 144 (3 to 141) W of 0 stands at 13 and each percent is 1.18 units. The script's
// y is 308 more.
struct Williams : OscFixture {
  explicit Williams(std::int16_t P) {
    host.OscCode = "WMS";
    settings.osc[kWmsA].daily = P;
  }
  // Bars with a high of 20 and a low of 10.
  void Between(const std::vector<float>& closes) {
    for (const float close : closes) {
      ChartBar bar{};
      bar.High = 20;
      bar.Low = 10;
      bar.Close = close;
      AddBar(bar);
    }
  }
};

std::vector<float> ValuesOf(const std::vector<WilliamsPoint>& series) {
  std::vector<float> out;
  for (const WilliamsPoint& p : series) out.push_back(p.W);
  return out;
}

}  // namespace

TEST(WilliamsTest, PositiveFormIsZeroAtTheHighAndHundredAtTheLow) {
  Williams f(1);
  f.Between({15, 20, 10, 15, 17.5f});
  EXPECT_EQ(ValuesOf(WilliamsSeries(f.chart.Bars, kShare, 1)),
            (std::vector<float>{0, 100, 50, 25}));
}

TEST(WilliamsTest, FirstValueIsThatOfBarPOverBarsOneToP) {
  Williams f(3);
  f.Closes({1000, 10, 20, 15, 18});
  const auto series = WilliamsSeries(f.chart.Bars, kShare, 3);
  ASSERT_EQ(series.size(), 2u);
  EXPECT_EQ(series[0].Bar, 3);
  EXPECT_EQ(series[0].W, 50);  // (20 - 15) / (20 - 10): bar 0 is not in
}

TEST(WilliamsTest, PanelByHandDrawsTheMeanOfThreeFromItsFourthPoint) {
  Williams f(1);
  f.Between({15, 20, 10, 15, 20, 15, 10, 20});
  ShowWilliams(f.host);
  // y of bars 1 to 7: 13, 131, 72, 13, 72, 131, 13. Means of three from bar 3: 72, 72, 52.3,
  // 72, 72; the fourth is bar 6's. Guides at 24.8 and 119.2; "O/B" is (778 + 278 + 667) * 11 /
  // 1000 = 19 wide, and so is "O/S".
  EXPECT_EQ(f.script.text(),
            "B,42,311,630,449,16\r\n"
            "T,8.25,44,313,Williams %R Oscillator (1 Period),27\r\n"
            "L,42,333,630,333,16\r\nT,8.25,18,327,O/B,27\r\n"
            "L,42,427,630,427,16\r\nT,8.25,18,421,O/S,27\r\n"
            "H,52,360,54,380,45\r\nH,54,380,56,380,45\r\n");
  EXPECT_TRUE(f.panel.Has("line solid 52,52,54,72 45"));
}

TEST(WilliamsTest, ZeroHighOrLowDoesNotCountAndNoCloseStandsInForIt) {
  OscFixture f;
  ChartBar bar{};
  f.AddBar(bar);
  bar.High = 20;
  bar.Low = 0;
  bar.Close = 5;
  f.AddBar(bar);
  bar.High = 0;
  bar.Low = 10;
  bar.Close = 15;
  f.AddBar(bar);
  const auto series = WilliamsSeries(f.chart.Bars, kShare, 2);
  ASSERT_EQ(series.size(), 1u);
  EXPECT_EQ(series[0].W, 50);  // (20 - 15) / (20 - 10)
}

TEST(WilliamsTest, SecuritiesWithoutARangeStandWithTheirCloses) {
  Williams f(2);
  f.Between({15, 12, 14, 0, 12});
  for (const std::int16_t type : {kCloseVolume, kCloseOnly, kAdvanceDecline}) {
    const auto series = WilliamsSeries(f.chart.Bars, type, 2);
    // Bar 2: 12 to 14, close 14. Bars 3 and 4 have one close that counts: no range.
    ASSERT_EQ(series.size(), 1u);
    EXPECT_EQ(series[0].Bar, 2);
    EXPECT_EQ(series[0].W, 0);
  }
}

TEST(WilliamsTest, BarWithoutARangeIsPassedOverAndTheLineSpansIt) {
  Williams f(1);
  f.Between({15, 20, 10, 15, 20, 15});
  ChartBar flat{};
  flat.High = flat.Low = flat.Close = 15;
  f.AddBar(flat);
  f.Between({10});
  ShowWilliams(f.host);
  // As by hand above, with bar 6 empty and its value at bar 7.
  EXPECT_EQ(f.Lines('H'), (Texts{"H,52,360,56,380,45"}));
}

TEST(WilliamsTest, WindowInWhichNothingCountsKeepsTheStartValues) {
  Williams f(3);
  f.Closes(std::vector<float>(250, 0.0f));
  const auto series = WilliamsSeries(f.chart.Bars, kShare, 3);
  ASSERT_EQ(series.size(), 247u);
  EXPECT_EQ(series.back().W, 50);  // -100000 / -200000
}

TEST(WilliamsTest, EqualPricesHaveNoRangeAndPricesBelowZeroDo) {
  OscFixture f;
  f.Closes({1, 1, 1, 1});
  EXPECT_TRUE(WilliamsSeries(f.chart.Bars, kShare, 2).empty());
  f.Closes({-1, -1, -2, -1});
  EXPECT_EQ(ValuesOf(WilliamsSeries(f.chart.Bars, kShare, 2)), (std::vector<float>{100, 0}));
}

TEST(WilliamsTest, FailingStepKeepsTheLastStateAndShowsNoMessage) {
  Williams f(1);
  f.Between({15, 20, 10, 15, 20, 15, 10});
  const float nan = std::numeric_limits<float>::quiet_NaN();
  f.Between({nan, std::numeric_limits<float>::infinity(), 3e38f});
  ShowWilliams(f.host);
  EXPECT_TRUE(f.dialogs.said.empty());
  // y stays 131 behind bar 6: means (72 + 131 + 131) / 3 = 111.3, 131, 131.
  EXPECT_EQ(f.Lines('H'), (Texts{"H,52,360,54,380,45", "H,54,380,56,419,45", "H,56,419,58,439,45",
                                 "H,58,439,60,439,45"}));
}

TEST(WilliamsTest, PeriodOfZeroDrawsAndWritesNothing) {
  Williams f(0);
  f.Closes({1, 2, 3});
  ShowWilliams(f.host);
  EXPECT_TRUE(f.panel.ops.empty());
  EXPECT_EQ(f.script.text(), "");
}

TEST(WilliamsTest, OddPeriodsAndFewBarsLeaveFrameAndGuides) {
  for (const std::int16_t P : std::initializer_list<std::int16_t>{5, 200, 201, 32767}) {
    Williams f(P);
    f.Between({15, 20, 10, 15, 20});
    ShowWilliams(f.host);
    EXPECT_TRUE(f.Lines('H').empty()) << P;
    EXPECT_EQ(f.Lines('L').size(), 2u) << P;
    EXPECT_TRUE(f.dialogs.said.empty()) << P;
  }
  Williams negative(-3);
  negative.Between({15, 20, 10, 15, 20});
  ShowWilliams(negative.host);
  EXPECT_TRUE(negative.dialogs.said.empty());
}

TEST(WilliamsTest, WeeklyAndMonthlyChartsShareTheTwinPeriod) {
  Williams f(1);
  f.settings.osc[kWmsA].twin = 9;
  f.request.ChartPeriod = Period::kMonthly;
  f.Between({15, 20});
  ShowWilliams(f.host);
  EXPECT_EQ(f.Lines('T')[0], "T,8.25,44,313,Williams %R Oscillator (9 Period),27");
}

TEST(WilliamsTest, BarBeyond16BitsKeepsTheLastPlace) {
  Williams f(1);
  f.Between({15, 20, 10, 15, 20, 15, 10, 20});
  f.chart.BarSpacing = 5400;  // bar 6 stands at 32,442 and bar 7 would at 37,842
  ShowWilliams(f.host);
  EXPECT_TRUE(f.dialogs.said.empty());
  EXPECT_EQ(f.Lines('H'), (Texts{"H,27042,360,32442,380,45", "H,32442,380,32442,380,45"}));
}

TEST(WilliamsTest, RealPricesAgreeWithAPlainComputation) {
  const std::vector<ChartBar> prices = test::RealBars("INTC");
  if (prices.empty()) GTEST_SKIP() << "no real prices here";
  constexpr size_t P = 7;
  Williams f(P);
  for (const ChartBar& bar : prices) f.AddBar(bar);
  ShowWilliams(f.host);

  const auto y = [&](size_t i) {
    double high = prices[i].High, low = prices[i].Low;
    for (size_t j = i - P + 1; j < i; ++j) {
      high = std::max<double>(high, prices[j].High);
      low = std::min<double>(low, prices[j].Low);
    }
    const double w = double(float(high - prices[i].Close)) / float(high - low) * 100;
    return std::nearbyint(w * 1.18 + 13);
  };
  const auto mean = [&](size_t i) { return std::nearbyint((y(i - 2) + y(i - 1) + y(i)) / 3); };
  Texts expected;
  for (size_t i = P + 5; i < prices.size(); ++i)
    expected.push_back("H," + Str(40.0 + 2 * double(i)) + "," + Str(308 + mean(i - 1)) + "," +
                       Str(42.0 + 2 * double(i)) + "," + Str(308 + mean(i)) + ",45");
  EXPECT_EQ(f.Lines('H'), expected);
}
