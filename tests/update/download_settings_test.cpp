#include "update/download_settings.h"

#include "platform/settings_file.h"
#include "tests/support/error_of.h"
#include "tests/support/mutate.h"
#include "tests/update/update_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class DownloadSettingsTest : public UpdateFixture {
 protected:
  SettingsFile ini{home.files(), "c:\\windows\\Kora.ini"};
  std::string Key(const std::string& key) { return ini.GetSetting("Download", key); }
  bool Save(const std::vector<UpdateRow>& rows, UpdateChoice& choice) {
    return SaveUpdateList(home.files(), kSystem, rows, choice, ini, settings.download, dialogs);
  }
};

const std::array<std::string, 6> kFolders{"c:\\1\\", "c:\\2",   "c:\\3\\",
                                          "c:\\4\\", "c:\\5\\", "c:\\6"};

}  // namespace

TEST_F(DownloadSettingsTest, WritesTheFoldersOfTheWholeMarket) {
  ASSERT_TRUE(SaveWmPaths(home.files(), kSystem, kFolders, 5, dialogs));
  EXPECT_EQ(home.Get(kHostSystem + "WMPaths.lst"),
            "c:\\1\\\r\nc:\\2\\\r\nc:\\3\\\r\nc:\\4\\\r\nc:\\5\\\r\n5\r\nc:\\6\\\r\n");
  EXPECT_EQ(dialogs.said.size(), 6u);
  EXPECT_EQ(LastTitle(), "Create Directory");
  EXPECT_EQ(LastSaid(), "Directory c:\\6\\ does not exist. Create this directory ?");
  EXPECT_TRUE(home.files().IsFolder("c:\\6"));
  const WmPaths lines = ReadWmPaths(home.files(), kSystem);
  EXPECT_TRUE(WmPathsComplete(lines));
  EXPECT_EQ(WmChosenFolder(lines), "c:\\6\\");
}

TEST_F(DownloadSettingsTest, NoLeavesAFolderUnmade) {
  dialogs.answers.assign(6, Answer::kNo);
  ASSERT_TRUE(SaveWmPaths(home.files(), kSystem, kFolders, 0, dialogs));
  EXPECT_FALSE(home.files().IsFolder("c:\\1"));
}

TEST_F(DownloadSettingsTest, AllFoldersMustBeEntered) {
  auto folders = kFolders;
  folders[3] = "  ";
  EXPECT_FALSE(SaveWmPaths(home.files(), kSystem, folders, 0, dialogs));
  EXPECT_EQ(LastSaid(), "Paths must be entered for all sections");
  EXPECT_EQ(LastTitle(), "W/M Paths");
  EXPECT_FALSE(SaveWizardFolders(home.files(), kSystem, folders, dialogs));
  EXPECT_EQ(LastTitle(), "Download Package Paths");
  EXPECT_FALSE(home.Exists(kHostSystem + "WMPaths.lst"));
}

TEST_F(DownloadSettingsTest, TheWizardRepeatsItsFirstBoxAndKeepsTheChoice) {
  home.Put(kHostSystem + "WMPaths.lst", "a\r\nb\r\nc\r\nd\r\ne\r\n4\r\ng\r\n");
  EXPECT_EQ(WizardFolders(ReadWmPaths(home.files(), kSystem)),
            (std::array<std::string, 6>{"a", "b", "c", "d", "e", "g"}));
  ASSERT_TRUE(SaveWizardFolders(home.files(), kSystem, kFolders, dialogs));
  EXPECT_EQ(LastSaid(), "Directory c:\\6\\ does not exist. Create folder?");
  EXPECT_EQ(home.Get(kHostSystem + "WMPaths.lst"),
            "c:\\1\\\r\nc:\\2\\\r\nc:\\3\\\r\nc:\\4\\\r\nc:\\5\\\r\n4\r\nc:\\1\\\r\n");
}

TEST_F(DownloadSettingsTest, KeepsTheTicksOfTheWizard) {
  EXPECT_EQ(WizardTicks(ini), (std::array<bool, 6>{}));
  const std::array<bool, 6> ticks{true, false, true, false, false, true};
  SaveWizardTicks(ini, ticks);
  EXPECT_EQ(Key("DLWiz"), "101001");
  EXPECT_EQ(WizardTicks(ini), ticks);
}

