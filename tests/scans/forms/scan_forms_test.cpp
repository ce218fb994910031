#include <QCheckBox>
#include <QClipboard>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <functional>

#include "lists/chart_list.h"
#include "lists/forms/RecSav.h"
#include "scans/forms/ChtScan2.h"
#include "scans/forms/ChtScan3.h"
#include "scans/forms/Statistics.h"
#include "scans/forms/chtScan1.h"
#include "tests/support/qt/form_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

using Texts = std::vector<std::string>;

class ScanFormsTest : public FormTest {
 protected:
  const std::string kData = "drive_c/korawin/data/";

  ScanFormsTest() {
    ReadSettings();
    // AAA rises by 50 percent, BBB falls by 50, CCC stays, DDD has one record.
    const auto days = [](float before, float last) {
      return Bytes(std::vector{Day("20260225", before, before, before, before, 100),
                               Day("20260226", before, before, before, before, 100),
                               Day("20260227", last, last, last, last, 900)});
    };
    home.Put(kData + "AAA.WDT", days(2, 3));
    home.Put(kData + "BBB.WDT", days(4, 2));
    home.Put(kData + "CCC.WDT", days(1, 1));
  }

  ScanFormServices Services() {
    return {.files = session->files,
            .dialogs = dialogs,
            .settings = session->settings,
            .user = session->user,
            .scanning = scanning,
            .disableMenus = [this] { ++disabled; },
            .enableMenus = [this] { ++enabled; },
            .print = [this](const TextTable& table, QWidget*) { printed = table; },
            .pageSetup = {},
            .openResult = [this](std::int16_t place) { opened.push_back("Z" + Str(place)); },
            .openRecord = [this](std::int32_t record) { opened.push_back("N" + Str(record)); }};
  }
  static std::string Str(int n) { return std::to_string(n); }
  template <typename Form, typename... More>
  Form* Show(More&&... more) {
    auto made = std::make_unique<Form>(Services(), std::forward<More>(more)..., nullptr);
    Form* here = made.get();
    form = std::move(made);
    form->show();
    EXPECT_TRUE(QTest::qWaitForWindowExposed(here));
    return here;
  }
  void Tick(const char* name) { Find<QCheckBox>(form.get(), name)->click(); }
  void Type(const char* name, const char* text) {
    auto* field = Find<QLineEdit>(form.get(), name);
    ASSERT_TRUE(field->isEnabled()) << name;
    field->setFocus();
    field->selectAll();
    QTest::keyClicks(field, text);
  }
  Grid* TheGrid(const char* name = "SS1") { return Find<Grid>(form.get(), name); }
  // The cells of a row, with blanks between.
  std::string Row(int row, const char* grid = "SS1") {
    auto* model = TheGrid(grid)->model();
    std::string out;
    for (int i = 0; i < model->columnCount(); ++i)
      out += (i ? " " : "") + model->index(row, i).data().toString().toStdString();
    return out;
  }
  int Rows(const char* grid = "SS1") { return TheGrid(grid)->model()->rowCount(); }
  Texts ResultCodes() {
    return CodesOf(ReadList(session->files, session->settings.paths.CurrentDataPath, kResultList));
  }
  // Rises of 10 and falls of 10.
  void Moves() {
    Tick("Check1");
    Type("Text1", "10");
    Tick("Check15");
    Type("Text6", "10");
  }

  bool scanning = false;
  int disabled = 0, enabled = 0;
  TextTable printed;
  Texts opened;
  std::unique_ptr<QDialog> form;
};

// Presses the form's stop button as soon as the first hit stands in the grid.
void StopAtTheFirstHit(QDialog* form, Grid* grid) {
  const auto stop = [form, model = grid->model()] {
    if (model->rowCount() > 0) form->findChild<QPushButton*>("StopWork")->click();
  };
  QObject::connect(grid->model(), &QAbstractItemModel::modelReset, form, stop);
  QObject::connect(grid->model(), &QAbstractItemModel::rowsInserted, form, stop);
}

}  // namespace

// ---- Chart Scan 1

