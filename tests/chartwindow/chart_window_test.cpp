#include "chartwindow/chart_window.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "base/dates.h"
#include "indicators/roc_momentum.h"
#include "lists/chart_list.h"
#include "tests/chartwindow/window_fixture.h"
#include "tests/support/all_oscillators.h"
#include "tests/support/failing_io.h"
#include "tests/support/recording_surface.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

using test::Bytes;
using test::Day;
using test::RecordingSurface;
using test::ScriptedDialogs;
using test::Security;
using test::TempHome;

TEST_F(ChartWindowTest, TheFirstChartIsTheFirstSecurityOfTheNameFile) {
  PutThree();
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(state.ChartIndex, 1);
  EXPECT_EQ(shown(), "AAA.WDT");
  EXPECT_EQ(current.NameCount, 3);
  EXPECT_EQ(current.NameRecNo, 1);
  EXPECT_TRUE(window().Chart.ChartDrawn);
  EXPECT_EQ(window().Chart.Bars.BarCount, 27);
  EXPECT_NE(script().find("AAA"), std::string::npos);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartWindowTest, TheSecurityOnShowIsFollowedWhereTheNameFileIsPutInAnotherOrder) {
  PutThree();
  window().NextChart();
  window().NextChart();
  EXPECT_EQ(shown(), "BBB.WDT");
  PutNames({Security("NEW"), Security("AAB"), Security("AAA"), Security("BBB"), Security("CCC")});
  --state.ChartIndex;  // drawn anew
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(state.ChartIndex, 4);
  PutThree();
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(shown(), "CCC.WDT");
  EXPECT_EQ(state.ChartIndex, 3);
  PutNames({Security("AAA"), Security("BBB")});  // gone: its place decides
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(shown(), "AAA.WDT");
}

TEST_F(ChartWindowTest, ForwardFromTheLastChartGoesToRecordOne) {
  PutThree();
  for (const char* expected : {"AAA.WDT", "BBB.WDT", "CCC.WDT", "AAA.WDT"}) {
    EXPECT_TRUE(window().NextChart());
    EXPECT_EQ(shown(), expected);
  }
  EXPECT_EQ(state.ChartIndex, 1);
}

TEST_F(ChartWindowTest, AChartIsShownByItsPlace) {
  PutThree();
  EXPECT_TRUE(window().ShowAt(3));
  EXPECT_EQ(shown(), "CCC.WDT");
  EXPECT_EQ(state.ChartIndex, 3);
  EXPECT_TRUE(window().ShowAt(2));
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_TRUE(window().ShowAt(4));
  EXPECT_EQ(shown(), "AAA.WDT") << "beyond the last comes the first";
}

TEST_F(ChartWindowTest, BackwardFromRecordOneGoesToTheLast) {
  PutThree();
  window().NextChart();
  state.ChartDirection = 0;
  EXPECT_TRUE(window().StepChart());
  EXPECT_EQ(shown(), "CCC.WDT");
  EXPECT_EQ(state.ChartIndex, 3);
  EXPECT_TRUE(window().StepChart());
  EXPECT_EQ(shown(), "BBB.WDT");
  state.ChartDirection = 1;
  EXPECT_TRUE(window().StepChart());
  EXPECT_EQ(shown(), "CCC.WDT");
}

TEST_F(ChartWindowTest, ARedrawStaysOnTheChart) {
  PutThree();
  window().NextChart();
  EXPECT_TRUE(window().Redraw());
  EXPECT_EQ(state.ChartIndex, 1);
  EXPECT_EQ(shown(), "AAA.WDT");
  window().NextChart();
  EXPECT_TRUE(window().Redraw());
  EXPECT_EQ(shown(), "BBB.WDT");
}

TEST_F(ChartWindowTest, ThereIsNothingToRedrawBeforeTheFirstChart) {
  PutThree();
  EXPECT_FALSE(window().Redraw());
  EXPECT_EQ(state.ChartIndex, 0);
  EXPECT_TRUE(surface.ops.empty());
}

TEST_F(ChartWindowTest, NothingIsComposedWhileLoading) {
  PutThree();
  window().Loading = true;
  EXPECT_FALSE(window().NextChart());
  EXPECT_FALSE(window().StepChart());
  EXPECT_FALSE(window().DrawChart());
  EXPECT_EQ(state.ChartIndex, 0);
  EXPECT_TRUE(surface.ops.empty());
}

TEST_F(ChartWindowTest, DataWithoutBarsComesUpAsALineAndTheStyleStays) {
  PutNames({Security("AAA"), Security("CLO", 1, kCloseOnly), Security("CCC")});
  window().NextChart();
  EXPECT_EQ(state.ChartStyle, Style::kBar);
  window().NextChart();
  EXPECT_EQ(state.ChartStyle, Style::kLine);
  window().NextChart();
  EXPECT_EQ(state.ChartStyle, Style::kLine);
  EXPECT_EQ(shown(), "CCC.WDT");
}

TEST_F(ChartWindowTest, EveryTypeWithoutBarsTurnsCandlesIntoALine) {
  for (const std::int16_t type : {kCloseVolume, kCloseOnly, kAdvanceDecline}) {
    PutNames({Security("CLO", 1, type)});
    state.ChartStyle = Style::kCandlestick;
    window().NextChart();
    EXPECT_EQ(state.ChartStyle, Style::kLine) << type;
  }
  for (const std::int16_t type : {kShare, kIndex}) {
    PutNames({Security("BAR", 1, type)});
    state.ChartStyle = Style::kCandlestick;
    window().NextChart();
    EXPECT_EQ(state.ChartStyle, Style::kCandlestick) << type;
  }
}

TEST_F(ChartWindowTest, AMissingNameFileIsToldAndNothingIsShown) {
  EXPECT_FALSE(window().NextChart());
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Charts");
  EXPECT_EQ(
      dialogs.said[0].text.find("There is a file access problem. Check directory paths option."),
      0u);
  EXPECT_NE(dialogs.said[0].text.find("c:\\korawin\\data\\Names.dat"), std::string::npos);
  EXPECT_EQ(state.ChartIndex, 0);
}

TEST_F(ChartWindowTest, AnEmptyNameFileIsTold) {
  // A torn record is none.
  for (const std::string& bytes : {std::string(), std::string(95, 'x')}) {
    home.Put("drive_c/korawin/data/Names.dat", bytes);
    dialogs.said.clear();
    EXPECT_FALSE(window().NextChart());
    ASSERT_EQ(dialogs.said.size(), 1u);
    EXPECT_EQ(dialogs.said[0].text, " There are no records in Names.Dat for this folder.");
    EXPECT_EQ(state.ChartIndex, 0);
  }
}

