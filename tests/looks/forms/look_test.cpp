// The forms of colours, fonts, scales and display values.

#include <QRadioButton>
#include <QSlider>
#include <QSpinBox>

#include "looks/forms/BlankSpc.h"
#include "looks/forms/ChtFonts.h"
#include "looks/forms/ChtSp.h"
#include "looks/forms/ColNew.h"
#include "looks/forms/F1Size.h"
#include "looks/forms/FinDate.h"
#include "looks/forms/GLSpaces.h"
#include "looks/forms/PLW.h"
#include "looks/forms/Scales.h"
#include "looks/forms/VHeight.h"
#include "tests/support/qt/look_fixture.h"

namespace kora {
namespace {

class LookForms : public test::LookFormTest {
 protected:
  QSpinBox* Spin() { return Find<QSpinBox>("Text1"); }
  bool Says(const char* text) {
    for (const QLabel* label : form->findChildren<QLabel*>())
      if (label->text() == text) return true;
    return false;
  }
};

// ---- PLW, VHeight, ChtSp, F1Size

TEST_F(LookForms, LineWidthIsKeptOnOk) {
  Open<PLW>(Look());
  EXPECT_TRUE(Says("Select a line width to be used on your PRINTED charts"));
  EXPECT_TRUE(Says("Chart Price, Averages, Volume, Oscillator and Bands only."));
  EXPECT_EQ(Spin()->value(), 2);
  QTest::keyClicks(Spin(), "7");
  Click("Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Chart("Line Width"), "7");
  EXPECT_EQ(settings.charts.LineWidth, 7);
  EXPECT_EQ(saved, 1);
}

TEST_F(LookForms, CancelAndEscapeChangeNothing) {
  for (const bool byKey : {false, true}) {
    Open<PLW>(Look());
    QTest::keyClicks(Spin(), "7");
    if (byKey)
      Press(Qt::Key_Escape);
    else
      Click("Command2");
    EXPECT_FALSE(form->isVisible());
    EXPECT_EQ(Chart("Line Width"), "2");
  }
  EXPECT_EQ(saved, 0);
}

TEST_F(LookForms, EnterOnCancelCancels) {
  Open<PLW>(Look());
  QTest::keyClicks(Spin(), "7");
  for (const char* next : {"Command1", "Command2"}) {
    Press(Qt::Key_Tab);
    EXPECT_EQ(Focused(), next);
  }
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Chart("Line Width"), "2");
  EXPECT_EQ(saved, 0);
}

TEST_F(LookForms, LineWidthStaysWithinOneToTen) {
  settings.charts.LineWidth = 50;
  Open<PLW>(Look());
  EXPECT_EQ(Spin()->value(), 2);
  for (int i = 0; i < 20; ++i) QTest::keyClick(Spin(), Qt::Key_Up);
  EXPECT_EQ(Spin()->value(), 10);
}

TEST_F(LookForms, VolumeHeightIsOneOfThree) {
  Open<VHeight>(Look());
  EXPECT_TRUE(Says("Selects volume height display for your charts."));
  EXPECT_TRUE(Find<QRadioButton>("Option1(1)")->isChecked());
  Click("Option1(2)");
  Click("Command1");
  EXPECT_EQ(Chart("VHeight"), "3");
  EXPECT_EQ(settings.charts.VolHeight, 3);
}

TEST_F(LookForms, VolumeHeightByKeyboard) {
  Open<VHeight>(Look());
  EXPECT_EQ(Focused(), "Option1(1)");
  Press(Qt::Key_Up);
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Chart("VHeight"), "1");
  EXPECT_EQ(saved, 1);
}

TEST_F(LookForms, SpacingIsPreselectedAndTypedOver) {
  settings.charts.Spacing = 4;
  Open<ChtSp>(Look(), Style::kBar);
  EXPECT_EQ(Focused(), "Text1");
  QTest::keyClicks(QApplication::focusWidget(), "12");
  EXPECT_EQ(Spin()->value(), 12);
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Chart("Spacing"), "12");
  EXPECT_EQ(settings.charts.Spacing, 12);
}

