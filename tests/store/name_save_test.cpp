#include <gtest/gtest.h>

#include <filesystem>

#include "store/name_file.h"
#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

const std::string kData = "c:\\data\\";
constexpr const char* kHost = "drive_c/data/Names.dat";
constexpr const char* kBackup = "drive_c/data/names.bak";

class SaveRows : public ::testing::Test {
 protected:
  SaveRows() : home_(io_) { home_.Put(kHost, old_); }

  bool Save(const std::vector<NameRec>& rows) {
    return SaveNames(home_.files(), kData, rows, dialogs_);
  }

  const std::string old_ = Bytes<NameRec>({Security("OLD")}) + "tail";
  FailingIo io_;
  TempHome home_;
  ScriptedDialogs dialogs_;
};

TEST_F(SaveRows, SortsByCategoryAndKeepsTheOldFileBeside) {
  EXPECT_TRUE(Save({Security("CCC", 2), Security("BBB", 1), Security("AAA", 2)}));
  EXPECT_EQ(home_.Get(kHost),
            Bytes<NameRec>({Security("BBB", 1), Security("AAA", 2), Security("CCC", 2)}));
  EXPECT_EQ(home_.Get(kBackup), old_);
  EXPECT_TRUE(dialogs_.said.empty());
  EXPECT_EQ(home_.files().List(kData), (std::vector<std::string>{"names.bak", "Names.dat"}));
}

TEST_F(SaveRows, WritesStatusZeroAndTheMinimumMove) {
  NameRec row = Security("AAA");
  row.NameStatus = 9;
  row.MinMove = 3;
  row.NameSpare.set("spare!");
  ASSERT_TRUE(Save({row}));
  const NameRec saved = NameFile(home_.files(), NameFilePath(kData)).Read(1);
  EXPECT_EQ(saved.NameStatus, 0);
  EXPECT_EQ(float(saved.MinMove), 0.05f);
  EXPECT_EQ(saved.NameSpare.raw(), "spare!");
}

TEST_F(SaveRows, ADeletedRowComesBackAsNormal) {
  NameRec row = Security("AAA");
  row.NameStatus = 1;
  ASSERT_TRUE(Save({row, Security("BBB")}));
  EXPECT_EQ(ReadNames(home_.files(), kData).size(), 2u);
}

TEST_F(SaveRows, RowsWithoutACodeAreLeftOutAndTheOthersCloseUp) {
  ASSERT_TRUE(Save({NameRec{}, Security("AAA"), Security("  "), Security("BBB")}));
  EXPECT_EQ(home_.Get(kHost), Bytes<NameRec>({Security("AAA"), Security("BBB")}));
}

TEST_F(SaveRows, NoRowsMakeAnEmptyFile) {
  ASSERT_TRUE(Save({}));
  EXPECT_TRUE(home_.Exists(kHost));
  EXPECT_EQ(home_.Get(kHost), "");
  EXPECT_EQ(home_.Get(kBackup), old_);
}

TEST_F(SaveRows, TheFirstSaveHasNoBackup) {
  TempHome home;
  home.Put("drive_c/data/other", "");
  ASSERT_TRUE(SaveNames(home.files(), kData, std::vector<NameRec>{Security("AAA")}, dialogs_));
  EXPECT_EQ(home.Get(kHost), Bytes<NameRec>({Security("AAA")}));
  EXPECT_FALSE(home.Exists(kBackup));
}

TEST_F(SaveRows, CutOffAnywhereKeepsTheOldFileAndSaysSo) {
  // A new file is opened, written, flushed and renamed, and its folder flushed; one that replaces
  // another takes its access and keeps it aside, too.
  constexpr int kBackupCalls = 5;
  constexpr int kCalls = kBackupCalls + 7;
  const std::vector<NameRec> rows{Security("BBB"), Security("AAA")};
  for (const bool lasting : {false, true}) {
    io_.lasting = lasting;
    io_.torn = true;
    bool done = false;
    int at = 0;
    while (!done) {
      ASSERT_LT(++at, 20);
      home_.Put(kHost, old_);
      std::filesystem::remove(home_.path() + "/" + kBackup);
      dialogs_.said.clear();
      io_.Reset(at);
      const bool saved = Save(rows);
      done = io_.calls < at;
      EXPECT_EQ(saved, done) << at;
      // The last call flushes the folder: on a disk that stays broken the new file stays.
      EXPECT_EQ(home_.Get(kHost), done || (lasting && at == kCalls)
                                      ? Bytes<NameRec>({Security("AAA"), Security("BBB")})
                                      : old_)
          << at;
      if (done) {
        EXPECT_TRUE(dialogs_.said.empty());
        continue;
      }
      ASSERT_EQ(dialogs_.said.size(), 1u) << at;
      EXPECT_EQ(dialogs_.said[0].text,
                at <= kBackupCalls ? "61 Cannot continue" : "Unable to save data")
          << at;
      EXPECT_EQ(dialogs_.said[0].title, "Saving Data");
      if (at > kBackupCalls) {
        EXPECT_EQ(home_.Get(kBackup), old_);
      }
    }
    EXPECT_EQ(at, kCalls + 1);
  }
}

