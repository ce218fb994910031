#include "maintenance/data_entry.h"

#include "base/dates.h"
#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class DataEntryTest : public MaintenanceTest {
 protected:
  EntryBox focus = EntryBox::kNone;

  EntrySecurity Open(const std::string& code) {
    auto security = FindEntry(home.files(), kData, code, dialogs);
    EXPECT_TRUE(security);
    return *security;
  }
  bool Save(const std::string& code, const EntryTexts& texts) {
    auto security = FindEntry(home.files(), kData, code, dialogs);
    return security && SaveEntry(home.files(), *security, texts, dialogs, focus);
  }
};

}  // namespace

TEST_F(DataEntryTest, AddsADayOfAShareBehindTheLast) {
  Names({Security("ORE")});
  Prices("ORE", {Flat("19980914", 1)});
  ASSERT_TRUE(Save("ore", {"15/9/98", "1", "2", "0.5", "1.5", "1200"}));
  EXPECT_EQ(Bytes(PricesOf("ORE")),
            Bytes(std::vector{Flat("19980914", 1), Day("19980915", 1, 2, 0.5f, 1.5f, 1200)}));
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(DataEntryTest, ADateEarlierThanTheLastIsAppendedAllTheSame) {
  Names({Security("ORE")});
  Prices("ORE", {Flat("19980914", 1)});
  ASSERT_TRUE(Save("ORE", {"11/9/98", "1", "1", "1", "1", ""}));
  EXPECT_EQ(Shown("ORE"), "19980914 1; 19980911 1");
}

TEST_F(DataEntryTest, KindsFillTheFieldsThatTheyHave) {
  Names({Security("VOL", 1, kCloseVolume), Security("CLO", 1, kCloseOnly)});
  ASSERT_TRUE(Save("VOL", {"15/9/98", "", "", "", "2.5", "7"}));
  EXPECT_EQ(Bytes(PricesOf("VOL")), Bytes(std::vector{Day("19980915", 2.5f, 2.5f, 2.5f, 2.5f, 7)}));
  ASSERT_TRUE(Save("CLO", {"15/9/98", "", "", "", "2.5", "7"}));
  EXPECT_EQ(Bytes(PricesOf("CLO")), Bytes(std::vector{Day("19980915", 2.5f, 2.5f, 2.5f, 2.5f, 0)}));
}

TEST_F(DataEntryTest, ACloseOfNothingIsRefused) {
  Names({Security("CLO", 1, kCloseOnly), Security("ORE")});
  for (const char* close : {"", " ", "0"}) {
    EXPECT_FALSE(Save("CLO", {"15/9/98", "", "", "", close, ""})) << close;
    EXPECT_EQ(LastSaid(), "Use previous close \n Close should not be 0");
    EXPECT_EQ(LastTitle(), "Data Entry");
    EXPECT_EQ(focus, EntryBox::kClose);
  }
  EXPECT_FALSE(Save("ORE", {"15/9/98", "1", "1", "0", "1", ""}));
  EXPECT_EQ(LastSaid(), "Use previous close \nData should not be 0");
  EXPECT_EQ(focus, EntryBox::kLow);
  EXPECT_FALSE(home.Exists(kHostData + "ORE.WDT"));
}

// The texts are compared, not what they are worth.
TEST_F(DataEntryTest, ZeroPointZeroPasses) {
  Names({Security("CLO", 1, kCloseOnly)});
  EXPECT_TRUE(Save("CLO", {"15/9/98", "", "", "", "0.00", ""}));
  EXPECT_EQ(Shown("CLO"), "19980915 0");
}

TEST_F(DataEntryTest, ATotalMustBeThePreviousOneWithRisesAndFalls) {
  Names({Security("XAD", 1, kAdvanceDecline)});
  Prices("XAD", {Day("19980914", 0, 5, 3, 102)});
  EXPECT_FALSE(Save("XAD", {"15/9/98", "", "10", "4", "107", "50"}));
  EXPECT_EQ(LastSaid(), "Cumulative total must equal\nPrevious total + Rises - Falls");
  EXPECT_EQ(LastTitle(), "Advance/Decline Edit");
  ASSERT_TRUE(Save("XAD", {"15/9/98", "", "10", "4", "108", "50"}));
  EXPECT_EQ(Bytes(std::vector{PricesOf("XAD")[1]}),
            Bytes(std::vector{Day("19980915", 0, 10, 4, 108, 50)}));
}

TEST_F(DataEntryTest, ATotalWithoutDaysBeforeItStartsAtNothing) {
  Names({Security("XAD", 1, kAdvanceDecline)});
  EXPECT_TRUE(Save("XAD", {"15/9/98", "", "10", "4", "6", ""}));
}

TEST_F(DataEntryTest, DatesAndNumbersThatAreNoneAreRefusedWithTheirBox) {
  Names({Security("ORE")});
  EXPECT_FALSE(Save("ORE", {"31/9/98", "1", "1", "1", "1", ""}));
  EXPECT_EQ(focus, EntryBox::kDate);
  EXPECT_FALSE(Save("ORE", {"15/9/98", "1", "x", "1", "1", ""}));
  EXPECT_EQ(LastSaid(), "Data must be numeric");
  EXPECT_EQ(focus, EntryBox::kHigh);
  EXPECT_FALSE(Save("ORE", {"15/9/98", "1", "1", "1", "1e39", ""}));
  EXPECT_EQ(focus, EntryBox::kClose);
  EXPECT_FALSE(Save("ORE", {"15/9/98", "1", "1", "1", "1", "2147483648"}));
  EXPECT_EQ(LastSaid(), "The number is too large");
  EXPECT_EQ(focus, EntryBox::kVolume);
  EXPECT_FALSE(home.Exists(kHostData + "ORE.WDT"));
}

TEST_F(DataEntryTest, TellsASecurityWithoutPrices) {
  Names({Security("ORE"), Security("ZAP")});
  Prices("ZAP", {});
  EXPECT_FALSE(Open("ORE").previous);
  EXPECT_EQ(LastSaid(), "No previous data for ORE");
  EXPECT_EQ(LastTitle(), "Data Entry");
  EXPECT_FALSE(Open("ZAP").previous);
  EXPECT_EQ(LastSaid(), "No previous data for ZAP");
}

TEST_F(DataEntryTest, StepsThroughTheNameFileAndStaysWithinIt) {
  EXPECT_FALSE(OpenEntry(home.files(), kData, 1, dialogs));
  EXPECT_EQ(LastSaid(), "No Records in Name File");
  Names({Security("ORE"), Security("ZAP")});
  for (const auto& [number, code] : {std::pair{0, "ORE"}, std::pair{2, "ZAP"}, std::pair{9, "ZAP"}})
    EXPECT_EQ(OpenEntry(home.files(), kData, number, dialogs)->code, code);
}

TEST_F(DataEntryTest, TheNextDatePassesOverTheWeekend) {
  EXPECT_EQ(NextEntryDate("19980914"), "15/9/98");  // Monday
  EXPECT_EQ(NextEntryDate("19980918"), "21/9/98");  // Friday: Saturday, so three days on
  EXPECT_EQ(NextEntryDate("19980919"), "21/9/98");  // Saturday: Sunday, so two days on
  EXPECT_EQ(NextEntryDate("19981231"), "1/1/99");
  EXPECT_EQ(NextEntryDate("        "), "");
}

TEST_F(DataEntryTest, BoxesShowByKind) {
  const auto shown = [](std::int16_t kind) {
    std::string out;
    for (const auto& [box, letter] :
         {std::pair{EntryBox::kOpen, 'O'}, std::pair{EntryBox::kHigh, 'H'},
          std::pair{EntryBox::kLow, 'L'}, std::pair{EntryBox::kClose, 'C'},
          std::pair{EntryBox::kVolume, 'V'}})
      if (EntryShows(kind, box)) out += letter;
    return out;
  };
  EXPECT_EQ(shown(kCloseVolume), "CV");
  EXPECT_EQ(shown(kCloseOnly), "C");
  EXPECT_EQ(shown(kAdvanceDecline), "HLCV");
  EXPECT_EQ(shown(kShare), "OHLCV");
  EXPECT_EQ(shown(kIndex), "OHLCV");
}

TEST_F(DataEntryTest, AFullFileIsTold) {
  Names({Security("ORE")});
  Prices("ORE", std::vector<PriceRec>(32767, Flat("19980914", 1)));
  EXPECT_FALSE(Save("ORE", {"15/9/98", "1", "1", "1", "1", ""}));
  EXPECT_NE(LastSaid().find("the file is full, with 32767 days"), std::string::npos);
  EXPECT_EQ(focus, EntryBox::kNone);
  EXPECT_EQ(PricesOf("ORE").size(), 32767u);
}

TEST_F(DataEntryTest, AKillLeavesTheOldDaysOrTheNewOne) {
  auto security = EntrySecurity{1, Security("ORE"), "ORE", kData + "ORE.WDT", {}};
  // A rerun of a save that was done would add the day once more: it is typed by a person who sees
  // the previous day.
  again = [&] {
    if (PricesOf("ORE").size() == 2) Prices("ORE", {Flat("19980914", 1)});
  };
  EXPECT_GT(KilledEverywhere(
                [&] {
                  Names({Security("ORE")});
                  Prices("ORE", {Flat("19980914", 1)});
                },
                [&] {
                  return SaveEntry(home.files(), security, {"15/9/98", "1", "1", "1", "2", "3"},
                                   dialogs, focus);
                }),
            1);
}
