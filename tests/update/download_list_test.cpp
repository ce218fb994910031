#include "update/download_list.h"

#include "tests/update/update_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class DownloadListTest : public UpdateFixture {
 protected:
  void Wait(const std::vector<std::string>& names) {
    for (const std::string& name : names) Download(name, name);
  }
  ListResult List() { return BuildDownloadList(home.files(), settings.download, dialogs, entries); }
  // Service 4 with this form of names.
  DownloadEntries Renamed(const std::string& form, const std::vector<std::string>& names) {
    settings.download.DataService = 4;
    settings.download.InternetDLfmt = form;
    Wait(names);
    List();
    return entries;
  }
};

}  // namespace

TEST_F(DownloadListTest, ListsTheOldestFirst) {
  Wait({"15SEP98.d", "01JAN99.D", "31dec97.d", "02FEB00.d", "30JUN29.d", "01JUL30.d"});
  EXPECT_EQ(List(), ListResult::kFilled);
  EXPECT_EQ(entries, (DownloadEntries{"01JUL30.d", "31DEC97.d", "15SEP98.d", "01JAN99.D",
                                      "02FEB00.d", "30JUN29.d"}));
}

TEST_F(DownloadListTest, PassesOverOtherFilesAndFolders) {
  Wait({"15SEP98.dX", "15SEP98.das", "notes.txt", "16SEP98.d"});
  home.files().MakeFolder(kDown + "17SEP98.d");
  List();
  EXPECT_EQ(entries, DownloadEntries{"16SEP98.d"});
}

TEST_F(DownloadListTest, PassesOverNamesThatLeadOutOfTheFolder) {
  home.Put(kHostSystem + "KEEP.d", "");
  Wait({"..\\KEEP.d", "16SEP98.d"});
  List();
  EXPECT_EQ(entries, DownloadEntries{"16SEP98.d"});
}

TEST_F(DownloadListTest, NothingWaits) {
  EXPECT_EQ(List(), ListResult::kNothingWaits);
  EXPECT_EQ(LastSaid(), " There are no downloaded files to update. ");
  EXPECT_EQ(LastTitle(), "Downloaded Data ");
}

TEST_F(DownloadListTest, AMissingFolderIsTold) {
  settings.download.DLPath = "c:\\nowhere\\";
  EXPECT_EQ(List(), ListResult::kStopped);
  EXPECT_EQ(LastSaid(), "There is a file access problem. Check directory paths option.");
  EXPECT_EQ(LastTitle(), "Error");
}

TEST_F(DownloadListTest, ANameWithoutAMonthIsListedAsItStands) {
  Wait({"README.D", "15SEP98.d"});
  List();
  EXPECT_EQ(entries.size(), 2u);
  EXPECT_NE(std::find(entries.begin(), entries.end(), "README.D"), entries.end());
}

TEST_F(DownloadListTest, RenamesInternetFilesByTheirForm) {
  EXPECT_EQ(Renamed("YYMMDD.D", {"980915.d"}), DownloadEntries{"15SEP98.d"});
  EXPECT_EQ(home.Get(kHostDown + "15SEP98.d"), "980915.d");
  EXPECT_FALSE(Waits("980915.d"));
  EXPECT_EQ(Renamed("YYMMDD.ASX", {"980916.ASX"}), (DownloadEntries{"15SEP98.d", "16SEP98.d"}));
  EXPECT_EQ(Renamed("ddmmyy.d", {"170998.d"}).back(), "17SEP98.d");
  EXPECT_EQ(Renamed("DDMMYY.ASX", {"180998.asx"}).back(), "18SEP98.d");
  EXPECT_EQ(Renamed("YYYYMMDD.D", {"19980921.d"}).back(), "21SEP98.d");
}

TEST_F(DownloadListTest, AFourDigitYearSortsAs2019) {
  EXPECT_EQ(Renamed("DDMMYYYY.D", {"15091998.d", "01012018.d"}),
            (DownloadEntries{"15SEP1998.d", "01JAN2018.d"}));  // 2019 before 2020
}

TEST_F(DownloadListTest, ARenamedFileTakesThePlaceOfOneWithItsName) {
  Wait({"15SEP98.d"});
  EXPECT_EQ(Renamed("YYMMDD.D", {"980915.d"}), DownloadEntries{"15SEP98.d"});
  EXPECT_EQ(home.Get(kHostDown + "15SEP98.d"), "980915.d");
}

TEST_F(DownloadListTest, LeavesNamesThatAreNoDates) {
  EXPECT_EQ(Renamed("YYMMDD.D", {"981315.d", "9809.d"}).size(), 2u);
  EXPECT_TRUE(Waits("981315.d"));
}

TEST_F(DownloadListTest, AnUnknownFormIsTold) {
  EXPECT_TRUE(Renamed("MMDDYY.D", {"091598.d"}).empty());
  EXPECT_EQ(LastTitle(), "Downloaded Data");
  EXPECT_TRUE(Waits("091598.d"));
  RenameInternetFiles(home.files(), kDown, 7, dialogs);
  EXPECT_EQ(LastTitle(), "Download");
}

TEST_F(DownloadListTest, ASortOfManyIsASort) {
  std::vector<std::string> names;
  for (int year = 10; year < 20; ++year)
    for (int month = 12; month > 0; --month)
      names.push_back("05" + std::string(MonthName(month)) + std::to_string(year) + ".d");
  const auto sorted = SortedEntries(names);
  ASSERT_EQ(sorted.size(), 120u);
  EXPECT_EQ(sorted.front(), "05JAN10.d");
  EXPECT_EQ(sorted[13], "05FEB11.d");
  EXPECT_EQ(sorted.back(), "05DEC19.d");
}

TEST_F(DownloadListTest, TheUpdateDateIsThatOfTheName) {
  const CalendarDate today{2026, 11, 5};
  EXPECT_EQ(UpdateDateOf("15SEP98.d", today), "15/9/98");
  EXPECT_EQ(UpdateDateOf("01Jan05.d", today), "1/1/05");
  EXPECT_EQ(UpdateDateOf("15SEP1998.d", today), "5/11/26");
  EXPECT_EQ(UpdateDateOf("31SEP98.d", today), "5/11/26");
}

TEST_F(DownloadListTest, RemovingTakesTheFirstEntryOffWhicheverWasNamed) {
  Wait({"15SEP98.d", "16SEP98.d"});
  List();
  dialogs.answers = {Answer::kNo};
  EXPECT_FALSE(RemoveDownload(home.files(), kDown, "16SEP98.d", dialogs, entries));
  EXPECT_TRUE(Waits("16SEP98.d"));
  EXPECT_TRUE(RemoveDownload(home.files(), kDown, "16SEP98.d", dialogs, entries));
  EXPECT_EQ(LastSaid(), "Remove 16SEP98.d");
  EXPECT_EQ(LastTitle(), "Remove Date");
  EXPECT_FALSE(Waits("16SEP98.d"));
  EXPECT_TRUE(Waits("15SEP98.d"));
  EXPECT_EQ(entries, DownloadEntries{"16SEP98.d"});
}

TEST_F(DownloadListTest, FailuresAreToldByTheirNumber) {
  EXPECT_EQ(DownloadErrorText(RunTimeError(7)),
            "There is a memory problem. Try closing windows and restarting");
  EXPECT_EQ(DownloadErrorText(RunTimeError(67)), "There is a device problem. Check and retry");
  EXPECT_EQ(DownloadErrorText(RunTimeError(63)),
            "There is a file access problem. Check directory paths option.");
  EXPECT_EQ(DownloadErrorText(RunTimeError(61)), "There is an unexpected error - Disk full");
}
