#pragma once

#include <QWidget>
#include <functional>
#include <optional>

#include "platform/printer.h"

class QDialog;
class QLayout;

namespace kora {

// A sheet of paper in small, at one third of its size or what the form has room for, with a box
// on it that can be dragged, and moved by the arrow keys. Places are twips from the upper left
// corner of the part of the sheet that the printer reaches.
class SheetView : public QWidget {
 public:
  explicit SheetView(QWidget* parent);

  void SetSheet(const Sheet& sheet);
  void SetBox(const QRectF& box);
  QRectF Box() const { return box_; }
  // What stands in the box: paints a chart whose upper left corner is the painter's origin, one
  // unit a twip. Empty: an empty box.
  void SetContent(std::function<void(QPainter&)> content);
  // Called with where the box was dropped; without it the box stays where it is.
  void SetDropped(std::function<void(QPointF)> dropped);

  // Where a place on the sheet shows.
  QPointF ToView(QPointF place) const;

  QSize sizeHint() const override;
  QSize minimumSizeHint() const override;

 protected:
  void paintEvent(QPaintEvent* event) override;
  void mousePressEvent(QMouseEvent* event) override;
  void mouseMoveEvent(QMouseEvent* event) override;
  void mouseReleaseEvent(QMouseEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;

 private:
  double Scale() const;  // view units to the twip
  QPointF Corner() const;
  QRectF Shown() const;  // the box as it is being dragged

  Sheet sheet_;
  QRectF box_;
  std::function<void(QPainter&)> content_;
  std::function<void(QPointF)> dropped_;
  std::optional<QPointF> grip_;  // where the box was taken hold of
  QPointF drag_;
  QPixmap picture_;  // of the content
};

// Lays a page form out: the sheet, `side` beside it, and OK and Cancel below.
void LayOutPageForm(QDialog* form, SheetView* sheet, QLayout* side, std::function<void()> ok);

}  // namespace kora
