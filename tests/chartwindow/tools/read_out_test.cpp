#include "chartwindow/tools/read_out.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <limits>
#include <set>
#include <utility>

#include "chartwindow/tools/cross_hair.h"
#include "store/name_rec.h"
#include "tests/chartwindow/tools/small_chart.h"
#include "tests/support/recording_surface.h"

using namespace kora;
using kora::test::RecordingSurface;
using Ops = std::vector<std::string>;

namespace {

ChartBar Bar(std::string_view date, float open, float high, float low, float close,
             std::int32_t volume) {
  ChartBar bar{};
  if (!date.empty()) std::memcpy(bar.Date, date.data(), 8);
  bar.Open = open;
  bar.High = high;
  bar.Low = low;
  bar.Close = close;
  bar.Volume = volume;
  return bar;
}

// With three bars, the second without a date.
Composition Chart() {
  Composition chart = test::EmptyChart();
  chart.Bars.BarCount = 2;
  chart.Bars.bars = {Bar("20240103", 10.5f, 11.25f, 9.875f, 10, 1200), Bar("", 1, 1, 1, 1, 1),
                     Bar("20241231", 0.125f, 0.5f, 0.05f, 0.255f, 0)};
  return chart;
}

Composition LogChart() {
  Composition chart = Chart();
  chart.Price.Logarithmic = true;
  chart.Price.LogBase = float(std::log(10.0));
  chart.Price.LogFactor = -100;
  return chart;
}

constexpr CrossLimits kLimits{42, 631, 45, 450, true, 3, 141};

// Flips the pixels that a line covers, as an XOR pen does.
class XorSurface : public HeadlessSurface {
 public:
  using HeadlessSurface::HeadlessSurface;
  std::set<std::pair<int, int>> lit;
  void SetDrawMode(DrawMode mode) override { mode_ = mode; }
  void Line(double x1, double y1, double x2, double y2, Colour) override {
    for (int x = int(std::min(x1, x2)); x <= int(std::max(x1, x2)); ++x)
      for (int y = int(std::min(y1, y2)); y <= int(std::max(y1, y2)); ++y) {
        const std::pair<int, int> pixel{x, y};
        if (mode_ == DrawMode::kXor && lit.erase(pixel) == 1) continue;
        lit.insert(pixel);
      }
  }

 private:
  DrawMode mode_ = DrawMode::kCopy;
};

}  // namespace

TEST(ReadOutTest, ColumnIsRoundedHalfToEven) {
  const Composition chart = Chart();
  EXPECT_EQ(ColumnOf(chart, 42), 0);
  EXPECT_EQ(ColumnOf(chart, 44), 0);  // 0.5
  EXPECT_EQ(ColumnOf(chart, 45), 1);
  EXPECT_EQ(ColumnOf(chart, 48), 2);   // 1.5
  EXPECT_EQ(ColumnOf(chart, 36), -2);  // -1.5
}

TEST(ReadOutTest, ColumnBeyondTheLastBarIsTheLastBar) {
  const Composition chart = Chart();
  EXPECT_EQ(ColumnOf(chart, 631), 2);
  EXPECT_EQ(BarReadout(chart, kShare, ColumnOf(chart, 631))->at(0), "31-12-24");
}

TEST(ReadOutTest, ColumnsStandOneRightOfTheirX) {
  const Composition chart = Chart();
  EXPECT_EQ(XOfColumn(chart, 0), 43);
  EXPECT_EQ(XOfColumn(chart, 3), 55);
}

TEST(ReadOutTest, PixelsArePricesToTwoDecimals) {
  const Composition chart = Chart();
  EXPECT_DOUBLE_EQ(PixelToPrice(chart, 430), 10);
  EXPECT_DOUBLE_EQ(PixelToPrice(chart, 230), 20);
  EXPECT_DOUBLE_EQ(PixelToPrice(chart, 231), 19.95);
}

