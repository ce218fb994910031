#include "chart/script_player.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>

#include "tests/chart/composer_fixture.h"
#include "tests/support/mutate.h"

using namespace kora;
using kora::test::ComposerFixture;
using kora::test::Mutator;
using kora::test::RecordingSurface;
using kora::test::ScriptedDialogs;
using kora::test::TempHome;
using Ops = std::vector<std::string>;

namespace {

struct PlayerFixture {
  FontSettings fonts;
  ChartColours colours{};
  RecordingSurface surface{638, 452};

  PlayerFixture() {
    fonts.Font2Size = 8;
    for (size_t i = 0; i < colours.size(); ++i) colours[i] = std::int32_t(i);
  }
  bool Play(std::string_view script) {
    surface.ops.clear();
    return PlayChartScript(script, surface, fonts, colours);
  }
};

struct SavedFixture : PlayerFixture {
  TempHome home;
  ScriptedDialogs dialogs;

  bool Show() {
    surface.ops.clear();
    dialogs.said.clear();
    return ShowSavedChart(home.files(), dialogs, surface, fonts, colours, "c:\\saved.cht");
  }
  bool Show(std::string_view bytes) {
    home.Put("drive_c/saved.cht", bytes);
    return Show();
  }
  bool SaidFormatInvalid() const {
    return dialogs.said.size() == 1 && dialogs.said[0].title == "Show Saved Chart" &&
           dialogs.said[0].text == "There is problem displaying this chart - format invalid.";
  }
};

// An operation of the composer as its line in the script plays it: paper has longer ticks and
// grid lines and a lower mode line, texts of S lose their blanks, and Font 2 is never bold.
std::string AsPlayed(const std::string& op) {
  int at = 0;
  if (op == "text 8.25 44,27 DAILY - ARITHMETIC - 27")
    return "text 8.25 44,33 DAILY-ARITHMETIC- 27";
  if (op.rfind("text 8.25 b ", 0) == 0) return "text 8.25 " + op.substr(12);
  if (std::sscanf(op.c_str(), "line dot %d,50,", &at) == 1) {
    const std::string x = std::to_string(at);
    if (op == "line dot " + x + ",50," + x + ",429 35")
      return "line dot " + x + ",45," + x + ",434 35";
  }
  if (std::sscanf(op.c_str(), "line solid 42,%d,37,", &at) == 1) {
    const std::string y = std::to_string(at);
    if (op == "line solid 42," + y + ",37," + y + " 16")
      return "line solid 42," + y + ",35," + y + " 16";
  }
  return op;
}

// Remembers every colour that texts were to have.
class ForeColourSurface : public RecordingSurface {
 public:
  using RecordingSurface::RecordingSurface;
  std::vector<Colour> fore;
  void SetForeColour(Colour colour) override {
    fore.push_back(colour);
    RecordingSurface::SetForeColour(colour);
  }
};

}  // namespace

TEST(ScriptPlayerTest, LinesOfEachLetterPlayInTheirStyle) {
  PlayerFixture f;
  ASSERT_TRUE(
      f.Play("L,1,2,3,4,5\r\nH,1,2,3,4,6\r\nM,1,2,3,4,7\r\nD,1,2,3,4,8\r\n"
             "E,1,2,3,4,9\r\nV,1,2,3,4,10\r\nL,5,6,7,8,11\r\n"));
  EXPECT_EQ(f.surface.ops,
            (Ops{"line solid 1,2,3,4 5", "line solid 1,2,3,4 6", "line solid 1,2,3,4 7",
                 "line dash 1,2,3,4 8", "line dash 1,2,3,4 9", "line dot 1,2,3,4 10",
                 "line solid 5,6,7,8 11"}));
}

TEST(ScriptPlayerTest, BoxesAndPoints) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("B,1,2,3,4,5\r\nF,1,2,3,4,6\r\nC,1,2,3,4,7\r\nP,41,252,18\r\n"));
  EXPECT_EQ(f.surface.ops,
            (Ops{"box 1,2,3,4 5", "fill 1,2,3,4 6", "fill 1,2,3,4 7", "point 41,252 18"}));
}

