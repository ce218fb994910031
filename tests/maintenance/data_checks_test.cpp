#include "maintenance/data_checks.h"

#include "lists/chart_list.h"
#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class DataChecksTest : public MaintenanceTest {
 protected:
  DataCheck Check(std::initializer_list<int> types, int staleDays = kStaleDays) {
    DataCheckPlan plan;
    for (const int type : types) plan.types[size_t(type)] = true;
    plan.StaleDays = staleDays;
    return CheckDataFiles(home.files(), kData, plan, progress, dialogs);
  }
  std::string Listed() {
    std::string out;
    for (const ListRec& rec : ReadList(home.files(), kData, kResultList))
      out += std::to_string(int(rec.ListRecNo)) + std::string(rec.ListCode.trimmed()) + " ";
    return out;
  }
};

}  // namespace

// ---- Prices

TEST_F(DataChecksTest, GapsTakeTheLastCloseThatIsNotNothing) {
  Names({Security("ORE")});
  Prices("ORE", {Day("19980911", 1, 3, 1, 2, 5), Day("19980914", 0, 0, 0, 0, 5),
                 Day("19980915", 0, 7, 0, 6, 5)});
  const DataCheck check = Check({4});
  EXPECT_TRUE(check.done);
  EXPECT_EQ(check.checked, 1);
  EXPECT_EQ(check.repaired, 1);
  EXPECT_EQ(Bytes(PricesOf("ORE")),
            Bytes(std::vector{Day("19980911", 1, 3, 1, 2, 5), Day("19980914", 2, 2, 2, 2, 5),
                              Day("19980915", 6, 7, 6, 6, 5)}));
  EXPECT_TRUE(check.messages.empty());
  EXPECT_EQ(progress.states, (std::vector<std::string>{"CHECKING :   ORE", "RECORDS CHECKED"}));
}

TEST_F(DataChecksTest, AFirstCloseOfNothingTakesTheFirstThatIsNot) {
  Names({Security("ORE")});
  Prices("ORE",
         {Day("19980911", 0, 0, 0, 0, 5), Day("19980914", 0, 0, 0, 0, 5), Flat("19980915", 9, 5)});
  Check({4});
  EXPECT_EQ(Shown("ORE"), "19980911 9; 19980914 9; 19980915 9");
}

TEST_F(DataChecksTest, AFileWithoutAnyCloseIsListedAndLeftAlone) {
  Names({Security("ORE"), Security("ZAP")});
  Prices("ORE", {Day("19980911", 1, 1, 1, 0, 5), Day("19980914", 1, 1, 1, 0, 5)});
  Prices("ZAP", {Flat("19980914", 1, 1)});
  const std::string before = home.Get(kHostData + "ORE.WDT");
  const DataCheck check = Check({4});
  EXPECT_EQ(check.messages, (std::vector<std::string>{"ORE has no price data values"}));
  EXPECT_EQ(check.codes, (std::vector<std::string>{"ORE"}));
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), before);
  EXPECT_EQ(Listed(), "1ORE ");
}

TEST_F(DataChecksTest, AMissingFileIsListedInItsPlace) {
  Names({Security("AAA"), Security("BBB"), Security("CCC"), Security("DDD")});
  Prices("CCC", {Flat("19980911", 0)});
  home.Put(kHostData + "SubListZ.Dat", "12345678");
  EXPECT_EQ(Check({4}).messages,
            (std::vector<std::string>{"AAA has no data file", "BBB has no data file",
                                      "CCC has no price data values", "DDD has no data file"}));
  EXPECT_EQ(Listed(), "1AAA 2BBB 3CCC 4DDD ");
}

// Days without volume at the end, the first of them having a close of its own.
TEST_F(DataChecksTest, StaleSharesAreListedFromTheLimitOn) {
  const auto days = [](int flat) {
    std::vector<PriceRec> recs{Flat("19980801", 2, 100)};
    for (int i = 0; i < flat; ++i) recs.push_back(Flat("19980902", 1));
    return recs;
  };
  Names({Security("AAA"), Security("BBB")});
  Prices("AAA", days(30));  // 30 without volume, 29 without movement
  Prices("BBB", days(31));
  EXPECT_EQ(Check({4}).messages,
            (std::vector<std::string>{" No volume and price movement for BBB 31 days"}));
  EXPECT_EQ(Check({4}, 29).messages.size(), 2u);
}

TEST_F(DataChecksTest, AMoveOrATradeEndsTheCount) {
  std::vector<PriceRec> recs(40, Flat("19980902", 1));
  Names({Security("AAA"), Security("BBB")});
  recs.push_back(Flat("19980903", 2));
  Prices("AAA", recs);
  recs.back() = Flat("19980903", 1, 5);
  Prices("BBB", recs);
  EXPECT_TRUE(Check({4}).messages.empty());
}

