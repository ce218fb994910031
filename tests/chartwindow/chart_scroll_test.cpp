#include "chartwindow/chart_scroll.h"

#include "tests/chartwindow/window_fixture.h"

namespace kora {
namespace {

class ChartScrollTest : public ChartWindowTest {
 protected:
  void PutDays(const std::string& code, int count) {
    std::vector<PriceRec> days;
    for (int i = 0; i < count; ++i) {
      const int month = i / 28 + 1, day = i % 28 + 1;
      const auto two = [](int n) { return std::string(n < 10 ? "0" : "") + std::to_string(n); };
      days.push_back(test::Day("2025" + two(month) + two(day), 10, 11, 9, 10, 100));
    }
    home.Put("drive_c/korawin/data/" + code + ".WDT", test::Bytes(days));
    current.PriceFileName = code + ".WDT";
  }
  ChartScroll scroll{{.files = home.files(),
                      .dialogs = dialogs,
                      .settings = settings,
                      .current = current,
                      .state = state}};
};

TEST_F(ChartScrollTest, AFileOfExactlyAHundredRecordsHasTooFew) {
  PutDays("AAA", 100);
  EXPECT_FALSE(scroll.SetScrollBar());
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Too few records to show scroll bar");
  EXPECT_EQ(dialogs.said[0].title, "Chart Scroll");
  EXPECT_FALSE(state.ScrollInUse);
  PutDays("AAA", 101);
  EXPECT_TRUE(scroll.SetScrollBar());
  EXPECT_TRUE(state.ScrollInUse);
  EXPECT_EQ(scroll.Maximum(), 101);
  EXPECT_EQ(scroll.Value(), 101);
  EXPECT_EQ(scroll.DateText(), "17/4/25");
}

TEST_F(ChartScrollTest, APlaceLimitsTheChartAndTheLastClearsTheLimit) {
  PutDays("AAA", 120);
  ASSERT_TRUE(scroll.SetScrollBar());
  scroll.SetValue(30);
  EXPECT_EQ(scroll.DateText(), "2/2/25");
  scroll.Accept();
  EXPECT_TRUE(state.DateLimitOn);
  EXPECT_EQ(state.DateLimitDate, "20250202");
  EXPECT_EQ(state.ChosenLimitDate, "20250202");
  EXPECT_EQ(state.DateLimitText, "02/02/2025");
  EXPECT_EQ(state.ChosenLimitText, "2/2/25");
  ASSERT_TRUE(scroll.SetScrollBar());
  EXPECT_EQ(scroll.Value(), 30) << "where it was left";
  scroll.SetValue(120);
  scroll.Accept();
  EXPECT_FALSE(state.DateLimitOn);
  EXPECT_FALSE(state.ScrollInUse);
  ASSERT_TRUE(scroll.SetScrollBar());
  EXPECT_EQ(scroll.Value(), 120);
}

TEST_F(ChartScrollTest, AnotherFileBeginsAtItsEnd) {
  PutDays("AAA", 120);
  ASSERT_TRUE(scroll.SetScrollBar());
  scroll.SetValue(30);
  scroll.Accept();
  PutDays("BBB", 110);
  ASSERT_TRUE(scroll.SetScrollBar());
  EXPECT_EQ(scroll.Value(), 110);
  scroll.SetValue(0);
  EXPECT_EQ(scroll.Value(), 1);
  scroll.SetValue(999);
  EXPECT_EQ(scroll.Value(), 110);
}

TEST_F(ChartScrollTest, AFileThatIsNotThereIsTold) {
  current.PriceFileName = "NONE.WDT";
  EXPECT_FALSE(scroll.SetScrollBar());
  EXPECT_EQ(dialogs.said.size(), 1u);
}

}  // namespace
}  // namespace kora
