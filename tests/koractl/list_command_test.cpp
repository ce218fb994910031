// Chart lists by koractl as a process.

#include <gtest/gtest.h>

#include <filesystem>

#include "lists/chart_list.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

using Words = std::vector<std::string>;

class ListCommand : public testing::Test {
 protected:
  ListCommand() {
    EXPECT_EQ(Run({"init"}).code, 0);
    Names({"AAA", "BHP", "ORE", "WOW"});
  }
  void Names(const std::vector<std::string>& codes) {
    std::vector<NameRec> names;
    for (const std::string& code : codes) names.push_back(Security(code));
    home.Put("kora/drive_c/korawin/data/Names.dat", Bytes(names));
  }
  static ListRec Entry(std::int16_t record, std::string_view code) {
    ListRec rec;
    rec.ListRecNo = record;
    rec.ListCode.set(code);
    return rec;
  }
  static std::string PathOf(char letter) {
    return std::string("kora/drive_c/korawin/data/SubList") + letter + ".Dat";
  }
  void Put(char letter, const std::vector<ListRec>& records) {
    home.Put(PathOf(letter), Bytes(records));
  }
  void ExpectList(char letter, const std::vector<ListRec>& records) {
    EXPECT_EQ(home.Get(PathOf(letter)), Bytes(records)) << letter;
  }
  ProgramResult Run(Words words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(BinDir() + "/koractl", words);
  }
  ProgramResult List(Words words) {
    words.insert(words.begin(), "list");
    return Run(words);
  }

  TempHome home;
};

TEST_F(ListCommand, ShowsAListAsItIsStored) {
  Put('A', {Entry(77, "ORE"), Entry(-1, "GONE")});
  EXPECT_EQ(List({"a"}).out, "Rec\tCode\n77\tORE\n-1\tGONE\n");
  EXPECT_EQ(List({"Z"}).out, "Rec\tCode\n");
}

TEST_F(ListCommand, AddsCodesWithTheirNumbersOnce) {
  EXPECT_EQ(List({"A", "add", "ore", "BHP", "ORE"}).code, 0);
  ExpectList('A', {Entry(3, "ORE"), Entry(2, "BHP")});
  EXPECT_EQ(List({"A", "add", "AAA", "BHP"}).code, 0);
  ExpectList('A', {Entry(3, "ORE"), Entry(2, "BHP"), Entry(1, "AAA")});
}

TEST_F(ListCommand, ACodeThatIsNotFoundLeavesTheListAsItWas) {
  Put('A', {Entry(3, "ORE")});
  for (const Words& words : {Words{"A", "add", "AAA", "XYZ"}, Words{"A", "remove", "ORE", "XYZ"},
                             Words{"move", "A", "B", "ORE", "XYZ"}}) {
    const ProgramResult result = List(words);
    EXPECT_EQ(result.code, 1) << words[1];
    EXPECT_EQ(result.err, "[Chart Lists] Code not found  XYZ\n");
  }
  ExpectList('A', {Entry(3, "ORE")});
  EXPECT_FALSE(home.Exists(PathOf('B')));
}

TEST_F(ListCommand, RemovesAndClearsUnlessAnsweredOtherwise) {
  Put('A', {Entry(3, "ORE"), Entry(2, "BHP"), Entry(1, "AAA")});
  const ProgramResult kept = Run({"--answer", "no", "list", "A", "remove", "BHP"});
  EXPECT_EQ(kept.code, 1);
  EXPECT_EQ(kept.err, "[Chart Lists] Delete BHP  ?\n");
  EXPECT_EQ(Run({"--answer", "no", "list", "A", "clear"}).code, 1);
  ExpectList('A', {Entry(3, "ORE"), Entry(2, "BHP"), Entry(1, "AAA")});
  EXPECT_EQ(List({"A", "remove", "bhp"}).code, 0);
  ExpectList('A', {Entry(3, "ORE"), Entry(1, "AAA")});
  const ProgramResult cleared = List({"A", "clear"});
  EXPECT_EQ(cleared.code, 0);
  EXPECT_EQ(cleared.err, "[Chart Lists] Delete all items ?\n");
  EXPECT_TRUE(home.Exists(PathOf('A')));
  ExpectList('A', {});
}

TEST_F(ListCommand, CopiesAndMovesInListOrder) {
  Put('A', {Entry(3, "ORE"), Entry(2, "BHP"), Entry(1, "AAA")});
  Put('B', {Entry(2, "BHP")});
  EXPECT_EQ(List({"copy", "A", "B", "AAA", "ORE", "BHP"}).code, 0);
  ExpectList('A', {Entry(3, "ORE"), Entry(2, "BHP"), Entry(1, "AAA")});
  ExpectList('B', {Entry(2, "BHP"), Entry(3, "ORE"), Entry(1, "AAA")});
  EXPECT_EQ(List({"move", "B", "K", "BHP", "AAA"}).code, 0);
  ExpectList('B', {Entry(3, "ORE")});
  ExpectList('K', {Entry(2, "BHP"), Entry(1, "AAA")});
}

TEST_F(ListCommand, OneListIsNotCopiedToItself) {
  Put('A', {Entry(3, "ORE")});
  const ProgramResult result = List({"copy", "A", "a", "ORE"});
  EXPECT_EQ(result.code, 1);
  EXPECT_EQ(result.err, "[Chart List Utilities] Lists cannot be same\n");
}

TEST_F(ListCommand, ASaveDropsCodesThatLeftTheNameFileAndTellsThem) {
  Put('A', {Entry(9, "GONE"), Entry(9, "ORE")});
  const ProgramResult result = List({"A", "add", "AAA"});
  EXPECT_EQ(result.code, 0);
  EXPECT_EQ(result.err, "[Chart Lists] GONE is no longer in the Name File\n");
  ExpectList('A', {Entry(3, "ORE"), Entry(1, "AAA")});
}

TEST_F(ListCommand, ChecksAllLists) {
  Put('A', {Entry(9, "GONE"), Entry(9, "ORE")});
  Put('Z', {Entry(9, "BHP"), Entry(0, "LEFT")});
  EXPECT_EQ(List({"check"}).out, "# Lists=2 Removed=2\n");
  ExpectList('A', {Entry(3, "ORE")});
  ExpectList('Z', {Entry(2, "BHP")});
}

TEST_F(ListCommand, AMisspeltCommandLineIsUsage) {
  Put('A', {Entry(3, "ORE")});
  for (const Words& words :
       {Words{}, Words{"I"}, Words{"AB"}, Words{""}, Words{"A", "add"}, Words{"A", "sort"},
        Words{"A", "clear", "ORE"}, Words{"check", "A"}, Words{"copy", "A", "ORE"},
        Words{"move", "A", "B"}, Words{"copy", "A", "I", "ORE"}})
    EXPECT_EQ(List(words).code, 2) << (words.empty() ? "" : words[0]);
  ExpectList('A', {Entry(3, "ORE")});
}

TEST_F(ListCommand, WithoutANameFileNothingIsSaved) {
  Put('A', {Entry(3, "ORE")});
  std::filesystem::remove(home.path() + "/kora/drive_c/korawin/data/Names.dat");
  EXPECT_EQ(List({"A", "remove", "ORE"}).code, 1);
  ExpectList('A', {Entry(3, "ORE")});
}

}  // namespace
}  // namespace kora::test
