#include "indicators/swing_settings.h"

#include <gtest/gtest.h>

using namespace kora;

TEST(SwingSettingsTest, WordsOfTheKinds) {
  EXPECT_EQ(SwingKindOf("NORM"), SwingKind::kStandard);
  EXPECT_EQ(SwingKindOf("xday"), SwingKind::kDays);
  EXPECT_EQ(SwingKindOf("XPoint"), SwingKind::kPoints);
  EXPECT_EQ(SwingKindOf("XPOINTAUTO"), SwingKind::kPointsAuto);
  EXPECT_EQ(SwingKindOf(""), std::nullopt);
  EXPECT_EQ(SwingKindOf("XPoin"), std::nullopt);
  EXPECT_EQ(SwingWord(SwingKind::kPointsAuto), "XPointAuto");
  EXPECT_EQ(SwingWord(SwingKind::kNone), "");
}

TEST(SwingSettingsTest, SizeIsANumberOfOneAtLeast) {
  EXPECT_EQ(ReadSwingSize(" 3 "), 3);
  EXPECT_EQ(ReadSwingSize("1"), 1);
  EXPECT_EQ(ReadSwingSize("0.1"), std::nullopt);
  EXPECT_EQ(ReadSwingSize("2.3"), 2.3) << "of 64 bits";
  EXPECT_EQ(ReadSwingSize("1e2"), 100);
  for (const char* bad : {"", "0", "-4", "four", "3x", "nan", "1e99"})
    EXPECT_EQ(ReadSwingSize(bad), std::nullopt) << bad;
}

TEST(SwingSettingsTest, SwingComesOnWithAKindOfSizeOrAsStandard) {
  const auto show = [](SwingKind kind, double size) { return SwingToShow({kind, size}); };
  EXPECT_EQ(show(SwingKind::kStandard, 0).kind, SwingKind::kStandard);
  EXPECT_EQ(show(SwingKind::kDays, 0.5).size, 3);
  EXPECT_EQ(show(SwingKind::kPoints, 0).size, 3);
  EXPECT_EQ(show(SwingKind::kPoints, 7).size, 7);
  EXPECT_EQ(show(SwingKind::kPointsAuto, 7).kind, SwingKind::kStandard);
  EXPECT_EQ(show(SwingKind::kNone, 0).kind, SwingKind::kStandard);
}
