#include "adjust/adjustment.h"

#include <gtest/gtest.h>

#include <cmath>
#include <csignal>
#include <filesystem>
#include <limits>
#include <map>

#include "base/numbers.h"
#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/killed_runs.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

const std::string kPrices = "c:\\data\\ORE.WDT", kNotes = "c:\\misc\\ORE.Txt";
constexpr const char* kHostPrices = "drive_c/data/ORE.WDT";
constexpr const char* kHostNotes = "drive_c/misc/ORE.Txt";

std::string DescOf(const PriceRec& rec) { return std::string(rec.AdjDesc.trimmed()); }

// ---- records

TEST(AdjustmentTest, ABonusIssueRescalesAllRecordsUpToItsDateAndStampsIt) {
  std::vector<PriceRec> records{Day("20240101", 4, 5.5f, 3.5f, 5, 700),
                                Day("20240102", 5, 5, 5, 5, 800), Day("20240103", 4, 4, 4, 4, 900)};
  AdjustRecords(records, 2, BonusIssue(1, 4));
  EXPECT_EQ(float(records[0].Open), 3.2f);
  EXPECT_EQ(float(records[0].High), 4.4f);
  EXPECT_EQ(float(records[0].Low), 2.8f);
  EXPECT_EQ(float(records[0].Close), 4.0f);
  EXPECT_EQ(std::int32_t(records[0].Volume), 700);
  EXPECT_EQ(float(records[0].AdjFactor), 0);
  EXPECT_EQ(DescOf(records[0]), "");
  EXPECT_EQ(float(records[1].Close), 4.0f);
  EXPECT_EQ(std::int32_t(records[1].Volume), 800);
  EXPECT_EQ(float(records[1].AdjFactor), 0.8f);
  EXPECT_EQ(DescOf(records[1]), "bi1:4");
  EXPECT_EQ(float(records[2].Close), 4.0f);
  EXPECT_EQ(float(records[2].AdjFactor), 0);
}

TEST(AdjustmentTest, PricesAreRoundedToFourDecimalsHalfToEven) {
  EXPECT_EQ(ScaledPrice(1.2345f, 0.5), CSng(0.6173)) << "the float lies above 1.2345";
  EXPECT_EQ(ScaledPrice(0.00025f, 1), CSng(0.0003)) << "the float lies above 0.00025";
  EXPECT_EQ(ScaledPrice(0.125f, 0.0004), CSng(0)) << "0.00005 exactly half: to even";
  EXPECT_EQ(ScaledPrice(0.375f, 0.0004), CSng(0.0002)) << "0.00015 exactly half: to even";
}

TEST(AdjustmentTest, TheStampGoesDownToTheFirstRecordWithAClose) {
  std::vector<PriceRec> records{Day("20240101", 2, 2, 2, 2), Day("20240102", 2, 2, 2, 2),
                                Day("20240103", 9, 9, 9, 0), Day("20240104", 0, 0, 0, 0)};
  AdjustRecords(records, 4, ShareSplit(2, 1));
  EXPECT_EQ(float(records[3].AdjFactor), 0);
  EXPECT_EQ(float(records[2].AdjFactor), 0);
  EXPECT_EQ(float(records[2].Open), 9) << "passed over";
  EXPECT_EQ(float(records[1].AdjFactor), 0.5f);
  EXPECT_EQ(DescOf(records[1]), "ss2:1");
  EXPECT_EQ(float(records[0].Close), 1);
  EXPECT_EQ(float(records[0].AdjFactor), 0);
}

TEST(AdjustmentTest, StampsOfEarlierAdjustmentsStay) {
  std::vector<PriceRec> records{Day("20240101", 2, 2, 2, 2, 0, 0.9f), Day("20240102", 2, 2, 2, 2)};
  records[0].AdjDesc.set("dv0.1");
  AdjustRecords(records, 2, ShareSplit(2, 1));
  EXPECT_EQ(float(records[0].AdjFactor), 0.9f);
  EXPECT_EQ(DescOf(records[0]), "dv0.1");
  EXPECT_EQ(float(records[1].AdjFactor), 0.5f);
}

