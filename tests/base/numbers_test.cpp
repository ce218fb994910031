#include "base/numbers.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "base/runtime_error.h"

using namespace kora;

namespace {

int ErrorOf(void (*work)()) {
  try {
    work();
  } catch (const RunTimeError& e) {
    return e.number();
  }
  return 0;
}

}  // namespace

TEST(ParseFloatTest, TakesWholeNumbersTextsAlone) {
  EXPECT_EQ(ParseFloat("2.1936"), 2.1936f);
  EXPECT_EQ(ParseFloat("-5"), -5.0f);
  EXPECT_EQ(ParseFloat("1e3"), 1000.0f);
  for (const char* text :
       {"", " 1", "1 ", "1x", "x", "nan", "inf", "-inf", "1e39", "1e-60", "0x1", "1,5"})
    EXPECT_FALSE(ParseFloat(text).has_value()) << text;
}

TEST(CIntTest, RoundsHalvesToEven) {
  EXPECT_EQ(CInt(0.5), 0);
  EXPECT_EQ(CInt(1.5), 2);
  EXPECT_EQ(CInt(2.5), 2);
  EXPECT_EQ(CInt(-0.5), 0);
  EXPECT_EQ(CInt(-1.5), -2);
  EXPECT_EQ(CInt(2.5000001), 3);
}

TEST(CIntTest, LeavingSixteenBitsIsError6) {
  EXPECT_EQ(CInt(32767.4), 32767);
  EXPECT_EQ(CInt(-32768.5), -32768);
  EXPECT_EQ(ErrorOf([] { CInt(32767.5); }), 6);
  EXPECT_EQ(ErrorOf([] { CInt(-32768.6); }), 6);
  EXPECT_EQ(ErrorOf([] { CInt(std::nan("")); }), 6);
  EXPECT_EQ(ErrorOf([] { CInt(HUGE_VAL); }), 6);
}

TEST(CLngTest, LeavingThirtyTwoBitsIsError6) {
  EXPECT_EQ(CLng(2147483647.4), 2147483647);
  EXPECT_EQ(CLng(2.5), 2);
  EXPECT_EQ(CLng(-2147483648.5), std::numeric_limits<std::int32_t>::min());
  EXPECT_EQ(ErrorOf([] { CLng(2147483647.5); }), 6);
}

TEST(IntTest, RoundsDownAndFixTowardsZero) {
  EXPECT_EQ(Int(-1.5), -2);
  EXPECT_EQ(Int(1.9), 1);
  EXPECT_EQ(Fix(-1.5), -1);
}

TEST(ValTest, TakesTheLeadingNumericPart) {
  EXPECT_EQ(Val("12abc"), 12);
  EXPECT_EQ(Val("  -3.25x"), -3.25);
  EXPECT_EQ(Val("+7"), 7);
  EXPECT_EQ(Val(".5"), 0.5);
  EXPECT_EQ(Val("5."), 5);
  EXPECT_EQ(Val("1E5"), 1);
  EXPECT_EQ(Val("1.2.3"), 1.2);
}

TEST(ValTest, TextWithNoNumberIsZero) {
  for (const char* text : {"", "unknown", "-", ".", "+", "abc1", "-.", "+-1"})
    EXPECT_EQ(Val(text), 0) << text;
}

TEST(ValTest, HundredsOfDigitsDoNotOverflowTheReader) {
  EXPECT_EQ(Val(std::string(400, '9')), HUGE_VAL);
  EXPECT_EQ(Val("-" + std::string(400, '9')), -HUGE_VAL);
  EXPECT_EQ(Val("0." + std::string(400, '0') + "1"), 0);
}

TEST(StrTest, ShortestFormWithoutExponent) {
  EXPECT_EQ(Str(2.1936f), "2.1936");
  EXPECT_EQ(Str(0.05f), "0.05");
  EXPECT_EQ(Str(100.0f), "100");
  EXPECT_EQ(Str(-1.5), "-1.5");
  EXPECT_EQ(Str(-0.0), "0");
  EXPECT_EQ(Str(1e20), "100000000000000000000");
  EXPECT_EQ(Str(1e-7), "0.0000001");
  std::string out = "x";
  AppendStr(out, 8.25);
  AppendStr(out, 42.0);
  AppendStr(out, 2.1936f);
  AppendStr(out, -7.0f);
  EXPECT_EQ(out, "x8.25422.1936-7");
}

TEST(CSngTest, WhatNoFloatHoldsIsAnOverflow) {
  EXPECT_EQ(CSng(0.1), 0.1f);
  EXPECT_EQ(CSng(-3.25), -3.25f);
  for (const double bad : {1e39, -1e39, std::nan(""), HUGE_VAL})
    EXPECT_THROW(CSng(bad), RunTimeError) << bad;
}

TEST(FormatTest, HashShowsDigitsOnlyWhereThereAreSome) {
  EXPECT_EQ(Format(0.0, "######"), "");
  EXPECT_EQ(Format(1234567.0, "###"), "1234567");
  EXPECT_EQ(Format(5.0, "#######.###"), "5.");
  EXPECT_EQ(Format(0.5, "#####.00#"), ".50");
  EXPECT_EQ(Format(0.125, ".00#"), ".125");
  EXPECT_EQ(Format(0.5, "0.00#"), "0.50");
}

TEST(FormatTest, ZerosAlwaysShow) {
  EXPECT_EQ(Format(7.0, "000"), "007");
  EXPECT_EQ(Format(0.0, "#####0.00"), "0.00");
  EXPECT_EQ(Format(99.999, "###.00"), "100.00");
}

TEST(FormatTest, RoundsHalfAwayFromZeroOnTheDecimalForm) {
  EXPECT_EQ(Format(2.1935f, "0.000"), "2.194");
  EXPECT_EQ(Format(1.005, "0.00"), "1.01");
  EXPECT_EQ(Format(0.5, "0"), "1");
  EXPECT_EQ(Format(-2.5, "0"), "-3");
  EXPECT_EQ(Format(0.0004, "0.000"), "0.000");
  EXPECT_EQ(Format(-0.0004, "0.000"), "0.000");
  EXPECT_EQ(Format(9.996, "#.##"), "10.");
}

TEST(FormatTest, NotANumberIsNoCrash) {
  EXPECT_EQ(Format(std::nan(""), "0.00"), "nan");
  EXPECT_EQ(Format(HUGE_VALF, "0.00"), "inf");
}
