#include "chartwindow/forms/Anal.h"

#include <QAction>
#include <QCloseEvent>
#include <QKeyEvent>
#include <QLabel>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QMouseEvent>
#include <QPointer>
#include <QPushButton>
#include <QScrollArea>
#include <QScrollBar>
#include <QStatusBar>
#include <cmath>

#include "base/runtime_error.h"
#include "base/text.h"
#include "chartwindow/tools/read_out.h"
#include "platform/qt/to_qt.h"

namespace kora {
namespace {

constexpr size_t kReadOuts = 6;

// The page: its size changes with the window, the pictures stand on it by the view's rules.
class Scroller : public QScrollArea {
 public:
  Scroller(QWidget* parent, QTimer& resized) : QScrollArea(parent), resized_(resized) {
    setObjectName("ScrollArea");
    setFrameShape(QFrame::NoFrame);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setFocusPolicy(Qt::NoFocus);
  }

 protected:
  void resizeEvent(QResizeEvent* event) override {
    QScrollArea::resizeEvent(event);
    resized_.start();
  }

 private:
  QTimer& resized_;
};

}  // namespace

Anal::Anal(const AnalServices& services, int set, QWidget* parent)
    : QMainWindow(parent), s_(services), view_(services.view, set) {
  setObjectName("Anal");
  setAttribute(Qt::WA_DeleteOnClose);
  setContextMenuPolicy(Qt::NoContextMenu);
  // A drag of the frame is many sizes: the view is drawn for the last one that waits.
  resized_.setSingleShot(true);
  resized_.setInterval(0);
  resized_.callOnTimeout(this, [this] {
    if (view_.Drawn() || panels_ > 0) Draw();
  });
  scroll_ = new Scroller(this, resized_);
  page_ = new QWidget;
  page_->setObjectName("Page");
  picture1_ = new PictureBox(page_);
  picture1_->setObjectName("Picture1");
  for (size_t i = 0; i < picture2_.size(); ++i) {
    picture2_[i] = new PictureBox(page_);
    picture2_[i]->setObjectName(QString("Picture2(%1)").arg(i));
    picture2_[i]->setFocusPolicy(Qt::NoFocus);
    picture2_[i]->hide();
  }
  for (QObject* picture : std::initializer_list<QObject*>{picture1_, picture2_[0], picture2_[1],
                                                          picture2_[2], picture2_[3]}) {
    static_cast<QWidget*>(picture)->setMouseTracking(true);
    picture->installEventFilter(this);
  }
  scroll_->setWidget(page_);
  QPalette ground;
  ground.setColor(QPalette::Window,
                  QColor::fromRgb(QtSurface::Rgb(services.view.colours[kBackground])));
  scroll_->setPalette(ground);
  setCentralWidget(scroll_);
  setFocusProxy(picture1_);
  BuildMenu();
  for (size_t i = 0; i < kReadOuts; ++i) {
    auto* label = new QLabel(this);
    label->setObjectName(QString("StatusBar1(%1)").arg(i + 1));
    statusBar()->addWidget(label, 1);
    status_.push_back(label);
  }
  statusBar()->setSizeGripEnabled(false);
  ShowCaptions();
}

Anal::~Anal() = default;

void Anal::BuildMenu() {
  const auto entry = [this](const char* name, const char* caption, QKeySequence key, auto deed) {
    QAction* action = menuBar()->addAction(caption);
    action->setObjectName(name);
    if (!key.isEmpty()) action->setShortcut(key);
    connect(action, &QAction::triggered, this, [this, deed] { (this->*deed)(); });
    return action;
  };
  amRet_ = entry("amRet", "&Return to Chart", Qt::Key_Escape, &Anal::Leave);
  ampnt_ = menuBar()->addAction("&Print");
  ampnt_->setObjectName("ampnt");
  ampnt_->setShortcut(QKeySequence::Print);
  connect(ampnt_, &QAction::triggered, this, [this] {
    if (view_.Drawn() && s_.print) s_.print();
  });
  amSAn2_ = entry("amSAn2", "", Qt::Key_F6, &Anal::Swap);
  amGrid_ = entry("amGrid", "&Grid", Qt::Key_F7, &Anal::ToggleGrid);
  amGrid_->setCheckable(true);
  command2_ = new QPushButton("&Show", this);
  command2_->setObjectName("Command2");
  command2_->setShortcut(Qt::Key_F5);
  command2_->setFocusPolicy(Qt::TabFocus);
  command2_->setToolTip("Draws the view afresh (F5)");
  connect(command2_, &QPushButton::clicked, this, [this] { Command2(); });
  menuBar()->setCornerWidget(command2_);
}

void Anal::ShowCaptions() {
  setWindowTitle(ToQt(view_.Caption()));
  amSAn2_->setText(ToQt(view_.SwapCaption()));
  ampnt_->setEnabled(bool(s_.print));
}

// ---- Drawing

void Anal::Command2() {
  if (busy_) return;
  panels_ = PanelCount(view_.Names());
  if (panels_ > 0) {
    Draw();
    return;
  }
  const QPointer<Anal> alive(this);
  s_.view.dialogs.Message(kNoMultiOsc, view_.Caption());
  if (!alive) return;
  const auto open = s_.openMultiOsc;
  Leave();
  if (open) open();
}

void Anal::Draw() {
  if (busy_) return;
  busy_ = true;
  // The grid goes with the pictures.
  gridColumn_ = -1;
  for (QLabel* label : status_) label->clear();
  const MultiPage page =
      LayOutMultiPage(scroll_->viewport()->width(), scroll_->viewport()->height(), panels_);
  page_->resize(int(page.width), int(std::ceil(page.Height(panels_))));
  picture1_->Place(QRect(0, 0, int(page.width), int(page.price)));
  std::vector<Surface*> panels;
  for (size_t i = 0; i < picture2_.size(); ++i) {
    PictureBox* picture = picture2_[i];
    const bool shown = int(i) < panels_;
    picture->setVisible(shown);
    if (!shown) continue;
    const int top = int(std::lround(page.price + double(i) * page.panel));
    const int end = int(std::lround(page.price + double(i + 1) * page.panel));
    picture->Place(QRect(0, top, int(page.width), end - top));
    panels.push_back(&picture->surface());
  }
  try {
    view_.Draw(picture1_->surface(), panels);
  } catch (const RunTimeError& e) {
    s_.view.dialogs.SetBusy(false);
    s_.view.dialogs.Message(e.what(), "Chart Display");
  }
  ShowCaptions();
  NamePictures();
  page_->update();
  busy_ = false;
}

// What a screen reader says of each picture.
void Anal::NamePictures() {
  const ChartBars& bars = view_.Chart.Bars;
  QString text = ToQt("Chart " + FromAnsi(view_.Request.Name.Code.trimmed()));
  if (view_.Drawn() && size_t(bars.BarCount) < bars.bars.size())
    text += ToQt(", last close " + Str(bars[size_t(bars.BarCount)].Close));
  picture1_->setAccessibleName(text);
  size_t place = 0;
  for (const std::string& name : view_.Names())
    if (name != kNoOscillator && place < picture2_.size())
      picture2_[place++]->setAccessibleName(ToQt(name));
}

ChartSize Anal::Size() const {
  const double price = picture1_->surface().ScaleHeight();
  // As the script has it: panels with 3 units between their frames.
  const double panel = panels_ > 0 ? MultiOscPanelHeight(price, panels_) : 0;
  return {picture1_->surface().ScaleWidth(), price + panels_ * std::max(panel, 0.98 * panel + 3)};
}

void Anal::ShowSet(int set) {
  if (view_.MultiOscSet() != set) view_.Swap();
  ShowCaptions();
  Command2();
}

void Anal::Swap() {
  if (busy_) return;
  view_.Swap();
  ShowCaptions();
  Command2();
}

// ---- The grid

void Anal::ToggleGrid() {
  if (busy_) return;
  if (!amGrid_->isChecked())
    MoveGrid(-1);
  else
    MoveGrid(view_.Chart.Bars.BarCount);
}

void Anal::FlipGrid() {
  if (gridColumn_ < 0) return;
  const double x = XOfColumn(view_.Chart, gridColumn_);
  const auto flip = [&](PictureBox* picture, double top, double bottom) {
    QtRasterSurface& surface = picture->surface();
    surface.SetDrawMode(DrawMode::kXor);
    surface.SetDrawStyle(DrawStyle::kSolid);
    surface.SetDrawWidth(1);
    surface.Line(x, top, x, bottom, s_.view.colours[kMovingGrid]);
    surface.SetDrawMode(DrawMode::kCopy);
    picture->update(QRect(int(x) - 2, 0, 5, picture->height()));
  };
  flip(picture1_, view_.Chart.ChartTop, view_.Chart.VolBottom);
  for (PictureBox* picture : picture2_)
    if (picture->isVisibleTo(page_)) flip(picture, 0, picture->surface().ScaleHeight() - 1);
}

void Anal::MoveGrid(std::int32_t column) {
  const Composition& chart = view_.Chart;
  if (!view_.Drawn()) column = -1;
  if (column > chart.Bars.BarCount) column = chart.Bars.BarCount;
  FlipGrid();
  gridColumn_ = column;
  FlipGrid();
  if (column < 0) {
    for (QLabel* label : status_) label->clear();
  } else if (const auto texts = BarReadout(chart, view_.Request.Name.RecType, column)) {
    for (size_t i = 0; i < texts->size(); ++i) status_[i]->setText(ToQt((*texts)[i]));
  }
}

bool Anal::eventFilter(QObject* object, QEvent* event) {
  if (event->type() == QEvent::MouseMove && amGrid_->isChecked() && !busy_) {
    const double x = static_cast<QMouseEvent*>(event)->position().x();
    MoveGrid(std::max<std::int32_t>(ColumnOf(view_.Chart, std::floor(x)), 0));
  }
  return QMainWindow::eventFilter(object, event);
}

void Anal::keyPressEvent(QKeyEvent* event) {
  QScrollBar* bar = scroll_->verticalScrollBar();
  const auto step = [&](std::int32_t by) {
    if (busy_) return;
    if (!amGrid_->isChecked()) {
      amGrid_->setChecked(true);
      MoveGrid(view_.Chart.Bars.BarCount);
    } else {
      MoveGrid(std::max<std::int32_t>(gridColumn_ + by, 0));
    }
  };
  switch (event->key()) {
    case Qt::Key_Left: return step(-1);
    case Qt::Key_Right: return step(1);
    case Qt::Key_Up: return bar->triggerAction(QAbstractSlider::SliderSingleStepSub);
    case Qt::Key_Down: return bar->triggerAction(QAbstractSlider::SliderSingleStepAdd);
    case Qt::Key_PageUp: return bar->triggerAction(QAbstractSlider::SliderPageStepSub);
    case Qt::Key_PageDown: return bar->triggerAction(QAbstractSlider::SliderPageStepAdd);
    default: QMainWindow::keyPressEvent(event);
  }
}

// ---- Leaving

void Anal::Leave() {
  if (busy_) return;
  // Within the frame it is the subwindow that closes, and this form in it.
  if (auto* sub = qobject_cast<QMdiSubWindow*>(parentWidget()))
    sub->close();
  else
    close();
}

// A drawing lets events run; the form has to outlive it.
void Anal::closeEvent(QCloseEvent* event) {
  if (busy_) {
    event->ignore();
    return;
  }
  QMainWindow::closeEvent(event);
  if (event->isAccepted() && s_.returned) s_.returned();
}

}  // namespace kora
