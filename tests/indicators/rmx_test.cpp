#include "indicators/rmx.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>

#include "tests/indicators/compare_fixture.h"
#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"

using namespace kora;
using namespace kora::test;

using Texts = std::vector<std::string>;

namespace {

// In the panel of 144 units (3 to 141) the highest value stands at 23, the lowest at 121, and
// the middle is 72. The script's y is 308 more.
struct Rmx : CompareFixture {
  Rmx(std::int16_t P, std::int16_t A) {
    host.OscCode = "RMX";
    settings.osc[kRmxP].daily = P;
    settings.osc[kRmxA].daily = A;
  }
  // Lines of the data in a colour entry.
  Texts Data(int entry) const {
    Texts out;
    const std::string end = "," + std::to_string(entry);
    for (const std::string& line : Lines('L'))
      if (line.ends_with(end)) out.push_back(line);
    return out;
  }
};

const std::vector<float> kOnes(6, 1.0f);
// Ratios 1, 1.5, 1, 3, 1, 1.5; means of two less the ratio: -0.25, 0.25, -1, 1, -0.25.
const std::vector<float> kIndexCloses{100, 150, 100, 300, 100, 150};
constexpr const char* kFrame = "B,42,311,630,449,16\r\n";

}  // namespace

TEST(RmxTest, PanelByHand) {
  Rmx f(2, 2);
  f.Put(kOnes, kIndexCloses);
  ShowRMX(f.host);
  // Range -1 to 1, 49 units to one.
  // bar  x   value  y            mean y       range so far   y of zero in it
  // 1    44  -0.25  84.25, 84                 -0.25..0       23
  // 2    46  0.25   59.75, 60    72           -0.25..0.25    72
  // 3    48  -1     121          90.5, 90     -1..0.25       121 - 78.4 = 42.6, 43
  // 4    50  1      23           72           -1..1          72
  // 5    52  -0.25  84           53.5, 54     -1..1          72
  EXPECT_EQ(f.Data(45), (Texts{"L,44,392,46,368,45", "L,46,368,48,429,45", "L,48,429,50,331,45",
                               "L,50,331,52,392,45"}));
  EXPECT_EQ(f.Data(46), (Texts{"L,46,380,48,398,46", "L,48,398,50,380,46", "L,50,380,52,362,46"}));
  EXPECT_EQ(f.Data(47), (Texts{"L,46,380,48,351,47", "L,48,351,50,380,47", "L,50,380,52,380,47"}));
  EXPECT_TRUE(f.panel.Has("line solid 48,121,50,23 45"));
}

TEST(RmxTest, TextsGuidesAndTicks) {
  Rmx f(2, 0);
  f.Put(kOnes, kIndexCloses);
  ShowRMX(f.host);
  const std::string start =
      std::string(kFrame) +
      "T,8.25,44,451,RMX Oscillator (2 Period)   Compared to INDEX   0 Ave           CenterLine = "
      "0  (0),27\r\n"
      // Zero, lowest; 0.8 of the highest 32.8, of the lowest 111.2. The labels are 19 wide.
      "L,42,380,630,380,16\r\nL,42,429,630,429,16\r\n"
      "L,42,341,630,341,16\r\nT,8.25,18,335,O/B,27\r\n"
      "L,42,419,630,419,16\r\nT,8.25,18,413,O/S,27\r\n"
      // Ticks at 0.2, 0.4, 0.6 and 1: 62.2, 52.4, 42.6, 23 and 81.8, 91.6, 101.4, 121.
      "L,38,370,42,370,16\r\nL,38,360,42,360,16\r\nL,38,351,42,351,16\r\nL,38,331,42,331,16\r\n"
      "L,38,390,42,390,16\r\nL,38,400,42,400,16\r\nL,38,409,42,409,16\r\nL,38,429,42,429,16\r\n";
  EXPECT_EQ(f.script.text().substr(0, start.size()), start);
  // Last y 84, before it 23: 12 below and 49 above the middle.
  EXPECT_EQ(f.Lines('T').back(), "T,8.25,432,463,RMX   -12 (49),27");
  EXPECT_TRUE(f.Data(46).empty());
}

TEST(RmxTest, CenterLineIsToldAsItsOffsetFromTheMiddle) {
  Rmx f(2, 0);
  // Ratios 1, 2, 5: values -0.5 and -1.5. Zero is the highest, 23, 49 above the middle.
  f.Put({1, 1, 1}, {100, 200, 500});
  ShowRMX(f.host);
  EXPECT_EQ(f.Lines('T')[0],
            "T,8.25,44,451,RMX Oscillator (2 Period)   Compared to INDEX   0 Ave           "
            "CenterLine = 49  (49),27");
}

