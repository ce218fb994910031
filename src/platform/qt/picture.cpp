#include "platform/qt/picture.h"

#include <QBuffer>
#include <QPageSize>
#include <QPdfWriter>
#include <QSvgGenerator>
#include <optional>

#include "base/runtime_error.h"
#include "platform/qt/png.h"
#include "platform/qt/qt_surface.h"

namespace kora {
namespace {

void DrawWith(QPainter& painter, const PictureSize& size, const DrawPicture& draw) {
  QtPainterSurface price(painter, 0, 0, size.width, size.height);
  std::optional<QtPainterSurface> panel;
  if (size.panel > 0) panel.emplace(painter, 0, size.height, size.width, size.panel);
  draw(price, panel ? &*panel : nullptr);
}

void MakePng(QBuffer& out, const PictureSize& size, const DrawPicture& draw) {
  QtRasterSurface price(size.width, size.height, size.dpr);
  std::optional<QtRasterSurface> panel;
  if (size.panel > 0) panel.emplace(size.width, size.panel, size.dpr);
  draw(price, panel ? &*panel : nullptr);
  if (panel)
    out.write(PngOf({&price.image(), &panel->image()}));
  else
    out.write(PngOf({&price.image()}));
}

void MakeSvg(QBuffer& out, const PictureSize& size, const DrawPicture& draw) {
  const double height = size.height + size.panel;
  QSvgGenerator svg;
  svg.setOutputDevice(&out);
  svg.setResolution(96);
  svg.setSize(QSizeF(size.width, height).toSize());
  svg.setViewBox(QRectF(0, 0, size.width, height));
  svg.setTitle("KORA Charting");
  QPainter painter(&svg);
  DrawWith(painter, size, draw);
  painter.end();  // here: what fails in a destructor ends the program
}

void MakePdf(QBuffer& out, const PictureSize& size, const DrawPicture& draw) {
  QPdfWriter pdf(&out);
  pdf.setResolution(96);
  pdf.setCreator("KORA Charting");
  pdf.setPageSize(QPageSize(QSizeF(size.width, size.height + size.panel) * 72.0 / 96.0,
                            QPageSize::Point, QString(), QPageSize::ExactMatch));
  pdf.setPageMargins(QMarginsF(0, 0, 0, 0));
  QPainter painter(&pdf);
  DrawWith(painter, size, draw);
  painter.end();  // here: what fails in a destructor ends the program
}

}  // namespace

std::string MakePicture(PictureKind kind, const PictureSize& size, const DrawPicture& draw) {
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
