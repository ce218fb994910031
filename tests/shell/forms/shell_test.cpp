#include <QAbstractButton>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPointer>
#include <QPushButton>
#include <QRadioButton>
#include <QTemporaryDir>
#include <QTextBrowser>
#include <QTimer>

#include "base/numbers.h"
#include "chartwindow/forms/Chart2.h"
#include "platform/qt/single_instance.h"
#include "shell/forms/AbtKora.h"
#include "shell/forms/HelpWindow.h"
#include "shell/forms/Logo.h"
#include "shell/forms/Main.h"
#include "shell/main_menu.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

// A day of which AAA alone traded, at 20.
constexpr const char* kDay = "AAA,20261102,20,21,19,20,500,0\r\n";

class MainTest : public test::FormTest {
 protected:
  // A main window that was closed has told the application to end, which lets no dialog run
  // until the application itself has run again.
  MainTest() {
    QTimer::singleShot(0, qApp, [] { QCoreApplication::exit(0); });
    QApplication::exec();
  }
  Main& Open() {
    ReadSettings();
    form = std::make_unique<Main>(*session, "");
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
    return *form;
  }
  QAction* Entry(const char* name) { return Find<QAction>(form.get(), name); }
  QAction* Menu(const char* name) { return Find<QMenu>(form.get(), name)->menuAction(); }

  std::unique_ptr<Main> form;
};

TEST_F(MainTest, EveryEntryIsThereUnderItsNameWithItsCaption) {
  Open();
  for (const MenuEntry& entry : MainMenu()) {
    const std::string name(entry.name);
    auto* menu = form->findChild<QMenu*>(name.c_str());
    QAction* action = menu ? menu->menuAction() : Entry(name.c_str());
    ASSERT_NE(action, nullptr) << name;
    EXPECT_EQ(action->text().toStdString(), entry.caption);
  }
}

TEST_F(MainTest, AnEntryWhoseFormIsNotThereIsGreyed) {
  Open();
  for (const char* there :
       {"mnuChartDisplay", "mnuChartDefaults", "mnuPaths", "mnFnts", "mnuExit", "mnuLists",
        "mnuChartScan", "mnuChartScan2", "mnuChtScan3", "mnStats", "mnuListsUte", "mnuRenameCL",
        "mnuManAdjust", "mnuDDetails", "mnuModem", "mnSHlp", "mnuAboutKora"})
    EXPECT_TRUE(Entry(there)->isEnabled()) << there;
  for (const char* there :
       {"mnuKBUpdate", "mnuCodeChanged", "mnuDataCk", "mnuChkNameData", "mnuADCheck",
        "mnuBackupData", "mnuRestoreData", "mnuTextFile", "mnuTFD", "mnuCDupDts"})
    EXPECT_TRUE(Entry(there)->isEnabled()) << there;
  EXPECT_FALSE(Entry("mnuMveData")->isEnabled()) << "one folder";
  session->settings.download.DataService = 3;
  form->EnableMenus();
  EXPECT_TRUE(Entry("mnuMveData")->isEnabled());
  form->SetOpener("mnuTextFile", {});
  EXPECT_FALSE(Entry("mnuTextFile")->isEnabled());
  form->SetOpener("mnuTextFile", [] {});
  EXPECT_TRUE(Entry("mnuTextFile")->isEnabled());
}

TEST_F(MainTest, TheDownloadMenuFollowsTheService) {
  session->ini.PutSetting("Download", "DataService", "2");
  Open();
  EXPECT_TRUE(Entry("mnuBourse")->isVisible());
  EXPECT_TRUE(Entry("mnuBourse")->isEnabled());
  EXPECT_FALSE(Entry("mnuTARVO")->isVisible());
  session->settings.download.DataService = 1;
  form->EnableMenus();
  EXPECT_FALSE(Entry("mnuBourse")->isVisible());
  EXPECT_TRUE(Entry("mnuTARVO")->isEnabled());
}

TEST_F(MainTest, ALongTaskDisablesTheMenusTogether) {
  Open();
  form->DisableMenus();
  for (const char* menu : {"mnuFile", "mnuData", "mnuAComms", "mnTools", "mnuAnalysis"})
    EXPECT_FALSE(Menu(menu)->isEnabled()) << menu;
  EXPECT_TRUE(Menu("mnuHelp")->isEnabled());
  form->EnableMenus();
  for (const char* menu : {"mnuFile", "mnuData", "mnuAComms", "mnTools", "mnuAnalysis"})
    EXPECT_TRUE(Menu(menu)->isEnabled()) << menu;
}

TEST_F(MainTest, TheTitleTellsTheDataFolderAndFollowsIt) {
  Open();
  EXPECT_EQ(form->windowTitle(), "KORA Charting 7F   -   Current Data Folder c:\\korawin\\data\\");
  Entry("mnuPaths")->trigger();
  auto* paths = form->findChild<CPath*>();
  ASSERT_NE(paths, nullptr);
  Find<QLineEdit>(paths, "Text2")->setText("c:\\elsewhere\\");
  Click(paths, "Command1");
  EXPECT_EQ(form->windowTitle(), "KORA Charting 7F   -   Current Data Folder c:\\elsewhere\\");
}

TEST_F(MainTest, TheSizeIsKeptFromRunToRun) {
  session->SaveUserSetting("Height", "6000");
  session->SaveUserSetting("Width", "7500");
  Open();
  EXPECT_EQ(form->size(), QSize(500, 400));
  form->resize(450, 300);
  form->close();
  EXPECT_EQ(session->UserSetting("Height"), "4500");
  EXPECT_EQ(session->UserSetting("Width"), "6750");
}

TEST_F(MainTest, ATooSmallHeightGivesTheStandingOne) {
  session->SaveUserSetting("Height", "2999");
  session->SaveUserSetting("Width", "7500");
  Open();
  EXPECT_EQ(form->size(), QSize(500, 443)) << "6645 twips";
}

