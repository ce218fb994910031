#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <map>
#include <regex>
#include <sstream>

#include "base/version.h"
#include "store/name_rec.h"
#include "store/price_rec.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

namespace {

const std::string kHostData = "drive_c/korawin/data/";
const char* kNoFile = "[Name File] No File For That Name\n";

using Words = std::vector<std::string>;

std::string Joined(const Words& words) {
  std::string out;
  for (const std::string& word : words) out += word + " ";
  return out;
}

class KoractlTest : public ::testing::Test {
 protected:
  ProgramResult Run(Words words, const Words& environment = {}) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(BinDir() + "/koractl", words, environment);
  }
  // Runs, expects that exit code, and gives standard output.
  std::string Out(const Words& words, int code = 0) {
    const ProgramResult result = Run(words);
    EXPECT_EQ(result.code, code) << Joined(words) << "\n" << result.err;
    return result.out;
  }
  // Runs and expects exit 1, no output, that message, and every file as it was.
  void ExpectAbandoned(const Words& words, const std::string& message) {
    const auto before = AllFiles();
    const ProgramResult result = Run(words);
    EXPECT_EQ(result.code, 1) << Joined(words);
    EXPECT_EQ(result.out, "") << Joined(words);
    EXPECT_NE(result.err.find(message), std::string::npos) << Joined(words) << result.err;
    EXPECT_EQ(AllFiles(), before) << Joined(words);
  }
  // Runs and expects exit 2 with the usage.
  void ExpectUsage(const Words& words, const std::string& part) {
    const auto before = AllFiles();
    const ProgramResult result = Run(words);
    EXPECT_EQ(result.code, 2) << Joined(words);
    EXPECT_EQ(result.out, "") << Joined(words);
    EXPECT_NE(result.err.find(part), std::string::npos) << Joined(words) << result.err;
    EXPECT_NE(result.err.find("Usage: koractl"), std::string::npos) << Joined(words);
    EXPECT_EQ(AllFiles(), before) << Joined(words);
  }
  // A home with one share of four days, Thursday to Tuesday.
  void MakeHome() {
    ASSERT_EQ(Run({"init"}).code, 0);
    home.Put("abc.csv",
             "ABC,20240104,1,3,1,2,100,0\r\nABC,20240105,2,4,2,3,300,0\r\n"
             "ABC,20240108,3,6,3,5,200,0\r\nABC,20240109,5,5.5,4,4.05,400,0\r\n");
    ASSERT_EQ(Run({"import", home.path() + "/abc.csv", "--name", "Abcot Mining"}).code, 0);
  }
  void PutData(const std::string& name, std::string_view bytes) {
    home.Put("kora/" + kHostData + name, bytes);
  }
  std::string GetData(const std::string& name) { return home.Get("kora/" + kHostData + name); }
  std::map<std::string, std::string> AllFiles() {
    std::map<std::string, std::string> out;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(home.path())) {
      const std::string name = std::filesystem::relative(entry.path(), home.path()).string();
      out[name] = entry.is_regular_file() ? home.Get(name) : "folder";
    }
    return out;
  }

  TempHome home;
};

std::string Repeat(std::string_view text, int times) {
  std::string out;
  for (int i = 0; i < times; ++i) out += text;
  return out;
}

}  // namespace

TEST_F(KoractlTest, EveryCommandButInitAndDemoNeedsASettingsFile) {
  home.Put("x.csv", "ABC,20240104,1,3,1,2,100,0\n");
  for (const Words& words :
       {Words{"names"}, Words{"find", "ABC"}, Words{"prices", "ABC"}, Words{"bars", "ABC"},
        Words{"chart", "ABC", "--out", "-"}, Words{"import", home.path() + "/x.csv"},
        Words{"scale", "--high", "2", "--low", "1"}, Words{"downloads"}, Words{"update"},
        Words{"master", home.path() + "/x.csv"},
        Words{"play", "x.cht", "--out", home.path() + "/x.png"},
        Words{"print", "ABC", "--out", home.path() + "/x.pdf"}})
    ExpectAbandoned(words, "[KORA] There is no Kora.ini in " + home.path() + "/kora.");
  std::filesystem::create_directories(home.path() + "/kora/Kora.ini");
  ExpectAbandoned({"names"}, "[KORA] There is no Kora.ini in ");
}

TEST_F(KoractlTest, TheVersionIsThatOfTheProgramWithTheRevision) {
  const std::string out = Out({"--version"});
  EXPECT_TRUE(
      std::regex_match(out, std::regex("koractl " + std::string(kVersion) +
                                       " \\(revision (unknown|[0-9a-f]{7,}(-dirty)?)\\)\n")))
      << out;
}

TEST_F(KoractlTest, InitMakesAnEmptyInstallationAndNeverOverwritesOne) {
  EXPECT_EQ(Out({"init"}), "");
  EXPECT_EQ(std::filesystem::file_size(home.path() + "/kora/" + kHostData + "Names.dat"), 0u);
  EXPECT_TRUE(home.Exists("kora/drive_c/korawin/IndClass.dat"));
  EXPECT_TRUE(home.Exists("kora/drive_c/korawin/chtsave"));
  EXPECT_TRUE(home.Exists("kora/drive_c/korawin/download"));
  EXPECT_NE(home.Get("kora/Kora.ini").find("ChtData=c:\\korawin\\data\\\r\n"), std::string::npos);
  ExpectAbandoned({"init"}, "already");
  ExpectAbandoned({"demo"}, "already");
}

TEST_F(KoractlTest, InitCompletesAHomeThatHasSettingsAlone) {
  const std::string ini = "[KoraPaths]\r\nSystem=c:\\korawin\\\r\nChtData=c:\\mine\\\r\n";
  home.Put("kora/Kora.ini", ini);
  EXPECT_EQ(Out({"init"}), "");
  EXPECT_TRUE(home.Exists("kora/drive_c/mine/Names.dat"));
  EXPECT_EQ(home.Get("kora/Kora.ini"), ini);
  ExpectAbandoned({"init"}, "already");
}

TEST_F(KoractlTest, InitKeepsTheNameFileOfAHomeWithoutSettings) {
  const std::string name(96, 'x');
  PutData("Names.dat", name);
  EXPECT_EQ(Run({"init"}).code, 0);
  EXPECT_EQ(GetData("Names.dat"), name);
}

TEST_F(KoractlTest, TheVariableNamesTheHomeAndTheOptionHoldsBeforeIt) {
  const std::string other = "KORA_HOME=" + home.path() + "/other";
  EXPECT_EQ(RunProgram(BinDir() + "/koractl", {"init"}, {other}).code, 0);
  EXPECT_TRUE(home.Exists("other/Kora.ini"));
  EXPECT_EQ(Run({"init"}, {other}).code, 0);
  EXPECT_TRUE(home.Exists("kora/Kora.ini"));
}

