#include <gtest/gtest.h>

#include <tuple>
#include <utility>
#include <vector>

#include "indicators/chart_defaults.h"
#include "indicators/osc_settings.h"
#include "indicators/overlay_settings.h"
#include "tests/support/all_oscillators.h"
#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

const std::string kCompareFile = "c:\\korawin\\data\\ALODB.WDT";

class SettingsRules : public testing::Test {
 protected:
  SettingsRules() { home.Put("drive_c/korawin/data/ALODB.WDT", ""); }

  std::string Osc(const char* key) { return ini.GetSetting("OscDef", key); }
  std::string Chart(const char* key) { return ini.GetSetting("Charts", key); }
  bool Read(const char* code, std::vector<std::string> typed, Period period = Period::kDaily) {
    return ReadOscFields(*FindOscBox(code), typed, period, osc, refused);
  }

  test::TempHome home;
  test::ScriptedDialogs dialogs;
  SettingsFile ini{home.files(), "C:\\WINDOWS\\Kora.ini"};
  Settings settings;
  OscSettings osc;
  size_t refused = 99;
};

// ---- The settings box

TEST_F(SettingsRules, EveryOscillatorWithPeriodsHasItsBox) {
  struct Expected {
    const char *code, *caption;
    std::vector<std::string> labels;
    bool compares;
  };
  const Expected boxes[] = {
      {"STO", "Stochastic", {"Period K", "Period D"}, false},
      {"FX", "FX", {"Period F", "Period X"}, false},
      {"RMX", "RMX", {"Period RMX", "RMX Ave"}, true},
      {"RMO", "RMO", {"Period RMO", "RMO Ave"}, true},
      {"ROC", "ROC", {"Period ROC", "ROC Ave"}, false},
      {"R/F", "ROC & FX", {"Period F", "Period X", "Period ROC", "ROC Ave"}, false},
      {"RSI", "RSI", {"RSI period"}, false},
      {"MACD", "MACD", {"EMA 1", "EMA 2", "EMA 3 signal"}, false},
      {"WMS", "Williams %R", {"Period"}, false},
      {"DM", "Dir.Mvmt", {"Period", "AveDX"}, false},
      {"MOM", "Momentum", {"Period "}, false},
      {"ERY", "Elder Ray", {"Period"}, false},
      {"COP", "Coppock", {"Period "}, false},
      {"JHG", "Jones Holy Grail", {"Period "}, false},
      {"VTY", "Volatility", {"Period "}, false},
  };
  for (const Expected& e : boxes) {
    const Oscillator* box = FindOscBox(e.code);
    ASSERT_NE(box, nullptr) << e.code;
    EXPECT_STREQ(box->boxCaption, e.caption);
    EXPECT_EQ(box->compares, e.compares) << e.code;
    std::vector<std::string> labels;
    for (const OscField& field : box->fields) labels.push_back(field.label);
    EXPECT_EQ(labels, e.labels) << e.code;
  }
  for (const char* none : {"OBV", "PARA", "PARAV", "", "sto"}) EXPECT_EQ(FindOscBox(none), nullptr);
}

