#include "chartwindow/tools/band.h"

namespace kora {

void Band::Draw(const std::vector<Shape>& shapes) {
  Flip();
  shapes_ = shapes;
  Flip();
}

void Band::Erase() {
  Flip();
  shapes_.clear();
}

void Band::Flip() const {
  for (const Shape& shape : shapes_) {
    Surface& surface = *shape.surface;
    surface.SetDrawMode(DrawMode::kXor);
    surface.SetDrawStyle(style_);
    if (shape.box)
      surface.Box(shape.x1, shape.y1, shape.x2, shape.y2, colour_);
    else
      surface.Line(shape.x1, shape.y1, shape.x2, shape.y2, colour_);
    surface.SetDrawStyle(DrawStyle::kSolid);
    surface.SetDrawMode(DrawMode::kCopy);
    if (!Touched) continue;
    if (!shape.box) {
      Touched(surface, shape.x1, shape.y1, shape.x2, shape.y2);
      continue;
    }
    Touched(surface, shape.x1, shape.y1, shape.x2, shape.y1);
    Touched(surface, shape.x1, shape.y2, shape.x2, shape.y2);
    Touched(surface, shape.x1, shape.y1, shape.x1, shape.y2);
    Touched(surface, shape.x2, shape.y1, shape.x2, shape.y2);
  }
}

}  // namespace kora
