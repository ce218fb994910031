#include "settings/style_period.h"

#include <gtest/gtest.h>

namespace kora {
namespace {

TEST(StylePeriod, LettersGoInAndComeOut) {
  EXPECT_EQ(ParseStyle("B"), Style::kBar);
  EXPECT_EQ(ParseStyle("C"), Style::kCandlestick);
  EXPECT_EQ(ParseStyle("L"), Style::kLine);
  EXPECT_EQ(ParseStyle("P"), Style::kPointFigure);
  EXPECT_EQ(ParsePeriod("A"), Period::kDaily);
  EXPECT_EQ(ParsePeriod("W"), Period::kWeekly);
  EXPECT_EQ(ParsePeriod("M"), Period::kMonthly);
  EXPECT_EQ(TextOf(Style::kCandlestick), "C");
  EXPECT_EQ(TextOf(Period::kDaily), "A");
}

TEST(StylePeriod, OtherTextsAreNone) {
  for (const char* text : {"", "b", "BC", " B", "A", "unknown"})
    EXPECT_FALSE(ParseStyle(text)) << text;
  for (const char* text : {"", "a", "AW", "D", "unknown"}) EXPECT_FALSE(ParsePeriod(text)) << text;
}

TEST(StylePeriod, BarsAndCandlesNeedARange) {
  EXPECT_TRUE(NeedsRange(Style::kBar));
  EXPECT_TRUE(NeedsRange(Style::kCandlestick));
  EXPECT_FALSE(NeedsRange(Style::kLine));
  EXPECT_FALSE(NeedsRange(Style::kPointFigure));
}

}  // namespace
}  // namespace kora
