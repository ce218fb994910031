#include "indicators/stochastic_fx.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>

#include "tests/indicators/osc_fixture.h"

using namespace kora;
using kora::test::OscFixture;

using Texts = std::vector<std::string>;

namespace {

// In the panel of 144 units a percentage v stands at 121 - 0.99 v: top 2, bottom 141, inset 20.
// The script's y is 308 more.
struct Stochastic : OscFixture {
  Stochastic(std::int16_t K, std::int16_t D, const std::string& code = "STO") {
    host.OscCode = code;
    settings.osc[kStochK].daily = settings.osc[kFXF].daily = K;
    settings.osc[kStochD].daily = settings.osc[kFXX].daily = D;
  }
  // The lines of the data: those behind the guides.
  Texts Data(char letter) const {
    Texts lines = Lines(letter);
    if (letter == 'L') lines.erase(lines.begin(), lines.begin() + 2);
    return lines;
  }
};

PriceRange RangeAt(const ChartBars& bars, std::int16_t recType, int K, int bar) {
  return StochasticRanges(bars, recType, K)[size_t(bar)];
}

const std::vector<float> kCloses{10, 12, 11, 14, 13, 13.25f};

}  // namespace

TEST(StochasticTest, FastFormByHand) {
  Stochastic f(2, 2);
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  // bar  window          above  range   %K           %D
  // 3    12, 11, 14      3      3       100, y 22    (0 + 3) / (0 + 3): 100, y 22
  // 4    11, 14, 13      2      3       67, y 55     5 / 6: 83, y 39
  // 5    14, 13, 13.25   0.25   1       25, y 96     2.25 / 4: 56, y 66 (a mean of %K: 46)
  EXPECT_EQ(f.Data('L'), (Texts{"L,48,330,50,363,45", "L,50,363,52,404,45"}));
  EXPECT_EQ(f.Data('D'), (Texts{"D,48,330,50,347,46", "D,50,347,52,374,46"}));
  EXPECT_TRUE(f.panel.Has("line solid 50,55,52,96 45"));
  EXPECT_TRUE(f.panel.Has("line dot 50,39,52,66 46"));
}

TEST(StochasticTest, SlowFormDrawsTheRatioOfSumsAndItsMeanAndNoPercentK) {
  Stochastic f(2, 2);
  f.Closes(kCloses);
  f.host.SlowStochastic = true;
  ShowStochasticFX(f.host);
  EXPECT_EQ(f.Data('L'), (Texts{"L,48,330,50,347,45", "L,50,347,52,374,45"}));
  // Mean of two from the start: bar 4 (100 + 83) / 2 = 91.5, 92, y 30; bar 5 (83 + 56) / 2 =
  // 69.5, 70, y 52. Drawn above bar K + D = 4.
  EXPECT_EQ(f.Data('D'), (Texts{"D,50,338,52,360,47"}));
}

TEST(StochasticTest, TitlesNameTheForm) {
  Stochastic fast(10, 5), slow(10, 5), fx(50, 25, "FX");
  slow.host.SlowStochastic = fx.host.SlowStochastic = true;
  for (Stochastic* f : {&fast, &slow, &fx}) {
    f->Closes(kCloses);
    ShowStochasticFX(f->host);
  }
  EXPECT_EQ(fast.Lines('T')[0], "T,8.25,44,312,Stochastic Oscillator (K=10 Period  D=5 Period),27");
  EXPECT_EQ(slow.Lines('T')[0],
            "T,8.25,44,312,SLOW Stochastic Oscillator (K=10 Period  D=5 Period),27");
  EXPECT_EQ(fx.Lines('T')[0], "T,8.25,44,312,FX Oscillator (F=50 Period  X=25 Period),27");
  EXPECT_FALSE(fx.host.SlowStochastic);
}