TEST_F(ScanFormsTest, TickingAValueEnablesItsBox) {
  Show<chtScan1>();
  for (const auto& [check, text] : {std::pair("Check7", "Text3"), std::pair("Check7", "Text2"),
                                    std::pair("Check1", "Text1"), std::pair("Check15", "Text6"),
                                    std::pair("Check8", "Text4"), std::pair("Check14", "Text5")}) {
    auto* box = Find<QCheckBox>(form.get(), check);
    EXPECT_FALSE(Find<QLineEdit>(form.get(), text)->isEnabled()) << text;
    box->setChecked(true);
    EXPECT_TRUE(Find<QLineEdit>(form.get(), text)->isEnabled()) << text;
    box->setChecked(false);
    EXPECT_FALSE(Find<QLineEdit>(form.get(), text)->isEnabled()) << text;
  }
  EXPECT_EQ(Find<QLineEdit>(form.get(), "Text3")->text(), "0.50");
  EXPECT_EQ(Find<QLineEdit>(form.get(), "Text2")->text(), "5.00");
}

TEST_F(ScanFormsTest, TabGoesFromABoxToItsFields) {
  Show<ChtScan2>();
  form->activateWindow();
  auto* check = Find<QCheckBox>(form.get(), "Check2");
  check->setChecked(true);
  check->setFocus();
  for (const char* next : {"Text3", "Text5", "Check3", "Check4"}) {
    QTest::keyClick(form->focusWidget(), Qt::Key_Tab);
    EXPECT_EQ(form->focusWidget()->objectName(), next);
  }
}

TEST_F(ScanFormsTest, AScanByMouseFillsTheGridAndTheList) {
  Show<chtScan1>();
  Moves();
  Click(form.get(), "Command1");
  ASSERT_EQ(Rows(), 2);
  EXPECT_EQ(Row(0), "AAA 3.00 50%U      1");
  EXPECT_EQ(Row(1), "BBB 2.00 -50%D      2");
  EXPECT_EQ(Find<QLabel>(form.get(), "Label8")->text(), "27/2/2026");
  EXPECT_EQ(ResultCodes(), (Texts{"AAA", "BBB"}));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, " Chart Scan");
  EXPECT_TRUE(dialogs.said[0].text.starts_with("The codes have been stored in list"));
  EXPECT_FALSE(dialogs.busy);
  EXPECT_FALSE(scanning);
  EXPECT_EQ(disabled, 1);
  EXPECT_EQ(enabled, 1);
  // The fall is red.
  auto* model = TheGrid()->model();
  EXPECT_FALSE(model->index(0, 2).data(Qt::ForegroundRole).isValid());
  EXPECT_EQ(model->index(1, 2).data(Qt::ForegroundRole).value<QColor>(), QColor(192, 0, 0));
}

TEST_F(ScanFormsTest, AFaultIsToldAndItsFieldHasTheFocus) {
  Show<chtScan1>();
  Tick("Check1");
  form->activateWindow();
  Click(form.get(), "Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Analysis");
  EXPECT_EQ(form->focusWidget(), Find<QLineEdit>(form.get(), "Text1"));
  EXPECT_EQ(disabled, 0);
}

TEST_F(ScanFormsTest, UnreadFilesAreToldInALineOfTheirOwn) {
  home.Put(kData + "CCC.WDT", "torn");
  Show<chtScan1>();
  Moves();
  Click(form.get(), "Command1");
  EXPECT_TRUE(dialogs.said.back().text.ends_with("\n1 file could not be read"));
}

TEST_F(ScanFormsTest, EnterAndADoubleClickOpenTheChart) {
  Show<chtScan1>();
  Moves();
  Click(form.get(), "Command1");
  Grid* grid = TheGrid();
  grid->GoTo(1, 0);
  grid->setFocus();
  QTest::keyClick(grid, Qt::Key_Return);
  const QRect cell = grid->visualRect(grid->model()->index(0, 0));
  QTest::mouseClick(grid->viewport(), Qt::LeftButton, {}, cell.center());
  QTest::mouseDClick(grid->viewport(), Qt::LeftButton, {}, cell.center());
  EXPECT_EQ(opened, (Texts{"Z2", "Z1"}));
}

