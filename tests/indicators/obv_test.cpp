#include "indicators/obv.h"

#include <gtest/gtest.h>

#include <limits>

#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"
#include "tests/support/error_of.h"

using namespace kora;
using namespace kora::test;

namespace {

constexpr std::int32_t kMost = std::numeric_limits<std::int32_t>::max();
constexpr std::int32_t kLeast = std::numeric_limits<std::int32_t>::min();

Bar Day(float close, std::int32_t volume) { return {close, close, close, volume}; }

ObvSeries Obv(const std::vector<Bar>& bars) {
  OscFixture f;
  SetBars(f, bars);
  int bar = 0;
  return OnBalanceVolume(f.chart.Bars, bar);
}

using Totals = std::vector<std::int32_t>;

const std::vector<Bar> kFive{Day(10, 7), Day(11, 500), Day(10, 200), Day(10, 100), Day(12, 300)};

}  // namespace

TEST(ObvTest, TheTotalStartsAt100000AndTheFirstBarsVolumeIsNotInIt) {
  EXPECT_EQ(Obv(kFive).totals, (Totals{0, 100500, 100300, 100300, 100600}));
}

TEST(ObvTest, BarsBesideAZeroCloseStoreNothing) {
  const ObvSeries s = Obv({Day(10, 1), Day(0, 50), Day(11, 60), Day(12, 100), Day(11, 30)});
  EXPECT_EQ(s.totals, (Totals{0, 0, 0, 100100, 100070}));
  EXPECT_EQ(s.lowest, 100070);
  EXPECT_EQ(s.highest, 100100);
}

TEST(ObvTest, TwoBarsHaveNoTotals) {
  EXPECT_EQ(Obv({Day(10, 1), Day(11, 50)}).totals, (Totals{0, 0}));
}

TEST(ObvTest, ATotalThatLeaves32BitsIsAnOverflow) {
  EXPECT_EQ(ErrorOf([] { Obv({Day(1, 0), Day(2, kMost), Day(3, 0)}); }), 6);
  EXPECT_EQ(ErrorOf([] { Obv({Day(2, 0), Day(1, kLeast), Day(3, 0)}); }), 6);
  EXPECT_EQ(Obv({Day(2, 0), Day(1, kMost), Day(1, 0)}).total, 100000 - kMost);
  EXPECT_EQ(Obv({Day(1, 0), Day(2, kMost - 100000), Day(2, 0)}).total, kMost);
}

TEST(ObvTest, TheScaleStandsAtTheQuartersWithItsTotals) {
  OscFixture f;
  SetBars(f, kFive);
  ShowOBV(f.host);
  // 100300 at 127.2 up to 100600 at 16.8.
  const auto solid = Drawn(f, 'L', 16);
  ASSERT_EQ(solid.size(), 3u);
  EXPECT_SEGMENT(solid[0], 42, 127.2, 630, 127.2);
  EXPECT_SEGMENT(solid[1], 42, 72, 630, 72);
  // "100.6k" is 33 wide: the line begins 10 further right.
  EXPECT_SEGMENT(solid[2], 85, 16.8, 630, 16.8);
  const auto dashed = Drawn(f, 'E', 16);
  ASSERT_EQ(dashed.size(), 2u);
  EXPECT_SEGMENT(dashed[0], 42, 99.6, 630, 99.6);
  EXPECT_SEGMENT(dashed[1], 42, 44.4, 630, 44.4);

  const auto texts = f.Lines('T');
  ASSERT_EQ(texts.size(), 6u);
  EXPECT_EQ(texts[0], "T,8.25,44,313,On-Balance Volume (base 10000),27");
  const char* labels[] = {"100.3k", "100.4k", "100.5k", "100.5k", "100.6k"};
  for (size_t i = 0; i < 5; ++i) {
    EXPECT_EQ(Numbers(texts[i + 1])[1], 4);  // 42 - 5 - 33
    EXPECT_NE(texts[i + 1].find(std::string(",") + labels[i] + ","), std::string::npos)
        << texts[i + 1];
  }
}

