#include "platform/surface_part.h"

namespace kora {

void SurfacePart::SetScale(double left, double top, double width, double height) {
  left_ = left;
  top_ = top;
  scaleWidth_ = width;
  scaleHeight_ = height;
}

void SurfacePart::Cls() {
  whole_.FilledBox(0, y_, Width() - 1, y_ + height_ - 1, back_);
  whole_.SetCurrent(0, y_);
}

void SurfacePart::Line(double x1, double y1, double x2, double y2, Colour colour) {
  whole_.Line(X(x1), Y(y1), X(x2), Y(y2), colour);
}

void SurfacePart::Box(double x1, double y1, double x2, double y2, Colour colour) {
  whole_.Box(X(x1), Y(y1), X(x2), Y(y2), colour);
}

void SurfacePart::FilledBox(double x1, double y1, double x2, double y2, Colour colour) {
  whole_.FilledBox(X(x1), Y(y1), X(x2), Y(y2), colour);
}

void SurfacePart::PSet(double x, double y, Colour colour) { whole_.PSet(X(x), Y(y), colour); }

}  // namespace kora
