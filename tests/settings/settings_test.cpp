#include "settings/settings.h"

#include <gtest/gtest.h>

#include "tests/support/failing_io.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

using namespace std::string_literals;

// Every byte value many times over, in no order that is text.
std::string Rubbish() {
  std::string out;
  for (int i = 0; i < 4096; ++i) out += char((i * 167 + i / 256) & 0xFF);
  return out;
}

class SettingsTest : public ::testing::Test {
 protected:
  SettingsTest() : home_(io_), ini_(home_.files(), "C:\\WINDOWS\\Kora.ini") {
    settings_.paths.WindowsPath = "C:\\WINDOWS\\";
  }

  // Reads a file with the program folder given and these lines.
  void Read(const std::string& lines) {
    home_.Put("Kora.ini", "[KoraPaths]\r\nSystem=d:\\kora\\\r\n" + lines);
    ASSERT_TRUE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
    EXPECT_TRUE(dialogs_.said.empty());
  }

  FailingIo io_;
  TempHome home_;
  SettingsFile ini_;
  ScriptedDialogs dialogs_;
  Settings settings_;
};

TEST_F(SettingsTest, ASettingsFileThatCantBeReadIsToldAndNothingElseIsTaken) {
  home_.Put("Kora.ini", std::string(5u << 20, 'x'));
  settings_.paths.CurrentDataPath = "c:\\mine\\";
  EXPECT_FALSE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
  ASSERT_EQ(dialogs_.said.size(), 1u);
  EXPECT_EQ(dialogs_.said[0].text,
            "Kora.ini in " + home_.path() + " can't be read: The file is too large");
  EXPECT_EQ(settings_.paths.CurrentDataPath, "c:\\mine\\");
}

// ---- conversions

TEST(SettingConversions, TextsThatAreNoNumberAreZero) {
  EXPECT_EQ(SettingCInt("unknown"), 0);
  EXPECT_EQ(SettingCInt(""), 0);
  EXPECT_EQ(SettingCInt("12abc"), 12);
  EXPECT_EQ(SettingCInt("2.5"), 2);  // half to even
  EXPECT_EQ(SettingCInt("-32768"), -32768);
  EXPECT_EQ(SettingCInt("32768"), 0);
  EXPECT_EQ(SettingCInt(std::string(400, '9')), 0);
  EXPECT_EQ(SettingCLng("unknown"), 0);
  EXPECT_EQ(SettingCLng("2147483647"), 2147483647);
  EXPECT_EQ(SettingCLng("2147483648"), 0);
}

TEST(SettingConversions, BooleansAreWordsInAnyCase) {
  EXPECT_TRUE(SettingBool("True"));
  EXPECT_TRUE(SettingBool("TRUE"));
  EXPECT_FALSE(SettingBool("False", true));
  EXPECT_FALSE(SettingBool("unknown"));
  EXPECT_TRUE(SettingBool("unknown", true));
  EXPECT_FALSE(SettingBool("1"));
}

TEST(CommandWordsTest, EachWordSetsItsOwn) {
  CommandWords w = ParseCommandWords("");
  EXPECT_FALSE(w.StochSignals || w.NoDownloads || w.ScriptPrintMode || w.OptionXT || w.OptionXS);
  w = ParseCommandWords("RM");
  EXPECT_TRUE(w.StochSignals);
  EXPECT_FALSE(w.NoDownloads || w.ScriptPrintMode || w.OptionXT || w.OptionXS);
  w = ParseCommandWords("xt");
  EXPECT_TRUE(w.StochSignals && w.OptionXT);
  EXPECT_FALSE(w.OptionXS);
  w = ParseCommandWords("  A   n XS ");
  EXPECT_TRUE(w.NoDownloads && w.ScriptPrintMode && w.OptionXS);
  EXPECT_FALSE(w.StochSignals || w.OptionXT);
  w = ParseCommandWords("RMX ANXT");
  EXPECT_FALSE(w.StochSignals || w.NoDownloads || w.ScriptPrintMode || w.OptionXT || w.OptionXS);
}

// ---- reading