TEST_F(SettingsRules, EachFieldIsAPeriodOfItsOwnOscillator) {
  ASSERT_TRUE(Read("R/F", {"1", "2", "3", "4"}));
  EXPECT_EQ(osc[kFXF].daily, 1);
  EXPECT_EQ(osc[kFXX].daily, 2);
  EXPECT_EQ(osc[kRocP].daily, 3);
  EXPECT_EQ(osc[kRocA].daily, 4);
  ASSERT_TRUE(Read("MACD", {"5", "6", "7"}));
  EXPECT_EQ(osc[kMd1].daily, 5);
  EXPECT_EQ(osc[kMd2].daily, 6);
  EXPECT_EQ(osc[kMd3].daily, 7);
  ASSERT_TRUE(Read("DM", {"8", "9"}));
  EXPECT_EQ(osc[kDMA].daily, 8);
  EXPECT_EQ(osc[kDMXA].daily, 9);
  const std::pair<const char*, const OscKey*> single[] = {
      {"RSI", &kRsiP}, {"WMS", &kWmsA},  {"MOM", &kMMA}, {"ERY", &kERA},
      {"COP", &kCopD}, {"JHG", &kHolyD}, {"VTY", &kVtyD}};
  std::int16_t value = 20;
  for (const auto& [code, member] : single) {
    ASSERT_TRUE(Read(code, {std::to_string(++value)}));
    EXPECT_EQ(osc[*member].daily, value) << code;
  }
  const std::tuple<const char*, const OscKey*, const OscKey*> pairs[] = {
      {"STO", &kStochK, &kStochD},
      {"FX", &kFXF, &kFXX},
      {"RMX", &kRmxP, &kRmxA},
      {"RMO", &kRmoP, &kRmoA},
      {"ROC", &kRocP, &kRocA}};
  for (const auto& [code, first, second] : pairs) {
    ASSERT_TRUE(Read(code, {std::to_string(value + 1), std::to_string(value + 2)}));
    EXPECT_EQ(osc[*first].daily, ++value) << code;
    EXPECT_EQ(osc[*second].daily, ++value) << code;
  }
}

TEST_F(SettingsRules, AFirstFieldIsOneToTwoHundredAndAnAverageMayBeZero) {
  EXPECT_TRUE(Read("STO", {"1", "0"}));
  EXPECT_TRUE(Read("STO", {"200", "200"}));
  EXPECT_EQ(osc[kStochK].daily, 200);
  struct Bad {
    const char* code;
    std::vector<std::string> typed;
    size_t refused;
  };
  const Bad bads[] = {{"STO", {"0", "5"}, 0},
                      {"STO", {"201", "5"}, 0},
                      {"STO", {"10", "201"}, 1},
                      {"STO", {"10", "-1"}, 1},
                      {"STO", {"-3", "5"}, 0},
                      {"STO", {"text", "5"}, 0},
                      {"STO", {"", ""}, 0},
                      {"R/F", {"50", "0", "0", "0"}, 2},
                      {"MACD", {"12", "0", "9"}, 1},
                      {"MACD", {"12", "26", "0"}, 2},
                      {"RSI", {"99999999999999999999"}, 0}};
  for (const Bad& bad : bads) {
    EXPECT_FALSE(Read(bad.code, bad.typed)) << bad.code;
    EXPECT_EQ(refused, bad.refused) << bad.code << bad.typed[0];
    EXPECT_EQ(osc[kStochK].daily, 200) << "as it was";
    EXPECT_EQ(osc[kFXF].daily, 0);
  }
}

TEST_F(SettingsRules, WeeklyAndMonthlyChartsShareTheTwin) {
  ASSERT_TRUE(Read("RSI", {"11"}, Period::kWeekly));
  EXPECT_EQ(osc[kRsiP].daily, 0);
  EXPECT_EQ(osc[kRsiP].twin, 11);
  ASSERT_TRUE(Read("RSI", {"12"}, Period::kMonthly));
  EXPECT_EQ(osc[kRsiP].twin, 12);
  EXPECT_EQ(osc[kRsiP].For(Period::kWeekly), 12);
}

TEST_F(SettingsRules, DefaultsAreGivenForThePeriodOnShowOnly) {
  FillOscDefaults(osc, Period::kDaily);
  EXPECT_EQ(osc[kRmxP].daily, 100);
  EXPECT_EQ(osc[kRmxP].twin, 0);
  EXPECT_EQ(osc[kStochK].daily, 10);
  EXPECT_EQ(osc[kStochK].twin, 0);
  EXPECT_EQ(osc[kVtyD].daily, 3);
  osc[kRmxA].twin = 33;
  FillOscDefaults(osc, Period::kMonthly);
  EXPECT_EQ(osc[kRmxP].twin, 50);
  EXPECT_EQ(osc[kRmxA].twin, 33) << "what is not zero stays";
  EXPECT_EQ(osc[kMd3].twin, 9);
}

