#include "chartwindow/chart_window.h"

#include <algorithm>
#include <cmath>
#include <vector>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/script_player.h"
#include "chartwindow/chart_selection.h"
#include "indicators/oscillators.h"
#include "indicators/price_overlays.h"
#include "lists/chart_list.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Charts";
constexpr std::string_view kSaveTitle = "Save Chart";
constexpr std::string_view kCompareTitle = "RMX Compare ";
constexpr std::string_view kFrameKey = "BDFrame";

bool EndsWith(std::string_view name, std::string_view ending) {
  return name.size() >= ending.size() &&
         EqualNoCase(name.substr(name.size() - ending.size()), ending);
}

void ReadyToCopy(Surface& surface) {
  surface.SetDrawMode(DrawMode::kCopy);
  surface.SetDrawStyle(DrawStyle::kSolid);
}

void OwnScale(Surface& surface) { surface.SetScale(0, 0, surface.Width(), surface.Height()); }

}  // namespace

PaneLayout LayOutPanes(double width, double height, double toolBar, double statusBar,
                       bool twoPanes) {
  PaneLayout panes;
  panes.width = std::max(width - 2, 1.0);
  const double one = std::max(height - toolBar - statusBar - 2, 1.0);
  const double usable = height - toolBar;
  panes.price = std::floor(0.7 * usable - 20);
  panes.panel = std::min(usable - panes.price - 51, one - panes.price - 2);
  // A form too low for two pictures keeps the one.
  if (!twoPanes || panes.price < 1 || panes.panel < 1) return {panes.width, one, 0, 0};
  panes.panelTop = panes.price + 2;
  return panes;
}

StatusWidths StatusBarWidths(double formWidth) {
  const int each = int(Fix(formWidth)) / 9;
  return {each, int(1.25 * each)};
}

const ToolButtonText& ToolButtonOf(int button) {
  static constexpr ToolButtonText kTexts[kToolButtons] = {
      {"new", "Select a new chart"},
      {"auto", "Automatic scroll through charts"},
      {"ref", "Refresh the current chart"},
      {"rev", "Show the previous chart"},
      {"fwd", "Show the next chart"},
      {"bar", "Bar chart"},
      {"cstick", "Candlestick chart"},
      {"lne", "Line chart"},
      {"pf", "Point and figure chart"},
      {"dly", "Show chart in daily format"},
      {"wky", "Show chart in weekly format"},
      {"mly", "Show chart in monthly format"},
      {"grid", "Show moving grid and prices"},
      {"tline", "Draw trendline"},
      {"terase", "Remove trendline"},
      {"mo1", "Show multiple oscillators - group 1"},
      {"mo2", "Show multiple oscillators - group 2"},
      {"fib", "Show Fibonacci retracements"},
      {"cspace", "Change chart spaces"},
      {"sZoom", "Enlarges a section Bar or Candlestick chart"},
  };
  return kTexts[std::clamp(button, 1, kToolButtons) - 1];
}

ChartWindow::ChartWindow(const ChartWindowServices& services)
    : services_(services), dialogs_(services.dialogs) {
  RefreshTitle();
}

void ChartWindow::Load() {
  ChartState& s = state();
  Loading = true;
  AnalPageMode = false;
  s.ChartIndex = 0;
  s.OutsideDaysOn = false;
  framePending_ = true;
  if (!s.ChartSelLoaded) {
    const ChartRequest standing = RequestFromSettings(services_.settings);
    s.ChartStyle = standing.ChartStyle;
    s.ChartPeriod = standing.ChartPeriod;
    s.BarSpacing = standing.BarSpacing;
    s.BandKind = standing.BandKind;
    s.Ma1On = standing.Ma1On;
    s.Ma2On = standing.Ma2On;
  }
  Loading = false;
  LayOut(false);
  GridOFF();
}

void ChartWindow::Unload() {
  CancelChartTools();
  state().PFAutoBox = false;
  state().SplitScreen = state().SplitShown = state().Superimposed = false;
}

void ChartWindow::RefreshTitle() {
  view_.Title = "KORA Charting 7F   -  CHARTS  " +
                std::string(Trim(services_.settings.paths.CurrentDataPath));
}

