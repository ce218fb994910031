#include "maintenance/code_change.h"

#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class CodeChangeTest : public MaintenanceTest {
 protected:
  CodeBox focus = CodeBox::kNone;
  CodeChange Change(const std::string& from, const std::string& to) {
    return ChangeCode(home.files(), kData, from, to, progress, dialogs, focus);
  }
};

}  // namespace

TEST_F(CodeChangeTest, RenamesFileAndName) {
  Names({Security("AAA"), Security("OLD", 7), Security("ZAP")});
  Prices("OLD", {Flat("19980914", 1)});
  EXPECT_EQ(Change("old", "new"), CodeChange::kChanged);
  EXPECT_EQ(dialogs.said.at(0).text,
            "Cannot find c:\\korawin\\data\\NEW.WDT\nDo you want data for "
            "c:\\korawin\\data\\OLD.WDT renamed to c:\\korawin\\data\\NEW.WDT?");
  EXPECT_EQ(dialogs.said.at(0).title, "File details");
  EXPECT_EQ(LastSaid(), "Data file renamed and OLD changed to NEW in the NAME File");
  EXPECT_EQ(LastTitle(), "Conversion");
  EXPECT_FALSE(home.Exists(kHostData + "OLD.WDT"));
  EXPECT_EQ(Shown("NEW"), "19980914 1");
  EXPECT_EQ(CodesOfNames(), "AAA NEW ZAP");
  EXPECT_EQ(int(NamesOf()[1].Category), 7);
  EXPECT_EQ(progress.states, (std::vector<std::string>{"RENAMING FILES", "CHECKING NAME FILE",
                                                       "RENAMING NAME FILE ENTRY", ""}));
}

TEST_F(CodeChangeTest, NoToRenamingLeavesEverything) {
  Names({Security("OLD")});
  Prices("OLD", {Flat("19980914", 1)});
  const auto before = Everything();
  dialogs.answers = {Answer::kNo};
  EXPECT_EQ(Change("OLD", "NEW"), CodeChange::kDeclined);
  EXPECT_EQ(Everything(), before);
}

TEST_F(CodeChangeTest, AFileWithoutANameIsRenamedAndTold) {
  Names({Security("AAA")});
  Prices("OLD", {Flat("19980914", 1)});
  EXPECT_EQ(Change("OLD", "NEW"), CodeChange::kChanged);
  EXPECT_EQ(LastSaid(), "Data file renamed but was unable to find entry for OLD the Name File");
  EXPECT_EQ(CodesOfNames(), "AAA");
}

// Dates are not compared: those at the join may stand there twice.
TEST_F(CodeChangeTest, CombinesByJoiningTheRecords) {
  Names({Security("OLD"), Security("NEW")});
  Prices("OLD", {Flat("19980911", 1), Flat("19980914", 2)});
  Prices("NEW", {Flat("19980914", 3), Flat("19980915", 4)});
  EXPECT_EQ(Change("OLD", "NEW"), CodeChange::kChanged);
  EXPECT_EQ(Shown("NEW"), "19980911 1; 19980914 2; 19980914 3; 19980915 4");
  EXPECT_FALSE(home.Exists(kHostData + "OLD.WDT"));
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text, "File converted and OLD changed to NEW in the NAME File");
  EXPECT_EQ(dialogs.said[1].text,
            "The converted data file for NEW may contain duplicate dates at the changeover point. "
            "Use View\\Modify Data from the Main Menu to check and/or delete unwanted records.");
}

TEST_F(CodeChangeTest, ANameOfTheNewCodeIsLeft) {
  Names({Security("NEW"), Security("OLD")});
  Prices("OLD", {Flat("19980911", 1)});
  Prices("NEW", {Flat("19980914", 3)});
  EXPECT_EQ(Change("OLD", "NEW"), CodeChange::kChanged);
  EXPECT_EQ(CodesOfNames(), "NEW NEW");
}

