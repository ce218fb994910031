#include "chart/styles/swing_line.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "base/numbers.h"
#include "store/price_rec.h"

using namespace kora;

namespace {

using Strokes = std::vector<std::string>;

struct Bar {
  double high, low;  // y
};

// "2,100 2,95 38" for each stroke. Bars stand 2 apart from x 0; prices are the y upside down.
Strokes Draw(const SwingRule& rule, const std::vector<Bar>& bars) {
  Strokes out;
  SwingLine line(rule, [&](const SwingStroke& s) {
    out.push_back(Str(s.x1) + "," + Str(s.y1) + " " + Str(s.x2) + "," + Str(s.y2) + " " +
                  std::to_string(s.entry));
  });
  double x = 0;
  for (const Bar& bar : bars) {
    line.Add({x, bar.high, bar.low, CSng(1000 - bar.high), CSng(1000 - bar.low)});
    x += 2;
  }
  return out;
}

Strokes Standard(std::vector<Bar> more) {
  // Rises from 100 to 90, at x 2.
  std::vector<Bar> bars = {{100, 110}, {100, 110}, {95, 105}, {90, 100}};
  bars.insert(bars.end(), more.begin(), more.end());
  Strokes out = Draw({SwingKind::kStandard, 0, 1, 2}, bars);
  EXPECT_EQ(Strokes(out.begin(), out.begin() + 2), (Strokes{"2,100 2,95 38", "2,95 2,90 38"}));
  out.erase(out.begin(), out.begin() + 2);
  return out;
}

// The same upside down and with the colours changed over: what falls as that rises.
Strokes Mirrored(std::vector<Bar> more) {
  std::vector<Bar> bars = {{100, 110}, {100, 110}, {95, 105}, {90, 100}};
  bars.insert(bars.end(), more.begin(), more.end());
  for (Bar& bar : bars) bar = {500 - bar.low, 500 - bar.high};
  Strokes out;
  SwingLine line({SwingKind::kStandard, 0, 1, 2}, [&](const SwingStroke& s) {
    out.push_back(Str(s.x1) + "," + Str(500 - s.y1) + " " + Str(s.x2) + "," + Str(500 - s.y2) +
                  " " + (s.entry == 38 ? "40" : "38"));
  });
  double x = 0;
  for (const Bar& bar : bars) line.Add({x, bar.high, bar.low, 1, 1}), x += 2;
  out.erase(out.begin(), out.begin() + 2);
  return out;
}

// Both must hold of a rising line and, mirrored, of a falling one.
void ExpectBothWays(const std::vector<Bar>& more, const Strokes& want) {
  EXPECT_EQ(Standard(more), want);
  EXPECT_EQ(Mirrored(more), want);
}

}  // namespace

TEST(SwingStandardTest, UpBarAfterAnUpBarExtendsTheLineWithNoTurn) {
  ExpectBothWays({{85, 95}}, {"2,90 2,85 38"});
}

TEST(SwingStandardTest, LowerBarTurnsTheLineDown) {
  ExpectBothWays({{92, 104}}, {"2,90 4,90 38", "4,90 4,104 40"});
  // And a higher one up again; each turn is a step to the right.
  ExpectBothWays({{92, 104}, {88, 100}},
                 {"2,90 4,90 38", "4,90 4,104 40", "4,104 6,104 40", "6,104 6,88 38"});
}

TEST(SwingStandardTest, EqualEndsAreNoMoveOfTheirOwn) {
  ExpectBothWays({{90, 103}}, {"2,90 4,90 38", "4,90 4,103 40"});  // equal high: a down bar
  ExpectBothWays({{86, 100}}, {"2,90 2,86 38"});                   // equal low: an up bar
  ExpectBothWays({{90, 100}}, {});
  ExpectBothWays({{92, 100}}, {});  // lower high, equal low
  ExpectBothWays({{90, 98}}, {});
}

TEST(SwingStandardTest, FlatSeriesDrawsNothing) {
  EXPECT_EQ(Draw({}, std::vector<Bar>(30, {100, 110})), Strokes{});
}

TEST(SwingStandardTest, LineStartsAtTheStoredHighOrLowAndTheStartingBarDraws) {
  // Bars 0 to 3 have no move of both ends; bar 4 has.
  const std::vector<Bar> still = {{100, 110}, {100, 110}, {99, 111}, {100, 110}};
  std::vector<Bar> up = still, down = still;
  up.push_back({98, 108});
  down.push_back({102, 112});
  EXPECT_EQ(Draw({}, up), Strokes{"6,100 6,98 38"});
  EXPECT_EQ(Draw({}, down), Strokes{"6,110 6,112 40"});
}

