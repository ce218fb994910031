#include "indicators/multi_osc.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "platform/headless/headless_surface.h"
#include "platform/surface_part.h"
#include "tests/indicators/osc_fixture.h"
#include "tests/support/all_oscillators.h"
#include "tests/support/records.h"

namespace kora {
namespace {

using Texts = std::vector<std::string>;

// ---- Sets

TEST(MultiOscNamesTest, AreNoneAndAllThatTheViewOffers) {
  const Texts expected{"None",
                       "Directional Movement",
                       "Coppock",
                       "Elder Ray",
                       "FX",
                       "Jones Holy Grail",
                       "MACD",
                       "Momentum",
                       "OBV",
                       "ROC",
                       "ROC and FX",
                       "RMX",
                       "RSI",
                       "Stochastic (Fast)",
                       "Stochastic (Slow)",
                       "Volatility",
                       "Williams %R"};
  Texts names;
  for (const MultiOscName& name : MultiOscNames()) names.emplace_back(name.name);
  EXPECT_EQ(names, expected);
  EXPECT_EQ(FindMultiOscName("RMO"), nullptr);
  EXPECT_EQ(FindMultiOscName("Stochastic (Slow)")->oscillator->code, "STO");
  EXPECT_TRUE(FindMultiOscName("Stochastic (Slow)")->slow);
  EXPECT_FALSE(FindMultiOscName("Stochastic (Fast)")->slow);
  EXPECT_EQ(FindMultiOscName(" rsi ")->name, "RSI");
}

struct MultiOscSets : testing::Test {
  test::TempHome home;
  SettingsFile user{home.files(), "C:\\WINDOWS\\KoraUser.ini", kLongestUserValue};
  // As another program or a hand left it there, with what this one would not keep.
  void Keep(const std::string& text) {
    home.Put("KoraUser.ini", "[" + std::string(kUserSection) + "]\r\nMulti-Osc 1=" + text + "\r\n");
  }
};

TEST_F(MultiOscSets, AnEmptyStoreHasNone) {
  const MultiOscSet none{"None", "None", "None", "None"};
  EXPECT_EQ(ReadMOSet(user, 1), none);
  EXPECT_EQ(ReadMOSet(user, 2), none);
  EXPECT_EQ(PanelCount(none), 0);
}

TEST_F(MultiOscSets, ASetIsKeptUnderItsOwnKeyWithBarsBetweenItsNames) {
  const MultiOscSet set{"Directional Movement", "Jones Holy Grail", "Stochastic (Fast)",
                        "Stochastic (Slow)"};
  ASSERT_TRUE(SaveMOSets(user, 2, set));
  EXPECT_EQ(user.GetSetting(kUserSection, "Multi-Osc 2"),
            "Directional Movement|Jones Holy Grail|Stochastic (Fast)|Stochastic (Slow)");
  EXPECT_EQ(ReadMOSet(user, 2), set);
  EXPECT_EQ(PanelCount(set), 4);
  EXPECT_EQ(ReadMOSet(user, 1), (MultiOscSet{"None", "None", "None", "None"}));
}

TEST_F(MultiOscSets, ForeignNamesReadAsNone) {
  Keep("MACD|Ichimoku|RMO|rsi");
  EXPECT_EQ(ReadMOSet(user, 1), (MultiOscSet{"MACD", "None", "None", "RSI"}));
  Keep("|||MACD|RSI|FX");
  EXPECT_EQ(ReadMOSet(user, 1), (MultiOscSet{"None", "None", "None", "MACD"}));
  Keep("OBV");
  EXPECT_EQ(ReadMOSet(user, 1), (MultiOscSet{"OBV", "None", "None", "None"}));
  Keep(std::string(20000, '|'));
  EXPECT_EQ(PanelCount(ReadMOSet(user, 1)), 0);
  Keep(std::string(200, 'x') + "|MACD");
  EXPECT_EQ(ReadMOSet(user, 1), (MultiOscSet{"None", "MACD", "None", "None"}));
}

TEST(MultiOscCaptionTest, HasTheCodeAndTheSet) {
  EXPECT_EQ(MultiOscCaption("ORE   ", 1), "ORE        Multi-Oscillator 1");
  EXPECT_EQ(MultiOscCaption("ORE", 2), "ORE        Multi-Oscillator 2");
}

// ---- The view

constexpr double kWidth = 640, kHeight = 400;  // of the price picture

class View : public testing::Test {
 protected:
  View() {
    std::vector<PriceRec> days;
    for (int i = 0; i < 200; ++i) {
      const float close = 20 + float((i * 7) % 13);
      const CalendarDate date = DateOfDayNumber(DayNumber({2024, 1, 1}) + i);
      days.push_back(test::Day(FormatFileDate(date), close, close + 1, close - 1, close, 1000 + i));
    }
    home.Put("drive_c/d/ORE.WDT", test::Bytes(days));
    settings.paths.CurrentDataPath = "c:\\d\\";
    for (const OscKey& key : OscKeys()) settings.osc[key] = {5, 5};
    settings.osc.CompFile = "c:\\d\\ORE.WDT";
    for (size_t i = 0; i < colours.size(); ++i) colours[i] = Colour(i);
    request.Name = test::Security("ORE");
    request.BarSpacing = 3;
  }

