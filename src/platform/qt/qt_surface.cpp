#include "platform/qt/qt_surface.h"

#include <QFontMetricsF>
#include <algorithm>
#include <cmath>
#include <tuple>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "platform/qt/chart_font.h"
#include "platform/qt/line_cut.h"
#include "platform/qt/to_qt.h"
#include "platform/text_metrics.h"

namespace kora {
namespace {

constexpr double kUnitsPerInch = 96;
constexpr size_t kTextsKept = 512;
constexpr size_t kFacesKept = 64;  // a chart needs a handful; a hostile script names thousands
constexpr double kMostPixels = 20000;

bool Finite(double a, double b, double c, double d) {
  return std::isfinite(a) && std::isfinite(b) && std::isfinite(c) && std::isfinite(d);
}

// 96 dots to the inch, so that a point is 96/72 units.
void SetDots(QImage& image) {
  image.setDotsPerMeterX(3780);
  image.setDotsPerMeterY(3780);
}

}  // namespace

QtSurface::QtSurface(double width, double height)
    : width_(width), height_(height), scaleWidth_(width), scaleHeight_(height) {}

QtSurface::~QtSurface() = default;

void QtSurface::SetScale(double left, double top, double width, double height) {
  if (!Finite(left, top, width, height) || width == 0 || height == 0)
    throw RunTimeError(kInvalidValue);
  left_ = left;
  top_ = top;
  scaleWidth_ = width;
  scaleHeight_ = height;
  factorX_ = width_ / width;
  factorY_ = height_ / height;
}

void QtSurface::ResetScale() { SetScale(0, 0, width_, height_); }

QtSurface::Dashes QtSurface::Pattern() const {
  switch (style_) {
    case DrawStyle::kSolid: break;
    case DrawStyle::kDash: return {6, 10};
    case DrawStyle::kDot: return {1, 3};
  }
  return {0, 1};
}

void QtSurface::SetFont(const SurfaceFont& font) {
  if (!CanBeFace(font)) throw RunTimeError(kInvalidValue);
  if (font == font_) return;
  font_ = font;
  face_ = nullptr;
}

QtSurface::Face& QtSurface::face() const {
  if (face_) return *face_;
  for (const auto& made : faces_)
    if (made->key == font_) return *(face_ = made.get());

  auto made = std::make_unique<Face>();
  made->key = font_;
  ChartFont font = MakeChartFont(font_);
  made->standard = font.standard;
  made->font = std::move(font.font);
  QImage dots(1, 1, QImage::Format_RGB32);
  SetDots(dots);
  const QFontMetricsF metrics(made->font, &dots);
  made->qtAscent = metrics.ascent();
  made->ascent = made->standard ? StandardAscent(font_) : metrics.ascent();
  made->height = made->standard ? StandardTextHeight(font_) : std::ceil(metrics.height());
  if (faces_.size() >= kFacesKept) faces_.clear();
  faces_.push_back(std::move(made));
  return *(face_ = faces_.back().get());
}

double QtSurface::TextWidth(std::string_view text) const {
  const Face& f = face();
  if (f.standard) return RoundHalfEven(StandardTextWidth(text, font_));
  QImage dots(1, 1, QImage::Format_RGB32);
  SetDots(dots);
  return RoundHalfEven(QFontMetricsF(f.font, &dots).horizontalAdvance(ToQt(text)));
}

double QtSurface::TextHeight() const { return face().height; }

void QtSurface::SetCurrent(double x, double y) {
  x_ = x;
  y_ = y;
}

void QtSurface::Print(std::string_view text) {
  const double x = UnitX(x_), y = UnitY(y_);
  Face& f = face();
  // A text that can't touch the surface is not laid out at all.
  if (!text.empty() && std::isfinite(x) && std::isfinite(y) && x < width_ && y < height_ &&
      y > -2 * f.height && x > -2 * font_.size * double(text.size()))
    DrawText(f, x, y, std::string(text));
  x_ = 0;
  y_ += f.height;
}

// ---- raster

QtRasterSurface::QtRasterSurface(double width, double height, double dpr)
    : QtSurface(width, height), dpr_(dpr) {
  Resize(width, height, dpr);
}

QtRasterSurface::~QtRasterSurface() {
  if (painter_.isActive()) painter_.end();
}

void QtRasterSurface::Allocate() {
  if (painter_.isActive()) painter_.end();
  pixelsX_ = int(std::clamp(std::ceil(width_ * dpr_ - 1e-6), 1.0, kMostPixels));
  pixelsY_ = int(std::clamp(std::ceil(height_ * dpr_ - 1e-6), 1.0, kMostPixels));
  pixels_.assign(size_t(pixelsX_) * size_t(pixelsY_), back_);
  image_ = QImage(reinterpret_cast<uchar*>(pixels_.data()), pixelsX_, pixelsY_,
                  qsizetype(pixelsX_) * 4, QImage::Format_RGB32);
  SetDots(image_);
  image_.setDevicePixelRatio(dpr_);
}

const QImage& QtRasterSurface::image() const {
  if (painter_.isActive()) painter_.end();
  return image_;
}

void QtRasterSurface::Resize(double width, double height, double dpr) {
  width_ = std::isfinite(width) && width > 1 ? width : 1;
  height_ = std::isfinite(height) && height > 1 ? height : 1;
  dpr_ = std::isfinite(dpr) && dpr > 0 ? dpr : 1;
  ResetScale();
  Allocate();
}

void QtRasterSurface::SetWidth(double width) {
  const QImage before = image().copy();
  Resize(width, height_, dpr_);
  for (int y = 0; y < pixelsY_; ++y) {
    const auto* from = reinterpret_cast<const QRgb*>(before.constScanLine(y));
    std::copy_n(from, std::min(pixelsX_, before.width()), &pixels_[size_t(y) * pixelsX_]);
  }
}

void QtRasterSurface::Cls() {
  std::fill(pixels_.begin(), pixels_.end(), back_);
  SetCurrent(0, 0);
}

int QtRasterSurface::Edge(double unit) const {
  return int(std::clamp(std::floor(unit * dpr_ + 0.5), -1e6, 1e6));
}

int QtRasterSurface::EdgeAfter(double unit) const {
  // Whole units tile without a gap. An end between two pixels leaves out the half one, so that
  // a stroke from x - 1.5 and one to x + 1.5 reach equally far from x.
  if (unit == std::floor(unit)) return Edge(unit + 1);
  return int(std::clamp(std::ceil((unit + 1) * dpr_ - 0.5), -1e6, 1e6));
}

int QtRasterSurface::Thickness() const {
  return std::max(1, int(std::min(std::floor(drawWidth_ * dpr_ + 0.5), 1000.0)));
}

void QtRasterSurface::Fill(int left, int top, int right, int bottom, QRgb colour) {
  left = std::max(left, 0);
  top = std::max(top, 0);
  right = std::min(right, pixelsX_);
  bottom = std::min(bottom, pixelsY_);
  if (left >= right) return;
  const QRgb flip = colour & 0xFFFFFF;
  for (int y = top; y < bottom; ++y) {
    QRgb* row = &pixels_[size_t(y) * pixelsX_];
    if (mode_ == DrawMode::kXor) {
      for (int x = left; x < right; ++x) row[x] ^= flip;
    } else {
      std::fill(row + left, row + right, colour);
    }
  }
}

void QtRasterSurface::AxisLine(bool horizontal, double from, double to, double at, QRgb colour) {
  if (from > to) std::swap(from, to);
  const int thick = Thickness();
  const int side = Edge(at) - (thick - std::max(1, int(std::floor(dpr_ + 0.5)))) / 2;
  const auto fill = [&](int begin, int end) {
    if (horizontal)
      Fill(begin, side, end, side + thick, colour);
    else
      Fill(side, begin, side + thick, end, colour);
  };
  const int begin = Edge(from), end = std::max(EdgeAfter(to), begin + 1);
  const Dashes dashes = Pattern();
  if (dashes.on == 0) return fill(begin, end);

  const double length = horizontal ? width_ : height_;
  double dash = from;
  if (dash < -dashes.period) dash += std::floor(-dash / dashes.period) * dashes.period;
  for (; dash <= to && dash < length + 1; dash += dashes.period)
    fill(Edge(dash), std::min(Edge(dash + dashes.on), end));
}

void QtRasterSurface::SlopedLine(double x1, double y1, double x2, double y2, QRgb colour) {
  // Steps along the longer side; `u` runs along it and `v` across.
  const bool steep = std::abs(y2 - y1) > std::abs(x2 - x1);
  double u1 = steep ? y1 : x1, v1 = steep ? x1 : y1;
  double u2 = steep ? y2 : x2, v2 = steep ? x2 : y2;
  if (u1 > u2) {
    std::swap(u1, u2);
    std::swap(v1, v2);
  }
  const double slope = (v2 - v1) / (u2 - u1);
  const double stretch = std::sqrt(1 + slope * slope);
  const int endU = steep ? pixelsY_ : pixelsX_, endV = steep ? pixelsX_ : pixelsY_;
  const ptrdiff_t stepU = steep ? pixelsX_ : 1, stepV = steep ? 1 : pixelsX_;
  const int first = std::max(Edge(u1), 0), last = std::min(EdgeAfter(u2), endU);
  const int thick = Thickness();
  const double half = drawWidth_ * dpr_ * stretch / 2;
  const Dashes dashes = Pattern();

  const auto blend = [colour](QRgb& pixel, double cover) {
    const unsigned a = unsigned(cover * 256 + 0.5), b = 256 - a;
    const unsigned rb = ((colour & 0xFF00FF) * a + (pixel & 0xFF00FF) * b) >> 8 & 0xFF00FF;
    const unsigned g = ((colour & 0x00FF00) * a + (pixel & 0x00FF00) * b) >> 8 & 0x00FF00;
    pixel = 0xFF000000 | rb | g;
  };

  for (int u = first; u < last; ++u) {
    const double along = (u + 0.5) / dpr_ - 0.5 - u1;
    if (dashes.on != 0) {
      const double phase = std::fmod(std::max(along, 0.0) * stretch, dashes.period);
      if (phase >= dashes.on) continue;
    }
    const double v = v1 + along * slope;
    QRgb* column = pixels_.data() + u * stepU;
    if (mode_ == DrawMode::kXor) {
      const double row = std::floor(v * dpr_ + 0.5) - (thick - 1) / 2;
      if (row + thick <= 0 || row >= endV) continue;
      const int top = std::max(int(row), 0), bottom = std::min(int(row) + thick, endV);
      for (int r = top; r < bottom; ++r) column[r * stepV] ^= colour & 0xFFFFFF;
      continue;
    }
    const double centre = (v + 0.5) * dpr_;
    const double top = std::max(centre - half, 0.0);
    const double bottom = std::min(centre + half, double(endV));
    if (top >= bottom) continue;
    const int lastRow = std::min(int(bottom), endV - 1);
    for (int r = int(top); r <= lastRow; ++r) {
      const double cover = std::min(bottom, r + 1.0) - std::max(top, double(r));
      blend(column[r * stepV], cover);
    }
  }
}

void QtRasterSurface::Line(double x1, double y1, double x2, double y2, Colour colour) {
  x1 = UnitX(x1), y1 = UnitY(y1), x2 = UnitX(x2), y2 = UnitY(y2);
  if (!Finite(x1, y1, x2, y2)) return;
  if (y1 == y2)
    AxisLine(true, x1, x2, y1, Rgb(colour));
  else if (x1 == x2)
    AxisLine(false, y1, y2, x1, Rgb(colour));
  else
    SlopedLine(x1, y1, x2, y2, Rgb(colour));
}

void QtRasterSurface::Box(double x1, double y1, double x2, double y2, Colour colour) {
  x1 = UnitX(x1), y1 = UnitY(y1), x2 = UnitX(x2), y2 = UnitY(y2);
  if (!Finite(x1, y1, x2, y2)) return;
  if (x1 > x2) std::swap(x1, x2);
  if (y1 > y2) std::swap(y1, y2);
  const QRgb rgb = Rgb(colour);
  AxisLine(true, x1, x2, y1, rgb);
  if (y2 > y1) AxisLine(true, x1, x2, y2, rgb);
  if (y2 - y1 < 2) return;
  AxisLine(false, y1 + 1, y2 - 1, x1, rgb);
  if (x2 > x1) AxisLine(false, y1 + 1, y2 - 1, x2, rgb);
}

void QtRasterSurface::FilledBox(double x1, double y1, double x2, double y2, Colour colour) {
  x1 = UnitX(x1), y1 = UnitY(y1), x2 = UnitX(x2), y2 = UnitY(y2);
  if (!Finite(x1, y1, x2, y2)) return;
  const auto [left, right] = std::minmax(x1, x2);
  const auto [top, bottom] = std::minmax(y1, y2);
  Fill(Edge(left), Edge(top), std::max(EdgeAfter(right), Edge(left) + 1),
       std::max(EdgeAfter(bottom), Edge(top) + 1), Rgb(colour));
}

void QtRasterSurface::PSet(double x, double y, Colour colour) {
  x = UnitX(x), y = UnitY(y);
  if (!Finite(x, y, 0, 0)) return;
  const int left = Edge(x), top = Edge(y), thick = Thickness();
  Fill(left, top, left + thick, top + thick, Rgb(colour));
}

void QtRasterSurface::DrawText(Face& face, double x, double y, const std::string& text) {
  if (!painter_.isActive()) {
    painter_.begin(&image_);
    painter_.setRenderHint(QPainter::TextAntialiasing);
  }
  painter_.setPen(QColor(fore_));
  painter_.setFont(face.font);
  if (face.texts.size() >= kTextsKept) face.texts.clear();
  const auto [place, added] = face.texts.try_emplace(text);
  QStaticText& laid = place->second;
  if (added) {
    laid.setTextFormat(Qt::PlainText);
    laid.setText(ToQt(text));
    laid.prepare(painter_.transform(), face.font);
  }
  painter_.drawStaticText(QPointF(x, y + face.ascent - face.qtAscent), laid);
}

// ---- any painter

QtPainterSurface::QtPainterSurface(QPainter& painter, double x, double y, double width,
                                   double height)
    : QtSurface(width, height), painter_(painter), originX_(x), originY_(y) {}

void QtPainterSurface::SetWidth(double width) {
  width_ = width;
  ResetScale();
}

void QtPainterSurface::Cls() {
  FillUnits(0, 0, width_, height_, back_);
  SetCurrent(0, 0);
}

void QtPainterSurface::FillUnits(double left, double top, double right, double bottom,
                                 QRgb colour) {
  left = std::max(left, 0.0);
  top = std::max(top, 0.0);
  right = std::min(right, width_);
  bottom = std::min(bottom, height_);
  if (left >= right || top >= bottom) return;
  painter_.fillRect(QRectF(originX_ + left, originY_ + top, right - left, bottom - top),
                    QColor(colour));
}

void QtPainterSurface::Line(double x1, double y1, double x2, double y2, Colour colour) {
  x1 = UnitX(x1), y1 = UnitY(y1), x2 = UnitX(x2), y2 = UnitY(y2);
  if (!Finite(x1, y1, x2, y2)) return;
  if (std::tie(x1, y1) > std::tie(x2, y2)) {
    std::swap(x1, x2);
    std::swap(y1, y2);
  }
  // From the outer edge of the first pixel to that of the last, through their centres.
  const double dx = x2 - x1, dy = y2 - y1;
  const double longer = std::max({std::abs(dx), std::abs(dy)});
  const double ux = longer > 0 ? dx / longer / 2 : 0.5, uy = longer > 0 ? dy / longer / 2 : 0;
  double ax = x1 + 0.5 - ux, ay = y1 + 0.5 - uy;
  const double lx = dx + 2 * ux, ly = dy + 2 * uy;

  double from, to;
  if (!CutLine(ax, ay, lx, ly, width_, height_, from, to)) return;
  const double length = std::hypot(lx, ly);

  QPen pen{QColor(Rgb(colour))};
  pen.setWidthF(drawWidth_);
  pen.setCapStyle(Qt::FlatCap);
  if (const Dashes dashes = Pattern(); dashes.on != 0) {
    pen.setDashPattern({dashes.on / drawWidth_, (dashes.period - dashes.on) / drawWidth_});
    pen.setDashOffset(std::fmod(from * length, dashes.period) / drawWidth_);
  }
  painter_.setPen(pen);
  painter_.drawLine(QPointF(originX_ + ax + lx * from, originY_ + ay + ly * from),
                    QPointF(originX_ + ax + lx * to, originY_ + ay + ly * to));
}

void QtPainterSurface::Box(double x1, double y1, double x2, double y2, Colour colour) {
  Line(x1, y1, x2, y1, colour);
  Line(x1, y2, x2, y2, colour);
  Line(x1, y1, x1, y2, colour);
  Line(x2, y1, x2, y2, colour);
}

void QtPainterSurface::FilledBox(double x1, double y1, double x2, double y2, Colour colour) {
  x1 = UnitX(x1), y1 = UnitY(y1), x2 = UnitX(x2), y2 = UnitY(y2);
  if (!Finite(x1, y1, x2, y2)) return;
  FillUnits(std::min(x1, x2), std::min(y1, y2), std::max(x1, x2) + 1, std::max(y1, y2) + 1,
            Rgb(colour));
}

void QtPainterSurface::PSet(double x, double y, Colour colour) {
  x = UnitX(x), y = UnitY(y);
  if (Finite(x, y, 0, 0)) FillUnits(x, y, x + drawWidth_, y + drawWidth_, Rgb(colour));
}

void QtPainterSurface::DrawText(Face& face, double x, double y, const std::string& text) {
  painter_.setPen(QColor(fore_));
  // Fonts are sized by the medium's dots to the inch, the painter's units are 96.
  QFont font = face.font;
  font.setPointSizeF(face.key.size * kUnitsPerInch / painter_.device()->logicalDpiY());
  painter_.setFont(font);
  painter_.drawText(QPointF(originX_ + x, originY_ + y + face.ascent), ToQt(text));
}

}  // namespace kora