TEST_F(SettingsTest, FoldersAreReadAndEndInABackslash) {
  Read("ChtData=d:\\prices\r\nChtBackUp=e:\\b\\\r\nPFMData=d:\\p\\\r\nPFMBackUp=d:\\pb\\\r\n");
  const Paths& p = settings_.paths;
  EXPECT_EQ(p.SystemPath, "d:\\kora\\");
  EXPECT_EQ(p.CurrentDataPath, "d:\\prices\\");
  EXPECT_EQ(p.ChartBackupPath, "e:\\b\\");
  EXPECT_EQ(p.PfmDataPath, "d:\\p\\");
  EXPECT_EQ(p.PfmBackupPath, "d:\\pb\\");
  EXPECT_EQ(p.ChartMiscPath, "d:\\kora\\chtmisc\\");
  EXPECT_EQ(p.ChartSavePath, "d:\\kora\\chtsave\\");
  EXPECT_EQ(p.KoraDrv, "d:");
  EXPECT_FALSE(settings_.PathsMissing);
}

TEST_F(SettingsTest, FoldersNeverKeptAreTheDefaultOnesOfTheDrive) {
  Read("");
  EXPECT_EQ(settings_.paths.CurrentDataPath, "d:\\korawin\\data\\");
  EXPECT_EQ(settings_.paths.ChartBackupPath, "d:\\korawin\\backup\\");
}

TEST_F(SettingsTest, WithoutOtherKeysTheUsualConversionHolds) {
  Read("");
  EXPECT_EQ(settings_.download.DataService, 0);
  EXPECT_FALSE(settings_.download.DownloadNew);
  EXPECT_EQ(settings_.download.DLPath, "");
  EXPECT_FALSE(settings_.download.InternetAccess);
  EXPECT_TRUE(settings_.download.UpdateAll);
  EXPECT_FALSE(settings_.download.NoWarrants);
  EXPECT_EQ(settings_.download.VolumeDivisor, 1);
  EXPECT_EQ(settings_.charts.Type, "unknown");
  EXPECT_EQ(settings_.charts.Period, "unknown");
  EXPECT_EQ(settings_.charts.Spacing, 0);
  EXPECT_EQ(settings_.charts.Av1D, 0);
  EXPECT_FALSE(settings_.charts.AvOne);
  EXPECT_FALSE(settings_.charts.AvCalc);
  EXPECT_TRUE(settings_.charts.ScMethod);
  EXPECT_TRUE(settings_.charts.MovingGrid);
  EXPECT_EQ(settings_.charts.VolHeight, 1);
  EXPECT_EQ(settings_.charts.WeekFactor, 4.75);
  EXPECT_FALSE(settings_.charts.StopLoss);
  EXPECT_EQ(settings_.charts.StopLossPct, 0);
  EXPECT_EQ(settings_.fonts.Font1Name, "");
  EXPECT_EQ(settings_.fonts.TitleSize, 8);
  EXPECT_EQ(settings_.fonts.Font2Name, "");
  EXPECT_EQ(settings_.fonts.Font2Size, 0);
  EXPECT_EQ(settings_.fonts.Font2Points(), 8);
  EXPECT_EQ(settings_.Zoom, 100);
  EXPECT_EQ(settings_.AdjDivs, 0);
  EXPECT_FALSE(settings_.NoShortNames);
  EXPECT_EQ(settings_.osc.CompFile, "");
  EXPECT_EQ(settings_.osc.MMASet, (std::array<std::int16_t, 12>{}));
}

