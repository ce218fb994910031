#include "store/chart_bars.h"

#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <cstring>
#include <limits>

#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

constexpr const char* kPath = "c:\\BHP.WDT";
constexpr const char* kHost = "drive_c/BHP.WDT";

class LoadBars : public ::testing::Test {
 protected:
  // Loads the slice first to last (0: the last record) of a file of `records`.
  ChartBars Load(const std::vector<PriceRec>& records, Period period, std::int16_t recType = kShare,
                 bool volume = true, std::int16_t first = 1, std::int16_t last = 0) {
    home_.Put(kHost, Bytes(records));
    const PriceFile file(home_.files(), kPath);
    ChartBars out;
    out.FirstDataRec = first;
    out.LastDataRec = last ? last : std::int16_t(file.count());
    LoadChartBars(file, period, volume, recType, out);
    return out;
  }

  // The error of such a load; `out` keeps what the load left.
  int LoadError(const std::vector<PriceRec>& records, Period period, ChartBars& out) {
    home_.Put(kHost, Bytes(records));
    const PriceFile file(home_.files(), kPath);
    return ErrorOf([&] { LoadChartBars(file, period, true, kShare, out); });
  }

  TempHome home_;
};

void ExpectBar(const ChartBar& bar, std::string_view date, float open, float high, float low,
               float close, std::int32_t volume = 0) {
  EXPECT_EQ(bar.date(), date);
  EXPECT_EQ(float(bar.Open), open);
  EXPECT_EQ(float(bar.High), high);
  EXPECT_EQ(float(bar.Low), low);
  EXPECT_EQ(float(bar.Close), close);
  EXPECT_EQ(std::int32_t(bar.Volume), volume);
}

// A week, Monday 1 January 2024 to Friday, and the Monday after.
std::vector<PriceRec> AWeekAndADay() {
  return {Day("20240101", 10, 12, 9, 11, 100), Day("20240103", 11, 13, 10, 12, 200),
          Day("20240105", 12, 12.5f, 8, 9, 300), Day("20240108", 9, 10, 8.5f, 9.5f, 50)};
}

// ---- daily

TEST_F(LoadBars, DailyCopiesEachRecord) {
  const ChartBars bars = Load(AWeekAndADay(), Period::kDaily);
  ASSERT_EQ(bars.BarCount, 3);
  ASSERT_EQ(bars.bars.size(), 4u);
  ExpectBar(bars[0], "20240101", 10, 12, 9, 11, 100);
  ExpectBar(bars[3], "20240108", 9, 10, 8.5f, 9.5f, 50);
  EXPECT_EQ(bars.ChartHigh, 13);
  EXPECT_EQ(bars.ChartLow, 8);
  EXPECT_EQ(bars.VolMax, 300);
  EXPECT_EQ(bars.VolMin, 50);
  EXPECT_EQ(bars.VolAvg, 162);  // 162.5, half to even
  EXPECT_TRUE(bars.VolumeShown);
  EXPECT_EQ(bars.CurrentDataRec, 4);
}

TEST_F(LoadBars, ASliceOfOneRecordHasBarCountZero) {
  const ChartBars bars = Load(AWeekAndADay(), Period::kDaily, kShare, true, 2, 2);
  EXPECT_EQ(bars.BarCount, 0);
  ASSERT_EQ(bars.bars.size(), 1u);
  ExpectBar(bars[0], "20240103", 11, 13, 10, 12, 200);
}

TEST_F(LoadBars, ADayWithoutCloseRepeatsTheCloseBeforeAndHasNoDate) {
  const ChartBars bars =
      Load({Day("20240101", 1, 1, 1, 10, 5), Day("20240102", 1, 1, 1, 11, 5),
            Day("20240103", 1, 20, 1, 12, 5), Day("20240104", 7, 30, 3, 0, 900, 2.0f)},
           Period::kDaily);
  ExpectBar(bars[3], "", 12, 12, 12, 12, 0);
  EXPECT_EQ(bars[3].SourceRec, 4);
  EXPECT_EQ(bars.VolMax, 15);     // three equal volumes, tripled; the 900 is on no bar
  EXPECT_EQ(bars.ChartHigh, 30);  // the record's own High counts all the same
}

