#include "base/file_set.h"

#include <gtest/gtest.h>
#include <signal.h>

#include <filesystem>
#include <map>
#include <new>

#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/forwarding_io.h"
#include "tests/support/killed_runs.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

namespace {

using Contents = std::map<std::string, std::string>;

Contents ContentsOf(const TempHome& home) {
  Contents out;
  for (const auto& entry : std::filesystem::directory_iterator(home.path() + "/drive_c"))
    out[entry.path().filename().string()] = home.Get("drive_c/" + entry.path().filename().string());
  return out;
}

// A change of code as it moves files: histories merged, old files kept beside, and the record
// that tells of it last.
void FillSet(FileSet& set) {
  set.Rename("c:\\OLD.WDT", "c:\\OLD.OLD");
  set.Rename("c:\\NEW.WDT", "c:\\NEW.OLD");
  set.Add("c:\\NEW.WDT", "merged");
  set.Remove("c:\\OLD.Txt");
  set.Remove("c:\\none.txt");
  set.Add("c:\\Names.dat", "new names");
}
const Contents kBefore{{"NEW.OLD", "very old new"}, {"NEW.WDT", "new"}, {"Names.dat", "names"},
                       {"OLD.Txt", "notes"},        {"OLD.WDT", "old"}, {"other", "x"}};
const Contents kAfter{{"NEW.OLD", "new"},
                      {"NEW.WDT", "merged"},
                      {"Names.dat", "new names"},
                      {"OLD.OLD", "old"},
                      {"other", "x"}};

void PutBefore(const TempHome& home) {
  std::filesystem::remove_all(home.path() + "/drive_c");
  for (const auto& [name, bytes] : kBefore) home.Put("drive_c/" + name, bytes);
}

}  // namespace

TEST(FileSetTest, ASetThatIsNotCommittedLeavesNothing) {
  TempHome home;
  home.Put("drive_c/a.dat", "old");
  {
    FileSet set(home.files());
    set.Add("c:\\a.dat", "new");
    set.Add("c:\\b.dat", "new");
    EXPECT_EQ(home.Get("drive_c/a.dat"), "old");
  }
  EXPECT_EQ(home.Get("drive_c/a.dat"), "old");
  EXPECT_EQ(home.files().List("c:\\").size(), 1u);
}

TEST(FileSetTest, AFailureDuringCommitBringsBackAllFiles) {
  FailingIo io;
  TempHome home(io);
  home.Put("drive_c/a.dat", "old a");
  home.Put("drive_c/c.dat", "old c");
  FileSet set(home.files());
  for (const char* name : {"c:\\a.dat", "c:\\b.dat", "c:\\c.dat"}) set.Add(name, "new");
  io.Reset(
      16);  // three files made (11 calls), two put in place (3); the third kept aside and renamed
  EXPECT_EQ(ErrorOf([&] { set.Commit(); }), kDiskFull);
  EXPECT_EQ(home.Get("drive_c/a.dat"), "old a");
  EXPECT_EQ(home.Get("drive_c/c.dat"), "old c");
  EXPECT_EQ(home.files().List("c:\\").size(), 2u);
}

TEST(FileSetTest, FilesAreFoundInAnyCase) {
  TempHome home;
  home.Put("drive_c/Names.dat", "old");
  FileSet set(home.files());
  set.Add("c:\\NAMES.DAT", "new");
  set.Commit();
  EXPECT_EQ(home.Get("drive_c/Names.dat"), "new");
  EXPECT_FALSE(home.Exists("drive_c/NAMES.DAT"));
}

TEST(FileSetTest, MovesRemovesAndWritesTogether) {
  TempHome home;
  PutBefore(home);
  FileSet set(home.files());
  FillSet(set);
  set.Stage();
  EXPECT_EQ(home.Get("drive_c/Names.dat"), "names");
  set.Commit();
  EXPECT_EQ(ContentsOf(home), kAfter);
  EXPECT_TRUE(home.files().CheckFile("c:\\old.old"));
  EXPECT_FALSE(home.files().CheckFile("c:\\old.wdt"));
}

