#include "platform/qt/picture_box.h"

#include <QPaintEvent>
#include <QPainter>
#include <QTimer>
#include <cmath>

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

void PictureBox::paintEvent(QPaintEvent* event) {
  QPainter painter(this);
  const QImage& image = surface_.image();
  const double dpr = surface_.DevicePixelRatio();
  // Piece by piece where units are whole pixels: a cross hair touches a few of them, and the
  // painter would go over the whole picture for it.
  if (dpr == std::floor(dpr)) {
    for (const QRect& part : event->region())
      painter.drawImage(
          QRectF(part), image,
          QRectF(part.x() * dpr, part.y() * dpr, part.width() * dpr, part.height() * dpr));
  } else {
    painter.drawImage(QPointF(0, 0), image);
  }
  // On a screen of another scale the picture is made anew, outside of this paint.
  if (surface_.DevicePixelRatio() != devicePixelRatioF())
    QTimer::singleShot(0, this, [this] {
      Fit();
      update();
    });
}

}  // namespace kora