TEST(RmxTest, LowestAboveZeroHasItsOversoldLineAboveZero) {
  Rmx f(2, 0);
  // Ratios 4, 3, 1.5, 1: values 0.5, 0.75, 0.25. Zero stands at 121 + 0.25 * 196 = 170 and 0.2,
  // which is 0.8 of the lowest, at 130.8.
  f.Put(std::vector<float>(4, 1.0f), {400, 300, 150, 100});
  ShowRMX(f.host);
  EXPECT_EQ(f.Lines('L')[0], "L,42,478,630,478,16");
  EXPECT_EQ(f.Lines('L')[3], "L,42,439,630,439,16");
  EXPECT_EQ(f.Lines('T')[2], "T,8.25,18,433,O/S,27");
}

TEST(RmxTest, RangeOfZeroSoFarGivesTheCentrePathNoPoint) {
  Rmx f(2, 0);
  // As above with two bars more: values 0.5 (range 0), 0.75, 0.25, then ratio 2: -0.5, 1: 0.5.
  // Centre from bar 3: 0.25..0.75 has zero at 121 + 0.25 * 196 = 170; -0.5..0.75 at
  // 121 - 0.5 * 78.4 = 81.8. Bar 2 (0.5..0.75): 121 + 0.5 * 392 = 317. Bar 1 has no point.
  f.Put(kOnes, {400, 300, 150, 100, 200, 100});
  ShowRMX(f.host);
  EXPECT_EQ(f.Data(47), (Texts{"L,46,625,48,478,47", "L,48,478,50,390,47", "L,50,390,52,390,47"}));
  const RmxSeries series = RmxValues(f.chart.Bars, std::vector<float>{400, 300}, 2);
  EXPECT_TRUE(series.Points[1].Stored);
  EXPECT_EQ(series.Points[1].Highest, series.Points[1].Lowest);
}

TEST(RmxTest, CentreBeyond16BitsHasNoPointAndEndsNothing) {
  Rmx f(2, 0);
  // Values 0.5 and 0.5 + 2^-14: zero lies 98 * 8192 units below, until -0.75 widens the range.
  f.Put(kOnes, {400, 300, 200 - 200.0f / 16384, 350, 100, 100});
  const RmxSeries series =
      RmxValues(f.chart.Bars, std::vector<float>{400, 300, 200 - 200.0f / 16384, 350, 100, 100}, 2);
  ASSERT_LT(series.Points[2].Highest - series.Points[2].Lowest, 0.001f);
  ASSERT_GT(series.Points[2].Highest, series.Points[2].Lowest);
  ShowRMX(f.host);
  EXPECT_TRUE(f.dialogs.said.empty());
  EXPECT_EQ(f.Data(45).size(), 3u);
  EXPECT_EQ(f.Data(47).size(), 1u);  // from bar 3, the first point, to bar 4
}

TEST(RmxTest, CentrePathBeginsAtBarThree) {
  Rmx f(2, 0);
  f.Put(kOnes, kIndexCloses);
  ShowRMX(f.host);
  EXPECT_EQ(f.Data(45)[0].substr(0, 5), "L,44,");
  EXPECT_EQ(f.Data(47)[0].substr(0, 5), "L,46,");
}

TEST(RmxTest, PeriodOfOneHasNoValues) {
  Rmx f(1, 0);
  f.Put(kOnes, kIndexCloses);
  ShowRMX(f.host);  // each ratio is its own mean
  EXPECT_EQ(f.script.text(), kFrame);
}

TEST(RmxTest, SecurityComparedWithItselfLeavesTheFrameOnly) {
  Rmx f(7, 2);
  std::vector<float> closes;
  for (int i = 0; i < 60; ++i) closes.push_back(float(3.17 + 0.37 * i));
  f.PutPrices("TEST.WDT", closes);
  f.settings.osc.CompFile = "C:\\korawin\\data\\TEST.WDT";
  f.Closes(closes);
  ShowRMX(f.host);
  EXPECT_EQ(f.script.text(), kFrame);
}

TEST(RmxTest, ZeroCloseIsPassedOverAndKeepsItsRoom) {
  Rmx f(2, 0);
  std::vector<float> security = kOnes, index = kIndexCloses;
  security.insert(security.begin() + 3, 0.0f);
  index.insert(index.begin() + 3, 777.0f);
  f.Put(security, index);
  ShowRMX(f.host);
  // Bar 3 is empty: the line to bar 4 begins one spacing left of it with the y of bar 2.
  EXPECT_EQ(f.Data(45), (Texts{"L,44,392,46,368,45", "L,48,368,50,429,45", "L,50,429,52,331,45",
                               "L,52,331,54,392,45"}));
}