TEST_F(SettingsTest, ChartKeysAreRead) {
  Read(
      "[Charts]\r\nType=C\r\nPeriod=W\r\nSpacing=5\r\nBands=2\r\nAutoOsc=True\r\nList=3\r\n"
      "AvOne=True\r\nAvTwo=TRUE\r\nAv1D=21\r\nAv2D=55\r\nAv1W=10\r\nAv2W=30\r\nAvCalc=True\r\n"
      "ScMethod=False\r\nCw=1800\r\nCh=1200.5\r\nSW=-7\r\nSH=9\r\nEFact=1.25\r\nLine Width=4\r\n"
      "DBlank=25\r\nVGSpace=40\r\nMidGrid=True\r\nGrid=True\r\nVHeight=3\r\nWeekFactor=5.2\r\n"
      "StopLoss=True\r\nSL Percent=7.5\r\n");
  const ChartSettings& c = settings_.charts;
  EXPECT_EQ(c.Type, "C");
  EXPECT_EQ(c.Period, "W");
  EXPECT_EQ(c.Spacing, 5);
  EXPECT_EQ(c.Bands, 2);
  EXPECT_EQ(c.AutoOsc, "True");
  EXPECT_EQ(c.List, 3);
  EXPECT_TRUE(c.AvOne && c.AvTwo && c.AvCalc);
  EXPECT_EQ(c.Av1D, 21);
  EXPECT_EQ(c.Av2D, 55);
  EXPECT_EQ(c.Av1W, 10);
  EXPECT_EQ(c.Av2W, 30);
  EXPECT_FALSE(c.ScMethod);
  EXPECT_EQ(c.Cw, 1800);
  EXPECT_EQ(c.Ch, 1200.5);
  EXPECT_EQ(c.SW, -7);
  EXPECT_EQ(c.SH, 9);
  EXPECT_EQ(c.EFact, 1.25);
  EXPECT_EQ(c.LineWidth, 4);
  EXPECT_EQ(c.BlankSpace, 25);
  EXPECT_EQ(c.GridSpace, 40);
  EXPECT_FALSE(c.MovingGrid);
  EXPECT_TRUE(c.HalfGrid);
  EXPECT_TRUE(c.GridLines);
  EXPECT_EQ(c.VolHeight, 3);
  EXPECT_EQ(c.WeekFactor, 5.2);
  EXPECT_TRUE(c.StopLoss);
  EXPECT_EQ(c.StopLossPct, 7.5f);
}

TEST_F(SettingsTest, WeekFactorOutside4To5Point2Is4Point75) {
  for (const char* text : {"5.3", "3.99", "-1", "x", "5.25"}) {
    Read("[Charts]\r\nWeekFactor="s + text + "\r\n");
    EXPECT_EQ(settings_.charts.WeekFactor, 4.75) << text;
  }
  Read("[Charts]\r\nWeekFactor=4\r\n");
  EXPECT_EQ(settings_.charts.WeekFactor, 4);
}

TEST_F(SettingsTest, VolumeHeightIsHeldTo1To3) {
  const std::pair<const char*, int> cases[] = {{"-5", 1}, {"0", 1}, {"2", 2}, {"4", 3}};
  for (const auto& [text, height] : cases) {
    Read("[Charts]\r\nVHeight="s + text + "\r\n");
    EXPECT_EQ(settings_.charts.VolHeight, height) << text;
  }
}

TEST_F(SettingsTest, VolumeDivisorIsAPowerOfTenOr1) {
  const std::pair<const char*, int> cases[] = {
      {"1", 1}, {"10", 10},    {"100", 100},   {"1000", 1000}, {"10000", 10000},
      {"7", 1}, {"100000", 1}, {"unknown", 1}, {"-10", 1},     {"10.5", 1}};
  for (const auto& [text, divisor] : cases) {
    Read("[Download]\r\nVolume divisor="s + text + "\r\n");
    EXPECT_EQ(settings_.download.VolumeDivisor, divisor) << text;
  }
}

TEST_F(SettingsTest, ZoomOutside50To200Is100) {
  const std::pair<const char*, int> cases[] = {{"30", 100},  {"49", 100},  {"50", 50},
                                               {"200", 200}, {"201", 100}, {"99999", 100}};
  for (const auto& [text, zoom] : cases) {
    Read("[ChartForms]\r\nZoom="s + text + "\r\n");
    EXPECT_EQ(settings_.Zoom, zoom) << text;
  }
}

TEST_F(SettingsTest, TheServiceFoldersAreReadForServices1And3Only) {
  const std::string folders = "System=s\r\nIn=i\r\nOut=o\r\n";
  for (const int service : {0, 1, 2, 3, 4, 5}) {
    settings_.download = DownloadSettings();
    Read("[Download]\r\nDataService=" + std::to_string(service) + "\r\n" + folders);
    const bool read = service == 1 || service == 3;
    EXPECT_EQ(settings_.download.DataService, service);
    EXPECT_EQ(settings_.download.ServiceSystem, read ? "s" : "") << service;
    EXPECT_EQ(settings_.download.ServiceIn, read ? "i" : "") << service;
    EXPECT_EQ(settings_.download.ServiceOut, read ? "o" : "") << service;
  }
}