TEST_F(KoractlTest, DemoWithTheSameSeedGivesTheSameBytes) {
  const Words words{"demo", "--securities", "8", "--years", "1", "--seed", "7"};
  EXPECT_EQ(Run(words).code, 0);
  const auto first = AllFiles();
  std::filesystem::remove_all(home.path() + "/kora");
  EXPECT_EQ(Run(words).code, 0);
  EXPECT_EQ(AllFiles(), first);
  const std::string names = Out({"names"});
  EXPECT_EQ(std::count(names.begin(), names.end(), '\n'), 9);
  ExpectUsage({"demo", "--securities", "4"}, "--securities");
  ExpectUsage({"demo", "--seed", "-1"}, "--seed");
}

TEST_F(KoractlTest, NamesShowsEveryField) {
  MakeHome();
  EXPECT_EQ(Out({"names"}),
            "Rec\tStatus\tCode\tRecType\tName\tOtherDetails\tBase\tTop\tPFInc\tMinMove\tBandUp\t"
            "BandDown\tBollPeriods\tBollWidth\tCategory\tId\tIndClass\n"
            "1\t0\tABC\t4\tAbcot Mining\t\t0\t0\t0\t0.05\t0\t0\t0\t0\t1\t\t\n");
}

TEST_F(KoractlTest, TextsOfTheNameFileStayOnTheirLine) {
  MakeHome();
  std::string bytes = GetData("Names.dat");
  bytes.replace(10, 6, std::string("A\tB\n\x80\xE9", 6));  // Euro sign and e acute in ANSI
  PutData("Names.dat", bytes);
  EXPECT_NE(Out({"names"}).find("\tA B \xE2\x82\xAC\xC3\xA9"), std::string::npos);
}

TEST_F(KoractlTest, FindTakesACodeInAnyCase) {
  MakeHome();
  const std::string found = "Rec\tCode\tFile\n1\tABC\tc:\\korawin\\data\\ABC.WDT\n";
  EXPECT_EQ(Out({"find", "ABC"}), found);
  EXPECT_EQ(Out({"find", "aBc"}), found);
  ExpectAbandoned({"find", "AB"}, kNoFile);
  ExpectAbandoned({"find", "ABCD"}, kNoFile);
  ExpectUsage({"find"}, "CODE");
}

TEST_F(KoractlTest, CodesThatCouldLeaveTheFolderFindNothing) {
  MakeHome();
  // Records of such codes, and files that they would reach.
  for (const char* code : {"..\\X", "A/B", "C:", "NUL", "..", "*"}) {
    NameRec rec = NewNameRec("");
    rec.Code.set(code);
    PutData("Names.dat", {reinterpret_cast<const char*>(&rec), sizeof rec});
    home.Put("kora/drive_c/korawin/X.WDT", "");
    for (const char* command : {"find", "prices", "bars"})
      ExpectAbandoned({command, code}, kNoFile);
    ExpectAbandoned({"chart", code, "--out", home.path() + "/c.png"}, kNoFile);
  }
}

TEST_F(KoractlTest, PricesShowsTheFileAsItStands) {
  MakeHome();
  std::string bytes = GetData("ABC.WDT");
  PriceRec rec;
  std::memcpy(&rec, bytes.data() + 50, 50);
  rec.AdjFactor = 0.5f;
  rec.AdjDesc.set("1:2 SPLIT");
  rec.High = std::numeric_limits<float>::quiet_NaN();
  rec.Low = -std::numeric_limits<float>::infinity();
  rec.Volume = -5;
  bytes.replace(50, 50, reinterpret_cast<const char*>(&rec), 50);
  PutData("ABC.WDT", bytes);
  EXPECT_EQ(Out({"prices", "abc"}),
            "Rec\tDate\tOpen\tHigh\tLow\tClose\tVolume\tAdjFactor\tAdjDesc\n"
            "1\t20240104\t1\t3\t1\t2\t100\t0\t\n"
            "2\t20240105\t2\tnan\t-inf\t3\t-5\t0.5\t1:2 SPLIT\n"
            "3\t20240108\t3\t6\t3\t5\t200\t0\t\n"
            "4\t20240109\t5\t5.5\t4\t4.05\t400\t0\t\n");
}

TEST_F(KoractlTest, BarsOfDaysWeeksAndMonths) {
  MakeHome();
  const std::string header = "Bar\tDate\tOpen\tHigh\tLow\tClose\tVolume\tSourceRec\n";
  EXPECT_EQ(Out({"bars", "ABC", "--first", "2", "--last", "3"}),
            header +
                "0\t20240105\t2\t4\t2\t3\t300\t0\n"
                "1\t20240108\t3\t6\t3\t5\t200\t0\n"
                "# BarCount=1 FirstDataRec=2 LastDataRec=3 ChartHigh=6 ChartLow=2 VolMax=300 "
                "VolMin=200 VolAvg=250 VolumeShown=True\n");
  EXPECT_EQ(Out({"bars", "ABC", "--period", "w"}),
            header +
                "0\t20240105\t1\t4\t1\t3\t400\t0\n"
                "1\t20240109\t3\t6\t3\t4.05\t600\t0\n"
                "# BarCount=1 FirstDataRec=1 LastDataRec=4 ChartHigh=6 ChartLow=1 VolMax=600 "
                "VolMin=400 VolAvg=500 VolumeShown=True\n");
  // Monthly volumes are in hundreds; one bar's volume gets a panel of three times its height.
  EXPECT_EQ(Out({"bars", "ABC", "--period", "M"}),
            header +
                "0\t20240109\t1\t6\t1\t4.05\t10\t0\n"
                "# BarCount=0 FirstDataRec=1 LastDataRec=4 ChartHigh=6 ChartLow=1 VolMax=30 "
                "VolMin=1 VolAvg=30 VolumeShown=True\n");
  EXPECT_NE(Out({"bars", "ABC", "--volume", "off"})
                .find("VolMax=0 VolMin=0 VolAvg=0 "
                      "VolumeShown=False"),
            std::string::npos);
  ExpectAbandoned({"bars", "ABC", "--first", "0"}, "There are no records 0 to 4 in ABC.WDT");
  ExpectAbandoned({"bars", "ABC", "--last", "5"}, "There are no records 1 to 5 in ABC.WDT");
  ExpectAbandoned({"bars", "ABC", "--first", "3", "--last", "2"}, "There are no records 3 to 2");
  ExpectUsage({"bars", "ABC", "--period", "Y"}, "--period");
  ExpectUsage({"bars", "ABC", "--first", "x"}, "--first");
  ExpectUsage({"bars", "ABC", "--volume", "maybe"}, "--volume");
}

TEST_F(KoractlTest, ScaleOfPricesAndOfAManualRange) {
  MakeHome();
  // 1500 x 1.02 is 153 tens, 1200 x 0.99 is 119 tens; then outward to hundreds.
  const std::string header = "ScaleLow\tScaleHigh\tGridStep\tGridCount\n";
  // A range of 500 takes its tenth as the step.
  EXPECT_EQ(Out({"scale", "--high", "1500", "--low", "1200"}), header + "1100\t1600\t50\t10\n");
  EXPECT_EQ(Out({"scale", "--high", "10", "--low", "5", "--base", "3", "--top", "12"}),
            header + "3\t12\t0.5\t18\n");
  EXPECT_EQ(Run({"scale", "--high", "-5", "--low", "-20"}).code, 0);
  ExpectUsage({"scale", "--high", "10"}, "--low");
  ExpectUsage({"scale", "--high", "10", "--low", "nan"}, "--low");
  ExpectUsage({"scale", "--high", "1e99", "--low", "1"}, "--high");
  ExpectUsage({"scale", "--high", "10", "--low", "5", "--base", "3"}, "--top");
  ExpectUsage({"scale", "--high", "10", "--low", "5", "--base", "0", "--top", "9"}, "0(zero)");
}

