#include "names/forms/NameForm.h"

#include <QCheckBox>
#include <QTableView>
#include <QTimer>

#include "names/forms/ExMaster.h"
#include "tests/support/qt/list_form_fixture.h"

namespace kora::test {
namespace {

constexpr const char* kHost = "drive_c/korawin/data/Names.dat";

struct MarchClock : Clock {
  CalendarDate Today() const override { return {2026, 3, 4}; }
};

class NameFormTest : public ListFormTest {
 protected:
  NameForm& Open() {
    NameForm& opened = Stand(std::make_unique<NameForm>(
        NameFormServices{.files = home.files(),
                         .settings = session->settings,
                         .ini = session->ini,
                         .user = session->user,
                         .dialogs = dialogs,
                         .clock = clock,
                         .print = [this](const TextTable& table, QWidget*) { printed = table; },
                         .saved = [this] { ++saved; }},
        nullptr));
    EXPECT_TRUE(opened.Fill());
    grid = On<QTableView>("SS1");
    return opened;
  }
  void Entry(const char* name) { Find<QAction>(form.get(), name)->trigger(); }
  std::string Cell(int row, int column) {
    return grid->model()->index(row, column).data().toString().toStdString();
  }
  std::string Codes() {
    std::string out;
    for (int row = 0; row < grid->model()->rowCount(); ++row) out += Cell(row, 1) + ".";
    return out;
  }
  // Types into a cell as a user does and leaves it by Enter.
  void TypeCell(int row, int column, const char* text) {
    grid->setFocus();
    grid->setCurrentIndex(grid->model()->index(row, column));
    QTest::keyClick(grid, Qt::Key_F2);
    QWidget* editor = QApplication::focusWidget();
    QTest::keySequence(editor, QKeySequence::SelectAll);
    QTest::keyClick(editor, Qt::Key_Delete);
    QTest::keyClicks(QApplication::focusWidget(), text);
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  }