std::string ChartWindow::ScriptOnShow() const {
  return ChartFromFile ? SavedChartFile : ScriptPath();
}

void ChartWindow::StartPrinting(bool print) {
  CancelChartTools();
  state().SuppressScript = true;
  if (print) state().ChartTask = kTaskPrinting;
}

std::string ChartWindow::ScriptPath() const {
  return services_.settings.paths.CurrentDataPath + "TCht.Tmp";
}

// ---- Which chart

bool ChartWindow::NextChart() {
  if (Loading) return false;
  if (!Move(1, false)) return false;
  ShowDateLimit();
  return DrawChart();
}

bool ChartWindow::StepChart() {
  if (Loading) return false;
  ChartState& s = state();
  if (s.ScrollInUse) {
    s.DateLimitOn = false;
    HideFrame();
  }
  s.PFBoxSize = 0;
  if (!Move(s.ChartDirection == 1 ? 1 : -1, s.ChartListNo == kFullList && s.ICFilterOn))
    return false;  // what stands on the window stays
  if (!s.OscShown) LayOut(false);
  if (s.DateLimitOn) TakeChosenLimit();
  return DrawChart();
}

bool ChartWindow::Redraw() {
  if (Loading || !HasChart()) return false;
  --state().ChartIndex;
  return NextChart();
}

bool ChartWindow::Refresh() {
  CancelChartTools();
  return Redraw();
}

bool ChartWindow::Resized() {
  ForgetCross();
  if (Loading || (!HasChart() && !ChartFromFile)) return false;
  return dialogs_.Repeat([this] { return DrawAll(); });
}

bool ChartWindow::DrawAll() {
  if (ChartFromFile) {
    LayOut(false);
    return ShowSavedChart(services_.files, dialogs_, services_.price, services_.settings.fonts,
                          services_.colours, SavedChartFile);
  }
  if (state().SplitShown || state().Superimposed) return RedrawPair();
  const std::string picked = panelPicked_ ? panelCode_ : "";
  if (!Redraw()) return false;
  if (picked.empty()) return true;
  state().OscCode = picked;
  return ShowOscillator();
}

// Both charts of a pair once more, or the first where the second is still to come.
bool ChartWindow::RedrawPair() {
  ChartState& s = state();
  const ChartRequest first = first_, second = Request;
  const bool split = s.SplitShown;
  const bool both = split ? !s.SplitScreen : Chart.OscPanel == 0;
  LayOut(false);
  if (split) {
    s.SplitScreen = true;
    Chart.ChartSlot = 1;
  } else {
    Chart.OscPanel = 1;
  }
  if (!Compose(first)) return false;
  if (!split) Chart.OscPanel = 2;
  return !both || Compose(second);
}

// Opens the files, finds the record `step` places on and reads it.
bool ChartWindow::Move(int step, bool filtered) {
  dialogs_.Forget();
  AnalPageMode = false;
  state().SuppressScript = false;
  EmptyDrawnLines();
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  std::string path = NameFilePath(dataPath);
  try {
    if (FindRecord(step, filtered)) return true;
    state().ChartIndex = 0;
    return false;
  } catch (const RunTimeError& e) {
    // A list may hold numbers that the name file lacks: the next step passes such a record. Of
    // a name file that can't be read there is no chart at all.
    if (state().ChartListNo != kFullList && e.number() == kBadRecordNumber)
      path = ListFilePath(dataPath, state().ChartListNo);
    else
      state().ChartIndex = 0;
    dialogs_.Message("There is a file access problem. Check directory paths option.\n" + path +
                         "  -  " + e.what(),
                     kTitle);
    return false;
  }
}

