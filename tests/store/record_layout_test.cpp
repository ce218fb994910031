#include <gtest/gtest.h>

#include "store/name_file.h"
#include "store/price_rec.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

using namespace std::string_literals;

TEST(RecordLayout, NameRecordByByte) {
  NameRec rec = NewNameRec("bhp ");
  rec.NameStatus = 9;
  rec.Name.set("B.H.P. Limited");
  rec.OtherDetails.set("Ord");
  rec.Base = 1.5f;
  rec.Top = -2.0f;
  rec.PFInc = 0.25f;
  rec.BandUp = 5;
  rec.BandDown = 300;
  rec.BollPeriods = -1;
  rec.BollWidth = 2;
  rec.Category = 86;
  rec.Id.set("A");
  rec.IndClass.set("012");
  rec.NameSpare.set("xyz");

  TempHome home;
  {
    NameFile file(home.files(), "c:\\data\\..\\Names.dat", OpenMode::kReplace);
    file.Append(rec);
  }
  const std::string expected =
      "\x09\x00"s
      "BHP   "
      "\x04\x00"s
      "B.H.P. Limited                     "
      "Ord            "
      "\x00\x00\xC0\x3F"s
      "\x00\x00\x00\xC0"s
      "\x00\x00\x80\x3E"s
      "\xCD\xCC\x4C\x3D"s
      "\x05\x00"s
      "\x2C\x01"s
      "\xFF\xFF"s
      "\x02\x00"s
      "\x56\x00"s
      "A"
      "012"
      "xyz   ";
  ASSERT_EQ(expected.size(), 96u);
  EXPECT_EQ(home.Get("drive_c/Names.dat"), expected);
}

TEST(RecordLayout, NewNameRecordHasTheDefaults) {
  const NameRec rec = NewNameRec("x");
  EXPECT_EQ(rec.NameStatus, 0);
  EXPECT_EQ(rec.Code.raw(), "X     ");
  EXPECT_EQ(rec.RecType, 4);
  EXPECT_EQ(rec.Category, 1);
  EXPECT_EQ(rec.IndClass.raw(), "   ");
  EXPECT_EQ(rec.Name.trimmed(), "");
  EXPECT_EQ(rec.OtherDetails.trimmed(), "");
  EXPECT_EQ(float(rec.MinMove), 0.05f);
  EXPECT_EQ(float(rec.PFInc), 0);
  EXPECT_EQ(float(rec.Base), 0);
  EXPECT_EQ(float(rec.Top), 0);
}

TEST(RecordLayout, PriceRecordByByte) {
  PriceRec rec = Day("19990827", 1.0f, 2.0f, 0.5f, 1.5f, 1000000, 2.0f);
  rec.AdjDesc.set("1:1 Bonus");

  TempHome home;
  {
    PriceFile file(home.files(), "c:\\BHP.WDT", OpenMode::kReplace);
    file.Append(rec);
  }
  const std::string expected =
      "19990827"
      "\x00\x00\x80\x3F"s
      "\x00\x00\x00\x40"s
      "\x00\x00\x00\x3F"s
      "\x00\x00\xC0\x3F"s
      "\x40\x42\x0F\x00"s
      "\x00\x00\x00\x40"s
      "1:1 Bonus     "
      "    ";
  ASSERT_EQ(expected.size(), 50u);
  EXPECT_EQ(home.Get("drive_c/BHP.WDT"), expected);
}

TEST(RecordLayout, NewPriceRecordIsBlank) {
  const PriceRec rec = NewPriceRec("20240102");
  EXPECT_EQ(Bytes(std::vector<PriceRec>{rec}),
            "20240102" + std::string(24, '\0') + std::string(18, ' '));
}

}  // namespace
}  // namespace kora::test
