#include "lists/name_search.h"

#include <gtest/gtest.h>

#include "tests/support/error_of.h"
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
  std::vector<NameMatch> Search(std::string_view text) {
    return NamesWith(home.files(), "c:\\korawin\\data\\", text);
  }
  test::TempHome home;
};

TEST_F(NameSearchTest, AllMatchesComeInFileOrderInAnyCase) {
  PutNames({Named("AAA", "Golden Bank"), Named("BBB", "Big bank"), Named("CCC", "Mines"),
            Named("DDD", "THE BANK GROUP")});
  for (const char* text : {"Bank", "bank", "BANK"}) {
    const auto found = Search(text);
    ASSERT_EQ(found.size(), 3u) << text;
    EXPECT_EQ(found[0].code, "AAA");
    EXPECT_EQ(found[0].name, "Golden Bank");
    EXPECT_EQ(found[0].record, 1);
    EXPECT_EQ(found[1].code, "BBB");
    EXPECT_EQ(found[2].code, "DDD");
    EXPECT_EQ(found[2].record, 4);
  }
  EXPECT_TRUE(Search("nowhere").empty());
}

TEST_F(NameSearchTest, AccentsAreThoseOfTheFile) {
  PutNames({Named("AAA", "Caf\xE9 Group")});
  EXPECT_EQ(Search("caf\xC3\xA9").size(), 1u);
  EXPECT_TRUE(Search("cafe").empty());
}

TEST_F(NameSearchTest, AMatchFarDownALongFileIsFound) {
  std::vector<NameRec> names(1500, Named("AAA", "Alpha"));
  names[1024] = Named("ZZZ", "Omega");
  PutNames(names);
  const auto found = Search("Omega");
  ASSERT_EQ(found.size(), 1u);
  EXPECT_EQ(found[0].record, 1025);
}

TEST_F(NameSearchTest, WithoutANameFileThereIsNoMatch) { EXPECT_TRUE(Search("a").empty()); }

TEST_F(NameSearchTest, AFileThatCannotBeReadIsAnError) {
  home.Put("drive_c/korawin/data/Names.dat/inner", "");
  EXPECT_NE(test::ErrorOf([&] { Search("a"); }), 0);
}

}  // namespace
}  // namespace kora