TEST_F(LoadBars, ADayWithoutCloseAtTheStartIsCopiedAsItStands) {
  const ChartBars bars = Load({Day("20240101", 0, 0, 0, 0, 0), Day("20240102", 9, 9, 9, 0, 7),
                               Day("20240103", 0, 0, 0, 0, 0), Day("20240104", 1, 2, 1, 2, 0)},
                              Period::kDaily);
  ExpectBar(bars[0], "20240101", 0, 0, 0, 0, 0);
  // Bar 1 is not above record number 1 yet.
  ExpectBar(bars[1], "20240102", 9, 9, 9, 0, 7);
  // Bar 2 is; the close before it is 0.
  ExpectBar(bars[2], "", 0, 0, 0, 0, 0);
}

TEST_F(LoadBars, InASliceThatStartsLateTheBarIndexIsHeldAgainstTheRecordNumber) {
  std::vector<PriceRec> records;
  for (int i = 1; i <= 9; ++i) records.push_back(Day("20240101", 5, 5, 5, 5));
  for (int i = 4; i <= 7; ++i) records[size_t(i)].Close = 0;  // records 5 to 8
  const ChartBars bars = Load(records, Period::kDaily, kShare, true, 3);
  // Records 5 and 6 are bars 2 and 3, which are not above 3; 7 and 8 are bars 4 and 5.
  ExpectBar(bars[2], "20240101", 5, 5, 5, 0);
  ExpectBar(bars[3], "20240101", 5, 5, 5, 0);
  ExpectBar(bars[4], "", 0, 0, 0, 0);
  ExpectBar(bars[5], "", 0, 0, 0, 0);
  ExpectBar(bars[6], "20240101", 5, 5, 5, 5);
}

TEST_F(LoadBars, AShareDayWithHighZeroIsFlatAtItsCloseWhichRaisesChartHigh) {
  const ChartBars bars =
      Load({Day("20240101", 4, 5, 3, 4), Day("20240102", 1, 0, 2, 6)}, Period::kDaily, kShare);
  ExpectBar(bars[1], "20240102", 6, 6, 6, 6);
  EXPECT_EQ(bars.ChartHigh, 6);
  EXPECT_EQ(bars.ChartLow, 2);  // the record's own Low
}

TEST_F(LoadBars, HighZeroOfALowerRecordTypeStays) {
  const ChartBars bars = Load({Day("20240101", 1, 0, 0, 6)}, Period::kDaily, kCloseOnly);
  ExpectBar(bars[0], "20240101", 1, 0, 0, 6);
  EXPECT_EQ(bars.ChartHigh, 6);
  EXPECT_EQ(bars.ChartLow, 6);
}

TEST_F(LoadBars, AdvanceDeclineTakesItsRangeFromTheTotal) {
  const ChartBars bars =
      Load({Day("20240101", 0, 500, 400, -100), Day("20240102", 0, 300, 450, -250)}, Period::kDaily,
           kAdvanceDecline);
  ExpectBar(bars[0], "20240101", 0, 500, 400, -100);
  EXPECT_EQ(bars.ChartHigh, -100);
  EXPECT_EQ(bars.ChartLow, -250);
}

TEST_F(LoadBars, NothingCountedLeavesTheStartValues) {
  const ChartBars bars = Load({Day("20240101", 0, 0, 0, 0)}, Period::kDaily, kShare);
  EXPECT_EQ(bars.ChartHigh, 0);  // a High of 0 is replaced by the Close of 0
  EXPECT_EQ(bars.ChartLow, 100000);
  EXPECT_FALSE(bars.VolumeShown);
  EXPECT_EQ(bars.VolMin, 100000000);
  EXPECT_EQ(bars.VolMax, 0);
  EXPECT_EQ(bars.VolAvg, 0);
}

TEST_F(LoadBars, SourceRecIsTheRecordOfAnAdjustment) {
  std::vector<PriceRec> records = AWeekAndADay();
  records[2].AdjFactor = 0.5f;
  const ChartBars bars = Load(records, Period::kDaily, kShare, true, 2, 4);
  EXPECT_EQ(bars[0].SourceRec, 0);
  EXPECT_EQ(bars[1].SourceRec, 3);
  EXPECT_EQ(bars[2].SourceRec, 0);
}

// ---- weekly

