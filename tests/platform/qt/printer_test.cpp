#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <QPrinterInfo>

#include "base/runtime_error.h"
#include "platform/qt/qt_printer.h"
#include "tests/support/error_of.h"

namespace kora {
namespace {

using test::ErrorOf;

constexpr double kDots = 4.8;  // twips to a dot

struct PdfFixture {
  std::vector<std::string> files;
  int sinkError = 0;
  QtPrinter printer{[this](const std::string& bytes) {
    if (sinkError != 0) throw RunTimeError(sinkError);
    files.push_back(bytes);
  }};
  PdfFixture() { printer.SetDevice(QtPrinter::kPdfPrinter); }

  // A page as a picture of 15 twips to the pixel.
  QImage Picture(size_t page = 0) const {
    const Sheet sheet = printer.Page();
    QImage image(int(sheet.reachWidth / 15), int(sheet.reachHeight / 15), QImage::Format_RGB32);
    image.fill(Qt::white);
    QPainter painter(&image);
    painter.scale(1 / 15.0, 1 / 15.0);
    printer.PaintPage(painter, page);
    return image;
  }
};

TEST(QtPrinterTest, PdfPrinterIsOnEveryMachineAndNeverTheDefault) {
  QtPrinter printer({});
  const auto names = printer.DeviceNames();
  ASSERT_FALSE(names.empty());
  EXPECT_EQ(names.back(), "PDF file");
  EXPECT_NE(printer.DeviceName(), "PDF file");
}

TEST(QtPrinterTest, APrinterThatIsNotThereIsNotAvailable) {
  QtPrinter printer({});
  EXPECT_EQ(ErrorOf([&] { printer.SetDevice("No such printer here"); }), kDeviceNotAvailable);
}

TEST(QtPrinterTest, WithoutAPrinterNoDocumentBegins) {
  if (!QPrinterInfo::defaultPrinterName().isEmpty()) GTEST_SKIP() << "there is a default printer";
  QtPrinter printer({});
  EXPECT_FALSE(printer.Exists());
  EXPECT_EQ(ErrorOf([&] { printer.StartDoc("x"); }), kDeviceNotAvailable);
  EXPECT_GT(printer.Page().width, 11000);
}

TEST(QtPrinterTest, SheetIsThePaperAsItLies) {
  PdfFixture f;
  Sheet sheet = f.printer.Page();
  EXPECT_NEAR(sheet.width, 11906, 20);  // 210 mm; paper sizes are whole points
  EXPECT_NEAR(sheet.height, 16838, 20);
  EXPECT_EQ(sheet.reachWidth, sheet.width - 2 * sheet.left);
  f.printer.SetOrientation(kLandscape);
  f.printer.SetPaper("letter");
  sheet = f.printer.Page();
  EXPECT_EQ(sheet.width, 11 * 1440);
  EXPECT_EQ(sheet.height, 8.5 * 1440);
  EXPECT_EQ(f.printer.PaperName(), "letter");
  EXPECT_EQ(ErrorOf([&] { f.printer.SetPaper("Papyrus"); }), kInvalidValue);
  EXPECT_EQ(ErrorOf([&] { f.printer.SetOrientation(3); }), kBadCall);
}

TEST(QtPrinterTest, PdfHasItsPagesAndSize) {
  PdfFixture f;
  f.printer.SetOrientation(kLandscape);
  f.printer.StartDoc("Title");
  f.printer.Line(0, 0, 1000, 1000, 0);
  f.printer.NewPage();
  f.printer.Line(0, 0, 1000, 1000, 0);
  EXPECT_TRUE(f.files.empty()) << "nothing is sent before the end";
  f.printer.EndDoc();
  ASSERT_EQ(f.files.size(), 1u);
  EXPECT_EQ(f.files[0].substr(0, 5), "%PDF-");
  EXPECT_NE(f.files[0].find("/MediaBox [0 0 842"), std::string::npos);
  EXPECT_NE(f.files[0].find("/Count 2"), std::string::npos);
}

TEST(QtPrinterTest, ADroppedDocumentIsNotSent) {
  PdfFixture f;
  f.printer.StartDoc("x");
  f.printer.Line(0, 0, 1000, 1000, 0);
  f.printer.KillDoc();
  f.printer.KillDoc();
  EXPECT_TRUE(f.files.empty());
  EXPECT_EQ(ErrorOf([&] { f.printer.EndDoc(); }), kBadCall);
}

TEST(QtPrinterTest, AFullDiskIsToldAndTheDocumentIsOver) {
  PdfFixture f;
  f.sinkError = kDiskFull;
  f.printer.StartDoc("x");
  EXPECT_EQ(ErrorOf([&] { f.printer.EndDoc(); }), kDiskFull);
  f.sinkError = 0;
  EXPECT_EQ(ErrorOf([&] { f.printer.EndDoc(); }), kBadCall);
  f.printer.StartDoc("x");
  f.printer.EndDoc();
  EXPECT_EQ(f.files.size(), 1u);
}

TEST(QtPrinterTest, NothingIsDrawnOrTurnedOutsideItsTime) {
  PdfFixture f;
  EXPECT_EQ(ErrorOf([&] { f.printer.Line(0, 0, 1, 1, 0); }), kBadCall);
  EXPECT_EQ(ErrorOf([&] { f.printer.Print("x"); }), kBadCall);
  EXPECT_EQ(ErrorOf([&] { f.printer.NewPage(); }), kBadCall);
  f.printer.StartDoc("x");
  EXPECT_EQ(ErrorOf([&] { f.printer.SetOrientation(kLandscape); }), kBadCall);
  EXPECT_EQ(ErrorOf([&] { f.printer.SetPaper("A3"); }), kBadCall);
  EXPECT_EQ(ErrorOf([&] { f.printer.SetDevice("PDF file"); }), kBadCall);
}

TEST(QtPrinterTest, ScaleMovesTheOriginAndColoursAreTheirOwn) {
  PdfFixture f;
  f.printer.StartDoc("x");
  f.printer.SetScale(-1500, -3000);
  f.printer.FilledBox(0, 0, 1500, 1500, 0x0000FF);     // 100 px right, 200 down
  f.printer.FilledBox(4500, 1500, 3000, 0, 0xFF0000);  // corners either way round
  f.printer.EndDoc();
  const QImage page = f.Picture();
  EXPECT_EQ(page.pixelColor(150, 250), QColor(255, 0, 0));
  EXPECT_EQ(page.pixelColor(95, 250), QColor(Qt::white));
  EXPECT_EQ(page.pixelColor(150, 195), QColor(Qt::white));
  EXPECT_EQ(page.pixelColor(350, 250), QColor(0, 0, 255));
}

TEST(QtPrinterTest, PensAreAsWideAsTheirDots) {
  PdfFixture f;
  f.printer.StartDoc("x");
  f.printer.SetDrawWidth(25);  // 120 twips, 8 pixels
  f.printer.Line(1500, 1500, 3000, 1500, 0);
  f.printer.Line(6000, 1500, 6000, 1500, 0);  // a point
  f.printer.EndDoc();
  const QImage page = f.Picture();
  const auto dark = [&](int x, int from, int to) {
    int n = 0;
    for (int y = from; y < to; ++y) n += page.pixelColor(x, y).value() < 128;
    return n;
  };
  EXPECT_EQ(dark(150, 80, 120), 25 * kDots / 15);
  EXPECT_EQ(dark(400, 80, 120), 25 * kDots / 15);
  EXPECT_EQ(dark(410, 80, 120), 0);
}

TEST(QtPrinterTest, DashesAndDotsHaveGaps) {
  PdfFixture f;
  f.printer.StartDoc("x");
  f.printer.SetDrawWidth(10);
  const auto line = [&](DrawStyle style, double y) {
    f.printer.SetDrawStyle(style);
    f.printer.Line(1500, y, 7500, y, 0);  // 400 pixels
  };
  line(DrawStyle::kSolid, 1500);
  line(DrawStyle::kDash, 3000);
  line(DrawStyle::kDot, 4500);
  f.printer.EndDoc();
  const QImage page = f.Picture();
  const auto dark = [&](int y) {
    int n = 0;
    for (int x = 100; x < 500; ++x) n += page.pixelColor(x, y).value() < 128;
    return n;
  };
  EXPECT_EQ(dark(100), 400);
  EXPECT_NEAR(dark(200), 240, 20);  // 90 of 150 twips
  EXPECT_NEAR(dark(300), 133, 40);  // 15 of 45
}

TEST(QtPrinterTest, TextStandsBelowItsPlaceAndMovesToTheNextLine) {
  PdfFixture f;
  f.printer.StartDoc("x");
  f.printer.SetScale(-1500, 0);
  f.printer.SetFont({"", 24, true, false});
  EXPECT_NEAR(f.printer.TextHeight(), 24 * 20 * 1.15, 30);
  const double width = f.printer.TextWidth("HHH");
  EXPECT_NEAR(width, 3 * 0.722 * 480, 15);  // the standard width of a bold H
  f.printer.SetForeColour(0x0000FF);
  f.printer.SetCurrent(0, 1500);
  f.printer.Print("HHH");
  EXPECT_EQ(f.printer.CurrentX(), -1500);
  EXPECT_EQ(f.printer.CurrentY(), 1500 + f.printer.TextHeight());
  f.printer.EndDoc();
  const QImage page = f.Picture();
  int left = 10000, right = 0, top = 10000, bottom = 0;
  for (int y = 0; y < page.height(); ++y)
    for (int x = 0; x < page.width(); ++x)
      if (page.pixelColor(x, y).green() < 100) {
        left = std::min(left, x), right = std::max(right, x);
        top = std::min(top, y), bottom = std::max(bottom, y);
      }
  EXPECT_NEAR(left, 100, 4);
  EXPECT_NEAR(right, 100 + width / 15, 4);
  EXPECT_GT(top, 99);
  EXPECT_LT(bottom, 100 + f.printer.TextHeight() / 15);
}

TEST(QtPrinterTest, FontsThatCanBeNoneAreRefused) {
  PdfFixture f;
  EXPECT_EQ(ErrorOf([&] { f.printer.SetFont({"", 0, false, false}); }), kInvalidValue);
  EXPECT_EQ(ErrorOf([&] { f.printer.SetFont({"bad\nname", 8, false, false}); }), kInvalidValue);
  EXPECT_EQ(ErrorOf([&] {
              f.printer.SetFont({std::string(300, 'x'), 8, false, false});
            }),
            kInvalidValue);
}

TEST(QtPrinterTest, WhatLiesFarOffThePageIsCutAndComesToNoHarm) {
  PdfFixture f;
  f.printer.StartDoc("x");
  for (const DrawStyle style : {DrawStyle::kSolid, DrawStyle::kDash, DrawStyle::kDot}) {
    f.printer.SetDrawStyle(style);
    f.printer.Line(-2e9, -2e9, 2e9, 2e9, 0);
    f.printer.Box(-2e9, -2e9, 2e9, 2e9, 0);
    f.printer.Line(1e300, 0, 1e308, 5, 0);
    f.printer.Line(1.0 / 0.0, 0, 5, 5, 0);
  }
  f.printer.FilledBox(-2e9, 1e9, 2e9, 2e9, 0);
  f.printer.SetCurrent(2e9, 2e9);
  f.printer.Print("far");
  f.printer.SetCurrent(0.0 / 0.0, 0);
  f.printer.Print("nowhere");
  f.printer.EndDoc();
  ASSERT_EQ(f.files.size(), 1u);
  EXPECT_LT(f.files[0].size(), 100000u);
  const QImage page = f.Picture();
  EXPECT_LT(page.pixelColor(200, 200).value(), 200);  // the diagonal
  EXPECT_EQ(page.pixelColor(400, 100), QColor(Qt::white));
}

TEST(QtPrinterTest, APreviewHasThePageOfItsPrinterAndSendsNothing) {
  PdfFixture f;
  f.printer.SetOrientation(kLandscape);
  QtPreview preview(f.printer);
  EXPECT_EQ(preview.Page().width, f.printer.Page().width);
  preview.StartDoc("x");
  preview.Line(0, 0, 100, 100, 0);
  preview.EndDoc();
  EXPECT_EQ(preview.PageCount(), 1u);
  EXPECT_TRUE(f.files.empty());
}

}  // namespace
}  // namespace kora
