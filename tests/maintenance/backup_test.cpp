#include "maintenance/backup.h"

#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class BackupTest : public MaintenanceTest {
 protected:
  const std::string kBack = "c:\\korawin\\backup\\";
  const std::string kHostBack = "drive_c/korawin/backup/";
  void Lay() {
    Names({Security("AAA"), Security("BBB")});
    for (const char* code : {"AAA", "BBB"}) Prices(code, {Flat("19980914", 1)});
    home.Put(kHostData + "notes.txt", "a text");
    home.Put(kHostData + "sub/deep.txt", "not copied");
  }
  CopyCount Backup() { return BackupAllFiles(home.files(), kData, kBack, progress, dialogs); }
  CopyCount Restore() { return RestoreAllFiles(home.files(), kData, kBack, progress, dialogs); }
};

}  // namespace

TEST_F(BackupTest, CopiesEveryFileOfTheFolderAndNoSubfolder) {
  Lay();
  const CopyCount count = Backup();
  EXPECT_TRUE(count.done);
  EXPECT_EQ(count.files, 4);
  EXPECT_EQ(LastSaid(), "Directory not found - creating c:\\korawin\\backup");
  EXPECT_EQ(LastTitle(), "Copy Files");
  for (const char* name : {"Names.dat", "AAA.WDT", "BBB.WDT", "notes.txt"})
    EXPECT_EQ(home.Get(kHostBack + name), home.Get(kHostData + name)) << name;
  EXPECT_FALSE(home.Exists(kHostBack + "sub"));
  EXPECT_EQ(progress.items.front(), "From: C:\\KORAWIN\\DATA\\AAA.WDT");
  EXPECT_EQ(progress.notes.front(), "To  : C:\\KORAWIN\\BACKUP\\AAA.WDT");
}

TEST_F(BackupTest, ARestoredFolderHasTheFilesOfTheBackup) {
  Lay();
  ASSERT_TRUE(Backup().done);
  const auto before = Everything();
  Names({});
  Prices("AAA", {});
  std::filesystem::remove(home.path() + "/" + kHostData + "BBB.WDT");
  EXPECT_EQ(Restore().files, 4);
  EXPECT_EQ(Everything(), before);
}

TEST_F(BackupTest, TheCaptionTellsTheDirection) {
  EXPECT_EQ(BackupCaption(home.files(), kData, kData), " Now COPYING Charting Data Files");
  EXPECT_EQ(BackupCaption(home.files(), kBack, kData), " Now RESTORING Charting Data Files");
}

TEST_F(BackupTest, AFolderThatHoldsNoBackupIsRefused) {
  Lay();
  const auto before = Everything();
  EXPECT_FALSE(Restore().done);
  EXPECT_EQ(LastSaid(), "Path not found");
  EXPECT_EQ(LastTitle(), "Copy Files");
  home.Put(kHostBack + "letter.doc", "x");
  EXPECT_FALSE(Restore().done);
  EXPECT_EQ(LastSaid(), "There is no backup in c:\\korawin\\backup\\");
  std::filesystem::remove_all(home.path() + "/" + kHostBack);
  EXPECT_EQ(Everything(), before);
}

TEST_F(BackupTest, OneFolderByAnyNameIsRefused) {
  Lay();
  std::filesystem::create_directory_symlink("data", home.path() + "/drive_c/korawin/link");
  const auto before = Everything();
  for (const char* folder : {"c:\\korawin\\data", "C:\\KoraWin\\DATA\\", "c:\\korawin\\link\\"}) {
    EXPECT_FALSE(BackupAllFiles(home.files(), kData, folder, progress, dialogs).done) << folder;
    EXPECT_EQ(Everything(), before);
  }
}

TEST_F(BackupTest, AFullDiskIsAskedAboutAndTheFileTriedAgain) {
  Lay();
  home.files().MakeFolder(kBack);
  io.Reset(3);
  dialogs.answers = {Answer::kRetry};
  EXPECT_TRUE(Backup().done);
  EXPECT_EQ(home.Get(kHostBack + "notes.txt"), "a text");
  io.Reset(3);
  io.lasting = true;
  dialogs.said.clear();
  dialogs.answers = {Answer::kRetry, Answer::kCancel};
  EXPECT_FALSE(Backup().done);
  EXPECT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(LastSaid(), "Disk full. Put in next diskette ");
  io.Reset();
  io.lasting = false;
}

TEST_F(BackupTest, AnotherFailureStopsWithItsNumber) {
  Lay();
  home.files().MakeFolder(kBack);
  io.Reset(3);
  io.error = kDeviceError;
  EXPECT_FALSE(Backup().done);
  EXPECT_NE(LastSaid().find("Unexpected Error No. 57 Cannot continue"), std::string::npos);
  EXPECT_EQ(LastTitle(), "Copy all Files");
}

TEST_F(BackupTest, AStoppedBackupKeepsWhatWasCopiedAndTellsHowMuch) {
  Lay();
  progress.stopAt = 3;
  const CopyCount count = Backup();
  EXPECT_TRUE(count.stopped);
  EXPECT_FALSE(count.done);
  EXPECT_EQ(count.files, 2);
  EXPECT_EQ(LastSaid(), "Stopped behind 2 files");
  EXPECT_EQ(home.Get(kHostBack + "BBB.WDT"), home.Get(kHostData + "BBB.WDT"));
  EXPECT_FALSE(home.Exists(kHostBack + "Names.dat"));
}

TEST_F(BackupTest, AFileThatCanNotBeCopiedLeavesThoseBeforeItInPlace) {
  Lay();
  home.Put(kHostBack + "Names.dat", "old");
  std::filesystem::permissions(home.path() + "/" + kHostBack + "Names.dat",
                               std::filesystem::perms::owner_read);
  const CopyCount count = Backup();
  EXPECT_FALSE(count.done);
  EXPECT_EQ(count.files, 2);
  EXPECT_EQ(count.last, "BBB.WDT");
  EXPECT_EQ(home.Get(kHostBack + "AAA.WDT"), home.Get(kHostData + "AAA.WDT"));
  EXPECT_EQ(home.Get(kHostBack + "Names.dat"), "old");
  EXPECT_NE(LastSaid().find("Unexpected Error No. 75 Cannot continue"), std::string::npos);
  EXPECT_NE(LastSaid().find("Names.dat"), std::string::npos);
}

TEST_F(BackupTest, OneFileIsCopiedAndTold) {
  Lay();
  EXPECT_TRUE(CopySelectedFile(home.files(), kData, kBack, "AAA.WDT", progress, dialogs));
  EXPECT_EQ(LastSaid(), "File AAA.WDT copied");
  EXPECT_EQ(LastTitle(), "Backup Charting Data");
  EXPECT_FALSE(home.Exists(kHostBack + "BBB.WDT"));
  EXPECT_FALSE(CopySelectedFile(home.files(), kData, kBack, "GONE.WDT", progress, dialogs));
  EXPECT_EQ(LastSaid(), "File not found");
}

TEST_F(BackupTest, AKilledRestoreIsCompletedByTheNext) {
  EXPECT_GT(KilledEverywhere(
                [&] {
                  Names({Security("NEW")});
                  Prices("NEW", {Flat("19980915", 2)});
                  Prices("AAA", {Flat("19980915", 2)});
                  Names({Security("AAA")}, kHostBack);
                  Prices("AAA", {Flat("19980914", 1)}, kHostBack);
                },
                [&] { return Restore().done; }),
            6);
}