TEST_F(KoractlTest, AChartsScriptIsTheSameInAFileAndOnStandardOutput) {
  MakeHome();
  const std::string script = Out({"chart", "abc", "--out", "-"});
  EXPECT_EQ(script.rfind("T,9.75,20,2,ABC    Abcot Mining,", 0), 0u) << script.substr(0, 80);
  const std::string file = home.path() + "/chart.CHT";
  EXPECT_EQ(Out({"chart", "ABC", "--out", file}), "");
  EXPECT_EQ(home.Get("chart.CHT"), script);
  // Not composed by another way when a picture is drawn.
  EXPECT_EQ(Out({"chart", "ABC", "--out", home.path() + "/chart.svg"}), "");
  EXPECT_NE(home.Get("chart.svg").find("Abcot Mining"), std::string::npos);
}

TEST_F(KoractlTest, ANewInstallationHasLegibleLabelsAndAMissingKeyHasNot) {
  EXPECT_EQ(Run({"demo", "--securities", "8", "--years", "1"}).code, 0);
  EXPECT_NE(home.Get("kora/Kora.ini").find("Legible=True\r\n"), std::string::npos);
  std::filesystem::remove_all(home.path() + "/kora");
  MakeHome();
  EXPECT_NE(home.Get("kora/Kora.ini").find("Legible=True\r\n"), std::string::npos);
  home.Put("dear.csv", "DEAR,20240104,1000,1010,990,1000,100,0\r\n");
  EXPECT_EQ(Run({"import", home.path() + "/dear.csv"}).code, 0);
  const std::string legible = Out({"chart", "DEAR", "--out", "-"});
  EXPECT_NE(legible.find("S,8.25,1,"), std::string::npos);
  std::string ini = home.Get("kora/Kora.ini");
  ini.erase(ini.find("Legible=True\r\n"), 14);
  home.Put("kora/Kora.ini", ini);
  const std::string plain = Out({"chart", "DEAR", "--out", "-"});
  EXPECT_NE(plain.find("S,8.25,-3,"), std::string::npos);
  EXPECT_EQ(Out({"chart", "DEAR", "--set", "Charts.Legible=True", "--out", "-"}), legible);
}

TEST_F(KoractlTest, ChartsFollowTheirOptions) {
  MakeHome();
  const std::string plain = Out({"chart", "ABC", "--out", "-"});
  const auto differs = [&](const Words& more) {
    Words words{"chart", "ABC", "--out", "-"};
    words.insert(words.end(), more.begin(), more.end());
    return Out(words) != plain;
  };
  EXPECT_TRUE(differs({"--style", "C"}));
  EXPECT_TRUE(differs({"--style", "L"}));
  EXPECT_TRUE(differs({"--period", "W"}));
  EXPECT_TRUE(differs({"--spacing", "10"}));
  EXPECT_TRUE(differs({"--size", "900x500"}));
  EXPECT_TRUE(differs({"--volume", "off"}));
  EXPECT_TRUE(differs({"--finish", "20240105"}));
  EXPECT_TRUE(differs({"--switch", "n"}));
  EXPECT_FALSE(differs({"--switch", "RM", "--switch", "A"}));
  EXPECT_FALSE(differs({"--style", "b", "--period", "a", "--spacing", "2", "--size", "638X452"}));
  // The settings say what the options do not.
  EXPECT_TRUE(differs({"--set", "OscDef.BCCalTp=True"}));
  EXPECT_TRUE(differs({"--ma1", "--set", "Charts.Av1D=2"}));
  EXPECT_FALSE(differs({"--set", "Charts.Av1D=2"}));
}

TEST_F(KoractlTest, PicturesHaveTheirSizeAndForm) {
  MakeHome();
  const auto draw = [&](const std::string& name, const Words& more = {}) {
    Words words{"chart", "ABC", "--out", home.path() + "/" + name};
    words.insert(words.end(), more.begin(), more.end());
    const ProgramResult result = Run(words, {"QT_QPA_PLATFORM=offscreen"});
    EXPECT_EQ(result.code, 0) << result.err;
    EXPECT_EQ(result.out + result.err, "");
    return home.Get(name);
  };
  const auto side = [](const std::string& png, size_t at) {
    int value = 0;
    for (size_t i = at; i < at + 4; ++i) value = value * 256 + static_cast<unsigned char>(png[i]);
    return value;
  };
  const std::string png = draw("a.png");
  ASSERT_EQ(png.substr(0, 8), "\x89PNG\r\n\x1a\n");
  EXPECT_EQ(side(png, 16), 638);
  EXPECT_EQ(side(png, 20), 452);
  const std::string twice = draw("b.PNG", {"--size", "300x200", "--scale", "2"});
  EXPECT_EQ(side(twice, 16), 600);
  EXPECT_EQ(side(twice, 20), 400);
  EXPECT_EQ(draw("c.pdf").substr(0, 5), "%PDF-");
  EXPECT_NE(draw("d.svg").find("<svg"), std::string::npos);
}

TEST_F(KoractlTest, PicturesNeedNoDisplay) {
  MakeHome();
  const ProgramResult result = Run({"chart", "ABC", "--out", home.path() + "/a.png"},
                                   {"DISPLAY=:987", "WAYLAND_DISPLAY=none"});
  EXPECT_EQ(result.code, 0) << result.err;
  EXPECT_GT(home.Get("a.png").size(), 1000u);
}

TEST_F(KoractlTest, ChartOptionsThatMakeNoSense) {
  MakeHome();
  ExpectUsage({"chart", "ABC"}, "--out");
  const std::string out = home.path() + "/c.png";
  for (const char* name : {"c.gif", "c", ".png", "", "c.png.txt"})
    ExpectUsage({"chart", "ABC", "--out", name}, "--out");
  for (const char* size : {"99x100", "100x99", "10001x100", "638", "638x", "x452", "638x452x",
                           "axb", "1e3x452", "-638x452", "99999999999x452"})
    ExpectUsage({"chart", "ABC", "--out", out, "--size", size}, "--size");
  ExpectUsage({"chart", "ABC", "--out", out, "--size", "10000x10000", "--scale", "2"}, "--scale");
  ExpectUsage({"chart", "ABC", "--out", out, "--spacing", "0"}, "--spacing");
  ExpectUsage({"chart", "ABC", "--out", out, "--spacing", "99999"}, "--spacing");
  ExpectUsage({"chart", "ABC", "--out", out, "--finish", "20240230"}, "--finish");
  ExpectUsage({"chart", "ABC", "--out", out, "--style", "X"}, "--style");
  ExpectUsage({"chart", "ABC", "--out", out, "--switch", "ZZ"}, "--switch");
  ExpectUsage({"chart", "ABC", "--out", out, "--osc", "ZZZ"}, "--osc");
  ExpectUsage({"chart", "ABC", "--out", out, "--nosuch"}, "--nosuch");
}

