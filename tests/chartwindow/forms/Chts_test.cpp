#include "chartwindow/forms/Chts.h"

#include <QClipboard>
#include <QDialog>
#include <QFrame>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QToolBar>
#include <QToolButton>

#include "chartwindow/tools/cross_hair.h"
#include "lists/chart_list.h"
#include "tests/support/all_oscillators.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

// The chart window as a window of its own, on the first of three shares.
class ChtsFormTest : public test::FormTest {
 protected:
  void SetUp() override {
    ReadSettings();
    home.files().MakeFolder("c:\\korawin\\chtsave");
  }
  void TearDown() override { delete form.data(); }

  Chts& Open() {
    form = new Chts({.files = session->files,
                     .dialogs = dialogs,
                     .settings = session->settings,
                     .ini = session->ini,
                     .user = session->user,
                     .colours = session->colours,
                     .current = session->current,
                     .state = session->charts,
                     .forms = forms,
                     .pickSaved =
                         [this](const std::string& name) {
                           suggested = name;
                           return save;
                         },
                     .pickToShow = [this] { return show; },
                     .closed = [this] { ++closed; }});
    form->resize(800, 600);
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.data()));
    form->Start();
    form->setFocus();
    return *form;
  }

  PictureBox* Box(const char* name) { return dynamic_cast<PictureBox*>(Find<QWidget>(form, name)); }
  PictureBox* Picture() { return Box("Picture1"); }
  QAction* Entry(const char* name) { return Find<QAction>(form, name); }
  QToolButton* Button(const char* key) { return Find<QToolButton>(form, key); }
  void Press(const char* key) { QTest::mouseClick(Button(key), Qt::LeftButton); }
  void Key(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
    QTest::keyClick(Picture(), key, modifiers);
  }
  std::string Status(int panel) {
    return Find<QLabel>(form, ("StatusBar1(" + std::to_string(panel) + ")").c_str())
        ->text()
        .toStdString();
  }
  QImage Shown(const char* name = "Picture1") { return Box(name)->surface().image().copy(); }
  // A pointer move, as the platform sends it.
  void MoveTo(double x, double y) {
    QMouseEvent move(QEvent::MouseMove, {x, y}, Picture()->mapToGlobal(QPointF(x, y)), Qt::NoButton,
                     Qt::NoButton, Qt::NoModifier);
    QCoreApplication::sendEvent(Picture(), &move);
  }
  std::string shown() { return session->current.PriceFileName; }
  const ChartRequest& request() { return form->window().Request; }
  std::string Saved(const char* name) {
    return home.Get(std::string("drive_c/korawin/chtsave/") + name);
  }

  QPointer<Chts> form;
  std::map<std::string, std::function<void()>> forms;
  std::optional<std::string> save, show;
  std::string suggested;
  int closed = 0;
};

TEST_F(ChtsFormTest, EveryButtonIsThereWithItsToolTipAndAnIconOfItsOwn) {
  Open();
  EXPECT_EQ(Find<QToolBar>(form, "Toolbar1")
                ->findChildren<QToolButton*>(QString(), Qt::FindDirectChildrenOnly)
                .size(),
            kToolButtons + 1)
      << "and the one that opens what has no room";
  std::vector<QImage> icons;
  for (int i = 1; i <= kToolButtons; ++i) {
    QToolButton* button = Button(ToolButtonOf(i).key);
    ASSERT_NE(button, nullptr);
    EXPECT_EQ(button->toolTip().toStdString(), ToolButtonOf(i).tip);
    const QImage icon = button->icon().pixmap(32, 32).toImage();
    ASSERT_FALSE(icon.isNull()) << ToolButtonOf(i).key;
    for (const QImage& other : icons) EXPECT_NE(icon, other) << ToolButtonOf(i).key;
    icons.push_back(icon);
  }
}

