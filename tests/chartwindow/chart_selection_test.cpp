#include "chartwindow/chart_selection.h"

#include <gtest/gtest.h>

#include "base/numbers.h"
#include "store/industry_classes.h"
#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

using test::Bytes;
using test::ScriptedDialogs;
using test::Security;
using test::TempHome;

NameRec Named(std::string_view code, std::string_view name, std::int16_t recType = kShare,
              std::string_view indClass = "") {
  NameRec rec = Security(code, 1, recType, indClass);
  rec.Name.set(name);
  return rec;
}

ListRec Entry(std::int16_t record, std::string_view code) {
  ListRec rec;
  rec.ListRecNo = record;
  rec.ListCode.set(code);
  return rec;
}

class ChartSelectionTest : public testing::Test {
 protected:
  ChartSelectionTest()
      : ini(home.files(), "c:\\windows\\Kora.ini"),
        user(home.files(), "c:\\windows\\KoraUser.ini") {
    settings.paths.SystemPath = "c:\\korawin\\";
    settings.paths.CurrentDataPath = "c:\\korawin\\data\\";
    settings.charts.Av1D = 21;
    settings.charts.Av2D = 55;
    settings.charts.Av1W = 10;
    settings.charts.Av2W = 30;
    // Places 1 to 6.
    PutNames({Named("AAA", "Alpha Mining", kShare, "011"), Named("BBB", "Beta Bank", kShare, "021"),
              Named("BHP", "Broken Hill", kShare, "012"), Named("XAO", "All Ords", kIndex),
              Named("ADV", "Advances", kAdvanceDecline), Named("ZZZ", "Last", kCloseOnly, "012")});
  }

  void PutNames(const std::vector<NameRec>& names) {
    home.Put("drive_c/korawin/data/Names.dat", Bytes(names));
  }
  void PutList(char letter, const std::vector<ListRec>& records) {
    home.Put(std::string("drive_c/korawin/data/SubList") + letter + ".Dat", Bytes(records));
  }
  void Keep(const char* key, const char* value) { ini.PutSetting("Charts", key, value); }
  std::string Kept(const char* key) { return ini.GetSetting("Charts", key); }

  ChartSelection& Selection() {
    if (!selection)
      selection = std::make_unique<ChartSelection>(ChartSelectionServices{.files = home.files(),
                                                                          .dialogs = dialogs,
                                                                          .settings = settings,
                                                                          .ini = ini,
                                                                          .user = user,
                                                                          .state = state,
                                                                          .current = current});
    return *selection;
  }
  const ChartSelectionView& Loaded() {
    Selection().Load();
    return Selection().view();
  }
  const ChartSelectionView& view() { return Selection().view(); }
  void ChooseList(std::int16_t item, const char* text = "My List") {
    const ListEntry entry{text, item};
    Selection().ChooseList(&entry);
  }
  void ExpectSaid(const std::string& text, const std::string& title) {
    ASSERT_EQ(dialogs.said.size(), 1u);
    EXPECT_EQ(dialogs.said[0].text, text);
    EXPECT_EQ(dialogs.said[0].title, title);
    dialogs.said.clear();
  }
  void ExpectShown(const char* code, std::int16_t index) {
    EXPECT_EQ(view().Text1, code);
    EXPECT_EQ(view().Text5, std::to_string(index));
    EXPECT_EQ(view().VScroll1, index);
    EXPECT_EQ(state.ChartIndex, index);
    EXPECT_EQ(current.PriceFileName, std::string(code) + ".WDT");
  }

  test::FailingIo io;
  TempHome home{io};
  ScriptedDialogs dialogs;
  Settings settings;
  SettingsFile ini, user;
  ChartState state;
  CurrentName current;
  std::unique_ptr<ChartSelection> selection;
};

// ---- Load

TEST_F(ChartSelectionTest, AFirstLoadWithNothingKeptTakesTheDefaults) {
  Loaded();
  EXPECT_EQ(state.ChartStyle, Style::kBar);
  EXPECT_EQ(state.ChartPeriod, Period::kDaily);
  EXPECT_EQ(state.BandKind, 0);
  EXPECT_EQ(state.BarSpacing, 2);
  EXPECT_TRUE(state.ChartSelLoaded);
  EXPECT_EQ(view().Label8, " FULL LIST   (Names.Dat)");
  EXPECT_EQ(state.ChartListName, " FULL LIST   (Names.Dat)");
  EXPECT_EQ(view().Text3, "2");
  EXPECT_EQ(view().Text4, "6");
  EXPECT_EQ(view().VScrollMax, 6);
  EXPECT_EQ(view().Text2, "Alpha Mining");
  EXPECT_EQ(view().Text6, "LATEST");
  EXPECT_EQ(view().Text7, "ON");
  EXPECT_EQ(view().Combo1, kBarIndex);
  EXPECT_EQ(view().Combo4, kDailyIndex);
  EXPECT_EQ(current.NameCount, 6);
  ExpectShown("AAA", 1);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartSelectionTest, KeptValuesComeBack) {
  Keep("Type", "C");
  Keep("Period", "M");
  Keep("Bands", "2");
  Keep("Spacing", "7");
  Loaded();
  EXPECT_EQ(view().Combo1, kCandleIndex);
  EXPECT_EQ(view().Combo4, kMonthlyIndex);
  EXPECT_EQ(view().Combo3, 2);
  EXPECT_EQ(view().Text3, "7");
  EXPECT_EQ(state.BarSpacing, 7);
  EXPECT_EQ(view().OAve1, "10");
  EXPECT_EQ(view().OAve2, "30");
}