TEST_F(LoadBars, AWeekEndsWhereTheWeekdayFalls) {
  const ChartBars bars = Load(AWeekAndADay(), Period::kWeekly);
  ASSERT_EQ(bars.BarCount, 1);
  ExpectBar(bars[0], "20240105", 10, 13, 8, 9, 600);
  ExpectBar(bars[1], "20240108", 9, 10, 8.5f, 9.5f, 50);
  EXPECT_EQ(bars.ChartHigh, 13);
  EXPECT_EQ(bars.ChartLow, 8);
  EXPECT_EQ(bars.VolMax, 600);
  EXPECT_EQ(bars.VolMin, 50);
  EXPECT_EQ(bars.VolAvg, 325);
}

TEST_F(LoadBars, AGapInWhichTheWeekdaysRiseMergesTwoWeeks) {
  const ChartBars bars = Load({Day("20240104", 1, 2, 1, 2, 1), Day("20240112", 2, 5, 2, 4, 2),
                               Day("20240115", 4, 4, 4, 4, 4)},
                              Period::kWeekly);
  ASSERT_EQ(bars.BarCount, 1);
  ExpectBar(bars[0], "20240112", 1, 5, 1, 4, 3);
}

TEST_F(LoadBars, ASundayTakesTheOpenAnew) {
  // 7 and 14 January 2024 are Sundays: the weekday does not fall between them.
  const ChartBars bars =
      Load({Day("20240107", 5, 6, 5, 6), Day("20240114", 7, 8, 4, 7)}, Period::kWeekly);
  ASSERT_EQ(bars.BarCount, 0);
  ExpectBar(bars[0], "20240114", 7, 8, 4, 7);
}

TEST_F(LoadBars, AWeekOpensWithItsFirstOpenThatIsNotZero) {
  const ChartBars bars =
      Load({Day("20240101", 0, 6, 5, 6), Day("20240102", 7, 8, 4, 7), Day("20240103", 9, 9, 9, 9)},
           Period::kWeekly);
  EXPECT_EQ(float(bars[0].Open), 7);
}

TEST_F(LoadBars, AnAdvanceDeclineWeekIsDatedOneRecordLateAtItsTotal) {
  const ChartBars bars = Load(AWeekAndADay(), Period::kWeekly, kAdvanceDecline);
  ASSERT_EQ(bars.BarCount, 1);
  ExpectBar(bars[0], "20240108", 9, 9, 9, 9, 600);
  ExpectBar(bars[1], "20240108", 9.5f, 9.5f, 9.5f, 9.5f, 50);
  EXPECT_EQ(bars.ChartHigh, 9.5f);
  EXPECT_EQ(bars.ChartLow, 9);
}

TEST_F(LoadBars, LowerRecordTypesTakeTheRangeOfTheirCloses) {
  const ChartBars bars = Load(AWeekAndADay(), Period::kWeekly, kCloseVolume);
  ExpectBar(bars[0], "20240105", 10, 12, 9, 9, 600);
}

TEST_F(LoadBars, AWeekThatEndsWithoutCloseKeepsItsLastGoodCloseAndIsDatedLate) {
  const ChartBars bars =
      Load({Day("20240101", 10, 12, 9, 11), Day("20240105", 0, 0, 0, 0),
            Day("20240108", 0, 0, 0, 8), Day("20240109", 0, 0, 0, 0), Day("20240115", 3, 3, 3, 3)},
           Period::kWeekly);
  ASSERT_EQ(bars.BarCount, 2);
  ExpectBar(bars[0], "20240108", 10, 12, 9, 11);
  // Neither open nor high: the last good close stands in. No low: its start value charts.
  ExpectBar(bars[1], "20240115", 8, 8, 100000, 8);
  EXPECT_EQ(bars.ChartLow, 3);
}

TEST_F(LoadBars, AFlushForgetsTheLastGoodCloseToo) {
  const ChartBars bars = Load(
      {Day("20240105", 10, 12, 9, 11), Day("20240111", 0, 0, 0, 0), Day("20240117", 3, 3, 3, 3)},
      Period::kWeekly);
  ASSERT_EQ(bars.BarCount, 2);
  ExpectBar(bars[1], "20240117", 0, 0, 100000, 0);
}

TEST_F(LoadBars, OnlyTheLastRecordOfAPeriodCarriesAnAdjustment) {
  std::vector<PriceRec> records = AWeekAndADay();
  records[1].AdjFactor = 2;
  EXPECT_EQ(Load(records, Period::kWeekly)[0].SourceRec, 0);
  records[2].AdjFactor = 2;
  EXPECT_EQ(Load(records, Period::kWeekly)[0].SourceRec, 3);
}

