#include <gtest/gtest.h>

#include <QElapsedTimer>
#include <cmath>
#include <limits>
#include <set>

#include "base/runtime_error.h"
#include "platform/headless/headless_surface.h"
#include "platform/qt/qt_surface.h"
#include "platform/text_metrics.h"

namespace kora {
namespace {

constexpr Colour kRed = 0x0000FF, kBlue = 0xFF0000, kWhite = 0xFFFFFF, kBlack = 0;
const QRgb kRedPixel = qRgb(255, 0, 0), kBluePixel = qRgb(0, 0, 255), kBlackPixel = qRgb(0, 0, 0);

// A black surface of 20 by 16 units.
struct Sheet : QtRasterSurface {
  explicit Sheet(double dpr = 1, double width = 20, double height = 16)
      : QtRasterSurface(width, height, dpr) {
    SetBackColour(kBlack);
    Cls();
  }
  QRgb at(int x, int y) const { return image().pixel(x, y) | 0xFF000000; }
  // The smallest rectangle that holds every pixel of the colour, and whether it is full.
  QRect extent(QRgb colour) const {
    QRect all;
    for (int y = 0; y < image().height(); ++y)
      for (int x = 0; x < image().width(); ++x)
        if (at(x, y) == colour) all |= QRect(x, y, 1, 1);
    return all;
  }
  int count(QRgb colour) const {
    int n = 0;
    for (int y = 0; y < image().height(); ++y)
      for (int x = 0; x < image().width(); ++x) n += at(x, y) == colour;
    return n;
  }
};

QImage Copy(const Sheet& s) { return s.image().copy(); }

TEST(RasterSurface, RedIsTheLowByte) {
  Sheet s;
  s.PSet(3, 4, 0x112233);
  EXPECT_EQ(s.at(3, 4), qRgb(0x33, 0x22, 0x11));
}

TEST(RasterSurface, AVerticalLineCoversBothItsEnds) {
  Sheet s;
  s.Line(1, 1, 1, 3, kRed);
  EXPECT_EQ(s.extent(kRedPixel), QRect(1, 1, 1, 3));
  EXPECT_EQ(s.count(kRedPixel), 3);
  EXPECT_EQ(s.count(kBlackPixel), 20 * 16 - 3);
}

TEST(RasterSurface, TheOrderOfTheEndsDoesNotMatter) {
  Sheet s;
  s.Line(9, 5, 2, 5, kRed);
  EXPECT_EQ(s.extent(kRedPixel), QRect(2, 5, 8, 1));
}

TEST(RasterSurface, AtTwoPixelsToTheUnitALineIsTwoPixelsWide) {
  Sheet s(2);
  ASSERT_EQ(s.image().width(), 40);
  s.Line(1, 1, 1, 3, kRed);
  EXPECT_EQ(s.extent(kRedPixel), QRect(2, 2, 2, 6));
  EXPECT_EQ(s.count(kRedPixel), 12);
  EXPECT_EQ(s.count(kBlackPixel), 40 * 32 - 12);
}

TEST(RasterSurface, AtOneAndAHalfPixelsLinesAreWholePixelsOfOneWidth) {
  for (int x = 1; x < 8; ++x) {
    Sheet s(1.5);
    s.Line(x, 2, x, 5, kRed);
    // From 2 to 6 units is 3 to 9 pixels; 1.5 pixels of width round to 2.
    EXPECT_EQ(s.extent(kRedPixel), QRect(int(std::floor(x * 1.5 + 0.5)), 3, 2, 6)) << x;
    EXPECT_EQ(s.count(kRedPixel) + s.count(kBlackPixel), 30 * 24) << "nothing is blended";
  }
}

TEST(RasterSurface, BoxesOfNeighbouringUnitsTouchWithoutAGapAtOneAndAHalf) {
  Sheet s(1.5);
  s.FilledBox(1, 1, 2, 4, kRed);
  s.FilledBox(3, 1, 4, 4, kBlue);
  const QRect red = s.extent(kRedPixel), blue = s.extent(kBluePixel);
  EXPECT_EQ(red.right() + 1, blue.left());
  EXPECT_EQ(s.count(kRedPixel), red.width() * red.height());
  EXPECT_EQ(s.count(kBluePixel), blue.width() * blue.height());
}

TEST(RasterSurface, TicksLeftAndRightOfABarAreEquallyLong) {
  for (const double dpr : {1.0, 2.0}) {
    Sheet s(dpr);
    s.Line(8 - 1.5, 3, 8, 3, kRed);
    s.Line(8, 6, 8 + 1.5, 6, kBlue);
    const QRect left = s.extent(kRedPixel), right = s.extent(kBluePixel);
    EXPECT_EQ(left.width(), right.width()) << dpr;
    EXPECT_EQ(left.right(), int(9 * dpr) - 1) << dpr;
    EXPECT_EQ(right.left(), int(8 * dpr)) << dpr;
  }
}

TEST(RasterSurface, AFilledBoxIncludesBothCornersInAnyOrder) {
  Sheet s;
  s.FilledBox(6, 7, 2, 3, kRed);
  EXPECT_EQ(s.extent(kRedPixel), QRect(2, 3, 5, 5));
  EXPECT_EQ(s.count(kRedPixel), 25);
}

TEST(RasterSurface, ABoxIsAnOutline) {
  Sheet s;
  s.Box(2, 3, 6, 7, kRed);
  EXPECT_EQ(s.extent(kRedPixel), QRect(2, 3, 5, 5));
  EXPECT_EQ(s.count(kRedPixel), 16);
  EXPECT_EQ(s.at(4, 5), kBlackPixel);
}

TEST(RasterSurface, ABoxOfNoSizeIsOnePixel) {
  Sheet s;
  s.Box(4, 4, 4, 4, kRed);
  EXPECT_EQ(s.count(kRedPixel), 1);
}

TEST(RasterSurface, APointIsOneUnit) {
  Sheet one, two(2);
  one.PSet(5, 6, kRed);
  two.PSet(5, 6, kRed);
  EXPECT_EQ(one.extent(kRedPixel), QRect(5, 6, 1, 1));
  EXPECT_EQ(two.extent(kRedPixel), QRect(10, 12, 2, 2));
}

TEST(RasterSurface, AWidePenIsCentredOnItsLine) {
  Sheet s;
  s.SetDrawWidth(3);
  s.Line(2, 5, 9, 5, kRed);
  EXPECT_EQ(s.extent(kRedPixel), QRect(2, 4, 8, 3));
}

TEST(RasterSurface, ADottedLineHasItsDotsWhateverTheOrderOfItsEnds) {
  Sheet a, b;
  a.SetDrawStyle(DrawStyle::kDot);
  b.SetDrawStyle(DrawStyle::kDot);
  a.Line(1, 4, 9, 4, kRed);
  b.Line(9, 4, 1, 4, kRed);
  EXPECT_EQ(a.count(kRedPixel), 3);  // 1, 4 and 7
  for (const int x : {1, 4, 7}) EXPECT_EQ(a.at(x, 4), kRedPixel) << x;
  EXPECT_EQ(Copy(a), Copy(b));
}

TEST(RasterSurface, ADashedLineIsBrokenAndEndsAtItsEnd) {
  Sheet s;
  s.SetDrawStyle(DrawStyle::kDash);
  s.Line(0, 4, 11, 4, kRed);  // six on, four off, two on
  EXPECT_EQ(s.count(kRedPixel), 8);
  EXPECT_EQ(s.at(5, 4), kRedPixel);
  EXPECT_EQ(s.at(6, 4), kBlackPixel);
  EXPECT_EQ(s.at(11, 4), kRedPixel);
  EXPECT_EQ(s.at(12, 4), kBlackPixel);
}

TEST(RasterSurface, ASlopedLineIsSmoothAndReachesBothEnds) {
  Sheet s;
  s.Line(2, 2, 12, 7, kRed);
  EXPECT_GT(qRed(s.at(2, 2)), 150);
  EXPECT_GT(qRed(s.at(12, 7)), 150);
  EXPECT_EQ(qRed(s.at(1, 2)), 0);
  EXPECT_EQ(qRed(s.at(13, 7)), 0);
  std::set<int> levels;
  for (int x = 2; x <= 12; ++x)
    for (int y = 1; y <= 8; ++y) levels.insert(qRed(s.at(x, y)));
  EXPECT_GT(levels.size(), 3u) << "blended at its edges";
}

TEST(RasterSurface, ADiagonalRunsThroughItsPixelCentres) {
  Sheet s;
  s.Line(3, 3, 8, 8, kWhite);
  for (int i = 3; i <= 8; ++i) EXPECT_GT(qRed(s.at(i, i)), 220) << i;
  for (int i = 4; i <= 7; ++i) {
    EXPECT_EQ(qRed(s.at(i - 1, i)), qRed(s.at(i + 1, i))) << "as much on either side " << i;
  }
}

class XorPen : public testing::TestWithParam<double> {};

TEST_P(XorPen, TheSameCallAgainBringsThePictureBack) {
  Sheet s(GetParam(), 60, 50);
  for (int i = 0; i < 60; ++i) s.Line(i, i % 7, i, 49 - i % 11, 0x010305 * (i + 1));
  s.SetCurrent(4, 20);
  s.Print("Under the pen");
  const QImage before = Copy(s);
  const auto draw = [&s] {
    for (const DrawStyle style : {DrawStyle::kSolid, DrawStyle::kDash, DrawStyle::kDot}) {
      s.SetDrawStyle(style);
      s.Line(0, 25, 59, 25, kWhite);
      s.Line(30, 0, 30, 49, 0x804020);
      s.Line(3, 4, 55, 41, kWhite);
      s.Line(50, 2, 41, 47, kWhite);
      s.Line(-1e9, -3, 1e9, 60, kWhite);
      s.Box(5, 6, 40, 33, 0x00FFFF);
      s.FilledBox(10, 10, 20, 20, 0xFF00FF);
      s.PSet(12, 13, kWhite);
    }
  };
  s.SetDrawMode(DrawMode::kXor);
  draw();
  EXPECT_NE(Copy(s), before);
  draw();
  EXPECT_EQ(Copy(s), before);
}

TEST_P(XorPen, EachPixelIsTouchedOnce) {
  Sheet s(GetParam(), 60, 50);
  s.SetDrawMode(DrawMode::kXor);
  s.Line(3, 4, 55, 41, 0x0000FF);
  s.Line(5, 45, 9, 2, 0x0000FF);
  // Each column of the flat line has its pixel, and no column lost it to a second touch.
  int missing = 0;
  for (int x = int(3 * GetParam() + 1); x < int(56 * GetParam()); ++x) {
    bool any = false;
    for (int y = 0; y < s.image().height(); ++y) any |= qRed(s.at(x, y)) == 255;
    missing += !any;
  }
  EXPECT_EQ(missing, 0);
}

INSTANTIATE_TEST_SUITE_P(Scales, XorPen, testing::Values(1.0, 1.25, 1.5, 2.0, 3.0));

TEST(RasterSurface, XorOfAColourWithAPixelIsItsBits) {
  Sheet s;
  s.PSet(2, 2, 0x0F0F0F);
  s.SetDrawMode(DrawMode::kXor);
  s.PSet(2, 2, 0xFFFFFF);
  EXPECT_EQ(s.at(2, 2), qRgb(0xF0, 0xF0, 0xF0));
}

TEST(RasterSurface, CoordinatesFarOutsideAreCut) {
  // A walk over every unit or dash of these lines would take minutes and run into the limit of
  // the test program.
  Sheet s;
  for (const DrawStyle style : {DrawStyle::kSolid, DrawStyle::kDash, DrawStyle::kDot}) {
    s.SetDrawStyle(style);
    for (const double far : {1e9, 1e15}) {
      s.Line(-far, 3, far, 3, kRed);
      s.Line(4, -far, 4, far, kRed);
      s.Line(-far, -far, far, far, kRed);
      s.Line(-far, 5, far, 6, kRed);
      s.Box(-far, -far, far, far, kBlue);
      s.PSet(far, -far, kBlue);
      s.SetCurrent(far, far);
      s.Print("far");
    }
  }
  EXPECT_EQ(s.at(0, 3), kRedPixel);
  EXPECT_EQ(s.at(19, 3), kRedPixel);
  EXPECT_EQ(s.at(4, 15), kRedPixel);
  EXPECT_EQ(s.count(kBluePixel), 0) << "the box is wholly outside";
  s.FilledBox(-1e9, -1e9, 1e9, 1e9, kBlue);
  EXPECT_EQ(s.count(kBluePixel), 20 * 16);
}

TEST(RasterSurface, ADottedLineFromFarAwayKeepsItsRhythm) {
  Sheet s;
  s.SetDrawStyle(DrawStyle::kDot);
  s.Line(-3e8, 2, 50, 2, kRed);  // a multiple of three: dots at 0, 3, 6 ...
  for (int x = 0; x < 20; ++x) EXPECT_EQ(s.at(x, 2) == kRedPixel, x % 3 == 0) << x;
}

TEST(RasterSurface, ValuesThatAreNoNumbersDrawNothing) {
  Sheet s;
  const double nan = std::numeric_limits<double>::quiet_NaN();
  const double inf = std::numeric_limits<double>::infinity();
  s.Line(nan, 1, 5, 5, kRed);
  s.Line(1, 1, inf, 5, kRed);
  s.Box(1, nan, 5, 5, kRed);
  s.FilledBox(1, 1, 5, -inf, kRed);
  s.PSet(nan, 2, kRed);
  s.SetCurrent(nan, inf);
  s.Print("nowhere");
  EXPECT_EQ(s.count(kBlackPixel), 20 * 16);
}

TEST(RasterSurface, AUserScaleStretchesThePicture) {
  Sheet s;
  s.SetScale(0, 0, 10, 8);
  EXPECT_EQ(s.ScaleWidth(), 10);
  s.PSet(4, 3, kRed);
  EXPECT_EQ(s.at(8, 6), kRedPixel);
  EXPECT_THROW(s.SetScale(0, 0, 0, 8), RunTimeError);
  EXPECT_EQ(s.ScaleWidth(), 10);
}

TEST(RasterSurface, SetWidthKeepsWhatWasDrawn) {
  Sheet s;
  s.PSet(3, 4, kRed);
  s.SetWidth(100);
  EXPECT_EQ(s.Width(), 100);
  EXPECT_EQ(s.image().width(), 100);
  EXPECT_EQ(s.at(3, 4), kRedPixel);
  EXPECT_EQ(s.at(90, 4), kBlackPixel);
}

TEST(RasterSurface, ResizeSetsTheScaleAndTheDevicePixels) {
  Sheet s;
  s.SetScale(0, 0, 5, 5);
  s.Resize(30, 10, 1.5);
  EXPECT_EQ(s.ScaleWidth(), 30);
  EXPECT_EQ(s.image().width(), 45);
  EXPECT_EQ(s.image().height(), 15);
  s.Resize(-5, 0, 0);
  EXPECT_EQ(s.image().width(), 1);
}

TEST(RasterSurface, ClsFillsAndMovesTheTextPositionHome) {
  Sheet s;
  s.SetCurrent(7, 8);
  s.SetBackColour(kBlue);
  s.Cls();
  EXPECT_EQ(s.count(kBluePixel), 20 * 16);
  EXPECT_EQ(s.CurrentX(), 0);
  EXPECT_EQ(s.CurrentY(), 0);
}

TEST(SurfaceText, StandsBelowAndRightOfItsPosition) {
  Sheet s(1, 100, 40);
  s.SetForeColour(kWhite);
  s.SetCurrent(10, 12);
  s.Print("HHHH");
  const int width = int(s.TextWidth("HHHH")), height = int(s.TextHeight());
  QRect ink;
  for (int y = 0; y < 40; ++y)
    for (int x = 0; x < 100; ++x)
      if (s.at(x, y) != kBlackPixel) ink |= QRect(x, y, 1, 1);
  EXPECT_TRUE(QRect(10, 12, width, height).contains(ink))
      << ink.x() << " " << ink.y() << " " << ink.width() << " " << ink.height();
  EXPECT_GT(ink.width(), width * 3 / 4);
  EXPECT_EQ(s.CurrentX(), 0);
  EXPECT_EQ(s.CurrentY(), 12 + height);
}

TEST(SurfaceText, HasTheSizesThatAChartWithoutAWindowHas) {
  Sheet s;
  HeadlessSurface plain(20, 16);
  for (const SurfaceFont& font :
       {SurfaceFont{}, SurfaceFont{"Arial", 9, true, false}, SurfaceFont{"", 12.5, false, true},
        SurfaceFont{"MS Sans Serif", 7, false, false}}) {
    s.SetFont(font);
    plain.SetFont(font);
    for (const char* text : {"", "12.50", "BROKEN HILL PTY", "caf\xC3\xA9 \xE2\x82\xAC", "  "}) {
      EXPECT_EQ(s.TextWidth(text), plain.TextWidth(text)) << font.name << font.size << text;
      EXPECT_EQ(s.TextHeight(), plain.TextHeight());
    }
  }
}

TEST(SurfaceText, TheStandardWidthIsWhatIsDrawn) {
  // Only where a face of these metrics is installed.
  Sheet s(1, 400, 30);
  const std::string text = "HMHM 1234567890 HMHM 1234567890 H";
  s.SetForeColour(kWhite);
  s.SetFont({"", 12, false, false});
  s.SetCurrent(0, 0);
  s.Print(text);
  int right = 0;
  for (int y = 0; y < 30; ++y)
    for (int x = 0; x < 400; ++x)
      if (s.at(x, y) != kBlackPixel) right = std::max(right, x);
  SurfaceFont font{"", 12, false, false};
  EXPECT_NEAR(right + 1, StandardTextWidth(text, font), 3);
}

TEST(SurfaceText, AnUnknownFaceIsShownInTheStandardOne) {
  Sheet s;
  s.SetFont({"No Such Face At All", 9, false, false});
  EXPECT_EQ(s.Font().name, "No Such Face At All");
  HeadlessSurface plain(20, 16);
  plain.SetFont({"", 9, false, false});
  EXPECT_EQ(s.TextWidth("12345"), plain.TextWidth("12345"));
}

TEST(SurfaceText, NamesAndSizesThatCannotBeAreRefused) {
  Sheet s;
  s.SetFont({"Arial", 9, false, false});
  for (const SurfaceFont& font :
       {SurfaceFont{std::string(201, 'x'), 9}, SurfaceFont{"Ar\tial", 9},
        SurfaceFont{std::string("A\0b", 3), 9}, SurfaceFont{"", 0}, SurfaceFont{"", -3},
        SurfaceFont{"", 5000}, SurfaceFont{"", std::nan("")}}) {
    try {
      s.SetFont(font);
      ADD_FAILURE() << font.name << " " << font.size;
    } catch (const RunTimeError& e) {
      EXPECT_EQ(e.number(), kInvalidValue);
    }
    EXPECT_EQ(s.Font().name, "Arial") << "the font stays";
  }
}

TEST(SurfaceText, BadBytesAndLongTextsAreHarmless) {
  Sheet s;
  s.SetCurrent(0, 0);
  s.Print("\xFF\xFE\x80 abc");
  s.Print(std::string(100000, 'W'));
  s.Print("<b>&amp;</b>\n\t");
  EXPECT_GT(s.CurrentY(), 0);
}

}  // namespace
}  // namespace kora