TEST_F(ChartSelectionTest, OddKeptValuesBecomeLineDailyNoBands) {
  Keep("Type", "Q");
  Keep("Period", "yearly");
  Keep("Bands", "3");
  Loaded();
  EXPECT_EQ(state.ChartStyle, Style::kLine);
  EXPECT_EQ(view().Combo1, kLineIndex);
  EXPECT_EQ(view().Combo4, kDailyIndex);
  EXPECT_EQ(state.ChartPeriod, Period::kDaily);
  EXPECT_EQ(state.BandKind, 0);
  EXPECT_EQ(view().Combo3, 0);
}

TEST_F(ChartSelectionTest, ASpacingOf0StaysAndOneOutside0To10Becomes2) {
  const struct {
    const char *kept, *shown;
    int spacing;
  } cases[] = {
      {"0", "0", 0},     {"10", "10", 10},  {"-1", "2", 2},    {"11", "2", 2},
      {"2.5", "2.5", 2}, {"3.5", "3.5", 4}, {"abc", "abc", 0}, {"99999999999999999999", "2", 2}};
  for (const auto& c : cases) {
    Keep("Spacing", c.kept);
    state.ChartSelLoaded = false;
    Loaded();
    EXPECT_EQ(view().Text3, c.shown) << c.kept;
    EXPECT_EQ(state.BarSpacing, c.spacing) << c.kept;
  }
}

TEST_F(ChartSelectionTest, AKeptSpacingOf2WithCandlesIsShownAsItWasUntilAControlIsTouched) {
  Keep("Type", "C");
  Keep("Spacing", "2");
  Loaded();
  EXPECT_EQ(view().Combo1, kCandleIndex);
  EXPECT_EQ(view().Text3, "2");
  Selection().LeaveSpacing();
  EXPECT_EQ(view().Text3, "3");
}

TEST_F(ChartSelectionTest, ALaterLoadShowsTheStateAndNotTheSettings) {
  Loaded();
  state.ChartStyle = Style::kCandlestick;
  state.ChartPeriod = Period::kWeekly;
  state.BarSpacing = 5;
  state.OscShown = true;
  state.OscSelected = "WMS";
  state.ChartIndex = 4;
  state.VolumeOption = false;
  Keep("Period", "M");
  Loaded();
  EXPECT_EQ(view().Combo4, kWeeklyIndex);
  EXPECT_EQ(view().Text3, "5");
  EXPECT_EQ(view().Combo2, 17);
  EXPECT_EQ(view().Text7, "OFF");
  ExpectShown("XAO", 4);
  state.OscShown = false;
  EXPECT_EQ(Loaded().Combo2, 0);
}

TEST_F(ChartSelectionTest, TheBoxOfOscillatorsSaysWhatWillBeDrawn) {
  Loaded();
  Selection().ChooseOscillator(14);
  ASSERT_TRUE(Selection().OK());
  state.OscCode = "MACD";  // from the menu of the chart
  EXPECT_EQ(Loaded().Combo2, 14);
  ASSERT_TRUE(Selection().OK());
  EXPECT_EQ(state.OscCode, "RSI");
  EXPECT_EQ(state.OscSelected, "RSI");
}

TEST_F(ChartSelectionTest, AnOscillatorThatWasChosenAndNotShownYetStaysInTheBox) {
  Loaded();
  Selection().ChooseOscillator(14);
  Selection().FolderChanged();
  EXPECT_EQ(Loaded().Combo2, 14);
  ASSERT_TRUE(Selection().OK());
  EXPECT_EQ(state.OscSelected, "RSI");
}

TEST_F(ChartSelectionTest, NoneInTheBoxDrawsNone) {
  Loaded();
  state.OscShown = true;
  state.OscSelected = state.OscCode = "PARAV";
  EXPECT_EQ(Loaded().Combo2, 0);
  ASSERT_TRUE(Selection().OK());
  EXPECT_FALSE(state.OscShown);
}

TEST_F(ChartSelectionTest, EachOscillatorHasItsPlaceAndCode) {
  const char* codes[] = {"",     "DM",  "COP", "ERY", "FX",  "JHG", "MACD", "MOM", "OBV",
                         "PARA", "ROC", "R/F", "RMO", "RMX", "RSI", "STO",  "VTY", "WMS"};
  ASSERT_EQ(OscChoices().size(), std::size(codes));
  Loaded();
  for (int i = 1; i < int(std::size(codes)); ++i) {
    Selection().ChooseOscillator(i);
    EXPECT_TRUE(state.OscShown);
    EXPECT_EQ(state.OscCode, codes[i]);
    EXPECT_EQ(view().Combo2, i);
  }
  Selection().ChooseOscillator(0);
  EXPECT_FALSE(state.OscShown);
}

TEST_F(ChartSelectionTest, TheResultListGivesWayToTheFullListOnLoad) {
  Loaded();
  PutList('Z', {Entry(2, "BBB")});
  state.ChartListNo = kResultList;
  Loaded();
  EXPECT_EQ(state.ChartListNo, kFullList);
  EXPECT_EQ(view().Text4, "6");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartSelectionTest, AListIsStillInUseOnTheNextLoad) {
  Loaded();
  PutList('B', {Entry(3, "BHP"), Entry(1, "AAA")});
  state.ChartListNo = 3;
  state.ChartIndex = 2;
  Loaded();
  EXPECT_EQ(view().Label8, "Chart List B");
  EXPECT_EQ(view().Text4, "2");
  EXPECT_EQ(state.ChartListCount, 2);
  EXPECT_FALSE(view().IndustryEnabled);
  ExpectShown("AAA", 2);
}

