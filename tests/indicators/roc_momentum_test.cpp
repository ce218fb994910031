#include "indicators/roc_momentum.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>

#include "indicators/stochastic_fx.h"
#include "tests/indicators/osc_fixture.h"
#include "tests/support/error_of.h"

using namespace kora;
using kora::test::ErrorOf;
using kora::test::OscFixture;

using Texts = std::vector<std::string>;
using Values = std::vector<std::int32_t>;

namespace {

// In a panel of 144 the frame stands from 3 to 141 and the range of the values from 13 to 131,
// zero at 72. The script's y is 308 more.
struct Change : OscFixture {
  Change(std::int16_t P, std::int16_t A, const std::string& code = "ROC") {
    host.OscCode = code;
    settings.osc[kRocP].daily = settings.osc[kMMA].daily = P;
    settings.osc[kRocA].daily = A;
  }
};

const std::vector<float> kCloses{100, 100, 125, 100, 80};

}  // namespace

TEST(RocTest, DivisorIsTheNewerClose) {
  OscFixture f;
  f.Closes({100, 100, 200, 100});
  // A rise to the double is 100 / 200, a fall to the half -100 / 100.
  EXPECT_EQ(RocSeries(f.chart.Bars, 1).V, (Values{0, 0, 50, -100}));
}

TEST(RocTest, FirstValueIsOneBarBehindThePeriod) {
  OscFixture f;
  f.Closes({50, 100, 100, 100, 200});
  // Bar 3 has bar 0 three before it and still carries 0; bar 4 is (200 - 100) / 200.
  EXPECT_EQ(RocSeries(f.chart.Bars, 3).V, (Values{0, 0, 0, 0, 50}));
}

TEST(RocTest, ZeroCloseAtEitherEndRepeatsTheValueBefore) {
  OscFixture f;
  f.Closes({100, 100, 125, 0, 80, 100});
  EXPECT_EQ(RocSeries(f.chart.Bars, 1).V, (Values{0, 0, 20, 20, 20, 20}));
}

TEST(RocTest, RatioIs64BitAndItsHalvesRoundToEven) {
  OscFixture f;
  // (200 - 197) / 200 = 1.5 %, which a 32-bit ratio would hold as 1.49999997; (200 - 195) / 200 =
  // 2.5 %.
  f.Closes({197, 197, 200, 195, 200});
  const Values v = RocSeries(f.chart.Bars, 1).V;
  EXPECT_EQ(v[2], 2);
  EXPECT_EQ(v[4], 2);
}

TEST(RocTest, ValueBeyond16BitsIsAnOverflow) {
  OscFixture f;
  f.Closes({1, 1, 0.003f});  // (0.003 - 1) / 0.003 = -33,233 %
  EXPECT_EQ(ErrorOf([&] { RocSeries(f.chart.Bars, 1); }), 6);
  f.Closes({1, 1, 0.0031f});  // -32,158 %
  EXPECT_EQ(ErrorOf([&] { RocSeries(f.chart.Bars, 1); }), 0);
}

TEST(RocTest, RangeIsSymmetricAboutZero) {
  OscFixture f;
  f.Closes({100, 100, 200, 100});
  const ChangeSeries down = RocSeries(f.chart.Bars, 1);
  EXPECT_EQ(down.Highest, 100);
  EXPECT_EQ(down.Lowest, -100);
  f.Closes({100, 100, 200, 160});
  const ChangeSeries up = RocSeries(f.chart.Bars, 1);
  EXPECT_EQ(up.Highest, 50);
  EXPECT_EQ(up.Lowest, -50);
}

