#include "chart/chart_script.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::TempHome;

namespace {

ScriptLine Split(std::string_view line) {
  ScriptLine out;
  SplitScriptLine(line, out);
  return out;
}

int SplitError(std::string_view line) {
  try {
    Split(line);
  } catch (const RunTimeError& e) {
    return e.number();
  }
  return 0;
}

}  // namespace

TEST(SplitScriptLineTest, TextOfTKeepsItsBlanks) {
  const ScriptLine line = Split("T,8.25,20, 2,  BHP    Steel ,255");
  EXPECT_EQ(line.letter(), 'T');
  EXPECT_EQ(line.number(2), 8.25);
  EXPECT_EQ(line.text[3], "2");
  EXPECT_EQ(line.text[4], "  BHP    Steel ");
  EXPECT_EQ(line.whole(6), 255);
}

TEST(SplitScriptLineTest, TextOfSAndZLosesItsBlanks) {
  EXPECT_EQ(Split("S,8,1,2, 12 50 ,7").text[4], "1250");
  EXPECT_EQ(Split("Z,7,1,2,KO RA,7").text[4], "KORA");
}

TEST(SplitScriptLineTest, LowerCaseLetterPlaysButLosesTheBlanksOfItsText) {
  const ScriptLine line = Split("t,8.25,20,2,A B,255");
  EXPECT_EQ(line.letter(), 'T');
  EXPECT_EQ(line.text[4], "AB");
}

TEST(SplitScriptLineTest, CommaInATextMovesTheRestIntoTheColour) {
  const ScriptLine line = Split("T,8.25,20,2,Bank, The");
  EXPECT_EQ(line.text[4], "Bank");
  EXPECT_EQ(line.text[5], "The");
  EXPECT_EQ(line.whole(6), 0);
}

TEST(SplitScriptLineTest, SeventhFieldIsError9) {
  EXPECT_EQ(SplitError("T,8.25,20,2,Bank, The,255"), 9);
  EXPECT_EQ(SplitError(",,,,,,"), 9);
  EXPECT_EQ(SplitError(",,,,,"), 0);
}

TEST(SplitScriptLineTest, WholeFieldsRoundHalfToEvenAndLeaveThirtyTwoBitsWithError6) {
  const ScriptLine line = Split("H,40.5,41.5,2147483648,x,1");
  EXPECT_EQ(line.whole(2), 40);
  EXPECT_EQ(line.whole(3), 42);
  EXPECT_EQ(line.whole(5), 0);
  EXPECT_THROW(line.whole(4), RunTimeError);
}

TEST(SplitScriptLineTest, LetterOfALongFirstFieldIsNone) {
  EXPECT_EQ(Split("LL,1,2").letter(), '\0');
  EXPECT_EQ(Split("").letter(), '\0');
  EXPECT_EQ(Split("  L ,1").letter(), 'L');
}

TEST(SplitScriptLineTest, LineOfAMegabyteIsRefused) {
  EXPECT_EQ(SplitError(std::string(1 << 20, '9')), 14);
}

TEST(ChartScriptTest, OutputEmptiesAndAppendGoesOn) {
  TempHome home;
  home.Put("drive_c/TCht.Tmp", "old");
  ChartScript script(home.files(), "c:\\TCht.Tmp");
  script.Open(false);
  script.buffer() += "L,1,2,3,4,5\r\n";
  script.Close();
  EXPECT_EQ(home.Get("drive_c/TCht.Tmp"), "L,1,2,3,4,5\r\n");
  script.Open(true);
  script.buffer() += "P,1,2,3\r\n";
  script.Close();
  EXPECT_EQ(home.Get("drive_c/TCht.Tmp"), "L,1,2,3,4,5\r\nP,1,2,3\r\n");
}

TEST(ChartScriptTest, ScriptInMemoryKeepsItsText) {
  ChartScript script;
  script.Open(false);
  script.buffer() += "a";
  script.Close();
  script.Open(true);
  script.buffer() += "b";
  script.Close();
  EXPECT_EQ(script.text(), "ab");
  script.Open(false);
  EXPECT_EQ(script.text(), "");
}
