#include "chart/chart_printing.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "chart/script_player.h"
#include "tests/chart/composer_fixture.h"
#include "tests/support/mutate.h"
#include "tests/support/recording_printer.h"

using namespace kora;
using kora::test::ComposerFixture;
using kora::test::Mutator;
using kora::test::RecordingPrinter;
using kora::test::ScriptedDialogs;
using kora::test::TempHome;
using Ops = std::vector<std::string>;

namespace {

constexpr ChartSize kChart{638, 452};
constexpr std::int32_t kBlue = 0x800000, kWhite = 0xFFFFFF, kPaleGrey = 0xC0C0C0;

struct PrintFixture {
  TempHome home;
  ScriptedDialogs dialogs;
  RecordingPrinter printer;
  FontSettings fonts;
  ChartColours colours{};
  PrintSetup setup;
  Ops captions;
  std::string caption = "CHARTS";

  PrintFixture() {
    std::copy(StandardColours().begin(), StandardColours().end(), colours.begin());
    setup.PrintEnlarge = 2;  // 30 twips to the unit
    setup.PrintWidth = setup.PrintHeight = 1;
    setup.PrintLine = 4;
    setup.PrintColourMode = 1;
    setup.PrintWhiteBlack = 0;
  }
  ChartPrintServices Services() {
    return {home.files(), dialogs, printer, fonts, colours, [this](const std::string& text) {
              captions.push_back(text);
              return std::exchange(caption, text);
            }};
  }
  bool Print(std::string_view script) {
    dialogs.said.clear();
    captions.clear();
    return PrintChartScript(Services(), setup, kChart, script);
  }
  // The operations of the one page that was sent.
  Ops Page(std::string_view script) {
    const size_t before = printer.sent.size();
    EXPECT_TRUE(Print(script));
    EXPECT_EQ(printer.sent.size(), before + 1);
    return printer.sent.empty() ? Ops{} : printer.sent.back();
  }
  void ExpectFailure(std::string_view script, const std::string& title, const std::string& text) {
    const size_t before = printer.sent.size();
    EXPECT_FALSE(Print(script)) << script;
    EXPECT_EQ(printer.sent.size(), before) << script;
    ASSERT_EQ(dialogs.said.size(), 1u) << script;
    EXPECT_EQ(dialogs.said[0].title, title);
    EXPECT_EQ(dialogs.said[0].text, text);
    EXPECT_EQ(caption, "CHARTS");
    EXPECT_FALSE(dialogs.busy);
  }
};

TEST(PaperColours, LightOnesAreDarkenedToReadOnWhiteAndDarkOnesStay) {
  for (const Colour dark : {0x000000, 0x800000, 0x0000C0, 0x006000})
    EXPECT_EQ(ForWhitePaper(dark), dark) << dark;
  // Yellow, cyan, white: each part gets less, and none of another comes in.
  const Colour yellow = ForWhitePaper(0x00FFFF);
  EXPECT_EQ(yellow >> 16, 0);
  EXPECT_EQ(yellow & 0xFF, yellow >> 8 & 0xFF);
  EXPECT_LT(yellow & 0xFF, 0xA0);  // contrast 3 with white is at 158 of 255
  EXPECT_GT(yellow & 0xFF, 0x90);
  const Colour white = ForWhitePaper(0xFFFFFF);
  EXPECT_EQ(white & 0xFF, white >> 16 & 0xFF);
  EXPECT_LT(white & 0xFF, 0x96);
}

TEST(PaperSide, IsTheOneOnWhichTheChartIsLarger) {
  EXPECT_EQ(BetterSide({638, 452}), kLandscape);
  EXPECT_EQ(BetterSide({638, 700}), kPortrait);
}

}  // namespace

TEST(ChartPrintingTest, LinesOfEachLetterHaveTheirStyleAndWeight) {
  PrintFixture f;
  EXPECT_EQ(f.Page("L,1,2,3,4,5\r\nH,1,2,3,4,5\r\nM,1,2,3,4,5\r\nD,1,2,3,4,5\r\nE,1,2,3,4,5\r\n"
                   "V,1,2,3,4,5\r\n"),
            (Ops{"line solid 1 30,60,90,120 5", "line solid 4 30,60,90,120 5",
                 "line solid 1 30,60,90,120 5", "line dash 1 30,60,90,120 5",
                 "line dash 1 30,60,90,120 5", "line dot 1 30,60,90,120 5"}));
}