TEST_F(KoractlTest, OscillatorsHaveTheirPanelBelowThePrices) {
  MakeHome();
  // A panel of 144 units stands from 2.88 to 141.12 below a price picture of 452.
  const std::string script = Out({"chart", "ABC", "--out", "-", "--osc", "rsi"});
  EXPECT_NE(script.find("\r\nB,42,455,631,593,"), std::string::npos);
  EXPECT_NE(script.find("Relative Strength Index Oscillator (14 Period)"), std::string::npos);
  // The parabolic has no panel, and slow is a form of the stochastic.
  EXPECT_EQ(Out({"chart", "ABC", "--out", "-", "--osc", "PARA"}).find("\r\nB,42,455"),
            std::string::npos);
  EXPECT_NE(Out({"chart", "ABC", "--out", "-", "--osc", "STO", "--slow"}).find("SLOW Stochastic"),
            std::string::npos);
  const std::string out = home.path() + "/o.png";
  EXPECT_EQ(Out({"chart", "ABC", "--out", out, "--osc", "RSI", "--panel", "200"}), "");
  EXPECT_EQ(home.Get("o.png").substr(20, 4), std::string("\0\0\x02\x8c", 4));  // 452 + 200
}

TEST_F(KoractlTest, AViewOfSeveralOscillatorsStacksTheirPanelsBelowThePrices) {
  MakeHome();
  // Two panels share 452 units, a frame of 226 each: the first where the price picture ends, the
  // second 3 below the frame of the first.
  const std::string script =
      Out({"multi", "abc", "--out", "-", "--oscs", "rsi,None,Momentum", "--size", "638x452"});
  EXPECT_NE(script.find("\r\nB,42,457,631,673,"), std::string::npos);
  EXPECT_NE(script.find("\r\nB,42,681,631,897,"), std::string::npos);
  EXPECT_LT(script.find("Relative Strength"), script.find("Momentum Oscillator"));
  const std::string out = home.path() + "/v.png";
  EXPECT_EQ(Out({"multi", "ABC", "--out", out, "--oscs", "RSI", "--size", "638x452"}), "");
  EXPECT_EQ(home.Get("v.png").substr(20, 4), std::string("\0\0\x03\x88", 4));  // twice 452
}

TEST_F(KoractlTest, ASetOfOscillatorsIsKeptAndShown) {
  MakeHome();
  const std::string none = "\tNone\n";
  EXPECT_EQ(Out({"multi", "sets"}), "Set\tSlot\tName\n1\t1" + none + "1\t2" + none + "1\t3" + none +
                                        "1\t4" + none + "2\t1" + none + "2\t2" + none + "2\t3" +
                                        none + "2\t4" + none);
  ExpectAbandoned({"multi", "ABC", "--set", "2", "--out", "-"}, "No oscillators have been set");
  EXPECT_EQ(Out({"multi", "sets", "--set", "2", "--oscs", " macd ,,RSI"}), "");
  const std::string sets = Out({"multi", "sets"});
  EXPECT_NE(sets.find("1\t1\tNone\n"), std::string::npos);
  EXPECT_NE(sets.find("2\t1\tMACD\n2\t2\tNone\n2\t3\tRSI\n2\t4\tNone\n"), std::string::npos);
  EXPECT_EQ(
      Out({"--set", "Charts.Grid=False", "multi", "ABC", "--set", "2", "--out", "-"}),
      Out({"--set", "Charts.Grid=False", "multi", "ABC", "--oscs", "MACD,RSI", "--out", "-"}));
}

TEST_F(KoractlTest, AViewThatMakesNoSenseIsRefused) {
  MakeHome();
  ExpectUsage({"multi", "ABC", "--out", "-"}, "--oscs");
  ExpectUsage({"multi", "ABC", "--out", "-", "--set", "1", "--oscs", "RSI"}, "--oscs");
  ExpectUsage({"multi", "ABC", "--out", "-", "--oscs", "RSI,RMO"}, "\"RMO\" is none of");
  ExpectUsage({"multi", "ABC", "--out", "-", "--oscs", "RSI,RSI,RSI,RSI,RSI"}, "at most 4");
  ExpectUsage({"multi", "ABC", "--out", "-", "--set", "3"}, "--set");
  ExpectUsage({"multi", "ABC", "--oscs", "RSI"}, "--out");
  ExpectUsage({"multi", "ABC", "--out", "-", "--oscs", "RSI", "--style", "P"}, "--style P");
  ExpectUsage({"multi", "ABC", "--out", "-", "--oscs", "RSI", "--osc", "FX"}, "--oscs");
  ExpectUsage({"multi", "sets", "--set", "1"}, "--oscs");
  ExpectUsage({"multi", "sets", "--oscs", "RSI"}, "--set");
  ExpectAbandoned({"multi", "NIX", "--out", "-", "--oscs", "RSI"}, kNoFile);
}

TEST_F(KoractlTest, RmoIsForDailyChartsAndNeedsItsCompareFile) {
  MakeHome();
  ExpectAbandoned(
      {"chart", "ABC", "--out", home.path() + "/r.png", "--osc", "RMO", "--period", "W"},
      "[RMO] RMO only available on Daily Charts");
  ExpectAbandoned({"chart", "ABC", "--out", home.path() + "/r.png", "--osc", "RMO"},
                  "[RMX/RMO Compare file] RMX/RMO Compare file path/file details are invalid.");
}

TEST_F(KoractlTest, PlayShowsASavedChartAndRefusesWhatIsNone) {
  MakeHome();
  const std::string saved = home.path() + "/a.cht", out = home.path() + "/a.svg";
  EXPECT_EQ(Out({"chart", "ABC", "--out", saved}), "");
  EXPECT_EQ(Out({"play", saved, "--out", out}), "");
  EXPECT_NE(home.Get("a.svg").find("Abcot Mining"), std::string::npos);
  home.Put("b.cht", "nothing of ours\r\n");
  for (const char* name : {"/b.cht", "/missing.cht"})
    ExpectAbandoned({"play", home.path() + name, "--out", out},
                    "[Show Saved Chart] There is problem displaying this chart - format invalid.");
  ExpectUsage({"play", saved, "--out", home.path() + "/a.cht"}, "--out");
}