TEST_F(SettingsTest, DownloadFlagsHaveTheirOwnMeaningOfOtherTexts) {
  Read(
      "[Download]\r\nDownloadNew=yes\r\nUpdateAll=no\r\nNoWarrants=1\r\nInternet Access=True\r\n"
      "DLPath=c:\\dl\\\r\nInternetDLfmt= YYMMDD.D \r\n");
  EXPECT_FALSE(settings_.download.DownloadNew);
  EXPECT_TRUE(settings_.download.UpdateAll);
  EXPECT_FALSE(settings_.download.NoWarrants);
  EXPECT_TRUE(settings_.download.InternetAccess);
  EXPECT_EQ(settings_.download.DLPath, "c:\\dl\\");
  EXPECT_EQ(settings_.download.InternetDLfmt, "YYMMDD.D");
  Read("[Download]\r\nUpdateAll =False\r\n");
  EXPECT_FALSE(settings_.download.UpdateAll);
}

TEST_F(SettingsTest, FontAndPageKeysAreRead) {
  Read(
      "[Chart Fonts]\r\nCFont=Arial\r\nCFontSize=9.75\r\nSFont=Courier\r\nSFontSize=8.25\r\n"
      "[ChtPage]\r\nPPTop=70000\r\nPPLft=-3\r\nPPBot=2.5\r\nPPRht=0.25\r\nOrient=2\r\n"
      "[Adjustments]\r\nDivs=4\r\nNoShortNames=True\r\n");
  EXPECT_EQ(settings_.fonts.Font1Name, "Arial");
  EXPECT_EQ(settings_.fonts.TitleSize, 9.75);
  EXPECT_EQ(settings_.fonts.Font2Name, "Courier");
  EXPECT_EQ(settings_.fonts.Font2Size, 8.25);
  EXPECT_EQ(settings_.fonts.Font2Points(), 8.25);
  EXPECT_EQ(settings_.page.PPTop, 70000);
  EXPECT_EQ(settings_.page.PPLft, -3);
  EXPECT_EQ(settings_.page.PPBot, 2.5f);
  EXPECT_EQ(settings_.page.PPRht, 0.25f);
  EXPECT_EQ(settings_.page.Orient, 2);
  EXPECT_EQ(settings_.AdjDivs, 4);
  EXPECT_TRUE(settings_.NoShortNames);
}

TEST_F(SettingsTest, SwitchesOfOscillatorsAreRead) {
  Read("[OscDef]\r\nCompFile=c:\\d\\XAO.WDT\r\nBCCalTp=True\r\nCutVols=True\r\nFXRev=True\r\n");
  EXPECT_EQ(settings_.osc.CompFile, "c:\\d\\XAO.WDT");
  EXPECT_TRUE(settings_.osc.BCCalTp && settings_.osc.CutVols && settings_.osc.FXRev);
  EXPECT_FALSE(settings_.osc.LCalTp || settings_.osc.VCalTp || settings_.osc.ShowOsc ||
               settings_.osc.FillIn || settings_.osc.RFAve);
}

TEST(OscSettingsTest, APeriodThatWasNeverReadIs0) {
  constexpr OscKey kKey{"NewP", "NewPW", 5, 6, "New"};
  OscSettings osc;
  EXPECT_EQ(std::as_const(osc)[kKey].For(Period::kDaily), 0);
  osc[kKey] = {7, 8};
  EXPECT_EQ(std::as_const(osc)[kKey].For(Period::kDaily), 7);
  EXPECT_EQ(std::as_const(osc)[kKey].For(Period::kWeekly), 8);
  EXPECT_EQ(std::as_const(osc)[kKey].For(Period::kMonthly), 8);
}

TEST_F(SettingsTest, TheAverageListTakesNumbersAndKeepsTheRest) {
  using Set = std::array<std::int16_t, 12>;
  Read("[OscDef]\r\nMMASet=3,5,8,10,12,15,30,35,40,45,50,60\r\n");
  EXPECT_EQ(settings_.osc.MMASet, (Set{3, 5, 8, 10, 12, 15, 30, 35, 40, 45, 50, 60}));
  Read("[OscDef]\r\nMMASet=4,x,, 9 ,-2,99999,600,1,1,1,1,1,77,88\r\n");
  EXPECT_EQ(settings_.osc.MMASet, (Set{4, 5, 8, 9, 12, 15, 600, 1, 1, 1, 1, 1}));
  Read("[OscDef]\r\nMMASet=7\r\n");
  EXPECT_EQ(settings_.osc.MMASet, (Set{7, 5, 8, 9, 12, 15, 600, 1, 1, 1, 1, 1}));
  Read("");
  EXPECT_EQ(settings_.osc.MMASet[0], 7);
}

