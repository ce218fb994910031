#include "maintenance/code_selection.h"

#include "tests/maintenance/maintenance_fixture.h"

namespace kora::test {
namespace {

class CodeSelectionTest : public MaintenanceTest {
 protected:
  CodeSelectionTest() {
    NameRec second = Security("ORE", 1, kAdvanceDecline);
    second.Name.set("Good Ore");
    Names({Security("AAA"), second, Security("BHP")});
    selection.Load();
  }
  CodeSelection selection{home.files(), settings.paths.CurrentDataPath};
  std::optional<size_t> moveTo;
};

TEST_F(CodeSelectionTest, CodesStandInFileOrder) {
  ASSERT_EQ(selection.count(), 3u);
  EXPECT_EQ(selection.CodeAt(0) + selection.CodeAt(1) + selection.CodeAt(2), "AAAOREBHP");
  EXPECT_EQ(selection.NameAt(1), "Good Ore");
}

TEST_F(CodeSelectionTest, AClickTakesCodeFileNameAndKind) {
  EXPECT_EQ(selection.CurrentDataFile(), "");
  selection.Choose(1);
  EXPECT_EQ(selection.CurrentCode(), "ORE");
  EXPECT_EQ(selection.CurrentDataFile(), kData + "ORE.WDT");
  EXPECT_EQ(selection.Name(), "Good Ore");
  EXPECT_EQ(selection.Label(), "ORE.WDT");
  EXPECT_EQ(selection.RecType(), kAdvanceDecline);
}

TEST_F(CodeSelectionTest, ATypedCodeMovesTheListAndIsTakenInAnyCase) {
  EXPECT_TRUE(selection.Enter(" ore ", dialogs, moveTo));
  EXPECT_EQ(moveTo, 1u);
  EXPECT_EQ(selection.CurrentDataFile(), kData + "ORE.WDT");
  EXPECT_EQ(selection.Name(), "Good Ore");
}

TEST_F(CodeSelectionTest, TheFirstRecordIsTakenWithoutMovingTheList) {
  EXPECT_TRUE(selection.Enter("AAA", dialogs, moveTo));
  EXPECT_EQ(moveTo, std::nullopt);
  EXPECT_EQ(selection.CurrentDataFile(), kData + "AAA.WDT");
}

TEST_F(CodeSelectionTest, ACodeThatIsNotThereIsToldAndNoFileIsChosen) {
  selection.Choose(1);
  EXPECT_FALSE(selection.Enter("XYZ", dialogs, moveTo));
  EXPECT_EQ(LastTitle() + ": " + LastSaid(), "Name File: No File For That Name");
  EXPECT_EQ(selection.CurrentDataFile(), "");
}

TEST_F(CodeSelectionTest, ACodeThatCanNameNoFileHasNone) {
  Names({Security("A\\B"), Security("NUL")});
  selection.Load();
  selection.Choose(0);
  EXPECT_EQ(selection.CurrentDataFile(), "");
  selection.Choose(1);
  EXPECT_EQ(selection.CurrentDataFile(), "");
  selection.Choose(9);
  EXPECT_EQ(selection.CurrentCode(), "NUL");
}

TEST_F(CodeSelectionTest, AnotherNameFileIsSeen) {
  EXPECT_FALSE(selection.Changed());
  Names({Security("ORE")});
  EXPECT_TRUE(selection.Changed());
  selection.Load();
  EXPECT_EQ(selection.count(), 1u);
  EXPECT_FALSE(selection.Changed());
}

}  // namespace
}  // namespace kora::test