TEST_F(SettingsRules, AMissingCompareFileIsToldWithTheTextOfTheBox) {
  EXPECT_EQ(TestCompareFile(home.files(), dialogs, " " + kCompareFile), CompareFileAnswer::kThere);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(TestCompareFile(home.files(), dialogs, "c:\\no.WDT"), CompareFileAnswer::kCorrect);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text,
            "c:\\no.WDT is not available. Use your code for the All Ordinaries Index");
  EXPECT_EQ(dialogs.said[0].title, "RMX Compare ");
  dialogs.answers = {Answer::kCancel};
  EXPECT_EQ(TestCompareFile(home.files(), dialogs, ""), CompareFileAnswer::kGiveUp);
}

TEST_F(SettingsRules, BoxValueMustBeThereAndNumeric) {
  EXPECT_EQ(ReadBoxValue(dialogs, " 0.20 "), 0.2f);
  EXPECT_EQ(ReadBoxValue(dialogs, ".5"), 0.5f);
  EXPECT_TRUE(dialogs.said.empty());
  for (const char* none : {"", "  ", "0", "0.00"}) {
    dialogs.said.clear();
    EXPECT_EQ(ReadBoxValue(dialogs, none), std::nullopt);
    ASSERT_EQ(dialogs.said.size(), 1u);
    EXPECT_EQ(dialogs.said[0].text, "Box value must have a value. eg 0.20");
    EXPECT_EQ(dialogs.said[0].title, "Box Value");
  }
  for (const char* text : {"abc", "1.2x", "1e99", "nan"}) {
    dialogs.said.clear();
    EXPECT_EQ(ReadBoxValue(dialogs, text), std::nullopt);
    ASSERT_EQ(dialogs.said.size(), 1u);
    EXPECT_EQ(dialogs.said[0].text, "Box value must be numeric eg 0.20");
  }
}

// ---- Chart defaults

class ChartDefaultsRules : public SettingsRules {
 protected:
  ChartDefaultsRules() {
    typed = DefaultsFromSettings(settings);
    typed.CompFile = kCompareFile;
  }
  DefaultsSaved Save() { return SaveChartDefaults(ini, home.files(), dialogs, typed, settings); }
  ChartDefaults typed;
};

TEST_F(ChartDefaultsRules, EveryKeyIsWritten) {
  for (size_t i = 0; i < OscKeys().size(); ++i)
    typed.periods[i] = {std::to_string(100 + i), std::to_string(200 + i)};
  typed.average1 = {"1", "2"};
  typed.average2 = {"3", "4"};
  typed.AvOne = typed.AvCalc = typed.BCCalTp = typed.VCalTp = typed.ShowOsc = typed.RFAve = true;
  typed.ScMethod = false;
  ASSERT_EQ(Save(), DefaultsSaved::kAll);
  EXPECT_TRUE(dialogs.said.empty());
  for (size_t i = 0; i < OscKeys().size(); ++i) {
    const OscKey& key = OscKeys()[i];
    EXPECT_EQ(Osc(key.daily), std::to_string(100 + i));
    EXPECT_EQ(Osc(key.twin), std::to_string(200 + i));
    EXPECT_EQ((settings.osc[key]).daily, int(100 + i));
    EXPECT_EQ((settings.osc[key]).twin, int(200 + i));
  }
  EXPECT_EQ(Osc("CompFile"), kCompareFile);
  const std::pair<const char*, const char*> osc_[] = {
      {"BCCalTp", "True"}, {"LCalTp", "False"}, {"VCalTp", "True"}, {"CutVols", "False"},
      {"ShowOsc", "True"}, {"FillIn", "False"}, {"RFAve", "True"}};
  for (const auto& [key, value] : osc_) EXPECT_EQ(Osc(key), value) << key;
  const std::pair<const char*, const char*> charts[] = {
      {"Av1D", "1"},     {"Av1W", "2"},      {"Av2D", "3"},      {"Av2W", "4"},
      {"AvOne", "True"}, {"AvTwo", "False"}, {"AvCalc", "True"}, {"ScMethod", "False"}};
  for (const auto& [key, value] : charts) EXPECT_EQ(Chart(key), value) << key;
  EXPECT_EQ(settings.charts.Av2D, 3);
  EXPECT_TRUE(settings.charts.AvCalc);
  EXPECT_FALSE(settings.charts.ScMethod);
  EXPECT_TRUE(settings.osc.VCalTp);
}