TEST(FileSetTest, AFailureAtAnyCallOfAnyKindLeavesAllAsItWas) {
  for (const int error : {int(kDiskFull), int(kDeviceError), int(kPathAccess)}) {
    for (int at = 1;; ++at) {
      ASSERT_LT(at, 100);
      FailingIo io;
      TempHome home(io);
      PutBefore(home);
      io.Reset(at);
      io.torn = true;
      io.error = error;
      const int raised = ErrorOf([&] {
        FileSet set(home.files());
        FillSet(set);
        set.Commit();
      });
      // A copy stands in for a second name that can't be had, and a journal that can't be taken
      // away is finished, with nothing to do, by the next writer.
      EXPECT_TRUE(raised == 0 || raised == error) << at;
      EXPECT_EQ(ContentsOf(home), raised == 0 ? kAfter : kBefore) << at;
      if (io.calls < at) break;
    }
  }
}

// The set committed in a process of its own. False when it was killed.
bool CommittedBehind(const std::function<void()>& prepare, TempHome& home) {
  const auto code = InChild([&] {
    prepare();
    return ErrorOf([&] {
      FileSet set(home.files());
      FillSet(set);
      set.Commit();
    });
  });
  EXPECT_EQ(code.value_or(0), 0);
  return code.has_value();
}

TEST(FileSetTest, KilledAnywhereAllAreOldOrAllAreNewForTheNextWriter) {
  FailingIo io;
  TempHome home(io);
  int finished = 0;
  for (int at = 1;; ++at) {
    ASSERT_LT(at, 100);
    PutBefore(home);
    const auto killed = [&] {
      io.Reset(at);
      io.kills = true;
    };
    if (CommittedBehind(killed, home)) break;
    const bool waits = home.Exists("Kora.set~");
    { const auto held = home.files().lock().Hold(); }
    Contents now = ContentsOf(home);
    std::erase_if(now, [](const auto& file) { return file.first.ends_with(".tmp~"); });
    EXPECT_TRUE(now == kBefore || now == kAfter) << at;
    if (now == kAfter) {
      EXPECT_TRUE(waits) << at;
      ++finished;
    }
    EXPECT_FALSE(home.Exists("Kora.set~"));
  }
  EXPECT_GT(finished, 5);
}

// Dies in place of the n-th removal of a file that a commit had beside another.
struct DiesSweeping : ForwardingIo {
  int dieAt = 0;
  void Remove(const std::string& path) override {
    if (path.ends_with('~') && --dieAt == 0) ::raise(SIGKILL);
    ForwardingIo::Remove(path);
  }
};

TEST(FileSetTest, KilledWhileItSweepsTheNextWriterSweeps) {
  DiesSweeping io;
  TempHome home(io);
  int kills = 0;
  for (int at = 1;; ++at) {
    ASSERT_LT(at, 100);
    PutBefore(home);
    if (CommittedBehind([&] { io.dieAt = at; }, home)) break;
    ++kills;
    { const auto held = home.files().lock().Hold(); }
    EXPECT_EQ(ContentsOf(home), kAfter) << at;
    for (const std::string& name : home.files().List("c:\\"))
      EXPECT_FALSE(name.ends_with('~')) << name << " at " << at;
  }
  EXPECT_GT(kills, 2);
}

TEST(FileSetTest, AJournalCutShortOrOfRubbishIsClearedAwayAndChangesNothing) {
  TempHome home;
  PutBefore(home);
  for (const std::string& journal :
       {std::string(), std::string("KORA set 1\0D\0", 13), std::string("rubbish"),
        std::string("KORA set 1\0R\0x\0whole\0", 21), std::string(100000, '\0')}) {
    home.Put("Kora.set~", journal);
    { const auto held = home.files().lock().Hold(); }
    EXPECT_FALSE(home.Exists("Kora.set~"));
    EXPECT_EQ(ContentsOf(home), kBefore);
  }
}

