#include "update/import_history.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <map>

#include "base/dates.h"
#include "base/record_file.h"
#include "lists/chart_list.h"
#include "store/name_file.h"
#include "store/price_rec.h"
#include "tests/support/failing_io.h"
#include "tests/support/killed_runs.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

namespace {

const std::string kData = "c:\\korawin\\data\\";
const std::string kHostData = "drive_c/korawin/data/";

class ImportTest : public ::testing::Test {
 protected:
  ImportTest() { home.Put(kHostData + "Names.dat", ""); }

  std::string Source(const std::string& name, std::string_view text) {
    home.Put("in/" + name, text);
    return home.path() + "/in/" + name;
  }
  bool Import(const std::string& name, std::string_view text, const ImportOptions& options = {}) {
    return Import({Source(name, text)}, options);
  }
  bool Import(const std::vector<std::string>& sources, const ImportOptions& options = {}) {
    return ImportHistory(home.files(), kData, sources, options, dialogs, counts);
  }
  std::vector<PriceRec> Prices(const std::string& code) {
    return PriceFile(home.files(), kData + code + ".WDT").ReadAll();
  }
  std::vector<NameRec> Names() { return ReadNames(home.files(), kData); }
  // Every file of the data folder with its bytes.
  std::map<std::string, std::string> DataFiles() {
    std::map<std::string, std::string> out;
    for (const auto& entry : std::filesystem::directory_iterator(home.path() + "/" + kHostData)) {
      const std::string name = entry.path().filename().string();
      out[name] = entry.is_directory() ? "folder" : home.Get(kHostData + name);
    }
    return out;
  }
  std::string LastSaid() { return dialogs.said.empty() ? "" : dialogs.said.back().text; }
  // The import fails, says `part`, and leaves every file as it was.
  void ExpectRefused(const std::string& name, std::string_view text, const std::string& part,
                     const ImportOptions& options = {}) {
    const auto before = DataFiles();
    const size_t said = dialogs.said.size();
    EXPECT_FALSE(Import(name, text, options)) << text.substr(0, 80);
    EXPECT_EQ(DataFiles(), before) << text.substr(0, 80);
    std::string all;
    for (size_t i = said; i < dialogs.said.size(); ++i) {
      EXPECT_EQ(dialogs.said[i].title, "Import");
      all += dialogs.said[i].text + "\n";
    }
    EXPECT_NE(all.find(part), std::string::npos) << all;
  }

  FailingIo io;
  TempHome home{io};
  ScriptedDialogs dialogs;
  ImportCounts counts;
};

ImportOptions WithType(std::int16_t type) {
  ImportOptions options;
  options.Type = type;
  return options;
}

}  // namespace

TEST_F(ImportTest, TakesEightFieldLinesWithoutAHeader) {
  ASSERT_TRUE(Import("x.csv",
                     "BHP,20240102,1.5,2,1.25,1.75,1200,0\r\n"
                     "BHP,20240103,1.75,2.5,1.5,2.25,900,0\r\n"));
  const auto rows = Prices("BHP");
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[0].RecDate.raw(), "20240102");
  EXPECT_EQ(float(rows[0].Open), 1.5f);
  EXPECT_EQ(float(rows[0].High), 2.0f);
  EXPECT_EQ(float(rows[0].Low), 1.25f);
  EXPECT_EQ(float(rows[0].Close), 1.75f);
  EXPECT_EQ(std::int32_t(rows[0].Volume), 1200);
  EXPECT_EQ(float(rows[0].AdjFactor), 0.0f);
  EXPECT_EQ(rows[0].AdjDesc.trimmed(), "");
  EXPECT_EQ(rows[1].RecDate.raw(), "20240103");
  EXPECT_EQ(counts.Added, 2);
  EXPECT_EQ(counts.Codes, std::set<std::string>{"BHP"});
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ImportTest, GivesANewCodeARecordWithTheStandingValues) {
  ImportOptions options = WithType(5);
  options.Name = "All Shares";
  ASSERT_TRUE(Import("x.csv", "xao,20240102,1,2,1,2,0,0\n", options));
  const auto names = Names();
  ASSERT_EQ(names.size(), 1u);
  EXPECT_EQ(names[0].Code.raw(), "XAO   ");
  EXPECT_EQ(names[0].RecType, 5);
  EXPECT_EQ(names[0].Name.trimmed(), "All Shares");
  EXPECT_EQ(names[0].NameStatus, 0);
  EXPECT_EQ(names[0].Category, 1);
  EXPECT_EQ(float(names[0].MinMove), 0.05f);
}

