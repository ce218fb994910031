#include "shell/new_home.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "shell/session.h"
#include "store/name_file.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

TEST(NewHome, WhatABrokenOffTryLeftIsNeverEmptied) {
  TempHome home;
  ScriptedDialogs dialogs;
  Session session(home.path(), dialogs);
  const std::string name(96, 'x');
  home.Put("drive_c/korawin/data/Names.dat", name);
  home.Put("drive_c/korawin/IndClass.dat", "classes");
  MakeEmptyHome(session.files, session.ini);
  EXPECT_EQ(home.Get("drive_c/korawin/data/Names.dat"), name);
  EXPECT_EQ(home.Get("drive_c/korawin/IndClass.dat"), "classes");
  EXPECT_TRUE(home.Exists("Kora.ini"));
}

TEST(NewHome, TheSettingsFileComesLast) {
  TempHome home;
  ScriptedDialogs dialogs;
  Session session(home.path(), dialogs);
  home.Put("drive_c/korawin/data", "a file where the folder goes");
  EXPECT_THROW(MakeEmptyHome(session.files, session.ini), RunTimeError);
  EXPECT_FALSE(home.Exists("Kora.ini"));
}

TEST(NewHome, AFolderThatIsThereBecomesTheDataFolderUntouched) {
  TempHome home;
  ScriptedDialogs dialogs;
  Session session(home.path(), dialogs);
  home.Put("drive_d/prices/names.DAT", std::string(96, ' '));
  EXPECT_EQ(WhyNoDataFolder(session.files, "d:\\prices\\"), "");
  EXPECT_EQ(WhyNoDataFolder(session.files, "d:\\"), "There is no name file (Names.dat) in d:\\.");
  EXPECT_EQ(WhyNoDataFolder(session.files, "e:\\"), "There is no folder e:\\.");
  MakeHomeOver(session.files, session.ini, "d:\\prices\\");
  ASSERT_TRUE(ReadAllSettings(session, "", false));
  EXPECT_EQ(session.settings.paths.CurrentDataPath, "d:\\prices\\");
  EXPECT_EQ(ReadNames(session.files, "d:\\prices\\").size(), 1u);
  EXPECT_TRUE(home.Exists("drive_c/korawin/download"));
  EXPECT_FALSE(home.Exists("drive_c/korawin/data"));
  EXPECT_TRUE(dialogs.said.empty());
}

}  // namespace
}  // namespace kora::test