bool ChartWindow::FindRecord(int step, bool filtered) {
  ChartState& s = state();
  CurrentName& current = services_.current;
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  const NameFile names(services_.files, NameFilePath(dataPath));
  current.NameCount = CInt(names.count());
  std::int16_t count = current.NameCount;
  std::vector<ListRec> list;
  if (s.ChartListNo != kFullList) {
    list = ReadList(services_.files, dataPath, s.ChartListNo);
    s.ChartListCount = CInt(double(list.size()));
    count = s.ChartListCount;
  }
  if (count == 0 || current.NameCount == 0) {
    const std::string what =
        current.NameCount == 0 ? "Names.Dat" : ChartListName(services_.user, s.ChartListNo);
    dialogs_.Message(" There are no records in " + what + " for this folder.",
                     current.NameCount == 0 ? kTitle : "Chart Lists");
    return false;
  }
  const int index = s.ChartIndex + step;
  if (index > count) s.ChartIndex = 1;
  else if (index < 1) s.ChartIndex = count;
  else s.ChartIndex = CInt(index);
  if (filtered) FindNextChtIC(ReadNames(services_.files, dataPath));

  const std::int32_t record =
      list.empty() ? s.ChartIndex : list[size_t(s.ChartIndex) - 1].ListRecNo;
  current.Rec = names.Read(record);
  current.NameRecNo = CInt(record);
  current.CurrentDataFile = std::string(current.Rec.Code.trimmed()) + ".WDT";
  // Such data has no bars. The style stays for the charts that follow.
  if (current.Rec.RecType >= kCloseVolume && current.Rec.RecType <= kAdvanceDecline &&
      (s.ChartStyle == 'B' || s.ChartStyle == 'C'))
    s.ChartStyle = 'L';
  return true;
}

// From ChartIndex on to the end, and once more from the far end.
bool ChartWindow::FindNextChtIC(const std::vector<NameRec>& names) {
  ChartState& s = state();
  const std::string_view filter = Trim(s.ICFilter);
  const int step = s.ChartDirection == 1 ? 1 : -1;
  const int count = int(names.size());
  int index = s.ChartIndex;
  for (int pass = 0; pass < 2; ++pass) {
    for (; index >= 1 && index <= count; index += step) {
      if (!MatchesIndClass(names[size_t(index) - 1].IndClass.trimmed(), filter)) continue;
      s.ChartIndex = CInt(index);
      return true;
    }
    index = step > 0 ? 1 : count;
  }
  dialogs_.Message("No records on file for that Industry classification or group",
                     "Industry Classification");
  s.ChartIndex = 1;
  return false;
}

// What the mouse drew belongs to one chart.
void ChartWindow::EmptyDrawnLines() {
  if (state().SplitScreen) return;
  try {
    const std::string path = services_.settings.paths.CurrentDataPath + "ChtLns.Tmp";
    if (!services_.files.CheckFile(path)) return;
    if (services_.files.Open(path, OpenMode::kRead)->Size() > 0)
      services_.files.WriteAll(path, "");
  } catch (const RunTimeError&) {
    // A data folder that can't be written still shows charts.
  }
}

bool ChartWindow::DrawChart() {
  if (Loading) return false;
  ChartState& s = state();
  panelPicked_ = false;
  // Two charts on one picture have no room for a panel.
  const bool pair = s.SplitScreen || Chart.OscPanel > 0;
  if (s.OscShown && !pair) {
    if (s.ChartPeriod != "A" && s.OscCode == "RMO") {
      dialogs_.Message("RMO only available on Daily Charts", "RMO");
      LayOut(false);
      return Compose();
    }
    LayOut(s.OscSelected != "PARA");
    dialogs_.Yield();
    if (!Compose()) return false;
    if (s.OscSelected == "STO" || s.OscSelected == "FX") s.OscCode = s.OscSelected;
    if (s.OscSelected != "PARAV") ShowPanel(s.OscSelected);
    return true;
  }
  s.OscCode.clear();
  LayOut(false);
  dialogs_.Yield();
  return Compose();
}

void ChartWindow::LayOut(bool twoPanes) {
  EraseCross();
  if (!twoPanes) {
    if (Chart.OscPanel == 0 && services_.panel.Visible()) {
      services_.panel.SetBackColour(services_.colours[kBackground]);
      services_.panel.Cls();
    }
    panelCode_.clear();
  }
  if (services_.layOut) services_.layOut(twoPanes);
  else services_.panel.SetVisible(twoPanes);
  view_.LegendShown = state().ReversalsOn && state().ChartStyle == 'B';
}