TEST_F(DownloadSettingsTest, NoChosenFolderWithoutANumber) {
  WmPaths lines{"a", "b", "c", "d", "e", "6", "g"};
  EXPECT_EQ(WmChosenFolder(lines), "");
  lines[kWmChosen] = "3";
  EXPECT_EQ(WmChosenFolder(lines), "d\\");
  EXPECT_FALSE(WmPathsComplete(ReadWmPaths(home.files(), "c:\\nowhere\\")));
}

TEST_F(DownloadSettingsTest, EntriesStandForServices) {
  EXPECT_EQ(ServiceOfIndex(0), 1);
  EXPECT_EQ(ServiceOfIndex(1), 3);
  EXPECT_EQ(ServiceOfIndex(2), 2);
  EXPECT_EQ(ServiceOfIndex(4), 5);
  EXPECT_EQ(ServiceOfIndex(-1), 1);
  EXPECT_EQ(ServiceIndex(3), 1);
  EXPECT_EQ(FormatIndex("yyyymmdd.d"), 6);
  EXPECT_EQ(FormatIndex("anything"), 0);
}

TEST_F(DownloadSettingsTest, ProposesAFolderByService) {
  EXPECT_EQ(ProposedDownloadFolder(home.files(), 1, kSystem), "c:\\korawin\\download\\Out\\");
  EXPECT_EQ(ProposedDownloadFolder(home.files(), 3, kSystem), "c:\\korawin\\download\\Out\\");
  EXPECT_EQ(ProposedDownloadFolder(home.files(), 4, kSystem), "c:\\NetData\\");
  EXPECT_EQ(ProposedDownloadFolder(home.files(), 2, kSystem), "c:\\bda32\\koradata\\");
  home.Put(kHostSystem + "BdaPaths.Dat", "x\r\ny\r\nc:\\bda\\out\r\n");
  EXPECT_EQ(ProposedDownloadFolder(home.files(), 2, kSystem), "C:\\BDA\\OUT\\");
  EXPECT_EQ(ProposedDownloadFolder(home.files(), 5, kSystem), "c:\\NetData\\");
  home.Put(kHostSystem + "AlSystem.lst", "x\r\ny\r\nz\r\nd:\\eis\\\r\n");
  EXPECT_EQ(ProposedDownloadFolder(home.files(), 5, kSystem), "d:\\eis\\");
}

TEST_F(DownloadSettingsTest, SavesTheService) {
  ASSERT_TRUE(
      SaveServiceChoice({3, " c:\\in\\ ", "YYMMDD.D", 100}, ini, settings.download, dialogs));
  EXPECT_EQ(Key("DataService"), "4");
  EXPECT_EQ(Key("DLPath"), "c:\\in\\");
  EXPECT_EQ(Key("InternetDLfmt"), "YYMMDD.D");
  EXPECT_EQ(Key("Volume divisor"), "100");
}

TEST_F(DownloadSettingsTest, AnotherServiceClearsTheFormOfNames) {
  ASSERT_TRUE(SaveServiceChoice({2, "", "YYMMDD.D", 1}, ini, settings.download, dialogs));
  EXPECT_EQ(settings.download.DataService, 2);
  EXPECT_EQ(settings.download.DLPath, "");  // allowed
  EXPECT_EQ(Key("InternetDLfmt"), "unknown");
}

TEST_F(DownloadSettingsTest, APathMustEndWithABackslash) {
  EXPECT_FALSE(SaveServiceChoice({2, "c:\\in", "", 1}, ini, settings.download, dialogs));
  EXPECT_EQ(LastSaid(), "Path must end with a backslash \\ ");
  EXPECT_EQ(Key("DataService"), "unknown");
}

TEST_F(DownloadSettingsTest, TakesFiveDivisorsAsPlainTextAlone) {
  EXPECT_EQ(VolumeDivisorOf("1000"), 1000);
  for (const char* text : {"7", "", "010", "1000 ", "1e3", "100000"})
    EXPECT_FALSE(VolumeDivisorOf(text)) << text;
}

