#include "base/dates.h"

#include <gtest/gtest.h>

#include "tests/support/error_of.h"

using namespace kora;
using kora::test::ErrorOf;

namespace {

// The calendar walked day by day, by the rule as one learns it.
CalendarDate NextDay(CalendarDate d) {
  const bool leap = d.year % 400 == 0 || (d.year % 4 == 0 && d.year % 100 != 0);
  int days = 31;
  if (d.month == 4 || d.month == 6 || d.month == 9 || d.month == 11) days = 30;
  if (d.month == 2) days = leap ? 29 : 28;
  if (++d.day > days) {
    d.day = 1;
    if (++d.month > 12) {
      d.month = 1;
      ++d.year;
    }
  }
  return d;
}

}  // namespace

TEST(DayNumberTest, AgreesWithACalendarWalkedDayByDay) {
  // 1 January 1800 was a Wednesday, 62,091 days before 1 January 1970: 170 years with 41 leap
  // days (1804 to 1968 less 1900), 170 * 365 + 41.
  CalendarDate d{1800, 1, 1};
  std::int32_t n = -(170 * 365 + 41);
  int weekday = 4;
  for (; d.year < 2201; d = NextDay(d), ++n, weekday = weekday % 7 + 1) {
    ASSERT_EQ(DayNumber(d), n) << FormatFileDate(d);
    ASSERT_EQ(DateOfDayNumber(n), d) << n;
    ASSERT_EQ(Weekday(d), weekday) << FormatFileDate(d);
    ASSERT_EQ(ParseFileDate(FormatFileDate(d)), d);
  }
}

TEST(WeekdayTest, KnownDays) {
  EXPECT_EQ(WeekdayOf("19700101"), 5);  // a Thursday
  EXPECT_EQ(WeekdayOf("20000229"), 3);  // a Tuesday
  EXPECT_EQ(WeekdayOf("19871020"), 3);  // Tuesday, the day after Black Monday
  EXPECT_EQ(ErrorOf([] { WeekdayOf("20010229"); }), 5);
  EXPECT_EQ(ErrorOf([] { WeekdayOf(""); }), 5);
}

TEST(ParseFileDateTest, CalendarDatesOfEightDigitsOnly) {
  EXPECT_EQ(ParseFileDate("20000229"), (CalendarDate{2000, 2, 29}));
  for (const char* text :
       {"19000229", "20010229", "20010431", "20011301", "20010001", "20010100", "00000101",
        "2001011", "200101011", "2001 101", "+2001011", "", "2001-1-1", "abcdefgh"})
    EXPECT_FALSE(ParseFileDate(text)) << text;
}

TEST(ParseUserDateTest, TwoDigitYearsTurnAtThirty) {
  EXPECT_EQ(ParseUserDate("1/2/29"), (CalendarDate{2029, 2, 1}));
  EXPECT_EQ(ParseUserDate("1/2/30"), (CalendarDate{1930, 2, 1}));
  EXPECT_EQ(ParseUserDate("01/02/00"), (CalendarDate{2000, 2, 1}));
  EXPECT_EQ(ParseUserDate("31/12/99"), (CalendarDate{1999, 12, 31}));
  EXPECT_EQ(ParseUserDate("31/12/1829"), (CalendarDate{1829, 12, 31}));
  EXPECT_EQ(ParseUserDate("1/1/5"), (CalendarDate{2005, 1, 1}));
}

TEST(ParseUserDateTest, WhatIsNoDateIsNothing) {
  for (const char* text : {"",
                           "/",
                           "//",
                           "1/2",
                           "1/2/",
                           "/2/3",
                           "1//3",
                           "29/2/2001",
                           "31/4/99",
                           "1/13/99",
                           "0/1/99",
                           "1/2/199",
                           "1/2/19999",
                           "001/2/99",
                           "1/002/99",
                           "1-2-99",
                           "1/2/99 ",
                           " 1/2/99",
                           "-1/2/99",
                           "1/2/-9",
                           "+1/2/99",
                           "1/2/99/3",
                           "99999999999/1/1",
                           "1/1/99999999999",
                           "1/2/0000"})
    EXPECT_FALSE(ParseUserDate(text)) << text;
}

TEST(DateFormsTest, AreSubstringWork) {
  EXPECT_EQ(DateToDisplay("19990131"), "31/01/1999");
  EXPECT_EQ(DateToFile("31/01/1999"), "19990131");
  EXPECT_EQ(DateToShort("19990131"), "31-01-99");
  EXPECT_EQ(DateToDisplay("abcdefgh"), "gh/ef/abcd");
}

TEST(DateFormsTest, ShortInputGivesShortParts) {
  EXPECT_EQ(DateToDisplay(""), "//");
  EXPECT_EQ(DateToDisplay("19990"), "/0/1999");
  EXPECT_EQ(DateToDisplay("1999013"), "3/01/1999");
  EXPECT_EQ(DateToFile("1/2/99"), "/91/");  // nothing from place 7, "/9" from 4, "1/" from 1
  EXPECT_EQ(DateToFile(""), "");
  EXPECT_EQ(DateToShort(""), "--");
  EXPECT_EQ(DateToShort("199"), "--9");
}

TEST(FormatDateTest, TheThreeForms) {
  const CalendarDate d{2005, 3, 7};
  EXPECT_EQ(FormatFileDate(d), "20050307");
  EXPECT_EQ(FormatDisplayDate(d), "07/03/2005");
  EXPECT_EQ(FormatUserDate(d), "7/3/05");
}

TEST(AddMonthsTest, DayIsHeldToTheMonthsLast) {
  EXPECT_EQ(AddMonths({2001, 1, 31}, 1), (CalendarDate{2001, 2, 28}));
  EXPECT_EQ(AddMonths({2000, 1, 31}, 1), (CalendarDate{2000, 2, 29}));
  EXPECT_EQ(AddMonths({1999, 12, 15}, 1), (CalendarDate{2000, 1, 15}));
  EXPECT_EQ(AddMonths({2000, 1, 31}, -1), (CalendarDate{1999, 12, 31}));
  EXPECT_EQ(AddMonths({2000, 3, 31}, -1), (CalendarDate{2000, 2, 29}));
  EXPECT_EQ(AddMonths({2000, 2, 29}, 12), (CalendarDate{2001, 2, 28}));
  EXPECT_EQ(AddMonths({2000, 5, 1}, 0), (CalendarDate{2000, 5, 1}));
  EXPECT_EQ(AddMonths({2000, 5, 1}, -17), (CalendarDate{1998, 12, 1}));
}

TEST(AddMonthsTest, BeforeTheFirstYearStaysAMonth) {
  EXPECT_EQ(AddMonths({1, 1, 31}, -14), (CalendarDate{-1, 11, 30}));
}