TEST(StochasticTest, FrameTitleAndGuidesComeInThatOrderAtTheirPlaces) {
  Stochastic f(10, 5);
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  // 121 - 24.75 = 96.25 and 121 - 74.25 = 46.75. " 25%" is (278 + 556 + 556 + 889) / 1000 * 11 =
  // 25 wide.
  EXPECT_EQ(f.script.text(),
            "B,42,310,630,449,16\r\n"
            "T,8.25,44,312,Stochastic Oscillator (K=10 Period  D=5 Period),27\r\n"
            "L,42,404,630,404,16\r\nT,8.25,12,398, 25%,27\r\n"
            "L,42,355,630,355,16\r\nT,8.25,12,349, 75%,27\r\n");
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(StochasticTest, PanelHas144UnitsWhateverItsHeight) {
  Stochastic f(2, 2);
  f.Closes(kCloses);
  test::RecordingSurface tall(638, 500);
  OscHost host{f.home.files(), f.dialogs, f.settings, f.colours, f.request,
               f.chart,        f.price,   tall,       &f.script};
  host.OscCode = "STO";
  ShowStochasticFX(host);
  EXPECT_EQ(f.Data('L'), (Texts{"L,48,330,50,363,45", "L,50,363,52,404,45"}));
}

TEST(StochasticTest, WindowHoldsOneBarMoreThanThePeriod) {
  Stochastic f(10, 0);
  std::vector<float> closes(13, 50.0f);
  closes[0] = 1;
  closes[1] = 100;
  f.Closes(closes);
  const PriceRange range = RangeAt(f.chart.Bars, kShare, 10, 11);
  EXPECT_EQ(range.Highest, 100);  // bar 1 is in
  EXPECT_EQ(range.Lowest, 50);    // bar 0 is not
}

TEST(StochasticTest, FirstPercentKIsOneBarBehindThePeriod) {
  Stochastic f(10, 0);
  std::vector<float> closes(14, 50.0f);
  closes[9] = 60;
  f.Closes(closes);
  ShowStochasticFX(f.host);
  // Points at bars 11, 12, 13 (x 64, 66, 68), lines between them.
  EXPECT_EQ(f.Data('L'), (Texts{"L,64,429,66,429,45", "L,66,429,68,429,45"}));
}

TEST(StochasticTest, FlatWindowDividesByOne) {
  Stochastic f(1, 0);
  ChartBar bar{};
  bar.High = bar.Low = 10;
  bar.Close = 10.25f;
  for (int i = 0; i < 4; ++i) f.AddBar(bar);
  ShowStochasticFX(f.host);
  // (10.25 - 10) * 100 = 25, y 96.
  EXPECT_EQ(f.Data('L'), (Texts{"L,46,404,48,404,45"}));
}

TEST(StochasticTest, ZeroCloseInTheWindowCountsForNeitherEnd) {
  Stochastic f(2, 0);
  f.Closes({10, 12, 0, 11});
  const PriceRange range = RangeAt(f.chart.Bars, kShare, 2, 3);
  EXPECT_EQ(range.Highest, 12);
  EXPECT_EQ(range.Lowest, 11);
}

TEST(StochasticTest, BarsOwnZeroCloseGivesAPercentFromZeroFarOutOfTheFrame) {
  Stochastic f(2, 0);
  f.Closes({10, 12, 11, 0, 12});
  ShowStochasticFX(f.host);
  // Bar 3: (0 - 11) / (12 - 11) = -1100, y 121 + 1089 = 1210; bar 4: 100, y 22.
  EXPECT_EQ(f.Data('L'), (Texts{"L,48,1518,50,330,45"}));
}

TEST(StochasticTest, ZeroHighOrLowStandsWithTheClose) {
  OscFixture f;
  ChartBar bar{};
  f.AddBar(bar);
  bar.High = 0;
  bar.Low = 5;
  bar.Close = 6;
  f.AddBar(bar);
  bar.High = 5.5f;
  bar.Low = 0;
  bar.Close = 4;
  f.AddBar(bar);
  const PriceRange range = RangeAt(f.chart.Bars, kShare, 1, 2);
  EXPECT_EQ(range.Highest, 6);
  EXPECT_EQ(range.Lowest, 4);
}

TEST(StochasticTest, SecuritiesWithoutARangeStandWithTheirCloses) {
  OscFixture f;
  for (const float close : {0.0f, 6.0f, 7.0f}) {
    ChartBar bar{};
    bar.High = 50;
    bar.Low = 1;
    bar.Close = close;
    f.AddBar(bar);
  }
  for (const std::int16_t type : {kCloseVolume, kCloseOnly, kAdvanceDecline}) {
    const PriceRange range = RangeAt(f.chart.Bars, type, 1, 2);
    EXPECT_EQ(range.Highest, 7);
    EXPECT_EQ(range.Lowest, 6);
  }
  EXPECT_EQ(RangeAt(f.chart.Bars, kIndex, 1, 2).Highest, 50);
}

TEST(StochasticTest, RangesAreThoseOfAScanOfEachWindow) {
  OscFixture f;
  std::uint32_t noise = 7;
  for (int i = 0; i < 400; ++i) {
    float price[3];
    for (float& p : price) {
      noise = noise * 1664525u + 1013904223u;
      // A third zeros, and now and then a price below zero or beyond the start value.
      p = noise >> 30 ? float(noise >> 20) * ((noise >> 12) % 16 ? 1.0f : -40.0f) : 0.0f;
    }
    ChartBar bar{};
    bar.High = price[0];
    bar.Low = i % 50 == 3 ? std::numeric_limits<float>::quiet_NaN() : price[1];
    bar.Close = price[2];
    f.AddBar(bar);
  }
  for (const std::int16_t type : {kCloseOnly, kShare}) {
    for (const int K : {1, 2, 10, 57}) {
      const std::vector<PriceRange> ranges = StochasticRanges(f.chart.Bars, type, K);
      for (int i = K + 1; i < 400; ++i) {
        PriceRange scan{0, 100000};
        for (int j = i - K; j <= i; ++j) {
          const ChartBar& bar = f.chart.Bars[size_t(j)];
          const float high = type > 3 && bar.High != 0 ? bar.High : bar.Close;
          const float low = type > 3 && bar.Low != 0 ? bar.Low : bar.Close;
          if (high != 0 && high > scan.Highest) scan.Highest = high;
          if (low != 0 && low < scan.Lowest) scan.Lowest = low;
        }
        ASSERT_EQ(ranges[size_t(i)].Highest, scan.Highest) << K << " " << i;
        ASSERT_EQ(ranges[size_t(i)].Lowest, scan.Lowest) << K << " " << i;
      }
    }
  }
}

TEST(StochasticTest, NoDGivesPercentKAloneInTheFastForm) {
  Stochastic f(2, 0);
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  EXPECT_EQ(f.Data('L').size(), 2u);
  EXPECT_TRUE(f.Data('D').empty());
}

TEST(StochasticTest, NoDGivesNoLineInTheSlowForm) {
  Stochastic f(2, 0);
  f.host.SlowStochastic = true;
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  EXPECT_TRUE(f.Data('L').empty());
  EXPECT_TRUE(f.Data('D').empty());
}

TEST(StochasticTest, LineFromAYOfZeroIsLeftOut) {
  Stochastic f(1, 0);
  ChartBar bar{};
  bar.High = 10;
  bar.Low = 9;
  // %K 100, 122 (y 121 - 120.78 = 0.22, 0), 100, 100.
  for (const float close : {10.0f, 10.0f, 10.0f, 10.22f, 10.0f, 10.0f}) {
    bar.Close = close;
    f.AddBar(bar);
  }
  ShowStochasticFX(f.host);
  EXPECT_EQ(f.Data('L'), (Texts{"L,46,330,48,308,45", "L,50,330,52,330,45"}));
}

TEST(FxTest, ReversedSwapsTheLabelsAndTheLinesAndLeavesTheGuides) {
  Stochastic f(2, 2, "FX");
  f.settings.osc.FXRev = true;
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  EXPECT_EQ(f.Lines('L')[0], "L,42,404,630,404,16");
  EXPECT_EQ(f.Lines('T')[1], "T,8.25,12,398, 75%,27");
  EXPECT_EQ(f.Lines('L')[1], "L,42,355,630,355,16");
  EXPECT_EQ(f.Lines('T')[2], "T,8.25,12,349, 25%,27");
  // %K 100, 67, 25 stand as 0 (y 121), 33 (y 88.33), 75 (y 46.75).
  EXPECT_EQ(f.Data('L'), (Texts{"L,48,429,50,396,45", "L,50,396,52,355,45"}));
}

TEST(FxTest, StochasticIsNeverReversed) {
  Stochastic f(2, 2);
  f.settings.osc.FXRev = true;
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  EXPECT_EQ(f.Lines('T')[1], "T,8.25,12,398, 25%,27");
  EXPECT_EQ(f.Data('L')[0], "L,48,330,50,363,45");
}

TEST(FxTest, OverRocItDrawsItsLinesAloneInColoursOfItsOwn) {
  Stochastic f(2, 2, "R/F");
  f.settings.osc.RFAve = true;
  f.host.SecondPass = true;
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  EXPECT_EQ(f.script.text(),
            "T,8.25,292,312,FX Oscillator (F=2 Period  X=2 Period),27\r\n"
            "L,48,330,50,363,47\r\nD,48,330,50,347,48\r\n"
            "L,50,363,52,404,47\r\nD,50,347,52,374,48\r\n");
  EXPECT_EQ(f.panel.ops[0], "text 8.25 332,4 FX Oscillator (F=2 Period  X=2 Period) 27");
}

TEST(FxTest, OverRocWithoutAveragesOnlyPercentKIsDrawn) {
  Stochastic f(2, 2, "R/F");
  f.host.SecondPass = true;
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  EXPECT_EQ(f.Lines('L').size(), 2u);
  EXPECT_TRUE(f.Lines('D').empty());
}

TEST(StochasticSignalTest, SellWhereTheRatioLeavesTheTopAndNothingInTheScript) {
  Stochastic f(2, 2);
  f.settings.words.StochSignals = true;
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  // %D: bar 3 y 22, above that of 90 (32); bar 4 y 39, between. At bar 3's x.
  EXPECT_EQ(f.price.ops, (Texts{"line solid 48,40,48,48 12", "line solid 48,48,45,45 12",
                                "line solid 48,48,51,45 12"}));
  // The lines at 10% (y 111.1) and 90% (y 31.9) are on the screen alone.
  EXPECT_TRUE(f.panel.Has("line solid 42,111,630,111 16"));
  EXPECT_TRUE(f.panel.Has("line solid 42,32,630,32 16"));
  EXPECT_EQ(f.Lines('L').size(), 4u);
}

TEST(StochasticSignalTest, BuyWhereTheRatioIsNoMoreThanThreeBelowTwentyPercent) {
  Stochastic f(2, 2);
  f.settings.words.StochSignals = true;
  f.Closes({14, 12, 13, 10, 11, 10.75f});
  ShowStochasticFX(f.host);
  // 20% stands at 101.2, 101. Bar 3: 0 / 3, y 121: zone 3. Bar 4: 1 / 6, 17%, y 104.17, 104,
  // which is 3 below and no more: zone 2.
  EXPECT_EQ(f.price.ops, (Texts{"line solid 48,48,48,40 10", "line solid 48,40,45,43 10",
                                "line solid 48,40,51,43 10"}));
}

TEST(StochasticSignalTest, FxHasNoArrows) {
  Stochastic f(2, 2, "FX");
  f.settings.words.StochSignals = true;
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  EXPECT_TRUE(f.price.ops.empty());
}

TEST(StochasticTest, WeeklyAndMonthlyChartsShareTheTwinPeriods) {
  for (const Period period : {Period::kWeekly, Period::kMonthly}) {
    Stochastic f(2, 2);
    f.settings.osc[kStochK].twin = 7;
    f.settings.osc[kStochD].twin = 3;
    f.request.ChartPeriod = period;
    f.Closes(kCloses);
    ShowStochasticFX(f.host);
    EXPECT_EQ(f.Lines('T')[0], "T,8.25,44,312,Stochastic Oscillator (K=7 Period  D=3 Period),27");
  }
}

TEST(StochasticTest, PeriodOfZeroDrawsAndWritesNothing) {
  Stochastic f(0, 5);
  f.Closes(kCloses);
  ShowStochasticFX(f.host);
  EXPECT_TRUE(f.panel.ops.empty());
  EXPECT_EQ(f.script.text(), "");
  EXPECT_TRUE(f.dialogs.said.empty());
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(StochasticTest, FewerBarsThanThePeriodLeaveFrameAndGuides) {
  for (const std::int16_t K : std::initializer_list<std::int16_t>{5, 6, 200, 201, 32767}) {
    Stochastic f(K, K);
    f.Closes(kCloses);
    ShowStochasticFX(f.host);
    EXPECT_TRUE(f.Data('L').empty()) << K;
    EXPECT_TRUE(f.Data('D').empty()) << K;
    EXPECT_TRUE(f.dialogs.said.empty()) << K;
  }
  Stochastic none(5, 5);
  ShowStochasticFX(none.host);
  EXPECT_TRUE(none.Data('L').empty());
}

TEST(StochasticTest, NegativePeriodHasAnEmptyWindowAndKeepsTheStartValues) {
  OscFixture f;
  f.Closes(kCloses);
  for (const std::int16_t K : std::initializer_list<std::int16_t>{-1, -200, -32768}) {
    const PriceRange range = RangeAt(f.chart.Bars, kShare, K, 2);
    EXPECT_EQ(range.Highest, 0);
    EXPECT_EQ(range.Lowest, 100000);
    Stochastic g(K, -3);
    g.Closes(kCloses);
    ShowStochasticFX(g.host);
    EXPECT_TRUE(g.dialogs.said.empty());
    EXPECT_EQ(g.Data('L').size(), 5u);
  }
}

TEST(StochasticTest, ZeroAndNegativeClosesLeaveNoRange) {
  for (const float close : {0.0f, -3.0f}) {
    Stochastic f(2, 2);
    f.Closes(std::vector<float>(8, close));
    ShowStochasticFX(f.host);
    EXPECT_TRUE(f.dialogs.said.empty()) << close;
    EXPECT_EQ(f.Data('L').size(), 4u) << close;
  }
}

TEST(StochasticTest, PriceThatIsNoNumberIsToldWithItsDate) {
  for (const float bad :
       {std::numeric_limits<float>::quiet_NaN(), std::numeric_limits<float>::infinity()}) {
    Stochastic f(2, 2);
    f.Closes({10, 12, 11, 14, bad, 13});
    ShowStochasticFX(f.host);
    ASSERT_EQ(f.dialogs.said.size(), 1u);
    EXPECT_EQ(f.dialogs.said[0].title, "FX");
    EXPECT_EQ(f.dialogs.said[0].text,
              "There is a problem with the data for TEST.WDT\n at date (20000107) 07/01/2000\n"
              "Use View/Modify Data procedure to correct.");
    EXPECT_FALSE(f.dialogs.busy);
    EXPECT_FALSE(f.script.IsOpen());
  }
}

TEST(StochasticTest, PanelTooLowForAScaleIsADivisionByZero) {
  Stochastic f(2, 2);
  f.Closes(kCloses);
  test::RecordingSurface low(638, 41);  // 0 to 40: nothing is left between the insets of 20
  OscHost host{f.home.files(), f.dialogs, f.settings, f.colours, f.request,
               f.chart,        f.price,   low,        &f.script};
  host.OscCode = "STO";
  host.OscCaller = "ANAL";
  ShowStochasticFX(host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 11\nDivision by zero");
}

TEST(StochasticTest, BarBeyond16BitsIsAnOverflow) {
  Stochastic f(1, 0);
  f.Closes(kCloses);
  f.chart.BarSpacing = 20000;  // bar 2 would stand at 40,042
  ShowStochasticFX(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_NE(f.dialogs.said[0].text.find("at date (20000105)"), std::string::npos);
}

TEST(StochasticTest, RealPricesAgreeWithAPlainComputation) {
  const std::vector<ChartBar> prices = test::RealBars("AAPL");
  if (prices.empty()) GTEST_SKIP() << "no real prices here";
  constexpr int K = 10, D = 5;
  Stochastic f(K, D);
  f.host.SlowStochastic = true;
  for (const ChartBar& bar : prices) f.AddBar(bar);
  ShowStochasticFX(f.host);

  // Each value from the bars anew, without running windows.
  const auto ends = [&](int i) {
    double high = 0, low = 100000;
    for (int j = i; j >= i - K; --j) {
      high = std::max<double>(high, prices[size_t(j)].High);
      low = std::min<double>(low, prices[size_t(j)].Low);
    }
    return std::pair(high, low);
  };
  const auto ratio = [&](int i) {
    double a = 0, b = 0;
    for (int j = std::max(K + 1, i - D + 1); j <= i; ++j) {
      const auto [high, low] = ends(j);
      a += float(prices[size_t(j)].Close - low);
      b += float(high - low);
    }
    return std::nearbyint(a / b * 100);
  };
  const auto third = [&](int i) {
    double sum = 0;
    for (int j = std::max(K + 1, i - D + 1); j <= i; ++j) sum += ratio(j);
    return std::nearbyint(sum / D);
  };
  const auto y = [](double v) { return std::nearbyint(121 - v / (100.0 / 99)) + 308; };
  Texts solid, dotted;
  for (int i = K + 2; i < int(prices.size()); ++i) {
    const std::string from = Str(40.0 + 2 * i) + ",", to = "," + Str(42.0 + 2 * i) + ",";
    solid.push_back("L," + from + Str(y(ratio(i - 1))) + to + Str(y(ratio(i))) + ",45");
    if (i > K + D)
      dotted.push_back("D," + from + Str(y(third(i - 1))) + to + Str(y(third(i))) + ",47");
  }
  EXPECT_EQ(f.Data('L'), solid);
  EXPECT_EQ(f.Data('D'), dotted);
}
