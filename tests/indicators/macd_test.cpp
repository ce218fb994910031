#include "indicators/macd.h"

#include <gtest/gtest.h>

#include "indicators/ema_column.h"
#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

// A steady rise of 1 a bar. Behind it an average of n lags by (n - 1) / 2 from its seed on: 5.5
// for 12, 12.5 for 26. The difference is 7 throughout.
void Rise(OscFixture& f, int count, float from = 0, float step = 1) {
  std::vector<float> closes;
  for (int i = 0; i < count; ++i) closes.push_back(from + step * float(i));
  f.Closes(closes);
  f.settings.osc[kMd1] = {12, 12};
  f.settings.osc[kMd2] = {26, 26};
  f.settings.osc[kMd3] = {9, 9};
  SetPriceMap(f, 1);
}

}  // namespace

TEST(EmaColumnTest, IsSeededByThePlainAverage) {
  const std::vector<float> closes{1, 2, 4, 8};
  std::vector<float> out(4);
  EmaColumn(2, -1, 0, closes, out);
  EXPECT_EQ(out[0], 0);
  EXPECT_FLOAT_EQ(out[1], 1.5f);
  EXPECT_FLOAT_EQ(out[2], 3.1666667f);  // 4 * 2/3 + 1.5 / 3
  EXPECT_FLOAT_EQ(out[3], 6.3888889f);  // 8 * 2/3 + 3.16667 / 3
}

TEST(EmaColumnTest, TheSignalsSeedHasOneValueTooMany) {
  const std::vector<float> difference{9, 1, 2, 4, 8};
  std::vector<float> out(5);
  EmaColumn(2, 1, 1, difference, out);
  EXPECT_EQ(out[2], 0);
  EXPECT_FLOAT_EQ(out[3], 3.5f);  // (1 + 2 + 4) / 2
}

TEST(EmaColumnTest, APeriodOfZeroOrBeyondTheBarsLeavesTheColumn) {
  const std::vector<float> closes{1, 2, 4, 8};
  std::vector<float> out(4);
  for (const int period : {0, -3, 5, 201}) EmaColumn(period, -1, 0, closes, out);
  EXPECT_EQ(out, std::vector<float>(4));
}

TEST(MacdTest, TheFirstDifferenceIsAtBar37AndTheFirstSignalAtBar46) {
  OscFixture f;
  Rise(f, 60);
  const MacdSeries s = Macd(f.chart.Bars, 12, 26, 9);
  EXPECT_EQ(s.ema1[10], 0);
  EXPECT_FLOAT_EQ(s.ema1[11], 5.5f);
  EXPECT_EQ(s.ema2[36], 0);
  EXPECT_FLOAT_EQ(s.ema2[37], 24.5f);
  EXPECT_EQ(s.difference[36], 0);
  EXPECT_NEAR(s.difference[37], 7, 1e-4);
  EXPECT_EQ(s.signal[45], 0);
  EXPECT_NEAR(s.signal[46], 70.0 / 9, 1e-4);  // ten sevens over nine
  EXPECT_NEAR(s.signal[47], 0.2 * 7 + 0.8 * 70 / 9, 1e-4);
}

TEST(MacdTest, TheRangeIsSymmetricAboutZero) {
  OscFixture f;
  Rise(f, 60);
  const MacdSeries s = Macd(f.chart.Bars, 12, 26, 9);
  EXPECT_NEAR(s.lowest, -7.0 / 9, 1e-4);
  EXPECT_NEAR(s.highest, 7.0 / 9, 1e-4);
}

TEST(MacdTest, TitleAndGuides) {
  OscFixture f;
  Rise(f, 60);
  ShowMACD(f.host);
  const auto texts = f.Lines('T');
  ASSERT_EQ(texts.size(), 6u);
  EXPECT_EQ(texts[0], "T,8.25,44,313,MACD ( 12 / 26 / 9  Period )  ,27");
  EXPECT_EQ(texts[1], "T,8.25,22,371,0.0,27");  // 138 / 2, not moved by the frame's top
  const std::vector<std::string> labels{".78", ".39", "-.78", "-.39"};
  const std::vector<double> ys{13, 42.5, 131, 101.5};
  const auto guides = Drawn(f, 'L', 16);
  ASSERT_EQ(guides.size(), 5u);
  EXPECT_SEGMENT(guides[0], 42, 69, 630, 69);
  for (size_t i = 0; i < 4; ++i) {
    EXPECT_SEGMENT(guides[i + 1], 42, ys[i], 630, ys[i]);
    EXPECT_NE(texts[i + 2].find("," + labels[i] + ",27"), std::string::npos) << texts[i + 2];
  }
}

TEST(MacdTest, TheHistogramStartsABarAfterTheSignal) {
  OscFixture f;
  Rise(f, 60);
  ShowMACD(f.host);
  const auto bars = Drawn(f, 'H', 36);
  ASSERT_EQ(bars.size(), 13u);  // bars 47 to 59
  // -0.62222 on a range of 1.55556 over 118 units is -47.2: 131 - ((69 - 47.2) - 10).
  EXPECT_SEGMENT(bars[0], 136, 69, 136, 119.2);
}

TEST(MacdTest, BothAveragesAreDrawnOnThePricePicture) {
  OscFixture f;
  Rise(f, 60);
  ShowMACD(f.host);
  const auto ema = Drawn(f, 'L', 38, 0);
  // 48 lines of the first average, from bar 12 on, and 22 of the second, from bar 38 on.
  ASSERT_EQ(ema.size(), 48u + 22u);
  EXPECT_SEGMENT(ema[0], 64, 284, 66, 284);  // 5.5 and 6.5: 284.5 and 283.5, half to even
  EXPECT_TRUE(f.price.Has("line solid 64,284,66,284 38"));
  // A rise: the slower average lies lower on the screen, and takes the same colour.
  EXPECT_TRUE(Drawn(f, 'L', 40, 0).empty());
}