TEST(ChartPrintingTest, BoxesAndFilledBoxes) {
  PrintFixture f;
  EXPECT_EQ(f.Page("B,1,2,3,4,5\r\nX,1,2,3,4,5\r\nF,1,2,3,4,5\r\nC,1,2,3,4,5\r\n"),
            (Ops{"box 1 30,60,90,120 5", "fill 1 30,60,90,120 5", "fill 1 30,60,90,120 5",
                 "fill 1 30,60,90,120 5"}));
}

TEST(ChartPrintingTest, PointsAreLinesOfNoLengthAtThePrintWeightAndHeavyOnesAt3) {
  PrintFixture f;
  EXPECT_EQ(f.Page("P,1,2,5\r\nK,3,4,5\r\n"),
            (Ops{"line solid 4 30,60,30,60 5", "line solid 3 90,120,90,120 5"}));
}

TEST(ChartPrintingTest, FilledBoxesAndHeavyPointsThatTheScreenSkipsPrint) {
  const std::string script = "X,1,2,3,4,5\r\nK,1,2,5\r\nL,1,2,3,4,5\r\n";
  PrintFixture f;
  EXPECT_EQ(f.Page(script), (Ops{"fill 1 30,60,90,120 5", "line solid 3 30,60,30,60 5",
                                 "line solid 1 30,60,90,120 5"}));
  test::RecordingSurface screen(638, 452);
  EXPECT_TRUE(PlayChartScript(script, screen, f.fonts, f.colours));
  EXPECT_EQ(screen.ops, (Ops{"line solid 1,2,3,4 5"}));
}

TEST(ChartPrintingTest, TwipsToTheUnitAreRoundedFromA32BitProduct) {
  PrintFixture f;
  // 13.5, 16.5, 19.5 and 22.5 twips.
  for (const auto& [enlarge, twips] : {std::pair{0.9f, 14}, {1.1f, 16}, {1.3f, 20}, {1.5f, 22}}) {
    f.setup.PrintEnlarge = enlarge;
    EXPECT_EQ(FrameOnPage(f.printer, f.setup, kChart).SX, twips) << enlarge;
    EXPECT_EQ(FrameOnPage(f.printer, f.setup, kChart).SY, twips) << enlarge;
  }
}

TEST(ChartPrintingTest, WeightOutsideOneToTenIsTwo) {
  PrintFixture f;
  for (const auto& [line, weight] : {std::pair{0, 2}, {1, 1}, {10, 10}, {11, 2}, {-3, 2}}) {
    f.setup.PrintLine = std::int16_t(line);
    EXPECT_EQ(f.Page("H,0,0,1,1,5\r\n"),
              (Ops{"line solid " + std::to_string(weight) + " 0,0,30,30 5"}));
  }
}

TEST(ChartPrintingTest, HalvesAreScaledBeforeTheyAreRounded) {
  PrintFixture f;
  f.setup.PrintEnlarge = 1.5f;  // 22.5 twips, 22 to even
  // 40.5 * 22 = 891; 0.25 * 22 = 5.5, 6 to even; 0.75 * 22 = 16.5, 16 to even.
  EXPECT_EQ(f.Page("C,40.5,0.25,43.5,0.75,5\r\n"), (Ops{"fill 1 891,6,957,16 5"}));
}

TEST(ChartPrintingTest, TextsKeepTheirSizeAndMoveWithTheChart) {
  PrintFixture f;
  f.fonts.Font1Name = "One";
  f.fonts.Font2Name = "Two";
  EXPECT_EQ(f.Page("T,8.25,20,2,ORE  Ore Holdings ,26\r\nS,9.75,5,294,12.50,27\r\n"
                   "Z,7,601,35,KORA,27\r\n"),
            (Ops{"text 8.25 One 600,60 ORE  Ore Holdings  26", "text 9.75 Two 150,8820 12.50 27",
                 "text 7 b i One 18030,1050 KORA 27"}));
}