TEST(ObvTest, TheLineBeginsAtTheSecondPointOnWholeUnits) {
  OscFixture f;
  SetBars(f, kFive);
  ShowOBV(f.host);
  const auto down = Drawn(f, 'H', 40);  // equal counts as down
  ASSERT_EQ(down.size(), 1u);
  EXPECT_SEGMENT(down[0], 46, 127, 48, 127);
  const auto up = Drawn(f, 'H', 38);
  ASSERT_EQ(up.size(), 1u);
  // From 127.2, and 300 above the lowest at 300 / 110 a unit: Q is CInt of 110.4, so that the
  // highest stands at 17.2.
  EXPECT_SEGMENT(up[0], 48, 127, 50, 17);
}

TEST(ObvTest, ATotalOfZeroIsNoPoint) {
  OscFixture f;
  SetBars(f, {Day(10, 0), Day(11, 10), Day(12, 10), Day(11, 100020), Day(12, 10), Day(13, 10)});
  ShowOBV(f.host);
  // Points at bars 1, 2, 4 and 5: two lines.
  EXPECT_EQ(f.Lines('H').size(), 2u);
}

TEST(ObvTest, NoVolumePrintsSoAndShowsNoScale) {
  OscFixture f;
  f.Closes({1, 2, 3, 2});
  ShowOBV(f.host);
  EXPECT_EQ(f.script.text(),
            "B,42,311,630,449,16\r\n"
            "T,8.25,44,313,On-Balance Volume (base 10000),27\r\n"
            "T,8.25,44,341,No Volume Data,27\r\n");
}

TEST(ObvTest, ASecondPassMovesTheTextsAndDrawsNoScale) {
  OscFixture f;
  f.host.SecondPass = true;
  f.Closes({1, 2, 3, 2});
  ShowOBV(f.host);
  EXPECT_EQ(f.script.text(),
            "T,8.25,292,313,On-Balance Volume (base 10000),27\r\n"
            "T,8.25,294,341,No Volume Data,27\r\n");
  EXPECT_TRUE(f.panel.Has("text 8.25 44,33 No Volume Data 27"));

  OscFixture g;
  g.host.SecondPass = true;
  SetBars(g, kFive);
  ShowOBV(g.host);
  EXPECT_TRUE(g.Lines('L').empty());
  EXPECT_EQ(g.Lines('H').size(), 2u);
}

TEST(ObvTest, OneTotalThroughoutKeepsTheScaleAndHasNoLine) {
  OscFixture f;
  SetBars(f, {Day(10, 0), Day(11, 500), Day(11, 0), Day(11, 0), Day(11, 9)});
  ShowOBV(f.host);
  EXPECT_EQ(f.Lines('L').size(), 3u);
  EXPECT_TRUE(f.Lines('H').empty());
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(ObvTest, AnOverflowNamesTheFileAndTheDay) {
  OscFixture f;
  SetBars(f, {Day(1, 0), Day(2, kMost), Day(3, 0)});
  ShowOBV(f.host);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "OBV");
  EXPECT_EQ(f.dialogs.said[0].text,
            "There is a problem with the data for TEST.WDT\n at date (20000104) 04/01/2000\n"
            "Use View/Modify Data procedure to correct.");
  EXPECT_FALSE(f.script.IsOpen());
}

TEST(ObvTest, TheDisksQuestionHasATitleOfItsOwn) {
  OscFixture f;
  f.dialogs.answers = {Answer::kCancel};
  RunOscillator(
      f.host, "OBV", true, [] { throw RunTimeError(kDiskNotReady); }, nullptr, "FX");
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "FX");
}

TEST(ObvTest, RealVolumesAgreeWithTheirSumsBySide) {
  OscFixture f;
  if (!SetRealBars(f, "AAPL")) GTEST_SKIP() << "no real prices here";
  int bar = 0;
  const ObvSeries s = OnBalanceVolume(f.chart.Bars, bar);
  std::int64_t sides[3] = {0, 0, 0};  // down, equal, up
  for (size_t i = 1; i < s.totals.size(); ++i) {
    const float now = f.chart.Bars[i].Close, before = f.chart.Bars[i - 1].Close;
    sides[(now > before) - (now < before) + 1] += f.chart.Bars[i].Volume;
    ASSERT_EQ(s.totals[i], 100000 + sides[2] - sides[0]) << "bar " << i;
  }
}
