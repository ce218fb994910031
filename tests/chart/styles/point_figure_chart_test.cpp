#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "chart/styles/point_figure.h"
#include "tests/chart/composer_fixture.h"

using namespace kora;

namespace {

// Boxes of 1 on a scale from 5: row r stands at y 429 - 6 r, and the plot is 42 to 631 wide and 45
// to 429 high.
struct PointFigureFixture : test::ComposerFixture {
  PointFigureFixture() {
    request.ChartStyle = Style::kPointFigure;
    request.BarSpacing = 3;
    request.AutoScale = false;
    request.Name.Base = 5;
    request.Name.Top = 69;
    request.PFAutoBox = false;
    request.PFBoxSize = 1;
  }
  void Closes(std::initializer_list<float> closes, std::string_view from = "20240301") {
    std::int32_t day = DayNumber(*ParseFileDate(from));
    for (const float c : closes) Day(FormatFileDate(DateOfDayNumber(day++)), c, c, c, c);
  }
  // The boxes in the script, without the frame.
  std::vector<std::string> Boxes() const {
    std::vector<std::string> out;
    for (const std::string& line : Script())
      if ((line[0] == 'B' && line != kFrame) || line[0] == 'X') out.push_back(line);
    return out;
  }
  static constexpr const char* kFrame = "B,42,45,631,429,16";
};

using Lines = std::vector<std::string>;

}  // namespace

TEST(PointFigureChartTest, BoxesStandAtTheirRowsAndColumns) {
  PointFigureFixture f;
  f.Closes({10, 11.5f, 13, 12, 10});
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Boxes(), (Lines{
                           "B,47,397,51,401,18",  // 10, row 5
                           "B,47,391,51,395,18",  // 11
                           "B,47,385,51,389,18",  // 12
                           "B,47,379,51,383,18",  // 13
                           "X,53,385,57,389,28",  // a column to the right: 12, 11, 10
                           "X,53,391,57,395,28",
                           "X,53,397,57,401,28",
                       }));
  EXPECT_EQ(f.chart.LastBarX, 55);
  EXPECT_EQ(f.chart.Boxes.PFBoxSize, 1);
  EXPECT_EQ(f.chart.Boxes.PFBoxPixels, 6);
  // Falls are outlines on the screen; paper fills them.
  EXPECT_TRUE(f.price.Has("box 53,385,57,389 28"));
  EXPECT_TRUE(f.price.Has("fill 47,397,51,401 18"));
}

TEST(PointFigureChartTest, ScaleFrameAndBoxValueStandInTheScript) {
  PointFigureFixture f;
  f.request.GridLines = true;
  f.Closes({10, 11});
  ASSERT_TRUE(f.Compose());
  // 64 rows, a label every 5: 5, 10, ... 65 at y 429, 399, ... 69.
  EXPECT_TRUE(f.Wrote("L,42,429,37,429,16"));
  EXPECT_TRUE(f.Wrote("L,42,69,37,69,16"));
  EXPECT_FALSE(f.Wrote("V,42,429,631,429,35"));
  EXPECT_TRUE(f.Wrote("V,42,399,631,399,35"));
  EXPECT_TRUE(f.Wrote("V,42,69,631,69,35"));
  EXPECT_TRUE(f.Wrote("T,8.25,300,29,Box Value = 1,16"));
  EXPECT_TRUE(f.Wrote(PointFigureFixture::kFrame));
  int labels = 0;
  for (const std::string& line : f.Lines('T'))
    if (line.find(".00,27") != std::string::npos) ++labels;
  EXPECT_EQ(labels, 13);
  EXPECT_TRUE(f.Lines('H').empty());
  EXPECT_TRUE(f.Wrote("Z,7,601,35,KORA,27"));
}

TEST(PointFigureChartTest, NoCloseEverMovesAFullBox) {
  PointFigureFixture f;
  f.Closes({10, 10.5f, 9.5f, 10.2f});
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Boxes(), Lines{"B,47,397,51,401,18"});
}

TEST(PointFigureChartTest, OneRecordIsOneBox) {
  PointFigureFixture f;
  f.Closes({10});
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Boxes(), Lines{"B,47,397,51,401,18"});
}

