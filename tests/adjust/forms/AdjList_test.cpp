#include "adjust/forms/AdjList.h"

#include <QCheckBox>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>

#include "adjust/forms/AdjOpts.h"
#include "store/market_folders.h"
#include "store/price_rec.h"
#include "tests/support/qt/form_fixture.h"
#include "tests/support/recording_printer.h"

namespace kora {
namespace {

const std::string kList = "drive_c/korawin/data/Adjust.Lst";
const std::string kBonus = "BI,AAA,a,,Y,20FEB26,1,4\r\n";

class AdjListTest : public test::FormTest {
 protected:
  void SetUp() override {
    ReadSettings();
    session->settings.download.DataService = 1;
  }
  bool Open(const std::string& list) {
    if (!list.empty()) home.Put(kList, list);
    form.reset();
    form = std::make_unique<AdjList>(AdjListServices{.files = session->files,
                                                     .settings = session->settings,
                                                     .ini = session->ini,
                                                     .user = session->user,
                                                     .dialogs = dialogs,
                                                     .print = print,
                                                     .changeSize = [](QWidget*) { return 150; },
                                                     .adjusted = [this] { ++adjusted; }},
                                     nullptr);
    if (!form->Fill()) return false;
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
    return true;
  }
  Grid* Rows() { return Find<Grid>(form.get(), "SS1"); }
  std::string Cell(int row, int column) {
    return Rows()->model()->index(row, column).data().toString().toStdString();
  }
  void Trigger(const char* name) { Find<QAction>(form.get(), name)->trigger(); }
  void TypeInto(int row, int column, const std::string& text) {
    Rows()->setFocus();
    Rows()->GoTo(row, column);
    for (const char c : text) QTest::keyClick(QApplication::focusWidget(), c);
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  }
  // 13 in record 19 of AAA, 11 in that of BBB, before 20 February.
  float CloseOf(const std::string& code, int record) {
    return PriceFile(session->files, "c:\\korawin\\data\\" + code + ".WDT").Read(record).Close;
  }
  std::string Said() { return dialogs.said.empty() ? std::string() : dialogs.said.back().text; }