TEST_F(LoadBars, WeekdaysAreTrueOverCenturies) {
  // Every day from a Sunday on: a week is a bar, dated on its Saturday.
  using namespace std::chrono;
  sys_days day = year{1895} / 12 / 29;
  ASSERT_EQ(weekday(day), Sunday);
  for (int slice = 0; slice < 3; ++slice) {
    std::vector<PriceRec> records;
    for (int i = 0; i < 4000 * 7; ++i, day += days{1}) {
      const year_month_day d(day);
      const int digits =
          int(d.year()) * 10000 + int(unsigned(d.month())) * 100 + int(unsigned(d.day()));
      records.push_back(Day(std::to_string(digits), 1, 1, 1, 1));
    }
    const ChartBars bars = Load(records, Period::kWeekly);
    ASSERT_EQ(bars.BarCount, 3999);
    for (size_t i = 0; i < 4000; ++i)
      ASSERT_EQ(bars[i].date(), records[i * 7 + 6].RecDate.raw()) << i;
  }
}

TEST_F(LoadBars, AWeeklyRecordWithNoCalendarDateIsError5AtThatRecord) {
  const std::string nul(8, '\0');
  for (const std::string date :
       {"20230229", "20240431", "20241301", "20240100", "ABCDEFGH", "        ", "20240132",
        "2024010:", "202401/5", "2024010 ", "-0240105", "00000101", nul.c_str()}) {
    ChartBars out;
    out.FirstDataRec = 1;
    out.LastDataRec = 3;
    EXPECT_EQ(
        LoadError({Day("20240102", 1, 1, 1, 1), Day(date, 1, 1, 1, 1), Day("20240103", 1, 1, 1, 1)},
                  Period::kWeekly, out),
        kBadCall)
        << date;
    EXPECT_EQ(out.CurrentDataRec, 2) << date;
  }
}

// ---- monthly

TEST_F(LoadBars, AMonthEndsWhereTheKeyGrows) {
  const ChartBars bars =
      Load({Day("20240130", 10, 12, 9, 11, 250), Day("20240131", 11, 13, 10, 12, 199),
            Day("20240201", 12, 14, 11, 13, 1000)},
           Period::kMonthly);
  ASSERT_EQ(bars.BarCount, 1);
  // Hundreds, each day cut by itself: 2 + 1.
  ExpectBar(bars[0], "20240131", 10, 13, 9, 12, 3);
  ExpectBar(bars[1], "20240201", 12, 14, 11, 13, 10);
}

TEST_F(LoadBars, ASingleMonthIsOneBar) {
  const ChartBars bars = Load(AWeekAndADay(), Period::kMonthly);
  ASSERT_EQ(bars.BarCount, 0);
  ExpectBar(bars[0], "20240108", 10, 13, 8, 9.5f, 6);
}

TEST_F(LoadBars, ASmallerMonthKeyEndsNoMonthButIsNoted) {
  const ChartBars bars =
      Load({Day("20240201", 1, 1, 1, 1), Day("20240101", 2, 2, 2, 2), Day("20240202", 3, 3, 3, 3)},
           Period::kMonthly);
  ASSERT_EQ(bars.BarCount, 1);
  ExpectBar(bars[0], "20240101", 1, 2, 1, 2);
  ExpectBar(bars[1], "20240202", 3, 3, 3, 3);
}

TEST_F(LoadBars, ASundayIsNothingSpecialInAMonth) {
  const ChartBars bars =
      Load({Day("20240105", 5, 6, 5, 6), Day("20240107", 7, 8, 4, 7)}, Period::kMonthly);
  EXPECT_EQ(float(bars[0].Open), 5);
}

TEST_F(LoadBars, VolumeBelowAHundredADayLeavesAMonthWithout) {
  const ChartBars bars = Load({Day("20240105", 5, 6, 5, 6, 99)}, Period::kMonthly);
  EXPECT_EQ(std::int32_t(bars[0].Volume), 0);
  EXPECT_FALSE(bars.VolumeShown);
}

TEST_F(LoadBars, MonthsOfForeignDatesCompareAsText) {
  const ChartBars bars =
      Load({Day("abcdefgh", 1, 1, 1, 1), Day("abcdez12", 2, 2, 2, 2)}, Period::kMonthly);
  EXPECT_EQ(bars.BarCount, 1);
}

