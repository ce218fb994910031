#include "scans/market_statistics.h"

#include "base/numbers.h"
#include "tests/scans/scan_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

using Texts = std::vector<std::string>;

class StatisticsTest : public ScanMarket {
 protected:
  void Moves(std::string_view code, float before, float last, std::int32_t volume = 100,
             const std::string& name = "", const std::string& indClass = "") {
    NameRec rec = Security(code, 1, kShare, indClass);
    rec.Name.set(name);
    Add(rec, {Day("20000103", before, before, before, before, 5),
              Day("20000104", last, last, last, last, volume)});
  }
  // "code name class latest previous percent" of the rises, then of the falls.
  std::pair<Texts, Texts> Sides(std::int32_t top = 20, StatsMode mode = StatsMode::kAll) {
    std::pair<Texts, Texts> out;
    result = ShowStats(Run(), mode, top);
    const auto text = [](const StatsCell& cell) {
      std::string line = cell.code;
      for (const std::string* part :
           {&cell.name, &cell.indClass, &cell.latest, &cell.previous, &cell.percent})
        line += "|" + *part;
      return line;
    };
    for (const StatsRow& row : result.rows) {
      out.first.push_back(text(row.rise));
      out.second.push_back(text(row.fall));
    }
    return out;
  }
  std::string Counts() {
    const StatsCounts& c = result.counts;
    return Str(c.Rises) + " " + Str(c.Falls) + " " + Str(c.Steady) + " " + Str(c.Traded) + " " +
           Str(c.Untraded);
  }

  MarketStats result;
};

}  // namespace

// A table worked by hand.
TEST_F(StatisticsTest, ATableOfAFewSecurities) {
  Moves("AAA", 2, 2.25f, 100, "Alpha Mines", "011");  // 12.5 %
  Moves("BBB", 4, 3, 100, "Beta Oil", "021");         // -25 %
  Moves("CCC", 1, 1.1f, 100, "Gamma", "031");         // 10 %
  Moves("DDD", 0.5f, 0.5f, 100, "Delta", "");         // steady
  Moves("EEE", 8, 7, 100, "Epsilon", "041");          // -12.5 %
  Moves("FFF", 1, 2, 1, "Zeta", "");                  // a volume of 1: untraded
  Moves("GGG", 1, 2, 0, "Eta", "");                   // untraded
  Moves("HHH", 0, 2, 50, "Theta", "");                // a rise from nothing: counted alone
  const auto [rises, falls] = Sides(2);
  EXPECT_EQ(rises,
            (Texts{"AAA|Alpha Mines|011|2.25|2.00|12.50 %", "CCC|Gamma|031|1.10|1.00|10.00 %"}));
  EXPECT_EQ(falls,
            (Texts{"BBB|Beta Oil|021|3.00|4.00|-25.00 %", "EEE|Epsilon|041|7.00|8.00|-12.50 %"}));
  EXPECT_EQ(Counts(), "3 2 1 6 2");
  EXPECT_EQ(progress.states, (Texts{"Checking Statistics", "SORTING STATISTICS", "COMPLETED"}));
}

TEST_F(StatisticsTest, AVolumeOfExactlyOneIsUntraded) {
  Moves("ONE", 1, 2, 1);
  Moves("TWO", 1, 2, 2);
  Sides();
  EXPECT_EQ(Counts(), "1 0 0 1 1");
}

TEST_F(StatisticsTest, MoreRowsThanMoversShowWhatThereIs) {
  Moves("AAA", 1, 2);
  Moves("BBB", 2, 1);
  const auto [rises, falls] = Sides(500);
  // Both sides come from one table: beyond the rises stand falls.
  EXPECT_EQ(rises, (Texts{"AAA|||2.00|1.00|100.00 %", "BBB|||1.00|2.00|-50.00 %"}));
  EXPECT_EQ(falls, (Texts{"BBB|||1.00|2.00|-50.00 %", "AAA|||2.00|1.00|100.00 %"}));
}

TEST_F(StatisticsTest, AChangeThatFourDecimalsDoNotHoldMakesNoMover) {
  Moves("SMALL", 100, 100.001f);
  Moves("LARGE", 1e-30f, 1e30f);
  Moves("SEEN", 100, 100.01f);
  const auto [rises, falls] = Sides();
  EXPECT_EQ(rises, (Texts{"SEEN|||100.01|100.00|0.01 %"}));
  EXPECT_EQ(Counts(), "3 0 0 3 0");
}

TEST_F(StatisticsTest, ModesGoByTheLengthOfTheCode) {
  for (const char* code : {"AB", "ABC", "ABCD", "ABCDE", "ABCDEF"}) Moves(code, 1, 2);
  const auto codes = [&](StatsMode mode) {
    std::string out;
    for (const std::string& row : Sides(20, mode).first) out += row.substr(0, row.find('|')) + " ";
    return out;
  };
  EXPECT_EQ(codes(StatsMode::kThree), "ABC ");
  EXPECT_EQ(codes(StatsMode::kWarrantsOnly), "ABCDEF ");
  EXPECT_EQ(Sides(20, StatsMode::kNoWarrants).first.size(), 4u);
  EXPECT_EQ(Sides(20, StatsMode::kAll).first.size(), 5u);
  EXPECT_EQ(StatsModeOf("nw"), StatsMode::kNoWarrants);
  EXPECT_EQ(StatsModeOf("x"), std::nullopt);
}