TEST_F(CodeChangeTest, CombinedFilesWithoutANameAreTold) {
  Prices("OLD", {Flat("19980911", 1)});
  Prices("NEW", {Flat("19980914", 3)});
  EXPECT_EQ(Change("OLD", "NEW"), CodeChange::kChanged);
  EXPECT_EQ(dialogs.said.at(0).text,
            "Files converted but was unable to find entry for OLD the Name File");
}

TEST_F(CodeChangeTest, CodesThatAreNoneAreRefusedWithTheirBox) {
  for (const char* code : {"", "  ", "../X", "TOOLONG", "NUL"}) {
    EXPECT_EQ(Change(code, "NEW"), CodeChange::kRefused) << code;
    EXPECT_EQ(LastSaid(), "Invalid Code");
    EXPECT_EQ(LastTitle(), "Old ASX Code");
    EXPECT_EQ(focus, CodeBox::kOld);
    EXPECT_EQ(Change("OLD", code), CodeChange::kRefused) << code;
    EXPECT_EQ(LastTitle(), "New ASX Code");
    EXPECT_EQ(focus, CodeBox::kNew);
  }
}

TEST_F(CodeChangeTest, AMissingFileIsTold) {
  EXPECT_EQ(Change("OLD", "NEW"), CodeChange::kRefused);
  EXPECT_EQ(LastSaid(), "Cannot find c:\\korawin\\data\\OLD.WDT");
  EXPECT_EQ(LastTitle(), "File details");
}

TEST_F(CodeChangeTest, OneFileUnderTwoNamesIsRefused) {
  Names({Security("OLD")});
  Prices("OLD", {Flat("19980911", 1)});
  std::filesystem::create_symlink("OLD.WDT", home.path() + "/" + kHostData + "NEW.WDT");
  const auto before = home.Get(kHostData + "OLD.WDT");
  EXPECT_EQ(Change("OLD", "NEW"), CodeChange::kRefused);
  EXPECT_EQ(Change("OLD", "old"), CodeChange::kRefused);
  EXPECT_EQ(home.Get(kHostData + "OLD.WDT"), before);
  EXPECT_EQ(CodesOfNames(), "OLD");
}

TEST_F(CodeChangeTest, MoreRecordsThanAFileHoldsAreRefused) {
  Prices("OLD", std::vector<PriceRec>(20000, Flat("19980911", 1)));
  Prices("NEW", std::vector<PriceRec>(20000, Flat("19980914", 1)));
  const auto before = Everything();
  EXPECT_EQ(Change("OLD", "NEW"), CodeChange::kRefused);
  EXPECT_FALSE(dialogs.said.empty());
  EXPECT_EQ(Everything(), before);
}

TEST_F(CodeChangeTest, AKilledChangeIsCompletedByTheSameOne) {
  const auto change = [&] {
    return Change("OLD", "NEW") == CodeChange::kChanged || !home.Exists(kHostData + "OLD.WDT");
  };
  EXPECT_GT(KilledEverywhere(
                [&] {
                  Names({Security("AAA"), Security("OLD")});
                  Prices("OLD", {Flat("19980911", 1)});
                },
                change),
            4);
  EXPECT_GT(KilledEverywhere(
                [&] {
                  Names({Security("AAA"), Security("OLD")});
                  Prices("OLD", {Flat("19980911", 1), Flat("19980914", 2)});
                  Prices("NEW", {Flat("19980914", 3), Flat("19980915", 4)});
                },
                change),
            4);
}

TEST_F(CodeChangeTest, AFailureLeavesEverything) {
  Names({Security("AAA"), Security("OLD")});
  Prices("OLD", {Flat("19980911", 1)});
  Prices("NEW", {Flat("19980914", 3)});
  EXPECT_GT(FailedEverywhere([&] { return Change("OLD", "NEW") == CodeChange::kChanged; }), 4);
}
