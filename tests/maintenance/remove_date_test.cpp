#include "maintenance/remove_date.h"

#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class RemoveDateTest : public MaintenanceTest {
 protected:
  RemoveDateBox focus = RemoveDateBox::kNone;
  RemovedDate Remove(const std::string& date, bool latest = false, std::string folder = "?") {
    if (folder == "?") folder = kData;
    return RemoveDate(home.files(), settings, folder, date, latest, progress, dialogs, focus);
  }
  void LayMarket() {
    Names({Security("AAA"), Security("BBB"), Security("CCC"), Security("NONE"), Security("VOID")});
    Prices("AAA", {Flat("19980914", 1), Flat("19980915", 2), Flat("19980916", 3)});
    Prices("BBB", {Flat("19980914", 1)});
    Prices("CCC", {Flat("19980915", 4)});
    Prices("VOID", {});
  }
};

}  // namespace

TEST_F(RemoveDateTest, TakesTheDateOutOfEveryFile) {
  LayMarket();
  const RemovedDate removed = Remove("15/9/98");
  EXPECT_TRUE(removed.done);
  EXPECT_EQ(removed.files, 2);
  EXPECT_EQ(removed.records, 2);
  EXPECT_EQ(Shown("AAA"), "19980914 1; 19980916 3");
  EXPECT_EQ(Shown("BBB"), "19980914 1");
  EXPECT_EQ(Shown("CCC"), "");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(progress.states.front(), "Removing 15/09/1998 from AAA");
  EXPECT_EQ(progress.states.back(), " COMPLETED c:\\korawin\\data\\");
}

TEST_F(RemoveDateTest, ADateThatIsOnNoFileLeavesTheFilesUntouched) {
  LayMarket();
  const auto before = Everything();
  io.Reset();
  EXPECT_EQ(Remove("17/9/98").files, 0);
  EXPECT_EQ(Everything(), before);
}

TEST_F(RemoveDateTest, TheLatestOfTwoGoesAndTheEarlierStays) {
  Names({Security("AAA")});
  const std::vector<PriceRec> twice{Flat("19980915", 1), Flat("19980914", 2), Flat("19980915", 3),
                                    Flat("19980916", 4)};
  Prices("AAA", twice);
  EXPECT_EQ(Remove("15/9/98", true).records, 1);
  EXPECT_EQ(Shown("AAA"), "19980915 1; 19980914 2; 19980916 4");
  Prices("AAA", twice);
  EXPECT_EQ(Remove("15/9/98").records, 2);
  EXPECT_EQ(Shown("AAA"), "19980914 2; 19980916 4");
}

// Two names of one file: it is gone through once.
TEST_F(RemoveDateTest, AFileOfTwoNamesLosesTheLatestOnce) {
  Names({Security("AAA"), Security("AAA")});
  Prices("AAA", {Flat("19980915", 1), Flat("19980915", 2)});
  EXPECT_EQ(Remove("15/9/98", true).records, 1);
  EXPECT_EQ(Shown("AAA"), "19980915 1");
}

TEST_F(RemoveDateTest, TheFolderBecomesThatOfTheProgram) {
  Names({Security("AAA")}, "drive_c/m/");
  Prices("AAA", {Flat("19980915", 1)}, "drive_c/m/");
  EXPECT_TRUE(Remove("15/9/98", false, " c:\\m ").done);
  EXPECT_EQ(settings.paths.CurrentDataPath, "c:\\m\\");
  EXPECT_EQ(Shown("AAA", "c:\\m\\"), "");
}

TEST_F(RemoveDateTest, RefusalsLeadBackToTheirBox) {
  Remove("15/9/98", false, " ");
  EXPECT_EQ(focus, RemoveDateBox::kFolder);
  EXPECT_TRUE(dialogs.said.empty());
  Remove(" ");
  EXPECT_EQ(focus, RemoveDateBox::kDate);
  EXPECT_EQ(LastSaid(), "Date to remove must be entered.");
  EXPECT_EQ(LastTitle(), "Remove Selected Data");
  Remove("31/9/98");
  EXPECT_EQ(focus, RemoveDateBox::kDate);
  EXPECT_EQ(LastSaid(), "The date is not a date d/m/yy");
  Remove("15/9/98", false, "c:\\nowhere");
  EXPECT_EQ(focus, RemoveDateBox::kFolder);
  EXPECT_EQ(settings.paths.CurrentDataPath, kData) << "no folder that is there was named";
}

TEST_F(RemoveDateTest, StoppingIsToldAndLeavesWholeFiles) {
  std::vector<NameRec> names;
  for (int i = 0; i < 200; ++i) {
    const std::string code = "C" + std::to_string(1000 + i);
    names.push_back(Security(code));
    Prices(code, {Flat("19980914", 1), Flat("19980915", 2)});
  }
  Names(names);
  progress.stopAt = 101;
  const RemovedDate removed = Remove("15/9/98");
  EXPECT_TRUE(removed.done);
  EXPECT_TRUE(removed.stopped);
  EXPECT_EQ(removed.files, 100);
  EXPECT_EQ(removed.last, "C1099");
  EXPECT_EQ(LastSaid(), "Stopped behind C1099: 100 files were changed, those behind it were not");
  EXPECT_EQ(PricesOf("C1099").size(), 1u);
  EXPECT_EQ(PricesOf("C1100").size(), 2u);
}

TEST_F(RemoveDateTest, AFileThatIsCutShortIsLeftAndCounted) {
  Names({Security("AAA"), Security("BBB")});
  Prices("AAA", {Flat("19980915", 1)});
  home.Put(kHostData + "BBB.WDT", Bytes(std::vector{Flat("19980915", 1)}) + "half");
  EXPECT_EQ(Remove("15/9/98").files, 1);
  EXPECT_EQ(PricesOf("BBB").size(), 1u);
  EXPECT_FALSE(dialogs.said.empty());
}

TEST_F(RemoveDateTest, AKilledRemovalIsCompletedByTheSameOne) {
  EXPECT_GT(KilledEverywhere([&] { LayMarket(); }, [&] { return Remove("15/9/98").done; }), 6);
}

TEST_F(RemoveDateTest, AFailureLeavesEveryFile) {
  LayMarket();
  EXPECT_GT(FailedEverywhere([&] { return Remove("15/9/98").done; }), 6);
}
