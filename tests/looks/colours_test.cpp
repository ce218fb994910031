#include "looks/colours.h"

#include <gtest/gtest.h>

#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

using namespace std::string_literals;

const std::string kSystem = "c:\\korawin\\";

// Lines 1000, 1001, ...
std::string Lines(int count, const char* end = "\r\n") {
  std::string out;
  for (int i = 0; i < count; ++i) out += std::to_string(1000 + i) + end;
  return out;
}

class Colours : public ::testing::Test {
 protected:
  Colours() : home_(io_) { home_.Put("drive_c/korawin/readme", ""); }

  void ExpectStandard() {
    EXPECT_EQ(colours_[0], 0);
    EXPECT_EQ(colours_[1], 0x800000);  // blue: red is the low byte
    EXPECT_EQ(colours_[4], 0x000080);
    EXPECT_EQ(colours_[7], 0xC0C0C0);
    EXPECT_EQ(colours_[12], 0x0000FF);
    EXPECT_EQ(colours_[14], 0x00FFFF);
    EXPECT_EQ(colours_[15], 0xFFFFFF);
  }
  void ExpectDefaultRoles() {
    const int standard[] = {3, 0,  15, 14, 10, 12, 14, 2,  6,  13, 14, 7,  4,  12, 10, 11, 14,
                            2, 11, 8,  10, 11, 10, 11, 14, 14, 6,  12, 10, 11, 12, 11, 10};
    static_assert(std::size(standard) == 33);
    for (size_t i = 0; i < 33; ++i)
      EXPECT_EQ(colours_[16 + i], colours_[size_t(standard[i])]) << 16 + i;
  }

  FailingIo io_;
  TempHome home_;
  ChartColours colours_{};
};

TEST_F(Colours, RolesHaveTheirNames) {
  EXPECT_STREQ(ColourRoleName(kBorder), "Border");
  EXPECT_STREQ(ColourRoleName(kScalesText), "Scales / text");
  EXPECT_STREQ(ColourRoleName(kCandleDown), "C'stick / P+F Dn");
  EXPECT_STREQ(ColourRoleName(kEndOfYear), "End of year marker");
  EXPECT_STREQ(ColourRoleName(kBands), "Bands");
  EXPECT_STREQ(ColourRoleName(kOscLine4), "Oscillator Line 4");
  EXPECT_STREQ(ColourRoleName(15), "");
  EXPECT_STREQ(ColourRoleName(49), "");
}

TEST_F(Colours, AVariantWithoutItsFileIsTheDefaultTable) {
  for (const char* variant : {"Black", "White", "Blue"}) {
    colours_.fill(77);
    LoadColours(home_.files(), kSystem, variant, colours_);
    ExpectStandard();
    ExpectDefaultRoles();
    EXPECT_EQ(colours_[49], 77);
  }
}

TEST_F(Colours, EachVariantHasItsFile) {
  const std::pair<const char*, const char*> variants[] = {
      {"Black", "BLK"}, {"White", "WHT"}, {"Blue", "BLU"}};
  int base = 0;
  for (const auto& [variant, extension] : variants) {
    std::string text;
    base += 100;
    for (int i = 0; i < 49; ++i) text += std::to_string(base + i) + "\n";
    home_.Put("drive_c/korawin/Koraclr."s + extension, text);
  }
  base = 0;
  for (const auto& [variant, extension] : variants) {
    base += 100;
    colours_.fill(-5);
    LoadColours(home_.files(), kSystem, variant, colours_);
    ExpectStandard();  // the first sixteen lines count for nothing
    EXPECT_EQ(colours_[16], base + 16) << variant;
    EXPECT_EQ(colours_[48], base + 48) << variant;
    EXPECT_EQ(colours_[49], -5) << variant;
  }
}

TEST_F(Colours, OfTheUserAreFiftyLines) {
  home_.Put("drive_c/korawin/KORACLR.DAT", Lines(60));
  EXPECT_TRUE(LoadUserColours(home_.files(), kSystem, colours_));
  ExpectStandard();
  EXPECT_EQ(colours_[16], 1016);
  EXPECT_EQ(colours_[49], 1049);
  EXPECT_EQ(colours_[50], 0);
}

TEST_F(Colours, OfTheUserMissingAreBlack) {
  home_.Put("drive_c/korawin/Koraclr.BLK", Lines(49));
  EXPECT_TRUE(LoadUserColours(home_.files(), kSystem, colours_));
  EXPECT_EQ(colours_[20], 1020);
}

TEST_F(Colours, AShortFileStopsWithAnErrorAndKeepsWhatWasRead) {
  home_.Put("drive_c/korawin/Koraclr.dat", Lines(20, "\n"));
  EXPECT_FALSE(LoadUserColours(home_.files(), kSystem, colours_));
  ExpectStandard();
  EXPECT_EQ(colours_[19], 1019);
  EXPECT_EQ(colours_[20], 0x00FF00);  // Average 2 by default
}

TEST_F(Colours, AColourBeyond32BitsStopsTheReading) {
  home_.Put("drive_c/korawin/Koraclr.dat", Lines(17) + "99999999999\r\n" + Lines(32));
  EXPECT_FALSE(LoadUserColours(home_.files(), kSystem, colours_));
  EXPECT_EQ(colours_[16], 1016);
  EXPECT_EQ(colours_[17], 0);
}

