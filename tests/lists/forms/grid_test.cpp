#include "lists/forms/grid.h"

#include <QClipboard>
#include <QDialog>
#include <QHeaderView>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>
#include <QScrollBar>
#include <QVBoxLayout>
#include <algorithm>
#include <set>

#include "base/runtime_error.h"
#include "tests/support/qt/form_fixture.h"
#include "tests/support/recording_printer.h"

namespace kora {
namespace {

// A million rows that nobody has: text is made as it is asked for, and who asks is counted.
class ManyRows : public GridSource {
 public:
  int count = 1'000'000;
  mutable int asked = 0;
  mutable std::set<int> rowsAsked;
  std::vector<RowBlock> deleted;
  int RowCount() const override { return count; }
  std::string Text(int row, int column) const override {
    ++asked;
    rowsAsked.insert(row);
    return std::to_string(row) + "/" + std::to_string(column);
  }
  void DeleteRows(RowBlock block) override {
    deleted.push_back(block);
    count -= block.count();
  }
};

class GridTest : public test::FormTest {
 protected:
  void SetUp() override { ReadSettings(); }

  Grid* Make(GridSource& source, std::vector<GridColumn> columns) {
    form.reset();
    form = std::make_unique<QDialog>();
    grid = new Grid(source,
                    {.dialogs = dialogs,
                     .files = session->files,
                     .widths = &session->ini,
                     .section = "Charts",
                     .key = "Grid_Widths"},
                    std::move(columns), "SS1", form.get());
    auto* box = new QVBoxLayout(form.get());
    box->addWidget(grid);
    button = new QPushButton("Close", form.get());
    button->setAutoDefault(false);
    box->addWidget(button);
    form->resize(500, 300);
    grid->changed = [this] { ++changes; };
    return grid;
  }
  void Show() {
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
    grid->setFocus();
  }
  // Three securities, code and price; prices must be numbers.
  Grid* Three() {
    rows.rows = {{{"AAA", "1"}}, {{"BBB", "2"}}, {{"CCC", "3"}}};
    rows.check = [](int, int column, std::string& text) -> std::optional<Refusal> {
      if (column == 1 && (text.empty() || text.find_first_not_of("0123456789.") != text.npos))
        return Refusal{"Data must be numeric", "Data"};
      return std::nullopt;
    };
    Make(rows, {{.heading = "Code", .chars = 8}, {.heading = "Last $", .chars = 8, .right = true}});
    Show();
    return grid;
  }
  QLineEdit* Editor() {
    const auto editors = grid->findChildren<QLineEdit*>("CellEditor");
    for (QLineEdit* editor : editors)
      if (editor->isVisible()) return editor;
    return nullptr;
  }
  void Key(Qt::Key key, Qt::KeyboardModifiers keys = Qt::NoModifier) {
    QTest::keyClick(QApplication::focusWidget(), key, keys);
  }
  // Each key goes to what has the focus by then.
  void TypeKeys(const std::string& text) {
    for (const char c : text) QTest::keyClick(QApplication::focusWidget(), c);
  }
  std::pair<int, int> At() { return {grid->CurrentRow(), grid->CurrentColumn()}; }
  static std::string Clipboard() { return QGuiApplication::clipboard()->text().toStdString(); }

