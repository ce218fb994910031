#include "base/text.h"

#include <gtest/gtest.h>

using namespace kora;

TEST(AnsiTest, EveryByteOfTheCodePageComesBack) {
  const std::string holes = "\x81\x8D\x8F\x90\x9D";
  for (int b = 0; b < 256; ++b) {
    const std::string byte(1, char(b));
    const std::string utf8 = FromAnsi(byte);
    if (holes.find(char(b)) != std::string::npos) {
      EXPECT_EQ(utf8, "\xEF\xBF\xBD") << b;
      EXPECT_EQ(ToAnsi(utf8), "?") << b;
    } else {
      EXPECT_EQ(ToAnsi(utf8), byte) << b;
    }
    if (b < 0x80) {
      EXPECT_EQ(utf8, byte) << b;
    }
    // From A0 the code page is Latin-1: two bytes, C2 or C3 in front.
    if (b >= 0xA0) {
      const std::string two{char(b < 0xC0 ? 0xC2 : 0xC3), char(b < 0xC0 ? b : b - 0x40)};
      EXPECT_EQ(utf8, two) << b;
    }
  }
}

TEST(AnsiTest, CharactersOfTheUpperRows) {
  EXPECT_EQ(FromAnsi("\x80 \x93x\x94 \x99"), "\u20AC \u201Cx\u201D \u2122");
  EXPECT_EQ(FromAnsi("\x82\x83\x84\x85\x86\x87\x88\x89\x8A\x8B\x8C\x8E"),
            "\u201A\u0192\u201E\u2026\u2020\u2021\u02C6\u2030\u0160\u2039\u0152\u017D");
  EXPECT_EQ(FromAnsi("\x91\x92\x95\x96\x97\x98\x9A\x9B\x9C\x9E\x9F"),
            "\u2018\u2019\u2022\u2013\u2014\u02DC\u0161\u203A\u0153\u017E\u0178");
}

TEST(AnsiTest, CharacterThatTheCodePageLacksIsAQuestionMark) {
  EXPECT_EQ(ToAnsi("a\u0416b"), "a?b");
  EXPECT_EQ(ToAnsi("\U0001F600"), "?");
  EXPECT_EQ(ToAnsi("\u0081"), "?");
}

TEST(AnsiTest, BadUtf8IsAQuestionMarkAByte) {
  EXPECT_EQ(ToAnsi("\x80"), "?");       // a continuation alone
  EXPECT_EQ(ToAnsi("a\xC3"), "a?");     // cut at the end
  EXPECT_EQ(ToAnsi("\xC3(x"), "?(x");   // no continuation behind
  EXPECT_EQ(ToAnsi("\xE2\x82"), "??");  // cut within three
  EXPECT_EQ(ToAnsi("\xFF\xFE"), "??");
  EXPECT_EQ(ToAnsi("\xF8\x88\x80\x80\x80"), "?????");  // five-byte form
  EXPECT_EQ(ToAnsi("\xE0\x82\xA9"), "???");            // (c) in a longer form than it needs
  EXPECT_EQ(ToAnsi("\xC1\x81"), "??");                 // "A" in two bytes
}

TEST(TextTest, TrimTakesBlanksOnly) {
  EXPECT_EQ(Trim("  a b  "), "a b");
  EXPECT_EQ(LTrim("  a "), "a ");
  EXPECT_EQ(RTrim("  a "), "  a");
  EXPECT_EQ(Trim("\ta\t"), "\ta\t");
  EXPECT_EQ(Trim("   "), "");
  EXPECT_EQ(Trim(""), "");
}

TEST(TextTest, CaseOfLettersAToZOnly) {
  EXPECT_EQ(UCase("abz@[`{\xE9"), "ABZ@[`{\xE9");
  EXPECT_EQ(LCase("ABZ@[`{\xC9"), "abz@[`{\xC9");
  EXPECT_TRUE(EqualNoCase("Names.DAT", "nAMES.dat"));
  EXPECT_FALSE(EqualNoCase("a", "ab"));
  EXPECT_FALSE(EqualNoCase("@", "`"));
}

TEST(TextTest, PadRightPadsAndCuts) {
  EXPECT_EQ(PadRight("BHP", 6), "BHP   ");
  EXPECT_EQ(PadRight("ABCDEFG", 6), "ABCDEF");
  EXPECT_EQ(PadRight("x", 0), "");
}

TEST(TextTest, SplitKeepsEmptyFields) {
  using V = std::vector<std::string_view>;
  EXPECT_EQ(Split("a,,b,", ','), (V{"a", "", "b", ""}));
  EXPECT_EQ(Split("", ','), (V{""}));
  EXPECT_EQ(Split(",", ','), (V{"", ""}));
}

TEST(FixedTextTest, PadsCutsAndTrimsBlanksAndNuls) {
  FixedText<6> text;
  text.set("BHP");
  EXPECT_EQ(text.raw(), "BHP   ");
  EXPECT_EQ(text.trimmed(), "BHP");
  text.set("ABCDEFGH");
  EXPECT_EQ(text.raw(), "ABCDEF");
  text.set(std::string_view("A\0 \0", 4));
  EXPECT_EQ(text.trimmed(), "A");
  text.set("");
  EXPECT_EQ(text.trimmed(), "");
}
