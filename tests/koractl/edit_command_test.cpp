// Price files corrected by koractl as a process.

#include <gtest/gtest.h>

#include <filesystem>

#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

constexpr const char* kOre = "kora/drive_c/korawin/data/ORE.WDT";
constexpr const char* kCopy = "kora/drive_c/korawin/data/Temp.WRK";

class EditCommand : public testing::Test {
 protected:
  EditCommand() {
    EXPECT_EQ(Run({"init"}).code, 0);
    home.Put("kora/drive_c/korawin/data/Names.dat", Bytes(std::vector{Security("ORE")}));
    Put(Three());
  }
  static std::vector<PriceRec> Three() {
    return {Day("19980911", 1, 2, 0.5f, 1.5f, 10), Day("19980914", 2, 3, 2, 2.5f, 199),
            Day("19980915", 3, 4, 3, 3.5f, 30000000)};
  }
  void Put(const std::vector<PriceRec>& days) { home.Put(kOre, Bytes(days)); }
  void ExpectDays(const std::vector<PriceRec>& days) { EXPECT_EQ(home.Get(kOre), Bytes(days)); }
  ProgramResult Run(std::vector<std::string> words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(BinDir() + "/koractl", words);
  }
  ProgramResult Edit(std::vector<std::string> words) {
    words.insert(words.begin(), {"edit", "ore"});
    return Run(words);
  }

  TempHome home;
};

TEST_F(EditCommand, SetsEachFieldOfARecordAndSaves) {
  const std::vector<std::vector<std::string>> cells = {
      {"Date", "19980912"}, {"Open", "1.1"},    {"high", "2.1"},      {"LOW", "0.6"},
      {"Close", "1.6"},     {"Volume", "12.5"}, {"AdjDesc", "Bonus"},
  };
  for (const auto& cell : cells) EXPECT_EQ(Edit({"set", "1", cell[0], cell[1]}).code, 0) << cell[0];
  auto days = Three();
  days[0] = Day("19980912", 1.1f, 2.1f, 0.6f, 1.6f, 12);
  days[0].AdjDesc.set("Bonus");
  ExpectDays(days);
  days[0].AdjDesc.set("");
  EXPECT_EQ(home.Get(kCopy), Bytes(days));  // as it was before the last save
  EXPECT_EQ(Edit({"set", "1", "AdjDesc", ""}).code, 0);
  EXPECT_EQ(Edit({"set", "1", "Volume", "--", "-3"}).code, 0);
  days[0].Volume = -3;
  ExpectDays(days);
}

TEST_F(EditCommand, WhatTheFormRefusesIsRefused) {
  const std::pair<std::vector<std::string>, const char*> refused[] = {
      {{"set", "1", "Close", "dear"}, "[Data] Data must be numeric\n"},
      {{"set", "1", "Volume", "2147483648"}, "[Data] The number is too large\n"},
      {{"set", "4", "Close", "1"}, "[Data] The file has 3 records\n"},
      {{"delete", "2-4"}, "[Data] The file has 3 records\n"},
      {{"scale", "1-3", "--items", "volume", "--by", "x100"},
       "[Data Modification] Record 3: The number is too large\n"},
  };
  for (const auto& [words, text] : refused) {
    const ProgramResult result = Edit(words);
    EXPECT_EQ(result.code, 1) << text;
    EXPECT_EQ(result.err, text);
  }
  ExpectDays(Three());
  EXPECT_FALSE(home.Exists(kCopy));
}

TEST_F(EditCommand, AMisspeltCommandLineIsUsage) {
  const std::vector<std::vector<std::string>> wrong = {
      {},
      {"set", "1", "Close"},
      {"set", "0", "Close", "1"},
      {"set", "1", "AdjFactor", "1"},
      {"delete"},
      {"delete", "x"},
      {"delete", "3-1"},
      {"delete", "1-2-3"},
      {"delete", "0"},
      {"delete", "-"},
      {"scale", "1", "--by", "x10"},
      {"scale", "1", "--items", "close"},
      {"scale", "1", "--items", "price", "--by", "x10"},
      {"scale", "1", "--items", "close", "--by", "x7"},
  };
  for (const auto& words : wrong) EXPECT_EQ(Edit(words).code, 2) << (words.empty() ? "" : words[0]);
  ExpectDays(Three());
}

TEST_F(EditCommand, DeletesRecordsUnlessAnsweredOtherwise) {
  const ProgramResult kept = Run({"--answer", "cancel", "edit", "ORE", "delete", "1-2"});
  EXPECT_EQ(kept.code, 1);
  EXPECT_EQ(kept.err, "[Delete Rows] Delete items 1 to 2 ?\n");
  ExpectDays(Three());
  EXPECT_EQ(Edit({"delete", "1-2"}).code, 0);
  ExpectDays({Three()[2]});
  const ProgramResult one = Edit({"delete", "1"});
  EXPECT_EQ(one.code, 0);
  EXPECT_EQ(one.err, "[Delete Rows] Delete row 1 ?\n");
  ExpectDays({});
  const ProgramResult none = Edit({"delete", "1"});
  EXPECT_EQ(none.code, 1);
  EXPECT_EQ(none.err, "[Data File] No data on file for c:\\korawin\\data\\ORE.WDT\n");
}

TEST_F(EditCommand, SortsByDateAndLeavesAFileThatIsInOrder) {
  EXPECT_EQ(Edit({"sort"}).code, 0);
  EXPECT_FALSE(home.Exists(kCopy));
  Put({Three()[2], Three()[0], Three()[1]});
  EXPECT_EQ(Edit({"sort"}).code, 0);
  ExpectDays(Three());
}

TEST_F(EditCommand, ScalesTheItemsOfSomeRecords) {
  EXPECT_EQ(Edit({"scale", "2-3", "--items", "close,volume", "--by", "/10"}).code, 0);
  auto days = Three();
  days[1].Close = 0.25f;
  days[1].Volume = 19;
  days[2].Close = 0.35f;
  days[2].Volume = 3000000;
  ExpectDays(days);
  EXPECT_EQ(Edit({"scale", "1", "--items", "OPEN", "--by", "X100"}).code, 0);
  days[0].Open = 100;
  ExpectDays(days);
}

TEST_F(EditCommand, ACodeThatIsNotThereIsTold) {
  EXPECT_EQ(Run({"edit", "XYZ", "sort"}).err, "[Name File] No File For That Name\n");
  std::filesystem::remove(home.path() + "/" + kOre);
  EXPECT_EQ(Edit({"sort"}).err, "[Data File] ORE NOT FOUND\n");
}

}  // namespace
}  // namespace kora::test