  TextGrid rows;
  std::unique_ptr<QDialog> form;
  Grid* grid = nullptr;
  QPushButton* button = nullptr;
  int changes = 0;
};

// ---- Rows that are asked for

TEST_F(GridTest, AsksOnlyForWhatIsOnTheScreen) {
  ManyRows many;
  Make(many, {{.heading = "Rec"}, {.heading = "Close"}});
  Show();
  QCoreApplication::processEvents();
  EXPECT_EQ(grid->model()->rowCount(), 1'000'000);
  EXPECT_LT(many.rowsAsked.size(), 100u);
  many.rowsAsked.clear();
  grid->verticalScrollBar()->setValue(grid->verticalScrollBar()->maximum());
  grid->viewport()->repaint();
  EXPECT_EQ(*many.rowsAsked.rbegin(), 999'999);
  EXPECT_LT(many.rowsAsked.size(), 100u);
  many.rowsAsked.clear();
  grid->GoTo(500'000, 1);
  grid->viewport()->repaint();
  EXPECT_TRUE(many.rowsAsked.contains(500'000));
  EXPECT_LT(many.rowsAsked.size(), 100u);
}

TEST_F(GridTest, SelectingAllOfAMillionRowsAsksForNone) {
  ManyRows many;
  Make(many, {{.heading = "Rec"}, {.heading = "Close"}});
  Show();
  QCoreApplication::processEvents();
  many.rowsAsked.clear();
  grid->SetDeletable(true);
  Key(Qt::Key_A, Qt::ControlModifier);
  EXPECT_EQ(grid->SelectedRows(), (RowBlock{0, 999'999}));
  Key(Qt::Key_Delete);
  EXPECT_EQ(dialogs.said.back().text, "Delete items 1 to 1000000 ?");
  EXPECT_EQ(many.deleted, (std::vector<RowBlock>{{0, 999'999}}));
  EXPECT_EQ(grid->model()->rowCount(), 0);
  EXPECT_LT(many.rowsAsked.size(), 100u);
}

TEST_F(GridTest, FollowsItsSourceAndKeepsTheCellInHand) {
  ManyRows many;
  many.count = 50;
  Make(many, {{.heading = "Rec"}, {.heading = "Close"}});
  Show();
  grid->GoTo(20, 1);
  many.count = 80;
  grid->Refresh();
  EXPECT_EQ(grid->model()->rowCount(), 80);
  EXPECT_EQ(At(), (std::pair{20, 1}));
  many.count = 5;
  grid->Refresh();
  EXPECT_EQ(grid->model()->rowCount(), 5);
}

TEST_F(GridTest, ASourceThatLostRowsIsNotAskedForThem) {
  Three();
  rows.rows.clear();
  grid->viewport()->repaint();
  EXPECT_FALSE(grid->model()->index(2, 0).data().isValid());
}

// ---- Editing

TEST_F(GridTest, TypingEditsAndEnterMovesDown) {
  Three();
  grid->GoTo(0, 1);
  TypeKeys("4.5");
  Key(Qt::Key_Return);
  EXPECT_EQ(rows.Text(0, 1), "4.5");
  EXPECT_EQ(At(), (std::pair{1, 1}));
  EXPECT_EQ(changes, 1);
  EXPECT_EQ(Editor(), nullptr);
  EXPECT_TRUE(grid->hasFocus());
  Key(Qt::Key_Return);  // without an edit, too
  EXPECT_EQ(At(), (std::pair{2, 1}));
  Key(Qt::Key_Return);
  EXPECT_EQ(At(), (std::pair{2, 1}));
  EXPECT_EQ(changes, 1);
}

TEST_F(GridTest, F2EditsWhatStandsThereAndTabMovesRight) {
  Three();
  grid->GoTo(1, 0);
  Key(Qt::Key_F2);
  ASSERT_NE(Editor(), nullptr);
  EXPECT_EQ(Editor()->text(), "BBB");
  Key(Qt::Key_End);
  TypeKeys("X");
  Key(Qt::Key_Tab);
  EXPECT_EQ(rows.Text(1, 0), "BBBX");
  EXPECT_EQ(At(), (std::pair{1, 1}));
}

TEST_F(GridTest, ADoubleClickEdits) {
  Three();
  const QPoint at = grid->visualRect(grid->model()->index(1, 1)).center();
  QTest::mouseClick(grid->viewport(), Qt::LeftButton, {}, at);
  QTest::mouseDClick(grid->viewport(), Qt::LeftButton, {}, at);
  ASSERT_NE(Editor(), nullptr);
  EXPECT_EQ(Editor()->text(), "2");
}

TEST_F(GridTest, EscapeLeavesTheCellAsItWas) {
  Three();
  grid->GoTo(0, 0);
  TypeKeys("ZZZ");
  Key(Qt::Key_Escape);
  EXPECT_EQ(rows.Text(0, 0), "AAA");
  EXPECT_EQ(changes, 0);
  EXPECT_TRUE(form->isVisible());  // not the form's Escape
}

TEST_F(GridTest, TabLeavesTheGridBehindItsLastCell) {
  Three();
  grid->GoTo(0, 1);
  Key(Qt::Key_Tab);
  EXPECT_EQ(At(), (std::pair{1, 0}));
  grid->GoTo(2, 1);
  Key(Qt::Key_Tab);
  EXPECT_TRUE(button->hasFocus());
  grid->setFocus();
  grid->GoTo(1, 0);
  Key(Qt::Key_Backtab, Qt::ShiftModifier);
  EXPECT_EQ(At(), (std::pair{0, 1}));
}

TEST_F(GridTest, ControlTabLeavesTheGridAnywhere) {
  Three();
  grid->GoTo(0, 0);
  Key(Qt::Key_Tab, Qt::ControlModifier);
  EXPECT_TRUE(button->hasFocus());
}

TEST_F(GridTest, ARefusedTextIsToldAndKeepsTheFocusInItsCell) {
  Three();
  grid->GoTo(1, 1);
  TypeKeys("abc");
  Key(Qt::Key_Return);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Data must be numeric");
  EXPECT_EQ(dialogs.said[0].title, "Data");
  ASSERT_TRUE(WaitFor([this] { return Editor() && Editor()->selectedText() == "abc"; }));
  EXPECT_TRUE(Editor()->hasFocus());
  EXPECT_EQ(At(), (std::pair{1, 1}));
  EXPECT_EQ(rows.Text(1, 1), "2");
  EXPECT_EQ(changes, 0);
  TypeKeys("7");
  Key(Qt::Key_Return);
  EXPECT_EQ(rows.Text(1, 1), "7");
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(GridTest, AClickElsewhereComesBackToARefusedCellAndTellsOnce) {
  Three();
  grid->GoTo(0, 1);
  TypeKeys("abc");
  QTest::mouseClick(grid->viewport(), Qt::LeftButton, {},
                    grid->visualRect(grid->model()->index(2, 0)).center());
  ASSERT_TRUE(WaitFor([this] { return At() == std::pair{0, 1}; }));
  EXPECT_EQ(dialogs.said.size(), 1u);
  ASSERT_TRUE(WaitFor([this] { return Editor() && Editor()->hasFocus(); }));
  Key(Qt::Key_Escape);
  EXPECT_EQ(rows.Text(0, 1), "1");
  EXPECT_EQ(Editor(), nullptr);
}

TEST_F(GridTest, AnotherControlComesBackToARefusedCell) {
  Three();
  grid->GoTo(0, 1);
  TypeKeys("abc");
  button->setFocus();
  ASSERT_TRUE(WaitFor([this] { return Editor() && Editor()->hasFocus(); }));
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_FALSE(grid->EndEdit());  // a save is given up: told once more
  EXPECT_EQ(dialogs.said.size(), 2u);
}

TEST_F(GridTest, WhatIsBeingTypedCountsAtEndEdit) {
  Three();
  grid->GoTo(0, 0);
  TypeKeys("NEW");
  EXPECT_TRUE(grid->EndEdit());
  EXPECT_EQ(rows.Text(0, 0), "NEW");
  EXPECT_EQ(Editor(), nullptr);
  EXPECT_TRUE(grid->EndEdit());
}

TEST_F(GridTest, AnUnchangedTextChangesNothing) {
  Three();
  rows.Set(0, 1, "n/a");  // which would be refused
  grid->GoTo(0, 1);
  Key(Qt::Key_F2);
  Key(Qt::Key_Return);
  EXPECT_EQ(changes, 0);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(GridTest, AnErrorOfTheSourceIsToldAndTheCellStaysOpen) {
  Three();
  rows.check = [](int, int, std::string&) -> std::optional<Refusal> {
    throw RunTimeError(kDiskFull);
  };
  grid->GoTo(0, 0);
  TypeKeys("NEW");
  Key(Qt::Key_Return);
  EXPECT_EQ(dialogs.said.back().text, "Disk full");
  EXPECT_EQ(rows.Text(0, 0), "AAA");
  EXPECT_NE(Editor(), nullptr);
}

TEST_F(GridTest, ColumnsAndGridsThatAreLockedTakeNoEdit) {
  Three();
  grid->SetLocked(true);
  grid->SetDeletable(true);
  grid->GoTo(0, 0);
  TypeKeys("X");
  Key(Qt::Key_F2);
  EXPECT_EQ(Editor(), nullptr);
  Key(Qt::Key_Delete);
  EXPECT_EQ(rows.RowCount(), 3);
  QGuiApplication::clipboard()->setText("Y");
  grid->Paste();
  EXPECT_EQ(rows.Text(0, 0), "AAA");
  EXPECT_TRUE(dialogs.said.empty());
  Key(Qt::Key_Tab);
  EXPECT_TRUE(button->hasFocus());
}

TEST_F(GridTest, EnterOnALockedRowIsTheCallers) {
  Three();
  grid->SetLocked(true);
  int row = -1;
  grid->activated = [&](int at) { row = at; };
  grid->GoTo(2, 0);
  Key(Qt::Key_Return);
  EXPECT_EQ(row, 2);
  EXPECT_TRUE(form->isVisible());
}

// ---- Rows deleted, sorted, coloured

TEST_F(GridTest, DeletesABlockAfterAsking) {
  Three();
  grid->SetDeletable(true);
  grid->SelectRows({0, 1});
  dialogs.answers = {Answer::kCancel};
  Key(Qt::Key_Delete);
  EXPECT_EQ(dialogs.said.back().text, "Delete items 1 to 2 ?");
  EXPECT_EQ(rows.RowCount(), 3);
  EXPECT_EQ(changes, 0);
  Key(Qt::Key_Delete);
  ASSERT_EQ(rows.RowCount(), 1);
  EXPECT_EQ(rows.Text(0, 0), "CCC");
  EXPECT_EQ(grid->model()->rowCount(), 1);
  EXPECT_EQ(At().first, 0);
  EXPECT_EQ(changes, 1);
}

TEST_F(GridTest, ASelectionByShiftAndArrowsIsOneBlock) {
  Three();
  grid->SetDeletable(true);
  grid->GoTo(0, 0);
  Key(Qt::Key_Down, Qt::ShiftModifier);
  Key(Qt::Key_Down, Qt::ShiftModifier);
  EXPECT_EQ(grid->SelectedRows(), (RowBlock{0, 2}));
}

TEST_F(GridTest, TheSourceSaysWhichRowsStayAndWhatTheyAreCalled) {
  class Some : public TextGrid {
   public:
    std::optional<Refusal> MayDelete(RowBlock block) const override {
      if (block.last < 2) return std::nullopt;
      return Refusal{"Only transactions can be deleted", "Delete Transaction"};
    }
  } some;
  some.rows = {{{"AAA"}}, {{"BBB"}}, {{""}}};
  some.rowName = [&](int row) { return some.Text(row, 0); };
  Make(some, {{.heading = "Code"}});
  Show();
  grid->SetDeletable(true);
  grid->SelectRows({1, 2});
  EXPECT_FALSE(grid->DeleteSelected());
  EXPECT_EQ(dialogs.said.back().title, "Delete Transaction");
  EXPECT_EQ(dialogs.said.size(), 1u);
  grid->SelectRows({1, 1});
  EXPECT_TRUE(grid->DeleteSelected());
  EXPECT_EQ(dialogs.said.back().text, "Delete row BBB ?");
  EXPECT_EQ(some.RowCount(), 2);
  form.reset();
}

TEST_F(GridTest, AHeadingAsksTheSourceToSort) {
  class Sorted : public TextGrid {
   public:
    bool Sort(int column, bool descending) override {
      if (column != 0) return false;
      std::sort(rows.begin(), rows.end(), [descending](const Row& a, const Row& b) {
        return descending ? a.cells[0] > b.cells[0] : a.cells[0] < b.cells[0];
      });
      return true;
    }
  } sorted;
  sorted.rows = {{{"B", "1"}}, {{"A", "2"}}};
  Make(sorted, {{.heading = "Code"}, {.heading = "Last"}});
  grid->SetSortable(true);
  Show();
  const auto click = [this](int column) {
    QHeaderView* heads = grid->horizontalHeader();
    QTest::mouseClick(heads->viewport(), Qt::LeftButton, {},
                      {heads->sectionViewportPosition(column) + 10, heads->height() / 2});
  };
  click(0);
  EXPECT_EQ(sorted.Text(0, 0), "A");
  EXPECT_EQ(changes, 1);
  EXPECT_EQ(grid->SelectedRows(), (RowBlock{0, 0})) << "a deletion would take all rows";
  click(0);
  EXPECT_EQ(sorted.Text(0, 0), "B");
  click(1);
  EXPECT_EQ(changes, 2);
  EXPECT_EQ(grid->SelectedRows(), (RowBlock{0, 0}));
  form.reset();
}

TEST_F(GridTest, ShadesRowsInColoursOfTheScreen) {
  Three();
  const auto back = [this](int row) {
    return grid->model()->index(row, 1).data(Qt::BackgroundRole).value<QColor>();
  };
  EXPECT_FALSE(grid->model()->index(0, 0).data(Qt::BackgroundRole).isValid());
  rows.rows[1].shade = GridShade::kDone;
  QPalette colours = grid->palette();
  colours.setColor(QPalette::Base, Qt::white);
  grid->setPalette(colours);
  const QColor light = back(1);
  EXPECT_GT(light.lightness(), 150);  // black text stays legible
  colours.setColor(QPalette::Base, Qt::black);
  grid->setPalette(colours);
  EXPECT_LT(back(1).lightness(), 100);  // and white text here
  rows.rows[2].shade = GridShade::kFall;
  EXPECT_TRUE(grid->model()->index(2, 0).data(Qt::ForegroundRole).isValid());
}

// ---- Columns

TEST_F(GridTest, KeepsTheWidthsThatTheUserGave) {
  Three();
  grid->horizontalHeader()->resizeSection(1, 133);
  form->hide();
  EXPECT_EQ(session->ini.GetSetting("Charts", "Grid_Widths"),
            WidthsText({grid->columnWidth(0), 133}));
  Three();
  EXPECT_EQ(grid->columnWidth(1), 133);
}

TEST_F(GridTest, WidthsThatNobodyChangedAreNotWritten) {
  Three();
  grid->SetZoom(150);
  form->hide();
  EXPECT_EQ(session->ini.GetSetting("Charts", "Grid_Widths"), "unknown");
}

TEST_F(GridTest, ZoomChangesTextRowsAndColumnsAndNotTheKeptWidths) {
  Three();
  grid->SetWidths({100, 60});
  const int height = grid->rowHeight(0);
  const double points = grid->font().pointSizeF();
  grid->SetZoom(200);
  EXPECT_EQ(grid->columnWidth(0), 200);
  EXPECT_GT(grid->rowHeight(0), height * 3 / 2);
  EXPECT_DOUBLE_EQ(grid->font().pointSizeF(), 2 * points);
  EXPECT_EQ(grid->Widths(), (std::vector<int>{100, 60}));
  grid->SetZoom(1000);  // held to 200
  EXPECT_EQ(grid->columnWidth(0), 200);
  grid->SetZoom(50);
  grid->SetZoom(100);
  EXPECT_EQ(grid->columnWidth(0), 100);
  EXPECT_EQ(grid->columnWidth(1), 60);
}

TEST_F(GridTest, AHiddenColumnIsNeitherCopiedNorSavedNorPrintedAndTabPassesIt) {
  rows.rows = {{{"AAA", "17", "9.5"}}};
  Make(rows, {{.heading = "Code"}, {.heading = "Rec", .hidden = true}, {.heading = "Last"}});
  Show();
  EXPECT_EQ(grid->Headings(), (std::vector<std::string>{"Code", "Last"}));
  grid->selectAll();
  grid->Copy();
  EXPECT_EQ(Clipboard(), "AAA\t9.5\n");
  EXPECT_EQ(grid->ToPrint("X").rows, (TextRows{{"AAA", "9.5"}}));
  grid->GoTo(0, 0);
  Key(Qt::Key_Tab);
  EXPECT_EQ(At(), (std::pair{0, 2}));
  grid->SetColumnShown(1, true);
  EXPECT_GT(grid->columnWidth(1), 20);
  EXPECT_EQ(grid->Texts({0, 0}), (TextRows{{"AAA", "17", "9.5"}}));
}

// ---- Text that leaves and enters

TEST_F(GridTest, CopiesABlockAndASingleCell) {
  Three();
  grid->SelectRows({0, 1});
  Key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(Clipboard(), "AAA\t1\nBBB\t2\n");
  grid->GoTo(2, 0);
  Key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(Clipboard(), "CCC");
}

TEST_F(GridTest, PastesABlockFromTheCellInHand) {
  Three();
  grid->GoTo(1, 0);
  QGuiApplication::clipboard()->setText("X\t8\tbeyond\nY\t9\nbeyond\n");
  Key(Qt::Key_V, Qt::ControlModifier);
  EXPECT_EQ(grid->Texts({0, 2}), (TextRows{{"AAA", "1"}, {"X", "8"}, {"Y", "9"}}));
  EXPECT_EQ(changes, 1);
}

TEST_F(GridTest, APasteEndsAtTheFirstTextThatIsRefused) {
  Three();
  grid->GoTo(0, 0);
  QGuiApplication::clipboard()->setText("X\tbad\nY\t9\n");
  grid->Paste();
  EXPECT_EQ(dialogs.said.back().text, "Data must be numeric");
  EXPECT_EQ(grid->Texts({0, 2}), (TextRows{{"X", "1"}, {"BBB", "2"}, {"CCC", "3"}}));
  EXPECT_EQ(At(), (std::pair{0, 1}));
  EXPECT_EQ(changes, 1);
}

TEST_F(GridTest, APasteTakesNoTextThatCouldNotBeTyped) {
  rows.rows = {{{"AAA"}}};
  Make(rows, {{.heading = "Code", .limit = 6, .typing = "[A-Z]*"}});
  Show();
  grid->GoTo(0, 0);
  for (const char* text : {"TOOLONG", "a,b"}) {
    QGuiApplication::clipboard()->setText(text);
    grid->Paste();
    EXPECT_EQ(rows.Text(0, 0), "AAA");
  }
  EXPECT_EQ(dialogs.said.size(), 2u);
}

TEST_F(GridTest, ATextOfAnyLengthIsRefusedInAMessageThatFitsTheScreen) {
  rows.rows = {{{"AAA"}}};
  Make(rows, {{.heading = "Code", .limit = 6, .typing = "[A-Z]*"}});
  Show();
  grid->GoTo(0, 0);
  QGuiApplication::clipboard()->setText(QString(33000, 'M'));
  grid->Paste();
  EXPECT_EQ(dialogs.said.back().text,
            "\"" + std::string(60, 'M') + "...\" can't stand in this column");
}

TEST_F(GridTest, SavesAllRowsUnderTheirHeadings) {
  Three();
  rows.Set(0, 0, "A,\xC3\xA4");
  grid->SaveCsv(home.path() + "/out.csv");
  EXPECT_EQ(home.Get("out.csv"), "Code,Last $\r\n\"A,\xE4\",1\r\nBBB,2\r\nCCC,3\r\n");
  EXPECT_THROW(grid->SaveCsv(home.path() + "/no/such/folder.csv"), RunTimeError);
}

TEST_F(GridTest, PrintsAllRowsInColumnsAsOnTheScreen) {
  Three();
  grid->SetWidths({300, 100});
  const TextTable table = grid->ToPrint("NAME FILE");
  EXPECT_EQ(table.layout.at, (std::vector<double>{0, 0.75}));
  test::RecordingPrinter printer;
  PrintTable(printer, session->settings.fonts, session->settings.page, table);
  ASSERT_EQ(printer.sent.size(), 1u);
  std::string texts;
  for (const std::string& op : printer.sent[0]) texts += op + "\n";
  for (const char* text : {" NAME FILE ", " Last $ ", " CCC ", " 3 "})
    EXPECT_NE(texts.find(text), std::string::npos) << text;
}

TEST_F(GridTest, TheMenuOfTheRightButtonOffersWhatCanBeDone) {
  Three();
  const auto names = [this] {
    QContextMenuEvent event(QContextMenuEvent::Keyboard, QPoint(5, 5),
                            grid->mapToGlobal(QPoint(5, 5)));
    QApplication::sendEvent(grid->viewport(), &event);
    QStringList out;
    auto* menu = grid->findChild<QMenu*>("GridMenu");
    EXPECT_NE(menu, nullptr);
    if (!menu) return out;
    for (const QAction* action : menu->actions()) out << action->objectName();
    delete menu;
    return out;
  };
  EXPECT_EQ(names(), (QStringList{"GridCopy", "GridPaste", "GridSaveAs"}));
  grid->SetDeletable(true);
  EXPECT_EQ(names(), (QStringList{"GridCopy", "GridPaste", "GridDelete", "GridSaveAs"}));
  grid->SetLocked(true);
  EXPECT_EQ(names(), (QStringList{"GridCopy", "GridSaveAs"}));
}

}  // namespace
}  // namespace kora
