#include "base/file_edits.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/support/failing_io.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

namespace {

class FileEditsTest : public ::testing::Test {
 protected:
  FailingIo io;
  TempHome home{io};
  const std::string kJournal = "c:\\Test.Jnl";

  // "0123456789" gets an end and two changed bytes; another file is made.
  std::vector<FileEdit> Edits() {
    return {{"c:\\old", true, 10, {{2, "23", "xy"}, {8, "89", "89ab"}}},
            {"c:\\new", false, 0, {{0, "", "fresh"}}}};
  }
  void Lay() {
    home.Put("drive_c/old", "0123456789");
    if (home.Exists("drive_c/new")) home.files().Remove("c:\\new");
  }
};

}  // namespace

TEST_F(FileEditsTest, ChangesBytesInTheirPlacesAndMakesFiles) {
  Lay();
  std::vector<std::string> seen;
  EXPECT_TRUE(
      MakeEdits(home.files(), Edits(), [&](const std::string& p) { seen.push_back(p); }).empty());
  EXPECT_EQ(home.Get("drive_c/old"), "01xy456789ab");
  EXPECT_EQ(home.Get("drive_c/new"), "fresh");
  EXPECT_EQ(seen, (std::vector<std::string>{"c:\\old", "c:\\new"}));
}

TEST_F(FileEditsTest, MakingThemAgainChangesNothing) {
  Lay();
  MakeEdits(home.files(), Edits());
  io.Reset(1);
  io.failAt = 3;  // opening the new file counts
  EXPECT_TRUE(MakeEdits(home.files(), Edits()).empty());
  io.Reset();
  EXPECT_EQ(home.Get("drive_c/old"), "01xy456789ab");
}

TEST_F(FileEditsTest, UndoBringsBackWhatWasThereFromAnyPoint) {
  for (int at = 1;; ++at) {
    Lay();
    io.Reset(at);
    io.torn = true;
    bool failed = false;
    try {
      MakeEdits(home.files(), Edits());
    } catch (const RunTimeError&) {
      failed = true;
    }
    io.Reset();
    UndoEdits(home.files(), Edits());
    EXPECT_EQ(home.Get("drive_c/old"), "0123456789") << at;
    EXPECT_FALSE(home.Exists("drive_c/new")) << at;
    if (!failed) break;
  }
}

TEST_F(FileEditsTest, HalfMadeFilesAreMade) {
  for (const char* half : {"01x3456789", "01xy45678900", "0023456789", "01xy456789ab"}) {
    std::string bytes(half);
    for (size_t i = 10; i < bytes.size(); ++i)
      if (bytes[i] == '0') bytes[i] = '\0';
    Lay();
    if (std::string(half) == "0023456789") bytes[2] = '\0', bytes[1] = '1';
    home.Put("drive_c/old", bytes);
    EXPECT_TRUE(MakeEdits(home.files(), Edits()).empty()) << half;
    EXPECT_EQ(home.Get("drive_c/old"), "01xy456789ab") << half;
  }
}

TEST_F(FileEditsTest, FilesThatWereChangedSinceAreNamedAndLeft) {
  for (const char* other : {"01Q3456789", "012345678", "01xy456789abc", "0123456789Q"}) {
    Lay();
    home.Put("drive_c/old", other);
    EXPECT_EQ(MakeEdits(home.files(), Edits()), std::vector<std::string>{"c:\\old"}) << other;
    EXPECT_EQ(home.Get("drive_c/old"), other);
    UndoEdits(home.files(), Edits());
    EXPECT_EQ(home.Get("drive_c/old"), other);
  }
  home.files().Remove("c:\\old");
  EXPECT_EQ(MakeEdits(home.files(), Edits()), std::vector<std::string>{"c:\\old"});
  EXPECT_FALSE(home.Exists("drive_c/old"));
}

TEST_F(FileEditsTest, AJournalReadsBack) {
  EXPECT_FALSE(ReadEditJournal(home.files(), kJournal));
  WriteEditJournal(home.files(), kJournal, "a note", Edits());
  const auto journal = ReadEditJournal(home.files(), kJournal);
  ASSERT_TRUE(journal);
  EXPECT_EQ(journal->note, "a note");
  ASSERT_EQ(journal->edits.size(), 2u);
  EXPECT_EQ(journal->edits[0].path, "c:\\old");
  EXPECT_TRUE(journal->edits[0].existed);
  EXPECT_EQ(journal->edits[0].before, 10u);
  EXPECT_EQ(journal->edits[0].After(), 12u);
  EXPECT_EQ(journal->edits[0].changes[1].old, "89");
  EXPECT_EQ(journal->edits[0].changes[1].fresh, "89ab");
  EXPECT_FALSE(journal->edits[1].existed);
  Lay();
  MakeEdits(home.files(), journal->edits);
  EXPECT_EQ(home.Get("drive_c/old"), "01xy456789ab");
}

TEST_F(FileEditsTest, AJournalWithoutItsEndIsNone) {
  WriteEditJournal(home.files(), kJournal, "a note", Edits());
  const std::string bytes = home.Get("drive_c/Test.Jnl");
  for (size_t size = 0; size < bytes.size(); ++size) {
    home.Put("drive_c/Test.Jnl", bytes.substr(0, size));
    EXPECT_FALSE(ReadEditJournal(home.files(), kJournal)) << size;
  }
}