TEST_F(MainTest, AboutShowsItsLinesAndEnterClosesIt) {
  Open();
  Entry("mnuAboutKora")->trigger();
  auto* about = form->findChild<AbtKora*>();
  ASSERT_NE(about, nullptr);
  EXPECT_EQ(about->windowTitle(), "About KORA");
  EXPECT_EQ(Find<QLabel>(about, "Label1(0)")->text(),
            "* * Version 7F * *     for Windows 95/98 or later ");
  EXPECT_EQ(Find<QLabel>(about, "Label1(1)")->text(),
            "KORA software is designed to be used as a tool only.");
  QTest::keyClick(about, Qt::Key_Return);
  EXPECT_FALSE(about->isVisible());
}

TEST_F(MainTest, TheMenusOpenByTheirKeys) {
  Open();
  QTest::keyClick(form.get(), Qt::Key_F, Qt::AltModifier);
  auto* file = Find<QMenu>(form.get(), "mnuFile");
  ASSERT_TRUE(WaitFor([&] { return file->isVisible(); }));
  QTest::keyClick(file, Qt::Key_C);
  EXPECT_NE(form->charts(), nullptr);
}

TEST_F(MainTest, ASiblingThatIsNotThereIsTold) {
  session->ini.PutSetting("Download", "DataService", "1");
  Open();
  Entry("mnuMMAScan")->trigger();
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_NE(dialogs.said[0].text.find("c:\\korawin\\Mmascan.EXE"), std::string::npos);
  EXPECT_TRUE(Menu("mnuFile")->isEnabled());
}

// ---- Taking data in

// A sibling that runs for some turns, and what was done meanwhile.
class ScriptedProcesses : public Processes {
 public:
  int RunAndWait(const std::string& program, const std::vector<std::string>&,
                 const std::function<void()>& idle) override {
    ran.push_back(program);
    for (int i = 0; i < 3; ++i) {
      if (meanwhile) meanwhile();
      idle();
    }
    ++ended;
    return 0;
  }
  std::vector<std::string> ran;
  std::function<void()> meanwhile;
  int ended = 0;
};

class DownloadTest : public MainTest {
 protected:
  DownloadTest() {
    session =
        std::make_unique<Session>(home.path(), dialogs, MachineIo(), MachineClock(), processes);
  }
  QDialog* List() { return form->findChild<QDialog*>("DLList"); }
  bool Left() {
    return WaitFor([&] { return List() == nullptr; });
  }
  void PutSibling(const char* name) { home.Put(std::string("drive_c/korawin/") + name, "program"); }
  ScriptedProcesses processes;
};

TEST_F(DownloadTest, TheEntryTakesADayInAndTheMenusComeBack) {
  home.Put("drive_c/korawin/download/02NOV26.d", kDay);
  Open();
  Entry("mnuModem")->trigger();
  ASSERT_NE(List(), nullptr);
  EXPECT_TRUE(List()->isVisible());
  EXPECT_FALSE(Menu("mnuFile")->isEnabled());
  Click(List(), "Command1");
  ASSERT_TRUE(Left()) << "the list is empty, so that the form closes itself";
  EXPECT_TRUE(Menu("mnuFile")->isEnabled());
  EXPECT_TRUE(home.Exists("drive_c/korawin/download/02NOV26.dX"));
  EXPECT_EQ(home.Get("drive_c/korawin/data/AAA.WDT").size(), 29u * 50) << "28 days and this one";
  EXPECT_EQ(home.Get("drive_c/korawin/data/BBB.WDT").size(), 29u * 50) << "did not trade";
}

TEST_F(DownloadTest, NothingWaitsIsToldAndNoFormStays) {
  home.Put("drive_c/korawin/download/readme.txt", "");
  Open();
  Entry("mnuModem")->trigger();
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, " There are no downloaded files to update. ");
  EXPECT_EQ(List(), nullptr);
  EXPECT_TRUE(Menu("mnuAComms")->isEnabled());
}

TEST_F(DownloadTest, WithoutAServiceItsDetailsComeFirst) {
  session->ini.PutSetting("Download", "DLPath", "");
  home.Put("drive_c/NetData/02NOV26.d", kDay);
  Open();
  Entry("mnuModem")->trigger();
  EXPECT_EQ(List(), nullptr);
  auto* details = Find<QDialog>(form.get(), "ModDetails");
  ASSERT_NE(details, nullptr);
  Find<QLineEdit>(details, "Text1")->setText("c:\\NetData\\");
  Click(details, "Command3");
  EXPECT_NE(List(), nullptr);
}

TEST_F(DownloadTest, SavedDetailsShapeTheMenu) {
  Open();
  EXPECT_FALSE(Entry("mnuBourse")->isVisible());
  Entry("mnuDDetails")->trigger();
  auto* details = Find<QDialog>(form.get(), "ModDetails");
  ASSERT_NE(details, nullptr);
  Find<QComboBox>(details, "Combo1")->setCurrentIndex(2);
  Click(details, "Command3");
  EXPECT_TRUE(Entry("mnuBourse")->isVisible());
  EXPECT_EQ(List(), nullptr) << "saving opens no list";
}

TEST_F(DownloadTest, TheUpdateListAsksHowToPrint) {
  home.Put("drive_c/korawin/Update.Lst", "ORE,3,Mine\r\n");
  Open();
  Entry("mnuDDetails")->trigger();
  Click(Find<QDialog>(form.get(), "ModDetails"), "Command1");
  auto* list = Find<QDialog>(form.get(), "INUpList");
  ASSERT_NE(list, nullptr);
  Find<QAction>(list, "UlPrint")->trigger();
  auto* question = Find<QDialog>(list, "PrintKora");
  ASSERT_NE(question, nullptr);
  question->reject();
}

TEST_F(DownloadTest, ADownloadProgramIsWaitedForThenTheListOpens) {
  struct {
    int service;
    const char *entry, *program;
  } const cases[] = {{1, "mnuTARVO", "Dlmain32.EXE"},
                     {2, "mnuBourse", "Dlbourse32.exe"},
                     {5, "mnuEIS", "Dleis32.EXE"}};
  for (const auto& c : cases) {
    session->ini.PutSetting("Download", "DataService", Str(c.service));
    PutSibling(c.program);
    Open();
    bool off = true;
    processes.meanwhile = [&] {
      off = off && !Menu("mnuFile")->isEnabled();
      home.Put("drive_c/korawin/download/02NOV26.d", kDay);  // what it leaves
    };
    Entry(c.entry)->trigger();
    EXPECT_TRUE(off) << "the menus are off meanwhile";
    ASSERT_NE(List(), nullptr) << c.entry;
    EXPECT_EQ(Find<QListWidget>(List(), "List1")->count(), 1);
    List()->reject();
    EXPECT_TRUE(Menu("mnuFile")->isEnabled());
    form.reset();
    session->files.Remove("c:\\korawin\\download\\02NOV26.d");
  }
  ASSERT_EQ(processes.ran.size(), 3u);
  EXPECT_TRUE(processes.ran[0].ends_with("/drive_c/korawin/Dlmain32.EXE"));
}