// ---- volumes

TEST_F(LoadBars, EqualVolumesAreTripled) {
  const ChartBars bars = Load({Day("20240101", 1, 1, 1, 1, 700), Day("20240102", 1, 1, 1, 1, 0),
                               Day("20240103", 1, 1, 1, 1, 700)},
                              Period::kDaily);
  EXPECT_EQ(bars.VolMin, 1);
  EXPECT_EQ(bars.VolMax, 2100);
  EXPECT_EQ(bars.VolAvg, 2100);
  EXPECT_TRUE(bars.VolumeShown);
}

TEST_F(LoadBars, TheMeanVolumeIsRoundedHalfToEven) {
  const auto average = [&](std::int32_t a, std::int32_t b) {
    return Load({Day("20240101", 1, 1, 1, 1, a), Day("20240102", 1, 1, 1, 1, b)}, Period::kDaily)
        .VolAvg;
  };
  EXPECT_EQ(average(1, 2), 2);
  EXPECT_EQ(average(2, 3), 2);
  EXPECT_EQ(average(2147483647, 2147483646), 2147483646);
}

TEST_F(LoadBars, WithoutTheRequestThereIsNoVolume) {
  const ChartBars bars = Load(AWeekAndADay(), Period::kDaily, kShare, false);
  EXPECT_EQ(bars.VolMax, 0);
  EXPECT_EQ(bars.VolMin, 0);
  EXPECT_EQ(bars.VolAvg, 0);
  EXPECT_FALSE(bars.VolumeShown);
  EXPECT_EQ(std::int32_t(bars[0].Volume), 100);
}

TEST_F(LoadBars, AWeekAbove32BitsIsError6WhereAMonthHolds) {
  const std::vector<PriceRec> records{Day("20240102", 1, 1, 1, 1, 2000000000),
                                      Day("20240103", 1, 1, 1, 1, 2000000000)};
  ChartBars out;
  out.FirstDataRec = 1;
  out.LastDataRec = 2;
  EXPECT_EQ(LoadError(records, Period::kWeekly, out), kOverflow);
  EXPECT_EQ(Load(records, Period::kMonthly)[0].Volume, 40000000);
}

// A week from Monday 1 January 2024: three days of 10^9 leave 2147483647 with the third.
TEST_F(LoadBars, OverflowOfAWeekNamesTheRecordAtWhichTheSumLeft) {
  constexpr std::int32_t kBillion = 1000000000;
  const std::vector<PriceRec> records{
      Day("20231229", 1, 1, 1, 1, kBillion), Day("20240101", 1, 1, 1, 1, kBillion),
      Day("20240102", 1, 1, 1, 1, kBillion), Day("20240103", 1, 1, 1, 1, kBillion),
      Day("20240104", 1, 1, 1, 1, 7),        Day("20240105", 1, 1, 1, 1, 7),
      Day("20240108", 1, 1, 1, 1, 7)};
  for (const int last : {7, 6, 4}) {  // ended by the next week, or by the slice
    ChartBars out;
    out.FirstDataRec = 1;
    out.LastDataRec = std::int16_t(last);
    EXPECT_EQ(LoadError(records, Period::kWeekly, out), kOverflow) << last;
    EXPECT_EQ(out.CurrentDataRec, 4) << last;
  }
  // In a slice that starts within the week the sum leaves no more: 2 * 10^9 + 14.
  EXPECT_EQ(Load(records, Period::kWeekly, kShare, true, 3)[0].Volume, 2000000014);
}

TEST_F(LoadBars, OverflowBelow32BitsNamesItsRecordToo) {
  const std::vector<PriceRec> records{Day("20240101", 1, 1, 1, 1, -2000000000),
                                      Day("20240102", 1, 1, 1, 1, -2000000000),
                                      Day("20240103", 1, 1, 1, 1, 5)};
  ChartBars out;
  out.FirstDataRec = 1;
  out.LastDataRec = 3;
  EXPECT_EQ(LoadError(records, Period::kWeekly, out), kOverflow);
  EXPECT_EQ(out.CurrentDataRec, 2);
}

