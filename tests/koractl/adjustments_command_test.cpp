#include <gtest/gtest.h>

#include "base/text.h"
#include "store/price_rec.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

const std::string kData = "kora/drive_c/korawin/data/";

class AdjustmentsCommand : public testing::Test {
 protected:
  AdjustmentsCommand() {
    EXPECT_EQ(Plain({"init"}).code, 0);
    home.Put(kData + "Names.dat", Bytes<NameRec>({Security("BHP"), Security("ORE")}));
    for (const char* code : {"BHP", "ORE"})
      home.Put(kData + code + ".WDT",
               Bytes<PriceRec>({Day("20260105", 5, 5, 5, 5), Day("20260106", 5, 5, 5, 5),
                                Day("20260107", 5, 5, 5, 5)}));
    home.Put("kora/drive_c/in/07JAN26.Asx.Btn",
             "DC,ORE,ASX.STK,,N,\r\nBI,BHP,ASX.STK,,N,07JAN26,1,4\r\n");
    home.Put("kora/drive_c/out/keep", "");
  }
  ProgramResult Plain(std::vector<std::string> words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(BinDir() + "/koractl", words);
  }
  ProgramResult Run(std::vector<std::string> words) {
    words.insert(words.begin(), {"--set", "Download.DataService=1", "--set", "Download.In=c:\\in\\",
                                 "--set", "Download.Out=c:\\out\\"});
    return Plain(words);
  }
  std::string List() { return home.Get(kData + "Adjust.Lst"); }

  TempHome home;
};

TEST_F(AdjustmentsCommand, TakesBulletinsOnceAndShowsTheList) {
  EXPECT_EQ(Run({"bulletins", "07JAN26"}).out, "# Added=2\n");
  EXPECT_EQ(Run({"bulletins", "07JAN26"}).out, "# Added=0\n");
  EXPECT_EQ(Run({"adjustments"}).out,
            "Act\tCode\tFile\tColumn4\tADJ\tName\tColumn7\tColumn8\tColumn9\tColumn10\n"
            "DC\tORE\t07JAN26\t\tY\t\t\t\t\t\n"
            "BI\tBHP\t07JAN26\t\tN\t07JAN26\t1\t4\t\t\n");
}

TEST_F(AdjustmentsCommand, WorksOnTheListAndCarriesItOut) {
  Run({"bulletins", "07JAN26"});
  EXPECT_EQ(Run({"adjustments", "sort"}).code, 0);
  EXPECT_EQ(List().substr(0, 6), "BI,BHP");
  EXPECT_EQ(Run({"adjustments", "set", "y"}).code, 0);
  EXPECT_EQ(List(), "BI,BHP,07JAN26,,Y,07JAN26,1,4\r\nDC,ORE,07JAN26,,Y,\r\n");
  const ProgramResult made = Run({"adjustments", "make"});
  EXPECT_EQ(made.code, 0) << made.err;
  EXPECT_EQ(List(), "");
  EXPECT_NE(Plain({"prices", "BHP"}).out.find("2\t20260106\t4\t4\t4\t4\t0\t0.8\tbi\n"),
            std::string::npos);
  EXPECT_EQ(home.Get(kData + "Names.dat").size(), 96u);
  EXPECT_TRUE(home.Exists(kData + "ORE.OLD"));
}

TEST_F(AdjustmentsCommand, MarksAndRemoves) {
  home.Put(kData + "Adjust.Lst", "BI,A,OPT\r\nBI,B,WNT\r\nBI,C,x\r\n");
  EXPECT_EQ(Run({"adjustments", "mark-options"}).code, 0);
  EXPECT_EQ(Run({"adjustments", "remove-done"}).code, 0);
  EXPECT_EQ(List(), "BI,B,WNT\r\nBI,C,x\r\n");
  EXPECT_EQ(Run({"adjustments", "mark-warrants"}).code, 0);
  EXPECT_EQ(List(), "BI,B,WNT,,D\r\nBI,C,x\r\n");
}

TEST_F(AdjustmentsCommand, ARowThatFailsIsToldAndExitsWithOne) {
  home.Put(kData + "Adjust.Lst", "BI,BHP,x,,Y,07JAN26,1,99999999999999999999\r\n");
  const ProgramResult made = Run({"adjustments", "make"});
  EXPECT_EQ(made.code, 1);
  EXPECT_NE(made.err.find("BHP: Overflow"), std::string::npos);
  EXPECT_EQ(List(), "BI,BHP,x,,Y,07JAN26,1,99999999999999999999\r\n");
}

TEST_F(AdjustmentsCommand, WrongWordsAreUsage) {
  EXPECT_EQ(Run({"adjustments", "set", "Q"}).code, 2);
  EXPECT_EQ(Run({"adjustments", "what"}).code, 2);
  EXPECT_EQ(Run({"bulletins"}).code, 2);
}

}  // namespace
}  // namespace kora::test
