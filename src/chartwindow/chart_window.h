#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "chart/chart_state.h"
#include "chart/composer.h"
#include "chart/composition.h"
#include "chartwindow/time_walk.h"
#include "chartwindow/told_once.h"
#include "chartwindow/tools/arrangement.h"
#include "chartwindow/tools/chart_tool.h"
#include "chartwindow/tools/cross_hair.h"
#include "chartwindow/tools/read_out.h"
#include "chartwindow/tools/saved_marks.h"
#include "chartwindow/tools/zoom_box.h"
#include "indicators/osc_panel.h"
#include "platform/settings_file.h"
#include "store/name_file.h"

namespace kora {

// What the menu of a trendline offers.
enum class TrendChoice { kNothing, kMove, kDelete };

// What the chart window works with. Nothing is owned.
struct ChartWindowServices {
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  SettingsFile& ini;   // Kora.ini
  SettingsFile& user;  // the per-user store
  const ChartColours& colours;
  CurrentName& current;
  ChartState& state;
  Surface& price;  // Picture1
  Surface& panel;  // Picture2(0)
  // Sizes the two surfaces for one pane or two, before each composition, and shows or hides the
  // lower one. A surface that takes another size comes back blank. May be empty.
  std::function<void(bool twoPanes)> layOut = {};
  // Shows the settings box of the oscillator on show, which calls ShowOscillator when it is
  // saved; without one the oscillator comes at once.
  std::function<void()> openOscFrm = {};
  // The dialog that chooses the second chart of a pair; it ends with NextChart.
  std::function<void()> openChart2 = {};
  // Asks for the box value of a point-and-figure chart, proposing one; the answer, or the
  // proposal. Empty takes the proposal.
  std::function<float(float)> askBoxValue = {};
  // The pop-up menu of a trendline, at the pointer.
  std::function<TrendChoice()> popUpTrend = {};
  // Shows the part of the chart within the box, until it is closed.
  std::function<void(const ZoomBox&)> openZoom = {};
  // The unit of a security's volumes; none while it is empty.
  std::function<std::string(const NameRec&)> VolumeUnitText = {};
};

// Heights of the pictures of a chart window, in its units.
struct PaneLayout {
  double width = 0;                // of both
  double price = 0;                // Picture1, from 0 down
  double panelTop = 0, panel = 0;  // Picture2(0); 0 high where there is one pane
};
// `height`: of the form between its menu and its lower edge; the bars are those of tools and
// status.
PaneLayout LayOutPanes(double width, double height, double toolBar, double statusBar,
                       bool twoPanes);
// Widths of the panels of the status bar: each of the first seven, and the last.
struct StatusWidths {
  int each, last;
};
StatusWidths StatusBarWidths(double formWidth);

// Where the frame of the date limit stands on the chart.
struct FramePlace {
  double top = 0, left = 0;
};

// Buttons of the tool bar, by their place.
enum ToolButton : int {
  kNoButton = 0,
  kButtonNew = 1,
  kButtonAuto,
  kButtonRefresh,
  kButtonBack,
  kButtonForward,
  kButtonBar,
  kButtonCandle,
  kButtonLine,
  kButtonPF,
  kButtonDaily,
  kButtonWeekly,
  kButtonMonthly,
  kButtonGrid,
  kButtonTrend,
  kButtonErase,
  kButtonMulti1,
  kButtonMulti2,
  kButtonFib,
  kButtonSpaces,
  kButtonZoom,
};
inline constexpr int kToolButtons = kButtonZoom;
struct ToolButtonText {
  const char* key;
  const char* tip;
};
// Key and tool tip of buttons 1 to 20.
const ToolButtonText& ToolButtonOf(int button);

// What the form shows beside the pictures.
struct ChartWindowView {
  static constexpr size_t kPanels = 8;
  int TB = kNoButton;   // the button that is pressed
  StatusPanels Panels;  // StatusBar1; Panels[0] is panel 1
  std::array<bool, kPanels> PanelShown{};
  bool FrameShown = false;          // Frame1 with the date steps, enabled when shown
  std::optional<FramePlace> Frame;  // nothing: where the form puts it
  bool LegendShown = false;         // Picture4
  bool PanelsAlike = false;         // the last panel is as wide as the others
  bool CrossPointer = false;        // over the pictures
  std::string Caption;              // Label1, hidden while empty
  int AutoScroll = 0;               // milliseconds between charts while they walk by; 0 off
  // The caption of the window: the data folder and, of a chart that stands, code, style and period.
  std::string Title;
};

// What the chart window does without its form: which security comes next, when it is composed, and what the
// tools do. The form shows the surfaces and the view, and passes on what the user does.
//
// Each call that composes returns false when no chart was drawn; the reason was told then.
class ChartWindow {
 public:
  explicit ChartWindow(const ChartWindowServices& services);
  ChartWindow(const ChartWindow&) = delete;
  ChartWindow& operator=(const ChartWindow&) = delete;

