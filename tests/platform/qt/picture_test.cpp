#include "platform/qt/picture.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <QSvgRenderer>

#include "base/runtime_error.h"

namespace kora {
namespace {

void Draw(Surface& price, Surface* panel) {
  price.SetBackColour(0x000000);
  price.Cls();
  price.FilledBox(10, 10, 19, 19, 0x0000FF);
  price.Line(0, 30, 39, 30, 0x00FF00);
  price.Line(-1e9, -1e9, 1e9, 1e9, 0x404040);
  price.SetForeColour(0xFFFFFF);
  price.SetCurrent(2, 35);
  price.Print("Text");
  if (!panel) return;
  panel->SetBackColour(0xFF0000);
  panel->Cls();
  panel->PSet(3, 3, 0x00FFFF);
}

TEST(Picture, TheKindIsTheEndingInAnyCase) {
  EXPECT_EQ(PictureKindOf("a.png"), PictureKind::kPng);
  EXPECT_EQ(PictureKindOf("a.b.SVG"), PictureKind::kSvg);
  EXPECT_EQ(PictureKindOf("x.Pdf"), PictureKind::kPdf);
  for (const char* name : {"", "png", "a.bmp", "a.png.cht"})
    EXPECT_THROW(PictureKindOf(name), RunTimeError) << name;
}

TEST(Picture, ThePanelStandsBelowThePricePictureAtItsWidth) {
  for (const double dpr : {1.0, 2.0}) {
    const std::string png = MakePicture(PictureKind::kPng, {40, 50, 20, dpr}, Draw);
    QImage image;
    ASSERT_TRUE(image.loadFromData(reinterpret_cast<const uchar*>(png.data()), int(png.size())));
    EXPECT_EQ(image.size(), QSize(int(40 * dpr), int(70 * dpr)));
    const auto at = [&](double x, double y) { return image.pixel(int(x * dpr), int(y * dpr)); };
    EXPECT_EQ(at(19, 11), qRgb(255, 0, 0));
    EXPECT_EQ(at(39, 30), qRgb(0, 255, 0));
    EXPECT_EQ(at(39, 49), qRgb(0, 0, 0));
    EXPECT_EQ(at(0, 50), qRgb(0, 0, 255));
    EXPECT_EQ(at(3, 53), qRgb(255, 255, 0));
  }
}

TEST(Picture, ASvgShowsWhatThePngShows) {
  const std::string svg = MakePicture(PictureKind::kSvg, {40, 50, 20, 1}, Draw);
  EXPECT_NE(svg.find(">Text<"), std::string::npos) << "text stays text";
  QSvgRenderer renderer(QByteArray(svg.data(), qsizetype(svg.size())));
  ASSERT_TRUE(renderer.isValid());
  EXPECT_EQ(renderer.viewBoxF(), QRectF(0, 0, 40, 70));
  QImage image(40, 70, QImage::Format_RGB32);
  image.fill(Qt::magenta);
  QPainter painter(&image);
  renderer.render(&painter, QRectF(0, 0, 40, 70));
  painter.end();
  EXPECT_EQ(image.pixel(10, 19), qRgb(255, 0, 0));
  EXPECT_EQ(image.pixel(19, 10), qRgb(255, 0, 0));
  EXPECT_EQ(image.pixel(20, 15), qRgb(0, 0, 0));
  EXPECT_EQ(image.pixel(0, 30), qRgb(0, 255, 0));
  EXPECT_EQ(image.pixel(39, 30), qRgb(0, 255, 0));
  EXPECT_EQ(image.pixel(5, 60), qRgb(0, 0, 255));
  EXPECT_EQ(image.pixel(3, 53), qRgb(255, 255, 0));
}

TEST(Picture, APdfIsOnePageOfThePicturesSize) {
  const std::string pdf = MakePicture(PictureKind::kPdf, {640, 480, 96, 1}, Draw);
  EXPECT_EQ(pdf.substr(0, 5), "%PDF-");
  // 640 by 576 units at 96 to the inch are 480 by 432 points.
  const size_t box = pdf.find("/MediaBox [");
  ASSERT_NE(box, std::string::npos);
  double left = 1, top = 1, width = 0, height = 0;
  ASSERT_EQ(
      std::sscanf(pdf.c_str() + box, "/MediaBox [%lf %lf %lf %lf", &left, &top, &width, &height),
      4);
  EXPECT_NEAR(width, 480, 1);
  EXPECT_NEAR(height, 432, 1);
  EXPECT_NE(pdf.find("/Count 1"), std::string::npos);
}

TEST(Picture, WithoutAPanelThereIsNone) {
  bool asked = false;
  MakePicture(PictureKind::kPng, {40, 50, 0, 1}, [&](Surface&, Surface* panel) {
    asked = true;
    EXPECT_EQ(panel, nullptr);
  });
  EXPECT_TRUE(asked);
}

TEST(Picture, SizesThatCannotBeAreRefused) {
  for (const PictureSize& size : {PictureSize{0, 50}, PictureSize{40, -1}, PictureSize{1e9, 50},
                                  PictureSize{40, 50, 1e9}, PictureSize{40, 50, -2}})
    EXPECT_THROW(MakePicture(PictureKind::kPng, size, Draw), RunTimeError);
}

TEST(Picture, AFailingDrawComesThrough) {
  for (const PictureKind kind : {PictureKind::kPng, PictureKind::kSvg, PictureKind::kPdf})
    EXPECT_THROW(
        MakePicture(kind, {40, 50}, [](Surface&, Surface*) { throw RunTimeError(kOverflow); }),
        RunTimeError);
}

}  // namespace
}  // namespace kora