TEST(RocTest, PanelByHand) {
  Change f(1, 2);
  f.Closes(kCloses);
  ShowROC(f.host);
  // Values 0, 0, 20, -25, -25; range -25 to 25, 2.36 units to one: y 72, 72, 24.8, 131, 131.
  // Guides at 0, 20 and -20 (119.2). Averages of two, bar 0 counted: 72, 48.5 (48), 78, 131;
  // lines from the second on. "  0%" is (278 * 2 + 556 + 889) * 11 / 1000 = 22 wide, "+80%"
  // (584 + 556 * 2 + 889) = 28, "-80%" (333 + 556 * 2 + 889) = 26.
  EXPECT_EQ(f.script.text(),
            "B,42,311,630,449,16\r\n"
            "T,8.25,44,313,Rate of Change Oscillator (1 Period)  2 Ave,27\r\n"
            "L,42,380,630,380,16\r\nT,8.25,15,374,  0%,27\r\n"
            "L,42,333,630,333,16\r\nT,8.25,9,327,+80%,27\r\n"
            "L,42,427,630,427,16\r\nT,8.25,11,421,-80%,27\r\n"
            "H,44,380,46,333,45\r\nL,44,380,46,356,46\r\n"
            "H,46,333,48,439,45\r\nL,46,356,48,386,46\r\n"
            "H,48,439,50,439,45\r\nL,48,386,50,439,46\r\n");
  EXPECT_TRUE(f.panel.Has("line dot 42,25,630,25 16"));
  EXPECT_TRUE(f.panel.Has("line solid 44,72,46,25 45"));
  EXPECT_TRUE(f.panel.Has("line solid 44,72,46,48 46"));
}

TEST(RocTest, AverageRunsOverTheBarsUpToThePeriodToo) {
  Change f(3, 3);
  f.Closes({100, 100, 100, 100, 125, 125});
  ShowROC(f.host);
  // Values 0, 0, 0, 0, 20, 20: y 72 and 13. The first mean of three is bar 2's, so that bar 3,
  // which has no value yet, has an average line; bar 4: 157 / 3, 52.
  EXPECT_EQ(f.Lines('H'), (Texts{"H,48,380,50,321,45", "H,50,321,52,321,45"}));
  Texts averages = f.Lines('L');
  averages.erase(averages.begin(), averages.begin() + 3);
  EXPECT_EQ(averages, (Texts{"L,46,380,48,380,46", "L,48,380,50,360,46", "L,50,360,52,341,46"}));
}

TEST(RocTest, AverageOfZeroIsOff) {
  for (const std::int16_t A : std::initializer_list<std::int16_t>{0, -1, -32768}) {
    Change f(1, A);
    f.Closes(kCloses);
    ShowROC(f.host);
    EXPECT_EQ(f.Lines('H').size(), 3u) << A;
    EXPECT_EQ(f.Lines('L').size(), 3u) << A;
  }
}

TEST(RocTest, SumOfTheAverageIs16Bit) {
  for (const double height : {300.0, 400.0}) {
    Change f(1, 200);
    std::vector<float> closes(260, 100.0f);
    closes.back() = 50;
    f.Closes(closes);
    test::RecordingSurface tall(638, height);
    OscHost host{f.home.files(), f.dialogs, f.settings, f.colours, f.request,
                 f.chart,        f.price,   tall,       &f.script};
    host.OscCode = "ROC";
    ShowROC(host);
    // 200 values on the zero line: y 150 makes 30,000 and y 200 makes 40,000.
    ASSERT_EQ(f.dialogs.said.size(), height == 300 ? 0u : 1u);
    if (height == 400) {
      EXPECT_EQ(f.dialogs.said[0].title, "Chart Display");
      EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
    }
  }
}