TEST(ChartPrintingTest, TextsOfAChartSmallerThanOnTheScreenShrinkWithIt) {
  PrintFixture f;
  f.setup.PrintEnlarge = 0.4f;  // 6 twips to the unit where the screen has 15
  EXPECT_EQ(f.Page("T,10,20,2,A,5\r\nS,15,1,1,B,5\r\nZ,2,1,1,C,5\r\n"),
            (Ops{"text 4 120,12 A 5", "text 6 6,6 B 5", "text 1 b i 6,6 C 5"}));
  f.setup.ScriptPrintMode = true;
  EXPECT_EQ(f.Page("T,10,20,2,A,5\r\n"), (Ops{"text 10 b 120,12 A 5"}));
}

TEST(ChartPrintingTest, TextOfBlanksPrintsNothing) {
  PrintFixture f;
  EXPECT_EQ(f.Page("T,8,20,2,   ,26\r\nT,8,20,2,,26\r\nS,8,20,2,  ,26\r\nL,0,0,1,1,5\r\n"),
            (Ops{"line solid 1 0,0,30,30 5"}));
}

TEST(ChartPrintingTest, Font1sBoldIsForTitlesAndNotForScales) {
  PrintFixture f;
  f.fonts.Font1Bold = true;
  // The stamp leaves the bold off until the next S.
  EXPECT_EQ(f.Page("T,8,1,1,A,5\r\nS,8,1,1,B,5\r\nZ,8,1,1,C,5\r\nT,8,1,1,D,5\r\nS,8,1,1,,5\r\n"
                   "T,8,1,1,E,5\r\n"),
            (Ops{"text 8 b 30,30 A 5", "text 8 30,30 B 5", "text 8 b i 30,30 C 5",
                 "text 8 30,30 D 5", "text 8 b 30,30 E 5"}));
}

TEST(ChartPrintingTest, PrintModeSetsTextsInBold) {
  PrintFixture f;
  f.setup.ScriptPrintMode = true;
  EXPECT_EQ(
      f.Page("S,8,1,1,A,5\r\nT,8,1,1,B,5\r\nS,8,1,1,C,5\r\nS,8,1,1,D,5\r\n"),
      (Ops{"text 8 30,30 A 5", "text 8 b 30,30 B 5", "text 8 b 30,30 C 5", "text 8 30,30 D 5"}));
}

TEST(ChartPrintingTest, BothWhitesAreBlackWhereAskedFor) {
  PrintFixture f;
  const std::string script = "L,0,0,1,1," + Str(kWhite) + "\r\nP,0,0," + Str(kPaleGrey) +
                             "\r\nT,8,0,0,A," + Str(kWhite) + "\r\nL,0,0,1,1," + Str(kBlue) +
                             "\r\n";
  f.setup.PrintWhiteBlack = 1;
  EXPECT_EQ(f.Page(script), (Ops{"line solid 1 0,0,30,30 0", "line solid 4 0,0,0,0 0",
                                 "text 8 0,0 A 0", "line solid 1 0,0,30,30 8388608"}));
  f.setup.PrintWhiteBlack = 0;
  EXPECT_EQ(f.Page(script), (Ops{"line solid 1 0,0,30,30 16777215", "line solid 4 0,0,0,0 12632256",
                                 "text 8 0,0 A 16777215", "line solid 1 0,0,30,30 8388608"}));
}

TEST(ChartPrintingTest, BlackAndWhiteTurnsEveryColourToTheFirstEntry) {
  PrintFixture f;
  f.setup.PrintColourMode = 0;
  f.colours[0] = 77;
  EXPECT_EQ(f.Page("L,0,0,1,1,255\r\nX,0,0,1,1,65280\r\nK,0,0,16777215\r\nS,8,0,0,A,9\r\n"
                   "Z,8,0,0,B,9\r\n"),
            (Ops{"line solid 1 0,0,30,30 77", "fill 1 0,0,30,30 77", "line solid 3 0,0,0,0 77",
                 "text 8 0,0 A 77", "text 8 b i 0,0 B 77"}));
}

TEST(ChartPrintingTest, WithoutMarginsTheChartIsCentred) {
  PrintFixture f;
  f.setup.PrintEnlarge = 1;
  // 638 * 15 = 9570 and 452 * 15 = 6780 on 11506 by 16438.
  f.Page("L,0,0,1,1,5\r\n");
  EXPECT_EQ(f.printer.scaleLeft, -968);
  EXPECT_EQ(f.printer.scaleTop, -4829);
  f.setup.PrintLeft = -500;  // one margin alone does not place it
  f.Page("L,0,0,1,1,5\r\n");
  EXPECT_EQ(f.printer.scaleLeft, -968);
  f.setup.PrintTop = -300;
  f.Page("L,0,0,1,1,5\r\n");
  EXPECT_EQ(f.printer.scaleLeft, -500);
  EXPECT_EQ(f.printer.scaleTop, -300);
}