TEST_F(ChartSelectionTest, AListThatLostAllItsRecordsFallsBackToTheWholeFileWithAMessage) {
  Loaded();
  PutList('A', {});
  state.ChartListNo = 2;
  Loaded();
  ExpectSaid(" There are no records in Chart List A for this folder.", "Chart Lists");
  EXPECT_EQ(state.ChartListNo, kFullList);
  EXPECT_EQ(view().Label8, " FULL LIST   (Names.Dat)");
  EXPECT_EQ(view().Text4, "6");
}

TEST_F(ChartSelectionTest, AnIndexOutsideTheListBecomes1) {
  Loaded();
  for (std::int16_t index : {std::int16_t(7), std::int16_t(0), std::int16_t(-5)}) {
    state.ChartIndex = index;
    Loaded();
    ExpectShown("AAA", 1);
  }
}

TEST_F(ChartSelectionTest, DataWithoutBarsShowsAsLineSaveForPointAndFigureOnTheFirstLoad) {
  PutNames({Named("ADV", "Advances", kAdvanceDecline)});
  Keep("Type", "P");
  EXPECT_EQ(Loaded().Combo1, kPointFigureIndex);
  EXPECT_EQ(Loaded().Combo1, kLineIndex) << "the second load";
  state.ChartSelLoaded = false;
  Keep("Type", "C");
  EXPECT_EQ(Loaded().Combo1, kLineIndex);
}

TEST_F(ChartSelectionTest, AShareComesBackInTheRememberedStyleAfterALineOnlySeries) {
  Keep("Type", "C");
  Loaded();
  Selection().Scroll(5);
  EXPECT_EQ(view().Combo1, kLineIndex);
  Selection().OK();
  EXPECT_EQ(state.ChartStyle, Style::kLine);
  state.ChartIndex = 1;
  EXPECT_EQ(Loaded().Combo1, kCandleIndex);
}

TEST_F(ChartSelectionTest, ChangeFolderShowsForService3Only) {
  EXPECT_FALSE(Loaded().Command6Shown);
  settings.download.DataService = 3;
  EXPECT_TRUE(Loaded().Command6Shown);
}

TEST_F(ChartSelectionTest, TickedAveragesComeInTheirColoursAndUntickedInTheBackground) {
  settings.charts.AvOne = true;
  Loaded();
  EXPECT_TRUE(view().OAve1Ticked);
  EXPECT_EQ(view().OAve1Colour, 20);
  EXPECT_FALSE(view().OAve2Ticked);
  EXPECT_EQ(view().OAve2Colour, 17);
  EXPECT_EQ(view().OAve1, "21");
  EXPECT_EQ(view().OAve2, "55");
  Selection().TickAverage(1, false);
  Selection().TickAverage(2, true);
  EXPECT_EQ(view().OAve1Colour, 0) << "black";
  EXPECT_EQ(view().OAve2Colour, 21);
  EXPECT_FALSE(state.Ma1On);
  EXPECT_TRUE(state.Ma2On);
}

// ---- Names.dat in odd states

TEST_F(ChartSelectionTest, AMissingOrEmptyNameFileIsToldByNumber) {
  home.files().Remove("c:\\korawin\\data\\Names.dat");
  Loaded();
  ExpectSaid("There is an unexpected error number 53", "Chart Select");
  PutNames({});
  Loaded();
  ExpectSaid("There is an unexpected error number 63", "Chart Select");
  EXPECT_EQ(view().Text1, "");
  EXPECT_EQ(view().Text4, "0");
  EXPECT_EQ(view().VScrollMax, 1);
}

TEST_F(ChartSelectionTest, ANameFileThatVanishesWhileTheFormStandsIsTold) {
  Loaded();
  home.files().Remove("c:\\korawin\\data\\Names.dat");
  Selection().Scroll(2);
  ExpectSaid("There is an unexpected error number 53", "Chart Select");
  EXPECT_EQ(Selection().EnterCode("BHP"), ChartSelection::Entered::kNothing);
  ExpectSaid("There is an unexpected error number 53", "Chart Select");
}

TEST_F(ChartSelectionTest, ANameFileThatShrinksLeadsBackToTheFirst) {
  Loaded();
  Selection().Scroll(6);
  PutNames({Named("AAA", "Alpha"), Named("BBB", "Beta")});
  Selection().Scroll(6);
  ExpectShown("AAA", 1);
  EXPECT_EQ(view().Text4, "2");
  EXPECT_EQ(view().VScrollMax, 2);
}

TEST_F(ChartSelectionTest, ATornLastRecordDoesNotCount) {
  home.Put("drive_c/korawin/data/Names.dat",
           Bytes(std::vector<NameRec>{Security("AAA"), Security("BBB")}) + "torn");
  EXPECT_EQ(Loaded().Text4, "2");
}

TEST_F(ChartSelectionTest, MoreRecordsThan16BitsNumberIsError6) {
  PutNames(std::vector<NameRec>(32768, Security("AAA")));
  Loaded();
  ExpectSaid("There is an unexpected error number 6", "Chart Select");
}

// ---- Lists in odd states

TEST_F(ChartSelectionTest, AStaleRecordNumberShowsTheSecurityNowAtThatNumber) {
  Loaded();
  PutList('A', {Entry(2, "AAA")});
  state.ChartListNo = 2;
  Loaded();
  EXPECT_EQ(view().Text1, "BBB");
}

