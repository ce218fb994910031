#include "indicators/holy_grail.h"

#include <gtest/gtest.h>

#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

// Averages of three from bar 3 on: 11/3, 4, 4, 5, 5, 5, 3, 4.
// Detrended: 7/3, -1, -1, 4, -2, -2, 0, 2.
// Over two from bar 4 on: 2/3, -1, 1.5, 1, -2, -1, 1; again from bar 8 on: -0.5, -1.5, 0.
const std::vector<float> kCloses{1, 2, 3, 6, 3, 3, 9, 3, 3, 3, 6};

}  // namespace

TEST(HolyGrailTest, TheFirstAverageLeavesOutBarZero) {
  OscFixture f;
  f.Closes(kCloses);
  const HolyGrailSeries s = HolyGrail(f.chart.Bars, 2);
  EXPECT_EQ(s.first[2], 0);  // bars 0 to 2 have none
  EXPECT_EQ(s.detrended[2], 3);
  EXPECT_NEAR(s.detrended[3], 7.0 / 3, 1e-9);
}

TEST(HolyGrailTest, EachAverageStartsWhereItsWindowIsFull) {
  OscFixture f;
  f.Closes(kCloses);
  const HolyGrailSeries s = HolyGrail(f.chart.Bars, 2);
  const double first[] = {2.0 / 3, -1, 1.5, 1, -2, -1, 1};
  for (size_t i = 0; i < 7; ++i) EXPECT_NEAR(s.first[4 + i], first[i], 1e-9) << i;
  // The second waits for P + 3 of the first, and is then made from the last P.
  EXPECT_EQ(s.second[7], 0);
  EXPECT_NEAR(s.second[8], -0.5, 1e-9);
  EXPECT_NEAR(s.second[9], -1.5, 1e-9);
  EXPECT_NEAR(s.second[10], 0, 1e-9);
  EXPECT_NEAR(s.highest, 1.5, 1e-9);
  EXPECT_NEAR(s.lowest, -2, 1e-9);
}

TEST(HolyGrailTest, LinesStandLeftOfThePricesByThePeriod) {
  OscFixture f;
  f.settings.osc[kHolyD].daily = 2;
  f.Closes(kCloses);
  ShowHolyGrail(f.host);
  // x grows from bar 3 on: 44 for bar 3, 54 for bar 8. 3.5 on 110 units from 127.2 up.
  const auto first = Drawn(f, 'H', 45);
  ASSERT_EQ(first.size(), 3u);  // bars 8 to 10
  EXPECT_SEGMENT(first[0], 52, 33, 54, 127);
  EXPECT_SEGMENT(first[2], 56, 127, 58, 33);
  const auto second = Drawn(f, 'L', 46);
  ASSERT_EQ(second.size(), 1u);  // bar 10
  EXPECT_SEGMENT(second[0], 56, 80, 58, 64);
}

TEST(HolyGrailTest, ADetrendedZeroKeepsTheLastY) {
  OscFixture f;
  f.settings.osc[kHolyD].daily = 2;
  f.Closes(kCloses);
  ShowHolyGrail(f.host);
  // Bar 9: its average of -1 would stand at 96.
  EXPECT_SEGMENT(Drawn(f, 'H', 45).at(1), 54, 127, 56, 127);
}

TEST(HolyGrailTest, TitleLabelsAndLines) {
  OscFixture f;
  f.settings.osc[kHolyD].daily = 2;
  f.Closes(kCloses);
  ShowHolyGrail(f.host);
  const auto texts = f.Lines('T');
  ASSERT_EQ(texts.size(), 4u);
  EXPECT_EQ(texts[0], "T,8.25,44,313,Jones Holy Grail    2 Period,27");
  EXPECT_NE(texts[1].find(",325,1.500,27"), std::string::npos) << texts[1];
  EXPECT_NE(texts[2].find(",423,-2.000,27"), std::string::npos) << texts[2];
  EXPECT_NE(texts[3].find(",366,0,27"), std::string::npos) << texts[3];
  const auto lines = Drawn(f, 'L', 16);
  ASSERT_EQ(lines.size(), 3u);
  EXPECT_SEGMENT(lines[0], 42, 23, 630, 23);
  EXPECT_SEGMENT(lines[1], 42, 121, 630, 121);
  EXPECT_SEGMENT(lines[2], 42, 64, 630, 64);
}