TEST_F(ChartWindowTest, ANameFileThatIsAFolderIsTold) {
  home.files().MakeFolder("c:\\korawin\\data\\Names.dat");
  EXPECT_FALSE(window().NextChart());
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(ChartWindowTest, ASecurityWithoutAPriceFileIsToldAndPassedByTheNextStep) {
  PutThree();
  home.files().Remove("c:\\korawin\\data\\BBB.WDT");
  window().NextChart();
  EXPECT_FALSE(window().NextChart());
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_FALSE(window().Chart.ChartDrawn);
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(shown(), "CCC.WDT");
  EXPECT_FALSE(dialogs.busy);
}

TEST_F(ChartWindowTest, AChartThatFailedIsTriedAgainAtAnotherSizeAndItsFailureToldOnce) {
  PutThree();
  home.files().Remove("c:\\korawin\\data\\AAA.WDT");
  EXPECT_FALSE(window().NextChart());
  ASSERT_EQ(dialogs.said.size(), 1u);
  for (int i = 0; i < 3; ++i) EXPECT_FALSE(window().Resized());
  EXPECT_EQ(dialogs.said.size(), 1u);
  PutPrices("AAA");
  EXPECT_TRUE(window().Resized());
  EXPECT_TRUE(window().Chart.ChartDrawn);
  EXPECT_EQ(shown(), "AAA.WDT");
  EXPECT_EQ(dialogs.said.size(), 1u);
  // It failed anew, of which the user knows nothing.
  home.files().Remove("c:\\korawin\\data\\AAA.WDT");
  EXPECT_FALSE(window().Resized());
  EXPECT_EQ(dialogs.said.size(), 2u);
  EXPECT_FALSE(window().Resized());
  EXPECT_EQ(dialogs.said.size(), 2u);
  EXPECT_FALSE(window().Refresh());
  EXPECT_EQ(dialogs.said.size(), 3u) << "the user asked";
}

TEST_F(ChartWindowTest, AChartThatFailsWhereABadRecordIsInSightStandsAtASmallerSize) {
  PutThree();
  // 400 days: 80 weeks, 20 units each. The oldest record has no date of the calendar.
  std::vector<PriceRec> days;
  for (int i = 0; i < 400; ++i) {
    const std::int32_t day = DayNumber({2020, 1, 6}) + i / 5 * 7 + i % 5;
    days.push_back(Day(FormatFileDate(DateOfDayNumber(day)), 10, 11, 9, 10));
  }
  days[0].RecDate.set("19999999");
  home.Put("drive_c/korawin/data/AAA.WDT", Bytes(days));
  window();
  state.ChartPeriod = Period::kWeekly;
  state.BarSpacing = 20;
  surface.SetWidth(2000);
  EXPECT_FALSE(window().NextChart());
  ASSERT_EQ(dialogs.said.size(), 1u);
  surface.SetWidth(1900);
  EXPECT_FALSE(window().Resized());
  EXPECT_EQ(dialogs.said.size(), 1u);
  surface.SetWidth(638);
  EXPECT_TRUE(window().Resized());
  EXPECT_GT(window().Chart.Bars.BarCount, 20);
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(ChartWindowTest, APairWhoseSecondChartFailsIsToldOnceForAllSizes) {
  PutThree();
  window().SetChart2([] {});
  window().NextChart();
  window().StartSplitScreen();
  home.files().Remove("c:\\korawin\\data\\BBB.WDT");
  EXPECT_FALSE(window().NextChart());
  ASSERT_EQ(dialogs.said.size(), 1u);
  for (int i = 0; i < 3; ++i) window().Resized();
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(ChartWindowTest, ADiskThatIsNotReadyIsAskedForOnceForAllSizes) {
  PutThree();
  struct NotReady : test::FailingIo {
    bool ready = true;
    std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
      if (!ready && path.ends_with(".WDT")) throw RunTimeError(kDiskNotReady);
      return FailingIo::Open(path, mode);
    }
  } drive;
  const Files files(home.path(), drive);
  ChartWindow charts({.files = files,
                      .dialogs = dialogs,
                      .settings = settings,
                      .ini = ini,
                      .user = user,
                      .colours = colours,
                      .current = current,
                      .state = state,
                      .price = surface,
                      .panel = panel});
  charts.Load();
  drive.ready = false;
  dialogs.answers = {Answer::kCancel, Answer::kCancel, Answer::kCancel};
  EXPECT_FALSE(charts.NextChart());
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_FALSE(charts.Resized());
  EXPECT_FALSE(charts.Resized());
  EXPECT_EQ(dialogs.said.size(), 1u);
  drive.ready = true;
  EXPECT_TRUE(charts.Resized());
}

TEST_F(ChartWindowTest, ACodeThatIsNoFileNameIsToldAndReadsNothing) {
  PutThree();
  std::vector<NameRec> names{Security("..\\X"), Security("A/B"), Security("NUL"), Security("C:")};
  home.Put("drive_c/korawin/data/Names.dat", Bytes(names));
  for (size_t i = 1; i <= names.size(); ++i) {
    EXPECT_FALSE(window().NextChart());
    EXPECT_EQ(dialogs.said.size(), i);
  }
}

TEST_F(ChartWindowTest, ANameFileThatShrankWhileTheWindowStoodWrapsToItsStart) {
  PutThree();
  for (int i = 0; i < 3; ++i) window().NextChart();
  PutNames({Security("ZZZ")});
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(shown(), "ZZZ.WDT");
}

TEST_F(ChartWindowTest, DrawnLinesAreEmptiedAtEachNewChartUnlessTwoShareTheSurface) {
  PutThree();
  window().NextChart();
  window().StartSplitScreen();
  home.Put("drive_c/korawin/data/ChtLns.Tmp", "H,1,2,3,4,5\r\n");
  window().NextChart();
  EXPECT_NE(home.Get("drive_c/korawin/data/ChtLns.Tmp"), "");
  window().NextChart();
  EXPECT_TRUE(home.Exists("drive_c/korawin/data/ChtLns.Tmp"));
  EXPECT_EQ(home.Get("drive_c/korawin/data/ChtLns.Tmp"), "");
}

// ---- Lists

std::string ListBytes(const std::vector<std::pair<int, std::string>>& records) {
  std::vector<ListRec> list;
  for (const auto& [number, code] : records) {
    ListRec rec{};
    rec.ListRecNo = std::int16_t(number);
    rec.ListCode.set(code);
    list.push_back(rec);
  }
  return Bytes(list);
}

TEST_F(ChartWindowTest, AListIsPagedInItsOwnOrderAndWrapsBothWays) {
  PutThree();
  home.Put("drive_c/korawin/data/SubListB.Dat", ListBytes({{3, "CCC"}, {1, "AAA"}}));
  window();
  state.ChartListNo = 3;
  for (const char* expected : {"CCC.WDT", "AAA.WDT", "CCC.WDT"}) {
    EXPECT_TRUE(window().NextChart());
    EXPECT_EQ(shown(), expected);
  }
  EXPECT_EQ(state.ChartListCount, 2);
  EXPECT_EQ(state.ChartIndex, 1);
  EXPECT_EQ(current.NameRecNo, 3);
  state.ChartDirection = 0;
  EXPECT_TRUE(window().StepChart());
  EXPECT_EQ(shown(), "AAA.WDT");
  EXPECT_EQ(state.ChartIndex, 2);
}

TEST_F(ChartWindowTest, ARedrawAtTheFirstPlaceOfAListReturnsToIt) {
  PutThree();
  home.Put("drive_c/korawin/data/SubListA.Dat", ListBytes({{2, "BBB"}, {1, "AAA"}}));
  window();
  state.ChartListNo = 2;
  window().NextChart();
  EXPECT_TRUE(window().Refresh());
  EXPECT_EQ(state.ChartIndex, 1);
  EXPECT_EQ(shown(), "BBB.WDT");
}

TEST_F(ChartWindowTest, ImpossibleRecordNumbersOfAListAreToldAndPassed) {
  PutThree();
  home.Put("drive_c/korawin/data/SubListA.Dat",
           ListBytes({{0, "X"}, {-5, "Y"}, {4, "Z"}, {32767, "W"}, {2, "BBB"}}) + "torn");
  window();
  state.ChartListNo = 2;
  for (size_t i = 1; i <= 4; ++i) {
    EXPECT_FALSE(window().NextChart());
    ASSERT_EQ(dialogs.said.size(), i);
    EXPECT_NE(dialogs.said.back().text.find("SubListA.Dat"), std::string::npos);
    EXPECT_EQ(state.ChartIndex, std::int16_t(i));
  }
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(state.ChartListCount, 5) << "the torn record does not count";
}

TEST_F(ChartWindowTest, AListThatVanishedIsTold) {
  PutThree();
  window();
  state.ChartListNo = 2;
  EXPECT_FALSE(window().NextChart());
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, " There are no records in Chart List A for this folder.");
  EXPECT_EQ(state.ChartIndex, 0);
}

// ---- Industry filter

class IndustryTest : public ChartWindowTest {
 protected:
  IndustryTest() {
    PutNames({Security("AAA", 1, kShare, "011"), Security("BBB", 1, kShare, "020"),
              Security("CCC", 1, kShare, "012"), Security("DDD", 1, kShare, "01"),
              Security("EEE", 1, kShare, "")});
    window().NextChart();
    state.ICFilterOn = true;
  }
  std::string Step(int direction) {
    state.ChartDirection = std::int16_t(direction);
    EXPECT_TRUE(window().StepChart());
    return shown();
  }
};

TEST_F(IndustryTest, AGroupIsEveryClassOfThreeDigitsThatBeginsAlike) {
  state.ICFilter = "010";
  EXPECT_EQ(Step(1), "CCC.WDT");
  EXPECT_EQ(Step(1), "AAA.WDT") << "DDD has two digits; the walk starts once more at the first";
  EXPECT_EQ(Step(0), "CCC.WDT") << "backward it starts once more at the last";
  EXPECT_EQ(Step(0), "AAA.WDT");
}

TEST_F(IndustryTest, AClassMustBeEqual) {
  state.ICFilter = " 012 ";
  EXPECT_EQ(Step(1), "CCC.WDT");
  EXPECT_EQ(Step(1), "CCC.WDT");
  EXPECT_EQ(Step(0), "CCC.WDT");
}

TEST_F(IndustryTest, WithoutAMatchItSaysSoAndShowsTheFirst) {
  for (const char* filter : {"099", ""}) {
    state.ICFilter = filter;
    dialogs.said.clear();
    EXPECT_EQ(Step(1), "AAA.WDT");
    ASSERT_EQ(dialogs.said.size(), 1u);
    EXPECT_EQ(dialogs.said[0].text, "No records on file for that Industry classification or group");
    EXPECT_EQ(dialogs.said[0].title, "Industry Classification");
    EXPECT_EQ(state.ChartIndex, 1);
  }
}

TEST_F(IndustryTest, TheFilterDoesNotHoldForTheNextChartOrInAList) {
  state.ICFilter = "012";
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(shown(), "BBB.WDT");
  home.Put("drive_c/korawin/data/SubListA.Dat", ListBytes({{2, "BBB"}, {5, "EEE"}}));
  state.ChartListNo = 2;
  state.ChartIndex = 1;
  EXPECT_EQ(Step(1), "EEE.WDT");
}

// ---- Date limit

TEST_F(ChartWindowTest, TheDateLimitShowsItsStepsAndEndsTheChart) {
  PutThree();
  window();
  state.DateLimitOn = true;
  state.ChosenLimitText = "15/02/2026";
  state.ChosenLimitDate = "20260215";
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(window().Chart.Bars.BarCount, 14);
  EXPECT_TRUE(window().view().FrameShown);
  EXPECT_EQ(window().view().Panels[0], "Date Limit ON");
  EXPECT_TRUE(window().view().PanelShown[0]);
  state.DateLimitOn = false;
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(window().Chart.Bars.BarCount, 27);
  EXPECT_FALSE(window().view().FrameShown);
  EXPECT_EQ(window().view().Panels[0], "");
}

TEST_F(ChartWindowTest, TheLimitStepsByTheCalendarAndTheNextChartGoesBackToTheChosenOne) {
  PutThree();
  window();
  state.DateLimitOn = true;
  state.ChosenLimitText = "31/01/2024";
  state.ChosenLimitDate = "20240131";
  window().NextChart();
  dialogs.said.clear();
  const struct {
    int index;
    const char* text;
  } steps[] = {{2, "29/02/2024"}, {1, "07/03/2024"}, {0, "08/03/2024"},
               {3, "07/03/2024"}, {4, "29/02/2024"}, {5, "29/01/2024"}};
  for (const auto& step : steps) {
    window().StepDateLimit(step.index);
    EXPECT_EQ(state.DateLimitText, step.text);
    EXPECT_EQ(state.DateLimitDate, DateToFile(step.text));
    EXPECT_EQ(state.ChosenLimitText, "31/01/2024");
    EXPECT_FALSE(state.DateLimitMoved);
  }
  EXPECT_EQ(shown(), "AAA.WDT");
  state.ChartDirection = 1;
  window().StepChart();
  EXPECT_EQ(state.DateLimitText, "31/01/2024");
}

TEST_F(ChartWindowTest, AStepBeyondTheDataOrOfNoDateIsHarmless) {
  PutThree();
  window();
  state.DateLimitOn = true;
  state.ChosenLimitText = "01/02/2026";
  state.ChosenLimitDate = "20260201";
  window().NextChart();
  window().StepDateLimit(5);  // before the data
  EXPECT_EQ(state.DateLimitDate, "20260101");
  window().StepDateLimit(2);
  EXPECT_EQ(state.DateLimitDate, "20260201");
  state.DateLimitText = "rubbish";
  EXPECT_FALSE(window().StepDateLimit(0));
  EXPECT_EQ(state.DateLimitText, "rubbish");
  state.DateLimitText = "31/12/9999";
  EXPECT_FALSE(window().StepDateLimit(0));
  EXPECT_EQ(state.DateLimitText, "31/12/9999");
}

TEST_F(ChartWindowTest, TheFrameIsKeptWhereItWasDropped) {
  PutThree();
  window();
  state.DateLimitOn = true;
  state.ChosenLimitText = "15/02/2026";
  state.ChosenLimitDate = "20260215";
  window().NextChart();
  EXPECT_FALSE(window().view().Frame) << "never kept";
  window().DropFrame(200, 100, 60, 40);
  EXPECT_EQ(user.GetSetting(kUserSection, "BDFrame"), "120,170") << "top, left";
  window().Load();
  window().NextChart();
  ASSERT_TRUE(window().view().Frame);
  EXPECT_EQ(window().view().Frame->top, 120);
  EXPECT_EQ(window().view().Frame->left, 170);
  for (const char* bad : {"x,y", "12", "1,2,3", ",", "nan,inf"}) {
    user.PutSetting(kUserSection, "BDFrame", bad);
    ChartWindow fresh({.files = home.files(),
                       .dialogs = dialogs,
                       .settings = settings,
                       .ini = ini,
                       .user = user,
                       .colours = colours,
                       .current = current,
                       .state = state,
                       .price = surface,
                       .panel = panel});
    fresh.Load();
    EXPECT_TRUE(fresh.NextChart());
    EXPECT_FALSE(fresh.view().Frame) << bad;
  }
}

// ---- Style, period and switches

TEST_F(ChartWindowTest, StyleAndPeriodRedrawTheChartOnShow) {
  PutThree();
  window().NextChart();
  window().NextChart();
  EXPECT_TRUE(window().SetStyle(Style::kCandlestick));
  EXPECT_EQ(window().Request.ChartStyle, Style::kCandlestick);
  EXPECT_TRUE(window().SetPeriod(Period::kWeekly));
  EXPECT_EQ(window().Request.ChartPeriod, Period::kWeekly);
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(state.ChartIndex, 2);
  EXPECT_LT(window().Chart.Bars.BarCount, 6) << "28 days are at most five weeks";
}

TEST_F(ChartWindowTest, GridLinesAreWrittenAndDrawn) {
  PutThree();
  window().NextChart();
  EXPECT_FALSE(window().Request.GridLines);
  EXPECT_TRUE(window().ToggleGridLines());
  EXPECT_TRUE(window().Request.GridLines);
  EXPECT_EQ(ini.GetSetting("Charts", "Grid"), "True");
  EXPECT_TRUE(window().ToggleGridLines());
  EXPECT_FALSE(window().Request.GridLines);
  EXPECT_EQ(ini.GetSetting("Charts", "Grid"), "False");
  EXPECT_EQ(state.ChartIndex, 1);
}

TEST_F(ChartWindowTest, AutomaticBoxesMoveOnToTheNextChart) {
  PutThree();
  window().NextChart();
  EXPECT_TRUE(state.PFAutoBox);
  EXPECT_TRUE(window().TogglePFAuto());
  EXPECT_FALSE(state.PFAutoBox);
  EXPECT_EQ(shown(), "BBB.WDT");
}

TEST_F(ChartWindowTest, BoxValueIsAskedForOncePerChart) {
  PutThree();
  state.PFAutoBox = false;
  int asked = 0;
  window().SetAskBoxValue([&](float computed) {
    ++asked;
    return computed * 2;
  });
  window().NextChart();
  EXPECT_EQ(asked, 0) << "bars have no boxes";
  EXPECT_TRUE(window().SetStyle(Style::kPointFigure));
  EXPECT_EQ(asked, 1);
  const float given = window().Chart.Boxes.PFBoxSize;
  EXPECT_FLOAT_EQ(state.PFBoxSize, given);
  // Another size, a switch of the grid and a page of it are the same chart.
  EXPECT_TRUE(window().Resized());
  EXPECT_TRUE(window().ToggleGridLines());
  RecordingSurface page{638, 452};
  EXPECT_TRUE(window().DrawAgain(page, nullptr));
  EXPECT_EQ(asked, 1);
  EXPECT_FLOAT_EQ(window().Chart.Boxes.PFBoxSize, given);
  EXPECT_NE(script().find("Box Value = " + Str(given)), std::string::npos);
  EXPECT_TRUE(window().Refresh());
  EXPECT_EQ(asked, 2);
  EXPECT_TRUE(window().StepChart());
  EXPECT_EQ(asked, 3);
  // Automatic again, on the chart after it.
  EXPECT_TRUE(window().TogglePFAuto());
  EXPECT_EQ(asked, 3);
  EXPECT_FLOAT_EQ(window().Chart.Boxes.PFBoxSize, given / 2);
}

TEST_F(ChartWindowTest, CrossHairReadsBoxesByTheMouseAndTheKeys) {
  PutThree();
  window().NextChart();
  window().SetStyle(Style::kPointFigure);
  window().ToggleGrid();
  surface.ops.clear();
  const Composition& chart = window().Chart;
  const auto price = [&](int row) {
    return Format(row * double(chart.Boxes.PFBoxSize) + double(chart.Scale.ScaleLow), "#######.00");
  };
  window().MouseMove({100, chart.ChartBottom - 6.0 * 10, Pane::kPrice});
  EXPECT_EQ(window().view().Panels[3], price(10));
  EXPECT_EQ(window().view().Panels[2], "") << "a column has no date";
  // No line downward: the one from the scale alone.
  EXPECT_EQ(surface.ops.size(), 1u);
  // The keys go over the rows from where the pointer is.
  window().MovePoint(-1);
  EXPECT_EQ(window().view().Panels[3], price(9));
  window().MovePoint(1);
  EXPECT_EQ(window().view().Panels[3], price(10));
  // Without a pointer they begin at the row of the last close, 13.
  window().ToggleGrid();
  window().ToggleGrid();
  window().MovePoint(0);
  const int row = CInt((13 - double(chart.Scale.ScaleLow)) / double(chart.Boxes.PFBoxSize));
  EXPECT_EQ(window().view().Panels[3], price(row));
  window().MovePoint(1);
  EXPECT_EQ(window().view().Panels[3], price(row + 1));
  window().PointToEnd(false);
  EXPECT_EQ(window().view().Panels[3], price(0));
}

TEST_F(ChartWindowTest, BoxesHaveNoOscillators) {
  PutThree();
  window().NextChart();
  window().SetStyle(Style::kPointFigure);
  const std::string before = script();
  for (const char* code : {"RSI", "PARA", "OBV"}) window().PickOscillator(code);
  EXPECT_FALSE(panel.Visible());
  EXPECT_EQ(script(), before);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ChartWindowTest, SwingStandsInPlaceOfBarsAtLeastThreeApart) {
  PutThree();
  window().NextChart();
  window().SetStyle(Style::kCandlestick);
  EXPECT_TRUE(window().ToggleSwing());
  EXPECT_TRUE(state.SwingOn);
  EXPECT_EQ(state.ChartStyle, Style::kBar);
  EXPECT_EQ(window().Chart.BarSpacing, 3);
  EXPECT_NE(script().find("Daily Swing  -  Standard"), std::string::npos);
  EXPECT_TRUE(window().ToggleSwing());
  EXPECT_EQ(window().Chart.BarSpacing, 2);
  EXPECT_EQ(script().find("Swing"), std::string::npos);
  // A spacing above 3 stays.
  state.BarSpacing = 7;
  window().ToggleSwing();
  EXPECT_EQ(window().Chart.BarSpacing, 7);
  window().Unload();
  EXPECT_FALSE(state.SwingOn);
  EXPECT_EQ(state.BarSpacing, 7);
}

TEST_F(ChartWindowTest, SwingComesOnWithItsKindAndASize) {
  PutThree();
  window().NextChart();
  const auto title = [&](SwingChoice choice) {
    state.Swing = choice;
    state.SwingOn = false;
    window().ToggleSwing();
    const std::string text = script();
    const size_t at = text.find("Daily Swing");
    return at == std::string::npos ? "" : text.substr(at, text.find(',', at) - at);
  };
  EXPECT_EQ(title({SwingKind::kDays, 0}), "Daily Swing 3 - DAY");
  EXPECT_EQ(title({SwingKind::kPoints, 0.5}), "Daily Swing 3 - POINT");
  EXPECT_EQ(title({SwingKind::kPoints, 9}), "Daily Swing 9 - POINT");
  EXPECT_EQ(title({SwingKind::kPointsAuto, 0}), "Daily Swing  -  Standard");
  // Chosen while it is on, automatic points stay.
  state.Swing = {SwingKind::kPointsAuto, 0};
  window().Refresh();
  EXPECT_NE(script().find(" - Point(Auto)"), std::string::npos);
}

TEST_F(ChartWindowTest, TheLegendShowsForReversalsOfABarChartAlone) {
  PutThree();
  window().NextChart();
  EXPECT_TRUE(window().ToggleReversals());
  EXPECT_TRUE(window().Request.ColourMarks);
  EXPECT_TRUE(window().view().LegendShown);
  window().SetStyle(Style::kCandlestick);
  EXPECT_FALSE(window().view().LegendShown);
  surface.ops.clear();
  EXPECT_FALSE(window().ToggleReversals());
  EXPECT_FALSE(surface.Has("cls")) << "nothing to draw anew";
}

TEST_F(ChartWindowTest, MultipleAveragesAreDrawnAndWritten) {
  PutThree();
  settings.osc.MMASet = {3, 5};
  window().NextChart();
  const std::string plain = script();
  EXPECT_TRUE(window().ToggleMMA());
  EXPECT_GT(script().size(), plain.size());
  EXPECT_EQ(shown(), "AAA.WDT");
  EXPECT_TRUE(window().ToggleMMA());
  EXPECT_EQ(script(), plain);
}

TEST_F(ChartWindowTest, NoToggleComposesBeforeTheFirstChart) {
  PutThree();
  window();
  EXPECT_FALSE(window().SetStyle(Style::kLine));
  EXPECT_FALSE(window().ToggleGridLines());
  EXPECT_FALSE(window().ToggleReversals());
  EXPECT_FALSE(window().ToggleMMA());
  EXPECT_FALSE(window().TogglePFAuto());
  EXPECT_FALSE(window().StepDateLimit(0));
  EXPECT_FALSE(window().Resized());
  window().PickOscillator("RSI");
  window().StartSuperimpose();
  window().StartSplitScreen();
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_FALSE(surface.Has("cls"));
}

// ---- Oscillators

class OscillatorTest : public ChartWindowTest {
 protected:
  OscillatorTest() {
    PutThree();
    OscSettings& osc = settings.osc;
    for (const OscKey& key : OscKeys()) osc[key] = {5, 6};
    window().NextChart();
    dialogs.said.clear();
    panel.ops.clear();
  }
};

TEST_F(OscillatorTest, APickedOscillatorTakesTheLowerPaneAndTheScript) {
  EXPECT_FALSE(panel.Visible());
  const size_t before = script().size();
  window().PickOscillator("RSI");
  EXPECT_TRUE(panel.Visible());
  EXPECT_EQ(state.OscCode, "RSI");
  EXPECT_FALSE(panel.ops.empty());
  EXPECT_GT(script().size(), before);
}

TEST_F(OscillatorTest, APickedOneGoesWithTheNextChartUnlessItIsKept) {
  window().PickOscillator("RSI");
  window().NextChart();
  EXPECT_FALSE(panel.Visible());
  EXPECT_FALSE(state.OscShown);

  window().ToggleKeepOscillator();
  EXPECT_EQ(ini.GetSetting("Charts", "KeepOsc"), "True");
  window().PickOscillator("RSI");
  EXPECT_TRUE(state.OscShown);
  EXPECT_EQ(state.OscSelected, "RSI") << "as chart selection then shows";
  window().NextChart();
  EXPECT_TRUE(panel.Visible());
  EXPECT_EQ(state.OscCode, "RSI");

  window().ToggleKeepOscillator();
  EXPECT_EQ(ini.GetSetting("Charts", "KeepOsc"), "False");
  window().NextChart();
  EXPECT_FALSE(panel.Visible());
}

TEST_F(OscillatorTest, KeepingBeginsWithTheOneOnShow) {
  window().PickOscillator("MOM");
  window().ToggleKeepOscillator();
  window().NextChart();
  EXPECT_EQ(state.OscCode, "MOM");
  EXPECT_TRUE(panel.Visible());
  window().PickOscillator("PARA");
  window().NextChart();
  EXPECT_EQ(state.OscSelected, "PARA");
  EXPECT_FALSE(panel.Visible());
}

TEST_F(OscillatorTest, AKeptOneIsLeftOutOnPointAndFigureChartsAndComesBack) {
  state.KeepOsc = true;
  window().PickOscillator("RSI");
  window().SetStyle(Style::kPointFigure);
  EXPECT_FALSE(panel.Visible());
  window().SetStyle(Style::kBar);
  EXPECT_TRUE(panel.Visible());
}

TEST_F(OscillatorTest, ThePicturesHaveNamesForThoseWhoCanNotSeeThem) {
  EXPECT_EQ(window().ChartName(), "Chart AAA, bars, daily, 28/02/2026, close 13");
  EXPECT_EQ(window().PanelName(), "Oscillator");
  window().SetStyle(Style::kLine);
  window().PickOscillator("WMS");
  EXPECT_EQ(window().ChartName(), "Chart AAA, line, daily, 28/02/2026, close 13");
  EXPECT_EQ(window().PanelName(), "Oscillator Williams %R, last value 33.33") << "13 of 9 to 15";
  window().PickOscillator("OBV");
  EXPECT_EQ(window().PanelName(), "Oscillator On-Balance Volume, last value 355000")
      << "100,000 and 330,000 up, 75,000 down";
  settings.osc[kRocP] = {3, 3};
  window().PickOscillator("R/F");
  EXPECT_EQ(window().PanelName(), "Oscillator ROC & FX, last values 23 and 67")
      << "13 from 10; 4 of 6";
}

TEST_F(OscillatorTest, ASecondOneReplacesTheFirstOnPaneAndScript) {
  window().PickOscillator("RSI");
  const std::string rsi = script();
  window().PickOscillator("MOM");
  window().PickOscillator("RSI");
  EXPECT_EQ(script(), rsi);
}

TEST_F(OscillatorTest, ItIsNotPartOfTheNextChartButStaysAtAnotherSize) {
  window().PickOscillator("RSI");
  EXPECT_TRUE(window().Resized());
  EXPECT_TRUE(panel.Visible());
  EXPECT_EQ(state.OscCode, "RSI");
  window().NextChart();
  EXPECT_FALSE(panel.Visible());
  EXPECT_EQ(state.OscCode, "");
}

TEST_F(OscillatorTest, OneThatCannotBeShownIsToldOnceForAllSizes) {
  state.OscShown = true;
  state.OscSelected = state.OscCode = "RMO";
  window().SetPeriod(Period::kWeekly);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "RMO only available on Daily Charts");
  for (int i = 0; i < 3; ++i) {
    state.OscCode = "RMO";
    EXPECT_TRUE(window().Resized());
  }
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(OscillatorTest, OneThatChartSelectionChoseIsPartOfEveryChart) {
  state.OscShown = true;
  state.OscCode = state.OscSelected = "MACD";
  window().NextChart();
  EXPECT_TRUE(panel.Visible());
  EXPECT_EQ(window().Request.OscName, "MACD");
  window().NextChart();
  EXPECT_TRUE(panel.Visible());
}

TEST_F(OscillatorTest, TheParabolicHasNoPane) {
  state.OscShown = true;
  state.OscCode = state.OscSelected = "PARA";
  window().NextChart();
  EXPECT_FALSE(panel.Visible());
  state.OscShown = false;
  window().NextChart();
  const std::string plain = script();
  window().Redraw();
  ASSERT_EQ(script(), plain);
  window().PickOscillator("PARA");
  EXPECT_NE(script(), plain);
  EXPECT_FALSE(panel.Visible());
}

TEST_F(OscillatorTest, APeriodOfZeroIsRefusedAsTheFirstOfAPairAndLegalAsTheSecond) {
  settings.osc[kStochD].daily = 0;
  window().PickOscillator("STO");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_TRUE(panel.Visible());
  window().NextChart();
  settings.osc[kStochK].daily = 0;
  window().PickOscillator("STO");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "STO Oscillator values not valid");
  EXPECT_EQ(dialogs.said[0].title, "Oscillator Values");
  EXPECT_FALSE(panel.Visible());
}

