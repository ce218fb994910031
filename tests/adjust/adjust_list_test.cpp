#include "adjust/adjust_list.h"

#include "tests/adjust/adjust_fixture.h"

namespace kora {
namespace {

using test::kData;
using AdjustListTest = test::AdjustTest;

std::string Codes(const AdjustRows& rows) {
  std::string out;
  for (const AdjustRow& row : rows)
    out += (out.empty() ? "" : " ") + row.Field(kAdjCode) + "/" + row.Field(kAdjAct);
  return out;
}

std::string Marks(const AdjustRows& rows) {
  std::string out;
  for (const AdjustRow& row : rows) out += row.Field(kAdjMark).empty() ? "-" : row.Field(kAdjMark);
  return out;
}

TEST_F(AdjustListTest, ALineOfAnyLengthComesBackAsItWas) {
  std::string many = "PC";
  for (int i = 0; i < 39; ++i) many += "," + std::to_string(i);
  for (const std::string& line : {std::string("BI,ORE,15SEP98,,Y,15SEP98,1,4"), std::string("x"),
                                  std::string(",,,"), std::string("\"a\",\xE4,"), many}) {
    const AdjustRow row = ParseAdjustLine(line);
    EXPECT_EQ(AdjustLine(row), line);
    EXPECT_LE(row.fields.size(), kAdjustColumns);
  }
  EXPECT_EQ(ParseAdjustLine(many).fields.back().substr(0, 5), "18,19");
}

TEST_F(AdjustListTest, FieldsAreTrimmedAndThoseThatAreMissingAreEmpty) {
  const AdjustRow row = ParseAdjustLine(" bi , ORE,,, y ");
  EXPECT_EQ(row.Action(), "BI");
  EXPECT_EQ(row.Field(kAdjCode), "ORE");
  EXPECT_TRUE(row.IsMarked('Y'));
  EXPECT_EQ(row.Field(kAdj9), "");
}

TEST_F(AdjustListTest, ReadsAndWritesTheFile) {
  EXPECT_TRUE(ReadAdjustList(home.files(), kData).empty());
  Put("Adjust.Lst", "BI,ORE,a\r\n\r\n  \nDC,BHP");
  const AdjustRows read = ReadAdjustList(home.files(), kData);
  EXPECT_EQ(Codes(read), "ORE/BI BHP/DC");
  WriteAdjustList(home.files(), kData, read);
  EXPECT_EQ(List(), "BI,ORE,a\r\nDC,BHP\r\n");
}

TEST_F(AdjustListTest, RubbishIsRowsOfRubbish) {
  std::string rubbish;
  for (int i = 0; i < 4096; ++i) rubbish += char((i * 7919) % 256);
  Put("Adjust.Lst", rubbish);
  const AdjustRows read = ReadAdjustList(home.files(), kData);
  EXPECT_FALSE(read.empty());
  Make({});
  rows = read;
  MarkAll(rows, 'Y');
  SortAdjustments(rows);
  const auto before = Prices("ORE");
  MakeAdjustments({home.files(), settings, 0, progress}, rows, kData);
  EXPECT_EQ(test::Bytes(Prices("ORE")), test::Bytes(before));
}

TEST_F(AdjustListTest, SortsByCodeAndWithinACodeByAction) {
  AdjustRows list = Rows({"NL,ORE,1", "DI,ORE,2", "PC,ORE,3", "BI,ORE,4", "SP,ORE,5", "DC,ORE,6",
                          "NC,ORE,7", "NI,ORE,8", "EN,ORE,9", "NI,ORE,10", "EN,BHP,11"});
  SortAdjustments(list);
  EXPECT_EQ(Codes(list),
            "BHP/EN ORE/NI ORE/NI ORE/NC ORE/DC ORE/SP ORE/BI ORE/PC ORE/DI ORE/NL ORE/EN");
  EXPECT_EQ(list[1].Field(3), "8");  // equal keys stay as they stood
  EXPECT_EQ(list[9].Field(3), "1");
}

TEST_F(AdjustListTest, MarksAllRowsAndThoseOfMarkets) {
  AdjustRows list =
      Rows({"BI,A,ASX.OPT,,Y", "BI,B,OPT,,Y", "BI,C,WNT", "BI,D,ASX.WNT,,N", "BI,E,"});
  MarkOptions(list);
  EXPECT_EQ(Marks(list), "DD-N-");
  MarkWarrants(list);
  EXPECT_EQ(Marks(list), "DDDD-");
  MarkAll(list, 'N');
  EXPECT_EQ(Marks(list), "NNNNN");
}

TEST_F(AdjustListTest, RemovesWhatIsDone) {
  AdjustRows list = Rows({"BI,A,,,D", "BI,B,,,d ", "BI,C,,,Y", "BI,D"});
  RemoveDone(list);
  EXPECT_EQ(Codes(list), "C/BI D/BI");
}

TEST(BulletinDateTest, TurnsTheCenturyAt30) {
  EXPECT_EQ(BulletinDate("15SEP98"), "19980915");
  EXPECT_EQ(BulletinDate("01jan30"), "19300101");
  EXPECT_EQ(BulletinDate("31Dec29"), "20291231");
}

TEST(BulletinDateTest, TakesNothingElse) {
  for (const char* text : {"", "5SEP98", "15SEP1998", "31FEB99", "15XXX98", "1xSEP98", "15EPO98",
                           "00SEP98", "-1SEP98", "15SEP 8"})
    EXPECT_EQ(BulletinDate(text), "") << text;
}

}  // namespace
}  // namespace kora