TEST_F(DownloadTest, ClosingWhileAProgramRunsEndsTheWaitingAndOpensNothing) {
  session->ini.PutSetting("Download", "DataService", "1");
  PutSibling("Dlmain32.EXE");
  Open();
  processes.meanwhile = [this] { form->close(); };
  Entry("mnuTARVO")->trigger();
  EXPECT_EQ(processes.ran.size(), 1u);
  EXPECT_EQ(processes.ended, 0);
  EXPECT_EQ(List(), nullptr);
}

TEST_F(DownloadTest, TheWholeMarketLeavesTheChosenFolderInTheTitle) {
  session->ini.PutSetting("Download", "DataService", "3");
  home.Put("drive_c/korawin/WMPaths.lst",
           "c:\\a\\\r\nc:\\i\\\r\nc:\\f\\\r\nc:\\v\\\r\nc:\\o\\\r\n1\r\nc:\\s\\\r\n");
  for (const char* folder : {"a", "i", "f", "v", "o", "s"})
    home.Put(std::string("drive_c/") + folder + "/Names.dat", "");
  home.Put("drive_c/korawin/download/02NOV26.d", "");
  home.Put("drive_c/korawin/download/02NOV26.dsu", kDay);
  Open();
  Entry("mnuModem")->trigger();
  ASSERT_NE(List(), nullptr);
  Click(List(), "Command1");
  ASSERT_TRUE(Left());
  EXPECT_EQ(form->windowTitle(), "KORA Charting 7F   -   Current Data Folder c:\\i\\");
  EXPECT_EQ(home.Get("drive_c/a/AAA.WDT").size(), 50u);
}

TEST_F(DownloadTest, BulletinsOpenTheAdjustmentListBehindTheUpdate) {
  session->ini.PutSetting("Download", "DataService", "3");
  session->ini.PutSetting("Download", "In", "c:\\in\\");
  session->ini.PutSetting("Download", "Out", "c:\\out\\");
  home.Put("drive_c/korawin/WMPaths.lst",
           "c:\\a\\\r\nc:\\i\\\r\nc:\\f\\\r\nc:\\v\\\r\nc:\\o\\\r\n1\r\nc:\\s\\\r\n");
  for (const char* folder : {"a", "i", "f", "v", "o", "s", "in", "out"})
    home.Put(std::string("drive_c/") + folder + "/Names.dat", "");
  home.Put("drive_c/in/02NOV26.Asx.Btn", "DC,AAA,ASX.STK,,N,\r\n");
  home.Put("drive_c/korawin/download/02NOV26.d", "");
  home.Put("drive_c/korawin/download/02NOV26.dsu", kDay);
  Open();
  Entry("mnuModem")->trigger();
  ASSERT_NE(List(), nullptr);
  Click(List(), "Command1");
  ASSERT_TRUE(Left());
  ASSERT_FALSE(dialogs.said.empty());
  EXPECT_EQ(dialogs.said.back().text,
            "There have been maintenance items added to the Adjustment List");
  EXPECT_EQ(dialogs.said.back().title, "Adjustment List");
  auto* list = Find<QDialog>(form.get(), "AdjList");
  ASSERT_NE(list, nullptr);
  EXPECT_TRUE(list->isVisible());
  EXPECT_EQ(home.Get("drive_c/a/Adjust.Lst"), "DC,AAA,02NOV26,,Y,\r\n");
  Find<QAction>(list, "muAdj")->trigger();
  EXPECT_EQ(home.Get("drive_c/a/Adjust.Lst"), "");
  EXPECT_TRUE(home.Exists("drive_c/a/AAA.OLD"));
  EXPECT_EQ(home.Get("drive_c/a/Names.dat"), "");
  list->reject();
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(DownloadTest, TheEntryOpensTheAdjustmentList) {
  Open();
  ASSERT_TRUE(Entry("mnuAdjExBtn")->isEnabled());
  Entry("mnuAdjExBtn")->trigger();
  EXPECT_NE(Find<QDialog>(form.get(), "AdjList"), nullptr);
}

TEST_F(DownloadTest, DestinationsOpenOverTheFoldersAndTheirFieldFollows) {
  session->ini.PutSetting("Download", "DataService", "3");
  home.Put("drive_c/korawin/WMPaths.lst",
           "c:\\a\\\r\nc:\\i\\\r\nc:\\f\\\r\nc:\\v\\\r\nc:\\o\\\r\n0\r\nc:\\s\\\r\n");
  Open();
  Entry("mnuPaths")->trigger();
  auto* paths = form->findChild<CPath*>();
  ASSERT_NE(paths, nullptr);
  QTimer::singleShot(0, [&] {
    auto* destinations = Find<QDialog>(paths, "WMPath");
    ASSERT_NE(destinations, nullptr);
    Find<QRadioButton>(destinations, "Option1(2)")->click();
    Click(destinations, "Command2");
  });
  ASSERT_TRUE(Find<QPushButton>(paths, "Command3")->isEnabled());
  Click(paths, "Command3");
  EXPECT_EQ(Find<QLineEdit>(paths, "Text2")->text(), "c:\\f\\");
  EXPECT_EQ(form->windowTitle(), "KORA Charting 7F   -   Current Data Folder c:\\f\\");
  EXPECT_EQ(session->ini.GetSetting("KoraPaths", "ChtData"), "c:\\f\\");
}

class ChtsTest : public MainTest {
 protected:
  Chts& OpenCharts() {
    Open();
    Choose();
    EXPECT_NE(form->charts(), nullptr);
    return *form->charts();
  }
  // The entry opens the window with chart selection over it; SHOW CHART shows the first.
  void Choose() {
    Entry("mnuChartDisplay")->trigger();
    auto* selection = Find<QDialog>(form.get(), "ChtSel");
    ASSERT_NE(selection, nullptr);
    QTest::mouseClick(Find<QPushButton>(selection, "OK"), Qt::LeftButton);
    ASSERT_TRUE(WaitFor([&] { return form->findChild<QDialog*>("ChtSel") == nullptr; }));
  }
  PictureBox* Picture() { return dynamic_cast<PictureBox*>(Find<QWidget>(form.get(), "Picture1")); }
  // Pixels that are not the background.
  int Ink() {
    const QImage& image = Picture()->surface().image();
    const QRgb ground = QtSurface::Rgb(session->colours[kBackground]);
    int ink = 0;
    for (int y = 0; y < image.height(); ++y)
      for (int x = 0; x < image.width(); ++x) ink += (image.pixel(x, y) | 0xFF000000) != ground;
    return ink;
  }
  std::string shown() { return session->current.PriceFileName; }
};

TEST_F(ChtsTest, OpensOnTheFirstSecurityInTheFrame) {
  Chts& charts = OpenCharts();
  EXPECT_EQ(shown(), "AAA.WDT");
  EXPECT_EQ(charts.windowTitle(),
            "KORA Charting 7F   -  CHARTS  c:\\korawin\\data\\  -  AAA  Bar  Daily");
  auto* mdi = Find<QMdiArea>(form.get(), "MDI");
  ASSERT_EQ(mdi->subWindowList().size(), 1);
  EXPECT_EQ(mdi->subWindowList()[0]->size(), mdi->viewport()->size());
  EXPECT_EQ(Picture()->surface().Width(), Picture()->width());
  EXPECT_GT(Ink(), 1000);
  EXPECT_TRUE(charts.window().Chart.ChartDrawn);
  EXPECT_TRUE(dialogs.said.empty());
}

// The window takes its forms with it; who ran them must not take them down once more, nor go on
// with a window that is gone.
TEST_F(ChtsTest, AFormMayGoWithItsWindowWhileItRuns) {
  for (const char* entry : {"cmfonts", "cmColours", "cmChtDef", "cmBSpaces"}) {
    Chts& charts = OpenCharts();
    bool ran = false;
    QTimer::singleShot(0, &charts, [&] {
      ran = QApplication::activeModalWidget() != nullptr;
      delete charts.parentWidget();
    });
    Entry(entry)->trigger();
    EXPECT_TRUE(ran) << entry;
    EXPECT_EQ(form->charts(), nullptr) << entry;
    EXPECT_EQ(QApplication::activeModalWidget(), nullptr) << entry;
    form.reset();
  }
}

TEST_F(ChtsTest, AChartThatRunsOutOfMemoryIsToldAndTheWindowGoesOn) {
  Chts& charts = OpenCharts();
  charts.SetForm("OscFrm", [] { throw std::bad_alloc(); });
  session->settings.osc.ShowOsc = true;
  Entry("cmRelStrength")->trigger();
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Out of memory");
  EXPECT_EQ(dialogs.said[0].title, "Charts");
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "BBB.WDT");
}