namespace {
// The drawing of a PDF's first page, without the dates around it.
std::string Drawing(const std::string& pdf) {
  const size_t page = pdf.find("/Contents");
  const size_t from = pdf.find("stream", page == pdf.npos ? 0 : page);
  return from == pdf.npos ? "" : pdf.substr(from, pdf.find("endstream", from) - from);
}
// ---- The marks of the mouse

class MarksCommandTest : public KoractlTest {
 protected:
  void SetUp() override {
    ASSERT_EQ(Run({"demo", "--securities", "8", "--years", "2", "--seed", "7"}).code, 0);
    const std::string names = Out({"names"});
    // Code of the first share.
    const size_t row = names.find('\n') + 1;
    const size_t start = names.find('\t', names.find('\t', row) + 1) + 1;
    code = names.substr(start, names.find('\t', start) - start);
  }
  std::string code;
};

TEST_F(MarksCommandTest, LinesAreDrawnShownDeletedAndCompacted) {
  const Words lines{"lines", code};
  const std::string header = "Rec\tSpacing\tPeriod\tStartDate\tStartPrice\tEndDate\tEndPrice\n";
  EXPECT_EQ(Out(lines), header);
  Out({"lines", code, "add", "--at", "100,200,300,150"});
  Out({"lines", code, "add", "--at", "300,100,625,90"});
  const std::string two = Out(lines);
  EXPECT_EQ(std::count(two.begin(), two.end(), '\n'), 3);
  EXPECT_NE(two.find("1\t3\tA\t"), std::string::npos);
  EXPECT_NE(two.find("\tX16"), std::string::npos) << two;
  EXPECT_NE(Out({"chart", code, "--out", "-"}).find("H,101,"), std::string::npos);
  Out({"lines", code, "delete", "1"});
  EXPECT_NE(Out(lines).find("1\t0\t\t\t0\t\t0\n"), std::string::npos);
  Out({"lines", code, "compact"});
  const std::string one = Out(lines);
  EXPECT_EQ(std::count(one.begin(), one.end(), '\n'), 2);
  ExpectAbandoned({"lines", code, "delete", "9"}, "[Trendline] Bad record number");
  ExpectUsage({"lines", code, "add", "--at", "1,2,3"}, "--at");
  ExpectUsage({"lines", code, "delete"}, "delete N");
  Out({"lines", code, "clear"});
  EXPECT_EQ(Out(lines), header);
}

TEST_F(MarksCommandTest, AMarkThatCantBeSavedEndsWithOne) {
  const std::string misc = "kora/drive_c/korawin/chtmisc/";
  for (const char* file : {".TND", ".Txt"}) home.Put(misc + code + file + "/folder", "");
  ExpectAbandoned({"lines", code, "add", "--at", "100,200,300,150"}, "[Trendline] ");
  ExpectAbandoned({"notes", code, "add", "--at", "200,120", "Bought"}, "] ");
}

TEST_F(MarksCommandTest, TextsLevelsAndAZoomFromAShell) {
  EXPECT_EQ(Out({"notes", code}), "Date\tPrice\tText\tColour\n");
  Out({"notes", code, "add", "--at", "200,120", "Bought, here"});
  EXPECT_NE(Out({"notes", code}).find("\tBought here\t"), std::string::npos);
  EXPECT_NE(Out({"chart", code, "--out", "-"}).find(",Bought here,"), std::string::npos);
  ExpectUsage({"notes", code, "add", "--at", "200,120"}, "TEXT");
  Out({"notes", code, "delete", "1"});
  EXPECT_EQ(Out({"notes", code}), "Date\tPrice\tText\tColour\n");
  const ProgramResult fib = Run({"chart", code, "--fib", "150,350,300,150", "--out", "-"});
  EXPECT_EQ(fib.code, 0);
  EXPECT_NE(fib.err.find("Start  "), std::string::npos) << fib.err;
  EXPECT_NE(fib.err.find("62%    "), std::string::npos) << fib.err;
  EXPECT_EQ(fib.out.substr(fib.out.rfind("\nD,") + 1, 6), "D,300,");
  ExpectUsage({"zoom", code, "--box", "100,100,100,300", "--out", "a.png"}, "--box");
  const std::string file = home.path() + "/zoom.svg";
  Out({"zoom", code, "--box", "100,290,180,380", "--out", file});
  EXPECT_NE(home.Get("zoom.svg").find("<svg"), std::string::npos);
}

}  // namespace

TEST_F(KoractlTest, PrintMakesAPdfOfOnePage) {
  MakeHome();
  const std::string out = home.path() + "/a.pdf";
  EXPECT_EQ(Out({"print", "abc", "--out", out}), "");
  // A chart that is wider than high lies on its better side, unless the page was turned.
  const std::string lying = home.Get("a.pdf");
  EXPECT_EQ(lying.substr(0, 5), "%PDF-");
  EXPECT_NE(lying.find("/MediaBox [0 0 842"), std::string::npos);
  EXPECT_NE(lying.find("/Count 1"), std::string::npos);
  EXPECT_EQ(Out({"print", "ABC", "--set", "ChtPage.Orient=1", "--osc", "MACD", "--out", out}), "");
  EXPECT_NE(home.Get("a.pdf").find("/MediaBox [0 0 595"), std::string::npos);
  EXPECT_EQ(Out({"print", "ABC", "--set", "Charts.FitSide=False", "--out", out}), "");
  EXPECT_NE(home.Get("a.pdf").find("/MediaBox [0 0 595"), std::string::npos);
  EXPECT_FALSE(home.Exists("kora/" + kHostData + "TCht.Tmp"));
}

TEST_F(KoractlTest, AChartPrintedAgainIsTheSameFileButForItsDate) {
  MakeHome();
  const auto print = [&] {
    EXPECT_EQ(Out({"print", "ABC", "--osc", "MACD", "--out", home.path() + "/a.pdf"}), "");
    std::string pdf = home.Get("a.pdf");
    const size_t date = pdf.find("/CreationDate");
    EXPECT_NE(date, pdf.npos);
    return pdf.erase(date, pdf.find('\n', date) - date);
  };
  const std::string first = print();
  for (int again = 0; again < 4; ++again) EXPECT_EQ(print(), first);
}

TEST_F(KoractlTest, ASavedChartPrintsAsTheChartItself) {
  MakeHome();
  const std::string saved = home.path() + "/a.CHT";
  EXPECT_EQ(Out({"chart", "ABC", "--style", "C", "--out", saved}), "");
  EXPECT_EQ(Out({"print", saved, "--out", home.path() + "/saved.pdf"}), "");
  EXPECT_EQ(Out({"print", "ABC", "--style", "C", "--out", home.path() + "/own.pdf"}), "");
  const std::string own = Drawing(home.Get("own.pdf"));
  EXPECT_GT(own.size(), 1000u);
  EXPECT_EQ(Drawing(home.Get("saved.pdf")), own);
  EXPECT_EQ(Out({"print", "ABC", "--style", "L", "--out", home.path() + "/line.pdf"}), "");
  EXPECT_NE(Drawing(home.Get("line.pdf")), own);
}

TEST_F(KoractlTest, PrintFollowsThePrintersSettings) {
  MakeHome();
  const auto print = [&](const Words& more) {
    Words words{"print", "ABC", "--out", home.path() + "/p.pdf"};
    words.insert(words.end(), more.begin(), more.end());
    EXPECT_EQ(Out(words), "");
    return Drawing(home.Get("p.pdf"));
  };
  const std::string plain = print({});
  EXPECT_EQ(print({}), plain);
  for (const char* setting :
       {"Charts.Line Width=9", "Charts.EFact=0.8", "Chart Fonts.CFontSize=20"})
    EXPECT_NE(print({"--set", setting}), plain) << setting;
  EXPECT_NE(print({"--switch", "N"}), plain);
  home.Put("kora/drive_c/korawin/koraprn.dat", std::string("\1\0\0\0", 4));
  EXPECT_NE(print({}), plain) << "in colour";
}

