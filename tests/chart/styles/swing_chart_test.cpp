#include <gtest/gtest.h>

#include "tests/chart/composer_fixture.h"

using namespace kora;

namespace {

struct SwingFixture : test::ComposerFixture {
  SwingFixture() {
    request.Swing = SwingKind::kStandard;
    request.VolumeOption = false;
    request.AutoScale = false;  // 384 units of y to 19.2: 20 to the unit of price
    request.Name.Base = 5;
    request.Name.Top = 24.2f;
  }
  void Ranges(std::initializer_list<std::pair<float, float>> highLow) {
    std::int32_t day = DayNumber({2024, 3, 1});
    for (const auto& [high, low] : highLow)
      Day(FormatFileDate(DateOfDayNumber(day++)), low, high, low, high);
  }
};

using Lines = std::vector<std::string>;

}  // namespace

TEST(SwingChartTest, LineStandsInPlaceOfTheBars) {
  SwingFixture f;
  f.Ranges({{10, 9}, {10, 9}, {11, 10}, {12, 11}, {11.5f, 10.5f}});
  ASSERT_TRUE(f.Compose());
  // y of 10 is 329; the line begins at the second bar, x 44.
  EXPECT_EQ(f.Lines('H'), (Lines{"H,44,329,44,309,38", "H,44,309,44,289,38", "H,44,289,46,289,38",
                                 "H,46,289,46,319,40"}));
  EXPECT_TRUE(f.Lines('P').empty());
  EXPECT_TRUE(f.Wrote("T,8.25,42,49,Daily Swing  -  Standard,27"));
  EXPECT_TRUE(f.Wrote("B,42,45,631,429,16"));
  EXPECT_TRUE(f.Wrote("T,8.25,380,2,Last date processed 05-03-24,27"));
  EXPECT_EQ(f.chart.LastBarX, 52);
}

TEST(SwingChartTest, TitleTellsPeriodKindAndSize) {
  const auto title = [](SwingKind kind, double size, Period period) {
    SwingFixture f;
    f.request.Swing = kind;
    f.request.SwingSize = size;
    f.request.ChartPeriod = period;
    f.Days("20240101", 400);
    EXPECT_TRUE(f.Compose());
    for (const std::string& line : f.Lines('T'))
      if (line.find("Swing") != std::string::npos) return line;
    return std::string();
  };
  EXPECT_EQ(title(SwingKind::kDays, 3, Period::kDaily), "T,8.25,42,49,Daily Swing 3 - DAY,27");
  EXPECT_EQ(title(SwingKind::kPoints, 9.5, Period::kWeekly),
            "T,8.25,42,49,Weekly Swing 9.5 - POINT,27");
  // Flat bars have no swing to take an average of: 5, of which three quarters are 3.
  EXPECT_EQ(title(SwingKind::kPointsAuto, 77, Period::kMonthly),
            "T,8.25,42,49,Monthly Swing 3 - Point(Auto),27");
}

TEST(SwingChartTest, SizeIsInCentsForSharesAndInPointsForIndices) {
  for (const std::int16_t type : {kShare, kIndex}) {
    SwingFixture f;
    f.request.Swing = SwingKind::kPoints;
    f.request.SwingSize = type == kIndex ? 1 : 100;
    f.request.Name.RecType = type;
    f.Ranges({{10, 9}, {10, 9}, {11, 10}, {12, 11}, {11.5f, 10.9f}});
    ASSERT_TRUE(f.Compose());
    const Lines h = f.Lines('H');
    ASSERT_EQ(h.size(), 4u) << type;
    EXPECT_EQ(h[2], "H,44,289,48,289,20");  // four units, whatever the spacing
    EXPECT_EQ(h[3], "H,48,289,48,311,21");
    f.request.SwingSize *= 1.2;
    ASSERT_TRUE(f.Compose());
    EXPECT_EQ(f.Lines('H').size(), 2u);
  }
}

TEST(SwingChartTest, TakesItsShareOfThePlotAndNoOverlays) {
  SwingFixture f;
  int overlays = 0;
  f.services.overlays.push_back([&](const ChartCanvas&) { ++overlays; });
  f.request.Ma1On = true;
  f.request.Ma1Days = 3;
  f.Days("20200101", 1000);
  ASSERT_TRUE(f.Compose());
  // Half of 589 units at 2 a bar.
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 1000 - 147);
  EXPECT_EQ(overlays, 0);
  EXPECT_TRUE(f.Lines('P').empty());
  f.request.BlankSpace = 50;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 1000 - 122);
  f.request.Swing = SwingKind::kPointsAuto;  // 0.65 of them
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 1000 - 191);
}

TEST(SwingChartTest, DataWithoutBarsShowsItsLine) {
  SwingFixture f;
  f.request.Name.RecType = kCloseVolume;
  f.Ranges({{10, 10}, {11, 11}, {12, 12}});
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Lines('H').size(), 2u);
  EXPECT_FALSE(f.Wrote("T,8.25,42,49,Daily Swing  -  Standard,27"));
}