TEST(ChartPrintingTest, OrientationIsThePrintersUnlessOneIsChosen) {
  PrintFixture f;
  f.printer.SetOrientation(kLandscape);
  f.setup.PrintOrient = 0;
  f.Page("L,0,0,1,1,5\r\n");
  EXPECT_EQ(f.printer.Orientation(), kLandscape);
  f.setup.PrintOrient = kPortrait;
  f.Page("L,0,0,1,1,5\r\n");
  EXPECT_EQ(f.printer.Orientation(), kPortrait);
  f.setup.PrintOrient = kLandscape;
  f.Page("L,0,0,1,1,5\r\n");
  EXPECT_EQ(f.printer.Orientation(), kLandscape);
}

TEST(ChartPrintingTest, FirstTimeTheChartStartsAt1Point5AndIsReducedOntoThePage) {
  PrintFixture f;
  PrintSetup s;
  SetPageDefaults(f.printer, {300, 200}, s);
  EXPECT_EQ(s.PrintEnlarge, 1.5f);
  EXPECT_EQ(s.PrintWidth, 6600);  // 22 twips
  EXPECT_EQ(s.PrintHeight, 4400);
  s = {};
  SetPageDefaults(f.printer, kChart, s);  // 11506 / 638 is 18.03: 18 twips
  EXPECT_EQ(s.PrintEnlarge, 1.2f);
  EXPECT_EQ(s.PrintWidth, 11484);
  // Twice the standard window: at most 7.19 twips, which 0.4 gives.
  s = {};
  SetPageDefaults(f.printer, {1600, 900}, s);
  EXPECT_EQ(s.PrintEnlarge, 0.4f);
  // What was saved is the user's.
  s = {};
  s.PrintWidth = s.PrintHeight = 1;
  s.PrintEnlarge = 3;
  SetPageDefaults(f.printer, kChart, s);
  EXPECT_EQ(s.PrintEnlarge, 3);
  EXPECT_EQ(s.PrintWidth, 1);
}

TEST(ChartPrintingTest, EnlargementGoesInStepsOfATenthAndStopsAt1Point2) {
  PrintFixture f;
  PrintSetup s;
  s.PrintEnlarge = 1.3f;
  Reduce(f.printer, {300, 200}, s);
  EXPECT_EQ(s.PrintEnlarge, 1.2f);
  Reduce(f.printer, {300, 200}, s);
  EXPECT_EQ(s.PrintEnlarge, 1.2f);
  for (int i = 0; i < 10; ++i) Enlarge(s);
  EXPECT_EQ(s.PrintEnlarge, 2.2f);
  s.ScriptPrintMode = true;
  for (int i = 0; i < 30; ++i) Reduce(f.printer, {300, 200}, s);
  EXPECT_EQ(s.PrintEnlarge, 0.5f);
}

TEST(ChartPrintingTest, AChartTooLargeForThePageReducesUntilItFits) {
  PrintFixture f;
  PrintSetup s;
  s.PrintEnlarge = 1.5f;
  for (int i = 0; i < 30; ++i) Reduce(f.printer, {1600, 900}, s);
  EXPECT_EQ(s.PrintEnlarge, 0.4f);
  EXPECT_TRUE(IsOnPage(f.printer, FrameOnPage(f.printer, s, {1600, 900})));
}

TEST(ChartPrintingTest, AChartIsOnThePageWhenNoEdgeLeavesIt) {
  PrintFixture f;
  ChartFrame frame{18, 18, 11506, 16438, 0, 0};
  EXPECT_TRUE(IsOnPage(f.printer, frame));
  for (ChartFrame off :
       {ChartFrame{18, 18, 11507, 100, 0, 0}, ChartFrame{18, 18, 100, 16439, 0, 0},
        ChartFrame{18, 18, 100, 100, 1, -5}, ChartFrame{18, 18, 100, 100, -5, 1},
        ChartFrame{18, 18, 100, 100, -11407, -5}, ChartFrame{18, 18, 100, 100, -5, -16339}})
    EXPECT_FALSE(IsOnPage(f.printer, off));
}