TEST_F(ScanFormsTest, ARightClickDeletesARowAndTheListFollows) {
  Show<chtScan1>();
  Moves();
  Click(form.get(), "Command1");
  dialogs.said.clear();
  Grid* grid = TheGrid();
  const QPoint place = grid->visualRect(grid->model()->index(0, 0)).center();
  dialogs.answers = {Answer::kCancel};
  QContextMenuEvent ask(QContextMenuEvent::Mouse, grid->viewport()->mapFrom(grid, place),
                        grid->viewport()->mapToGlobal(place));
  QApplication::sendEvent(grid->viewport(), &ask);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Delete Rows");
  EXPECT_EQ(dialogs.said[0].text, "Delete row AAA ?");
  EXPECT_EQ(Rows(), 2);
  QContextMenuEvent again(QContextMenuEvent::Mouse, grid->viewport()->mapFrom(grid, place),
                          grid->viewport()->mapToGlobal(place));
  QApplication::sendEvent(grid->viewport(), &again);
  ASSERT_EQ(Rows(), 1);
  EXPECT_EQ(Row(0).substr(0, 3), "BBB");
  Click(form.get(), "Command2");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(ResultCodes(), Texts{"BBB"});
}

TEST_F(ScanFormsTest, AHeadingSortsByPercentage) {
  Show<chtScan1>();
  Moves();
  Click(form.get(), "Command1");
  Grid* grid = TheGrid();
  auto* header = grid->horizontalHeader();
  const QPoint place(header->sectionViewportPosition(2) + 10, header->height() / 2);
  QTest::mouseClick(header->viewport(), Qt::LeftButton, {}, place);
  EXPECT_EQ(Row(0).substr(0, 3), "BBB");  // "-50%D" before "50%U"
  QTest::mouseClick(header->viewport(), Qt::LeftButton, {}, place);
  EXPECT_EQ(Row(0).substr(0, 3), "AAA");
}

TEST_F(ScanFormsTest, AStopKeepsTheHitsAndAsksBeforeTheListIsReplaced) {
  WriteList(session->files, session->settings.paths.CurrentDataPath, kResultList, {});
  std::vector<NameRec> names(100, Security("AAA"));
  home.Put(kData + "Names.dat", Bytes(names));
  for (const Answer answer : {Answer::kNo, Answer::kYes}) {
    Show<chtScan1>();
    Find<QCheckBox>(form.get(), "Check1")->setChecked(true);
    Find<QLineEdit>(form.get(), "Text1")->setText("10");
    dialogs.said.clear();
    dialogs.answers = {answer};
    StopAtTheFirstHit(form.get(), TheGrid());
    Click(form.get(), "Command1");
    const int hits = Rows();
    ASSERT_EQ(hits, 1);
    ASSERT_EQ(dialogs.said.size(), 1u);
    EXPECT_EQ(dialogs.said[0].text, kStoppedQuestion);
    EXPECT_EQ(ResultCodes().size(), answer == Answer::kYes ? size_t(hits) : 0u);
    // Leaving does not store what was not wanted; a chart opens from the name file then.
    Grid* grid = TheGrid();
    grid->GoTo(0, 0);
    grid->setFocus();
    QTest::keyClick(grid, Qt::Key_Return);
    EXPECT_EQ(opened.back(), answer == Answer::kYes ? "Z1" : "N1");
    form->reject();
    EXPECT_EQ(ResultCodes().size(), answer == Answer::kYes ? size_t(hits) : 0u);
  }
}

TEST_F(ScanFormsTest, ASecondScanIsRefusedWhileOneRuns) {
  Show<chtScan1>();
  Moves();
  scanning = true;
  Click(form.get(), "Command1");
  EXPECT_EQ(Rows(), 0);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "A scan is running. Wait until it is done, or stop it.");
  EXPECT_TRUE(scanning);
}

TEST_F(ScanFormsTest, ANameFileThatCantBeReadIsToldAndTheFormStays) {
  std::filesystem::remove(home.path() + "/" + kData + "Names.dat");
  std::filesystem::create_directory(home.path() + "/" + kData + "Names.dat");
  Show<chtScan1>();
  Moves();
  Click(form.get(), "Command1");
  ASSERT_FALSE(dialogs.said.empty());
  EXPECT_EQ(Rows(), 0);
  EXPECT_FALSE(scanning);
  EXPECT_EQ(enabled, 1);
  EXPECT_TRUE(form->isVisible());
}

