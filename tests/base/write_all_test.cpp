#include <gtest/gtest.h>

#include <filesystem>

#include "base/files.h"
#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::ErrorOf;
using kora::test::FailingIo;
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
  EXPECT_EQ(calls, 4);  // open, write, flush, rename
}

TEST(WriteAllTest, DiskThatStaysBrokenLeavesTheOldFile) {
  FailAtEveryCall(true, true, "old", [](TempHome& home, int at) {
    EXPECT_EQ(home.Get("drive_c/Names.dat"), "old") << at;
  });
}

TEST(WriteAllTest, FailureWhereThereWasNoFileLeavesNone) {
  FailAtEveryCall(false, false, "", [](TempHome& home, int at) {
    EXPECT_TRUE(home.files().List("c:\\").empty()) << at;
    EXPECT_FALSE(home.files().CheckFile("c:\\Names.dat")) << at;
  });
}

TEST(WriteAllTest, NextWriteGoesOverWhatACrashLeft) {
  FailingIo io;
  TempHome home(io);
  home.Put("drive_c/a.txt", "old");
  io.Reset(2);
  io.lasting = io.torn = true;
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\a.txt", "a longer text"); }), 61);
  EXPECT_EQ(home.files().List("c:\\").size(), 2u);  // the torn temporary file could not be removed
  io.Reset();
  home.files().WriteAll("c:\\a.txt", "new");
  EXPECT_EQ(home.Get("drive_c/a.txt"), "new");
  EXPECT_EQ(home.files().List("c:\\").size(), 1u);
}

TEST(WriteAllTest, BytesAreOnTheDiskBeforeTheNameIs) {
  // The order is what makes a crash harmless: a rename before the flush could leave an empty file.
  struct Recording : Io {
    std::string calls;
    struct File : HostFile {
      File(std::unique_ptr<HostFile> f, std::string& c) : base(std::move(f)), calls(c) {}
      ~File() override { calls += "close "; }
      size_t ReadAt(std::uint64_t o, void* d, size_t n) override { return base->ReadAt(o, d, n); }
      void WriteAt(std::uint64_t o, const void* d, size_t n) override {
        calls += "write ";
        base->WriteAt(o, d, n);
      }
      std::uint64_t Size() override { return base->Size(); }
      void Truncate(std::uint64_t n) override { base->Truncate(n); }
      void Flush() override {
        calls += "flush ";
        base->Flush();
      }
      std::unique_ptr<HostFile> base;
      std::string& calls;
    };
    std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
      calls += "open ";
      return std::make_unique<File>(MachineIo().Open(path, mode), calls);
    }
    HostStatus Status(const std::string& path) override { return MachineIo().Status(path); }
    std::vector<std::string> List(const std::string& f) override { return MachineIo().List(f); }
    void MakeFolder(const std::string& path) override { MachineIo().MakeFolder(path); }
    void Remove(const std::string& path) override { MachineIo().Remove(path); }
    void Rename(const std::string& from, const std::string& to) override {
      calls += "rename ";
      MachineIo().Rename(from, to);
    }
  } io;
  TempHome home(io);
  home.files().WriteAll("c:\\a.txt", "x");
  EXPECT_EQ(io.calls, "open write flush close rename ");
}

TEST(WriteAllTest, FolderInThePlaceOfTheFileOrOfItsTemporaryIsError75) {
  TempHome home;
  home.Put("drive_c/folder/x", "x");
  home.Put("drive_c/a.txt", "old");
  home.Put("drive_c/a.txt.tmp~/x", "x");
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\folder", "f"); }), 75);
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\a.txt", "f"); }), 75);
  EXPECT_EQ(home.Get("drive_c/a.txt"), "old");
  EXPECT_EQ(home.Get("drive_c/folder/x"), "x");
  EXPECT_EQ(home.files().List("c:\\").size(), 3u);
}

TEST(WriteAllTest, EmptyTextEmptiesTheFile) {
  TempHome home;
  home.Put("drive_c/a.txt", "old");
  home.files().WriteAll("c:\\a.txt", "");
  EXPECT_TRUE(home.Exists("drive_c/a.txt"));
  EXPECT_EQ(home.Get("drive_c/a.txt"), "");
}
