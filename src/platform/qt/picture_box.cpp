#include "platform/qt/picture_box.h"

#include <QPainter>
#include <QTimer>

namespace kora {

PictureBox::PictureBox(QWidget* parent) : QWidget(parent), surface_(640, 454) {
  setAttribute(Qt::WA_OpaquePaintEvent);
  setFocusPolicy(Qt::StrongFocus);
}

QSize PictureBox::minimumSizeHint() const { return {160, 100}; }
QSize PictureBox::sizeHint() const { return {640, 454}; }

// A surface of the right size keeps its picture.
void PictureBox::Fit() {
  if (surface_.Width() == width() && surface_.Height() == height() &&
      surface_.DevicePixelRatio() == devicePixelRatioF())
    return;
  surface_.Resize(width(), height(), devicePixelRatioF());
  if (Resized) Resized();
}

void PictureBox::Place(const QRect& place) {
  setGeometry(place);
  Fit();
}

void PictureBox::resizeEvent(QResizeEvent*) { Fit(); }

void PictureBox::paintEvent(QPaintEvent*) {
  QPainter painter(this);
  painter.drawImage(QPointF(0, 0), surface_.image());
  // On a screen of another scale the picture is made anew, outside of this paint.
  if (surface_.DevicePixelRatio() != devicePixelRatioF())
    QTimer::singleShot(0, this, [this] {
      Fit();
      update();
    });
}

}  // namespace kora