TEST(ReadOutTest, PricesBelowThirtyCentsHaveThreeDecimals) {
  Composition chart = Chart();
  chart.Price.ScaleLow = 0.1f;
  chart.Price.PricePerY = 0.0012f;
  EXPECT_DOUBLE_EQ(PixelToPrice(chart, 427), 0.104);  // 0.1036
  EXPECT_DOUBLE_EQ(PixelToPrice(chart, 264), 0.299);  // 0.2992
  EXPECT_DOUBLE_EQ(PixelToPrice(chart, 262), 0.3);    // 0.3016
}

TEST(ReadOutTest, PricesArePixelsRoundedHalfToEven) {
  Composition chart = Chart();
  EXPECT_EQ(PriceToPixel(chart, 10), 430);
  EXPECT_EQ(PriceToPixel(chart, 20), 230);
  EXPECT_EQ(PriceToPixel(chart, 19.96), 231);
  chart.Price.PricePerY = 0.5f;
  EXPECT_EQ(PriceToPixel(chart, 10.25), 430);  // 429.5
  EXPECT_EQ(PriceToPixel(chart, 10.75), 428);  // 428.5
}

TEST(ReadOutTest, LogarithmicScaleBothWays) {
  const Composition chart = LogChart();
  EXPECT_EQ(PriceToPixel(chart, 20), 360);            // 430 - 69.3 down to the whole
  EXPECT_DOUBLE_EQ(PixelToPrice(chart, 360), 20.14);  // 10 * e^0.7 = 20.1375
  EXPECT_DOUBLE_EQ(PixelToPrice(chart, 430), 10);
}

TEST(ReadOutTest, WhatCannotBeComputedIsZero) {
  Composition chart = Chart();
  EXPECT_EQ(PriceToPixel(chart, 1e9), 0);  // beyond 16 bits
  chart.Price.PricePerY = 0;
  EXPECT_EQ(PriceToPixel(chart, 12), 0);
  chart.BarSpacing = 0;
  EXPECT_EQ(ColumnOf(chart, 100), 0);
  chart.Price.PricePerY = std::numeric_limits<float>::infinity();
  EXPECT_EQ(PixelToPrice(chart, 100), 0);
  Composition log = LogChart();
  EXPECT_EQ(PriceToPixel(log, 0), 0);
  EXPECT_EQ(PriceToPixel(log, -3), 0);
  log.Price.LogFactor = 0;
  EXPECT_EQ(PixelToPrice(log, 100), 0);
}

TEST(ReadOutTest, PointAndFigureReadsThePriceOfARow) {
  const Composition chart = Chart();
  const PFBoxes boxes{0.5f, 8};
  EXPECT_DOUBLE_EQ(PFPixelToPrice(chart, boxes, 430), 10);
  EXPECT_DOUBLE_EQ(PFPixelToPrice(chart, boxes, 415), 10.5);  // row 1.875, whole part 1
  EXPECT_DOUBLE_EQ(PFPixelToPrice(chart, boxes, 414), 11);
  EXPECT_EQ(PFPriceToPixel(chart, boxes, 11), 414);
  EXPECT_EQ(PFPriceToPixel(chart, boxes, 10.75), 414);  // 1.5 rows: 2
  EXPECT_EQ(PFPriceToPixel(chart, boxes, 11.25), 414);  // 2.5 rows: 2
  EXPECT_EQ(PFPixelToPrice(chart, {}, 415), 0);
  EXPECT_EQ(PFPriceToPixel(chart, {}, 11), 0);
}

TEST(ReadOutTest, FormatOfAPointAndFigurePrice) {
  EXPECT_EQ(ReadoutFormat(1), "########.0");
  EXPECT_EQ(ReadoutFormat(2), "########.0");
  EXPECT_EQ(ReadoutFormat(3), "#######0");
  EXPECT_EQ(ReadoutFormat(4), "#######.00");
  EXPECT_EQ(ReadoutFormat(5), "#######0");
}

