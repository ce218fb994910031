#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "tests/indicators/osc_fixture.h"
#include "tests/support/all_oscillators.h"

// What no market has, and files can: every panel ends, tells at most one message, leaves the
// pointer free and the script closed, and writes no coordinate that is no number.

using namespace kora;
using namespace kora::test;

namespace {

struct Panel {
  const char* name;
  void (*show)(OscHost&);
};

void PrintTo(const Panel& panel, std::ostream* out) { *out << panel.name; }

constexpr Panel kPanels[] = {
    {"RSI", ShowRSI},        {"VTY", ShowVolatility},
    {"MACD", ShowMACD},      {"DM", ShowDirectionalMovement},
    {"ERY", ShowElderRay},   {"COP", ShowCoppock},
    {"JHG", ShowHolyGrail},  {"OBV", ShowOBV},
    {"PARA", ShowParabolic}, {"PARAV", ShowParabolicOnAverage},
};

// A price that swings, so that every indicator has something to show.
Bar Swing(int i) {
  const float close = 20 + 5 * std::sin(float(i) * 0.13f) + 2 * std::sin(float(i) * 0.7f);
  return {close + 0.6f, close - 0.5f, close + 0.2f * std::sin(float(i)), 1000 + i * 7};
}

std::vector<Bar> Swings(int count) {
  std::vector<Bar> bars;
  for (int i = 0; i < count; ++i) bars.push_back(Swing(i));
  return bars;
}

void Show(OscFixture& f, const Panel& panel, const std::vector<Bar>& bars) {
  SetBars(f, bars);
  SetPriceMap(f, 0.1f);
  f.chart.CloseY.clear();
  for (int i = 0; i < int(bars.size()); ++i)
    f.chart.CloseY.push_back(std::int16_t(150 + 50 * std::sin(i * 0.13)));
  panel.show(f.host);
  EXPECT_FALSE(f.dialogs.busy);
  EXPECT_FALSE(f.script.IsOpen());
  EXPECT_EQ(f.script.text().find("nan,"), std::string::npos);
  EXPECT_EQ(f.script.text().find("inf,"), std::string::npos);
}

class HostileBarsTest : public testing::TestWithParam<Panel> {};

}  // namespace

TEST_P(HostileBarsTest, EveryPeriodIsHeldWithoutAMessage) {
  for (const int period : {1, 2, 3, 199, 200, 201, 299, 300, 301, -1, -5, 32767, -32768}) {
    for (const int count : {1, 2, 3, 4, 300}) {
      OscFixture f;
      SetAllPeriods(f, std::int16_t(period));
      Show(f, GetParam(), Swings(count));
      EXPECT_TRUE(f.dialogs.said.empty()) << period << " over " << count;
    }
  }
}

TEST_P(HostileBarsTest, APeriodOfZeroOrLessDrawsNothingWherePeriodsCount) {
  const std::string name = GetParam().name;
  if (name == "DM" || name == "OBV" || name == "PARA" || name == "PARAV") return;
  for (const std::int16_t period : {std::int16_t{0}, std::int16_t{-7}}) {
    OscFixture f;
    SetAllPeriods(f, period);
    Show(f, GetParam(), Swings(100));
    EXPECT_EQ(f.script.text(), "");
    EXPECT_TRUE(f.panel.ops.empty());
  }
}

TEST_P(HostileBarsTest, EqualZeroAndNegativeClosesAreHeldWithoutAMessage) {
  for (const float close : {10.0f, 0.0f, -3.0f}) {
    OscFixture f;
    SetAllPeriods(f, 14);
    Show(f, GetParam(), std::vector<Bar>(300, {close, close, close, 5}));
    EXPECT_TRUE(f.dialogs.said.empty()) << close;
  }
}

TEST_P(HostileBarsTest, AYearOfZeroClosesInsideIsHeldWithoutAMessage) {
  OscFixture f;
  SetAllPeriods(f, 14);
  std::vector<Bar> bars = Swings(700);
  for (size_t i = 200; i < 450; ++i) bars[i] = {0, 0, 0, 0};
  Show(f, GetParam(), bars);
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST_P(HostileBarsTest, PricesThatAreNoNumbersEndInOneMessageAtMost) {
  for (const float bad : {std::nanf(""), std::numeric_limits<float>::infinity(),
                          -std::numeric_limits<float>::infinity(), 3e38f, -3e38f, 1e-45f}) {
    for (int field = 0; field < 4; ++field) {
      OscFixture f;
      SetAllPeriods(f, 5);
      std::vector<Bar> bars = Swings(120);
      for (const size_t i : {size_t{0}, size_t{40}, size_t{41}, size_t{119}}) {
        if (field != 1) bars[i].high = bad;
        if (field != 2) bars[i].low = bad;
        if (field != 3) bars[i].close = bad;
      }
      Show(f, GetParam(), bars);
      EXPECT_LE(f.dialogs.said.size(), 1u) << bad;
    }
  }
}

TEST_P(HostileBarsTest, VolumesAtTheLimitsEndInOneMessageAtMost) {
  for (const std::int32_t volume :
       {std::numeric_limits<std::int32_t>::max(), std::numeric_limits<std::int32_t>::min()}) {
    OscFixture f;
    SetAllPeriods(f, 5);
    std::vector<Bar> bars = Swings(120);
    for (Bar& bar : bars) bar.volume = volume;
    Show(f, GetParam(), bars);
    EXPECT_EQ(f.dialogs.said.size(), std::string(GetParam().name) == "OBV" ? 1u : 0u);
  }
}

TEST_P(HostileBarsTest, AChartWiderThan16BitsEndsInTheMessage) {
  OscFixture f;
  SetAllPeriods(f, 5);
  f.chart.BarSpacing = 400;  // 300 bars to 120,000 units
  Show(f, GetParam(), Swings(300));
  EXPECT_EQ(f.dialogs.said.size(), 1u);
}

TEST_P(HostileBarsTest, APanelWithoutHeightEndsAtItsFrame) {
  for (const double height : {0.0, 1.0, 5.0, 20.8}) {
    OscFixture f;
    SetAllPeriods(f, 5);
    f.panel.SetScale(0, 0, 638, height);
    Show(f, GetParam(), Swings(100));
    EXPECT_TRUE(f.dialogs.said.empty()) << height;
  }
}

INSTANTIATE_TEST_SUITE_P(Panels, HostileBarsTest, testing::ValuesIn(kPanels),
                         [](const auto& panel) { return std::string(panel.param.name); });
