#include "base/files.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>

#include "tests/support/counting_io.h"
#include "tests/support/error_of.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::CountingIo;
using kora::test::ErrorOf;
using kora::test::TempHome;
namespace fs = std::filesystem;

namespace {

struct timespec ModifiedOf(const std::string& path) {
  struct stat st {};
  ::stat(path.c_str(), &st);
  return st.st_mtim;
}

// As a change within one tick of the clock leaves the time.
void SetModified(const std::string& path, struct timespec time) {
  const struct timespec times[2] = {time, time};
  ASSERT_EQ(::utimensat(AT_FDCWD, path.c_str(), times, 0), 0);
}

struct timespec LongAgo() {
  return {1'000'000'000, 0};
}

void Touch(Files& files, const std::string& path) { files.Open(path, OpenMode::kCreate); }

}  // namespace

// ---- where a path leads

TEST(HostPathTest, DrivesAreFoldersOfTheHome) {
  TempHome home;
  const Files& files = home.files();
  EXPECT_EQ(files.HostPath("c:\\a.txt"), home.path() + "/drive_c/a.txt");
  EXPECT_EQ(files.HostPath("C:\\korawin\\a.txt"), home.path() + "/drive_c/korawin/a.txt");
  EXPECT_EQ(files.HostPath("D:/x/y"), home.path() + "/drive_d/x/y");
  EXPECT_EQ(files.HostPath("a.txt"), home.path() + "/drive_c/a.txt");
  EXPECT_EQ(files.HostPath("c:a.txt"), home.path() + "/drive_c/a.txt");
  EXPECT_EQ(files.HostPath("c:"), home.path() + "/drive_c");
  EXPECT_EQ(files.HostPath("c:\\"), home.path() + "/drive_c");
}

TEST(HostPathTest, ZIsTheHostsRoot) {
  TempHome home;
  home.Put("x:y.csv", "1");
  EXPECT_EQ(home.files().HostPath("Z:\\"), "/");
  EXPECT_EQ(home.files().HostPath("z:\\nowhere\\a"), "/nowhere/a");
  // A colon is a letter like others in a host's file name.
  EXPECT_EQ(home.files().ReadAll("z:" + home.path() + "/x:y.csv"), "1");
}

TEST(HostPathTest, WindowsFolderIsTheHomeItself) {
  TempHome home;
  home.Put("Kora.ini", "i");
  const Files& files = home.files();
  EXPECT_EQ(files.HostPath("C:\\WINDOWS\\Kora.ini"), home.path() + "/Kora.ini");
  EXPECT_EQ(files.HostPath("c:\\windows\\"), home.path());
  EXPECT_EQ(files.HostPath("c:\\windows"), home.path());
  EXPECT_TRUE(files.IsFolder("C:\\Windows"));
  EXPECT_EQ(files.ReadAll("c:\\windows\\KORA.INI"), "i");
  EXPECT_EQ(files.HostPath("c:\\windows\\system\\x"), home.path() + "/system/x");
  EXPECT_EQ(files.HostPath("d:\\windows\\x"), home.path() + "/drive_d/windows/x");
  EXPECT_EQ(files.HostPath("c:\\korawin\\windows"), home.path() + "/drive_c/korawin/windows");
}

TEST(HostPathTest, DotsNeverClimbAboveTheDrive) {
  TempHome home;
  home.Put("secret", "s");
  const Files& files = home.files();
  const std::string drive = home.path() + "/drive_c";
  for (const char* path : {"c:\\..\\secret", "c:\\..\\..\\..\\secret", "c:..\\secret", "..\\secret",
                           "c:/../secret", "c:\\a\\..\\..\\secret", "c:\\.\\..\\.\\secret"})
    EXPECT_EQ(files.HostPath(path), drive + "/secret") << path;
  for (const char* path : {"c:\\..", "c:\\..\\", "..", ".", "c:..", "c:\\a\\..\\..", "c:\\.\\."})
    EXPECT_EQ(files.HostPath(path), drive) << path;
  EXPECT_EQ(files.HostPath("c:\\windows\\..\\secret"), drive + "/secret");
  EXPECT_FALSE(files.CheckFile("c:\\..\\secret"));
  EXPECT_EQ(ErrorOf([&] { files.ReadAll("c:\\..\\secret"); }), 53);
}

TEST(HostPathTest, WhatIsNoPathIsError52) {
  TempHome home;
  const Files& files = home.files();
  using namespace std::string_view_literals;
  for (const std::string_view path :
       {""sv, "1:\\a"sv, "::"sv, "c:\\a\0b"sv, "\0"sv, "c:\\x\0\\a"sv}) {
    EXPECT_EQ(ErrorOf([&] { files.HostPath(path); }), 52) << path;
    EXPECT_EQ(ErrorOf([&] { files.Open(path, OpenMode::kRead); }), 52) << path;
    EXPECT_EQ(ErrorOf([&] { files.WriteAll(path, ""); }), 52) << path;
    EXPECT_FALSE(files.CheckFile(path)) << path;
    EXPECT_FALSE(files.IsFolder(path)) << path;
  }
  EXPECT_EQ(ErrorOf([&] { files.Open("c:\\", OpenMode::kRead); }), 52);
  EXPECT_EQ(ErrorOf([&] { files.Open("c:\\" + std::string(300, 'x'), OpenMode::kRead); }), 52);
}

TEST(HostPathTest, NulInANameOfAKnownFolderIsError52) {
  TempHome home;
  home.Put("drive_c/a", "1");
  home.files().ReadAll("c:\\a");
  EXPECT_EQ(ErrorOf([&] { home.files().ReadAll(std::string_view("c:\\a\0b", 6)); }), 52);
}

TEST(DosPathTest, NamesAFileOnItsDrive) {
  TempHome home;
  const Files& files = home.files();
  EXPECT_EQ(files.DosPath(home.path() + "/drive_c/korawin/a.txt"), "c:\\korawin\\a.txt");
  EXPECT_EQ(files.DosPath("/usr/share/x"), "Z:\\usr\\share\\x");
  EXPECT_EQ(files.HostPath(files.DosPath("/usr/share/x")), "/usr/share/x");
}

TEST(FilesTest, EmptyHomeIsNotTheRoot) {
  EXPECT_EQ(Files("").HostPath("c:\\a"), "./drive_c/a");
  EXPECT_EQ(Files("h//").HostPath("c:\\a"), "h/drive_c/a");
}

TEST(WithBackslashTest, ClosesAFolder) {
  EXPECT_EQ(WithBackslash("c:\\a"), "c:\\a\\");
  EXPECT_EQ(WithBackslash("c:\\a\\"), "c:\\a\\");
  EXPECT_EQ(WithBackslash("c:/a/"), "c:/a/");
  EXPECT_EQ(WithBackslash(""), "");
}

// ---- any case

TEST(AnyCaseTest, FindsFilesAndFoldersInAnotherCase) {
  TempHome home;
  home.Put("drive_c/KoraWin/Data/Names.dat", "n");
  const Files& files = home.files();
  EXPECT_EQ(files.ReadAll("c:\\korawin\\DATA\\NAMES.DAT"), "n");
  EXPECT_TRUE(files.CheckFile("C:\\KORAWIN\\data\\names.DAT"));
  EXPECT_TRUE(files.IsFolder("C:\\KORAWIN\\data"));
  EXPECT_TRUE(files.IsFolder("C:\\KORAWIN\\data\\"));
  EXPECT_EQ(files.HostPath("c:\\korawin\\data\\NEW.DAT"),
            home.path() + "/drive_c/KoraWin/Data/NEW.DAT");
}

TEST(AnyCaseTest, WritingKeepsTheNameThatIsThere) {
  TempHome home;
  home.Put("drive_c/Names.dat", "old");
  home.files().WriteAll("c:\\NAMES.DAT", "new");
  EXPECT_EQ(home.Get("drive_c/Names.dat"), "new");
  EXPECT_FALSE(home.Exists("drive_c/NAMES.DAT"));
  home.files().Open("c:\\NAMES.DAT", OpenMode::kReplace);
  EXPECT_EQ(home.Get("drive_c/Names.dat"), "");
  EXPECT_EQ(home.files().List("c:\\").size(), 1u);
}

TEST(AnyCaseTest, ExactNameWinsAndOtherwiseTheFirstByBytes) {
  TempHome home;
  home.Put("drive_c/bhp.wdt", "lower");
  home.Put("drive_c/BHP.wdt", "upper");
  const Files& files = home.files();
  EXPECT_EQ(files.ReadAll("c:\\bhp.wdt"), "lower");
  EXPECT_EQ(files.ReadAll("c:\\BHP.wdt"), "upper");
  EXPECT_EQ(files.ReadAll("c:\\Bhp.Wdt"), "upper");
}

TEST(AnyCaseTest, RemovingOneOfTwoTwinsLeavesTheOther) {
  TempHome home;
  home.Put("drive_c/bhp.wdt", "lower");
  home.Put("drive_c/BHP.wdt", "upper");
  SetModified(home.path() + "/drive_c", LongAgo());
  const Files& files = home.files();
  EXPECT_EQ(files.ReadAll("c:\\Bhp.Wdt"), "upper");
  files.Remove("c:\\Bhp.Wdt");
  EXPECT_FALSE(home.Exists("drive_c/BHP.wdt"));
  EXPECT_EQ(files.ReadAll("c:\\Bhp.Wdt"), "lower");
  files.Remove("c:\\Bhp.Wdt");
  EXPECT_FALSE(files.CheckFile("c:\\Bhp.Wdt"));
}

TEST(AnyCaseTest, RenameThatChangesTheCaseAlone) {
  TempHome home;
  home.Put("drive_c/bhp.wdt", "1");
  home.files().Rename("c:\\BHP.WDT", "c:\\BHP.WDT");
  EXPECT_TRUE(home.Exists("drive_c/BHP.WDT"));
  EXPECT_FALSE(home.Exists("drive_c/bhp.wdt"));
}

// ---- what the folder listings remember

TEST(ListingTest, FollowsTheProgramsOwnChanges) {
  TempHome home;
  home.Put("drive_c/a.txt", "a");
  SetModified(home.path() + "/drive_c", LongAgo());
  Files& files = home.files();
  EXPECT_TRUE(files.CheckFile("c:\\A.TXT"));
  Touch(files, "c:\\b.txt");
  EXPECT_TRUE(files.CheckFile("c:\\B.TXT"));
  files.WriteAll("c:\\c.txt", "c");
  EXPECT_TRUE(files.CheckFile("c:\\C.TXT"));
  files.Remove("c:\\B.TXT");
  EXPECT_FALSE(files.CheckFile("c:\\B.TXT"));
  EXPECT_FALSE(files.CheckFile("c:\\b.txt"));
  files.Rename("c:\\C.TXT", "c:\\d.old");
  EXPECT_FALSE(files.CheckFile("c:\\C.TXT"));
  EXPECT_EQ(files.ReadAll("c:\\D.OLD"), "c");
  files.MakeFolder("c:\\Sub\\Inner");
  EXPECT_TRUE(files.IsFolder("c:\\SUB\\INNER"));
  files.Rename("c:\\d.old", "c:\\SUB\\d.new");
  EXPECT_FALSE(files.CheckFile("c:\\D.OLD"));
  EXPECT_EQ(files.ReadAll("c:\\sub\\D.NEW"), "c");
  files.Rename("c:\\sub", "c:\\Moved");
  EXPECT_FALSE(files.CheckFile("c:\\sub\\D.NEW"));
  EXPECT_EQ(files.ReadAll("c:\\MOVED\\D.NEW"), "c");
}

TEST(ListingTest, SeesForeignChanges) {
  TempHome home;
  home.Put("drive_c/a.txt", "a");
  SetModified(home.path() + "/drive_c", LongAgo());
  Files& files = home.files();
  EXPECT_TRUE(files.CheckFile("c:\\A.TXT"));
  home.Put("drive_c/b.txt", "b");
  EXPECT_EQ(files.ReadAll("c:\\B.TXT"), "b");
  fs::remove(home.path() + "/drive_c/a.txt");
  EXPECT_FALSE(files.CheckFile("c:\\A.TXT"));
  fs::rename(home.path() + "/drive_c/b.txt", home.path() + "/drive_c/B.txt");
  EXPECT_EQ(files.ReadAll("c:\\b.TXT"), "b");
}

TEST(ListingTest, SeesForeignChangesThatLeaveTheFoldersTimeAsItWas) {
  TempHome home;
  home.Put("drive_c/a.txt", "a");
  Files& files = home.files();
  const std::string folder = home.path() + "/drive_c";
  EXPECT_TRUE(files.CheckFile("c:\\A.TXT"));
  const struct timespec time = ModifiedOf(folder);

  home.Put("drive_c/b.txt", "b");
  SetModified(folder, time);
  EXPECT_EQ(files.ReadAll("c:\\B.TXT"), "b");

  fs::rename(folder + "/b.txt", folder + "/B.txt");
  SetModified(folder, time);
  EXPECT_EQ(files.ReadAll("c:\\b.TXT"), "b");
  EXPECT_TRUE(files.CheckFile("c:\\b.Txt"));
}

TEST(ListingTest, ForeignChangeInTheTickOfAnOwnOneIsSeen) {
  TempHome home;
  home.Put("drive_c/a.txt", "a");
  Files& files = home.files();
  EXPECT_TRUE(files.CheckFile("c:\\A.TXT"));
  Touch(files, "c:\\own.txt");
  const struct timespec time = ModifiedOf(home.path() + "/drive_c");
  home.Put("drive_c/b.txt", "b");
  SetModified(home.path() + "/drive_c", time);
  EXPECT_EQ(files.ReadAll("c:\\B.TXT"), "b");
}

TEST(ListingTest, SettledFolderIsReadOnce) {
  CountingIo io;
  TempHome home(io);
  for (int i = 0; i < 20; ++i) home.Put("drive_c/f" + std::to_string(i), "x");
  SetModified(home.path() + "/drive_c", LongAgo());
  for (int i = 0; i < 20; ++i) {
    EXPECT_TRUE(home.files().CheckFile("c:\\F" + std::to_string(i)));
    EXPECT_FALSE(home.files().CheckFile("c:\\none" + std::to_string(i)));
  }
  EXPECT_EQ(io.lists, 1);
}

TEST(ListingTest, ThousandsOfNewFilesDoNotReadTheFolderAgain) {
  CountingIo io;
  TempHome home(io);
  home.files().MakeFolder("c:\\data");
  for (int i = 0; i < 3000; ++i) Touch(home.files(), "c:\\data\\C" + std::to_string(i) + ".WDT");
  EXPECT_LE(io.lists, 4);
  EXPECT_EQ(home.files().List("c:\\data").size(), 3000u);
  EXPECT_TRUE(home.files().CheckFile("c:\\data\\c2999.wdt"));
}

TEST(ListingTest, ThousandsOfRenamesDoNotReadTheFolderAgain) {
  CountingIo io;
  TempHome home(io);
  home.files().MakeFolder("c:\\data");
  for (int i = 0; i < 1000; ++i) Touch(home.files(), "c:\\data\\C" + std::to_string(i) + ".WDT");
  io.lists = 0;
  for (int i = 0; i < 1000; ++i) {
    const std::string stem = "c:\\data\\C" + std::to_string(i);
    home.files().Rename(stem + ".WDT", stem + ".OLD");
    Touch(home.files(), stem + ".WDT");
  }
  EXPECT_LE(io.lists, 4);
  EXPECT_EQ(home.files().List("c:\\data").size(), 2000u);
}

TEST(ListingTest, ExactNameAsksTheHostForNothingButTheFile) {
  CountingIo io;
  TempHome home(io);
  home.Put("drive_c/data/BHP.WDT", "x");
  home.files().Open("c:\\data\\BHP.WDT", OpenMode::kRead);
  io.stats = io.opens = 0;
  home.files().Open("c:\\data\\BHP.WDT", OpenMode::kRead);
  EXPECT_EQ(io.opens, 1);
  EXPECT_EQ(io.stats, 0);
  EXPECT_EQ(io.lists, 0);
}

TEST(ListingTest, FilesInAnotherCaseCostOneLookAtTheFolderEach) {
  CountingIo io;
  TempHome home(io);
  for (int i = 0; i < 10; ++i)
    home.Put("drive_c/c" + std::to_string(i) + ".wdt", std::to_string(i));
  SetModified(home.path() + "/drive_c", LongAgo());
  EXPECT_EQ(home.files().ReadAll("c:\\C0.WDT"), "0");
  io.stats = io.opens = 0;
  for (int i = 1; i < 10; ++i)
    EXPECT_EQ(home.files().ReadAll("c:\\C" + std::to_string(i) + ".WDT"), std::to_string(i));
  EXPECT_EQ(io.opens, 9);
  EXPECT_EQ(io.stats, 9);
  EXPECT_EQ(io.lists, 1);
}

TEST(ListingTest, ExactNameThatAppearsBesideTheOtherCaseWins) {
  TempHome home;
  for (const char* name : {"a.wdt", "b.wdt"}) home.Put(std::string("drive_c/") + name, "lower");
  SetModified(home.path() + "/drive_c", LongAgo());
  EXPECT_EQ(home.files().ReadAll("c:\\A.WDT"), "lower");
  EXPECT_EQ(home.files().ReadAll("c:\\B.WDT"), "lower");
  home.Put("drive_c/A.WDT", "upper");
  EXPECT_EQ(home.files().ReadAll("c:\\A.WDT"), "upper");
  EXPECT_EQ(home.files().ReadAll("c:\\B.WDT"), "lower");
  EXPECT_EQ(home.files().ReadAll("c:\\a.wdt"), "lower");
}

TEST(ListingTest, FileInAnotherCaseThatWentAwayIsError53) {
  TempHome home;
  home.Put("drive_c/a.wdt", "1");
  home.Put("drive_c/b.wdt", "1");
  SetModified(home.path() + "/drive_c", LongAgo());
  EXPECT_EQ(home.files().ReadAll("c:\\A.WDT"), "1");
  fs::rename(home.path() + "/drive_c/b.wdt", home.path() + "/drive_c/B.wdt");
  EXPECT_EQ(home.files().ReadAll("c:\\B.WDT"), "1");
  fs::remove(home.path() + "/drive_c/B.wdt");
  EXPECT_EQ(ErrorOf([&] { home.files().ReadAll("c:\\B.WDT"); }), 53);
}

TEST(ListingTest, FolderReplacedByOneInAnotherCaseIsFound) {
  TempHome home;
  home.Put("drive_c/data/a.txt", "1");
  Files& files = home.files();
  EXPECT_EQ(files.ReadAll("c:\\data\\a.txt"), "1");
  fs::rename(home.path() + "/drive_c/data", home.path() + "/drive_c/DATA");
  EXPECT_TRUE(files.CheckFile("c:\\data\\a.txt"));
  EXPECT_EQ(files.ReadAll("c:\\data\\a.txt"), "1");
  files.WriteAll("c:\\data\\b.txt", "2");
  EXPECT_EQ(home.Get("drive_c/DATA/b.txt"), "2");
}

TEST(ListingTest, FolderThatMayNotBeListedStillOpensExactNames) {
  CountingIo io;
  TempHome home(io);
  home.Put("drive_c/a.txt", "a");
  io.refuseLists = true;
  EXPECT_EQ(home.files().ReadAll("c:\\a.txt"), "a");
  EXPECT_FALSE(home.files().CheckFile("c:\\A.TXT"));
  EXPECT_EQ(ErrorOf([&] { home.files().ReadAll("c:\\A.TXT"); }), 53);
  EXPECT_EQ(ErrorOf([&] { home.files().List("c:\\"); }), 75);
}

// ---- the host's own oddities

TEST(FilesTest, SymlinkLoopIsNeitherHangNorFile) {
  TempHome home;
  home.Put("drive_c/x", "");
  fs::create_symlink("loop", home.path() + "/drive_c/loop");
  fs::create_directory_symlink(".", home.path() + "/drive_c/self");
  Files& files = home.files();
  EXPECT_FALSE(files.CheckFile("c:\\loop"));
  EXPECT_FALSE(files.CheckFile("c:\\LOOP"));
  EXPECT_EQ(ErrorOf([&] { files.ReadAll("c:\\loop"); }), 75);
  EXPECT_EQ(ErrorOf([&] { files.ReadAll("c:\\loop\\x"); }), 75);
  EXPECT_EQ(ErrorOf([&] { files.ReadAll("c:\\SELF\\self\\SELF\\x"); }), 0);
}

TEST(FilesTest, FileInThePlaceOfAFolderIsError76) {
  TempHome home;
  home.Put("drive_c/data", "a file");
  EXPECT_EQ(ErrorOf([&] { home.files().ReadAll("c:\\data\\a"); }), 76);
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\data\\a", ""); }), 76);
  EXPECT_EQ(ErrorOf([&] { home.files().List("c:\\data"); }), 76);
  EXPECT_EQ(ErrorOf([&] { home.files().MakeFolder("c:\\data\\b"); }), 75);
  EXPECT_EQ(ErrorOf([&] { home.files().MakeFolder("c:\\data"); }), 75);
  EXPECT_EQ(home.Get("drive_c/data"), "a file");
}

TEST(FilesTest, RemoveAndRenameTellWhatIsMissing) {
  TempHome home;
  home.Put("drive_c/a", "a");
  home.Put("drive_c/folder/b", "b");
  Files& files = home.files();
  EXPECT_EQ(ErrorOf([&] { files.Remove("c:\\none"); }), 53);
  EXPECT_EQ(ErrorOf([&] { files.Remove("c:\\none\\x"); }), 76);
  EXPECT_EQ(ErrorOf([&] { files.Remove("c:\\folder"); }), 75);
  EXPECT_EQ(ErrorOf([&] { files.Rename("c:\\none", "c:\\x"); }), 53);
  EXPECT_EQ(ErrorOf([&] { files.Rename("c:\\a", "c:\\none\\x"); }), 76);
  EXPECT_EQ(ErrorOf([&] { files.Rename("c:\\a", "c:\\folder"); }), 75);
  EXPECT_EQ(home.Get("drive_c/a"), "a");
  files.Rename("c:\\a", "c:\\folder\\B");
  EXPECT_EQ(home.Get("drive_c/folder/b"), "a");
}

TEST(FilesTest, ListIsSortedWithoutRegardToCase) {
  TempHome home;
  for (const char* name : {"b", "A", "c", "a", "_x"}) home.Put(std::string("drive_c/") + name, "");
  EXPECT_EQ(home.files().List("c:\\"), (std::vector<std::string>{"_x", "A", "a", "b", "c"}));
  EXPECT_EQ(ErrorOf([&] { home.files().List("c:\\none"); }), 76);
}

TEST(FilesTest, MakeFolderMakesThoseAboveAndKeepsWhatIsThere) {
  TempHome home;
  home.Put("drive_c/KoraWin/x", "");
  home.files().MakeFolder("c:\\korawin\\a\\b\\");
  EXPECT_TRUE(fs::is_directory(home.path() + "/drive_c/KoraWin/a/b"));
  EXPECT_EQ(ErrorOf([&] { home.files().MakeFolder("c:\\KORAWIN\\A\\B"); }), 0);
  home.files().MakeFolder("e:\\new");
  EXPECT_TRUE(fs::is_directory(home.path() + "/drive_e/new"));
}

TEST(FilesTest, FileLargerThanTheLimitIsError7) {
  TempHome home;
  home.Put("drive_c/a", "12345");
  EXPECT_EQ(home.files().ReadAll("c:\\a", 5), "12345");
  EXPECT_EQ(ErrorOf([&] { home.files().ReadAll("c:\\a", 4); }), 7);
}

TEST(FilesTest, SettledTimeLiesSecondsBack) {
  const auto now = std::chrono::system_clock::now().time_since_epoch();
  const std::int64_t ns = std::chrono::duration_cast<std::chrono::nanoseconds>(now).count();
  EXPECT_FALSE(TimeIsSettled(ns + 3'600'000'000'000));  // a clock that is ahead
  EXPECT_FALSE(TimeIsSettled(ns + 1));
  EXPECT_TRUE(TimeIsSettled(ns - 10'000'000'000));
}

// ---- codes as file names

TEST(IsFileCodeTest, OrdinaryCodes) {
  for (const char* code : {"BHP", "A", "ABCDEF", " BHP ", "NUL1", "COM", "COM0", "COMX", "CON1",
                           "A.B", "XAO-", "9", "$", "~", "LPTX"})
    EXPECT_TRUE(IsFileCode(code)) << code;
  EXPECT_EQ(CodeFileName("BHP   ", ".WDT"), "BHP.WDT");
}

TEST(IsFileCodeTest, WhatCouldLeaveTheFolderOrIsNoFile) {
  for (const char* code :
       {"",    " ",    "      ", "ABCDEFG", "..",   ".",      "A.",    ".A",  "../A", "..\\A",
        "A/B", "A\\B", "C:",     "C:A",     "A*",   "A?",     "A\"",   "A<",  "A>",   "A|",
        "A\t", "A\nB", "\x7F",   "\x01",    "A B",  "\xE9",   "CON",   "con", "PRN",  "AUX",
        "nul", "NUL.", "NUL.X",  "COM1",    "com9", "LPT1.A", "CONIN$"})
    EXPECT_FALSE(IsFileCode(code)) << code;
  EXPECT_FALSE(IsFileCode(std::string_view("A\0B", 3)));
  EXPECT_FALSE(IsFileCode(std::string_view("\0\0\0\0\0\0", 6)));
  EXPECT_EQ(ErrorOf([] { CodeFileName("..", ".WDT"); }), 52);
}

TEST(IsFileCodeTest, NoByteMakesAPathOfACode) {
  for (int b = 0; b < 256; ++b) {
    const std::string code = {'A', char(b), 'B'};
    const bool word = (b >= 'a' && b <= 'z') || (b >= 'A' && b <= 'Z') || (b >= '0' && b <= '9');
    if (word) {
      EXPECT_TRUE(IsFileCode(code)) << b;
    }
    if (b <= 0x20 || b >= 0x7F || b == '/' || b == '\\' || b == ':') {
      EXPECT_FALSE(IsFileCode(code)) << b;
    }
  }
}

// ---- lines

namespace {
std::vector<std::string> Lines(std::string_view text) {
  std::vector<std::string> out;
  LineReader reader(text);
  std::string_view line;
  while (reader.Next(line)) {
    out.emplace_back(line);
    EXPECT_EQ(reader.number(), int(out.size()));
  }
  return out;
}
}  // namespace

TEST(LineReaderTest, CrLfAndLfAndNoEnd) {
  using V = std::vector<std::string>;
  EXPECT_EQ(Lines(""), V{});
  EXPECT_EQ(Lines("a\r\nb\nc"), (V{"a", "b", "c"}));
  EXPECT_EQ(Lines("a\r\n"), V{"a"});
  EXPECT_EQ(Lines("\r\n\n"), (V{"", ""}));
  EXPECT_EQ(Lines("a\rb\n"), V{"a\rb"});
  EXPECT_EQ(Lines(std::string_view("a\0b\nc", 5)), (V{std::string("a\0b", 3), "c"}));
}