TEST_F(DownloadSettingsTest, SavesTheUpdateList) {
  home.Put(kHostSystem + "Update.Lst", "OLD,1,Old\r\n");
  home.Put(kHostSystem + "Update.Bak", "OLDER");
  UpdateChoice choice = UpdateChoice::kListed;
  EXPECT_TRUE(Save({{"ore", 5, "Ore Ltd"}, {"", 1, "none"}, {"zap", 100, ""}}, choice));
  EXPECT_EQ(home.Get(kHostSystem + "Update.Lst"), "ORE,5,Ore Ltd\r\nZAP,0,\r\n");
  EXPECT_EQ(home.Get(kHostSystem + "Update.Bak"), "OLD,1,Old\r\n");
  EXPECT_EQ(Key("UpdateAll"), "False");
  EXPECT_EQ(Key("NoWarrants"), "False");
  const auto rows = ReadUpdateList(home.files(), kSystem);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[0].code, "ORE");
  EXPECT_EQ(rows[0].category, 5);
  EXPECT_EQ(rows[0].name, "Ore Ltd");
}

TEST_F(DownloadSettingsTest, UpdatingAllStillKeepsTheRows) {
  UpdateChoice choice = UpdateChoice::kAll;
  EXPECT_TRUE(Save({{"ORE", 1, ""}}, choice));
  EXPECT_EQ(home.Get(kHostSystem + "Update.Lst"), "ORE,1,\r\n");
  EXPECT_EQ(Key("UpdateAll"), "True");
  choice = UpdateChoice::kNoWarrants;
  Save({{"ORE", 1, ""}}, choice);
  EXPECT_EQ(Key("NoWarrants"), "True");
  EXPECT_EQ(UpdateChoiceOf(settings.download), UpdateChoice::kNoWarrants);
}

TEST_F(DownloadSettingsTest, AnEmptyListIsResetToAll) {
  UpdateChoice choice = UpdateChoice::kListed;
  EXPECT_FALSE(Save({}, choice));
  EXPECT_EQ(choice, UpdateChoice::kAll);
  EXPECT_EQ(LastTitle(), "Update List");
  EXPECT_EQ(Key("UpdateAll"), "True");
}

TEST_F(DownloadSettingsTest, ReadsOddUpdateListsWithoutHarm) {
  home.Put(kHostSystem + "Update.Lst",
           " ore \n,,\nzap,700,\"Z\",more\n" + std::string(1 << 20, 'q'));
  const auto rows = ReadUpdateList(home.files(), kSystem);
  ASSERT_EQ(rows.size(), 3u);
  EXPECT_EQ(rows[0].code, "ORE");
  EXPECT_EQ(rows[1].category, 0);
  EXPECT_EQ(rows[1].name, "\"Z\",more");
}

TEST_F(DownloadSettingsTest, AnEmptyPathIsAllowedAndGivesAnEmptyDLPath) {
  ini.PutSetting("KoraPaths", "System", kSystem);
  ini.PutSetting("Download", "DLPath", "c:\\in\\");
  ASSERT_TRUE(SaveServiceChoice({4, "  ", "", 1}, ini, settings.download, dialogs));
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(settings.download.DLPath, "");
  Settings read;
  ASSERT_TRUE(ReadSettings(ini, home.files(), dialogs, read));
  EXPECT_EQ(read.download.DLPath, "");
}

TEST_F(DownloadSettingsTest, AStoredDivisorOf7LoadsAs1) {
  ini.PutSetting("KoraPaths", "System", kSystem);
  ini.PutSetting("Download", "Volume divisor", "7");
  Settings read;
  ASSERT_TRUE(ReadSettings(ini, home.files(), dialogs, read));
  EXPECT_EQ(read.download.VolumeDivisor, 1);
  ini.PutSetting("Download", "Volume divisor", "1000");
  ASSERT_TRUE(ReadSettings(ini, home.files(), dialogs, read));
  EXPECT_EQ(read.download.VolumeDivisor, 1000);
}

TEST_F(DownloadSettingsTest, WithUpdateAllTheSavedListKeepsItsRows) {
  home.Put(kHostSystem + "Update.Lst", "ORE,5,Ore Ltd\r\n");
  UpdateChoice choice = UpdateChoice::kAll;
  EXPECT_TRUE(Save(ReadUpdateList(home.files(), kSystem), choice));
  EXPECT_EQ(home.Get(kHostSystem + "Update.Lst"), "ORE,5,Ore Ltd\r\n");
  EXPECT_EQ(Key("UpdateAll"), "True");
}