ChartServices ChartWindow::Services(Surface& price, Surface* panel, ChartScript* script) {
  return {.files = services_.files,
          .dialogs = dialogs_,
          .paths = services_.settings.paths,
          .fonts = services_.settings.fonts,
          .colours = services_.colours,
          .price = price,
          .panel = panel,
          .script = script,
          .overlays = PriceOverlays(state().MMAOn, services_.settings.osc.MMASet),
          .VolumeUnitText = services_.VolumeUnitText};
}

bool ChartWindow::Compose() {
  return Compose(MakeRequest(state(), services_.settings, services_.current.Rec));
}

bool ChartWindow::Compose(const ChartRequest& request) {
  ChartState& s = state();
  // Two charts of a pair are composed one after the other over a picture that stays. What the
  // cross hair read is of the chart before, and must not stand under this one.
  EraseCross();
  if (cross_) ClearStatusBar();
  ChartFromFile = false;
  Chart.TwoCharts = s.SplitScreen;
  s.SplitShown = s.SplitScreen;
  s.Superimposed = Chart.OscPanel == 1 || Chart.OscPanel == 2;
  const bool second = Chart.OscPanel == 2;
  Request = request;
  if (Chart.OscPanel == 1 || (s.SplitScreen && Chart.ChartSlot == 1)) first_ = request;
  script_.emplace(services_.files, ScriptPath());
  const bool drawn = ComposeChart(Services(services_.price, &services_.panel, &*script_), Request,
                                  Chart);
  if (!drawn) {
    Chart.TwoCharts = false;
    s.MultiOscOn = 0;
  }
  s.SplitScreen = Chart.TwoCharts;
  if (!s.SplitScreen) Chart.ChartSlot = 0;
  if (second || !drawn) Chart.OscPanel = 0;
  if (!drawn && services_.panel.Visible()) services_.panel.Cls();
  return drawn;
}

bool ChartWindow::Recompose() {
  if (Loading || !HasChart()) return false;
  if (Chart.OscPanel == 2 || state().SplitScreen) {
    // The second chart is still to come: the first one alone is drawn anew.
    first_.GridLines = services_.settings.charts.GridLines;
    return RedrawPair();
  }
  if (!Compose()) return false;
  if (!panelCode_.empty()) ShowPanel(panelCode_);
  return true;
}

bool ChartWindow::DrawAgain(Surface& price, Surface* panel) {
  const ChartState& s = state();
  try {
    if (ChartFromFile || s.SplitShown || s.Superimposed) {
      price.SetBackColour(services_.colours[kBackground]);
      price.Cls();
      return PlayChartScript(
          services_.files.ReadAll(ScriptOnShow()), price,
          services_.settings.fonts, services_.colours);
    }
  } catch (const RunTimeError&) {
    return false;
  }
  if (!HasChart()) return false;
  Composition chart = Chart;
  ChartRequest request = Request;
  request.SuppressScript = true;
  if (!ComposeChart(Services(price, panel, nullptr), request, chart)) return false;
  const bool overlay = !panelCode_.empty() && !HasPanel(panelCode_);
  if (!panelCode_.empty() && (panel || overlay)) {
    OscHost host = Host(panelCode_, chart, request, price, panel ? *panel : services_.panel,
                        nullptr);
    ShowOscillatorPanel(host);
  }
  return true;
}

// ---- How it is drawn

bool ChartWindow::SetStyle(char style) {
  CancelChartTools();
  state().ChartStyle = style;
  return Redraw();
}

bool ChartWindow::SetPeriod(std::string_view period) {
  CancelChartTools();
  state().ChartPeriod = period;
  return Redraw();
}

bool ChartWindow::ToggleGridLines() {
  bool& on = services_.settings.charts.GridLines;
  on = !on;
  services_.ini.PutSetting("Charts", "Grid", on ? "True" : "False");
  return Recompose();
}

bool ChartWindow::ToggleReversals() {
  CancelChartTools();
  ChartState& s = state();
  s.ReversalsOn = !s.ReversalsOn;
  view_.LegendShown = s.ReversalsOn && s.ChartStyle == 'B';
  return s.ChartStyle == 'B' && Recompose();
}

