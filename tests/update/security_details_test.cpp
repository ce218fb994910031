#include "update/security_details.h"

#include "tests/support/mutate.h"
#include "tests/update/update_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class DetailsTest : public UpdateFixture {
 protected:
  DetailsTest() {
    settings.download.ServiceSystem = "c:\\sys\\";
    settings.download.ServiceIn = "c:\\in\\";
    home.files().MakeFolder("c:\\sys");
    home.files().MakeFolder("c:\\in");
  }
  void Take(std::string_view text) {
    home.Put("drive_c/in/SecurityDetails.Asx.Stk", text);
    UpdateSecurityDetails(home.files(), settings.download);
  }
  std::string Sys(const std::string& name) { return home.Get("drive_c/sys/" + name); }
};

}  // namespace

TEST_F(DetailsTest, TakesTheFileIntoTheStore) {
  EXPECT_FALSE(KoraDetailsReady(home.files(), settings.download));
  Take(
      "Code|ShortDescription|PARVALUE|My Name\r\nBHP|Big Hole|1.00|x\r\nBHP|second|2\r\n"
      "ORE|Ore|3|y\r\nX|dropped\r\n|none\r\nno delimiter\r\nABCDEFGH|long");
  EXPECT_EQ(Sys("STKHeader.txt"), "4\r\nCODE\r\nDescription\r\nPar Value\r\nMY NAME\r\n");
  const std::string store = Sys("SecurityDetails.Stx");
  ASSERT_EQ(store.size(), 4u * 312);
  EXPECT_EQ(store.substr(0, 312), "BHP   " + PadRight("Big Hole|1.00|x", 306));
  EXPECT_EQ(store.substr(3 * 312, 10), "ABCDEFlong");
  EXPECT_EQ(Sys("Sdix1.inx"), "BHP,1\r\nORE,3\r\nABCDEF,4\r\n");
  EXPECT_FALSE(home.Exists("drive_c/in/SecurityDetails.Asx.Stk"));
  EXPECT_TRUE(home.Exists("drive_c/in/SecurityDetails.Asx.Bak"));
  EXPECT_TRUE(KoraDetailsReady(home.files(), settings.download));
}

TEST_F(DetailsTest, TheDelimiterIsTheFirstOddCharacterOfTheHeader) {
  Take("Code Of_It;Name,2\r\nBHP;a,b;c\r\n");
  EXPECT_EQ(Sys("STKHeader.txt"), "2\r\nCODE OF_IT\r\nNAME,2\r\n");
  EXPECT_EQ(Sys("SecurityDetails.Stx").substr(0, 11), "BHP   a,b;c");
}

TEST_F(DetailsTest, AHeaderWithoutDelimiterChangesNothing) {
  Take("CODE\r\nBHP|x\r\n");
  EXPECT_EQ(Sys("STKHeader.txt"), "");
  EXPECT_TRUE(home.Exists("drive_c/in/SecurityDetails.Asx.Stk"));
  Take("");
  EXPECT_FALSE(KoraDetailsReady(home.files(), settings.download));
}

TEST_F(DetailsTest, DoesNothingWithoutFileOrFolder) {
  UpdateSecurityDetails(home.files(), settings.download);
  settings.download.ServiceSystem = "unknown";
  Take("A|B\r\nBHP|x\r\n");
  EXPECT_FALSE(home.Exists("drive_c/sys/STKHeader.txt"));
  settings.download.ServiceSystem = "c:\\nowhere\\";
  UpdateSecurityDetails(home.files(), settings.download);
  EXPECT_TRUE(home.Exists("drive_c/in/SecurityDetails.Asx.Stk"));
}

TEST_F(DetailsTest, AFullDiskLeavesTheOldStore) {
  Take("A|B\r\nBHP|old\r\n");
  const std::string old = Sys("SecurityDetails.Stx");
  home.Put("drive_c/in/SecurityDetails.Asx.Stk", "A|B\r\nBHP|new\r\n");
  for (int at = 1;; ++at) {
    io.Reset(at);
    io.lasting = true;
    UpdateSecurityDetails(home.files(), settings.download);
    const bool cut = io.calls >= at;
    io.Reset();
    if (!cut) break;
    const std::string now = Sys("SecurityDetails.Stx");
    EXPECT_EQ(now.size(), 312u);
    EXPECT_TRUE(home.Exists("drive_c/in/SecurityDetails.Asx.Stk")) << at;
  }
  EXPECT_NE(Sys("SecurityDetails.Stx"), old);
}

TEST_F(DetailsTest, AFailureAtAnyWriteLeavesHeaderStoreAndIndexTogether) {
  Take("A|B\r\nBHP|old\r\n");
  const auto before = Everything();
  for (int at = 1;; ++at) {
    home.Put("drive_c/in/SecurityDetails.Asx.Stk", "A|B|C\r\nAMC|new\r\nBHP|new\r\n");
    io.Reset(at);
    UpdateSecurityDetails(home.files(), settings.download);
    const bool cut = io.calls >= at;
    io.Reset();
    if (!cut) break;
    const bool took = Sys("STKHeader.txt")[0] == '3';
    EXPECT_EQ(Sys("SecurityDetails.Stx").size(), took ? 624u : 312u) << at;
    EXPECT_EQ(Sys("Sdix1.inx"), took ? "AMC,1\r\nBHP,2\r\n" : "BHP,1\r\n") << at;
    EXPECT_TRUE(home.Exists("drive_c/in/SecurityDetails.Asx.Stk")) << at;
  }
  EXPECT_EQ(Sys("Sdix1.inx"), "AMC,1\r\nBHP,2\r\n");
  EXPECT_EQ(Everything().size(), before.size());
}