TEST_F(OscillatorTest, EveryPeriodLiesInOneToTwoHundred) {
  const struct {
    const char* code;
    const OscKey* value;
    bool zeroIsLegal;
  } checks[] = {{"STO", &kStochK, false}, {"STO", &kStochD, true}, {"FX", &kFXF, false},
                {"FX", &kFXX, true},      {"R/F", &kFXF, false},   {"R/F", &kFXX, true},
                {"R/F", &kRocP, false},   {"ROC", &kRocP, false},  {"RSI", &kRsiP, false},
                {"MACD", &kMd1, false},   {"MACD", &kMd2, false},  {"MACD", &kMd3, false},
                {"WMS", &kWmsA, false},   {"ERY", &kERA, false},   {"DM", &kDMA, false},
                {"MOM", &kMMA, false},    {"COP", &kCopD, false},  {"JHG", &kHolyD, false},
                {"VTY", &kVtyD, false}};
  for (const auto& check : checks) {
    PeriodPair& pair = settings.osc[*check.value];
    const PeriodPair standing = pair;
    for (const int value : {0, 1, 200, 201, -1}) {
      pair.daily = std::int16_t(value);
      dialogs.said.clear();
      window().PickOscillator(check.code);
      const bool refused = value < (check.zeroIsLegal ? 0 : 1) || value > 200;
      bool told = false;
      for (const auto& said : dialogs.said)
        told |= said.text == std::string(check.code) + " Oscillator values not valid";
      EXPECT_EQ(told, refused) << check.code << " " << value;
    }
    pair = standing;
  }
}

