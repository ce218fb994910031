#include "indicators/rmo.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>

#include "tests/indicators/compare_fixture.h"
#include "tests/support/error_of.h"

using namespace kora;
using namespace kora::test;

using Texts = std::vector<std::string>;

namespace {

// In a panel of 144 (3 to 141) the highest value stands at 23 and the lowest at 121. The
// script's y is 308 more.
struct Rmo : CompareFixture {
  Rmo(std::int16_t P, std::int16_t A) {
    host.OscCode = "RMO";
    settings.osc[kRmoP].daily = P;
    settings.osc[kRmoA].daily = A;
  }
  Texts Averages() const {
    Texts lines = Lines('L');
    lines.erase(lines.begin(), lines.begin() + 3);
    return lines;
  }
};

const std::vector<float> kOnes(7, 1.0f);
// Ratios 1, 2, 1, 3, 1, 1.5, 6; means of two less the ratio: -0.5, 0.5, -1, 1, -0.25, -2.25.
const std::vector<float> kIndexCloses{100, 200, 100, 300, 100, 150, 600};

}  // namespace

TEST(RmoTest, ValueIsTheMeanOfTheRatiosLessTheRatio) {
  std::vector<RelRec> series = PairFromEnd(kOnes, kIndexCloses);
  SetRmoValues(series, 2);
  std::vector<float> values;
  for (const RelRec& r : series) values.push_back(r.Value);
  EXPECT_EQ(values, (std::vector<float>{0, -0.5f, 0.5f, -1, 1, -0.25f, -2.25f}));
}

TEST(RmoTest, PanelByHandOnARunningScale) {
  Rmo f(2, 2);
  f.Put(kOnes, kIndexCloses);
  ShowRMO(f.host);
  // value   range        y      drawn  x    mean y
  // -0.5    0            left
  //  0.5    -0.5..0.5    23     1      40
  // -1      -1..0.5      121    2      42   72
  //  1      -1..1        23     3      44   72
  // -0.25   -1..1        84.25  4      46   53.5, 54
  // -2.25   -2.25..1     121    5      48   102.5, 102
  // On the range of the whole series the -1 would stand at 83.
  EXPECT_EQ(f.Lines('H'),
            (Texts{"H,42,429,44,331,45", "H,44,331,46,392,45", "H,46,392,48,429,45"}));
  EXPECT_EQ(f.Averages(),
            (Texts{"L,42,380,44,380,46", "L,44,380,46,362,46", "L,46,362,48,410,46"}));
  EXPECT_TRUE(f.panel.Has("line solid 42,121,44,23 45"));
}

