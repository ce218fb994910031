#pragma once

#include <functional>
#include <vector>

#include "platform/surface.h"

namespace kora {

// Where a picture changed: the corners of what was drawn. Only there it is shown anew.
using TouchedFn = std::function<void(const Surface&, double x1, double y1, double x2, double y2)>;

// Lines and boxes that stand on the pictures for a moment, drawn by XOR: drawn once more they
// are gone and the picture is as it was. What was drawn is remembered, so that it goes even
// after a recomposition has moved the chart.
class Band {
 public:
  struct Shape {
    Surface* surface;
    double x1, y1, x2, y2;
    bool box = false;
  };

  Band(DrawStyle style, Colour colour) : style_(style), colour_(colour) {}

  // Takes the standing shapes away and draws these.
  void Draw(const std::vector<Shape>& shapes);
  void Erase();
  // The pictures were painted afresh: there is nothing to take away.
  void Forget() { shapes_.clear(); }
  bool Drawn() const { return !shapes_.empty(); }
  // Takes the shapes away, or brings them back, without forgetting them.
  void Flip() const;

  TouchedFn Touched;  // called for each shape as it is drawn or taken away; may be empty

 private:
  DrawStyle style_;
  Colour colour_;
  std::vector<Shape> shapes_;
};

}  // namespace kora