TEST_F(ImportTest, TakesColumnsInAnyOrderAndCaseAndPassesOverOthers) {
  ASSERT_TRUE(Import("cba.csv",
                     "volume,CLOSE,Adj Close,low,High,OPEN,date\n"
                     "500,4,99,1,5,2,2024-01-31\n"));
  const auto rows = Prices("CBA");  // from the file's name
  ASSERT_EQ(rows.size(), 1u);
  EXPECT_EQ(rows[0].RecDate.raw(), "20240131");
  EXPECT_EQ(float(rows[0].Open), 2.0f);
  EXPECT_EQ(float(rows[0].High), 5.0f);
  EXPECT_EQ(float(rows[0].Low), 1.0f);
  EXPECT_EQ(float(rows[0].Close), 4.0f);
  EXPECT_EQ(std::int32_t(rows[0].Volume), 500);
}

TEST_F(ImportTest, TakesTheCodeFromItsColumnUnderAnyOfItsNames) {
  ASSERT_TRUE(Import("a.csv", "Symbol,Date,Close\nAAA,20240102,1\nbbb,20240102,2\n"));
  ASSERT_TRUE(Import("b.csv", "Date,Close,Ticker\n20240102,1,CCC\n"));
  ASSERT_TRUE(Import("c.csv", "code,Date,Close\nDDD,20240102,1\n"));
  EXPECT_EQ(counts.Codes, (std::set<std::string>{"AAA", "BBB", "CCC", "DDD"}));
  EXPECT_EQ(float(Prices("BBB")[0].Close), 2.0f);
}

TEST_F(ImportTest, CodesThatCannotBeFileNamesAreKeptAsTheDailyUpdateKeepsThem) {
  ASSERT_TRUE(Import("x.csv", "prn,20240102,1,1,1,1,7,0\nAUX,20240102,2,2,2,2,8,0\n"));
  ASSERT_TRUE(Import("prn.csv", "Date,Close\n20240103,3\n"));
  EXPECT_EQ(Prices("PRNX").size(), 2u);
  EXPECT_EQ(Prices("1AUX").size(), 1u);
}

TEST_F(ImportTest, TheCodeOptionStandsForTheFilesOneSecurity) {
  ImportOptions options;
  options.Code = "new";
  ASSERT_TRUE(Import("longname.csv", "Date,Close\n20240102,1\n", options));
  ASSERT_TRUE(Import("b.csv", "OLD,20240103,1,1,1,1,0,0\n", options));
  EXPECT_EQ(Prices("NEW").size(), 2u);
  ExpectRefused("c.csv", "Date,Code,Close\n20240102,AAA,1\n20240102,BBB,1\n",
                "more than one security", options);
}

TEST_F(ImportTest, AcceptsBomQuotesBlanksSemicolonsTabsAndMissingLastLineEnd) {
  ASSERT_TRUE(Import("a.csv", "\xEF\xBB\xBF\"Date\" ; \"Close\"\r\n\"20240102\" ; \"1.5\""));
  ASSERT_TRUE(Import("b.csv", "Date\tClose\n20240102\t2.5\n\n   \n20240103\t3.5\n"));
  ASSERT_TRUE(Import("c.csv", "Date,Name,Close\n20240102,\"Smith, \"\"J\"\" & Co\",4.5\n"));
  EXPECT_EQ(float(Prices("A")[0].Close), 1.5f);
  EXPECT_EQ(Prices("B").size(), 2u);
  EXPECT_EQ(float(Prices("C")[0].Close), 4.5f);
}

TEST_F(ImportTest, TakesSlashedDatesOnlyWhenTold) {
  ExpectRefused("a.csv", "Date,Close\n2/1/2024,1\n", "line 2: the Date \"2/1/2024\"");
  ImportOptions options;
  options.Dates = ImportDates::kSlashed;
  ASSERT_TRUE(Import("a.csv", "Date,Close\n2/1/2024,1\n31/12/2023,2\n", options));
  const auto rows = Prices("A");
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[0].RecDate.raw(), "20231231");
  EXPECT_EQ(rows[1].RecDate.raw(), "20240102");
  ExpectRefused("a.csv", "Date,Close\n2/1/24,1\n", "d/m/yyyy", options);
  ExpectRefused("a.csv", "Date,Close\n20240102,1\n", "d/m/yyyy", options);
  options.Dates = ImportDates::kDashed;
  ExpectRefused("a.csv", "Date,Close\n20240102,1\n", "yyyy-mm-dd", options);
}