TEST_F(ChtsTest, ThePageKeysWithControlStepThroughTheNameFile) {
  Chts& charts = OpenCharts();
  EXPECT_TRUE(charts.isAncestorOf(QApplication::focusWidget()));
  const QImage first = Picture()->surface().image().copy();
  for (const char* expected : {"BBB.WDT", "CCC.WDT", "AAA.WDT"}) {
    QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
    EXPECT_EQ(shown(), expected);
  }
  EXPECT_EQ(Picture()->surface().image(), first);
  QTest::keyClick(Picture(), Qt::Key_PageUp, Qt::ControlModifier);
  EXPECT_EQ(shown(), "CCC.WDT");
  EXPECT_NE(Picture()->surface().image(), first);
}

TEST_F(ChtsTest, ANewSizeRecomposesTheSameChart) {
  Chts& charts = OpenCharts();
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  const auto before = charts.window().Chart.ChartRight;
  form->resize(form->width() - 150, form->height() - 90);
  ASSERT_TRUE(WaitFor([&] { return charts.window().Chart.ChartRight < before && Ink() > 1000; }));
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(charts.window().state().ChartIndex, 2);
  EXPECT_EQ(Picture()->surface().Width(), Picture()->width());
}

TEST_F(ChtsTest, TheEntryBringsTheStandingWindowBack) {
  Chts* charts = &OpenCharts();
  Entry("mnuChartDisplay")->trigger();
  EXPECT_EQ(form->charts(), charts);
  EXPECT_EQ(Find<QMdiArea>(form.get(), "MDI")->subWindowList().size(), 1);
}

TEST_F(ChtsTest, TheEntryRestoresAWindowThatIsMinimised) {
  Chts& charts = OpenCharts();
  charts.parentWidget()->showMinimized();
  Entry("mnuChartDisplay")->trigger();
  EXPECT_FALSE(charts.parentWidget()->isMinimized());
  EXPECT_TRUE(charts.isAncestorOf(QApplication::focusWidget()));
  EXPECT_GT(Ink(), 1000);
}

TEST_F(ChtsTest, EscapeInChartSelectionGoesBackToTheChart) {
  Chts& charts = OpenCharts();
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  const QImage before = Picture()->surface().image().copy();
  Entry("new")->trigger();
  auto* selection = Find<QDialog>(form.get(), "ChtSel");
  QTest::keyClick(selection, Qt::Key_PageDown);
  EXPECT_EQ(shown(), "CCC.WDT");
  QTest::keyClick(selection, Qt::Key_Escape);
  EXPECT_FALSE(selection->isVisible());
  EXPECT_EQ(form->charts(), &charts);
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(Picture()->surface().image(), before);
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "CCC.WDT") << "from the chart on show";
}

