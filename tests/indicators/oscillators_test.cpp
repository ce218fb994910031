#include "indicators/oscillators.h"

#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "indicators/osc_settings.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

using Texts = std::vector<std::string>;

TEST(OscillatorTable, TheMenuHasItsEntriesInTheirOrder) {
  const Texts expected{"cmDirect|&Directional Movement|DM",
                       "cmCoppock|&Coppock Indicator|COP",
                       "cmElderRay|&Elder Ray|ERY",
                       "cmFX|&FX|FX",
                       "cmJHGrail|Jones Holy Grail|JHG",
                       "cmMacD|&MACD Histogram and Classic|MACD",
                       "cmMomentum|Momen&tum|MOM",
                       "cmOBV|OB&V (On Balance Volume)|OBV",
                       "cmPara|&Parabolic|PARA",
                       "cmParaAve|Parabolic on Average 1|PARAV",
                       "cmROC|&ROC (Rate of Change)|ROC",
                       "cmROCFX|RO&C and  FX|R/F",
                       "cmRMO|RM&O (Relative Movement - all data)|RMO",
                       "cmRMX|RM&X (Relative Movement - chart data)|RMX",
                       "cmRelStrength|RS&I (Relative Strength Index)|RSI",
                       "cmStochastic|&Stochastic (Fast)|STO",
                       "cmSlowStoch|Stoc&hastic (Slow)|STO slow",
                       "cmVolt|Volatility|VTY",
                       "cmWilliams|&Williams %R|WMS"};
  Texts entries;
  for (const Oscillator& row : Oscillators())
    for (const OscEntry& entry : row.entries)
      entries.push_back(std::string(entry.menu) + "|" + entry.caption + "|" +
                        std::string(row.code) + (entry.slow ? " slow" : ""));
  EXPECT_EQ(entries, expected);
}

TEST(OscillatorTable, ACodeIsFoundAsItStands) {
  std::set<std::string> codes;
  for (const Oscillator& row : Oscillators()) {
    EXPECT_TRUE(codes.emplace(row.code).second) << row.code;
    EXPECT_EQ(FindOscillator(row.code), &row);
    EXPECT_NE(row.show, nullptr);
    EXPECT_EQ(row.boxCaption == nullptr, row.fields.empty()) << row.code;
  }
  EXPECT_EQ(codes.size(), 18u);
  for (const char* none : {"", "sto", "STO ", "(None)", "SWING"})
    EXPECT_EQ(FindOscillator(none), nullptr) << none;
}

TEST(OscillatorTable, AllButTheParabolicsHaveAPanel) {
  for (const Oscillator& row : Oscillators())
    EXPECT_EQ(HasPanel(row.code), row.code != "PARA" && row.code != "PARAV") << row.code;
  EXPECT_FALSE(HasPanel(""));
}

TEST(OscKeysTest, HaveTheDefaultsAndCaptionsOfTheDefaultsForm) {
  struct Row {
    const char *daily, *twin, *caption;
    int value;
  };
  const Row table[] = {
      {"StochK", "StochKW", "Stochastic K", 10},  {"StochD", "StochDW", "Stochastic D", 5},
      {"FXF", "FXFW", "FX periods", 50},          {"FXX", "FXXW", "FX average", 25},
      {"RocP", "RocPW", "ROC periods", 21},       {"RocA", "RocAW", "ROC average", 10},
      {"RsiP", "RsiPW", "RSI periods", 14},       {"RmoP", "RmoPW", "RMO periods", 30},
      {"RmoA", "RmoAW", "RMO average", 10},       {"RmxP", "RmxPW", "RMX periods", 100},
      {"RmxA", "RmxAW", "RMX average", 20},       {"Md1", "Md1W", "MACD EMA 1", 12},
      {"Md2", "Md2W", "MACD EMA 2", 26},          {"Md3", "Md3W", "MACD EMA 3 signal", 9},
      {"WmsA", "WmsW", "Williams %R period", 7},  {"ERA", "ERW", "Elder Ray  period", 14},
      {"DMA", "DMW", "Directional Move DX", 14},  {"DMXA", "DMXW", "Directional Move ADX", 14},
      {"MMA", "MMW", "Momentum  period", 14},     {"CopD", "CopW", "Coppock", 14},
      {"HolyD", "HolyW", "Jones Holy Grail", 50}, {"VtyD", "VtyW", "Volatility", 3}};
  ASSERT_EQ(std::size(table), OscKeys().size());
  for (size_t i = 0; i < OscKeys().size(); ++i) {
    const OscKey& key = OscKeys()[i];
    EXPECT_STREQ(key.daily, table[i].daily);
    EXPECT_STREQ(key.twin, table[i].twin);
    EXPECT_STREQ(key.caption, table[i].caption);
    EXPECT_EQ(key.defaultDaily, table[i].value) << key.daily;
    EXPECT_EQ(key.defaultTwin, std::string(key.daily) == "RmxP" ? 50 : table[i].value) << key.daily;
  }
}

struct OscPeriods : testing::Test {
  test::TempHome home;
  SettingsFile ini{home.files(), "C:\\WINDOWS\\Kora.ini"};
  OscSettings osc;
};

TEST_F(OscPeriods, EachKeyGoesToItsOwnPeriod) {
  int value = 0;
  for (const OscKey& key : OscKeys()) {
    ini.PutSetting("OscDef", key.daily, std::to_string(++value));
    ini.PutSetting("OscDef", key.twin, std::to_string(++value));
  }
  ReadOscPeriods(ini, osc);
  value = 0;
  for (const OscKey& key : OscKeys()) {
    EXPECT_EQ(osc[key].For(Period::kDaily), ++value) << key.daily;
    EXPECT_EQ(osc[key].For(Period::kMonthly), ++value) << key.twin;
  }
}

TEST_F(OscPeriods, AMissingKeyAndOneThatIsNoNumberAre0) {
  ini.PutSetting("OscDef", "RsiP", "abc");
  ini.PutSetting("OscDef", "RsiPW", "40000");
  ReadOscPeriods(ini, osc);
  for (const OscKey& key : OscKeys()) {
    EXPECT_EQ(osc[key].daily, 0) << key.daily;
    EXPECT_EQ(osc[key].twin, 0) << key.twin;
  }
}

TEST_F(OscPeriods, ANewInstallationHasTheDefaults) {
  WriteDefaultOscPeriods(ini);
  ReadOscPeriods(ini, osc);
  for (const OscKey& key : OscKeys()) {
    EXPECT_EQ(osc[key].daily, key.defaultDaily) << key.daily;
    EXPECT_EQ(osc[key].twin, key.defaultTwin) << key.twin;
  }
}

}  // namespace
}  // namespace kora