TEST(RocTest, SeriesWithNoChangeLeavesTheFrameOnly) {
  Change f(1, 2);
  f.Closes(std::vector<float>(20, 3.0f));
  ShowROC(f.host);
  EXPECT_EQ(f.script.text(), "B,42,311,630,449,16\r\n");
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(RocTest, WithoutAveragesInRfTheTitleEndsBehindThePeriod) {
  Change without(1, 2, "R/F"), with(1, 2, "R/F");
  with.settings.osc.RFAve = true;
  without.Closes(kCloses);
  with.Closes(kCloses);
  ShowROC(without.host);
  ShowROC(with.host);
  EXPECT_EQ(without.Lines('T')[0], "T,8.25,44,313,Rate of Change Oscillator (1 Period),27");
  EXPECT_EQ(without.Lines('L').size(), 3u);
  EXPECT_EQ(with.Lines('T')[0], "T,8.25,44,313,Rate of Change Oscillator (1 Period)  2 Ave,27");
  EXPECT_EQ(with.Lines('L').size(), 6u);
}

TEST(RocTest, RfDrawsFxOverRoc) {
  Change f(1, 2, "R/F");
  f.settings.osc[kFXF].daily = 2;
  f.settings.osc[kFXX].daily = 1;
  f.settings.osc.RFAve = true;
  f.Closes(kCloses);
  ShowOscillatorPanel(f.host);
  EXPECT_EQ(f.Lines('B').size(), 1u);
  EXPECT_EQ(f.Lines('H').size(), 3u);
  // FX: bar 3 0 of 25 (y 121), bar 4 0 of 45, on a frame of 2 to 141.
  EXPECT_EQ(f.Lines('L').back(), "L,48,429,50,429,47");
  EXPECT_EQ(f.Lines('D'), (Texts{"D,48,429,50,429,48"}));
  EXPECT_EQ(std::count(f.panel.ops.begin(), f.panel.ops.end(), "cls"), 1);
}

TEST(RocTest, PeriodOfZeroDrawsAndWritesNothing) {
  Change f(0, 2);
  f.Closes(kCloses);
  ShowROC(f.host);
  ShowMomentum(f.host);
  EXPECT_TRUE(f.panel.ops.empty());
  EXPECT_EQ(f.script.text(), "");
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(RocTest, FewerBarsThanThePeriodLeaveTheFrameOnly) {
  for (const std::int16_t P : std::initializer_list<std::int16_t>{5, 200, 201, 32767}) {
    Change f(P, 2);
    f.Closes(kCloses);
    ShowROC(f.host);
    EXPECT_EQ(f.script.text(), "B,42,311,630,449,16\r\n") << P;
    EXPECT_TRUE(f.dialogs.said.empty()) << P;
  }
  Change none(5, 2);
  ShowROC(none.host);
  EXPECT_TRUE(none.dialogs.said.empty());
}

TEST(RocTest, NegativePeriodLooksPastTheBarsAndIsAnIndexOutOfRange) {
  Change f(-1, 2);
  f.Closes(kCloses);
  ShowROC(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 9\nIndex out of range");
}

TEST(RocTest, PriceThatIsNoNumberIsAnOverflow) {
  for (const float bad :
       {std::numeric_limits<float>::quiet_NaN(), std::numeric_limits<float>::infinity()}) {
    Change f(1, 2);
    f.Closes({100, 100, bad, 100});
    ShowROC(f.host);
    ASSERT_EQ(f.dialogs.said.size(), 1u);
    EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
    EXPECT_FALSE(f.dialogs.busy);
  }
}

TEST(RocTest, YearOfZeroClosesIsALevelLine) {
  OscFixture f;
  std::vector<float> closes(600, 100.0f);
  closes[99] = 125;
  std::fill(closes.begin() + 100, closes.begin() + 350, 0.0f);
  f.Closes(closes);
  const Values v = RocSeries(f.chart.Bars, 21).V;
  EXPECT_EQ(v[99], 20);
  EXPECT_EQ(v[370], 20);  // 21 days after the last empty bar, which is 349
  EXPECT_EQ(v[371], 0);
}

TEST(MomentumTest, IsAPriceDifferenceInHundredths) {
  OscFixture f;
  f.Closes({1.25f, 1.25f, 1.5f, 0.5f, 400000});
  // The last: 399,999.5 * 100.
  EXPECT_EQ(MomentumSeries(f.chart.Bars, 1).V, (Values{0, 0, 25, -100, 39999950}));
}

TEST(MomentumTest, HalfAHundredthRoundsToEven) {
  OscFixture f;
  // The difference of the prices is the float 0.005, a shade under a half.
  f.Closes({0.001f, 0.001f, 0.006f});
  EXPECT_EQ(MomentumSeries(f.chart.Bars, 1).V.back(), 0);
  f.Closes({1, 1, 1.125f, 1.28f});  // 12.5 is 12
  EXPECT_EQ(MomentumSeries(f.chart.Bars, 1).V[2], 12);
}

TEST(MomentumTest, ValueBeyond32BitsIsAnOverflow) {
  OscFixture f;
  f.Closes({1, 1, 3e7f});
  EXPECT_EQ(ErrorOf([&] { MomentumSeries(f.chart.Bars, 1); }), 6);
}

TEST(MomentumTest, RangeNearTheLimitOf32BitsIsSymmetricToo) {
  OscFixture f;
  f.Closes({1, 21474836.0f, 21474836.0f, 0.5f});
  const ChangeSeries series = MomentumSeries(f.chart.Bars, 1);
  // Floats of that size are whole even numbers: the difference is -21,474,836.
  EXPECT_EQ(series.Lowest, -2147483600.0);
  EXPECT_EQ(series.Highest, 2147483600.0);
}

TEST(MomentumTest, PanelByHandHasNoAverage) {
  Change f(1, 2, "MOM");
  f.Closes({1, 1, 1.25f, 1, 1});
  ShowMomentum(f.host);
  // Values 0, 0, 25, -25, 0. "0%" is (556 + 889) * 11 / 1000 = 16 wide.
  EXPECT_EQ(f.script.text(),
            "B,42,311,630,449,16\r\n"
            "T,8.25,44,313,Momentum Oscillator (1 Period)  0 Ave,27\r\n"
            "L,42,380,630,380,16\r\nT,8.25,21,374,0%,27\r\n"
            "L,42,333,630,333,16\r\nT,8.25,9,327,+80%,27\r\n"
            "L,42,427,630,427,16\r\nT,8.25,11,421,-80%,27\r\n"
            "H,44,380,46,321,45\r\nH,46,321,48,439,45\r\nH,48,439,50,380,45\r\n");
}

TEST(RocTest, BarBeyond16BitsIsAnOverflow) {
  Change f(1, 2);
  f.Closes(kCloses);
  f.chart.BarSpacing = 20000;  // bar 2 would stand at 40,042
  ShowROC(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
}

TEST(RocTest, RealPricesAgreeWithAPlainComputation) {
  const std::vector<ChartBar> prices = test::RealBars("ORCL");
  if (prices.empty()) GTEST_SKIP() << "no real prices here";
  Change f(21, 10);
  for (const ChartBar& bar : prices) f.AddBar(bar);
  ShowROC(f.host);

  std::vector<double> v(prices.size()), y(prices.size());
  double reach = 0;
  for (size_t i = 22; i < prices.size(); ++i) {
    const double close = prices[i].Close;
    v[i] = std::nearbyint(float(close - prices[i - 21].Close) / close * 100);
    reach = std::max(reach, std::abs(v[i]));
  }
  for (size_t i = 0; i < prices.size(); ++i)
    y[i] = 308 + std::nearbyint(131 - (v[i] + reach) * 118 / (2 * reach));
  const auto mean = [&](size_t i) {
    double sum = 0;
    for (size_t j = i - 9; j <= i; ++j) sum += y[j] - 308;
    return 308 + std::nearbyint(sum / 10);
  };
  Texts values, averages;
  for (size_t i = 10; i < prices.size(); ++i) {
    const std::string from = Str(40.0 + 2 * double(i)) + ",";
    const std::string to = "," + Str(42.0 + 2 * double(i)) + ",";
    if (i > 21) values.push_back("H," + from + Str(y[i - 1]) + to + Str(y[i]) + ",45");
    averages.push_back("L," + from + Str(mean(i - 1)) + to + Str(mean(i)) + ",46");
  }
  EXPECT_EQ(f.Lines('H'), values);
  Texts drawn = f.Lines('L');
  drawn.erase(drawn.begin(), drawn.begin() + 3);
  EXPECT_EQ(drawn, averages);
}
