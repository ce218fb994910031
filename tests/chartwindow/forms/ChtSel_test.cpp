#include "chartwindow/forms/ChtSel.h"

#include <QCheckBox>
#include <QScrollBar>
#include <QTableView>
#include <QToolButton>

#include "chartwindow/forms/Chart2.h"
#include "chartwindow/forms/ChtOptions.h"
#include "lists/forms/IndClass.h"
#include "lists/forms/Search.h"
#include "tests/support/qt/list_form_fixture.h"

namespace kora {
namespace {

class ChtSelTest : public test::ListFormTest {
 protected:
  void SetUp() override {
    ListFormTest::SetUp();
    selection =
        std::make_unique<ChartSelection>(ChartSelectionServices{.files = session->files,
                                                                .dialogs = dialogs,
                                                                .settings = session->settings,
                                                                .ini = session->ini,
                                                                .user = session->user,
                                                                .state = state,
                                                                .current = session->current});
  }
  ChtSelServices Services() {
    return {.selection = *selection,
            .state = state,
            .files = session->files,
            .dialogs = dialogs,
            .settings = session->settings,
            .user = session->user,
            .colours = session->colours,
            .showChart =
                [this] {
                  ++shown;
                  shownIndex = state.ChartIndex;
                },
            .showWindow = [this] { ++windows; },
            .closed = [this] { ++closed; },
            .openChtDef =
                [this](const std::function<void()>& averagesChanged) {
                  taskAtDefaults = state.ChartTask;
                  if (atDefaults) atDefaults();
                  averagesChanged();
                },
            .openFinDate =
                [this] {
                  state.ChosenLimitText = "9/4/95";
                  state.ChosenLimitDate = "19950409";
                  return dateChosen;
                },
            .openChtBands = [this] { ++bandsAsked; },
            .openWMPath = [this] { return folderChanged; }};
  }
  void Open() { Stand(std::make_unique<ChtSel>(Services(), nullptr)); }
  void OpenSecond() { Stand(std::make_unique<Chart2>(Services(), nullptr)); }
  std::string Kept(const char* key) { return session->ini.GetSetting("Charts", key); }
  void PressKey(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
    QTest::keyClick(QApplication::focusWidget(), key, modifiers);
  }
  std::string Focus() {
    QWidget* focus = QApplication::focusWidget();
    return focus ? focus->objectName().toStdString() : "";
  }
  void DoubleClick(const char* name) {
    QTest::mouseClick(Text(name), Qt::LeftButton);
    QTest::mouseDClick(Text(name), Qt::LeftButton);
  }