TEST(ReadOutTest, PanelsOfAShare) {
  EXPECT_EQ(*BarReadout(Chart(), kShare, 0),
            (ReadoutTexts{"03-01-24", "Open  10.50", "High  11.25", "Low  9.875", "Close  10.00",
                          "Vol  1200"}));
  // A price below 1 has no digit before the point.
  EXPECT_EQ(*BarReadout(Chart(), kShare, 2), (ReadoutTexts{"31-12-24", "Open  .125", "High  .50",
                                                           "Low  .05", "Close  .255", "Vol  0"}));
}

TEST(ReadOutTest, PanelsOfTheOtherTypes) {
  EXPECT_EQ(*BarReadout(Chart(), kCloseVolume, 0),
            (ReadoutTexts{"03-01-24", "Close  10.00", "Vol  1200", "", "", ""}));
  EXPECT_EQ(*BarReadout(Chart(), kCloseOnly, 0),
            (ReadoutTexts{"03-01-24", "Close  10.00", "Vol  1200", "", "", ""}));
  EXPECT_EQ(*BarReadout(Chart(), kAdvanceDecline, 0),
            (ReadoutTexts{"03-01-24", "Rise  11", "Fall  10", "Total  10", "Vol  1200", ""}));
  EXPECT_EQ(*BarReadout(Chart(), kIndex, 2),
            (ReadoutTexts{"31-12-24", "Open  0", "High  1", "Low  0", "Close  0", "Vol  0"}));
}

TEST(ReadOutTest, VolumesInHundredsShowTheirZeros) {
  Composition chart = Chart();
  chart.VolLabel = "'00";
  EXPECT_EQ(BarReadout(chart, kShare, 0)->at(5), "Vol  120000");
  EXPECT_EQ(BarReadout(chart, kShare, 2)->at(5), "Vol  0");
  chart.VolLabel = "'0";
  EXPECT_EQ(BarReadout(chart, kShare, 0)->at(5), "Vol  1200");
}

TEST(ReadOutTest, BarWithoutADateLeavesThePanels) {
  EXPECT_EQ(BarReadout(Chart(), kShare, 1), std::nullopt);
  Composition blank = Chart();
  blank.Bars.bars[0] = Bar("        ", 1, 1, 1, 1, 1);
  EXPECT_EQ(BarReadout(blank, kShare, 0), std::nullopt);
}

TEST(ReadOutTest, ColumnsWithoutABarLeaveThePanels) {
  EXPECT_EQ(BarReadout(Chart(), kShare, -1), std::nullopt);
  EXPECT_EQ(BarReadout(Composition{}, kShare, 0), std::nullopt);
  Composition chart = Chart();
  chart.Bars.BarCount = 30;  // more than there are
  EXPECT_EQ(BarReadout(chart, kShare, 30)->at(0), "31-12-24");
}

TEST(CrossHairTest, IsAnInvertedLWithALineInThePanel) {
  RecordingSurface price(638, 452), panel(638, 144);
  CrossHair cross(price, &panel, 25);
  EXPECT_TRUE(cross.Move(100, 200, kLimits));
  EXPECT_EQ(price.ops, (Ops{"xor dot 100,200,100,450 25", "xor dot 42,200,100,200 25"}));
  EXPECT_EQ(panel.ops, (Ops{"xor dot 100,3,100,141 25"}));
  EXPECT_EQ(cross.GridX(), 100);
  EXPECT_EQ(cross.GridY(), 200);
}

TEST(CrossHairTest, LeavesTheCopyPenSolidBetweenMoves) {
  RecordingSurface price(638, 452);
  CrossHair cross(price, nullptr, 25);
  cross.Move(100, 200, kLimits);
  price.ops.clear();
  price.Line(1, 2, 3, 4, 5);
  EXPECT_EQ(price.ops, (Ops{"line solid 1,2,3,4 5"}));
}

