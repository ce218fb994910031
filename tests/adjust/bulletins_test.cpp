#include "adjust/bulletins.h"

#include "store/market_folders.h"
#include "tests/adjust/adjust_fixture.h"

namespace kora {
namespace {

using test::kHostIn;
using test::kHostOut;

const BulletinRules kPlain{.baseName = "15SEP98", .OptionsFolderOK = true};

std::string Merged(std::string_view line, const BulletinRules& rules = kPlain) {
  return MergeBulletinLine(line, rules).value_or("(left out)");
}

// ---- A line

TEST(BulletinLineTest, KeepsDeviceNamesUnderTheirOtherCodes) {
  EXPECT_EQ(Merged("BI,AUX,SFE.FUT,,N"), "BI,1AUX,SFE,,N");
  EXPECT_EQ(Merged("BI,prn,SFE.FUT,,N"), "BI,PRNX,SFE,,N");
}

TEST(BulletinLineTest, NamesTheFirstMarketAlone) {
  EXPECT_EQ(Merged("BI,ORE,SUM,,N"), "BI,ORE,15SEP98,,N");
  EXPECT_EQ(Merged("BI,ORE,ASX.STK,,N"), "BI,ORE,15SEP98,,N");
  EXPECT_EQ(Merged("BI,ORE,ASX.OPT,,N"), "BI,ORE,OPT,,N");
  EXPECT_EQ(Merged("BI,ORE,ASX.IDX,,N"), "BI,ORE,IDX,,N");
  EXPECT_EQ(Merged("BI,ORE,ASX.WNT,,N"), "BI,ORE,WNT,,N");
  EXPECT_EQ(Merged("BI,ORE,SFE.FUT,,N"), "BI,ORE,SFE,,N");
  EXPECT_EQ(Merged("BI,ORE,WCM.OVS,,N"), "BI,ORE,OVS,,N");
  EXPECT_EQ(Merged("BI,ORE,WCM.OVS,SUM,N"), "BI,ORE,WCM.OVS,15SEP98,N");
}

TEST(BulletinLineTest, LeavesOptionsOutWithoutTheirFolder) {
  BulletinRules rules = kPlain;
  rules.OptionsFolderOK = false;
  EXPECT_EQ(Merged("BI,ORE,ASX.OPT,,N", rules), "(left out)");
  EXPECT_EQ(Merged("BI,ORE,ASX.STK,,N", rules), "BI,ORE,15SEP98,,N");
}

TEST(BulletinLineTest, LeavesWarrantsOut) {
  BulletinRules rules = kPlain;
  rules.NoWarrants = true;
  EXPECT_EQ(Merged("BI,ORE,ASX.WNT,,N", rules), "(left out)");
  for (const char letter : std::string("WIEXDS"))
    EXPECT_EQ(Merged("BI,ORE" + std::string(1, letter) + "AB,SUM,,N", rules), "(left out)");
  EXPECT_EQ(Merged("BI,ORECAB,SUM,,N", rules), "BI,ORECAB,15SEP98,,N");
  EXPECT_EQ(Merged("BI,OREWA,SUM,,N", rules), "BI,OREWA,15SEP98,,N");  // five letters
  EXPECT_EQ(Merged("BI,OREWAB,SUM,,N"), "BI,OREWAB,15SEP98,,N");
}

TEST(BulletinLineTest, LeavesShortNamesAndDeletedOnesOut) {
  BulletinRules rules = kPlain;
  EXPECT_EQ(Merged("NI,ORE,SUM,,N,DELETE THIS ONE,010", rules), "(left out)");
  EXPECT_EQ(Merged("NI,ORE,SUM,,N,ORE MINING,010", rules), "NI,ORE,15SEP98,,N,ORE MINING,010");
  rules.NoShortNames = true;
  EXPECT_EQ(Merged("NI,ORE,SUM,,N,ORE MINING,010", rules), "(left out)");
}

TEST(BulletinLineTest, MarksRemovalsAndListings) {
  EXPECT_EQ(Merged("DC,ORE,SUM,,N,15SEP98,N"), "DC,ORE,15SEP98,,Y,15SEP98,N");
  EXPECT_EQ(Merged("DC,N,SUM,,N,"), "DC,Y,15SEP98,,N,");  // the first, whatever it is
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,GOLD MINES,010"), "NL,ORE,15SEP98,,Y,GOLD MINES,010");
}

TEST(BulletinLineTest, AustraliaLimitedIsAustLtdWithAClosingBlank) {
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,AUSTRALIA LIMITED"), "NL,ORE,15SEP98,,Y,AUST LTD ");
}

TEST(BulletinLineTest, TheCharacterBehindAWordGoesWithItACommaToo) {
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,GOLD LIMITED,010"), "NL,ORE,15SEP98,,Y,GOLD LTD 010");
}

TEST(BulletinLineTest, ShortensEachWordOnceInOrder) {
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,AAA INTERNATIONAL EXPLORATION CORPORATION ENDOWMENT INSTALMENT "
                   "LIMITED LIMITED x"),
            "NL,ORE,15SEP98,,Y,AAA INTER EXP CORP ENDOW INSTAL LTD LIMITED x");
}

