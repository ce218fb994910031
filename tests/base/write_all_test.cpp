#include <gtest/gtest.h>

#include <filesystem>

#include "base/files.h"
#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::ErrorOf;
using kora::test::FailingIo;
using kora::test::ForwardingFile;
using kora::test::ForwardingIo;
using kora::test::TempHome;

namespace {

// Runs a replacement with a failure at the first, second, ... call until one goes through;
// `check` sees the home after each failure.
template <typename Check>
int FailAtEveryCall(bool lasting, bool torn, std::string_view old, Check check) {
  for (int at = 1;; ++at) {
    FailingIo io;
    TempHome home(io);
    if (!old.empty()) home.Put("drive_c/Names.dat", old);
    io.Reset(at);
    io.lasting = lasting;
    io.torn = torn;
    const int error = ErrorOf([&] { home.files().WriteAll("c:\\NAMES.DAT", "new content"); });
    if (io.calls < at) {
      EXPECT_EQ(error, 0);
      return at - 1;
    }
    EXPECT_EQ(error, 61) << "call " << at;
    check(home, at);
  }
}

}  // namespace

TEST(WriteAllTest, FailureAtAnyCallLeavesTheOldFileAndNoTrash) {
  const int calls = FailAtEveryCall(false, true, "old", [](TempHome& home, int at) {
    EXPECT_EQ(home.Get("drive_c/Names.dat"), "old") << at;
    EXPECT_EQ(home.files().List("c:\\").size(), 1u) << at;
  });
  // The temporary file opened, given the old one's access, written and flushed, the old one kept
  // aside, the new one renamed over it, the folder flushed.
  EXPECT_EQ(calls, 7);
}

TEST(WriteAllTest, DiskThatStaysBrokenLeavesTheOldFileOrTheNewOne) {
  FailAtEveryCall(true, true, "old", [](TempHome& home, int at) {
    // Behind the renaming nothing can be brought back any more: the new file is whole.
    EXPECT_EQ(home.Get("drive_c/Names.dat"), at < 7 ? "old" : "new content") << at;
  });
}

TEST(WriteAllTest, FailureWhereThereWasNoFileLeavesNone) {
  FailAtEveryCall(false, false, "", [](TempHome& home, int at) {
    EXPECT_TRUE(home.files().List("c:\\").empty()) << at;
    EXPECT_FALSE(home.files().CheckFile("c:\\Names.dat")) << at;
  });
}

TEST(WriteAllTest, NextWriteClearsAwayWhatACrashLeft) {
  FailingIo io;
  TempHome home(io);
  home.Put("drive_c/a.txt", "old");
  io.Reset(3);
  io.lasting = io.torn = true;
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\a.txt", "a longer text"); }), 61);
  EXPECT_EQ(home.files().List("c:\\").size(), 2u);  // the torn temporary file could not be removed
  io.Reset();
  home.files().WriteAll("c:\\a.txt", "new");
  EXPECT_EQ(home.Get("drive_c/a.txt"), "new");
  EXPECT_EQ(home.files().List("c:\\").size(), 1u);
}

TEST(WriteAllTest, AFileThatAnotherWriterIsMakingIsLeftAlone) {
  TempHome home;
  home.Put("drive_c/a.txt", "old");
  const std::string beside = home.path() + "/drive_c/a.txt.tmp~";
  const auto another = MachineIo().Open(beside, OpenMode::kNew);
  another->WriteAt(0, "another's", 9);
  home.files().WriteAll("c:\\a.txt", "new");
  EXPECT_EQ(home.Get("drive_c/a.txt"), "new");
  EXPECT_EQ(home.Get("drive_c/a.txt.tmp~"), "another's");
  EXPECT_EQ(home.files().List("c:\\").size(), 2u);
}

TEST(WriteAllTest, ALinkUnderTheTemporaryNameIsNotFollowed) {
  TempHome home;
  home.Put("drive_c/a.txt", "old");
  home.Put("precious", "kept");
  std::filesystem::create_symlink(home.path() + "/precious", home.path() + "/drive_c/a.txt.tmp~");
  home.files().WriteAll("c:\\a.txt", "new");
  EXPECT_EQ(home.Get("drive_c/a.txt"), "new");
  EXPECT_EQ(home.Get("precious"), "kept");
  EXPECT_TRUE(std::filesystem::is_symlink(home.path() + "/drive_c/a.txt.tmp~"));
}