// A colour apart enough from both a light and a dark tool bar to be seen on it.
TEST_F(ChtsFormTest, IconsStandOutOnLightAndDark) {
  Open();
  const auto light = [](QRgb c) {
    const auto part = [](int v) {
      const double s = v / 255.0;
      return s <= 0.03928 ? s / 12.92 : std::pow((s + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * part(qRed(c)) + 0.7152 * part(qGreen(c)) + 0.0722 * part(qBlue(c));
  };
  for (const int size : {16, 48})
    for (int i = 1; i <= kToolButtons; ++i) {
      const QImage icon = Button(ToolButtonOf(i).key)
                              ->icon()
                              .pixmap(size, size)
                              .toImage()
                              .convertToFormat(QImage::Format_ARGB32);
      int clear = 0;
      for (int y = 0; y < icon.height(); ++y)
        for (int x = 0; x < icon.width(); ++x) {
          const QRgb pixel = icon.pixel(x, y);
          if (qAlpha(pixel) < 200) continue;
          const double l = light(pixel);
          const double onLight = (light(qRgb(239, 239, 239)) + 0.05) / (l + 0.05);
          const double onDark = (l + 0.05) / (light(qRgb(45, 45, 45)) + 0.05);
          clear += onLight >= 2.5 && onDark >= 2.5;
        }
      EXPECT_GT(clear, size * size / 25) << ToolButtonOf(i).key << " " << size;
    }
}

TEST_F(ChtsFormTest, EveryEntryOfTheMenusIsThereWithItsCaption) {
  Open();
  const std::map<std::string, std::string> captions = {
      {"cmSaveAs", "&Save Chart as"},
      {"cmSSavedCht", "Show Sa&ved Chart"},
      {"cmPageSetup", "Pa&ge Setup"},
      {"cmPrintChart", "&Print Chart"},
      {"cmExit", "&Close"},
      {"cmChtDef", "&Chart Defaults"},
      {"cmStkDetails", "Show &Stock Details"},
      {"cmSuperimpose", "&Superimpose"},
      {"cmSplitScreen", "S&plit Screen"},
      {"cmInd", "&Indicators (reversal)"},
      {"cmChtScroll", "Chart Scroll &Bar"},
      {"cmGridLines", "&Grid Lines"},
      {"cmGLSpaces", "Grid &Line spacing "},
      {"cmText", "&Text"},
      {"cmRText", "&Remove Text"},
      {"cmRemAllTrend", "Remove &All Trendlines"},
      {"cmPFAuto", "Auto &Point and Figure Box Value "},
      {"cmChtSpaces", "&Change Chart Spacing"},
      {"cmInsOuts", "Highlight &Outside days on Bar Chart"},
      {"cmSLInd", "Stop Loss Indicator"},
      {"cmColours", "&Colours"},
      {"cmfonts", "&Fonts"},
      {"cmVHeight", "&Volume Height"},
      {"cmLineWidth", "&Line Width (Printing)"},
      {"cmBSpaces", "&Blank space at end of chart"},
      {"cmLegible", "Legible &Labels"},
      {"cmDirect", "&Directional Movement"},
      {"cmROCFX", "RO&C and  FX"},
      {"cmRMX", "RM&X (Relative Movement - chart data)"},
      {"cmSwing", "Swin&g"},
      {"cmuMOS", "Multi-Oscillator Display Selections"}};
  for (const auto& [name, caption] : captions)
    EXPECT_EQ(Entry(name.c_str())->text().toStdString(), caption);
  for (const char* menu : {"cmFile", "cmTools", "cmOptions", "cmOscillators"})
    EXPECT_NE(Find<QMenu>(form, menu), nullptr);
  EXPECT_EQ(Find<QMenu>(form, "cmOptions")->title(), "O&ptions");
  EXPECT_TRUE(form->menuBar()->isVisible());
}

TEST_F(ChtsFormTest, WhatHasNoFormYetIsGreyed) {
  Open();
  for (const char* name :
       {"cmPageSetup", "cmPrintChart", "cmStkDetails", "cmRText", "cmuSwingsettings", "cmuMOS",
        "cmChtDef", "cmSuperimpose", "cmParaAve", "cmInsOuts", "cmSLInd"})
    EXPECT_FALSE(Entry(name)->isEnabled()) << name;
  for (const char* key : {"mo1", "mo2", "new"}) EXPECT_FALSE(Button(key)->isEnabled()) << key;
  for (const char* name : {"cmSaveAs", "cmSSavedCht", "cmExit", "cmInd", "cmGridLines", "cmPFAuto",
                           "cmMMA", "cmSwing", "cmRelStrength", "cmPara", "cmChtScroll", "cmText",
                           "cmRemAllTrend", "auto", "tline", "terase", "fib", "sZoom"})
    EXPECT_TRUE(Entry(name)->isEnabled()) << name;
  EXPECT_TRUE(Button("pf")->isEnabled());
  form->SetForm("new", [] {});
  form->SetForm("cmChtDef", [] {});
  form->SetForm("cmChtSpaces", [] {});
  EXPECT_TRUE(Button("new")->isEnabled());
  EXPECT_TRUE(Entry("cmChtDef")->isEnabled());
  EXPECT_TRUE(Button("cspace")->isEnabled());
}

TEST_F(ChtsFormTest, TheSwitchesOfTheCommandLineEnableTheirEntries) {
  session->settings.words.OptionXS = session->settings.words.OptionXT = true;
  Open();
  EXPECT_TRUE(Entry("cmParaAve")->isEnabled());
  EXPECT_TRUE(Entry("cmInsOuts")->isEnabled());
  EXPECT_FALSE(Entry("cmSLInd")->isEnabled()) << "no form";
  form->SetForm("cmSLInd", [] {});
  EXPECT_TRUE(Entry("cmSLInd")->isEnabled());
  Entry("cmInsOuts")->trigger();
  EXPECT_TRUE(request().OutsideMarks);
  EXPECT_TRUE(Entry("cmInsOuts")->isChecked());
}

TEST_F(ChtsFormTest, TheToolBarPagesAndChangesTypeAndPeriod) {
  Open();
  EXPECT_EQ(shown(), "AAA.WDT");
  Press("fwd");
  EXPECT_EQ(shown(), "BBB.WDT");
  Press("rev");
  Press("rev");
  EXPECT_EQ(shown(), "CCC.WDT");
  const QImage bars = Shown();
  Press("cstick");
  EXPECT_EQ(request().ChartStyle, Style::kCandlestick);
  Press("wky");
  EXPECT_EQ(request().ChartPeriod, Period::kWeekly);
  Press("lne");
  EXPECT_EQ(request().ChartStyle, Style::kLine);
  EXPECT_NE(Shown(), bars);
  Press("mly");
  EXPECT_EQ(request().ChartPeriod, Period::kMonthly);
  Press("dly");
  Press("bar");
  EXPECT_EQ(shown(), "CCC.WDT");
  EXPECT_EQ(Shown(), bars);
  Press("ref");
  EXPECT_EQ(Shown(), bars);
  for (const char* on : {"bar", "dly"}) EXPECT_TRUE(Button(on)->isChecked()) << on;
  for (const char* off : {"cstick", "lne", "wky", "mly", "ref"})
    EXPECT_FALSE(Button(off)->isChecked()) << off;
}

TEST_F(ChtsFormTest, TheKeysPageAndRefresh) {
  Open();
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "BBB.WDT");
  Key(Qt::Key_PageUp, Qt::ControlModifier);
  Key(Qt::Key_PageUp, Qt::ControlModifier);
  EXPECT_EQ(shown(), "CCC.WDT");
  const QImage before = Shown();
  Picture()->surface().Cls();
  Key(Qt::Key_F5);
  EXPECT_EQ(Shown(), before);
}

TEST_F(ChtsFormTest, LegibleLabelsAreSwitchedInTheOptions) {
  Open();
  EXPECT_TRUE(Entry("cmLegible")->isChecked()) << "a new installation";
  EXPECT_TRUE(request().Legible);
  Entry("cmLegible")->trigger();
  EXPECT_FALSE(Entry("cmLegible")->isChecked());
  EXPECT_FALSE(request().Legible);
  EXPECT_EQ(session->ini.GetSetting("Charts", "Legible"), "False");
  Entry("cmLegible")->trigger();
  EXPECT_TRUE(request().Legible);
  EXPECT_EQ(session->ini.GetSetting("Charts", "Legible"), "True");
}

TEST_F(ChtsFormTest, LegibleLabelsAreOffWhereTheKeyIsMissing) {
  session->settings = {};
  session->ini.PutSetting("Charts", "Legible", "");
  Open();
  EXPECT_FALSE(Entry("cmLegible")->isChecked());
  EXPECT_FALSE(request().Legible);
}

// A wheel's notches over the chart; up is above 0.
class ChtsWheelTest : public ChtsFormTest {
 protected:
  // 900 days to 4 February 2026; a window of them is smaller.
  void SetUp() override {
    ChtsFormTest::SetUp();
    std::vector<PriceRec> days;
    for (int i = 0; i < 900; ++i) {
      const float close = 10.0f + float(i % 7);
      days.push_back(test::Day(FormatFileDate(DateOfDayNumber(DayNumber({2026, 2, 4}) - 899 + i)),
                               close, close + 1, close - 1, close, 1000));
    }
    home.Put("drive_c/korawin/data/AAA.WDT", test::Bytes(days));
    Open();
    wanted = RecordsWanted(request(), form->window().Chart);
    ASSERT_GT(wanted, 50);
    ASSERT_LT(wanted, 800);
  }
  void Wheel(int notches, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
    QWheelEvent event({100, 100}, Picture()->mapToGlobal(QPointF(100, 100)), {},
                      {0, notches * QWheelEvent::DefaultDeltasPerStep}, Qt::NoButton, modifiers,
                      Qt::NoScrollPhase, false);
    QCoreApplication::sendEvent(Picture(), &event);
  }
  void Turn(int notches, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
    Wheel(notches, modifiers);
    QCoreApplication::processEvents();
  }
  int First() { return form->window().Chart.Bars.FirstDataRec; }
  int Last() { return form->window().Chart.Bars.LastDataRec; }
  std::string LastDate() {
    const ChartBars& bars = form->window().Chart.Bars;
    return std::string(bars[size_t(bars.BarCount)].date());
  }
  int wanted = 0;
};

TEST_F(ChtsWheelTest, ANotchIsABarAndWithShiftAMonth) {
  EXPECT_EQ(LastDate(), "20260204");
  Turn(1);
  EXPECT_EQ(LastDate(), "20260203");
  EXPECT_TRUE(session->charts.DateLimitOn);
  Turn(2);
  EXPECT_EQ(LastDate(), "20260201");
  Turn(1, Qt::ShiftModifier);
  EXPECT_EQ(LastDate(), "20260101");
  Turn(-1, Qt::ShiftModifier);
  EXPECT_EQ(LastDate(), "20260201");
  Turn(-3);
  EXPECT_EQ(LastDate(), "20260204");
  EXPECT_FALSE(session->charts.DateLimitOn) << "the newest window has no limit";
  Turn(-1);
  EXPECT_EQ(LastDate(), "20260204");
}

TEST_F(ChtsWheelTest, NotchesThatComeTogetherAreOneMove) {
  for (int i = 0; i < 20; ++i) Wheel(1);
  EXPECT_EQ(LastDate(), "20260204") << "nothing is drawn while they come";
  QCoreApplication::processEvents();
  EXPECT_EQ(LastDate(), "20260115");
}

TEST_F(ChtsWheelTest, WithControlTheSpacingChangesFromOneToTwenty) {
  EXPECT_EQ(request().BarSpacing, 2);
  Turn(1, Qt::ControlModifier);
  EXPECT_EQ(request().BarSpacing, 3);
  Turn(30, Qt::ControlModifier);
  EXPECT_EQ(request().BarSpacing, 20);
  Turn(-30, Qt::ControlModifier);
  EXPECT_EQ(request().BarSpacing, 1);
  EXPECT_EQ(LastDate(), "20260204");
  Press("cstick");
  Turn(-1, Qt::ControlModifier);
  EXPECT_EQ(request().BarSpacing, 1) << "no wider by narrowing";
  Turn(4, Qt::ControlModifier);
  Turn(-30, Qt::ControlModifier);
  EXPECT_EQ(request().BarSpacing, 3) << "a candle needs three";
  Press("pf");
  const QImage boxes = Shown();
  Turn(1, Qt::ControlModifier);
  Turn(1);
  EXPECT_EQ(Shown(), boxes);
}

TEST_F(ChtsWheelTest, HomeAndEndGoToTheOldestAndNewestWindowThePageKeysAWindow) {
  Key(Qt::Key_PageUp);
  EXPECT_EQ(Last(), 900 - wanted);
  Key(Qt::Key_PageDown);
  EXPECT_EQ(Last(), 900);
  Key(Qt::Key_Home);
  EXPECT_EQ(First(), 1);
  EXPECT_EQ(Last(), 1 + wanted);
  Key(Qt::Key_PageUp);
  EXPECT_EQ(Last(), 1 + wanted) << "nothing is older";
  Key(Qt::Key_PageDown);
  EXPECT_EQ(Last(), std::min(900, 1 + 2 * wanted));
  Key(Qt::Key_End);
  EXPECT_EQ(Last(), 900);
  EXPECT_FALSE(session->charts.DateLimitOn);
  EXPECT_EQ(shown(), "AAA.WDT");
}

TEST_F(ChtsWheelTest, TheKeysOfTheMenuDoWhatTheWheelDoes) {
  Key(Qt::Key_Left, Qt::ControlModifier);
  EXPECT_EQ(LastDate(), "20260203");
  Key(Qt::Key_Left, Qt::ControlModifier | Qt::ShiftModifier);
  EXPECT_EQ(LastDate(), "20260103");
  Key(Qt::Key_Right, Qt::ControlModifier | Qt::ShiftModifier);
  EXPECT_EQ(LastDate(), "20260203");
  Key(Qt::Key_Right, Qt::ControlModifier);
  EXPECT_EQ(LastDate(), "20260204");
  Key(Qt::Key_Plus, Qt::ControlModifier);
  EXPECT_EQ(request().BarSpacing, 3);
  Key(Qt::Key_Minus, Qt::ControlModifier);
  EXPECT_EQ(request().BarSpacing, 2);
  EXPECT_FALSE(form->window().ToolOn());
}

TEST_F(ChtsWheelTest, EveryMoveIsInTheMenuWithItsKey) {
  const std::pair<const char*, const char*> entries[] = {{"cmNextChart", "Ctrl+Page Down"},
                                                         {"cmPrevChart", "Ctrl+Page Up"},
                                                         {"cmOldest", "Home"},
                                                         {"cmNewest", "End"},
                                                         {"cmEarlier", "Page Up"},
                                                         {"cmLater", "Page Down"},
                                                         {"cmBarBack", "Wheel"},
                                                         {"cmBarOn", "Wheel"},
                                                         {"cmMonthBack", "Shift+Wheel"},
                                                         {"cmMonthOn", "Shift+Wheel"},
                                                         {"cmWider", "Ctrl+Wheel"},
                                                         {"cmNarrower", "Ctrl+Wheel"}};
  for (const auto& [name, key] : entries) {
    EXPECT_TRUE(Entry(name)->isEnabled()) << name;
    EXPECT_TRUE(Entry(name)->text().section('\t', 1).endsWith(key)) << name;
  }
  Entry("cmBarBack")->trigger();
  EXPECT_EQ(LastDate(), "20260203");
  Entry("cmMonthBack")->trigger();
  EXPECT_EQ(LastDate(), "20260103");
  Entry("cmOldest")->trigger();
  EXPECT_EQ(First(), 1);
  Entry("cmNewest")->trigger();
  EXPECT_EQ(Last(), 900);
  Entry("cmWider")->trigger();
  EXPECT_EQ(request().BarSpacing, 3);
  Entry("cmNextChart")->trigger();
  EXPECT_EQ(shown(), "BBB.WDT");
}

TEST_F(ChtsWheelTest, TheNextChartIsShownToItsNewestDay) {
  Turn(5);
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_FALSE(session->charts.DateLimitOn);
}

TEST_F(ChtsWheelTest, AnOscillatorOfTheMenuMovesWithTheChart) {
  Entry("cmRelStrength")->trigger();
  const QImage panel = Shown("Picture2(0)");
  Turn(40);
  EXPECT_TRUE(Box("Picture2(0)")->isVisible());
  EXPECT_NE(Shown("Picture2(0)"), panel);
}

TEST_F(ChtsWheelTest, AShortFileStaysWhereItIs) {
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  const QImage before = Shown();
  for (const Qt::Key key : {Qt::Key_PageUp, Qt::Key_Home, Qt::Key_PageDown, Qt::Key_End}) Key(key);
  Turn(3);
  Turn(1, Qt::ShiftModifier);
  EXPECT_EQ(Shown(), before);
  EXPECT_FALSE(session->charts.DateLimitOn);
}

TEST_F(ChtsFormTest, TheLegendGoesWhileAPanelIsOpenAndIsNeverOverASavedChart) {
  Open();
  Entry("cmKeepOsc")->trigger();
  Entry("cmInd")->trigger();
  auto* legend = Box("Picture4");
  EXPECT_TRUE(legend->isVisible());
  Entry("cmRelStrength")->trigger();
  EXPECT_FALSE(legend->isVisible());
  Press("ref");
  EXPECT_TRUE(legend->isVisible());
  save = "c:\\korawin\\chtsave\\x.cht";
  Entry("cmSaveAs")->trigger();
  show = save;
  Entry("cmSSavedCht")->trigger();
  EXPECT_TRUE(form->window().ChartFromFile);
  EXPECT_FALSE(legend->isVisible());
  form->resize(form->width() - 20, form->height() - 20);
  QTest::qWait(0);
  EXPECT_FALSE(legend->isVisible());
  Press("ref");
  EXPECT_TRUE(legend->isVisible());
}

TEST_F(ChtsFormTest, TheMenusOpenByTheirKeys) {
  Open();
  for (const auto& [key, name] : {std::pair{Qt::Key_F, "cmFile"},
                                  {Qt::Key_T, "cmTools"},
                                  {Qt::Key_P, "cmOptions"},
                                  {Qt::Key_M, "cmMove"},
                                  {Qt::Key_O, "cmOscillators"}}) {
    Key(key, Qt::AltModifier);
    auto* menu = Find<QMenu>(form, name);
    ASSERT_TRUE(WaitFor([menu = menu] { return menu->isVisible(); })) << name;
    QTest::keyClick(menu, Qt::Key_Escape);
    menu->close();
  }
}

TEST_F(ChtsFormTest, EscapeInAMenuGivesTheKeysBackToTheChart) {
  Open();
  Key(Qt::Key_M, Qt::AltModifier);
  auto* menu = Find<QMenu>(form, "cmMove");
  ASSERT_TRUE(WaitFor([&] { return menu->isVisible(); }));
  QTest::keyClick(menu, Qt::Key_Escape);
  EXPECT_TRUE(WaitFor([&] { return form->focusWidget() == Picture(); }));
}

TEST_F(ChtsFormTest, EnterTakesTheFirstEntryOfAMenuOpenedByItsKey) {
  Open();
  Key(Qt::Key_O, Qt::AltModifier);
  auto* menu = Find<QMenu>(form, "cmOscillators");
  ASSERT_TRUE(WaitFor([&] { return menu->isVisible(); }));
  QTest::keyClick(menu, Qt::Key_Return);
  EXPECT_EQ(session->charts.OscCode, "DM");
}

TEST_F(ChtsFormTest, SuperimposeByItsLetter) {
  Open();
  bool opened = false;
  form->SetForm("cmSuperimpose", [&] { opened = true; });
  EXPECT_FALSE(Entry("cmStkDetails")->isVisible());
  Key(Qt::Key_T, Qt::AltModifier);
  auto* menu = Find<QMenu>(form, "cmTools");
  ASSERT_TRUE(WaitFor([&] { return menu->isVisible(); }));
  QTest::keyClick(menu, Qt::Key_S);
  EXPECT_TRUE(opened);
  form->SetForm("cmStkDetails", [] {});
  EXPECT_TRUE(Entry("cmStkDetails")->isVisible());
}

TEST_F(ChtsFormTest, AnOscillatorByTheKeysAlone) {
  Open();
  Key(Qt::Key_O, Qt::AltModifier);
  auto* menu = Find<QMenu>(form, "cmOscillators");
  ASSERT_TRUE(WaitFor([&] { return menu->isVisible(); }));
  QTest::keyClick(menu, Qt::Key_I);
  EXPECT_EQ(session->charts.OscCode, "RSI");
  EXPECT_TRUE(Box("Picture2(0)")->isVisible());
  EXPECT_GT(Box("Picture2(0)")->y(), Picture()->geometry().bottom());
  EXPECT_EQ(Box("Picture2(0)")->width(), Picture()->width());
}

TEST_F(ChtsFormTest, EveryOscillatorOfTheMenuHasItsPanel) {
  // The compare file of RMO and RMX: any price file.
  session->settings.osc.CompFile = "c:\\korawin\\data\\BBB.WDT";
  for (const OscKey& key : OscKeys()) session->settings.osc[key] = {5, 5};
  Open();
  const std::pair<const char*, const char*> entries[] = {
      {"cmDirect", "DM"},       {"cmCoppock", "COP"},    {"cmElderRay", "ERY"},  {"cmFX", "FX"},
      {"cmJHGrail", "JHG"},     {"cmMacD", "MACD"},      {"cmMomentum", "MOM"},  {"cmOBV", "OBV"},
      {"cmROC", "ROC"},         {"cmROCFX", "R/F"},      {"cmRMO", "RMO"},       {"cmRMX", "RMX"},
      {"cmRelStrength", "RSI"}, {"cmStochastic", "STO"}, {"cmSlowStoch", "STO"}, {"cmVolt", "VTY"},
      {"cmWilliams", "WMS"}};
  QImage before;
  for (const auto& [entry, code] : entries) {
    dialogs.said.clear();
    Entry(entry)->trigger();
    EXPECT_TRUE(dialogs.said.empty())
        << entry << " " << (dialogs.said.empty() ? "" : dialogs.said[0].text);
    EXPECT_EQ(session->charts.OscCode, code);
    ASSERT_TRUE(Box("Picture2(0)")->isVisible()) << entry;
    const QImage now = Shown("Picture2(0)");
    EXPECT_NE(now, before) << entry;
    before = now;
  }
  EXPECT_TRUE((Entry("cmStochastic")->trigger(), !session->charts.SlowStochastic));
  EXPECT_TRUE((Entry("cmSlowStoch")->trigger(), session->charts.SlowStochastic));
  Entry("cmPara")->trigger();
  EXPECT_FALSE(Box("Picture2(0)")->isVisible());
}

TEST_F(ChtsFormTest, TheCrossHairLeavesThePictureItFound) {
  Open();
  Entry("cmRelStrength")->trigger();
  const QImage price = Shown(), panel = Shown("Picture2(0)");
  Press("grid");
  EXPECT_TRUE(Button("grid")->isChecked());
  for (int i = 0; i < 200; ++i)
    MoveTo((i * 97) % Picture()->width(), (i * 41) % Picture()->height());
  MoveTo(200, 150);
  EXPECT_NE(Shown(), price);
  EXPECT_NE(Shown("Picture2(0)"), panel);
  QTest::mouseClick(Picture(), Qt::LeftButton, {}, QPoint(200, 150));
  EXPECT_EQ(Shown(), price);
  EXPECT_EQ(Shown("Picture2(0)"), panel);
  EXPECT_FALSE(Button("grid")->isChecked());
}

// At any scale of the screen, between whole numbers too.
TEST(CrossHairOnPixels, LeavesThePictureItFoundAtEveryScale) {
  for (const double dpr : {1.0, 1.25, 1.5, 2.0, 3.0}) {
    QtRasterSurface price(400, 300, dpr), panel(400, 100, dpr);
    panel.SetScale(0, 0, 400, 144);
    std::uint32_t seed = 7;
    for (int i = 0; i < 400; ++i) {
      const auto next = [&](int range) {
        seed = seed * 1664525u + 1013904223u;
        return double(seed >> 8) / 7 - std::floor(double(seed >> 8) / 7 / range) * range;
      };
      price.Line(next(400), next(300), next(400), next(300), Colour(seed & 0xFFFFFF));
      panel.Line(next(400), next(144), next(400), next(144), Colour(seed & 0xFFFFFF));
    }
    const QImage priceBefore = price.image().copy(), panelBefore = panel.image().copy();
    CrossHair cross(price, &panel, 0xC0A0FF);
    const CrossLimits limits{42, 390, 10, 280, true, 3, 141};
    for (int i = 0; i < 300; ++i) cross.Move((i * 97) % 420, (i * 41) % 310, limits);
    ASSERT_TRUE(cross.Move(200, 150, limits));
    EXPECT_NE(price.image(), priceBefore) << dpr;
    EXPECT_NE(panel.image(), panelBefore) << dpr;
    cross.Erase();
    EXPECT_EQ(price.image(), priceBefore) << dpr;
    EXPECT_EQ(panel.image(), panelBefore) << dpr;
  }
}

TEST_F(ChtsFormTest, TheWidgetShowsThePictureOfTheSurfacePixelByPixel) {
  Open();
  Press("grid");
  for (const QPoint at : {QPoint(100, 100), QPoint(333, 222), QPoint(250, 300)}) {
    MoveTo(at.x(), at.y());
    QCoreApplication::processEvents();
    EXPECT_EQ(Picture()->grab().toImage().convertToFormat(QImage::Format_RGB32), Shown());
  }
}

TEST_F(ChtsFormTest, AMouseMoveShowsTheBarAndPaintsOnlyTheLines) {
  struct Watch : QObject {
    QRegion painted;
    bool eventFilter(QObject*, QEvent* e) override {
      if (e->type() == QEvent::Paint) painted += static_cast<QPaintEvent*>(e)->region();
      return false;
    }
  } watch;
  Open();
  Press("grid");
  MoveTo(100, 100);
  QCoreApplication::processEvents();
  Picture()->installEventFilter(&watch);
  MoveTo(102, 104);
  QCoreApplication::processEvents();
  qint64 area = 0;
  for (const QRect& r : watch.painted) area += qint64(r.width()) * r.height();
  EXPECT_GT(area, 0);
  EXPECT_LT(area, qint64(Picture()->width()) * Picture()->height() / 10);
  EXPECT_FALSE(watch.painted.contains(QPoint(400, 50)));
  // The third share of the fixture's days: column (x - left) / spacing.
  const auto& chart = form->window().Chart;
  MoveTo(chart.ChartLeft + 2 * chart.BarSpacing, 200);
  EXPECT_EQ(Status(2), "GRID");
  EXPECT_EQ(Status(3), "03-02-26");
  // 10 + (3 * 'A') % 7 is 16.
  EXPECT_EQ(Status(4), "Open  16.00");
  EXPECT_EQ(Status(5), "High  17.00");
  EXPECT_EQ(Status(6), "Low  15.00");
  EXPECT_EQ(Status(7), "Close  16.00");
  MoveTo(2, 2);
  EXPECT_EQ(Status(3), "");
}

TEST_F(ChtsFormTest, TheCrossHairByTheKeysAlone) {
  Open();
  const QImage before = Shown();
  Key(Qt::Key_Left);
  EXPECT_EQ(Status(3), "28-02-26");
  Key(Qt::Key_Left);
  EXPECT_EQ(Status(3), "27-02-26");
  Key(Qt::Key_Right);
  EXPECT_EQ(Status(3), "28-02-26");
  Key(Qt::Key_Home);
  EXPECT_EQ(Status(3), "01-02-26");
  Key(Qt::Key_End);
  EXPECT_EQ(Status(3), "28-02-26");
  EXPECT_NE(Shown(), before);
  Key(Qt::Key_Escape);
  EXPECT_EQ(Shown(), before);
  EXPECT_FALSE(form->window().GridOn());
  EXPECT_EQ(Status(3), "");
}

TEST_F(ChtsFormTest, AnotherSizeKeepsTheOscillatorOnShow) {
  Open();
  Entry("cmRelStrength")->trigger();
  form->resize(700, 520);
  form->resize(720, 540);
  form->resize(740, 560);
  const auto ready = [&] {
    return form->window().Chart.ChartRight > Picture()->width() - 40 && Picture()->width() < 742;
  };
  ASSERT_TRUE(WaitFor(ready));
  QCoreApplication::processEvents();
  EXPECT_TRUE(Box("Picture2(0)")->isVisible());
  EXPECT_EQ(shown(), "AAA.WDT");
  EXPECT_EQ(Picture()->surface().Width(), Picture()->width());
  EXPECT_GT(Shown("Picture2(0)").height(), 50);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChtsFormTest, TheCrossHairDoesNotStainANewSize) {
  Open();
  Press("grid");
  MoveTo(200, 200);
  const auto right = form->window().Chart.ChartRight;
  form->resize(700, 520);
  ASSERT_TRUE(WaitFor([&] { return form->window().Chart.ChartRight < right; }));
  QCoreApplication::processEvents();
  Key(Qt::Key_Escape);
  const QImage picture = Shown();
  Press("ref");
  EXPECT_EQ(Shown(), picture);
}

TEST_F(ChtsFormTest, TheLegendStandsAtTheRightOfABarChart) {
  Open();
  auto* legend = Box("Picture4");
  EXPECT_FALSE(legend->isVisible());
  Entry("cmInd")->trigger();
  EXPECT_TRUE(Entry("cmInd")->isChecked());
  EXPECT_TRUE(legend->isVisible());
  EXPECT_EQ(legend->size(), QSize(113, 77));
  EXPECT_EQ(legend->geometry().right(), Picture()->geometry().right());
  Press("cstick");
  EXPECT_FALSE(legend->isVisible());
}

TEST_F(ChtsFormTest, TheTicksFollowTheirSwitches) {
  Open();
  // The settings of a new installation draw grid lines.
  EXPECT_TRUE(Entry("cmGridLines")->isChecked());
  Entry("cmGridLines")->trigger();
  EXPECT_FALSE(Entry("cmGridLines")->isChecked());
  EXPECT_EQ(session->ini.GetSetting("Charts", "Grid"), "False");
  Entry("cmMMA")->trigger();
  EXPECT_TRUE(Entry("cmMMA")->isChecked());
  EXPECT_TRUE(Entry("cmPFAuto")->isChecked());
  Entry("cmPFAuto")->trigger();
  EXPECT_FALSE(Entry("cmPFAuto")->isChecked());
  EXPECT_EQ(shown(), "BBB.WDT");
}

TEST_F(ChtsFormTest, TheDateLimitStepsByItsButtons) {
  ChartState& state = session->charts;
  Open();
  EXPECT_FALSE(Find<QFrame>(form, "Frame1")->isVisible());
  state.DateLimitOn = true;
  state.ChosenLimitText = "15/02/2026";
  state.ChosenLimitDate = "20260215";
  Press("ref");
  EXPECT_TRUE(Find<QFrame>(form, "Frame1")->isVisible());
  EXPECT_EQ(Status(1), "Date Limit ON");
  Click(form, "Command31(0)");
  EXPECT_EQ(state.DateLimitText, "16/02/2026");
  EXPECT_EQ(form->window().Chart.Bars.BarCount, 15);
  auto* week = Find<QPushButton>(form, "Command31(4)");
  week->setFocus();
  QTest::keyClick(week, Qt::Key_Space);
  EXPECT_EQ(state.DateLimitText, "09/02/2026");
  Click(form, "Command31(2)");
  EXPECT_EQ(state.DateLimitText, "09/03/2026");
}

TEST_F(ChtsFormTest, TheFrameIsDraggedAndStaysWithinReach) {
  ChartState& state = session->charts;
  Open();
  state.DateLimitOn = true;
  state.ChosenLimitText = "15/02/2026";
  state.ChosenLimitDate = "20260215";
  Press("ref");
  auto* frame = Find<QFrame>(form, "Frame1");
  const auto drag = [&](QPoint to) {
    const QPoint grip(3, 3);
    const auto send = [&](QEvent::Type type, QPoint at, Qt::MouseButtons buttons) {
      QMouseEvent e(type, at, frame->mapToGlobal(at), Qt::LeftButton, buttons, Qt::NoModifier);
      QCoreApplication::sendEvent(frame, &e);
    };
    send(QEvent::MouseButtonPress, grip, Qt::LeftButton);
    send(QEvent::MouseMove, frame->mapFrom(frame->parentWidget(), to), Qt::LeftButton);
    send(QEvent::MouseButtonRelease, frame->mapFrom(frame->parentWidget(), to), Qt::NoButton);
  };
  drag({400, 200});
  const double halfWidth = frame->width() / 2.0, halfHeight = frame->height() / 2.0;
  EXPECT_EQ(session->UserSetting("BDFrame"), Str(200 + halfHeight) + "," + Str(400 - halfWidth));
  EXPECT_NEAR(frame->x(), 400 - halfWidth, 1);
  EXPECT_NEAR(frame->y(), 200 + halfHeight, 1);
  drag({795, 5000});
  EXPECT_TRUE(frame->parentWidget()->rect().contains(frame->geometry()));
  session->SaveUserSetting("BDFrame", "-900,90000");
  delete form.data();
  Open();
  Press("ref");
  frame = Find<QFrame>(form, "Frame1");
  EXPECT_TRUE(frame->parentWidget()->rect().contains(frame->geometry()));
}

TEST_F(ChtsFormTest, AChartIsSavedAndShown) {
  Open();
  const QImage picture = Shown();
  save = "c:\\korawin\\chtsave\\a.cht";
  Key(Qt::Key_S, Qt::ControlModifier);
  EXPECT_EQ(suggested, "AAA.cht");
  EXPECT_EQ(dialogs.said.back().text, " CHART SAVED ");
  EXPECT_EQ(Saved("a.cht"), home.Get("drive_c/korawin/data/TCht.Tmp"));
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_NE(Shown(), picture);
  show = save;
  Entry("cmSSavedCht")->trigger();
  EXPECT_TRUE(form->window().ChartFromFile);
  const QImage played = Shown();
  EXPECT_NE(played, picture) << "what is for the screen alone is not in the file";
  form->resize(780, 580);
  ASSERT_TRUE(WaitFor([&] {
    return Picture()->surface().Width() < 780 && !Shown().isNull() && form->window().ChartFromFile;
  }));
  Key(Qt::Key_F5);
  EXPECT_FALSE(form->window().ChartFromFile);
  EXPECT_EQ(shown(), "BBB.WDT");
}

TEST_F(ChtsFormTest, ACancelledDialogChangesNothing) {
  Open();
  const QImage picture = Shown();
  Entry("cmSaveAs")->trigger();
  Entry("cmSSavedCht")->trigger();
  EXPECT_EQ(Shown(), picture);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChtsFormTest, PicturesHoldBothPanesAndLeaveTheScript) {
  Open();
  Entry("cmRelStrength")->trigger();
  const std::string script = home.Get("drive_c/korawin/data/TCht.Tmp");
  const std::pair<const char*, const char*> kinds[] = {
      {"a.png", "\x89PNG"}, {"a.svg", "<?xml"}, {"a.PDF", "%PDF-"}};
  for (const auto& [name, start] : kinds) {
    save = std::string("c:\\korawin\\chtsave\\") + name;
    Entry("cmSaveAs")->trigger();
    EXPECT_EQ(dialogs.said.back().text, " CHART SAVED ") << name;
    EXPECT_EQ(Saved(name).find(start), 0u) << name;
  }
  EXPECT_EQ(home.Get("drive_c/korawin/data/TCht.Tmp"), script);
  const QImage png = QImage::fromData(QByteArray::fromStdString(Saved("a.png")));
  const int height = Picture()->height() + Box("Picture2(0)")->height();
  EXPECT_EQ(png.size(), QSize(2 * Picture()->width(), 2 * height));
  EXPECT_NE(Saved("a.svg").find("AAA"), std::string::npos);
}

TEST_F(ChtsFormTest, ThePictureIsCopiedWithoutTheCrossHair) {
  Open();
  Entry("cmRelStrength")->trigger();
  Key(Qt::Key_C, Qt::ControlModifier);
  const QImage plain = QGuiApplication::clipboard()->image();
  ASSERT_EQ(plain.height(), Shown().height() + Shown("Picture2(0)").height());
  Press("grid");
  MoveTo(200, 200);
  const QImage withCross = Shown();
  Key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(QGuiApplication::clipboard()->image(), plain);
  EXPECT_EQ(Shown(), withCross);
}

TEST_F(ChtsFormTest, TheFormsOfOthersOpenByTheirEntries) {
  std::vector<std::string> opened;
  for (const char* name : {"new", "cmChtDef", "cmColours", "cmfonts", "cmVHeight", "cmLineWidth",
                           "cmBSpaces", "cmGLSpaces", "cmChtSpaces", "cmMMASet"})
    forms[name] = [&opened, name] { opened.push_back(name); };
  forms["cmColours"] = [&] {
    opened.push_back("cmColours");
    EXPECT_EQ(session->charts.ChartTask, kTaskColours);
    form->Refresh();
  };
  Open();
  for (const char* name : {"cmChtDef", "cmColours", "cmfonts", "cmVHeight", "cmLineWidth",
                           "cmBSpaces", "cmGLSpaces", "cmChtSpaces", "cmMMASet"}) {
    Entry(name)->trigger();
    ASSERT_FALSE(opened.empty());
    EXPECT_EQ(opened.back(), name);
  }
  Press("cspace");
  EXPECT_EQ(opened.back(), "cmChtSpaces");
  Press("new");
  EXPECT_EQ(opened.back(), "new");
  const size_t before = opened.size();
  session->charts.ChartStyle = Style::kPointFigure;
  Press("cspace");
  EXPECT_EQ(opened.size(), before) << "point and figure has no spaces";
}

TEST_F(ChtsFormTest, ChartSelectionShowsItsChartThroughTheWindow) {
  forms["new"] = [this] {
    session->charts.ChartIndex = 3;
    session->charts.ChartStyle = Style::kLine;
    form->ShowChosen();
  };
  Open();
  Press("new");
  EXPECT_EQ(shown(), "CCC.WDT");
  EXPECT_EQ(request().ChartStyle, Style::kLine);
}

TEST_F(ChtsFormTest, TheSecondOfAPairIsAskedForOnceTheFirstStands) {
  int asked = 0;
  forms["Chart2"] = [this, &asked] {
    ++asked;
    ++session->charts.ChartIndex;
    form->ShowChosen();
  };
  Open();
  const QImage one = Shown();
  Entry("cmSplitScreen")->trigger();
  ASSERT_TRUE(WaitFor([&] { return asked == 1; }));
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(form->window().arrangement(), Arrangement::kSplit);
  const QImage pair = Shown();
  EXPECT_NE(pair, one);
  save = "c:\\korawin\\chtsave\\pair.png";
  Entry("cmSaveAs")->trigger();
  EXPECT_EQ(dialogs.said.back().text, " CHART SAVED ");
  Entry("cmSuperimpose")->trigger();
  ASSERT_TRUE(WaitFor([&] { return asked == 2; }));
  EXPECT_EQ(form->window().arrangement(), Arrangement::kSuperimposed);
  EXPECT_EQ(shown(), "CCC.WDT");
  form->grab();  // lays out what is hidden too
  QCoreApplication::processEvents();
  EXPECT_EQ(form->window().arrangement(), Arrangement::kSuperimposed) << "the pair stays";
}

TEST_F(ChtsFormTest, WhileAMessageStandsNothingElseStarts) {
  struct Nosy : test::ScriptedDialogs {
    std::function<void()> meanwhile;
    void Message(std::string_view text, std::string_view title) override {
      test::ScriptedDialogs::Message(text, title);
      if (meanwhile) meanwhile();
    }
  } nosy;
  Open();
  delete form.data();
  form = new Chts({.files = session->files,
                   .dialogs = nosy,
                   .settings = session->settings,
                   .ini = session->ini,
                   .user = session->user,
                   .colours = session->colours,
                   .current = session->current,
                   .state = session->charts});
  form->resize(800, 600);
  form->show();
  QCoreApplication::processEvents();
  form->Start();
  session->files.Remove("c:\\korawin\\data\\BBB.WDT");
  nosy.meanwhile = [this] {
    for (int i = 0; i < 3; ++i) Key(Qt::Key_PageDown, Qt::ControlModifier);
    Entry("cmRelStrength")->trigger();
    form->resize(700, 500);
    QCoreApplication::processEvents();
    form->close();
  };
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(nosy.said.size(), 1u);
  ASSERT_TRUE(form) << "it outlives its message";
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(session->charts.ChartIndex, 2);
  nosy.meanwhile = nullptr;
  QCoreApplication::processEvents();
  EXPECT_EQ(nosy.said.size(), 1u) << "the size that came meanwhile does not tell it again";
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "CCC.WDT");
}

TEST_F(ChtsFormTest, AChartThatFailedIsTriedAgainAtAnotherSize) {
  Open();
  const std::string prices = home.Get("drive_c/korawin/data/BBB.WDT");
  session->files.Remove("c:\\korawin\\data\\BBB.WDT");
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  ASSERT_EQ(dialogs.said.size(), 1u);
  form->resize(700, 520);
  QCoreApplication::processEvents();
  form->resize(720, 540);
  QCoreApplication::processEvents();
  EXPECT_EQ(dialogs.said.size(), 1u) << "it does not say so again at every size";
  EXPECT_FALSE(form->window().Chart.ChartDrawn);
  home.Put("drive_c/korawin/data/BBB.WDT", prices);
  form->resize(740, 560);
  ASSERT_TRUE(WaitFor([&] { return form->window().Chart.ChartDrawn; }));
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(ChtsFormTest, ANameFileThatShrinksOrVanishesWhilePagingIsTold) {
  Open();
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  home.Put("drive_c/korawin/data/Names.dat",
           test::Bytes(std::vector<NameRec>{test::Security("BBB")}).substr(0, 95));
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, " There are no records in Names.Dat for this folder.");
  session->files.Remove("c:\\korawin\\data\\Names.dat");
  Key(Qt::Key_PageUp, Qt::ControlModifier);
  EXPECT_EQ(dialogs.said.size(), 2u);
  home.Put("drive_c/korawin/data/Names.dat",
           test::Bytes(std::vector<NameRec>{test::Security("BBB")}));
  Key(Qt::Key_PageDown, Qt::ControlModifier);
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(dialogs.said.size(), 2u);
}

TEST_F(ChtsFormTest, CloseEndsTheWindowAndItsModes) {
  Open();
  Press("grid");
  session->charts.PFAutoBox = true;
  Entry("cmExit")->trigger();
  ASSERT_TRUE(WaitFor([&] { return form.isNull(); }));
  EXPECT_EQ(closed, 1);
  EXPECT_FALSE(session->charts.PFAutoBox);
}

// ---- Drawing by mouse and keys

class ChtsToolsTest : public ChtsFormTest {
 protected:
  QWidget* Lower() { return Find<QWidget>(form, "Picture2(0)"); }
  void Mouse(QWidget* on, QEvent::Type type, QPoint at, Qt::MouseButton button,
             Qt::MouseButtons held) {
    QMouseEvent event(type, at, on->mapToGlobal(at), button, held, Qt::NoModifier);
    QCoreApplication::sendEvent(on, &event);
  }
  void ClickAt(QWidget* on, QPoint at, Qt::MouseButton button = Qt::LeftButton) {
    Mouse(on, QEvent::MouseMove, at, Qt::NoButton, Qt::NoButton);
    Mouse(on, QEvent::MouseButtonPress, at, button, button);
    Mouse(on, QEvent::MouseButtonRelease, at, button, Qt::NoButton);
  }
  std::string Drawn() const { return home.Get("drive_c/korawin/data/ChtLns.Tmp"); }
};

TEST_F(ChtsToolsTest, ALineIsDrawnByTwoClicksAndDeletedByTheRightButton) {
  home.files().MakeFolder("c:\\korawin\\chtmisc");
  Open();
  dialogs.answers = {Answer::kYes};
  Press("tline");
  EXPECT_TRUE(Button("tline")->isChecked());
  const auto& chart = form->window().Chart;
  const int left = chart.ChartLeft + 2 * chart.BarSpacing;
  ClickAt(Picture(), {left, 200});
  const QImage before = Shown();
  Mouse(Picture(), QEvent::MouseMove, {left + 100, 150}, Qt::NoButton, Qt::NoButton);
  EXPECT_NE(Shown(), before);
  ClickAt(Picture(), {left + 100, 150});
  EXPECT_EQ(dialogs.said.back().text, "Save Trendline");
  EXPECT_FALSE(Button("tline")->isChecked());
  const std::string file = "drive_c/korawin/chtmisc/AAA.TND";
  ASSERT_EQ(home.Get(file).size(), 27u);
  EXPECT_NE(home.Get(file)[0], 0);
  bool shown = false;
  QTimer::singleShot(0, form, [&] {
    auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
    ASSERT_NE(menu, nullptr);
    shown = menu->objectName() == "smTrend";
    EXPECT_EQ(Find<QAction>(menu, "smMove")->text(), "&Move");
    EXPECT_EQ(Find<QAction>(menu, "smDelete")->text(), "&Delete");
    menu->setActiveAction(Find<QAction>(menu, "smDelete"));
    QTest::keyClick(menu, Qt::Key_Return);
  });
  Mouse(Picture(), QEvent::MouseButtonPress, {left + 50, 175}, Qt::RightButton, Qt::RightButton);
  EXPECT_TRUE(shown);
  ASSERT_EQ(home.Get(file).size(), 27u);
  EXPECT_EQ(home.Get(file)[0], 0) << "an empty slot";
  // Nothing that an eye could see is left of it where there was nothing else.
  const QImage after = Shown();
  const QRgb ground = QtSurface::Rgb(session->colours[kBackground]);
  int traces = 0;
  for (int y = 0; y < after.height(); ++y)
    for (int x = 0; x < after.width(); ++x) {
      if ((before.pixel(x, y) | 0xFF000000) != ground) continue;
      const QRgb now = after.pixel(x, y);
      traces += std::abs(qRed(now) - qRed(ground)) > 12 ||
                std::abs(qGreen(now) - qGreen(ground)) > 12 ||
                std::abs(qBlue(now) - qBlue(ground)) > 12;
    }
  EXPECT_EQ(traces, 0);
}

TEST_F(ChtsToolsTest, AToolThatAButtonPutsOnByKeyHasTheKeys) {
  Open();
  Button("tline")->setFocus();
  QTest::keyClick(Button("tline"), Qt::Key_Space);
  EXPECT_TRUE(Button("tline")->isChecked());
  EXPECT_TRUE(Picture()->hasFocus());
}

TEST_F(ChtsToolsTest, ABandThatIsGivenUpLeavesThePictureItFound) {
  Open();
  const QImage before = Shown();
  for (const char* tool : {"tline", "sZoom"}) {
    Press(tool);
    Mouse(Picture(), QEvent::MouseButtonPress, {100, 200}, Qt::LeftButton, Qt::LeftButton);
    if (std::string(tool) == "tline")
      Mouse(Picture(), QEvent::MouseButtonRelease, {100, 200}, Qt::LeftButton, Qt::NoButton);
    for (int i = 0; i < 30; ++i)
      Mouse(Picture(), QEvent::MouseMove, {60 + i * 13, 80 + (i * 37) % 200}, Qt::NoButton,
            Qt::NoButton);
    EXPECT_NE(Shown(), before) << tool;
    Key(Qt::Key_Escape);
    EXPECT_EQ(Shown(), before) << tool;
  }
}

TEST_F(ChtsToolsTest, ByTheKeysAlone) {
  home.files().MakeFolder("c:\\korawin\\chtmisc");
  Open();
  dialogs.answers = {Answer::kYes};
  Press("tline");
  Key(Qt::Key_Home);
  Key(Qt::Key_Right);
  Key(Qt::Key_Return);
  for (int i = 0; i < 4; ++i) Key(Qt::Key_Right);
  Key(Qt::Key_Up, Qt::ShiftModifier);
  Key(Qt::Key_Return);
  EXPECT_EQ(home.Get("drive_c/korawin/chtmisc/AAA.TND").size(), 27u);

  Entry("cmText")->trigger();
  Key(Qt::Key_End);
  Key(Qt::Key_Return);
  EXPECT_EQ(form->windowTitle(), "Text - Enter text required - Press ENTER to Save");
  for (const char c : {'H', 'i'}) QTest::keyClick(Picture(), c);
  Key(Qt::Key_PageDown);
  EXPECT_EQ(shown(), "AAA.WDT") << "the text has the keys";
  Key(Qt::Key_Backspace);
  Key(Qt::Key_Return);
  EXPECT_NE(home.Get("drive_c/korawin/chtmisc/AAA.Txt").find(",H,"), std::string::npos);
  EXPECT_TRUE(form->windowTitle().contains("CHARTS"));

  Press("fib");
  Key(Qt::Key_Home);
  Key(Qt::Key_Return);
  Key(Qt::Key_Up, Qt::ShiftModifier);
  Key(Qt::Key_Up, Qt::ShiftModifier);
  Key(Qt::Key_Return);
  EXPECT_TRUE(Drawn().find("\nD,") != std::string::npos || Drawn().starts_with("D,"));
  EXPECT_TRUE(Find<QLabel>(form, "StatusBar1(8)")->text().startsWith("62%    "));
  EXPECT_EQ(Find<QLabel>(form, "StatusBar1(8)")->width(),
            Find<QLabel>(form, "StatusBar1(7)")->width());
}

TEST_F(ChtsToolsTest, ADraggedBoxOpensTheZoom) {
  Open();
  Press("sZoom");
  bool opened = false;
  QTimer::singleShot(0, form, [&] {
    auto* zoom = qobject_cast<QDialog*>(QApplication::activeModalWidget());
    ASSERT_NE(zoom, nullptr);
    opened = zoom->objectName() == "ZoomKora" && zoom->windowTitle() == "Zoom";
    auto* picture = Find<PictureBox>(zoom, "Picture1");
    const QImage& image = picture->surface().image();
    int ink = 0;
    for (int y = 0; y < image.height(); ++y)
      for (int x = 0; x < image.width(); ++x)
        ink += image.pixel(x, y) != image.pixel(0, image.height() - 1);
    EXPECT_GT(ink, 1000);
    zoom->reject();
  });
  const int left = form->window().Chart.ChartLeft;
  Mouse(Picture(), QEvent::MouseButtonPress, {left + 5, 60}, Qt::LeftButton, Qt::LeftButton);
  Mouse(Picture(), QEvent::MouseMove, {left + 30, 300}, Qt::NoButton, Qt::LeftButton);
  Mouse(Picture(), QEvent::MouseButtonRelease, {left + 40, 300}, Qt::LeftButton, Qt::NoButton);
  EXPECT_TRUE(opened);
  EXPECT_FALSE(Button("sZoom")->isChecked());
  EXPECT_EQ(shown(), "AAA.WDT");
}

TEST_F(ChtsToolsTest, TheScrollBarNeedsMoreThanAHundredDays) {
  Open();
  Entry("cmChtScroll")->trigger();
  EXPECT_EQ(dialogs.said.back().text, "Too few records to show scroll bar");
  EXPECT_EQ(dialogs.said.back().title, "Chart Scroll");
}

TEST_F(ChtsToolsTest, TheWalkShowsItsCaptionUntilItsButton) {
  Open();
  dialogs.replies = {"1"};
  Press("auto");
  EXPECT_TRUE(Button("auto")->isChecked());
  auto* caption = Find<QLabel>(form, "Label1");
  EXPECT_TRUE(caption->isVisible());
  EXPECT_EQ(caption->text(), "AUTOMATIC SCROLL - TO STOP click AUTO");
  EXPECT_EQ(form->window().view().AutoScroll, 1000);
  Press("auto");
  EXPECT_FALSE(caption->isVisible());
  EXPECT_FALSE(Button("auto")->isChecked());
}

}  // namespace
}  // namespace kora