// Who is given a folder of data is given its journal too.
TEST(FileSetTest, AJournalThatNamesOtherFilesThanASetMakesBesideTakesNoneAway) {
  TempHome home;
  const auto lay = [&] {
    home.Put("drive_c/a", "old");
    home.Put("drive_c/a.tmp~", "new");
    home.Put("mine", "kept");
    home.Put("mine.tmp~", "kept");
  };
  const std::string path = home.path() + "/drive_c/a", mine = home.path() + "/mine";
  const auto finish = [&](const std::string& kind, const std::string& temporary,
                          const std::string& aside) {
    lay();
    std::string journal;
    for (const std::string& field :
         {std::string("KORA set 1"), kind, path, std::string(), temporary, aside, std::string("0"),
          std::string("0"), std::string("0"), std::string("whole")})
      journal += field + '\0';
    home.Put("Kora.set~", journal);
    { const auto held = home.files().lock().Hold(); }
    EXPECT_FALSE(home.Exists("Kora.set~"));
    return home.Get("drive_c/a");
  };
  for (const std::string& temporary : {mine, mine + ".tmp~", path + ".tmp",
                                       path + ".tmp/../../mine~", path + "~", std::string()}) {
    EXPECT_EQ(finish("W", temporary, path + ".old~"), "old") << temporary;
    EXPECT_EQ(home.Get("mine") + home.Get("mine.tmp~"), "keptkept") << temporary;
  }
  for (const std::string kind : {"W", "D", "R", "x", ""}) {
    EXPECT_EQ(finish(kind, path + ".tmp~", mine), "old") << kind;
    EXPECT_EQ(home.Get("mine"), "kept") << kind;
  }
  EXPECT_EQ(finish("W", path + ".tmp~", path + ".old~"), "new");
}

TEST(FileSetTest, AFileThatCameInThePlaceOfAMovedOneIsNotMovedAgain) {
  TempHome home;
  home.Put("drive_c/a", "old");
  const std::string path = home.path() + "/drive_c/a";
  const HostStatus before = MachineIo().Status(path);
  std::string journal;
  for (const std::string& field :
       {std::string("KORA set 1"), std::string("R"), path, path + ".OLD", std::string(),
        path + ".old~", std::to_string(before.id), std::to_string(before.size),
        std::to_string(before.modified), std::string("whole")})
    journal += field + '\0';
  home.Put("Kora.set~", journal);
  std::filesystem::rename(path, path + ".OLD");
  home.Put("drive_c/a", "new");
  { const auto held = home.files().lock().Hold(); }
  EXPECT_EQ(ContentsOf(home), (Contents{{"a", "new"}, {"a.OLD", "old"}}));
}

TEST(FileSetTest, RunningOutOfMemoryLeavesAllAsItWas) {
  struct NoMemory : ForwardingIo {
    int left = 0;
    void Rename(const std::string& from, const std::string& to) override {
      if (left-- == 0) throw std::bad_alloc();
      ForwardingIo::Rename(from, to);
    }
  } io;
  TempHome home(io);
  for (int before = 0; before < 5; ++before) {
    PutBefore(home);
    FileSet set(home.files());
    FillSet(set);
    io.left = before;
    EXPECT_THROW(set.Commit(), std::bad_alloc) << before;
    EXPECT_EQ(ContentsOf(home), kBefore) << before;
  }
}

TEST(FileSetTest, WhereAFileHasOneNameAloneItIsCopiedAside) {
  struct NoLinks : ForwardingIo {
    bool failFlush = false;
    void Link(const std::string&, const std::string&) override { throw RunTimeError(kPathAccess); }
    void FlushFolder(const std::string&) override {
      if (failFlush) throw RunTimeError(kDeviceError);
    }
  } io;
  TempHome home(io);
  home.Put("drive_c/a", "old");
  io.failFlush = true;
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\a", "new"); }), kDeviceError);
  EXPECT_EQ(ContentsOf(home), (Contents{{"a", "old"}}));
  io.failFlush = false;
  home.files().WriteAll("c:\\a", "new");
  EXPECT_EQ(ContentsOf(home), (Contents{{"a", "new"}}));
}

TEST(FileSetTest, WhatACrashSetAsideIsClearedAwayByTheNextWrite) {
  TempHome home;
  home.Put("drive_c/a", "old");
  home.Put("drive_c/a.old~", "older");
  home.files().WriteAll("c:\\a", "new");
  EXPECT_EQ(ContentsOf(home), (Contents{{"a", "new"}}));
}