TEST(ChartPrintingTest, TheCaptionShowsThatItPrintsAndComesBack) {
  PrintFixture f;
  EXPECT_TRUE(f.Print("L,0,0,1,1,5\r\n"));
  EXPECT_EQ(f.captions, (Ops{"PRINTING - WAIT", "CHARTS"}));
  EXPECT_EQ(f.dialogs.busyCalls, 2);
  EXPECT_TRUE(f.dialogs.said.empty());
}

TEST(ChartPrintingTest, AScriptThatBreaksSendsNoPageAndTellsTheNumber) {
  PrintFixture f;
  const std::string good = "L,1,2,3,4,5\r\n";
  f.ExpectFailure(good + "L,1,2,3,4,5,6\r\n" + good, "Chart Printing",
                  "There is an unexpected error No. 9\nIndex out of range");
  f.ExpectFailure(good + "L,99999999999,2,3,4,5\r\n", "Chart Printing",
                  "There is an unexpected error No. 6\nOverflow");
  f.ExpectFailure(good + "L,100000000,2,3,4,5\r\n", "Chart Printing",  // times 30
                  "There is an unexpected error No. 6\nOverflow");
  for (const std::string& broken :
       {good + "X,1,2,3", good + "K,1,2", std::string(), std::string("Q,1\r\n")})
    f.ExpectFailure(broken, "Chart Printing",
                    std::string("There is an unexpected error No. 5\n") + ErrorText(kBadCall));
  EXPECT_EQ(f.printer.started, f.printer.killed);
}

TEST(ChartPrintingTest, AFontThatIsRefusedIsNamedByItsLabel) {
  PrintFixture f;
  f.fonts.Font1Name = "One";
  f.fonts.Font2Name = "Two";
  f.printer.refused = "Two";
  f.ExpectFailure("T,8,1,2,A,5\r\nS,8,1,2,B,5\r\n", "Printer Font",
                  "Your printer will not accept font selected for Font 2");
  f.printer.refused = "One";
  f.ExpectFailure("L,1,2,3,4,5\r\n", "Printer Font",
                  "Your printer will not accept font selected for Font 1");
  f.printer.refused.clear();
  f.ExpectFailure("T,0,1,2,A,5\r\n", "Printer Font",
                  "Your printer will not accept font selected for Font 1");
}

TEST(ChartPrintingTest, APrinterThatFailsAtTheEndIsTold) {
  PrintFixture f;
  f.printer.failAtEnd = kDeviceNotAvailable;
  f.ExpectFailure(
      "L,1,2,3,4,5\r\n", "Chart Printing",
      std::string("There is an unexpected error No. 68\n") + ErrorText(kDeviceNotAvailable));
  f.printer.failAtEnd = kDiskFull;
  f.ExpectFailure("L,1,2,3,4,5\r\n", "Chart Printing",
                  "There is an unexpected error No. 61\nDisk full");
}

TEST(ChartPrintingTest, WithoutAPrinterNothingStarts) {
  PrintFixture f;
  f.printer.device.clear();
  f.ExpectFailure("L,1,2,3,4,5\r\n", "Printer Page", "There is no default printer.");
  EXPECT_EQ(f.printer.started, 0);
}

TEST(ChartPrintingTest, AFileIsPrintedAndAMissingOneIsTold) {
  PrintFixture f;
  f.home.Put("drive_c/saved.cht", "X,1,2,3,4,5\r\n");
  EXPECT_TRUE(PrintChart(f.Services(), f.setup, kChart, "c:\\saved.cht"));
  ASSERT_EQ(f.printer.sent.size(), 1u);
  EXPECT_EQ(f.printer.sent[0], (Ops{"fill 1 30,60,90,120 5"}));
  EXPECT_FALSE(PrintChart(f.Services(), f.setup, kChart, "c:\\gone.cht"));
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].text.substr(0, 36), "There is an unexpected error No. 53\n");
  EXPECT_EQ(f.printer.sent.size(), 1u);
  EXPECT_EQ(f.home.Get("drive_c/saved.cht"), "X,1,2,3,4,5\r\n");
}