  std::unique_ptr<AdjList> form;
  std::function<void(const TextTable&, QWidget*)> print;
  int adjusted = 0;
};

TEST_F(AdjListTest, ShowsTheListUnderItsHeadings) {
  ASSERT_TRUE(Open(kBonus + "NL,BBB,a,,Y,B\xE4r\r\n"));
  EXPECT_EQ(form->windowTitle(), "KORA Data Mainenance");
  EXPECT_EQ(Find<QLabel>(form.get(), "Label1")->text(),
            "Click MAKE ADJUSTMENTS (above) to process maintenance data");
  EXPECT_EQ(Rows()->Headings(),
            (std::vector<std::string>{"Act", "Code", "File", "", "ADJ", "Name", "", "", "", ""}));
  EXPECT_EQ(Cell(0, 0), "BI");
  EXPECT_EQ(Cell(0, 7), "4");
  EXPECT_EQ(Cell(1, 5), "B\xC3\xA4r");
  EXPECT_EQ(Find<QAction>(form.get(), "muAdj")->text(), "&MAKE ADJUSTMENTS");
}

TEST_F(AdjListTest, AnEmptyListSaysSoAndTakesNothing) {
  ASSERT_TRUE(Open(""));
  EXPECT_EQ(Rows()->model()->rowCount(), 1);
  EXPECT_EQ(Cell(0, 0), "There is no bulletin data");
  EXPECT_EQ(Rows()->columnSpan(0, 0), 10);  // with room to be read
  TypeInto(0, 0, "BI");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Escape);
  EXPECT_EQ(Cell(0, 0), "There is no bulletin data");
  Rows()->SelectRows({0, 0});
  Trigger("alDelRow");
  Trigger("alSetY");
  Trigger("muAdj");
  EXPECT_TRUE(dialogs.said.empty());
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_FALSE(home.Exists(kList));
}

TEST_F(AdjListTest, CarriesTheListOut) {
  ASSERT_TRUE(Open(kBonus + "BI,BBB,a,,N,20FEB26,1,4\r\nNI,CCC,a,,Y,Cement,012\r\n"));
  Trigger("muAdj");
  EXPECT_EQ(CloseOf("AAA", 19), 10.4f);
  EXPECT_EQ(home.Get(kList), "BI,BBB,a,,N,20FEB26,1,4\r\nNI,CCC,a,,Y,Cement,012\r\n");
  EXPECT_EQ(Rows()->model()->rowCount(), 2);
  EXPECT_EQ(Cell(0, 1), "BBB");
  EXPECT_EQ(adjusted, 1);
  QTest::keyClick(form.get(), Qt::Key_Escape);  // no question is left
  EXPECT_FALSE(form->isVisible());
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(AdjListTest, EditedCellsCount) {
  ASSERT_TRUE(Open(kBonus));
  TypeInto(0, 4, "n");
  EXPECT_EQ(Cell(0, 4), "n");
  Trigger("muAdj");
  EXPECT_EQ(home.Get(kList), "BI,AAA,a,,n,20FEB26,1,4\r\n");
}

TEST_F(AdjListTest, ACommaCanNotBeTypedAndStrangeLettersAreRefused) {
  ASSERT_TRUE(Open(kBonus));
  Rows()->GoTo(0, 5);
  QTest::keyClick(Rows(), 'a');
  QTest::keyClick(QApplication::focusWidget(), ',');
  QTest::keyClick(QApplication::focusWidget(), 'b');
  EXPECT_TRUE(Rows()->EndEdit());
  EXPECT_EQ(Cell(0, 5), "ab");
  QTest::keyClick(Rows(), Qt::Key_F2);
  auto* editor = qobject_cast<QLineEdit*>(QApplication::focusWidget());
  ASSERT_NE(editor, nullptr);
  editor->setText(QString::fromUtf8("\xD0\xAF"));
  EXPECT_FALSE(Rows()->EndEdit());
  EXPECT_NE(Said().find("can't keep"), std::string::npos);
}

TEST_F(AdjListTest, SortsAndMarks) {
  ASSERT_TRUE(Open("DI,BBB,OPT\r\nBI,BBB,WNT\r\nBI,AAA,a\r\n"));
  Trigger("alSort");
  EXPECT_EQ(Cell(0, 1), "AAA");
  EXPECT_EQ(Cell(1, 0), "BI");
  Trigger("rmOPTS");
  EXPECT_EQ(Cell(2, 4), "D");
  EXPECT_EQ(Cell(1, 4), "");
  EXPECT_TRUE(Rows()->model()->index(2, 0).data(Qt::BackgroundRole).isValid());
  Trigger("rmWNT");
  EXPECT_EQ(Cell(1, 4), "D");
  Trigger("alSetY");
  EXPECT_EQ(Cell(0, 4), "Y");
  Trigger("alSetD");
  Trigger("alSetN");
  EXPECT_EQ(Cell(2, 4), "N");
  Trigger("alSave");
  EXPECT_EQ(home.Get(kList), "BI,AAA,a,,N\r\nBI,BBB,WNT,,N\r\nDI,BBB,OPT,,N\r\n");
}

TEST_F(AdjListTest, RemovesRowsMarkedD) {
  ASSERT_TRUE(Open("BI,AAA,a,,D\r\nBI,BBB,a,,Y\r\n"));
  Trigger("muRemAdj");
  EXPECT_EQ(home.Get(kList), "BI,BBB,a,,Y\r\n");
  EXPECT_EQ(Cell(0, 1), "BBB");
}

TEST_F(AdjListTest, DeletesRowsAfterAsking) {
  ASSERT_TRUE(Open("BI,AAA\r\nBI,BBB\r\nBI,CCC\r\n"));
  Rows()->SelectRows({0, 1});
  Trigger("alDelRow");
  EXPECT_EQ(Said(), "Delete items 1 to 2 ?");
  EXPECT_EQ(dialogs.said.back().title, "Delete Rows");
  Rows()->setFocus();
  Rows()->SelectRows({0, 0});
  QTest::keyClick(Rows(), Qt::Key_Delete);
  EXPECT_EQ(Said(), "Delete row 1 ?");
  EXPECT_EQ(Cell(0, 0), "There is no bulletin data");
  Trigger("alSave");
  EXPECT_EQ(home.Get(kList), "");
}

TEST_F(AdjListTest, ClosingAsksToSaveAndToProcess) {
  ASSERT_TRUE(Open(kBonus));
  Trigger("alSetN");
  dialogs.answers = {Answer::kCancel};
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(Said(), "File has changed. SAVE Changes?");
  EXPECT_EQ(dialogs.said.back().title, "Adjustments List");
  dialogs.answers = {Answer::kYes, Answer::kNo};
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_EQ(Said(), "You have not processed the adjustments.Do you want to process these now ?");
  EXPECT_EQ(dialogs.said.back().title, "Process Adjustments");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(home.Get(kList), "BI,AAA,a,,N,20FEB26,1,4\r\n");
}

TEST_F(AdjListTest, YesToProcessRunsIt) {
  ASSERT_TRUE(Open(kBonus));
  dialogs.answers = {Answer::kYes};
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_EQ(CloseOf("AAA", 19), 10.4f);
  EXPECT_EQ(home.Get(kList), "");
}

TEST_F(AdjListTest, AListThatAnotherProgramChangedIsReplacedOnlyWhenTheUserSaysSo) {
  ASSERT_TRUE(Open(kBonus));
  home.Put(kList, kBonus + "DC,BBB,a,,Y\r\n");
  dialogs.answers = {Answer::kNo, Answer::kYes};
  Trigger("alSave");
  EXPECT_EQ(home.Get(kList), kBonus + "DC,BBB,a,,Y\r\n");
  Trigger("alSave");
  EXPECT_EQ(home.Get(kList), kBonus);
}

TEST_F(AdjListTest, TellsWhatCouldNotBeCarriedOut) {
  ASSERT_TRUE(Open(kBonus + "BI,BBB,a,,Y,20FEB26,1,4\r\n"));
  session->files.Remove("c:\\korawin\\data\\AAA.WDT");
  session->files.MakeFolder("c:\\korawin\\data\\AAA.WDT");
  Trigger("muAdj");
  EXPECT_NE(Said().find("AAA: "), std::string::npos);
  EXPECT_EQ(CloseOf("BBB", 19), 8.8f);
  EXPECT_EQ(home.Get(kList), kBonus);
}

TEST_F(AdjListTest, StaysAwayWhileFoldersOfTheWholeMarketAreMissing) {
  session->settings.download.DataService = 3;
  EXPECT_FALSE(Open(kBonus));
  EXPECT_EQ(dialogs.said.back().title, "W/M Paths");
}

TEST_F(AdjListTest, OtherServicesCloseWithoutAQuestionAndCarryNothingOut) {
  session->settings.download.DataService = 4;
  ASSERT_TRUE(Open(kBonus));
  Trigger("muAdj");
  EXPECT_EQ(CloseOf("AAA", 19), 13);
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(AdjListTest, PrintsTheList) {
  test::RecordingPrinter printer;
  print = [&](const TextTable& table, QWidget*) {
    PrintTable(printer, session->settings.fonts, session->settings.page, table);
  };
  ASSERT_TRUE(Open(kBonus));
  Trigger("alPrint");
  ASSERT_EQ(printer.sent.size(), 1u);
  std::string texts;
  for (const std::string& op : printer.sent[0]) texts += op + "\n";
  for (const char* text : {" ADJUSTMENTS LIST ", " ADJ ", " AAA ", " 20FEB26 "})
    EXPECT_NE(texts.find(text), std::string::npos) << text;
  session->files.Remove("c:\\korawin\\data\\Adjust.Lst");
  ASSERT_TRUE(Open(""));
  Trigger("alPrint");
  EXPECT_EQ(Said(), "No records to print");
}

TEST_F(AdjListTest, FurtherColumnsShowWhereALineHasThem) {
  ASSERT_TRUE(Open("BI,AAA,3,4,5,6,7,8,9,10,11,12\r\n"));
  EXPECT_EQ(Rows()->Headings().size(), 12u);
  EXPECT_EQ(Cell(0, 11), "12");
}

TEST_F(AdjListTest, DisplayAsksForTheSizeOfTables) {
  ASSERT_TRUE(Open(kBonus));
  const double points = Rows()->font().pointSizeF();
  Trigger("alDisplay");
  EXPECT_DOUBLE_EQ(Rows()->font().pointSizeF(), points * 1.5);
}

TEST_F(AdjListTest, TheOptionsAreKept) {
  ASSERT_TRUE(Open(kBonus));
  session->settings.AdjDivs = 7;  // shows as 3
  Trigger("alopt");
  auto* options = form->findChild<AdjOpts*>();
  ASSERT_NE(options, nullptr);
  EXPECT_TRUE(Find<QRadioButton>(options, "Option1(2)")->isChecked());
  Find<QRadioButton>(options, "Option1(1)")->setChecked(true);
  Find<QCheckBox>(options, "Check1")->setChecked(true);
  Click(options, "Command1");
  EXPECT_EQ(session->ini.GetSetting("Adjustments", "Divs"), "2");
  EXPECT_EQ(session->ini.GetSetting("Adjustments", "NoShortNames"), "True");
  EXPECT_EQ(session->settings.AdjDivs, 2);
  EXPECT_TRUE(session->settings.NoShortNames);
}

}  // namespace
}  // namespace kora