TEST(FileSetTest, WhatACrashSetAsideOfAFileThatWentSinceIsClearedAwayToo) {
  TempHome home;
  home.Put("drive_c/a.old~", "left");
  home.files().WriteAll("c:\\a", "new");
  EXPECT_EQ(home.Get("drive_c/a"), "new");
  EXPECT_FALSE(home.Exists("drive_c/a.old~"));
}

TEST(FileSetTest, AReadOnlyFileIsNeitherReplacedNorRemoved) {
  TempHome home;
  home.Put("drive_c/a", "old");
  home.Put("drive_c/b", "b");
  std::filesystem::permissions(home.path() + "/drive_c/a", std::filesystem::perms(0444));
  FileSet set(home.files());
  EXPECT_EQ(ErrorOf([&] { set.Add("c:\\a", "new"); }), kPathAccess);
  EXPECT_EQ(ErrorOf([&] { set.Remove("c:\\a"); }), kPathAccess);
  EXPECT_EQ(ErrorOf([&] { set.Rename("c:\\b", "c:\\a"); }), kPathAccess);
}

TEST(FileSetTest, AMissingFileCannotBeMoved) {
  TempHome home;
  home.Put("drive_c/a", "old");
  FileSet set(home.files());
  set.Add("c:\\a", "new");
  set.Rename("c:\\none", "c:\\some");
  EXPECT_EQ(ErrorOf([&] { set.Commit(); }), kFileNotFound);
  EXPECT_EQ(ContentsOf(home), (Contents{{"a", "old"}}));
}

TEST(FileSetTest, ANameThatDiffersInCaseAloneChangesItsCase) {
  TempHome home;
  home.Put("drive_c/ore.wdt", "x");
  FileSet set(home.files());
  set.Rename("c:\\ORE.WDT", "c:\\ORE.WDT");
  set.Commit();
  EXPECT_EQ(ContentsOf(home), (Contents{{"ORE.WDT", "x"}}));
}

TEST(FileSetTest, AFolderThatCannotBeListedForAFailureOfTheDiskIsTold) {
  struct Broken : ForwardingIo {
    std::vector<std::string> List(const std::string&) override { throw RunTimeError(kDeviceError); }
  } io;
  TempHome home(io);
  home.Put("drive_c/Names.dat", "names");
  // In another case than on the disk, so that the folder has to be looked through: taking the
  // name file for missing would make an empty one beside it.
  EXPECT_EQ(ErrorOf([&] { home.files().CheckFile("c:\\NAMES.DAT"); }), kDeviceError);
  EXPECT_EQ(ErrorOf([&] { home.files().WriteAll("c:\\NAMES.DAT", "x"); }), kDeviceError);
}

// ---- Copies

