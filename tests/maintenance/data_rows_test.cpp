#include "maintenance/data_rows.h"

#include <limits>

#include "base/home_lock.h"
#include "tests/maintenance/maintenance_fixture.h"

namespace kora::test {
namespace {

class DataRowsTest : public MaintenanceTest {
 protected:
  const std::string kOre = kData + "ORE.WDT";

  DataRows& Show(const std::string& code = "ORE") {
    rows.emplace(home.files(), kData + code + ".WDT");
    shown = rows->ShowData(code, progress, dialogs);
    return *rows;
  }
  // What was refused, as "title: text"; empty for nothing.
  static std::string Said(const std::optional<Refusal>& refusal) {
    return refusal ? refusal->title + ": " + refusal->text : "";
  }
  std::string Put(int row, int column, const std::string& text) {
    return Said(rows->SetText(row, column, text));
  }
  std::string Row(int row) {
    std::string out;
    for (int column = 0; column < kDataColumns; ++column)
      out += (column ? "|" : "") + rows->Text(row, column);
    return out;
  }
  std::string Dates() {
    std::string out;
    for (const PriceRec& rec : rows->records()) out += std::string(rec.RecDate.raw()) + ".";
    return out;
  }

  std::optional<DataRows> rows;
  bool shown = false;
};

std::vector<PriceRec> ThreeDays() {
  PriceRec adjusted = Day("19980914", 2.5f, 2.75f, 2.25f, 2.1936f, 2000, 0.5f);
  adjusted.AdjDesc.set("Bonus 1:1");
  return {Day("19980911", 1, 2, 0.5f, 1.5f, 10), adjusted,
          Day("19980915", 3, 4, 3, 3.5f, 2147483647)};
}

TEST_F(DataRowsTest, ShowsEachRecordWithItsNumberDatePricesVolumeAndAdjustment) {
  Prices("ORE", ThreeDays());
  Show();
  EXPECT_TRUE(shown);
  EXPECT_EQ(rows->RowCount(), 3);
  EXPECT_EQ(Row(0), "1|19980911|1|2|0.5|1.5|10|0|");
  EXPECT_EQ(Row(1), "2|19980914|2.5|2.75|2.25|2.1936|2000|0.5|Bonus 1:1");
  EXPECT_EQ(Row(2), "3|19980915|3|4|3|3.5|2147483647|0|");
  EXPECT_FALSE(rows->changed());
  EXPECT_GE(progress.steps, 1);
}

TEST_F(DataRowsTest, AnAdvanceDeclineSeriesHasHeadingsOfItsOwn) {
  std::string share, series;
  for (int i = 0; i < kDataColumns; ++i) {
    share += DataHeading(DataColumn(i), kShare) + "|";
    series += DataHeading(DataColumn(i), kAdvanceDecline) + "|";
  }
  EXPECT_EQ(share, "Rec|Date|Open|High|Low|Close|Volume|Adj.Factor|Adj.Desc.|");
  EXPECT_EQ(series, "Rec|Date|Open|Rises|Falls|Cum.Total|Volume|Adj.Factor|Adj.Desc.|");
}

TEST_F(DataRowsTest, AMissingFileIsToldByItsCode) {
  Show();
  EXPECT_FALSE(shown);
  EXPECT_EQ(LastTitle() + ": " + LastSaid(), "Data File: ORE NOT FOUND");
}

TEST_F(DataRowsTest, AFileWithoutAWholeRecordIsTold) {
  home.Put(kHostData + "ORE.WDT", std::string(49, 'x'));
  Show();
  EXPECT_FALSE(shown);
  EXPECT_EQ(LastTitle() + ": " + LastSaid(), "Data File: No data on file for " + kOre);
}

TEST_F(DataRowsTest, ReadingCanBeStopped) {
  Prices("ORE", ThreeDays());
  progress.stopAt = 1;
  Show();
  EXPECT_FALSE(shown);
  EXPECT_EQ(rows->RowCount(), 0);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(DataRowsTest, NumberAndFactorCannotBeEdited) {
  Prices("ORE", ThreeDays());
  Show();
  EXPECT_EQ(Put(1, kDataRec, "9"), "Data: Cannot edit this column");
  EXPECT_EQ(Put(1, kDataAdjFactor, "1"), "Data: Cannot edit this column");
  EXPECT_FALSE(rows->changed());
}

TEST_F(DataRowsTest, PricesAndVolumesMustBeNumbers) {
  Prices("ORE", ThreeDays());
  Show();
  for (const int column : {kDataOpen, kDataHigh, kDataLow, kDataClose, kDataVolume})
    for (const char* text : {"", " ", "x", "1.5x", "1,5", "nan", "inf", "--1"})
      EXPECT_EQ(Put(0, column, text), "Data: Data must be numeric") << text;
  EXPECT_FALSE(rows->changed());
  EXPECT_EQ(Put(0, kDataOpen, " 1.25 "), "");
  EXPECT_EQ(Put(0, kDataHigh, "+1e1"), "");
  EXPECT_EQ(Put(0, kDataLow, "-.5"), "");
  EXPECT_EQ(Put(0, kDataClose, "1e-400"), "");
  EXPECT_EQ(Row(0), "1|19980911|1.25|10|-0.5|0|10|0|");
  EXPECT_TRUE(rows->changed());
}

TEST_F(DataRowsTest, AVolumeIsRoundedHalfToEven) {
  Prices("ORE", ThreeDays());
  Show();
  for (const auto& [typed, kept] : {std::pair{"2.5", "2"}, {"3.5", "4"}, {"2.51", "3"}}) {
    EXPECT_EQ(Put(0, kDataVolume, typed), "");
    EXPECT_EQ(rows->Text(0, kDataVolume), kept);
  }
}

TEST_F(DataRowsTest, AVolumeBeyond32BitsIsRefused) {
  Prices("ORE", ThreeDays());
  Show();
  EXPECT_EQ(Put(0, kDataVolume, "2147483648"), "Data: The number is too large");
  EXPECT_EQ(Put(0, kDataVolume, "-2147483649"), "Data: The number is too large");
  EXPECT_FALSE(rows->changed());
  EXPECT_EQ(Put(0, kDataVolume, "2147483647"), "");
  EXPECT_EQ(std::int32_t(rows->records()[0].Volume), 2147483647);
}

TEST_F(DataRowsTest, APriceBeyondAFloatIsRefused) {
  Prices("ORE", ThreeDays());
  Show();
  for (const char* text : {"3.5e38", "-3.5e38", "1e400"})
    EXPECT_EQ(Put(0, kDataClose, text), "Data: The number is too large") << text;
  EXPECT_FALSE(rows->changed());
  EXPECT_EQ(Put(0, kDataClose, "3.4e38"), "");
}

TEST_F(DataRowsTest, ADateIsTakenAsTypedAndCutToEightBytes) {
  Prices("ORE", ThreeDays());
  Show();
  EXPECT_EQ(Put(0, kDataDate, "19980912999"), "");
  EXPECT_EQ(rows->Text(0, kDataDate), "19980912");
  EXPECT_EQ(Put(0, kDataDate, "soon"), "");
  EXPECT_EQ(rows->records()[0].RecDate.raw(), "soon    ");
  EXPECT_EQ(Put(0, kDataDate, ""), "");
  EXPECT_EQ(rows->records()[0].RecDate.raw(), "        ");
}

TEST_F(DataRowsTest, ARowWhoseDateIsNoDateStandsOut) {
  Prices("ORE", {Flat("19980911", 1), Flat("19980931", 1), Flat("", 1), Flat("11/9/98", 1)});
  Show();
  const GridShade shades[] = {GridShade::kNone, GridShade::kMarked, GridShade::kMarked,
                              GridShade::kMarked};
  for (int row = 0; row < 4; ++row)
    for (const int column : {kDataRec, kDataDate, kDataAdjDesc})
      EXPECT_EQ(rows->Shade(row, column), shades[row]) << row;
  Put(1, kDataDate, "19980930");
  EXPECT_EQ(rows->Shade(1, kDataDate), GridShade::kNone);
}

TEST_F(DataRowsTest, ANoteIsCutToFourteenBytes) {
  Prices("ORE", ThreeDays());
  Show();
  EXPECT_EQ(Put(0, kDataAdjDesc, "Bonus 1:10 at 2.50"), "");
  EXPECT_EQ(rows->records()[0].AdjDesc.raw(), "Bonus 1:10 at ");
  EXPECT_EQ(Put(0, kDataAdjDesc, "caf\u00e9"), "");
  EXPECT_EQ(rows->records()[0].AdjDesc.trimmed(), "caf\xE9");
}

TEST_F(DataRowsTest, LettersThatTheFileLacksAreRefused) {
  Prices("ORE", ThreeDays());
  Show();
  EXPECT_EQ(Put(0, kDataAdjDesc, "\u0141"),
            "Data: \"\u0141\" has letters that the file can't keep");
  EXPECT_FALSE(rows->changed());
}

TEST_F(DataRowsTest, RowsGoFromTheGridAndFromTheFileAtTheSave) {
  Prices("ORE", ThreeDays());
  const std::string before = home.Get(kHostData + "ORE.WDT");
  Show();
  EXPECT_FALSE(rows->MayDelete({0, 1}));
  rows->DeleteRows({0, 1});
  EXPECT_EQ(Row(0), "1|19980915|3|4|3|3.5|2147483647|0|");
  EXPECT_TRUE(rows->changed());
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), before);
  EXPECT_TRUE(rows->SaveData(progress, dialogs));
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), before.substr(100));
  EXPECT_FALSE(rows->changed());
}

