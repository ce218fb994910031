#include "store/industry_classes.h"

#include <gtest/gtest.h>

#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

const std::string kSystem = "c:\\korawin\\";
constexpr const char* kHost = "drive_c/korawin/IndClass.dat";

TEST(IndustryClasses, IdsAreNumbersOfThreeDigits) {
  IndustryClass row{"010", "Gold"};
  EXPECT_FALSE(PutClassId(row, " 7 "));
  EXPECT_EQ(row.id, "007");
  for (const char* bad : {"x", "1.5", "-1", "7a"}) {
    EXPECT_EQ(PutClassId(row, bad), "Id must be numeric") << bad;
    EXPECT_EQ(row.id, "007");
  }
  EXPECT_TRUE(PutClassId(row, "1000"));
}

TEST(IndustryClasses, DescriptionsAreFreeOfCommas) {
  IndustryClass row{"010", "Gold"};
  EXPECT_EQ(PutClassDescription(row, "Gold, other"), "Commas cannot be used");
  EXPECT_EQ(row.description, "Gold");
  EXPECT_FALSE(PutClassDescription(row, " Caf\xC3\xA9s "));
  EXPECT_EQ(row.description, "Caf\xC3\xA9s");
  EXPECT_TRUE(PutClassDescription(row, "\xE6\x97\xA5"));
}

TEST(IndustryClasses, SortGoesById) {
  std::vector<IndustryClass> rows{{"020", "b"}, {"", "none"}, {"010", "a"}, {"015", "c"}};
  SortIC(rows);
  EXPECT_EQ(rows[0].id + rows[1].id + rows[2].id + rows[3].description, "010015020none");
}

TEST(IndustryClasses, TheFileIsWrittenTrimmedAndReadBack) {
  FailingIo io;
  TempHome home(io);
  home.Put(kHost, "old");
  WriteIndustryClasses(home.files(), kSystem, {{"010", "Gold "}, {"", "left out"}, {"011", ""}});
  EXPECT_EQ(home.Get(kHost), "010,Gold\r\n011,\r\n");
  EXPECT_EQ(ReadIndustryClasses(home.files(), kSystem).size(), 2u);
  const std::string before = home.Get(kHost);
  for (int at = 1;; ++at) {
    io.Reset(at);
    bool failed = false;
    try {
      WriteIndustryClasses(home.files(), kSystem, {{"099", "New"}});
    } catch (const RunTimeError&) {
      failed = true;
    }
    const bool cut = io.calls >= at;
    io.Reset();
    EXPECT_EQ(failed, cut) << at;
    if (!cut) break;
    EXPECT_EQ(home.Get(kHost), before) << at;
  }
}

TEST(IndustryClasses, ReadsIdAndDescription) {
  TempHome home;
  home.Put("drive_c/korawin/IndClass.dat",
           "010,Gold\r\n011, Gold - producers \r\n\r\n,none\n020\n");
  const auto classes = ReadIndustryClasses(home.files(), "c:\\korawin\\");
  ASSERT_EQ(classes.size(), 3u);
  EXPECT_EQ(classes[0].id, "010");
  EXPECT_EQ(classes[0].description, "Gold");
  EXPECT_EQ(classes[1].description, "Gold - producers");
  EXPECT_EQ(classes[2].id, "020");
  EXPECT_EQ(classes[2].description, "");
}

TEST(IndustryClasses, NoFileIsNoClassAndAHugeOneIsError7) {
  TempHome home;
  EXPECT_TRUE(ReadIndustryClasses(home.files(), "c:\\korawin\\").empty());
  home.Put("drive_c/korawin/IndClass.dat", std::string((1u << 20) + 1, 'x'));
  EXPECT_EQ(ErrorOf([&] { ReadIndustryClasses(home.files(), "c:\\korawin\\"); }), 7);
}

TEST(IndustryClasses, BinaryTextIsReadAsItStands) {
  TempHome home;
  home.Put("drive_c/korawin/IndClass.dat", std::string("\0\xFF,\x81\r\r\n,,,,\n", 11));
  EXPECT_EQ(ReadIndustryClasses(home.files(), "c:\\korawin\\").size(), 1u);
}

}  // namespace
}  // namespace kora::test
