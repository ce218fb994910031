#pragma once

#include <QFont>
#include <QImage>
#include <QPainter>
#include <QStaticText>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/surface.h"

namespace kora {

// What every surface that Qt draws has in common: state, the user scale, fonts and text sizes.
//
// Texts of the standard face measure by the standard metrics, so that a chart has the same
// places here and without a window; other faces measure as Qt measures them. A face that the
// machine lacks is shown in the standard one. Error 380 for a name that can't be one (over 200
// bytes, control characters) and for a size outside 1 to 2,048 points.
//
// Needs a QGuiApplication.
class QtSurface : public Surface {
 public:
  ~QtSurface() override;
  double Width() const override { return width_; }
  double Height() const override { return height_; }
  void SetScale(double left, double top, double width, double height) override;
  double ScaleWidth() const override { return scaleWidth_; }
  double ScaleHeight() const override { return scaleHeight_; }
  void SetBackColour(Colour colour) override { back_ = Rgb(colour); }
  void SetForeColour(Colour colour) override { fore_ = Rgb(colour); }
  void SetDrawStyle(DrawStyle style) override { style_ = style; }
  void SetDrawWidth(double width) override { drawWidth_ = width > 1 ? width : 1; }
  void SetDrawMode(DrawMode mode) override { mode_ = mode; }
  void SetFont(const SurfaceFont& font) override;
  const SurfaceFont& Font() const override { return font_; }
  double TextWidth(std::string_view text) const override;
  double TextHeight() const override;
  void SetCurrent(double x, double y) override;
  double CurrentX() const override { return x_; }
  double CurrentY() const override { return y_; }
  void Print(std::string_view text) override;
  void SetAutoRedraw(bool keep) override { autoRedraw_ = keep; }
  bool AutoRedraw() const { return autoRedraw_; }
  void SetVisible(bool visible) override { visible_ = visible; }
  bool Visible() const override { return visible_; }

  static QRgb Rgb(Colour colour) {
    return qRgb(colour & 0xFF, (colour >> 8) & 0xFF, (colour >> 16) & 0xFF);
  }

 protected:
  // A font made ready, with the texts that were lately set in it.
  struct Face {
    SurfaceFont key;
    QFont font;
    bool standard = true;
    double ascent = 0;  // of the line; `qtAscent` is what Qt hangs the text from
    double qtAscent = 0;
    double height = 0;
    std::unordered_map<std::string, QStaticText> texts;
  };

  QtSurface(double width, double height);
  void ResetScale();

  double UnitX(double x) const { return (x - left_) * factorX_; }
  double UnitY(double y) const { return (y - top_) * factorY_; }
  // Lengths of the pen's dashes and gaps, units; `on` 0 for a solid pen.
  struct Dashes {
    double on, period;
  };
  Dashes Pattern() const;

  // `x`, `y`: upper left corner of the text in units.
  virtual void DrawText(Face& face, double x, double y, const std::string& text) = 0;
  Face& face() const;

  double width_, height_;
  QRgb back_ = qRgb(255, 255, 255);
  QRgb fore_ = qRgb(0, 0, 0);
  DrawStyle style_ = DrawStyle::kSolid;
  DrawMode mode_ = DrawMode::kCopy;
  double drawWidth_ = 1;
  double x_ = 0, y_ = 0;

 private:
  double left_ = 0, top_ = 0, scaleWidth_, scaleHeight_, factorX_ = 1, factorY_ = 1;
  SurfaceFont font_;
  mutable std::vector<std::unique_ptr<Face>> faces_;
  mutable Face* face_ = nullptr;
  bool autoRedraw_ = false;
  bool visible_ = true;
};

// A picture in memory at any number of device pixels to the unit.
//
// Lines along an axis, boxes and points are whole device pixels, never blended; sloped lines
// are smooth. Under the XOR pen nothing is blended, each pixel is touched once a call, and the
// same call again brings back what was there.
class QtRasterSurface : public QtSurface {
 public:
  // Sizes in units, at least 1; at most 20,000 pixels a side are kept.
  QtRasterSurface(double width, double height, double dpr = 1);
  ~QtRasterSurface() override;

  // The picture so far. Good until the next call that draws or resizes.
  const QImage& image() const;
  double DevicePixelRatio() const { return dpr_; }
  // A new size; the user scale goes back to it and the picture to the background.
  void Resize(double width, double height, double dpr);

  void SetWidth(double width) override;
  void Cls() override;
  void Line(double x1, double y1, double x2, double y2, Colour colour) override;
  void Box(double x1, double y1, double x2, double y2, Colour colour) override;
  void FilledBox(double x1, double y1, double x2, double y2, Colour colour) override;
  void PSet(double x, double y, Colour colour) override;

 private:
  void Allocate();
  int Edge(double unit) const;       // device pixel where a unit begins
  int EdgeAfter(double unit) const;  // and the one behind it
  int Thickness() const;
  void Fill(int left, int top, int right, int bottom, QRgb colour);
  void AxisLine(bool horizontal, double from, double to, double at, QRgb colour);
  void SlopedLine(double x1, double y1, double x2, double y2, QRgb colour);
  void DrawText(Face& face, double x, double y, const std::string& text) override;

  double dpr_;
  int pixelsX_ = 0, pixelsY_ = 0;
  std::vector<QRgb> pixels_;
  QImage image_;  // over pixels_
  mutable QPainter painter_;
};

// A rectangle of whatever a QPainter draws on: SVG, PDF, paper. One unit of the painter is one
// chart unit. Several surfaces may share a painter. There is no XOR on such media: the pen
// copies.
class QtPainterSurface : public QtSurface {
 public:
  // `painter` is not owned and must be active. `x`, `y`: upper left corner of the surface.
  QtPainterSurface(QPainter& painter, double x, double y, double width, double height);

  void SetWidth(double width) override;
  void Cls() override;
  void Line(double x1, double y1, double x2, double y2, Colour colour) override;
  void Box(double x1, double y1, double x2, double y2, Colour colour) override;
  void FilledBox(double x1, double y1, double x2, double y2, Colour colour) override;
  void PSet(double x, double y, Colour colour) override;

 private:
  void FillUnits(double left, double top, double right, double bottom, QRgb colour);
  void DrawText(Face& face, double x, double y, const std::string& text) override;

  QPainter& painter_;
  double originX_, originY_;
};

}  // namespace kora
