#include "chartwindow/multi_view.h"

#include <gtest/gtest.h>

namespace kora {
namespace {

TEST(MultiPageTest, PanelsShareAsMuchAsThePricePictureHas) {
  const MultiPage two = LayOutMultiPage(1200, 700, 2);
  EXPECT_EQ(two.width, 1200);
  EXPECT_EQ(two.price, 350);
  EXPECT_EQ(two.panel, 175);
  EXPECT_EQ(two.Height(2), 700);
  const MultiPage three = LayOutMultiPage(1200, 700, 3);
  EXPECT_EQ(three.price, 350);
  EXPECT_DOUBLE_EQ(three.panel, 350.0 / 3);
}

TEST(MultiPageTest, AWindowTooLowForThePanelsIsScrolled) {
  const MultiPage page = LayOutMultiPage(600, 300, 4);
  EXPECT_EQ(page.panel, 80);
  EXPECT_EQ(page.price, 320);
  EXPECT_EQ(page.Height(4), 640);
}

TEST(MultiPageTest, AWindowOfNothingHasAPageAllTheSame) {
  const MultiPage page = LayOutMultiPage(0, 0, 0);
  EXPECT_EQ(page.width, 1);
  EXPECT_EQ(page.price, 1);
}

}  // namespace
}  // namespace kora
