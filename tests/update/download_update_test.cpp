#include "update/download_update.h"

#include "base/record_file.h"
#include "tests/support/mutate.h"
#include "tests/update/update_fixture.h"
#include "update/price_write.h"

using namespace kora;
using namespace kora::test;

namespace {

using DownloadUpdate = UpdateFixture;

// The same price in every field.
PriceRec Flat(std::string_view date, float price, std::int32_t volume = 0) {
  return Day(date, price, price, price, price, volume);
}

const std::string kBothDays = "ORE,19980915,1,2,0.5,1.5,100,0\r\nZAP,19980915,3,4,2,3,200,0\r\n";

}  // namespace

// ---- Plain days

TEST_F(DownloadUpdate, AppendsARecordAndTakesTheFileOffTheList) {
  Names({Security("ORE")});
  Prices("ORE", {Flat("19980914", 1)});
  EXPECT_EQ(Take("ORE,19980915,1,2,0.5,1.5,1234,0\r\n"), UpdateEnd::kUpdated);
  const auto recs = PricesOf("ORE");
  ASSERT_EQ(recs.size(), 2u);
  EXPECT_EQ(Bytes(std::vector{recs[1]}),
            Bytes(std::vector{Day("19980915", 1, 2, 0.5f, 1.5f, 1234)}));
  EXPECT_FALSE(Waits("15SEP98.d"));
  EXPECT_TRUE(Waits("15SEP98.dX"));
  EXPECT_TRUE(entries.empty());
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_FALSE(display.running);
  // No folder before the name, though the last 11 characters of the path have one.
  EXPECT_EQ(display.firsts.front(), " Updating  15SEP98.d");
}

TEST_F(DownloadUpdate, GivesANewSecurityANameRecord) {
  Names({Security("ORE")});
  Prices("ORE", {Flat("19980914", 1)});
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,1,0\nNEW,19980915,2,2,2,2,5,0"), UpdateEnd::kUpdated);
  const auto names = NamesOf();
  ASSERT_EQ(names.size(), 2u);
  NameRec wanted = NewNameRec("NEW");
  EXPECT_EQ(Bytes(std::vector{names[1]}), Bytes(std::vector{wanted}));
  EXPECT_EQ(Shown("NEW"), "19980915 2 5");
}

TEST_F(DownloadUpdate, AnEmptyPriceFileGetsItsFirstRecordAndNoName) {
  Prices("ORE", {});
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,7,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980915 1 7");
  EXPECT_TRUE(NamesOf().empty());
}