TEST(RmxTest, ZeroCloseOfTheCompareFileIsARatioOfZero) {
  OscFixture f;
  f.Closes({1, 1, 1});
  const RmxSeries series = RmxValues(f.chart.Bars, std::vector<float>{100, 0, 100}, 2);
  EXPECT_EQ(series.Points[1].Value, 0.5f);
  EXPECT_EQ(series.Points[2].Value, -0.5f);
}

TEST(RmxTest, BarsOnShowGoWithTheLastRecordsOfTheCompareFile) {
  Rmx f(2, 0), g(2, 0);
  f.Put(kOnes, kIndexCloses);
  std::vector<float> longer{900, 800, 700};
  longer.insert(longer.end(), kIndexCloses.begin(), kIndexCloses.end());
  g.Put(kOnes, longer);
  ShowRMX(f.host);
  ShowRMX(g.host);
  EXPECT_EQ(f.script.text(), g.script.text());
}

TEST(RmxTest, ShorterCompareFileBeginsAtBarZero) {
  Rmx f(2, 0);
  f.Put(kOnes, {100, 150, 100});
  ShowRMX(f.host);
  // Values of bars 1 and 2 alone: -0.25 and 0.25, at 121 and 23.
  EXPECT_EQ(f.Data(45), (Texts{"L,44,429,46,331,45"}));
}

TEST(RmxTest, WithNoValueTheStartRangeStands) {
  for (const std::int16_t P : std::initializer_list<std::int16_t>{7, 200, 201, 32767}) {
    Rmx f(P, 2);
    f.Put(kOnes, P == 7 ? std::vector<float>() : kIndexCloses);
    ShowRMX(f.host);
    // Highest 0 and lowest 100000: zero at 121 - 98 = 23, lowest at 121.
    EXPECT_EQ(f.Lines('L')[0], "L,42,331,630,331,16");
    EXPECT_EQ(f.Lines('L')[1], "L,42,429,630,429,16");
    EXPECT_TRUE(f.Data(45).empty());
    EXPECT_TRUE(f.dialogs.said.empty());
  }
}

TEST(RmxTest, TitleAndValuesStandWithinThePictureOfTheWindow) {
  for (const double height : {100.0, 144.0, 190.0, 400.0}) {
    Rmx f(2, 0);
    f.Put(kOnes, kIndexCloses);
    f.panel.SetScale(0, 0, 638, height);
    ShowRMX(f.host);
    // The values begin 14 below the frame, whose end is at 141 units; a line of text is 14 high.
    EXPECT_EQ(f.Lines('B')[0], "B,42,311,630,449,16") << "the script is that of 144 units";
    const double unit = f.panel.Height() / f.panel.ScaleHeight();
    EXPECT_LE((141 + 14) * unit + 14, f.panel.Height() + 0.2) << height;
  }
}

TEST(RmxTest, AViewOfPanelsLeavesRoomForTheTextsBelowTheFrame) {
  Rmx f(2, 0);
  f.Put(kOnes, kIndexCloses);
  f.host.OscCaller = "ANAL";
  f.host.PanelOffsetY = 1000;
  ShowRMX(f.host);
  // A panel of 144: 2% from the top, 28 units more than 2% from its end.
  EXPECT_EQ(f.Lines('B')[0], "B,42,1003,630,1113,16");
  // 110 units for -1 to 1 with no inset; the middle is 58.
  EXPECT_EQ(f.Data(45), (Texts{"L,44,1072,46,1044,45", "L,46,1044,48,1113,45",
                               "L,48,1113,50,1003,45", "L,50,1003,52,1072,45"}));
  EXPECT_EQ(f.Lines('T').back(), "T,8.25,432,1127,RMX   -14 (55),27");
}

TEST(RmxTest, WeeklyAndMonthlyChartsAreDrawnWithTheTwinPeriods) {
  Rmx f(0, 0);
  f.settings.osc[kRmxP].twin = 2;
  f.request.ChartPeriod = Period::kWeekly;
  f.Put(kOnes, kIndexCloses);
  ShowRMX(f.host);
  EXPECT_EQ(f.Data(45).size(), 4u);
}

TEST(RmxTest, PeriodOfZeroOrRefusedCompareFileDrawsNothing) {
  Rmx f(0, 2);
  f.Put(kOnes, kIndexCloses);
  ShowRMX(f.host);
  EXPECT_TRUE(f.dialogs.said.empty());
  f.settings.osc[kRmxP].daily = 2;
  f.settings.osc.CompFile = "c:\\korawin\\data\\index.dat";
  ShowRMX(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, kBadCompareFile);
  EXPECT_TRUE(f.panel.ops.empty());
  EXPECT_EQ(f.script.text(), "");
  EXPECT_EQ(f.settings.osc.CompFile, "c:\\korawin\\data\\index.dat");
}