TEST_F(DownloadSettingsTest, TheKeyWrittenWithABlankIsTheOneThatIsRead) {
  ini.PutSetting("KoraPaths", "System", kSystem);
  UpdateChoice choice = UpdateChoice::kListed;
  EXPECT_TRUE(Save({{"ORE", 1, ""}}, choice));
  Settings read;
  ASSERT_TRUE(ReadSettings(ini, home.files(), dialogs, read));
  EXPECT_FALSE(read.download.UpdateAll);
  EXPECT_NE(home.Get("Kora.ini").find("\r\nUpdateAll=False\r\n"), std::string::npos);
}

TEST_F(DownloadSettingsTest, AnEmptiedListGoesToTheCopy) {
  home.Put(kHostSystem + "Update.Lst", "ORE,5,Ore Ltd\r\n");
  UpdateChoice choice = UpdateChoice::kAll;
  EXPECT_FALSE(Save({}, choice));
  EXPECT_FALSE(home.Exists(kHostSystem + "Update.Lst"));
  EXPECT_EQ(home.Get(kHostSystem + "Update.Bak"), "ORE,5,Ore Ltd\r\n");
}

TEST_F(DownloadSettingsTest, AFullDiskLeavesTheOldUpdateListAndItsChoice) {
  const std::string old = "ORE,5,Ore Ltd\r\n";
  home.Put(kHostSystem + "Update.Lst", old);
  for (int at = 1;; ++at) {
    UpdateChoice choice = UpdateChoice::kListed;
    io.Reset(at);
    io.lasting = true;
    const int error = ErrorOf([&] { Save({{"NEW", 1, ""}}, choice); });
    const bool cut = io.calls >= at;
    io.Reset();
    if (!cut) break;
    const std::string now = home.Get(kHostSystem + "Update.Lst");
    // A disk that stays broken behind the renaming leaves the new list.
    EXPECT_TRUE(now == "NEW,1,\r\n" || (error && now == old)) << at;
    EXPECT_EQ(settings.download.UpdateAll, error != 0) << at;
    home.Put(kHostSystem + "Update.Lst", old);
    settings.download.UpdateAll = true;
  }
}

TEST_F(DownloadSettingsTest, TextsCannotBreakTheListsLines) {
  UpdateChoice choice = UpdateChoice::kListed;
  EXPECT_TRUE(Save(
      {{"a,b", 1, "x\r\nEVIL,1,y"}, {"\n", 1, "none"}, {"c\xC3\xA9", 1, "Smith, Jones"}}, choice));
  EXPECT_EQ(home.Get(kHostSystem + "Update.Lst"), "A B,1,x  EVIL,1,y\r\nC\xE9,1,Smith, Jones\r\n");
  const auto rows = ReadUpdateList(home.files(), kSystem);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[1].name, "Smith, Jones");
  EXPECT_EQ(rows[1].code, "C\xC3\xA9");
  const std::string once = home.Get(kHostSystem + "Update.Lst");
  EXPECT_TRUE(Save(rows, choice));
  EXPECT_EQ(home.Get(kHostSystem + "Update.Lst"), once);
}

