#include "chartwindow/time_walk.h"

#include <gtest/gtest.h>

#include <vector>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

// Every day of 2024: record n is the n-th day. 1 January was a Monday.
std::vector<std::int32_t> Year() {
  std::vector<std::int32_t> dates;
  for (int i = 0; i < 366; ++i)
    dates.push_back(CLng(Val(FormatFileDate(DateOfDayNumber(DayNumber({2024, 1, 1}) + i)))));
  return dates;
}

std::int32_t Moved(Period period, std::int32_t last, TimeStep step, int by,
                   std::int32_t wanted = 50) {
  return MovedEnd(Year(), period, last, wanted, step, by);
}

TEST(TimeWalk, ABarOfDaysIsARecord) {
  EXPECT_EQ(Moved(Period::kDaily, 366, TimeStep::kBar, -1), 365);
  EXPECT_EQ(Moved(Period::kDaily, 300, TimeStep::kBar, 3), 303);
}

// Saturdays are 6, 13, ... 363 (28 December), 356.
TEST(TimeWalk, ABarOfWeeksEndsOnSaturday) {
  EXPECT_EQ(Moved(Period::kWeekly, 366, TimeStep::kBar, -1), 363);
  EXPECT_EQ(Moved(Period::kWeekly, 363, TimeStep::kBar, -1), 356);
  EXPECT_EQ(Moved(Period::kWeekly, 356, TimeStep::kBar, 1), 363);
  EXPECT_EQ(Moved(Period::kWeekly, 363, TimeStep::kBar, 1), 366) << "the last week is not over";
}

// 30 November is day 335, 31 October day 305.
TEST(TimeWalk, ABarOfMonthsEndsWithIts) {
  EXPECT_EQ(Moved(Period::kMonthly, 366, TimeStep::kBar, -1), 335);
  EXPECT_EQ(Moved(Period::kMonthly, 366, TimeStep::kBar, -2), 305);
  EXPECT_EQ(Moved(Period::kMonthly, 310, TimeStep::kBar, 1), 366);
  EXPECT_EQ(Moved(Period::kMonthly, 305, TimeStep::kBar, 1), 335);
}

// 31 December, 30 November, and a month from there 30 December, day 365.
TEST(TimeWalk, AMonthIsOneOfTheCalendar) {
  EXPECT_EQ(Moved(Period::kDaily, 366, TimeStep::kMonth, -1), 335);
  EXPECT_EQ(Moved(Period::kDaily, 335, TimeStep::kMonth, 1), 365);
}

TEST(TimeWalk, AMonthWithoutARecordIsARecord) {
  const std::vector<std::int32_t> dates{20200101, 20210101, 20220101, 20230101};
  EXPECT_EQ(MovedEnd(dates, Period::kDaily, 4, 1, TimeStep::kMonth, -1), 3);
  EXPECT_EQ(MovedEnd(dates, Period::kDaily, 3, 1, TimeStep::kMonth, 1), 4);
}

TEST(TimeWalk, AWindowIsItsOwnLengthAndStopsAtBothEnds) {
  EXPECT_EQ(Moved(Period::kDaily, 366, TimeStep::kWindow, -1), 316);
  EXPECT_EQ(Moved(Period::kDaily, 80, TimeStep::kWindow, -1), 51) << "record 1 to 51";
  EXPECT_EQ(Moved(Period::kDaily, 340, TimeStep::kWindow, 1), 366);
  EXPECT_EQ(Moved(Period::kDaily, 300, TimeStep::kEnd, -1), 51);
  EXPECT_EQ(Moved(Period::kDaily, 51, TimeStep::kBar, -1), 51);
  EXPECT_EQ(Moved(Period::kDaily, 300, TimeStep::kEnd, 1), 366);
}

TEST(TimeWalk, AWindowThatHoldsAllStays) {
  EXPECT_EQ(Moved(Period::kDaily, 366, TimeStep::kWindow, -1, 400), 366);
  EXPECT_EQ(Moved(Period::kDaily, 366, TimeStep::kEnd, -1, 400), 366);
  EXPECT_EQ(MovedEnd({}, Period::kDaily, 1, 10, TimeStep::kBar, -1), 0);
}

TEST(TimeWalk, AnEndBeforeTheOldestWindowIsNotMovedOn) {
  EXPECT_EQ(Moved(Period::kDaily, 20, TimeStep::kWindow, -1), 20);
  EXPECT_EQ(Moved(Period::kDaily, 20, TimeStep::kWindow, 1), 70);
}

}  // namespace
}  // namespace kora