TEST_F(ChartDefaultsRules, TickedFXReversedIsKeptAsFalse) {
  EXPECT_TRUE(typed.FXReversed) << "FXRev False shows ticked";
  ASSERT_EQ(Save(), DefaultsSaved::kAll);
  EXPECT_EQ(Osc("FXRev"), "False");
  typed.FXReversed = false;
  ASSERT_EQ(Save(), DefaultsSaved::kAll);
  EXPECT_EQ(Osc("FXRev"), "True");
  EXPECT_TRUE(settings.osc.FXRev);
  EXPECT_FALSE(DefaultsFromSettings(settings).FXReversed);
}

TEST_F(ChartDefaultsRules, SaveStopsAtTheCompareFileAndKeepsWhatStandsBefore) {
  for (const char* bad : {"", "   ", "c:\\no\\such.WDT", "c:\\korawin\\data\\", "?|*"}) {
    dialogs.said.clear();
    typed.CompFile = bad;
    typed.periods[0].daily = "33";
    typed.BCCalTp = true;
    typed.average1.daily = "44";
    EXPECT_EQ(Save(), DefaultsSaved::kCompareFile) << bad;
    ASSERT_EQ(dialogs.said.size(), 1u) << bad;
    EXPECT_EQ(dialogs.said[0].text,
              "RMO/RMX compare file not found.\nEnter path and file details\n"
              "Example   c:\\korawin\\data\\ALODB.WDT");
    EXPECT_EQ(dialogs.said[0].title, "RMO/RMX Compare File");
  }
  EXPECT_EQ(Osc("StochK"), "33");
  EXPECT_EQ(Osc("VtyD"), "0") << "the last of the periods";
  EXPECT_EQ(Osc("BCCalTp"), "unknown");
  EXPECT_EQ(Chart("Av1D"), "unknown");
  EXPECT_EQ(settings.osc[kStochK].daily, 33);
  EXPECT_FALSE(settings.osc.BCCalTp);
}

TEST_F(ChartDefaultsRules, ATextThatIsNoShortNumberIsZero) {
  typed.periods[0] = {"abc", "40000"};
  typed.periods[1] = {"12abc", "-7"};
  ASSERT_EQ(Save(), DefaultsSaved::kAll);
  EXPECT_EQ(Osc("StochK"), "0");
  EXPECT_EQ(Osc("StochKW"), "0");
  EXPECT_EQ(Osc("StochD"), "12");
  EXPECT_EQ(Osc("StochDW"), "-7");
}

TEST_F(ChartDefaultsRules, KeysThatCantBeWrittenAreListedAtTheEnd) {
  test::FailingIo io;
  test::TempHome failing(io);
  failing.Put("drive_c/korawin/data/ALODB.WDT", "");
  SettingsFile file(failing.files(), "C:\\WINDOWS\\Kora.ini");
  ASSERT_TRUE(file.PutSetting("OscDef", "StochK", "1"));
  io.lasting = true;
  io.Reset(1);
  EXPECT_EQ(SaveChartDefaults(file, failing.files(), dialogs, typed, settings),
            DefaultsSaved::kAll);
  io.Reset();
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Chart Defaults");
  const std::string& text = dialogs.said[0].text;
  EXPECT_EQ(text.substr(0, 18), "; StochK; StochKW;");
  EXPECT_NE(text.find("; VtyD; VtyW; CompFile; BCCalTp; "), std::string::npos) << text;
  EXPECT_EQ(text.substr(text.size() - 10), "; ScMethod");
}

TEST_F(ChartDefaultsRules, OneFailedWriteLeavesNoneOfThemHalfKept) {
  test::FailingIo io;
  test::TempHome failing(io);
  failing.Put("drive_c/korawin/data/ALODB.WDT", "");
  SettingsFile file(failing.files(), "C:\\WINDOWS\\Kora.ini");
  ASSERT_TRUE(file.PutSetting("OscDef", "StochK", "1"));
  const std::string before = failing.Get("Kora.ini");
  io.Reset(1);
  EXPECT_EQ(SaveChartDefaults(file, failing.files(), dialogs, typed, settings),
            DefaultsSaved::kAll);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text.substr(0, 18), "; StochK; StochKW;");
  EXPECT_EQ(failing.Get("Kora.ini"), before);
}