TEST_F(SettingsTest, AnOverrideIsReadInPlaceOfTheFile) {
  ini_.Override("Charts", "Av1D", "30");
  Read("[Charts]\r\nAv1D=21\r\n");
  EXPECT_EQ(settings_.charts.Av1D, 30);
}

TEST_F(SettingsTest, NumbersBeyondMeasureAreZero) {
  const std::string nines(60, '9');
  Read("[Charts]\r\nSpacing=" + nines + "\r\nSL Percent=" + nines +
       "\r\n[ChtPage]\r\nPPTop=" + nines + "\r\nPPBot=" + nines + "\r\n");
  EXPECT_EQ(settings_.charts.Spacing, 0);
  EXPECT_EQ(settings_.charts.StopLossPct, 0);
  EXPECT_EQ(settings_.page.PPTop, 0);
  EXPECT_EQ(settings_.page.PPBot, 0);
}

// ---- the drive

TEST_F(SettingsTest, WithoutAFileTheUserIsAskedForTheDrive) {
  dialogs_.replies = {"e"};
  EXPECT_TRUE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
  ASSERT_EQ(dialogs_.said.size(), 1u);
  EXPECT_EQ(dialogs_.said[0].text,
            "There is a path problem.\nEnter the drive on which KORA is located");
  EXPECT_EQ(dialogs_.said[0].title, "Drive");
  EXPECT_EQ(settings_.paths.SystemPath, "e:\\korawin\\");
  EXPECT_EQ(settings_.paths.CurrentDataPath, "e:\\korawin\\data\\");
  EXPECT_EQ(settings_.paths.KoraDrv, "e:");
  EXPECT_EQ(settings_.paths.ChartMiscPath, "e:\\korawin\\chtmisc\\");
  EXPECT_EQ(ini_.GetSetting("KoraPaths", "System"), "e:\\korawin\\");
  EXPECT_EQ(ini_.GetSetting("KoraDisk", "KoraDrv"), "e:");
  EXPECT_FALSE(settings_.PathsMissing);
}

TEST_F(SettingsTest, AnEmptyAnswerGivesUpAndWritesNothing) {
  for (const std::optional<std::string>& reply :
       {std::optional<std::string>(), std::optional<std::string>(""),
        std::optional<std::string>("  ")}) {
    dialogs_.replies = {reply};
    EXPECT_FALSE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
    EXPECT_FALSE(home_.Exists("Kora.ini"));
  }
}

TEST_F(SettingsTest, WhatIsNoDriveIsAskedAgain) {
  dialogs_.replies = {"1", "??", ":", "C:\\korawin"};
  EXPECT_TRUE(FindSystemDrive(ini_, home_.files(), dialogs_, settings_));
  EXPECT_EQ(dialogs_.said.size(), 4u);
  EXPECT_EQ(settings_.paths.SystemPath, "C:\\korawin\\");
}

TEST_F(SettingsTest, TheProgramOnTheWindowsDriveIsFoundWithoutAsking) {
  home_.Put("drive_c/korawin/KORA32.EXE", "");
  EXPECT_TRUE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
  EXPECT_TRUE(dialogs_.said.empty());
  EXPECT_EQ(settings_.paths.SystemPath, "C:\\korawin\\");
}

TEST_F(SettingsTest, FindingTheDriveLosesNoOtherKey) {
  home_.Put("drive_c/korawin/kora32.exe", "");
  home_.Put("Kora.ini", "[Download]\r\nDataService=2\r\nDLPath=c:\\bda\\\r\nOther=kept\r\n");
  EXPECT_TRUE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
  EXPECT_EQ(ini_.GetSetting("Download", "DataService"), "2");
  EXPECT_EQ(ini_.GetSetting("Download", "DLPath"), "c:\\bda\\");
  EXPECT_EQ(ini_.GetSetting("Download", "Other"), "kept");
}