TEST_F(OscillatorTest, MonthlyChartsCheckTheWeeklyPeriods) {
  settings.osc[kRsiP] = {0, 5};
  window().SetPeriod(Period::kMonthly);
  window().PickOscillator("RSI");
  EXPECT_TRUE(dialogs.said.empty());
  settings.osc[kRsiP] = {5, 0};
  window().PickOscillator("RSI");
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(OscillatorTest, RmoIsForDailyChartsOnly) {
  window().SetPeriod(Period::kWeekly);
  window().PickOscillator("RMO");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "RMO only available on Daily Charts");
  EXPECT_EQ(dialogs.said[0].title, "RMO");
  state.OscShown = true;
  state.OscCode = state.OscSelected = "RMO";
  EXPECT_TRUE(window().DrawChart());
  EXPECT_EQ(dialogs.said.size(), 2u);
  EXPECT_FALSE(panel.Visible());
}

TEST_F(OscillatorTest, AMissingCompareFileIsTold) {
  settings.osc.CompFile = "c:\\korawin\\data\\XAO.WDT";
  window().PickOscillator("RMX");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "RMX Compare ");
  EXPECT_EQ(dialogs.said[0].text, " Oscillator values not valid");
  window().PickOscillator("RMO");
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[1].text,
            "c:\\korawin\\data\\XAO.WDT is not available. Use your code "
            "for the All Ordinaries Index");
  EXPECT_FALSE(panel.Visible());
}