TEST(CrossHairTest, MovingErasesWithTheLinesThatWereDrawn) {
  RecordingSurface price(638, 452);
  CrossHair cross(price, nullptr, 25);
  cross.Move(100, 200, kLimits);
  price.ops.clear();
  CrossLimits moved = kLimits;
  moved.Left = 50;
  moved.Bottom = 300;
  cross.Move(110, 210, moved);
  EXPECT_EQ(price.ops, (Ops{"xor dot 100,200,100,450 25", "xor dot 42,200,100,200 25",
                            "xor dot 110,210,110,300 25", "xor dot 50,210,110,210 25"}));
}

TEST(CrossHairTest, PointerOutsideThePlotLeavesNoCrossHair) {
  RecordingSurface price(638, 452);
  CrossHair cross(price, nullptr, 25);
  for (const auto& [x, y] : {std::pair{41, 200}, {632, 200}, {100, 44}, {100, 451}}) {
    EXPECT_TRUE(cross.Move(100, 200, kLimits));
    EXPECT_FALSE(cross.Move(x, y, kLimits));
    EXPECT_FALSE(cross.Drawn());
    EXPECT_EQ(cross.GridX(), 0);
    EXPECT_EQ(price.ops.size(), 4u);
    price.ops.clear();
  }
  EXPECT_TRUE(cross.Move(42, 45, kLimits));  // the edges belong to the plot
  EXPECT_TRUE(cross.Move(631, 450, kLimits));
}

TEST(CrossHairTest, PointAndFigureHasNoVerticalLine) {
  RecordingSurface price(638, 452), panel(638, 144);
  CrossHair cross(price, &panel, 25);
  CrossLimits limits = kLimits;
  limits.Columns = false;
  EXPECT_TRUE(cross.Move(100, 200, limits));
  EXPECT_EQ(price.ops, (Ops{"xor dot 42,200,100,200 25"}));
  EXPECT_TRUE(panel.ops.empty());
}

TEST(CrossHairTest, HiddenPanelGetsNoLineButOneDrawnBeforeIsErased) {
  RecordingSurface price(638, 452), panel(638, 144);
  CrossHair cross(price, &panel, 25);
  cross.Move(100, 200, kLimits);
  panel.SetVisible(false);
  cross.Move(110, 200, kLimits);
  EXPECT_EQ(panel.ops, (Ops{"xor dot 100,3,100,141 25", "xor dot 100,3,100,141 25"}));
}

TEST(CrossHairTest, FreshPictureHasNothingToErase) {
  RecordingSurface price(638, 452);
  CrossHair cross(price, nullptr, 25);
  cross.Move(100, 200, kLimits);
  price.ops.clear();
  cross.Forget();
  cross.Erase();
  EXPECT_TRUE(price.ops.empty());
}

TEST(CrossHairTest, LeavesThePictureItFound) {
  XorSurface price(638, 452), panel(638, 144);
  for (int i = 0; i < 200; ++i) price.lit.insert({i * 3, (i * i) % 452});
  panel.Line(0, 70, 638, 70, 1);
  const auto priceBefore = price.lit, panelBefore = panel.lit;
  CrossHair cross(price, &panel, 25);
  for (int i = 0; i < 60; ++i) cross.Move((i * 97) % 700, (i * 41) % 460, kLimits);
  EXPECT_TRUE(cross.Move(300, 300, kLimits));
  EXPECT_NE(price.lit, priceBefore);
  EXPECT_NE(panel.lit, panelBefore);
  cross.Erase();
  EXPECT_EQ(price.lit, priceBefore);
  EXPECT_EQ(panel.lit, panelBefore);
}

TEST(CrossHairTest, LimitsReachDownToTheVolumePanel) {
  const CrossLimits limits = LimitsOf(Chart(), Style::kBar);
  EXPECT_EQ(limits.Left, 42);
  EXPECT_EQ(limits.Right, 631);
  EXPECT_EQ(limits.Top, 45);
  EXPECT_EQ(limits.Bottom, 450);
  EXPECT_TRUE(limits.Columns);
  EXPECT_FALSE(LimitsOf(Chart(), Style::kPointFigure).Columns);
  EXPECT_EQ(LimitsOf(Chart(), Style::kBar, true, 9).Top, 9);
}