TEST(AdjustmentTest, ALongNoteIsCutToItsFourteenBytes) {
  std::vector<PriceRec> records{Day("20240101", 4, 4, 4, 4), Day("20240102", 4, 4, 4, 4)};
  AdjustRecords(records, 2, CashIssue(17, 120, Currency(1.2345), 4));
  EXPECT_EQ(records[1].AdjDesc.raw(), "ci17:120 @ 1.2");
}

TEST(AdjustmentTest, PricesThatLeaveTheRangeOfMoneyAreAnOverflow) {
  std::vector<PriceRec> records{Day("20240101", 1, 1, 1, 1), Day("20240102", 1e10f, 1, 1, 1)};
  EXPECT_EQ(ErrorOf([&] { AdjustRecords(records, 2, {1e5f, "x"}); }), kOverflow);
  records[1].Open = std::nanf("");
  EXPECT_EQ(ErrorOf([&] { AdjustRecords(records, 2, {0.5f, "x"}); }), kOverflow);
  EXPECT_EQ(ErrorOf([&] { AdjustRecords(records, 3, {0.5f, "x"}); }), kBadRecordNumber);
  EXPECT_EQ(ErrorOf([&] { AdjustRecords(records, 0, {0.5f, "x"}); }), kBadRecordNumber);
}

// ---- chart notes

TEST(AdjustmentTest, NotesUpToTheDateMoveWithThePricesAndAllTakeTheColour) {
  std::vector<ChartNote> notes{{"T", "8.25", "20240101", "5.00", "before", "1"},
                               {"T", "8.25", "20240102", ".49", "at it", "1"},
                               {"T", "8.25", "20240103", "5.00", "behind", "1"},
                               {"T", "8.25", "", "abc", "no date", ""}};
  AdjustNotes(notes, "20240102", 0.8f, 255);
  EXPECT_EQ(ChartNotesText(notes),
            "T,8.25,20240101,4.00,before,255\r\nT,8.25,20240102,.39,at it,255\r\n"
            "T,8.25,20240103,5.00,behind,255\r\nT,8.25,,.00,no date,255\r\n");
}

TEST(AdjustmentTest, ANotesPriceThatIsOutOfRangeStays) {
  std::vector<ChartNote> notes{{"T", "8.25", "20240101", "99999999999999999999", "far", "1"}};
  AdjustNotes(notes, "20240102", 0.8f, 255);
  EXPECT_EQ(notes[0].Price, "99999999999999999999");
}

// ---- removal

TEST(RemoveAdjustmentTest, GivesThePricesBackWithinHalfAUnitOfTheFourthDecimal) {
  std::vector<PriceRec> records;
  for (int i = 0; i < 200; ++i) {
    const float close = 0.37f + float(i) * 0.731f;
    records.push_back(Day("20240101", close, close + 0.01f, close - 0.01f, close, i));
  }
  const auto before = records;
  for (const Adjustment& adjustment :
       {BonusIssue(1, 4), ShareSplit(2, 1), ShareCall(Currency(0.5), 5)}) {
    AdjustRecords(records, 150, adjustment);
    EXPECT_EQ(RemoveLatestAdjustment(records), 1);
    // What the rounding of the scaled price, half a unit of its fourth decimal, can come to.
    const double unit = 0.00005 / adjustment.AdjFactorValue + 0.00005 + 1e-5;
    for (size_t i = 0; i < records.size(); ++i) {
      EXPECT_NEAR(float(records[i].Close), float(before[i].Close), unit) << i;
      EXPECT_NEAR(float(records[i].High), float(before[i].High), unit) << i;
      EXPECT_EQ(float(records[i].AdjFactor), 0);
    }
    records = before;
  }
}

TEST(RemoveAdjustmentTest, TakesTheLatestAndPassesNoRecordOver) {
  std::vector<PriceRec> records{Day("20240101", 1, 1, 1, 1, 0, 0.9f),
                                Day("20240102", 2, 2, 2, 2, 0, 0.5f), Day("20240103", 3, 3, 3, 0),
                                Day("20240104", 4, 4, 4, 4, 7, 0.8f), Day("20240105", 5, 5, 5, 5)};
  records[3].AdjDesc.set("bi1:4");
  EXPECT_EQ(RemoveLatestAdjustment(records), 2) << "record 1 is not looked at";
  EXPECT_EQ(float(records[3].Close), 5);
  EXPECT_EQ(std::int32_t(records[3].Volume), 7);
  EXPECT_EQ(float(records[3].AdjFactor), 0);
  EXPECT_EQ(DescOf(records[3]), "");
  EXPECT_EQ(float(records[2].Open), 3.75f);
  EXPECT_EQ(float(records[1].Close), 2.5f);
  EXPECT_EQ(float(records[1].AdjFactor), 0.5f);
  EXPECT_EQ(float(records[0].Close), 1.25f);
  EXPECT_EQ(float(records[4].Close), 5);
  EXPECT_EQ(RemoveLatestAdjustment(records), 1);
  EXPECT_EQ(float(records[1].Close), 5);
  EXPECT_EQ(RemoveLatestAdjustment(records), 0);
}