bool ChartWindow::ToggleOutsideDays() {
  CancelChartTools();
  state().OutsideDaysOn = !state().OutsideDaysOn;
  return Recompose();
}

bool ChartWindow::ToggleMMA() {
  state().MMAOn = !state().MMAOn;
  return Refresh();
}

bool ChartWindow::TogglePFAuto() {
  state().PFAutoBox = !state().PFAutoBox;
  return HasChart() && NextChart();
}

// ---- Oscillators

OscHost ChartWindow::Host(std::string_view code, Composition& chart, const ChartRequest& request,
                          Surface& price, Surface& panel, ChartScript* script) {
  return {.files = services_.files,
          .dialogs = dialogs_,
          .settings = services_.settings,
          .colours = services_.colours,
          .request = request,
          .chart = chart,
          .price = price,
          .panel = panel,
          .script = script,
          .OscCode = std::string(code),
          .SlowStochastic = state().SlowStochastic,
          .AnalPageMode = AnalPageMode};
}

void ChartWindow::ShowPanel(std::string_view code) {
  EraseCross();
  OscHost host = Host(code, Chart, Request, services_.price, services_.panel,
                      script_ ? &*script_ : nullptr);
  // The panel before may have left a scale of its own.
  OwnScale(services_.panel);
  ShowOscillatorPanel(host);
  panelTop_ = host.PanelTop;
  panelBottom_ = host.PanelBottom;
  panelCode_ = host.OscCode;
}

void ChartWindow::PickOscillator(std::string_view code, bool slow) {
  ChartState& s = state();
  if (!HasChart()) return;
  const auto never = [&](bool hindered) { return hindered || s.ChartStyle == 'P'; };
  if (code == "PARA" || code == "PARAV") {
    if (never(false)) return;
    if (code == "PARAV") CancelChartTools();
    s.OscCode = code;
    LayOut(false);
    if (!Compose()) return;
    ShowPanel(code);
    panelPicked_ = true;
    return;
  }
  if (code == "OBV" && never(!s.VolumeOption || !Chart.Bars.VolumeShown)) return;
  CancelChartTools();
  if (code == "RMO" && s.ChartPeriod != "A") {
    dialogs_.Message("RMO only available on Daily Charts", "RMO");
    return;
  }
  if (code == "STO") s.SlowStochastic = slow;
  s.OscCode = code;
  AnalPageMode = false;
  s.SuppressScript = false;
  EmptyDrawnLines();
  if (never(false)) return;
  if (services_.settings.osc.ShowOsc && services_.openOscFrm) {
    services_.openOscFrm();
    dialogs_.Yield();
  } else {
    ShowOscillator();
  }
}

bool ChartWindow::PeriodsValid() const {
  const OscSettings& osc = services_.settings.osc;
  const std::string& code = state().OscCode;
  const auto first = [&](const PeriodPair& pair) {
    const std::int16_t value = pair.For(state().ChartPeriod);
    return value >= 1 && value <= 200;
  };
  const auto second = [&](const PeriodPair& pair) {
    const std::int16_t value = pair.For(state().ChartPeriod);
    return value >= 0 && value <= 200;
  };
  if (code == "STO") return first(osc.StochK) && second(osc.StochD);
  if (code == "FX") return first(osc.FXF) && second(osc.FXX);
  if (code == "R/F") return first(osc.FXF) && second(osc.FXX) && first(osc.RocP);
  if (code == "ROC") return first(osc.RocP);
  // One value for all chart periods.
  if (code == "RMX") return osc.RmxP.daily >= 1 && osc.RmxP.daily <= 200;
  if (code == "RMO") return first(osc.RmoP);
  if (code == "RSI") return first(osc.RsiP);
  if (code == "MACD") return first(osc.Md1) && first(osc.Md2) && first(osc.Md3);
  if (code == "WMS") return first(osc.WmsA);
  if (code == "ERY") return first(osc.ERA);
  if (code == "DM") return first(osc.DMA);
  if (code == "MOM") return first(osc.MMA);
  if (code == "COP") return first(osc.CopD);
  if (code == "JHG") return first(osc.HolyD);
  if (code == "VTY") return first(osc.VtyD);
  return true;
}

