#include "maintenance/forms/DataForm.h"

#include <QCheckBox>
#include <QRadioButton>
#include <QScrollBar>
#include <QTableView>
#include <QTimer>

#include "maintenance/forms/VolMod.h"
#include "tests/support/qt/list_form_fixture.h"

namespace kora::test {
namespace {

constexpr const char* kHost = "drive_c/korawin/data/ORE.WDT";
constexpr const char* kPath = "c:\\korawin\\data\\ORE.WDT";

class DataFormTest : public ListFormTest {
 protected:
  DataForm& Make(std::int16_t RecType = kShare) {
    return Stand(std::make_unique<DataForm>(
        DataFormServices{.files = home.files(),
                         .settings = session->settings,
                         .user = session->user,
                         .dialogs = dialogs,
                         .print = [this](const TextTable& table, QWidget*) { printed = table; },
                         .saved = [this] { ++saved; }},
        DataFormFile{"ORE", "Good Ore", kPath, RecType}, nullptr));
  }
  DataForm& Open(std::int16_t RecType = kShare) {
    DataForm& opened = Make(RecType);
    EXPECT_TRUE(opened.Fill());
    grid = On<QTableView>("SS1");
    return opened;
  }
  void Put(const std::vector<PriceRec>& days) { home.Put(kHost, Bytes(days)); }
  void PutThree() {
    Put({Day("19980911", 1, 2, 0.5f, 1.5f, 10), Day("19980914", 2, 3, 2, 2.5f, 199),
         Day("19980915", 3, 4, 3, 3.5f, 30)});
  }
  void Choose(const char* entry) { Find<QAction>(form.get(), entry)->trigger(); }
  std::string Cell(int row, int column) {
    return grid->model()->index(row, column).data().toString().toStdString();
  }
  std::string Column(int column) {
    std::string out;
    for (int row = 0; row < grid->model()->rowCount(); ++row) out += Cell(row, column) + " ";
    return out;
  }
  std::string Title() { return form->windowTitle().toStdString(); }
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
  // The cell that was refused is open still; Esc leaves it as it was.
  void LeaveRefused(const std::string& text) {
    ASSERT_TRUE(WaitFor([this] { return !dialogs.said.empty(); }));
    ExpectSaid(text, "Data");
    QApplication::processEvents();  // the cell takes the keyboard back
    ASSERT_TRUE(
        WaitFor([] { return dynamic_cast<QLineEdit*>(QApplication::focusWidget()) != nullptr; }));
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Escape);
  }
  void SelectRows(int first, int last) {
    const auto* model = grid->model();
    grid->setCurrentIndex(model->index(first, kDataClose));
    grid->selectionModel()->select(
        QItemSelection(model->index(first, kDataClose), model->index(last, kDataClose)),
        QItemSelectionModel::ClearAndSelect);
  }
  // Opens "Data Modification" and does `work` in it.
  void InVolMod(const std::function<void(QDialog*)>& work) {
    QTimer::singleShot(0, qApp, [work] {
      auto* opened = qobject_cast<QDialog*>(QApplication::activeModalWidget());
      ASSERT_NE(opened, nullptr);
      const QPointer<QDialog> still(opened);
      work(opened);
      if (still && still->isVisible()) still->reject();
    });
    Choose("nmAdjVol");
  }

