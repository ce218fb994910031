#include "store/name_file.h"

#include <gtest/gtest.h>

#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

const std::string kData = "c:\\data\\";
constexpr const char* kHost = "drive_c/data/Names.dat";

class Names : public ::testing::Test {
 protected:
  void Put(const std::vector<NameRec>& records, const std::string& tail = "") {
    home_.Put(kHost, Bytes(records) + tail);
  }
  std::int16_t Find(std::string_view code) {
    const NameFile file(home_.files(), NameFilePath(kData));
    return FindCode(file, code, found_);
  }
  bool Locate(const std::string& code) {
    current_.CurrentCode = code;
    return LocateCurrentCode(home_.files(), kData, dialogs_, current_);
  }

  TempHome home_;
  ScriptedDialogs dialogs_;
  CurrentName current_;
  NameRec found_{};
};

TEST_F(Names, AreReadInFileOrder) {
  Put({Security("BBB"), Security("AAA")});
  const std::vector<NameRec> names = ReadNames(home_.files(), kData);
  ASSERT_EQ(names.size(), 2u);
  EXPECT_EQ(names[0].Code.trimmed(), "BBB");
  EXPECT_EQ(names[1].Code.trimmed(), "AAA");
}

TEST_F(Names, NoFileHasNoRecords) { EXPECT_TRUE(ReadNames(home_.files(), kData).empty()); }

TEST_F(Names, AnEmptyFileFindsNothing) {
  Put({});
  EXPECT_TRUE(ReadNames(home_.files(), kData).empty());
  EXPECT_EQ(Find("BHP   "), 0);
  current_.NameCount = 77;
  EXPECT_FALSE(Locate("BHP"));
  EXPECT_EQ(current_.NameCount, 0);
}

TEST_F(Names, ATornRecordAtTheEndIsIgnored) {
  Put({Security("AAA")}, Bytes<NameRec>({Security("BHP")}).substr(0, 95));
  EXPECT_EQ(ReadNames(home_.files(), kData).size(), 1u);
  EXPECT_EQ(Find("BHP   "), 0);
}

TEST_F(Names, AFileShorterThanARecordIsEmpty) {
  home_.Put(kHost, "rubbish");
  EXPECT_TRUE(ReadNames(home_.files(), kData).empty());
}

TEST_F(Names, ACodeMatchesInItsPaddedFormOnly) {
  Put({Security("BHPABC"), Security("BHP")});
  EXPECT_EQ(Find("BHP   "), 2);
  EXPECT_EQ(found_.Code.raw(), "BHP   ");
  EXPECT_EQ(Find("BHP"), 0);
  EXPECT_EQ(Find("bhp   "), 0);
}

TEST_F(Names, TheFirstOfEqualCodesWins) {
  NameRec first = Security("BHP"), second = Security("BHP");
  first.Name.set("first");
  second.Name.set("second");
  Put({Security("AAA"), first, second});
  EXPECT_EQ(Find("BHP   "), 2);
  EXPECT_EQ(found_.Name.trimmed(), "first");
}

TEST_F(Names, AreFoundInEveryRunOfALongFile) {
  std::vector<NameRec> records;
  for (int i = 1; i <= 1100; ++i) records.push_back(Security("C" + std::to_string(i)));
  Put(records);
  for (const int n : {1, 511, 512, 513, 1024, 1025, 1100})
    EXPECT_EQ(Find(PadRight("C" + std::to_string(n), 6)), n);
}

TEST_F(Names, ALookUpReadsInRuns) {
  FailingIo io;
  TempHome home(io);
  std::vector<NameRec> records(3000, Security("AAA"));
  records.back() = Security("BHP");
  home.Put(kHost, Bytes(records));
  const NameFile file(home.files(), NameFilePath(kData));
  io.Reset();
  EXPECT_EQ(FindCode(file, "BHP   ", found_), 3000);
  EXPECT_EQ(io.reads, 6);  // 512 records each
}

TEST_F(Names, MoreRecordsThan16BitsCanNameIsError6) {
  Put(std::vector<NameRec>(40000, Security("AAA")));
  EXPECT_EQ(ErrorOf([&] { ReadNames(home_.files(), kData); }), kOverflow);
  EXPECT_EQ(ErrorOf([&] { Find("BHP   "); }), kOverflow);
  EXPECT_EQ(ErrorOf([&] { FindNameByCode(home_.files(), kData, "AAA   ", found_); }), kOverflow);
  EXPECT_EQ(ErrorOf([&] { Locate("AAA"); }), kOverflow);
  EXPECT_FALSE(dialogs_.busy);
}

