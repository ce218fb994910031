#include "shell/session.h"

#include <gtest/gtest.h>

#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

struct SessionTest : testing::Test {
  test::TempHome home;
  test::ScriptedDialogs dialogs;
  Session session{home.path(), dialogs};
};

TEST_F(SessionTest, StartUpReadsSettingsAndMakesTheTwoFolders) {
  WriteDefaultSettings(session.ini);
  EXPECT_TRUE(ReadAllSettings(session, "XT", false));
  EXPECT_TRUE(session.settings.words.OptionXT);
  EXPECT_TRUE(session.settings.words.StochSignals);
  EXPECT_EQ(session.settings.paths.CurrentDataPath, "c:\\korawin\\data\\");
  EXPECT_EQ(session.settings.paths.ChartMiscPath, "c:\\korawin\\chtmisc\\");
  EXPECT_TRUE(home.Exists("drive_c/korawin/chtmisc"));
  EXPECT_TRUE(home.Exists("drive_c/korawin/chtsave"));
  EXPECT_EQ(session.colours[kChartLines], StandardColours()[15]);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(SessionTest, AMissingSettingsFileStartsThePromptOfTheDrive) {
  EXPECT_FALSE(ReadAllSettings(session, "", false));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Drive");
  dialogs.replies = {"C"};
  EXPECT_TRUE(ReadAllSettings(session, "", false));
  EXPECT_EQ(session.settings.paths.SystemPath, "C:\\korawin\\");
  EXPECT_EQ(session.ini.GetSetting("KoraPaths", "System"), "C:\\korawin\\");
  // What a new installation has on.
  for (const char* key : {"DarkPaper", "FitSide", "KeepOsc", "Legible"})
    EXPECT_EQ(session.ini.GetSetting("Charts", key), "True") << key;
  EXPECT_TRUE(session.settings.charts.Legible);
}

TEST_F(SessionTest, TheTwoPrinterQuestionsComeOnceWhenThereIsNoAnswerYet) {
  WriteDefaultSettings(session.ini);
  dialogs.answers = {Answer::kYes, Answer::kNo};
  EXPECT_TRUE(ReadAllSettings(session, "", true));
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text, "  Do you have a Colour Printer ?");
  EXPECT_EQ(dialogs.said[1].text, "Print the colour WHITE as BLACK ?");
  EXPECT_TRUE(ReadAllSettings(session, "", true));
  EXPECT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(session.printer.ColourPrinter, 1);
  EXPECT_EQ(session.printer.WhiteAsBlack, 0);
}

TEST_F(SessionTest, AnOverrideHoldsForTheRunAndIsNotWritten) {
  WriteDefaultSettings(session.ini);
  session.ini.Override("Charts", "Av1D", "30");
  EXPECT_TRUE(ReadAllSettings(session, "", false));
  EXPECT_EQ(session.settings.charts.Av1D, 30);
  EXPECT_EQ(home.Get("Kora.ini").find("Av1D=30"), std::string::npos);
}

TEST_F(SessionTest, PerUserValuesAreEmptyUntilSaved) {
  EXPECT_EQ(session.UserSetting("Height"), "");
  session.SaveUserSetting("Height", "7000");
  EXPECT_EQ(session.UserSetting("Height"), "7000");
  Session again(home.path(), dialogs);
  EXPECT_EQ(again.UserSetting("Height"), "7000");
}

TEST_F(SessionTest, TwoSessionsStandBesideEachOther) {
  test::TempHome other;
  Session second(other.path(), dialogs);
  WriteDefaultSettings(session.ini);
  WriteDefaultSettings(second.ini);
  second.ini.PutSetting("KoraPaths", "ChtData", "e:\\prices\\");
  EXPECT_TRUE(ReadAllSettings(session, "", false));
  EXPECT_TRUE(ReadAllSettings(second, "A", false));
  EXPECT_EQ(session.settings.paths.CurrentDataPath, "c:\\korawin\\data\\");
  EXPECT_EQ(second.settings.paths.CurrentDataPath, "e:\\prices\\");
  EXPECT_FALSE(session.settings.words.NoDownloads);
}

}  // namespace
}  // namespace kora