TEST_F(ChartSelectionTest, ImpossibleRecordNumbersAreToldAndLeaveNoSecurityOnShow) {
  Loaded();
  PutList('A',
          {Entry(1, "AAA"), Entry(0, "BBB"), Entry(-3, "BHP"), Entry(7, "ZZZ"), Entry(3, "BHP")});
  state.ChartListNo = 2;
  Loaded();
  ExpectShown("AAA", 1);
  for (std::int16_t index : {std::int16_t(2), std::int16_t(3), std::int16_t(4)}) {
    Selection().Scroll(index);
    ExpectSaid("There is an unexpected error number 63", "Chart Select");
    EXPECT_EQ(view().Text1, "");
    EXPECT_EQ(view().Text2, "");
    EXPECT_EQ(current.PriceFileName, "");
    EXPECT_EQ(view().VScroll1, index) << "so that the next step goes past it";
  }
  Selection().Scroll(5);
  ExpectShown("BHP", 5);
  EXPECT_EQ(Selection().EnterCode("BHP"), ChartSelection::Entered::kFound)
      << "the walk goes past such records";
  ExpectShown("BHP", 5);
}

TEST_F(ChartSelectionTest, AListLengthThatIsNoMultipleOf8CountsWholeRecords) {
  Loaded();
  home.Put("drive_c/korawin/data/SubListA.Dat",
           Bytes(std::vector<ListRec>{Entry(1, "AAA"), Entry(2, "BBB")}) + "1234567");
  state.ChartListNo = 2;
  EXPECT_EQ(Loaded().Text4, "2");
}

TEST_F(ChartSelectionTest, AListThatIsEmptiedWhileTheFormStandsFallsBackWithAMessage) {
  Loaded();
  PutList('A', {Entry(2, "BBB"), Entry(3, "BHP")});
  state.ChartListNo = 2;
  Loaded();
  PutList('A', {});
  Selection().Scroll(2);
  ExpectSaid(" There are no records in Chart List A for this folder.", "Chart Lists");
  EXPECT_EQ(state.ChartListNo, kFullList);
  EXPECT_TRUE(view().IndustryEnabled);
  ExpectShown("BBB", 2);
}

// ---- The list chooser

TEST_F(ChartSelectionTest, TheChooserOffersTheFullListTenListsAndTheResults) {
  PutList('A', {Entry(1, "AAA")});
  home.Put("drive_c/korawin/data/SubListB.Dat", "x");
  home.Put("drive_c/korawin/data/SubListC.Dat", "xy");
  user.PutSetting("KORA Charting System", "SubListK", "Banks");
  const auto entries = ListEntries(home.files(), settings.paths.CurrentDataPath, user);
  ASSERT_EQ(entries.size(), 12u);
  for (size_t i = 0; i < entries.size(); ++i) EXPECT_EQ(entries[i].item, int(i) + 1);
  EXPECT_EQ(entries[0].text, "Full List as per Name File");
  EXPECT_EQ(entries[1].text, "Chart List A");
  EXPECT_EQ(entries[2].text, "Chart List B (Empty)") << "fewer than 2 bytes";
  EXPECT_EQ(entries[3].text, "Chart List C") << "2 bytes";
  EXPECT_EQ(entries[9].text, "Chart List J (Empty)") << "no I";
  EXPECT_EQ(entries[10].text, "Banks (Empty)");
  EXPECT_EQ(entries[11].text, "Chart Scan Results (Empty)");
}

TEST_F(ChartSelectionTest, AChosenListIsShownFromItsFirstRecord) {
  Loaded();
  state.ICFilterOn = true;
  state.ICFilter = "011";
  state.BarSpacing = 0;
  state.ChartPeriod = Period::kWeekly;
  PutList('A', {Entry(5, "ADV"), Entry(1, "AAA")});
  ChooseList(2, "Mine");
  EXPECT_TRUE(state.ChartListChanged);
  EXPECT_EQ(state.ChartIndex, 0);
  EXPECT_TRUE(Selection().Activate());
  EXPECT_FALSE(state.ChartListChanged);
  EXPECT_EQ(view().Label8, "Mine");
  EXPECT_EQ(view().Text4, "2");
  EXPECT_EQ(view().Combo1, kLineIndex);
  EXPECT_EQ(view().Combo4, kWeeklyIndex);
  EXPECT_FALSE(state.ICFilterOn);
  EXPECT_EQ(state.ICFilter, "");
  EXPECT_FALSE(view().IndustryEnabled);
  EXPECT_EQ(state.BarSpacing, 2);
  EXPECT_EQ(view().Text3, "2");
  ExpectShown("ADV", 1);
  EXPECT_FALSE(Selection().Activate()) << "the next return changes nothing";
}

TEST_F(ChartSelectionTest, AnEmptyChosenListTellsHowToMakeOne) {
  Loaded();
  ChooseList(4, "Chart List C (Empty)");
  Selection().Activate();
  ExpectSaid(
      " There are no records in Chart List C (Empty) for this folder.\n"
      " At Main Menu click EDIT / Edit Chart Lists to create your special interest list",
      "Chart Lists  c:\\korawin\\data\\");
  EXPECT_EQ(state.ChartListNo, kFullList);
  EXPECT_EQ(view().Label8, " FULL LIST   (Names.Dat)");
  EXPECT_TRUE(view().IndustryEnabled);
  ExpectShown("AAA", 1);
}

TEST_F(ChartSelectionTest, TheResultListCanBeChosen) {
  Loaded();
  PutList('Z', {Entry(4, "XAO")});
  ChooseList(kResultList, "Chart Scan Results");
  Selection().Activate();
  EXPECT_EQ(state.ChartListNo, kResultList);
  ExpectShown("XAO", 1);
}