TEST(RmxTest, CompareFileGoneAtTheTimeOfReadingLeavesTheFrame) {
  Rmx f(2, 0);
  f.Put(kOnes, kIndexCloses);
  GoneIo io;
  Files files(f.home.path(), io);
  OscHost host{files,   f.dialogs, f.settings, f.colours, f.request,
               f.chart, f.price,   f.panel,    &f.script};
  ShowRMX(host);
  EXPECT_EQ(f.script.text(), kFrame);
  EXPECT_TRUE(f.dialogs.said.empty());
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(RmxTest, ReadErrorIsToldByItsNumber) {
  Rmx f(2, 0);
  f.Put(kOnes, kIndexCloses);
  FailingIo io;
  io.failReadAt = 2;
  Files files(f.home.path(), io);
  OscHost host{files,   f.dialogs, f.settings, f.colours, f.request,
               f.chart, f.price,   f.panel,    &f.script};
  ShowRMX(host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text.rfind("There is an unexpected error No. 57\n", 0), 0u);
}

TEST(RmxTest, NegativePeriodIsAnIndexOutOfRange) {
  OscFixture f;
  f.Closes(kOnes);
  for (const int P : {-1, -200, -32768})
    EXPECT_EQ(ErrorOf([&] { RmxValues(f.chart.Bars, kIndexCloses, P); }), 9);
}

TEST(RmxTest, PriceThatIsNoNumberEndsInTheMessage) {
  Rmx f(2, 0);
  std::vector<float> index = kIndexCloses;
  index[3] = std::numeric_limits<float>::quiet_NaN();
  f.Put(kOnes, index);
  ShowRMX(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "Chart Display");
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
}

TEST(RmxTest, BarBeyond16BitsIsAnOverflow) {
  Rmx f(2, 0);
  f.Put(kOnes, kIndexCloses);
  f.chart.BarSpacing = 20000;  // bar 2 would stand at 40,042
  ShowRMX(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
}

TEST(RmxTest, RealPricesAgreeWithAPlainComputation) {
  std::vector<ChartBar> prices = RealBars("AAPL"), index = RealBars("INTC");
  if (prices.empty()) GTEST_SKIP() << "no real prices here";
  prices.erase(prices.begin(), prices.end() - 1000);
  constexpr size_t P = 100, A = 20;
  Rmx f(P, A);
  std::vector<float> closes, indexCloses;
  for (const ChartBar& bar : prices) closes.push_back(bar.Close);
  for (const ChartBar& bar : index) indexCloses.push_back(bar.Close);
  f.Put(closes, indexCloses);
  ShowRMX(f.host);
  ASSERT_TRUE(f.dialogs.said.empty());

  const size_t n = closes.size();
  std::vector<float> ratio(n), value(n);
  std::vector<double> centre(n), y(n);
  double high = 0, low = 1e5;
  for (size_t i = 0; i < n; ++i) {
    ratio[i] = float(indexCloses[indexCloses.size() - n + i] / (100.0 * closes[i]));
    if (i + 1 < P) continue;
    double sum = 0;
    for (size_t j = i + 1 - P; j <= i; ++j) sum += ratio[j];
    value[i] = float(sum / P - ratio[i]);
    ASSERT_NE(value[i], 0);
    high = std::max<double>(high, value[i]);
    low = std::min<double>(low, value[i]);
    centre[i] = std::nearbyint(121 + low / ((high - low) / 98));
  }
  for (size_t i = P - 1; i < n; ++i)
    y[i] = std::nearbyint(121 - (value[i] - low) / ((high - low) / 98));
  const auto mean = [&](size_t i) {
    double sum = 0;
    for (size_t j = i + 1 - A; j <= i; ++j) sum += y[j];
    return std::nearbyint(sum / A);
  };
  Texts values, averages, centres;
  for (size_t i = P; i < n; ++i) {
    const std::string from = "L," + Str(40.0 + 2 * double(i)) + ",";
    const std::string to = "," + Str(42.0 + 2 * double(i)) + ",";
    values.push_back(from + Str(308 + y[i - 1]) + to + Str(308 + y[i]) + ",45");
    if (std::isfinite(centre[i - 1]))  // the range of the first value alone is 0
      centres.push_back(from + Str(308 + centre[i - 1]) + to + Str(308 + centre[i]) + ",47");
    if (i >= P - 1 + A)
      averages.push_back(from + Str(308 + mean(i - 1)) + to + Str(308 + mean(i)) + ",46");
  }
  EXPECT_EQ(f.Data(45), values);
  EXPECT_EQ(f.Data(46), averages);
  EXPECT_EQ(f.Data(47), centres);
}
