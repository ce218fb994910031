#include "platform/qt/png.h"

#include <gtest/gtest.h>

namespace kora {
namespace {

// The colour of the pixel number n, out of `colours` different ones.
QImage Picture(int width, int height, int colours) {
  QImage image(width, height, QImage::Format_RGB32);
  for (int n = 0; n < width * height; ++n)
    image.setPixel(n % width, n / width, 0xFF000000u + unsigned(n % colours) * 40503u);
  image.setDotsPerMeterX(3780);
  image.setDotsPerMeterY(3780);
  return image;
}

// Colour types 3, by index, and 2, in full, stand behind width, height and depth.
char ColourType(const QByteArray& png) { return png.at(25); }

TEST(PngTest, EveryPixelComesBackByIndexAndInFull) {
  for (const auto& [width, height, colours, type] : {std::array{1, 1, 1, 3},
                                                     {17, 9, 2, 3},
                                                     {64, 64, 256, 3},
                                                     {64, 64, 257, 2},
                                                     {638, 452, 5000, 2}}) {
    const QImage image = Picture(width, height, colours);
    const QByteArray png = PngOf({&image});
    EXPECT_EQ(ColourType(png), type) << colours;
    const QImage read = QImage::fromData(png, "PNG");
    ASSERT_EQ(read.size(), image.size());
    EXPECT_EQ(read.convertToFormat(QImage::Format_RGB32), image) << colours;
    EXPECT_EQ(read.dotsPerMeterX(), 3780);
  }
}

TEST(PngTest, PicturesStandOneBelowTheOther) {
  const QImage upper = Picture(30, 20, 200), lower = Picture(30, 7, 90);
  const QImage read =
      QImage::fromData(PngOf({&upper, &lower}), "PNG").convertToFormat(QImage::Format_RGB32);
  ASSERT_EQ(read.size(), QSize(30, 27));
  EXPECT_EQ(read.copy(0, 0, 30, 20), upper);
  EXPECT_EQ(read.copy(0, 20, 30, 7), lower);
}

}  // namespace
}  // namespace kora