TEST_F(LookForms, SpacingOfCandlesticksIsAtLeastThree) {
  settings.charts.Spacing = 2;
  Open<ChtSp>(Look(), Style::kCandlestick);
  EXPECT_EQ(Spin()->value(), 3);
  QTest::keyClick(Spin(), Qt::Key_Down);
  EXPECT_EQ(Spin()->value(), 3);
  Open<ChtSp>(Look(), Style::kLine);
  QTest::keyClick(Spin(), Qt::Key_Down);
  EXPECT_EQ(Spin()->value(), 1);
}

TEST_F(LookForms, ASpacingNeverSetShowsTwo) {
  settings.charts.Spacing = 0;
  Open<ChtSp>(Look(), Style::kBar);
  EXPECT_EQ(Spin()->value(), 2);
}

TEST_F(LookForms, FormSizeIsFiftyToTwoHundred) {
  Open<F1Size>(Look());
  EXPECT_EQ(Spin()->minimum(), 50);
  EXPECT_EQ(Spin()->maximum(), 200);
  QTest::keyClick(Spin(), Qt::Key_Up);
  Press(Qt::Key_Return);
  EXPECT_EQ(ini.GetSetting("ChartForms", "Zoom"), "110");
  EXPECT_EQ(settings.Zoom, 110);
}

// ---- GLSpaces, BlankSpc

TEST_F(LookForms, GridLineSpacingOutOfRangeIsToldAndTheFormStays) {
  Open<GLSpaces>(Look());
  EXPECT_EQ(form->windowTitle(), "Grid Line Spacing");
  EXPECT_TRUE(Says(" (2) Allows you to set the intermediate horizontal grid ON or OFF"));
  for (const char* bad : {"101", "-1", "x", ""}) {
    Type("Text1", bad);
    Click("Command1");
    const auto said = Told();
    EXPECT_EQ(said.text, "Value must be between 0 and 100") << bad;
    EXPECT_EQ(said.title, "Grid Line Spacing");
    EXPECT_TRUE(form->isVisible());
    EXPECT_EQ(Focused(), "Text1");
    EXPECT_EQ(Chart("VGSpace"), "0");
  }
  Type("Text1", "20");
  Click("Check1");
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Chart("VGSpace"), "20");
  EXPECT_EQ(Chart("MidGrid"), "True");
  EXPECT_FALSE(settings.charts.MovingGrid);
  EXPECT_EQ(saved, 1);
}

TEST_F(LookForms, GridFormShowsWhatStands) {
  settings.charts.GridSpace = 15;
  settings.charts.HalfGrid = true;
  Open<GLSpaces>(Look());
  EXPECT_EQ(Text("Text1")->text(), "15");
  EXPECT_TRUE(Find<QAbstractButton>("Check1")->isChecked());
}

TEST_F(LookForms, BlankSpaceOutOfRangeIsToldAndTheFormStays) {
  Open<BlankSpc>(Look());
  EXPECT_EQ(form->windowTitle(), "Blank Spaces");
  EXPECT_EQ(Text("Text1")->text(), "10");
  for (const char* bad : {"0", "151", ""}) {
    Type("Text1", bad);
    Press(Qt::Key_Return);
    const auto said = Told();
    EXPECT_EQ(said.text, "Value must be between 1 and 150") << bad;
    EXPECT_EQ(said.title, "Blank Spaces");
    EXPECT_TRUE(form->isVisible());
  }
  EXPECT_EQ(Chart("DBlank"), "10");
}

TEST_F(LookForms, WeekSliderGivesTheDaysOfAWeek) {
  Open<BlankSpc>(Look());
  auto* slider = Find<QSlider>("Slider1");
  EXPECT_EQ(slider->minimum(), 1);
  EXPECT_EQ(slider->maximum(), 26);
  EXPECT_EQ(slider->value(), 16) << "4.75";
  slider->setFocus();
  QTest::keyClick(slider, Qt::Key_Right);
  EXPECT_EQ(Find<QLabel>("Label4")->text(), "4.80");
  Click("Command1");
  EXPECT_EQ(Chart("WeekFactor"), "4.8");
  EXPECT_EQ(settings.charts.WeekFactor, 4.8);
  EXPECT_EQ(Chart("DBlank"), "10");
}