TEST(SwingStandardTest, FirstTwoBarsAreStoredAlone) {
  EXPECT_EQ(Draw({}, {{100, 110}, {90, 100}}), Strokes{});
  EXPECT_EQ(Draw({}, {{100, 110}, {90, 100}, {80, 90}}), Strokes{"2,90 2,80 38"});
}

TEST(SwingStandardTest, BarAtTheTopOfTheSurfaceIsStoredAlone) {
  ExpectBothWays({{85, 95}}, {"2,90 2,85 38"});
  std::vector<Bar> bars = {{100, 110}, {100, 110}, {95, 105}, {0, 90}, {95, 105}, {90, 100}};
  // The bar with a y of 0 is what the next one is compared with: a fall from it.
  EXPECT_EQ(Draw({}, bars), (Strokes{"2,100 2,95 38", "2,95 4,95 38", "4,95 4,105 40",
                                     "4,105 6,105 40", "6,105 6,90 38"}));
}

TEST(SwingStandardTest, OutsideBarIsSettledByTheNext) {
  const Bar outside{85, 105};
  ExpectBothWays({outside}, {});
  ExpectBothWays({outside, {80, 100}},
                 {"2,90 4,90 38", "4,90 4,105 40", "4,105 6,105 40", "6,105 6,80 38"});
  // Down at once: the high, and back over it at the same x.
  ExpectBothWays({outside, {88, 110}}, {"2,90 2,85 38", "2,85 2,110 40"});
  // An inside bar: both ends are drawn, and that bar is held.
  const Strokes bothEnds = {"2,90 4,90 38", "4,90 4,105 40", "4,105 6,105 40", "6,105 6,85 38"};
  ExpectBothWays({outside, {88, 100}}, bothEnds);
  Strokes higher = bothEnds;
  higher.insert(higher.end(),
                {"6,85 8,85 38", "8,85 8,100 40", "8,100 10,100 40", "10,100 10,80 38"});
  ExpectBothWays({outside, {88, 100}, {80, 95}}, higher);
  // Outside again: the wider one is held.
  ExpectBothWays({outside, {80, 110}, {75, 100}},
                 {"2,90 4,90 38", "4,90 4,110 40", "4,110 6,110 40", "6,110 6,75 38"});
}

TEST(SwingStandardTest, InsideBarIsSettledByTheNext) {
  const Bar inside{93, 97};
  ExpectBothWays({inside}, {});
  ExpectBothWays({inside, {85, 95}},
                 {"2,90 4,90 38", "4,90 4,97 40", "4,97 6,97 40", "6,97 6,85 38"});
  ExpectBothWays({inside, {95, 99}}, {"2,90 4,90 38", "4,90 4,99 40"});
  // An outside bar: down to the held low, and that bar is held in a fall.
  ExpectBothWays({inside, {88, 101}}, {"2,90 4,90 38", "4,90 4,97 40"});
  ExpectBothWays({inside, {88, 101}, {95, 105}}, {"2,90 4,90 38", "4,90 4,97 40", "4,97 6,97 40",
                                                  "6,97 6,88 38", "6,88 8,88 38", "8,88 8,105 40"});
  // A further inside bar likewise; a rise from it is then a turn.
  ExpectBothWays({inside, {94, 96}, {92, 95}},
                 {"2,90 4,90 38", "4,90 4,97 40", "4,97 6,97 40", "6,97 6,92 38"});
}

TEST(SwingDaysTest, ThreeDaysReverseOnTheThirdLowerLowWithNoNewHighBetween) {
  const SwingRule rule{SwingKind::kDays, 3, 100, 4};
  const std::vector<Bar> rise = {{100, 110}, {100, 110}, {95, 105}, {90, 100}};
  std::vector<Bar> bars = rise;
  bars.insert(bars.end(), {{92, 101}, {93, 103}});
  EXPECT_EQ(Draw(rule, bars), (Strokes{"2,100 2,95 20", "2,95 2,90 20"}));
  bars.push_back({94, 106});
  EXPECT_EQ(Draw(rule, bars),
            (Strokes{"2,100 2,95 20", "2,95 2,90 20", "2,90 6,90 20", "6,90 6,106 21"}));
  // A new high begins the count anew.
  bars = rise;
  bars.insert(bars.end(), {{92, 101}, {93, 103}, {89, 99}, {91, 101}, {92, 102}});
  EXPECT_EQ(Draw(rule, bars), (Strokes{"2,100 2,95 20", "2,95 2,90 20", "2,90 2,89 20"}));
}

