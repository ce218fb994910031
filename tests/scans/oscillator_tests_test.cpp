#include "scans/oscillator_tests.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "indicators/oscillators.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using kora::test::Bar;
using kora::test::OscFixture;

namespace {

std::vector<ChartBar> Days(const std::vector<Bar>& days) {
  std::vector<ChartBar> bars;
  for (const Bar& day : days) {
    ChartBar bar{};
    bar.Open = bar.Close = day.close;
    bar.High = day.high;
    bar.Low = day.low;
    bars.push_back(bar);
  }
  return bars;
}
std::vector<ChartBar> Closes(const std::vector<float>& closes) {
  std::vector<Bar> days;
  for (const float c : closes) days.push_back({c, c, c});
  return Days(days);
}
// Days between 10 and 20 with these closes.
std::vector<ChartBar> Between(const std::vector<float>& closes) {
  std::vector<Bar> days;
  for (const float c : closes) days.push_back({20, 10, c});
  return Days(days);
}

OscRows Of(const Rows& rows) { return rows.value_or(OscRows{-1, -1, -1, -1}); }

// Prices that go up and down by quarters, so that cents are exact: 261 days as a scan has them.
std::vector<Bar> Swings() {
  std::vector<Bar> days;
  std::uint32_t seed = 7;
  int price = 80;
  for (int i = 0; i < 261; ++i) {
    const auto draw = [&](int n) {
      seed = seed * 1664525u + 1013904223u;
      return int(seed >> 16) % n;
    };
    price = std::max(20, price + draw(9) - 4);
    const float close = float(price) / 4;
    days.push_back({close + float(draw(4)) / 4, close - float(draw(4)) / 4, close});
  }
  return days;
}

// The rows of the last line that the panel of the chart drew, and of two of its guide lines.
OscRows Panel(OscFixture& f, char letter, size_t guideOb, size_t guideOs) {
  ShowOscillatorPanel(f.host);
  const auto line = Drawn(f, letter, kOscLine1);
  EXPECT_FALSE(line.empty());
  const auto guides = Drawn(f, 'L', kBorder);
  EXPECT_GT(guides.size(), std::max(guideOb, guideOs));
  return {int(line.back()[3]), int(line.back()[1]), int(guides[guideOb][1]),
          int(guides[guideOs][1])};
}

}  // namespace

// ---- The rule

TEST(SignalRuleTest, EachOutcome) {
  constexpr int ob = 47, os = 96;
  const auto of = [](int p, int y) { return SignalOf({y, p, ob, os}); };
  EXPECT_EQ(of(60, 40), Signal::kCutObUp);
  EXPECT_EQ(of(40, 30), Signal::kOb);
  EXPECT_EQ(of(60, 100), Signal::kCutOsDown);
  EXPECT_EQ(of(100, 110), Signal::kOs);
  EXPECT_EQ(of(40, 60), Signal::kCutObDown);
  EXPECT_EQ(of(100, 60), Signal::kCutOsUp);
  EXPECT_EQ(of(60, 70), Signal::kNone);
}

TEST(SignalRuleTest, ARowOnTheLineIsAtTheLine) {
  constexpr int ob = 47, os = 96;
  const auto of = [](int p, int y) { return SignalOf({y, p, ob, os}); };
  EXPECT_EQ(of(48, 47), Signal::kCutObUp);
  EXPECT_EQ(of(47, 47), Signal::kOb);  // a cut needs a row strictly below the line before
  EXPECT_EQ(of(47, 48), Signal::kCutObDown);
  EXPECT_EQ(of(95, 96), Signal::kCutOsDown);
  EXPECT_EQ(of(96, 96), Signal::kOs);
  EXPECT_EQ(of(96, 95), Signal::kCutOsUp);
  EXPECT_EQ(of(48, 95), Signal::kNone);
}

TEST(SignalRuleTest, FromOneSideToTheOtherIsACut) {
  EXPECT_EQ(SignalOf({40, 100, 47, 96}), Signal::kCutObUp);
  EXPECT_EQ(SignalOf({100, 40, 47, 96}), Signal::kCutOsDown);
}