TEST(ScriptPlayerTest, CoordinatesOfLinesAndBoxesRoundHalfToEven) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("H,40.5,10.5,42.5,11.5,1\r\nC,43.5,0.5,41.5,-0.5,2\r\nL,1.4,-1.6,0,0,3\r\n"));
  EXPECT_EQ(f.surface.ops,
            (Ops{"line solid 40,10,42,12 1", "fill 44,0,42,0 2", "line solid 1,-2,0,0 3"}));
}

TEST(ScriptPlayerTest, TextKeepsFractionsOfPlaceAndSize) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("T,8.25,20.5,2.25,BHP,255\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"text 8.25 20.5,2.25 BHP 255"}));
}

TEST(ScriptPlayerTest, ColourLeftAfterTIsScalesText) {
  PlayerFixture f;
  ForeColourSurface surface(638, 452);
  ASSERT_TRUE(PlayChartScript("T,8.25,20,2,BHP,255\r\n", surface, f.fonts, f.colours));
  EXPECT_EQ(surface.fore, (std::vector<Colour>{255, kScalesText}));
}

TEST(ScriptPlayerTest, BlanksAroundATextOfTStayAndOfSVanish) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("T,8,20,2,  A B ,1\r\nS,8,20,2,  A B ,1\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"text 8 20,2   A B  1", "text 8 20,2 AB 1"}));
}

TEST(ScriptPlayerTest, LowerCaseLettersPlayButATextOfLowerTLosesItsBlanks) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("l,1,2,3,4,5\r\nt,8,20,2,A B,1\r\nv,1,2,3,4,5\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,3,4 5", "text 8 20,2 AB 1", "line dot 1,2,3,4 5"}));
}

TEST(ScriptPlayerTest, CommaInATextCutsItAndTheRestIsTheColour) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("T,8,20,2,Bank,17 The\r\nT,8,20,2,Bank, The\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"text 8 20,2 Bank 17", "text 8 20,2 Bank 0"}));
}

TEST(ScriptPlayerTest, SIsSetInFont2AndLeavesFont1) {
  PlayerFixture f;
  f.fonts.Font1Name = "One";
  f.fonts.Font2Name = "Two";
  f.fonts.Font1Bold = true;
  ASSERT_TRUE(f.Play("S,9.75,20,2,12.50,7\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"text 9.75 20,2 12.50 7"}));
  EXPECT_EQ(f.surface.Font().name, "One");
  EXPECT_TRUE(f.surface.Font().bold);
}

TEST(ScriptPlayerTest, EmptySDrawsNothingButBringsFont1Back) {
  PlayerFixture f;
  f.fonts.Font1Bold = true;
  // The stamp leaves the bold off; S brings it back, with a text or without.
  ASSERT_TRUE(f.Play("Z,7,1,2,KORA,3\r\nT,8,20,2,A,1\r\nS,8,1,2,,3\r\nT,8,20,2,A,1\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"text 7 b i 1,2 KORA 3", "text 8 20,2 A 1", "text 8 b 20,2 A 1"}));
}

TEST(ScriptPlayerTest, SWithBlanksAloneCountsAsACommand) {
  PlayerFixture f;
  EXPECT_TRUE(f.Play("S,8,1,2,   ,3\r\n"));
  EXPECT_TRUE(f.surface.ops.empty());
}

TEST(ScriptPlayerTest, LettersOfThePrinterShowNothing) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("X,1,2,3,4,5\r\nK,1,2,5\r\nL,1,2,3,4,5\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,3,4 5"}));
  EXPECT_FALSE(f.Play("X,1,2,3,4,5\r\nK,1,2,5\r\n"));
}

TEST(ScriptPlayerTest, UnknownLettersAndEmptyLinesArePassedOver) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("\r\nQ,1,2\r\nLL,1,2,3,4,5\r\n,,,\r\nL,1,2,3,4,5\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,3,4 5"}));
}