TEST_F(DataRowsTest, ARowWithoutADateHoldsNoRecordToDelete) {
  Prices("ORE", {Flat("19980911", 1), Flat("", 1)});
  Show();
  EXPECT_EQ(Said(rows->MayDelete({1, 1})), "Delete Transaction: Only transactions can be deleted");
  EXPECT_EQ(Said(rows->MayDelete({0, 1})), "Delete Transaction: Only transactions can be deleted");
  EXPECT_EQ(Said(rows->MayDelete({0, 0})), "");
}

TEST_F(DataRowsTest, RowsSortByDateAndThoseOfOneDateStayAsTheyStand) {
  Prices("ORE", {Flat("19980914", 1), Flat("19980911", 2), Flat("19980914", 3), Flat("", 4)});
  Show();
  rows->SortByDate();
  EXPECT_EQ(Dates(), "        .19980911.19980914.19980914.");
  EXPECT_EQ(rows->Text(2, kDataClose) + rows->Text(3, kDataClose), "13");
  EXPECT_EQ(rows->Text(0, kDataRec), "1");
  EXPECT_TRUE(rows->changed());
}

TEST_F(DataRowsTest, RowsThatStandInOrderAreNotChangedByASort) {
  Prices("ORE", ThreeDays());
  Show();
  rows->SortByDate();
  EXPECT_FALSE(rows->changed());
}

