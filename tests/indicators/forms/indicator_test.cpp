// The forms of oscillators and overlays.

#include <QCheckBox>
#include <QRadioButton>

#include "indicators/forms/ChtBands.h"
#include "indicators/forms/ChtDef.h"
#include "indicators/forms/MMASet.h"
#include "indicators/forms/OscFrm.h"
#include "indicators/forms/StpLs.h"
#include "indicators/forms/SwingSet.h"
#include "tests/support/all_oscillators.h"
#include "tests/support/qt/look_fixture.h"

namespace kora {
namespace {

const char* const kCompareFile = "c:\\korawin\\data\\ALODB.WDT";

// ---- OscFrm

class OscForm : public test::LookFormTest {
 protected:
  OscForm() {
    home.Put("drive_c/korawin/data/ALODB.WDT", "");
    WriteDefaultOscPeriods(ini);
    ReadOscPeriods(ini, settings.osc);
  }
  void Open(const char* code, Period period = Period::kDaily, Style style = Style::kBar) {
    form = std::make_unique<OscFrm>(OscFrmServices{.files = home.files(),
                                                   .dialogs = dialogs,
                                                   .settings = settings,
                                                   .chartPeriod = period,
                                                   .chartStyle = style,
                                                   .boxValue = boxValue,
                                                   .redraw = [this] { ++saved; }},
                                    code, nullptr);
    Show();
  }
  std::vector<QString> Labels() {
    std::vector<QString> texts;
    for (const QLabel* label : form->findChildren<QLabel*>()) texts.push_back(label->text());
    return texts;
  }
  float boxValue = 0.125f;
};

TEST_F(OscForm, CaptionAndFieldsAreThoseOfTheOscillator) {
  Open("R/F");
  EXPECT_EQ(form->windowTitle(), "ROC & FX");
  EXPECT_EQ(Labels(), (std::vector<QString>{"Period F", "Period X", "Period ROC", "ROC Ave"}));
  EXPECT_EQ(Text("Text1")->text(), "50");
  EXPECT_EQ(Text("Text4")->text(), "10");
  EXPECT_FALSE(form->findChild<QLineEdit*>("Text5"));
  Open("RMX");
  EXPECT_EQ(Labels(), (std::vector<QString>{"Period RMX", "RMX Ave", "Compare to:"}));
  EXPECT_EQ(Text("Text1")->maxLength(), 4);
  EXPECT_EQ(Text("Text5")->maxLength(), 100);
}

TEST_F(OscForm, EmptySettingsGetTheDefaultsOfThePeriodOnShowOnly) {
  settings.osc = {};
  Open("RMX");
  EXPECT_EQ(Text("Text1")->text(), "100");
  EXPECT_EQ(settings.osc[kRmxP].daily, 100);
  EXPECT_EQ(settings.osc[kRmxP].twin, 0);
  Open("RMX", Period::kWeekly);
  EXPECT_EQ(Text("Text1")->text(), "50");
  EXPECT_EQ(settings.osc[kRmxP].twin, 50);
}

TEST_F(OscForm, PeriodsGoToThePeriodOnShowAndTheChartIsRedrawn) {
  Open("STO", Period::kMonthly);
  Type("Text1", "77");
  Type("Text2", "0");
  Click("Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(settings.osc[kStochK].twin, 77);
  EXPECT_EQ(settings.osc[kStochD].twin, 0);
  EXPECT_EQ(settings.osc[kStochK].daily, 10);
  EXPECT_EQ(saved, 1);
  EXPECT_EQ(Osc("StochKW"), "10") << "for this run only";
}

TEST_F(OscForm, PeriodsOutOfRangeAreToldAndTheBoxStays) {
  Open("STO");
  const std::pair<const char*, const char*> bads[] = {{"0", "5"},    {"201", "5"},  {"-1", "5"},
                                                      {"text", "5"}, {"10", "201"}, {"10", "-1"}};
  for (const auto& [k, d] : bads) {
    Type("Text1", k);
    Type("Text2", d);
    Click("Command1");
    const auto said = Told();
    EXPECT_EQ(said.text, " Periods must be between 1 - 200 ") << k << " " << d;
    EXPECT_EQ(said.title, "Oscillator Values");
    EXPECT_TRUE(form->isVisible());
    EXPECT_EQ(Focused(), std::string(k) == "10" ? "Text2" : "Text1");
  }
  EXPECT_EQ(settings.osc[kStochK].daily, 10);
  Type("Text1", "200");
  Type("Text2", "200");
  Click("Command1");
  EXPECT_EQ(settings.osc[kStochK].daily, 200);
  EXPECT_EQ(saved, 1);
}

TEST_F(OscForm, EnterGoesToTheNextBoxThenToTheButton) {
  Open("MACD");
  EXPECT_EQ(Focused(), "Text1");
  QTest::keyClicks(QApplication::focusWidget(), "5");
  for (const char* next : {"Text2", "Text3", "Command1"}) {
    Press(Qt::Key_Return);
    EXPECT_EQ(Focused(), next);
    EXPECT_TRUE(form->isVisible());
    QApplication::processEvents();
    if (auto* field = qobject_cast<QLineEdit*>(QApplication::focusWidget())) {
      EXPECT_EQ(field->selectedText(), field->text());
    }
  }
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(settings.osc[kMd1].daily, 5);
}

TEST_F(OscForm, ABoxEnteredByTheMouseHasItsTextSelected) {
  Open("FX");
  QTest::mouseClick(Text("Text2"), Qt::LeftButton);
  QApplication::processEvents();
  EXPECT_EQ(Text("Text2")->selectedText(), "25");
  QTest::keyClicks(Text("Text2"), "9");
  EXPECT_EQ(Text("Text2")->text(), "9");
}

TEST_F(OscForm, BoxesTakeFourCharactersAndShowWhatStandsWhole) {
  settings.osc[kRsiP].daily = -12345;
  Open("RSI");
  EXPECT_EQ(Text("Text1")->text(), "-12345");
  settings.osc[kRsiP].daily = 14;
  Open("RSI");
  Type("Text1", "12345");
  EXPECT_EQ(Text("Text1")->text(), "1234");
}

TEST_F(OscForm, AMissingCompareFileIsToldAndOkGoesBackToIt) {
  Open("RMX");
  Type("Text1", "60");
  Type("Text5", "c:\\no.WDT");
  Click("Command1");
  const auto said = Told();
  EXPECT_EQ(said.text, "c:\\no.WDT is not available. Use your code for the All Ordinaries Index");
  EXPECT_EQ(said.title, "RMX Compare ");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(Focused(), "Text5");
  EXPECT_EQ(settings.osc[kRmxP].daily, 100);
  Type("Text5", kCompareFile);
  Click("Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(settings.osc[kRmxP].daily, 60);
  EXPECT_EQ(settings.osc.CompFile, kCompareFile);
  EXPECT_EQ(saved, 1);
}

TEST_F(OscForm, CancelAtAMissingCompareFileClosesTheBoxWithNothingChanged) {
  Open("RMO");
  Type("Text1", "60");
  dialogs.answers = {Answer::kCancel};
  Click("Command1");
  EXPECT_EQ(Told().text, " is not available. Use your code for the All Ordinaries Index");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(settings.osc[kRmoP].daily, 30);
  EXPECT_EQ(saved, 0);
}

TEST_F(OscForm, ACompareFileThatIsNoPriceFileIsRefused) {
  home.Put("drive_c/korawin/data/notes.txt", "x");
  Open("RMX");
  Type("Text5", "c:\\korawin\\data\\notes.txt");
  Click("Command1");
  const auto said = Told();
  EXPECT_EQ(said.title, "RMX/RMO Compare file");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(settings.osc.CompFile, "");
  EXPECT_EQ(saved, 0);
}

TEST_F(OscForm, PointAndFigureAsksForTheBoxValue) {
  Open("STO", Period::kDaily, Style::kPointFigure);
  EXPECT_EQ(form->windowTitle(), "Point and Figure");
  EXPECT_EQ(Labels(), (std::vector<QString>{"Box Value "}));
  EXPECT_EQ(Text("Text1")->text(), "0.125");
  const std::pair<const char*, const char*> bads[] = {{"", "Box value must have a value. eg 0.20"},
                                                      {"0", "Box value must have a value. eg 0.20"},
                                                      {"abc", "Box value must be numeric eg 0.20"}};
  for (const auto& [typed, text] : bads) {
    Type("Text1", typed);
    Click("Command1");
    const auto said = Told();
    EXPECT_EQ(said.text, text);
    EXPECT_EQ(said.title, "Box Value");
    EXPECT_TRUE(form->isVisible());
  }
  EXPECT_EQ(boxValue, 0.125f);
  Type("Text1", "0.20");
  Click("Command1");
  EXPECT_EQ(boxValue, 0.2f);
  EXPECT_EQ(saved, 1);
}

TEST_F(OscForm, EscapeLeavesThePeriods) {
  Open("STO");
  Type("Text1", "99");
  Press(Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(settings.osc[kStochK].daily, 10);
  EXPECT_EQ(saved, 0);
}

// ---- ChtDef

class DefaultsForm : public test::LookFormTest {
 protected:
  DefaultsForm() {
    WriteDefaultOscPeriods(ini);
    ReadOscPeriods(ini, settings.osc);
    home.Put("drive_c/korawin/data/ALODB.WDT", "");
    settings.osc.CompFile = kCompareFile;
  }
  void Open(ChtDefOpener opener = ChtDefOpener::kShell) {
    form =
        std::make_unique<ChtDef>(ChtDefServices{.ini = ini,
                                                .files = home.files(),
                                                .dialogs = dialogs,
                                                .settings = settings,
                                                .colours = colours,
                                                .chartPeriod = Period::kWeekly,
                                                .opener = opener,
                                                .readSettings = [this] { ++readings; },
                                                .openScales = [this] { ++scales; },
                                                .refreshChart = [this] { ++refreshed; },
                                                .averagesChanged = [this] { ++averagesChanged; }},
                                 nullptr);
    Show();
  }
  int readings = 0, scales = 0, refreshed = 0;
  int averagesChanged = 0;
};

TEST_F(DefaultsForm, ShowsEveryPeriodWithItsTwin) {
  settings.osc[kWmsA] = {71, 72};
  settings.charts.Av2W = 73;
  Open();
  EXPECT_EQ(readings, 1);
  EXPECT_EQ(form->windowTitle(), "Chart Defaults");
  EXPECT_EQ(Text("WmsA")->text(), "71");
  EXPECT_EQ(Text("WmsW")->text(), "72");
  EXPECT_EQ(Text("Av2W")->text(), "73");
  EXPECT_EQ(Text("CompFile")->text(), kCompareFile);
  for (const OscKey& key : OscKeys()) {
    EXPECT_TRUE(form->findChild<QLineEdit*>(key.daily)) << key.daily;
    EXPECT_TRUE(form->findChild<QLineEdit*>(key.twin)) << key.twin;
  }
  QStringList labels;
  for (const QLabel* label : form->findChildren<QLabel*>()) labels << label->text();
  for (const char* caption :
       {"Stochastic K", "Elder Ray  period", "Momentum  period", "Directional Move ADX",
        "Bar Charts and   Candlestick Charts", "Always show oscillator settings box "})
    EXPECT_TRUE(labels.contains(caption)) << caption;
}

TEST_F(DefaultsForm, FitsASmallScreen) {
  Open();
  EXPECT_LE(form->sizeHint().width(), 1280);
  EXPECT_LE(form->sizeHint().height(), 720);
}

TEST_F(DefaultsForm, TogglesByClick) {
  Open();
  struct Toggle {
    const char *name, *off, *on;
    bool standing;
  };
  const Toggle toggles[] = {{"AvOne", "OFF", "ON", false},
                            {"AvTwo", "OFF", "ON", false},
                            {"ShowOsc", "OFF", "ON", false},
                            {"AvCalc", "Simple Moving", "Exponential", false},
                            {"ScMethod", "Name File", "Automatic", true},
                            {"BCCalTp", "Arithmetic", "Logarithmic", false},
                            {"LCalTp", "Arithmetic", "Logarithmic", false},
                            {"VCalTp", "Arithmetic", "Logarithmic", false},
                            {"CutVols", "Full Height", "Limit Height", false}};
  for (const Toggle& t : toggles) {
    EXPECT_EQ(Caption(t.name), t.standing ? t.on : t.off) << t.name;
    Click(t.name);
    EXPECT_EQ(Caption(t.name), t.standing ? t.off : t.on) << t.name;
  }
  Click("Command1");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Chart("AvCalc"), "True");
  EXPECT_EQ(Chart("ScMethod"), "False");
  EXPECT_EQ(Osc("CutVols"), "True");
  EXPECT_EQ(Osc("LCalTp"), "True");
  EXPECT_TRUE(settings.osc.ShowOsc);
}

TEST_F(DefaultsForm, AKeyInTheScaleMethodBoxChangesIt) {
  Open();
  auto* box = Find<QAbstractButton>("ScMethod");
  box->setFocus();
  QTest::keyClicks(box, "n");
  EXPECT_EQ(box->text(), "Name File");
  QTest::keyClicks(box, " ");
  EXPECT_EQ(box->text(), "Automatic");
  QTest::keyClick(box, Qt::Key_Tab);
  EXPECT_EQ(box->text(), "Automatic");
  EXPECT_EQ(Focused(), "BCCalTp");
  Press(Qt::Key_Space);
  EXPECT_EQ(Caption("BCCalTp"), "Logarithmic") << "the others go by Space and Enter";
  QTest::keyClicks(QApplication::focusWidget(), "n");
  EXPECT_EQ(Caption("BCCalTp"), "Logarithmic");
  Press(Qt::Key_Return);
  EXPECT_EQ(Caption("BCCalTp"), "Arithmetic");
  EXPECT_EQ(Osc("BCCalTp"), "False") << "nothing saved";
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(DefaultsForm, AnAverageSwitchedTakesEffectAtOnce) {
  Open(ChtDefOpener::kChartSelection);
  Click("AvTwo");
  EXPECT_TRUE(settings.charts.AvTwo);
  EXPECT_FALSE(settings.charts.AvOne);
  EXPECT_EQ(Chart("AvTwo"), "False") << "not saved yet";
  EXPECT_EQ(averagesChanged, 1);
}

TEST_F(DefaultsForm, SaveTellsWhateverOpenedItOfTheAverages) {
  for (const auto opener : {ChtDefOpener::kChartSelection, ChtDefOpener::kChartWindow}) {
    averagesChanged = 0;
    Open(opener);
    Type("Av1W", "44");
    Click("Command1");
    EXPECT_EQ(averagesChanged, 1);
    EXPECT_EQ(settings.charts.Av1W, 44);
  }
}

TEST_F(DefaultsForm, FXReversedIsKeptTheOtherWayRound) {
  Open();
  EXPECT_TRUE(Find<QCheckBox>("FXRev")->isChecked()) << "FXRev is False";
  Click("FXRev");
  Click("FillIn");
  Click("Command1");
  EXPECT_EQ(Osc("FXRev"), "True");
  EXPECT_EQ(Osc("FillIn"), "True");
  EXPECT_EQ(Osc("RFAve"), "False");
  EXPECT_TRUE(form->isVisible()) << "Close closes";
}

TEST_F(DefaultsForm, APeriodThatIsNoneIsRefusedAndASaveIsTold) {
  Open();
  auto* saved = Find<QLabel>("Saved");
  for (const char* bad : {"", "x", "12x", "-1", "32768", "2.5"}) {
    Text("RocP")->setText(bad);
    dialogs.said.clear();
    Click("Command1");
    ASSERT_EQ(dialogs.said.size(), 1u) << bad;
    EXPECT_EQ(dialogs.said[0].text, "Value must be between 0 and 32767");
    EXPECT_TRUE(Text("RocP")->hasFocus());
    EXPECT_EQ(saved->text(), "");
  }
  Text("RocP")->setText("32767");
  dialogs.said.clear();
  Click("Command1");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(saved->text(), "Saved");
  QTest::keyClicks(Text("RocP"), "1");
  EXPECT_EQ(saved->text(), "");
}

TEST_F(DefaultsForm, SaveStopsAtTheCompareFile) {
  Open();
  Type("StochK", "33");
  Type("Av1D", "44");
  Type("CompFile", "c:\\no.WDT");
  Click("Command1");
  const auto said = Told();
  EXPECT_EQ(said.title, "RMO/RMX Compare File");
  EXPECT_EQ(said.text,
            "RMO/RMX compare file not found.\nEnter path and file details\n"
            "Example   c:\\korawin\\data\\ALODB.WDT");
  EXPECT_EQ(Focused(), "CompFile");
  EXPECT_EQ(Osc("StochK"), "33");
  EXPECT_EQ(Chart("Av1D"), "21");
  EXPECT_EQ(Text("Av1D")->text(), "44") << "what was typed stays";
  Type("CompFile", kCompareFile);
  Press(Qt::Key_Return);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Chart("Av1D"), "44");
  EXPECT_EQ(Osc("CompFile"), kCompareFile);
}

TEST_F(DefaultsForm, ChangeScalesOpensOnlyWithScalesOfTheNameFile) {
  Open();
  EXPECT_EQ(Caption("ScMethod"), "Automatic");
  Click("Command3");
  EXPECT_EQ(scales, 0);
  Click("ScMethod");
  Click("Command3");
  EXPECT_EQ(scales, 1);
}

TEST_F(DefaultsForm, CloseRefreshesTheChartWindowThatOpenedIt) {
  Open(ChtDefOpener::kChartWindow);
  Click("Command2");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(refreshed, 1);
  Open(ChtDefOpener::kChartWindow);
  Press(Qt::Key_Escape);
  EXPECT_EQ(refreshed, 2);
  Open(ChtDefOpener::kChartSelection);
  Click("Command2");
  EXPECT_EQ(refreshed, 2);
}

TEST_F(DefaultsForm, TabGoesFromADailyPeriodToItsTwinAndDown) {
  Open();
  EXPECT_EQ(Focused(), "StochK");
  for (const char* next : {"StochKW", "StochD", "StochDW", "FXF"}) {
    Press(Qt::Key_Tab);
    EXPECT_EQ(Focused(), next);
  }
}

// ---- MMASet, StpLs, ChtBands

using OverlayForms = test::LookFormTest;

TEST_F(OverlayForms, MultipleAveragesAreShownAndKept) {
  settings.osc.MMASet = {1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12};
  Open<MMASet>(Look());
  EXPECT_EQ(Text("Text1(0)")->text(), "1");
  EXPECT_EQ(Text("Text1(11)")->text(), "12");
  Type("Text1(4)", "");
  Type("Text1(11)", "600");
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Osc("MMASet"), "1,2,3,4,0,6,7,8,9,10,11,600");
  EXPECT_EQ(settings.osc.MMASet[11], 600);
  EXPECT_EQ(saved, 1) << "the chart window's refresh";
}

TEST_F(OverlayForms, AnAverageOutOfRangeIsRefused) {
  Open<MMASet>(Look());
  for (const char* bad : {"601", "-1"}) {
    Type("Text1(7)", bad);
    Click("Command1");
    EXPECT_EQ(Told().text, "Values must be between 0 - 600") << bad;
    EXPECT_TRUE(form->isVisible());
    EXPECT_EQ(Focused(), "Text1(7)");
  }
  EXPECT_EQ(Osc("MMASet"), "3,5,8,10,12,15,30,35,40,45,50,60");
  EXPECT_EQ(saved, 0);
}

TEST_F(OverlayForms, DefaultsFillTheTwelveBoxesAndCancelKeepsTheOldOnes) {
  settings.osc.MMASet = {};
  Open<MMASet>(Look());
  Click("Command3");
  const char* expected[] = {"3", "5", "8", "10", "12", "15", "30", "35", "40", "45", "50", "60"};
  for (int i = 0; i < 12; ++i)
    EXPECT_EQ(Text(("Text1(" + std::to_string(i) + ")").c_str())->text(), expected[i]);
  EXPECT_EQ(settings.osc.MMASet[0], 0);
  Click("Command2");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(settings.osc.MMASet[0], 0);
  EXPECT_EQ(saved, 0);
}

TEST_F(OverlayForms, StopLossIsSwitchedAndItsPercentChecked) {
  Open<StpLs>(Look());
  EXPECT_EQ(form->windowTitle(), "Stop Loss");
  EXPECT_TRUE(Find<QRadioButton>("Option1(1)")->isChecked());
  Click("Option1(0)");
  for (const char* bad : {"101", "-1", "ten", ""}) {
    Type("Text1", bad);
    Click("Command1");
    const auto said = Told();
    EXPECT_EQ(said.text, "Invalid value - must be between 0 and 100") << bad;
    EXPECT_EQ(said.title, "Stop Loss");
    EXPECT_TRUE(form->isVisible());
    EXPECT_FALSE(settings.charts.StopLoss);
  }
  Type("Text1", "7.5");
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Chart("StopLoss"), "True");
  EXPECT_EQ(Chart("SL Percent"), "7.5");
  EXPECT_TRUE(settings.charts.StopLoss);
  EXPECT_EQ(settings.charts.StopLossPct, 7.5f);
  EXPECT_EQ(saved, 1);
}

// ---- SwingSet

class SwingForm : public test::LookFormTest {
 protected:
  void Open(const SwingChoice& kept) {
    choice = kept;
    form =
        std::make_unique<SwingSet>(SwingSetServices{dialogs, choice, [this] { ++saved; }}, nullptr);
    Show();
  }
  bool Ticked(const char* option) { return Find<QRadioButton>(option)->isChecked(); }
  SwingChoice choice;
};

TEST_F(SwingForm, ShowsTheKindAndItsSize) {
  Open({});
  EXPECT_EQ(form->windowTitle(), "Swing");
  EXPECT_TRUE(Ticked("Option1(0)"));
  EXPECT_EQ(Text("Text1")->text(), "3") << "where no size was set";
  EXPECT_EQ(Text("Text2")->text(), "9");
  EXPECT_FALSE(Text("Text1")->isEnabled());
  Open({SwingKind::kDays, 4});
  EXPECT_TRUE(Ticked("Option1(1)"));
  EXPECT_EQ(Text("Text1")->text(), "4");
  EXPECT_EQ(Text("Text2")->text(), "9");
  EXPECT_TRUE(Text("Text1")->isEnabled());
  Open({SwingKind::kPoints, 2.5});
  EXPECT_EQ(Text("Text2")->text(), "2.5");
  Open({SwingKind::kPointsAuto, 0});
  EXPECT_TRUE(Ticked("Option1(3)"));
}

TEST_F(SwingForm, KeepsWhatWasChosenWithTheMouse) {
  Open({});
  Click("Option1(2)");
  Type("Text2", "12.5");
  Click("Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(choice.kind, SwingKind::kPoints);
  EXPECT_EQ(choice.size, 12.5);
  EXPECT_EQ(saved, 1);
}

TEST_F(SwingForm, KeepsWhatWasChosenWithTheKeys) {
  Open({});
  EXPECT_EQ(Focused(), "Option1(0)");
  Press(Qt::Key_Down);
  EXPECT_TRUE(Ticked("Option1(1)"));
  Press(Qt::Key_Tab);
  EXPECT_EQ(Focused(), "Text1");
  Text("Text1")->selectAll();
  QTest::keyClicks(Text("Text1"), "5");
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(choice.kind, SwingKind::kDays);
  EXPECT_EQ(choice.size, 5);
}

TEST_F(SwingForm, ValueBelowOneOrNoNumberIsRefused) {
  Open({SwingKind::kDays, 4});
  for (const char* bad : {"0", "0.9", "-2", "", "three", "3x"}) {
    Type("Text1", bad);
    Click("Command1");
    const auto said = Told();
    EXPECT_EQ(said.text, "Incorrect values entered") << bad;
    EXPECT_EQ(said.title, "Swing");
    EXPECT_TRUE(form->isVisible());
    EXPECT_EQ(Focused(), "Text1");
  }
  // A box whose option is off has no say.
  Click("Option1(3)");
  Click("Command1");
  EXPECT_EQ(choice.kind, SwingKind::kPointsAuto);
  EXPECT_EQ(choice.size, 4) << "of the kinds that have one";
}

TEST_F(SwingForm, CancelKeepsTheOldOnes) {
  Open({SwingKind::kDays, 4});
  Click("Option1(0)");
  Press(Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(choice.kind, SwingKind::kDays);
  EXPECT_EQ(saved, 0);
}

class BandsForm : public test::LookFormTest {
 protected:
  void Open(BandForm which) {
    form = std::make_unique<ChtBands>(ChtBandsServices{home.files(), settings.paths.CurrentDataPath,
                                                       dialogs, current, [this] { ++saved; }},
                                      which, nullptr);
    Show();
  }
};

TEST_F(BandsForm, PercentagesAreTheFirstPairOfTheRecord) {
  Open(BandForm::kPercentage);
  EXPECT_EQ(form->windowTitle(), "Percentage Bands");
  EXPECT_EQ(Text("Text1")->text(), "7");
  EXPECT_EQ(Text("Text2")->text(), "8");
  Type("Text1", "0");
  Type("Text2", "100");
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(OnDisk(2).BandUp, 0);
  EXPECT_EQ(OnDisk(2).BandDown, 100);
  EXPECT_EQ(OnDisk(2).BollPeriods, 21);
  EXPECT_EQ(current.Rec.BandDown, 100);
  EXPECT_EQ(saved, 1);
}

TEST_F(BandsForm, BollingerValuesAreTheSecondPair) {
  Open(BandForm::kBollinger);
  EXPECT_EQ(form->windowTitle(), "Bollinger Bands");
  EXPECT_EQ(Text("Text1")->text(), "21");
  EXPECT_EQ(Text("Text2")->text(), "2");
  Type("Text1", "30");
  Click("Command1");
  EXPECT_EQ(OnDisk(2).BollPeriods, 30);
  EXPECT_EQ(OnDisk(2).BollWidth, 2);
  EXPECT_EQ(OnDisk(2).BandUp, 7);
}

TEST_F(BandsForm, ValuesOutOfRangeAreToldAndTheFormStays) {
  Open(BandForm::kPercentage);
  const std::pair<const char*, const char*> bads[] = {{"101", "5"}, {"-1", "5"}, {"5", "101"},
                                                      {"5", "-1"},  {"x", "5"},  {"5", "5a"}};
  for (const auto& [up, down] : bads) {
    Type("Text1", up);
    Type("Text2", down);
    Click("Command1");
    const auto said = Told();
    EXPECT_EQ(said.text, "Values must be between 0 - 100") << up << " " << down;
    EXPECT_EQ(said.title, "Bands");
    EXPECT_TRUE(form->isVisible());
  }
  EXPECT_EQ(OnDisk(2).BandUp, 7);
  EXPECT_EQ(saved, 0);
}

TEST_F(BandsForm, ARecordThatCantBeWrittenIsTold) {
  Open(BandForm::kPercentage);
  home.files().Remove(NameFilePath(settings.paths.CurrentDataPath));
  Click("Command1");
  EXPECT_EQ(Told().text, "Unable to save data");
  EXPECT_TRUE(form->isVisible());
}

}  // namespace
}  // namespace kora