TEST(ChartPrintingTest, ScriptOfMoreCommandsThanAnyChartHasIsNotPrinted) {
  PrintFixture f;
  std::string script;
  for (int i = 0; i < 200001; ++i) script += "P,1,2,3\r\n";
  f.ExpectFailure(script, "Chart Printing",
                  std::string("There is an unexpected error No. 7\n") + ErrorText(kOutOfMemory));
  EXPECT_TRUE(f.Print(std::string_view(script).substr(9)));
}

TEST(ChartPrintingTest, AComposedChartHasAnOperationForEachLineWithAText) {
  ComposerFixture c;
  c.Days("20240101", 60, 5000);
  ASSERT_TRUE(c.Compose());
  PrintFixture f;
  const std::string& script = c.script.text();
  const Ops page = f.Page(script);
  EXPECT_EQ(page.size(), size_t(std::count(script.begin(), script.end(), '\n')));
  EXPECT_GT(page.size(), 100u);
}

TEST(ChartPrintingTest, SetupComesFromTheSettingsAndGoesBackToTheirKeys) {
  TempHome home;
  SettingsFile file(home.files(), "C:\\WINDOWS\\Kora.ini");
  Settings settings;
  settings.charts.EFact = 1.3;
  settings.charts.Cw = 9000;
  settings.charts.Ch = 1e20;  // no size of paper
  settings.charts.SW = -700;
  settings.charts.SH = -800;
  settings.charts.LineWidth = 3;
  settings.page.Orient = 2;
  settings.words.ScriptPrintMode = true;
  PrintSetup s = PrintSetupFrom(settings, {true, 1, 0});
  EXPECT_EQ(s.PrintEnlarge, 1.3f);
  EXPECT_EQ(s.PrintWidth, 9000);
  EXPECT_EQ(s.PrintHeight, 0);
  EXPECT_EQ(s.PrintLeft, -700);
  EXPECT_EQ(s.PrintTop, -800);
  EXPECT_EQ(s.PrintLine, 3);
  EXPECT_EQ(s.PrintOrient, 2);
  EXPECT_EQ(s.PrintColourMode, 1);
  EXPECT_EQ(s.PrintWhiteBlack, 0);
  EXPECT_TRUE(s.ScriptPrintMode);

  s.PrintHeight = 6000;
  s.PrintLeft = -50;
  s.PrintEnlarge = 1.7f;
  s.PrintOrient = 1;
  SavePrintSetup(file, settings, s);
  for (const auto& [section, key, value] : {std::tuple{"Charts", "Cw", "9000"},
                                            {"Charts", "Ch", "6000"},
                                            {"Charts", "SW", "-50"},
                                            {"Charts", "SH", "-800"},
                                            {"Charts", "EFact", "1.7"},
                                            {"ChtPage", "Orient", "1"}})
    EXPECT_EQ(file.GetSetting(section, key), value) << key;
  EXPECT_EQ(settings.charts.SW, -50);
  EXPECT_EQ(settings.charts.EFact, 1.7);
  EXPECT_EQ(settings.page.Orient, 1);
}

TEST(ChartPrintingTest, EnlargementThatNoPageHasCountsAsNone) {
  Settings settings;
  for (const double bad : {0.0, -1.5, 1e9, 1e300}) {
    settings.charts.EFact = bad;
    EXPECT_EQ(PrintSetupFrom(settings, {}).PrintEnlarge, 0) << bad;
  }
}

// Whatever a script holds, either its page is sent whole or a message comes.
TEST(ChartPrintingTest, DamagedScriptsSendAPageOrAreTold) {
  PrintFixture f;
  const std::string whole =
      "T,8.25,20,2,TEST    Test Holdings,26\r\nL,42,300,37,300,27\r\nS,8,5,294,12.50,27\r\n"
      "H,42,104,42,399,18\r\nK,41,252,18\r\nX,40.5,178,43.5,252,28\r\nV,80,45,80,429,25\r\n"
      "Z,7,601,35,KORA,27\r\n";
  int printed = 0, refused = 0;
  Mutator(11).Run({whole}, 4000, [&](const std::string& text) {
    const bool ok = f.Print(text);
    ++(ok ? printed : refused);
    ASSERT_EQ(f.dialogs.said.size(), ok ? 0u : 1u);
    ASSERT_EQ(f.printer.sent.size(), size_t(printed));
  });
  EXPECT_GT(printed, 100);
  EXPECT_GT(refused, 100);
}