TEST_F(DataChecksTest, OnlyTheKindsChosenAreChecked) {
  Names({Security("AAA"), Security("BBB", 1, kAdvanceDecline), Security("CCC", 1, kIndex)});
  EXPECT_EQ(Check({4}).codes, (std::vector<std::string>{"AAA"}));
  EXPECT_EQ(Check({1, 2, 5}).codes, (std::vector<std::string>{"CCC"}));
  const DataCheck none = Check({});
  EXPECT_FALSE(none.done);
  EXPECT_EQ(LastSaid(), "No Record Types selected");
  EXPECT_EQ(LastTitle(), "Record Types");
}

TEST_F(DataChecksTest, AnEmptyNameFileIsTold) {
  EXPECT_FALSE(Check({4}).done);
  EXPECT_EQ(LastSaid(), "Cannot check - No Records in Name File");
}

TEST_F(DataChecksTest, StoppingKeepsWhatWasListedAndRepaired) {
  std::vector<NameRec> names;
  for (int i = 0; i < 10; ++i) {
    names.push_back(Security("C" + std::to_string(i)));
    Prices("C" + std::to_string(i), {Flat("19980911", 1, 1), Flat("19980914", 0, 1)});
  }
  Names(names);
  progress.stopAt = 4;
  const DataCheck check = Check({4});
  EXPECT_TRUE(check.stopped);
  EXPECT_EQ(check.repaired, 3);
  EXPECT_EQ(check.last, "C2");
  EXPECT_EQ(Shown("C2"), "19980911 1; 19980914 1");
  EXPECT_EQ(Shown("C3"), "19980911 1; 19980914 0");
  EXPECT_EQ(progress.states.back(), "STOPPED BEHIND C2");
}

TEST_F(DataChecksTest, AKilledCheckIsCompletedByTheNext) {
  EXPECT_GT(KilledEverywhere(
                [&] {
                  Names({Security("AAA"), Security("BBB"), Security("CCC")});
                  Prices("AAA", {Flat("19980911", 1, 1), Flat("19980914", 0, 1)});
                  Prices("BBB", {Flat("19980911", 3, 1), Flat("19980914", 0, 1)});
                },
                [&] { return Check({4}).done; }),
            8);
}

// ---- Removal of what was listed

TEST_F(DataChecksTest, ListedSecuritiesAreRemovedAndTheirFilesKept) {
  Names({Security("AAA"), Security("BBB"), Security("CCC")});
  Prices("AAA", {Flat("19980911", 1)});
  Prices("BBB", {Flat("19980911", 2)});
  home.Put(kHostData + "BBB.old", "older");
  ASSERT_TRUE(RemoveListed(home.files(), kData, {"BBB", "CCC"}, dialogs));
  EXPECT_EQ(LastTitle(), "Erase Data Files");
  EXPECT_EQ(CodesOfNames(), "AAA");
  EXPECT_FALSE(home.Exists(kHostData + "BBB.WDT"));
  EXPECT_EQ(home.Get(kHostData + "BBB.old"), Bytes(std::vector{Flat("19980911", 2)}));
  EXPECT_TRUE(home.Exists(kHostData + "AAA.WDT"));
}

TEST_F(DataChecksTest, NoToTheRemovalLeavesEverything) {
  Names({Security("AAA")});
  Prices("AAA", {Flat("19980911", 1)});
  const auto before = Everything();
  dialogs.answers = {Answer::kNo};
  EXPECT_FALSE(RemoveListed(home.files(), kData, {"AAA"}, dialogs));
  EXPECT_EQ(Everything(), before);
}

TEST_F(DataChecksTest, AKilledRemovalOfListedOnesIsCompletedByTheNext) {
  EXPECT_GT(KilledEverywhere(
                [&] {
                  Names({Security("AAA"), Security("BBB"), Security("CCC")});
                  for (const char* code : {"AAA", "BBB", "CCC"})
                    Prices(code, {Flat("19980911", 1)});
                },
                [&] {
                  return RemoveListed(home.files(), kData, {"AAA", "CCC"}, dialogs);
                }),
            5);
}

// ---- Names and files

