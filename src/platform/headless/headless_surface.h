#pragma once

#include "platform/surface.h"

namespace kora {

// A surface that draws nothing but keeps its state and measures text, for scripts composed
// without a window. Text widths are those of the standard metrics whatever the font.
class HeadlessSurface : public Surface {
 public:
  HeadlessSurface(double width, double height);

  double Width() const override { return width_; }
  double Height() const override { return height_; }
  void SetScale(double left, double top, double width, double height) override;
  double ScaleWidth() const override { return scaleWidth_; }
  double ScaleHeight() const override { return scaleHeight_; }
  void SetWidth(double width) override { width_ = width; }
  void Cls() override;
  void SetBackColour(Colour) override {}
  void SetForeColour(Colour) override {}
  void SetDrawStyle(DrawStyle) override {}
  void SetDrawWidth(double) override {}
  void SetDrawMode(DrawMode) override {}
  void Line(double, double, double, double, Colour) override {}
  void Box(double, double, double, double, Colour) override {}
  void FilledBox(double, double, double, double, Colour) override {}
  void PSet(double, double, Colour) override {}
  void SetFont(const SurfaceFont& font) override { font_ = font; }
  const SurfaceFont& Font() const override { return font_; }
  double TextWidth(std::string_view text) const override;
  double TextHeight() const override;
  void SetCurrent(double x, double y) override;
  double CurrentX() const override { return x_; }
  double CurrentY() const override { return y_; }
  void Print(std::string_view text) override;
  void SetAutoRedraw(bool) override {}
  void SetVisible(bool visible) override { visible_ = visible; }
  bool Visible() const override { return visible_; }

 private:
  double width_, height_, scaleWidth_, scaleHeight_;
  double x_ = 0, y_ = 0;
  SurfaceFont font_;
  bool visible_ = true;
};

}  // namespace kora
