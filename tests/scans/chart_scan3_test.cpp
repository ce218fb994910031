#include "scans/chart_scan3.h"

#include <cstdint>

#include "tests/scans/scan_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

using Texts = std::vector<std::string>;

class Scan3Test : public ScanOf<Scan3Choices, Scan3Criteria, ReadScan3, RunScan3> {
 protected:
  Texts Rows() {
    Texts out;
    for (const Scan3Hit& hit : Scan().hits) {
      const Texts cells = CellsOf(hit);
      out.push_back(cells[0] + " " + cells[1] + " " + cells[2]);
    }
    return out;
  }
  // The breaks of parabolic_break_test: four rising highs, then a record below the stop.
  static std::vector<PriceRec> BreaksDown(bool up = false) {
    std::vector<PriceRec> days;
    for (const auto& [high, low] :
         {std::pair(10.f, 9.f), std::pair(11.f, 9.5f), std::pair(12.f, 10.5f),
          std::pair(13.f, 11.f), std::pair(12.f, 9.2f), std::pair(9.f, 8.f)}) {
      const float h = up ? 20 - low : high, l = up ? 20 - high : low;
      days.push_back(Day(std::to_string(20000101 + days.size()), l, h, l, l));
    }
    return days;
  }
};

}  // namespace

TEST_F(Scan3Test, BreaksOfTheSideThatIsLookedFor) {
  Add(Security("DN"), BreaksDown());
  Add(Security("UP"), BreaksDown(true));
  Closes("FLAT", {1, 1, 1, 1, 1, 1});
  choices.Check3 = true;
  EXPECT_EQ(Rows(), (Texts{"UP 11.00 UP"}));
  choices.Check5 = true;
  EXPECT_EQ(Rows(), (Texts{"DN 8.00 DOWN", "UP 11.00 UP"}));
  choices.Check3 = false;
  EXPECT_EQ(Rows(), (Texts{"DN 8.00 DOWN"}));
}

// Of a longer file the last 101 records count: one is looked for in which the earlier ones would
// have made another outcome.
TEST_F(Scan3Test, TheLastHundredAndOneRecordsCount) {
  std::uint32_t seed = 3;
  const auto draw = [&](int n) { return int((seed = seed * 1664525u + 1013904223u) >> 16) % n; };
  choices.Check3 = choices.Check5 = true;
  for (int tries = 0; tries < 1000; ++tries) {
    std::vector<PriceRec> days;
    int price = 1000;
    for (int i = 0; i < 300; ++i) {
      price += draw(41) - 20;
      const float low = float(price) / 8, high = low + float(draw(30)) / 8;
      days.push_back(Day("20000103", low, high, low, low));
    }
    const Break all = FindBreak(days, 1), last = FindBreak(std::span(days).last(101), 200);
    if (all == last) continue;
    Add(Security("LONG"), days);
    const Scan3Result result = Scan();
    EXPECT_EQ(result.hits.empty() ? Break::kNone : result.hits[0].side, last);
    return;
  }
  ADD_FAILURE() << "none found";
}

TEST_F(Scan3Test, FiltersAndRanges) {
  const auto days = BreaksDown();
  Add(Security("SHARE", 2, kShare, "121"), days);
  Add(Security("INDEX", 2, kIndex, "121"), days);
  Add(Security("BHPWAB", 2, kShare, "121"), days);
  Add(Security("CAT", 3, kShare, "121"), days);
  Add(Security("CLASS", 2, kShare, "131"), days);
  choices.Check5 = choices.Check2 = choices.Check4 = choices.Check6 = true;
  choices.Text3 = "2";
  choices.Text6 = "120";
  EXPECT_EQ(Rows(), (Texts{"SHARE 8.00 DOWN"}));
  choices.Check1 = true;
  choices.Text2 = "7.99";
  EXPECT_EQ(Rows(), Texts{});
  choices.Text2 = "8";
  EXPECT_EQ(Rows(), (Texts{"SHARE 8.00 DOWN"}));
}

TEST_F(Scan3Test, UnreadFilesAndStops) {
  Add(Security("ONE"), DaysOf({1}));
  Add(Security("A"), BreaksDown());
  Add(Security("B"), BreaksDown());
  choices.Check5 = true;
  EXPECT_EQ(Scan().unread.total(), 1);
  progress.steps = 0;
  progress.stopAt = 3;
  const Scan3Result result = Scan();
  EXPECT_TRUE(result.stopped);
  EXPECT_EQ(result.hits.size(), 1u);
}

TEST_F(Scan3Test, Faults) {
  EXPECT_EQ(FaultOf(),
            (Texts{"Either Look for break UP  or Look for break DOWN need to be selected",
                   "Break Parabolic", "Check3"}));
  choices.Check3 = true;
  EXPECT_EQ(FaultOf(), Texts{});
  choices.Check1 = true;
  choices.Text2 = "0";
  EXPECT_EQ(FaultOf(), (Texts{"Price values invalid", "Closing Price Range", "Text2"}));
  choices.Text2 = "1";
  choices.Check2 = true;
  for (const char* bad : {"", "-1", "40000"}) {
    choices.Text3 = bad;
    EXPECT_EQ(FaultOf(), (Texts{"Invalid Category", "Category Selected", "Text3"}));
  }
  choices.Text3 = "1";
  choices.Check4 = true;
  choices.Text6 = "x";
  EXPECT_EQ(FaultOf(), (Texts{"Industry Class invalid", "Industry Class", "Text6"}));
}

TEST_F(Scan3Test, ChoicesAreKept) {
  choices.Check2 = choices.Check5 = choices.Check6 = true;
  choices.Text3 = "7";
  Scan3Choices back;
  TakeKeptScan3(KeptScan3(choices), back);
  EXPECT_TRUE(!back.Check1 && back.Check2 && !back.Check3 && !back.Check4 && back.Check5 &&
              back.Check6);
  EXPECT_EQ(back.Text1 + " " + back.Text2 + " " + back.Text3, "0.005 1.00 7");
}

TEST(Scan3EndingTest, Texts) {
  EXPECT_EQ(Scan3Ending(false), "No records for the criteria selected were found");
  EXPECT_EQ(Scan3Ending(true),
            "The codes have been stored in Chart Scan list Z\n"
            " The list can be selected for viewing from the\n Chart Selection Window.");
}

TEST(Scan3PrintTest, TwoHitsOnALine) {
  const TextTable table = Scan3Print({{"A", 1, Break::kUp, 1}, {"B", 2, Break::kDown, 2}});
  ASSERT_EQ(table.rows.size(), 1u);
  EXPECT_EQ(table.rows[0], (Texts{"A", "1.00", "UP", "B", "2.00", "DOWN"}));
}
