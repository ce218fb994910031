#include "update/security_details.h"

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
  Take("Code|ShortDescription|PARVALUE|My Name\r\nBHP|Big Hole|1.00|x\r\nBHP|second|2\r\n"
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

TEST_F(DetailsTest, TheUpdateOfServicesOneAndThreeTakesThem) {
  home.Put("drive_c/in/SecurityDetails.Asx.Stk", "A|B\r\nBHP|x\r\n");
  ASSERT_EQ(UpdateFixture::Take("ORE,19980915,1,1,1,1,1,0\n"), UpdateEnd::kUpdated);
  EXPECT_FALSE(KoraDetailsReady(home.files(), settings.download));
  settings.download.DataService = 1;
  ASSERT_EQ(UpdateFixture::Take("ORE,19980916,1,1,1,1,1,0\n", "16SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_TRUE(KoraDetailsReady(home.files(), settings.download));
}