TEST(ScriptPlayerTest, BareLineFeedsAndALastLineWithoutEndAreAccepted) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("L,1,2,3,4,5\nP,1,2,3"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,3,4 5", "point 1,2 3"}));
}

TEST(ScriptPlayerTest, MissingFieldsAreZeroWhereTheLineIsWhole) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("L,1,2\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,0,0 0"}));
}

TEST(ScriptPlayerTest, ScriptCutOffWithinALineEndsThere) {
  PlayerFixture f;
  EXPECT_FALSE(f.Play("L,1,2,3,4,5\r\nL,10,20,3"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,3,4 5"}));
  EXPECT_FALSE(f.Play("L,1,2,3,4,5\r\nT,8,20,2,Test Hol"));
  EXPECT_FALSE(f.Play("L,1,2,3,4,5\r\nP,1,2"));
}

TEST(ScriptPlayerTest, EmptyScriptAndUnknownLettersAloneAreInvalid) {
  PlayerFixture f;
  EXPECT_FALSE(f.Play(""));
  EXPECT_FALSE(f.Play("\r\n\r\n"));
  EXPECT_FALSE(f.Play("Q,1,2,3\r\nhello\r\n"));
}

TEST(ScriptPlayerTest, SeventhFieldEndsThePlayAndWhatWasDrawnStays) {
  PlayerFixture f;
  EXPECT_FALSE(f.Play("L,1,2,3,4,5\r\nT,8,20,2,Bank, The,255\r\nL,5,6,7,8,9\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,3,4 5"}));
}

TEST(ScriptPlayerTest, NumbersOfAHundredDigitsEndThePlay) {
  PlayerFixture f;
  const std::string huge(100, '9');
  for (const std::string& line :
       {"L," + huge + ",2,3,4,5", "L,1,2,3,4," + huge, "P," + huge + ",2,3", "P,1,2," + huge,
        "T,8," + huge + ",2,A,5", "T," + huge + ",1,2,A,5", "T,8,1,2,A," + huge,
        "S,8,1,2,A,-" + huge, "B,1,2,3," + huge + ",5", "Z," + huge + ",1,2,A,5"}) {
    EXPECT_FALSE(f.Play("L,1,2,3,4,5\r\n" + line + "\r\nL,5,6,7,8,9\r\n")) << line;
    EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,3,4 5"})) << line;
  }
  // A hundred digits behind the point are a number like any other.
  EXPECT_TRUE(f.Play("L,1." + std::string(100, '0') + "1,2,3,4,5\r\n"));
}

TEST(ScriptPlayerTest, ThirtyTwoBitsAreTheLimitOfCoordinatesAndColours) {
  PlayerFixture f;
  EXPECT_TRUE(f.Play("L,2147483647,-2147483648,0,0,2147483647\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 2147483647,-2147483648,0,0 2147483647"}));
  EXPECT_FALSE(f.Play("L,2147483648,0,0,0,0\r\n"));
  EXPECT_FALSE(f.Play("L,0,0,0,0,4294967295\r\n"));
}

TEST(ScriptPlayerTest, FontSizeThatIsNoneEndsThePlay) {
  PlayerFixture f;
  EXPECT_FALSE(f.Play("T,0,1,2,A,5\r\n"));
  EXPECT_FALSE(f.Play("T,-8,1,2,A,5\r\n"));
  EXPECT_FALSE(f.Play("S,,1,2,A,5\r\n"));
  EXPECT_FALSE(f.Play("Z,501,1,2,A,5\r\n"));
  EXPECT_TRUE(f.Play("Z,500,1,2,A,5\r\n"));
}