  MarchClock clock;
  QTableView* grid = nullptr;
  std::optional<TextTable> printed;
  int saved = 0;
};

TEST_F(NameFormTest, ShowsARowARecordWithItsColumns) {
  Open();
  EXPECT_EQ(Codes(), "AAA.BBB.BHP.XAO.ADV.ZZZ.");
  const char* headings[] = {"Rec",
                            "Code",
                            "Type",
                            "Cat.",
                            "Industy\nClass",
                            "Name    (displayed on chart)",
                            "Other\nDetails",
                            "Base",
                            "Top",
                            "PF Inc",
                            "Id"};
  for (int i = 0; i < 11; ++i)
    EXPECT_EQ(grid->model()->headerData(i, Qt::Horizontal), headings[i]) << i;
  EXPECT_EQ(Cell(0, 0) + Cell(0, 2) + Cell(0, 3) + Cell(0, 4) + Cell(0, 5),
            "1"
            "4"
            "1"
            "011"
            "Alpha Mining");
  EXPECT_EQ(Cell(0, 7), "");
}

TEST_F(NameFormTest, ATypedNameIsSavedAndToldToTheProgram) {
  Open();
  TypeCell(1, 5, "Better Bank");
  Entry("nmSave");
  EXPECT_EQ(saved, 1);
  EXPECT_EQ(ReadNames(home.files(), session->settings.paths.CurrentDataPath)[3].Name.trimmed(),
            "Better Bank");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(NameFormTest, ARefusedCellIsToldAndStaysOpen) {
  Open();
  const std::string before = home.Get(kHost);
  grid->setCurrentIndex(grid->model()->index(0, 5));
  TypeCell(0, 5, "a,b");
  ASSERT_TRUE(WaitFor([this] { return !dialogs.said.empty(); }));
  ExpectSaid("Commas NOT to be used in Name or Other Details columns", "Name File");
  ASSERT_TRUE(
      WaitFor([] { return dynamic_cast<QLineEdit*>(QApplication::focusWidget()) != nullptr; }));
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Escape);
  EXPECT_EQ(Cell(0, 5), "Alpha Mining");
  EXPECT_EQ(home.Get(kHost), before);
}

TEST_F(NameFormTest, ARowWithoutACodeTakesTheCursorAndIsNotSaved) {
  Open();
  const std::string before = home.Get(kHost);
  Entry("nmAdd");
  EXPECT_EQ(grid->currentIndex().row(), 6);
  TypeCell(6, 5, "Nobody");
  Entry("nmSave");
  ExpectSaid("Code must be entered", "Name File");
  EXPECT_EQ(grid->currentIndex().row(), 6);
  EXPECT_EQ(grid->currentIndex().column(), 1);
  EXPECT_EQ(home.Get(kHost), before);
}

TEST_F(NameFormTest, SortingIsAViewUntilTheSave) {
  Open();
  Entry("mnSrtCde");
  EXPECT_EQ(Codes(), "AAA.ADV.BBB.BHP.XAO.ZZZ.");
  EXPECT_EQ(Cell(1, 0), "2");
  Entry("nmSave");
  EXPECT_EQ(Codes(), "ZZZ.ADV.AAA.BBB.BHP.XAO.");  // category, then type
}

TEST_F(NameFormTest, ClosingWithChangesAsks) {
  Open();
  const std::string before = home.Get(kHost);
  TypeCell(0, 5, "Changed");
  dialogs.answers = {Answer::kCancel};
  Entry("nmQuit");
  EXPECT_TRUE(form->isVisible());
  ExpectSaid("File has changed. SAVE Changes?", "Name File");
  dialogs.answers = {Answer::kNo};
  Entry("nmQuit");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(home.Get(kHost), before);
}

TEST_F(NameFormTest, WarrantsGoFromTheGridAndTheFile) {
  PutNames({Named("AAA", "a"), Security("AAAWMA", 84), Named("BBB", "b")});
  Open();
  Entry("mnRmvWar");
  EXPECT_EQ(Codes(), "AAA.BBB.");
  EXPECT_EQ(saved, 1);
}

TEST_F(NameFormTest, RowsAreDeletedAfterAQuestion) {
  Open();
  grid->selectionModel()->setCurrentIndex(grid->model()->index(1, 1),
                                          QItemSelectionModel::ClearAndSelect);
  grid->setFocus();
  QTest::keyClick(grid, Qt::Key_Delete);
  EXPECT_EQ(Codes(), "AAA.BHP.XAO.ADV.ZZZ.");
  EXPECT_EQ(dialogs.said.back().title, "Delete Rows");
}

TEST_F(NameFormTest, PrintsItsFiveColumns) {
  Open();
  Entry("nmPrint");
  ASSERT_TRUE(printed);
  EXPECT_EQ(printed->layout.heading, "NAME FILE   04-Mar-26");
  EXPECT_EQ(printed->layout.columns,
            (std::vector<std::string>{"Item", "Code", "Name", "Class", "Other Details"}));
  ASSERT_EQ(printed->rows.size(), 6u);
  EXPECT_EQ(printed->rows[1], (std::vector<std::string>{"2", "BBB", "Beta Bank", "021", ""}));
}

TEST_F(NameFormTest, TheMasterListIsAskedForWhatToKeep) {
  home.Put("drive_c/korawin/KoraName.Mas",
           "AAA   " + PadRight("421011MASTER NAME", 56) + "BBB   " + PadRight("412   OTHER", 56));
  home.Put("drive_c/korawin/KoraName.idx",
           "1,2,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0\r\n");
  Open();
  QTimer::singleShot(0, [] {
    auto* master = TopLevel<ExMaster>();
    ASSERT_TRUE(master);
    Find<QCheckBox>(master, "Check1(0)")->setChecked(true);
    Click(master, "Command1");
  });
  Entry("nmMList");
  EXPECT_EQ(Cell(0, 5), "Alpha Mining");
  EXPECT_EQ(Cell(0, 3), "21");
}

TEST_F(NameFormTest, AFileThatCannotBeReadIsToldAndTheFormStaysAway) {
  home.Put(kHost, std::string(96 * 32768, ' '));
  NameForm& opened =
      Stand(std::make_unique<NameForm>(NameFormServices{.files = home.files(),
                                                        .settings = session->settings,
                                                        .ini = session->ini,
                                                        .user = session->user,
                                                        .dialogs = dialogs,
                                                        .clock = clock},
                                       nullptr));
  EXPECT_FALSE(opened.Fill());
  EXPECT_EQ(dialogs.said.size(), 1u);
}

}  // namespace
}  // namespace kora::test
