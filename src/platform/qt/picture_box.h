#pragma once

#include <QWidget>
#include <functional>

#include "platform/qt/qt_surface.h"

namespace kora {

// A widget that shows a raster surface of its own size, at the screen's own pixels.
class PictureBox : public QWidget {
 public:
  explicit PictureBox(QWidget* parent = nullptr);

  QtRasterSurface& surface() { return surface_; }
  // Moves and sizes the widget, its surface with it at once, shown or not.
  void Place(const QRect& place);

  // Called when the surface has taken a new size; it is blank then.
  std::function<void()> Resized;

  QSize minimumSizeHint() const override;
  QSize sizeHint() const override;

 protected:
  void paintEvent(QPaintEvent* event) override;
  void resizeEvent(QResizeEvent* event) override;

 private:
  void Fit();

  QtRasterSurface surface_;
};

}  // namespace kora
