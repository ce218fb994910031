#include "chart/styles/point_figure.h"

#include <gtest/gtest.h>

#include <string>

#include "base/runtime_error.h"
#include "tests/support/error_of.h"

using namespace kora;

namespace {

// "5: D12 D11 D10" for a column that began at close 5; "." the first box.
std::vector<std::string> Texts(const std::vector<float>& closes, float box, std::int16_t reversal) {
  std::vector<std::string> out;
  for (const PFColumn& column : ColumnsOf(closes, box, reversal)) {
    std::string text = std::to_string(column.start) + ":";
    for (const PFMove& move : column.moves)
      for (std::int32_t n = 1; n <= move.boxes; ++n) {
        text += move.way == PFMove::Way::kUp ? " U" : move.way == PFMove::Way::kDown ? " D" : " .";
        text += std::to_string(int(move.LevelOf(n, box)));
      }
    out.push_back(text);
  }
  return out;
}

using Columns = std::vector<std::string>;

}  // namespace

TEST(PointFigureColumnsTest, TwentyClosesGiveTheColumnsWorkedByHand) {
  const std::vector<float> closes = {10, 11.5f, 13, 12,    10.5f, 10,    9.2f, 10, 12,    13.4f,
                                     14, 13,    11, 10.9f, 12,    14.2f, 0,    15, 11.9f, 8};
  EXPECT_EQ(Texts(closes, 1, 3),
            (Columns{"0: .10 U11 U12 U13", "5: D12 D11 D10", "9: U11 U12 U13 U14",
                     "12: D13 D12 D11", "15: U12 U13 U14 U15", "18: D14 D13 D12 D11 D10 D9 D8"}));
}

TEST(PointFigureColumnsTest, NoCloseMovesAFullBox) {
  EXPECT_EQ(Texts({10, 10.5f, 9.5f, 10.9f, 9.1f}, 1, 3), Columns{"0: .10"});
}

TEST(PointFigureColumnsTest, NoClosesGiveNoColumns) {
  EXPECT_EQ(Texts({}, 1, 3), Columns{});
  EXPECT_EQ(Texts({0, 0, 0}, 1, 3), Columns{});
}

TEST(PointFigureColumnsTest, FallOfExactlyTheReversalMakesAColumnAndOneUnitShortDoesNot) {
  EXPECT_EQ(Texts({10, 15, 12}, 1, 3), (Columns{"0: .10 U11 U12 U13 U14 U15", "2: D14 D13 D12"}));
  EXPECT_EQ(Texts({10, 15, 12.01f}, 1, 3), Columns{"0: .10 U11 U12 U13 U14 U15"});
  EXPECT_EQ(Texts({15, 10, 13}, 1, 3), (Columns{"0: .15 D14 D13 D12 D11 D10", "2: U11 U12 U13"}));
  EXPECT_EQ(Texts({15, 10, 12.99f}, 1, 3), Columns{"0: .15 D14 D13 D12 D11 D10"});
}

TEST(PointFigureColumnsTest, BoxesAgainstASingleBoxStandInItsColumn) {
  // One box up is no column to turn from: the fall goes beside it, and only then comes a new one.
  EXPECT_EQ(Texts({10, 11, 8, 11}, 1, 3), (Columns{"0: .10 U11 D10 D9 D8", "3: U9 U10 U11"}));
  // The same further on. A new column has three boxes at least, so none is single there.
  EXPECT_EQ(Texts({10, 12, 9, 12}, 1, 3),
            (Columns{"0: .10 U11 U12", "2: D11 D10 D9", "3: U10 U11 U12"}));
}

TEST(PointFigureColumnsTest, FirstCloseTakesTheFirstBoxEitherWay) {
  EXPECT_EQ(Texts({10, 9}, 1, 6), Columns{"0: .10 D9"});
  EXPECT_EQ(Texts({0, 10, 11}, 1, 6), Columns{"1: .10 U11"});
}

TEST(PointFigureColumnsTest, ReversalOfOneOrSevenIsTwo) {
  for (const std::int16_t odd : std::initializer_list<std::int16_t>{-1, 0, 1, 7, 40})
    EXPECT_EQ(ReversalOf(odd), 2) << odd;
  for (std::int16_t r = 2; r <= 6; ++r) EXPECT_EQ(ReversalOf(r), r);
}

TEST(PointFigureColumnsTest, QuotientAtTheEdgeOfABoxIsTheOneOfAWalkBoxByBox) {
  // Tenths are no exact floats: the walk by comparisons is the rule.
  const float box = 0.1f;
  for (int tenths = -40; tenths <= 40; ++tenths) {
    const float from = 10.0f, to = from + float(tenths) * 0.1f;
    double level = from;
    int walked = 0;
    while (to <= level - double(box)) level -= double(box), ++walked;
    while (to >= level + double(box)) level += double(box), ++walked;
    PFColumns columns(box, 2);
    columns.Add(from);
    const auto move = columns.Add(to);
    EXPECT_EQ(move ? move->boxes : 0, walked) << tenths;
  }
}

TEST(PointFigureColumnsTest, ColumnOfMoreBoxesThanItsCounterHoldsIsAnOverflow) {
  const auto run = [](float to) { ColumnsOf(std::vector<float>{1000, to}, 1, 2); };
  EXPECT_NO_THROW(run(1000 + 32766));
  EXPECT_EQ(test::ErrorOf([&] { run(1000 + 32767); }), kOverflow);
  EXPECT_EQ(test::ErrorOf([&] { run(3e38f); }), kOverflow);
  // Told with the close at which it was.
  std::int32_t at = 0;
  const std::vector<float> closes{1000, 1001, 1002, 90000, 3};
  EXPECT_EQ(test::ErrorOf([&] { ColumnsOf(closes, 1, 2, &at); }), kOverflow);
  EXPECT_EQ(at, 3);
}

TEST(PointFigureBoxTest, ComputedValueKeepsThreeDecimalsHalfToEven) {
  EXPECT_FLOAT_EQ(ComputedBoxValue(5, 25, 64), 0.312f);  // 0.3125
  EXPECT_FLOAT_EQ(ComputedBoxValue(5, 24, 64), 0.297f);  // 0.296875
  EXPECT_FLOAT_EQ(ComputedBoxValue(0.1f, 0.1f, 64), 0);
  EXPECT_EQ(test::ErrorOf([] { ComputedBoxValue(5, 25, 0); }), kDivisionByZero);
}

TEST(PointFigureDryRunTest, TenColumnsStayFreeOnceThereAreMoreThanFit) {
  EXPECT_EQ(FirstColumnShown(1, 98), 1);
  EXPECT_EQ(FirstColumnShown(88, 98), 1);
  EXPECT_EQ(FirstColumnShown(89, 98), 1);
  EXPECT_EQ(FirstColumnShown(90, 98), 2);
  EXPECT_EQ(FirstColumnShown(120, 98), 32);
  // A frame with room for fewer than ten shows the last one.
  EXPECT_EQ(FirstColumnShown(120, 4), 120);
}