TEST_F(DownloadUpdate, CutsACodeOfSevenCharactersBeforeEveryFilter) {
  settings.download.NoWarrants = true;
  ASSERT_EQ(Take("ABCDEFG,19980915,1,1,1,1,7,0\nABCWEFG,19980915,1,1,1,1,7,0\n"),
            UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ABCDEF"), "19980915 1 7");
  EXPECT_FALSE(home.Exists(kHostData + "ABCWEF.WDT"));  // six characters with a W: a warrant
}

TEST_F(DownloadUpdate, TakesWarrantsThatAreNotExcluded) {
  ASSERT_EQ(Take("ABCWEF,19980915,1,1,1,1,7,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ABCWEF"), "19980915 1 7");
}

TEST_F(DownloadUpdate, CodesThatAreDevicesGoUnderOtherNames) {
  ASSERT_EQ(Take("PRN,19980915,1,1,1,1,7,0\nAUX,19980915,2,2,2,2,8,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("PRNX"), "19980915 1 7");
  EXPECT_EQ(Shown("1AUX"), "19980915 2 8");
}

TEST_F(DownloadUpdate, DividesVolumesOfServiceFourAlone) {
  settings.download.VolumeDivisor = 100;
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,1234,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980915 1 1234");
  settings.download.DataService = 2;
  ASSERT_EQ(Take("TWO,19980915,1,1,1,1,1234,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("TWO"), "19980915 1 1234");
  settings.download.DataService = 4;
  settings.download.InternetDLfmt = "DDMMMYY.D";
  ASSERT_EQ(Take("FOUR,19980915,1,1,1,1,1234,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("FOUR"), "19980915 1 12");
}

TEST_F(DownloadUpdate, TakesListedCodesAlone) {
  settings.download.UpdateAll = false;
  home.Put(kHostSystem + "Update.Lst", " zap ,1,Zap Ltd\r\n");
  ASSERT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_FALSE(home.Exists(kHostData + "ORE.WDT"));
  EXPECT_EQ(Shown("ZAP"), "19980915 3 200");
}

TEST_F(DownloadUpdate, SkipsAllLinesWithoutAnUpdateList) {
  settings.download.UpdateAll = false;
  ASSERT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_TRUE(NamesOf().empty());
  EXPECT_FALSE(home.Exists(kHostData + "ZAP.WDT"));
  EXPECT_FALSE(Waits("15SEP98.d"));
}

TEST_F(DownloadUpdate, SkipsABlankCode) {
  // After the probe met a security with prices; the blank line stands behind it.
  Prices("ORE", {Flat("19980914", 1)});
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,1,0\n ,19980915,1,1,1,1,1,0\nZAP,19980915,3,3,3,3,3,0\n"),
            UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980914 1 0; 19980915 1 1");
  EXPECT_EQ(Shown("ZAP"), "19980915 3 3");
}

TEST_F(DownloadUpdate, ABlankCodeInTheProbeLosesTheLinesBeforeIt) {
  ASSERT_EQ(Take("NEW,19980915,1,1,1,1,1,0\n,19980915,1,1,1,1,1,0\nZAP,19980915,3,3,3,3,3,0\n"),
            UpdateEnd::kUpdated);
  EXPECT_FALSE(home.Exists(kHostData + "NEW.WDT"));
  EXPECT_EQ(Shown("ZAP"), "19980915 3 3");
}

TEST_F(DownloadUpdate, TheSpareFieldCorrectsTheVolumeOfTheDayBefore) {
  Prices("ORE", {Flat("19980911", 1, 10), Flat("19980914", 1, 20)});
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,30,25\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980911 1 10; 19980914 1 25; 19980915 1 30");
}

TEST_F(DownloadUpdate, TheSpareFieldOfAFirstRecordHasNothingToCorrect) {
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,30,25\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980915 1 30");
}

// ---- What is on file already

TEST_F(DownloadUpdate, ReplacesTheSameDateAfterOk) {
  Prices("ORE", {Flat("19980914", 1), Day("19980915", 9, 9, 9, 9, 9, 2)});
  dialogs.answers = {Answer::kOk};
  ASSERT_EQ(Take("ORE,19980915,1,2,0.5,1.5,100,0\nZAP,19980915,3,3,3,3,3,0\n"),
            UpdateEnd::kUpdated);
  EXPECT_EQ(LastTitle(), kData);
  EXPECT_EQ(LastSaid(),
            " There is already data on file with this date\n"
            "  New data will replace the old data");
  const auto recs = PricesOf("ORE");
  ASSERT_EQ(recs.size(), 2u);
  EXPECT_EQ(Bytes(std::vector{recs[1]}),
            Bytes(std::vector{Day("19980915", 1, 2, 0.5f, 1.5f, 100)}));
  EXPECT_EQ(Shown("ZAP"), "19980915 3 3");
}

TEST_F(DownloadUpdate, CancelAtTheDateLeavesEverything) {
  Prices("ORE", {Flat("19980914", 1), Flat("19980915", 9, 9)});
  Download("15SEP98.d", kBothDays);
  const auto before = Everything();
  dialogs.answers = {Answer::kCancel};
  EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kAbandoned);
  EXPECT_EQ(Everything(), before);
  EXPECT_EQ(entries, DownloadEntries{"15SEP98.d"});
}

TEST_F(DownloadUpdate, InsertsInOrderOfDate) {
  Prices("ORE", {Flat("19980910", 1, 0), Flat("19980911", 1, 1), Flat("19980916", 3, 3),
                 Flat("19980917", 4, 4)});
  Prices("ZAP", {Flat("19980911", 1, 1), Flat("19980914", 2, 2)});
  ASSERT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_EQ(LastSaid(),
            " There is already data on file LATER than this date\n"
            " This procedure will insert the data in the correct position \n"
            " The update will take a little longer than usual");
  EXPECT_EQ(Shown("ORE"), "19980910 1 0; 19980911 1 1; 19980915 1 100; 19980916 3 3; 19980917 4 4");
  EXPECT_EQ(Shown("ZAP"), "19980911 1 1; 19980914 2 2; 19980915 3 200");
}

TEST_F(DownloadUpdate, ReplacesADateBeforeTheLast) {
  Prices("ORE", {Flat("19980911", 1, 1), Flat("19980915", 9, 9), Flat("19980917", 4, 4)});
  ASSERT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_EQ(LastSaid(),
            " There is already data on file for this date\n"
            "  New data will replace the old data");
  EXPECT_EQ(Shown("ORE"), "19980911 1 1; 19980915 1 100; 19980917 4 4");
}

TEST_F(DownloadUpdate, ADateBeforeAllOnFileIsAppendedWithoutAWord) {
  Prices("ORE", {Flat("19980916", 3, 3), Flat("19980917", 4, 4)});
  ASSERT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Shown("ORE"), "19980916 3 3; 19980917 4 4; 19980915 1 100");
}

TEST_F(DownloadUpdate, TheLastLineIsNeverProbed) {
  Prices("ORE", {Flat("19980915", 9, 9)});
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,1,0\n"), UpdateEnd::kUpdated);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Shown("ORE"), "19980915 9 9; 19980915 1 1");
}

TEST_F(DownloadUpdate, AFileOfOneRecordTakesALaterDateInFront) {
  Prices("ORE", {Flat("19980911", 1, 1), Flat("19980915", 3, 3)});
  Prices("ZAP", {Flat("19980911", 1, 1)});
  ASSERT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ZAP"), "19980915 3 200; 19980911 1 1");
}

TEST(FindPlaceTest, FollowsTheTableOfDates) {
  TempHome home;
  const auto place = [&](std::vector<std::string> dates, std::string_view date, int mode) {
    std::vector<PriceRec> recs;
    for (const std::string& d : dates) recs.push_back(Flat(d, 1));
    home.Put("drive_c/A.WDT", Bytes(recs));
    StagedPrices staged;
    const PriceView file(home.files(), "c:\\A.WDT", true, staged);
    const RecordPlace p = FindPlace(file, date, std::int16_t(mode));
    return std::to_string(p.position) + (p.overwrite ? "=" : "<");
  };
  EXPECT_EQ(place({"19980910", "19980912"}, "19980909", 1), "1<");  // before all
  EXPECT_EQ(place({"19980910", "19980912"}, "19980911", 1), "1<");  // later than record 1 alone
  EXPECT_EQ(place({"19980909", "19980910", "19980912"}, "19980911", 1), "3<");
  EXPECT_EQ(place({"19980910", "19980912"}, "19980913", 1), "3<");  // behind the last
  EXPECT_EQ(place({"19980910"}, "19980913", 1), "1<");              // one record, later
  EXPECT_EQ(place({"19980910", "19980912"}, "19980912", 2), "2=");
  EXPECT_EQ(place({"19980910", "19980912"}, "19980910", 2), "1=");
  EXPECT_EQ(place({"19980908", "19980910", "19980912"}, "19980912", 1), "3<");  // equal goes on
  EXPECT_EQ(place({"19980910", "19980912"}, "19980910", 1), "1<");
  std::vector<std::string> many;
  for (int i = 0; i < 100; ++i) many.push_back(std::to_string(19980000 + 2 * i));
  EXPECT_EQ(place(many, "19980041", 1), "22<");  // behind record 21, 19980040
  EXPECT_EQ(place(many, "19980040", 2), "21=");
}

// ---- Kinds of data

TEST_F(DownloadUpdate, TheRecordLastHeldDrivesAServiceWithoutLookUp) {
  current.Rec = Security("ANY", 1, kCloseOnly);
  Prices("ORE", {Flat("19980914", 1)});
  ASSERT_EQ(Take("ORE,19980915,1,2,0.5,1.5,1234,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980914 1 0; 19980915 1 0");  // kind 2: no volume
}

TEST_F(DownloadUpdate, ServiceOneLooksTheCodeUp) {
  settings.download.DataService = 1;
  Names({Security("XAD", 1, kAdvanceDecline), Security("ORE"), Security("CLO", 1, kCloseOnly)});
  Prices("XAD", {Day("19980911", 0, 5, 3, 2, 9), Day("19980914", 0, 4, 5, 1, 9)});
  Prices("CLO", {Flat("19980914", 1)});
  Prices("ORE", {Flat("19980914", 1)});
  ASSERT_EQ(Take("XAD,19980915,7,10,4,99,50,0\nCLO,19980915,1,2,1,1,77,0\n"
                 "ORE,19980915,1,1,1,1,88,0\n"),
            UpdateEnd::kUpdated);
  // 10 rises, 4 falls on a total of 1.
  EXPECT_EQ(Shown("XAD"), "19980911 2 9; 19980914 1 9; 19980915 7 50");
  EXPECT_EQ(float(PricesOf("XAD")[2].Open), 0);
  EXPECT_EQ(Shown("CLO"), "19980914 1 0; 19980915 1 0");
  EXPECT_EQ(Shown("ORE"), "19980914 1 0; 19980915 1 88");
}

TEST_F(DownloadUpdate, AnInsertedTotalRunsOnToTheEnd) {
  settings.download.DataService = 1;
  Names({Security("XAD", 1, kAdvanceDecline)});
  Prices("XAD", {Day("19980910", 0, 1, 1, 0), Day("19980911", 0, 5, 3, 2),
                 Day("19980914", 0, 4, 5, 1), Day("19980916", 0, 6, 1, 6)});
  ASSERT_EQ(Take("XAD,19980915,0,10,4,0,0,0\nXAD,19980914,0,9,5,0,0,0\n"), UpdateEnd::kUpdated);
  // Inserted: 1 + 10 - 4 = 7, then 7 + 6 - 1 = 12. The second line is inserted behind the 11th:
  // 2 + 9 - 5 = 6, 6 + 4 - 5 = 5, 5 + 10 - 4 = 11, 11 + 6 - 1 = 16.
  EXPECT_EQ(Shown("XAD"),
            "19980910 0 0; 19980911 2 0; 19980914 6 0; 19980914 5 0; 19980915 11 0; "
            "19980916 16 0");
}

TEST_F(DownloadUpdate, AReplacedTotalRunsOnToTheEnd) {
  settings.download.DataService = 1;
  Names({Security("XAD", 1, kAdvanceDecline)});
  Prices("XAD",
         {Day("19980911", 0, 5, 3, 2), Day("19980915", 3, 4, 5, 1), Day("19980916", 0, 6, 1, 6)});
  ASSERT_EQ(Take("XAD,19980915,0,10,4,0,12,0\n,19980915,,,,,,\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("XAD"), "19980911 2 0; 19980915 8 12; 19980916 13 0");  // 2+10-4, 8+6-1
  EXPECT_EQ(float(PricesOf("XAD")[1].Open), 3);
}

// ---- No-trade pass

TEST_F(DownloadUpdate, GivesSharesThatDidNotTradeAFlatRecord) {
  Names({Security("ORE"), Security("ZAP"), Security("OLD", 90), Security("EDGE", 89),
         Security("IDX", 1, kIndex), Security("LATE"), Security("NONE"), Security("VOID")});
  for (const char* code : {"ORE", "ZAP", "OLD", "EDGE", "IDX"})
    Prices(code, {Day("19980914", 1, 3, 1, 2, 5)});
  Prices("LATE", {Flat("19980917", 1)});
  Prices("VOID", {});
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,1,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980914 2 5; 19980915 1 1");
  EXPECT_EQ(Bytes(std::vector{PricesOf("ZAP").at(1)}), Bytes(std::vector{Flat("19980915", 2)}));
  EXPECT_EQ(PricesOf("OLD").size(), 1u);  // categories 90 to 99
  EXPECT_EQ(PricesOf("EDGE").size(), 2u);
  EXPECT_EQ(PricesOf("IDX").size(), 1u);   // shares alone
  EXPECT_EQ(PricesOf("LATE").size(), 1u);  // an earlier date adds nothing
  EXPECT_TRUE(PricesOf("VOID").empty());
  EXPECT_FALSE(home.Exists(kHostData + "NONE.WDT"));
}

TEST_F(DownloadUpdate, ServiceOneHasNoNoTradePass) {
  settings.download.DataService = 1;
  Names({Security("ORE"), Security("ZAP")});
  Prices("ZAP", {Flat("19980914", 1)});
  ASSERT_EQ(Take("ORE,19980915,1,1,1,1,1,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(PricesOf("ZAP").size(), 1u);
}

TEST_F(DownloadUpdate, ReplacingHasNoNoTradePass) {
  Names({Security("ORE"), Security("OLD")});
  Prices("ORE", {Flat("19980914", 1), Flat("19980915", 1)});
  Prices("OLD", {Flat("19980914", 1)});
  ASSERT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_EQ(PricesOf("OLD").size(), 1u);
}

// The pass goes with the renaming: an internet file that keeps the ending ".ASX" has neither.
TEST_F(DownloadUpdate, AFileOfTheAsxFormIsNotRenamedAndHasNoNoTradePass) {
  settings.download.DataService = 4;
  Names({Security("ORE"), Security("ZAP")});
  for (const char* code : {"ORE", "ZAP"}) Prices(code, {Flat("19980914", 1)});
  Download("980915.ASX", "ORE,19980915,2,2,2,2,1,0\r\nORE,19980916,3,3,3,3,1,0\r\n");
  entries = {"980915.ASX"};
  EXPECT_EQ(UpdateOneDay(Run(), entries, 0), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980914 1 0; 19980915 2 1; 19980916 3 1");
  EXPECT_EQ(Shown("ZAP"), "19980914 1 0");
  EXPECT_TRUE(Waits("980915.ASX"));
  EXPECT_FALSE(Waits("980915.ASXX"));
}

TEST_F(DownloadUpdate, AFileOfTheAsxFormIsListedOnlyOnceItIsRenamed) {
  settings.download.DataService = 4;
  settings.download.InternetDLfmt = "DDMMMYY.D";
  Download("980915.ASX", kBothDays);
  EXPECT_EQ(BuildDownloadList(home.files(), settings.download, dialogs, entries),
            ListResult::kNothingWaits);
  settings.download.InternetDLfmt = "YYMMDD.ASX";
  ASSERT_EQ(BuildDownloadList(home.files(), settings.download, dialogs, entries),
            ListResult::kFilled);
  EXPECT_EQ(entries, DownloadEntries{"15SEP98.d"});
  EXPECT_EQ(UpdateOneDay(Run(), entries, 0), UpdateEnd::kUpdated);
  EXPECT_TRUE(Waits("15SEP98.dX"));
}

// ---- Files that are refused

TEST_F(DownloadUpdate, AFileThatIsGoneIsToldAndNothingIsFinished) {
  entries = {"15SEP98.d"};
  EXPECT_EQ(UpdateOneDay(Run(), entries, 0), UpdateEnd::kNotBegun);
  EXPECT_EQ(LastTitle(), "Update");
  EXPECT_EQ(LastSaid(), "File does not exist\nc:\\korawin\\download\\15SEP98.d");
  EXPECT_EQ(entries, DownloadEntries{"15SEP98.d"});
  EXPECT_EQ(display.states, (std::vector<std::string>{"Updating ", ""}));
}

TEST_F(DownloadUpdate, ATextBelowEightBytesIsNoData) {
  Download("15SEP98.d", "A,,,,,,");
  const auto before = Everything();
  EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kAbandoned);
  EXPECT_EQ(LastTitle(), "Data Update");
  EXPECT_EQ(LastSaid(), "There is no data in 15SEP98.d\n");
  EXPECT_EQ(Everything(), before);
}

TEST_F(DownloadUpdate, EightBytesFallToTheCommaCount) {
  EXPECT_EQ(Take("A,,,,,,3"), UpdateEnd::kAbandoned);
  EXPECT_EQ(LastTitle(), "Download Data Update");
  EXPECT_NE(LastSaid().find("7 commas seperating 8 fields"), std::string::npos);
}

TEST_F(DownloadUpdate, AnEmptyMainfileIsToBeConverted) {
  settings.download.DataService = 1;
  EXPECT_EQ(Take(""), UpdateEnd::kAbandoned);
  EXPECT_EQ(LastSaid(),
            "There is no data in 15SEP98.d\n"
            "Use Convert Mainfile Data routine in KORA/Tarvo Download to reprocess data");
  EXPECT_EQ(Take("1234567"), UpdateEnd::kAbandoned);
  EXPECT_EQ(LastSaid(), "There is no data in 15SEP98.d\n");
}

TEST_F(DownloadUpdate, OneWrongLineRefusesTheFile) {
  Download("15SEP98.d", kBothDays + "BAD,19980915,1,2,3\r\n");
  const auto before = Everything();
  EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kAbandoned);
  EXPECT_EQ(LastTitle(), "Download Data Update");
  EXPECT_EQ(LastSaid(),
            "15SEP98.d There is a problem with \n"
            " There is an incorrect number of fields in the record\n"
            " There should be 7 commas seperating 8 fields\n"
            " code,date,open,high,low,close,vol,spare\n"
            "MAKE SURE THE DOWNLOADED DATA IS SET UP FOR KORA FORMAT\n"
            " The first incorrect record found was \n"
            "BAD,19980915,1,2,3\n\nCorrect and retry\n");
  EXPECT_EQ(Everything(), before);
}

TEST_F(DownloadUpdate, ABlankLineIsWrongUnlessTheDataAreFromTheInternet) {
  EXPECT_EQ(Take(kBothDays + "\r\n"), UpdateEnd::kAbandoned);
  settings.download.DataService = 4;
  settings.download.InternetDLfmt = "DDMMMYY.D";
  ASSERT_EQ(Take("\r\n" + kBothDays + "  \r\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(home.Get(kHostDown + "15SEP98.dX"), kBothDays);
  EXPECT_FALSE(Waits("IData.tmp"));
}

// Each names its line and leaves everything as it was.
TEST_F(DownloadUpdate, HostileLinesAreRefusedBeforeAnythingIsWritten) {
  Prices("ORE", {Flat("19980914", 1)});
  const std::string good = "ORE,19980915,1,1,1,1,1,0\n";
  const std::string rest = ",19980915,1,1,1,1,1,0\n";
  using std::string_literals::operator""s;
  const std::vector<std::string> bad = {"..\\..\\X" + rest,
                                        "../X" + rest,
                                        "A:B" + rest,
                                        "C*" + rest,
                                        "NUL" + rest,
                                        "COM1" + rest,
                                        "\xFF\xFE" + rest,
                                        "A B" + rest,
                                        "..." + rest,
                                        "A\0B"s + rest,
                                        "A,1998091,1,1,1,1,1,0\n",
                                        "A,19980231,1,1,1,1,1,0\n",
                                        "A,date,1,1,1,1,1,0\n",
                                        "A,19980915,1" + std::string(50, '0') + ",1,1,1,1,0\n",
                                        "A,19980915,1,1,1,1,2147483648,0\n",
                                        "A,19980915,1,1,1,1,1,-9999999999\n",
                                        std::string(1 << 20, 'A') + ",19980915,1,1,1,1,\0,0\n"s};
  for (const std::string& line : bad) {
    Download("15SEP98.d", good + line + good);
    const auto before = Everything();
    EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kAbandoned) << line.substr(0, 40);
    EXPECT_EQ(LastTitle(), "Download Data Update") << line.substr(0, 40);
    EXPECT_NE(LastSaid().find("\n line 2\n"), std::string::npos) << LastSaid().substr(0, 300);
    EXPECT_LT(LastSaid().size(), 1000u);
    EXPECT_EQ(Everything(), before) << line.substr(0, 40);
  }
}

TEST_F(DownloadUpdate, TextOfAnotherEncodingIsRefused) {
  std::string utf16 = "\xFF\xFE";
  for (const char c : kBothDays) {
    utf16 += c;
    utf16 += '\0';
  }
  std::string carriage = kBothDays;
  std::erase(carriage, '\n');  // CR alone: one line of 14 commas
  for (const std::string& text :
       {utf16, carriage, std::string("no data at all\n"), std::string(1 << 20, ',')}) {
    Download("15SEP98.d", text);
    const auto before = Everything();
    EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kAbandoned);
    EXPECT_EQ(LastTitle(), "Download Data Update");
    EXPECT_EQ(Everything(), before);
  }
}

TEST_F(DownloadUpdate, TakesALineOfAMegabyte) {
  ASSERT_EQ(Take("ORE" + std::string(1 << 20, 'E') + ",19980915,1,1,1,1,1,0"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("OREEEE"), "19980915 1 1");
}

TEST_F(DownloadUpdate, TakesTwoHundredThousandLines) {
  std::string text;
  for (int i = 0; i < 200000; ++i)
    text += "C" + std::to_string(i % 10) + ",19980915,1,1,1,1," + std::to_string(i) + ",0\n";
  ASSERT_EQ(Take(text), UpdateEnd::kUpdated);
  EXPECT_EQ(NamesOf().size(), 10u);
  EXPECT_EQ(PricesOf("C3").size(), 20000u);
  EXPECT_EQ(int(PricesOf("C3").back().Volume), 199993);
}

TEST_F(DownloadUpdate, AFullPriceFileIsNamedAndTheRestOfTheDayIsTaken) {
  const std::vector<PriceRec> full(32767, Flat("19980914", 1));
  Names({Security("ORE"), Security("ZAP"), Security("FLAT"), Security("IDLE")});
  for (const char* code : {"ORE", "FLAT"}) Prices(code, full);
  Prices("IDLE", {Flat("19980914", 7)});
  EXPECT_EQ(Take(kBothDays), UpdateEnd::kUpdatedInPart);
  EXPECT_EQ(LastTitle(), "Data Update");
  EXPECT_EQ(LastSaid(),
            "Not everything was taken in as it stands:\n"
            "15SEP98.d\n"
            " left out: ORE: its price file is full, with 32767 days\n"
            " left out: FLAT: its price file is full, with 32767 days");
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(PricesOf("ORE").size(), 32767u);
  EXPECT_EQ(PricesOf("FLAT").size(), 32767u);
  EXPECT_EQ(Shown("ZAP"), "19980915 3 200");
  EXPECT_EQ(Shown("IDLE"), "19980914 7 0; 19980915 7 0");
  EXPECT_FALSE(Waits("15SEP98.d"));
}

TEST_F(DownloadUpdate, AFullPriceFileStillTakesADateThatIsThere) {
  std::vector<PriceRec> full(32767, Flat("19980914", 1));
  full.back() = Flat("19980915", 1);
  Prices("ORE", full);
  EXPECT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_EQ(int(PricesOf("ORE").back().Volume), 100);
}

TEST_F(DownloadUpdate, AFullNameFileLeavesNewCodesOutAndTakesTheRest) {
  std::vector<NameRec> names(32767, Security("ZZZ"));
  names[0] = Security("ORE");
  Names(names);
  Prices("ORE", {Flat("19980914", 1)});
  EXPECT_EQ(Take(kBothDays), UpdateEnd::kUpdatedInPart);
  EXPECT_EQ(LastSaid(),
            "Not everything was taken in as it stands:\n"
            "15SEP98.d\n"
            " left out: ZAP: the name file is full, with 32767 names");
  EXPECT_EQ(NamesOf().size(), 32767u);
  EXPECT_FALSE(home.Exists(kHostData + "ZAP.WDT"));
  EXPECT_EQ(Shown("ORE"), "19980914 1 0; 19980915 1 100");
}

TEST_F(DownloadUpdate, TooManyNamesAreTold) {
  Names(std::vector<NameRec>(32768, Security("ZZZ")));
  EXPECT_EQ(Take(kBothDays), UpdateEnd::kStopped);
  EXPECT_EQ(LastSaid(),
            "There is an unexpected error - Overflow\n"
            "c:\\korawin\\data\\: 32768 names, and 32767 at most");
  EXPECT_TRUE(Waits("15SEP98.d"));
}

TEST_F(DownloadUpdate, ATotalThatLeavesItsRangeIsLeftOut) {
  settings.download.DataService = 1;
  Names({Security("XAD", 1, kAdvanceDecline), Security("ORE")});
  Prices("XAD", {Day("19980914", 0, 4, 5, 3e38f)});
  Prices("ORE", {Flat("19980914", 1)});
  EXPECT_EQ(Take("XAD,19980915,0,300000000000000000000000000000000000000,0,0,0,0\n" + kBothDays),
            UpdateEnd::kUpdatedInPart);
  EXPECT_EQ(PricesOf("XAD").size(), 1u);
  EXPECT_EQ(PricesOf("ORE").size(), 2u);
  EXPECT_NE(LastSaid().find(" left out: XAD: its total leaves the range of its field"),
            std::string::npos);
}

TEST_F(DownloadUpdate, FieldsThatAreNoNumbersAreReadByTheirLeadingPartAndTold) {
  ASSERT_EQ(Take("ORE,19980915,1.2x,abc,0.5,,1E5,0\r\nZAP,19980915,,,,3,,\r\n"),
            UpdateEnd::kUpdated);
  const auto recs = PricesOf("ORE");
  EXPECT_EQ(float(recs[0].Open), 1.2f);
  EXPECT_EQ(float(recs[0].High), 0);
  EXPECT_EQ(float(recs[0].Close), 0);
  EXPECT_EQ(int(recs[0].Volume), 1);
  EXPECT_EQ(LastSaid(),
            "Not everything was taken in as it stands:\n"
            "15SEP98.d\n"
            " line 1, ORE: Open \"1.2x\" read as 1.2\n"
            " line 1, ORE: High \"abc\" read as 0\n"
            " line 1, ORE: Close \"\" read as 0\n"
            " line 1, ORE: Volume \"1E5\" read as 1");
}

TEST_F(DownloadUpdate, ManyRemarksAreCountedBehindTheFirstTwenty) {
  std::string text;
  for (int i = 0; i < 30; ++i) text += "ORE,19980915,1,1,1,x,1,0\n";
  ASSERT_EQ(Take(text), UpdateEnd::kUpdated);
  EXPECT_TRUE(LastSaid().ends_with("line 20, ORE: Close \"x\" read as 0\n and 10 more"));
}

TEST_F(DownloadUpdate, ACodeKeepsItsCase) {
  Names({Security("ORE")});
  Prices("ORE", {Flat("19980914", 1)});
  ASSERT_EQ(Take("ore,19980915,2,2,2,2,20,0\nnew,19980915,3,3,3,3,30,0\n"
                 "prn,19980915,4,4,4,4,40,0\n"),
            UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980914 1 0; 19980915 2 20");  // names of files match in any case
  const auto names = NamesOf();
  ASSERT_EQ(names.size(), 3u);
  EXPECT_EQ(names[1].Code.raw(), "new   ");
  EXPECT_TRUE(home.Exists(kHostData + "new.WDT"));
  EXPECT_EQ(names[2].Code.raw(), "PRNX  ");
}

TEST_F(DownloadUpdate, CodesInLowerCaseAreNotThoseOfTheUpdateList) {
  settings.download.UpdateAll = false;
  home.Put(kHostSystem + "Update.Lst", "zap,1,Zap Ltd\r\n");
  ASSERT_EQ(Take("zap,19980915,3,3,3,3,200,0\nZAP,19980915,3,3,3,3,300,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ZAP"), "19980915 3 300");
}

TEST_F(DownloadUpdate, ServiceOneLooksCodesUpAsTheyAre) {
  settings.download.DataService = 1;
  Names({Security("XAD", 1, kAdvanceDecline)});
  Prices("XAD", {Day("19980914", 0, 4, 5, 1)});
  current.Rec = Security("ANY");
  ASSERT_EQ(Take("xad,19980915,1,10,4,7,5,0\n"), UpdateEnd::kUpdated);
  EXPECT_EQ(float(PricesOf("XAD")[1].Close), 7);  // not found: of the kind last held
}

TEST_F(DownloadUpdate, AMissingFolderIsTold) {
  settings.paths.CurrentDataPath = "c:\\nowhere\\";
  EXPECT_EQ(Take(kBothDays), UpdateEnd::kStopped);
  EXPECT_EQ(LastSaid(),
            "There is a file access problem. Check directory paths option.\nc:\\nowhere\\: "
            "No such file or directory");
}

// ---- Several days

TEST_F(DownloadUpdate, UpdateAllGoesThroughTheDatesInOrder) {
  Download("02OCT98.d", "ORE,19981002,3,3,3,3,3,0\n");
  Download("30SEP98.d", "ORE,19980930,1,1,1,1,1,0\n");
  Download("01OCT98.d", "ORE,19981001,2,2,2,2,2,0\n");
  ASSERT_EQ(Update(), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ORE"), "19980930 1 1; 19981001 2 2; 19981002 3 3");
  EXPECT_FALSE(Waits("02OCT98.d"));
}

// Events are handled between the days as well.
TEST_F(DownloadUpdate, UpdateAllRunsWithoutARestBetweenTheDays) {
  struct Watched : ScriptedDialogs {
    const KeptDisplay* display = nullptr;
    std::vector<bool> running;
    void Yield() override { running.push_back(display->running); }
  } watched;
  watched.display = &display;
  Download("30SEP98.d", "ORE,19980930,1,1,1,1,1,0\n");
  Download("01OCT98.d", "ORE,19981001,2,2,2,2,2,0\n");
  const UpdateRun run{home.files(), settings, current, watched, clock, display, {}};
  EXPECT_EQ(UpdateAllDays(run, {"30SEP98.d", "01OCT98.d"}), UpdateEnd::kUpdated);
  EXPECT_EQ(watched.running, (std::vector<bool>{true, true}));
  EXPECT_FALSE(display.running);
}

TEST_F(DownloadUpdate, ARefusedDateDoesNotEndUpdateAll) {
  Download("30SEP98.d", "no data at all");
  Download("01OCT98.d", "ORE,19981001,2,2,2,2,2,0\n");
  EXPECT_EQ(Update(), UpdateEnd::kAbandoned);
  EXPECT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(LastSaid(),
            "Not everything was taken in as it stands:\n"
            "30SEP98.d\n not taken in: an incorrect number of fields");
  EXPECT_EQ(Shown("ORE"), "19981001 2 2");
  EXPECT_TRUE(Waits("30SEP98.d"));
}

TEST_F(DownloadUpdate, AFileThatIsStoppedInTheMiddleLeavesEverything) {
  Download("15SEP98.d", kBothDays);
  const auto before = Everything();
  display.stopAt = 2;
  dialogs.answers = {Answer::kYes};
  EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kStopped);
  EXPECT_EQ(LastSaid(), "The update is not finished. Stop it ?");
  EXPECT_EQ(Everything(), before);
  EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(DownloadUpdate, StoppingAmongTheFlatRecordsLeavesTheDay) {
  Names({Security("ORE"), Security("ZAP"), Security("OLD")});
  for (const char* code : {"ORE", "ZAP", "OLD"}) Prices(code, {Flat("19980914", 1)});
  Download("16SEP98.d", "ORE,19980916,1,1,1,1,1,0\n");
  Download("15SEP98.d", "ORE,19980915,1,1,1,1,1,0\n");
  const auto before = Everything();
  display.stopAt = 3;  // the second share of the pass
  dialogs.answers = {Answer::kYes};
  EXPECT_EQ(Update(), UpdateEnd::kStopped);
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(Everything(), before);
}

TEST_F(DownloadUpdate, NoToStoppingGoesOn) {
  display.stopAt = 1;
  dialogs.answers = {Answer::kNo};
  EXPECT_EQ(Take(kBothDays), UpdateEnd::kUpdated);
  EXPECT_EQ(Shown("ZAP"), "19980915 3 200");
}

// ---- The whole market

namespace {

class WholeMarket : public UpdateFixture {
 protected:
  const std::string hostOf(const std::string& n) { return "drive_c/m/" + n + "/"; }
  const std::string dosOf(const std::string& n) { return "c:\\m\\" + n + "\\"; }
  WholeMarket() {
    settings.download.DataService = 3;
    std::string text;
    for (const char* n : {"asx", "idx", "sfe", "ovs", "opt"}) {
      home.Put(hostOf(n) + "Names.dat", "");
      text += dosOf(n) + "\r\n";
    }
    home.Put(hostOf("sum") + "Names.dat", "");
    home.Put(kHostSystem + "WMPaths.lst", text + "3\r\n" + dosOf("sum") + "\r\n");
    Download("15SEP98.d", "");
  }
};

}  // namespace

TEST_F(WholeMarket, EachFileGoesToItsOwnFolder) {
  Download("15SEP98.das", "SUM,19980915,1,1,1,1,1,0\n");
  Download("15SEP98.dix", "XAO,19980915,2,2,2,2,2,0\n");
  Download("15SEP98.dov", "DJI,19980915,3,3,3,3,3,0\n");
  Download("15SEP98.dsu",
           "ABCEXX,19980915,4,4,4,4,4,0\nABCIXX,19980915,4,4,4,4,4,0\n"
           "ABCWXX,19980915,4,4,4,4,4,0\nABCDXX,19980915,4,4,4,4,4,0\n"
           "ABC,19980915,4,4,4,4,4,0\n");
  Download("15SEP98.dsf", "SPI,19980915,5,5,5,5,5,0\n");
  Download("15SEP98.dop", "BHPAA,19980915,6,6,6,6,6,10,P\n");
  ASSERT_EQ(Update("15SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_TRUE(dialogs.said.empty());
  const auto only = [&](const std::string& folder) {
    const auto names = NamesOf(dosOf(folder));
    EXPECT_EQ(names.size(), 1u);
    return names.at(0);
  };
  EXPECT_EQ(only("sum").Id.raw(), "A");
  EXPECT_EQ(only("idx").Id.raw(), "X");
  EXPECT_EQ(int(only("idx").RecType), int(kIndex));
  EXPECT_EQ(only("ovs").Id.raw(), "V");
  EXPECT_EQ(only("sfe").Id.raw(), "F");
  EXPECT_EQ(only("opt").Id.raw(), "P");
  EXPECT_EQ(only("opt").OtherDetails.trimmed(), "0P25/9/98");  // 15 September and 10 days
  EXPECT_EQ(int(only("opt").RecType), int(kShare));
  std::vector<int> categories;
  for (const NameRec& rec : NamesOf(dosOf("asx"))) categories.push_back(rec.Category);
  EXPECT_EQ(categories, (std::vector<int>{86, 87, 84, 88, 1}));
  EXPECT_EQ(Shown("SPI", dosOf("sfe")), "19980915 5 5");
  EXPECT_EQ(settings.paths.CurrentDataPath, dosOf("ovs"));  // line 6 is 3
  EXPECT_FALSE(Waits("15SEP98.d"));
  EXPECT_TRUE(Waits("15SEP98.dsu"));  // market files stay
  EXPECT_TRUE(NamesOf().empty());     // nothing in the folder in use before
}

TEST_F(WholeMarket, SixCharactersInTheExtraStocksAreOfCategoryOne) {
  Download("15SEP98.das", "ABCWXX,19980915,1,1,1,1,1,0\n");
  ASSERT_EQ(Update("15SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_EQ(int(NamesOf(dosOf("sum")).at(0).Category), 1);
}

TEST_F(WholeMarket, PassesOnOverAFileWithoutData) {
  Download("15SEP98.das", "");
  Download("15SEP98.dsf", "SPI,19980915,5,5,5,5,5,0\n");
  EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_EQ(dialogs.said.at(0).text,
            "There is no data in 15SEP98.das\n"
            "Use Update The Lot in KORA/Tarvo Download to reprocess");
  EXPECT_EQ(LastSaid(),
            "Not everything was taken in as it stands:\n15SEP98.das\n not taken in: no data");
  EXPECT_EQ(Shown("SPI", dosOf("sfe")), "19980915 5 5");
}

TEST_F(WholeMarket, ARefusedFileStaysListedAndTheOthersAreTaken) {
  Download("15SEP98.dop", "BHPAA,19980915,6,6,6,6,6,10\n");  // a field short
  Download("15SEP98.dsf", "SPI,19980915,5,5,5,5,5,0\n");
  EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kAbandoned);
  EXPECT_NE(dialogs.said.at(0).text.find(" code,date,open,high,low,close,vol,days,OptType\n"),
            std::string::npos);
  EXPECT_EQ(LastSaid(),
            "Not everything was taken in as it stands:\n"
            "15SEP98.dop\n not taken in: an incorrect number of fields");
  EXPECT_EQ(Shown("SPI", dosOf("sfe")), "19980915 5 5");
  EXPECT_TRUE(Waits("15SEP98.d"));
  EXPECT_EQ(entries, DownloadEntries{"15SEP98.d"});
}

TEST_F(WholeMarket, WantsAllFolders) {
  home.Put(kHostSystem + "WMPaths.lst",
           "c:\\a\\\r\n\r\nc:\\a\\\r\nc:\\a\\\r\nc:\\a\\\r\n0\r\nc:\\a\\\r\n");
  EXPECT_EQ(Update("15SEP98.d"), UpdateEnd::kNotBegun);
  EXPECT_EQ(LastTitle(), "W/M Paths");
  EXPECT_EQ(LastSaid(),
            "Separate destination directories for Whole Market data have not been defined. Select "
            "Paths option and define ALL data directories.");
  EXPECT_TRUE(Waits("15SEP98.d"));
}

TEST_F(WholeMarket, OptionsThatExpireAreMarked) {
  const auto option = [](std::string_view code, std::string_view details) {
    NameRec rec = Security(code);
    rec.OtherDetails.set(details);
    return rec;
  };
  Names({option("DEAD", "0P15/9/98"), option("LIVE", "0C16/9/98"), option("NONE", "zero"),
         option("ODD", "0P99/9/98")},
        hostOf("opt"));
  for (const char* code : {"DEAD", "LIVE", "NONE", "ODD"})
    Prices(code, {Flat("19980914", 1)}, hostOf("opt"));
  Download("15SEP98.dop", "NEW,19980915,6,6,6,6,6,10,C\n");
  ASSERT_EQ(Update("15SEP98.d"), UpdateEnd::kUpdated);
  const auto names = NamesOf(dosOf("opt"));
  EXPECT_EQ(names[0].Name.trimmed(), "**EXPIRED**");
  EXPECT_EQ(names[1].Name.trimmed(), "");
  EXPECT_EQ(names[2].Name.trimmed(), "DETAILS INCOMPLETE - CHECK");
  EXPECT_EQ(names[3].Name.trimmed(), "DETAILS INCOMPLETE - CHECK");
  EXPECT_EQ(Shown("DEAD", dosOf("opt")), "19980914 1 0");
  EXPECT_EQ(Shown("LIVE", dosOf("opt")), "19980914 1 0; 19980915 1 0");
}

// Two digits read back stand for 2000 to 2029 and 1930 to 1999.
TEST_F(WholeMarket, ExpiriesOfTheNextCenturyLive) {
  std::vector<NameRec> names{Security("LIVE"), Security("DEAD")};
  names[0].OtherDetails.set("0P1/6/29");
  names[1].OtherDetails.set("0P1/6/30");
  Names(names, hostOf("opt"));
  Download("15SEP98.dop", "NEW,19980915,6,6,6,6,6,10,C\n");
  ASSERT_EQ(Update("15SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_EQ(NamesOf(dosOf("opt"))[0].Name.trimmed(), "");
  EXPECT_EQ(NamesOf(dosOf("opt"))[1].Name.trimmed(), "**EXPIRED**");
}

TEST_F(WholeMarket, TellsWhatItIsDoing) {
  Names({Security("OLD")}, hostOf("sfe"));
  Prices("OLD", {Flat("19980914", 1)}, hostOf("sfe"));
  Download("15SEP98.das", "SUM,19980915,1,1,1,1,1,0\n");
  Download("15SEP98.dsf", "SPI,19980915,5,5,5,5,5,0\n");
  ASSERT_EQ(Update("15SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_EQ(display.states,
            (std::vector<std::string>{"Updating ASX ", "Updating FUTURES ", "Checking no-trades",
                                      "Updated", "FINISHED"}));
  EXPECT_EQ(display.targets, (std::vector<std::string>{dosOf("sum"), dosOf("sfe")}));
  EXPECT_EQ(display.firsts, (std::vector<std::string>{" Updating  15SEP98.das", " Updating  SUM",
                                                      " Updating  15SEP98.dsf", " Updating  SPI",
                                                      "", " Checking OLD", ""}));
  EXPECT_EQ(display.seconds,
            (std::vector<std::string>{
                "", " Checking file format - wait", " Data OK - updating",
                " Created record for SUM", " Checking file format - wait", " Data OK - updating",
                " Created record for SPI", " Checking stocks not traded",
                " Data files updated with c:\\korawin\\download\\15SEP98.dsf", ""}));
}

TEST_F(WholeMarket, ExtraStocksIndicesAndOverseasHaveNoNoTradePass) {
  for (const char* n : {"sum", "idx", "ovs", "sfe"}) {
    Names({Security("OLD")}, hostOf(n));
    Prices("OLD", {Flat("19980914", 1)}, hostOf(n));
  }
  for (const char* ext : {"das", "dix", "dov", "dsf"})
    Download(std::string("15SEP98.") + ext, "NEW,19980915,6,6,6,6,6,0\n");
  ASSERT_EQ(Update("15SEP98.d"), UpdateEnd::kUpdated);
  for (const char* n : {"sum", "idx", "ovs"}) EXPECT_EQ(PricesOf("OLD", dosOf(n)).size(), 1u) << n;
  EXPECT_EQ(PricesOf("OLD", dosOf("sfe")).size(), 2u);
}

TEST_F(WholeMarket, CallsTheBulletinsWithTheBaseName) {
  std::string path, base;
  auto run = Run();
  run.CheckBulletins = [&](const std::string& p, const std::string& b) { path = p, base = b; };
  entries = {"15SEP98.d"};
  UpdateOneDay(run, entries, 0);
  EXPECT_EQ(path, dosOf("asx"));
  EXPECT_EQ(base, "15SEP98");
}

// ---- Damaged files

// Whatever stands in a file: it is taken in or refused with a message, and the store stays one
// of whole records.
TEST_F(DownloadUpdate, DamagedFilesNeverHarmTheStore) {
  const std::vector<std::string> corpus{
      kBothDays, "ORE,19980916,1,2,0.5,1.5,100,50\nPRN,19980916,3,4,2,3,200,0\n",
      "NEW,19981231,1,1,1,1,1,0\r\n,19981231,,,,,,\r\nZAP,19981231,9,9,9,9,9,9\r\n"};
  Names({Security("ORE"), Security("ZAP")});
  int taken = 0, refused = 0;
  Mutator(7).Run(corpus, 600, [&](const std::string& text) {
    Prices("ORE", {Flat("19980911", 1, 1), Flat("19980914", 2, 2)});
    Prices("ZAP", {Flat("19980915", 1, 1)});
    Download("15SEP98.d", text);
    dialogs.said.clear();
    DownloadEntries waiting{"15SEP98.d"};
    const UpdateEnd end = UpdateOneDay(Run(), waiting, 0);
    if (end == UpdateEnd::kUpdated) {
      ++taken;
      EXPECT_FALSE(Waits("15SEP98.d"));
    } else {
      ++refused;
      EXPECT_EQ(end, UpdateEnd::kAbandoned);
      EXPECT_FALSE(dialogs.said.empty());
      EXPECT_EQ(Shown("ORE"), "19980911 1 1; 19980914 2 2");
    }
    for (const auto& e : std::filesystem::directory_iterator(home.path() + "/" + kHostData)) {
      const std::string name = e.path().filename().string();
      const size_t record = name == "Names.dat" ? 96 : 50;
      EXPECT_TRUE(name == "Names.dat" || name.ends_with(".WDT")) << name;
      EXPECT_EQ(e.file_size() % record, 0u) << name;
    }
  });
  EXPECT_GT(taken, 20);
  EXPECT_GT(refused, 200);
  // Nothing was written outside the data folder.
  for (const auto& [name, bytes] : Everything())
    EXPECT_TRUE(name.starts_with("korawin/data/") || name.starts_with("korawin/download/15SEP98.d"))
        << name;
}
