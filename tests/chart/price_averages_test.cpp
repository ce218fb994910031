#include "chart/price_averages.h"

#include <gtest/gtest.h>

#include <vector>

#include "chart/chart_pen.h"
#include "tests/support/recording_surface.h"

using namespace kora;
using kora::test::RecordingSurface;

namespace {

struct Drawn {
  std::vector<std::string> ops;
  std::string script;
};

Drawn Draw(decltype(SimpleAverageLine)* routine, std::int16_t period,
           const std::vector<std::int16_t>& y, int index) {
  RecordingSurface surface(638, 452);
  ChartScript script;
  script.Open(false);
  ChartPen pen(surface, &script);
  routine(pen, period, y, 7, 42, 3, index);
  return {surface.ops, script.text()};
}

}  // namespace

TEST(SimpleAverageLineTest, StartsWithTheSecondFullWindow) {
  // Means of three: 20, 23 (22.67), 31 (31.33).
  const Drawn d = Draw(SimpleAverageLine, 3, {10, 20, 30, 18, 46}, 1);
  EXPECT_EQ(d.ops,
            (std::vector<std::string>{"line solid 48,20,51,23 7", "line solid 51,23,54,31 7"}));
  EXPECT_EQ(d.script, "L,48,20,51,23,7\r\nL,51,23,54,31,7\r\n");
}

TEST(SimpleAverageLineTest, MeanRoundsHalfToEven) {
  // 2.5 to 2, 3.5 to 4.
  EXPECT_EQ(Draw(SimpleAverageLine, 2, {2, 3, 4}, 1).script, "L,45,2,48,4,7\r\n");
}

TEST(SimpleAverageLineTest, SecondAverageIsWrittenAtThePrintWeight) {
  EXPECT_EQ(Draw(SimpleAverageLine, 1, {5, 6}, 2).script, "H,42,5,45,6,7\r\n");
}

TEST(SimpleAverageLineTest, PointAfterAYOf0HasNoLine) {
  EXPECT_EQ(Draw(SimpleAverageLine, 1, {0, 6, 8}, 1).script, "L,45,6,48,8,7\r\n");
}

TEST(SimpleAverageLineTest, FewerClosesThanThePeriodOrNoPeriodDrawNothing) {
  for (const int period : {6, 5, 0, -3})
    EXPECT_EQ(Draw(SimpleAverageLine, std::int16_t(period), {1, 2, 3, 4, 5}, 1).script, "")
        << period;
}

TEST(ExpAverageLineTest, SeedsWithTheMeanThenTakesTwoOverPeriodPlusOne) {
  // k = 0.5: seed 20; 0.5 * 18 + 0.5 * 20 = 19; 0.5 * 46 + 0.5 * 19 = 32.5 -> 32.
  EXPECT_EQ(Draw(ExpAverageLine, 3, {10, 20, 30, 18, 46}, 1).script,
            "L,48,20,51,19,7\r\nL,51,19,54,32,7\r\n");
}

TEST(CloseSmootherTest, SimpleIsARollingMeanOfTen) {
  CloseSmoother smoother(false);
  for (int i = 1; i <= 9; ++i) EXPECT_FALSE(smoother.Add(std::int16_t(i)).has_value());
  EXPECT_EQ(smoother.Add(10), 6);  // 5.5 to even
  EXPECT_EQ(smoother.Add(11), 6);  // 6.5 to even
  EXPECT_EQ(smoother.Add(22), 8);  // 3 to 11 and 22: 8.5 to even
}

TEST(CloseSmootherTest, ExponentialRoundsAtEachStep) {
  CloseSmoother smoother(true);
  for (int i = 0; i < 9; ++i) smoother.Add(100);
  EXPECT_EQ(smoother.Add(100), 100);
  EXPECT_EQ(smoother.Add(111), 102);  // 111 * 2/11 + 100 * 9/11 = 102
  EXPECT_EQ(smoother.Add(100), 102);  // 101.64
}