TEST_F(OscillatorTest, VolumesThatAreNotShownHaveNoBalance) {
  state.VolumeOption = false;
  window().Redraw();
  window().PickOscillator("OBV");
  EXPECT_FALSE(panel.Visible());
  state.VolumeOption = true;
  window().Redraw();
  window().PickOscillator("OBV");
  EXPECT_TRUE(panel.Visible());
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(OscillatorTest, TheSettingsBoxComesFirstWhenItIsAskedFor) {
  int opened = 0;
  window().SetOscFrm([&] {
    ++opened;
    window().ShowOscillator();
  });
  window().PickOscillator("RSI");
  EXPECT_EQ(opened, 0);
  settings.osc.ShowOsc = true;
  window().PickOscillator("MOM");
  EXPECT_EQ(opened, 1);
  EXPECT_TRUE(panel.Visible());
}

TEST_F(OscillatorTest, NothingIsDrawnWhileChartSelectionStartsTheWindow) {
  state.ChartStartup = true;
  state.OscCode = "RSI";
  EXPECT_FALSE(window().ShowOscillator());
  EXPECT_FALSE(panel.Visible());
}

TEST_F(OscillatorTest, AChartThatFailsLeavesNoPanelOfAnother) {
  state.OscShown = true;
  state.OscCode = state.OscSelected = "RSI";
  window().NextChart();
  home.files().Remove("c:\\korawin\\data\\CCC.WDT");
  panel.ops.clear();
  EXPECT_FALSE(window().NextChart());
  EXPECT_EQ(panel.ops, std::vector<std::string>{"cls"});
}

// ---- Two charts

TEST_F(ChartWindowTest, ASecondChartIsLaidOverTheFirst) {
  PutThree();
  window().NextChart();
  int asked = 0;
  window().SetChart2([&] { ++asked; });
  window().StartSuperimpose();
  EXPECT_EQ(asked, 1);
  EXPECT_EQ(state.ChartTask, kTaskSuperimpose);
  EXPECT_EQ(window().arrangement(), Arrangement::kUnder);
  surface.ops.clear();
  EXPECT_TRUE(window().NextChart());
  EXPECT_FALSE(surface.Has("cls")) << "the first chart stays";
  EXPECT_EQ(window().arrangement(), Arrangement::kSuperimposed);
  window().NextChart();
  EXPECT_TRUE(surface.Has("cls"));
  EXPECT_EQ(window().arrangement(), Arrangement::kOne);
}

TEST_F(ChartWindowTest, ASplitScreenTakesTheNextChartBelowAndEnds) {
  PutThree();
  window().NextChart();
  window().StartSplitScreen();
  EXPECT_EQ(window().arrangement(), Arrangement::kUpper);
  EXPECT_LT(window().Chart.ChartBottom, 226) << "the upper half";
  surface.ops.clear();
  window().NextChart();
  EXPECT_FALSE(surface.Has("cls"));
  EXPECT_GT(window().Chart.ChartTop, 226) << "the lower half";
  EXPECT_EQ(window().arrangement(), Arrangement::kSplit);
  window().NextChart();
  EXPECT_EQ(window().arrangement(), Arrangement::kOne);
  EXPECT_TRUE(surface.Has("cls"));
}

TEST_F(ChartWindowTest, APairIsDrawnAgainAtAnotherSize) {
  PutThree();
  for (const bool split : {true, false}) {
    state.ChartIndex = 0;
    window().NextChart();
    if (split)
      window().StartSplitScreen();
    else
      window().StartSuperimpose();
    EXPECT_TRUE(window().Resized()) << "the second is still to come";
    const std::string first = script();
    surface.ops.clear();
    EXPECT_TRUE(window().NextChart());
    const auto second = surface.ops;
    const std::string pair = script();
    surface.ops.clear();
    EXPECT_TRUE(window().Resized());
    EXPECT_EQ(script(), pair);
    EXPECT_GT(pair.size(), first.size());
    EXPECT_EQ(std::count(surface.ops.begin(), surface.ops.end(), "cls"), 1);
    ASSERT_GT(surface.ops.size(), second.size());
    EXPECT_TRUE(std::equal(second.rbegin(), second.rend(), surface.ops.rbegin()));
    EXPECT_EQ(window().arrangement(), split ? Arrangement::kSplit : Arrangement::kSuperimposed);
    EXPECT_EQ(shown(), "BBB.WDT");
    window().NextChart();
    EXPECT_EQ(window().arrangement(), Arrangement::kOne);
  }
}

TEST_F(ChartWindowTest, ASecondChartThatIsNotChosenLeavesOneChart) {
  PutThree();
  window().NextChart();
  for (const bool split : {true, false}) {
    if (split)
      window().StartSplitScreen();
    else
      window().StartSuperimpose();
    window().DropSecondChart();
    surface.ops.clear();
    window().NextChart();
    EXPECT_TRUE(surface.Has("cls"));
    EXPECT_EQ(window().arrangement(), Arrangement::kOne);
  }
}

// ---- Saving

class SaveTest : public ChartWindowTest {
 protected:
  SaveTest() {
    PutThree();
    home.files().MakeFolder("c:\\korawin\\chtsave");
    window().NextChart();
  }
  std::string Save(const std::string& name) {
    dialogs.said.clear();
    window().StartSaving();
    EXPECT_EQ(state.ChartTask, kTaskSaving);
    window().SaveChartAs("c:\\korawin\\chtsave\\" + name);
    EXPECT_EQ(state.ChartTask, kTaskNone);
    return dialogs.said.empty() ? "" : dialogs.said.back().text;
  }
  std::string saved(const char* name) {
    return home.Get(std::string("drive_c/korawin/chtsave/") + name);
  }
};

TEST_F(SaveTest, TheScriptIsCopied) {
  EXPECT_EQ(window().SuggestedName(), "AAA.cht");
  EXPECT_EQ(Save("mine.CHT"), " CHART SAVED ");
  EXPECT_EQ(dialogs.said[0].title, "Save Chart");
  EXPECT_EQ(saved("mine.CHT"), script());
}

TEST_F(SaveTest, TheChartOnShowIsSavedThoughTheDataFolderHasChangedSince) {
  const std::string first = script();
  home.Put("drive_c/other/Names.dat", Bytes(std::vector<NameRec>{Security("ZZZ")}));
  home.Put("drive_c/other/ZZZ.WDT", home.Get("drive_c/korawin/data/BBB.WDT"));
  settings.paths.CurrentDataPath = "c:\\other\\";
  EXPECT_EQ(window().ScriptOnShow(), "c:\\korawin\\data\\TCht.Tmp");
  EXPECT_EQ(Save("a.cht"), " CHART SAVED ");
  EXPECT_EQ(saved("a.cht"), first);
  window().ShowAt(1);
  settings.paths.CurrentDataPath = "c:\\korawin\\data\\";
  EXPECT_EQ(window().SuggestedName(), "ZZZ.cht");
  EXPECT_EQ(window().ScriptOnShow(), "c:\\other\\TCht.Tmp");
  EXPECT_EQ(Save("b.cht"), " CHART SAVED ");
  EXPECT_EQ(saved("b.cht"), home.Get("drive_c/other/TCht.Tmp"));
  EXPECT_NE(saved("b.cht").find("ZZZ"), std::string::npos);
}

TEST_F(SaveTest, WhatChartSelectionLooksAtDoesNotNameTheChartOnShow) {
  current.Rec = Security("CCC");
  EXPECT_EQ(window().SuggestedName(), "AAA.cht");
}

TEST_F(SaveTest, AChartThatFailedToDrawIsNotSaved) {
  home.files().Remove("c:\\korawin\\data\\BBB.WDT");
  EXPECT_FALSE(window().NextChart());
  EXPECT_EQ(window().ScriptOnShow(), "");
  EXPECT_EQ(Save("a.cht"), " CHART NOT SAVED ");
  EXPECT_FALSE(home.Exists("drive_c/korawin/chtsave/a.cht"));
  RecordingSurface elsewhere(638, 452);
  EXPECT_FALSE(window().DrawAgain(elsewhere, nullptr));
  EXPECT_TRUE(window().NextChart());
  EXPECT_EQ(Save("a.cht"), " CHART SAVED ");
}

TEST_F(SaveTest, ASavedChartOnShowIsSavedUnderItsOwnName) {
  Save("a.cht");
  const std::string first = saved("a.cht");
  window().NextChart();
  window().ShowSaved("c:\\korawin\\chtsave\\a.cht");
  EXPECT_EQ(window().SuggestedName(), "a.cht");
  EXPECT_EQ(Save("copy.cht"), " CHART SAVED ");
  EXPECT_EQ(saved("copy.cht"), first);
}

TEST_F(SaveTest, AnotherEndingIsRefused) {
  for (const char* name : {"a.txt", "cht", "a.cht.bak", "a"}) {
    EXPECT_EQ(Save(name), "File extension must be .cht") << name;
    EXPECT_FALSE(home.Exists(std::string("drive_c/korawin/chtsave/") + name));
  }
}

TEST_F(SaveTest, AFileThatIsThereIsReplacedOnlyOnOk) {
  home.Put("drive_c/korawin/chtsave/a.cht", "old");
  dialogs.answers = {Answer::kCancel, Answer::kCancel, Answer::kCancel};
  EXPECT_EQ(Save("a.cht"), " CHART NOT SAVED ");
  EXPECT_EQ(dialogs.said[0].text, "c:\\korawin\\chtsave\\a.cht already exists - Overwrite");
  EXPECT_EQ(saved("a.cht"), "old");
  dialogs.answers = {Answer::kOk};
  EXPECT_EQ(Save("a.cht"), " CHART SAVED ");
  EXPECT_EQ(saved("a.cht"), script());
}

TEST_F(SaveTest, ANameThatCanBeNoneIsTold) {
  EXPECT_EQ(Save(std::string("a\0b.cht", 7)), "File name invalid");
  home.files().MakeFolder("c:\\korawin\\chtsave\\dir.cht");
  EXPECT_EQ(Save("dir.cht"), "File name invalid");
}

TEST_F(SaveTest, AFileThatCannotBeWrittenIsNotSaved) {
  EXPECT_EQ(Save("nowhere\\a.cht"), " CHART NOT SAVED ");
}

TEST_F(SaveTest, CancelDrawsTheChartAgain) {
  surface.ops.clear();
  dialogs.said.clear();
  window().StartSaving();
  window().SaveChartAs(std::nullopt);
  EXPECT_TRUE(surface.Has("cls"));
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(shown(), "AAA.WDT");
}

TEST_F(SaveTest, PicturesAreOfferedWhereTheyCanBeMade) {
  window().SaveChartAs("c:\\korawin\\chtsave\\a.svg",
                       [](const std::string& path) { return "picture of " + path; });
  EXPECT_EQ(dialogs.said.back().text, " CHART SAVED ");
  EXPECT_EQ(saved("a.svg"), "picture of c:\\korawin\\chtsave\\a.svg");
  window().SaveChartAs("c:\\korawin\\chtsave\\b.png",
                       [](const std::string&) -> std::string { throw RunTimeError(kNoPicture); });
  EXPECT_EQ(dialogs.said.back().text, " CHART NOT SAVED ");
  EXPECT_FALSE(home.Exists("drive_c/korawin/chtsave/b.png"));
}

TEST_F(SaveTest, ASavedChartIsPlayedInPlaceOfTheComposedOne) {
  Save("a.cht");
  surface.ops.clear();
  dialogs.said.clear();
  window().ShowSaved("c:\\korawin\\chtsave\\A.CHT");
  EXPECT_TRUE(window().ChartFromFile);
  EXPECT_TRUE(surface.Has("cls"));
  EXPECT_GT(surface.ops.size(), 30u);
  EXPECT_TRUE(dialogs.said.empty());
  window().Redraw();
  EXPECT_FALSE(window().ChartFromFile);
  EXPECT_EQ(shown(), "AAA.WDT");
}

TEST_F(SaveTest, ThePointerReadsNothingFromASavedChart) {
  Save("a.cht");
  window().ShowSaved("c:\\korawin\\chtsave\\a.cht");
  window().ToggleGrid();
  surface.ops.clear();
  window().MouseMove({100, 200});
  EXPECT_TRUE(surface.ops.empty());
  EXPECT_EQ(window().view().Panels[2], "");
}

TEST_F(SaveTest, WhatIsNoSavedChartIsTold) {
  dialogs.said.clear();
  window().ShowSaved("c:\\korawin\\chtsave\\a.txt");
  EXPECT_EQ(dialogs.said.back().text, "File extension must be .cht");
  EXPECT_EQ(dialogs.said.back().title, "Saved Charts");
  home.Put("drive_c/korawin/chtsave/bad.cht", std::string("\x01\x02\0,,,,,,,,\r\n", 14));
  window().ShowSaved("c:\\korawin\\chtsave\\bad.cht");
  EXPECT_EQ(dialogs.said.back().text, "There is problem displaying this chart - format invalid.");
  EXPECT_FALSE(window().ChartFromFile);
}

TEST_F(SaveTest, TheChartIsDrawnAgainElsewhereWithoutTouchingTheScript) {
  settings.osc[kRsiP] = {5, 5};
  window().PickOscillator("RSI");
  const std::string before = script();
  surface.ops.clear();
  window().Redraw();
  window().PickOscillator("RSI");
  RecordingSurface price(638, 452), lower(638, 144);
  const auto tops = panel.ops;
  EXPECT_TRUE(window().DrawAgain(price, &lower));
  EXPECT_EQ(script(), before);
  EXPECT_FALSE(price.ops.empty());
  EXPECT_FALSE(lower.ops.empty());
  EXPECT_EQ(price.ops.back(), surface.ops.back());
}

// ---- Read-out

class GridTest : public ChartWindowTest {
 protected:
  GridTest() {
    PutThree();
    window().NextChart();
    window().ToggleGrid();
    surface.ops.clear();
  }
  const auto& panels() { return window().view().Panels; }
};

TEST_F(GridTest, TheToolShowsThePanelsAndItsButton) {
  EXPECT_EQ(window().view().TB, kButtonGrid);
  EXPECT_EQ(panels()[1], "GRID");
  for (const bool shown : window().view().PanelShown) EXPECT_TRUE(shown);
  EXPECT_EQ(state.ChartTask, kTaskGrid);
  window().ToggleGrid();
  EXPECT_EQ(window().view().TB, kNoButton);
  for (const bool shown : window().view().PanelShown) EXPECT_FALSE(shown);
  EXPECT_EQ(state.ChartTask, kTaskNone);
}

TEST_F(GridTest, ThePanelsShowTheBarOfThePriceFile) {
  const double x = window().Chart.ChartLeft + 3.0 * window().Chart.BarSpacing;
  window().MouseMove({x, 200});
  // The fourth day: close 10 + 4 % 5.
  EXPECT_EQ(panels()[2], "04-02-26");
  EXPECT_EQ(panels()[3], "Open  14.00");
  EXPECT_EQ(panels()[4], "High  15.00");
  EXPECT_EQ(panels()[5], "Low  13.00");
  EXPECT_EQ(panels()[6], "Close  14.00");
  EXPECT_EQ(panels()[7].find("Vol  40"), 0u) << panels()[7];
}

TEST_F(GridTest, EveryColumnReadsItsDayOfThePriceFile) {
  const PriceFile prices(home.files(), "c:\\korawin\\data\\AAA.WDT");
  const auto& chart = window().Chart;
  ASSERT_EQ(prices.count(), 28);
  for (std::int32_t record = 1; record <= 28; ++record) {
    const PriceRec day = prices.Read(record);
    window().MouseMove({chart.ChartLeft + (record - 1) * double(chart.BarSpacing), 200});
    const std::string date(day.RecDate.raw());
    EXPECT_EQ(panels()[2], date.substr(6, 2) + "-" + date.substr(4, 2) + "-" + date.substr(2, 2));
    EXPECT_EQ(panels()[4], "High  " + std::to_string(int(day.High)) + ".00");
    EXPECT_EQ(panels()[6], "Close  " + std::to_string(int(day.Close)) + ".00");
  }
}

TEST_F(GridTest, BeyondTheLastBarItShowsTheLast) {
  window().MouseMove({double(window().Chart.ChartRight), 200});
  EXPECT_EQ(panels()[2], "28-02-26");
}

TEST_F(GridTest, OutsideThePlotThePanelsAreClearAndThereIsNoCrossHair) {
  window().MouseMove({100, 200});
  ASSERT_NE(panels()[2], "");
  surface.ops.clear();
  window().MouseMove({5, 200});
  EXPECT_EQ(panels()[2], "");
  EXPECT_EQ(panels()[1], "GRID");
  EXPECT_EQ(surface.ops.size(), 2u) << "the two lines are taken away";
}

TEST_F(GridTest, AClickEndsIt) {
  window().MouseMove({100, 200});
  surface.ops.clear();
  window().MouseRelease({100, 200}, MouseButton::kLeft);
  EXPECT_EQ(surface.ops.size(), 2u);
  EXPECT_FALSE(window().GridOn());
  window().MouseMove({120, 200});
  EXPECT_EQ(surface.ops.size(), 2u);
}

TEST_F(GridTest, AMoveComposesNothing) {
  const std::string before = script();
  home.Put("drive_c/korawin/data/TCht.Tmp", "untouched");
  for (int x = 50; x < 600; x += 7) window().MouseMove({double(x), 200});
  EXPECT_EQ(script(), "untouched");
  for (const std::string& op : surface.ops) EXPECT_EQ(op.find("xor dot"), 0u) << op;
}

TEST_F(GridTest, TheKeysGoFromBarToBar) {
  window().MovePoint(-1);
  EXPECT_EQ(panels()[2], "28-02-26") << "it begins at the last bar";
  window().MovePoint(-1);
  EXPECT_EQ(panels()[2], "27-02-26");
  window().MovePoint(-1);
  EXPECT_EQ(panels()[2], "26-02-26");
  window().MovePoint(1);
  EXPECT_EQ(panels()[2], "27-02-26");
  window().PointToEnd(false);
  EXPECT_EQ(panels()[2], "01-02-26");
  window().MovePoint(-1);
  EXPECT_EQ(panels()[2], "01-02-26");
  window().PointToEnd(true);
  EXPECT_EQ(panels()[2], "28-02-26");
  window().MovePoint(1);
  EXPECT_EQ(panels()[2], "28-02-26");
}

TEST_F(GridTest, AKeyStartsTheTool) {
  window().ToggleGrid();
  window().MovePoint(-1);
  EXPECT_TRUE(window().GridOn());
  EXPECT_EQ(panels()[2], "28-02-26");
}

TEST_F(GridTest, ItOutlivesAPageAndLeavesNoLineBehind) {
  window().MouseMove({100, 200});
  state.ChartDirection = 1;
  window().StepChart();
  EXPECT_TRUE(window().GridOn());
  surface.ops.clear();
  window().MouseMove({110, 200});
  EXPECT_EQ(surface.ops.size(), 2u) << "nothing to take away from the new picture";
}

TEST_F(GridTest, NothingOfTheChartBeforeIsReadUnderTheNext) {
  window().MouseMove({double(window().Chart.ChartLeft), 200});
  ASSERT_NE(panels()[2], "");
  state.ChartDirection = 1;
  window().StepChart();
  EXPECT_EQ(panels()[1], "GRID");
  for (size_t i = 2; i < panels().size(); ++i) EXPECT_EQ(panels()[i], "") << i;
  window().MouseMove({double(window().Chart.ChartLeft), 200});
  EXPECT_NE(panels()[2], "");
}

TEST_F(GridTest, TwoChartsKeepTheLastText) {
  for (const bool split : {true, false}) {
    if (split)
      window().StartSplitScreen();
    else
      window().StartSuperimpose();
    window().NextChart();
    window().ToggleGrid();
    window().MouseMove({double(window().Chart.ChartLeft), 300});
    EXPECT_EQ(panels()[2], "");
  }
}

TEST_F(GridTest, NothingToReadAfterAChartThatFailed) {
  home.files().Remove("c:\\korawin\\data\\BBB.WDT");
  EXPECT_FALSE(window().NextChart());
  surface.ops.clear();
  window().MouseMove({100, 200});
  EXPECT_TRUE(surface.ops.empty());
  window().MovePoint(-1);
  window().PointToEnd(true);
  EXPECT_TRUE(surface.ops.empty());
}

// ---- The rest

TEST_F(ChartWindowTest, CancellingTheToolsLeavesNothingOn) {
  PutThree();
  window().NextChart();
  window().StartSuperimpose();
  window().ToggleGrid();
  window().CancelChartTools();
  EXPECT_FALSE(window().GridOn());
  EXPECT_EQ(window().arrangement(), Arrangement::kOne);
  EXPECT_EQ(window().view().TB, kNoButton);
  EXPECT_EQ(state.ChartTask, kTaskNone);
  EXPECT_EQ(window().view().Panels[1], "");
}

TEST_F(ChartWindowTest, ANewChartLeavesTheToolsAndEmptiesTheDrawnLines) {
  PutThree();
  window().NextChart();
  home.Put("drive_c/korawin/data/ChtLns.Tmp", "H,1,2,3,4,5\r\n");
  state.SuppressScript = true;
  window().StartSuperimpose();
  surface.ops.clear();
  window().StartNewChart();
  EXPECT_EQ(home.Get("drive_c/korawin/data/ChtLns.Tmp"), "");
  EXPECT_FALSE(state.SuppressScript);
  EXPECT_TRUE(surface.Has("cls")) << "half of a pair goes";
  EXPECT_EQ(state.ChartTask, kTaskNewChart);
}

TEST_F(ChartWindowTest, ScrollingEndsTheDateLimitAtTheNextStep) {
  PutThree();
  window();
  state.DateLimitOn = true;
  state.ChosenLimitText = "15/02/2026";
  state.ChosenLimitDate = "20260215";
  window().NextChart();
  state.ScrollInUse = true;
  window().StepChart();
  EXPECT_FALSE(state.DateLimitOn);
  EXPECT_FALSE(window().view().FrameShown);
}

TEST(PanesTest, OneTakesTheFormAndTwoShareIt) {
  const PaneLayout one = LayOutPanes(640, 454, 30, 25, false);
  EXPECT_EQ(one.width, 638);
  EXPECT_EQ(one.price, 397);
  EXPECT_EQ(one.panel, 0);
  const PaneLayout two = LayOutPanes(640, 454, 24, 25, true);  // 430 to share
  EXPECT_EQ(two.price, 281);
  EXPECT_EQ(two.panelTop, 283);
  EXPECT_EQ(two.panel, 98);
  EXPECT_EQ(LayOutPanes(640, 90, 30, 25, true).panel, 0) << "too low for two";
  EXPECT_GE(LayOutPanes(0, 0, 30, 25, true).price, 1);
}

TEST(StatusBarTest, PanelsAreANinthAndTheLastAQuarterMore) {
  EXPECT_EQ(StatusBarWidths(640).each, 71);
  EXPECT_EQ(StatusBarWidths(640).last, 88);
  EXPECT_EQ(StatusBarWidths(647.9).each, 71);
}

TEST(ToolBarTest, ForwardIsTheFifthOfTwenty) {
  EXPECT_STREQ(ToolButtonOf(kButtonForward).key, "fwd");
  EXPECT_EQ(kButtonForward, 5);
  EXPECT_EQ(kButtonGrid, 13);
  EXPECT_EQ(kToolButtons, 20);
  EXPECT_STREQ(ToolButtonOf(20).key, "sZoom");
}

TEST_F(ChartWindowTest, TheTitleTellsTheDataFolderAndTheChartOnShow) {
  EXPECT_EQ(window().view().Title, "KORA Charting 7F   -  CHARTS  c:\\korawin\\data\\");
  PutThree();
  window().NextChart();
  const std::string start = "KORA Charting 7F   -  CHARTS  c:\\korawin\\data\\  -  ";
  EXPECT_EQ(window().view().Title, start + "AAA  Bar  Daily");
  window().SetPeriod(Period::kWeekly);
  window().SetStyle(Style::kCandlestick);
  EXPECT_EQ(window().view().Title, start + "AAA  Candlestick  Weekly");
  home.Put("drive_c/korawin/chtsave/Mine.cht", script());
  window().ShowSaved("c:\\korawin\\chtsave\\Mine.cht");
  EXPECT_EQ(window().view().Title, start + "Mine.cht");
}

}  // namespace
}  // namespace kora