TEST(SignalRuleTest, BoxesDropWhatIsNotAskedFor) {
  const auto reported = [](const SignalBoxes& boxes) {
    std::string out;
    for (const Signal s : {Signal::kCutObUp, Signal::kCutObDown, Signal::kOb, Signal::kCutOsUp,
                           Signal::kCutOsDown, Signal::kOs, Signal::kNone})
      if (boxes.Report(s)) out += std::string(SignalText(s)) + ";";
    return out;
  };
  EXPECT_EQ(reported({}), "");
  EXPECT_EQ(reported({.ob = true}), "Cut OB UP;OB;");
  EXPECT_EQ(reported({.cutOb = true}), "Cut OB UP;Cut OB DN;");
  EXPECT_EQ(reported({.os = true}), "Cut OS DN;OS;");
  EXPECT_EQ(reported({.cutOs = true}), "Cut OS UP;Cut OS DN;");
  EXPECT_EQ(reported({true, true, true, true}), "Cut OB UP;Cut OB DN;OB;Cut OS UP;Cut OS DN;OS;");
}

// ---- Each oscillator, by hand

TEST(OscillatorTest, StochasticOverKAndOneBars) {
  // k of 40 and 75: rows 121 - 39.6 and 121 - 74.25; the lines at 75 and 25.
  EXPECT_EQ(Of(StochasticRows(Between({15, 15, 15, 14, 17.5f}), 2)), (OscRows{47, 81, 47, 96}));
  // The bar K before the last counts: with its high of 30, (17.5 - 10) / 20 is 37.5, to even 38.
  auto bars = Between({15, 15, 15, 14, 17.5f});
  bars[2].High = 30;
  EXPECT_EQ(Of(StochasticRows(bars, 2)).y, 83);  // 121 - 37.62
  bars[2].High = 20;
  bars[1].High = 30;  // beyond the last window, within the one before: 4 / 20
  EXPECT_EQ(Of(StochasticRows(bars, 2)).y, 47);
  EXPECT_EQ(Of(StochasticRows(bars, 2)).p, 101);  // 121 - 19.8
}

TEST(OscillatorTest, StochasticCountsZeroHighsAndLows) {
  auto bars = Between({15, 15, 15, 14, 17.5f});
  bars[3].Low = 0;  // 17.5 / 20 is 87.5, to even 88; 14 / 20 is 70
  EXPECT_EQ(Of(StochasticRows(bars, 2)), (OscRows{34, 52, 47, 96}));
  // High and low of days without a range are what they are, too.
  EXPECT_EQ(
      Of(StochasticRows(Days({{0, 0, 5}, {0, 0, 5}, {0, 0, 5}, {0, 0, 0}, {0, 0, 0.25f}}), 2)),
      (OscRows{96, 121, 47, 96}));  // close - low, times 100
}

TEST(OscillatorTest, StochasticOfAFlatWindowIsTheDistanceFromIt) {
  EXPECT_EQ(Of(StochasticRows(Closes({10, 10, 10, 10, 10}), 2)), (OscRows{121, 121, 47, 96}));
}

TEST(OscillatorTest, WilliamsIsTheMeanOfThreeRowsOverCloses) {
  // Rows of bars 2 to 5 over two closes each: 131, 13, 131, 13.
  EXPECT_EQ(Of(WilliamsRows(Closes({10, 20, 10, 20, 15, 20}), 2)), (OscRows{52, 92, 25, 119}));
  // Highs and lows do not count.
  auto bars = Closes({10, 20, 10, 20, 15, 20});
  for (ChartBar& bar : bars) bar.High = 100, bar.Low = 1;
  EXPECT_EQ(Of(WilliamsRows(bars, 2)), (OscRows{52, 92, 25, 119}));
}

