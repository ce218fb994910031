#include "looks/look_settings.h"

#include <gtest/gtest.h>

#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

using test::ErrorOf;

const std::string kData = "c:\\korawin\\data\\";

class LookSettings : public testing::Test {
 protected:
  LookSettings() { WriteDefaultSettings(ini); }

  std::string Chart(const char* key) { return ini.GetSetting("Charts", key); }
  // What a start of the program would read.
  Settings ReadAgain() {
    Settings read;
    SettingsFile file(home.files(), ini.path());
    EXPECT_TRUE(ReadSettings(file, home.files(), dialogs, read));
    return read;
  }

  test::TempHome home;
  test::ScriptedDialogs dialogs;
  SettingsFile ini{home.files(), "C:\\WINDOWS\\Kora.ini"};
  Settings settings;
};

TEST_F(LookSettings, LineWidthOutsideOneToTenCountsAsTwo) {
  for (const int width : {0, -1, 11, 32767}) {
    settings.charts.LineWidth = std::int16_t(width);
    EXPECT_EQ(PrintedLineWidth(settings), 2) << width;
  }
  for (const int width : {1, 10}) {
    settings.charts.LineWidth = std::int16_t(width);
    EXPECT_EQ(PrintedLineWidth(settings), width);
  }
  SaveLineWidth(ini, settings, 7);
  EXPECT_EQ(Chart("Line Width"), "7");
  EXPECT_EQ(settings.charts.LineWidth, 7);
}

TEST_F(LookSettings, VolumeHeightIsHeldToOneToThree) {
  SaveVHeight(ini, settings, 3);
  EXPECT_EQ(Chart("VHeight"), "3");
  SaveVHeight(ini, settings, 4);
  EXPECT_EQ(Chart("VHeight"), "3");
  SaveVHeight(ini, settings, -1);
  EXPECT_EQ(Chart("VHeight"), "1");
  EXPECT_EQ(settings.charts.VolHeight, 1);
}

TEST_F(LookSettings, GridSpacingTakesZeroToOneHundred) {
  EXPECT_TRUE(SaveGridSpacing(ini, settings, "100", true));
  EXPECT_EQ(Chart("VGSpace"), "100");
  EXPECT_EQ(Chart("MidGrid"), "True");
  EXPECT_EQ(settings.charts.GridSpace, 100);
  EXPECT_TRUE(settings.charts.HalfGrid);
  EXPECT_FALSE(settings.charts.MovingGrid);
  for (const char* bad : {"101", "-1", "", "  ", "ten", "10x", "1e999", "100.6", "nan"}) {
    EXPECT_FALSE(SaveGridSpacing(ini, settings, bad, false)) << bad;
    EXPECT_EQ(settings.charts.GridSpace, 100) << bad;
    EXPECT_TRUE(settings.charts.HalfGrid) << bad;
    EXPECT_EQ(Chart("VGSpace"), "100") << bad;
  }
}

TEST_F(LookSettings, GridSpacingOfZeroMovesTheLinesWithTheDates) {
  settings.charts.MovingGrid = false;
  EXPECT_TRUE(SaveGridSpacing(ini, settings, " 0 ", false));
  EXPECT_TRUE(settings.charts.MovingGrid);
  EXPECT_EQ(Chart("VGSpace"), "0");
  EXPECT_EQ(Chart("MidGrid"), "False");
  EXPECT_TRUE(ReadAgain().charts.MovingGrid);
}

TEST_F(LookSettings, BlankSpaceTakesOneToOneHundredAndFifty) {
  EXPECT_TRUE(SaveBlankSpace(ini, settings, "1", 1));
  EXPECT_TRUE(SaveBlankSpace(ini, settings, "150", 16));
  EXPECT_EQ(Chart("DBlank"), "150");
  EXPECT_EQ(Chart("WeekFactor"), "4.75");
  EXPECT_EQ(settings.charts.BlankSpace, 150);
  for (const char* bad : {"0", "151", "-5", "", "x", "150.5", "99999999999999999999"}) {
    EXPECT_FALSE(SaveBlankSpace(ini, settings, bad, 3)) << bad;
    EXPECT_EQ(settings.charts.BlankSpace, 150) << bad;
    EXPECT_EQ(Chart("WeekFactor"), "4.75") << bad;
  }
}

TEST_F(LookSettings, WeekSliderHasStepsOfATwentieth) {
  EXPECT_EQ(WeekFactorOfStep(1), 4.0);
  EXPECT_EQ(WeekFactorOfStep(2), 4.05);
  EXPECT_EQ(WeekFactorOfStep(16), 4.75);
  EXPECT_EQ(WeekFactorOfStep(25), 5.2);
  EXPECT_EQ(WeekFactorOfStep(26), 5.25);
  for (int step = 1; step <= 26; ++step) EXPECT_EQ(StepOfWeekFactor(WeekFactorOfStep(step)), step);
  EXPECT_EQ(StepOfWeekFactor(0), 1);
  EXPECT_EQ(StepOfWeekFactor(1e300), 26);
}

