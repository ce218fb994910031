#include "chartwindow/chart_window.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <utility>
#include <vector>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "base/version.h"
#include "chart/script_player.h"
#include "chartwindow/chart_selection.h"
#include "chartwindow/tools/cross_hair.h"
#include "chartwindow/tools/fibonacci.h"
#include "chartwindow/tools/move_trendline.h"
#include "chartwindow/tools/text_note.h"
#include "chartwindow/tools/trendline.h"
#include "chartwindow/tools/zoom_chart.h"
#include "indicators/osc_settings.h"
#include "indicators/oscillators.h"
#include "indicators/price_overlays.h"
#include "indicators/swing_settings.h"
#include "lists/chart_list.h"
#include "store/industry_classes.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Charts";
constexpr int kMostRows = 32767;
constexpr std::string_view kSaveTitle = "Save Chart";
constexpr std::string_view kCompareTitle = "RMX Compare ";
constexpr std::string_view kFrameKey = "BDFrame";

void ReadyToCopy(Surface& surface) {
  surface.SetDrawMode(DrawMode::kCopy);
  surface.SetDrawStyle(DrawStyle::kSolid);
}

const char* NameOf(Style style) {
  switch (style) {
    case Style::kCandlestick: return "Candlestick";
    case Style::kLine: return "Line";
    case Style::kPointFigure: return "Point and Figure";
    default: return "Bar";
  }
}