TEST_F(ChtsTest, EscapeInTheFirstChartSelectionGoesBackToTheChartBehindIt) {
  Open();
  Entry("mnuChartDisplay")->trigger();
  ASSERT_TRUE(WaitFor([&] { return form->charts()->window().Chart.ChartDrawn; }));
  auto* selection = Find<QDialog>(form.get(), "ChtSel");
  QTest::keyClick(selection, Qt::Key_PageDown);
  QTest::keyClick(selection, Qt::Key_Escape);
  EXPECT_FALSE(selection->isVisible());
  ASSERT_NE(form->charts(), nullptr);
  EXPECT_EQ(shown(), "AAA.WDT");
  Entry("cmRelStrength")->trigger();
  EXPECT_TRUE(Find<QWidget>(form.get(), "Picture2(0)")->isVisible());
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "BBB.WDT");
}

TEST_F(ChtsTest, EscapeInChartSelectionWithoutAChartLeavesTheCharts) {
  home.Put("drive_c/korawin/data/AAA.WDT", "");
  Open();
  Entry("mnuChartDisplay")->trigger();
  QTest::keyClick(Find<QDialog>(form.get(), "ChtSel"), Qt::Key_Escape);
  EXPECT_TRUE(WaitFor([&] { return form->charts() == nullptr; }));
}

TEST_F(ChtsTest, TheButtonsOfSeveralOscillatorsOpenTheViewAndReturnBringsTheChart) {
  Chts& charts = OpenCharts();
  SaveMOSets(session->user, 2, {"RSI", "MACD", "None", "None"});
  const int ink = Ink();
  QTest::mouseClick(Find<QWidget>(form.get(), "mo2"), Qt::LeftButton);
  auto* view = form->findChild<QMainWindow*>("Anal");
  ASSERT_NE(view, nullptr);
  EXPECT_EQ(view->windowTitle(), "AAA        Multi-Oscillator 2");
  EXPECT_TRUE(charts.window().AnalPageMode);
  Find<QAction>(view, "amRet")->trigger();
  ASSERT_TRUE(WaitFor([&] { return form->findChild<QMainWindow*>("Anal") == nullptr; }));
  EXPECT_FALSE(charts.window().AnalPageMode);
  EXPECT_EQ(Ink(), ink);
}

TEST_F(ChtsTest, ASetThatIsNotMadeYetOpensItsForm) {
  OpenCharts();
  QTimer::singleShot(0, form.get(), [] {
    if (QWidget* box = QApplication::activeModalWidget()) box->close();
  });
  bool asked = false;
  QTimer closer;
  closer.callOnTimeout([&] {
    if (auto* sets = form->findChild<QDialog*>("MultiOsc")) {
      asked = true;
      sets->reject();
    }
  });
  closer.start(10);
  QTest::mouseClick(Find<QWidget>(form.get(), "mo1"), Qt::LeftButton);
  EXPECT_TRUE(WaitFor([&] { return asked; }));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "No oscillators have been set");
  EXPECT_TRUE(WaitFor([&] { return form->findChild<QMainWindow*>("Anal") == nullptr; }));
}

// The view closes itself within an event of its own menu bar, which has to be through with that
// before it goes.
TEST_F(ChtsTest, ChangingToASetThatIsNotMadeYetOpensItsFormBehindTheView) {
  OpenCharts();
  SaveMOSets(session->user, 1, {"RSI", "None", "None", "None"});
  QTest::mouseClick(Find<QWidget>(form.get(), "mo1"), Qt::LeftButton);
  QPointer<QMainWindow> view = form->findChild<QMainWindow*>("Anal");
  ASSERT_NE(view, nullptr);
  bool inKey = true, goneInKey = false, asked = false;
  QObject::connect(view->menuBar(), &QObject::destroyed, [&] { goneInKey = inKey; });
  QTimer closer;
  closer.callOnTimeout([&] {
    if (auto* sets = form->findChild<QDialog*>("MultiOsc")) {
      asked = true;
      sets->reject();
    }
  });
  closer.start(10);
  QTest::keyClick(view, Qt::Key_F6);
  inKey = false;
  EXPECT_TRUE(WaitFor([&] { return asked && !view; }));
  EXPECT_FALSE(goneInKey);
  EXPECT_EQ(dialogs.said.back().text, "No oscillators have been set");
}

TEST_F(ChtsTest, LeavingTheChartsLeavesTheViewToo) {
  OpenCharts();
  SaveMOSets(session->user, 1, {"RSI", "None", "None", "None"});
  QTest::mouseClick(Find<QWidget>(form.get(), "mo1"), Qt::LeftButton);
  ASSERT_NE(form->findChild<QMainWindow*>("Anal"), nullptr);
  form->charts()->parentWidget()->close();
  EXPECT_TRUE(WaitFor([&] { return form->findChild<QMainWindow*>("Anal") == nullptr; }));
}

TEST_F(ChtsTest, ASecondChartThatIsNotChosenLeavesTheNextOneAlone) {
  Chts& charts = OpenCharts();
  Entry("cmSplitScreen")->trigger();
  Chart2* second = nullptr;
  ASSERT_TRUE(WaitFor([&] { return (second = TopLevel<Chart2>()) != nullptr; }));
  EXPECT_EQ(charts.window().arrangement(), Arrangement::kUpper);
  Click(second, "Command2");
  EXPECT_EQ(charts.window().arrangement(), Arrangement::kOne);
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(charts.window().arrangement(), Arrangement::kOne);
  EXPECT_TRUE(charts.window().Chart.ChartDrawn);
}

TEST_F(ChtsTest, ClosingAndOpeningStartsAnew) {
  OpenCharts();
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  form->charts()->parentWidget()->close();
  ASSERT_TRUE(WaitFor([&] { return form->charts() == nullptr; }));
  Choose();
  EXPECT_EQ(shown(), "AAA.WDT");
}

TEST_F(ChtsTest, WithoutSecuritiesOneMessageSaysSoAndWhatToDoNext) {
  Open();
  const auto tells = [&](const std::string& what) {
    dialogs.said.clear();
    Entry("mnuChartDisplay")->trigger();
    ASSERT_EQ(dialogs.said.size(), 1u) << what;
    EXPECT_EQ(dialogs.said[0].text.find(what + "c:\\korawin\\data\\"), 0u) << dialogs.said[0].text;
    for (const char* next : {"import", "demo", "Folder Locations"})
      EXPECT_NE(dialogs.said[0].text.find(next), std::string::npos) << next;
    EXPECT_EQ(form->charts(), nullptr);
    EXPECT_EQ(form->findChild<QDialog*>("ChtSel"), nullptr);
  };
  home.Put("drive_c/korawin/data/Names.dat", "");
  tells("There are no securities in ");
  session->files.Remove("c:\\korawin\\data\\Names.dat");
  tells("There are no securities in ");
  session->files.Rename("c:\\korawin\\data", "c:\\korawin\\gone");
  tells("There is no folder ");
}

