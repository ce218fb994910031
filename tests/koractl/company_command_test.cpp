#include <gtest/gtest.h>

#include <filesystem>

#include "base/text.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

namespace fs = std::filesystem;

class CompanyCommand : public testing::Test {
 protected:
  CompanyCommand() {
    EXPECT_EQ(Run({"init"}).code, 0);
    home.Put("kora/drive_c/dl/STKHeader.txt",
             "4\r\nASXCODE\r\nDescription\r\nCurrent Div\r\nDiv. Type\r\n");
    home.Put("kora/drive_c/dl/SecurityDetails.Stx",
             PadRight("BHP", 6) + PadRight("Broken Hill|0.5|FINAL", 306) + PadRight("CBA", 6) +
                 PadRight("Bank|1|INTERIM", 306));
    home.Put("kora/drive_c/dl/Sdix1.inx", "BHP,1\r\nCBA,2\r\n");
    NameRec bhp = Security("BHP", 1, kShare, "012");
    bhp.Name.set("Broken Hill Pty");
    home.Put("kora/drive_c/korawin/data/Names.dat", Bytes<NameRec>({bhp}));
    home.Put("kora/drive_c/korawin/data/BHP.WDT", Bytes<PriceRec>({Day("20260106", 1, 1, 1, 10)}));
  }
  ProgramResult Run(std::vector<std::string> words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(BinDir() + "/koractl", words);
  }
  ProgramResult Service(std::vector<std::string> words) {
    words.insert(words.begin(),
                 {"--set", "Download.DataService=1", "--set", "Download.System=c:\\dl\\"});
    return Run(words);
  }

  TempHome home;
};

TEST_F(CompanyCommand, CompanyShowsDescriptionsAndValues) {
  const ProgramResult result = Service({"company", "bhp"});
  EXPECT_EQ(result.code, 0) << result.err;
  EXPECT_EQ(result.out,
            "Description\tValue\nDescription\tBroken Hill\nCurrent Div\t0.5\nDiv. Type\tFINAL\n");
  EXPECT_EQ(Service({"company", "XYZ"}).code, 1);
}

TEST_F(CompanyCommand, YieldsHaveARowASecurityAndTellWhatHasNoPrice) {
  const ProgramResult result = Service({"yields"});
  EXPECT_EQ(result.code, 0) << result.err;
  EXPECT_EQ(
      result.out,
      "Code\tName\tInd Class\tLast Price\tPrice $\tYield %\tDescription\tCurrent Div\tDiv. Type\n"
      "BHP\tBroken Hill Pty\t012\t06/01/2026\t10.00\t5.00 %\tBroken Hill\t0.5\tFINAL\n"
      "CBA\t\t\t\t\t\tBank\t1\tINTERIM\n");
  EXPECT_NE(result.err.find("NO DATA FOR CBA"), std::string::npos);
  const ProgramResult one = Service({"yields", "--class", "012"});
  EXPECT_EQ(std::count(one.out.begin(), one.out.end(), '\n'), 2);
  EXPECT_EQ(Service({"yields", "--class", "12"}).code, 2);
}

TEST_F(CompanyCommand, WithoutTheServiceOrItsFilesThereIsNoData) {
  const ProgramResult other = Run({"yields"});
  EXPECT_EQ(other.code, 1);
  EXPECT_EQ(other.err, "[ASX Details] There is no fundamental data\n");
  fs::remove(home.path() + "/kora/drive_c/dl/Sdix1.inx");
  EXPECT_EQ(Service({"company", "BHP"}).code, 1);
}

TEST_F(CompanyCommand, SnapshotListsAreShownAndChanged) {
  EXPECT_EQ(Run({"snapshot", "2", "add", "bhp"}).code, 0);
  EXPECT_EQ(Run({"snapshot", "2", "add", "XAO", "--index"}).code, 0);
  EXPECT_EQ(home.Get("kora/drive_c/korawin/Snap2.Dat"), "BHP,S,,,\r\nXAO,I,,,\r\n");
  EXPECT_EQ(Run({"snapshot", "2", "remove", "BHP"}).code, 0);
  EXPECT_EQ(Run({"snapshot", "2", "remove", "BHP"}).code, 1);
  EXPECT_EQ(Run({"snapshot", "2"}).out,
            "Code\tLast\tBid\tAsk\tClose\tVolume\tTrade\tToday\tTag\tUnits\tUnitCost\tDividend\n"
            "XAO\t\t\t\t\t\t\t\tI\t\t\t\n");
  EXPECT_EQ(Run({"snapshot", "4"}).code, 2);
  EXPECT_EQ(Run({"snapshot", "1", "add", "../x"}).code, 2);
  for (int i = 0; i < 15; ++i)
    EXPECT_EQ(Run({"snapshot", "3", "add", "S" + std::to_string(i)}).code, 0);
  const ProgramResult full = Run({"snapshot", "3", "add", "X"});
  EXPECT_EQ(full.code, 1);
  EXPECT_NE(full.err.find("Maximum number of stocks for snapshot is 15"), std::string::npos);
}

TEST_F(CompanyCommand, ASnapshotIsFetchedThroughTheCommsProgram) {
  ASSERT_EQ(Run({"snapshot", "1", "add", "BHP"}).code, 0);
  const ProgramResult missing = Service({"snapshot", "1", "fetch"});
  EXPECT_EQ(missing.code, 1);
  EXPECT_NE(missing.err.find("Quickcomm.exe"), std::string::npos);
  const std::string program = "kora/drive_c/korawin/Quickcomm.exe";
  home.Put(program,
           "#!/bin/sh\nsed 's/^[SI],\\([^\\r]*\\).*/\\1,9.5,9.4,9.6,9.2,5000,12,0.3/' "
           "../dl/Snap.Snd > ../dl/Snap.Lst\n");
  fs::permissions(home.path() + "/" + program, fs::perms::owner_all);
  const ProgramResult fetched = Service({"snapshot", "1", "fetch"});
  EXPECT_EQ(fetched.code, 0) << fetched.err;
  EXPECT_NE(fetched.out.find("BHP\t9.5\t9.4\t9.6\t9.2\t5000\t12\t0.3\tS"), std::string::npos)
      << fetched.out;
}

}  // namespace
}  // namespace kora::test