const char* NameOf(Period period) {
  return period == Period::kWeekly ? "Weekly" : period == Period::kMonthly ? "Monthly" : "Daily";
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
    : services_(services),
      dialogs_(services.dialogs),
      toolView_{.chart = Chart,
                .request = Request,
                .arrangement = arrangement_,
                .boxes = Chart.Boxes,
                .panelFrame = panelFrame_,
                .chartFromFile = ChartFromFile,
                .price = services_.price,
                .panel = services_.panel,
                .colours = services_.colours,
                .settings = services_.settings,
                .dialogs = dialogs_,
                .files = services_.files,
                .panels = view_.Panels,
                .title = view_.Title,
                .SwingOn = services_.state.SwingOn,
                .rows = rows_,
                .Touched =
                    [this](const Surface& surface, double x1, double y1, double x2, double y2) {
                      if (Touched) Touched(surface, x1, y1, x2, y2);
                    },
                .Keep = [this](const DrawnMark& mark) { Keep(mark); }} {
  RefreshTitle();
}

void ChartWindow::Load() {
  ChartState& s = state();
  Loading = true;
  AnalPageMode = false;
  s.ChartIndex = 0;
  s.OutsideDaysOn = false;
  s.KeepOsc = SettingBool(services_.ini.GetSetting("Charts", "KeepOsc"));
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
  if (std::exchange(state().SwingOn, false)) state().BarSpacing = SavedSpacing_;
  arrangement_ = Arrangement::kOne;
}

void ChartWindow::RefreshTitle() {
  view_.Title = std::string(kProgramTitle) + "   -  CHARTS  " +
                std::string(Trim(services_.settings.paths.CurrentDataPath));
  if (ChartFromFile)
    view_.Title += "  -  " + SuggestedName();
  else if (Chart.ChartDrawn)
    view_.Title += "  -  " + FromAnsi(Request.Name.Code.trimmed()) + "  " +
                   NameOf(Request.ChartStyle) + "  " + NameOf(Request.ChartPeriod);
}

std::string ChartWindow::ScriptOnShow() const {
  if (ChartFromFile) return SavedChartFile;
  return Chart.ChartDrawn ? scriptPath_ : std::string();
}

void ChartWindow::StartPrinting(bool print) {
  CancelChartTools();
  state().SuppressScript = true;
  if (print) state().ChartTask = kTaskPrinting;
}

// ---- Which chart

bool ChartWindow::ShowAt(int index) {
  if (Loading) return false;
  if (!GoTo(index, false)) return false;
  ShowDateLimit();
  return DrawChart();
}

bool ChartWindow::NextChart() { return ShowAt(state().ChartIndex + 1); }

bool ChartWindow::StepChart() {
  if (Loading) return false;
  ChartState& s = state();
  if (s.ScrollInUse) {
    s.DateLimitOn = false;
    HideFrame();
  }
  if (!GoTo(s.ChartIndex + (s.ChartDirection == 1 ? 1 : -1),
            s.ChartListNo == kFullList && s.ICFilterOn))
    return false;  // what stands on the window stays
  if (!s.OscShown) LayOut(false);
  if (s.DateLimitOn) TakeChosenLimit();
  return DrawChart();
}

bool ChartWindow::Redraw() { return HasChart() && ShowAt(state().ChartIndex); }

bool ChartWindow::Refresh() {
  CancelChartTools();
  return Redraw();
}

bool ChartWindow::Resized() {
  ForgetTool();
  // Under the multi-oscillator view the script is the view's; the chart is drawn on return.
  if (Loading || AnalPageMode || (!HasChart() && !ChartFromFile)) return false;
  return dialogs_.Repeat([this] { return DrawAll(); });
}

bool ChartWindow::DrawAll() {
  if (ChartFromFile) {
    LayOut(false);
    return ShowSavedChart(services_.files, dialogs_, services_.price, services_.settings.fonts,
                          services_.colours, SavedChartFile);
  }
  if (IsPair(arrangement_)) return RedrawPair();
  const std::string picked = panelPicked_ ? panelCode_ : "";
  boxKept_ = true;
  const bool drawn = Redraw();
  boxKept_ = false;
  if (!drawn) return false;
  if (picked.empty()) return true;
  state().OscCode = picked;
  return ShowOscillator();
}

// Both charts of a pair once more, or the first where the second is still to come.
bool ChartWindow::RedrawPair() {
  const ChartRequest first = first_, second = Request;
  const bool split = IsSplit(arrangement_), both = !AwaitsSecond(arrangement_);
  LayOut(false);
  if (!Compose(first, split ? ChartPlace::kUpper : ChartPlace::kUnder)) return false;
  return !both || Compose(second, split ? ChartPlace::kLower : ChartPlace::kOver);
}

// Opens the files, finds the record at that place and reads it.
bool ChartWindow::GoTo(int index, bool filtered) {
  dialogs_.Forget();
  AnalPageMode = false;
  state().SuppressScript = false;
  if (!boxKept_) state().PFBoxSize = 0;
  EmptyDrawnLines();
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  std::string path = NameFilePath(dataPath);
  try {
    if (FindRecord(index, filtered)) return true;
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

namespace {

// How many records the security on show has moved since another program wrote the name file in
// another order; 0 where it is gone.
int MovedBy(const NameFile& names, const CurrentName& current) {
  const std::int16_t shown = current.NameRecNo;
  if (shown < 1) return 0;
  if (shown <= names.count() && names.Read(shown).Code == current.Rec.Code) return 0;
  NameRec found;
  const std::int16_t number = FindCode(names, current.Rec.Code.raw(), found);
  return number == 0 ? 0 : number - shown;
}

}  // namespace

bool ChartWindow::FindRecord(int index, bool filtered) {
  ChartState& s = state();
  CurrentName& current = services_.current;
  const std::string& dataPath = services_.settings.paths.CurrentDataPath;
  const NameFile names(services_.files, NameFilePath(dataPath));
  // The record on show, or one beside it: where they stand now.
  if (s.ChartListNo == kFullList && std::abs(index - current.NameRecNo) <= 1)
    index += MovedBy(names, current);
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
  if (index > count)
    s.ChartIndex = 1;
  else if (index < 1)
    s.ChartIndex = count;
  else
    s.ChartIndex = CInt(index);
  if (filtered) FindNextChtIC(ReadNames(services_.files, dataPath));

  const std::int32_t record =
      list.empty() ? s.ChartIndex : list[size_t(s.ChartIndex) - 1].ListRecNo;
  current.Rec = names.Read(record);
  current.NameRecNo = CInt(record);
  current.PriceFileName = std::string(current.Rec.Code.trimmed()) + ".WDT";
  // Such data has no bars. The style stays for the charts that follow.
  if (current.Rec.RecType >= kCloseVolume && current.Rec.RecType <= kAdvanceDecline &&
      NeedsRange(s.ChartStyle))
    s.ChartStyle = Style::kLine;
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
  if (arrangement_ == Arrangement::kUpper) return;
  try {
    const std::string path = services_.settings.paths.CurrentDataPath + "ChtLns.Tmp";
    if (!services_.files.CheckFile(path)) return;
    if (services_.files.Open(path, OpenMode::kRead)->Size() > 0) services_.files.WriteAll(path, "");
  } catch (const RunTimeError&) {
    // A data folder that can't be written still shows charts.
  }
}

bool ChartWindow::DrawChart() {
  if (Loading) return false;
  ChartState& s = state();
  panelPicked_ = false;
  // Two charts on one picture have no room for a panel.
  // One that was kept has no place on a point-and-figure chart, and comes back behind it.
  const bool hidden = panelKept_ && s.ChartStyle == Style::kPointFigure;
  if (s.OscShown && !AwaitsSecond(arrangement_) && !hidden) {
    const Oscillator* oscillator = FindOscillator(s.OscCode);
    if (oscillator && oscillator->dailyOnly && s.ChartPeriod != Period::kDaily) {
      TellDailyOnly(s.OscCode);
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
  if (tool_) tool_->Recomposed();
  if (!twoPanes) {
    if (services_.panel.Visible()) {
      services_.panel.SetBackColour(services_.colours[kBackground]);
      services_.panel.Cls();
    }
    panelCode_.clear();
  }
  if (services_.layOut)
    services_.layOut(twoPanes);
  else
    services_.panel.SetVisible(twoPanes);
  ShowLegend();
}

// Never over a panel's chart, nor over one that was saved.
void ChartWindow::ShowLegend() {
  view_.LegendShown = state().ReversalsOn && state().ChartStyle == Style::kBar &&
                      !services_.panel.Visible() && !ChartFromFile;
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
          .VolumeUnitText = services_.VolumeUnitText,
          .AskBoxValue = services_.askBoxValue};
}

// Lines and texts of the security, read as the chart is composed and placed on it.
std::function<void(const ChartCanvas&)> ChartWindow::MarksOverlay() {
  return [this](const ChartCanvas& canvas) {
    savedMarks_ = ReadSavedMarks(services_.files, services_.settings.paths.ChartMiscPath,
                                 canvas.request.Name.Code.trimmed());
    DrawSavedMarks(canvas, savedMarks_, rows_);
  };
}

bool ChartWindow::Compose() {
  return Compose(MakeRequest(state(), services_.settings, services_.current.Rec),
                 PlaceOfNext(arrangement_));
}

bool ChartWindow::Compose(const ChartRequest& request, ChartPlace place) {
  // Two charts of a pair are composed one after the other over a picture that stays.
  if (tool_) tool_->Recomposed();
  DropMarker();
  point_.reset();
  if (!IsSecond(place)) {
    marks_.clear();
    rows_.clear();
    savedMarks_ = {};
  }
  ChartFromFile = false;
  ShowLegend();
  Request = request;
  Request.Place = place;
  if (place == ChartPlace::kUpper || place == ChartPlace::kUnder) first_ = request;
  // The script belongs to this chart, wherever the data folder goes meanwhile.
  scriptPath_ = services_.settings.paths.CurrentDataPath + "TCht.Tmp";
  script_.emplace(services_.files, scriptPath_);
  ChartServices services = Services(services_.price, &services_.panel, &*script_);
  services.overlays.push_back(MarksOverlay());
  const bool drawn = ComposeChart(services, Request, Chart);
  // Drawn again, by a print or another size, it is not asked for again.
  if (drawn && Request.ChartStyle == Style::kPointFigure && !Request.PFAutoBox) {
    Request.PFBoxSize = state().PFBoxSize = Chart.Boxes.PFBoxSize;
    if (place == ChartPlace::kUpper || place == ChartPlace::kUnder) first_ = Request;
  }
  arrangement_ = ArrangementAfter(place, drawn);
  RefreshTitle();
  if (!drawn && services_.panel.Visible()) services_.panel.Cls();
  return drawn;
}

bool ChartWindow::Recompose() {
  if (Loading || !HasChart()) return false;
  if (AwaitsSecond(arrangement_)) {
    // The second chart is still to come: the first one alone is drawn anew.
    first_.GridLines = services_.settings.charts.GridLines;
    return RedrawPair();
  }
  EmptyDrawnLines();
  if (!Compose()) return false;
  if (!panelCode_.empty()) ShowPanel(panelCode_);
  return true;
}

bool ChartWindow::DrawAgain(Surface& price, Surface* panel) {
  if (ScriptOnShow().empty()) return false;
  try {
    if (ChartFromFile || IsPair(arrangement_)) {
      price.SetBackColour(services_.colours[kBackground]);
      price.Cls();
      return PlayChartScript(services_.files.ReadAll(ScriptOnShow()), price,
                             services_.settings.fonts, services_.colours);
    }
  } catch (const RunTimeError&) {
    return false;
  }
  Composition chart = Chart;
  ChartRequest request = Request;
  request.SuppressScript = true;
  // The marks as they stand on the window, whatever became of their files since.
  ChartServices services = Services(price, panel, nullptr);
  services.overlays.push_back([this](const ChartCanvas& canvas) {
    std::vector<TrendlineRow> rows;
    DrawSavedMarks(canvas, savedMarks_, rows);
  });
  if (!ComposeChart(services, request, chart)) return false;
  const bool overlay = !panelCode_.empty() && !HasPanel(panelCode_);
  if (!panelCode_.empty() && (panel || overlay)) {
    OscHost host =
        Host(panelCode_, chart, request, price, panel ? *panel : services_.panel, nullptr);
    ShowOscillatorPanel(host);
  }
  ReplayMarks(price, panel);
  return true;
}

// ---- How it is drawn

bool ChartWindow::SetStyle(Style style) {
  CancelChartTools();
  state().ChartStyle = style;
  return Redraw();
}

bool ChartWindow::SetPeriod(Period period) {
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

bool ChartWindow::ToggleLegible() {
  bool& on = services_.settings.charts.Legible;
  on = !on;
  services_.ini.PutSetting("Charts", "Legible", on ? "True" : "False");
  if (!IsPair(arrangement_)) return Recompose();
  first_.Legible = Request.Legible = on;
  return RedrawPair();
}

bool ChartWindow::ToggleReversals() {
  CancelChartTools();
  ChartState& s = state();
  s.ReversalsOn = !s.ReversalsOn;
  ShowLegend();
  return s.ChartStyle == Style::kBar && Recompose();
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

bool ChartWindow::ToggleSwing() {
  CancelChartTools();
  ChartState& s = state();
  s.SwingOn = !s.SwingOn;
  if (s.SwingOn) {
    s.ChartStyle = Style::kBar;
    SavedSpacing_ = s.BarSpacing;
    s.BarSpacing = std::max<std::int16_t>(s.BarSpacing, 3);
    s.Swing = SwingToShow(s.Swing);
  } else {
    s.BarSpacing = SavedSpacing_;
  }
  return Redraw();
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
          .SlowStochastic = state().SlowStochastic};
}

void ChartWindow::ShowPanel(std::string_view code) {
  if (tool_) tool_->Recomposed();
  OscHost host =
      Host(code, Chart, Request, services_.price, services_.panel, script_ ? &*script_ : nullptr);
  // The panel before may have left a scale of its own.
  OwnScale(services_.panel);
  ShowOscillatorPanel(host);
  panelFrame_ = {.Left = Chart.ChartLeft,
                 .Right = Chart.ChartRight,
                 .Top = host.PanelTop,
                 .Bottom = host.PanelBottom};
  panelCode_ = host.OscCode;
  panelValues_ = host.LastValues;
}

void ChartWindow::PickOscillator(std::string_view code, bool slow) {
  ChartState& s = state();
  if (!HasChart()) return;
  const auto never = [&](bool hindered) { return hindered || s.ChartStyle == Style::kPointFigure; };
  const Oscillator* oscillator = FindOscillator(code);
  if (!oscillator) return;
  if (!oscillator->panel) {
    if (never(false)) return;
    if (code == "PARAV") CancelChartTools();
    s.OscCode = code;
    LayOut(false);
    if (!Compose()) return;
    ShowPanel(code);
    panelPicked_ = true;
    KeepPicked();
    return;
  }
  if (oscillator->needsVolume && never(!s.VolumeOption || !Chart.Bars.VolumeShown)) return;
  CancelChartTools();
  if (oscillator->dailyOnly && s.ChartPeriod != Period::kDaily) {
    TellDailyOnly(code);
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

std::string ChartWindow::ChartName() const {
  if (ChartFromFile) return "Saved chart " + SavedChartFile;
  const ChartBars& bars = Chart.Bars;
  if (!Chart.ChartDrawn || bars.BarCount < 0 || size_t(bars.BarCount) >= bars.bars.size())
    return "Chart";
  const ChartBar& last = bars[size_t(bars.BarCount)];
  std::string name = "Chart " + FromAnsi(Request.Name.Code.trimmed());
  switch (Request.ChartStyle) {
    case Style::kBar: name += ", bars"; break;
    case Style::kCandlestick: name += ", candlesticks"; break;
    case Style::kLine: name += ", line"; break;
    case Style::kPointFigure: name += ", point and figure"; break;
  }
  switch (Request.ChartPeriod) {
    case Period::kDaily: name += ", daily"; break;
    case Period::kWeekly: name += ", weekly"; break;
    case Period::kMonthly: name += ", monthly"; break;
  }
  if (!last.date().empty()) name += ", " + DateToDisplay(std::string(last.date()));
  return name + ", close " + Str(last.Close);
}

std::string ChartWindow::PanelName() const {
  const Oscillator* oscillator = FindOscillator(panelCode_);
  if (!oscillator) return "Oscillator";
  std::string name =
      "Oscillator " + std::string(oscillator->choice ? oscillator->choice : panelCode_);
  for (size_t i = 0; i < panelValues_.size(); ++i) {
    // Of a penny share values are small.
    const double value = panelValues_[i], places = std::abs(value) < 1 ? 10000 : 100;
    name += (i > 0                     ? " and "
             : panelValues_.size() > 1 ? ", last values "
                                       : ", last value ") +
            Str(RoundHalfEven(value * places) / places);
  }
  return name;
}

// What was picked is asked for as chart selection does, which then shows it.
void ChartWindow::KeepPicked() {
  ChartState& s = state();
  const Oscillator* oscillator = FindOscillator(panelCode_);
  if (!s.KeepOsc || !oscillator || !oscillator->choice) return;
  s.OscShown = panelKept_ = true;
  s.OscSelected = panelCode_;
}

void ChartWindow::ToggleKeepOscillator() {
  ChartState& s = state();
  const bool keep = s.KeepOsc = !s.KeepOsc;
  services_.ini.PutSetting("Charts", "KeepOsc", keep ? "True" : "False");
  if (keep && panelPicked_) KeepPicked();
  // What was kept goes with the next chart.
  if (!keep && panelKept_ && s.OscSelected == panelCode_) s.OscShown = false;
  if (!keep) panelKept_ = false;
}

void ChartWindow::TellDailyOnly(std::string_view code) {
  dialogs_.Message(std::string(code) + " only available on Daily Charts", code);
}

bool ChartWindow::CompareFileThere() {
  const std::string& code = state().OscCode;
  const Oscillator* oscillator = FindOscillator(code);
  if (!oscillator || !oscillator->compares) return true;
  const std::string& file = services_.settings.osc.CompFile;
  try {
    if (!Trim(file).empty() && services_.files.CheckFile(Trim(file))) return true;
  } catch (const RunTimeError&) {
    // A name that can't be one names no file.
  }
  dialogs_.Message(code == "RMX"
                       ? " Oscillator values not valid"
                       : file + " is not available. Use your code for the All Ordinaries Index",
                   kCompareTitle);
  return false;
}

bool ChartWindow::ShowOscillator() {
  ChartState& s = state();
  const Oscillator* oscillator = FindOscillator(s.OscCode);
  if (oscillator && !PeriodsInRange(*oscillator, services_.settings.osc, s.ChartPeriod)) {
    dialogs_.Message(s.OscCode + " Oscillator values not valid", "Oscillator Values");
    return false;
  }
  if (!CompareFileThere() || s.ChartStartup) return false;
  if (!HasChart() || s.ChartStyle == Style::kPointFigure) return false;
  const std::string code = s.OscCode;
  LayOut(HasPanel(code));
  dialogs_.Yield();
  // Composed even where a panel stands already, so that the script holds this panel alone.
  if (!Compose()) return false;
  ShowPanel(code);
  panelPicked_ = true;
  KeepPicked();
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
  s.ChartTask = kTaskSuperimpose;
  services_.price.SetAutoRedraw(true);
  if (!Compose(MakeRequest(s, services_.settings, services_.current.Rec), ChartPlace::kUnder))
    return;
  dialogs_.Yield();
  if (services_.openChart2) services_.openChart2();
}

void ChartWindow::StartSplitScreen() {
  CancelChartTools();
  ChartState& s = state();
  if (!HasChart()) return;
  s.ChartTask = kTaskFibonacciOrSplit;
  if (arrangement_ == Arrangement::kUpper) return;
  s.OscShown = false;
  s.OscCode.clear();
  LayOut(false);
  if (Compose(MakeRequest(s, services_.settings, services_.current.Rec), ChartPlace::kUpper) &&
      services_.openChart2)
    services_.openChart2();
}

void ChartWindow::DropSecondChart() {
  CancelChartTools();
  arrangement_ = Arrangement::kOne;
}

// ---- Files

std::string ChartWindow::SuggestedName() const {
  if (!ChartFromFile) return std::string(Request.Name.Code.trimmed()) + ".cht";
  return SavedChartFile.substr(SavedChartFile.find_last_of('\\') + 1);
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
  const bool script = EndsNoCase(*path, ".cht");
  const bool picture = makePicture && (EndsNoCase(*path, ".png") || EndsNoCase(*path, ".svg") ||
                                       EndsNoCase(*path, ".pdf"));
  if (!script && !picture) {
    dialogs.Message("File extension must be .cht", kSaveTitle);
    return;
  }
  if (ScriptOnShow().empty()) {
    dialogs.Message(" CHART NOT SAVED ", kSaveTitle);
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
  if (there && dialogs.Ask(*path + " already exists - Overwrite", kSaveTitle, Buttons::kOkCancel) !=
                   Answer::kOk) {
    dialogs.Message(" CHART NOT SAVED ", kSaveTitle);
    return;
  }
  try {
    files.WriteAll(*path, script ? files.ReadAll(ScriptOnShow()) : makePicture(*path));
  } catch (const RunTimeError&) {
    dialogs.Message(" CHART NOT SAVED ", kSaveTitle);
    return;
  }
  dialogs.Message(" CHART SAVED ", kSaveTitle);
}

void ChartWindow::ShowSaved(const std::string& path) {
  CancelChartTools();
  if (!EndsNoCase(path, ".cht")) {
    dialogs_.Message("File extension must be .cht", "Saved Charts");
    return;
  }
  arrangement_ = Arrangement::kOne;
  LayOut(false);
  state().OscCode.clear();
  SavedChartFile = path;
  ChartFromFile = ShowSavedChart(services_.files, dialogs_, services_.price,
                                 services_.settings.fonts, services_.colours, path);
  // Whatever came of it, the composed chart is gone: nothing reads its tables.
  if (!ChartFromFile) Chart.ChartDrawn = false;
  ShowLegend();
  RefreshTitle();
}

// ---- The date limit

void ChartWindow::ShowDateLimit() {
  const ChartState& s = state();
  if (!s.DateLimitOn || arrangement_ == Arrangement::kMulti) {
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
  if (unit == 2)
    moved = AddMonths(*date, sign);
  else
    moved = DateOfDayNumber(DayNumber(*date) + sign * (unit == 0 ? 1 : 7));
  // The calendar ends where a year no longer has four digits.
  if (moved.year < 1000 || moved.year > 9999) return false;
  s.DateLimitText = FormatDisplayDate(moved);
  s.DateLimitDate = DateToFile(s.DateLimitText);
  s.DateLimitMoved = true;
  return Redraw();
}

bool ChartWindow::MoveTime(TimeStep step, int by) {
  ChartState& s = state();
  if (by == 0 || Loading || !HasChart() || ChartFromFile || !Chart.ChartDrawn ||
      IsPair(arrangement_) || Request.ChartStyle == Style::kPointFigure)
    return false;
  const PriceFile file(services_.files,
                       services_.settings.paths.CurrentDataPath + services_.current.PriceFileName);
  std::vector<std::int32_t> dates;
  for (const PriceRec& rec : file.ReadAll()) dates.push_back(CLng(Val(rec.RecDate.raw())));
  const std::int32_t last = Chart.Bars.LastDataRec;
  const std::int32_t end =
      MovedEnd(dates, Request.ChartPeriod, last, RecordsWanted(Request, Chart), step, by);
  if (end < 1 || end == last) return false;
  const auto date = ParseFileDate(Format(double(dates[size_t(end) - 1]), "00000000"));
  if (!date) return false;
  const bool chosen = s.DateLimitOn && !s.ScrollInUse;
  if (!chosen && end == std::int32_t(dates.size())) {
    s.DateLimitOn = s.ScrollInUse = false;
    return DrawAll();
  }
  s.DateLimitOn = true;
  s.DateLimitDate = FormatFileDate(*date);
  s.DateLimitText = FormatDisplayDate(*date);
  s.DateLimitMoved = true;
  if (!chosen) {
    s.ScrollInUse = true;
    s.ChosenLimitDate = s.DateLimitDate;
    s.ChosenLimitText = FormatUserDate(*date);
  }
  return DrawAll();
}

bool ChartWindow::ChangeSpacing(int by) {
  ChartState& s = state();
  if (Loading || !HasChart() || ChartFromFile || IsPair(arrangement_) ||
      s.ChartStyle == Style::kPointFigure)
    return false;
  const int needed = s.ChartStyle == Style::kCandlestick || s.SwingOn ? 3 : 1;
  const int now = s.BarSpacing > 0 ? s.BarSpacing : 2;
  // What is closer already is not moved apart by narrowing.
  const int least = by > 0 ? needed : std::min(now, needed);
  const auto spacing = std::int16_t(std::clamp(now + by, least, 20));
  if (spacing == s.BarSpacing) return false;
  s.BarSpacing = services_.settings.charts.Spacing = spacing;
  return DrawAll();
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
  if (arrangement_ == Arrangement::kMulti) arrangement_ = Arrangement::kOne;
  CancelChartTools();
  s.SuppressScript = false;
  EmptyDrawnLines();
  pictureGone_ = superimposing;
  if (superimposing) services_.price.Cls();
  services_.price.SetAutoRedraw(false);
  s.ChartTask = kTaskNewChart;
}

void ChartWindow::BackToChart() {
  state().ChartTask = kTaskNone;
  if (std::exchange(pictureGone_, false)) Resized();
}

void ChartWindow::CancelChartTools() {
  LeaveTool();
  GridOFF();
  SetTB(kNoButton);
  // The first of two in one frame is left to stand alone.
  if (arrangement_ == Arrangement::kUnder) arrangement_ = Arrangement::kOne;
  FibOFF();
  view_.AutoScroll = 0;
  view_.Caption.clear();
  ReadyToCopy(services_.price);
  ReadyToCopy(services_.panel);
  state().ChartTask = kTaskNone;
  RefreshTitle();
}

void ChartWindow::GridON() {
  view_.PanelShown.fill(true);
  view_.Panels[1] = "GRID";
}

void ChartWindow::GridOFF() { view_.PanelShown.fill(false); }

void ChartWindow::FibOFF() {
  std::fill(view_.Panels.begin() + 1, view_.Panels.end(), std::string());
  std::fill(view_.PanelShown.begin() + 1, view_.PanelShown.end(), false);
  view_.PanelsAlike = false;
}

void ChartWindow::ToggleGrid() {
  const bool on = GridOn();
  CancelChartTools();
  if (on) return;
  StartTool(std::make_unique<CrossHairTool>(toolView_), kButtonGrid, kTaskGrid);
  GridON();
}

void ChartWindow::ToggleTrendline() {
  const bool on = IsOn(kTaskTrendline);
  CancelChartTools();
  if (on || state().ChartStyle == Style::kPointFigure || !toolView_.Readable()) return;
  StartTool(std::make_unique<TrendlineTool>(toolView_), kButtonTrend, kTaskTrendline);
}

void ChartWindow::ToggleFibonacci() {
  const bool on = IsOn(kTaskFibonacciOrSplit);
  // The first of two charts in one frame waits for its second: no tool starts then.
  const bool waits = arrangement_ == Arrangement::kUnder;
  CancelChartTools();
  if (on || waits || !toolView_.Readable()) return;
  StartTool(std::make_unique<FibonacciTool>(toolView_), kButtonFib, kTaskFibonacciOrSplit);
  view_.PanelShown.fill(true);
  view_.PanelsAlike = true;
  view_.Panels[1] = "FIBONACCI";
}

void ChartWindow::StartText() {
  CancelChartTools();
  if (state().ChartStyle == Style::kPointFigure || !toolView_.Readable()) return;
  StartTool(std::make_unique<TextNoteTool>(toolView_), kNoButton, kTaskNone);
}

void ChartWindow::ToggleZoom() {
  const bool on = IsOn(kTaskZoom);
  CancelChartTools();
  const Style style = Request.ChartStyle;
  if (on || !NeedsRange(style) || !toolView_.Readable()) return;
  const auto zoom = [this](const ZoomBox& box) {
    if (services_.openZoom) services_.openZoom(box);
    Redraw();
  };
  StartTool(std::make_unique<ZoomBoxTool>(toolView_, zoom), kButtonZoom, kTaskZoom);
}

void ChartWindow::TellHowToErase() {
  if (view_.AutoScroll > 0) CancelChartTools();
  if (state().ChartStyle == Style::kPointFigure) return;
  dialogs_.Message(
      "To delete a trendline, click that trendline with your RIGHT mouse button the select DELETE",
      kTitle);
}

void ChartWindow::RemoveAllTrendlines() {
  constexpr std::string_view kRemoveTitle = "Remove all Trendlines";
  if (state().ChartStyle == Style::kPointFigure || !toolView_.Readable()) return;
  const std::string code(Request.Name.Code.trimmed());
  if (dialogs_.Ask("Remove all trendlines for " + code, kRemoveTitle, Buttons::kYesNo) !=
          Answer::kYes ||
      dialogs_.Ask("WARNING - All trendlines for " + code + " will be removed. Are you sure?",
                   kRemoveTitle, Buttons::kYesNo) != Answer::kYes)
    return;
  try {
    RemoveTrendlines(services_.files, TrendlinePath(services_.settings.paths.ChartMiscPath, code));
  } catch (const RunTimeError&) {
    // The chart shows whether they are gone.
  }
  Refresh();
}

// Each hit in turn: the line shows which is meant while its menu is open.
void ChartWindow::HitTrendlines(const ToolPoint& at) {
  if (!toolView_.Readable() || at.pane != Pane::kPrice || !services_.popUpTrend) return;
  Surface& price = services_.price;
  const auto draw = [&](const TrendlineRow& row, Colour colour, int times = 1, int width = 1) {
    if (tool_) tool_->Hide();
    price.SetDrawWidth(width);
    for (int i = 0; i < times; ++i) price.Line(row.x1, row.y1, row.x2, row.y2, colour);
    price.SetDrawWidth(1);
    if (tool_) tool_->Show();
    toolView_.Touched(price, row.x1, row.y1, row.x2, row.y2);
  };
  // The edges of a sloped line are blended with what is there, and traces of another colour below it
  // would stay: drawn this often it covers them, and in three units it takes them all away.
  constexpr int kCovering = 5, kErasing = 3;
  const auto sloped = [](const TrendlineRow& row) { return row.x1 != row.x2 && row.y1 != row.y2; };
  const ChartColours& colours = services_.colours;
  std::optional<TrendlineRow> moved;
  for (size_t i = 0; i < rows_.size(); ++i) {
    const TrendlineRow row = rows_[i];
    if (!HitsLine(row, at.x, at.y)) continue;
    draw(row, colours[kMovingGrid]);
    const TrendChoice choice = services_.popUpTrend();
    if (choice == TrendChoice::kDelete) {
      draw(row, colours[colours[kTrendlines] == colours[14] ? 15 : 14]);
      draw(row, colours[kBackground], 1, sloped(row) ? kErasing : 1);
      try {
        DeleteTrendline(
            services_.files,
            TrendlinePath(services_.settings.paths.ChartMiscPath, Request.Name.Code.trimmed()),
            std::int32_t(i) + 1);
      } catch (const RunTimeError& e) {
        draw(row, colours[kTrendlines], sloped(row) ? kCovering : 1);
        dialogs_.Message(e.what(), "Trendline");
        break;
      }
      continue;
    }
    draw(row, colours[kTrendlines], sloped(row) ? kCovering : 1);
    if (choice == TrendChoice::kMove) moved = row;
  }
  if (!moved) return;
  CancelChartTools();
  StartTool(std::make_unique<MoveTrendlineTool>(toolView_, *moved, at), kNoButton, kTaskNone);
  point_ = at;
}

// ---- What the mouse has drawn

void ChartWindow::Keep(const DrawnMark& mark) {
  marks_.push_back(mark);
  const auto append = [&](const std::string& path) {
    ChartScript script(services_.files, path);
    script.Open(true);
    script.buffer() += LineOf(mark);
    script.Close();
  };
  try {
    append(scriptPath_);
    // Texts come back from their own file.
    if (mark.letter != 'T')
      append(scriptPath_.substr(0, scriptPath_.find_last_of('\\') + 1) + "ChtLns.Tmp");
  } catch (const RunTimeError& e) {
    dialogs_.Message(e.what(), kTitle);
  }
}

void ChartWindow::ReplayMarks(Surface& price, Surface* panel) const {
  ChartPen upper(price, nullptr);
  const double below = services_.price.ScaleHeight();
  for (const DrawnMark& mark : marks_) {
    if (mark.letter == 'T') {
      const FontSettings& fonts = services_.settings.fonts;
      upper.Text('T', {fonts.Font1Name, ChartCanvas::kSmallText, fonts.Font1Bold, false},
                 {ChartCanvas::kSmallText, mark.x1, mark.y1, mark.text, mark.colour});
    } else if (mark.letter != 'M') {
      upper.Line(mark.letter, {mark.x1, mark.y1, mark.x2, mark.y2, mark.colour});
    } else if (panel) {
      ChartPen(*panel, nullptr)
          .Line('M', {mark.x1, mark.y1 - below, mark.x2, mark.y2 - below, mark.colour});
    }
  }
}

// ---- The walk through all charts

void ChartWindow::ToggleAutoScroll() {
  constexpr std::string_view kInterval = "Display Interval";
  ChartState& s = state();
  const bool on = s.ChartTask == kTaskAutoScroll;
  CancelChartTools();
  if (on || !HasChart()) return;
  SetTB(kButtonAuto);
  s.ICFilterOn = false;
  s.ICFilter.clear();
  s.ChartTask = kTaskAutoScroll;
  std::string standing(Trim(services_.ini.GetSetting("Charts", "Auto")));
  if (standing == kUnknown || Val(standing) < 1 || Val(standing) > 20) standing = "2.5";
  const auto answer =
      dialogs_.Prompt(std::string("Set interval between charts (0 - 60 seconds)\n\n") +
                          (s.ChartListNo == kFullList ? "All charts" : ""),
                      kInterval, standing);
  if (!answer || answer->empty()) {
    CancelChartTools();
    return;
  }
  double seconds = RoundHalfEven(Val(*answer));
  if (!(seconds >= 0 && seconds <= 60)) seconds = 30;
  services_.ini.PutSetting("Charts", "Auto", Str(seconds));
  try {
    // The timer counts in 16 bits: 33 seconds and more are beyond it.
    view_.AutoScroll = CInt(seconds * 1000);
  } catch (const RunTimeError& e) {
    CancelChartTools();
    dialogs_.Message(e.what(), kInterval);
    return;
  }
  view_.Caption = "AUTOMATIC SCROLL - TO STOP click AUTO";
}

bool ChartWindow::AutoScrollTick() { return view_.AutoScroll > 0 && NextChart(); }

void ChartWindow::StartTool(std::unique_ptr<ChartTool> tool, ToolButton button, std::int16_t task) {
  SetTB(button);
  state().ChartTask = task;
  tool_ = std::move(tool);
  view_.CrossPointer = tool_->Cross();
}

void ChartWindow::LeaveTool() {
  DropMarker();
  point_.reset();
  view_.CrossPointer = false;
  if (!tool_) return;
  const std::unique_ptr<ChartTool> tool = std::move(tool_);
  tool->Leave();
}

// A tool that is done is left as by Escape.
void ChartWindow::After(ToolState toolState) {
  if (toolState == ToolState::kOn || !tool_) return;
  const std::function<void()> afterwards = tool_->Afterwards();
  CancelChartTools();
  if (afterwards) afterwards();
}

void ChartWindow::MouseMove(const ToolPoint& at) {
  if (!tool_) return;
  DropMarker();
  point_ = at;
  After(tool_->Move(at));
}

void ChartWindow::MousePress(const ToolPoint& at, MouseButton button) {
  DropMarker();
  if (button == MouseButton::kRight && !IsOn(kTaskZoom)) return HitTrendlines(at);
  if (tool_) After(tool_->Press(at, button));
}

void ChartWindow::MouseRelease(const ToolPoint& at, MouseButton button) {
  DropMarker();
  if (tool_) After(tool_->Release(at, button));
}

// ---- The point of the keys

void ChartWindow::PointTo(const ToolPoint& at) {
  DropMarker();
  point_ = at;
  const ToolState done = tool_->Move(at);
  // The cross hair shows the point by itself.
  if (done == ToolState::kOn && !GridOn() && toolView_.Readable() && at.pane == Pane::kPrice) {
    marker_ = std::make_unique<CrossHair>(services_.price, nullptr, services_.colours[kMovingGrid]);
    marker_->SetTouched(toolView_.Touched);
    marker_->Move(at.x, at.y, LimitsOf(Chart, Request.ChartStyle));
  }
  After(done);
}

void ChartWindow::DropMarker() {
  if (!marker_) return;
  marker_->Erase();
  marker_.reset();
}

void ChartWindow::MovePoint(int bars, int down) {
  if (!tool_) ToggleGrid();
  if (!tool_ || !toolView_.Readable()) return;
  if (Request.ChartStyle == Style::kPointFigure)
    return MoveRow(down == 0 ? bars : down < 0 ? 1 : -1);
  const std::int32_t last = std::max<std::int32_t>(Chart.Bars.BarCount, 0);
  // Where the bar is drawn: the column is read back from there without rounding.
  const auto x = [&](std::int32_t column) {
    return Chart.ChartLeft + double(column) * Chart.BarSpacing;
  };
  const auto close = [&](std::int32_t column) {
    const double y =
        size_t(column) < Chart.CloseY.size() ? Chart.CloseY[size_t(column)] : Chart.ChartTop;
    return std::clamp<double>(y, Chart.ChartTop, std::max(Chart.ChartTop, Chart.ChartBottom));
  };
  const bool begins = !point_ || (point_->pane == Pane::kPrice &&
                                  (point_->x < Chart.ChartLeft || point_->x > Chart.ChartRight));
  if (begins) return PointTo({x(last), close(last), Pane::kPrice});
  ToolPoint at = *point_;
  if (bars != 0) {
    // Into the blank space beyond the last bar too, where lines may end.
    const std::int32_t furthest =
        tool_->FollowsCloses()
            ? last
            : std::max(last, std::int32_t((Chart.ChartRight - Chart.ChartLeft) / Chart.BarSpacing));
    const std::int32_t column = std::clamp<std::int32_t>(
        CLng((at.x - Chart.ChartLeft) / Chart.BarSpacing) + bars, 0, furthest);
    at.x = x(column);
    if (tool_->FollowsCloses() && down == 0) at.y = close(std::min(column, last));
  }
  at.y += down;
  const bool panel = services_.panel.Visible() && panelFrame_.Bottom > panelFrame_.Top;
  if (at.pane == Pane::kPrice) {
    if (panel && down > 0 && at.y > Chart.ChartBottom && !GridOn()) {
      at.pane = Pane::kPanel;
      at.y = panelFrame_.Top;
    } else {
      at.y = std::clamp<double>(
          at.y, Chart.ChartTop,
          std::max(Chart.ChartTop, GridOn() ? Chart.VolBottom : Chart.ChartBottom));
    }
  } else if (!panel || at.y < panelFrame_.Top) {
    at.pane = Pane::kPrice;
    at.y = Chart.ChartBottom;
  } else {
    at.y = std::min<double>(at.y, panelFrame_.Bottom);
  }
  PointTo(at);
}

void ChartWindow::PointToEnd(bool last) {
  if (!tool_) ToggleGrid();
  point_.reset();
  MovePoint(0);
  if (Request.ChartStyle == Style::kPointFigure)
    MovePoint(last ? kMostRows : -kMostRows);
  else if (!last)
    MovePoint(-std::max<std::int32_t>(Chart.Bars.BarCount, 0) - 1);
}

void ChartWindow::ClickPoint() {
  if (!tool_) return;
  if (!point_) MovePoint(0);
  if (!tool_ || !point_) return;
  const ToolPoint at = *point_;
  DropMarker();
  After(tool_->Click(at));
}

void ChartWindow::Type(char32_t character) {
  if (tool_) After(tool_->Type(character));
}

// Boxes have no bar to go to: the keys go up and down their rows, at the last column, from the
// row of the last close on.
void ChartWindow::MoveRow(std::int32_t rows) {
  const std::int32_t last = Chart.Bars.BarCount, pitch = Chart.Boxes.PFBoxPixels;
  if (pitch < 1 || last < 0 || size_t(last) >= Chart.Bars.bars.size()) return;
  const std::int32_t most = (Chart.ChartBottom - Chart.ChartTop) / pitch;
  ToolPoint at{double(Chart.LastBarX), 0, Pane::kPrice};
  std::int32_t row = 0;
  if (point_) {
    at.x = point_->x;
    row = std::int32_t((Chart.ChartBottom - point_->y) / pitch) + rows;
  } else {
    const double close = double(Chart.Bars[size_t(last)].Close);
    row = (Chart.ChartBottom - PFPriceToPixel(Chart, Chart.Boxes, close)) / pitch;
  }
  at.y = Chart.ChartBottom - std::clamp(row, 0, most) * pitch;
  PointTo(at);
}

void ChartWindow::WithoutTool(const std::function<void()>& work) {
  if (marker_) marker_->Flip();
  if (tool_) tool_->Hide();
  work();
  if (tool_) tool_->Show();
  if (marker_) marker_->Flip();
}

void ChartWindow::ForgetTool() {
  if (marker_) marker_->Forget();
  if (tool_) tool_->Forget();
}

}  // namespace kora