TEST_F(LookSettings, LastStepOfTheWeekSliderHoldsForThisRunAndIsRefusedAtTheNextStart) {
  EXPECT_TRUE(SaveBlankSpace(ini, settings, "10", 25));
  EXPECT_EQ(ReadAgain().charts.WeekFactor, 5.2);
  EXPECT_TRUE(SaveBlankSpace(ini, settings, "10", 26));
  EXPECT_EQ(settings.charts.WeekFactor, 5.25);
  EXPECT_EQ(Chart("WeekFactor"), "5.25");
  EXPECT_EQ(ReadAgain().charts.WeekFactor, 4.75);
}

TEST_F(LookSettings, CandlesticksNeedASpacingOfThree) {
  EXPECT_EQ(LeastSpacing(Style::kCandlestick), 3);
  EXPECT_EQ(LeastSpacing(Style::kBar), 1);
  EXPECT_EQ(LeastSpacing(Style::kLine), 1);
  SaveSpacing(ini, settings, 9);
  EXPECT_EQ(Chart("Spacing"), "9");
  EXPECT_EQ(settings.charts.Spacing, 9);
}

TEST_F(LookSettings, BothFontsMustBeSelected) {
  EXPECT_FALSE(SaveFonts(ini, settings, {"Arial", 10}, {}));
  EXPECT_FALSE(SaveFonts(ini, settings, {}, {"Arial", 10}));
  EXPECT_EQ(settings.fonts.Font1Name, "");
  EXPECT_EQ(ini.GetSetting("Chart Fonts", "CFont"), "unknown");
  EXPECT_TRUE(SaveFonts(ini, settings, {"Arial", 9.75}, {"Courier New", 8}));
  const FontSettings read = ReadAgain().fonts;
  EXPECT_EQ(read.Font1Name, "Arial");
  EXPECT_EQ(read.TitleSize, 9.75);
  EXPECT_EQ(read.Font2Name, "Courier New");
  EXPECT_EQ(read.Font2Size, 8);
  EXPECT_EQ(settings.fonts.Font2Name, "Courier New");
  EXPECT_EQ(settings.fonts.TitleSize, 9.75);
}

TEST_F(LookSettings, ZoomIsHeldToFiftyToTwoHundred) {
  SaveZoom(ini, settings, 50);
  EXPECT_EQ(settings.Zoom, 50);
  EXPECT_EQ(ini.GetSetting("ChartForms", "Zoom"), "50");
  SaveZoom(ini, settings, 30);
  EXPECT_EQ(settings.Zoom, 50);
  SaveZoom(ini, settings, 500);
  EXPECT_EQ(ReadAgain().Zoom, 200);
}

TEST_F(LookSettings, FinishDateIsEnteredAsDayMonthYear) {
  EXPECT_EQ(ReadFinishDate("9/4/95"), "19950409");
  EXPECT_EQ(ReadFinishDate(" 29/9/95 "), "19950929");
  EXPECT_EQ(ReadFinishDate("29/2/24"), "20240229");
  for (const char* bad : {"", "29/2/23", "1995-04-09", "9.4.95", "9/4", "9/13/95", "LATEST",
                          "9/4/95x", "99999999999/1/1", "0/1/95"})
    EXPECT_EQ(ReadFinishDate(bad), std::nullopt) << bad;
}

TEST_F(LookSettings, StandingFinishDateReadsBackAsItself) {
  EXPECT_EQ(FinishDateText("19950409"), "9/4/95");
  EXPECT_EQ(FinishDateText("20260201"), "1/2/26");
  EXPECT_EQ(FinishDateText("19250409"), "09/04/1925") << "25 would be 2025";
  EXPECT_EQ(FinishDateText(""), "");
  EXPECT_EQ(FinishDateText("LATEST"), "");
}

TEST_F(LookSettings, AKeyThatCantBeWrittenHoldsForThisRun) {
  test::FailingIo io;
  test::TempHome failing(io);
  SettingsFile file(failing.files(), "C:\\WINDOWS\\Kora.ini");
  io.lasting = true;
  io.Reset(1);
  EXPECT_TRUE(SaveGridSpacing(file, settings, "12", true));
  EXPECT_EQ(settings.charts.GridSpace, 12);
  SaveLineWidth(file, settings, 5);
  EXPECT_EQ(settings.charts.LineWidth, 5);
  io.Reset();
}