TEST(WriteAllTest, ALinkedFileIsReplacedAtItsTarget) {
  TempHome home;
  home.Put("elsewhere/real.txt", "old");
  home.Put("drive_c/b.txt", "");
  std::filesystem::create_symlink("../elsewhere/real.txt", home.path() + "/drive_c/a.txt");
  std::filesystem::create_symlink("a.txt", home.path() + "/drive_c/c.txt");
  home.files().WriteAll("c:\\c.txt", "new");
  EXPECT_EQ(home.Get("elsewhere/real.txt"), "new");
  EXPECT_TRUE(std::filesystem::is_symlink(home.path() + "/drive_c/a.txt"));
  EXPECT_TRUE(std::filesystem::is_symlink(home.path() + "/drive_c/c.txt"));
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(home.path() + "/elsewhere"), {}), 1);
}

TEST(WriteAllTest, LinksInACircleAreError75) {
  TempHome home;
  std::filesystem::create_symlink("b.txt", home.path() + "/drive_c/a.txt");
  std::filesystem::create_symlink("a.txt", home.path() + "/drive_c/b.txt");
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\a.txt", "new"); }), 75);
}

TEST(WriteAllTest, TheNewFileHasTheModeOfTheOldOne) {
  TempHome home;
  home.Put("drive_c/a.txt", "old");
  const std::filesystem::path path = home.path() + "/drive_c/a.txt";
  for (const unsigned mode : {0600u, 0664u, 0640u}) {
    std::filesystem::permissions(path, std::filesystem::perms(mode));
    home.files().WriteAll("c:\\a.txt", "new");
    EXPECT_EQ(unsigned(std::filesystem::status(path).permissions()), mode);
  }
}

TEST(WriteAllTest, AReadOnlyFileIsRefusedByName) {
  TempHome home;
  home.Put("drive_c/a.txt", "old");
  std::filesystem::permissions(home.path() + "/drive_c/a.txt", std::filesystem::perms(0444));
  try {
    home.files().WriteAll("c:\\A.TXT", "new");
    FAIL() << "written";
  } catch (const RunTimeError& e) {
    EXPECT_EQ(e.number(), kPathAccess);
    EXPECT_STREQ(e.what(), "a.txt is read-only");
  }
  EXPECT_EQ(home.Get("drive_c/a.txt"), "old");
  EXPECT_EQ(home.files().List("c:\\").size(), 1u);
}

TEST(WriteAllTest, BytesAreOnTheDiskBeforeTheNameIs) {
  // The order is what makes a crash harmless: a rename before the flush could leave an empty file.
  struct Recording : ForwardingIo {
    std::string calls;
    struct File : ForwardingFile {
      File(std::unique_ptr<HostFile> f, std::string& c) : ForwardingFile(std::move(f)), calls(c) {}
      ~File() override { calls += "close "; }
      void WriteAt(std::uint64_t o, const void* d, size_t n) override {
        calls += "write ";
        base_->WriteAt(o, d, n);
      }
      void Flush() override {
        calls += "flush ";
        base_->Flush();
      }
      std::string& calls;
    };
    std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
      calls += "open ";
      return std::make_unique<File>(MachineIo().Open(path, mode), calls);
    }
    void Rename(const std::string& from, const std::string& to) override {
      calls += "rename ";
      MachineIo().Rename(from, to);
    }
    void FlushFolder(const std::string& folder) override {
      calls += "folder ";
      MachineIo().FlushFolder(folder);
    }
  } io;
  TempHome home(io);
  home.files().WriteAll("c:\\a.txt", "x");
  EXPECT_EQ(io.calls, "open write flush rename close folder ");
}

TEST(WriteAllTest, AFolderInThePlaceOfTheFileIsError75) {
  TempHome home;
  home.Put("drive_c/folder/x", "x");
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\folder", "f"); }), 75);
  EXPECT_EQ(home.Get("drive_c/folder/x"), "x");
  EXPECT_EQ(home.files().List("c:\\").size(), 1u);
}

TEST(WriteAllTest, EmptyTextEmptiesTheFile) {
  TempHome home;
  home.Put("drive_c/a.txt", "old");
  home.files().WriteAll("c:\\a.txt", "");
  EXPECT_TRUE(home.Exists("drive_c/a.txt"));
  EXPECT_EQ(home.Get("drive_c/a.txt"), "");
}