TEST_F(ScanFormsTest, ChoicesAndWidthsComeBack) {
  Show<chtScan1>();
  Moves();
  TheGrid()->horizontalHeader()->resizeSection(0, 123);
  form->reject();
  Show<chtScan1>();
  EXPECT_TRUE(Find<QCheckBox>(form.get(), "Check1")->isChecked());
  EXPECT_EQ(Find<QLineEdit>(form.get(), "Text1")->text(), "10");
  EXPECT_EQ(TheGrid()->horizontalHeader()->sectionSize(0), 123);
  EXPECT_EQ(session->user.GetSetting(kUserSection, "Scan1_Other"), "0,0.50,5.00,1,10,1,10,0,,0,");
}

TEST_F(ScanFormsTest, ClassesArePaddedAsTheirBoxIsLeft) {
  Show<chtScan1>();
  form->activateWindow();
  Tick("Check14");
  Type("Text5", "10");
  QTest::keyClick(Find<QLineEdit>(form.get(), "Text5"), Qt::Key_Tab);
  EXPECT_EQ(Find<QLineEdit>(form.get(), "Text5")->text(), "010");
  Type("Text5", "x1");
  QTest::keyClick(Find<QLineEdit>(form.get(), "Text5"), Qt::Key_Tab);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Industry Classification ID must be numeric   eg 010");
  EXPECT_EQ(dialogs.said[0].title, "Chart Scan");
}

TEST_F(ScanFormsTest, PrintsWithoutTheRecordNumbers) {
  Show<chtScan1>();
  EXPECT_FALSE(Find<QPushButton>(form.get(), "Command3")->isEnabled());
  Click(form.get(), "Command1");  // nothing is ticked: no hits
  EXPECT_EQ(dialogs.said.back().text, "There were no Buy/Sell Indications ");
  Click(form.get(), "Command3");
  EXPECT_EQ(dialogs.said.back().text, "No records to print");
  EXPECT_EQ(dialogs.said.back().title, "Analysis Results");
  Moves();
  Click(form.get(), "Command1");
  Click(form.get(), "Command3");
  EXPECT_EQ(printed.layout.heading, "ANALYSIS RESULTS  KORA Charting 7F");
  EXPECT_EQ(printed.layout.pageLabel, "Page ");
  ASSERT_EQ(printed.rows.size(), 2u);
  EXPECT_EQ(printed.layout.columns.size(), 8u);
  EXPECT_EQ(printed.rows[0].size(), 8u);
}

TEST_F(ScanFormsTest, CopyPutsTheRowsOnTheClipboard) {
  Show<chtScan1>();
  Moves();
  Click(form.get(), "Command1");
  TheGrid()->clearSelection();
  Click(form.get(), "GridCopy");
  EXPECT_EQ(QApplication::clipboard()->text(),
            "AAA\t3.00\t50%U\t\t\t\t\t\t1\n"
            "BBB\t2.00\t-50%D\t\t\t\t\t\t2\n");
}

// ---- Chart Scans 2 and 3

TEST_F(ScanFormsTest, Scan2StoresItsHits) {
  Show<ChtScan2>();
  EXPECT_EQ(form->windowTitle(), "Chart Scan 2 (Increases in Volume)");
  Click(form.get(), "Command1");
  EXPECT_EQ(dialogs.said.back().text, "No selection made");
  Tick("Check3");
  Type("Text4", "10");
  Click(form.get(), "Command1");
  ASSERT_EQ(Rows("List1"), 2);
  EXPECT_EQ(Row(0, "List1"), "AAA 3.00 899 50%");
  EXPECT_EQ(ResultCodes(), (Texts{"AAA", "BBB"}));
  EXPECT_EQ(home.Get(kData + "ChtScan2.txt").substr(0, 10), "AAA,,3.00,");
  EXPECT_EQ(dialogs.said.back().title, " Chart Scan 2");
  TheGrid("List1")->GoTo(1, 0);
  TheGrid("List1")->setFocus();
  QTest::keyClick(TheGrid("List1"), Qt::Key_Return);
  EXPECT_EQ(opened, Texts{"Z2"});
  Click(form.get(), "Command3");
  EXPECT_EQ(printed.layout.heading, "CHART SCAN 2 DATA");
  form->reject();
  Show<ChtScan2>();
  EXPECT_TRUE(Find<QCheckBox>(form.get(), "Check3")->isChecked());
  EXPECT_EQ(Find<QLineEdit>(form.get(), "Text4")->text(), "10");
}

