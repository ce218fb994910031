#include "chart/forms/sheet_view.h"

#include <QDialog>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <algorithm>

#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr double kPartOfSize = 1.0 / 3;
constexpr double kKeyStep = kTwipsPerInch / 25.4;  // a millimetre

}  // namespace

SheetView::SheetView(QWidget* parent) : QWidget(parent) {
  QSizePolicy policy(QSizePolicy::Expanding, QSizePolicy::Expanding);
  setSizePolicy(policy);
}

void SheetView::SetSheet(const Sheet& sheet) {
  sheet_ = sheet;
  picture_ = {};
  updateGeometry();
  update();
}

void SheetView::SetBox(const QRectF& box) {
  if (box.size() != box_.size()) picture_ = {};
  box_ = box;
  update();
}

void SheetView::SetContent(std::function<void(QPainter&)> content) {
  content_ = std::move(content);
  picture_ = {};
  update();
}

void SheetView::SetDropped(std::function<void(QPointF)> dropped) {
  dropped_ = std::move(dropped);
  setFocusPolicy(dropped_ ? Qt::StrongFocus : Qt::NoFocus);
}

QSize SheetView::sizeHint() const {
  // Room for the sheet either way round.
  const double unit = logicalDpiX() / kTwipsPerInch * kPartOfSize;
  const int side = int(std::max(sheet_.width, sheet_.height) * unit) + 2;
  return {side, side};
}

QSize SheetView::minimumSizeHint() const { return sizeHint() / 2; }

double SheetView::Scale() const {
  if (sheet_.width <= 0 || sheet_.height <= 0) return 1;
  return std::min((width() - 2) / sheet_.width, (height() - 2) / sheet_.height);
}

QPointF SheetView::Corner() const {
  const double scale = Scale();
  return {(width() - sheet_.width * scale) / 2, (height() - sheet_.height * scale) / 2};
}

QPointF SheetView::ToView(QPointF place) const {
  return Corner() + (place + QPointF(sheet_.left, sheet_.top)) * Scale();
}

QRectF SheetView::Shown() const { return grip_ ? box_.translated(drag_) : box_; }

void SheetView::paintEvent(QPaintEvent*) {
  const double scale = Scale();
  QPainter painter(this);
  const QRectF paper(Corner(), QSizeF(sheet_.width, sheet_.height) * scale);
  painter.fillRect(paper, Qt::white);
  painter.setPen(QPen(Qt::darkGray, 0));
  painter.drawRect(paper);
  painter.setPen(QPen(Qt::lightGray, 0, Qt::DotLine));
  painter.drawRect(QRectF(ToView({0, 0}), ToView({sheet_.reachWidth, sheet_.reachHeight})));

  const QRectF shown = Shown();
  const QRectF box(ToView(shown.topLeft()), ToView(shown.bottomRight()));
  if (content_ && picture_.isNull() && !box.isEmpty()) {
    // At twice the pixels, and made smaller: thin lines of paper would else be lost.
    const double fine = devicePixelRatioF() * 2;
    const QSize size = (box.size() * fine).toSize().expandedTo({1, 1}).boundedTo({8000, 8000});
    QImage image(size, QImage::Format_RGB32);
    image.fill(Qt::white);
    QPainter inside(&image);
    inside.setRenderHint(QPainter::Antialiasing);
    inside.scale(scale * fine, scale * fine);
    content_(inside);
    inside.end();
    picture_ =
        QPixmap::fromImage(image.scaled(size / 2, Qt::IgnoreAspectRatio, Qt::SmoothTransformation));
  }
  if (!picture_.isNull()) painter.drawPixmap(box, picture_, QRectF(picture_.rect()));
  painter.setPen(QPen(hasFocus() ? palette().color(QPalette::Highlight) : QColor(Qt::blue), 0));
  painter.drawRect(box);
}

void SheetView::mousePressEvent(QMouseEvent* event) {
  const QRectF box(ToView(box_.topLeft()), ToView(box_.bottomRight()));
  if (!dropped_ || event->button() != Qt::LeftButton || !box.contains(event->position())) return;
  grip_ = event->position();
  drag_ = {};
  setCursor(Qt::ClosedHandCursor);
}

void SheetView::mouseMoveEvent(QMouseEvent* event) {
  if (!grip_) return;
  drag_ = (event->position() - *grip_) / Scale();
  update();
}

void SheetView::mouseReleaseEvent(QMouseEvent* event) {
  if (!grip_ || event->button() != Qt::LeftButton) return;
  drag_ = (event->position() - *grip_) / Scale();
  const QRectF shown = Shown();
  grip_.reset();
  unsetCursor();
  if (drag_ != QPointF()) dropped_(shown.topLeft());
  update();
}

void SheetView::keyPressEvent(QKeyEvent* event) {
  QPointF step;
  switch (event->key()) {
    case Qt::Key_Left: step = {-kKeyStep, 0}; break;
    case Qt::Key_Right: step = {kKeyStep, 0}; break;
    case Qt::Key_Up: step = {0, -kKeyStep}; break;
    case Qt::Key_Down: step = {0, kKeyStep}; break;
    default: return QWidget::keyPressEvent(event);
  }
  if (dropped_) dropped_(box_.topLeft() + step);
}

void LayOutPageForm(QDialog* form, SheetView* sheet, QLayout* side, std::function<void()> ok) {
  auto* row = new QHBoxLayout;
  row->addWidget(sheet, 1);
  row->addLayout(side);
  auto* buttons = new ButtonRow(form);
  buttons->AddOkCancel(std::move(ok));
  auto* column = new QVBoxLayout(form);
  column->addLayout(row, 1);
  column->addLayout(buttons);
}

}  // namespace kora