  QTableView* grid = nullptr;
  std::optional<TextTable> printed;
  int saved = 0;
};

TEST_F(DataFormTest, ShowsTheFileWithItsLastRecordInHand) {
  PutThree();
  Open();
  EXPECT_EQ(Title(), "ORE   -   Good Ore");
  std::string headings;
  for (int i = 0; i < kDataColumns; ++i)
    headings += grid->model()->headerData(i, Qt::Horizontal).toString().toStdString() + "|";
  EXPECT_EQ(headings, "Rec|Date|Open|High|Low|Close|Volume|Adj.Factor|Adj.Desc.|");
  EXPECT_EQ(Column(kDataRec) + Column(kDataDate) + Column(kDataClose),
            "1 2 3 19980911 19980914 19980915 1.5 2.5 3.5 ");
  EXPECT_EQ(grid->currentIndex().row(), 2);
  EXPECT_EQ(On<QLabel>("WorkText")->text(), QString(kPath) + "   -   3 records");
}

TEST_F(DataFormTest, AnAdvanceDeclineSeriesShowsRisesFallsAndTotal) {
  PutThree();
  Open(kAdvanceDecline);
  EXPECT_EQ(grid->model()->headerData(kDataHigh, Qt::Horizontal), "Rises");
  EXPECT_EQ(grid->model()->headerData(kDataClose, Qt::Horizontal), "Cum.Total");
}

TEST_F(DataFormTest, WithoutAFileNothingIsShown) {
  EXPECT_FALSE(Make().Fill());
  ExpectSaid("ORE NOT FOUND", "Data File");
}

TEST_F(DataFormTest, ACorrectedPriceIsSavedAndToldToTheCharts) {
  PutThree();
  Open();
  TypeCell(1, kDataClose, "2.25");
  EXPECT_EQ(Title(), "ORE   -   Good Ore *");
  QTest::keySequence(form.get(), QKeySequence::Save);
  EXPECT_EQ(saved, 1);
  EXPECT_EQ(Title(), "ORE   -   Good Ore");
  EXPECT_EQ(home.Get(kHost), Bytes(std::vector{Day("19980911", 1, 2, 0.5f, 1.5f, 10),
                                               Day("19980914", 2, 3, 2, 2.25f, 199),
                                               Day("19980915", 3, 4, 3, 3.5f, 30)}));
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(DataFormTest, WhatIsStillBeingTypedCountsAtTheSave) {
  PutThree();
  Open();
  grid->setCurrentIndex(grid->model()->index(0, kDataVolume));
  QTest::keyClick(grid, '7');
  QTest::keyClick(QApplication::focusWidget(), '7');
  Choose("nmSave");
  EXPECT_EQ(std::int32_t(PriceFile(home.files(), kPath).Read(1).Volume), 77);
}

TEST_F(DataFormTest, NumberAndFactorRefuseEdits) {
  PutThree();
  Open();
  TypeCell(0, kDataRec, "9");
  LeaveRefused("Cannot edit this column");
  TypeCell(0, kDataAdjFactor, "2");
  LeaveRefused("Cannot edit this column");
  EXPECT_EQ(Title(), "ORE   -   Good Ore");
}

TEST_F(DataFormTest, APriceThatIsNoNumberKeepsTheCellOpen) {
  PutThree();
  Open();
  TypeCell(0, kDataOpen, "dear");
  LeaveRefused("Data must be numeric");
  EXPECT_EQ(Cell(0, kDataOpen), "1");
}

TEST_F(DataFormTest, ARowWhoseDateIsNoDateIsColoured) {
  PutThree();
  Open();
  const auto background = [&](int row) {
    return grid->model()->index(row, kDataDate).data(Qt::BackgroundRole).value<QBrush>();
  };
  EXPECT_EQ(background(0), background(1));
  TypeCell(1, kDataDate, "19980931");
  EXPECT_NE(background(0), background(1));
}

TEST_F(DataFormTest, ClosingWithAChangeAsks) {
  PutThree();
  const std::string before = home.Get(kHost);
  Open();
  TypeCell(0, kDataClose, "9");
  dialogs.answers = {Answer::kCancel};
  Choose("nmClose");
  ExpectSaid("Data File has changed\nSAVE c:\\korawin\\data\\ORE.WDT?", "Data File");
  EXPECT_TRUE(form->isVisible());
  dialogs.answers = {Answer::kNo};
  Choose("nmClose");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(home.Get(kHost), before);
}

TEST_F(DataFormTest, YesSavesAndCloses) {
  PutThree();
  Open();
  TypeCell(0, kDataClose, "9");
  dialogs.answers = {Answer::kYes};
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(float(PriceFile(home.files(), kPath).Read(1).Close), 9.0f);
}

TEST_F(DataFormTest, RowsAreDeletedInTheGridAndNotYetInTheFile) {
  PutThree();
  const std::string before = home.Get(kHost);
  Open();
  SelectRows(0, 1);
  dialogs.answers = {Answer::kCancel};
  Choose("nmDelete");
  ExpectSaid("Delete items 1 to 2 ?", "Delete Rows");
  EXPECT_EQ(grid->model()->rowCount(), 3);
  SelectRows(1, 1);
  Choose("nmDelete");
  ExpectSaid("Delete row 2 ?", "Delete Rows");
  EXPECT_EQ(Column(kDataRec) + Column(kDataDate), "1 2 19980911 19980915 ");
  EXPECT_EQ(home.Get(kHost), before);
  Choose("nmSave");
  EXPECT_EQ(home.Get(kHost), before.substr(0, 50) + before.substr(100));
}

TEST_F(DataFormTest, ARowWithoutADateCannotBeDeleted) {
  Put({Day("19980911", 1, 1, 1, 1), Day("", 2, 2, 2, 2)});
  Open();
  SelectRows(1, 1);
  Choose("nmDelete");
  ExpectSaid("Only transactions can be deleted", "Delete Transaction");
  EXPECT_EQ(grid->model()->rowCount(), 2);
}

TEST_F(DataFormTest, SortsByDate) {
  Put({Day("19980914", 1, 1, 1, 1), Day("19980911", 2, 2, 2, 2)});
  Open();
  Choose("nmSort");
  EXPECT_EQ(Column(kDataDate) + Column(kDataRec), "19980911 19980914 1 2 ");
  EXPECT_EQ(Title(), "ORE   -   Good Ore *");
}

TEST_F(DataFormTest, PrintsAllRowsWithTheirHeadings) {
  PutThree();
  Open();
  Choose("nmPrint");
  ASSERT_TRUE(printed);
  EXPECT_EQ(printed->layout.heading, "ORE   Good Ore");
  EXPECT_EQ(printed->layout.columns.size(), size_t(kDataColumns));
  ASSERT_EQ(printed->rows.size(), 3u);
  EXPECT_EQ(printed->rows[1][kDataDate], "19980914");
}

TEST_F(DataFormTest, ATickedItemOfTheSelectionIsDivided) {
  PutThree();
  Open();
  SelectRows(1, 2);
  InVolMod([&](QDialog* volMod) {
    EXPECT_EQ(Find<QLabel>(volMod, "Label1")->text(), "Modify records 2 to 3");
    EXPECT_EQ(Find<QLabel>(volMod, "Label2")->text(), "");
    Find<QCheckBox>(volMod, "Check1(4)")->click();
    EXPECT_EQ(Find<QLabel>(volMod, "Label2")->text(),
              "This procedure multiplies or divides the VOLUME of the highlighted record/s, by the "
              "factor selected. ");
    Find<QRadioButton>(volMod, "Option1(2)")->click();
    Click(volMod, "Command1");
    EXPECT_FALSE(volMod->isVisible());
  });
  EXPECT_EQ(Column(kDataVolume), "10 19 3 ");
  EXPECT_EQ(Column(kDataClose), "1.5 2.5 3.5 ");
  EXPECT_EQ(Title(), "ORE   -   Good Ore *");
}

TEST_F(DataFormTest, WhatIsMissingForTheProcessIsTold) {
  PutThree();
  Open();
  SelectRows(0, 0);
  InVolMod([&](QDialog* volMod) {
    EXPECT_EQ(Find<QLabel>(volMod, "Label1")->text(), "Modify record 1");
    Click(volMod, "Command1");
    ExpectSaid("No data item to Adjust", "Data Modification");
    Find<QCheckBox>(volMod, "Check1(0)")->click();
    Click(volMod, "Command1");
    ExpectSaid("Multiply or Divide option must be selected", "Data Modification");
    EXPECT_TRUE(volMod->isVisible());
  });
  EXPECT_EQ(Title(), "ORE   -   Good Ore");
}

TEST_F(DataFormTest, WithoutRowsThereIsNothingToModify) {
  PutThree();
  Open();
  SelectRows(0, 2);
  Choose("nmDelete");
  dialogs.said.clear();
  InVolMod([&](QDialog* volMod) {
    EXPECT_EQ(Find<QLabel>(volMod, "Label1")->text(), "There are no records selected");
    EXPECT_FALSE(Find<QPushButton>(volMod, "Command1")->isEnabled());
  });
}

TEST_F(DataFormTest, AFileChangedByAnotherProgramAsksBeforeTheSave) {
  PutThree();
  Open();
  TypeCell(0, kDataClose, "9");
  Put({Day("19980916", 1, 1, 1, 1)});
  const std::string other = home.Get(kHost);
  dialogs.answers = {Answer::kNo};
  Choose("nmSave");
  ExpectSaid("The data file was changed by another program. Save over these changes ?",
             "Saving Data");
  EXPECT_EQ(home.Get(kHost), other);
  EXPECT_EQ(saved, 0);
  EXPECT_EQ(Title(), "ORE   -   Good Ore *");
}

// Cells are made of the records that are in sight: were they made of all, this would take minutes.
TEST_F(DataFormTest, AFileOfAMillionRecordsIsShownByWhatIsInSight) {
  std::string bytes;
  bytes.reserve(50'000'000);
  const std::string day = Bytes(std::vector{Day("19980911", 1, 2, 0.5f, 1.5f, 10)});
  for (int i = 0; i < 1'000'000; ++i) bytes += day;
  home.Put(kHost, bytes);
  Open();
  EXPECT_EQ(grid->model()->rowCount(), 1'000'000);
  EXPECT_EQ(grid->currentIndex().row(), 999'999);
  EXPECT_EQ(Cell(999'999, kDataRec), "1000000");
  grid->verticalScrollBar()->setValue(grid->verticalScrollBar()->maximum() / 2);
  QApplication::processEvents();
  const int row = grid->rowAt(10);
  EXPECT_GT(row, 400'000);
  EXPECT_LT(row, 600'000);
  EXPECT_EQ(Cell(row, kDataRec), std::to_string(row + 1));
}

}  // namespace
}  // namespace kora::test