TEST(HolyGrailTest, APeriodOf50NeedsMoreThan105BarsForTheSecondLine) {
  for (const int last : {105, 106}) {
    OscFixture f;
    f.settings.osc[kHolyD].daily = 50;
    std::vector<float> closes;
    for (int i = 0; i <= last; ++i) closes.push_back(10.0f + float(i % 7) * float(i % 3 + 1));
    f.Closes(closes);
    ShowHolyGrail(f.host);
    EXPECT_EQ(Drawn(f, 'L', 46).size(), last == 105 ? 0u : 1u) << last;
  }
}

TEST(HolyGrailTest, AYThatCannotBeHadKeepsTheLastOneWithoutAMessage) {
  OscFixture f;
  f.settings.osc[kHolyD].daily = 2;
  // At bar 3 the price itself still stands in the column: far outside any picture.
  std::vector<float> closes;
  for (const float c : kCloses) closes.push_back(c + 1e6f);
  f.Closes(closes);
  ShowHolyGrail(f.host);
  EXPECT_TRUE(f.dialogs.said.empty());
  EXPECT_EQ(Drawn(f, 'H', 45).size(), 3u);
}

TEST(HolyGrailTest, NoLineComesFromAYThatWasNeverHad) {
  OscFixture f;
  f.settings.osc[kHolyD].daily = 2;
  // Flat up to bar 8; bar 9 is the first with a y, bar 10 the first with a line.
  f.Closes({5, 5, 5, 5, 5, 5, 5, 5, 5, 8, 6, 7});
  ShowHolyGrail(f.host);
  const auto first = Drawn(f, 'H', 45);
  ASSERT_EQ(first.size(), 2u);
  EXPECT_EQ(first[0][0], 42 + 2 * 7);
}

TEST(HolyGrailTest, FewBarsAndEqualCloses) {
  OscFixture f;
  f.settings.osc[kHolyD].daily = 5;
  f.Closes({1, 2, 3, 4, 5, 6});  // BarCount 5 is not above the period
  ShowHolyGrail(f.host);
  EXPECT_EQ(f.script.text(), "");
  f.Closes(std::vector<float>(60, 0.1f));
  ShowHolyGrail(f.host);
  EXPECT_EQ(f.script.text(), "B,42,311,630,449,16\r\n");
}

TEST(HolyGrailTest, RealPricesAgreeWithRunningSums) {
  OscFixture f;
  if (!SetRealBars(f, "INDX")) GTEST_SKIP() << "no real prices here";
  const size_t P = 50;
  const HolyGrailSeries s = HolyGrail(f.chart.Bars, int(P));
  const auto close = [&](size_t i) { return double(f.chart.Bars[i].Close); };
  std::vector<double> detrended{0, 0, 0}, first{0, 0, 0};  // running sums, by bar
  std::vector<double> mean(s.first.size());
  for (size_t i = 3; i < s.first.size(); ++i) {
    detrended.push_back(detrended.back() + close(i) * 2 / 3 - (close(i - 1) + close(i - 2)) / 3);
    if (i >= P + 2) {
      mean[i] = (detrended[i] - detrended[i - P]) / double(P);
      ASSERT_NEAR(s.first[i], mean[i], 1e-6) << "bar " << i;
    }
    first.push_back(first.back() + mean[i]);
    if (i >= 2 * P + 4) {
      ASSERT_NEAR(s.second[i], (first[i] - first[i - P]) / double(P), 1e-6) << "bar " << i;
    }
  }
}