TEST_F(StatisticsTest, NamesAreThoseOfTheFirstRecordOfACode) {
  Moves("AAA", 1, 2, 100, "First", "011");
  Moves("AAA", 1, 2, 100, "Second", "021");
  const auto rises = Sides().first;
  EXPECT_EQ(rises, (Texts{"AAA|First|011|2.00|1.00|100.00 %", "AAA|First|011|2.00|1.00|100.00 %"}));
}

TEST_F(StatisticsTest, SortsByTheChange) {
  std::vector<Mover> movers;
  for (const double change : {0.1, -0.5, 3.0, -0.0001, 0.0001, 12345.6789, -0.25})
    movers.push_back({Str(change), 1, 1, Currency(change)});
  SortStats(movers);
  Texts order;
  for (const Mover& mover : movers) order.push_back(mover.code);
  EXPECT_EQ(order, (Texts{"12345.6789", "3", "0.1", "0.0001", "-0.0001", "-0.25", "-0.5"}));
}

TEST_F(StatisticsTest, AnEmptyNumberIsTwenty) {
  EXPECT_EQ(StatsTop(""), 20);
  EXPECT_EQ(StatsTop(" "), 20);
  EXPECT_EQ(StatsTop("5"), 5);
  EXPECT_EQ(StatsTop("-5"), 0);
  EXPECT_EQ(StatsTop("abc"), 0);
  EXPECT_EQ(StatsTop("99999999999999"), 1000000000);
}

TEST_F(StatisticsTest, UnreadFilesAreCountedAndAStopGivesNoTable) {
  Moves("AAA", 1, 2);
  Closes("ONE", {1});
  Moves("BBB", 1, 3);
  Sides();
  EXPECT_EQ(result.unread.total(), 1);
  progress.steps = 0;
  progress.stopAt = 2;
  Sides();
  EXPECT_TRUE(result.stopped);
  EXPECT_TRUE(result.rows.empty());
}

TEST_F(StatisticsTest, WithoutANameFileThereIsNothingToCount) {
  EXPECT_EQ(ErrorOf([&] { Sides(); }), kFileNotFound);
}

TEST(StatisticsErrorTest, TextsByNumber) {
  EXPECT_EQ(StatsErrorText(RunTimeError(kDiskNotReady)),
            "There is a device problem. Check and retry");
  EXPECT_EQ(StatsErrorText(RunTimeError(kPathNotFound)),
            "There is a file access problem. Check directory paths option.");
  EXPECT_EQ(StatsErrorText(RunTimeError(kOutOfMemory)),
            "There is a memory problem. Try closing windows and restarting");
  EXPECT_EQ(StatsErrorText(RunTimeError(kOverflow)), "There is an unexpected error - Overflow");
}

// ---- Texts, and the file that keeps them

TEST_F(StatisticsTest, RowsAndCountsBelowThem) {
  Moves("AAA", 1, 2, 100, "Alpha", "011");
  Moves("BBB", 2, 1, 100, "Beta", "021");
  Sides(1);
  const auto texts = StatsTexts(result);
  EXPECT_EQ(texts, (std::vector<Texts>{{"AAA", "Alpha", "011", "2.00", "1.00", "100.00 %", "BBB",
                                        "Beta", "021", "1.00", "2.00", "-50.00 %"},
                                       {},
                                       {"Rises", "1"},
                                       {"Falls", "1"},
                                       {"Steady", "0"},
                                       {"Traded", "2"},
                                       {"Untraded", "0"}}));
  EXPECT_EQ(StatsColumns().size(), 12u);
}

TEST_F(StatisticsTest, StatsDatKeepsTheLastUpdate) {
  EXPECT_TRUE(KeptStats(home.files(), kData).empty());
  const std::vector<Texts> texts{{"AAA", "Tab\there, and\nline"}, {}, {"Rises", "1"}};
  KeepStats(home.files(), kData, texts);
  EXPECT_EQ(home.Get(kHostData + "Stats.dat"), "AAA\tTab here, and line\r\n\r\nRises\t1\r\n");
  EXPECT_EQ(KeptStats(home.files(), kData),
            (std::vector<Texts>{{"AAA", "Tab here, and line"}, {""}, {"Rises", "1"}}));
}

TEST_F(StatisticsTest, AForeignStatsDatShowsNoMoreThanTheGridHolds) {
  home.Put(kHostData + "Stats.dat", std::string(100, '\t') + "\r\nx");
  const auto texts = KeptStats(home.files(), kData);
  ASSERT_EQ(texts.size(), 2u);
  EXPECT_EQ(texts[0].size(), 12u);
  home.Put(kHostData + "Stats.dat", std::string((4u << 20) + 1, 'x'));
  EXPECT_TRUE(KeptStats(home.files(), kData).empty());
}