TEST_F(SaveRows, ADriveThatComesBackIsTriedAgain) {
  for (const auto& [error, text] :
       {std::pair{kDeviceNotAvailable, "Device not available. Try again"},
        std::pair{kDiskNotReady, "Drive door open"}}) {
    io_.Reset(1);
    io_.error = error;
    dialogs_.said.clear();
    dialogs_.answers = {Answer::kRetry};
    home_.Put(kHost, old_);
    EXPECT_TRUE(Save({Security("AAA")}));
    ASSERT_EQ(dialogs_.said.size(), 1u);
    EXPECT_EQ(dialogs_.said[0].text, text);
    EXPECT_EQ(home_.Get(kBackup), old_);
  }
}

TEST_F(SaveRows, ADriveThatStaysAwayIsAskedForUntilTheUserGivesUp) {
  io_.Reset(1);
  io_.error = kDiskNotReady;
  io_.lasting = true;
  dialogs_.answers = {Answer::kRetry, Answer::kRetry, Answer::kCancel};
  EXPECT_FALSE(Save({Security("AAA")}));
  EXPECT_EQ(dialogs_.said.size(), 3u);
  EXPECT_EQ(home_.Get(kHost), old_);
}

TEST_F(SaveRows, MemoryHasItsOwnMessage) {
  for (const int error : {kOutOfMemory, kOutOfTextSpace, kOutOfStack}) {
    for (const int at : {1, 5}) {  // in the backup, in the rows
      io_.Reset(at);
      io_.error = error;
      dialogs_.said.clear();
      EXPECT_FALSE(Save({Security("AAA")}));
      ASSERT_EQ(dialogs_.said.size(), 1u);
      EXPECT_EQ(dialogs_.said[0].text,
                "There is a memory problem. Try closing windows and restarting");
      EXPECT_EQ(home_.Get(kHost), old_);
    }
  }
}

TEST_F(SaveRows, AFolderInPlaceOfTheNameFileIsToldAndStays) {
  TempHome home;
  home.Put("drive_c/data/Names.dat/inner", "");
  EXPECT_FALSE(SaveNames(home.files(), kData, std::vector<NameRec>{Security("AAA")}, dialogs_));
  ASSERT_EQ(dialogs_.said.size(), 1u);
  EXPECT_EQ(dialogs_.said[0].text, "75 Cannot continue");
  EXPECT_TRUE(home.Exists("drive_c/data/Names.dat/inner"));
}

TEST_F(SaveRows, MoreRowsThan16BitsCanNameAreNotSaved) {
  EXPECT_FALSE(Save(std::vector<NameRec>(32768, Security("AAA"))));
  ASSERT_EQ(dialogs_.said.size(), 1u);
  EXPECT_EQ(dialogs_.said[0].text, "Unable to save data");
  EXPECT_EQ(home_.Get(kHost), old_);
}

// ---- the check before a save

TEST(CheckRows, GoodRowsAndBlankOnesHaveNoFault) {
  NameRec blank{};
  NameRec padded{};
  padded.Code.set("");
  padded.Name.set("");
  padded.OtherDetails.set("");
  padded.Id.set("");
  padded.IndClass.set("");
  std::vector<NameRec> rows{Security("AAA"), blank, padded, Security("BBB", 1, 1)};
  EXPECT_FALSE(CheckRows(rows));
}

TEST(CheckRows, ARowWithoutACodeIsAFault) {
  std::vector<NameRec> rows{Security("AAA"), Security("  ")};
  rows[1].Name.set("Something");
  const auto fault = CheckRows(rows);
  ASSERT_TRUE(fault);
  EXPECT_EQ(fault->row, 1u);
  EXPECT_EQ(fault->message, "Code must be entered");
}

TEST(CheckRows, ARecordTypeOutside1To5IsAFault) {
  for (const int type : {0, 6, -1}) {
    std::vector<NameRec> rows{Security("AAA", 1, std::int16_t(type))};
    const auto fault = CheckRows(rows);
    ASSERT_TRUE(fault) << type;
    EXPECT_EQ(fault->row, 0u);
    EXPECT_EQ(fault->message, "Record Type must be entered");
  }
}

TEST(CheckRows, ACategoryOutside0To99BecomesZero) {
  std::vector<NameRec> rows{Security("AAA", -1), Security("BBB", 100), Security("CCC", 99),
                            Security("DDD", 0)};
  EXPECT_FALSE(CheckRows(rows));
  EXPECT_EQ(rows[0].Category, 0);
  EXPECT_EQ(rows[1].Category, 0);
  EXPECT_EQ(rows[2].Category, 99);
  EXPECT_EQ(rows[3].Category, 0);
}

}  // namespace
}  // namespace kora::test
