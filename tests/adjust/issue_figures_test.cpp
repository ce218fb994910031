#include "adjust/issue_figures.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/support/error_of.h"

namespace kora::test {
namespace {

TEST(IssueFiguresTest, BonusOfOneForFour) {
  const Adjustment a = BonusIssue(1, 4);
  EXPECT_EQ(a.AdjFactorValue, 0.8f);
  EXPECT_EQ(a.AdjDescText, "bi1:4");
}

TEST(IssueFiguresTest, SplitOfTwoForOne) {
  const Adjustment a = ShareSplit(2, 1);
  EXPECT_EQ(a.AdjFactorValue, 0.5f);
  EXPECT_EQ(a.AdjDescText, "ss2:1");
}

// T = (2 x 1 + 4 x 5) / 5 = 4.4; 1 - (5 - 4.4) / 5 = 0.88
TEST(IssueFiguresTest, CashIssueOfOneForFourAtTwo) {
  const Adjustment a = CashIssue(1, 4, Currency(2.0), 5);
  EXPECT_EQ(a.AdjFactorValue, 0.88f);
  EXPECT_EQ(a.AdjDescText, "ci1:4 @ 2");
}

TEST(IssueFiguresTest, DividendAndCall) {
  EXPECT_EQ(Dividend(Currency(0.25), 5).AdjFactorValue, 0.95f);
  EXPECT_EQ(Dividend(Currency(0.25), 5).AdjDescText, "dv0.25");
  EXPECT_EQ(ShareCall(Currency(0.5), 5).AdjFactorValue, 1.1f);
  EXPECT_EQ(ShareCall(Currency(0.5), 5).AdjDescText, "cl0.5");
}

TEST(IssueFiguresTest, AFactorOfSevenDecimalsIsRoundedToSix) {
  EXPECT_EQ(BonusIssue(2, 1).AdjFactorValue, 0.333333f);  // 0.3333333
  EXPECT_EQ(ShareSplit(3, 2).AdjFactorValue, 0.666667f);
  EXPECT_EQ(ShareSplit(1, 3).AdjFactorValue, 3.0f);
}

TEST(IssueFiguresTest, NumbersInTheNotesAreAsShortAsTheyCanBe) {
  EXPECT_EQ(BonusIssue(1.5f, 10).AdjDescText, "bi1.5:10");
  EXPECT_EQ(CashIssue(7, 12, Currency(1.2345), 4).AdjDescText, "ci7:12 @ 1.2345");
}

TEST(IssueFiguresTest, ACloseOfZeroDividesByZero) {
  EXPECT_EQ(ErrorOf([] { CashIssue(1, 4, Currency(2.0), 0); }), kDivisionByZero);
  EXPECT_EQ(ErrorOf([] { ShareCall(Currency(1.0), 0); }), kDivisionByZero);
  EXPECT_EQ(ErrorOf([] { Dividend(Currency(1.0), 0); }), kDivisionByZero);
  EXPECT_EQ(ErrorOf([] { BonusIssue(0, 0); }), kDivisionByZero);
  EXPECT_EQ(ErrorOf([] { ShareSplit(0, 1); }), kDivisionByZero);
}

TEST(IssueFiguresTest, AFactorThatIsNotAboveZeroIsAnOverflow) {
  EXPECT_EQ(ErrorOf([] { Dividend(Currency(5.0), 5); }), kOverflow);  // 0
  EXPECT_EQ(ErrorOf([] { Dividend(Currency(6.0), 5); }), kOverflow);  // below
  EXPECT_EQ(ErrorOf([] { BonusIssue(1e30f, 1); }), kOverflow);        // 0 in 6 decimals
  EXPECT_EQ(ErrorOf([] { ShareSplit(1e-30f, 1e30f); }), kOverflow);   // no 32-bit float
  EXPECT_EQ(ErrorOf([] { RoundedFactor(0.0000004); }), kOverflow);
  EXPECT_EQ(RoundedFactor(0.000001), 0.000001f);
}

TEST(IssueFiguresTest, EachKindHasItsFigures) {
  const IssueFigures figures{.AdjFirst = 1, .AdjSecond = 4, .Amount = Currency(2.0)};
  EXPECT_EQ(FigureAdjustment(IssueKind::kBonus, figures, 5).AdjDescText, "bi1:4");
  EXPECT_EQ(FigureAdjustment(IssueKind::kCash, figures, 5).AdjDescText, "ci1:4 @ 2");
  EXPECT_EQ(FigureAdjustment(IssueKind::kSplit, figures, 5).AdjDescText, "ss1:4");
  EXPECT_EQ(FigureAdjustment(IssueKind::kCall, figures, 5).AdjDescText, "cl2");
  EXPECT_EQ(FigureAdjustment(IssueKind::kDividend, figures, 5).AdjDescText, "dv2");
  EXPECT_EQ(AdjKindOf(IssueKind::kSplit), "B") << "as the bonus issue";
  EXPECT_EQ(AdjKindOf(IssueKind::kCall), "CC");
}

TEST(IssueFiguresTest, AFieldIsANumberOrIsRefused) {
  EXPECT_EQ(FieldNumber(" 4 "), 4.0);
  EXPECT_EQ(FieldNumber(""), 0.0);
  EXPECT_EQ(FieldNumber("1234.5678"), 1234.5678) << "more than a 32-bit float keeps";
  EXPECT_EQ(FieldNumber("-1"), -1.0);
  EXPECT_EQ(FieldNumber("1e3"), 1000.0);
  for (const char* text : {"a", "1a", "1:4", "1 4", "1e400", "nan", "--1"})
    EXPECT_EQ(FieldNumber(text), std::nullopt) << text;
}

TEST(IssueFiguresTest, FiguresThatAreNotAboveZeroAreIncomplete) {
  const Currency two(2.0);
  EXPECT_EQ(FiguresFault(IssueKind::kBonus, {1, 4, {}}, true), "");
  EXPECT_EQ(FiguresFault(IssueKind::kBonus, {0, 4, {}}, true), "Ratio Data incomplete");
  EXPECT_EQ(FiguresFault(IssueKind::kSplit, {1, -4, {}}, true), "Ratio Data incomplete");
  EXPECT_EQ(FiguresFault(IssueKind::kBonus, {1, 0, {}}, false), "Data incomplete");
  EXPECT_EQ(FiguresFault(IssueKind::kCash, {1, 4, {}}, true), "Data incomplete");
  EXPECT_EQ(FiguresFault(IssueKind::kCash, {1, 0, two}, true), "Data incomplete");
  EXPECT_EQ(FiguresFault(IssueKind::kCash, {1, 4, two}, true), "");
  EXPECT_EQ(FiguresFault(IssueKind::kCall, {0, 0, two}, true), "");
  EXPECT_EQ(FiguresFault(IssueKind::kDividend, {0, 0, {}}, true), "Data incomplete");
  EXPECT_EQ(FiguresFault(IssueKind::kDividend, {0, 0, Currency(-1.0)}, true), "Data incomplete");
}

TEST(IssueFiguresTest, TheRatioIsShownOnceBothFiguresAreThere) {
  EXPECT_EQ(RatioText({1, 4, {}}), "Ratio of Bonus Issue is 1:4");
  EXPECT_EQ(RatioText({0, 4, {}}), "");
  EXPECT_EQ(RatioText({1, 0, {}}), "");
}

TEST(IssueDateTest, SeparatorsStandWhereTheyMay) {
  EXPECT_EQ(AdjWantedDateOf("2/10/93"), "19931002");
  EXPECT_EQ(AdjWantedDateOf("12-10-93"), "19931012");
  EXPECT_EQ(AdjWantedDateOf(" 2/1/1993 "), "19930102");
  EXPECT_EQ(AdjWantedDateOf("02/1/05"), "20050102");
  for (const char* text :
       {"", "2", "21093", "2/1093", "2/10/9/3", "/2/93", "0/1/93", "a/1/93", "32/1/93", "aa/1/93",
        "123/1/93", "31/2/99", "2/13/93", "2/10/", "2.10.93", "2/a/93"})
    EXPECT_EQ(AdjWantedDateOf(text), std::nullopt) << text;
}

}  // namespace
}  // namespace kora::test