TEST_F(DownloadSettingsTest, AHugeUpdateListIsRefused) {
  home.Put(kHostSystem + "Update.Lst", "ORE,1,\r\n");
  std::filesystem::resize_file(home.path() + "/" + kHostSystem + "Update.Lst", 5u << 20);
  EXPECT_EQ(ErrorOf([&] { ReadUpdateList(home.files(), kSystem); }), kOutOfMemory);
  std::string text;
  for (int i = 0; i < 100'000; ++i) text += "A\n";
  home.Put(kHostSystem + "Update.Lst", text);
  EXPECT_EQ(ReadUpdateList(home.files(), kSystem).size(), 100'000u);
  home.Put(kHostSystem + "Update.Lst", text + "B");
  EXPECT_EQ(ErrorOf([&] { ReadUpdateList(home.files(), kSystem); }), kOutOfMemory);
}

TEST_F(DownloadSettingsTest, DamagedListsAreReadForWhatTheyHave) {
  Mutator(13).Run(
      {"ORE,1,Ore Ltd\r\nZAP,2,Zap\r\n", "c:\\1\\\r\nb\r\nc\r\nd\r\ne\r\n4\r\ng\r\n", ""}, 300,
      [&](const std::string& text) {
        home.Put(kHostSystem + "Update.Lst", text);
        for (const UpdateRow& row : ReadUpdateList(home.files(), kSystem)) {
          EXPECT_FALSE(row.code.empty());
          EXPECT_GE(row.category, 0);
          EXPECT_LE(row.category, 99);
        }
        home.Put(kHostSystem + "WMPaths.lst", text);
        const WmPaths lines = ReadWmPaths(home.files(), kSystem);
        const std::string chosen = WmChosenFolder(lines);
        EXPECT_TRUE(chosen.empty() || chosen.back() == '\\');
      });
}

TEST_F(DownloadSettingsTest, OddFilesOfOtherProgramsProposeNothing) {
  const std::string nul("x\ny\nc:\\a\0b\nd:\\a\x01\n", 17);
  for (const std::string& text :
       {std::string(), std::string("x\ny"), "x\ny\n" + std::string(300, 'c'),
        "x\ny\n" + std::string(900'000, 'c'), nul, std::string(2u << 20, '\n')}) {
    home.Put(kHostSystem + "BdaPaths.Dat", text);
    home.Put(kHostSystem + "AlSystem.lst", "w\n" + text);
    EXPECT_EQ(ProposedDownloadFolder(home.files(), 2, kSystem), "c:\\bda32\\koradata\\");
    EXPECT_EQ(ProposedDownloadFolder(home.files(), 5, kSystem), "c:\\NetData\\");
  }
}

TEST_F(DownloadSettingsTest, AFormThatMatchesNoneIsKeptAsTheOneThatShows) {
  EXPECT_EQ(FormatToStore(""), "ddMMMyy.d");
  EXPECT_EQ(FormatToStore("rubbish"), "DDMMMYY.D");
  EXPECT_EQ(FormatToStore("ddMMMyy.d"), "ddMMMyy.d");
  EXPECT_EQ(FormatToStore("YYMMDD.ASX"), "YYMMDD.ASX");
}

TEST_F(DownloadSettingsTest, TheServiceFoldersFollowTheService) {
  ini.PutSetting("Download", "System", "c:\\sys\\");
  ini.PutSetting("Download", "In", "c:\\in\\");
  ASSERT_TRUE(SaveServiceChoice({1, "", "", 1}, ini, settings.download, dialogs));
  EXPECT_EQ(settings.download.ServiceSystem, "c:\\sys\\");
  EXPECT_EQ(settings.download.ServiceIn, "c:\\in\\");
  EXPECT_EQ(settings.download.ServiceOut, "");
  ASSERT_TRUE(SaveServiceChoice({4, "", "", 1}, ini, settings.download, dialogs));
  EXPECT_EQ(settings.download.ServiceSystem, "");
}

TEST_F(DownloadSettingsTest, AFileInTheWayOfAFolderIsNotTakenForIt) {
  home.Put("drive_c/2", "a file");
  EXPECT_NE(ErrorOf([&] { SaveWmPaths(home.files(), kSystem, kFolders, 0, dialogs); }), 0);
  EXPECT_FALSE(home.Exists(kHostSystem + "WMPaths.lst"));
}

TEST_F(DownloadSettingsTest, EachBoxOfTheWizardOpensOnItsFolder) {
  const WmPaths lines{"c:\\1\\", "c:\\2\\", "c:\\3\\", "c:\\4\\", "c:", "0", "c:\\7\\"};
  const std::pair<const char*, const char*> wanted[] = {{"ASX stocks", "c:\\1\\"},
                                                        {"Aust Indices", "c:\\2\\"},
                                                        {"SFE Futures", "c:\\3\\"},
                                                        {"Overseas Data", "c:\\4\\"},
                                                        {"Put / Call Options", kData.c_str()},
                                                        {"Extra stocks", "c:\\7\\"}};
  for (int i = 0; i < 6; ++i) {
    const LocateCase what = WizardLocate(lines, i, settings.paths);
    EXPECT_EQ(what.purpose, wanted[i].first);
    EXPECT_EQ(what.start, wanted[i].second);
  }
}