TEST_F(DetailsTest, ACodeThatComesAgainIsIndexedAtEachChange) {
  Take("A|B\r\nBHP|1\r\nORE|2\r\nBHP|3\r\n");
  EXPECT_EQ(Sys("Sdix1.inx"), "BHP,1\r\nORE,2\r\nBHP,3\r\n");
}

TEST_F(DetailsTest, EachNameOfTheServiceHasItsLabel) {
  const std::pair<const char*, const char*> labels[] = {
      {"SHORTDESCRIPTION", "Description"},
      {"SECURITYTYPE", "Type"},
      {"FIRSTACTIVEDATE", "First Active"},
      {"FIRSTQUOTEDDATE", "First Quoted"},
      {"LASTQUOTEDATE", "Last Quoted"},
      {"SUSPENSIONSTARTDATE", "Suspension Start"},
      {"SUSPENSIONENDDATE", "Suspension End"},
      {"TOTALCLASSISSUE", "Total Issued"},
      {"PARVALUE", "Par Value"},
      {"PAIDUPVALUE", "Paid Value"},
      {"ASSETBACKING", "Asset backing"},
      {"DIVENDRATEPERSHARE", "DPS"},
      {"DIVIDENDSPAIDMONTHS", "Div. Mths"},
      {"CURRENTDIVIDENDAMOUNT", "Current Div"},
      {"DIVIDENTTYPE", "Div. Type"},
      {"DIVIDENDPAYABLEDATE", "Div. Payable  "},
      {"EXDATE", "Ex Div Date"},
      {"FRANKINGPERCENT", "Franking %"},
      {"CLASSAFRANKEDAMOUNT", "Class A Franked $"},
      {"CLASSBFRANKEDAMOUNT", "Class B Franked $"},
      {"CLASSCFRANKEDAMOUNT", "Class C Franked $"},
      {"GROSSDIVIDENDAMOUNT", "Gross Div."},
      {"MINAPPLICATIONMONEY", "Min. Applic.Money"},
      {"MAXAPPLICATIONMONEY", "Max Applic. Money"},
      {"APPLICATIONCLOSEDATE", "Applic.Close"},
      {"QUOTEDSECURITYINDICATOR", "Security Ind."},
      {"STAMPDUTYINDICATOR", "Stamp Duty Ind."},
      {"SHORTSELLINDICATOR", "Short Sell Ind."},
      {"PARIPASSUINDICATOR", "Pari Passu Ind."},
      {"ANNUALDIVIDENDRATE", "Annual Dividend"}};
  std::string header, wanted = std::to_string(std::size(labels)) + "\r\n";
  for (const auto& [name, label] : labels) {
    header += (header.empty() ? "" : "\t") + LCase(name);
    wanted += std::string(label) + "\r\n";
  }
  Take(header + "\r\n");
  EXPECT_EQ(Sys("STKHeader.txt"), wanted);
}

TEST_F(DetailsTest, AHeaderInAnotherAlphabetChangesNothing) {
  Take("A|B\r\nBHP|old\r\n");
  const std::string store = Sys("SecurityDetails.Stx");
  for (const std::string& text : {std::string("\xFF\xFE"
                                              "A\0|\0",
                                              6),
                                  std::string("A\0|\0B\0", 6),
                                  std::string("A\x01"
                                              "B\n"),
                                  std::string("A\xA6"
                                              "B\n"),
                                  std::string(1 << 20, 'A')}) {
    Take(text);
    EXPECT_EQ(Sys("SecurityDetails.Stx"), store);
    EXPECT_TRUE(home.Exists("drive_c/in/SecurityDetails.Asx.Stk"));
  }
  Take(
      "\xEF\xBB\xBF"
      "A|B\nBHP|new\n");
  EXPECT_EQ(Sys("STKHeader.txt"), "2\r\nA\r\nB\r\n");
}

TEST_F(DetailsTest, MoreCodesThanThereAreSecuritiesChangeNothing) {
  Take("A|B\r\nBHP|old\r\n");
  const std::string store = Sys("SecurityDetails.Stx");
  std::string text = "A|B\n";
  for (int i = 0; i <= 200'000; ++i) text += "AB|\n";
  Take(text);
  EXPECT_EQ(Sys("SecurityDetails.Stx"), store);
  std::filesystem::resize_file(home.path() + "/drive_c/in/SecurityDetails.Asx.Stk", 65u << 20);
  UpdateSecurityDetails(home.files(), settings.download);
  EXPECT_EQ(Sys("SecurityDetails.Stx"), store);
}

TEST_F(DetailsTest, DamagedFilesLeaveWholeRecordsAndAnIndexIntoThem) {
  Mutator(12).Run(
      {"Code|ShortDescription|PARVALUE\r\nBHP|Big Hole|1.00\r\nORE|Ore|3\r\n", "", "|||\n|||\n|||"},
      150, [&](const std::string& text) {
        Take(text);
        const std::string store = Sys("SecurityDetails.Stx");
        ASSERT_EQ(store.size() % 312, 0u);
        for (size_t at = 0; at < store.size(); at += 312) EXPECT_NE(store[at], ' ');
      });
}

TEST_F(DetailsTest, TheUpdateOfServicesOneAndThreeTakesThem) {
  home.Put("drive_c/in/SecurityDetails.Asx.Stk", "A|B\r\nBHP|x\r\n");
  ASSERT_EQ(UpdateFixture::Take("ORE,19980915,1,1,1,1,1,0\n"), UpdateEnd::kUpdated);
  EXPECT_FALSE(KoraDetailsReady(home.files(), settings.download));
  settings.download.DataService = 1;
  ASSERT_EQ(UpdateFixture::Take("ORE,19980916,1,1,1,1,1,0\n", "16SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_TRUE(KoraDetailsReady(home.files(), settings.download));
}