TEST(PointFigureChartTest, SecurityWithoutACloseGivesAnEmptyPlot) {
  PointFigureFixture f;
  f.Closes({0, 0, 0});
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.Boxes(), Lines{});
}

TEST(PointFigureChartTest, ReversalOfOneOrSevenChartsWithTwo) {
  Lines two;
  for (const std::int16_t reversal : std::initializer_list<std::int16_t>{2, 1, 7, 40, 0}) {
    PointFigureFixture f;
    f.request.BarSpacing = reversal;
    f.Closes({10, 13, 11, 14, 10});
    ASSERT_TRUE(f.Compose());
    if (reversal == 2) two = f.Boxes();
    EXPECT_EQ(f.Boxes(), two) << reversal;
    EXPECT_EQ(f.chart.LastBarX, 49 + 3 * 6) << reversal;
  }
}

TEST(PointFigureChartTest, LatestColumnsShowWithTenToSpare) {
  // Bars 0 and 1 are the first of 120 columns, each bar behind them one more. 98 fit: the chart
  // begins with column 32, at bar 32.
  PointFigureFixture f;
  std::int32_t day = DayNumber({2023, 2, 1});
  for (int i = 0; i <= 120; ++i) {
    const float c = i % 2 == 0 ? 10 : 13;
    f.Day(FormatFileDate(DateOfDayNumber(day++)), c, c, c, c);
  }
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.LastBarX, 49 + 6 * 87);
  EXPECT_EQ((631 - f.chart.LastBarX) / 6, 10);
  EXPECT_EQ(f.Boxes()[0], "B,47,397,51,401,18");
  EXPECT_EQ(f.Boxes().size(), 1u + 88 * 3);
  // Blank space at the end takes columns off it.
  f.request.BlankSpace = 60;
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.LastBarX, 49 + 6 * 77);
}

TEST(PointFigureChartTest, FirstBoxOfAYearIsSolidInTheColourOfTheScale) {
  // Four columns in December bring the columns to x 67, past the 64 units that a year line needs.
  PointFigureFixture f;
  f.Closes({10, 13, 10, 13, 10, 10.5f, 13}, "20231227");  // the sixth on 1 January
  ASSERT_TRUE(f.Compose());
  const Lines boxes = f.Boxes();
  ASSERT_EQ(boxes.size(), 16u);
  EXPECT_EQ(boxes[12], "X,65,397,69,401,28");  // the last box of the fourth column
  EXPECT_EQ(boxes[13], "B,71,391,75,395,27");
  EXPECT_EQ(boxes[14], "B,71,385,75,389,18");
  EXPECT_TRUE(f.Wrote("D,67,431,67,45,27"));
  EXPECT_TRUE(f.Wrote("T,8.25,67,431,2024,27"));
}

TEST(PointFigureChartTest, FullFrameGoesOnFromTheLeftAndTheScriptWithIt) {
  // Swings that turn from the grid of the first bar shown, and not from that of the file: the dry
  // run sees 20 columns, the chart gets 45, in a frame for 24.
  PointFigureFixture f;
  f.price = test::RecordingSurface(200, 452);
  std::int32_t day = DayNumber({2024, 3, 1});
  const auto close = [&](float c) { f.Day(FormatFileDate(DateOfDayNumber(day++)), c, c, c, c); };
  for (int i = 0; i < 20; ++i) close(i == 0 ? 20 : i % 2 ? 30 : 20.6f);
  for (int i = 0; i < 30; ++i) close(i % 2 == 0 ? 24.5f : 27.7f);
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.FirstBarX, 48);
  EXPECT_EQ(f.chart.LastBarX, 49 + 6 * 20);  // the 21 columns behind the first 24
  int frames = 0;
  for (const std::string& line : f.Script()) frames += line == "B,42,45,198,429,16";
  EXPECT_EQ(frames, 1);
  EXPECT_EQ(f.Boxes().size() - size_t(frames), 21u * 3);
  EXPECT_TRUE(f.price.Has("fill 43,46,199,450 17"));
}