TEST(BulletinLineTest, TakesBanksOutInTheirOrder) {
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,UBS WARBURG x"), "NL,ORE,15SEP98,,Y,UBS x");
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,MACQUARIE BANK x MACQUARIE y"), "NL,ORE,15SEP98,,Y,x y");
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,SG AUSTRALIA x"), "NL,ORE,15SEP98,,Y,x");  // "SG AUST "
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,GOLD WARRANTS WARR 99"), "NL,ORE,15SEP98,,Y,GOLD  99");
}

TEST(BulletinLineTest, AWarrantLosesTheCodeOfItsShare) {
  //                      5th comma   v          4 places on
  EXPECT_EQ(Merged("NL,OREWAB,SUM,,N,GOLD ORE CALL,099"), "NL,OREWAB,15SEP98,,Y,GOLD CALL,099");
  EXPECT_EQ(Merged("NL,OREWAB,SUM,,N,G ORE CALL,099"), "NL,OREWAB,15SEP98,,Y,G ORE CALL,099");
  EXPECT_EQ(Merged("NL,ORE,SUM,,N,GOLD ORE CALL,099"), "NL,ORE,15SEP98,,Y,GOLD ORE CALL,099");
}

TEST(BulletinLineTest, DividendsGoByTheOption) {
  BulletinRules rules = kPlain;
  const char* line = "DI,ORE,SUM,,N,15SEP98,,,25";
  for (const auto& [divs, mark] :
       std::map<int, std::string>{{2, "Y"}, {3, "N"}, {4, "D"}, {0, "N"}}) {
    rules.Divs = std::int16_t(divs);
    EXPECT_EQ(Merged(line, rules), "DI,ORE,15SEP98,," + mark + ",15SEP98,,,25");
  }
  rules.Divs = 1;
  EXPECT_EQ(Merged(line, rules), "(left out)");
}

TEST(BulletinLineTest, OddLinesAreCarriedAsTheyStand) {
  const std::string large(1 << 20, 'x');
  for (const std::string& line : {std::string("NL"), std::string("DC,"), std::string("\xEF\xBB"),
                                  "BI," + large, std::string("NL,OREWAB"), std::string("\"BI\",x")})
    EXPECT_EQ(Merged(line), line);
}

// ---- The files of a day

class BulletinsTest : public test::AdjustTest {
 protected:
  int Check(const std::string& base = "15SEP98") {
    return CheckBulletins(home.files(), settings, test::kData, base, progress);
  }
};

TEST_F(BulletinsTest, TakesAllFourInTheirOrderAndCopiesThem) {
  home.Put(kHostIn + "15SEP98.Btn", "DC,DDD,SUM,,N,\r\n");
  home.Put(kHostIn + "15SEP98.Asx.Btn", "DC,AAA,ASX.STK,,N,\r\nBI,AAB,SUM,,N,15SEP98,1,4\r\n");
  home.Put(kHostIn + "15SEP98.Sfe.Btn", "DC,BBB,SFE.FUT,,N,\n");
  home.Put(kHostIn + "15SEP98.Wcm.Btn", "DC,CCC,WCM.OVS,,N,");
  EXPECT_EQ(Check(), 5);
  EXPECT_EQ(List(),
            "DC,AAA,15SEP98,,Y,\r\nBI,AAB,15SEP98,,N,15SEP98,1,4\r\nDC,BBB,SFE,,Y,\r\n"
            "DC,CCC,OVS,,Y,\r\nDC,DDD,15SEP98,,Y,\r\n");
  EXPECT_EQ(home.Get(kHostOut + "15SEP98.Btx"), "DC,DDD,SUM,,N,\r\n");
  EXPECT_TRUE(home.Exists(kHostOut + "15SEP98.Asx.Btx"));
  EXPECT_TRUE(home.Exists(kHostOut + "15SEP98.Sfe.Btx"));
  EXPECT_TRUE(home.Exists(kHostOut + "15SEP98.Wcm.Btx"));
  EXPECT_EQ(progress.notes,
            (std::vector<std::string>{"Checking and updating adjustments list.", ""}));
}

