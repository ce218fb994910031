#include "platform/qt/picture.h"

#include <QBuffer>
#include <QPageSize>
#include <QPdfWriter>
#include <QSvgGenerator>
#include <optional>

#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/qt/qt_surface.h"

namespace kora {
namespace {

using Draw = std::function<void(Surface&, Surface*)>;

void DrawWith(QPainter& painter, const PictureSize& size, const Draw& draw) {
  QtPainterSurface price(painter, 0, 0, size.width, size.height);
  std::optional<QtPainterSurface> panel;
  if (size.panel > 0) panel.emplace(painter, 0, size.height, size.width, size.panel);
  draw(price, panel ? &*panel : nullptr);
}

void MakePng(QBuffer& out, const PictureSize& size, const Draw& draw) {
  QtRasterSurface price(size.width, size.height, size.dpr);
  std::optional<QtRasterSurface> panel;
  if (size.panel > 0) panel.emplace(size.width, size.panel, size.dpr);
  draw(price, panel ? &*panel : nullptr);
  const QImage& upper = price.image();
  if (!panel) {
    upper.save(&out, "PNG");
    return;
  }
  const QImage& lower = panel->image();
  QImage both(upper.width(), upper.height() + lower.height(), QImage::Format_RGB32);
  for (int y = 0; y < both.height(); ++y) {
    const uchar* row = y < upper.height() ? upper.constScanLine(y)
                                          : lower.constScanLine(y - upper.height());
    std::copy_n(row, size_t(both.width()) * 4, both.scanLine(y));
  }
  both.save(&out, "PNG");
}

void MakeSvg(QBuffer& out, const PictureSize& size, const Draw& draw) {
  const double height = size.height + size.panel;
  QSvgGenerator svg;
  svg.setOutputDevice(&out);
  svg.setResolution(96);
  svg.setSize(QSizeF(size.width, height).toSize());
  svg.setViewBox(QRectF(0, 0, size.width, height));
  svg.setTitle("KORA Charting");
  QPainter painter(&svg);
  DrawWith(painter, size, draw);
}

void MakePdf(QBuffer& out, const PictureSize& size, const Draw& draw) {
  QPdfWriter pdf(&out);
  pdf.setResolution(96);
  pdf.setCreator("KORA Charting");
  pdf.setPageSize(QPageSize(QSizeF(size.width, size.height + size.panel) * 72.0 / 96.0,
                            QPageSize::Point, QString(), QPageSize::ExactMatch));
  pdf.setPageMargins(QMarginsF(0, 0, 0, 0));
  QPainter painter(&pdf);
  DrawWith(painter, size, draw);
}

}  // namespace

PictureKind PictureKindOf(std::string_view fileName) {
  const size_t dot = fileName.rfind('.');
  const std::string ending = dot == fileName.npos ? "" : LCase(fileName.substr(dot));
  if (ending == ".png") return PictureKind::kPng;
  if (ending == ".svg") return PictureKind::kSvg;
  if (ending == ".pdf") return PictureKind::kPdf;
  throw RunTimeError(kBadFileName);
}

std::string MakePicture(PictureKind kind, const PictureSize& size, const Draw& draw) {
  const auto fits = [](double v) { return v >= 1 && v <= 20000; };
  if (!fits(size.width) || !fits(size.height) || (size.panel != 0 && !fits(size.panel)))
    throw RunTimeError(kBadCall);
  QByteArray bytes;
  QBuffer out(&bytes);
  out.open(QIODevice::WriteOnly);
  switch (kind) {
    case PictureKind::kPng: MakePng(out, size, draw); break;
    case PictureKind::kSvg: MakeSvg(out, size, draw); break;
    case PictureKind::kPdf: MakePdf(out, size, draw); break;
  }
  return bytes.toStdString();
}

}  // namespace kora