bool ChartWindow::CompareFileThere() {
  const std::string& code = state().OscCode;
  if (code != "RMX" && code != "RMO") return true;
  const std::string& file = services_.settings.osc.CompFile;
  try {
    if (!Trim(file).empty() && services_.files.CheckFile(Trim(file))) return true;
  } catch (const RunTimeError&) {
    // A name that can't be one names no file.
  }
  dialogs_.Message(
      code == "RMX" ? " Oscillator values not valid"
                    : file + " is not available. Use your code for the All Ordinaries Index",
      kCompareTitle);
  return false;
}

bool ChartWindow::ShowOscillator() {
  ChartState& s = state();
  if (!PeriodsValid()) {
    dialogs_.Message(s.OscCode + " Oscillator values not valid", "Oscillator Values");
    return false;
  }
  if (!CompareFileThere() || s.ChartStartup) return false;
  if (!HasChart() || s.ChartStyle == 'P') return false;
  const std::string code = s.OscCode;
  LayOut(HasPanel(code));
  dialogs_.Yield();
  // Composed even where a panel stands already, so that the script holds this panel alone.
  if (!Compose()) return false;
  ShowPanel(code);
  panelPicked_ = true;
  return true;
}

// ---- Two charts

void ChartWindow::StartSuperimpose() {
  CancelChartTools();
  ChartState& s = state();
  if (!HasChart()) return;
  s.OscShown = false;
  s.OscCode.clear();
  LayOut(false);
  s.SplitScreen = false;
  s.ChartTask = kTaskSuperimpose;
  Chart.OscPanel = 1;
  services_.price.SetAutoRedraw(true);
  if (!Compose()) return;
  dialogs_.Yield();
  Chart.OscPanel = 2;
  if (services_.openChart2) services_.openChart2();
}

void ChartWindow::StartSplitScreen() {
  CancelChartTools();
  ChartState& s = state();
  if (!HasChart()) return;
  s.ChartTask = kTaskFibonacci;
  if (s.SplitScreen) return;
  s.OscShown = false;
  s.OscCode.clear();
  LayOut(false);
  s.SplitScreen = true;
  Chart.ChartSlot = 1;
  if (Compose() && services_.openChart2) services_.openChart2();
}

void ChartWindow::DropSecondChart() {
  CancelChartTools();
  EndPair();
}

void ChartWindow::EndPair() {
  ChartState& s = state();
  s.SplitScreen = s.SplitShown = s.Superimposed = false;
  Chart.TwoCharts = false;
  Chart.ChartSlot = 0;
}

// ---- Files

std::string ChartWindow::SuggestedName() const {
  return std::string(services_.current.Rec.Code.trimmed()) + ".cht";
}

void ChartWindow::StartSaving() {
  CancelChartTools();
  state().ChartTask = kTaskSaving;
}

void ChartWindow::SaveChartAs(const std::optional<std::string>& path,
                              const std::function<std::string(const std::string&)>& makePicture) {
  Dialogs& dialogs = dialogs_;
  const Files& files = services_.files;
  state().ChartTask = kTaskNone;
  if (!path) {
    Resized();  // as it stands, with a panel that was picked
    return;
  }
  const bool script = EndsWith(*path, ".cht");
  const bool picture = makePicture && (EndsWith(*path, ".png") || EndsWith(*path, ".svg") ||
                                       EndsWith(*path, ".pdf"));
  if (!script && !picture) {
    dialogs.Message("File extension must be .cht", kSaveTitle);
    return;
  }
  bool there = false;
  try {
    there = files.CheckFile(*path);
    if (files.HostPath(*path).empty() || files.IsFolder(*path)) throw RunTimeError(kBadFileName);
  } catch (const RunTimeError&) {
    dialogs.Message("File name invalid", kSaveTitle);
    return;
  }
  if (there && dialogs.Ask(*path + " already exists - Overwrite", kSaveTitle,
                           Buttons::kOkCancel) != Answer::kOk) {
    dialogs.Message(" CHART NOT SAVED ", kSaveTitle);
    return;
  }
  try {
    files.WriteAll(*path, script ? files.ReadAll(ScriptPath()) : makePicture(*path));
  } catch (const RunTimeError&) {
    dialogs.Message(" CHART NOT SAVED ", kSaveTitle);
    return;
  }
  dialogs.Message(" CHART SAVED ", kSaveTitle);
}