TEST(RmoTest, FrameTitleAndGuidesHaveNoRegardToTheData) {
  Rmo f(30, 10);
  f.Put(kOnes, kIndexCloses);
  ShowRMO(f.host);
  // Middle (141 - 3) \ 2 + 1.
  EXPECT_EQ(f.script.text(),
            "B,42,311,630,449,16\r\n"
            "T,8.25,44,313,RMO Oscillator (30 Period)   Compared to INDEX   10 Ave,27\r\n"
            "L,42,378,630,378,16\r\n"
            "L,42,336,630,336,16\r\nT,8.25,2,330, +80,27\r\n"
            "L,42,424,630,424,16\r\nT,8.25,2,418, -80,27\r\n");
  EXPECT_TRUE(f.dialogs.said.empty());
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(RmoTest, WithoutAnAverageTheValueAloneIsDrawn) {
  Rmo f(2, 0);
  f.Put(kOnes, kIndexCloses);
  ShowRMO(f.host);
  EXPECT_EQ(f.Lines('H').size(), 3u);
  EXPECT_TRUE(f.Averages().empty());
}

TEST(RmoTest, FirstFullAverageDrawsNoLine) {
  Rmo f(2, 4);
  f.Put(kOnes, kIndexCloses);
  ShowRMO(f.host);
  // 23 + 121 + 23 + 84 = 251, 62.75, 63 at x 46; then 121 + 23 + 84 + 121 = 349, 87.25.
  EXPECT_EQ(f.Averages(), (Texts{"L,46,371,48,395,46"}));
}

TEST(RmoTest, BarWithNoRangeCountsTwiceSoThatThePlotStartsEarlier) {
  Rmo f(2, 0);
  f.Put(kOnes, kIndexCloses);
  f.chart.Bars.FirstDataRec = 5;
  ShowRMO(f.host);
  // The bar with no range counted twice: record 4 is seen as 5 and is the first drawn, at x 40.
  EXPECT_EQ(f.Lines('H'), (Texts{"H,42,331,44,392,45", "H,44,392,46,429,45"}));
}

TEST(RmoTest, SingleValueHasNoRangeAndIsNotDrawn) {
  Rmo f(2, 0);
  // The ratio rises once and stays: -0.5, then zeros.
  f.Put(std::vector<float>(4, 1.0f), {100, 200, 200, 200});
  ShowRMO(f.host);
  EXPECT_TRUE(f.Lines('H').empty());
}

TEST(RmoTest, ZeroCloseIsPassedOverAndTakesNoRoom) {
  Rmo f(2, 0);
  std::vector<float> security = kOnes, index = kIndexCloses;
  security.insert(security.begin() + 4, 0.0f);
  index.insert(index.begin() + 4, 777.0f);
  f.Put(security, index);
  ShowRMO(f.host);
  EXPECT_EQ(f.Lines('H'),
            (Texts{"H,42,429,44,331,45", "H,44,331,46,392,45", "H,46,392,48,429,45"}));
}

TEST(RmoTest, FilesArePairedFromTheirEndsWhateverTheirDates) {
  Rmo f(2, 0);
  std::vector<float> index = kIndexCloses;
  index.insert(index.begin(), {7, 8, 9});
  f.Put(kOnes, index);
  ShowRMO(f.host);
  EXPECT_EQ(f.Lines('H').size(), 3u);
  EXPECT_EQ(f.Lines('H')[0], "H,42,429,44,331,45");
}

TEST(RmoTest, FirstRecordIsPairedToo) {
  const std::vector<RelRec> series =
      PairFromEnd(std::vector<float>{1, 1}, std::vector<float>{500, 600});
  EXPECT_EQ(series[0].Ratio, 5);
}

TEST(RmoTest, ShorterCompareFileLeavesTheOldestElementsZero) {
  const std::vector<RelRec> series =
      PairFromEnd(std::vector<float>{1, 1, 1, 1}, std::vector<float>{500, 600});
  EXPECT_EQ(series[0].Ratio, 0);
  EXPECT_EQ(series[1].Ratio, 0);
  EXPECT_EQ(series[2].Ratio, 5);
  EXPECT_EQ(series[3].Ratio, 6);
  Rmo f(2, 0);
  std::vector<float> longer(10, 1.0f);
  longer.insert(longer.end(), kOnes.begin(), kOnes.end());
  f.Put(longer, kIndexCloses);
  ShowRMO(f.host);
  EXPECT_EQ(f.Lines('H')[0], "H,42,429,44,331,45");
}

TEST(RmoTest, OldestRecordsOfAFileOver30000Drop) {
  Rmo f(2, 0);
  std::vector<float> security(30010, 1.0f), index(30010);
  for (size_t i = 0; i < index.size(); ++i)
    index[i] = i < 10 ? 1e6f * float(i + 1) : i % 2 ? 200.0f : 100.0f;
  f.PutPrices("TEST.WDT", security);
  f.PutPrices("INDEX.WDT", index);
  f.chart.Bars.FirstDataRec = 29990;
  ShowRMO(f.host);
  // Values of 0.5 and -0.5 by turns stand at the ends of the plot as no larger one came before.
  // The 30,000 elements are seen as 1 to 30,001, one counted twice: 12 are drawn.
  const Texts lines = f.Lines('H');
  ASSERT_EQ(lines.size(), 10u);
  for (size_t i = 0; i < lines.size(); ++i) {
    const bool up = lines[i].find(",429,") < lines[i].find(",331,");
    EXPECT_NE(lines[i].find(",429,"), std::string::npos) << lines[i];
    EXPECT_NE(lines[i].find(",331,"), std::string::npos) << lines[i];
    if (i) {
      EXPECT_NE(up, lines[i - 1].find(",429,") < lines[i - 1].find(",331,"));
    }
  }
}

TEST(RmoTest, SecurityComparedWithItselfHasNoValues) {
  Rmo f(3, 2);
  std::vector<float> closes;
  for (int i = 0; i < 40; ++i) closes.push_back(float(3.17 + 0.37 * i));
  f.PutPrices("TEST.WDT", closes);
  f.settings.osc.CompFile = "C:\\korawin\\data\\TEST.WDT";
  f.Closes(closes);
  ShowRMO(f.host);
  EXPECT_TRUE(f.Lines('H').empty());
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(RmoTest, NothingIsDrawnOnWeeklyAndMonthlyCharts) {
  for (const Period period : {Period::kWeekly, Period::kMonthly}) {
    Rmo f(2, 0);
    f.settings.osc[kRmoP].twin = 2;
    f.request.ChartPeriod = period;
    f.Put(kOnes, kIndexCloses);
    ShowRMO(f.host);
    EXPECT_TRUE(f.panel.ops.empty());
    EXPECT_EQ(f.script.text(), "");
  }
}

TEST(RmoTest, PeriodOfZeroDrawsNothingAndDoesNotAskForTheCompareFile) {
  Rmo f(0, 0);
  f.settings.osc.CompFile = "";
  ShowRMO(f.host);
  EXPECT_TRUE(f.panel.ops.empty());
  EXPECT_EQ(f.script.text(), "");
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(RmoTest, RefusedCompareFileDrawsNothing) {
  Rmo f(2, 0);
  f.Put(kOnes, kIndexCloses);
  for (const char* path : {"", "unknown", "index.wdt", "c:\\korawin\\data\\none.wdt"}) {
    f.settings.osc.CompFile = path;
    f.dialogs.said.clear();
    ShowRMO(f.host);
    ASSERT_EQ(f.dialogs.said.size(), 1u);
    EXPECT_EQ(f.dialogs.said[0].text, kBadCompareFile);
  }
  EXPECT_TRUE(f.panel.ops.empty());
  EXPECT_EQ(f.script.text(), "");
}

TEST(RmoTest, CompareFileGoneAtTheTimeOfReadingDrawsNothing) {
  Rmo f(2, 0);
  f.Put(kOnes, kIndexCloses);
  GoneIo io;
  Files files(f.home.path(), io);
  OscHost host{files,   f.dialogs, f.settings, f.colours, f.request,
               f.chart, f.price,   f.panel,    &f.script};
  ShowRMO(host);
  EXPECT_TRUE(f.panel.ops.empty());
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(RmoTest, EmptyFilesLeaveFrameAndGuides) {
  for (const bool emptySecurity : {false, true}) {
    Rmo f(2, 2);
    f.Put(emptySecurity ? std::vector<float>() : kOnes,
          emptySecurity ? kIndexCloses : std::vector<float>());
    ShowRMO(f.host);
    EXPECT_EQ(f.Lines('L').size(), 3u);
    EXPECT_TRUE(f.Lines('H').empty());
    EXPECT_TRUE(f.dialogs.said.empty());
  }
}

TEST(RmoTest, MissingFileOfTheSecurityIsTold) {
  Rmo f(2, 2);
  f.PutPrices("INDEX.WDT", kIndexCloses);
  ShowRMO(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "Chart Display");
  EXPECT_EQ(f.dialogs.said[0].text.rfind("There is an unexpected error No. 53\n", 0), 0u);
}

TEST(RmoTest, OddPeriodsDrawNothingAndNegativeOnesAreAnIndexOutOfRange) {
  for (const std::int16_t P : std::initializer_list<std::int16_t>{8, 200, 201, 32767}) {
    Rmo f(P, 200);
    f.Put(kOnes, kIndexCloses);
    ShowRMO(f.host);
    EXPECT_TRUE(f.Lines('H').empty());
    EXPECT_TRUE(f.dialogs.said.empty());
  }
  Rmo f(-1, 0);
  f.Put(kOnes, kIndexCloses);
  ShowRMO(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 9\nIndex out of range");
}

TEST(RmoTest, PriceThatIsNoNumberEndsInTheMessage) {
  Rmo f(2, 0);
  std::vector<float> index = kIndexCloses;
  index[4] = std::numeric_limits<float>::quiet_NaN();
  f.Put(kOnes, index);
  ShowRMO(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
}

TEST(RmoTest, BarBeyond16BitsIsAnOverflow) {
  Rmo f(2, 0);
  f.Put(kOnes, kIndexCloses);
  f.chart.BarSpacing = 20000;  // the plot would begin at -39,958
  ShowRMO(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
}

TEST(RmoTest, RealPricesAgreeWithAPlainComputation) {
  const std::vector<ChartBar> prices = RealBars("AAPL"), index = RealBars("INTC");
  if (prices.empty()) GTEST_SKIP() << "no real prices here";
  constexpr size_t P = 30, A = 10;
  Rmo f(P, A);
  std::vector<float> closes, indexCloses;
  for (const ChartBar& bar : prices) closes.push_back(bar.Close);
  for (const ChartBar& bar : index) indexCloses.push_back(bar.Close);
  f.Put(closes, indexCloses);
  const size_t first = closes.size() - 300;
  f.chart.Bars.FirstDataRec = static_cast<std::int16_t>(first + 1);
  ShowRMO(f.host);

  // Ratios where both files have records; every price is there.
  std::vector<float> ratio, value;
  const size_t n = std::min(closes.size(), indexCloses.size());
  for (size_t i = 0; i < n; ++i)
    ratio.push_back(
        float(indexCloses[indexCloses.size() - n + i] / (100.0 * closes[closes.size() - n + i])));
  double high = -1e5, low = 1e5;
  std::vector<double> y;
  size_t doubled = 0;
  for (size_t i = P - 1; i < n; ++i) {
    double sum = 0;
    for (size_t j = i + 1 - P; j <= i; ++j) sum += ratio[j];
    const float v = float(sum / P - ratio[i]);
    ASSERT_NE(v, 0);
    high = std::max<double>(high, v);
    low = std::min<double>(low, v);
    if (high == low) ++doubled;
    const size_t record = closes.size() - n + i + 1;
    if (high != low && record + doubled >= first + 1)
      y.push_back(std::nearbyint(121 - (v - low) / ((high - low) / 98)));
  }
  ASSERT_EQ(doubled, 1u);
  ASSERT_EQ(y.size(), 301u);
  Texts values, averages;
  for (size_t i = 2; i < y.size(); ++i) {
    const std::string from = Str(38.0 + 2 * double(i)) + ",";
    const std::string to = "," + Str(40.0 + 2 * double(i)) + ",";
    values.push_back("H," + from + Str(308 + y[i - 1]) + to + Str(308 + y[i]) + ",45");
    if (i < A) continue;
    double before = 0, now = 0;
    for (size_t j = i + 1 - A; j <= i; ++j) before += y[j - 1], now += y[j];
    averages.push_back("L," + from + Str(308 + std::nearbyint(before / A)) + to +
                       Str(308 + std::nearbyint(now / A)) + ",46");
  }
  EXPECT_EQ(f.Lines('H'), values);
  EXPECT_EQ(f.Averages(), averages);
}