TEST_F(KoractlTest, AChartThatCannotBePrintedLeavesTheOldFile) {
  MakeHome();
  const std::string out = home.path() + "/p.pdf";
  home.Put("p.pdf", "old");
  home.Put("empty.cht", "");
  home.Put("seven.cht", "L,1,2,3,4,5\r\nL,1,2,3,4,5,6\r\n");
  home.Put("cut.cht", "L,1,2,3,4,5\r\nL,1,2");
  const std::string said = "[Chart Printing] There is an unexpected error No. ";
  ExpectAbandoned({"print", home.path() + "/empty.cht", "--out", out}, said + "5\n");
  ExpectAbandoned({"print", home.path() + "/seven.cht", "--out", out}, said + "9\n");
  ExpectAbandoned({"print", home.path() + "/cut.cht", "--out", out}, said + "5\n");
  ExpectAbandoned({"print", home.path() + "/gone.cht", "--out", out}, said + "53\n");
  ExpectAbandoned({"print", "ABC", "--out", home.path() + "/no/p.pdf"}, said);
  ExpectAbandoned({"print", "XYZ", "--out", out}, kNoFile);
  PutData("ABC.WDT", "");
  ExpectAbandoned({"print", "ABC", "--out", out}, "[Chart Display] No Data for ABC.WDT");
  ExpectUsage({"print", "ABC", "--out", home.path() + "/p.png"}, "does not end in .pdf");
  ExpectUsage({"print", "ABC", "--out", "-"}, "does not end in .pdf");
  ExpectUsage({"print", "ABC"}, "--out");
}

TEST_F(KoractlTest, OptionsWithoutAPlaceOnTheChartAreRefused) {
  MakeHome();
  for (const Words& more :
       {Words{"--box", "0.5"}, Words{"--style", "C", "--swing", "NORM"}, Words{"--swing", "NORM:5"},
        Words{"--swing", "XPointAuto:5"}, Words{"--swing", "Up"}, Words{"--swing", ":3"},
        Words{"--osc", "RSI", "--style", "P"}}) {
    Words words{"chart", "ABC", "--out", "-"};
    words.insert(words.end(), more.begin(), more.end());
    ExpectUsage(words, more[0]);
  }
}

TEST_F(KoractlTest, PointAndFigureTakesReversalAndBoxValue) {
  MakeHome();
  std::string data;
  for (const float c : {10.0f, 13.0f, 11.0f, 14.0f}) {
    PriceRec rec = NewPriceRec("2024030" + std::to_string(1 + data.size() / sizeof rec));
    rec.Open = rec.High = rec.Low = rec.Close = c;
    data.append(reinterpret_cast<const char*>(&rec), sizeof rec);
  }
  PutData("ABC.WDT", data);
  const auto script = [&](const Words& more) {
    Words words{"chart", "ABC", "--style", "P", "--out", "-"};
    words.insert(words.end(), more.begin(), more.end());
    return Out(words);
  };
  // Two boxes back are a column of their own with a reversal of 2, and none with 3.
  EXPECT_NE(script({"--box", "1", "--spacing", "2"}).find("\r\nX,53,"), std::string::npos);
  EXPECT_EQ(script({"--box", "1", "--spacing", "3"}).find("\r\nX,"), std::string::npos);
  EXPECT_NE(script({"--box", "1"}).find(",Box Value = 1,"), std::string::npos);
  EXPECT_EQ(script({"--box", "1", "--spacing", "0"}), script({"--box", "1", "--spacing", "40"}));
  EXPECT_NE(script({}).find(",Box Value = 0.0"), std::string::npos);
  EXPECT_NE(script({"--box", "-1", "--size", "638x300"}).find(",Box Value = 0.003,"),
            std::string::npos);
  const Words words{"chart", "ABC", "--style", "P", "--out", "-", "--box"};
  const auto with = [&](const char* box) {
    Words all = words;
    all.push_back(box);
    return all;
  };
  ExpectAbandoned(with("0"), "[Box Value] Box value must have a value. eg 0.20");
  ExpectAbandoned(with("x"), "[Box Value] Box value must be numeric eg 0.20");
}

TEST_F(KoractlTest, SwingTakesItsKindAndSize) {
  MakeHome();
  std::string data;
  for (int i = 0; i < 30; ++i) {
    PriceRec rec = NewPriceRec("202403" + std::to_string(i / 9 + 1) + std::to_string(i % 9 + 1));
    rec.Open = rec.Low = rec.Close = 10 + float(i % 7) * 0.2f;
    rec.High = rec.Low + 0.3f;
    data.append(reinterpret_cast<const char*>(&rec), sizeof rec);
  }
  PutData("ABC.WDT", data);
  const auto title = [&](const char* swing) {
    const std::string script = Out({"chart", "ABC", "--swing", swing, "--out", "-"});
    const size_t at = script.find("Daily Swing");
    return at == std::string::npos ? "" : script.substr(at, script.find(',', at) - at);
  };
  EXPECT_EQ(title("NORM"), "Daily Swing  -  Standard");
  EXPECT_EQ(title("xday:4"), "Daily Swing 4 - DAY");
  EXPECT_EQ(title("XDay"), "Daily Swing 3 - DAY");
  EXPECT_EQ(title("XPoint:9.5"), "Daily Swing 9.5 - POINT");
  EXPECT_EQ(title("XPoint"), "Daily Swing 9 - POINT");
  EXPECT_NE(title("XPointAuto").find(" - Point(Auto)"), std::string::npos);
  for (const char* bad : {"XDay:", "XDay:0", "XDay:0.5", "XPoint:-3", "XPoint:nine", "XDay:3x"})
    ExpectAbandoned({"chart", "ABC", "--swing", bad, "--out", "-"},
                    "[Swing] Incorrect values entered");
}

TEST_F(KoractlTest, AChartThatFailsLeavesTheOldPicture) {
  MakeHome();
  home.Put("c.png", "old");
  const Words words{"chart", "ABC", "--out", home.path() + "/c.png"};
  PutData("ABC.WDT", "");
  ExpectAbandoned(words, "[Chart Display] No Data for ABC.WDT");
  PutData("ABC.WDT", std::string(49, ' '));  // less than one record
  ExpectAbandoned(words, "[Chart Display] No Data for ABC.WDT");
  std::filesystem::remove(home.path() + "/kora/" + kHostData + "ABC.WDT");
  ExpectAbandoned(words, "[Chart Display] There is a problem with ABC.WDT Cannot find or open");
  std::filesystem::create_directory(home.path() + "/kora/" + kHostData + "ABC.WDT");
  ExpectAbandoned(words, "[Chart Display] There is a problem with ABC.WDT Cannot find or open");
  std::filesystem::remove(home.path() + "/kora/" + kHostData + "ABC.WDT");
  PutData("ABC.WDT", Repeat(std::string(50, '\xFF'), 3));  // NaN prices, dates of no digits
  // No price counts, which leaves a range far below nothing: more steps of the grid than 16 bits
  // number. A week needs a weekday.
  for (const char* period : {"A", "W", "M"}) {
    Words by = words;
    by.insert(by.end(), {"--period", period});
    ExpectAbandoned(by, "[Chart Display] There is a problem with the data for ABC.WDT");
  }
}

