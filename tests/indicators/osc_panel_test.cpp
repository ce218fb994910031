#include "indicators/osc_panel.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/indicators/osc_fixture.h"

using namespace kora;
using kora::test::OscFixture;

TEST(OscPanelTest, FrameStandsAtTwoAndNinetyEightPercentAndBelowThePriceInTheScript) {
  OscFixture f;
  OscPanel panel(f.host);
  EXPECT_EQ(panel.PanelTop, 3);       // 2.88
  EXPECT_EQ(panel.PanelBottom, 141);  // 141.12
  EXPECT_EQ(panel.PanelRight, 630);
  panel.Frame();
  EXPECT_TRUE(f.panel.Has("box 42,3,630,141 16"));
  EXPECT_EQ(f.Lines('B'), std::vector<std::string>{"B,42,311,630,449,16"});
}

TEST(OscPanelTest, PanelOf144UnitsKeepsThemWhateverItsHeight) {
  OscFixture f;
  test::RecordingSurface tall(638, 400);
  OscHost host{f.home.files(), f.dialogs, f.settings, f.colours, f.request,
               f.chart,        f.price,   tall,       &f.script};
  OscPanel panel(host, 144);
  EXPECT_EQ(tall.ScaleHeight(), 144);
  EXPECT_EQ(tall.ScaleWidth(), 638);
  EXPECT_EQ(panel.PanelTop, 2);       // 288 \ 100
  EXPECT_EQ(panel.PanelBottom, 141);  // 14112 \ 100
}

TEST(OscPanelTest, GuideHasItsLabelRightAlignedLeftOfTheFrame) {
  OscFixture f;
  OscPanel panel(f.host);
  panel.Guide(50, "70%");
  // "70%": (556 + 556 + 889) / 1000 * 11 units = 22.01, so x = 42 - 5 - 22.
  EXPECT_EQ(f.Lines('L'), std::vector<std::string>{"L,42,358,630,358,16"});
  EXPECT_EQ(f.Lines('T'), std::vector<std::string>{"T,8.25,15,352,70%,27"});
}

TEST(OscPanelTest, SecondPassRedrawsNeitherFrameNorGuidesAndMovesTheTitle) {
  OscFixture f;
  f.host.SecondPass = true;
  OscPanel panel(f.host);
  panel.Frame();
  panel.Guide(50, "70%");
  panel.Title("FX");
  EXPECT_EQ(f.panel.ops, std::vector<std::string>{"text 8.25 332,5 FX 27"});
  EXPECT_EQ(f.script.text(), "T,8.25,292,313,FX,27\r\n");
}

TEST(OscPanelTest, SuppressedScriptDrawsThePanelAndWritesNothing) {
  OscFixture f;
  f.request.SuppressScript = true;
  OscPanel panel(f.host);
  panel.Frame();
  EXPECT_TRUE(f.panel.Has("box 42,3,630,141 16"));
  EXPECT_EQ(f.script.text(), "");
}

TEST(RunOscillatorTest, ShortFormTellsEveryErrorByItsNumber) {
  OscFixture f;
  EXPECT_FALSE(RunOscillator(f.host, "Chart Display", false, [] { CInt(1e9); }));
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "Chart Display");
  EXPECT_EQ(f.dialogs.said[0].text, "There is an unexpected error No. 6\nOverflow");
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(RunOscillatorTest, LongFormNamesTheFileAndTheDate) {
  OscFixture f;
  EXPECT_FALSE(RunOscillator(
      f.host, "FX", true, [] { CInt(1e9); }, [] { return std::string("20010203"); }));
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text,
            "There is a problem with the data for TEST.WDT\n at date (20010203) 03/02/2001\n"
            "Use View/Modify Data procedure to correct.");
}

TEST(RunOscillatorTest, LongFormRetriesWhileTheDiskIsNotReady) {
  OscFixture f;
  f.dialogs.answers = {Answer::kOk, Answer::kCancel};
  int runs = 0;
  EXPECT_FALSE(RunOscillator(f.host, "FX", true, [&runs] {
    ++runs;
    throw RunTimeError(kDiskNotReady);
  }));
  EXPECT_EQ(runs, 2);
  EXPECT_EQ(f.dialogs.said.size(), 2u);
}