TEST(OscillatorTest, WilliamsPassesOverBarsWithoutARange) {
  // Bars 4 and 7 equal the close before: the rows are those of bars 2, 3, 5 and 6.
  EXPECT_EQ(Of(WilliamsRows(Closes({10, 20, 10, 20, 20, 15, 20, 20}), 2)),
            (OscRows{52, 92, 25, 119}));
  // A zero close is none of the closes: the last two days have one, and no range.
  EXPECT_EQ(WilliamsRows(Closes({10, 20, 10, 20, 15, 0}), 2), std::nullopt);
  // Four rows are wanted.
  EXPECT_EQ(WilliamsRows(Closes({10, 20, 10, 20, 15}), 2), std::nullopt);
}

TEST(OscillatorTest, RocIsAShareOfTheNewerClose) {
  // 50, 16.67, -4.35 percent; the range 50 and -50, 1.18 units a percent, lines at 40 and -40.
  EXPECT_EQ(Of(RocRows(Closes({10, 10, 20, 24, 23}), 1)), (OscRows{77, 52, 25, 119}));
}

TEST(OscillatorTest, MomentumIsADifferenceInHundredths) {
  // 1000, 400, -100; the range 1000 and -1000.
  EXPECT_EQ(Of(MomentumRows(Closes({10, 10, 20, 24, 23}), 1)), (OscRows{78, 48, 25, 119}));
}

TEST(OscillatorTest, AZeroCloseKeepsTheValueBefore) {
  EXPECT_EQ(Of(MomentumRows(Closes({10, 10, 20, 24, 0}), 1)), (OscRows{48, 48, 25, 119}));
  EXPECT_EQ(Of(RocRows(Closes({10, 10, 20, 24, 0, 30}), 1)), (OscRows{52, 52, 25, 119}));
}

TEST(OscillatorTest, AChangeWithoutARangeOrBeyondItGivesNothing) {
  EXPECT_EQ(RocRows(Closes({10, 10, 10, 10, 10}), 1), std::nullopt);
  // 40000 * 0.8 is within 16 bits, 41000 * 0.8 is not.
  EXPECT_NE(MomentumRows(Closes({10, 10, 410, 410}), 1), std::nullopt);
  EXPECT_EQ(MomentumRows(Closes({10, 10, 420, 420}), 1), std::nullopt);
}

TEST(OscillatorTest, RsiIsOfTheLastChangesTheLatestToo) {
  // Changes +2 -1, then -1 +3: 66.67 and 75 percent.
  EXPECT_EQ(Of(RsiRows(Closes({10, 12, 11, 14}), 3)), (OscRows{42, 52, 48, 95}));
  // Without a fall 1 stands for the falls: 100 - 100 / 1.667 is 40.
  EXPECT_EQ(Of(RsiRows(Closes({9, 10, 11, 12}), 3)).y, 83);
}

TEST(OscillatorTest, AFirstCloseOfZeroDoesNotStopRsi) {
  EXPECT_EQ(Of(RsiRows(Closes({10, 0, 12, 11, 14}), 4)).y, 42);  // -1 and +3 alone
}

TEST(OscillatorTest, AnRsiPeriodOfZeroIsTwentyOne) {
  std::vector<float> closes(30, 10);
  closes[8] = 5;  // the rise from it is the 21st change back from the last
  EXPECT_EQ(Of(RsiRows(Closes(closes), 0)).y, Of(RsiRows(Closes(closes), 21)).y);
  EXPECT_NE(Of(RsiRows(Closes(closes), 0)).y, Of(RsiRows(Closes(closes), 22)).y);
}