TEST(RemoveAdjustmentTest, MoreThanTwentyStampsRunOutOfTheTable) {
  std::vector<PriceRec> records(21, Day("20240101", 1, 1, 1, 1, 0, 0.5f));
  EXPECT_EQ(RemoveLatestAdjustment(records), 20);
  records.assign(22, Day("20240101", 1, 1, 1, 1, 0, 0.5f));
  const std::string before = Bytes(records);
  EXPECT_EQ(ErrorOf([&] { RemoveLatestAdjustment(records); }), kIndexOutOfRange);
  EXPECT_EQ(Bytes(records), before);
}

TEST(RemoveAdjustmentTest, AStampThatIsNoNumberIsAnOverflow) {
  std::vector<PriceRec> records(2, Day("20240101", 1, 1, 1, 1));
  for (const float factor : {std::nanf(""), std::numeric_limits<float>::infinity(), 1e-30f}) {
    records[1].AdjFactor = factor;
    EXPECT_EQ(ErrorOf([&] { RemoveLatestAdjustment(records); }), kOverflow) << factor;
  }
}

// ---- files

class AdjustedFiles : public ::testing::Test {
 protected:
  using Store = std::map<std::string, std::string>;

  AdjustedFiles() : home(io) {}

  void Lay() {
    std::filesystem::remove_all(home.path() + "/drive_c");
    std::filesystem::remove(home.path() + "/Kora.set~");
    home.Put(kHostPrices, Bytes<PriceRec>({Day("20240101", 5, 5, 5, 5), Day("20240102", 5, 5, 5, 5),
                                           Day("20240103", 4, 4, 4, 4)}));
    home.Put(kHostNotes, "T,8.25,20240101,5.00,note,1\r\n");
  }
  void Adjust() {
    PriceEdit edit(home.files(), kPrices);
    ApplyAdjustment({home.files(), kPrices, kNotes, 255}, edit, 2, BonusIssue(1, 4));
  }
  // What is on the disk; leftovers too, unless they wait for the next write.
  Store Everything() {
    Store store;
    for (const auto& entry :
         std::filesystem::recursive_directory_iterator(home.path() + "/drive_c")) {
      const std::string name = entry.path().lexically_relative(home.path()).string();
      if (entry.is_regular_file() && !name.ends_with("~")) store[name] = home.Get(name);
    }
    return store;
  }
  bool IsStamped() { return PriceFile(home.files(), kPrices).Read(2).AdjFactor == 0.8f; }

  // In a process of its own, killed in place of change `at`. False when it came to its end.
  template <typename Action>
  bool KilledAt(int at, Action action) {
    const auto code = InChild([&] {
      io.Reset(at);
      io.kills = io.torn = true;
      return ErrorOf(action);
    });
    EXPECT_EQ(code.value_or(0), 0);
    return !code;
  }

  FailingIo io;
  TempHome home;
};

TEST_F(AdjustedFiles, PricesAndNotesChangeTogether) {
  Lay();
  Adjust();
  EXPECT_EQ(home.Get(kHostNotes), "T,8.25,20240101,4.00,note,255\r\n");
  EXPECT_EQ(float(PriceFile(home.files(), kPrices).Read(1).Close), 4);
  EXPECT_TRUE(IsStamped());
}

TEST_F(AdjustedFiles, ASecurityWithoutNotesGetsNone) {
  Lay();
  std::filesystem::remove(home.path() + "/" + kHostNotes);
  Adjust();
  EXPECT_TRUE(IsStamped());
  EXPECT_FALSE(home.Exists(kHostNotes));
}