TEST_F(LookForms, BlankSpaceTellsTenMillimetresInUnitsOfTheChart) {
  const auto units = [this](double pixelsPerUnit) {
    form = std::make_unique<BlankSpc>(Look(), nullptr, pixelsPerUnit);
    const QString text = Find<QLabel>("Label2")->text();
    EXPECT_TRUE(text.startsWith("10mm = "));
    EXPECT_TRUE(text.endsWith(" approx (varies with some monitors)"));
    return text.mid(7).section(' ', 0, 0).toInt();
  };
  const int one = units(1), half = units(0.5);
  EXPECT_GT(one, 0);
  EXPECT_NEAR(half, 2 * one, 1);
}

// ---- ChtFonts

class FontsForm : public LookForms {
 protected:
  void Open() {
    form = std::make_unique<ChtFonts>(
        Look(), nullptr, [this](QWidget*, const FontChoice& standing, bool printerOnly) {
          asked.push_back(standing);
          printer = printerOnly;
          return reply;
        });
    Show();
  }
  std::vector<FontChoice> asked;
  std::optional<FontChoice> reply;
  bool printer = false;
};

TEST_F(FontsForm, BothFontsMustBeSelected) {
  Open();
  EXPECT_TRUE(Says("Selects Fonts to be used on charts, printouts and spreadsheets."));
  EXPECT_TRUE(Says("Click Select Font 1 or 2 to display list of available fonts."));
  EXPECT_TRUE(Says("List all fonts or only those supported by your printer"));
  reply = FontChoice{"Arial", 11};
  Click("Command3(0)");
  Click("Command1");
  EXPECT_EQ(Told().text, "Both fonts must be selected.");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(ini.GetSetting("Chart Fonts", "CFont"), "unknown");
  reply = FontChoice{"Courier New", 9.5};
  Click("Command3(1)");
  EXPECT_EQ(Find<QLabel>("Label3(1)")->text(), "Courier New  9.5");
  Click("Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(ini.GetSetting("Chart Fonts", "CFont"), "Arial");
  EXPECT_EQ(ini.GetSetting("Chart Fonts", "CFontSize"), "11");
  EXPECT_EQ(ini.GetSetting("Chart Fonts", "SFont"), "Courier New");
  EXPECT_EQ(ini.GetSetting("Chart Fonts", "SFontSize"), "9.5");
  EXPECT_EQ(settings.fonts.Font2Name, "Courier New");
  EXPECT_EQ(saved, 1);
}

TEST_F(FontsForm, ACancelledListKeepsTheStandingFont) {
  settings.fonts.Font1Name = "Times";
  settings.fonts.TitleSize = 12;
  Open();
  Click("Command3(0)");
  ASSERT_EQ(asked.size(), 1u);
  EXPECT_EQ(asked[0].name, "Times");
  EXPECT_EQ(asked[0].points, 12);
  EXPECT_FALSE(printer);
  EXPECT_EQ(Find<QLabel>("Label3(0)")->text(), "Times  12");
  Click("Option1(1)");
  Click("Command3(0)");
  EXPECT_TRUE(printer);
}

// ---- Scales, FinDate

TEST_F(LookForms, ScalesAreWrittenIntoTheRecordAtOnce) {
  Open<Scales>(ScalesServices{home.files(), settings.paths.CurrentDataPath, dialogs, current,
                              [this] { ++saved; }});
  EXPECT_EQ(Find<QLabel>("Label1")->text(), "BBB  Broken Hill");
  EXPECT_EQ(Text("Text1")->text(), "2.5");
  EXPECT_EQ(Text("Text2")->text(), "");
  Type("Text2", "7.5");
  Type("Text3", "0.1");
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(OnDisk(2).Base, 2.5f);
  EXPECT_EQ(OnDisk(2).Top, 7.5f);
  EXPECT_EQ(OnDisk(2).PFInc, 0.1f);
  EXPECT_EQ(OnDisk(2).MinMove, 0.05f);
  EXPECT_EQ(OnDisk(1).Top, 0);
  EXPECT_EQ(current.Rec.Top, 7.5f);
  EXPECT_EQ(saved, 1);
}

TEST_F(LookForms, ScalesThatCantBeWrittenAreToldAndTheFormStays) {
  Open<Scales>(ScalesServices{home.files(), settings.paths.CurrentDataPath, dialogs, current,
                              [this] { ++saved; }});
  home.files().Remove(NameFilePath(settings.paths.CurrentDataPath));
  Type("Text2", "7.5");
  Click("Command1");
  const auto said = Told();
  EXPECT_EQ(said.text, "Unable to save data");
  EXPECT_EQ(said.title, "Saving Data");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(saved, 0);
}

TEST_F(LookForms, ScalesAreNotSavedWhileAnotherProgramWritesTheStore) {
  Open<Scales>(ScalesServices{home.files(), settings.paths.CurrentDataPath, dialogs, current,
                              [this] { ++saved; }});
  HomeLock other(home.path(), MachineIo());
  other.program = "koractl";
  const auto held = other.Hold();
  home.files().lock().wait = std::chrono::milliseconds(0);
  Type("Text2", "7.5");
  Click("Command1");
  const auto said = Told();
  EXPECT_EQ(said.text.substr(0, 46), "The data is being written by koractl (process ");
  EXPECT_EQ(said.title, "Saving Data");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(OnDisk(2).Top, 0);
}

TEST_F(LookForms, ScalesNeedASecurity) {
  current = {};
  Open<Scales>(ScalesServices{home.files(), settings.paths.CurrentDataPath, dialogs, current, {}});
  EXPECT_FALSE(Text("Text1")->isEnabled());
  EXPECT_FALSE(Find<QWidget>("Command1")->isEnabled());
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
}

TEST_F(LookForms, FinishDateIsTakenAsDayMonthYear) {
  std::string date = "19991231";
  bool on = false;
  Open<FinDate>(FinDateServices{dialogs, date, on, [this] { ++saved; }});
  EXPECT_EQ(Text("Text1")->text(), "31/12/99");
  for (const char* bad : {"31/2/95", "hello", "", "1995"}) {
    Type("Text1", bad);
    Click("Command1");
    const auto said = Told();
    EXPECT_EQ(said.text, "Date must be entered as d/m/yy eg. 9/4/95 or 29/9/95") << bad;
    EXPECT_EQ(said.title, "Date");
    EXPECT_TRUE(form->isVisible());
    EXPECT_EQ(date, "19991231");
    EXPECT_FALSE(on);
  }
  Type("Text1", "9/4/95");
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(date, "19950409");
  EXPECT_TRUE(on);
  EXPECT_EQ(saved, 1);
}

TEST_F(LookForms, LeavingTheFinishDateKeepsIt) {
  std::string date;
  bool on = false;
  Open<FinDate>(FinDateServices{dialogs, date, on, {}});
  Type("Text1", "9/4/95");
  Press(Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(date, "");
  EXPECT_FALSE(on);
}

// ---- ColNew

class ColoursForm : public LookForms {
 protected:
  void Open() {
    LookFormTest::Open<ColNew>(ColNewServices{home.files(), settings.paths.SystemPath, dialogs,
                                              colours, [this] { ++saved; }});
  }
  std::string UserFile() { return home.Get("drive_c/korawin/Koraclr.dat"); }
  // The backdrop of an item, beside its text and frame.
  QColor Backdrop(const char* name) {
    return Find<QWidget>(name)->grab().toImage().pixelColor(4, 4);
  }
};

TEST_F(ColoursForm, AClickedColourGoesToTheClickedItemsAtOnce) {
  Open();
  EXPECT_EQ(form->windowTitle(), "Change Chart Colours");
  EXPECT_TRUE(Says("Click colour then click items that you want to change to that colour"));
  Click("Label1(12)");
  Click("Label2(1)");
  Click("Label2(2)");
  EXPECT_EQ(colours[kBorder], 0x0000FF) << "light red, red in the low byte";
  EXPECT_EQ(colours[kChartLines], 0x0000FF);
  EXPECT_EQ(colours[kAverage1], 0x00FFFF) << "not clicked";
  EXPECT_TRUE(UserFile().empty());
}

TEST_F(ColoursForm, ItemsAreTheRolesWithBackgroundFirst) {
  Open();
  EXPECT_EQ(Caption("Label2(0)"), "Background");
  EXPECT_EQ(Caption("Label2(1)"), "Border");
  EXPECT_EQ(Caption("Label2(2)"), "Chart lines");
  EXPECT_EQ(Caption("Label2(12)"), "C'stick / P+F Dn");
  EXPECT_EQ(Caption("Label2(32)"), "Oscillator Line 4");
  EXPECT_TRUE(form->findChild<QWidget*>("Label1(15)"));
  EXPECT_FALSE(form->findChild<QWidget*>("Label1(16)"));
  EXPECT_FALSE(form->findChild<QWidget*>("Label2(35)"));
  // Entries 49 and 50 are kept as they are.
  colours[49] = 5;
  colours[50] = 6;
  Click("Label2(33)");
  Click("Label2(34)");
  EXPECT_EQ(colours[49], 5);
  EXPECT_EQ(colours[50], 6);
}

TEST_F(ColoursForm, TheBackgroundIsTheBackdropOfEveryItem) {
  Open();
  EXPECT_EQ(Backdrop("Label2(5)"), QColor(Qt::black));
  Click("Label1(9)");
  Click("Label2(0)");
  EXPECT_EQ(colours[kBackground], 0xFF0000);
  for (const char* item : {"Label2(0)", "Label2(1)", "Label2(20)", "Label2(32)"})
    EXPECT_EQ(Backdrop(item), QColor(0, 0, 255)) << item;
  EXPECT_EQ(Backdrop("Label1(12)"), QColor(255, 0, 0)) << "swatches keep theirs";
}

TEST_F(ColoursForm, SaveWritesTheTable) {
  Open();
  Click("Label1(4)");
  Click("Label2(6)");
  Click("Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(saved, 1);
  ChartColours read{};
  EXPECT_TRUE(LoadUserColours(home.files(), settings.paths.SystemPath, read));
  EXPECT_EQ(read[kVolumeBars], 0x000080);
  EXPECT_EQ(colours[kVolumeBars], 0x000080);
}

TEST_F(ColoursForm, LeavingWithoutSavingReloadsTheUsersColours) {
  colours[kBands] = 0x123456;
  SaveColours(home.files(), settings.paths.SystemPath, colours);
  const std::string kept = UserFile();
  for (const bool byKey : {false, true}) {
    Open();
    Click("Label1(4)");
    Click("Label2(0)");
    Click("Label2(25)");
    EXPECT_EQ(colours[kBands], 0x000080);
    if (byKey)
      Press(Qt::Key_Escape);
    else
      Click("Command3");
    EXPECT_FALSE(form->isVisible());
    EXPECT_EQ(colours[kBands], 0x123456);
    EXPECT_EQ(colours[kBackground], 0);
    EXPECT_EQ(UserFile(), kept);
  }
  EXPECT_EQ(saved, 2) << "the chart is drawn anew";
}

TEST_F(ColoursForm, ADefaultWhoseFileIsMissingGivesTheDefaultTable) {
  Open();
  Click("Label1(4)");
  Click("Label2(0)");
  Click("Command2(2)");
  EXPECT_EQ(Caption("Command2(2)"), "Default &BLUE");
  EXPECT_EQ(colours[kBackground], 0);
  EXPECT_EQ(colours[kChartLines], 0xFFFFFF);
  EXPECT_TRUE(form->isVisible());
}

TEST_F(ColoursForm, ADefaultIsReadFromItsFile) {
  std::string lines;
  for (int i = 0; i < 49; ++i) lines += std::to_string(1000 + i) + "\r\n";
  home.Put("drive_c/korawin/Koraclr.WHT", lines);
  Open();
  Click("Command2(1)");
  EXPECT_EQ(colours[kBackground], 1017);
  EXPECT_EQ(colours[48], 1048);
  EXPECT_EQ(colours[3], StandardColours()[3]) << "the sixteen are no one's to change";
  Click("Command2(0)");
  EXPECT_EQ(colours[kBackground], 0);
}

TEST_F(ColoursForm, ColoursByKeyboardAlone) {
  Open();
  EXPECT_EQ(Focused(), "Label1(0)");
  Press(Qt::Key_Right);
  EXPECT_EQ(Focused(), "Label1(1)");
  Press(Qt::Key_Tab);
  EXPECT_EQ(Focused(), "Label2(0)");
  Press(Qt::Key_Space);
  EXPECT_EQ(colours[kBackground], 0x800000);
  Press(Qt::Key_Down);
  EXPECT_EQ(Focused(), "Label2(1)");
  Press(Qt::Key_Space);
  EXPECT_EQ(colours[kBorder], 0x800000);
  Press(Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_FALSE(UserFile().empty());
}

}  // namespace
}  // namespace kora