TEST_F(ImportTest, KindsOfDataFillTheFieldsThatTheyHave) {
  const char* text = "Date,Open,High,Low,Close,Volume\n20240102,1,3,0.5,2,70\n";
  ASSERT_TRUE(Import("A1.csv", text, WithType(1)));
  ASSERT_TRUE(Import("A2.csv", text, WithType(2)));
  ASSERT_TRUE(Import("A3.csv", "Date,Rises,Falls,Cum.Total\n20240102,120,80,-35\n", WithType(3)));
  ASSERT_TRUE(Import("A4.csv", "Date,Open,Close\n20240102,3,2\n", WithType(4)));
  const PriceRec one = Prices("A1")[0], two = Prices("A2")[0], three = Prices("A3")[0],
                 four = Prices("A4")[0];
  EXPECT_EQ(float(one.Open), 2.0f);
  EXPECT_EQ(float(one.High), 2.0f);
  EXPECT_EQ(float(one.Low), 2.0f);
  EXPECT_EQ(std::int32_t(one.Volume), 70);
  EXPECT_EQ(float(two.Low), 2.0f);
  EXPECT_EQ(std::int32_t(two.Volume), 0);
  EXPECT_EQ(float(three.High), 120.0f);
  EXPECT_EQ(float(three.Low), 80.0f);
  EXPECT_EQ(float(three.Close), -35.0f);
  // Columns that are not there are made of those that are.
  EXPECT_EQ(float(four.High), 3.0f);
  EXPECT_EQ(float(four.Low), 2.0f);
}

TEST_F(ImportTest, AKnownSecurityKeepsItsKind) {
  ASSERT_TRUE(Import("A.csv", "Date,Close\n20240102,1\n", WithType(1)));
  ASSERT_TRUE(Import("A.csv", "Date,Open,High,Low,Close\n20240103,1,9,1,2\n"));
  EXPECT_EQ(float(Prices("A")[1].High), 2.0f);
  EXPECT_EQ(Names().size(), 1u);
  ExpectRefused("A.csv", "Date,Close\n20240104,1\n", "A is of type 1", WithType(4));
}

TEST_F(ImportTest, MergesByDateAndKeepsAdjustmentMarks) {
  ASSERT_TRUE(Import("A.csv", "Date,Close\n20240105,5\n20240103,3\n20240101,1\n"));
  PriceFile file(home.files(), kData + "A.WDT", OpenMode::kReadWrite);
  PriceRec marked = file.Read(2);
  marked.AdjFactor = 0.5f;
  marked.AdjDesc.set("1:2 SPLIT");
  file.Write(2, marked);
  counts = {};
  ASSERT_TRUE(Import("A.csv", "Date,Close\n20240104,4\n20240103,33\n20240106,6\n20240106,66\n"));
  const auto rows = Prices("A");
  ASSERT_EQ(rows.size(), 5u);
  const char* dates[] = {"20240101", "20240103", "20240104", "20240105", "20240106"};
  const float closes[] = {1, 33, 4, 5, 66};
  for (size_t i = 0; i < 5; ++i) {
    EXPECT_EQ(rows[i].RecDate.raw(), dates[i]);
    EXPECT_EQ(float(rows[i].Close), closes[i]);
  }
  EXPECT_EQ(float(rows[1].AdjFactor), 0.5f);
  EXPECT_EQ(rows[1].AdjDesc.trimmed(), "1:2 SPLIT");
  EXPECT_EQ(counts.Added, 2);     // the 4th and the first row of the 6th
  EXPECT_EQ(counts.Replaced, 2);  // the 3rd and the 6th's second row
}

TEST_F(ImportTest, VolumesRoundHalfToEvenWithin32Bits) {
  ASSERT_TRUE(Import("A.csv",
                     "Date,Close,Volume\n20240101,1,2.5\n20240102,1,3.5\n20240103,1,2147483647\n"
                     "20240104,1,\n"));
  const auto rows = Prices("A");
  EXPECT_EQ(std::int32_t(rows[0].Volume), 2);
  EXPECT_EQ(std::int32_t(rows[1].Volume), 4);
  EXPECT_EQ(std::int32_t(rows[2].Volume), 2147483647);
  EXPECT_EQ(std::int32_t(rows[3].Volume), 0);
  ExpectRefused("A.csv", "Date,Close,Volume\n20240105,1,2147483648\n", "line 2: the Volume");
  ExpectRefused("A.csv", "Date,Close,Volume\n20240105,1,-1\n", "line 2: the Volume");
}