// ---- Saving

TEST_F(DataRowsTest, SavesEachRowAtItsNumberAndKeepsTheFileAsItWas) {
  Prices("ORE", ThreeDays());
  const std::string before = home.Get(kHostData + "ORE.WDT");
  Show();
  Put(1, kDataClose, "2.2");
  Put(1, kDataVolume, "7");
  Put(1, kDataAdjDesc, "Split");
  EXPECT_TRUE(rows->SaveData(progress, dialogs));
  auto expected = ThreeDays();
  expected[1].Close = 2.2f;
  expected[1].Volume = 7;
  expected[1].AdjDesc.set("Split");
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), Bytes(expected));
  EXPECT_EQ(home.Get(kHostData + "Temp.WRK"), before);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(DataRowsTest, WhatNobodyEditedIsSavedByteForByte) {
  PriceRec odd = Flat("1998\0091", std::numeric_limits<float>::quiet_NaN());
  odd.AdjDesc.set(std::string_view("\0\x81\xFF", 3));
  odd.RecSpare.set("keep");
  Prices("ORE", {odd, Flat("19980914", 1)});
  Show();
  Put(1, kDataClose, "2");
  EXPECT_TRUE(rows->SaveData(progress, dialogs));
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), Bytes(std::vector{odd, [] {
                                                                 PriceRec rec = Flat("19980914", 1);
                                                                 rec.Close = 2;
                                                                 return rec;
                                                               }()}));
}

