#include "lists/grid_rows.h"

#include <gtest/gtest.h>

#include "lists/grid_source.h"
#include "tests/support/scripted_dialogs.h"

namespace kora {
namespace {

std::vector<int> Places(const RowOrder& order) {
  std::vector<int> out;
  for (int i = 0; i < order.count(); ++i) out.push_back(order[i]);
  return out;
}

TEST(RowOrderTest, EachRowStandsAtItsOwnPlaceFirst) {
  EXPECT_EQ(Places(RowOrder(3)), (std::vector<int>{0, 1, 2}));
  EXPECT_EQ(RowOrder(-1).count(), 0);
}

TEST(RowOrderTest, SortsByTheCallersRuleAndLeavesEqualRowsAsTheyStand) {
  const std::vector<std::string> codes{"BBB", "AAA", "CCC", "AAA"};
  RowOrder order(4);
  order.Sort([&](int a, int b) { return codes[size_t(a)] < codes[size_t(b)]; });
  EXPECT_EQ(Places(order), (std::vector<int>{1, 3, 0, 2}));
  order.Reverse();
  EXPECT_EQ(Places(order), (std::vector<int>{2, 0, 3, 1}));
}

TEST(RowOrderTest, TakesABlockOutWhereItStands) {
  RowOrder order(5);
  order.Reverse();  // 4 3 2 1 0
  order.Remove({1, 2});
  EXPECT_EQ(Places(order), (std::vector<int>{4, 1, 0}));
  order.Remove({2, 99});
  order.Remove({-5, 0});
  EXPECT_EQ(Places(order), std::vector<int>{1});
  order.Remove({});
  EXPECT_EQ(order.count(), 1);
}

TEST(GridRowsTest, AsksForOneRowByNameAndForSeveralFromTo) {
  test::ScriptedDialogs dialogs;
  EXPECT_TRUE(AskDeleteRows(dialogs, 1, "ORE", "ORE"));
  EXPECT_EQ(dialogs.said.back().text, "Delete row ORE ?");
  EXPECT_EQ(dialogs.said.back().title, "Delete Rows");
  dialogs.answers = {Answer::kCancel};
  EXPECT_FALSE(AskDeleteRows(dialogs, 5, "3", "7"));
  EXPECT_EQ(dialogs.said.back().text, "Delete items 3 to 7 ?");
}

TEST(GridRowsTest, TabTextAndBack) {
  EXPECT_EQ(TabText({{"ORE", "1.2", ""}, {"a\tb", "c\r\nd", "x"}}), "ORE\t1.2\t\na b\tc  d\tx\n");
  EXPECT_EQ(ParseTabText("ORE\t1.2\t\r\nBHP\n\nZ"),
            (TextRows{{"ORE", "1.2", ""}, {"BHP"}, {""}, {"Z"}}));
  EXPECT_TRUE(ParseTabText("").empty());
}

TEST(GridRowsTest, TabTextStopsAtItsLimit) {
  size_t cells = 0;
  for (const auto& row :
       ParseTabText(std::string(5000, '\t') + "\n" + std::string(5000, '\n'), 100))
    cells += row.size();
  EXPECT_EQ(cells, 100u);
}

TEST(GridRowsTest, CsvQuotesWhatWouldBreakARow) {
  EXPECT_EQ(CsvText({{"Code", "Name"}, {"ORE", "Mine, Old"}, {"Q\"", "two\nlines"}, {"", ""}}),
            "Code,Name\r\nORE,\"Mine, Old\"\r\n\"Q\"\"\",\"two\nlines\"\r\n,\r\n");
}

TEST(GridRowsTest, WidthsReadBackAsTheyWereKept) {
  EXPECT_EQ(WidthsText({80, 7, 120}), "80,7,120");
  EXPECT_EQ(ParseWidths("80,7,120"), (std::vector<int>{80, 7, 120}));
  EXPECT_EQ(WidthsText({0, 123456}), "1,9999");
}

TEST(GridRowsTest, WidthsThatAreNoneEndTheRow) {
  EXPECT_TRUE(ParseWidths("unknown").empty());
  EXPECT_TRUE(ParseWidths("").empty());
  EXPECT_EQ(ParseWidths("80,-5,70"), std::vector<int>{80});
  EXPECT_EQ(ParseWidths("80,0,70"), std::vector<int>{80});
  EXPECT_EQ(ParseWidths("80,99999,70"), std::vector<int>{80});
}

// A settings file gives 60 characters back: what stands last may be the beginning of a number.
TEST(GridRowsTest, AWidthThatWasCutDoesNotCount) {
  std::vector<int> widths(20, 100);
  widths[0] = 7;  // "7," and 58 characters: 14 numbers of four, then "10"
  widths.resize(15);
  EXPECT_EQ(ParseWidths(WidthsText(std::vector<int>(20, 100)).insert(0, "7,").substr(0, 60)),
            widths);
}

TEST(TextGridTest, CellsThatAreMissingAreEmptyAndAreMadeWhereTextComes) {
  TextGrid grid;
  grid.rows = {{{"ORE"}}, {{"BHP", "2"}}};
  EXPECT_EQ(grid.Text(0, 5), "");
  EXPECT_FALSE(grid.SetText(0, 2, "x"));
  EXPECT_EQ(grid.rows[0].cells, (std::vector<std::string>{"ORE", "", "x"}));
  grid.DeleteRows({0, 0});
  EXPECT_EQ(grid.Text(0, 0), "BHP");
  EXPECT_EQ(grid.RowName(0), "1");
}

TEST(TextGridTest, AnEmptyTextOfTheCheckIsARefusalToo) {
  TextGrid grid;
  grid.rows = {{{"1"}}};
  grid.check = [](int, int, std::string&) { return std::optional<Refusal>(Refusal{}); };
  EXPECT_TRUE(grid.SetText(0, 0, "2"));
  EXPECT_EQ(grid.Text(0, 0), "1");
}

}  // namespace
}  // namespace kora
