#include "base/currency.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "tests/support/error_of.h"

using namespace kora;
using kora::test::ErrorOf;

TEST(CurrencyTest, KeepsFourDecimalsAndRoundsHalfToEven) {
  EXPECT_EQ(Currency(1.2345).units(), 12345);
  // Halves of a unit that a double holds exactly: n / 32 of a ten-thousandth's multiple.
  EXPECT_EQ(Currency(0.03125).units(), 312);  // 312.5
  EXPECT_EQ(Currency(0.09375).units(), 938);  // 937.5
  EXPECT_EQ(Currency(-0.03125).units(), -312);
  EXPECT_EQ(Currency(-0.09375).units(), -938);
  EXPECT_EQ(Currency(0.00004).units(), 0);
  EXPECT_EQ(Currency(0.00006).units(), 1);
}

TEST(CurrencyTest, WholeNumbersAreExact) {
  EXPECT_EQ(Currency::FromWhole(-7).units(), -70000);
  EXPECT_EQ(Currency::FromWhole(std::numeric_limits<std::int32_t>::min()).units(), -21474836480000);
  EXPECT_EQ(Currency::FromUnits(12345).ToDouble(), 1.2345);
  EXPECT_EQ(Currency(), Currency::FromWhole(0));
}

TEST(CurrencyTest, LeavingTheRangeIsError6) {
  EXPECT_EQ(ErrorOf([] { (void)Currency{922337203685477.0}; }), 0);
  EXPECT_EQ(ErrorOf([] { (void)Currency{922337203685478.0}; }), 6);
  EXPECT_EQ(ErrorOf([] { (void)Currency{-922337203685479.0}; }), 6);
  EXPECT_EQ(ErrorOf([] { (void)Currency{std::nan("")}; }), 6);
  EXPECT_EQ(ErrorOf([] { (void)Currency{HUGE_VAL}; }), 6);
}

TEST(CurrencyTest, SumOutOfRangeIsError6AndLeavesTheSum) {
  Currency sum = Currency::FromUnits(std::numeric_limits<std::int64_t>::max() - 1);
  sum += Currency::FromUnits(1);
  EXPECT_EQ(ErrorOf([&] { sum += Currency::FromUnits(1); }), 6);
  EXPECT_EQ(sum.units(), std::numeric_limits<std::int64_t>::max());
  sum = Currency::FromUnits(std::numeric_limits<std::int64_t>::min());
  EXPECT_EQ(ErrorOf([&] { sum += Currency::FromUnits(-1); }), 6);
  sum += Currency::FromUnits(5);
  EXPECT_EQ(sum.units(), std::numeric_limits<std::int64_t>::min() + 5);
}
