#include "chartwindow/chart_window.h"

#include <gtest/gtest.h>

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

class ChartWindowTest : public testing::Test {
 protected:
  ChartWindowTest() {
    settings.paths.SystemPath = "c:\\korawin\\";
    settings.paths.CurrentDataPath = "c:\\korawin\\data\\";
    settings.charts.Type = "B";
    settings.charts.Period = "A";
    settings.charts.Spacing = 2;
    home.files().MakeFolder("c:\\korawin\\data");
    LoadColours(home.files(), settings.paths.SystemPath, "Black", colours);
  }

  void PutNames(const std::vector<NameRec>& names) {
    home.Put("drive_c/korawin/data/Names.dat", Bytes(names));
    for (const NameRec& name : names)
      PutPrices(std::string(name.Code.trimmed()));
  }
  void PutPrices(const std::string& code) {
    std::vector<PriceRec> days;
    for (int i = 1; i <= 28; ++i) {
      const std::string date = "202602" + std::string(i < 10 ? "0" : "") + std::to_string(i);
      const float close = 10.0f + float(i % 5);
      days.push_back(Day(date, close, close + 1, close - 1, close, 1000 * i));
    }
    home.Put("drive_c/korawin/data/" + code + ".WDT", Bytes(days));
  }
  // A, B and C, all shares.
  void PutThree() { PutNames({Security("AAA"), Security("BBB"), Security("CCC")}); }

  ChartWindow& window() {
    if (!window_) {
      window_ = std::make_unique<ChartWindow>(ChartWindowServices{.files = home.files(),
                                                                  .dialogs = dialogs,
                                                                  .settings = settings,
                                                                  .ini = ini,
                                                                  .user = user,
                                                                  .colours = colours,
                                                                  .current = current,
                                                                  .state = state,
                                                                  .price = surface,
                                                                  .panel = panel});
      window_->Load();
      surface.ops.clear();
      panel.ops.clear();
    }
    return *window_;
  }
  std::string shown() const { return current.CurrentDataFile; }
  std::string script() const { return home.Get("drive_c/korawin/data/TCht.Tmp"); }

  TempHome home;
  ScriptedDialogs dialogs;
  Settings settings;
  ChartColours colours{};
  CurrentName current;
  SettingsFile ini{home.files(), "C:\\WINDOWS\\Kora.ini"};
  SettingsFile user{home.files(), "C:\\WINDOWS\\KoraUser.ini"};
  ChartState state;
  RecordingSurface surface{638, 452}, panel{638, 144};

 private:
  std::unique_ptr<ChartWindow> window_;
};

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

TEST_F(ChartWindowTest, ForwardFromTheLastChartGoesToRecordOne) {
  PutThree();
  for (const char* expected : {"AAA.WDT", "BBB.WDT", "CCC.WDT", "AAA.WDT"}) {
    EXPECT_TRUE(window().NextChart());
    EXPECT_EQ(shown(), expected);
  }
  EXPECT_EQ(state.ChartIndex, 1);
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
  EXPECT_EQ(state.ChartStyle, 'B');
  window().NextChart();
  EXPECT_EQ(state.ChartStyle, 'L');
  window().NextChart();
  EXPECT_EQ(state.ChartStyle, 'L');
  EXPECT_EQ(shown(), "CCC.WDT");
}

TEST_F(ChartWindowTest, EveryTypeWithoutBarsTurnsCandlesIntoALine) {
  for (const std::int16_t type : {kCloseVolume, kCloseOnly, kAdvanceDecline}) {
    PutNames({Security("CLO", 1, type)});
    state.ChartStyle = 'C';
    window().NextChart();
    EXPECT_EQ(state.ChartStyle, 'L') << type;
  }
  for (const std::int16_t type : {kShare, kIndex}) {
    PutNames({Security("BAR", 1, type)});
    state.ChartStyle = 'C';
    window().NextChart();
    EXPECT_EQ(state.ChartStyle, 'C') << type;
  }
}

TEST_F(ChartWindowTest, AMissingNameFileIsToldAndNothingIsShown) {
  EXPECT_FALSE(window().NextChart());
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Charts");
  EXPECT_EQ(dialogs.said[0].text.find(
                "There is a file access problem. Check directory paths option."), 0u);
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
  home.Put("drive_c/korawin/data/ChtLns.Tmp", "H,1,2,3,4,5\r\n");
  state.SplitScreen = true;
  window().NextChart();
  EXPECT_NE(home.Get("drive_c/korawin/data/ChtLns.Tmp"), "");
  state.SplitScreen = false;
  window().NextChart();
  EXPECT_TRUE(home.Exists("drive_c/korawin/data/ChtLns.Tmp"));
  EXPECT_EQ(home.Get("drive_c/korawin/data/ChtLns.Tmp"), "");
}

TEST_F(ChartWindowTest, TheTitleTellsTheDataFolder) {
  EXPECT_EQ(window().view().Title, "KORA Charting 7F   -  CHARTS  c:\\korawin\\data\\");
}

}  // namespace
}  // namespace kora