TEST_F(ChtsTest, ANameFileThatGoesIsToldAndTheWindowStands) {
  Chts& charts = OpenCharts();
  session->files.Remove("c:\\korawin\\data\\Names.dat");
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_TRUE(charts.isVisible());
}

TEST_F(ChtsTest, PageSetUpAndPrintOpenTheirFormsOverTheChart) {
  Chts& charts = OpenCharts();
  for (const auto& [entry, name] :
       {std::pair{"cmPageSetup", "Page"}, {"cmPrintChart", "PrintKora"}}) {
    Find<QAction>(&charts, entry)->trigger();
    auto* dialog = Find<QDialog>(&charts, name);
    ASSERT_NE(dialog, nullptr) << name;
    EXPECT_TRUE(dialog->isVisible());
    EXPECT_TRUE(session->charts.SuppressScript);
    dialog->reject();
    ASSERT_TRUE(WaitFor([&, form = name] { return charts.findChild<QDialog*>(form) == nullptr; }))
        << name;
  }
  EXPECT_TRUE(home.Exists("drive_c/korawin/data/TCht.Tmp"));
}

TEST_F(ChtsTest, AChartOrASavedChartIsPrintedIntoAPdfOfItsNameOnThePageAsItWasKept) {
  session->ini.PutSetting("ChtPage", "Orient", "2");
  Chts& charts = OpenCharts();
  const auto print = [&](const char* expected) {
    Find<QAction>(&charts, "cmPrintChart")->trigger();
    auto* dialog = Find<QDialog>(&charts, "PrintKora");
    ASSERT_NE(dialog, nullptr);
    Find<QComboBox>(dialog, "Combo1")->setCurrentText("PDF file");
    EXPECT_EQ(Find<QLineEdit>(dialog, "Text2")->text(), expected);
    Click(dialog, "Command1");
    ASSERT_TRUE(WaitFor([&] { return charts.findChild<QDialog*>("PrintKora") == nullptr; }));
    EXPECT_EQ(charts.windowTitle().toStdString(), charts.window().view().Title);
  };
  print("c:\\korawin\\chtsave\\AAA.pdf");
  EXPECT_NE(home.Get("drive_c/korawin/chtsave/AAA.pdf").find("/MediaBox [0 0 842"),
            std::string::npos);
  EXPECT_EQ(session->settings.page.Orient, 2);

  home.Put("drive_c/korawin/chtsave/Mine.v2.cht", "L,1,2,300,400,255\r\n");
  charts.window().ShowSaved("c:\\korawin\\chtsave\\Mine.v2.cht");
  print("c:\\korawin\\chtsave\\Mine.v2.pdf");
  EXPECT_TRUE(home.Exists("drive_c/korawin/chtsave/Mine.v2.pdf"));
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text, "Saved in " + home.path() + "/drive_c/korawin/chtsave/AAA.pdf");
  EXPECT_EQ(dialogs.said[1].text,
            "Saved in " + home.path() + "/drive_c/korawin/chtsave/Mine.v2.pdf");
}

TEST_F(ChtsTest, AChartThatFailedToDrawIsNotPrinted) {
  Chts& charts = OpenCharts();
  session->files.Remove("c:\\korawin\\data\\BBB.WDT");
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  ASSERT_EQ(dialogs.said.size(), 1u);
  Find<QAction>(&charts, "cmPrintChart")->trigger();
  EXPECT_EQ(dialogs.said.back().text, "There is no chart to print");
  EXPECT_EQ(charts.findChild<QDialog*>("PrintKora"), nullptr);
}

TEST_F(ChtsTest, PricesThatCameInShowOnTheChart) {
  home.Put("drive_c/korawin/download/02NOV26.d", kDay);
  Chts& charts = OpenCharts();
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  ASSERT_EQ(shown(), "BBB.WDT");
  const auto bars = charts.window().Chart.Bars.BarCount;
  Entry("mnuModem")->trigger();
  auto* list = Find<QDialog>(form.get(), "DLList");
  ASSERT_NE(list, nullptr);
  Click(list, "Command1");
  EXPECT_EQ(charts.window().Chart.Bars.BarCount, bars + 1);
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(session->current.Rec.Code.trimmed(), "BBB") << "as the update left another";
}

TEST_F(ChtsTest, StockDetailsShowTheSecurityOfTheChart) {
  session->ini.PutSetting("Download", "DataService", "1");
  session->ini.PutSetting("Download", "System", "c:\\dl\\");
  const auto entry = [this] { return Find<QAction>(form->charts(), "cmStkDetails"); };
  const auto reopen = [this] {
    form->charts()->parentWidget()->close();
    ASSERT_TRUE(WaitFor([&] { return form->charts() == nullptr; }));
    Choose();
  };
  OpenCharts();
  EXPECT_FALSE(entry()->isVisible()) << "there are no details";
  home.Put("drive_c/dl/STKHeader.txt", "2\r\nASXCODE\r\nDescription\r\n");
  home.Put("drive_c/dl/SecurityDetails.Stx", PadRight("BBB", 6) + PadRight("Small miner|", 306));
  home.Put("drive_c/dl/Sdix1.inx", "BBB,1\r\n");
  reopen();
  ASSERT_TRUE(entry()->isVisible());
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  entry()->trigger();
  auto* stock = form->findChild<QDialog*>("StockInf");
  ASSERT_NE(stock, nullptr);
  EXPECT_EQ(stock->windowTitle(), "BBB");
  EXPECT_FALSE(stock->isModal());
  // Another chart, and the form that stands follows.
  QTest::keyClick(Picture(), Qt::Key_PageUp, Qt::ControlModifier);
  entry()->trigger();
  EXPECT_EQ(stock->windowTitle(), "AAA");
  EXPECT_EQ(form->findChildren<QDialog*>("StockInf").size(), 1);
  session->settings.download.DataService = 2;  // a service without such details
  reopen();
  EXPECT_FALSE(entry()->isVisible());
}