TEST_F(DataChecksTest, NamesAndFilesAreMatchedByQuestions) {
  Names({Security("ZAP"), Security("GONE"), Security("KEPT"), Security("ORE")});
  for (const char* code : {"ZAP", "ORE", "NEW", "LEFT"}) Prices(code, {Flat("19980911", 1)});
  home.Put(kHostData + "LONGNAME.WDT", "");
  const std::string old = home.Get(kHostData + "Names.dat");
  dialogs.answers = {Answer::kYes, Answer::kNo, Answer::kNo, Answer::kYes};
  const NameCheck check = CheckNameData(home.files(), kData, progress, dialogs);
  EXPECT_TRUE(check.done);
  ASSERT_EQ(dialogs.said.size(), 4u);
  EXPECT_EQ(dialogs.said[0].text,
            "Name File Entry exists for GONE but NO Data file.\nRemove entry ?");
  EXPECT_EQ(dialogs.said[0].title, "No Data File");
  EXPECT_EQ(dialogs.said[2].text, "Data file exists for LEFT but NO Name file entry.\nAdd entry ?");
  EXPECT_EQ(dialogs.said[2].title, "No Name File Entry");
  EXPECT_EQ(CodesOfNames(), "KEPT NEW ORE ZAP");  // by code
  EXPECT_EQ(check.removed, 1);
  EXPECT_EQ(check.added, 1);
  EXPECT_EQ(check.count, 4);
  EXPECT_EQ(home.Get(kHostData + "Names.Bak"), old);
  EXPECT_EQ(progress.states,
            (std::vector<std::string>{"Checking Files - WAIT", "Checking Data Files - WAIT",
                                      " Checking complete "}));
}

TEST_F(DataChecksTest, NamesThatMatchStayInTheirOrder) {
  Names({Security("ZAP"), Security("ORE")});
  for (const char* code : {"ZAP", "ORE"}) Prices(code, {Flat("19980911", 1)});
  const auto before = Everything();
  EXPECT_EQ(CheckNameData(home.files(), kData, progress, dialogs).count, 2);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Everything(), before);
}

TEST_F(DataChecksTest, AStoppedNameCheckChangesNothing) {
  Names({Security("GONE"), Security("ORE")});
  Prices("ORE", {Flat("19980911", 1)});
  const auto before = Everything();
  progress.stopAt = 2;
  EXPECT_FALSE(CheckNameData(home.files(), kData, progress, dialogs).done);
  EXPECT_EQ(Everything(), before);
}

TEST_F(DataChecksTest, AFailureOfTheNameCheckLeavesEverything) {
  Names({Security("GONE"), Security("ORE")});
  Prices("ORE", {Flat("19980911", 1)});
  EXPECT_GT(
      FailedEverywhere([&] { return CheckNameData(home.files(), kData, progress, dialogs).done; }),
      4);
}

// ---- Advance/decline totals

TEST_F(DataChecksTest, TotalsAreWorkedOutAnewFromTheBase) {
  Names({Security("ORE"), Security("XAD", 1, kAdvanceDecline)});
  EXPECT_EQ(AdvanceDeclines(home.files(), kData, dialogs), (std::vector<std::string>{"XAD"}));
  Prices("XAD", {Day("19980911", 9, 5, 3, 99, 1), Day("19980914", 9, 4, 10, 99, 2)});
  EXPECT_EQ(CheckTotals(home.files(), kData, "xad", "1000", dialogs),
            " Checked XAD\nCumulative Total at end is 996");
  EXPECT_EQ(Bytes(PricesOf("XAD")), Bytes(std::vector{Day("19980911", 0, 5, 3, 1002, 1),
                                                      Day("19980914", 0, 4, 10, 996, 2)}));
}

TEST_F(DataChecksTest, OnABaseOfNothingTheTotalIsRisesLessFalls) {
  Prices("XAD", {Day("19980911", 0, 5, 3, 50), Day("19980914", 0, 4, 10, 50),
                 Day("19980915", 0, 7, 1, 50)});
  EXPECT_EQ(CheckTotals(home.files(), kData, "XAD", "0", dialogs),
            " Checked XAD\nCumulative Total at end is 2");  // 16 less 14
  EXPECT_EQ(float(PricesOf("XAD")[2].Close), 2);
}

TEST_F(DataChecksTest, TotalsAreWholeNumbers) {
  Prices("XAD", {Day("19980911", 0, 2.5f, 0, 0), Day("19980914", 0, 1.5f, 0, 0)});
  CheckTotals(home.files(), kData, "XAD", "0", dialogs);
  EXPECT_EQ(Shown("XAD"), "19980911 2; 19980914 4");  // 2.5 to 2, 3.5 to 4
}

TEST_F(DataChecksTest, TotalsThatCannotBeCheckedAreTold) {
  EXPECT_FALSE(CheckTotals(home.files(), kData, "XAD", "1x", dialogs));
  EXPECT_EQ(LastSaid(), "Base Value must be numeric");
  EXPECT_EQ(LastTitle(), "Base Value");
  EXPECT_FALSE(CheckTotals(home.files(), kData, "XAD", "0", dialogs));
  EXPECT_EQ(LastSaid(), "There are no records for XAD");
  EXPECT_EQ(LastTitle(), "Advance/Decline");
  EXPECT_TRUE(AdvanceDeclines(home.files(), kData, dialogs).empty());
  EXPECT_EQ(LastSaid(), "There are no Advance/Declines");
}