TEST(ScriptPlayerTest, LineOfAMegabyteEndsThePlay) {
  PlayerFixture f;
  EXPECT_FALSE(f.Play("L,1,2,3,4,5\r\nT,8,1,2," + std::string(1 << 20, 'a') + ",5\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"line solid 1,2,3,4 5"}));
}

TEST(ScriptPlayerTest, TextsAreAnsi) {
  PlayerFixture f;
  ASSERT_TRUE(f.Play("T,8,1,2,Caf\xE9 \x80,5\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"text 8 1,2 Café € 5"}));
}

TEST(ScriptPlayerTest, ComposedChartPlaysBackAsItWasDrawn) {
  for (const Style style : {Style::kBar, Style::kLine}) {
    ComposerFixture f;
    f.Days("20240101", 120, 5000);
    for (size_t i = 0; i < f.days.size(); ++i) {
      const float rise = float(i % 17) * 0.1f;
      f.days[i].Open += rise;
      f.days[i].High += rise;
      f.days[i].Close += rise * 0.5f;
      f.days[i].Volume += std::int32_t(i % 13) * 300;
    }
    f.request.ChartStyle = style;
    f.request.GridLines = true;
    f.request.Ma1On = f.request.Ma2On = true;
    f.request.Ma1Days = 5;
    f.request.Ma2Days = 12;
    ASSERT_TRUE(f.Compose());

    RecordingSurface played(638, 452);
    ASSERT_TRUE(PlayChartScript(f.script.text(), played, f.fonts, f.colours));
    // The picture begins with a cleared surface, which the script has no line for; the stamp is
    // in the script alone.
    Ops composed, replayed;
    for (const std::string& op : f.price.ops)
      if (op != "cls") composed.push_back(AsPlayed(op));
    for (const std::string& op : played.ops)
      if (op.find(" KORA ") == std::string::npos) replayed.push_back(op);
    EXPECT_EQ(played.ops.size(), replayed.size() + 1);
    EXPECT_GT(composed.size(), 300u);
    ASSERT_EQ(replayed.size(), composed.size()) << TextOf(style);
    for (size_t i = 0; i < composed.size(); ++i)
      EXPECT_EQ(replayed[i], composed[i]) << TextOf(style);
  }
}

TEST(ScriptPlayerTest, CandlesPlayBackHalfAUnitWider) {
  ComposerFixture f;
  f.request.ChartStyle = Style::kCandlestick;
  f.request.BarSpacing = 4;
  // y(10) = 252, y(10.5) = 178 on this surface.
  f.Day("20240315", 10.5f, 11, 9, 10);
  f.Day("20240318", 10, 11, 9, 10.5f);
  ASSERT_TRUE(f.Compose());
  RecordingSurface played(638, 452);
  ASSERT_TRUE(PlayChartScript(f.script.text(), played, f.fonts, f.colours));
  EXPECT_TRUE(f.price.Has("fill 41,178,43,252 28"));
  EXPECT_TRUE(played.Has("fill 40,178,44,252 28"));
  EXPECT_TRUE(f.price.Has("fill 45,252,47,178 18"));
  EXPECT_TRUE(played.Has("box 44,252,48,178 18"));
}

TEST(ShowSavedChartTest, ClearsTheSurfaceAndPlaysTheFile) {
  SavedFixture f;
  EXPECT_TRUE(f.Show("L,1,2,3,4,5\r\n"));
  EXPECT_EQ(f.surface.ops, (Ops{"cls", "line solid 1,2,3,4 5"}));
  EXPECT_TRUE(f.dialogs.said.empty());
  EXPECT_EQ(f.dialogs.busyCalls, 2);
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(ShowSavedChartTest, FilesThatAreNoChartGiveTheFormatMessage) {
  SavedFixture f;
  EXPECT_FALSE(f.Show());  // not there
  EXPECT_TRUE(f.SaidFormatInvalid());
  EXPECT_FALSE(f.Show(""));
  EXPECT_TRUE(f.SaidFormatInvalid());
  EXPECT_FALSE(f.Show("Q,1\r\nW,2\r\n"));
  EXPECT_TRUE(f.SaidFormatInvalid());
  EXPECT_FALSE(f.Show(std::string("\x00\x01\xFF\r\n\x7F\x45LF\x02\x01", 12)));
  EXPECT_TRUE(f.SaidFormatInvalid());
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(ShowSavedChartTest, FailureInTheMiddleLeavesWhatWasDrawn) {
  SavedFixture f;
  EXPECT_FALSE(f.Show("L,1,2,3,4,5\r\nL,1,2,3,4,5,6\r\nL,5,6,7,8,9\r\n"));
  EXPECT_TRUE(f.SaidFormatInvalid());
  EXPECT_EQ(f.surface.ops, (Ops{"cls", "line solid 1,2,3,4 5"}));
  EXPECT_FALSE(f.dialogs.busy);
}

TEST(ShowSavedChartTest, FileOfFiftyMegabytesIsRefusedUnread) {
  SavedFixture f;
  std::string big;
  big.reserve(50u << 20);
  while (big.size() < (50u << 20)) big += "L,1,2,3,4,5\r\n";
  EXPECT_FALSE(f.Show(big));
  EXPECT_TRUE(f.SaidFormatInvalid());
  EXPECT_EQ(f.surface.ops, (Ops{"cls"}));
}

TEST(ScriptPlayerTest, MoreDrawingThanAnyChartNeedsEndsThePlay) {
  const auto repeat = [](const std::string& line, int times) {
    std::string out;
    while (times-- > 0) out += line;
    return out;
  };
  PlayerFixture f;
  // A whole surface is 638 * 452 / 40 = 7,209 and ten more; 200 million hold 27,703 of them.
  const std::string fill = "F,-5000,0,5000,452,1\r\n";
  EXPECT_TRUE(f.Play(repeat(fill, 27703)));
  EXPECT_FALSE(f.Play(repeat(fill, 27704)));
  EXPECT_EQ(f.surface.ops.size(), 27703u);
  // Dashes over width and height are 4 * 1,090 and ten.
  const std::string dash = "D,-2000000000,0,2000000000,452,1\r\n";
  EXPECT_TRUE(f.Play(repeat(dash, 45766)));
  EXPECT_FALSE(f.Play(repeat(dash, 45767)));
  EXPECT_FALSE(f.Play(repeat("T,8,1,2," + std::string(4000, 'a') + ",1\r\n", 1300)));
}

TEST(ScriptPlayerTest, ScriptOfManyFontSizesEndsThere) {
  PlayerFixture f;
  std::string script;
  for (int i = 0; i < 33; ++i) script += "T," + std::to_string(8 + i) + ",1,2,A,5\r\n";
  EXPECT_FALSE(f.Play(script));
  EXPECT_EQ(f.surface.ops.size(), 32u);
}

TEST(ShowSavedChartTest, FolderInPlaceOfAFileGivesTheFormatMessage) {
  SavedFixture f;
  f.home.Put("drive_c/saved.cht/inside", "L,1,2,3,4,5\r\n");
  EXPECT_FALSE(f.Show());
  EXPECT_TRUE(f.SaidFormatInvalid());
}

// Whatever a script holds, the play ends by itself, draws no more than a command a line and
// tells the truth about whether it saw one.
TEST(ScriptPlayerTest, DamagedScriptsNeverDrawMoreThanTheirLines) {
  PlayerFixture f;
  const std::string whole =
      "T,8.25,20,2,TEST    Test Holdings,26\r\nL,42,300,37,300,27\r\nS,8,5,294,12.50,27\r\n"
      "H,42,104,42,399,18\r\nP,41,252,18\r\nC,40.5,178,43.5,252,28\r\nV,80,45,80,429,25\r\n"
      "Z,7,601,35,KORA,27\r\nD,42,60,631,60,10\r\nB,42,45,631,429,16\r\n";
  int played = 0, refused = 0;
  const std::vector<std::string> corpus{whole, "L,1,2,3,4,5\nt,8,1,2,a b,3", "Q\r\n"};
  Mutator(7).Run(corpus, 8000, [&](const std::string& text) {
    const bool ok = f.Play(text);
    ++(ok ? played : refused);
    const auto lines = std::count(text.begin(), text.end(), '\n') + 1;
    ASSERT_LE(f.surface.ops.size(), size_t(lines));
    // Only an S can be played and show nothing.
    ASSERT_FALSE(ok && f.surface.ops.empty() && text.find_first_of("Ss") == std::string::npos);
  });
  EXPECT_GT(played, 100);
  EXPECT_GT(refused, 100);
}