  bool Draw(const MultiOscSet& names, ChartScript& drawn) {
    const int count = PanelCount(names);
    panels.clear();
    std::vector<Surface*> surfaces;
    for (int i = 0; i < count; ++i) {
      panels.push_back(std::make_unique<HeadlessSurface>(kWidth, 10));
      surfaces.push_back(panels.back().get());
    }
    const ChartServices services{.files = home.files(),
                                 .dialogs = dialogs,
                                 .paths = settings.paths,
                                 .fonts = settings.fonts,
                                 .colours = colours,
                                 .price = price,
                                 .script = &drawn};
    return DrawMultiOsc(services, settings, request, chart, names, surfaces);
  }
  // The frames of panels in a script, those below the price picture.
  static Texts Frames(const ChartScript& drawn) {
    Texts frames;
    for (const std::string& line : test::LinesOf(drawn, 'B')) {
      const auto parts = Split(line, ',');
      if (Val(parts[2]) >= kHeight) frames.push_back(line);
    }
    return frames;
  }

  test::TempHome home;
  test::ScriptedDialogs dialogs;
  Settings settings;
  ChartColours colours{};
  ChartRequest request;
  Composition chart;
  HeadlessSurface price{kWidth, kHeight};
  std::vector<std::unique_ptr<HeadlessSurface>> panels;
  ChartScript script;
};

TEST_F(View, ASetWithNoneInItsSecondSlotDrawsTheOtherThreeAtAThirdOfTheHeightEach) {
  ASSERT_TRUE(Draw({"RSI", "None", "MACD", "Coppock"}, script));
  ASSERT_EQ(panels.size(), 3u);
  for (const auto& panel : panels) {
    EXPECT_EQ(panel->ScaleWidth(), kWidth);
    EXPECT_DOUBLE_EQ(panel->ScaleHeight(), kHeight / 3);
  }
  // 133.33 high: a frame from 3 to 131. Each begins 3 below the end of the one before, and the
  // first where the price picture ends.
  EXPECT_EQ(Frames(script),
            (Texts{"B,42,403,633,531,16", "B,42,537,633,665,16", "B,42,671,633,799,16"}));
}

TEST_F(View, OnePanelTakesTheWholeHeight) {
  ASSERT_TRUE(Draw({"None", "None", "None", "RSI"}, script));
  EXPECT_EQ(Frames(script), (Texts{"B,42,408,633,792,16"}));
}

TEST_F(View, ThePriceChartComesFirstInTheScriptAndIsThatOfAChartWithAPanelBelow) {
  ASSERT_TRUE(Draw({"RSI", "FX", "None", "None"}, script));
  ChartScript alone;
  HeadlessSurface below(kWidth, 100);
  Composition composed;
  ASSERT_TRUE(ComposeChart({.files = home.files(),
                            .dialogs = dialogs,
                            .paths = settings.paths,
                            .fonts = settings.fonts,
                            .colours = colours,
                            .price = price,
                            .panel = &below,
                            .script = &alone},
                           request, composed));
  EXPECT_EQ(script.text().substr(0, alone.text().size()), alone.text());
}

TEST_F(View, MacdShowsNoLinesOnThePricePicture) {
  ASSERT_TRUE(Draw({"MACD", "None", "None", "None"}, script));
  for (const std::string& line : test::LinesOf(script, 'L')) {
    const auto parts = Split(line, ',');
    const bool average = parts[5] == "38" || parts[5] == "40";
    EXPECT_FALSE(average && Val(parts[2]) < kHeight) << line;
  }
  EXPECT_FALSE(test::LinesOf(script, 'H').empty());
}

TEST_F(View, TheSlowAndTheFastStochasticStandSideBySide) {
  ASSERT_TRUE(Draw({"Stochastic (Slow)", "Stochastic (Fast)", "None", "None"}, script));
  Texts titles;
  for (const std::string& line : test::LinesOf(script, 'T'))
    if (line.find("Stochastic") != std::string::npos) titles.push_back(line);
  EXPECT_EQ(titles, (Texts{"T,8.25,44,406,SLOW Stochastic Oscillator (K=5 Period  D=5 Period),27",
                           "T,8.25,44,605,Stochastic Oscillator (K=5 Period  D=5 Period),27"}));
}

TEST_F(View, RocAndFxAreTwoPassesOverOnePanel) {
  ASSERT_TRUE(Draw({"ROC and FX", "None", "None", "None"}, script));
  EXPECT_EQ(Frames(script).size(), 1u);
  Texts titles;
  for (const std::string& line : test::LinesOf(script, 'T'))
    if (line.find("Oscillator (") != std::string::npos) titles.push_back(line);
  ASSERT_EQ(titles.size(), 2u);
  EXPECT_EQ(titles[1], "T,8.25,292,410,FX Oscillator (F=5 Period  X=5 Period),27");
}

TEST_F(View, AnOscillatorThatFailsIsToldAndTheOthersAreDrawn) {
  settings.osc.CompFile = "c:\\d\\GONE.WDT";
  ASSERT_TRUE(Draw({"RSI", "RMX", "MACD", "None"}, script));
  ASSERT_EQ(dialogs.said.size(), 1u);
  // The one that is not drawn keeps its place.
  EXPECT_EQ(Frames(script), (Texts{"B,42,403,633,531,16", "B,42,671,633,799,16"}));
}

TEST_F(View, APeriodOfZeroLeavesItsPlaceEmpty) {
  settings.osc[kRsiP] = {};
  ASSERT_TRUE(Draw({"RSI", "MACD", "None", "None"}, script));
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Frames(script), (Texts{"B,42,603,633,795,16"}));
}

TEST_F(View, WithoutOscillatorsNothingIsDrawn) {
  EXPECT_FALSE(Draw({"None", "None", "None", "None"}, script));
  EXPECT_EQ(script.text(), "");
}

TEST_F(View, ASecurityWithoutDataIsTold) {
  home.Put("drive_c/d/ORE.WDT", "");
  EXPECT_FALSE(Draw({"RSI", "None", "None", "None"}, script));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "No Data for ORE.WDT");
}

}  // namespace
}  // namespace kora