TEST_F(ChtsTest, AnAverageSwitchedOnInTheDefaultsStandsOnTheChart) {
  Chts& charts = OpenCharts();
  ASSERT_FALSE(charts.window().Request.Ma2On);
  QTimer::singleShot(0, [&] {
    auto* defaults = Find<QDialog>(&charts, "ChtDef");
    ASSERT_NE(defaults, nullptr);
    Find<QAbstractButton>(defaults, "AvTwo")->click();
    defaults->reject();
  });
  Find<QAction>(&charts, "cmChtDef")->trigger();
  EXPECT_TRUE(charts.window().Request.Ma2On);
}

TEST_F(ChtsTest, TheUnitOfVolumesStandsOnTheChart) {
  session->ini.PutSetting("Download", "DataService", "1");
  session->ini.PutSetting("Download", "System", "c:\\korawin\\download\\system\\");
  home.Put("drive_c/korawin/download/system/Mainfile.ASX",
           std::string(22, ' ') + "AAA   " + std::string(26, ' ') + " 0-3   ");
  Chts& charts = OpenCharts();
  EXPECT_EQ(charts.window().Chart.VolLabel, "'00000");
}

TEST_F(ChtsTest, AChartThatFailsIsNotToldAgainAtEverySize) {
  home.Put("drive_c/korawin/data/AAA.WDT", "torn");
  OpenCharts();
  EXPECT_EQ(dialogs.said.size(), 1u);
  for (int i = 1; i < 4; ++i) {
    form->resize(form->width() - 20, form->height() - 20);
    QCoreApplication::processEvents();
  }
  EXPECT_EQ(dialogs.said.size(), 1u);
  QTest::keyClick(Picture(), Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_GT(Ink(), 1000);
}

class LogoTest : public test::FormTest {
 protected:
  Logo& Make() {
    logo = std::make_unique<Logo>(*session, "");
    Find<QTimer>(logo.get(), "Timer2")->setInterval(0);
    return *logo;
  }
  bool MainShows() {
    return WaitFor([&] { return logo->main() && logo->main()->isVisible() && !logo->isVisible(); });
  }
  std::unique_ptr<Logo> logo;
};

TEST_F(LogoTest, ASecondInstanceIsToldBeforeAnySettingIsRead) {
  const SingleInstance first(home.path(), "KORA32");
  EXPECT_FALSE(first.Previous());
  const SingleInstance second(home.path(), "KORA32");
  EXPECT_TRUE(second.Previous());
  EXPECT_FALSE(Make().Start(second.Previous()));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "You already have this application running.");
  EXPECT_EQ(dialogs.said[0].title, "KORA Charting 7F");
  EXPECT_EQ(session->settings.paths.SystemPath, "") << "nothing was read";
  EXPECT_FALSE(home.Exists("drive_c/korawin/chtmisc"));
  EXPECT_EQ(logo->main(), nullptr);
}

TEST_F(LogoTest, TheInstanceBeforeMayHaveEndedOrHaveAnotherHome) {
  { const SingleInstance gone(home.path(), "KORA32"); }
  const SingleInstance next(home.path(), "KORA32");
  EXPECT_FALSE(next.Previous());
  test::TempHome other;
  EXPECT_FALSE(SingleInstance(other.path(), "KORA32").Previous());
  EXPECT_FALSE(SingleInstance(home.path() + "/not there", "KORA32").Previous());
}

TEST_F(LogoTest, TheLockOfADeadProgramIsTakenOverWithoutRoomForASecondFile) {
  // No process has this number; a folder of the name keeps the second file from being made.
  home.Put("KORA32.lock", "2147483647\nkora\n\n\n\n");
  QDir(QString::fromStdString(home.path())).mkdir("KORA32.lock.rmlock");
  const SingleInstance next(home.path(), "KORA32");
  EXPECT_FALSE(next.Previous());
  EXPECT_TRUE(SingleInstance(home.path(), "KORA32").Previous());
}

TEST_F(LogoTest, ASettingsFileThatCantBeReadEndsTheStart) {
  home.Put("Kora.ini", std::string(5u << 20, 'x'));
  EXPECT_FALSE(Make().Start(false));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_NE(dialogs.said[0].text.find("can't be read: The file is too large"), std::string::npos);
  EXPECT_FALSE(logo->isVisible());
  EXPECT_EQ(logo->main(), nullptr);
  EXPECT_FALSE(home.Exists("drive_c/korawin/chtmisc"));
}