TEST_F(ChartSelectionTest, NothingChosenStandsForTheFullList) {
  Loaded();
  state.ChartListNo = 5;
  Selection().ChooseList(nullptr);
  EXPECT_EQ(state.ChartListNo, kFullList);
  EXPECT_EQ(state.ChartListName, "Full List as per Name File");
  ChooseList(13);
  EXPECT_EQ(state.ChartListNo, kFullList);
  Selection().Activate();
  EXPECT_EQ(view().Label8, " FULL LIST   (Names.Dat)");
  EXPECT_EQ(state.ChartListName, " FULL LIST   (Names.Dat)");
}

// ---- Codes

TEST_F(ChartSelectionTest, ALowerCaseCodeFindsTheUpperCaseRecord) {
  Loaded();
  Selection().ChoosePeriod(kWeeklyIndex);
  EXPECT_EQ(Selection().EnterCode(" bhp "), ChartSelection::Entered::kFound);
  ExpectShown("BHP", 3);
  EXPECT_EQ(view().Text2, "Broken Hill");
  EXPECT_EQ(view().Combo4, kDailyIndex);
  EXPECT_EQ(view().OAve1, "21");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartSelectionTest, ACodeOfASeriesWithoutBarsGivesLineAndAShareTheStyleOfTheChart) {
  Keep("Type", "C");
  Loaded();
  Selection().EnterCode("ADV");
  EXPECT_EQ(view().Combo1, kLineIndex);
  Selection().EnterCode("XAO");
  EXPECT_EQ(view().Combo1, kCandleIndex);
}

TEST_F(ChartSelectionTest, AFoundCodeBringsASpacingOutside1To20To2) {
  Loaded();
  for (const char* text : {"0", "21", "", "-4"}) {
    Selection().TypeSpacing(text);
    Selection().EnterCode("BHP");
    EXPECT_EQ(view().Text3, "2") << text;
  }
  Selection().TypeSpacing("20");
  Selection().EnterCode("BHP");
  EXPECT_EQ(view().Text3, "20");
}

TEST_F(ChartSelectionTest, AnEmptyEntryDoesNothing) {
  Loaded();
  EXPECT_EQ(Selection().EnterCode("   "), ChartSelection::Entered::kNothing);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartSelectionTest, TheNearestCodeIsTheFirstAtOrAfterItsThreeCharacters) {
  Loaded();
  Selection().ChooseOscillator(12);
  EXPECT_EQ(Selection().EnterCode("BH"), ChartSelection::Entered::kNearest);
  ExpectSaid("No record on file for that code - Find nearest code ?", "Chart Selection");
  ExpectShown("BHP", 3);
  EXPECT_EQ(view().Combo2, 0);
  EXPECT_FALSE(state.OscShown);
  EXPECT_EQ(Selection().EnterCode("BBBOPT"), ChartSelection::Entered::kNearest);
  ExpectShown("BBB", 2);
}

TEST_F(ChartSelectionTest, NoToTheNearestCodeLeavesEverything) {
  Loaded();
  Selection().Scroll(4);
  dialogs.answers = {Answer::kNo};
  EXPECT_EQ(Selection().EnterCode("QQQ"), ChartSelection::Entered::kNothing);
  ExpectShown("XAO", 4);
}

TEST_F(ChartSelectionTest, NothingNearGoesToTheFirst) {
  Loaded();
  Selection().Scroll(4);
  EXPECT_EQ(Selection().EnterCode("ZZZZ9"), ChartSelection::Entered::kNearest);
  ExpectShown("ZZZ", 6);
  PutNames({Named("AAA", "Alpha"), Named("BBB", "Beta")});
  EXPECT_EQ(Selection().EnterCode("ZZZ"), ChartSelection::Entered::kNearest);
  ExpectShown("AAA", 1);
}