TEST_F(KoractlTest, APictureThatCannotBeWrittenIsTold) {
  MakeHome();
  std::filesystem::create_directory(home.path() + "/folder.png");
  ExpectAbandoned({"chart", "ABC", "--out", home.path() + "/folder.png"}, "folder.png: ");
  ExpectAbandoned({"chart", "ABC", "--out", home.path() + "/no/c.cht"}, "no/c.cht: ");
}

TEST_F(KoractlTest, TornStoreFilesCountWholeRecordsAlone) {
  MakeHome();
  PutData("Names.dat", GetData("Names.dat") + "torn");
  PutData("ABC.WDT", GetData("ABC.WDT") + std::string(49, 'x'));
  const std::string names = Out({"names"});
  EXPECT_EQ(std::count(names.begin(), names.end(), '\n'), 2);
  const std::string prices = Out({"prices", "ABC"});
  EXPECT_EQ(std::count(prices.begin(), prices.end(), '\n'), 5);
  EXPECT_NE(Out({"bars", "ABC"}).find("# BarCount=3 "), std::string::npos);
  EXPECT_EQ(Run({"chart", "ABC", "--out", "-"}).code, 0);
}

TEST_F(KoractlTest, ANameFileThatIsEmptyMissingOrAFolder) {
  MakeHome();
  PutData("Names.dat", "");
  const std::string names = Out({"names"});
  EXPECT_EQ(std::count(names.begin(), names.end(), '\n'), 1);
  ExpectAbandoned({"find", "ABC"}, kNoFile);
  const std::string path = home.path() + "/kora/" + kHostData + "Names.dat";
  const char* message = "There is a problem with Names.dat Cannot find or open";
  std::filesystem::remove(path);
  ExpectAbandoned({"names"}, message);
  ExpectAbandoned({"prices", "ABC"}, message);
  std::filesystem::create_directory(path);
  ExpectAbandoned({"names"}, message);
  ExpectAbandoned({"chart", "ABC", "--out", "-"}, message);
}

TEST_F(KoractlTest, PriceFilesThatAreMissingEmptyOrFolders) {
  MakeHome();
  const std::string path = home.path() + "/kora/" + kHostData + "ABC.WDT";
  PutData("ABC.WDT", "");
  const std::string prices = Out({"prices", "ABC"});
  EXPECT_EQ(std::count(prices.begin(), prices.end(), '\n'), 1);
  ExpectAbandoned({"bars", "ABC"}, "[Chart Display] No Data for ABC.WDT");
  std::filesystem::remove(path);
  const char* message = "There is a problem with ABC.WDT Cannot find or open";
  ExpectAbandoned({"prices", "ABC"}, message);
  ExpectAbandoned({"bars", "ABC"}, message);
  std::filesystem::create_directory(path);
  ExpectAbandoned({"prices", "ABC"}, message);
  ExpectAbandoned({"bars", "ABC"}, message);
}

TEST_F(KoractlTest, AWeekOfDatesThatAreNoneIsAProblemWithTheData) {
  MakeHome();
  std::string bytes = GetData("ABC.WDT");
  bytes.replace(100, 8, "2024XX08");
  PutData("ABC.WDT", bytes);
  ExpectAbandoned({"bars", "ABC", "--period", "W"},
                  "[Chart Display] There is a problem with the data for ABC.WDT\n at Rec Number "
                  "(3) 2024XX08\nUse View/Modify Data procedure to correct.");
  EXPECT_NE(Out({"bars", "ABC"}).find("2024XX08"), std::string::npos);
}

TEST_F(KoractlTest, ASettingsFileOfRubbishAsksWhereTheSystemIs) {
  MakeHome();
  std::string rubbish;
  for (int i = 0; i < 5000; ++i) rubbish += char(i * 7 % 256);
  home.Put("kora/Kora.ini", rubbish);
  ExpectAbandoned({"--answer", "cancel", "names"}, "[Drive] There is a path problem.");
  // The standing answer takes the drive that is offered.
  EXPECT_NE(Out({"names"}).find("Abcot Mining"), std::string::npos);
}

TEST_F(KoractlTest, ASettingsFileThatCantBeReadEndsEveryCommand) {
  MakeHome();
  home.Put("kora/Kora.ini", std::string(5u << 20, 'x'));
  home.Put("x.csv", "ABC,20240104,1,3,1,2,100,0\n");
  for (const Words& words :
       {Words{"init"}, Words{"names"}, Words{"find", "ABC"}, Words{"prices", "ABC"},
        Words{"bars", "ABC"}, Words{"chart", "ABC", "--out", "-"},
        Words{"import", home.path() + "/x.csv"}, Words{"scale", "--high", "2", "--low", "1"},
        Words{"downloads"}, Words{"update"}, Words{"master", home.path() + "/x.csv"},
        Words{"play", "x.cht", "--out", home.path() + "/x.png"},
        Words{"print", "ABC", "--out", home.path() + "/x.pdf"}})
    ExpectAbandoned(
        words, "[KORA] Kora.ini in " + home.path() + "/kora can't be read: The file is too large");
  ExpectAbandoned({"demo"}, "already");
}

TEST_F(KoractlTest, AWorkingFolderThatIsGoneIsTold) {
  MakeHome();
  const std::string program = BinDir() + "/koractl --home " + home.path() + "/kora ";
  for (const std::string command : {"play a.cht --out a.png", "print a.cht --out a.pdf"}) {
    const ProgramResult result =
        RunProgram("/bin/sh", {"-c", "mkdir " + home.path() + "/gone && cd " + home.path() +
                                         "/gone && rmdir " + home.path() + "/gone && exec " +
                                         program + command});
    EXPECT_EQ(result.code, 1) << command;
    EXPECT_EQ(result.err, "[KORA] a.cht: the working folder is gone\n");
  }
  // What is named from the root needs none.
  ASSERT_EQ(Run({"chart", "ABC", "--out", home.path() + "/a.cht"}).code, 0);
  const ProgramResult result = RunProgram(
      "/bin/sh", {"-c", "mkdir " + home.path() + "/gone && cd " + home.path() + "/gone && rmdir " +
                            home.path() + "/gone && exec " + program + "play " + home.path() +
                            "/a.cht --out " + home.path() + "/a.png"});
  EXPECT_EQ(result.code, 0) << result.err;
}

TEST_F(KoractlTest, AnEmptyNameIsNoFileAndNoHome) {
  MakeHome();
  ExpectUsage({"play", "", "--out", home.path() + "/a.png"}, "An empty name is no file");
  const ProgramResult nowhere = RunProgram(BinDir() + "/koractl", {"--home", "", "names"});
  EXPECT_EQ(nowhere.code, 2);
  EXPECT_NE(nowhere.err.find("--home: an empty name is no folder"), std::string::npos);
  ExpectAbandoned({"print", "", "--out", home.path() + "/a.pdf"}, kNoFile);
}

TEST_F(KoractlTest, AnOverrideThatASettingCantHoldIsRefused) {
  MakeHome();
  ExpectUsage({"names", "--set", "KoraPaths.ChtData=c:\\" + std::string(60, 'x')},
              "is longer than 60 characters");
  ExpectUsage({"names", "--set", "OscDef.CompFile=\u4E2D"}, "has characters that the settings");
}