TEST(SwingDaysTest, TurnCountsAsTheFirstDayOfTheNext) {
  const SwingRule rule{SwingKind::kDays, 3, 100, 4};
  std::vector<Bar> bars = {{100, 110}, {100, 110}, {95, 105}, {90, 100},
                           {92, 101},  {93, 103},  {94, 106}};
  // Two higher highs above the low of 106 turn the line again.
  bars.insert(bars.end(), {{93, 105}, {92, 104}});
  const Strokes strokes = Draw(rule, bars);
  ASSERT_EQ(strokes.size(), 6u);
  EXPECT_EQ(strokes[4], "6,106 10,106 21");
  EXPECT_EQ(strokes[5], "10,106 10,92 20");
}

TEST(SwingDaysTest, OneDayReversesOnTheFirstLowerLow) {
  EXPECT_EQ(Draw({SwingKind::kDays, 1, 100, 4}, {{100, 110}, {100, 110}, {95, 105}, {96, 106}}),
            (Strokes{"2,100 2,95 20", "2,95 6,95 20", "6,95 6,106 21"}));
}

TEST(SwingPointsTest, MoveOfTheSizeFromTheExtremeReverses) {
  // A unit of y is a unit of price here; 12 points to 1 are 12 units.
  const SwingRule rule{SwingKind::kPoints, 12, 1, 4};
  const std::vector<Bar> rise = {{100, 110}, {100, 110}, {95, 105}, {90, 100}};
  std::vector<Bar> bars = rise;
  bars.push_back({91, 101});  // 11 below the high of 90
  EXPECT_EQ(Draw(rule, bars), (Strokes{"2,100 2,95 20", "2,95 2,90 20"}));
  bars.push_back({91, 102});
  EXPECT_EQ(Draw(rule, bars),
            (Strokes{"2,100 2,95 20", "2,95 2,90 20", "2,90 6,90 20", "6,90 6,102 21"}));
  // 12 above the low turns it up; the low it had fallen to counts, not that of the turn.
  bars.insert(bars.end(), {{97, 104}, {92, 103}});
  const Strokes strokes = Draw(rule, bars);
  ASSERT_EQ(strokes.size(), 7u);
  EXPECT_EQ(strokes[4], "6,102 6,104 21");
  EXPECT_EQ(strokes[6], "10,104 10,92 20");
}

TEST(SwingPointsTest, SizeOfNothingReversesAtEachLowerLow) {
  EXPECT_EQ(Draw({SwingKind::kPointsAuto, 0, 100, 4},
                 {{100, 110}, {100, 110}, {95, 105}, {96, 106}, {95, 105}}),
            (Strokes{"2,100 2,95 20", "2,95 6,95 20", "6,95 6,106 21", "6,106 10,106 21",
                     "10,106 10,95 20"}));
}

namespace {

std::vector<ChartBar> Bars(const std::vector<std::pair<float, float>>& highLow) {
  std::vector<ChartBar> out;
  for (const auto& [high, low] : highLow) {
    ChartBar bar{};
    bar.High = bar.Open = bar.Close = high;
    bar.Low = low;
    out.push_back(bar);
  }
  return out;
}

}  // namespace

TEST(AverageSwingTest, IsTheMeanMoveBetweenTurnsInHundredths) {
  // Up to 13, down to 9, up to 14, down: moves of 4 and 5.
  auto bars =
      Bars({{10, 9}, {10, 9}, {11, 10}, {13, 12}, {12, 11}, {10, 9}, {11, 10}, {14, 13}, {12, 11}});
  EXPECT_DOUBLE_EQ(AverageSwing(bars), 450);
  // Bars without an Open are no part of it.
  ChartBar odd = bars[4];
  odd.Open = 0;
  odd.High = 99;
  bars.insert(bars.begin() + 4, odd);
  EXPECT_DOUBLE_EQ(AverageSwing(bars), 450);
}

TEST(AverageSwingTest, WithoutTwoTurnsItIsFive) {
  EXPECT_EQ(AverageSwing({}), 5);
  EXPECT_EQ(AverageSwing(Bars({{10, 9}, {10, 9}, {11, 10}, {13, 12}, {12, 11}})), 5);
}
