#include <gtest/gtest.h>

#include "platform/headless/headless_surface.h"
#include "platform/text_metrics.h"

using namespace kora;

TEST(TextMetricsTest, WidthsAreThousandthsOfTheSizeInChartUnits) {
  SurfaceFont font;
  font.size = 7.5;  // 10 chart units
  EXPECT_NEAR(StandardTextWidth("0", font), 5.56, 1e-9);
  EXPECT_NEAR(StandardTextWidth("0123456789", font), 55.6, 1e-9);
  EXPECT_NEAR(StandardTextWidth("1.25", font), 3 * 5.56 + 2.78, 1e-9);
  // B 667, H 722, P 667, blank 278
  EXPECT_NEAR(StandardTextWidth("BHP ", font), 23.34, 1e-9);
  EXPECT_NEAR(StandardTextWidth("Will", font), 9.44 + 3 * 2.22, 1e-9);
  EXPECT_EQ(StandardTextWidth("", font), 0);
  font.bold = true;
  // bold: digits stay 556, B 722, H 722, P 667
  EXPECT_NEAR(StandardTextWidth("0", font), 5.56, 1e-9);
  EXPECT_NEAR(StandardTextWidth("BHP", font), 21.11, 1e-9);
}

TEST(TextMetricsTest, OtherLettersCountAsADigitEach) {
  SurfaceFont font;
  font.size = 7.5;
  EXPECT_NEAR(StandardTextWidth("\u00E9", font), 5.56, 1e-9);
  EXPECT_NEAR(StandardTextWidth("\u20AC\u00E9", font), 11.12, 1e-9);
  EXPECT_NEAR(StandardTextWidth("\t", font), 5.56, 1e-9);
}

TEST(TextMetricsTest, HeightIsWholeUnits) {
  SurfaceFont font;
  EXPECT_EQ(font.size, 8.25);               // 11 units
  EXPECT_EQ(StandardTextHeight(font), 13);  // 12.639
  EXPECT_NEAR(StandardAscent(font), 9.955, 1e-9);
  font.size = 7.5;
  EXPECT_EQ(StandardTextHeight(font), 12);  // 11.49
}

TEST(TextMetricsTest, FacesThatShareTheWidths) {
  SurfaceFont font;
  EXPECT_TRUE(HasStandardMetrics(font));
  font.name = "ARIAL";
  EXPECT_TRUE(HasStandardMetrics(font));
  font.name = "Arial Narrow";
  EXPECT_FALSE(HasStandardMetrics(font));
}

TEST(HeadlessSurfaceTest, MeasuresInWholeUnitsHalfToEven) {
  HeadlessSurface surface(640, 480);
  SurfaceFont font;
  font.size = 7.5;
  surface.SetFont(font);
  EXPECT_EQ(surface.TextWidth("0"), 6);     // 5.56
  EXPECT_EQ(surface.TextWidth("BHP"), 21);  // 20.56
  EXPECT_EQ(surface.TextHeight(), 12);
  font.size = 93.75;          // 125 units
  font.name = "Courier New";  // widths stay the standard ones
  surface.SetFont(font);
  EXPECT_EQ(surface.Font(), font);
  EXPECT_EQ(surface.TextWidth("00"), 139);  // 1112 thousandths of 125
  EXPECT_EQ(surface.TextWidth("k"), 62);    // 500 thousandths: 62.5
}

TEST(HeadlessSurfaceTest, PrintMovesToTheNextLinesStart) {
  HeadlessSurface surface(640, 480);
  surface.SetCurrent(20, 7);
  EXPECT_EQ(surface.CurrentX(), 20);
  surface.Print("text");
  EXPECT_EQ(surface.CurrentX(), 0);
  EXPECT_EQ(surface.CurrentY(), 7 + 13);
  surface.Cls();
  EXPECT_EQ(surface.CurrentY(), 0);
}

TEST(HeadlessSurfaceTest, ScaleIsItsSizeUntilSet) {
  HeadlessSurface surface(640, 480);
  EXPECT_EQ(surface.ScaleWidth(), 640);
  surface.SetScale(0, 0, 800, 600);
  EXPECT_EQ(surface.ScaleWidth(), 800);
  EXPECT_EQ(surface.ScaleHeight(), 600);
  EXPECT_EQ(surface.Width(), 640);
  surface.SetWidth(3000);
  EXPECT_EQ(surface.Width(), 3000);
  surface.SetVisible(false);
  EXPECT_FALSE(surface.Visible());
}
