#include "shell/main_menu.h"

#include <gtest/gtest.h>

#include <map>
#include <set>

namespace kora {
namespace {

EntryState StateOf(std::string_view name, int service, bool noDownloads = false) {
  DownloadSettings download;
  download.DataService = std::int16_t(service);
  CommandWords words;
  words.NoDownloads = noDownloads;
  return MenuEntryState(name, download, words);
}

TEST(MainMenu, NamesAreUniqueAndParentsStandBefore) {
  std::set<std::string_view> names;
  for (const MenuEntry& entry : MainMenu()) {
    EXPECT_TRUE(entry.parent.empty() || names.count(entry.parent)) << entry.name;
    EXPECT_TRUE(names.insert(entry.name).second) << entry.name;
    EXPECT_FALSE(entry.caption.empty()) << entry.name;
  }
}

TEST(MainMenu, TheMenuBarHasItsSixMenusInOrder) {
  std::vector<std::string_view> bar;
  for (const MenuEntry& entry : MainMenu())
    if (entry.parent.empty()) bar.push_back(entry.caption);
  EXPECT_EQ(bar, (std::vector<std::string_view>{"&File", "&Edit", "&Download", "&Tools",
                                                "&Chart Scans", "&Help"}));
}

TEST(MainMenu, EachMenuHasAllItsEntries) {
  std::map<std::string_view, int> count;
  for (const MenuEntry& entry : MainMenu()) ++count[entry.parent];
  EXPECT_EQ(count["mnuFile"], 12);
  EXPECT_EQ(count["mnuData"], 5);
  EXPECT_EQ(count["mnuAComms"], 6);
  EXPECT_EQ(count["mnTools"], 10);
  EXPECT_EQ(count["mnuAdjustData"], 2);
  EXPECT_EQ(count["mnuAnalysis"], 5);
  EXPECT_EQ(count["mnuHelp"], 2);
}

TEST(MainMenu, CaptionsAreTheSystemsOwn) {
  const std::map<std::string_view, std::string_view> expected{
      {"mnuChartDisplay", "&CHARTS"},
      {"mnuExit", "E&XIT"},
      {"mnuDataCk", "Check &Data for Errors and Stocks Stopped Tradin"},
      {"mnuTFD", "Create te&xt file of data (OHLCV)"},
      {"mnuEIS", "&EIS / Just data"},
      {"mnStats", "Market S&tatistics"}};
  size_t seen = 0;
  for (const MenuEntry& entry : MainMenu())
    if (const auto it = expected.find(entry.name); it != expected.end()) {
      EXPECT_EQ(entry.caption, it->second);
      ++seen;
    }
  EXPECT_EQ(seen, expected.size());
}

TEST(MenuState, EachServiceShowsItsOwnDownload) {
  struct Row {
    int service;
    bool tarvo, bourse, eis;
  };
  for (const Row& row :
       {Row{0, false, false, false}, Row{1, true, false, false}, Row{2, false, true, false},
        Row{3, true, false, false}, Row{4, false, false, false}, Row{5, false, false, true}}) {
    EXPECT_EQ(StateOf("mnuTARVO", row.service).visible, row.tarvo) << row.service;
    EXPECT_EQ(StateOf("mnuTARVO", row.service).enabled, row.tarvo) << row.service;
    EXPECT_EQ(StateOf("mnuSnap", row.service).enabled, row.tarvo) << row.service;
    EXPECT_EQ(StateOf("mnuBourse", row.service).visible, row.bourse) << row.service;
    EXPECT_EQ(StateOf("mnuBourse", row.service).enabled, row.bourse) << row.service;
    EXPECT_EQ(StateOf("mnuEIS", row.service).visible, row.eis) << row.service;
  }
}

TEST(MenuState, TheWordAGreysTheDownloadOfItsService) {
  EXPECT_FALSE(StateOf("mnuTARVO", 1, true).enabled);
  EXPECT_TRUE(StateOf("mnuTARVO", 1, true).visible);
  EXPECT_FALSE(StateOf("mnuSnap", 3, true).enabled);
  EXPECT_TRUE(StateOf("mnuBourse", 2, true).enabled);
}

TEST(MenuState, MovingDataNeedsTheServiceWithSeveralFolders) {
  for (const int service : {0, 1, 2, 4, 5}) EXPECT_FALSE(StateOf("mnuMveData", service).enabled);
  EXPECT_TRUE(StateOf("mnuMveData", 3).enabled);
}

TEST(MenuState, OtherEntriesDoNotFollowTheService) {
  EXPECT_TRUE(StateOf("mnuChartDisplay", 0).enabled);
  EXPECT_TRUE(StateOf("mnuExit", 4, true).enabled);
}

TEST(LongTask, DisablesTheFiveMenusOfTheWorkAndNotHelp) {
  std::set<std::string_view> disabled;
  for (const MenuEntry& entry : MainMenu())
    if (DisabledByLongTask(entry.name)) disabled.insert(entry.name);
  EXPECT_EQ(disabled, (std::set<std::string_view>{"mnuFile", "mnuData", "mnuAComms", "mnTools",
                                                  "mnuAnalysis"}));
}

TEST(MainWindow, TheTitleTellsTheDataFolder) {
  Paths paths;
  paths.CurrentDataPath = "d:\\prices\\";
  EXPECT_EQ(MainTitle(paths), "KORA Charting 7F   -   Current Data Folder d:\\prices\\");
}

TEST(MainWindow, AHeightOf2999GivesTheStandingSize) {
  EXPECT_EQ(MainWindowSize("2999", "9000").height, 6645);
  EXPECT_FALSE(MainWindowSize("2999", "9000").heightKept);
  EXPECT_EQ(MainWindowSize("2999", "9000").width, 9000);
  EXPECT_EQ(MainWindowSize("3000", "2999").height, 3000);
  EXPECT_EQ(MainWindowSize("3000", "2999").width, 9045);
}

TEST(MainWindow, WhatIsNoSizeGivesTheStandingSize) {
  for (const char* text : {"", "unknown", "-5000", "abc", "99999999999999999999", "0"}) {
    EXPECT_EQ(MainWindowSize(text, text).height, 6645) << text;
    EXPECT_EQ(MainWindowSize(text, text).width, 9045) << text;
  }
}

TEST(CentreForm, StandsALittleAboveTheMiddleRoundedHalfToEven) {
  // 1280 / 2 - 301 / 2 = 489.5; 0.97 * 800 / 2 - 200 / 2 = 288.
  const FormPlace place = CentreForm(1280, 800, 301, 200);
  EXPECT_EQ(place.left, 490);
  EXPECT_EQ(place.top, 288);
  EXPECT_EQ(CentreForm(1280, 800, 303, 200).left, 488);  // 488.5
}

}  // namespace
}  // namespace kora