TEST(OscillatorTest, FewBarsGiveNothing) {
  for (size_t n = 0; n < 12; ++n) {
    std::vector<float> closes;
    for (size_t i = 0; i < n; ++i) closes.push_back(i % 2 ? 10 : 12);
    const auto bars = Closes(closes);
    EXPECT_EQ(StochasticRows(bars, 5).has_value(), n >= 8) << n;
    EXPECT_EQ(WilliamsRows(bars, 5).has_value(), n >= 9) << n;
    EXPECT_EQ(MomentumRows(bars, 5).has_value(), n >= 8) << n;
    EXPECT_EQ(RsiRows(bars, 5).has_value(), n >= 6) << n;
    EXPECT_EQ(StochasticRows(bars, 0), std::nullopt);
    EXPECT_EQ(WilliamsRows(bars, -3), std::nullopt);
    EXPECT_EQ(RocRows(bars, 32767), std::nullopt);
    EXPECT_EQ(RsiRows(bars, -32768), std::nullopt);
  }
}

TEST(OscillatorTest, HostilePricesEndInARowOrNothing) {
  const float odd[] = {0,
                       -1,
                       1e-38f,
                       std::numeric_limits<float>::max(),
                       -std::numeric_limits<float>::max(),
                       std::numeric_limits<float>::infinity(),
                       std::numeric_limits<float>::quiet_NaN()};
  std::uint32_t seed = 1;
  int given = 0;
  for (int round = 0; round < 500; ++round) {
    std::vector<Bar> days;
    for (int i = 0; i < 12; ++i) {
      const auto draw = [&] { return odd[(seed = seed * 1664525u + 1013904223u) % 7]; };
      const float high = draw(), low = draw();
      days.push_back({high, low, draw()});
    }
    const auto bars = Days(days);
    for (const auto rows : {StochasticRows, WilliamsRows, RocRows, MomentumRows, RsiRows})
      given += rows(bars, 3).has_value();
  }
  EXPECT_GT(given, 0);
  EXPECT_LT(given, 2500);
}

// ---- Beside the panels of the chart

TEST(OscillatorBesideTheChartTest, StochasticIsThatOfThePanel) {
  for (const auto K : std::vector<std::int16_t>{2, 5, 10, 14}) {
    OscFixture f;
    f.host.OscCode = "STO";
    f.settings.osc.periods["StochK"].daily = K;
    SetBars(f, Swings());
    EXPECT_EQ(Of(StochasticRows(f.chart.Bars.bars, K)), Panel(f, 'L', 1, 0)) << K;
  }
}

// The panel takes highs and lows, the scan closes: they are the same where a day has one price.
TEST(OscillatorBesideTheChartTest, WilliamsIsThatOfThePanelForCloses) {
  for (const auto P : std::vector<std::int16_t>{3, 7, 14}) {
    OscFixture f;
    f.host.OscCode = "WMS";
    f.settings.osc.periods["WmsA"].daily = P;
    std::vector<Bar> days = Swings();
    for (Bar& day : days) day.high = day.low = day.close;
    SetBars(f, days);
    EXPECT_EQ(Of(WilliamsRows(f.chart.Bars.bars, P)), Panel(f, 'H', 0, 1)) << P;
  }
}

// The panel rounds values to whole numbers, the scan does not: they are the same in whole cents.
TEST(OscillatorBesideTheChartTest, MomentumIsThatOfThePanelInWholeCents) {
  for (const auto P : std::vector<std::int16_t>{3, 10, 21}) {
    OscFixture f;
    f.host.OscCode = "MOM";
    f.settings.osc.periods["MMA"].daily = P;
    SetBars(f, Swings());
    EXPECT_EQ(Of(MomentumRows(f.chart.Bars.bars, P)), Panel(f, 'H', 1, 2)) << P;
  }
}

TEST(OscillatorBesideTheChartTest, RocIsThatOfThePanelInWholePercents) {
  OscFixture f;
  f.host.OscCode = "ROC";
  f.settings.osc.periods["RocP"].daily = 1;
  // 50, 20, -25, 60, 0 percent of the newer close.
  SetBars(f, {{1, 1, 10}, {1, 1, 10}, {1, 1, 20}, {1, 1, 25}, {1, 1, 20}, {1, 1, 50}, {1, 1, 50}});
  EXPECT_EQ(Of(RocRows(f.chart.Bars.bars, 1)), Panel(f, 'H', 1, 2));
}
