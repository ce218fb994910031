#include "lists/name_search.h"

#include <gtest/gtest.h>

#include "lists/industry_classes.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

NameRec Named(std::string_view code, std::string_view name) {
  NameRec rec = test::Security(code);
  rec.Name.set(name);
  return rec;
}

class NameSearchTest : public testing::Test {
 protected:
  void PutNames(const std::vector<NameRec>& names) {
    home.Put("drive_c/korawin/data/Names.dat", test::Bytes(names));
  }
  NameSearch Search(std::string_view text) {
    return NameSearch(home.files(), "c:\\korawin\\data\\", text);
  }
  test::TempHome home;
};

TEST_F(NameSearchTest, MatchesComeInFileOrderInTheCaseAsGiven) {
  PutNames({Named("AAA", "Golden Bank"), Named("BBB", "Big bank"), Named("CCC", "The Bank Group")});
  NameSearch search = Search("Bank");
  auto match = search.FindNext();
  ASSERT_TRUE(match);
  EXPECT_EQ(match->code, "AAA");
  EXPECT_EQ(match->name, "Golden Bank");
  EXPECT_EQ(match->record, 1);
  match = search.FindNext();
  ASSERT_TRUE(match);
  EXPECT_EQ(match->code, "CCC");
  EXPECT_EQ(match->record, 3);
  EXPECT_FALSE(search.FindNext());
  EXPECT_FALSE(search.FindNext());
}

TEST_F(NameSearchTest, AccentsAreThoseOfTheFile) {
  PutNames({Named("AAA", "Caf\xE9 Group")});
  EXPECT_TRUE(Search("Caf\xC3\xA9").FindNext());
}

TEST_F(NameSearchTest, AMatchFarDownALongFileIsFound) {
  std::vector<NameRec> names(1500, Named("AAA", "Alpha"));
  names[1024] = Named("ZZZ", "Omega");
  PutNames(names);
  NameSearch search = Search("Omega");
  const auto match = search.FindNext();
  ASSERT_TRUE(match);
  EXPECT_EQ(match->record, 1025);
  EXPECT_FALSE(search.FindNext());
}

TEST_F(NameSearchTest, AFileThatShrinksOrVanishesEndsTheSearch) {
  PutNames({Named("AAA", "Alpha"), Named("BBB", "Alpha")});
  NameSearch search = Search("Alpha");
  search.FindNext();
  search.FindNext();
  PutNames({Named("AAA", "Alpha")});
  EXPECT_FALSE(search.FindNext());
  home.files().Remove("c:\\korawin\\data\\Names.dat");
  EXPECT_EQ(test::ErrorOf([&] { search.FindNext(); }), 53);
}

TEST(IndustryClassesTest, ReadsIdAndDescription) {
  test::TempHome home;
  home.Put("drive_c/korawin/IndClass.dat", "010,Gold\r\n011, Gold - producers \r\n\r\n,none\n020\n");
  const auto classes = ReadIndustryClasses(home.files(), "c:\\korawin\\");
  ASSERT_EQ(classes.size(), 3u);
  EXPECT_EQ(classes[0].id, "010");
  EXPECT_EQ(classes[0].description, "Gold");
  EXPECT_EQ(classes[1].description, "Gold - producers");
  EXPECT_EQ(classes[2].id, "020");
  EXPECT_EQ(classes[2].description, "");
}

TEST(IndustryClassesTest, NoFileIsNoClassAndAHugeOneIsError7) {
  test::TempHome home;
  EXPECT_TRUE(ReadIndustryClasses(home.files(), "c:\\korawin\\").empty());
  home.Put("drive_c/korawin/IndClass.dat", std::string((1u << 20) + 1, 'x'));
  EXPECT_EQ(test::ErrorOf([&] { ReadIndustryClasses(home.files(), "c:\\korawin\\"); }), 7);
}

TEST(IndustryClassesTest, BinaryTextIsReadAsItStands) {
  test::TempHome home;
  home.Put("drive_c/korawin/IndClass.dat", std::string("\0\xFF,\x81\r\r\n,,,,\n", 11));
  EXPECT_EQ(ReadIndustryClasses(home.files(), "c:\\korawin\\").size(), 1u);
}

}  // namespace
}  // namespace kora