TEST_F(LoadBars, VolumeThatCameBackInto32BitsIsNoneAndOneThatLeftAgainNamesTheSecondTime) {
  constexpr std::int32_t kTwoBillion = 2000000000;
  std::vector<PriceRec> records{Day("20240101", 1, 1, 1, 1, kTwoBillion),
                                Day("20240102", 1, 1, 1, 1, kTwoBillion),
                                Day("20240103", 1, 1, 1, 1, -kTwoBillion)};
  EXPECT_EQ(Load(records, Period::kWeekly)[0].Volume, kTwoBillion);
  records.push_back(Day("20240104", 1, 1, 1, 1, kTwoBillion));
  records.push_back(Day("20240105", 1, 1, 1, 1, 1));
  ChartBars out;
  out.FirstDataRec = 1;
  out.LastDataRec = 5;
  EXPECT_EQ(LoadError(records, Period::kWeekly, out), kOverflow);
  EXPECT_EQ(out.CurrentDataRec, 4);
}

// 2147483600 is 21474836 hundreds: a hundred records make 2147483600, and 48 hundreds more are
// one too many for 2147483647.
TEST_F(LoadBars, OverflowOfAMonthCountsInHundreds) {
  std::vector<PriceRec> records{Day("20231229", 1, 1, 1, 1, 100)};
  for (int i = 0; i < 100; ++i) records.push_back(Day("20240102", 1, 1, 1, 1, 2147483600));
  records.push_back(Day("20240103", 1, 1, 1, 1, 4799));
  EXPECT_EQ(Load(records, Period::kMonthly)[1].Volume, 2147483647);
  records.back().Volume = 4800;
  records.push_back(Day("20240104", 1, 1, 1, 1, 100));
  records.push_back(Day("20240201", 1, 1, 1, 1, 100));
  ChartBars out;
  out.FirstDataRec = 1;
  out.LastDataRec = std::int16_t(records.size());
  EXPECT_EQ(LoadError(records, Period::kMonthly, out), kOverflow);
  EXPECT_EQ(out.CurrentDataRec, 102);
}

TEST_F(LoadBars, VolumesAboveTheStartOfVolMinDoNotLowerIt) {
  // So that one volume of 10^9 is no case of equal volumes.
  const ChartBars bars = Load({Day("20240102", 1, 1, 1, 1, 1000000000)}, Period::kDaily);
  EXPECT_EQ(bars.VolMin, 100000000);
  EXPECT_EQ(bars.VolMax, 1000000000);
  EXPECT_EQ(bars.VolAvg, 1000000000);
}

// ---- hostile files and odd slices

TEST_F(LoadBars, ASliceOutsideTheFileIsError63) {
  const auto error = [&](std::int16_t first, std::int16_t last) {
    ChartBars out;
    out.FirstDataRec = first;
    out.LastDataRec = std::int16_t(last);
    return LoadError(AWeekAndADay(), Period::kDaily, out);
  };
  EXPECT_EQ(error(0, 2), kBadRecordNumber);
  EXPECT_EQ(error(-5, 2), kBadRecordNumber);
  EXPECT_EQ(error(2, 5), kBadRecordNumber);
  EXPECT_EQ(error(3, 2), kBadRecordNumber);
  EXPECT_EQ(error(1, 4), 0);
}

TEST_F(LoadBars, AnEmptyFileHasNoSlice) {
  ChartBars out;
  out.FirstDataRec = 1;
  out.LastDataRec = 0;
  EXPECT_EQ(LoadError({}, Period::kDaily, out), kBadRecordNumber);
}

TEST_F(LoadBars, ATornRecordAtTheEndDoesNotCount) {
  home_.Put(kHost, Bytes(AWeekAndADay()) + std::string(49, 'x'));
  const PriceFile file(home_.files(), kPath);
  EXPECT_EQ(file.count(), 4);
}

TEST_F(LoadBars, PricesThatAreNoNumbersCountNowhere) {
  const float nan = std::nanf(""), inf = std::numeric_limits<float>::infinity();
  const std::vector<PriceRec> records{Day("20240101", 10, 12, 9, 11),
                                      Day("20240102", nan, nan, nan, nan),
                                      Day("20240103", 5, 6, 5, 5)};
  for (const Period period : {Period::kDaily, Period::kWeekly, Period::kMonthly}) {
    const ChartBars bars = Load(records, period);
    EXPECT_EQ(bars.ChartHigh, 12) << TextOf(period);
    EXPECT_EQ(bars.ChartLow, 5) << TextOf(period);
  }
  const ChartBars endless =
      Load({Day("20240101", inf, inf, -inf, inf), Day("20240102", 1, 1, 1, 1)}, Period::kWeekly);
  EXPECT_EQ(endless.ChartHigh, inf);
  EXPECT_EQ(endless.ChartLow, -inf);
}

