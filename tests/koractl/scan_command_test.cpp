// The scans and the statistics by koractl as a process.

#include <gtest/gtest.h>

#include <filesystem>

#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

namespace {

using Words = std::vector<std::string>;

// Four shares: AAA rises by a half, BBB falls by a half, CCC stands, DDD has no file.
class ScanCommand : public ::testing::Test {
 protected:
  const std::string kData = "kora/drive_c/korawin/data/";

  ScanCommand() {
    EXPECT_EQ(Run({"init"}).code, 0);
    const auto days = [](float before, float last) {
      std::vector<PriceRec> out;
      for (int i = 1; i <= 28; ++i) {
        const float c = i < 28 ? before : last;
        out.push_back(Day("202602" + std::string(i < 10 ? "0" : "") + std::to_string(i), c, c, c, c,
                          i < 28 ? 100 : 900));
      }
      return Bytes(out);
    };
    std::vector<NameRec> names{Security("AAA", 1, kShare, "121"), Security("BBB"), Security("CCC"),
                               Security("DDD")};
    names[0].Name.set("Alpha <Mines> & Sons");
    home.Put(kData + "Names.dat", Bytes(names));
    home.Put(kData + "AAA.WDT", days(2, 3));
    home.Put(kData + "BBB.WDT", days(4, 2));
    home.Put(kData + "CCC.WDT", days(1, 1));
  }

  ProgramResult Run(Words words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(BinDir() + "/koractl", words);
  }
  std::string ListZ() { return home.Get(kData + "SubListZ.Dat"); }

  TempHome home;
};

}  // namespace

TEST_F(ScanCommand, Scan1) {
  const ProgramResult run = Run({"scan1", "--rise", "10", "--fall", "10"});
  EXPECT_EQ(run.code, 0);
  EXPECT_EQ(run.out,
            "Code\tLast\tPercent\tStochastic\tWilliams\tROC\tMomentum\tRSI\tRec\n"
            "AAA\t3.00\t50%U\t\t\t\t\t\t1\n"
            "BBB\t2.00\t-50%D\t\t\t\t\t\t2\n");
  EXPECT_EQ(run.err,
            "[ Chart Scan] The codes have been stored in list Chart Scan Results List\n"
            " This list can be selected to view charts from the\n Chart Selection form.\n"
            "1 file could not be read\n");
  EXPECT_EQ(ListZ(), std::string("\1\0AAA   \2\0BBB   ", 16));
}

TEST_F(ScanCommand, Scan1SortsByTheTextOfThePercentages) {
  const ProgramResult run = Run({"scan1", "--rise", "10", "--fall", "10", "--sort"});
  EXPECT_EQ(run.code, 0);
  EXPECT_LT(run.out.find("BBB"), run.out.find("AAA"));
  EXPECT_EQ(ListZ(), std::string("\2\0BBB   \1\0AAA   ", 16));
}

TEST_F(ScanCommand, NoHitIsDoneAndLeavesTheListOfScan1) {
  home.Put(kData + "SubListZ.Dat", "12345678");
  const ProgramResult run = Run({"scan1", "--rise", "90"});
  EXPECT_EQ(run.code, 0);
  EXPECT_EQ(run.out.find("AAA"), std::string::npos);
  EXPECT_NE(run.err.find("There were no rises of 90%\n or Buy/Sell Indications "),
            std::string::npos);
  EXPECT_EQ(ListZ(), "12345678");
}

TEST_F(ScanCommand, Scan2) {
  const ProgramResult run = Run({"scan2", "--volume", "100", "--days", "5", "--price", "10"});
  EXPECT_EQ(run.code, 0);
  // The average of 5 days is six volumes of 100 by 5, twice that 240.
  EXPECT_EQ(run.out, "Code\tLast\tVolume\tPercent\nAAA\t3.00\t660\t50%\nBBB\t2.00\t660\t-50%\n");
  EXPECT_EQ(home.Get(kData + "ChtScan2.txt"),
            "AAA,121,3.00,Alpha <Mines> & Sons\r\nBBB,,2.00,\r\n");
  EXPECT_EQ(ListZ().size(), 16u);
  EXPECT_EQ(Run({"scan2", "--price", "90"}).code, 0);
  EXPECT_EQ(ListZ(), "");
}

TEST_F(ScanCommand, Scan3) {
  std::vector<PriceRec> days;
  for (const auto& [high, low] :
       {std::pair(10.f, 9.f), std::pair(11.f, 9.5f), std::pair(12.f, 10.5f), std::pair(13.f, 11.f),
        std::pair(12.f, 9.2f), std::pair(9.f, 8.f)})
    days.push_back(Day("20260227", low, high, low, low));
  home.Put(kData + "BBB.WDT", Bytes(days));
  const ProgramResult run = Run({"scan3", "--up", "--down"});
  EXPECT_EQ(run.code, 0);
  EXPECT_EQ(run.out, "Code\tLast\tBreak\nBBB\t8.00\tDOWN\n");
  EXPECT_EQ(Run({"scan3", "--up"}).out, "Code\tLast\tBreak\n");
}

