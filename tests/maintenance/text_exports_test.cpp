#include "maintenance/text_exports.h"

#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class TextExportsTest : public MaintenanceTest {
 protected:
  const std::string kHostMisc = "drive_c/korawin/chtmisc/";
  TextExportsTest() {
    Names({Security("ORE"), Security("LATE"), Security("ZAP"), Security("NONE")});
    Prices("ORE", {Flat("19961119", 1), Day("19961120", 1.5f, 2.25f, 1, 2.1936f, 1200)});
    Prices("ZAP", {Flat("19961119", 3), Flat("19961120", 100)});
    Prices("LATE", {Flat("19961118", 7)});
  }
  std::optional<std::string> Closes(const std::optional<std::string>& date,
                                    ExportForm form = ExportForm::kCommas) {
    return ExportCloses(home.files(), kData, kMisc, date, form, progress, dialogs);
  }
  std::optional<std::string> History(const std::string& code,
                                     ExportForm form = ExportForm::kCommas) {
    return ExportHistory(home.files(), kData, kMisc, code, form, dialogs);
  }
};

}  // namespace

TEST_F(TextExportsTest, TheClosesOfTheLatestDate) {
  EXPECT_EQ(Closes({}), "20NOV96.TXT");
  EXPECT_EQ(home.Get(kHostMisc + "20NOV96.TXT"), "ORE,19961120,2.1936\r\nZAP,19961120,100\r\n");
  EXPECT_EQ(LastSaid(), "Text File 20NOV96.TXT created");
  EXPECT_EQ(LastTitle(), "Text File");
}

TEST_F(TextExportsTest, TheClosesOfAParticularDateInColumns) {
  EXPECT_EQ(Closes("19/11/96", ExportForm::kColumns), "19NOV96.TXT");
  EXPECT_EQ(home.Get(kHostMisc + "19NOV96.TXT"),
            "ORE         19961119    1\r\nZAP         19961119    3\r\n");
}

TEST_F(TextExportsTest, ADateThatIsMissingOrNoneIsRefused) {
  EXPECT_FALSE(Closes(" "));
  EXPECT_EQ(LastSaid(), "A particular date has not been entered");
  EXPECT_EQ(LastTitle(), "Text Data");
  EXPECT_FALSE(Closes("31/11/96"));
  EXPECT_EQ(LastSaid(), "The date is not a date d/m/yy");
  EXPECT_FALSE(home.Exists("drive_c/korawin/chtmisc"));
}

TEST_F(TextExportsTest, AMarketWithoutDataIsTold) {
  Names({});
  EXPECT_FALSE(Closes({}));
  EXPECT_EQ(LastSaid(), "No data on file");
}

TEST_F(TextExportsTest, TheWholeHistoryOfASecurity) {
  EXPECT_EQ(History("ore"), "ORE.txt");
  EXPECT_EQ(home.Get(kHostMisc + "ORE.txt"),
            "ORE,19/11/96,1,1,1,1,0\r\nORE,20/11/96,1.5,2.25,1,2.1936,1200\r\n");
  EXPECT_EQ(History("ORE", ExportForm::kColumns), "ORE.txt");  // prices are replaced unasked
  EXPECT_EQ(home.Get(kHostMisc + "ORE.txt"),
            "ORE     19/11/96  1         1         1         1         0\r\n"
            "ORE     20/11/96  1.5       2.25      1         2.1936    1200\r\n");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(TextExportsTest, TheTextsOfTheChartsAreAskedAbout) {
  const std::string notes = "T,8.25,19961119,1.50,A note,255\r\n";
  home.Put(kHostMisc + "ORE.Txt", notes);
  dialogs.answers = {Answer::kNo};
  EXPECT_FALSE(History("ORE"));
  EXPECT_EQ(home.Get(kHostMisc + "ORE.Txt"), notes);
  EXPECT_EQ(LastTitle(), "Create Text File");
  dialogs.answers = {Answer::kYes};
  EXPECT_TRUE(History("ORE"));
  EXPECT_EQ(home.Get(kHostMisc + "ORE.Txt").substr(0, 12), "ORE,19/11/96");
}

TEST_F(TextExportsTest, CodesWithoutANameOrDataAreTold) {
  EXPECT_FALSE(History("XXX"));
  EXPECT_EQ(LastSaid(), " File not found");
  EXPECT_EQ(LastTitle(), "Data Entry");
  EXPECT_FALSE(History("NONE"));
  EXPECT_EQ(LastSaid(), "No data for NONE");
  EXPECT_EQ(LastTitle(), "Create Text File");
}

TEST_F(TextExportsTest, AFailureLeavesTheOldText) {
  home.Put(kHostMisc + "20NOV96.TXT", "old");
  EXPECT_GT(FailedEverywhere([&] { return Closes({}).has_value(); }), 2);
}
