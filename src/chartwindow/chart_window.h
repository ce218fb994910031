#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "chart/chart_state.h"
#include "chart/composer.h"
#include "chart/composition.h"
#include "chartwindow/read_out.h"
#include "chartwindow/told_once.h"
#include "indicators/osc_panel.h"
#include "platform/settings_file.h"
#include "store/name_file.h"

namespace kora {

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
  kNoButton = 0, kButtonNew = 1, kButtonAuto, kButtonRefresh, kButtonBack, kButtonForward,
  kButtonBar, kButtonCandle, kButtonLine, kButtonPF, kButtonDaily, kButtonWeekly, kButtonMonthly,
  kButtonGrid, kButtonTrend, kButtonErase, kButtonMulti1, kButtonMulti2, kButtonFib,
  kButtonSpaces, kButtonZoom,
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
  int TB = kNoButton;                     // the button that is pressed
  std::array<std::string, kPanels> Panels;  // StatusBar1; Panels[0] is panel 1
  std::array<bool, kPanels> PanelShown{};
  bool FrameShown = false;                // Frame1 with the date steps, enabled when shown
  std::optional<FramePlace> Frame;        // nothing: where the form puts it
  bool LegendShown = false;               // Picture4
  std::string Title;
};

// The rules of the chart window: which security comes next, when it is composed, and what the
// tools do. The form shows the surfaces and the view, and passes on what the user does.
//
// Each call that composes returns false when no chart was drawn; the reason was told then.
class ChartWindow {
 public:
  explicit ChartWindow(const ChartWindowServices& services);

  const ChartWindowView& view() const { return view_; }
  ChartState& state() const { return services_.state; }

  // Forms that come or go after the window.
  void SetOscFrm(std::function<void()> open) { services_.openOscFrm = std::move(open); }
  void SetChart2(std::function<void()> open) { services_.openChart2 = std::move(open); }

  // The window was opened: no chart yet. In a run that has not met chart selection, charts are
  // drawn as the settings have them.
  void Load();
  // The window goes.
  void Unload();
  // After the data folder changed.
  void RefreshTitle();

  // ---- Which chart

  // Moves on to the next chart with wrap and draws it. ChartIndex is 0 when there is none.
  bool NextChart();
  // One chart forward or backward by ChartDirection, with wrap; under an industry filter the
  // next one of that class.
  bool StepChart();
  // The current chart once more: one back, then the next.
  bool Redraw();
  // The same with every tool left: the tool bar's "ref".
  bool Refresh();
  // The pictures have another size and are blank: all that stood on them once more. A chart that
  // failed is tried too, for another size shows other records; what the last try told is not
  // told again.
  bool Resized();
  // Composes the security in hand with its oscillator.
  bool DrawChart();
  // True when a chart was asked for and stands, or stood until it failed.
  bool HasChart() const { return services_.state.ChartIndex != 0; }

  // ---- How it is drawn. Each leaves the tools and draws again.

  bool SetStyle(char style);
  bool SetPeriod(std::string_view period);
  bool ToggleGridLines();
  bool ToggleReversals();
  bool ToggleOutsideDays();
  bool ToggleMMA();
  // Moves on to the next chart.
  bool TogglePFAuto();
  // A dialog changed what the chart shows: the stop loss.
  bool Recompose();

  // ---- Oscillators

  // A menu entry's code: "DM", "COP", ... "PARA", "PARAV".
  void PickOscillator(std::string_view code, bool slow = false);
  // Checks the periods of OscCode and draws it. False when nothing was drawn.
  bool ShowOscillator();

  // ---- Two charts

  void StartSuperimpose();
  void StartSplitScreen();
  // The second chart was not chosen.
  void DropSecondChart();

  // ---- Files

  // Before the dialog, and then what was chosen in it (a DOS path, nothing for cancel). Endings
  // other than .cht are made by `makePicture`, where there is one, from the name: the bytes.
  void StartSaving();
  void SaveChartAs(const std::optional<std::string>& path,
                   const std::function<std::string(const std::string&)>& makePicture = {});
  // Trimmed code + ".cht".
  std::string SuggestedName() const;
  // The script of the chart on show: TCht.Tmp, or the saved chart's file.
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
  // The frame was dropped at (x, y) of the chart; its size.
  bool DropFrame(double x, double y, double width, double height);

  // ---- Tools

  // Before chart selection opens.
  void StartNewChart();
  void CancelChartTools();
  void SetTB(int button) { view_.TB = button; }
  void ToggleGrid();
  void MouseMove(double x, double y);
  void MouseClick();
  // The cross hair some bars to the right or left; it begins at the last bar.
  void MoveCross(int bars);
  void CrossToEnd(bool last);
  // Takes the cross hair away while `work` reads the pictures.
  void WithoutCross(const std::function<void()>& work);
  // Lines of the cross hair, as they are drawn and taken away.
  std::function<void(const Surface&, double x1, double y1, double x2, double y2)> CrossTouched;
  // The surfaces are blank: there is nothing to take away.
  void ForgetCross();
  bool GridOn() const { return cross_.has_value(); }

  bool Loading = true;        // no handler composes while it is true
  bool AnalPageMode = false;  // the multi-oscillator view is open
  bool ChartFromFile = false;  // a saved chart is on show
  std::string SavedChartFile;
  PFBoxes Boxes;              // of a point-and-figure chart

  ChartRequest Request;  // of the last composition
  Composition Chart;

 private:
  void EndPair();
  std::string ScriptPath() const;
  bool Move(int step, bool filtered);
  bool FindRecord(int step, bool filtered);
  bool FindNextChtIC(const std::vector<NameRec>& names);
  void EmptyDrawnLines();
  void ShowDateLimit();
  void HideFrame();
  void TakeChosenLimit();
  void LayOut(bool twoPanes);
  bool Compose();
  bool Compose(const ChartRequest& request);
  bool DrawAll();
  bool RedrawPair();
  ChartServices Services(Surface& price, Surface* panel, ChartScript* script);
  OscHost Host(std::string_view code, Composition& chart, const ChartRequest& request,
               Surface& price, Surface& panel, ChartScript* script);
  void ShowPanel(std::string_view code);
  bool PeriodsValid() const;
  bool CompareFileThere();
  void ClearStatusBar();
  void GridON();
  void GridOFF();
  void FibOFF();
  void MoveTo(double x, double y, std::int32_t column);
  void EraseCross();
  void CrossToColumn(std::int32_t column);

  ChartWindowServices services_;
  ToldOnce dialogs_;  // through which the window says everything
  ChartWindowView view_;
  std::optional<ChartScript> script_;
  ChartRequest first_;     // of the first chart of a pair
  std::string panelCode_;  // the oscillator that was drawn last, empty none
  bool panelPicked_ = false;  // from the menu: it is not part of the next chart
  std::int16_t panelTop_ = 0, panelBottom_ = 0;
  std::optional<CrossHair> cross_;
  std::int32_t crossColumn_ = 0;
  bool framePending_ = true;  // the frame's place was not read yet
};

}  // namespace kora
