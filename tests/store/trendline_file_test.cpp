#include "store/trendline_file.h"

#include <gtest/gtest.h>

#include <cstring>

#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

using test::ErrorOf;
using test::TempHome;

constexpr const char* kPath = "c:\\misc\\AAA.TND";
constexpr const char* kHost = "drive_c/misc/AAA.TND";

TrendlineRec Line(const char* start, float price, const char* end = "20260210") {
  TrendlineRec rec = EmptyTrendline();
  rec.TLSpacing = 3;
  rec.TLPeriod.set("A");
  rec.TLStartDate.set(start);
  rec.TLStartPrice = price;
  rec.TLEndDate.set(end);
  rec.TLEndPrice = price + 1;
  return rec;
}

TEST(TrendlineFileTest, TheBytesOfARecordAreTwentySevenAsTheyAreKept) {
  TempHome home;
  home.files().MakeFolder("c:\\misc");
  EXPECT_EQ(SaveTrendline(home.files(), kPath, Line("20260203", 1.5f, "X35")), 1);
  // 3 in two bytes, "A", the dates, 1.5 and 2.5 as floats.
  const std::string expected(
      "\x03\x00"
      "A20260203\x00\x00\xC0\x3FX35     \x00\x00\x20\x40",
      27);
  EXPECT_EQ(home.Get(kHost), expected);
}

TEST(TrendlineFileTest, ADeletedSlotIsRefilledByTheNextSaveAndTheCountStays) {
  TempHome home;
  home.files().MakeFolder("c:\\misc");
  for (const char* date : {"20260101", "20260102", "20260103"})
    SaveTrendline(home.files(), kPath, Line(date, 5));
  DeleteTrendline(home.files(), kPath, 2);
  auto records = ReadTrendlines(home.files(), kPath);
  ASSERT_EQ(records.size(), 3u);
  EXPECT_TRUE(records[1].Empty());
  EXPECT_EQ(home.Get(kHost).substr(27, 27), std::string(2, '\0') + std::string(9, ' ') +
                                                std::string(4, '\0') + std::string(8, ' ') +
                                                std::string(4, '\0'));
  EXPECT_EQ(SaveTrendline(home.files(), kPath, Line("20260109", 9)), 2);
  records = ReadTrendlines(home.files(), kPath);
  ASSERT_EQ(records.size(), 3u);
  EXPECT_EQ(records[1].TLStartDate.trimmed(), "20260109");
  EXPECT_EQ(SaveTrendline(home.files(), kPath, Line("20260110", 9)), 4);
}

TEST(TrendlineFileTest, ASlotOfZerosIsEmptyToo) {
  TrendlineRec rec;
  std::memset(&rec, 0, sizeof rec);
  EXPECT_TRUE(rec.Empty());
  rec.TLPeriod.set("W");
  EXPECT_FALSE(rec.Empty());
}

TEST(TrendlineFileTest, CompactionKeepsRecordsWithAStartDateAndAPrice) {
  TempHome home;
  home.files().MakeFolder("c:\\misc");
  for (const char* date : {"20260101", "20260102", "20260103"})
    SaveTrendline(home.files(), kPath, Line(date, 5));
  SaveTrendline(home.files(), kPath, Line("20260104", 0));
  DeleteTrendline(home.files(), kPath, 1);
  CompactTrendlines(home.files(), kPath);
  const auto records = ReadTrendlines(home.files(), kPath);
  ASSERT_EQ(records.size(), 2u);
  EXPECT_EQ(records[0].TLStartDate.trimmed(), "20260102");
  EXPECT_EQ(records[1].TLStartDate.trimmed(), "20260103");
  EXPECT_FALSE(home.Exists("drive_c/misc/Temp.Wk3"));
  CompactTrendlines(home.files(), "c:\\misc\\none.TND");
  EXPECT_FALSE(home.Exists("drive_c/misc/none.TND"));
}

TEST(TrendlineFileTest, ATornRecordAtTheEndDoesNotCountAndGivesWay) {
  TempHome home;
  home.files().MakeFolder("c:\\misc");
  SaveTrendline(home.files(), kPath, Line("20260101", 5));
  home.Put(kHost, home.Get(kHost) + "torn");
  EXPECT_EQ(ReadTrendlines(home.files(), kPath).size(), 1u);
  EXPECT_EQ(SaveTrendline(home.files(), kPath, Line("20260102", 5)), 2);
  EXPECT_EQ(home.Get(kHost).size(), 54u);
}

TEST(TrendlineFileTest, NoFileAnEmptyOneAndAFolderInItsPlace) {
  TempHome home;
  home.files().MakeFolder("c:\\misc");
  EXPECT_TRUE(ReadTrendlines(home.files(), kPath).empty());
  EXPECT_EQ(ErrorOf([&] { DeleteTrendline(home.files(), kPath, 1); }), kBadRecordNumber);
  RemoveTrendlines(home.files(), kPath);
  home.Put(kHost, "");
  EXPECT_TRUE(ReadTrendlines(home.files(), kPath).empty());
  EXPECT_EQ(SaveTrendline(home.files(), kPath, Line("20260101", 5)), 1);
  home.files().MakeFolder("c:\\misc\\BBB.TND");
  EXPECT_NE(ErrorOf([&] { ReadTrendlines(home.files(), "c:\\misc\\BBB.TND"); }), 0);
  EXPECT_NE(ErrorOf([&] { SaveTrendline(home.files(), "c:\\misc\\BBB.TND", Line("20260101", 5)); }),
            0);
}

TEST(TrendlineFileTest, ACodeThatIsNoFileNameIsRefused) {
  EXPECT_EQ(TrendlinePath("c:\\misc\\", "AAA  "), "c:\\misc\\AAA.TND");
  EXPECT_EQ(ErrorOf([] { TrendlinePath("c:\\misc\\", "..\\X"); }), kBadFileName);
}

TEST(TrendlineFileTest, ADiskThatFailsAtAnyCallLeavesTheOldFileWhole) {
  test::FailingIo io;
  TempHome home{io};
  home.files().MakeFolder("c:\\misc");
  SaveTrendline(home.files(), kPath, Line("20260101", 5));
  const std::string before = home.Get(kHost);
  int at = 1;
  for (;; ++at) {
    io.Reset(at);
    if (ErrorOf([&] { SaveTrendline(home.files(), kPath, Line("20260102", 5)); }) == 0) break;
    io.Reset();
    EXPECT_EQ(home.Get(kHost), before) << at;
  }
  EXPECT_GT(at, 2);
  io.Reset();
  EXPECT_EQ(ReadTrendlines(home.files(), kPath).size(), 2u);
}

}  // namespace
}  // namespace kora