TEST_F(ChartDefaultsRules, OneKeyThatCantBeKeptIsTheOnlyOneListed) {
  const std::string folder = "c:\\" + std::string(60, 'x');
  home.files().MakeFolder(folder);
  typed.CompFile = folder + "\\ALODB.WDT";
  home.files().WriteAll(typed.CompFile, "");
  EXPECT_EQ(SaveChartDefaults(ini, home.files(), dialogs, typed, settings), DefaultsSaved::kAll);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "; CompFile");
  EXPECT_EQ(Osc("FillIn"), "False");
}

// ---- Overlays

TEST_F(SettingsRules, MultipleAveragesAreKeptAsAList) {
  std::array<std::string, 12> boxes{"3", "5", "", "10", "600", "0", "1", "2", "4", "6", "7", "8"};
  EXPECT_TRUE(SaveMMASet(ini, settings, boxes, refused));
  EXPECT_EQ(Osc("MMASet"), "3,5,0,10,600,0,1,2,4,6,7,8");
  EXPECT_EQ(settings.osc.MMASet[4], 600);
  for (const char* bad : {"601", "-1"}) {
    boxes[8] = bad;
    EXPECT_FALSE(SaveMMASet(ini, settings, boxes, refused));
    EXPECT_EQ(refused, 8u);
  }
  EXPECT_EQ(Osc("MMASet"), "3,5,0,10,600,0,1,2,4,6,7,8");
}

TEST_F(SettingsRules, StopLossIsKeptUnderItsTwoKeys) {
  EXPECT_TRUE(SaveStopLoss(ini, settings, true, "7.5"));
  EXPECT_EQ(Chart("StopLoss"), "True");
  EXPECT_EQ(Chart("SL Percent"), "7.5");
  for (const char* bad : {"100.1", "-1", "x", ""})
    EXPECT_FALSE(SaveStopLoss(ini, settings, false, bad)) << bad;
  EXPECT_TRUE(settings.charts.StopLoss);
  EXPECT_EQ(settings.charts.StopLossPct, 7.5f);
  EXPECT_TRUE(SaveStopLoss(ini, settings, false, "100"));
  EXPECT_EQ(Chart("StopLoss"), "False");
}

TEST_F(SettingsRules, EachBandFormHasItsPairOfTheNameRecord) {
  const std::string data = "c:\\korawin\\data\\";
  NameRec record = test::Security("BBB");
  record.BandUp = 1;
  record.BandDown = 2;
  record.BollPeriods = 3;
  record.BollWidth = 4;
  home.Put("drive_c/korawin/data/Names.dat", test::Bytes(std::vector<NameRec>{record}));
  CurrentName current;
  current.Rec = record;
  current.NameRecNo = 1;
  EXPECT_STREQ(BandFormTitle(BandForm::kPercentage), "Percentage Bands");
  EXPECT_STREQ(BandFormTitle(BandForm::kBollinger), "Bollinger Bands");
  EXPECT_EQ(StandingBands(BandForm::kBollinger, record).second, "4");
  EXPECT_TRUE(SaveBands(home.files(), data, current, BandForm::kPercentage, "0", "100"));
  EXPECT_TRUE(SaveBands(home.files(), data, current, BandForm::kBollinger, "30", "40"));
  EXPECT_FALSE(SaveBands(home.files(), data, current, BandForm::kPercentage, "101", "5"));
  EXPECT_FALSE(SaveBands(home.files(), data, current, BandForm::kBollinger, "5", "-1"));
  const NameRec written = NameFile(home.files(), NameFilePath(data)).Read(1);
  EXPECT_EQ(written.BandUp, 0);
  EXPECT_EQ(written.BandDown, 100);
  EXPECT_EQ(written.BollPeriods, 30);
  EXPECT_EQ(written.BollWidth, 40);
  EXPECT_EQ(current.Rec.BandDown, 100);
}

}  // namespace
}  // namespace kora
