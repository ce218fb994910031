#include "companies/stock_details.h"

#include <gtest/gtest.h>

#include "companies/company_grid.h"
#include "lists/chart_list.h"
#include "tests/support/mutate.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

constexpr const char* kFolder = "drive_c/dlsys/";
constexpr const char* kData = "drive_c/korawin/data/";

std::string Rec(std::string_view code, std::string_view details) {
  return PadRight(code, 6) + PadRight(details, 306);
}

class CompanyTest : public testing::Test {
 protected:
  CompanyTest() {
    download.ServiceSystem = "c:\\dlsys\\";
    Header({"ASXCODE", "Description", "Current Div", "Div. Type", "Franking %"});
    Store({Rec("BHP", "Broken Hill|0.25|INTERIM|100"), Rec("BHP", "Broken Hill|0.3|FINAL|100"),
           Rec("CBA", "Bank, big|1.1|F|50"), Rec("NIL", "No dividend||  |")},
          "BHP,1\r\nCBA,3\r\nNIL,4\r\n");
  }
  void Header(const std::vector<std::string>& labels) {
    std::string text = std::to_string(labels.size()) + "\r\n";
    for (const std::string& label : labels) text += label + "\r\n";
    home.Put(std::string(kFolder) + "STKHeader.txt", text);
  }
  void Store(const std::vector<std::string>& records, const std::string& index) {
    std::string bytes;
    for (const std::string& rec : records) bytes += rec;
    home.Put(std::string(kFolder) + "SecurityDetails.Stx", bytes);
    home.Put(std::string(kFolder) + "Sdix1.inx", index);
  }
  CompanyStore Open() { return CompanyStore(home.files(), download); }
  void Prices(const std::string& code, const std::vector<PriceRec>& days) {
    home.Put(kData + code + ".WDT", Bytes(days));
  }

  const std::string data = "c:\\korawin\\data\\";
  TempHome home;
  ScriptedDialogs dialogs;
  DownloadSettings download;
  NoProgress progress;
};

TEST_F(CompanyTest, DetailsOfACodeArePairsOfLabelAndValue) {
  const auto details = GetStockDetails(Open(), "bhp ");
  ASSERT_EQ(details.size(), 4u);
  EXPECT_EQ(details[0].description, "Description");
  EXPECT_EQ(details[0].value, "Broken Hill");
  EXPECT_EQ(details[1].value, "0.25");
  EXPECT_EQ(details[3].description, "Franking %");
  EXPECT_EQ(details[3].value, "100");
}

TEST_F(CompanyTest, ACodeThatIsNotThereHasNoDetails) {
  EXPECT_TRUE(GetStockDetails(Open(), "XYZ").empty());
  EXPECT_TRUE(GetStockDetails(Open(), "").empty());
}

TEST_F(CompanyTest, TheDelimiterIsTheOneThatFitsTheLabels) {
  // A comma stands in a name; the bar gives as many fields as there are labels.
  EXPECT_EQ(GetStockDetails(Open(), "CBA")[0].value, "Bank, big");
  Store({Rec("AAA", "One\t2\tI\t4"), Rec("BBB", "Two|x\t3\tF\t5")}, "AAA,1\r\nBBB,2\r\n");
  EXPECT_EQ(GetStockDetails(Open(), "BBB")[0].value, "Two|x");
}

TEST_F(CompanyTest, MissingFieldsAreEmptyAndFieldsBeyondTheLabelsAreLeftOut) {
  Store({Rec("AAA", "One|2|I|4"), Rec("BBB", "Two"), Rec("CCC", "a|b|c|d|e|f")},
        "AAA,1\r\nBBB,2\r\nCCC,3\r\n");
  const CompanyStore store = Open();
  EXPECT_EQ(store.Fields(2), (std::vector<std::string>{"Two", "", "", ""}));
  EXPECT_EQ(store.Fields(3), (std::vector<std::string>{"a", "b", "c", "d"}));
  EXPECT_EQ(store.Fields(4).size(), 4u);
  EXPECT_EQ(store.Fields(0)[0], "");
}

TEST_F(CompanyTest, DividendsAreTheFirstInterimAndTheFirstFinal) {
  const CompanyStore store = Open();
  EXPECT_DOUBLE_EQ(DividendsOf(store, "BHP").interim, 0.25);
  EXPECT_DOUBLE_EQ(DividendsOf(store, "BHP").final, 0.3);
  EXPECT_DOUBLE_EQ(DividendsOf(store, "CBA").Sum(), 1.1);
  EXPECT_EQ(DividendsOf(store, "NIL").Sum(), 0);
  Store({Rec("AAA", "a|1|F|"), Rec("AAA", "a|2|F|"), Rec("AAA", "a|5|SPECIAL|")}, "AAA,1\r\n");
  EXPECT_DOUBLE_EQ(DividendsOf(Open(), "AAA").Sum(), 1);
}

TEST_F(CompanyTest, AnIndexThatPointsElsewhereFindsNothing) {
  Store({Rec("AAA", "a"), Rec("BBB", "b")},
        "AAA,2\r\nBBB,99\r\nCCC,0\r\nDDD,-1\r\n,1\r\nEEE\r\nFFF,x\r\n");
  const CompanyStore store = Open();
  for (const char* code : {"AAA", "BBB", "CCC", "DDD", "EEE", "FFF"})
    EXPECT_EQ(store.Find(code), 0) << code;
}

