#include "lists/text_print_out.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/support/error_of.h"
#include "tests/support/recording_printer.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::RecordingPrinter;
using Ops = std::vector<std::string>;

namespace {

struct PrintOutFixture {
  RecordingPrinter printer;
  FontSettings fonts;
  PageSettings page;
  TextPrintLayout layout;

  PrintOutFixture() {
    fonts.TitleSize = 10;  // a line is 200 twips high, a letter 100 wide
    fonts.Font2Size = 10;
    layout.heading = "NAMES";
    layout.lineHeight = 1;
    page.PPLft = 506;  // 10,000 twips are left of 11,506
    page.PPRht = 1000;
    page.PPTop = 300;
  }
};

}  // namespace

TEST(TextPrintOutTest, HeadingPageNumberColumnsAndLinesStandWithinTheMargins) {
  PrintOutFixture f;
  f.fonts.Font1Name = "One";
  f.fonts.Font2Name = "Two";
  f.layout.columns = {"Code", "Name"};
  f.layout.at = {0.1, 0.5};
  TextPrintOut out(f.printer, f.fonts, f.page, f.layout);
  out.Line({"ORE", "Ore Holdings"});
  out.Line({"ABC", "", "too many"});
  out.End();
  ASSERT_EQ(f.printer.sent.size(), 1u);
  EXPECT_EQ(f.printer.sent[0],
            (Ops{"text 10 b One 506,300 NAMES 0", "text 10 b One 8506,300 Page  1 0",
                 "text 10 b One 1506,700 Code 0", "text 10 b One 5506,700 Name 0",
                 "text 10 Two 1506,1000 ORE 0", "text 10 Two 5506,1000 Ore Holdings 0",
                 "text 10 Two 1506,1200 ABC 0"}));
}

TEST(TextPrintOutTest, AFullPageGoesOnOnTheNextUnderItsHeading) {
  PrintOutFixture f;
  f.layout.continued = "  (cont)";
  f.layout.pageLabel = "      Page  ";
  // Lines begin at 700, below two of the heading: five of them end at 1,700.
  f.page.PPBot = float(16438 - 1700);
  TextPrintOut out(f.printer, f.fonts, f.page, f.layout);
  for (int i = 1; i <= 5; ++i) out.Line({"L" + std::to_string(i)});
  EXPECT_EQ(out.PageNumber(), 1);
  out.Line({"L6"});
  EXPECT_EQ(out.PageNumber(), 2);
  out.End();
  const Ops& ops = f.printer.sent.at(0);
  ASSERT_EQ(ops.size(), 11u);
  EXPECT_EQ(ops[6], "text 10 506,1500 L5 0");
  EXPECT_EQ(ops[7], "page");
  EXPECT_EQ(ops[8], "text 10 b 506,300 NAMES  (cont) 0");
  EXPECT_EQ(ops[9], "text 10 b 8506,300       Page  2 0");
  EXPECT_EQ(ops[10], "text 10 506,700 L6 0");
}

TEST(TextPrintOutTest, APageThatIsJustFullStartsNoEmptyOne) {
  PrintOutFixture f;
  f.page.PPBot = float(16438 - 900);
  TextPrintOut out(f.printer, f.fonts, f.page, f.layout);
  out.Line({"only"});
  out.End();
  EXPECT_EQ(f.printer.sent.at(0).size(), 3u);
}

TEST(TextPrintOutTest, TextsTooWideForTheirColumnAreCutAtWholeCharacters) {
  PrintOutFixture f;
  f.layout.at = {0, 0.03, 0.97};  // 300 twips, 9,400 and 300
  TextPrintOut out(f.printer, f.fonts, f.page, f.layout);
  out.Line({"ABCD", "x", "a\xC3\xA9\xC3\xA9"});  // the recording printer counts bytes
  out.End();
  const Ops& ops = f.printer.sent.at(0);
  EXPECT_EQ(ops[2], "text 10 506,700 ABC 0");
  EXPECT_EQ(ops[4], "text 10 10206,700 a\xC3\xA9 0");
}

TEST(TextPrintOutTest, ATextHasTheRoomOfTheEmptyColumnsBehindIt) {
  PrintOutFixture f;
  f.layout.at = {0, 0.03, 0.97};
  TextPrintOut out(f.printer, f.fonts, f.page, f.layout);
  out.Line({"ABCDEF"});
  out.Line({"ABCDEF", "", "x"});
  out.End();
  const Ops& ops = f.printer.sent.at(0);
  EXPECT_TRUE(ops[2].ends_with(" ABCDEF 0")) << ops[2];
  EXPECT_TRUE(std::any_of(ops.begin() + 3, ops.end(),
                          [](const std::string& op) { return op.ends_with(" ABCDEF 0"); }));
}

TEST(TextPrintOutTest, WhatIsNotEndedIsNotSent) {
  PrintOutFixture f;
  {
    TextPrintOut out(f.printer, f.fonts, f.page, f.layout);
    out.Line({"x"});
  }
  EXPECT_TRUE(f.printer.sent.empty());
  EXPECT_EQ(f.printer.killed, 1);
}

TEST(TextPrintOutTest, MarginsWithoutRoomAndNoPrinterAreErrors) {
  PrintOutFixture f;
  f.page.PPTop = 16300;
  EXPECT_EQ(test::ErrorOf([&] { TextPrintOut(f.printer, f.fonts, f.page, f.layout); }), kBadCall);
  f.page.PPTop = 0;
  f.page.PPRht = 11000;
  EXPECT_EQ(test::ErrorOf([&] { TextPrintOut(f.printer, f.fonts, f.page, f.layout); }), kBadCall);
  EXPECT_EQ(f.printer.started, f.printer.killed);
  f.page.PPRht = 0;
  f.printer.device.clear();
  EXPECT_EQ(test::ErrorOf([&] { TextPrintOut(f.printer, f.fonts, f.page, f.layout); }),
            kDeviceNotAvailable);
}

TEST(TextPrintOutTest, OrientationOfThePageSetUpHolds) {
  PrintOutFixture f;
  f.page.Orient = kLandscape;
  TextPrintOut out(f.printer, f.fonts, f.page, f.layout);
  EXPECT_EQ(f.printer.Orientation(), kLandscape);
  out.End();
}

TEST(TextPrintOutTest, MarginsAreKeptUnderTheirKeys) {
  test::TempHome home;
  SettingsFile file(home.files(), "C:\\WINDOWS\\Kora.ini");
  PageSettings page;
  page.PPTop = 567;
  page.PPLft = 1134;
  page.PPBot = 283.5f;
  page.PPRht = 850;
  page.Orient = 2;
  SaveTextPage(file, page);
  for (const auto& [key, value] : {std::pair{"PPTop", "567"},
                                   {"PPLft", "1134"},
                                   {"PPBot", "283.5"},
                                   {"PPRht", "850"},
                                   {"Orient", "2"}})
    EXPECT_EQ(file.GetSetting("ChtPage", key), value);
}

TEST(PaperDates, HaveTheMonthAsAWord) {
  EXPECT_EQ(MediumDate({2026, 3, 4}), "04-Mar-26");
  EXPECT_EQ(MediumDate({2006, 12, 31}), "31-Dec-06");
  EXPECT_EQ(ShortMediumDate({2026, 3, 4}), "4-Mar-26");
}