TEST_F(Names, TheLargestCountIsStillNamed) {
  std::vector<NameRec> records(32767, Security("AAA"));
  records.back() = Security("BHP");
  Put(records);
  EXPECT_TRUE(Locate("BHP"));
  EXPECT_EQ(current_.NameRecNo, 32767);
  EXPECT_EQ(current_.NameCount, 32767);
}

TEST_F(Names, TitleLookUpComparesAsGivenAndTrims) {
  NameRec rec = Security("BHP", 1, kShare, "012");
  rec.Name.set("Caf\xE9 Ltd");
  Put({Security("AAA"), rec});
  const NameAndClass title = FindNameByCode(home_.files(), kData, "BHP   ", found_);
  EXPECT_EQ(title.Name, "Caf\xC3\xA9 Ltd");
  EXPECT_EQ(title.IndClass, "012");
  EXPECT_EQ(found_.Code.trimmed(), "BHP");
  for (const char* code : {"bhp   ", "BHP", "XYZ   ", ""}) {
    const NameAndClass none = FindNameByCode(home_.files(), kData, code, found_);
    EXPECT_EQ(none.Name + none.IndClass, "") << code;
  }
}

TEST_F(Names, TitleLookUpWithoutAFileIsEmpty) {
  EXPECT_EQ(FindNameByCode(home_.files(), kData, "BHP   ", found_).Name, "");
}

TEST_F(Names, LocatePadsAndUpperCases) {
  Put({Security("AAA"), Security("BHP")});
  EXPECT_TRUE(Locate("bhp"));
  EXPECT_EQ(current_.NameRecNo, 2);
  EXPECT_EQ(current_.NameCount, 2);
  EXPECT_EQ(current_.CurrentCode, "BHP   ");
  EXPECT_EQ(current_.PriceFileName, "BHP.WDT");
  EXPECT_EQ(current_.Rec.Code.raw(), "BHP   ");
  EXPECT_TRUE(dialogs_.said.empty());
  EXPECT_EQ(dialogs_.busyCalls, 2);
  EXPECT_FALSE(dialogs_.busy);
}

TEST_F(Names, LocateTellsWhatItDoesNotFind) {
  Put({Security("AAA")});
  ASSERT_TRUE(Locate("AAA"));
  EXPECT_FALSE(Locate("BHP"));
  ASSERT_EQ(dialogs_.said.size(), 1u);
  EXPECT_EQ(dialogs_.said[0].text, "No File For That Name");
  EXPECT_EQ(current_.PriceFileName, "");
  EXPECT_EQ(current_.NameRecNo, 1);
  EXPECT_FALSE(dialogs_.busy);
}

TEST_F(Names, ALongerCodeIsNotItsFirstSixLetters) {
  Put({Security("ABCDEF")});
  EXPECT_TRUE(Locate("ABCDEF"));
  EXPECT_FALSE(Locate("ABCDEFG"));
}

TEST_F(Names, ACodeThatCouldLeaveTheFolderHasNoFile) {
  std::vector<NameRec> records;
  const std::vector<std::string> codes{"..\\X", "A/B", "C:", "NUL", "", "..", "*", "A\tB"};
  for (const std::string& code : codes) {
    records.push_back(Security("x"));
    records.back().Code.set(code);
  }
  Put(records);
  for (const std::string& code : codes) {
    EXPECT_FALSE(Locate(code)) << code;
    EXPECT_EQ(current_.PriceFileName, "") << code;
  }
}

TEST_F(Names, LocateRaisesWhatKeepsTheFileShut) {
  EXPECT_EQ(ErrorOf([&] { Locate("BHP"); }), kPathNotFound);
  home_.Put("drive_c/data/other", "");
  EXPECT_EQ(ErrorOf([&] { Locate("BHP"); }), kFileNotFound);
  home_.Put("drive_c/data/Names.dat/inner", "");
  EXPECT_EQ(ErrorOf([&] { Locate("BHP"); }), kPathAccess);
  EXPECT_FALSE(dialogs_.busy);
}

TEST_F(Names, AFileThatMayNotBeReadRaisesItsError) {
  FailingIo io;
  TempHome home(io);
  home.Put(kHost, Bytes<NameRec>({Security("BHP")}));
  io.failReadAt = 1;
  io.readError = kPathAccess;
  EXPECT_EQ(ErrorOf([&] { ReadNames(home.files(), kData); }), kPathAccess);
}

}  // namespace
}  // namespace kora::test