TEST_F(CompanyTest, ATornStoreKeepsItsWholeRecordsAndAMissingOneRaises) {
  Store({Rec("AAA", "a|1|I|2"), "BBB   torn"}, "AAA,1\r\nBBB,2\r\n");
  EXPECT_EQ(Open().codes(), std::vector<std::string>{"AAA"});
  home.files().Remove("c:\\dlsys\\Sdix1.inx");
  EXPECT_EQ(ErrorOf([&] { Open(); }), kFileNotFound);
  home.files().Remove("c:\\dlsys\\SecurityDetails.Stx");
  EXPECT_EQ(ErrorOf([&] { Open(); }), kFileNotFound);
}

TEST_F(CompanyTest, AStoreWithoutLabelsHasNoFields) {
  home.files().Remove("c:\\dlsys\\STKHeader.txt");
  EXPECT_TRUE(GetStockDetails(Open(), "BHP").empty());
}

TEST_F(CompanyTest, DamagedStoresAndIndexesNeverLeadOutside) {
  Mutator(7).Run({"BHP,1\r\nCBA,3\r\nNIL,4\r\n", ""}, 300, [&](const std::string& damaged) {
    home.Put(std::string(kFolder) + "Sdix1.inx", damaged);
    const CompanyStore opened = Open();
    for (const std::string& code : opened.codes()) {
      const std::int32_t record = opened.Find(code);
      EXPECT_LE(record, 4);
      EXPECT_GE(record, 0);
      DividendsOf(opened, code);
    }
  });
}

TEST_F(CompanyTest, OtherDetailsTakeNoCommasAndFifteenBytes) {
  EXPECT_EQ(AsOtherDetails(" Bank, big "), "Bank  big");
  EXPECT_EQ(AsOtherDetails("0123456789abcdefgh"), "0123456789abcde");
  EXPECT_EQ(TransferQuestion("Franking %"),
            "Transfer data in Franking % column to the Other Details column of the Name File");
}

TEST_F(CompanyTest, YieldIsInterimAndFinalOverTheLastClose) {
  NameRec bhp = Security("BHP", 1, kShare, "012");
  bhp.Name.set("Broken Hill");
  home.Put(std::string(kData) + "Names.dat",
           Bytes<NameRec>({Security("AAA"), bhp, Security("NIL")}));
  Prices("BHP", {Day("20260105", 9, 9, 9, 9), Day("20260106", 11, 11, 11, 11)});
  Prices("NIL", {Day("20260106", 2, 2, 2, 2.125f)});
  const CompanyStore store = Open();
  auto rows = LoadCompanies(store, home.files(), data);
  ASSERT_EQ(rows.size(), 3u);
  EXPECT_EQ(rows[0].IndClass, "012");
  EXPECT_EQ(rows[0].nameRec, 2);
  EXPECT_EQ(rows[1].name, "");
  const YieldEnd end = CalculateYields(store, home.files(), data, progress, rows);
  EXPECT_FALSE(end.stopped);
  EXPECT_EQ(rows[0].price, "11.00");
  EXPECT_EQ(rows[0].yield, "5.00 %");  // 0.55 / 11
  EXPECT_EQ(rows[0].lastDate, "06/01/2026");
  EXPECT_EQ(rows[2].price, "2.125");
  EXPECT_EQ(rows[2].yield, "");  // no dividend
  EXPECT_EQ(rows[1].price, "");
  EXPECT_EQ(end.missing, std::vector<std::string>{"CBA"});
  EXPECT_EQ(MissingText(end.missing), "NO DATA FOR CBA");
  EXPECT_EQ(CompanyHeadings(store).size(), CompanyCells(rows[0]).size());

  WriteCompanyList(home.files(), data, rows);
  const auto list = ReadList(home.files(), data, kResultList);
  ASSERT_EQ(list.size(), 2u);
  EXPECT_EQ(list[0].ListRecNo, 2);
  EXPECT_EQ(list[0].ListCode.trimmed(), "BHP");
  EXPECT_EQ(list[1].ListCode.trimmed(), "NIL");
}

TEST_F(CompanyTest, EmptyTruncatedAndForeignPriceFilesHaveNoYield) {
  home.Put(std::string(kData) + "Names.dat", Bytes<NameRec>({Security("BHP")}));
  Prices("BHP", {});
  home.Put(std::string(kData) + "CBA.WDT", "too short");
  Prices("NIL", {Day("20260106", 0, 0, 0, 0)});
  const CompanyStore store = Open();
  auto rows = LoadCompanies(store, home.files(), data);
  const YieldEnd end = CalculateYields(store, home.files(), data, progress, rows);
  EXPECT_EQ(end.missing, (std::vector<std::string>{"BHP", "CBA"}));
  EXPECT_EQ(rows[2].price, "0.00");
  EXPECT_EQ(rows[2].yield, "");
}

TEST(MissingPrices, ManyAreTold) {
  std::vector<std::string> codes(23, "ABC");
  const std::string text = MissingText(codes);
  EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 20);
  EXPECT_TRUE(text.ends_with("and 3 others"));
}

}  // namespace
}  // namespace kora::test
