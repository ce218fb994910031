#pragma once

#include "platform/surface.h"

namespace kora {

// A strip of another surface, over its whole width, as a surface of its own: panels that are
// stacked in one picture. What is drawn beyond its edges is not cut off.
//
// The owner's scale is its size. Pen, font and colours are the owner's: one strip is drawn on at
// a time.
class SurfacePart : public Surface {
 public:
  // `top`, `height`: in units of `whole`, which is not owned.
  SurfacePart(Surface& whole, double top, double height)
      : whole_(whole), y_(top), height_(height), scaleWidth_(whole.Width()), scaleHeight_(height) {}

  double Width() const override { return whole_.Width(); }
  double Height() const override { return height_; }
  void SetScale(double left, double top, double width, double height) override;
  double ScaleWidth() const override { return scaleWidth_; }
  double ScaleHeight() const override { return scaleHeight_; }
  // Its width is the owner's.
  void SetWidth(double) override {}

  void Cls() override;
  void SetBackColour(Colour colour) override { back_ = colour; }
  void SetForeColour(Colour colour) override { whole_.SetForeColour(colour); }
  void SetDrawStyle(DrawStyle style) override { whole_.SetDrawStyle(style); }
  void SetDrawWidth(double width) override { whole_.SetDrawWidth(width); }
  void SetDrawMode(DrawMode mode) override { whole_.SetDrawMode(mode); }

  void Line(double x1, double y1, double x2, double y2, Colour colour) override;
  void Box(double x1, double y1, double x2, double y2, Colour colour) override;
  void FilledBox(double x1, double y1, double x2, double y2, Colour colour) override;
  void PSet(double x, double y, Colour colour) override;

  void SetFont(const SurfaceFont& font) override { whole_.SetFont(font); }
  const SurfaceFont& Font() const override { return whole_.Font(); }
  double TextWidth(std::string_view text) const override { return whole_.TextWidth(text); }
  double TextHeight() const override { return whole_.TextHeight(); }
  void SetCurrent(double x, double y) override { whole_.SetCurrent(X(x), Y(y)); }
  double CurrentX() const override { return left_ + whole_.CurrentX() * scaleWidth_ / Width(); }
  double CurrentY() const override {
    return top_ + (whole_.CurrentY() - y_) * scaleHeight_ / height_;
  }
  void Print(std::string_view text) override { whole_.Print(text); }

  void SetAutoRedraw(bool keep) override { whole_.SetAutoRedraw(keep); }
  void SetVisible(bool visible) override { visible_ = visible; }
  bool Visible() const override { return visible_; }

 private:
  double X(double x) const { return (x - left_) * Width() / scaleWidth_; }
  double Y(double y) const { return y_ + (y - top_) * height_ / scaleHeight_; }

  Surface& whole_;
  double y_, height_;
  double left_ = 0, top_ = 0, scaleWidth_, scaleHeight_;
  Colour back_ = 0;
  bool visible_ = true;
};

}  // namespace kora