void ChartWindow::ShowSaved(const std::string& path) {
  CancelChartTools();
  if (!EndsWith(path, ".cht")) {
    dialogs_.Message("File extension must be .cht", "Saved Charts");
    return;
  }
  EndPair();
  LayOut(false);
  state().OscCode.clear();
  SavedChartFile = path;
  ChartFromFile = ShowSavedChart(services_.files, dialogs_, services_.price,
                                 services_.settings.fonts, services_.colours, path);
  // Whatever came of it, the composed chart is gone: nothing reads its tables.
  if (!ChartFromFile) Chart.ChartDrawn = false;
}

// ---- The date limit

void ChartWindow::ShowDateLimit() {
  const ChartState& s = state();
  if (!s.DateLimitOn || s.MultiOscOn != 0) {
    HideFrame();
    return;
  }
  if (framePending_) {
    framePending_ = false;
    const std::string place = services_.user.GetSetting(kUserSection, kFrameKey);
    const auto parts = Split(place, ',');
    const auto top = ParseFloat(Trim(parts[0]));
    const auto left = parts.size() == 2 ? ParseFloat(Trim(parts[1])) : std::nullopt;
    if (top && left) view_.Frame = FramePlace{*top, *left};
  }
  view_.FrameShown = true;
  view_.Panels[0] = "Date Limit ON";
  view_.PanelShown[0] = true;
  TakeChosenLimit();
}

void ChartWindow::HideFrame() {
  view_.FrameShown = false;
  view_.Panels[0].clear();
  view_.PanelShown[0] = false;
}

void ChartWindow::TakeChosenLimit() {
  ChartState& s = state();
  if (!s.DateLimitMoved) {
    s.DateLimitDate = s.ChosenLimitDate;
    s.DateLimitText = s.ChosenLimitText;
  }
  s.DateLimitMoved = false;
}

bool ChartWindow::StepDateLimit(int index) {
  ChartState& s = state();
  const auto date = ParseUserDate(s.DateLimitText);
  if (!date || index < 0 || index > 5) return false;
  const int sign = index < 3 ? 1 : -1;
  const int unit = index % 3;
  CalendarDate moved;
  if (unit == 2) moved = AddMonths(*date, sign);
  else moved = DateOfDayNumber(DayNumber(*date) + sign * (unit == 0 ? 1 : 7));
  // The calendar ends where a year no longer has four digits.
  if (moved.year < 1000 || moved.year > 9999) return false;
  s.DateLimitText = FormatDisplayDate(moved);
  s.DateLimitDate = DateToFile(s.DateLimitText);
  s.DateLimitMoved = true;
  return Redraw();
}

bool ChartWindow::DropFrame(double x, double y, double width, double height) {
  view_.Frame = FramePlace{y + height / 2, x - width / 2};
  view_.FrameShown = true;
  services_.user.PutSetting(kUserSection, kFrameKey,
                            Str(view_.Frame->top) + "," + Str(view_.Frame->left));
  return Redraw();
}

// ---- Tools

void ChartWindow::StartNewChart() {
  ChartState& s = state();
  const bool superimposing = s.ChartTask == kTaskSuperimpose;
  if (Chart.OscPanel > 3) s.MultiOscOn = 0;
  CancelChartTools();
  s.SuppressScript = false;
  EmptyDrawnLines();
  if (superimposing) services_.price.Cls();
  services_.price.SetAutoRedraw(false);
  s.ChartTask = kTaskNewChart;
}

void ChartWindow::CancelChartTools() {
  EraseCross();
  cross_.reset();
  GridOFF();
  SetTB(kNoButton);
  Chart.OscPanel = 0;
  FibOFF();
  ReadyToCopy(services_.price);
  ReadyToCopy(services_.panel);
  state().ChartTask = kTaskNone;
}