TEST_F(BulletinsTest, ABulletinRunTwiceAddsItsLinesOnce) {
  home.Put(kHostIn + "15SEP98.Btn", "DC,AAA,SUM,,N,\r\n");
  EXPECT_EQ(Check(), 1);
  EXPECT_EQ(Check(), 0);
  EXPECT_EQ(List(), "DC,AAA,15SEP98,,Y,\r\n");
}

TEST_F(BulletinsTest, AnEmptyBulletinIsLookedAtAgain) {
  home.Put(kHostIn + "15SEP98.Btn", "");
  EXPECT_EQ(Check(), 0);
  EXPECT_FALSE(home.Exists(kHostOut + "15SEP98.Btx"));
  home.Put(kHostIn + "15SEP98.Btn", "DC,AAA,SUM,,N,\r\n");
  EXPECT_EQ(Check(), 1);
}

TEST_F(BulletinsTest, AppendsToWhatIsOnTheList) {
  home.Put(test::kHostData + "Adjust.Lst", "BI,OLD");  // no line end
  home.Put(kHostIn + "15SEP98.Btn",
           "\xEF\xBB\xBF"
           "DC,AAA,SUM,,N,\r\n\r\n");
  EXPECT_EQ(Check(), 1);
  EXPECT_EQ(List(), "BI,OLD\r\nDC,AAA,15SEP98,,Y,\r\n");
}

TEST_F(BulletinsTest, DoesNothingWithoutItsFolders) {
  home.Put(kHostIn + "15SEP98.Btn", "DC,AAA,SUM,,N,\r\n");
  for (const char* folder : {"", "unknown"}) {
    settings.download.ServiceOut = folder;
    EXPECT_EQ(Check(), 0);
  }
  EXPECT_TRUE(progress.notes.empty());
  EXPECT_FALSE(There("Adjust.Lst"));
}

TEST_F(BulletinsTest, OptionsNeedAFolderWithMoreThanTenNames) {
  home.Put(kHostIn + "15SEP98.Btn", "DC,AAA,ASX.OPT,,N,\r\n");
  WmPaths lines;
  lines[kWmOptions] = "c:\\opt\\";
  WriteWmPaths(home.files(), "c:\\korawin\\", lines);
  home.Put("drive_c/opt/Names.dat", std::string(10 * 96, ' '));
  EXPECT_EQ(Check(), 0);
  home.files().Remove("c:\\bul\\out\\15SEP98.Btx");
  home.Put("drive_c/opt/Names.dat", std::string(11 * 96, ' '));
  EXPECT_EQ(Check(), 1);
  lines[kWmOptions] = "\\KORAWIN\\DATA\\";
  WriteWmPaths(home.files(), "c:\\korawin\\", lines);
  home.Put(test::kHostData + "Names.dat", std::string(20 * 96, ' '));
  home.files().Remove("c:\\bul\\out\\15SEP98.Btx");
  EXPECT_EQ(Check(), 0);
}

TEST_F(BulletinsTest, ABulletinThatCanNotBeTakenWaitsForTheNextRun) {
  home.Put(kHostIn + "15SEP98.Btn", "DC,AAA,SUM,,N,\r\n");
  home.Put(test::kHostData + "Adjust.Lst/x", "");  // a folder where the list would be
  EXPECT_EQ(Check(), 0);
  EXPECT_FALSE(home.Exists(kHostOut + "15SEP98.Btx"));
  EXPECT_EQ(progress.notes.back(), "");
}

// Killed at every write, a run that follows has the lines once, and the copy.
TEST_F(BulletinsTest, ARunThatDiesIsTakenUpWithoutALineLostOrTwice) {
  for (int at = 1;; ++at) {
    SCOPED_TRACE(at);
    test::FailingIo io;
    io.lasting = io.torn = true;
    test::TempHome dying(io);
    AdjustTest::Fill(dying);
    dying.Put(kHostIn + "15SEP98.Asx.Btn", "DC,AAA,SUM,,N,\r\n");
    dying.Put(kHostIn + "15SEP98.Btn", "DC,BBB,SUM,,N,\r\n");
    io.Reset(at);
    CheckBulletins(dying.files(), settings, test::kData, "15SEP98", progress);
    const bool whole = io.calls < at;
    Files again(dying.path());
    CheckBulletins(again, settings, test::kData, "15SEP98", progress);
    EXPECT_EQ(dying.Get(test::kHostData + "Adjust.Lst"),
              "DC,AAA,15SEP98,,Y,\r\nDC,BBB,15SEP98,,Y,\r\n");
    EXPECT_TRUE(dying.Exists(kHostOut + "15SEP98.Asx.Btx"));
    EXPECT_TRUE(dying.Exists(kHostOut + "15SEP98.Btx"));
    if (whole) break;
  }
}

}  // namespace
}  // namespace kora