TEST_F(DataRowsTest, ATornRecordAtTheEndIsGoneAfterTheSave) {
  home.Put(kHostData + "ORE.WDT", Bytes(ThreeDays()) + "torn");
  Show();
  EXPECT_EQ(rows->RowCount(), 3);
  EXPECT_TRUE(rows->SaveData(progress, dialogs));
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), Bytes(ThreeDays()));
}

TEST_F(DataRowsTest, EmptyRowsLeaveAnEmptyFile) {
  Prices("ORE", ThreeDays());
  Show();
  rows->DeleteRows({0, 2});
  EXPECT_TRUE(rows->SaveData(progress, dialogs));
  EXPECT_TRUE(home.Exists(kHostData + "ORE.WDT"));
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), "");
  EXPECT_EQ(home.Get(kHostData + "Temp.WRK"), Bytes(ThreeDays()));
}

TEST_F(DataRowsTest, AFileThatAnotherProgramChangedAsksBeforeTheSave) {
  Prices("ORE", ThreeDays());
  Show();
  Put(0, kDataClose, "9");
  auto updated = ThreeDays();
  updated.push_back(Flat("19980916", 4));
  Prices("ORE", updated);
  dialogs.answers = {Answer::kNo};
  EXPECT_FALSE(rows->SaveData(progress, dialogs));
  EXPECT_EQ(LastTitle() + ": " + LastSaid(),
            "Saving Data: The data file was changed by another program. Save over these changes ?");
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), Bytes(updated));
  EXPECT_TRUE(rows->changed());
  dialogs.answers = {Answer::kYes};
  EXPECT_TRUE(rows->SaveData(progress, dialogs));
  EXPECT_EQ(rows->records().size(), 3u);
  EXPECT_EQ(PricesOf("ORE").size(), 3u);
  EXPECT_EQ(home.Get(kHostData + "Temp.WRK"), Bytes(updated));
}