TEST_F(SettingsTest, AFileOfRubbishStartsTheQuestionOfTheDrive) {
  home_.Put("Kora.ini", Rubbish());
  dialogs_.replies = {"C:"};
  EXPECT_TRUE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
  EXPECT_EQ(dialogs_.said.size(), 1u);
  EXPECT_EQ(settings_.Zoom, 100);
  EXPECT_EQ(ini_.GetSetting("KoraPaths", "System"), "C:\\korawin\\");
}

TEST_F(SettingsTest, AFolderInPlaceOfTheFileIsTold) {
  home_.Put("Kora.ini/inner", "");
  EXPECT_FALSE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
  ASSERT_EQ(dialogs_.said.size(), 1u);
  EXPECT_NE(dialogs_.said[0].text.find("can't be read"), std::string::npos);
}

// ---- writing

TEST_F(SettingsTest, SavePathsWritesFoldersServiceAndDrive) {
  Read("");
  settings_.paths.SystemPath = "f:\\k\\";
  settings_.paths.CurrentDataPath = "f:\\d\\";
  settings_.paths.ChartBackupPath = "f:\\b\\";
  settings_.paths.PfmDataPath = "f:\\p\\";
  settings_.paths.PfmBackupPath = "f:\\pb\\";
  settings_.download.DataService = 5;
  settings_.download.DLPath = "f:\\dl\\";
  SavePaths(ini_, settings_);
  EXPECT_EQ(settings_.paths.KoraDrv, "f:");
  EXPECT_EQ(settings_.paths.ChartSavePath, "f:\\k\\chtsave\\");
  EXPECT_EQ(home_.Get("Kora.ini"),
            "[KoraPaths]\r\nSystem=f:\\k\\\r\nChtData=f:\\d\\\r\nChtBackUp=f:\\b\\\r\n"
            "PFMData=f:\\p\\\r\nPFMBackUp=f:\\pb\\\r\n\r\n[KoraDisk]\r\nKoraDrv=f:\r\n\r\n"
            "[Download]\r\nDataService=5\r\nDLPath=f:\\dl\\\r\n");
}

TEST_F(SettingsTest, AFailingWriteIsPassedOverAndLeavesTheOldFile) {
  Read("");
  const std::string old = home_.Get("Kora.ini");
  settings_.paths.CurrentDataPath = "c:\\x\\";
  for (int at = 1; at <= 7; ++at) {
    io_.Reset(at);
    SavePaths(ini_, settings_);
    EXPECT_EQ(home_.Get("Kora.ini"), old) << at;
  }
  io_.Reset(8);
  SavePaths(ini_, settings_);
  EXPECT_NE(home_.Get("Kora.ini"), old);
}

TEST_F(SettingsTest, ANewInstallationReadsBackWhole) {
  io_.Reset();
  WriteDefaultSettings(ini_);
  EXPECT_EQ(io_.calls, 5);  // the file is written once
  EXPECT_TRUE(ReadSettings(ini_, home_.files(), dialogs_, settings_));
  EXPECT_TRUE(dialogs_.said.empty());
  EXPECT_EQ(settings_.paths.SystemPath, "c:\\korawin\\");
  EXPECT_EQ(settings_.paths.CurrentDataPath, "c:\\korawin\\data\\");
  EXPECT_EQ(settings_.paths.PfmBackupPath, "c:\\korawin\\pfmback\\");
  EXPECT_EQ(settings_.download.DataService, 4);
  EXPECT_EQ(settings_.download.DLPath, "c:\\korawin\\download\\");
  EXPECT_EQ(settings_.charts.Type, "B");
  EXPECT_EQ(settings_.charts.Spacing, 2);
  EXPECT_TRUE(settings_.charts.GridLines);
  EXPECT_TRUE(settings_.charts.MovingGrid);
  EXPECT_EQ(settings_.charts.BlankSpace, 10);
  EXPECT_EQ(settings_.charts.VolHeight, 2);
  EXPECT_EQ(settings_.fonts.TitleSize, 9.75);
  EXPECT_EQ(settings_.fonts.Font2Size, 6);
  EXPECT_EQ(settings_.fonts.Font1Name, "");
  EXPECT_EQ(settings_.osc.MMASet[11], 60);
  EXPECT_EQ(settings_.Zoom, 100);
}

}  // namespace
}  // namespace kora::test
