#include "adjust/adjust_date.h"

#include <gtest/gtest.h>

#include "base/dates.h"
#include "tests/support/records.h"

namespace kora::test {
namespace {

// One record a day from 1 January 2024, closing at 1.00, 1.01, ...
std::vector<PriceRec> Days(int count) {
  std::vector<PriceRec> records;
  const std::int32_t first = DayNumber({2024, 1, 1});
  for (int i = 0; i < count; ++i) {
    const float close = 1 + float(i) / 100;
    records.push_back(Day(FormatFileDate(DateOfDayNumber(first + i)), close, close, close, close));
  }
  return records;
}

TEST(AdjustDateTest, ADateBeforeTheSecondRecordGivesNoList) {
  const auto records = Days(30);
  EXPECT_TRUE(FindAdjustmentDate(records, "20231231").empty());
  EXPECT_TRUE(FindAdjustmentDate(records, "20240101").empty());
  EXPECT_FALSE(FindAdjustmentDate(records, "20240102").empty());
  EXPECT_TRUE(FindAdjustmentDate(Days(1), "20240601").empty());
  EXPECT_TRUE(FindAdjustmentDate({}, "20240601").empty());
}

TEST(AdjustDateTest, TheListHoldsTwentyToEachSideAndSelectsTheOneBetween) {
  const auto records = Days(100);
  const AdjustmentDates dates = FindAdjustmentDate(records, "20240219");  // day 50 of the year
  EXPECT_EQ(dates.Found, 50);
  EXPECT_EQ(dates.AdjListFirst, 30);
  EXPECT_EQ(dates.Lines.size(), 41u);
  EXPECT_EQ(dates.Selected, 20u);
  EXPECT_EQ(dates.AdjRecNo(dates.Selected), 50);
  EXPECT_EQ(dates.Lines[20], "19/02/2024             1.49");
}

TEST(AdjustDateTest, NearTheStartLineTwentyIsAnotherRecord) {
  const AdjustmentDates dates = FindAdjustmentDate(Days(100), "20240105");
  EXPECT_EQ(dates.Found, 5);
  EXPECT_EQ(dates.AdjListFirst, 1);
  EXPECT_EQ(dates.Lines.size(), 25u);
  EXPECT_EQ(dates.AdjRecNo(dates.Selected), 21);
}

TEST(AdjustDateTest, AShortListHasItsLastLineSelected) {
  AdjustmentDates dates = FindAdjustmentDate(Days(10), "20240105");
  EXPECT_EQ(dates.Lines.size(), 10u);
  EXPECT_EQ(dates.Selected, 9u);
  dates = FindAdjustmentDate(Days(20), "20240105");  // line 20, counted from 0, is not there
  EXPECT_EQ(dates.Lines.size(), 20u);
  EXPECT_EQ(dates.Selected, 19u);
}

TEST(AdjustDateTest, ALaterDateThanTheFilesLastFindsTheLastRecord) {
  const AdjustmentDates dates = FindAdjustmentDate(Days(100), "20250101");
  EXPECT_EQ(dates.Found, 100);
  EXPECT_EQ(dates.Lines.size(), 21u);
  EXPECT_EQ(dates.AdjRecNo(dates.Selected), 100);
}

TEST(AdjustDateTest, AnotherDateThanTheOneWantedIsTold) {
  auto records = Days(30);
  records.erase(records.begin() + 9);  // 10 January
  const AdjustmentDates dates = FindAdjustmentDate(records, "20240110");
  EXPECT_EQ(OtherDateText(records, dates, "20240110", "10/1/24"),
            "No close price on file for 10/1/24\n Nearest date prior is 09/01/2024\n"
            " Close price is 1.08");
  EXPECT_EQ(OtherDateText(records, FindAdjustmentDate(records, "20240111"), "20240111", "11/1/24"),
            "");
}

}  // namespace
}  // namespace kora::test