TEST_F(AdjustedFiles, ABonusIssueKilledAtAnyWriteIsDoneOrNotAndItsStampTellsIt) {
  Lay();
  const Store before = Everything();
  Adjust();
  const Store whole = Everything();
  bool finished = false;
  int kills = 0;
  for (int at = 1;; ++at) {
    ASSERT_LT(at, 100);
    Lay();
    if (!KilledAt(at, [&] { Adjust(); })) break;
    ++kills;
    const bool waits = home.Exists("Kora.set~");
    { const auto held = home.files().lock().Hold(); }  // as the next writer, or the next start
    EXPECT_EQ(Everything(), IsStamped() ? whole : before) << at;
    finished |= waits && IsStamped();
    if (!IsStamped()) Adjust();
    EXPECT_EQ(Everything(), whole) << at;
  }
  EXPECT_GT(kills, 10);
  EXPECT_TRUE(finished);
}

TEST_F(AdjustedFiles, ARemovalKilledAtAnyWriteIsDoneOrNotAndItsStampTellsIt) {
  Lay();
  Adjust();
  const Store before = Everything();
  const auto lay = [&] {
    Lay();
    for (const auto& [name, bytes] : before) home.Put(name, bytes);
  };
  RemoveAdjustment(home.files(), kPrices);
  const Store whole = Everything();
  EXPECT_NE(whole, before);
  int kills = 0;
  for (int at = 1;; ++at) {
    ASSERT_LT(at, 100);
    lay();
    if (!KilledAt(at, [&] { RemoveAdjustment(home.files(), kPrices); })) break;
    ++kills;
    EXPECT_EQ(Everything(), IsStamped() ? before : whole) << at;
    RemoveAdjustment(home.files(), kPrices);
    EXPECT_EQ(Everything(), whole) << at;
  }
  EXPECT_GT(kills, 5);
}

TEST_F(AdjustedFiles, AFailureAtAnyCallLeavesBothAsTheyWere) {
  for (int at = 1;; ++at) {
    ASSERT_LT(at, 100);
    Lay();
    const Store before = Everything();
    io.Reset(at);
    io.torn = true;
    const int error = ErrorOf([&] { Adjust(); });
    if (io.calls < at) break;
    if (error == 0) continue;  // the journal that could not be taken away: all is done
    EXPECT_EQ(error, kDiskFull);
    EXPECT_EQ(Everything(), before) << at;
  }
  io.Reset();
}

TEST_F(AdjustedFiles, ReadOnlyPricesOrNotesRefuseAll) {
  for (const char* name : {kHostPrices, kHostNotes}) {
    Lay();
    const Store before = Everything();
    std::filesystem::permissions(home.path() + "/" + name, std::filesystem::perms(0444));
    EXPECT_EQ(ErrorOf([&] { Adjust(); }), kPathAccess) << name;
    EXPECT_EQ(Everything(), before) << name;
  }
}

TEST_F(AdjustedFiles, AFileThatChangedSinceTheDateWasChosenIsNotAdjusted) {
  Lay();
  PriceEdit edit(home.files(), kPrices);
  home.files().WriteAll(
      kPrices, Bytes<PriceRec>({Day("20231231", 5, 5, 5, 5), Day("20240101", 5, 5, 5, 5)}));
  const Store before = Everything();
  EXPECT_EQ(ErrorOf([&] {
              ApplyAdjustment({home.files(), kPrices, kNotes, 255}, edit, 2, BonusIssue(1, 4));
            }),
            kPermissionDenied);
  EXPECT_EQ(Everything(), before);
}

TEST_F(AdjustedFiles, AdjustingTheLastRecordRescalesTheWholeFile) {
  Lay();
  PriceEdit edit(home.files(), kPrices);
  ApplyAdjustment({home.files(), kPrices, kNotes, 255}, edit, 3, ShareSplit(2, 1));
  const auto records = PriceFile(home.files(), kPrices).ReadAll();
  EXPECT_EQ(float(records[0].Close), 2.5f);
  EXPECT_EQ(float(records[1].Close), 2.5f);
  EXPECT_EQ(float(records[2].Close), 2);
  EXPECT_EQ(float(records[2].AdjFactor), 0.5f);
}

}  // namespace
}  // namespace kora::test