class NameRecordInPlace : public LookSettings {
 protected:
  NameRecordInPlace() {
    NameRec second = test::Security("BBB");
    second.Name.set("Second");
    second.NameSpare.set("spare");
    Put({test::Security("AAA"), second, test::Security("CCC")});
    current.Rec = second;
    current.NameRecNo = 2;
  }
  void Put(const std::vector<NameRec>& records) {
    home.Put("drive_c/korawin/data/Names.dat", test::Bytes(records));
  }
  NameRec OnDisk(int number) { return NameFile(home.files(), NameFilePath(kData)).Read(number); }
  std::string FileBytes() { return home.Get("drive_c/korawin/data/Names.dat"); }

  CurrentName current;
};

TEST_F(NameRecordInPlace, ScalesChangeTheirFieldsOfOneRecordAndNothingElse) {
  const std::string before = FileBytes();
  SaveScales(home.files(), kData, current, "1.25", "3.5", "0.1");
  const NameRec written = OnDisk(2);
  EXPECT_EQ(written.Base, 1.25f);
  EXPECT_EQ(written.Top, 3.5f);
  EXPECT_EQ(written.PFInc, 0.1f);
  EXPECT_EQ(written.MinMove, 0.05f);
  EXPECT_EQ(current.Rec.Top, 3.5f);
  // Bytes 60 to 75 of the second record are the four values.
  const std::string after = FileBytes();
  ASSERT_EQ(after.size(), before.size());
  for (size_t i = 0; i < after.size(); ++i)
    if (i < 96 + 60 || i >= 96 + 76) {
      ASSERT_EQ(after[i], before[i]) << i;
    }
}

TEST_F(NameRecordInPlace, MinMoveIsWrittenWhateverItWas) {
  NameRec odd = current.Rec;
  odd.MinMove = 7;
  Put({test::Security("AAA"), odd});
  SaveScales(home.files(), kData, current, "", "", "");
  EXPECT_EQ(OnDisk(2).MinMove, 0.05f);
}

TEST_F(NameRecordInPlace, ScaleTextsAreNumbersByTheirLeadingPart) {
  SaveScales(home.files(), kData, current, "12abc", "abc", "  ");
  EXPECT_EQ(OnDisk(2).Base, 12);
  EXPECT_EQ(OnDisk(2).Top, 0);
  EXPECT_EQ(OnDisk(2).PFInc, 0);
}

TEST_F(NameRecordInPlace, ANumberThatIsNoPriceChangesNothing) {
  const std::string before = FileBytes();
  EXPECT_EQ(
      ErrorOf([&] { SaveScales(home.files(), kData, current, "1", std::string(60, '9'), "1"); }),
      kOverflow);
  EXPECT_EQ(FileBytes(), before);
  EXPECT_EQ(current.Rec.Base, 0);
}

TEST_F(NameRecordInPlace, WhatAnotherFormChangedMeanwhileStays) {
  NameRec renamed = current.Rec;
  renamed.Name.set("Renamed");
  Put({test::Security("AAA"), renamed});
  SaveScales(home.files(), kData, current, "1", "2", "");
  EXPECT_EQ(OnDisk(2).Name.trimmed(), "Renamed");
  EXPECT_EQ(OnDisk(2).Top, 2);
  EXPECT_EQ(current.Rec.Name.trimmed(), "Renamed");
}

TEST_F(NameRecordInPlace, ARecordThatMovedIsFoundByItsCode) {
  Put({test::Security("AAA"), test::Security("AAB"), current.Rec});
  SaveScales(home.files(), kData, current, "1", "2", "");
  EXPECT_EQ(OnDisk(2).Top, 0);
  EXPECT_EQ(OnDisk(3).Top, 2);
  EXPECT_EQ(current.NameRecNo, 3);
  // Beyond the end too.
  Put({current.Rec});
  SaveScales(home.files(), kData, current, "1", "5", "");
  EXPECT_EQ(OnDisk(1).Top, 5);
}

TEST_F(NameRecordInPlace, ASecurityThatIsGoneOrNoneIsAnError) {
  Put({test::Security("AAA")});
  const std::string before = FileBytes();
  const auto save = [&] { SaveScales(home.files(), kData, current, "1", "2", ""); };
  EXPECT_EQ(ErrorOf(save), kBadRecordNumber);
  current.NameRecNo = 0;
  EXPECT_EQ(ErrorOf(save), kBadRecordNumber);
  EXPECT_EQ(FileBytes(), before);
  EXPECT_EQ(current.Rec.Top, 0);
  home.files().Remove(NameFilePath(kData));
  current.NameRecNo = 2;
  EXPECT_EQ(ErrorOf(save), kFileNotFound);
  EXPECT_FALSE(home.Exists("drive_c/korawin/data/Names.dat")) << "none is made";
}

TEST_F(NameRecordInPlace, AScaleOfZeroShowsAsAnEmptyBox) {
  EXPECT_EQ(ScaleText(0), "");
  EXPECT_EQ(ScaleText(0.05f), "0.05");
  EXPECT_EQ(ScaleText(1250), "1250");
}

}  // namespace
}  // namespace kora