  const ChartWindowView& view() const { return view_; }
  ChartState& state() const { return services_.state; }

  // Forms that come or go after the window.
  void SetOscFrm(std::function<void()> open) { services_.openOscFrm = std::move(open); }
  void SetChart2(std::function<void()> open) { services_.openChart2 = std::move(open); }
  void SetAskBoxValue(std::function<float(float)> ask) { services_.askBoxValue = std::move(ask); }

  // The window was opened: no chart yet. In a run that has not met chart selection, charts are
  // drawn as the settings have them.
  void Load();
  // The window goes.
  void Unload();
  // After the data folder changed.
  void RefreshTitle();

  // ---- Which chart

  // Draws the chart at a place of the list; beyond the last it is the first. ChartIndex is its
  // place then, and 0 when there is none.
  bool ShowAt(int index);
  // Moves on to the next chart with wrap and draws it.
  bool NextChart();
  // One chart forward or backward by ChartDirection, with wrap; under an industry filter the
  // next one of that class.
  bool StepChart();
  // The current chart once more.
  bool Redraw();
  // The same with every tool left: the tool bar's "ref".
  bool Refresh();
  // The pictures have another size and are blank: all that stood on them once more. A chart that
  // failed is tried too, for another size shows other records; what the last try told is not
  // told again.
  bool Resized();
  // Composes the security in hand with its oscillator.
  bool DrawChart();
  // What the pictures are called to those who can't see them: code, style, period, last date and
  // close of the chart, and the oscillator below it; "Chart" and "Oscillator" where there is none.
  std::string ChartName() const;
  std::string PanelName() const;
  // True when a chart was asked for and stands, or stood until it failed.
  bool HasChart() const { return services_.state.ChartIndex != 0; }

  // ---- How it is drawn. Each leaves the tools and draws again.

  bool SetStyle(Style style);
  bool SetPeriod(Period period);
  bool ToggleGridLines();
  // Whether labels that would not fit are made to; kept.
  bool ToggleLegible();
  bool ToggleReversals();
  bool ToggleOutsideDays();
  bool ToggleMMA();
  // Moves on to the next chart.
  bool TogglePFAuto();
  // A swing chart in place of the bars, at least 3 apart, and back to the bars as they were.
  bool ToggleSwing();
  // A dialog changed what the chart shows: the stop loss.
  bool Recompose();

  // ---- Oscillators

  // A menu entry's code: "DM", "COP", ... "PARA", "PARAV".
  void PickOscillator(std::string_view code, bool slow = false);
  // Whether an oscillator of the menu stays for the charts that follow, from the one on show on.
  void ToggleKeepOscillator();
  // Checks the periods of OscCode and draws it. False when nothing was drawn.
  bool ShowOscillator();

  // ---- Two charts

  void StartSuperimpose();
  void StartSplitScreen();
  // The second chart was not chosen.
  void DropSecondChart();
  Arrangement arrangement() const { return arrangement_; }

  // ---- Files

  // Before the dialog, and then what was chosen in it (a DOS path, nothing for cancel). Endings
  // other than .cht are made by `makePicture`, where there is one, from the name: the bytes.
  void StartSaving();
  void SaveChartAs(const std::optional<std::string>& path,
                   const std::function<std::string(const std::string&)>& makePicture = {});
  // Trimmed code + ".cht".
  std::string SuggestedName() const;
  // The script of the chart on show: the TCht.Tmp that it was composed with, or the saved
  // chart's file. Empty while no chart stands that was drawn whole: there is nothing to save or
  // print then.
  std::string ScriptOnShow() const;
  // Before the forms of page set-up and printing: tools left, the script kept as it is.
  void StartPrinting(bool print);
  // Plays a saved chart in place of the composed one.
  void ShowSaved(const std::string& path);
  // Draws what stands on the window once more, on surfaces of the same sizes. `panel` may be
  // null. The script stays as it is.
  bool DrawAgain(Surface& price, Surface* panel);

  // ---- The date limit

  // 0 to 2 a day, week or month forward, 3 to 5 backward. The ends of the data are no limit.
  bool StepDateLimit(int index);
  // Moves the end of the chart through the data, by steps to later bars or, below 0, to earlier
  // ones. At the newest window the limit goes, and with the next chart, unless it was chosen in
  // chart selection. False where nothing moves: at an end, on point and figure, on two charts.
  bool MoveTime(TimeStep step, int by);
  // Space between bars, 1 to 20; candlesticks and swings need 3. Not for point and figure.
  bool ChangeSpacing(int by);
  // The frame was dropped at (x, y) of the chart; its size.
  bool DropFrame(double x, double y, double width, double height);

  // ---- Tools

