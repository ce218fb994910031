#include "chartwindow/forms/Chts.h"

#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QCloseEvent>
#include <QFileDialog>
#include <QFileInfo>
#include <QFontMetricsF>
#include <QFrame>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QMouseEvent>
#include <QPainter>
#include <QPointer>
#include <QPushButton>
#include <QStatusBar>
#include <QToolBar>
#include <QToolButton>
#include <QWheelEvent>
#include <algorithm>
#include <cmath>
#include <new>
#include <tuple>
#include <utility>
#include <vector>

#include "base/runtime_error.h"
#include "base/text.h"
#include "chartwindow/forms/KoraScroll.h"
#include "chartwindow/forms/ZoomKora.h"
#include "indicators/oscillators.h"
#include "indicators/price_overlays.h"
#include "platform/qt/modal.h"
#include "platform/qt/picture.h"
#include "platform/qt/to_qt.h"

// Resources of a library are taken in by hand, outside of any namespace.
static void TakeIcons() { Q_INIT_RESOURCE(chts_icons); }

namespace kora {
namespace {

struct Entry {
  const char* name;  // empty: a separator
  const char* caption;
  const Oscillator* oscillator = nullptr;
  bool slow = false;
};
struct Menu {
  const char* name;
  const char* caption;
  std::vector<Entry> entries;
};

// The oscillators of the table, the multiple averages among them, and what else has its place
// here.
std::vector<Entry> OscillatorEntries() {
  std::vector<Entry> entries;
  for (const Oscillator& oscillator : Oscillators()) {
    if (oscillator.code == "OBV") entries.push_back({"cmMMA", "MM&A (Multiple Moving Averages)"});
    for (const OscEntry& entry : oscillator.entries)
      entries.push_back({entry.menu, entry.caption, &oscillator, entry.slow});
  }
  const Entry rest[] = {{"cmSwing", "Swin&g"},
                        {"", ""},
                        {"cmMMASet", "MMA Se&ttings"},
                        {"cmuSwingsettings", "Swi&ng Settings"},
                        {"cmuMOS", "Multi-Oscillator Display Selections"},
                        {"cmKeepOsc", "&Keep Oscillator"}};
  entries.insert(entries.end(), std::begin(rest), std::end(rest));
  return entries;
}

const std::vector<Menu>& Menus() {
  static const std::vector<Menu> menus = {
      {"cmFile",
       "&File",
       {{"cmSaveAs", "&Save Chart as"},
        {"cmSSavedCht", "Show Sa&ved Chart"},
        {"cmPageSetup", "Pa&ge Setup"},
        {"cmPrintChart", "&Print Chart"},
        {"cmExit", "&Close"}}},
      {"cmTools",
       "&Tools",
       {{"cmChtDef", "&Chart Defaults"},
        {"cmStkDetails", "Show &Stock Details"},
        {"cmSuperimpose", "&Superimpose"},
        {"cmSplitScreen", "S&plit Screen"},
        {"cmInd", "&Indicators (reversal)"},
        {"cmChtScroll", "Chart Scroll &Bar"},
        {"cmGridLines", "&Grid Lines"},
        {"cmGLSpaces", "Grid &Line spacing "},
        {"cmText", "&Text"},
        {"cmRText", "&Remove Text"},
        {"cmRemAllTrend", "Remove &All Trendlines"},
        {"cmPFAuto", "Auto &Point and Figure Box Value "},
        {"cmChtSpaces", "&Change Chart Spacing"},
        {"cmInsOuts", "Highlight &Outside days on Bar Chart"},
        {"cmSLInd", "Stop Loss Indicator"}}},
      {"cmOptions",
       "O&ptions",
       {{"cmColours", "&Colours"},
        {"cmfonts", "&Fonts"},
        {"cmVHeight", "&Volume Height"},
        {"cmLineWidth", "&Line Width (Printing)"},
        {"cmBSpaces", "&Blank space at end of chart"},
        {"cmLegible", "Legible &Labels"}}},
      {"cmMove",
       "&Move",
       {{"cmNextChart", "&Next Chart\tCtrl+Page Down"},
        {"cmPrevChart", "&Previous Chart\tCtrl+Page Up"},
        {"", ""},
        {"cmOldest", "&Oldest Window\tHome"},
        {"cmNewest", "Ne&west Window\tEnd"},
        {"cmEarlier", "&Earlier Window\tPage Up"},
        {"cmLater", "&Later Window\tPage Down"},
        {"", ""},
        {"cmBarBack", "A &Bar Earlier\tCtrl+Left, Wheel"},
        {"cmBarOn", "A B&ar Later\tCtrl+Right, Wheel"},
        {"cmMonthBack", "A &Month Earlier\tCtrl+Shift+Left, Shift+Wheel"},
        {"cmMonthOn", "A Mon&th Later\tCtrl+Shift+Right, Shift+Wheel"},
        {"", ""},
        {"cmWider", "W&ider Spacing\tCtrl++, Ctrl+Wheel"},
        {"cmNarrower", "Na&rrower Spacing\tCtrl+-, Ctrl+Wheel"}}},
      {"cmOscillators", "&Oscillators", OscillatorEntries()},
  };
  return menus;
}

// The entry of an oscillator; null for every other one.
const Entry* OscillatorEntry(const std::string& name) {
  for (const Entry& entry : Menus().back().entries)
    if (name == entry.name) return entry.oscillator ? &entry : nullptr;
  return nullptr;
}

// The entries that move through time.
struct Move {
  const char* entry;
  TimeStep step;
  int by;
};
constexpr Move kMoves[] = {
    {"cmOldest", TimeStep::kEnd, -1},      {"cmNewest", TimeStep::kEnd, 1},
    {"cmEarlier", TimeStep::kWindow, -1},  {"cmLater", TimeStep::kWindow, 1},
    {"cmBarBack", TimeStep::kBar, -1},     {"cmBarOn", TimeStep::kBar, 1},
    {"cmMonthBack", TimeStep::kMonth, -1}, {"cmMonthOn", TimeStep::kMonth, 1}};

int ButtonOf(const std::string& entry) {
  for (int button = 1; button <= kToolButtons; ++button)
    if (entry == ToolButtonOf(button).key) return button;
  return kNoButton;
}

}  // namespace

// The client area: a size of its own for each form size, pictures placed by the panes' rules.
struct Chts::Area : QWidget {
  Area(Chts* owner) : QWidget(owner), form(owner) { setObjectName("Area"); }
  QSize minimumSizeHint() const override { return {160, 100}; }
  QSize sizeHint() const override { return {640, 400}; }
  void resizeEvent(QResizeEvent*) override { form->SizeChanged(); }
  // What the pictures leave free looks like them.
  void paintEvent(QPaintEvent* event) override {
    QPainter(this).fillRect(event->rect(), QtSurface::Rgb(form->colours()[kBackground]));
  }
  Chts* form;
};

Chts::Chts(const ChtsServices& services, QWidget* parent)
    : QMainWindow(parent),
      s_(services),
      area_(new Area(this)),
      picture1_(new PictureBox(area_)),
      picture2_(new PictureBox(area_)),
      picture4_(new PictureBox(area_)),
      window_({.files = services.files,
               .dialogs = services.dialogs,
               .settings = services.settings,
               .ini = services.ini,
               .user = services.user,
               .colours = services.colours,
               .current = services.current,
               .state = services.state,
               .price = picture1_->surface(),
               .panel = picture2_->surface(),
               .layOut = [this](bool two) { LayOut(two); },
               .popUpTrend = [this] { return PopUpTrend(); },
               .openZoom = [this](const ZoomBox& box) { OpenZoom(box); },
               .VolumeUnitText = services.VolumeUnitText}),
      scroll_({.files = services.files,
               .dialogs = services.dialogs,
               .settings = services.settings,
               .current = services.current,
               .state = services.state}) {
  setObjectName("Chts");
  setAttribute(Qt::WA_DeleteOnClose);
  setContextMenuPolicy(Qt::NoContextMenu);
  setCentralWidget(area_);
  for (const auto& [picture, name, text] :
       {std::tuple{picture1_, "Picture1", "Chart"},
        {picture2_, "Picture2(0)", "Oscillator"},
        {picture4_, "Picture4", "Legend of the reversal marks"}}) {
    picture->setObjectName(name);
    picture->setAccessibleName(text);
    picture->surface().SetBackColour(s_.colours[kBackground]);
    picture->surface().Cls();
    if (picture != picture1_) picture->setFocusPolicy(Qt::NoFocus);
  }
  for (PictureBox* picture : {picture1_, picture2_}) {
    picture->setMouseTracking(true);
    picture->installEventFilter(this);
  }
  label1_ = new QLabel(area_);
  label1_->setObjectName("Label1");
  label1_->setAutoFillBackground(true);
  label1_->setMargin(4);
  label1_->setFrameStyle(QFrame::StyledPanel | QFrame::Raised);
  label1_->hide();
  timer1_.callOnTimeout(this, [this] {
    if (!busy_) Do([this] { window_.AutoScrollTick(); });
  });
  picture2_->hide();
  picture2_->surface().SetVisible(false);
  picture4_->hide();
  setFocusProxy(picture1_);
  window_.Touched = [this](const Surface& surface, double x1, double y1, double x2, double y2) {
    TouchLine(surface, x1, y1, x2, y2);
  };
  BuildMenus();
  BuildToolBar();
  BuildStatusBar();
  BuildFrame();
  // A drag of the frame is many sizes: the chart is composed for the last one that waits.
  resized_.setSingleShot(true);
  resized_.setInterval(0);
  resized_.callOnTimeout(this, [this] {
    if (busy_)
      sizeWaits_ = true;
    else
      Do([this] { window_.Resized(); });
  });
  wheeled_.setSingleShot(true);
  wheeled_.setInterval(0);
  wheeled_.callOnTimeout(this, [this] { TurnWheel(); });
  for (PictureBox* picture : {picture1_, picture2_})
    picture->Resized = [this, picture] {
      picture->surface().SetBackColour(s_.colours[kBackground]);
      picture->surface().Cls();
      window_.ForgetTool();
      // A hidden panel takes its size when it is needed.
      if (picture->isVisibleTo(area_) && !window_.Loading && !busy_) resized_.start();
    };
  window_.Load();
  SetForm("OscFrm", s_.forms["OscFrm"]);
  SetForm("Chart2", s_.forms["Chart2"]);
  EnableEntries();
  ShowView();
}

Chts::~Chts() {
  window_.Touched = nullptr;
  window_.Unload();
}

// ---- What stands on the form

void Chts::BuildMenus() {
  for (const Menu& each : Menus()) {
    QMenu* menu = menuBar()->addMenu(each.caption);
    menu->setObjectName(each.name);
    // Escape in a menu leaves the keys with the bar, which does nothing with them.
    connect(menu, &QMenu::aboutToHide, this, [this] {
      QTimer::singleShot(0, this, [this] {
        if (QWidget::window()->focusWidget() == menuBar() && !QApplication::activePopupWidget())
          setFocus();
      });
    });
    for (const Entry& entry : each.entries) {
      if (!*entry.name) {
        menu->addSeparator();
        continue;
      }
      const std::string name = entry.name;
      QAction* action = menu->addAction(entry.caption);
      action->setObjectName(entry.name);
      entries_[name] = action;
      connect(action, &QAction::triggered, this, [this, name] { Trigger(name); });
    }
  }
  for (const char* name : {"cmInd", "cmGridLines", "cmPFAuto", "cmInsOuts", "cmMMA", "cmSwing",
                           "cmKeepOsc", "cmLegible"})
    entries_[name]->setCheckable(true);
}

void Chts::BuildToolBar() {
  TakeIcons();
  toolbar1_ = addToolBar("Tool bar");
  toolbar1_->setObjectName("Toolbar1");
  toolbar1_->setMovable(false);
  toolbar1_->setContextMenuPolicy(Qt::PreventContextMenu);
  toolbar1_->setIconSize({20, 20});
  for (int button = 1; button <= kToolButtons; ++button) {
    const ToolButtonText& text = ToolButtonOf(button);
    for (const int first : {kButtonBack, kButtonBar, kButtonDaily, kButtonGrid, kButtonMulti1})
      if (button == first) toolbar1_->addSeparator();
    QAction* action = toolbar1_->addAction(QIcon(QString(":/chts/%1.svg").arg(text.key)), text.tip);
    action->setToolTip(text.tip);
    action->setObjectName(text.key);
    action->setCheckable(true);
    QWidget* widget = toolbar1_->widgetForAction(action);
    widget->setObjectName(text.key);
    widget->setAccessibleName(text.tip);
    widget->setFocusPolicy(Qt::TabFocus);
    const std::string name = text.key;
    entries_[name] = action;
    connect(action, &QAction::triggered, this, [this, name] { Trigger(name); });
  }
}

void Chts::BuildStatusBar() {
  QStatusBar* bar = statusBar();
  bar->setObjectName("StatusBar1");
  bar->setSizeGripEnabled(false);
  for (size_t i = 0; i < status_.size(); ++i) {
    status_[i] = new QLabel(bar);
    status_[i]->setObjectName(QString("StatusBar1(%1)").arg(i + 1));
    status_[i]->setFrameStyle(QFrame::Panel | (i == 0 ? QFrame::Raised : QFrame::Sunken));
    // Of one size in both directions: a text that changes lays nothing out.
    status_[i]->setFixedHeight(status_[i]->sizeHint().height() + 2);
    bar->addWidget(status_[i]);
  }
  // As high with panels as without.
  bar->setMinimumHeight(status_[0]->height() + 4);
}

void Chts::BuildFrame() {
  frame1_ = new QFrame(area_);
  frame1_->setObjectName("Frame1");
  frame1_->setAccessibleName("Date limit");
  frame1_->setFrameStyle(QFrame::StyledPanel | QFrame::Raised);
  frame1_->setAutoFillBackground(true);
  frame1_->setCursor(Qt::SizeAllCursor);
  auto* grid = new QGridLayout(frame1_);
  grid->setContentsMargins(6, 10, 6, 6);
  grid->setSpacing(3);
  static constexpr const char* kUnits[] = {"Day", "Week", "Month"};
  for (int i = 0; i < 6; ++i) {
    const bool forward = i < 3;
    auto* button =
        new QPushButton(QString("%1 %2").arg(kUnits[i % 3], forward ? "+" : "-"), frame1_);
    button->setObjectName(QString("Command31(%1)").arg(i));
    button->setToolTip(QString("The chart ends one %1 %2")
                           .arg(QString(kUnits[i % 3]).toLower(), forward ? "later" : "earlier"));
    button->setCursor(Qt::ArrowCursor);
    button->setAutoDefault(false);
    grid->addWidget(button, forward ? 0 : 1, i % 3);
    connect(button, &QPushButton::clicked, this,
            [this, i] { Do([&] { window_.StepDateLimit(i); }); });
  }
  frame1_->installEventFilter(this);
  frame1_->hide();
}

void Chts::SetForm(const std::string& entry, std::function<void()> open) {
  s_.forms[entry] = std::move(open);
  const std::function<void()>& form = s_.forms[entry];
  if (entry == "OscFrm") window_.SetOscFrm(form);
  // Opens once the first chart stands and the window is free for the second.
  if (entry == "Chart2")
    window_.SetChart2(!form ? form : [this] { QTimer::singleShot(0, this, s_.forms["Chart2"]); });
  EnableEntries();
}

// ---- What the entries do

std::function<void()> Chts::DeedOf(const std::string& entry) {
  using Deed = std::function<void()>;
  ChartWindow& w = window_;
  const auto deed = [this](auto work) -> Deed { return [this, work] { Do(work); }; };
  const bool xs = s_.settings.words.OptionXS;
  if (entry == "cmSaveAs") return [this] { SaveAs(); };
  if (entry == "cmSSavedCht") return [this] { ShowSaved(); };
  if (entry == "cmExit") return [this] { CloseWindow(); };
  if (entry == "cmGridLines") return deed([&w] { w.ToggleGridLines(); });
  if (entry == "cmInd") return deed([&w] { w.ToggleReversals(); });
  if (entry == "cmInsOuts" && xs) return deed([&w] { w.ToggleOutsideDays(); });
  if (entry == "cmKeepOsc") return deed([&w] { w.ToggleKeepOscillator(); });
  if (entry == "cmLegible") return deed([&w] { w.ToggleLegible(); });
  if (entry == "cmMMA") return deed([&w] { w.ToggleMMA(); });
  if (entry == "cmPFAuto") return deed([&w] { w.TogglePFAuto(); });
  if (entry == "cmSwing") return deed([&w] { w.ToggleSwing(); });
  if (entry == "cmSuperimpose" && s_.forms["Chart2"]) return deed([&w] { w.StartSuperimpose(); });
  if (entry == "cmSplitScreen" && s_.forms["Chart2"]) return deed([&w] { w.StartSplitScreen(); });
  if (entry == "cmText") return deed([&w] { w.StartText(); });
  if (entry == "cmRemAllTrend") return deed([&w] { w.RemoveAllTrendlines(); });
  if (entry == "cmChtScroll") return [this] { OpenScroll(); };
  if (entry == "cmNextChart") return DeedOf("fwd");
  if (entry == "cmPrevChart") return DeedOf("rev");
  for (const Move& move : kMoves)
    if (entry == move.entry) return deed([&w, &move] { w.MoveTime(move.step, move.by); });
  if (entry == "cmWider") return deed([&w] { w.ChangeSpacing(1); });
  if (entry == "cmNarrower") return deed([&w] { w.ChangeSpacing(-1); });
  if (const Entry* picked = OscillatorEntry(entry)) {
    if (picked->oscillator->switchXT && !s_.settings.words.OptionXT) return {};
    return deed([&w, picked] { w.PickOscillator(picked->oscillator->code, picked->slow); });
  }
  switch (ButtonOf(entry)) {
    case kButtonRefresh: return deed([&w] { w.Refresh(); });
    case kButtonBack:
    case kButtonForward:
      return deed([&w, forward = entry == "fwd"] {
        w.state().ChartDirection = forward ? 1 : 0;
        if (w.view().AutoScroll > 0) w.CancelChartTools();
        w.SetTB(w.ToolOn() ? w.view().TB : kNoButton);
        if (w.HasChart())
          w.StepChart();
        else
          w.NextChart();
      });
    case kButtonBar: return deed([&w] { w.SetStyle(Style::kBar); });
    case kButtonCandle: return deed([&w] { w.SetStyle(Style::kCandlestick); });
    case kButtonPF: return deed([&w] { w.SetStyle(Style::kPointFigure); });
    case kButtonLine: return deed([&w] { w.SetStyle(Style::kLine); });
    case kButtonDaily: return deed([&w] { w.SetPeriod(Period::kDaily); });
    case kButtonWeekly: return deed([&w] { w.SetPeriod(Period::kWeekly); });
    case kButtonMonthly: return deed([&w] { w.SetPeriod(Period::kMonthly); });
    case kButtonAuto: return deed([&w] { w.ToggleAutoScroll(); });
    case kButtonGrid: return deed([&w] { w.ToggleGrid(); });
    case kButtonTrend: return deed([&w] { w.ToggleTrendline(); });
    case kButtonErase: return deed([&w] { w.TellHowToErase(); });
    case kButtonFib: return deed([&w] { w.ToggleFibonacci(); });
    case kButtonZoom: return deed([&w] { w.ToggleZoom(); });
    default: break;
  }
  const std::string form = entry == "cspace" ? "cmChtSpaces" : entry;
  if (entry == "cmSLInd" && !xs) return {};
  if (!s_.forms[form]) return {};
  return [this, form] { OpenForm(form); };
}

void Chts::EnableEntries() {
  // It stands there only where it can be used: greyed it would take its letter from Superimpose.
  entries_["cmStkDetails"]->setVisible(bool(DeedOf("cmStkDetails")));
  for (const auto& [name, action] : entries_) action->setEnabled(bool(DeedOf(name)));
}

void Chts::Trigger(const std::string& entry) {
  const QPointer<Chts> alive(this);
  if (const auto deed = DeedOf(entry); deed && !busy_) deed();
  // The keys of a tool are for the picture, also where a button of the tool bar has put it on.
  if (alive && window_.ToolOn() && !picture1_->hasFocus()) picture1_->setFocus();
  // A click has flipped the tick of the entry already; what it says is the window's to tell.
  if (alive) ShowView();
}

void Chts::OpenForm(const std::string& entry) {
  ChartState& state = window_.state();
  if (entry == "cmChtSpaces" && state.ChartStyle == Style::kPointFigure) return;
  const bool view = entry == "mo1" || entry == "mo2";
  if (view && (state.ChartStyle == Style::kPointFigure || !window_.HasChart())) return;
  Do([&] {
    if (entry == "new") window_.StartNewChart();
    if (entry == "cmColours" || entry == "cmSLInd") window_.CancelChartTools();
    if (entry == "cmColours") state.ChartTask = kTaskColours;
    if (entry == "cmChtDef") state.ChartTask = kTaskChartDefaults;
    if (view) window_.CancelChartTools();
    if (view) window_.SetTB(ButtonOf(entry));
    if (entry == "cmPageSetup" || entry == "cmPrintChart")
      window_.StartPrinting(entry == "cmPrintChart");
  });
  // The form may ask for a chart, or close this window with it.
  const QPointer<Chts> alive(this);
  s_.forms[entry]();
  if (!alive) return;
  if (entry == "cmChtDef" || entry == "cmColours") state.ChartTask = kTaskNone;
  Do([&] {
    if (entry == "cmSLInd") window_.Recompose();
  });
}

void Chts::Start() {
  if (window_.HasChart()) return;
  Do([this] { window_.NextChart(); });
}

void Chts::ShowChosen() {
  Do([this] { window_.ShowAt(std::max<int>(window_.state().ChartIndex, 1)); });
}

void Chts::Refresh() {
  Do([this] { window_.Refresh(); });
}

void Chts::BackToChart() {
  Do([this] { window_.BackToChart(); });
  setFocus();
}

void Chts::DropSecondChart() {
  Do([this] { window_.DropSecondChart(); });
  Refresh();
}

QSizeF Chts::ChartSize() const {
  const Surface& price = picture1_->surface();
  const Surface& panel = picture2_->surface();
  const bool below = picture2_->isVisibleTo(area_);
  return {price.ScaleWidth(), price.ScaleHeight() + (below ? panel.ScaleHeight() : 0)};
}

void Chts::RefreshTitle() {
  window_.RefreshTitle();
  ShowView();
}

template <typename Deed>
void Chts::Do(Deed deed) {
  // Drawing lets events through: one of them may be that which takes a closed window down.
  if (busy_ || closed_) return;
  busy_ = true;
  // A deed may run a form, and the window may be gone when that one is left.
  const QPointer<Chts> window(this);
  Dialogs& dialogs = s_.dialogs;
  const auto tell = [&dialogs](const char* text) {
    dialogs.SetBusy(false);
    dialogs.Message(text, "Charts");
  };
  try {
    deed();
  } catch (const RunTimeError& e) {
    tell(e.what());
  } catch (const std::bad_alloc&) {
    tell(ErrorText(kOutOfMemory));
  }
  if (!window) return;
  busy_ = false;
  ShowView();
  picture1_->update();
  picture2_->update();
  if (std::exchange(sizeWaits_, false)) resized_.start();
}

// ---- Showing

void Chts::ShowView() {
  picture1_->setAccessibleName(ToQt(window_.ChartName()));
  picture2_->setAccessibleName(ToQt(window_.PanelName()));
  const ChartWindowView& view = window_.view();
  const ChartState& state = window_.state();
  setWindowTitle(ToQt(view.Title));
  ShowStatus();
  for (int button = 1; button <= kToolButtons; ++button)
    entries_[ToolButtonOf(button).key]->setChecked(button == view.TB || ShownOn(button));
  entries_["cmInd"]->setChecked(state.ReversalsOn);
  entries_["cmGridLines"]->setChecked(s_.settings.charts.GridLines);
  entries_["cmPFAuto"]->setChecked(state.PFAutoBox);
  entries_["cmInsOuts"]->setChecked(state.OutsideDaysOn);
  entries_["cmMMA"]->setChecked(state.MMAOn);
  entries_["cmKeepOsc"]->setChecked(state.KeepOsc);
  entries_["cmLegible"]->setChecked(s_.settings.charts.Legible);
  entries_["cmSwing"]->setChecked(state.SwingOn);
  PlaceLegend();
  label1_->setText(ToQt(view.Caption));
  if (!view.Caption.empty()) {
    label1_->adjustSize();
    label1_->move((area_->width() - label1_->width()) / 2, 4);
    label1_->raise();
  }
  label1_->setVisible(!view.Caption.empty());
  if (view.AutoScroll == 0)
    timer1_.stop();
  else if (!timer1_.isActive() || timer1_.interval() != view.AutoScroll)
    timer1_.start(view.AutoScroll);
  for (PictureBox* picture : {picture1_, picture2_})
    picture->setCursor(view.CrossPointer ? Qt::CrossCursor : Qt::ArrowCursor);
  if (view.FrameShown) {
    frame1_->adjustSize();
    QPoint place = frame1_->pos();
    if (view.Frame)
      place = QPoint(int(std::lround(view.Frame->left)), int(std::lround(view.Frame->top)));
    else if (!frameStood_)
      place = QPoint(60, 60);
    // Within reach, whatever was kept.
    place.setX(std::clamp(place.x(), 0, std::max(0, area_->width() - frame1_->width())));
    place.setY(std::clamp(place.y(), 0, std::max(0, area_->height() - frame1_->height())));
    frame1_->move(place);
    frameStood_ = true;
  }
  frame1_->setEnabled(view.FrameShown);
  frame1_->setVisible(view.FrameShown);
}

// Whether the chart on show is of the style or period that the button stands for.
bool Chts::ShownOn(int button) const {
  if (!window_.Chart.ChartDrawn || window_.ChartFromFile) return false;
  const ChartRequest& request = window_.Request;
  switch (button) {
    case kButtonBar: return request.ChartStyle == Style::kBar;
    case kButtonCandle: return request.ChartStyle == Style::kCandlestick;
    case kButtonLine: return request.ChartStyle == Style::kLine;
    case kButtonPF: return request.ChartStyle == Style::kPointFigure;
    case kButtonDaily: return request.ChartPeriod == Period::kDaily;
    case kButtonWeekly: return request.ChartPeriod == Period::kWeekly;
    case kButtonMonthly: return request.ChartPeriod == Period::kMonthly;
    default: return false;
  }
}

void Chts::ShowStatus() {
  const ChartWindowView& view = window_.view();
  for (size_t i = 0; i < status_.size(); ++i) {
    const QString text = ToQt(view.Panels[i]);
    if (status_[i]->text() != text) status_[i]->setText(text);
    const StatusWidths widths = StatusBarWidths(width());
    const bool last = i + 1 == status_.size() && !view.PanelsAlike;
    const int wide = last ? widths.last : widths.each;
    if (status_[i]->width() != wide) status_[i]->setFixedWidth(wide);
    if (status_[i]->isVisibleTo(statusBar()) != view.PanelShown[i])
      status_[i]->setVisible(view.PanelShown[i]);
  }
  // The reading of a tool is told by a screen reader as it moves.
  QStringList readings;
  for (size_t i = 2; i < view.Panels.size(); ++i)
    if (!view.Panels[i].empty()) readings << ToQt(view.Panels[i]);
  const QString reading = readings.join(", ");
  if (picture1_->accessibleDescription() != reading) picture1_->setAccessibleDescription(reading);
}

void Chts::LayOut(bool twoPanes) {
  twoPanes_ = twoPanes;
  const PaneLayout panes = LayOutPanes(area_->width(), area_->height() + statusBar()->height(), 0,
                                       statusBar()->height(), twoPanes);
  picture1_->Place(QRect(0, 0, int(panes.width), int(panes.price)));
  const bool second = panes.panel > 0;
  if (second) picture2_->Place(QRect(0, int(panes.panelTop), int(panes.width), int(panes.panel)));
  picture2_->setVisible(second);
  picture2_->surface().SetVisible(second);
  PlaceLegend();
}

void Chts::PlaceLegend() {
  const bool shown = window_.view().LegendShown;
  if (shown) {
    picture4_->Place(QRect(picture1_->geometry().right() + 1 - int(kLegendWidth),
                           picture1_->geometry().bottom() + 1 - int(kLegendHeight),
                           int(kLegendWidth), int(kLegendHeight)));
    picture4_->surface().SetBackColour(s_.colours[kBackground]);
    picture4_->surface().Cls();
    DrawReversalLegend(picture4_->surface(), s_.settings.fonts, s_.colours);
    picture4_->update();
  }
  picture4_->setVisible(shown);
}

void Chts::SizeChanged() {
  const StatusWidths widths = StatusBarWidths(width());
  // A price of three digits has room in every panel; where it has not, the letters are smaller.
  QFont font = statusBar()->font();
  const auto needed = [&] { return QFontMetricsF(font).horizontalAdvance("Close  000.00") + 8; };
  while (needed() > widths.each && font.pointSizeF() > 6.5)
    font.setPointSizeF(font.pointSizeF() - 0.5);
  for (size_t i = 0; i < status_.size(); ++i) {
    if (!status_[i]) continue;
    status_[i]->setFont(font);
    status_[i]->setFixedWidth(i + 1 < status_.size() ? widths.each : widths.last);
  }
  if (status_[0] == nullptr || window_.Loading) return;
  if (busy_) sizeWaits_ = true;
  LayOut(twoPanes_);
}

void Chts::TouchLine(const Surface& surface, double x1, double y1, double x2, double y2) {
  PictureBox* picture = &surface == &picture1_->surface() ? picture1_ : picture2_;
  // The panel may have a scale of its own.
  const double fx = picture->width() / surface.ScaleWidth();
  const double fy = picture->height() / surface.ScaleHeight();
  // A sloped line touches few of the pixels of the rectangle that it spans: a piece at a time.
  constexpr double kPiece = 32;
  const double dx = (x2 - x1) * fx, dy = (y2 - y1) * fy;
  const int pieces = std::clamp(int(std::min(std::abs(dx), std::abs(dy)) / kPiece), 1, 64);
  QRegion touched;
  for (int i = 0; i < pieces; ++i) {
    const QPointF from(x1 * fx + dx * i / pieces, y1 * fy + dy * i / pieces);
    const QPointF to(x1 * fx + dx * (i + 1) / pieces, y1 * fy + dy * (i + 1) / pieces);
    touched += QRectF(from, to).normalized().adjusted(-2, -2, 3, 3).toAlignedRect();
  }
  picture->update(touched);
}

// ---- Files

void Chts::SaveAs() {
  Do([this] { window_.StartSaving(); });
  std::optional<std::string> path;
  const Paths& paths = s_.settings.paths;
  if (s_.pickSaved) {
    path = s_.pickSaved(window_.SuggestedName());
  } else {
    Modal<QFileDialog> dialog(this, "Save Chart As ...");
    dialog->setObjectName("SaveKora");
    dialog->setAcceptMode(QFileDialog::AcceptSave);
    dialog->setFileMode(QFileDialog::AnyFile);
    dialog->setOption(QFileDialog::DontConfirmOverwrite);  // the question is the window's own
    dialog->setNameFilters(
        {"Saved charts (*.cht)", "Pictures (*.png)", "Drawings (*.svg)", "Documents (*.pdf)"});
    dialog->setDefaultSuffix("cht");
    QObject::connect(&*dialog, &QFileDialog::filterSelected, &*dialog, [&dialog](const QString& f) {
      const QString ending = f.section("*.", 1).chopped(1);
      dialog->setDefaultSuffix(ending);
      if (dialog->selectedFiles().isEmpty()) return;
      dialog->selectFile(QFileInfo(dialog->selectedFiles().first()).completeBaseName() + "." +
                         ending);
    });
    try {
      dialog->setDirectory(ToQt(s_.files.HostPath(paths.ChartSavePath)));
    } catch (const RunTimeError&) {
      // A folder that can't be one: the dialog opens where it likes.
    }
    dialog->selectFile(ToQt(window_.SuggestedName()));
    const auto result = dialog.Run();
    if (!result) return;  // this window went with it
    if (result == QDialog::Accepted && !dialog->selectedFiles().isEmpty())
      path = s_.files.DosPath(dialog->selectedFiles().first().toStdString());
  }
  Do([&] {
    window_.SaveChartAs(path, [this](const std::string& file) { return MakePictureFile(file); });
  });
}

std::string Chts::MakePictureFile(const std::string& path) {
  const QtRasterSurface& price = picture1_->surface();
  const bool panel = picture2_->isVisibleTo(area_);
  const PictureSize size{price.Width(), price.Height(), panel ? picture2_->surface().Height() : 0,
                         2};
  bool drawn = false;
  std::string bytes = MakePicture(PictureKindOf(path), size, [&](Surface& upper, Surface* lower) {
    drawn = window_.DrawAgain(upper, lower);
  });
  if (!drawn) throw RunTimeError(kNoPicture);
  return bytes;
}

void Chts::ShowSaved() {
  Do([this] { window_.CancelChartTools(); });
  std::optional<std::string> path;
  if (s_.pickToShow) {
    path = s_.pickToShow();
  } else {
    QString folder;
    try {
      folder = ToQt(s_.files.HostPath(s_.settings.paths.ChartSavePath));
    } catch (const RunTimeError&) {
    }
    Modal<QFileDialog> dialog(this, "Display Saved Chart", folder, "Saved charts (*.cht)");
    dialog->setFileMode(QFileDialog::ExistingFile);
    if (dialog.Run() != QDialog::Accepted || dialog->selectedFiles().isEmpty()) return;
    path = s_.files.DosPath(dialog->selectedFiles().first().toStdString());
  }
  if (path) ShowSavedFile(*path);
}

void Chts::ShowSavedFile(const std::string& path) {
  Do([&] { window_.ShowSaved(path); });
}

QImage Chts::Picture() {
  QImage both;
  window_.WithoutTool([&] {
    const QImage& upper = picture1_->surface().image();
    if (!picture2_->isVisibleTo(area_)) {
      both = upper.copy();
      return;
    }
    const QImage& lower = picture2_->surface().image();
    both = QImage(upper.width(), upper.height() + lower.height(), QImage::Format_RGB32);
    both.fill(QtSurface::Rgb(s_.colours[kBackground]));
    for (int y = 0; y < both.height(); ++y) {
      const QImage& from = y < upper.height() ? upper : lower;
      const int row = y < upper.height() ? y : y - upper.height();
      std::copy_n(from.constScanLine(row), size_t(std::min(from.width(), both.width())) * 4,
                  both.scanLine(y));
    }
  });
  both.setDevicePixelRatio(1);
  return both;
}

void Chts::CopyPicture() { QGuiApplication::clipboard()->setImage(Picture()); }

// ---- Mouse and keys

bool Chts::eventFilter(QObject* object, QEvent* event) {
  if (object == picture1_ && PictureEvent(picture1_, event)) return true;
  if (object == picture2_ && PictureEvent(picture2_, event)) return true;
  if (object == frame1_ && FrameEvent(event)) return true;
  return QMainWindow::eventFilter(object, event);
}

// Notches that come while a chart is drawn are one move.
void Chts::TakeWheel(const QWheelEvent& wheel) {
  const QPoint angle = wheel.angleDelta();
  const bool control = wheel.modifiers() & Qt::ControlModifier;
  const WheelUse use = control                                 ? WheelUse::kSpacing
                       : wheel.modifiers() & Qt::ShiftModifier ? WheelUse::kMonth
                                                               : WheelUse::kBar;
  if (use != wheelUse_) wheelAngle_ = 0;
  wheelUse_ = use;
  wheelAngle_ += angle.y() != 0 ? angle.y() : angle.x();
  if (std::abs(wheelAngle_) >= QWheelEvent::DefaultDeltasPerStep) wheeled_.start();
}

// Up is back in time, and wider.
void Chts::TurnWheel() {
  const int notches = wheelAngle_ / QWheelEvent::DefaultDeltasPerStep;
  if (busy_ || notches == 0) return;
  wheelAngle_ -= notches * QWheelEvent::DefaultDeltasPerStep;
  Do([&] {
    if (wheelUse_ == WheelUse::kSpacing)
      window_.ChangeSpacing(notches);
    else
      window_.MoveTime(wheelUse_ == WheelUse::kMonth ? TimeStep::kMonth : TimeStep::kBar, -notches);
  });
}

bool Chts::PictureEvent(PictureBox* picture, QEvent* event) {
  if (event->type() == QEvent::Wheel) {
    TakeWheel(*static_cast<QWheelEvent*>(event));
    return true;
  }
  const bool press = event->type() == QEvent::MouseButtonPress;
  const bool release = event->type() == QEvent::MouseButtonRelease;
  if (busy_ || !(press || release || event->type() == QEvent::MouseMove)) return false;
  const auto* mouse = static_cast<QMouseEvent*>(event);
  const Surface& surface = picture->surface();
  const ToolPoint at{std::floor(mouse->position().x() * surface.ScaleWidth() / picture->width()),
                     std::floor(mouse->position().y() * surface.ScaleHeight() / picture->height()),
                     picture == picture1_ ? Pane::kPrice : Pane::kPanel};
  if (!press && !release) {
    if (!window_.ToolOn()) return false;
    window_.MouseMove(at);
    ShowStatus();
    return false;
  }
  if (mouse->button() != Qt::LeftButton && mouse->button() != Qt::RightButton) return false;
  const MouseButton button =
      mouse->button() == Qt::LeftButton ? MouseButton::kLeft : MouseButton::kRight;
  if (!window_.ToolOn() && button == MouseButton::kLeft) return false;
  Do([&] {
    if (press)
      window_.MousePress(at, button);
    else
      window_.MouseRelease(at, button);
  });
  return false;
}

TrendChoice Chts::PopUpTrend() {
  Modal<QMenu> menu(this);
  menu->setObjectName("smTrend");
  QAction* move = menu->addAction("&Move");
  move->setObjectName("smMove");
  QAction* remove = menu->addAction("&Delete");
  remove->setObjectName("smDelete");
  const auto chosen = menu.Run(QCursor::pos());
  if (!chosen || *chosen == nullptr) return TrendChoice::kNothing;
  return *chosen == move ? TrendChoice::kMove : TrendChoice::kDelete;
}

void Chts::OpenZoom(const ZoomBox& box) {
  QWidget* over = s_.zoomOver ? s_.zoomOver() : this;
  Modal<ZoomKora> form(
      ZoomKoraServices{s_.dialogs, window_.Chart, window_.Request, s_.colours, s_.settings.fonts},
      box, over, this);
  form.Run();
}

void Chts::OpenScroll() {
  if (window_.state().ChartStyle == Style::kPointFigure || !window_.HasChart()) return;
  bool ready = false;
  Do([&] { ready = scroll_.SetScrollBar(); });
  if (!ready) return;
  Modal<KoraScroll> form(scroll_, this);
  if (form.Run()) Do([this] { window_.Redraw(); });
}

bool Chts::FrameEvent(QEvent* event) {
  const auto mouse = [&] { return static_cast<QMouseEvent*>(event); };
  if (event->type() == QEvent::MouseButtonPress && mouse()->button() == Qt::LeftButton) {
    frameGrip_ = mouse()->position().toPoint();
    frameDragged_ = false;
    return true;
  }
  if (event->type() == QEvent::MouseMove && (mouse()->buttons() & Qt::LeftButton)) {
    const QPoint at = mouse()->position().toPoint();
    if (!frameDragged_ && (at - frameGrip_).manhattanLength() < QApplication::startDragDistance())
      return true;
    frameDragged_ = true;
    frame1_->move(frame1_->mapToParent(at) - frameGrip_);
    return true;
  }
  if (event->type() == QEvent::MouseButtonRelease && frameDragged_) {
    frameDragged_ = false;
    const QPoint at = frame1_->mapTo(area_, mouse()->position().toPoint());
    Do([&] { window_.DropFrame(at.x(), at.y(), frame1_->width(), frame1_->height()); });
    return true;
  }
  return false;
}

// The frame around this window has menus of its own, some under the same letters: where this
// window has the keys, its own menus open.
bool Chts::OpenMenuByKey(QKeyEvent* event, bool open) {
  if (event->modifiers() != Qt::AltModifier || event->key() < Qt::Key_A || event->key() > Qt::Key_Z)
    return false;
  const QString mnemonic = QString("&") + QChar(event->key());
  for (QAction* menu : menuBar()->actions())
    if (menu->text().contains(mnemonic, Qt::CaseInsensitive)) {
      if (open) {
        menuBar()->setActiveAction(menu);
        // As in any menu opened by its key: Enter takes the first entry that can be used.
        for (QAction* entry : menu->menu()->actions())
          if (entry->isEnabled() && entry->isVisible() && !entry->isSeparator()) {
            menu->menu()->setActiveAction(entry);
            break;
          }
      }
      return true;
    }
  return false;
}

bool Chts::event(QEvent* event) {
  if (event->type() == QEvent::ShortcutOverride &&
      OpenMenuByKey(static_cast<QKeyEvent*>(event), false)) {
    event->accept();
    return true;
  }
  return QMainWindow::event(event);
}

void Chts::keyPressEvent(QKeyEvent* event) {
  // Some window managers leave the keyboard here when a message over a form is closed.
  if (QApplication::activeModalWidget()) return;
  const bool plain = (event->modifiers() & ~Qt::KeypadModifier) == Qt::NoModifier;
  if (OpenMenuByKey(event, true)) return;
  if (event == QKeySequence::Save) return Trigger("cmSaveAs");
  if (event == QKeySequence::Copy) return CopyPicture();
  if (event == QKeySequence::Print) return Trigger("cmPrintChart");
  if (ToolKey(event)) return;
  const auto modifiers = event->modifiers() & ~Qt::KeypadModifier;
  const bool month = modifiers == (Qt::ControlModifier | Qt::ShiftModifier);
  if (modifiers == Qt::ControlModifier || month) {
    switch (event->key()) {
      case Qt::Key_Left: return Trigger(month ? "cmMonthBack" : "cmBarBack");
      case Qt::Key_Right: return Trigger(month ? "cmMonthOn" : "cmBarOn");
      case Qt::Key_Plus:
      case Qt::Key_Equal: return Trigger("cmWider");
      case Qt::Key_Minus: return Trigger("cmNarrower");
      case Qt::Key_PageDown: return Trigger("fwd");
      case Qt::Key_PageUp: return Trigger("rev");
      default: break;
    }
  }
  switch (plain ? event->key() : 0) {
    case Qt::Key_PageDown: return Trigger("cmLater");
    case Qt::Key_PageUp: return Trigger("cmEarlier");
    case Qt::Key_Home: return Trigger("cmOldest");
    case Qt::Key_End: return Trigger("cmNewest");
    case Qt::Key_F5: return Trigger("ref");
    case Qt::Key_Escape: return Do([this] { window_.CancelChartTools(); });
    default: QMainWindow::keyPressEvent(event);
  }
}

// The keys of the tool that is on: arrows move its point, ten times as far with Shift, Enter is the
// click, and a text that is being typed takes every character.
bool Chts::ToolKey(QKeyEvent* event) {
  if (busy_ || !window_.HasChart() || event->key() == Qt::Key_Escape) return false;
  const auto modifiers = event->modifiers() & ~Qt::KeypadModifier;
  const bool enter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
  if (window_.TakesText()) {
    if (modifiers & (Qt::ControlModifier | Qt::AltModifier | Qt::MetaModifier)) return false;
    const QString typed = event->text();
    if (enter)
      Do([this] { window_.Type(13); });
    else if (event->key() == Qt::Key_Backspace)
      Do([this] { window_.Type(8); });
    else if (!typed.isEmpty())
      Do([&] {
        for (const char32_t c : typed.toStdU32String()) window_.Type(c);
      });
    return true;
  }
  if (modifiers & ~Qt::ShiftModifier) return false;
  // Without a tool they move the chart.
  if ((event->key() == Qt::Key_Home || event->key() == Qt::Key_End) && !window_.ToolOn())
    return false;
  const int far = modifiers & Qt::ShiftModifier ? 10 : 1;
  const auto move = [&](auto work) {
    work();
    ShowView();
    return true;
  };
  switch (event->key()) {
    case Qt::Key_Left: return move([&] { window_.MovePoint(-far); });
    case Qt::Key_Right: return move([&] { window_.MovePoint(far); });
    case Qt::Key_Up: return move([&] { window_.MovePoint(0, -far); });
    case Qt::Key_Down: return move([&] { window_.MovePoint(0, far); });
    case Qt::Key_Home: return move([&] { window_.PointToEnd(false); });
    case Qt::Key_End: return move([&] { window_.PointToEnd(true); });
    default: break;
  }
  if (!enter || !window_.ToolOn()) return false;
  Do([this] { window_.ClickPoint(); });
  return true;
}

void Chts::CloseWindow() {
  if (busy_) return;
  Do([this] { window_.CancelChartTools(); });
  // Within the frame it is the subwindow that closes, and this form in it.
  if (auto* sub = qobject_cast<QMdiSubWindow*>(parentWidget()))
    sub->close();
  else
    close();
}

// A composition lets events run; the window has to outlive it.
void Chts::closeEvent(QCloseEvent* event) {
  if (busy_) {
    event->ignore();
    return;
  }
  QMainWindow::closeEvent(event);
  if (!event->isAccepted()) return;
  closed_ = true;
  if (s_.closed) s_.closed();
}

}  // namespace kora
