#include "scans/scan_report.h"

#include <gtest/gtest.h>

using namespace kora;

using Texts = std::vector<std::string>;

namespace {

ScanReport Small() {
  return {
      .title = "Chart Scan <1>",
      .date = "30/10/2026",
      .criteria = {"a & b"},
      .columns = {"Code", "Last"},
      .rows = {{"A\"B", "1.00"}, {"CCC", "-3%D"}},
      .right = {false, true},
      .notes = {"done"},
      .pictures = {{.code = "A\"B", .name = "X", .type = "image/png", .bytes = "Man", .fault = {}},
                   {.code = "CCC", .name = "Y", .type = {}, .bytes = {}, .fault = "no <file>"}}};
}

bool Has(const std::string& page, const std::string& part) {
  return page.find(part) != std::string::npos;
}

}  // namespace

TEST(ScanReportTest, TextsCantBreakThePage) {
  const std::string page = ReportHtml(Small());
  EXPECT_TRUE(Has(page, "<h1>Chart Scan &lt;1&gt;</h1>"));
  EXPECT_TRUE(Has(page, "<li>a &amp; b</li>"));
  EXPECT_TRUE(Has(page, "<p>no &lt;file&gt;</p>"));
  EXPECT_TRUE(Has(page, "<a href=\"#chart-A_22B\">A&quot;B</a>"));
  EXPECT_TRUE(Has(page, "<figure id=\"chart-A_22B\">"));
  EXPECT_FALSE(Has(page, "A\"B"));
}

TEST(ScanReportTest, PicturesStandInThePage) {
  EXPECT_TRUE(Has(ReportHtml(Small()), "src=\"data:image/png;base64,TWFu\""));
  ScanReport report = Small();
  for (const auto& [bytes, text] : {std::pair("M", "TQ=="), std::pair("Ma", "TWE="),
                                    std::pair("\xFF\xFE\xFD\xFC", "//79/A==")}) {
    report.pictures[0].bytes = bytes;
    EXPECT_TRUE(Has(ReportHtml(report), std::string("base64,") + text + "\"")) << text;
  }
}

TEST(ScanReportTest, NumbersStandToTheRightAndFallsAreRed) {
  const std::string page = ReportHtml(Small());
  EXPECT_TRUE(Has(page, "<td class=\"n\">1.00</td>"));
  EXPECT_TRUE(Has(page, "<td class=\"n fall\">-3%D</td>"));
  EXPECT_TRUE(Has(page, "<h2>2 rows</h2>"));
}

TEST(ScanReportTest, CriteriaAreTheTickedOnes) {
  Scan1Choices one;
  EXPECT_TRUE(CriteriaOf(one).empty());
  one.Check7 = one.Check16 = one.Check12 = one.Check10 = true;
  one.oscillators[kRsi] = one.oscillators[kStochastic] = true;
  EXPECT_EQ(CriteriaOf(one), (Texts{"Closing price from 0.50 to 5.00", "No warrants",
                                    "Oscillators: Stochastic, R.S.I", "Signals: cut OB, OS"}));
  Scan2Choices two;
  two.Check2 = true;
  EXPECT_EQ(CriteriaOf(two), Texts{"Volume 600 % above 1"});
  two.Text5 = "5";
  EXPECT_EQ(CriteriaOf(two), Texts{"Volume 600 % above the average of the last 5 days"});
  Scan3Choices three;
  three.Check5 = three.Check2 = true;
  three.Text3 = "4";
  EXPECT_EQ(CriteriaOf(three), (Texts{"Parabolic stop broken downwards", "Category 4 only"}));
}
