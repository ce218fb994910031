// What is drawn on a chart by the mouse, and by the keys in its place.

#include <algorithm>

#include "base/dates.h"
#include "indicators/rsi.h"
#include "store/chart_notes.h"
#include "store/trendline_file.h"
#include "tests/chartwindow/window_fixture.h"

namespace kora {
namespace {

class MarksTest : public ChartWindowTest {
 protected:
  MarksTest() {
    PutThree();
    // Thirty units to the bar: a click is on one.
    state.ChartSelLoaded = true;
    state.BarSpacing = 20;
    window().NextChart();
    surface.ops.clear();
  }
  // x of a column, y of a price.
  double X(int column) { return window().Chart.ChartLeft + 20.0 * column; }
  double Y(double price) { return PriceToPixel(window().Chart, price); }
  void Click(double x, double y, Pane pane = Pane::kPrice) {
    window().MouseMove({x, y, pane});
    window().MousePress({x, y, pane}, MouseButton::kLeft);
    window().MouseRelease({x, y, pane}, MouseButton::kLeft);
  }
  void DrawLine(double x1, double y1, double x2, double y2) {
    window().ToggleTrendline();
    Click(x1, y1);
    Click(x2, y2);
  }
  void RightClick(double x, double y) {
    window().MousePress({x, y, Pane::kPrice}, MouseButton::kRight);
  }
  std::vector<TrendlineRec> Saved() {
    return ReadTrendlines(home.files(), "c:\\korawin\\chtmisc\\AAA.TND");
  }
  std::string drawn() const { return home.Get("drive_c/korawin/data/ChtLns.Tmp"); }
  std::string LastLine(const std::string& text) {
    const size_t end = text.rfind("\r\n");
    const size_t start = text.rfind("\r\n", end - 1);
    return text.substr(start == std::string::npos ? 0 : start + 2,
                       end - (start == std::string::npos ? 0 : start + 2));
  }
  std::string Colour23() { return Str(colours[kTrendlines]); }
};

// ---- Trendlines

TEST_F(MarksTest, TwoClicksDrawALineThatIsOfferedForSavingAndKept) {
  dialogs.answers = {Answer::kYes};
  const double y1 = Y(12), y2 = Y(14);
  DrawLine(X(3), y1, X(10), y2);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Save Trendline");
  EXPECT_EQ(dialogs.said[0].title, "Trendline");
  const std::string line =
      "H," + Str(X(3)) + "," + Str(y1) + "," + Str(X(10)) + "," + Str(y2) + "," + Colour23();
  EXPECT_EQ(LastLine(script()), line);
  EXPECT_EQ(drawn(), line + "\r\n");
  const auto saved = Saved();
  ASSERT_EQ(saved.size(), 1u);
  EXPECT_EQ(std::int16_t(saved[0].TLSpacing), 21);
  EXPECT_EQ(saved[0].TLPeriod.raw(), "A");
  EXPECT_EQ(saved[0].TLStartDate.raw(), "20260204");
  EXPECT_EQ(saved[0].TLEndDate.raw(), "20260211");
  EXPECT_NEAR(saved[0].TLStartPrice, 12, 0.02);
  EXPECT_NEAR(saved[0].TLEndPrice, 14, 0.02);
  EXPECT_FALSE(window().ToolOn());
  EXPECT_EQ(window().view().TB, kNoButton);
}

TEST_F(MarksTest, TheBandErasesAndDrawsTwoLinesAndNeverTheChart) {
  window().ToggleTrendline();
  EXPECT_EQ(window().view().TB, kButtonTrend);
  EXPECT_EQ(state.ChartTask, kTaskTrendline);
  Click(100, 200);
  window().MouseMove({150, 210});
  surface.ops.clear();
  window().MouseMove({160, 220});
  const std::string colour = " " + Colour23();
  EXPECT_EQ(surface.ops, (std::vector<std::string>{"xor solid 100,200,150,210" + colour,
                                                   "xor solid 100,200,160,220" + colour}));
  surface.ops.clear();
  window().MouseMove({5, 5});
  EXPECT_TRUE(surface.ops.empty()) << "outside the frame the band stands still";
  dialogs.answers = {Answer::kNo};
  Click(5, 5);
  EXPECT_EQ(LastLine(script()), "H,100,200,160,220," + Colour23()) << "where the band stood";
  EXPECT_TRUE(Saved().empty());
}

TEST_F(MarksTest, NoKeepsTheLineOnThisChartAlone) {
  dialogs.answers = {Answer::kNo};
  DrawLine(X(3), 200, X(10), 150);
  EXPECT_FALSE(home.Exists("drive_c/korawin/chtmisc/AAA.TND"));
  EXPECT_NE(script().find("H," + Str(X(3)) + ",200"), std::string::npos);
  window().Redraw();
  EXPECT_EQ(script().find("H," + Str(X(3)) + ",200"), std::string::npos);
  EXPECT_EQ(drawn(), "");
}

TEST_F(MarksTest, ASavedLineComesBackWithEveryChartOfThatPeriodAtItsDates) {
  dialogs.answers = {Answer::kYes};
  DrawLine(X(3), Y(12), X(10), Y(14));
  const auto placed = [&] {
    return std::count_if(surface.ops.begin(), surface.ops.end(), [&](const std::string& op) {
      return op.starts_with("line solid") && op.ends_with(" " + Colour23());
    });
  };
  for (const std::int16_t spacing : std::initializer_list<std::int16_t>{20, 7, 3}) {
    state.BarSpacing = spacing;
    surface.ops.clear();
    window().Redraw();
    EXPECT_EQ(placed(), 1) << spacing;
    EXPECT_NE(script().find("H," + Str(43.0 + 3 * spacing) + ","), std::string::npos);
  }
  state.ChartPeriod = Period::kWeekly;
  surface.ops.clear();
  window().Redraw();
  EXPECT_EQ(placed(), 0);
  state.ChartPeriod = Period::kDaily;
  window().NextChart();
  EXPECT_EQ(shown(), "BBB.WDT");
  EXPECT_EQ(script().find("," + Colour23() + "\r\n"), std::string::npos);
}

TEST_F(MarksTest, ALineFromColumnZeroIsNotKeptAndNothingIsSaid) {
  dialogs.answers = {Answer::kYes};
  DrawLine(X(0), 200, X(10), 150);
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_TRUE(Saved().empty());
}

TEST_F(MarksTest, ASwingChartDoesNotOfferToSave) {
  state.SwingOn = true;
  DrawLine(X(3), 200, X(10), 150);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_NE(drawn(), "");
}

TEST_F(MarksTest, NoLinesOnPointAndFigureCharts) {
  state.ChartStyle = Style::kPointFigure;
  window().ToggleTrendline();
  EXPECT_FALSE(window().ToolOn());
  window().StartText();
  EXPECT_FALSE(window().ToolOn());
  window().TellHowToErase();
  window().RemoveAllTrendlines();
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(MarksTest, AFileThatCannotBeWrittenIsToldAndTheLineStaysOnThePicture) {
  home.files().MakeFolder("c:\\korawin\\chtmisc\\AAA.TND");
  dialogs.answers = {Answer::kYes};
  DrawLine(X(3), 200, X(10), 150);
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[1].title, "Trendline");
  EXPECT_NE(drawn(), "");
  EXPECT_TRUE(surface.Has("line solid " + Str(X(3)) + ",200," + Str(X(10)) + ",150 " + Colour23()));
  window().Redraw();
  EXPECT_TRUE(window().Chart.ChartDrawn) << "the chart shows without its lines";
}

TEST_F(MarksTest, OddFilesOfLinesLeaveTheChartWhole) {
  const std::string ten(10u << 20, 'x');
  for (const std::string& bytes : {std::string(), std::string("short"), std::string(100, '\xFF'),
                                   std::string(27 * 3 + 5, '\0'), ten}) {
    home.Put("drive_c/korawin/chtmisc/AAA.TND", bytes);
    EXPECT_TRUE(window().Redraw());
    EXPECT_TRUE(window().Chart.ChartDrawn);
  }
  EXPECT_TRUE(dialogs.said.empty());
}

// ---- The right button

TEST_F(MarksTest, DeleteBlanksTheRecordAndTheNextSaveTakesItsPlace) {
  dialogs.answers = {Answer::kYes, Answer::kYes, Answer::kYes};
  DrawLine(X(3), 200, X(10), 200);
  DrawLine(X(3), 150, X(10), 150);
  ASSERT_EQ(Saved().size(), 2u);
  choices = {TrendChoice::kDelete};
  surface.ops.clear();
  RightClick(X(5), 201);
  EXPECT_EQ(popUps, 1);
  const std::string place = "line solid " + Str(X(3)) + ",200," + Str(X(10)) + ",200 ";
  const int marked = colours[kTrendlines] == colours[14] ? 15 : 14;
  EXPECT_EQ(surface.ops, (std::vector<std::string>{place + Str(colours[kMovingGrid]),
                                                   place + Str(colours[size_t(marked)]),
                                                   place + Str(colours[kBackground])}));
  ASSERT_EQ(Saved().size(), 2u);
  EXPECT_TRUE(Saved()[0].Empty());
  RightClick(X(5), 201);
  EXPECT_EQ(popUps, 2) << "it hits there until the next composition";
  DrawLine(X(4), 120, X(9), 120);
  ASSERT_EQ(Saved().size(), 2u);
  EXPECT_EQ(Saved()[0].TLStartDate.raw(), "20260205");
}

TEST_F(MarksTest, AMovedLineIsAFurtherRecord) {
  dialogs.answers = {Answer::kYes, Answer::kYes};
  DrawLine(X(3), 200, X(8), 200);
  choices = {TrendChoice::kMove};
  RightClick(X(5), 200);
  EXPECT_TRUE(window().ToolOn());
  EXPECT_TRUE(window().view().CrossPointer);
  surface.ops.clear();
  window().MouseMove({X(6), 180});
  EXPECT_EQ(surface.ops, std::vector<std::string>{"xor solid " + Str(X(4)) + ",180," + Str(X(9)) +
                                                  ",180 " + Colour23()});
  window().MouseMove({X(7), 160});
  window().MouseRelease({X(7), 160}, MouseButton::kLeft);
  EXPECT_FALSE(window().ToolOn());
  EXPECT_EQ(LastLine(drawn()), "H," + Str(X(5)) + ",160," + Str(X(10)) + ",160," + Colour23());
  ASSERT_EQ(Saved().size(), 2u);
  EXPECT_EQ(Saved()[0].TLStartDate.raw(), "20260204");
  EXPECT_EQ(Saved()[1].TLStartDate.raw(), "20260206");
}

TEST_F(MarksTest, OverlappingLinesEachHaveTheirPopUp) {
  dialogs.answers = {Answer::kYes, Answer::kYes};
  DrawLine(X(3), 200, X(8), 200);
  DrawLine(X(9), 200, X(12), 200);
  RightClick(X(5), 200);
  EXPECT_EQ(popUps, 2);
  ASSERT_EQ(Saved().size(), 2u);
  EXPECT_FALSE(Saved()[0].Empty());
  RightClick(X(5), 300);
  EXPECT_EQ(popUps, 2);
}

TEST_F(MarksTest, AllLinesAreRemovedAfterTwoQuestions) {
  dialogs.answers = {Answer::kYes};
  DrawLine(X(3), 200, X(8), 200);
  dialogs.said.clear();
  dialogs.answers = {Answer::kYes, Answer::kNo};
  window().RemoveAllTrendlines();
  EXPECT_EQ(Saved().size(), 1u);
  dialogs.answers = {Answer::kYes, Answer::kYes};
  dialogs.said.clear();
  window().RemoveAllTrendlines();
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text, "Remove all trendlines for AAA");
  EXPECT_EQ(dialogs.said[0].title, "Remove all Trendlines");
  EXPECT_EQ(dialogs.said[1].text,
            "WARNING - All trendlines for AAA will be removed. Are you sure?");
  EXPECT_FALSE(home.Exists("drive_c/korawin/chtmisc/AAA.TND"));
  EXPECT_EQ(script().find("," + Colour23() + "\r\n"), std::string::npos);
}

TEST_F(MarksTest, TheButtonToRemoveALineSaysHow) {
  window().TellHowToErase();
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Charts");
  EXPECT_EQ(dialogs.said[0].text,
            "To delete a trendline, click that trendline with your RIGHT mouse button the select "
            "DELETE");
}

// ---- The oscillator picture

TEST_F(MarksTest, LinesOfTheOscillatorPictureAreOfThisChartAndTheToolStaysOn) {
  settings.osc[kRsiP] = {5, 5};
  window().PickOscillator("RSI");
  window().ToggleTrendline();
  panel.ops.clear();
  Click(100, 40, Pane::kPanel);
  Click(200, 60, Pane::kPanel);
  const std::string line = "M,100,492,200,512," + Colour23();
  EXPECT_EQ(LastLine(script()), line) << "452 below";
  EXPECT_EQ(drawn(), line + "\r\n");
  EXPECT_TRUE(panel.Has("line solid 100,40,200,60 " + Colour23()));
  EXPECT_TRUE(window().ToolOn());
  EXPECT_TRUE(dialogs.said.empty());
  test::RecordingSurface upper(638, 452), lower(638, 144);
  EXPECT_TRUE(window().DrawAgain(upper, &lower));
  EXPECT_TRUE(lower.Has("line solid 100,40,200,60 " + Colour23()));
}

// ---- Text

TEST_F(MarksTest, TextIsTypedOntoTheChartAndKeptUnderItsDate) {
  window().StartText();
  EXPECT_TRUE(window().view().CrossPointer);
  EXPECT_FALSE(window().TakesText());
  const double y = Y(13);
  window().MousePress({X(4), y}, MouseButton::kLeft);
  EXPECT_TRUE(window().TakesText());
  EXPECT_EQ(window().view().Title, "Text - Enter text required - Press ENTER to Save");
  surface.ops.clear();
  for (const char32_t c : U"Bu,yy") {
    if (c) window().Type(c);
  }
  window().Type(8);
  window().Type(13);
  EXPECT_FALSE(window().ToolOn());
  EXPECT_NE(window().view().Title, "Text - Enter text required - Press ENTER to Save");
  const std::string place = Str(X(4)) + "," + Str(y);
  EXPECT_EQ(surface.ops.front(), "text 8.25 " + place + " B " + Str(colours[kChartTitle]));
  EXPECT_TRUE(surface.Has("text 8.25 " + place + " Bu " + Str(colours[kChartTitle])));
  EXPECT_TRUE(surface.Has("text 8.25 " + place + " Buyy " + Str(colours[kBackground])));
  EXPECT_EQ(surface.ops.back(), "text 8.25 " + place + " Buy " + Str(colours[kChartTitle]));
  const auto notes = ReadNoteLines(home.files(), "c:\\korawin\\chtmisc\\AAA.Txt");
  ASSERT_EQ(notes.size(), 1u);
  const std::string price = Format(window().Chart.Price.Price(y), "#.00");
  EXPECT_EQ(notes[0].line, "T,8.25,20260205," + price + ",Buy," + Str(colours[kScalesText]));
  EXPECT_EQ(home.Get("drive_c/korawin/chtmisc/AAA.Txt"), notes[0].line + "\r\n");
  EXPECT_EQ(LastLine(script()), "T,8.25," + place + ",Buy," + Str(colours[kScalesText]));
  window().Redraw();
  EXPECT_NE(script().find("T,8.25," + Str(43.0 + 4 * 20) + "," + Str(y) + ",Buy,"),
            std::string::npos);
}

TEST_F(MarksTest, ATextThatIsGivenUpIsTakenAway) {
  window().StartText();
  window().MousePress({X(4), 200}, MouseButton::kLeft);
  window().Type('A');
  window().CancelChartTools();
  EXPECT_EQ(surface.ops.back(), "text 8.25 " + Str(X(4)) + ",200 A " + Str(colours[kBackground]));
  EXPECT_FALSE(home.Exists("drive_c/korawin/chtmisc/AAA.Txt"));
}

TEST_F(MarksTest, ATextThatCannotBeKeptIsTold) {
  home.files().MakeFolder("c:\\korawin\\chtmisc\\AAA.Txt");
  window().Redraw();
  window().StartText();
  window().MousePress({X(4), 200}, MouseButton::kLeft);
  window().Type('A');
  window().Type(13);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Text");
}

// ---- Fibonacci

TEST_F(MarksTest, TwoClicksUpARiseDrawThreeLevels) {
  window().ToggleFibonacci();
  EXPECT_EQ(window().view().TB, kButtonFib);
  EXPECT_EQ(window().view().Panels[1], "FIBONACCI");
  EXPECT_TRUE(window().view().PanelsAlike);
  const double from = Y(10), to = Y(14);
  window().MousePress({100, from}, MouseButton::kLeft);
  const auto& panels = window().view().Panels;
  const double start = PixelToPrice(window().Chart, from), end = PixelToPrice(window().Chart, to);
  EXPECT_EQ(panels[2], "Start  " + Format(start, "#####.00#"));
  window().MousePress({200, to}, MouseButton::kLeft);
  EXPECT_EQ(panels[3], "End   " + Format(end, "#####.00#"));
  EXPECT_EQ(panels[4], "Rise   " + Format(end - start, "#####.00#"));
  const double rise = end - start;
  const struct {
    double factor;
    size_t panel;
    const char* label;
    int colour;
  } levels[] = {{0.38, 5, "38%    ", 20}, {0.5, 6, "50%    ", 21}, {0.62, 7, "62%    ", 20}};
  std::string expected;
  for (const auto& level : levels) {
    const double price = end - rise * level.factor;
    EXPECT_EQ(panels[level.panel], level.label + Format(price, "#####.00#"));
    const std::string y = Str(Y(price));
    const std::string colour = Str(colours[size_t(level.colour)]);
    expected += "D,200," + y + ",350," + y + "," + colour + "\r\n";
    EXPECT_TRUE(surface.Has("line dot 200," + y + ",350," + y + " " + colour));
  }
  EXPECT_EQ(drawn(), expected);
  EXPECT_TRUE(script().ends_with(expected));
  EXPECT_TRUE(window().ToolOn());
  window().MousePress({100, from}, MouseButton::kLeft);
  EXPECT_EQ(panels[5], "") << "the next pair begins";
}

TEST_F(MarksTest, ASecondClickBelowTheFirstGivesNoLevels) {
  window().ToggleFibonacci();
  window().MousePress({100, Y(14)}, MouseButton::kLeft);
  window().MousePress({200, Y(10)}, MouseButton::kLeft);
  EXPECT_TRUE(window().view().Panels[4].starts_with("Rise   -"));
  EXPECT_EQ(window().view().Panels[5], "");
  EXPECT_FALSE(home.Exists("drive_c/korawin/data/ChtLns.Tmp"));
}

TEST_F(MarksTest, LevelsEndAtTheFrame) {
  window().ToggleFibonacci();
  const double right = window().Chart.ChartRight;
  window().MousePress({right - 30, Y(10)}, MouseButton::kLeft);
  window().MousePress({right - 20, Y(14)}, MouseButton::kLeft);
  EXPECT_TRUE(drawn().starts_with("D," + Str(right - 20) + ",")) << drawn();
  EXPECT_NE(drawn().find("," + Str(right) + ","), std::string::npos);
}

TEST_F(MarksTest, FibonacciIsLeftByItsButton) {
  window().ToggleFibonacci();
  window().ToggleFibonacci();
  EXPECT_FALSE(window().ToolOn());
  for (const bool shown : window().view().PanelShown) EXPECT_FALSE(shown);
  EXPECT_FALSE(window().view().PanelsAlike);
}

// ---- Zoom

TEST_F(MarksTest, ADraggedBoxOpensTheZoomAndTheChartIsDrawnAgain) {
  window().ToggleZoom();
  EXPECT_EQ(window().view().TB, kButtonZoom);
  window().MousePress({300, 200}, MouseButton::kLeft);
  window().MouseMove({250, 180});
  surface.ops.clear();
  window().MouseMove({200, 100});
  EXPECT_EQ(surface.ops,
            (std::vector<std::string>{"box 300,200,250,180 " + Str(colours[kMovingGrid]),
                                      "box 300,200,200,100 " + Str(colours[kMovingGrid])}));
  window().MouseRelease({200, 100}, MouseButton::kLeft);
  ASSERT_EQ(zoomed.size(), 1u);
  EXPECT_EQ(zoomed[0].x1, 200);
  EXPECT_EQ(zoomed[0].y1, 100);
  EXPECT_EQ(zoomed[0].x2, 300);
  EXPECT_EQ(zoomed[0].y2, 200);
  EXPECT_FALSE(window().ToolOn());
  EXPECT_EQ(shown(), "AAA.WDT");
  EXPECT_TRUE(surface.Has("cls"));
}

TEST_F(MarksTest, AZoomOnASingleColumnDoesNotOpen) {
  window().ToggleZoom();
  window().MousePress({200, 100}, MouseButton::kLeft);
  window().MouseRelease({200, 180}, MouseButton::kLeft);
  EXPECT_TRUE(zoomed.empty());
  EXPECT_FALSE(window().ToolOn());
}

TEST_F(MarksTest, TheRightButtonGivesTheZoomUp) {
  window().ToggleZoom();
  window().MousePress({200, 100}, MouseButton::kLeft);
  window().MouseMove({250, 180});
  surface.ops.clear();
  RightClick(260, 190);
  EXPECT_EQ(surface.ops,
            std::vector<std::string>{"box 200,100,250,180 " + Str(colours[kMovingGrid])});
  EXPECT_FALSE(window().ToolOn());
  EXPECT_EQ(popUps, 0);
}

TEST_F(MarksTest, OnlyBarsAndCandlesAreZoomed) {
  state.ChartStyle = Style::kLine;
  window().Redraw();
  window().ToggleZoom();
  EXPECT_FALSE(window().ToolOn());
}

// ---- By the keys alone

TEST_F(MarksTest, ALineByTheKeysAlone) {
  dialogs.answers = {Answer::kYes};
  window().ToggleTrendline();
  window().PointToEnd(false);
  window().MovePoint(3);
  window().ClickPoint();
  window().MovePoint(5, 0);
  window().MovePoint(0, -20);
  window().ClickPoint();
  ASSERT_EQ(Saved().size(), 1u);
  EXPECT_EQ(Saved()[0].TLStartDate.raw(), "20260204");
  EXPECT_EQ(Saved()[0].TLEndDate.raw(), "20260209");
  EXPECT_GT(float(Saved()[0].TLEndPrice), float(Saved()[0].TLStartPrice));
  EXPECT_FALSE(window().ToolOn());
}

TEST_F(MarksTest, TheKeysReachTheOscillatorPictureAndComeBack) {
  settings.osc[kRsiP] = {5, 5};
  window().PickOscillator("RSI");
  window().ToggleTrendline();
  window().MovePoint(0);
  for (int i = 0; i < 60; ++i) window().MovePoint(0, 10);
  window().ClickPoint();
  window().MovePoint(-5);
  window().ClickPoint();
  EXPECT_TRUE(drawn().starts_with("M,")) << drawn();
}

TEST_F(MarksTest, ATextAndAZoomByTheKeysAlone) {
  window().StartText();
  window().PointToEnd(true);
  window().ClickPoint();
  ASSERT_TRUE(window().TakesText());
  window().Type('x');
  window().Type(13);
  EXPECT_EQ(ReadNoteLines(home.files(), "c:\\korawin\\chtmisc\\AAA.Txt").size(), 1u);
  window().ToggleZoom();
  window().PointToEnd(false);
  window().ClickPoint();
  window().MovePoint(10);
  window().MovePoint(0, 30);
  window().ClickPoint();
  EXPECT_EQ(zoomed.size(), 1u);
}

TEST_F(MarksTest, ThePointOfTheKeysLeavesNoLineBehind) {
  window().ToggleTrendline();
  window().MovePoint(0);
  window().MovePoint(-2);
  window().CancelChartTools();
  std::vector<std::string> lines;
  for (const std::string& op : surface.ops)
    if (op.starts_with("xor")) lines.push_back(op);
  EXPECT_FALSE(lines.empty());
  std::sort(lines.begin(), lines.end());
  for (size_t i = 0; i < lines.size(); i += 2) EXPECT_EQ(lines[i], lines[i + 1]);
}

TEST_F(MarksTest, NoToolStartsOnASavedChart) {
  home.Put("drive_c/korawin/chtsave/a.cht", script());
  window().ShowSaved("c:\\korawin\\chtsave\\a.cht");
  window().ToggleTrendline();
  EXPECT_FALSE(window().ToolOn());
  window().ToggleFibonacci();
  EXPECT_FALSE(window().ToolOn());
  window().ToggleZoom();
  EXPECT_FALSE(window().ToolOn());
}

TEST_F(MarksTest, ASavedPictureCarriesWhatWasDrawn) {
  dialogs.answers = {Answer::kYes, Answer::kNo};
  DrawLine(X(3), 200, X(8), 200);
  window().Redraw();
  DrawLine(X(3), 100, X(8), 100);
  test::RecordingSurface upper(638, 452);
  EXPECT_TRUE(window().DrawAgain(upper, nullptr));
  const auto lines = std::count_if(upper.ops.begin(), upper.ops.end(), [&](const std::string& op) {
    return op.ends_with(" " + Colour23());
  });
  EXPECT_EQ(lines, 2);
}

// ---- The walk through all charts

TEST_F(MarksTest, AnIntervalOfThirtyThreeFailsAndThirtyTwoWorks) {
  dialogs.replies = {"33"};
  window().ToggleAutoScroll();
  EXPECT_EQ(window().view().AutoScroll, 0);
  EXPECT_EQ(dialogs.said.back().text, "Overflow");
  EXPECT_EQ(ini.GetSetting("Charts", "Auto"), "33") << "what was written stays";
  EXPECT_EQ(state.ChartTask, kTaskNone);
  dialogs.replies = {"32"};
  window().ToggleAutoScroll();
  EXPECT_EQ(window().view().AutoScroll, 32000);
  EXPECT_EQ(window().view().TB, kButtonAuto);
  EXPECT_EQ(window().view().Caption, "AUTOMATIC SCROLL - TO STOP click AUTO");
  window().ToggleAutoScroll();
  EXPECT_EQ(window().view().AutoScroll, 0);
  EXPECT_EQ(window().view().Caption, "");
}

TEST_F(MarksTest, AnIntervalOf61Gives30AndHalvesGoToTheEvenSecond) {
  for (const auto& [typed, milliseconds] :
       {std::pair{"61", 30000}, {"-1", 30000}, {"2.5", 2000}, {"3.5", 4000}, {"0", 0}}) {
    dialogs.replies = {typed};
    window().ToggleAutoScroll();
    EXPECT_EQ(window().view().AutoScroll, milliseconds) << typed;
    window().CancelChartTools();
  }
  EXPECT_EQ(ini.GetSetting("Charts", "Auto"), "0");
}

TEST_F(MarksTest, TheWalkAsksOnceAndGoesRoundTheList) {
  state.ICFilterOn = true;
  dialogs.replies = {"2"};
  window().ToggleAutoScroll();
  EXPECT_EQ(dialogs.said.back().title, "Display Interval");
  EXPECT_EQ(dialogs.said.back().text, "Set interval between charts (0 - 60 seconds)\n\nAll charts");
  EXPECT_FALSE(state.ICFilterOn);
  for (const char* expected : {"BBB.WDT", "CCC.WDT", "AAA.WDT"}) {
    EXPECT_TRUE(window().AutoScrollTick());
    EXPECT_EQ(shown(), expected);
  }
  window().CancelChartTools();
  EXPECT_FALSE(window().AutoScrollTick());
  EXPECT_EQ(shown(), "AAA.WDT");
  dialogs.replies = {std::nullopt};
  window().ToggleAutoScroll();
  EXPECT_EQ(window().view().TB, kNoButton);
}

}  // namespace
}  // namespace kora