void ChartWindow::ClearStatusBar() {
  std::fill(view_.Panels.begin() + 2, view_.Panels.end(), std::string());
}

void ChartWindow::GridON() {
  view_.PanelShown.fill(true);
  view_.Panels[1] = "GRID";
}

void ChartWindow::GridOFF() { view_.PanelShown.fill(false); }

void ChartWindow::FibOFF() {
  std::fill(view_.Panels.begin() + 1, view_.Panels.end(), std::string());
  std::fill(view_.PanelShown.begin() + 1, view_.PanelShown.end(), false);
}

void ChartWindow::ToggleGrid() {
  if (GridOn()) {
    CancelChartTools();
    return;
  }
  CancelChartTools();
  SetTB(kButtonGrid);
  state().ChartTask = kTaskGrid;
  GridON();
  cross_.emplace(services_.price, &services_.panel, services_.colours[kMovingGrid]);
  cross_->Touched = [this](const Surface& surface, double x1, double y1, double x2, double y2) {
    if (CrossTouched) CrossTouched(surface, x1, y1, x2, y2);
  };
}

void ChartWindow::MouseMove(double x, double y) {
  if (cross_) MoveTo(x, y, ColumnOf(Chart, x));
}

void ChartWindow::MoveTo(double x, double y, std::int32_t column) {
  const ChartState& s = state();
  crossColumn_ = column;
  // What the pointer reads are the tables of a composition, not what a saved chart shows.
  if (ChartFromFile || !Chart.ChartDrawn) {
    ClearStatusBar();
    return;
  }
  const CrossLimits limits =
      LimitsOf(Chart, Request.ChartStyle, s.SplitShown, panelTop_, panelBottom_);
  if (!cross_->Move(x, y, limits)) {
    ClearStatusBar();
    return;
  }
  const std::int16_t type = Request.Name.RecType;
  if (Request.ChartStyle == 'P') {
    view_.Panels[3] = Format(PFPixelToPrice(Chart, Boxes, y), ReadoutFormat(type));
    return;
  }
  if (s.Superimposed || s.SplitShown) return;
  if (const auto texts = BarReadout(Chart, type, column))
    std::copy(texts->begin(), texts->end(), view_.Panels.begin() + 2);
}

void ChartWindow::MouseClick() {
  if (GridOn()) CancelChartTools();
}

void ChartWindow::MoveCross(int bars) {
  const bool begins = !cross_ || !cross_->Drawn();
  if (!cross_) ToggleGrid();
  CrossToColumn(begins ? Chart.Bars.BarCount : crossColumn_ + bars);
}

void ChartWindow::CrossToEnd(bool last) {
  if (!cross_) ToggleGrid();
  CrossToColumn(last ? Chart.Bars.BarCount : 0);
}

void ChartWindow::CrossToColumn(std::int32_t column) {
  column = std::clamp<std::int32_t>(column, 0, std::max<std::int32_t>(Chart.Bars.BarCount, 0));
  const auto place = size_t(column);
  double y = Chart.ChartTop;
  if (place < Chart.CloseY.size()) y = Chart.CloseY[place];
  y = std::clamp<double>(y, Chart.ChartTop, std::max(Chart.ChartTop, Chart.ChartBottom));
  MoveTo(XOfColumn(Chart, column), y, column);
}

void ChartWindow::WithoutCross(const std::function<void()>& work) {
  const bool drawn = cross_ && cross_->Drawn();
  const double x = drawn ? cross_->GridX() : 0, y = drawn ? cross_->GridY() : 0;
  if (drawn) cross_->Erase();
  work();
  if (drawn)
    cross_->Move(x, y,
                 LimitsOf(Chart, Request.ChartStyle, state().SplitShown, panelTop_, panelBottom_));
}

void ChartWindow::EraseCross() {
  if (cross_) cross_->Erase();
}

void ChartWindow::ForgetCross() {
  if (cross_) cross_->Forget();
}

}  // namespace kora