  ChartState state;
  std::unique_ptr<ChartSelection> selection;
  int shown = 0, shownIndex = 0, windows = 0, closed = 0, bandsAsked = 0;
  int taskAtDefaults = 0;
  std::function<void()> atDefaults;
  bool dateChosen = true, folderChanged = true;
};

TEST_F(ChtSelTest, OpensOnTheFirstSecurityWithTheCodeSelected) {
  Open();
  EXPECT_EQ(form->windowTitle(), "Chart Selection Menu");
  EXPECT_EQ(Focus(), "Text1");
  EXPECT_EQ(Text("Text1")->selectedText(), "AAA");
  EXPECT_EQ(TextOf("Text2"), "Alpha Mining");
  EXPECT_EQ(TextOf("Text4"), "6");
  EXPECT_EQ(TextOf("Text5"), "1");
  EXPECT_EQ(On<QLabel>("Label8")->text(), " FULL LIST   (Names.Dat)");
  EXPECT_EQ(Combo("Combo2")->count(), 18);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChtSelTest, EnterFindsTheCodeAndASecondEnterShowsItsChart) {
  Open();
  QTest::keyClicks(Text("Text1"), "bhp");
  PressKey(Qt::Key_Return);
  EXPECT_EQ(TextOf("Text1"), "BHP");
  EXPECT_EQ(TextOf("Text2"), "Broken Hill");
  EXPECT_EQ(On<QScrollBar>("VScroll1")->value(), 3);
  EXPECT_EQ(Focus(), "OK");
  EXPECT_EQ(shown, 0);
  PressKey(Qt::Key_Return);
  EXPECT_EQ(shown, 1);
  EXPECT_EQ(shownIndex, 3);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(closed, 0);
  EXPECT_EQ(Kept("Type"), "B");
}

TEST_F(ChtSelTest, ACodeThatIsNotThereAsksForTheNearest) {
  Open();
  dialogs.answers = {Answer::kNo};
  Enter("Text1", "qqq");
  ExpectSaid("No record on file for that code - Find nearest code ?", "Chart Selection");
  EXPECT_EQ(TextOf("Text1"), "qqq") << "to be corrected";
  EXPECT_EQ(TextOf("Text2"), "Alpha Mining");
  Enter("Text1", "bh");
  EXPECT_EQ(TextOf("Text1"), "BHP");
  EXPECT_EQ(Focus(), "Text1");
  EXPECT_EQ(shown, 0);
}

TEST_F(ChtSelTest, StepsByScrollBarAndPageKeys) {
  Open();
  PressKey(Qt::Key_PageDown);
  EXPECT_EQ(TextOf("Text1"), "BBB");
  PressKey(Qt::Key_PageDown);
  EXPECT_EQ(TextOf("Text1"), "BHP");
  PressKey(Qt::Key_PageUp);
  EXPECT_EQ(TextOf("Text1"), "BBB");
  auto* bar = On<QScrollBar>("VScroll1");
  bar->setFocus();
  PressKey(Qt::Key_End);
  EXPECT_EQ(TextOf("Text1"), "ZZZ");
  EXPECT_EQ(TextOf("Text5"), "6");
  EXPECT_EQ(Combo("Combo1")->currentText(), "Line");
  PressKey(Qt::Key_Down);
  EXPECT_EQ(TextOf("Text1"), "ZZZ") << "the last stays";
  PressKey(Qt::Key_Up);
  EXPECT_EQ(TextOf("Text1"), "ADV");
}

TEST_F(ChtSelTest, TabGoesThroughTheFieldsInTheirOrder) {
  Open();
  for (const char* name :
       {"Text2", "VScroll1", "Combo1", "Combo4", "Text3", "Text6", "Combo3", "Combo2", "OAve1",
        "OAve2", "Text7", "Check16", "Text8", "OK", "Command2", "Command1", "Command7"}) {
    PressKey(Qt::Key_Tab);
    EXPECT_EQ(Focus(), name);
  }
}

TEST_F(ChtSelTest, MnemonicsReachTheFields) {
  Open();
  const std::pair<Qt::Key, const char*> keys[] = {
      {Qt::Key_T, "Combo1"}, {Qt::Key_P, "Combo4"}, {Qt::Key_S, "Text3"}, {Qt::Key_D, "Text6"},
      {Qt::Key_B, "Combo3"}, {Qt::Key_O, "Combo2"}, {Qt::Key_A, "OAve1"}, {Qt::Key_V, "Text7"},
      {Qt::Key_N, "Text2"},  {Qt::Key_C, "Text1"}};
  for (const auto& [key, name] : keys) {
    PressKey(key, Qt::AltModifier);
    EXPECT_EQ(Focus(), name);
  }
}

TEST_F(ChtSelTest, TheWholeRequestByKeyboardIsWritten) {
  Open();
  Enter("Text1", "BHP");
  Choose("Combo1", kCandleIndex);
  EXPECT_EQ(TextOf("Text3"), "3");
  Choose("Combo4", kWeeklyIndex);
  EXPECT_EQ(On<QCheckBox>("OAve1")->text(), "10");
  Choose("Combo3", 2);
  EXPECT_EQ(bandsAsked, 1) << "on the way down through the percentage bands";
  Choose("Combo2", 12);
  On<QCheckBox>("OAve2")->setFocus();
  PressKey(Qt::Key_Space);
  Type("Text3", "6");
  PressKey(Qt::Key_H, Qt::AltModifier);
  ASSERT_TRUE(WaitFor([this] { return shown == 1; }));
  EXPECT_EQ(state.ChartStyle, Style::kCandlestick);
  EXPECT_EQ(state.ChartPeriod, Period::kWeekly);
  EXPECT_EQ(state.BarSpacing, 6);
  EXPECT_EQ(state.BandKind, 2);
  EXPECT_EQ(state.OscSelected, "RMO");
  EXPECT_TRUE(state.Ma2On);
  EXPECT_EQ(Kept("Spacing"), "6");
  EXPECT_EQ(Kept("AvTwo"), "True");
  EXPECT_EQ(shownIndex, 3);
}

TEST_F(ChtSelTest, TheWindowIsShownOnTheWayFromTheStart) {
  state.ChartStartup = true;
  Open();
  Press("OK");
  EXPECT_EQ(windows, 1);
  EXPECT_FALSE(state.ChartStartup);
  EXPECT_EQ(shown, 1);
}

TEST_F(ChtSelTest, TheSpacingFollowsItsRules) {
  Open();
  Type("Text3", "25");
  PressKey(Qt::Key_Tab);
  EXPECT_EQ(TextOf("Text3"), "20");
  Type("Text3", "0");
  PressKey(Qt::Key_Tab);
  EXPECT_EQ(TextOf("Text3"), "2");
  Press("UpDown2(0)");
  EXPECT_EQ(TextOf("Text3"), "1");
  Press("UpDown2(0)");
  EXPECT_EQ(TextOf("Text3"), "10");
  Press("UpDown2(1)");
  EXPECT_EQ(TextOf("Text3"), "1");
  Text("Text3")->setFocus();
  PressKey(Qt::Key_Up);
  EXPECT_EQ(TextOf("Text3"), "2");
  PressKey(Qt::Key_Down);
  EXPECT_EQ(TextOf("Text3"), "1");
}

TEST_F(ChtSelTest, PointAndFigureGreysWhatItCannotShow) {
  Open();
  Choose("Combo2", 3);
  Choose("Combo1", kPointFigureIndex);
  EXPECT_EQ(On<QLabel>("Label4")->text().remove('&'), "Point Reversal");
  for (const char* name : {"Combo2", "Combo3", "OAve1", "OAve2"})
    EXPECT_FALSE(On<QWidget>(name)->isEnabled()) << name;
  EXPECT_FALSE(state.OscShown);
  Choose("Combo1", kLineIndex);
  EXPECT_EQ(On<QLabel>("Label4")->text().remove('&'), "Chart Spacing");
  for (const char* name : {"Combo2", "Combo3", "OAve1", "OAve2"})
    EXPECT_TRUE(On<QWidget>(name)->isEnabled()) << name;
}

TEST_F(ChtSelTest, VolumesFlipByClickAndEnter) {
  Open();
  Press("Text7");
  EXPECT_EQ(TextOf("Text7"), "OFF");
  EXPECT_FALSE(state.VolumeOption);
  Text("Text7")->setFocus();
  PressKey(Qt::Key_Return);
  EXPECT_EQ(TextOf("Text7"), "ON");
}

TEST_F(ChtSelTest, TheFinishDateComesFromItsFormAndGoesByAClick) {
  Open();
  Press("Text6");
  EXPECT_EQ(TextOf("Text6"), "9/4/95");
  EXPECT_TRUE(state.DateLimitOn);
  Press("Text6");
  EXPECT_EQ(TextOf("Text6"), "LATEST");
  EXPECT_FALSE(state.DateLimitOn);
  Text("Text6")->setFocus();
  PressKey(Qt::Key_Return);
  EXPECT_EQ(TextOf("Text6"), "9/4/95");
  QTest::mouseDClick(Text("Text6"), Qt::LeftButton);
  EXPECT_FALSE(state.DateLimitOn);
  dateChosen = false;
  state.DateLimitOn = false;
  PressKey(Qt::Key_Return);
  EXPECT_EQ(TextOf("Text6"), "LATEST");
}

TEST_F(ChtSelTest, AveragesAreTickedInTheirColour) {
  Open();
  auto* average = On<QCheckBox>("OAve1");
  EXPECT_EQ(average->text(), "21");
  average->setFocus();
  PressKey(Qt::Key_Space);
  EXPECT_TRUE(state.Ma1On);
  const std::int32_t colour = session->colours[kAverage2];
  EXPECT_EQ(average->palette().color(QPalette::WindowText),
            QColor(colour & 0xFF, colour >> 8 & 0xFF, colour >> 16 & 0xFF));
  PressKey(Qt::Key_Return);
  EXPECT_FALSE(state.Ma1On) << "ENTER flips the tick";
  EXPECT_FALSE(average->isChecked());
}

TEST_F(ChtSelTest, TheListIsChangedByDoubleClick) {
  PutList('A', {Entry(5, "ADV"), Entry(1, "AAA")});
  Open();
  Press("Command1");
  auto* options = Opened<ChtOptions>();
  ASSERT_TRUE(options);
  EXPECT_EQ(options->windowTitle(), "Viewing Options");
  auto* list = Find<QListWidget>(options, "List1");
  EXPECT_EQ(list->currentRow(), 0);
  EXPECT_EQ(list->item(2)->text(), "Chart List B (Empty)");
  ClickItem(list, 1);
  EXPECT_EQ(Find<QLabel>(options, "Label1")->text(), "Chart List A");
  DoubleClickItem(list, 1);
  ASSERT_TRUE(WaitFor([this] { return TextOf("Text1") == "ADV"; }));
  EXPECT_EQ(On<QLabel>("Label8")->text(), "Chart List A");
  EXPECT_EQ(TextOf("Text4"), "2");
  EXPECT_EQ(Focus(), "Text1");
  EXPECT_EQ(Text("Text1")->selectedText(), "ADV");
  EXPECT_FALSE(On<QWidget>("Text8")->isEnabled());
  EXPECT_FALSE(On<QWidget>("Check16")->isEnabled());
  Enter("Text2", "Bank");
  ExpectSaid("You have Chart List A selected.\nSearch by NAME only available when using FULL LIST",
             "Search by Name");
}

TEST_F(ChtSelTest, AnEmptyListChosenByKeyboardFallsBackWithItsMessage) {
  Open();
  PressKey(Qt::Key_L, Qt::AltModifier);
  auto* options = Opened<ChtOptions>();
  ASSERT_TRUE(options);
  QTest::keyClick(Find<QListWidget>(options, "List1"), Qt::Key_Down);
  QTest::keyClick(Find<QListWidget>(options, "List1"), Qt::Key_Return);
  ASSERT_TRUE(WaitFor([this] { return !dialogs.said.empty(); }));
  ExpectSaid(
      " There are no records in Chart List A (Empty) for this folder.\n"
      " At Main Menu click EDIT / Edit Chart Lists to create your special interest list",
      "Chart Lists  c:\\korawin\\data\\");
  EXPECT_EQ(On<QLabel>("Label8")->text(), " FULL LIST   (Names.Dat)");
  EXPECT_EQ(TextOf("Text1"), "AAA");
}

TEST_F(ChtSelTest, EscapeInTheChooserChangesNothing) {
  PutList('A', {Entry(5, "ADV")});
  Open();
  Press("Command1");
  auto* options = Opened<ChtOptions>();
  ASSERT_TRUE(options);
  ClickItem(Find<QListWidget>(options, "List1"), 1);
  QTest::keyClick(options, Qt::Key_Escape);
  EXPECT_EQ(state.ChartListNo, kFullList);
  EXPECT_FALSE(state.ChartListChanged);
  EXPECT_EQ(TextOf("Text1"), "AAA");
}

TEST_F(ChtSelTest, ASecurityIsFoundByAPartOfItsName) {
  Open();
  Enter("Text2", "Bank");
  auto* search = Opened<Search>();
  ASSERT_TRUE(search);
  EXPECT_EQ(Find<QLineEdit>(search, "Text1(0)")->text(), "BBB");
  EXPECT_EQ(Find<QLineEdit>(search, "Text1(1)")->text(), "Beta Bank");
  QTest::keyClick(search, Qt::Key_Return);
  EXPECT_EQ(Find<QLineEdit>(search, "Text1(0)")->text(), "ZZZ") << "ENTER finds the next";
  Click(search, "Command3");
  EXPECT_EQ(TextOf("Text1"), "ZZZ");
  EXPECT_EQ(TextOf("Text2"), "Last Bank");
  EXPECT_EQ(state.ChartIndex, 6);
}

TEST_F(ChtSelTest, AllSecuritiesWithTheNameAreListedInAnyCase) {
  Open();
  Enter("Text2", "bANK");
  auto* search = Opened<Search>();
  ASSERT_TRUE(search);
  auto* list = Find<QListWidget>(search, "List1");
  ASSERT_EQ(list->count(), 2);
  EXPECT_EQ(list->currentRow(), 0);
  EXPECT_TRUE(list->item(1)->text().contains("Last Bank"));
  list->setCurrentRow(1);
  EXPECT_EQ(Find<QLineEdit>(search, "Text1(0)")->text(), "ZZZ");
  Click(search, "Command3");
  EXPECT_EQ(TextOf("Text1"), "ZZZ");
}

TEST_F(ChtSelTest, NoMoreMatchesLeadsToTheFirstAndCloseToNothing) {
  Open();
  PressKey(Qt::Key_PageDown);
  Enter("Text2", "nowhere");
  auto* search = Opened<Search>();
  ASSERT_TRUE(search);
  EXPECT_EQ(Find<QLineEdit>(search, "Text1(1)")->text(), "No more matches");
  QTest::keyClick(search, Qt::Key_Escape);
  EXPECT_EQ(state.ChartIndex, 2);
  ASSERT_TRUE(WaitFor([this] { return form->findChild<Search*>() == nullptr; }));
  Enter("Text2", "nowhere");
  search = Opened<Search>();
  ASSERT_TRUE(search);
  Click(search, "Command3");
  EXPECT_EQ(TextOf("Text1"), "AAA");
  EXPECT_EQ(state.ChartIndex, 1);
}

TEST_F(ChtSelTest, AClassIsPickedByDoubleClick) {
  Open();
  DoubleClick("Text8");
  auto* picker = Opened<IndClass>();
  ASSERT_TRUE(picker);
  EXPECT_FALSE(dialogs.busy);
  auto* grid = Find<QTableView>(picker, "SS1");
  ASSERT_EQ(grid->model()->rowCount(), 3);
  EXPECT_EQ(grid->model()->headerData(0, Qt::Horizontal), "Class Id");
  EXPECT_EQ(grid->model()->index(1, 1).data(), "Gold - producers");
  const QPoint copper = grid->visualRect(grid->model()->index(2, 1)).center();
  QTest::mouseClick(grid->viewport(), Qt::LeftButton, Qt::NoModifier, copper);
  QTest::mouseDClick(grid->viewport(), Qt::LeftButton, Qt::NoModifier, copper);
  ASSERT_TRUE(WaitFor([this] { return TextOf("Text8") == "012"; }));
  EXPECT_TRUE(On<QCheckBox>("Check16")->isChecked());
  EXPECT_EQ(TextOf("Text1"), "BHP");
  PressKey(Qt::Key_PageDown);
  EXPECT_EQ(TextOf("Text1"), "ZZZ") << "only that class is stepped through";
  Press("Check16");
  EXPECT_EQ(TextOf("Text8"), "");
  EXPECT_FALSE(state.ICFilterOn);
}

TEST_F(ChtSelTest, TheTickOpensThePickerAndGivingUpIsInvalid) {
  Open();
  On<QCheckBox>("Check16")->setFocus();
  PressKey(Qt::Key_Space);
  auto* picker = Opened<IndClass>();
  ASSERT_TRUE(picker);
  QTest::keyClick(picker, Qt::Key_Escape);
  ExpectSaid("Industry Classification invalid", "Analysis");
  EXPECT_FALSE(On<QCheckBox>("Check16")->isChecked());
}

TEST_F(ChtSelTest, AClassIsTypedAndOneThatNobodyHasIsTold) {
  Open();
  Enter("Text8", "010");
  EXPECT_EQ(TextOf("Text1"), "AAA");
  EXPECT_TRUE(On<QCheckBox>("Check16")->isChecked());
  Enter("Text8", "777");
  ExpectSaid("No records on file for that Industry classification or group",
             "Industry Classification");
  EXPECT_EQ(TextOf("Text8"), "");
  EXPECT_FALSE(On<QCheckBox>("Check16")->isChecked());
}

TEST_F(ChtSelTest, EscapeClosesAndWrites) {
  Open();
  On<QCheckBox>("OAve1")->setFocus();
  PressKey(Qt::Key_Space);
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(closed, 1);
  EXPECT_EQ(shown, 0);
  EXPECT_EQ(Kept("AvOne"), "True");
}

TEST_F(ChtSelTest, EscapeGoesBackToTheChartThatStands) {
  int back = 0;
  ChtSelServices services = Services();
  services.backToChart = [&] { return ++back; };
  Stand(std::make_unique<ChtSel>(std::move(services), nullptr));
  On<QCheckBox>("OAve1")->setFocus();
  PressKey(Qt::Key_Space);
  PressKey(Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(back, 1);
  EXPECT_EQ(closed, 0);
  EXPECT_NE(Kept("AvOne"), "True");
}

TEST_F(ChtSelTest, ShowChartEntersTheCodeThatWasTyped) {
  Open();
  QTest::keyClicks(Text("Text1"), "bhp");
  Press("OK");
  EXPECT_EQ(shown, 1);
  EXPECT_EQ(shownIndex, 3);
}

TEST_F(ChtSelTest, ATypedCodeStaysWhileTypeAndPeriodAreChosenForIt) {
  Open();
  QTest::keyClicks(Text("Text1"), "bhp");
  Choose("Combo4", kWeeklyIndex);
  EXPECT_EQ(TextOf("Text1"), "bhp");
  Choose("Combo1", kCandleIndex);
  PressKey(Qt::Key_H, Qt::AltModifier);
  ASSERT_TRUE(WaitFor([this] { return shown == 1; }));
  EXPECT_EQ(shownIndex, 3);
  EXPECT_EQ(state.ChartPeriod, Period::kWeekly);
  EXPECT_EQ(state.ChartStyle, Style::kCandlestick);
}

TEST_F(ChtSelTest, ShowChartOfACodeThatIsNotThereShowsNone) {
  Open();
  dialogs.answers = {Answer::kNo};
  QTest::keyClicks(Text("Text1"), "qqq");
  Press("OK");
  ExpectSaid("No record on file for that code - Find nearest code ?", "Chart Selection");
  EXPECT_EQ(shown, 0);
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(TextOf("Text1"), "qqq");
  EXPECT_EQ(Focus(), "Text1");
  Press("OK");
  EXPECT_EQ(shown, 0) << "the nearest is shown to be looked at";
  EXPECT_EQ(TextOf("Text1"), "XAO");
}

TEST_F(ChtSelTest, CloseFromTheFramePressesClose) {
  Open();
  form->close();
  EXPECT_EQ(closed, 1);
  EXPECT_FALSE(form->isVisible());
}

TEST_F(ChtSelTest, SetDefaultsTellsItsTask) {
  Open();
  Press("Command7");
  EXPECT_EQ(taskAtDefaults, 777);
}

TEST_F(ChtSelTest, AveragesSwitchedInTheDefaultsShowWithTheirPeriods) {
  Open();
  ASSERT_FALSE(state.Ma1On);
  atDefaults = [this] {
    session->settings.charts.AvOne = true;
    session->settings.charts.Av1D = 33;
  };
  Press("Command7");
  EXPECT_TRUE(state.Ma1On);
  EXPECT_TRUE(On<QCheckBox>("OAve1")->isChecked());
  EXPECT_EQ(On<QCheckBox>("OAve1")->text(), "33");
  EXPECT_FALSE(On<QCheckBox>("OAve2")->isChecked());
}

TEST_F(ChtSelTest, FormsThatAreNotThereLeaveTheirControlsGreyed) {
  ChtSelServices services = Services();
  services.openChtDef = {};
  services.openFinDate = {};
  services.openWMPath = {};
  services.openChtBands = {};
  session->settings.download.DataService = 3;
  Stand(std::make_unique<ChtSel>(services, nullptr));
  for (const char* name : {"Command6", "Command7", "Text6"})
    EXPECT_FALSE(On<QWidget>(name)->isEnabled()) << name;
  Press("Text6");
  EXPECT_EQ(TextOf("Text6"), "LATEST");
  Choose("Combo3", 1);
  EXPECT_EQ(state.BandKind, 1);
}

TEST_F(ChtSelTest, AnotherFolderIsShownFromItsFirstSecurity) {
  session->settings.download.DataService = 3;
  Open();
  PressKey(Qt::Key_PageDown);
  PutNames({Named("NEW", "New folder")});
  folderChanged = false;
  Press("Command6");
  EXPECT_EQ(TextOf("Text1"), "BBB");
  folderChanged = true;
  Press("Command6");
  EXPECT_EQ(TextOf("Text1"), "NEW");
  EXPECT_EQ(TextOf("Text4"), "1");
}

TEST_F(ChtSelTest, ANameFileThatVanishesIsToldAndTheFormStands) {
  Open();
  home.files().Remove("c:\\korawin\\data\\Names.dat");
  PressKey(Qt::Key_PageDown);
  ExpectSaid("There is an unexpected error number 53", "Chart Select");
  EXPECT_TRUE(form->isVisible());
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_EQ(closed, 1);
}

TEST_F(ChtSelTest, FitsASmallScreen) {
  session->settings.download.DataService = 3;
  Open();
  EXPECT_LE(form->width(), 1280);
  EXPECT_LE(form->height(), 800);
}

// ---- Chart2

TEST_F(ChtSelTest, TheSecondChartIsChosenByCodeTypePeriodAndSpacing) {
  Open();
  Press("OK");
  state.DateLimitOn = true;
  state.ChartIndex = 1;
  OpenSecond();
  EXPECT_EQ(Focus(), "Text1");
  EXPECT_EQ(TextOf("Text1"), "AAA");
  Enter("Text1", "xao");
  EXPECT_EQ(Focus(), "OK");
  Choose("Combo1", kLineIndex);
  Choose("Combo4", kMonthlyIndex);
  Type("Text3", "4");
  On<QWidget>("OK")->setFocus();
  const std::string before = Kept("Period");
  PressKey(Qt::Key_Return);
  EXPECT_EQ(shown, 2);
  EXPECT_EQ(shownIndex, 4);
  EXPECT_EQ(state.ChartStyle, Style::kLine);
  EXPECT_EQ(state.ChartPeriod, Period::kMonthly);
  EXPECT_EQ(state.BarSpacing, 4);
  EXPECT_TRUE(state.DateLimitOn);
  EXPECT_EQ(Kept("Period"), before) << "the choice is for this chart";
}

TEST_F(ChtSelTest, LeavingTheSecondChartLeavesTheFirst) {
  state.ChartSelLoaded = true;
  state.ChartIndex = 3;
  state.OscShown = true;
  OpenSecond();
  Choose("Combo1", kPointFigureIndex);
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(shown, 0);
  EXPECT_EQ(closed, 0);
  EXPECT_EQ(state.ChartIndex, 3);
  EXPECT_EQ(state.ChartStyle, Style::kBar);
  EXPECT_TRUE(state.OscShown);
}

}  // namespace
}  // namespace kora
