#include "chartwindow/tools/cross_hair.h"

#include <gtest/gtest.h>

#include "platform/qt/qt_surface.h"

using namespace kora;

TEST(CrossHairPixelTest, LeavesTheVeryPictureItFoundAtAnyScreenScale) {
  for (const double dpr : {1.0, 1.25, 1.5, 2.0}) {
    QtRasterSurface price(320, 240, dpr), panel(320, 80, dpr);
    for (QtRasterSurface* surface : {&price, &panel}) {
      surface->SetBackColour(0x203040);
      surface->Cls();
      for (int i = 0; i < 40; ++i) surface->Line(i * 8, 5, 320 - i * 5, 75, 0xFF8000 + i);
      surface->FilledBox(50, 20, 120, 60, 0x00FFFF);
    }
    const QImage priceBefore = price.image().copy(), panelBefore = panel.image().copy();
    CrossHair cross(price, &panel, 0xC0C0C0);
    const CrossLimits limits{20, 310, 10, 230, true, 2, 78};
    for (int i = 0; i < 50; ++i) cross.Move((i * 53) % 330, (i * 31) % 240, limits);
    ASSERT_TRUE(cross.Move(100, 100, limits));
    EXPECT_NE(price.image(), priceBefore) << dpr;
    EXPECT_NE(panel.image(), panelBefore) << dpr;
    cross.Erase();
    EXPECT_EQ(price.image(), priceBefore) << dpr;
    EXPECT_EQ(panel.image(), panelBefore) << dpr;
  }
}