TEST_F(ScanCommand, Stats) {
  const ProgramResult run = Run({"stats", "--top", "1"});
  EXPECT_EQ(run.code, 0);
  EXPECT_EQ(run.out,
            "Side\tCode\tName\tClass\tLatest\tPrevious\tPercent\n"
            "RISE\tAAA\tAlpha <Mines> & Sons\t121\t3.00\t2.00\t50.00 %\n"
            "FALL\tBBB\t\t\t2.00\t4.00\t-50.00 %\n"
            "# Rises=1 Falls=1 Steady=1 Traded=3 Untraded=0\n");
  EXPECT_NE(home.Get(kData + "Stats.dat").find("AAA\tAlpha"), std::string::npos);
  EXPECT_NE(Run({"stats", "--mode", "wo"}).out.find("Rises=0"), std::string::npos);
  EXPECT_EQ(Run({"stats", "--mode", "x"}).code, 2);
}

TEST_F(ScanCommand, WhatIsRefusedIsToldAndNothingIsStored) {
  home.Put(kData + "SubListZ.Dat", "12345678");
  for (const auto& [words, text] : std::vector<std::pair<Words, std::string>>{
           {{"scan1", "--fall", "10"}, "[Analysis] Percentage Not valid - Valid Range 1 to 200 \n"},
           {{"scan1", "--rise", "10", "--class", "x"},
            "[Chart Scan] Industry Classification ID must be numeric   eg 010\n"},
           {{"scan1", "--min", "5", "--max", "1"}, "[Analysis] Invalid price range\n"},
           {{"--set", "OscDef.StochK=0", "scan1", "--stochastic", "--ob"},
            "[Analysis] Invalid STOCHASTIC Oscillator Values. Correct the values in the CHART "
            "DEFAULTS List\n"},
           {{"scan2"}, "[Selection criteria] No selection made\n"},
           {{"scan2", "--max", "0"}, "[Closing Price Range] Price values invalid\n"},
           {{"scan3"},
            "[Break Parabolic] Either Look for break UP  or Look for break DOWN need to be "
            "selected\n"}}) {
    const ProgramResult run = Run(words);
    EXPECT_EQ(run.code, 1) << text;
    EXPECT_EQ(run.err, text);
    EXPECT_EQ(run.out, "");
    EXPECT_EQ(ListZ(), "12345678");
  }
  EXPECT_EQ(Run({"scan2", "--days", "5"}).code, 2);
}

TEST_F(ScanCommand, AReportIsOnePageWithEverythingInIt) {
  const std::string folder = home.path() + "/reports/tonight";
  const ProgramResult run =
      Run({"scan1", "--rise", "10", "--stochastic", "--cut-ob", "--report", folder});
  EXPECT_EQ(run.code, 0) << run.err;
  const std::string page = home.Get("reports/tonight/index.html");
  for (const char* part :
       {"<h1>Chart Scan 1</h1>", "Prices up to 28/2/2026", "<li>Percentage rise of 10 or more</li>",
        "<li>Oscillators: Stochastic</li>", "<a href=\"#chart-AAA\">AAA</a>",
        "Alpha &lt;Mines&gt; &amp; Sons", "src=\"data:image/png;base64,iVBOR",
        "prefers-color-scheme: dark", "1 file could not be read"})
    EXPECT_NE(page.find(part), std::string::npos) << part;
  // It needs nothing of the network and no script.
  for (const char* part : {"http:", "https:", "<script", "<link", "url("})
    EXPECT_EQ(page.find(part), std::string::npos) << part;
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder), {}), 1);
  // The same scan again leaves the same page.
  EXPECT_EQ(Run({"scan1", "--rise", "10", "--stochastic", "--cut-ob", "--report", folder}).code, 0);
  EXPECT_EQ(home.Get("reports/tonight/index.html"), page);
}

TEST_F(ScanCommand, AReportWithoutHitsSaysSo) {
  const std::string folder = home.path() + "/r";
  EXPECT_EQ(Run({"scan3", "--up", "--report", folder}).code, 0);
  const std::string page = home.Get("r/index.html");
  EXPECT_NE(page.find("No records for the criteria selected were found"), std::string::npos);
  EXPECT_EQ(page.find("<table"), std::string::npos);
}

TEST_F(ScanCommand, AReportThatCantBeWrittenIsTold) {
  home.Put("file", "x");
  const ProgramResult run = Run({"stats", "--report", home.path() + "/file"});
  EXPECT_EQ(run.code, 1);
  EXPECT_NE(run.err.find("index.html"), std::string::npos);
  EXPECT_EQ(home.Get("file"), "x");
}
