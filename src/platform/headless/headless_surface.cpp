#include "platform/headless/headless_surface.h"

#include "base/numbers.h"
#include "platform/text_metrics.h"

namespace kora {

HeadlessSurface::HeadlessSurface(double width, double height)
    : width_(width), height_(height), scaleWidth_(width), scaleHeight_(height) {}

void HeadlessSurface::SetScale(double, double, double width, double height) {
  scaleWidth_ = width;
  scaleHeight_ = height;
}

void HeadlessSurface::Cls() { x_ = y_ = 0; }

double HeadlessSurface::TextWidth(std::string_view text) const {
  return RoundHalfEven(StandardTextWidth(text, font_));
}

double HeadlessSurface::TextHeight() const { return StandardTextHeight(font_); }

void HeadlessSurface::SetCurrent(double x, double y) {
  x_ = x;
  y_ = y;
}

void HeadlessSurface::Print(std::string_view) {
  x_ = 0;
  y_ += TextHeight();
}

}  // namespace kora
