#include "indicators/coppock.h"

#include <gtest/gtest.h>

#include <cmath>

#include "indicators/oscillators.h"
#include "indicators/value_frame.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

CoppockSeries Cop(const std::vector<float>& closes, int period) {
  OscFixture f;
  f.Closes(closes);
  return Coppock(f.chart.Bars, period);
}

using Column = std::vector<std::int16_t>;

// Rise, an empty bar, and two bars that still look back at it.
const std::vector<float> kGap{100, 100, 100, 110, 0, 121, 121, 121};

}  // namespace

TEST(CoppockTest, TheTwoLookbacksAreThePeriodAndOneLess) {
  // k = 2/3. Bar 3: 10% over both, 20 * 2/3 = 13.3. Bar 4: 21% over two bars and 10% over one:
  // 31 * 2/3 + 13 / 3 = 25.
  EXPECT_EQ(Cop({100, 100, 100, 110, 121}, 2).smoothed, (Column{0, 0, 0, 13, 25}));
}

TEST(CoppockTest, TheStateIsAWholeNumberAtEveryStep) {
  // k = 1/2, a raw sum of 1 a bar: 0.5 is 0, half to even, and never gets anywhere.
  EXPECT_EQ(Cop({100, 100, 100, 100, 100.5f}, 3).smoothed[4], 0);
  // A raw sum of 3: 1.5 is 2.
  EXPECT_EQ(Cop({100, 100, 100, 100, 101.5f}, 3).smoothed[4], 2);
}

TEST(CoppockTest, FineMovesDieOut) {
  // 0.2% a bar makes a raw sum of 1 (0.6 + 0.4): a state of half a unit, rounded away each bar.
  std::vector<float> closes{100, 100, 100, 100};
  for (int i = 0; i < 50; ++i) closes.push_back(closes.back() * 1.0019f);
  for (const std::int16_t v : Cop(closes, 3).smoothed) EXPECT_EQ(v, 0);
}

TEST(CoppockTest, AZeroCloseMakesTheBarZeroAndLeavesTheState) {
  // 13 at bar 3; bars 4 to 6 miss a close; at bar 7 nothing moved: 13 / 3 = 4.3.
  EXPECT_EQ(Cop(kGap, 2).smoothed, (Column{0, 0, 0, 13, 0, 0, 0, 4}));
}

TEST(CoppockTest, TheLineBridgesZeroedBars) {
  OscFixture f;
  f.settings.osc[kCopD].daily = 2;
  f.Closes(kGap);
  ShowCoppock(f.host);
  // 0 to 13 on 110 units from 127.2 up: 17.2 and 127.2 - 33.8.
  const auto line = Drawn(f, 'H', 45);
  ASSERT_EQ(line.size(), 1u);
  EXPECT_SEGMENT(line[0], 48, 17, 56, 93);
}

TEST(CoppockTest, TitleLabelsAndLines) {
  OscFixture f;
  f.settings.osc[kCopD].daily = 2;
  f.Closes(kGap);
  ShowCoppock(f.host);
  const auto lines = Drawn(f, 'L', 16);
  ASSERT_EQ(lines.size(), 3u);
  EXPECT_SEGMENT(lines[0], 42, 23, 630, 23);
  EXPECT_SEGMENT(lines[1], 42, 121, 630, 121);
  EXPECT_SEGMENT(lines[2], 42, 127, 630, 127);
  // A digit is 6.1 wide: 12 and 6.
  EXPECT_EQ(f.Lines('T'),
            (std::vector<std::string>{"T,8.25,44,313,Coppock    2 Period,27", "T,8.25,25,325,13,27",
                                      "T,8.25,31,423,0,27", "T,8.25,31,429,0,27"}));
}

TEST(CoppockTest, AStateBeyond16BitsEndsInTheMessage) {
  OscFixture f;
  f.settings.osc[kCopD].daily = 2;
  f.Closes({0.001f, 0.001f, 0.001f, 5000});
  ShowCoppock(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
}

TEST(CoppockTest, TwoBarsDrawNothingAndFewerThanThePeriodTheFrame) {
  OscFixture f;
  f.settings.osc[kCopD].daily = 1;
  f.Closes({10, 11});
  ShowCoppock(f.host);
  EXPECT_EQ(f.script.text(), "");
  f.settings.osc[kCopD].daily = 200;
  f.Closes({10, 11, 12});
  ShowCoppock(f.host);
  EXPECT_EQ(f.script.text(), "B,42,311,630,449,16\r\n");
}

TEST(CoppockTest, RealPricesAgreeWithRatesOfChangeKeptWhole) {
  OscFixture f;
  if (!SetRealBars(f, "AAPL")) GTEST_SKIP() << "no real prices here";
  const size_t P = 14;
  const CoppockSeries s = Coppock(f.chart.Bars, int(P));
  int state = 0;
  for (size_t i = P + 1; i < s.smoothed.size(); ++i) {
    const double c = f.chart.Bars[i].Close;
    const double raw =
        100 * (c / f.chart.Bars[i - P].Close + c / f.chart.Bars[i - P + 1].Close - 2);
    state = int(std::nearbyint((2 * raw + 13.0 * state) / 15));
    ASSERT_EQ(s.smoothed[i], state) << "bar " << i;
  }
}

TEST(ValueFrameTest, ASeriesAboveZeroIsSpreadFromZeroWithLowestAsTheOffset) {
  OscFixture f;
  const OscPanel panel(f.host);
  const ValueFrame frame(panel, 3, 1);
  // 3 to 110 units, from 127.2 up.
  EXPECT_EQ(frame.Y(3), 54);  // 127.2 - 73.3
  EXPECT_EQ(frame.Y(1), 127);
  EXPECT_EQ(frame.Y(0), 164);  // below the panel
}

TEST(ValueFrameTest, ASeriesBelowZeroIsSpreadFromItsLowest) {
  OscFixture f;
  const OscPanel panel(f.host);
  const ValueFrame frame(panel, 3, -1);
  EXPECT_EQ(frame.Y(3), 17);
  EXPECT_EQ(frame.Y(0), 100);  // 127.2 - 27.5 = 99.7
}

TEST(ValueFrameTest, NothingToSpreadIsEmpty) {
  OscFixture f;
  const OscPanel panel(f.host);
  EXPECT_TRUE(ValueFrame(panel, 0, 100000).Empty());
  EXPECT_TRUE(ValueFrame(panel, 0, 0).Empty());
  EXPECT_FALSE(ValueFrame(panel, 0, -1).Empty());
}