TEST_F(DataRowsTest, TheSecondSaveDoesNotAskAboutTheFirst) {
  Prices("ORE", ThreeDays());
  Show();
  for (const char* close : {"9", "8"}) {
    Put(0, kDataClose, close);
    EXPECT_TRUE(rows->SaveData(progress, dialogs));
  }
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(DataRowsTest, AFileThatIsGoneIsMadeAgainWhereTheUserSaysSo) {
  Prices("ORE", ThreeDays());
  Show();
  home.files().Remove(kOre);
  EXPECT_TRUE(rows->SaveData(progress, dialogs));
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT"), Bytes(ThreeDays()));
  EXPECT_FALSE(home.Exists(kHostData + "Temp.WRK"));
}

TEST_F(DataRowsTest, AReadOnlyFileIsNotSavedAndNothingIsLeftBehind) {
  namespace fs = std::filesystem;
  Prices("ORE", ThreeDays());
  Show();
  Put(0, kDataClose, "9");
  fs::permissions(home.path() + "/" + kHostData + "ORE.WDT", fs::perms::owner_read);
  const Store before = Everything();
  EXPECT_FALSE(rows->SaveData(progress, dialogs));
  fs::permissions(home.path() + "/" + kHostData + "ORE.WDT", fs::perms::owner_all);
  // The question first: the file has another stamp.
  EXPECT_EQ(LastTitle() + ": " + LastSaid(), "Saving Data: Unable to save data");
  EXPECT_TRUE(Everything() == before);
  EXPECT_TRUE(rows->changed());
}

TEST_F(DataRowsTest, ASaveIsRefusedByNameWhileAnotherProgramWrites) {
  Prices("ORE", ThreeDays());
  Show();
  Put(0, kDataClose, "9");
  Files other(home.path());
  other.lock().program = "koractl";
  const auto held = other.lock().Hold();
  home.files().lock().wait = std::chrono::milliseconds(0);
  EXPECT_FALSE(rows->SaveData(progress, dialogs));
  EXPECT_EQ(LastTitle(), "Saving Data");
  EXPECT_NE(LastSaid().find("koractl"), std::string::npos) << LastSaid();
  EXPECT_TRUE(rows->changed());
}

TEST_F(DataRowsTest, AFailingSaveLeavesEverythingAsItWas) {
  Prices("ORE", ThreeDays());
  home.Put(kHostData + "Temp.WRK", "kept before");
  Show();
  Put(0, kDataClose, "9");
  EXPECT_GT(FailedEverywhere([&] { return rows->SaveData(progress, dialogs); }), 4);
}

TEST_F(DataRowsTest, AKillAtAnyWriteLeavesTheOldFileOrTheNewOne) {
  const auto lay = [&] {
    Prices("ORE", ThreeDays());
    home.Put(kHostData + "Temp.WRK", "kept before");
  };
  bool anyOld = false, anyNew = false;
  const auto work = [&] {
    rows.emplace(home.files(), kOre);
    if (!rows->ShowData("ORE", progress, dialogs)) return false;
    return rows->SetText(0, kDataClose, "9") == std::nullopt && rows->SaveData(progress, dialogs);
  };
  again = [&] {
    { const auto held = home.files().lock().Hold(); }  // finishes what the dead one began
    const std::string file = home.Get(kHostData + "ORE.WDT");
    const std::string copy = home.Get(kHostData + "Temp.WRK");
    const bool old = file == Bytes(ThreeDays());
    EXPECT_EQ(copy, old ? "kept before" : Bytes(ThreeDays()));
    (old ? anyOld : anyNew) = true;
    lay();
  };
  EXPECT_GT(KilledEverywhere(lay, work), 4);
  EXPECT_TRUE(anyOld && anyNew);
}

TEST_F(DataRowsTest, AFileOfMoreRecordsThanAChartCanNumberIsShownAndSaved) {
  std::vector<PriceRec> many(40000, Flat("19980911", 1));
  many.back() = Flat("19980914", 2);
  Prices("ORE", many);
  Show();
  ASSERT_TRUE(shown);
  EXPECT_EQ(rows->RowCount(), 40000);
  EXPECT_EQ(rows->Text(39999, kDataDate), "19980914");
  rows->DeleteRows({0, 9});
  EXPECT_TRUE(rows->SaveData(progress, dialogs));
  EXPECT_EQ(home.Get(kHostData + "ORE.WDT").size(), 39990u * 50);
}

TEST_F(DataRowsTest, ASaveThatIsStoppedWritesNothing) {
  Prices("ORE", ThreeDays());
  Show();
  Put(0, kDataClose, "9");
  const Store before = Everything();
  for (const int at : {1, 2}) {
    progress.steps = 0;
    progress.stopAt = at;
    EXPECT_FALSE(rows->SaveData(progress, dialogs));
  }
  EXPECT_TRUE(Everything() == before);
  EXPECT_TRUE(rows->changed());
  EXPECT_TRUE(dialogs.said.empty());
}

// ---- Multiplying and dividing

constexpr ScaleItems kAll{true, true, true, true, true};
constexpr ScaleItems kCloseAlone{false, false, false, true, false};
constexpr ScaleItems kVolumeAlone{false, false, false, false, true};

TEST_F(DataRowsTest, TheSelectionIsCalledByItsRecords) {
  EXPECT_EQ(ScaleCaption({2, 2}), "Modify record 3");
  EXPECT_EQ(ScaleCaption({2, 6}), "Modify records 3 to 7");
  EXPECT_EQ(ScaleCaption({}), "There are no records selected");
}

TEST_F(DataRowsTest, TheTextFollowsTheTicks) {
  EXPECT_EQ(ScaleText({}), "");
  EXPECT_EQ(ScaleText(kCloseAlone),
            "This procedure multiplies or divides the CLOSE of the highlighted record/s, by the "
            "factor selected. ");
  EXPECT_EQ(ScaleText(kAll),
            "This procedure multiplies or divides the OPEN, HIGH, LOW, CLOSE, VOLUME of the "
            "highlighted record/s, by the factor selected. ");
}

TEST_F(DataRowsTest, ItemsAndFactorMustBeChosen) {
  EXPECT_EQ(Said(CheckScale({}, ScaleBy::kOver10)), "Data Modification: No data item to Adjust");
  EXPECT_EQ(Said(CheckScale(kAll, {})),
            "Data Modification: Multiply or Divide option must be selected");
  EXPECT_EQ(Said(CheckScale(kAll, ScaleBy::kOver10)), "");
}

TEST_F(DataRowsTest, TickedItemsOfTheSelectedRowsAreMultiplied) {
  Prices("ORE", ThreeDays());
  Show();
  EXPECT_EQ(Said(rows->Scale({0, 1}, kAll, ScaleBy::kTimes10)), "");
  EXPECT_EQ(Row(0), "1|19980911|10|20|5|15|100|0|");
  EXPECT_EQ(Row(1), "2|19980914|25|27.5|22.5|21.936|20000|0.5|Bonus 1:1");
  EXPECT_EQ(Row(2), "3|19980915|3|4|3|3.5|2147483647|0|");
  EXPECT_EQ(Said(rows->Scale({1, 1}, kCloseAlone, ScaleBy::kTimes100)), "");
  EXPECT_EQ(Row(1), "2|19980914|25|27.5|22.5|2193.6|20000|0.5|Bonus 1:1");
  EXPECT_TRUE(rows->changed());
}

TEST_F(DataRowsTest, PricesAreRoundedToFourDecimals) {
  Prices("ORE", {Day("19980911", 2.1936f, 0.0125f, 0.003f, 12345.5f)});
  Show();
  EXPECT_EQ(Said(rows->Scale({0, 0}, kAll, ScaleBy::kOver100)), "");
  EXPECT_EQ(Row(0), "1|19980911|0.0219|0.0001|0|123.455|0|0|");
}

TEST_F(DataRowsTest, VolumesAreCutToWholeNumbersAndZeroStays) {
  Prices("ORE", {Flat("19980911", 1, 199), Flat("19980914", 1, 0), Flat("19980915", 1, -199)});
  Show();
  EXPECT_EQ(Said(rows->Scale({0, 2}, kVolumeAlone, ScaleBy::kOver10)), "");
  EXPECT_EQ(std::int32_t(rows->records()[0].Volume), 19);
  EXPECT_EQ(std::int32_t(rows->records()[1].Volume), 0);
  EXPECT_EQ(std::int32_t(rows->records()[2].Volume), -19);
  EXPECT_EQ(float(rows->records()[0].Close), 1.0f);
}

TEST_F(DataRowsTest, WhatWouldNotFitLeavesAllRowsAsTheyWere) {
  auto days = ThreeDays();
  days[1].Close = 3e37f;
  Prices("ORE", days);
  Show();
  EXPECT_EQ(Said(rows->Scale({0, 2}, kVolumeAlone, ScaleBy::kTimes10)),
            "Data Modification: Record 3: The number is too large");
  EXPECT_EQ(Said(rows->Scale({0, 2}, kCloseAlone, ScaleBy::kTimes100)),
            "Data Modification: Record 2: The number is too large");
  EXPECT_FALSE(rows->changed());
  EXPECT_EQ(Bytes(rows->records()), Bytes(days));
}

TEST_F(DataRowsTest, APriceThatIsNoNumberIsNotScaled) {
  Prices("ORE", {Flat("19980911", 1), Flat("19980914", std::numeric_limits<float>::infinity())});
  Show();
  EXPECT_EQ(Said(rows->Scale({0, 1}, kCloseAlone, ScaleBy::kOver10)),
            "Data Modification: Record 2: Data must be numeric");
  EXPECT_EQ(float(rows->records()[0].Close), 1.0f);
}

TEST_F(DataRowsTest, NothingIsScaledWithoutASelection) {
  Prices("ORE", ThreeDays());
  Show();
  for (const RowBlock block : {RowBlock{}, RowBlock{1, 3}, RowBlock{-1, 0}})
    EXPECT_EQ(Said(rows->Scale(block, kAll, ScaleBy::kTimes10)),
              "Data Modification: There are no records selected");
  EXPECT_FALSE(rows->changed());
}

}  // namespace
}  // namespace kora::test