TEST_F(ImportTest, SortsTheNameFileAndGivesTheListsTheNewNumbers) {
  ASSERT_TRUE(Import("A.csv", "Code,Date,Close\nDDD,20240101,1\nBBB,20240101,1\n"));
  ListRec rec{};
  rec.ListRecNo = 2;
  rec.ListCode.set("DDD");
  home.Put(kHostData + "SubListB.Dat", std::string(reinterpret_cast<char*>(&rec), 8));
  ASSERT_TRUE(Import("AAA.csv", "Date,Close\n20240101,1\n"));
  const auto names = Names();
  ASSERT_EQ(names.size(), 3u);
  EXPECT_EQ(names[0].Code.trimmed(), "AAA");
  EXPECT_EQ(names[1].Code.trimmed(), "BBB");
  EXPECT_EQ(names[2].Code.trimmed(), "DDD");
  const ListRec now =
      RecordFile<ListRec>(home.files(), ListFilePath(kData, kFirstChartList + 1)).Read(1);
  EXPECT_EQ(now.ListRecNo, 3);
  EXPECT_EQ(now.ListCode.trimmed(), "DDD");
}

TEST_F(ImportTest, ABadRowLeavesAllSecuritiesOfTheFileAsTheyWere) {
  ASSERT_TRUE(Import("A.csv", "Date,Close\n20240101,1\n"));
  counts = {};
  const char* text = "Code,Date,Close\nA,20240102,2\nB,20240102,2\nA,20240230,2\nA,20240103,abc\n";
  ExpectRefused("x.csv", text, "x.csv line 4: the Date \"20240230\"");
  EXPECT_EQ(counts.Refused, 4);
  EXPECT_EQ(counts.Added, 0);
  counts = {};
  ImportOptions options;
  options.SkipBad = true;
  ASSERT_TRUE(Import("x.csv", text, options));
  EXPECT_EQ(Prices("A").size(), 2u);
  EXPECT_EQ(Prices("B").size(), 1u);
  EXPECT_EQ(counts.Added, 2);
  EXPECT_EQ(counts.Refused, 2);
}

TEST_F(ImportTest, RowsThatAreNoPricesAreBad) {
  for (const char* row :
       {"20240102,nan,1", "20240102,inf,1", "20240102,-1,1", "20240102,1e39,1", "20240102,1x,1",
        "20240102,,1", "20240102,0x10,1", "2024010,1,1", "20241301,1,1", "00000000,1,1", ",1,1",
        "20240102", "20240102,\"1,1", "20240102,\"1\"2,1", "20240102,1,nan", "20240102,1,9e99"})
    ExpectRefused("A.csv", std::string("Date,Close,Volume\n") + row + "\n", "A.csv line 2: ");
  ExpectRefused("A.csv", "A,20240102,1,1,1,1,1,0\nA,20240102,1,1,1,1,1\n", "line 2: 7 fields");
  ExpectRefused("A.csv", "A,20240102,1,1,1,1,1,0\nA,20240102,1,1,1,1,1,0,0\n", "line 2: 9 fields");
}

TEST_F(ImportTest, CodesThatCouldLeaveTheFolderAreRefused) {
  for (const char* code : {"..\\X", "A/B", "C:", "NUL", "TOOLONG", "", "A*", ".."}) {
    const std::string text = std::string("Code,Date,Close\n") + code + ",20240102,1\n";
    ExpectRefused("x.csv", text, "is no code");
  }
  ExpectRefused("muchtoolong.csv", "Date,Close\n20240102,1\n", "is no code");
}