  // Before chart selection opens.
  void StartNewChart();
  // It was left without a choice: the chart on show stands.
  void BackToChart();
  void CancelChartTools();
  void SetTB(int button) { view_.TB = button; }
  void ToggleGrid();
  // These are for composed charts, the first and the third not for point and figure.
  void ToggleTrendline();
  void ToggleFibonacci();
  void StartText();
  // Bar and candle charts alone.
  void ToggleZoom();
  // What the button to remove a trendline says.
  void TellHowToErase();
  // Asks twice, then removes the file of this security and draws it again.
  void RemoveAllTrendlines();
  // All charts of the list one after another; asks for the interval. Again, and it stops.
  void ToggleAutoScroll();
  // The next chart of the walk.
  bool AutoScrollTick();
  // The mouse over a picture; without a tool nothing comes of it.
  void MouseMove(const ToolPoint& at);
  void MousePress(const ToolPoint& at, MouseButton button);
  void MouseRelease(const ToolPoint& at, MouseButton button);
  // The keys have a point of their own, which goes on from where the mouse left it, or begins at
  // the last bar: so many bars to the right and units down, to one end, a click there, a character
  // typed. Without a tool the cross hair comes.
  void MovePoint(int bars, int down = 0);
  void PointToEnd(bool last);
  void ClickPoint();
  void Type(char32_t character);
  bool TakesText() const { return tool_ && tool_->TakesText(); }
  // Takes away what the tool has drawn while `work` reads the pictures.
  void WithoutTool(const std::function<void()>& work);
  // What tools draw and take away.
  TouchedFn Touched;
  // The surfaces are blank: there is nothing to take away.
  void ForgetTool();
  bool ToolOn() const { return tool_ != nullptr; }
  bool GridOn() const { return IsOn(kTaskGrid); }
  bool IsOn(std::int16_t task) const { return tool_ && state().ChartTask == task; }

  bool Loading = true;         // no handler composes while it is true
  bool AnalPageMode = false;   // the multi-oscillator view is open
  bool ChartFromFile = false;  // a saved chart is on show
  std::string SavedChartFile;

  ChartRequest Request;  // of the last composition
  Composition Chart;

 private:
  bool GoTo(int index, bool filtered);
  bool FindRecord(int index, bool filtered);
  bool FindNextChtIC(const std::vector<NameRec>& names);
  void EmptyDrawnLines();
  void ShowDateLimit();
  void HideFrame();
  void TakeChosenLimit();
  void LayOut(bool twoPanes);
  void ShowLegend();
  bool Compose();
  bool Compose(const ChartRequest& request, ChartPlace place);
  bool DrawAll();
  bool RedrawPair();
  ChartServices Services(Surface& price, Surface* panel, ChartScript* script);
  OscHost Host(std::string_view code, Composition& chart, const ChartRequest& request,
               Surface& price, Surface& panel, ChartScript* script);
  void ShowPanel(std::string_view code);
  void TellDailyOnly(std::string_view code);
  void KeepPicked();
  bool CompareFileThere();
  void ClearStatusBar();
  void GridON();
  void GridOFF();
  void FibOFF();
  void StartTool(std::unique_ptr<ChartTool> tool, ToolButton button, std::int16_t task);
  void LeaveTool();
  void After(ToolState state);
  void PointTo(const ToolPoint& at);
  void MoveRow(std::int32_t rows);
  void DropMarker();
  void HitTrendlines(const ToolPoint& at);
  void Keep(const DrawnMark& mark);
  void ReplayMarks(Surface& price, Surface* panel) const;
  std::function<void(const ChartCanvas&)> MarksOverlay();

  ChartWindowServices services_;
  ToldOnce dialogs_;  // through which the window says everything
  ChartWindowView view_;
  std::optional<ChartScript> script_;
  ChartRequest first_;               // of the first chart of a pair
  std::string panelCode_;            // the oscillator that was drawn last, empty none
  std::vector<double> panelValues_;  // what it ends at
  bool pictureGone_ = false;         // the picture was cleared for a chart to come
  bool boxKept_ = false;             // the chart to come is the one on show: its box value stands
  std::int16_t SavedSpacing_ = 2;    // of the bars, while a swing is on
  bool panelPicked_ = false;         // from the menu: it is not part of the next chart, unless
  bool panelKept_ = false;           // it is kept
  PanelFrame panelFrame_;
  Arrangement arrangement_ = Arrangement::kOne;
  std::string scriptPath_;  // of the composition on show
  ToolView toolView_;
  std::unique_ptr<ChartTool> tool_;
  std::optional<ToolPoint> point_;     // where mouse or keys have left it
  std::unique_ptr<CrossHair> marker_;  // shows the point of the keys, for tools that do not
  SavedMarks savedMarks_;              // as they were when the chart was composed
  std::vector<TrendlineRow> rows_;     // where its lines stand
  std::vector<DrawnMark> marks_;       // drawn since
  bool framePending_ = true;           // the frame's place was not read yet
};

}  // namespace kora