TEST(FileSetTest, ACopyIsPutInPlaceWithTheBytesOfItsSourceAndTheAccessOfTheOldFile) {
  TempHome home;
  std::string large(3'000'000, 'x');
  for (size_t i = 0; i < large.size(); i += 1000) large[i] = char('a' + i / 1000 % 26);
  home.Put("drive_c/a/one.dat", large);
  home.Put("drive_c/a/two.dat", "");
  home.Put("drive_c/b/one.dat", "old");
  std::filesystem::permissions(
      home.path() + "/drive_c/b/one.dat",
      std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
  FileSet set(home.files());
  const CopiedFile one = set.AddCopy("c:\\a\\one.dat", "c:\\b\\ONE.dat");
  EXPECT_EQ(one.bytes, large.size());
  EXPECT_EQ(one.replaces, 3u);
  const CopiedFile two = set.AddCopy("c:\\a\\two.dat", "c:\\b\\two.dat");
  EXPECT_EQ(two.bytes + two.replaces, 0u);
  EXPECT_EQ(home.Get("drive_c/b/one.dat"), "old") << "not committed yet";
  set.Commit();
  EXPECT_TRUE(home.Get("drive_c/b/one.dat") == large);
  EXPECT_TRUE(home.Exists("drive_c/b/two.dat"));
  EXPECT_EQ(home.files().List("c:\\b").size(), 2u);
  EXPECT_EQ(std::filesystem::status(home.path() + "/drive_c/b/one.dat").permissions(),
            std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
}

TEST(FileSetTest, ACopyThatFailsLeavesWhatTheSetHas) {
  FailingIo io;
  TempHome home(io);
  for (const char* name : {"one.dat", "two.dat"}) home.Put(std::string("drive_c/a/") + name, name);
  home.files().MakeFolder("c:\\b");
  FileSet set(home.files());
  set.AddCopy("c:\\a\\one.dat", "c:\\b\\one.dat");
  EXPECT_EQ(ErrorOf([&] { set.AddCopy("c:\\a\\none.dat", "c:\\b\\none.dat"); }), kFileNotFound);
  io.Reset(2);  // made, and then written
  EXPECT_EQ(ErrorOf([&] { set.AddCopy("c:\\a\\two.dat", "c:\\b\\two.dat"); }), kDiskFull);
  io.Reset();
  set.Commit();
  EXPECT_EQ(home.files().List("c:\\b"), std::vector<std::string>{"one.dat"});
  EXPECT_EQ(home.Get("drive_c/b/one.dat"), "one.dat");
}

TEST(FileSetTest, CopiesThatAreNotCommittedLeaveNothing) {
  TempHome home;
  home.Put("drive_c/a.dat", "new");
  home.Put("drive_c/b/a.dat", "old");
  {
    FileSet set(home.files());
    set.AddCopy("c:\\a.dat", "c:\\b\\a.dat");
  }
  EXPECT_EQ(home.Get("drive_c/b/a.dat"), "old");
  EXPECT_EQ(home.files().List("c:\\b").size(), 1u);
}

TEST(FileSetTest, ManyCopiesReadTheFolderOnceAndFlushTheDiskOnce) {
  struct Counting : ForwardingIo {
    int lists = 0, disks = 0;
    std::vector<std::string> List(const std::string& folder) override {
      ++lists;
      return ForwardingIo::List(folder);
    }
    void FlushDisk(const std::string&) override { ++disks; }
  } io;
  TempHome home(io);
  for (int i = 0; i < 200; ++i) home.Put("drive_c/a/" + std::to_string(i), "x");
  home.files().MakeFolder("c:\\b");
  FileSet set(home.files());
  io.lists = 0;
  for (int i = 0; i < 200; ++i)
    set.AddCopy("c:\\a\\" + std::to_string(i), "c:\\b\\" + std::to_string(i));
  set.Commit();
  EXPECT_LE(io.lists, 3);
  EXPECT_EQ(io.disks, 1);
  EXPECT_EQ(home.files().List("c:\\b").size(), 200u);
}

TEST(FileSetTest, KillsAmongCopiesLeaveWholeFiles) {
  FailingIo io;
  TempHome home(io);
  for (int at = 1;; ++at) {
    SCOPED_TRACE(at);
    io.Reset();
    std::filesystem::remove_all(home.path() + "/drive_c");
    for (const char* name : {"one", "two"}) {
      home.Put(std::string("drive_c/a/") + name, std::string("new ") + name);
      home.Put(std::string("drive_c/b/") + name, std::string("old ") + name);
    }
    const auto code = InChild([&] {
      io.Reset(at);
      io.kills = true;
      const auto held = home.files().lock().Hold();
      FileSet set(home.files());
      for (const char* name : {"one", "two"})
        set.AddCopy(std::string("c:\\a\\") + name, std::string("c:\\b\\") + name);
      set.Commit();
      return 0;
    });
    // The next who takes the lock finishes what was begun: both are old, or both new.
    Files next(home.path());
    { const auto held = next.lock().Hold(); }
    const std::string one = home.Get("drive_c/b/one"), two = home.Get("drive_c/b/two");
    EXPECT_TRUE((one == "old one" && two == "old two") || (one == "new one" && two == "new two"))
        << one << ", " << two;
    if (code) {
      EXPECT_EQ(one, "new one");
      EXPECT_GT(at, 6);
      break;
    }
  }
}