TEST_F(ImportTest, FilesThatAreNoHistoryAreRefused) {
  ExpectRefused("a.csv", "", "no rows");
  ExpectRefused("a.csv", "Date,Close\n", "no rows");
  ExpectRefused("a.csv", "hello\n", "line 1: neither");
  ExpectRefused("a.csv", "Date,Open\n20240102,1\n", "no Close column");
  ExpectRefused("a.csv",
                std::string("\xFF\xFE"
                            "D\0a\0",
                            6),
                "no plain text");
  ExpectRefused("a.csv", std::string("Date,Close\n2024\0,1\n", 18), "no plain text");
  ExpectRefused("a.csv", std::string(2'000'000, 'x'), "line 1: neither");
  ExpectRefused("a.csv", "Date,Close\n20240102," + std::string(2'000'000, '1') + "\n",
                "line 2: longer than 4096");
  ImportOptions options;
  options.SkipBad = true;
  ExpectRefused("a.csv", "Date,Close\nx,1\n", "no row can be read", options);
  std::filesystem::create_directory(home.path() + "/folder.csv");
  EXPECT_FALSE(Import({home.path() + "/folder.csv"}));
  EXPECT_FALSE(Import({home.path() + "/absent.csv"}));
  // A file of 257 million bytes that takes no room on the disk.
  const std::string huge = Source("huge.csv", "");
  std::filesystem::resize_file(huge, 257u << 20);
  EXPECT_FALSE(Import({huge}));
  EXPECT_EQ(DataFiles().size(), 1u);
}

TEST_F(ImportTest, ManyBadRowsAreCountedAndNotAllTold) {
  std::string text = "Date,Close\n";
  for (int i = 0; i < 1000; ++i) text += "x,1\n";
  ExpectRefused("a.csv", text, "and 980 more rows");
  EXPECT_EQ(dialogs.said.size(), 22u);  // 20 rows, the rest, the verdict
  EXPECT_EQ(counts.Refused, 1000);
}

TEST_F(ImportTest, APriceFileThatCannotBeNumberedIsRefused) {
  std::string text = "Date,Close\n";
  CalendarDate day{1900, 1, 1};
  for (int i = 0; i < 32768; ++i)
    text += FormatFileDate(DateOfDayNumber(DayNumber(day) + i)) + ",1\n";
  ExpectRefused("a.csv", text, "more than 32767 records");
  text.resize(text.size() - 11);  // one row less
  EXPECT_TRUE(Import("a.csv", text));
  EXPECT_EQ(Prices("A").size(), 32767u);
}

TEST_F(ImportTest, StoreFilesThatAreFoldersOrOutOfOrderAreRefused) {
  std::filesystem::create_directory(home.path() + "/" + kHostData + "A.WDT");
  ExpectRefused("a.csv", "Date,Close\n20240102,1\n", "A.WDT: ");
  PriceRec late = NewPriceRec("20240105"), early = NewPriceRec("20240101");
  std::string bytes(reinterpret_cast<char*>(&late), 50);
  bytes.append(reinterpret_cast<char*>(&early), 50);
  home.Put(kHostData + "B.WDT", bytes);
  ExpectRefused("b.csv", "Date,Close\n20240102,1\n", "not in order");
}

TEST_F(ImportTest, EveryFailureOfTheDiskLeavesEveryFileAsItWas) {
  ASSERT_TRUE(Import("a.csv", "Code,Date,Close\nBBB,20240101,1\nDDD,20240101,1\n"));
  ListRec rec{};
  rec.ListRecNo = 2;
  rec.ListCode.set("DDD");
  home.Put(kHostData + "SubListA.Dat", std::string(reinterpret_cast<char*>(&rec), 8));
  const auto before = DataFiles();
  // Changes two price files, makes two new ones, the name file and the list anew.
  const std::string source =
      Source("m.csv",
             "Code,Date,Close\nBBB,20240102,2\nDDD,20240101,3\nAAA,20240102,1\n"
             "CCC,20240102,1\n");
  int failures = 0;
  for (int at = 1; at < 200; ++at) {
    io.Reset(at);
    const bool done = Import({source});
    if (io.calls < at) {
      EXPECT_TRUE(done);
      break;
    }
    EXPECT_FALSE(done) << at;
    EXPECT_EQ(DataFiles(), before) << at;
    ++failures;
  }
  io.Reset();
  // Six files: each opened, written, flushed, renamed, those that replace one given its access and
  // the old one kept aside; the journal of the set opened, written, flushed; the folder flushed.
  EXPECT_EQ(failures, 6 * 4 + 4 * 2 + 3 + 1);
  EXPECT_EQ(Names().size(), 4u);
}