TEST_F(KoractlTest, InitThatCantWriteFailsAndLeavesNoSettings) {
  // A limit on the size of files stands for a full disk.
  const ProgramResult result = RunProgram(
      "/bin/sh", {"-c", "ulimit -f 0; trap '' XFSZ; exec " + BinDir() + "/koractl --home " +
                            home.path() + "/kora init 2>" + "/dev/null"});
  EXPECT_EQ(result.code, 1);
  EXPECT_FALSE(home.Exists("kora/Kora.ini"));
}

TEST_F(KoractlTest, OverridesHoldForOneRun) {
  MakeHome();
  const std::string ini = home.Get("kora/Kora.ini");
  home.Put("kora/drive_c/other/Names.dat", "");
  EXPECT_EQ(Run({"--set", "KoraPaths.ChtData=c:\\other\\", "find", "ABC"}).err, kNoFile);
  EXPECT_EQ(Run({"find", "ABC", "--set", "koraPATHS.chtdata=c:\\other\\"}).err, kNoFile);
  EXPECT_EQ(home.Get("kora/Kora.ini"), ini);
  EXPECT_EQ(Run({"find", "ABC"}).code, 0);
  for (const char* text : {"", "x", "A=b", ".k=v", "A.=v", "A.b"}) {
    ExpectUsage({"--set", text, "names"}, "--set");
    ExpectUsage({"--set", text, "scale", "--high", "2", "--low", "1"}, "--set");
  }
}

TEST_F(KoractlTest, AnOverrideIsNotWrittenWhereTheFoldersAreSaved) {
  MakeHome();
  std::string ini = home.Get("kora/Kora.ini");
  const size_t at = ini.find("System=c:\\korawin\\");
  ini.replace(at, std::string("System=c:\\korawin\\").size(), "System=");
  home.Put("kora/Kora.ini", ini);
  // The program folder is looked for, and all folders are saved.
  EXPECT_EQ(
      Run({"--set", "Download.DataService=3", "--set", "Download.DLPath=z:\\away", "find", "ABC"})
          .code,
      0);
  const std::string after = home.Get("kora/Kora.ini");
  EXPECT_NE(after.find("System=C:\\korawin\\"), std::string::npos) << after;
  EXPECT_NE(after.find("DataService=4"), std::string::npos) << after;
  EXPECT_EQ(after.find("away"), std::string::npos);
}

TEST_F(KoractlTest, CommandLinesThatAreWrong) {
  ExpectUsage({}, "subcommand");
  ExpectUsage({"nosuch"}, "There is no command \"nosuch\"");
  ExpectUsage({"demo", "--seed", "-1"}, "--seed");
  ExpectUsage({"names", "more"}, "");
  ExpectUsage({"--answer", "perhaps", "names"}, "--answer");
  ExpectUsage({"print"}, "");
  const ProgramResult help = Run({"--help"});
  EXPECT_EQ(help.code, 0);
  EXPECT_NE(help.out.find("Usage: koractl"), std::string::npos);
}

TEST_F(KoractlTest, ImportTellsWhatItTookAndWhatNot) {
  MakeHome();
  home.Put("two.csv", "Date,Code,Close\n2024-01-09,ABC,7\n2024-01-10,ABC,8\n2024-01-10,DEF,9\n");
  EXPECT_EQ(Out({"import", home.path() + "/two.csv"}),
            "2 securities, 2 rows added, 1 replaced, 0 refused\n");
  home.Put("bad.csv", "Date,Close\n2024-01-10,x\n2024-01-11,1\n");
  const ProgramResult bad = Run({"import", home.path() + "/bad.csv", home.path() + "/two.csv"});
  EXPECT_EQ(bad.code, 1);
  EXPECT_EQ(bad.out, "2 securities, 0 rows added, 3 replaced, 2 refused\n");
  EXPECT_NE(bad.err.find("[Import] " + home.path() + "/bad.csv line 2: "), std::string::npos);
  EXPECT_FALSE(home.Exists("kora/" + kHostData + "BAD.WDT"));
  EXPECT_EQ(Out({"import", "--skip-bad", home.path() + "/bad.csv"}),
            "1 securities, 1 rows added, 0 replaced, 1 refused\n");
  home.Put("eu.csv", "Date;Close\n1/2/2024;1\n");
  EXPECT_EQ(Out({"import", home.path() + "/eu.csv", "--dates", "D/M/YYYY", "--code", "xx", "--type",
                 "5", "--name", "Europe"}),
            "1 securities, 1 rows added, 0 replaced, 0 refused\n");
  EXPECT_NE(Out({"prices", "XX"}).find("20240201"), std::string::npos);
  EXPECT_NE(Out({"names"}).find("XX\t5\tEurope"), std::string::npos);
}

TEST_F(KoractlTest, ImportOptionsThatMakeNoSense) {
  MakeHome();
  const std::string file = home.path() + "/abc.csv";
  ExpectUsage({"import"}, "FILE");
  ExpectUsage({"import", file, "--type", "6"}, "--type");
  ExpectUsage({"import", file, "--dates", "m/d/yyyy"}, "--dates");
  for (const char* code : {"..\\X", "A/B", "C:", "NUL", "TOOLONG"})
    ExpectUsage({"import", file, "--code", code}, "--code");
  ExpectUsage({"import", file, "--name", "Commas, Inc"}, "--name");
  ExpectUsage({"import", file, "--name", std::string(36, 'x')}, "--name");
  ExpectUsage({"import", file, file, "--name", "One"}, "--name");
}

// Real prices, compared by a reading of their own: every field of every row as text.
TEST_F(KoractlTest, RealPricesComeBackAsTheyWere) {
  if (!std::filesystem::is_directory(DataDir())) GTEST_SKIP() << "no real prices here";
  ASSERT_EQ(Run({"init"}).code, 0);
  Words words{"import"};
  std::vector<std::filesystem::path> sources;
  for (const auto& entry : std::filesystem::directory_iterator(DataDir()))
    if (entry.path().extension() == ".csv") sources.push_back(entry.path());
  ASSERT_FALSE(sources.empty());
  for (const auto& source : sources) words.push_back(source.string());
  const std::string summary = Out(words);
  int rows = 0;
  for (const auto& source : sources) {
    std::ifstream in(source);
    std::string line, expected = "Rec\tDate\tOpen\tHigh\tLow\tClose\tVolume\tAdjFactor\tAdjDesc\n";
    for (int n = 1; std::getline(in, line); ++n, ++rows) {
      while (!line.empty() && line.back() == '\r') line.pop_back();
      std::string row = line.substr(line.find(',') + 1);
      std::replace(row.begin(), row.end(), ',', '\t');
      expected += std::to_string(n) + "\t" + row + "\t\n";
    }
    EXPECT_TRUE(Out({"prices", source.stem().string()}) == expected) << source;
    EXPECT_EQ(Run({"chart", source.stem().string(), "--out", "-"}).code, 0);
  }
  EXPECT_EQ(summary, std::to_string(sources.size()) + " securities, " + std::to_string(rows) +
                         " rows added, 0 replaced, 0 refused\n");
}