TEST_F(LogoTest, ReadsTheSettingsThenOpensTheMainWindow) {
  EXPECT_TRUE(Make().Start(false));
  EXPECT_TRUE(logo->isVisible());
  EXPECT_TRUE(dialogs.busy);
  EXPECT_EQ(session->settings.paths.SystemPath, "c:\\korawin\\");
  EXPECT_TRUE(home.Exists("drive_c/korawin/chtmisc"));
  EXPECT_TRUE(home.Exists("drive_c/korawin/chtsave"));
  ASSERT_TRUE(MainShows());
  EXPECT_FALSE(dialogs.busy);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(LogoTest, NoWaitingFilesNoMessageAndTheMainWindowStands) {
  Make();
  home.Put("drive_c/korawin/download/readme.txt", "");
  ASSERT_TRUE(logo->Start(false));
  ASSERT_TRUE(MainShows());
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(logo->main()->findChild<QDialog*>("DLList"), nullptr);
}

TEST_F(LogoTest, ASavedChartIsShownOnceTheMainWindowStands) {
  home.Put("drive_c/korawin/chtsave/a.cht", "L,10,10,300,200,255\r\n");
  Make().Opened = [this](Main& main) {
    EXPECT_FALSE(logo->isVisible());
    main.OpenSavedChart(home.path() + "/drive_c/korawin/chtsave/a.cht");
  };
  EXPECT_TRUE(logo->Start(false));
  EXPECT_TRUE(MainShows());
  EXPECT_TRUE(dialogs.said.empty());
  ASSERT_NE(logo->main()->charts(), nullptr);
  EXPECT_TRUE(logo->main()->charts()->window().ChartFromFile);
  EXPECT_EQ(logo->main()->charts()->window().SavedChartFile, "c:\\korawin\\chtsave\\a.cht");
  EXPECT_EQ(logo->main()->findChild<QDialog*>("ChtSel"), nullptr);
}

TEST_F(LogoTest, ASavedChartNeedsNoSecurity) {
  home.Put("drive_c/korawin/data/Names.dat", "");
  home.Put("elsewhere/a.cht", "L,10,10,300,200,255\r\n");
  Make().Opened = [this](Main& main) { main.OpenSavedChart(home.path() + "/elsewhere/a.cht"); };
  EXPECT_TRUE(logo->Start(false));
  EXPECT_TRUE(MainShows());
  EXPECT_TRUE(dialogs.said.empty()) << dialogs.said.at(0).text;
  EXPECT_TRUE(logo->main()->charts()->window().ChartFromFile);
}

TEST_F(LogoTest, AChartThatIsMissingOrNoneIsToldAndTheWindowStands) {
  home.Put("none.cht", "Date,Close\r\n");
  home.Put("picture.png", "L,10,10,300,200,255\r\n");
  Make().Opened = [this](Main& main) {
    for (const char* file : {"/missing.cht", "/none.cht", "/picture.png", "/folder/"})
      main.OpenSavedChart(home.path() + file);
  };
  EXPECT_TRUE(logo->Start(false));
  EXPECT_TRUE(MainShows());
  ASSERT_EQ(dialogs.said.size(), 4u);
  for (int i : {0, 1}) {
    EXPECT_EQ(dialogs.said[size_t(i)].title, "Show Saved Chart");
    EXPECT_EQ(dialogs.said[size_t(i)].text,
              "There is problem displaying this chart - format invalid.");
  }
  for (int i : {2, 3}) {
    EXPECT_EQ(dialogs.said[size_t(i)].title, "Saved Charts");
    EXPECT_EQ(dialogs.said[size_t(i)].text, "File extension must be .cht");
  }
  EXPECT_FALSE(logo->main()->charts()->window().ChartFromFile);
}

TEST_F(LogoTest, WaitingFilesAreListedOnOkAndPassedOverOnCancel) {
  home.Put("drive_c/korawin/download/02NOV26.d", kDay);
  for (const Answer answer : {Answer::kOk, Answer::kCancel}) {
    dialogs.said.clear();
    dialogs.answers = {answer};
    ASSERT_TRUE(Make().Start(false));
    ASSERT_TRUE(MainShows());
    ASSERT_EQ(dialogs.said.size(), 1u);
    EXPECT_EQ(dialogs.said[0].text, " There are some Ex Internet data files to update into KORA");
    EXPECT_EQ(dialogs.said[0].title, "Downloaded Data");
    EXPECT_EQ(logo->main()->findChild<QDialog*>("DLList") != nullptr, answer == Answer::kOk);
    logo.reset();
  }
}

TEST_F(LogoTest, GivingUpTheDriveEndsTheProgram) {
  session->files.Remove("C:\\WINDOWS\\Kora.ini");
  dialogs.replies = {std::nullopt};
  EXPECT_FALSE(Make().Start(false));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Drive");
  EXPECT_FALSE(dialogs.busy);
  EXPECT_FALSE(logo->isVisible());
}

TEST_F(LogoTest, SettingsThatMakeNoSenseAreToldAndTheProgramStands) {
  for (const std::string system : {"1:\\x\\y\\", "\\\\\\", "c:\\a\\\\b\\", "c:\\..\\..\\"}) {
    home.Put("Kora.ini", "[KoraPaths]\r\nSystem=" + system + "\r\nChtData=" + system + "\r\n");
    session = std::make_unique<Session>(home.path(), dialogs);
    dialogs.replies = {std::nullopt};
    dialogs.answers = {Answer::kYes, Answer::kYes};
    if (!Make().Start(false)) continue;
    ASSERT_TRUE(MainShows()) << system;
    dialogs.said.clear();
    Find<QAction>(logo->main(), "mnuChartDisplay")->trigger();
    EXPECT_EQ(dialogs.said.size(), 1u) << system;
    Find<QAction>(logo->main(), "mnuPaths")->trigger();
    logo.reset();
  }
}

TEST_F(LogoTest, ASettingsFileOfRubbishStartsThePromptOfTheDrive) {
  std::string rubbish;
  for (int i = 0; i < 5000; ++i) rubbish += char(i * 131 + i / 7);
  home.Put("Kora.ini", rubbish);
  session = std::make_unique<Session>(home.path(), dialogs);
  dialogs.replies = {std::nullopt};
  EXPECT_FALSE(Make().Start(false));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Drive");
}

TEST(Help, TheGuideIsFoundBesideTheProgramOrAboveIt) {
  QTemporaryDir folder;
  const QDir root(folder.path());
  const auto put = [&](const QString& place) {
    root.mkpath(place);
    QFile file(root.filePath(place + "/index.html"));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write("<html><body><h1>Guide</h1></body></html>");
  };
  root.mkpath("build/release/bin");
  const QString bin = root.filePath("build/release/bin");
  put("docs/guide");
  EXPECT_EQ(FindGuide(bin), QFileInfo(root.filePath("docs/guide/index.html")).canonicalFilePath());
  put("build/release/bin/guide");
  EXPECT_EQ(FindGuide(bin),
            QFileInfo(root.filePath("build/release/bin/guide/index.html")).canonicalFilePath());

  const QPointer<HelpWindow> help = new HelpWindow(FindGuide(bin));
  help->show();
  EXPECT_EQ(help->windowTitle(), "KORA Charting Help");
  auto* page = help->findChild<QTextBrowser*>("Text1");
  ASSERT_NE(page, nullptr);
  EXPECT_EQ(page->toPlainText(), "Guide");
  ASSERT_TRUE(QTest::qWaitForWindowActive(help));
  QTest::keyClick(page, Qt::Key_Escape);
  EXPECT_TRUE(QTest::qWaitFor([&] { return help.isNull(); })) << "it deletes itself on closing";
  delete help;
}

}  // namespace
}  // namespace kora