TEST_F(ImportTest, ACutOffLeavesEachFileOldOrNewAndNoNameWithoutItsFile) {
  const std::string source = Source("m.csv", "Code,Date,Close\nAAA,20240102,1\nCCC,20240102,1\n");
  io.lasting = true;
  for (int at = 1; at < 200; ++at) {
    io.Reset(at);
    const bool done = Import({source});
    io.Reset();
    if (done) break;
    for (const NameRec& name : Names())
      EXPECT_EQ(Prices(std::string(name.Code.trimmed())).size(), 1u) << at;
    for (const auto& [name, bytes] : DataFiles()) {
      if (name.ends_with(".WDT")) {
        EXPECT_EQ(bytes.size(), 50u) << at << name;
      }
    }
  }
  EXPECT_EQ(Names().size(), 2u);
}

// ---- Several files of one command

TEST_F(ImportTest, TheFilesOfOneCommandAreTakenTogether) {
  EXPECT_TRUE(Import({Source("a.csv", "Code,Date,Close\nAAA,20240102,1\nBBB,20240102,2\n"),
                      Source("b.csv", "Code,Date,Close\nBBB,20240103,3\nCCC,20240102,4\n")}));
  EXPECT_EQ(Names().size(), 3u);
  EXPECT_EQ(Prices("BBB").size(), 2u);
  EXPECT_EQ(counts.Codes.size(), 3u);
  EXPECT_EQ(counts.Added, 4);
}

TEST_F(ImportTest, ARowOfALaterFileTakesThePlaceOfAnEarlierOne) {
  EXPECT_TRUE(Import({Source("AAA.csv", "Date,Close\n20240103,1\n20240102,1\n"),
                      Source("x.csv", "Code,Date,Close\nAAA,20240102,7\n")}));
  ASSERT_EQ(Prices("AAA").size(), 2u);
  EXPECT_EQ(float(Prices("AAA")[0].Close), 7);
  EXPECT_EQ(counts.Added, 2);
  EXPECT_EQ(counts.Replaced, 1);
}

TEST_F(ImportTest, ARefusedFileLeavesTheOthersOfTheCommand) {
  EXPECT_FALSE(Import({Source("a.csv", "Code,Date,Close\nAAA,20240102,1\n"),
                       Source("b.csv", "Code,Date,Close\nBBB,20240102,1\nAAA,20240103,x\n"),
                       Source("c.csv", "Code,Date,Close\nCCC,20240102,1\n")}));
  EXPECT_EQ(Names().size(), 2u);
  EXPECT_EQ(Prices("AAA").size(), 1u);
  EXPECT_FALSE(home.Exists(kHostData + "BBB.WDT"));
  EXPECT_EQ(counts.Refused, 2);
}

// A new code of the command is a known one to the files behind it.
TEST_F(ImportTest, ANewCodeIsAddedOnceACommand) {
  ImportOptions index;
  index.Type = std::int16_t(kIndex);
  EXPECT_TRUE(Import({Source("a.csv", "Code,Date,Close\nAAA,20240102,1\n"),
                      Source("b.csv", "Code,Date,Close\nAAA,20240103,1\n")},
                     index));
  ASSERT_EQ(Names().size(), 1u);
  EXPECT_EQ(int(Names()[0].RecType), int(kIndex));
}

TEST_F(ImportTest, TheRowsOfAllFilesCountForWhatAPriceFileCanHold) {
  home.Put(kHostData + "Names.dat", Bytes(std::vector{Security("AAA")}));
  std::string first = "Date,Close\n", second = first;
  for (int i = 0; i < 20000; ++i) {
    first += FormatFileDate(DateOfDayNumber(i)) + ",1\n";
    second += FormatFileDate(DateOfDayNumber(i + 12766)) + ",2\n";
  }
  // 32,766 days of their own; one more day fits and two do not.
  EXPECT_TRUE(
      Import({Source("AAA.csv", first), Source("AAA2.csv", second)}, ImportOptions{.Code = "AAA"}));
  EXPECT_EQ(Prices("AAA").size(), 32766u);
  const std::string days = "Date,Close\n" + FormatFileDate(DateOfDayNumber(40000)) + ",1\n";
  EXPECT_FALSE(Import({Source("AAA.csv", days),
                       Source("b.csv", "Code,Date,Close\nAAA," +
                                           FormatFileDate(DateOfDayNumber(40001)) + ",1\n")}));
  EXPECT_EQ(Prices("AAA").size(), 32767u);
  EXPECT_NE(LastSaid().find("b.csv: AAA.WDT: more than 32767 records"), std::string::npos)
      << LastSaid();
}

