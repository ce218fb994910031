#include "store/volume_unit.h"

#include <gtest/gtest.h>

#include "base/text.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

namespace {

class VolumeUnitTest : public testing::Test {
 protected:
  VolumeUnitTest() {
    settings.paths.SystemPath = "c:\\korawin\\";
    settings.download.ServiceSystem = "c:\\sys\\";
    settings.download.DataService = 1;
  }
  static std::string Record(const std::string& code, const std::string& volumePower) {
    return std::string(22, 'u') + PadRight(code, 6) + std::string(26, 'u') + "-1" +
           PadRight(volumePower, 2) + "uuu";
  }
  void Main(const std::string& name, const std::string& text) {
    home.Put("drive_c/sys/" + name, text);
  }
  std::string Unit(const std::string& code) { return VolumeUnitText(home.files(), settings, code); }

  TempHome home;
  Settings settings;
};

}  // namespace

TEST_F(VolumeUnitTest, HasATextForEachPower) {
  const char* texts[] = {"'000000", "'00000", "'0000", "'000", "'00", "'0", "'00", "x000", "x0000"};
  for (int power = -4; power <= 4; ++power) EXPECT_EQ(VolumeUnitOfPower(power), texts[power + 4]);
  EXPECT_EQ(VolumeUnitOfPower(5), "");
  EXPECT_EQ(VolumeUnitOfPower(-5), "");
}

TEST_F(VolumeUnitTest, ServiceOneSearchesThreeFilesInOrder) {
  Main("Mainfile.ASX", Record("BHP", "-1") + Record("ORE", "+3"));
  Main("Mainfile.OVS", Record("BHP", "4") + Record("DJI", "1") + Record("ODD", "99"));
  Main("Mainfile.SFE", Record("SPI", "0") + Record("ODD", "1") + "torn");
  EXPECT_EQ(Unit("bhp "), "'000");
  EXPECT_EQ(Unit("ORE"), "x000");
  EXPECT_EQ(Unit("DJI"), "'0");
  EXPECT_EQ(Unit("SPI"), "'00");
  EXPECT_EQ(Unit("ODD"), "");  // the first hit ends the search, and 99 has no text
  EXPECT_EQ(Unit("NONE"), "");
}

TEST_F(VolumeUnitTest, ServiceThreeGoesByTheFolder) {
  settings.download.DataService = 3;
  home.Put(std::string("drive_c/korawin/") + "WMPaths.lst",
           "c:\\1\\\r\nc:\\2\\\r\nc:\\3\\\r\nc:\\4\\\r\nc:\\5\\\r\n0\r\nc:\\7\\\r\n");
  Main("WMDef.Lst", "1,general,-2\r\n1,indices,3\r\n");
  Main("WMMain.SFE", Record("SP", "1"));
  Main("WMMain.OVS", Record("DJIA", "4"));
  Main("WMMain.OPT", Record("BHP", "-3"));
  Main("Mainfile.ASX", Record("EXTRA", "-4"));
  const auto at = [&](const std::string& folder, const std::string& code) {
    settings.paths.CurrentDataPath = folder;
    return Unit(code);
  };
  EXPECT_EQ(at("C:\\1\\", "ANY"), "'0000");
  EXPECT_EQ(at("c:\\2\\", "ANY"), "x000");
  EXPECT_EQ(at("c:\\3\\", "SPZ8"), "'0");
  EXPECT_EQ(at("c:\\4\\", "DJIA"), "x0000");
  EXPECT_EQ(at("c:\\4\\", "DJ"), "");
  EXPECT_EQ(at("c:\\5\\", "BHPAA"), "'00000");
  EXPECT_EQ(at("c:\\7\\", "EXTRA"), "'000000");
  EXPECT_EQ(at("c:\\8\\", "EXTRA"), "");
}

TEST_F(VolumeUnitTest, NoTextWithoutAService) {
  Main("Mainfile.ASX", Record("BHP", "-1"));
  settings.download.DataService = 4;
  EXPECT_EQ(Unit("BHP"), "");
  settings.download.DataService = 1;
  settings.download.ServiceSystem = "";
  EXPECT_EQ(Unit("BHP"), "");
  settings.download.ServiceSystem = "c:\\nowhere\\";
  EXPECT_EQ(Unit("BHP"), "");
}
