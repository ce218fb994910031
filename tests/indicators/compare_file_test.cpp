#include "indicators/compare_file.h"

#include <gtest/gtest.h>

#include <limits>

#include "tests/indicators/compare_fixture.h"
#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"

using namespace kora;
using namespace kora::test;

namespace {

struct Validated {
  std::string name;
  std::vector<ScriptedDialogs::Said> said;
};

Validated Validate(CompareFixture& f, const std::string& path) {
  f.dialogs.said.clear();
  const std::string name = ValidateCompareFile(f.home.files(), f.dialogs, path);
  return {name, f.dialogs.said};
}

}  // namespace

TEST(CompareFileTest, NameIsWithoutFolderAndExtensionInUpperCase) {
  CompareFixture f;
  f.PutPrices("AlOdb.wdt", {1});
  for (const char* path : {"c:\\korawin\\data\\alodb.wdt", "C:\\korawin\\data\\ALODB.WDT",
                           "  c:\\korawin\\data\\alodb.Wdt  ", "\\korawin\\data\\alodb.wdt"}) {
    const Validated v = Validate(f, path);
    EXPECT_EQ(v.name, "ALODB") << path;
    EXPECT_TRUE(v.said.empty()) << path;
  }
}

TEST(CompareFileTest, BadPathsAreRefusedWithTheMessage) {
  CompareFixture f;
  f.PutPrices("ALODB.DAT", {1});
  f.home.Put("drive_c/ALODB.WDT", "");
  f.home.Put("drive_c/korawin/data/.WDT", "");
  for (const std::string& path :
       {std::string(), std::string("   "), std::string("unknown"),
        std::string("c:\\korawin\\data\\MISSING.WDT"), std::string("c:\\korawin\\data\\ALODB.DAT"),
        std::string("c:\\korawin\\data"), std::string("ALODB.WDT"), std::string("c:ALODB.WDT"),
        std::string("c:\\korawin\\data\\.WDT"), std::string("WDT"), std::string(".WDT"),
        std::string("c:\\a\0b.WDT", 10), std::string(5000, '\\') + ".WDT"}) {
    const Validated v = Validate(f, path);
    EXPECT_EQ(v.name, "") << path;
    ASSERT_EQ(v.said.size(), 1u) << path;
    EXPECT_EQ(v.said[0].title, "RMX/RMO Compare file");
    EXPECT_EQ(v.said[0].text, kBadCompareFile);
  }
}

TEST(CompareFileTest, FileThatIsGoneAtTheTimeOfReadingIsNothing) {
  CompareFixture f;
  f.PutPrices("INDEX.WDT", {1});
  EXPECT_TRUE(OpenCompareFile(f.home.files(), CompareFixture::kIndex));
  EXPECT_FALSE(OpenCompareFile(f.home.files(), "c:\\korawin\\data\\GONE.WDT"));
  FailingIo io;
  io.failReadAt = 1;
  Files files(f.home.path(), io);
  EXPECT_EQ(ErrorOf([&] { OpenCompareFile(files, CompareFixture::kIndex); }), kDeviceError);
}

TEST(CompareFileTest, TornRecordAtTheEndDoesNotCount) {
  CompareFixture f;
  f.home.Put("drive_c/korawin/data/TORN.WDT", std::string(149, 'x'));
  EXPECT_EQ(OpenCompareFile(f.home.files(), "c:\\korawin\\data\\TORN.WDT")->count(), 2);
}

TEST(CompareRatioTest, IsTheComparesCloseOverAHundredCloses) {
  EXPECT_EQ(CompareRatio(300, 2), 1.5f);
  EXPECT_EQ(CompareRatio(0, 2), 0);
  EXPECT_EQ(CompareRatio(300, 0), 0);
}

TEST(CompareRatioTest, RatioBeyondAFloatIsAnOverflow) {
  EXPECT_EQ(ErrorOf([] { CompareRatio(3e38f, 1e-30f); }), 6);
}