TEST_F(ImportTest, AnImportThatIsStoppedLeavesEverything) {
  struct Stopping : ScriptedDialogs {
    int at = 0, steps = 0;
    std::unique_ptr<Progress> StartProgress(std::string_view) override {
      struct Counted : Progress {
        explicit Counted(Stopping& stopping_) : owner(stopping_) {}
        bool Step(int, int) override { return ++owner.steps != owner.at; }
        Stopping& owner;
      };
      return std::make_unique<Counted>(*this);
    }
  } stopping;
  ASSERT_TRUE(Import("a.csv", "Code,Date,Close\nAAA,20240101,1\n"));
  const auto before = DataFiles();
  const std::vector<std::string> sources{
      Source("a.csv", "Code,Date,Close\nAAA,20240102,1\nBBB,20240102,1\n"),
      Source("b.csv", "Code,Date,Close\nCCC,20240102,1\n")};
  for (stopping.at = 1; stopping.at <= 5; ++stopping.at) {
    stopping.steps = 0;
    EXPECT_FALSE(ImportHistory(home.files(), kData, sources, {}, stopping, counts)) << stopping.at;
    EXPECT_EQ(DataFiles(), before) << stopping.at;
  }
}

// Numbers of the lists go by the codes, also where a run that was killed behind the name file has
// left them behind and this one adds no name.
TEST_F(ImportTest, EveryImportSetsTheNumbersOfTheListsRight) {
  ASSERT_TRUE(Import("a.csv", "Code,Date,Close\nAAA,20240101,1\nCCC,20240101,1\n"));
  std::vector<ListRec> list(3);
  list[0].ListRecNo = 1;
  list[0].ListCode.set("CCC");  // as it was before AAA came in front of it
  list[1].ListRecNo = 7;
  list[1].ListCode.set("GONE");
  list[2].ListRecNo = 2;
  list[2].ListCode.set("AAA");
  home.Put(kHostData + "SubListB.Dat", Bytes(list));
  ASSERT_TRUE(Import("a.csv", "Code,Date,Close\nAAA,20240102,1\n"));
  const auto after = ReadList(home.files(), kData, 3);
  ASSERT_EQ(after.size(), 2u);
  EXPECT_EQ(int(after[0].ListRecNo), 2);
  EXPECT_EQ(after[0].ListCode.trimmed(), "CCC");
  EXPECT_EQ(int(after[1].ListRecNo), 1);
}

// Cut off at each change in turn, lists and names told apart; the same import again then gives what
// an undisturbed one gives.
TEST_F(ImportTest, AnImportThatWasCutOffIsCompletedByTheSameImport) {
  const auto lay = [this] {
    std::filesystem::remove_all(home.path() + "/drive_c/korawin/data");
    home.Put(kHostData + "Names.dat", Bytes(std::vector{Security("BBB"), Security("DDD")}));
    for (const char* code : {"BBB", "DDD"})
      home.Put(kHostData + code + ".WDT", Bytes(std::vector{NewPriceRec("20240101")}));
    std::vector<ListRec> list(2);
    list[0].ListRecNo = 2;
    list[0].ListCode.set("DDD");
    list[1].ListRecNo = 1;
    list[1].ListCode.set("BBB");
    for (const char* name : {"SubListA.Dat", "SubListZ.Dat"})
      home.Put(kHostData + name, Bytes(list));
  };
  const std::vector<std::string> sources{
      Source("a.csv", "Code,Date,Close\nAAA,20240102,1\nBBB,20240102,1\n"),
      Source("b.csv", "Code,Date,Close\nCCC,20240102,1\n")};
  lay();
  ASSERT_TRUE(Import(sources));
  const auto whole = DataFiles();
  int points = 0;
  for (int at = 1;; ++at) {
    lay();
    const auto code = InChild([&] {
      io.Reset(at);
      io.kills = true;
      return Import(sources) ? 0 : 1;
    });
    EXPECT_EQ(code.value_or(0), 0);
    if (code) break;
    ++points;
    io.Reset();
    for (const NameRec& name : Names())
      EXPECT_GE(Prices(std::string(name.Code.trimmed())).size(), 1u) << at;
    ASSERT_TRUE(Import(sources)) << at << LastSaid();
    auto after = DataFiles();
    std::erase_if(after, [](const auto& file) { return file.first.ends_with('~'); });
    EXPECT_EQ(after, whole) << at;
  }
  EXPECT_GT(points, 20);
}