TEST(MacdTest, TheSlowerAverageAboveTheOtherOnTheScreenHasTheOtherColour) {
  OscFixture f;
  Rise(f, 60, 200, -1);
  ShowMACD(f.host);
  EXPECT_EQ(Drawn(f, 'L', 38, 0).size(), 48u);
  EXPECT_EQ(Drawn(f, 'L', 40, 0).size(), 22u);
}

TEST(MacdTest, NoLineLeavesAYOfZero) {
  OscFixture f;
  Rise(f, 60);
  SetPriceMap(f, 0.5f, 13);
  ShowMACD(f.host);
  // 5.5, 6.5, 7.5 at bars 11 to 13 stand at 2, 0, -2.
  const auto ema = Drawn(f, 'L', 38, 0);
  ASSERT_EQ(ema.size(), 47u + 22u);  // the first average has none to bar 13
  EXPECT_SEGMENT(ema[0], 64, 2, 66, 0);
  EXPECT_SEGMENT(ema[1], 68, -2, 70, -4);
}

TEST(MacdTest, TheMultiOscillatorViewShowsTheHistogramOnly) {
  OscFixture f;
  Rise(f, 60);
  f.host.OscCaller = "ANAL";
  f.host.PanelOffsetY = 500;
  ShowMACD(f.host);
  EXPECT_TRUE(f.price.ops.empty());
  EXPECT_TRUE(Drawn(f, 'L', 38).empty());
  EXPECT_EQ(Drawn(f, 'H', 36, 500).size(), 13u);
  EXPECT_EQ(f.Lines('B'), std::vector<std::string>{"B,42,503,630,641,16"});
}

TEST(MacdTest, WeeksAndMonthsReadTheTwins) {
  OscFixture f;
  Rise(f, 60);
  f.settings.osc[kMd1].twin = 5;
  f.request.ChartPeriod = Period::kMonthly;
  ShowMACD(f.host);
  EXPECT_EQ(f.Lines('T').at(0), "T,8.25,44,313,MACD ( 5 / 26 / 9  Period )  ,27");
}

TEST(MacdTest, EqualClosesLeaveTheFrame) {
  OscFixture f;
  Rise(f, 60, 5, 0);
  ShowMACD(f.host);
  EXPECT_EQ(f.script.text(), "B,42,311,630,449,16\r\n");
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(MacdTest, FewerBarsThanTheFirstSignalNeedsLeaveTheFrame) {
  OscFixture f;
  Rise(f, 46);  // bars 0 to 45
  ShowMACD(f.host);
  EXPECT_EQ(f.script.text(), "B,42,311,630,449,16\r\n");
  EXPECT_TRUE(f.price.ops.empty());
}

TEST(MacdTest, OneOfThreePeriodsMissingDrawsNothing) {
  for (const OscKey* pair : {&kMd1, &kMd2, &kMd3}) {
    OscFixture f;
    Rise(f, 60);
    f.settings.osc[*pair] = {};
    ShowMACD(f.host);
    EXPECT_TRUE(f.panel.ops.empty());
    EXPECT_EQ(f.script.text(), "");
  }
}

TEST(MacdTest, AnAverageFarOffThePictureEndsInTheMessage) {
  OscFixture f;
  Rise(f, 60);
  SetPriceMap(f, 0.0001f);
  ShowMACD(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
}

TEST(MacdTest, RealPricesAgreeWithTheAveragesWrittenOut) {
  OscFixture f;
  if (!SetRealBars(f, "AAPL")) GTEST_SKIP() << "no real prices here";
  const MacdSeries s = Macd(f.chart.Bars, 12, 26, 9);
  // Each average as the weighted sum of its last closes and of its seed.
  const auto weighted = [](auto value, int first, double seed, int n, int i) {
    const double k = 2.0 / (n + 1);
    double sum = 0, weight = 1;
    for (int j = i; j > first; --j, weight *= 1 - k) sum += weight * k * value(j);
    return sum + weight * seed;
  };
  const auto close = [&](int i) { return double(f.chart.Bars[size_t(i)].Close); };
  const auto mean = [&](int from, int to) {
    double sum = 0;
    for (int i = from; i <= to; ++i) sum += close(i);
    return sum / (to - from + 1);
  };
  std::vector<double> difference(s.ema1.size());
  const double seed1 = mean(0, 11), seed2 = mean(12, 37);
  for (int i = 37; i <= f.chart.Bars.BarCount; ++i) {
    const double ema1 = weighted(close, 11, seed1, 12, i);
    const double ema2 = weighted(close, 37, seed2, 26, i);
    difference[size_t(i)] = ema1 - ema2;
    ASSERT_NEAR(s.ema1[size_t(i)], ema1, 1e-3) << "bar " << i;
    ASSERT_NEAR(s.ema2[size_t(i)], ema2, 1e-3) << "bar " << i;
  }
  double seed3 = 0;
  for (int i = 37; i <= 46; ++i) seed3 += difference[size_t(i)] / 9;
  for (int i = 46; i <= f.chart.Bars.BarCount; ++i) {
    const double signal = weighted([&](int j) { return difference[size_t(j)]; }, 46, seed3, 9, i);
    ASSERT_NEAR(s.signal[size_t(i)], signal, 1e-3) << "bar " << i;
  }
}