TEST(PointFigureChartTest, BoxValueIsTheComputedOneTheUsersOrThatOfTheNameRecord) {
  PointFigureFixture f;
  f.Closes({10, 20, 10});
  const auto box = [&] {
    EXPECT_TRUE(f.Compose());
    return f.chart.Boxes.PFBoxSize;
  };
  f.request.Name.Top = 25;  // 20 on 64 rows: 0.3125
  f.request.Name.PFInc = 0.5f;
  EXPECT_FLOAT_EQ(box(), 1);
  f.request.PFBoxSize = 0;
  EXPECT_FLOAT_EQ(box(), 0.5f);
  f.request.Name.PFInc = 0;
  EXPECT_FLOAT_EQ(box(), 0.312f);
  f.request.Name.PFInc = 0.5f;
  f.request.PFAutoBox = true;
  EXPECT_FLOAT_EQ(box(), 0.312f);
  // The lower limit holds for all of them.
  f.request.PFAutoBox = false;
  f.request.Name.Base = 9;
  f.request.Name.Top = 9.1f;
  f.days.clear();
  f.Closes({9, 9.05f});
  for (const float low : {0.001f, -1.0f}) {
    f.request.PFBoxSize = low;
    EXPECT_FLOAT_EQ(box(), 0.003f);
  }
}

TEST(PointFigureChartTest, AutomaticScaleAsksForTheBoxValueProposingTheComputedOne) {
  PointFigureFixture f;
  f.request.AutoScale = true;
  f.request.PFBoxSize = 0;
  f.request.Name.PFInc = 7;  // of manual scales alone
  f.Closes({25, 30});
  float proposed = 0;
  f.services.AskBoxValue = [&](float computed) {
    proposed = computed;
    return 0.5f;
  };
  ASSERT_TRUE(f.Compose());
  EXPECT_FLOAT_EQ(proposed, 0.103f);  // 24.6 to 31.2 on 64 rows
  EXPECT_FLOAT_EQ(f.chart.Boxes.PFBoxSize, 0.5f);
  f.services.AskBoxValue = nullptr;
  ASSERT_TRUE(f.Compose());
  EXPECT_FLOAT_EQ(f.chart.Boxes.PFBoxSize, 0.103f);
}

TEST(PointFigureChartTest, ScaleWithAZeroAtOneEndIsRefused) {
  PointFigureFixture f;
  f.request.Name.Base = 0;
  f.Closes({10, 11});
  EXPECT_FALSE(f.Compose());
  EXPECT_TRUE(f.chart.ScaleMissing);
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_NE(f.dialogs.said[0].text.find("MANUAL SCALING"), std::string::npos);
}

TEST(PointFigureChartTest, BoxesBeyondTheSurfacesNumbersAreToldWithTheirDateAndDrawNothingLong) {
  PointFigureFixture f;
  f.request.Name.RecType = kIndex;
  f.request.AutoScale = true;
  f.request.PFBoxSize = 0.003f;
  std::int32_t day = DayNumber({2000, 1, 1});
  for (int i = 0; i < 5000; ++i) {
    const float c = i % 2 == 0 ? 24000 : 24050;
    f.Day(FormatFileDate(DateOfDayNumber(day++)), c, c, c, c);
  }
  EXPECT_FALSE(f.Compose());
  ASSERT_EQ(f.dialogs.said.size(), 1u);
  EXPECT_EQ(f.dialogs.said[0].title, "Chart Display");
  EXPECT_EQ(f.dialogs.said[0].text.find("There is a problem with the data for TEST.WDT"), 0u);
  EXPECT_LT(f.price.ops.size(), 20000u);
}

TEST(PointFigureChartTest, WholeFileIsReadWhateverFitsAndWhereverItEnds) {
  PointFigureFixture f;
  f.Days("20200101", 700);
  f.request.FinishDateOn = true;
  f.request.FinishDate = "20200601";
  ASSERT_TRUE(f.Compose());
  EXPECT_EQ(f.chart.Bars.FirstDataRec, 1);
  EXPECT_EQ(f.chart.Bars.LastDataRec, 700);
}
