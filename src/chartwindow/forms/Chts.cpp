#include "chartwindow/forms/Chts.h"

#include <QCloseEvent>
#include <QKeyEvent>

namespace kora {
namespace {

PictureBox* MakePicture(QWidget* parent) {
  auto* picture = new PictureBox(parent);
  picture->setObjectName("Picture1");
  picture->setAccessibleName("Chart");
  return picture;
}

}  // namespace

Chts::Chts(const ChtsServices& s, QWidget* parent)
    : QMainWindow(parent),
      picture_(MakePicture(this)),
      window_({.files = s.files,
               .dialogs = s.dialogs,
               .settings = s.settings,
               .colours = s.colours,
               .current = s.current,
               .price = picture_->surface()}),
      colours_(s.colours) {
  setObjectName("Chts");
  setAttribute(Qt::WA_DeleteOnClose);
  setCentralWidget(picture_);
  setFocusProxy(picture_);
  RefreshTitle();
  picture_->Resized = [this] { SurfaceResized(); };
  picture_->surface().SetBackColour(colours_[kBackground]);
  picture_->surface().Cls();
  // A drag of the frame is many sizes: the chart is composed for the last one that waits.
  redraw_.setSingleShot(true);
  redraw_.setInterval(0);
  redraw_.callOnTimeout(this, [this] {
    if (composing_ || window_.ChartIndex == 0) return;
    composing_ = true;
    window_.Redraw();
    composing_ = false;
    picture_->update();
  });
}

void Chts::RefreshTitle() { setWindowTitle(QString::fromStdString(window_.Title())); }

void Chts::Start() {
  window_.Loading = false;
  if (window_.ChartIndex == 0) Step(1);
}

void Chts::Step(int direction) {
  // A message of the chart before may still stand.
  if (composing_) return;
  composing_ = true;
  window_.ChartDirection = std::int16_t(direction);
  if (window_.ChartIndex == 0) window_.NextChart();
  else window_.StepChart();
  composing_ = false;
  redraw_.stop();
  picture_->update();
}

void Chts::SurfaceResized() {
  picture_->surface().SetBackColour(colours_[kBackground]);
  picture_->surface().Cls();
  // A chart that could not be drawn would only say so again at every size.
  if (!window_.Loading && window_.Chart.ChartDrawn) redraw_.start();
}

void Chts::keyPressEvent(QKeyEvent* event) {
  if (event->key() == Qt::Key_PageDown) Step(1);
  else if (event->key() == Qt::Key_PageUp) Step(0);
  else QMainWindow::keyPressEvent(event);
}

// A composition lets events run; the window has to outlive it.
void Chts::closeEvent(QCloseEvent* event) {
  if (composing_) event->ignore();
  else QMainWindow::closeEvent(event);
}

}  // namespace kora
