#include "settings/locate.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/support/temp_home.h"

namespace kora {
namespace {

using Names = std::vector<std::string>;

TEST(Locate, EachPlaceOfThePathFormOpensOnItsFolder) {
  Paths paths;
  paths.CurrentDataPath = "c:\\d\\";
  paths.ChartBackupPath = "c:\\b\\";
  ASSERT_TRUE(LocateFor("CPath", 0, paths));
  EXPECT_EQ(LocateFor("CPath", 0, paths)->purpose, "Charting Data File Folder");
  EXPECT_EQ(LocateFor("CPath", 0, paths)->start, "c:\\d\\");
  EXPECT_EQ(LocateFor("CPath", 1, paths)->purpose, "Charting Data Backup");
  EXPECT_EQ(LocateFor("CPath", 1, paths)->start, "c:\\b\\");
  EXPECT_FALSE(LocateFor("CPath", 2, paths));
  EXPECT_FALSE(LocateFor("Nobody", 0, paths));
}

TEST(Locate, DrivesThatAreThereWithCFirst) {
  test::TempHome home;
  home.Put("drive_a/x", "");
  home.Put("drive_e/x", "");
  const Names drives = Drives(home.files());
  ASSERT_GE(drives.size(), 3u);
  EXPECT_EQ(drives[0], "C:");
  EXPECT_EQ(drives[1], "A:");
  EXPECT_EQ(drives[2], "E:");
  EXPECT_EQ(std::count(drives.begin(), drives.end(), "D:"), 0);
}

TEST(Locate, FoldersWithoutTheFilesBesideThem) {
  test::TempHome home;
  home.Put("drive_c/korawin/data/Names.dat", "");
  home.Put("drive_c/korawin/Kora32.exe", "");
  home.Put("drive_c/korawin/backup/x", "");
  EXPECT_EQ(SubFolders(home.files(), "c:\\korawin\\"), (Names{"backup", "data"}));
  EXPECT_EQ(SubFolders(home.files(), "c:\\korawin\\data"), Names{});
  EXPECT_EQ(SubFolders(home.files(), "c:\\none"), Names{});
  EXPECT_EQ(SubFolders(home.files(), ""), Names{});
}

TEST(Locate, TheNearestFolderThatIsThere) {
  test::TempHome home;
  home.Put("drive_c/korawin/data/Names.dat", "");
  const Files& files = home.files();
  EXPECT_EQ(NearestFolder(files, "c:\\korawin\\data\\"), "c:\\korawin\\data\\");
  EXPECT_EQ(NearestFolder(files, " c:\\korawin\\none\\deep "), "c:\\korawin\\");
  EXPECT_EQ(NearestFolder(files, "c:\\none"), "c:\\");
  EXPECT_EQ(NearestFolder(files, "c:"), "c:\\");
  for (const char* bad : {"", "\\", "korawin", "..\\..", "\\\\host\\share"})
    EXPECT_EQ(NearestFolder(files, bad), "") << bad;
}

TEST(Locate, ParentsEndAtTheRoot) {
  EXPECT_EQ(ParentFolder("c:\\a\\b\\"), "c:\\a\\");
  EXPECT_EQ(ParentFolder("c:\\a"), "c:\\");
  EXPECT_EQ(ParentFolder("c:\\"), "c:\\");
}

}  // namespace
}  // namespace kora