TEST_F(ScanFormsTest, Scan2WithoutHitsEmptiesTheList) {
  SaveScan(session->files, session->settings.paths.CurrentDataPath, {{"AAA", 1}});
  Show<ChtScan2>();
  Tick("Check3");
  Type("Text4", "90");
  Click(form.get(), "Command1");
  EXPECT_EQ(dialogs.said.back().text, "No records for the criteria selected were found");
  EXPECT_TRUE(ResultCodes().empty());
}

TEST_F(ScanFormsTest, Scan3FindsABreak) {
  std::vector<PriceRec> days;
  for (const auto& [high, low] :
       {std::pair(10.f, 9.f), std::pair(11.f, 9.5f), std::pair(12.f, 10.5f), std::pair(13.f, 11.f),
        std::pair(12.f, 9.2f), std::pair(9.f, 8.f)})
    days.push_back(Day("20260227", low, high, low, low));
  home.Put(kData + "BBB.WDT", Bytes(days));
  Show<ChtScan3>();
  Click(form.get(), "Command1");
  EXPECT_EQ(dialogs.said.back().title, "Break Parabolic");
  EXPECT_EQ(form->focusWidget(), Find<QCheckBox>(form.get(), "Check3"));
  Tick("Check5");
  Click(form.get(), "Command1");
  ASSERT_EQ(Rows("List1"), 1);
  EXPECT_EQ(Row(0, "List1"), "BBB 8.00 DOWN");
  EXPECT_EQ(ResultCodes(), Texts{"BBB"});
  EXPECT_EQ(dialogs.said.back().title, " Chart Scan 3");
}

// ---- Statistics

TEST_F(ScanFormsTest, StatisticsAreUpdatedFromTheMenuAndStay) {
  Show<Statistics>(session->clock);
  EXPECT_EQ(form->windowTitle(), "Top Movers by Percentage");
  EXPECT_EQ(Rows(), 0);
  Find<QAction>(form.get(), "mnUpStats")->trigger();
  ASSERT_EQ(Rows(), 8);  // two movers, a blank row, five counts
  EXPECT_EQ(Row(0), "AAA   3.00 2.00 50.00 % BBB   2.00 4.00 -50.00 %");
  EXPECT_EQ(Row(3).substr(0, 7), "Rises 1");
  EXPECT_EQ(Find<QLabel>(form.get(), "Label1")->text(), "COMPLETED");
  EXPECT_TRUE(dialogs.said.empty());
  form->reject();
  // Another opening shows the same rows until the next update.
  Show<Statistics>(session->clock);
  ASSERT_EQ(Rows(), 8);
  EXPECT_EQ(Row(0), "AAA   3.00 2.00 50.00 % BBB   2.00 4.00 -50.00 %");
}

TEST_F(ScanFormsTest, StatisticsOpenTheChartOfTheSideUnderTheCell) {
  Show<Statistics>(session->clock);
  Type("Text1", "1");
  Click(form.get(), "Command1");
  Grid* grid = TheGrid();
  grid->setFocus();
  grid->GoTo(0, 1);
  QTest::keyClick(grid, Qt::Key_Return);
  grid->GoTo(0, 7);
  QTest::keyClick(grid, Qt::Key_Return);
  grid->GoTo(2, 0);  // a count
  QTest::keyClick(grid, Qt::Key_Return);
  EXPECT_EQ(opened, (Texts{"N1", "N2"}));
}

TEST_F(ScanFormsTest, StatisticsWithoutANameFile) {
  std::filesystem::remove(home.path() + "/" + kData + "Names.dat");
  Show<Statistics>(session->clock);
  Click(form.get(), "Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "There is no Name File ");
  EXPECT_EQ(dialogs.said[0].title, "Statistics");
  Find<QRadioButton>(form.get(), "Option1(3)")->click();
  EXPECT_TRUE(Find<QRadioButton>(form.get(), "Option1(3)")->isChecked());
}