TEST_F(LoadBars, EveryValueOfAnEarlierLoadIsReplaced) {
  home_.Put(kHost, Bytes(AWeekAndADay()));
  const PriceFile file(home_.files(), kPath);
  for (const Period period : {Period::kDaily, Period::kWeekly, Period::kMonthly}) {
    ChartBars fresh, used;
    fresh.FirstDataRec = used.FirstDataRec = 1;
    fresh.LastDataRec = used.LastDataRec = 4;
    ChartBar rubbish;
    std::memset(&rubbish, 0x5A, sizeof rubbish);
    used.bars.assign(9, rubbish);
    used.ChartHigh = 1e9f;
    used.ChartLow = -1e9f;
    used.VolMax = used.VolAvg = 1 << 30;
    LoadChartBars(file, period, true, kShare, fresh);
    LoadChartBars(file, period, true, kShare, used);
    ASSERT_EQ(used.BarCount, fresh.BarCount);
    EXPECT_EQ(used.ChartHigh, fresh.ChartHigh);
    EXPECT_EQ(used.ChartLow, fresh.ChartLow);
    EXPECT_EQ(used.VolMax, fresh.VolMax);
    EXPECT_EQ(used.VolAvg, fresh.VolAvg);
    for (size_t i = 0; i <= size_t(fresh.BarCount); ++i) {
      ExpectBar(used[i], fresh[i].date(), fresh[i].Open, fresh[i].High, fresh[i].Low,
                fresh[i].Close, fresh[i].Volume);
      EXPECT_EQ(used[i].SourceRec, 0);
    }
  }
}

TEST_F(LoadBars, TheLongestSliceOf16BitsLoadsWhole) {
  std::vector<PriceRec> records;
  for (int i = 1; i <= 32767; ++i) records.push_back(Day("20240101", 1, 1, 1, float(i)));
  const ChartBars bars = Load(records, Period::kDaily);
  EXPECT_EQ(bars.BarCount, 32766);
  EXPECT_EQ(bars.CurrentDataRec, 32767);
  for (size_t i = 0; i < 32767; ++i) ASSERT_EQ(float(bars[i].Close), float(i + 1));
}

TEST_F(LoadBars, AFailingReadRaisesItsError) {
  FailingIo io;
  TempHome home(io);
  home.Put(kHost, Bytes(AWeekAndADay()));
  const PriceFile file(home.files(), kPath);
  io.failReadAt = io.reads + 1;
  io.readError = kDiskNotReady;
  ChartBars out;
  out.FirstDataRec = 1;
  out.LastDataRec = 4;
  EXPECT_EQ(ErrorOf([&] { LoadChartBars(file, Period::kDaily, true, kShare, out); }),
            kDiskNotReady);
  EXPECT_EQ(out.BarCount, 3);
  EXPECT_EQ(out.bars.size(), 4u);
}

TEST_F(LoadBars, AFileCutShortMeanwhileIsError63) {
  home_.Put(kHost, Bytes(AWeekAndADay()));
  const PriceFile file(home_.files(), kPath);
  home_.Put(kHost, Bytes(AWeekAndADay()).substr(0, 120));
  ChartBars out;
  out.FirstDataRec = 1;
  out.LastDataRec = 4;
  EXPECT_EQ(ErrorOf([&] { LoadChartBars(file, Period::kDaily, true, kShare, out); }),
            kBadRecordNumber);
}

TEST_F(LoadBars, AFolderOrNoFileInItsPlaceCannotBeOpened) {
  home_.Put("drive_c/DIR.WDT/inner", "");
  EXPECT_EQ(ErrorOf([&] { PriceFile file(home_.files(), "c:\\DIR.WDT"); }), kPathAccess);
  EXPECT_EQ(ErrorOf([&] { PriceFile file(home_.files(), "c:\\NONE.WDT"); }), kFileNotFound);
  EXPECT_EQ(ErrorOf([&] { PriceFile file(home_.files(), "c:\\none\\A.WDT"); }), kPathNotFound);
}

}  // namespace
}  // namespace kora::test