TEST_F(ChartSelectionTest, AnEntryOfMoreThanSixCharactersMatchesNoCode) {
  PutNames({Named("ABCDEF", "Six")});
  Loaded();
  dialogs.answers = {Answer::kNo};
  EXPECT_EQ(Selection().EnterCode("ABCDEFG"), ChartSelection::Entered::kNothing);
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(ChartSelectionTest, InAListTheCodeIsThatOfTheRecordsItLeadsTo) {
  Loaded();
  PutList('A', {Entry(2, "BBB"), Entry(3, "OLD")});
  state.ChartListNo = 2;
  Loaded();
  EXPECT_EQ(Selection().EnterCode("bhp"), ChartSelection::Entered::kFound);
  ExpectShown("BHP", 2);
  dialogs.answers = {Answer::kNo};
  EXPECT_EQ(Selection().EnterCode("AAA"), ChartSelection::Entered::kNothing) << "not in the list";
}

TEST_F(ChartSelectionTest, ACodeFarDownALongFileIsFound) {
  std::vector<NameRec> names;
  for (int i = 1000; i < 3000; ++i) names.push_back(Security("C" + std::to_string(i)));
  PutNames(names);
  Loaded();
  EXPECT_EQ(Selection().EnterCode("C2999"), ChartSelection::Entered::kFound);
  ExpectShown("C2999", 2000);
  EXPECT_EQ(Selection().EnterCode("C1512"), ChartSelection::Entered::kFound);
  ExpectShown("C1512", 513);
}

TEST_F(ChartSelectionTest, SearchByNameNeedsTheFullListAndAText) {
  Loaded();
  EXPECT_TRUE(Selection().MaySearchByName("Hill"));
  EXPECT_FALSE(Selection().MaySearchByName("  "));
  EXPECT_TRUE(dialogs.said.empty());
  PutList('A', {Entry(1, "AAA")});
  state.ChartListNo = 2;
  Loaded();
  EXPECT_FALSE(Selection().MaySearchByName("Hill"));
  ExpectSaid("You have Chart List A selected.\nSearch by NAME only available when using FULL LIST",
             "Search by Name");
}

TEST_F(ChartSelectionTest, AMatchIsShownAndNoMatchLeadsToTheFirst) {
  Loaded();
  Selection().TakeSearch(std::int16_t(5));
  ExpectShown("ADV", 5);
  EXPECT_EQ(view().Combo1, kLineIndex);
  Selection().TakeSearch(std::nullopt);
  ExpectShown("AAA", 1);
}

TEST_F(ChartSelectionTest, ScrollingBeyondTheCountGoesToTheFirst) {
  Loaded();
  Selection().Scroll(2);
  ExpectShown("BBB", 2);
  Selection().Scroll(7);
  ExpectShown("AAA", 1);
}

// ---- Spacing

TEST_F(ChartSelectionTest, LeavingTheSpacingHoldsItTo1To20) {
  Loaded();
  const struct {
    const char *typed, *bar, *candle;
  } cases[] = {{"0", "2", "3"},    {"1", "1", "3"},    {"2", "2", "3"}, {"3", "3", "3"},
               {"20", "20", "20"}, {"21", "20", "20"}, {"x", "2", "3"}, {"", "2", "3"}};
  for (const auto& c : cases) {
    Selection().ChooseStyle(kBarIndex);
    Selection().TypeSpacing(c.typed);
    Selection().LeaveSpacing();
    EXPECT_EQ(view().Text3, c.bar) << c.typed;
    Selection().ChooseStyle(kCandleIndex);
    Selection().TypeSpacing(c.typed);
    Selection().LeaveSpacing();
    EXPECT_EQ(view().Text3, c.candle) << c.typed;
  }
}

TEST_F(ChartSelectionTest, UpDownWrapsFrom10To1AndBack) {
  Loaded();
  const auto step = [&](const char* from, bool up) {
    Selection().TypeSpacing(from);
    Selection().StepSpacing(up);
    return view().Text3;
  };
  EXPECT_EQ(step("10", true), "1");
  EXPECT_EQ(step("1", false), "10");
  EXPECT_EQ(step("", true), "2") << "an empty box counts as 1";
  EXPECT_EQ(step("", false), "10");
  EXPECT_EQ(step("20", false), "19");
  EXPECT_EQ(step("20", true), "1");
  Selection().ChooseStyle(kCandleIndex);
  EXPECT_EQ(step("2", false), "3") << "candles need three";
  EXPECT_EQ(step("10", true), "3");
  EXPECT_EQ(step("4", false), "3");
}

// ---- Type, period, bands, date, volumes

TEST_F(ChartSelectionTest, CandlesRaiseTheSpacingTo3WhenChosen) {
  Loaded();
  Selection().ChooseStyle(kCandleIndex);
  EXPECT_EQ(view().Text3, "3");
  Selection().TypeSpacing("8");
  Selection().ChooseStyle(kCandleIndex);
  EXPECT_EQ(view().Text3, "8");
}

TEST_F(ChartSelectionTest, PointAndFigureTurnsOffWhatItCannotShow) {
  Loaded();
  Selection().ChoosePeriod(kMonthlyIndex);
  Selection().ChooseOscillator(3);
  state.DateLimitOn = true;
  state.ScrollInUse = true;
  Selection().ChooseStyle(kPointFigureIndex);
  EXPECT_EQ(view().Label4, "Point Reversal");
  EXPECT_EQ(view().Combo4, kDailyIndex);
  EXPECT_FALSE(view().ExtrasEnabled);
  EXPECT_FALSE(state.OscShown);
  EXPECT_FALSE(state.DateLimitOn);
  EXPECT_FALSE(state.ScrollInUse);
  EXPECT_EQ(view().Text6, "LATEST");
  Selection().ChooseStyle(kLineIndex);
  EXPECT_EQ(view().Label4, "Chart Spacing");
  EXPECT_TRUE(view().ExtrasEnabled);
}

TEST_F(ChartSelectionTest, AveragesFollowThePeriodSaveForPointAndFigure) {
  Loaded();
  Selection().ChoosePeriod(kWeeklyIndex);
  EXPECT_EQ(view().OAve1, "10");
  Selection().ChoosePeriod(kDailyIndex);
  EXPECT_EQ(view().OAve1, "21");
  Selection().ChoosePeriod(kMonthlyIndex);
  EXPECT_EQ(view().OAve2, "30");
  Selection().ChoosePeriod(kDailyIndex);
  Selection().ChooseStyle(kPointFigureIndex);
  Selection().ChoosePeriod(kWeeklyIndex);
  EXPECT_EQ(view().OAve1, "21");
}

TEST_F(ChartSelectionTest, OnlyPercentageBandsAreAskedFor) {
  Loaded();
  EXPECT_TRUE(Selection().ChooseBands(1));
  EXPECT_EQ(state.BandKind, 1);
  EXPECT_FALSE(Selection().ChooseBands(2));
  EXPECT_EQ(state.BandKind, 2);
  EXPECT_FALSE(Selection().ChooseBands(0));
}

TEST_F(ChartSelectionTest, TheFinishDateIsAskedForAndGoesBackToLatest) {
  Loaded();
  int asked = 0;
  const auto ask = [&] {
    EXPECT_TRUE(state.DateLimitOn);
    ++asked;
    state.ChosenLimitText = "9/4/95";
    state.ChosenLimitDate = "19950409";
    return true;
  };
  Selection().ClickFinishDate(ask);
  EXPECT_EQ(view().Text6, "9/4/95");
  EXPECT_TRUE(state.DateLimitOn);
  EXPECT_EQ(state.DateLimitDate, "19950409");
  EXPECT_EQ(Loaded().Text6, "9/4/95") << "on the next load too";
  state.ScrollInUse = true;
  Selection().ClickFinishDate(ask);
  EXPECT_EQ(view().Text6, "LATEST");
  EXPECT_FALSE(state.DateLimitOn);
  EXPECT_FALSE(state.ScrollInUse);
  EXPECT_EQ(asked, 1);
  Selection().ClickFinishDate([] { return false; });
  EXPECT_FALSE(state.DateLimitOn) << "given up";
  EXPECT_EQ(view().Text6, "LATEST");
  Selection().ClickFinishDate({});
  EXPECT_FALSE(state.DateLimitOn) << "no form to ask";
  Selection().ChooseStyle(kPointFigureIndex);
  Selection().ClickFinishDate(ask);
  EXPECT_EQ(view().Text6, "LATEST");
  EXPECT_EQ(asked, 1);
}

TEST_F(ChartSelectionTest, VolumesFlip) {
  Loaded();
  Selection().FlipVolumes();
  EXPECT_EQ(view().Text7, "OFF");
  EXPECT_FALSE(state.VolumeOption);
  Selection().FlipVolumes();
  EXPECT_EQ(view().Text7, "ON");
}

// ---- Industry filter

TEST_F(ChartSelectionTest, AFilterThatEndsIn0IsAGroupAndAnyOtherOneClass) {
  EXPECT_TRUE(MatchesIndClass("011", "010"));
  EXPECT_TRUE(MatchesIndClass("019", "010"));
  EXPECT_TRUE(MatchesIndClass("010", "010"));
  EXPECT_FALSE(MatchesIndClass("021", "010"));
  EXPECT_FALSE(MatchesIndClass("01", "010")) << "three characters";
  EXPECT_TRUE(MatchesIndClass("011", "011"));
  EXPECT_FALSE(MatchesIndClass("012", "011"));
  EXPECT_FALSE(MatchesIndClass("", "010"));
  EXPECT_FALSE(MatchesIndClass("011", ""));
  EXPECT_FALSE(MatchesIndClass("011", "0"));
  EXPECT_FALSE(MatchesIndClass("0", "0"));
}

TEST_F(ChartSelectionTest, AGroupIsSteppedThroughAndItsEndIsTold) {
  Loaded();
  Selection().ChoosePeriod(kWeeklyIndex);
  Selection().EnterIndustry(" 010 ", false);
  ExpectShown("AAA", 1);
  EXPECT_TRUE(view().Check16);
  EXPECT_EQ(view().Text8, "010");
  EXPECT_EQ(state.ICFilter, "010");
  EXPECT_TRUE(state.ICFilterOn);
  EXPECT_EQ(view().Combo1, kBarIndex);
  EXPECT_EQ(view().Combo4, kDailyIndex);
  Selection().Scroll(2);
  ExpectShown("BHP", 3);
  Selection().Scroll(4);
  ExpectShown("ZZZ", 6);
  EXPECT_EQ(view().Combo1, kLineIndex);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartSelectionTest, OneClassAlone) {
  Loaded();
  Selection().EnterIndustry("012", true);
  ExpectShown("BHP", 3);
  Selection().Scroll(4);
  ExpectShown("ZZZ", 6);
}

TEST_F(ChartSelectionTest, AClassThatNoRecordHasClearsTheFilter) {
  Loaded();
  Selection().Scroll(4);
  Selection().EnterIndustry("999", false);
  ExpectSaid("No records on file for that Industry classification or group",
             "Industry Classification");
  EXPECT_FALSE(state.ICFilterOn);
  EXPECT_EQ(state.ICFilter, "");
  EXPECT_FALSE(view().Check16);
  EXPECT_EQ(view().Text8, "");
  ExpectShown("AAA", 1);
}

TEST_F(ChartSelectionTest, AnEmptyPickIsInvalidAndAnEmptyEntryUnticks) {
  Loaded();
  Selection().StartIndustryPicker();
  EXPECT_TRUE(view().Check16);
  EXPECT_TRUE(state.ICFilterOn);
  Selection().EnterIndustry(" ", true);
  ExpectSaid("Industry Classification invalid", "Analysis");
  EXPECT_FALSE(view().Check16);
  EXPECT_FALSE(state.ICFilterOn);
  Selection().EnterIndustry("011", false);
  Selection().EnterIndustry("", false);
  EXPECT_FALSE(view().Check16);
  EXPECT_FALSE(state.ICFilterOn);
  EXPECT_EQ(state.ICFilter, "");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartSelectionTest, TheFilterIsStillThereOnTheNextLoadUnlessItIsEmpty) {
  Loaded();
  Selection().EnterIndustry("011", false);
  Loaded();
  EXPECT_TRUE(view().Check16);
  EXPECT_EQ(view().Text8, "011");
  state.ICFilter.clear();
  Loaded();
  EXPECT_FALSE(view().Check16);
  EXPECT_FALSE(state.ICFilterOn);
}

// ---- OK and Close

TEST_F(ChartSelectionTest, OkStoresAndWritesTheChoices) {
  Loaded();
  Selection().EnterCode("BHP");
  Selection().ChooseStyle(kCandleIndex);
  Selection().ChoosePeriod(kWeeklyIndex);
  Selection().TypeSpacing("5.5");
  Selection().ChooseBands(2);
  Selection().ChooseOscillator(14);
  Selection().TickAverage(2, true);
  ASSERT_TRUE(Selection().OK());
  EXPECT_EQ(state.ChartStyle, Style::kCandlestick);
  EXPECT_EQ(state.ChartPeriod, Period::kWeekly);
  EXPECT_EQ(state.BarSpacing, 6) << "half to even";
  EXPECT_EQ(state.BandKind, 2);
  EXPECT_EQ(state.OscSelected, "RSI");
  EXPECT_EQ(state.ChartIndex, 3);
  EXPECT_EQ(Kept("Type"), "C");
  EXPECT_EQ(Kept("Period"), "W");
  EXPECT_EQ(Kept("Spacing"), "6");
  EXPECT_EQ(Kept("Bands"), "2");
  EXPECT_EQ(Kept("AutoOsc"), "True");
  EXPECT_EQ(Kept("List"), "1");
  EXPECT_EQ(Kept("AvOne"), "False");
  EXPECT_EQ(Kept("AvTwo"), "True");
  EXPECT_EQ(settings.charts.Type, "C");
  EXPECT_TRUE(settings.charts.AvTwo);
}

TEST_F(ChartSelectionTest, OkWithPointAndFigureKeepsItsReversalOf1AndNoBands) {
  Loaded();
  Selection().ChooseBands(1);
  Selection().ChooseStyle(kPointFigureIndex);
  Selection().TypeSpacing("1");
  state.OscShown = true;
  ASSERT_TRUE(Selection().OK());
  EXPECT_EQ(state.BarSpacing, 1);
  EXPECT_EQ(state.BandKind, 0);
  EXPECT_FALSE(state.OscShown);
  EXPECT_EQ(Kept("Type"), "P");
  EXPECT_EQ(Kept("Spacing"), "1");
  EXPECT_EQ(Kept("Bands"), "0");
  EXPECT_EQ(Kept("AutoOsc"), "False");
}

TEST_F(ChartSelectionTest, OkTakesASpacingBelow2As2ForOtherStyles) {
  Loaded();
  Selection().TypeSpacing("1");
  Selection().OK();
  EXPECT_EQ(state.BarSpacing, 2);
}

TEST_F(ChartSelectionTest, OkWithASpacingThatIsNoNumberToKeepSaysSoAndChangesNothing) {
  Loaded();
  Selection().TypeSpacing("99999999");
  Selection().ChoosePeriod(kWeeklyIndex);
  EXPECT_FALSE(Selection().OK());
  ExpectSaid("There is an unexpected error number 6", "Chart Select");
  EXPECT_EQ(state.BarSpacing, 2);
  EXPECT_EQ(state.ChartPeriod, Period::kDaily);
  EXPECT_EQ(state.ChartIndex, 1);
  EXPECT_EQ(Kept("Period"), "unknown");
}

TEST_F(ChartSelectionTest, SettingsThatCannotBeWrittenDoNotKeepTheChartFromShowing) {
  Loaded();
  Selection().ChoosePeriod(kWeeklyIndex);
  io.Reset(1);
  io.lasting = true;
  EXPECT_TRUE(Selection().OK());
  EXPECT_EQ(state.ChartPeriod, Period::kWeekly);
  Selection().Close();
  EXPECT_GT(io.calls, 0);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartSelectionTest, CloseWritesOnlyWhatIsInRange) {
  Loaded();
  state.BarSpacing = 11;
  state.BandKind = 0;
  state.ChartListNo = 4;
  Selection().Close();
  EXPECT_EQ(Kept("Type"), "B");
  EXPECT_EQ(Kept("Period"), "A");
  for (const char* key : {"Spacing", "Bands", "List"}) EXPECT_EQ(Kept(key), "unknown") << key;
  EXPECT_EQ(Kept("AutoOsc"), "False");
  EXPECT_EQ(Kept("AvOne"), "False");
  EXPECT_EQ(Kept("AvTwo"), "False");
  state.BarSpacing = 10;
  state.BandKind = 2;
  state.ChartListNo = 3;
  state.ChartPeriod = Period::kMonthly;
  Selection().Close();
  EXPECT_EQ(Kept("Period"), "M");
  EXPECT_EQ(Kept("Spacing"), "10");
  EXPECT_EQ(Kept("Bands"), "2");
  EXPECT_EQ(Kept("List"), "3");
}

TEST_F(ChartSelectionTest, AnotherFolderStartsWithTheFullList) {
  Loaded();
  state.ChartListNo = 3;
  state.ChartListName = "x";
  Selection().FolderChanged();
  EXPECT_EQ(state.ChartListNo, kFullList);
  EXPECT_EQ(state.ChartListName, "");
}

// ---- The second chart of a pair

TEST_F(ChartSelectionTest, TheSecondChartStartsFromTheFirstAndWritesNothing) {
  Loaded();
  state.ChartIndex = 3;
  state.ChartStyle = Style::kCandlestick;
  state.BarSpacing = 4;
  state.DateLimitOn = true;
  state.OscShown = true;
  Selection().LoadSecond();
  EXPECT_EQ(view().Combo1, kCandleIndex);
  EXPECT_EQ(view().Text3, "4");
  ExpectShown("BHP", 3);
  Selection().ChooseStyle(kPointFigureIndex);
  EXPECT_EQ(view().Label4, "Point Reversal");
  EXPECT_TRUE(state.DateLimitOn) << "the first chart's limit is the pair's";
  EXPECT_TRUE(state.OscShown);
  Selection().ChooseStyle(kLineIndex);
  Selection().EnterCode("XAO");
  ASSERT_TRUE(Selection().OK());
  EXPECT_EQ(state.ChartIndex, 4);
  EXPECT_EQ(Kept("Type"), "unknown");
}

}  // namespace
}  // namespace kora
