#include <gtest/gtest.h>

#include "store/name_rec.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

constexpr const char* kNames = "kora/drive_c/korawin/data/Names.dat";

class EditNamesCommand : public testing::Test {
 protected:
  EditNamesCommand() { EXPECT_EQ(Run({"init"}).code, 0); }
  ProgramResult Run(std::vector<std::string> words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(BinDir() + "/koractl", words);
  }
  ProgramResult Edit(std::vector<std::string> words) {
    words.insert(words.begin(), "edit-names");
    return Run(words);
  }
  void Put(const std::vector<NameRec>& rows) { home.Put(kNames, Bytes(rows)); }
  static NameRec Named(std::string_view code, std::string_view name, std::int16_t category = 1,
                       std::string_view indClass = "") {
    NameRec rec = Security(code, category, kShare, indClass);
    rec.Name.set(name);
    return rec;
  }
  void ExpectNames(const std::vector<NameRec>& rows) { EXPECT_EQ(home.Get(kNames), Bytes(rows)); }

  TempHome home;
};

TEST_F(EditNamesCommand, KeepsTheFileInOrderOfCategoryWhateverTheEditorShows) {
  for (const char* order : {"code", "category", "class"}) {
    Put({Named("BBB", "b", 2, "001"), Named("AAA", "a", 2, "002"), Named("CCC", "c", 1, "003")});
    EXPECT_EQ(Edit({"sort", order}).code, 0);
    ExpectNames(
        {Named("CCC", "c", 1, "003"), Named("AAA", "a", 2, "002"), Named("BBB", "b", 2, "001")});
  }
  EXPECT_EQ(Edit({"sort", "name"}).code, 2);
  EXPECT_EQ(Edit({"sort"}).code, 2);
  EXPECT_EQ(Edit({}).code, 2);
}

TEST_F(EditNamesCommand, EachEntryOfTheMenuEndsInTheFile) {
  const NameRec last = Named("ZZZ", "", 99);
  Put({Named("BHPWMA", "warrant", 84), Named("BHP", "BHP LTD", 1, "012"), last});
  EXPECT_EQ(Edit({"fill-classes"}).code, 0);
  ExpectNames({Named("BHP", "BHP LTD", 1, "012"), Named("BHPWMA", "warrant", 84, "012"), last});
  EXPECT_EQ(Edit({"title-case"}).code, 0);
  ExpectNames({Named("BHP", "Bhp Ltd", 1, "012"), Named("BHPWMA", "Warrant", 84, "012"), last});

  EXPECT_EQ(Run({"--answer", "no", "edit-names", "remove-warrants"}).code, 0);
  EXPECT_EQ(home.Get(kNames).size(), 3 * sizeof(NameRec));
  const ProgramResult removed = Edit({"remove-warrants"});
  EXPECT_NE(removed.err.find("[Name File]  Warrants removed"), std::string::npos);
  ExpectNames({Named("BHP", "Bhp Ltd", 1, "012"), last});
  EXPECT_NE(home.Get("kora/Kora.ini").find("NoWarrants=True"), std::string::npos);

  NameRec scaled = Named("BHP", "Bhp Ltd", 1, "012");
  scaled.Top = 7;
  Put({scaled, Named("OLDO", "**EXPIRED**")});
  EXPECT_EQ(Edit({"clean-optional"}).code, 0);
  EXPECT_EQ(Edit({"remove-expired"}).code, 0);
  ExpectNames({Named("BHP", "Bhp Ltd", 1, "012")});

  Put({Named("B", "1"), Named("A", "2"), Named("B", "3")});
  const ProgramResult doubles = Edit({"remove-duplicates"});
  EXPECT_NE(doubles.err.find("[Duplicate codes] 1 duplicate entries removed"), std::string::npos);
  EXPECT_EQ(home.Get(kNames).size(), 2 * sizeof(NameRec));
}

TEST_F(EditNamesCommand, TheMasterListIsTakenOrItsLackTold) {
  Put({Named("AAA", "Mine"), Named("BBB", "")});
  const std::string before = home.Get(kNames);
  const ProgramResult missing = Edit({"from-master"});
  EXPECT_EQ(missing.code, 1);
  EXPECT_NE(missing.err.find("There is no master list (KoraName.Mas) in folder"),
            std::string::npos);
  EXPECT_EQ(home.Get(kNames), before);

  home.Put("list.csv", "AAA,5,3,11,Alpha,x\nBBB,4,2,12,Beta,y\n");
  ASSERT_EQ(Run({"master", home.path() + "/list.csv"}).code, 0);
  EXPECT_EQ(Edit({"from-master", "--keep", "name,type"}).code, 0);
  NameRec a = Named("AAA", "Mine", 3, "011"), b = Named("BBB", "Beta", 2, "012");
  a.OtherDetails.set("x");
  b.OtherDetails.set("y");
  ExpectNames({b, a});
  EXPECT_EQ(Edit({"from-master", "--keep", "colour"}).code, 2);
}

TEST_F(EditNamesCommand, AFileThatCannotBeReadIsToldAndStays) {
  std::string many(32768 * sizeof(NameRec), ' ');
  home.Put(kNames, many);
  const ProgramResult result = Edit({"title-case"});
  EXPECT_EQ(result.code, 1);
  EXPECT_FALSE(result.err.empty());
  EXPECT_EQ(home.Get(kNames), many);
}

}  // namespace
}  // namespace kora::test