TEST_F(Colours, AForeignOrUnreadableFileLeavesATable) {
  home_.Put("drive_c/korawin/Koraclr.dat", "\0\xFF\x81\n\r\n\0"s);
  EXPECT_FALSE(LoadUserColours(home_.files(), kSystem, colours_));
  ExpectStandard();

  io_.failReadAt = io_.reads + 1;
  EXPECT_FALSE(LoadUserColours(home_.files(), kSystem, colours_));
  ExpectDefaultRoles();

  home_.Put("drive_c/korawin/Koraclr.BLU/inner", "");
  LoadColours(home_.files(), kSystem, "Blue", colours_);
  ExpectDefaultRoles();
}

TEST_F(Colours, AreSavedAsFiftyLinesAndReadBack) {
  for (size_t i = 0; i < colours_.size(); ++i) colours_[i] = std::int32_t(i) * 3 - 60;
  SaveColours(home_.files(), kSystem, colours_);
  std::string expected;
  for (int i = 0; i < 50; ++i) expected += std::to_string(i * 3 - 60) + "\r\n";
  EXPECT_EQ(home_.Get("drive_c/korawin/Koraclr.dat"), expected);

  ChartColours back{};
  EXPECT_TRUE(LoadUserColours(home_.files(), kSystem, back));
  for (size_t i = 16; i < 50; ++i) EXPECT_EQ(back[i], colours_[i]);
}

TEST_F(Colours, AFailingSaveLeavesTheOldFile) {
  home_.Put("drive_c/korawin/Koraclr.dat", "old");
  for (int at = 1; at <= 7; ++at) {
    io_.Reset(at);
    EXPECT_EQ(ErrorOf([&] { SaveColours(home_.files(), kSystem, colours_); }), kDiskFull);
    EXPECT_EQ(home_.Get("drive_c/korawin/Koraclr.dat"), "old");
  }
}

// ---- printer

TEST_F(Colours, OfThePrinterAreFourBytes) {
  WritePrinterColours(home_.files(), kSystem, {true, 1, 0});
  EXPECT_EQ(home_.Get("drive_c/korawin/koraprn.dat"), "\x01\0\0\0"s);
  const PrinterColours value = ReadPrinterColours(home_.files(), kSystem);
  EXPECT_TRUE(value.asked);
  EXPECT_EQ(value.ColourPrinter, 1);
  EXPECT_EQ(value.WhiteAsBlack, 0);
}

TEST_F(Colours, OfThePrinterAreNotAskedWhereTheFileSaysNothing) {
  EXPECT_FALSE(ReadPrinterColours(home_.files(), kSystem).asked);
  for (const std::string& bytes : {""s, "\x01\0\0"s}) {
    home_.Put("drive_c/korawin/koraprn.dat", bytes);
    const PrinterColours value = ReadPrinterColours(home_.files(), kSystem);
    EXPECT_FALSE(value.asked);
    EXPECT_EQ(value.ColourPrinter, 0);
    EXPECT_EQ(value.WhiteAsBlack, 1);
  }
}

TEST_F(Colours, AFolderInPlaceOfThePrinterFileIsNotAsked) {
  home_.Put("drive_c/korawin/koraprn.dat/inner", "");
  EXPECT_FALSE(ReadPrinterColours(home_.files(), kSystem).asked);
}

TEST_F(Colours, OfThePrinterAreAskedInTwoQuestions) {
  struct Case {
    std::deque<Answer> answers;
    std::int16_t colour, white;
    size_t questions;
    std::string bytes;
  };
  for (const Case& c : {Case{{Answer::kNo}, 0, 1, 1, "\0\0\x01\0"s},
                        Case{{Answer::kYes, Answer::kYes}, 1, 1, 2, "\x01\0\x01\0"s},
                        Case{{Answer::kYes, Answer::kNo}, 1, 0, 2, "\x01\0\0\0"s}}) {
    ScriptedDialogs dialogs;
    dialogs.answers = c.answers;
    PrinterColours value;
    AskPrinterColours(home_.files(), kSystem, dialogs, value);
    EXPECT_TRUE(value.asked);
    EXPECT_EQ(value.ColourPrinter, c.colour);
    EXPECT_EQ(value.WhiteAsBlack, c.white);
    ASSERT_EQ(dialogs.said.size(), c.questions);
    EXPECT_EQ(dialogs.said[0].text, "  Do you have a Colour Printer ?");
    EXPECT_EQ(dialogs.said[0].title, "Printer");
    if (c.questions == 2) {
      EXPECT_EQ(dialogs.said[1].text, "Print the colour WHITE as BLACK ?");
      EXPECT_EQ(dialogs.said[1].title, "Chart Printing");
    }
    EXPECT_EQ(home_.Get("drive_c/korawin/koraprn.dat"), c.bytes);
  }
}

TEST_F(Colours, OfThePrinterHoldForTheRunWhenTheyCannotBeWritten) {
  ScriptedDialogs dialogs;
  PrinterColours value;
  io_.Reset(1);
  AskPrinterColours(home_.files(), kSystem, dialogs, value);
  EXPECT_EQ(value.ColourPrinter, 1);
  EXPECT_FALSE(home_.Exists("drive_c/korawin/koraprn.dat"));
}

}  // namespace
}  // namespace kora::test
