#include "store/chart_bars.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstring>
#include <limits>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "store/name_rec.h"

namespace kora {
namespace {

// Records read from the file at a time: few calls to the host, and a buffer that stays in the
// cache while it is worked through.
constexpr std::int32_t kRecordsPerRead = 1024;

// The month key, "yyyymm", as a number that compares as its characters do.
std::uint64_t MonthKey(const FixedText<8>& date) {
  std::uint64_t key = 0;
  for (int i = 0; i < 8; ++i) key = key << 8 | static_cast<unsigned char>(date.bytes[i]);
  return key >> 16;
}
// The same as a number that tells months apart in any order of bytes, which is read at once.
std::uint64_t MonthBytes(const FixedText<8>& date) {
  constexpr std::uint64_t kFirstSix =
      std::endian::native == std::endian::little ? ~0ull >> 16 : ~0ull << 16;
  return std::bit_cast<std::uint64_t>(date.bytes) & kFirstSix;
}

// x == 0, by its bits: the tests of every record are many, and those of whole numbers are cheap.
bool IsZero(float x) { return std::bit_cast<std::uint32_t>(x) << 1 == 0; }

// A month of file dates. Neighbours in a price file share theirs, so that the calendar is asked
// once a month.
struct CalendarMonth {
  std::uint64_t bytes = 0;
  int days = 0;
  int firstWeekday = 0;  // 1 Sunday to 7 Saturday
};

// Error 5 when there is no such month.
CalendarMonth MonthOf(const FixedText<8>& date) {
  const auto first = ParseFileDate(std::string(date.bytes, 6) + "01");
  if (!first) throw RunTimeError(kBadCall);
  return {MonthBytes(date), DayNumber(AddMonths(*first, 1)) - DayNumber(*first), Weekday(*first)};
}

// The figures of the load, and the bars as they are made. It goes by value from run to run of
// records, so that the loop over a run can keep the figures in registers.
class Loader {
 public:
  Loader(const ChartBars& out, ChartBar* bars, bool volumeOption, std::int16_t recType)
      : next_(bars),
        bars_(bars),
        firstDataRec_(out.FirstDataRec),
        volumeOption_(volumeOption),
        recType_(recType) {}

  void Day(const PriceRec& rec, std::int32_t number) {
    ChartBar& bar = *next_;
    static_assert(offsetof(ChartBar, SourceRec) == offsetof(PriceRec, AdjFactor));
    std::memcpy(&bar, &rec, offsetof(ChartBar, SourceRec));  // Date to Volume, as they stand
    bar.SourceRec = IsZero(rec.AdjFactor) ? 0 : number;
    float high = rec.High, low = rec.Low;
    if (IsZero(high) || IsZero(low) || IsZero(rec.Close) || recType_ == kAdvanceDecline) {
      if (IsZero(high) || recType_ == kAdvanceDecline) high = rec.Close;
      if (IsZero(low) || recType_ == kAdvanceDecline) low = rec.Close;
      // A bar index is held against a record number here: in a slice that starts late in the
      // file the first days without a close stay as they are.
      if (IsZero(rec.Close) && next_ - bars_ > firstDataRec_) {
        std::memset(bar.Date, 0, sizeof bar.Date);
        bar.Open = bar.High = bar.Low = bar.Close = next_[-1].Close;
        bar.Volume = 0;
      } else if (IsZero(rec.High) && HasRange()) {
        bar.Open = bar.High = bar.Low = rec.Close;
      }
    }
    ++next_;
    RaiseHigh(high);
    LowerLow(low);
    CountVolume(bar.Volume);
  }

  void Week(const PriceRec& rec, std::int32_t number) {
    const int before = weekday_;
    weekday_ = WeekdayOf(rec.RecDate);
    if (weekday_ < before) Flush(rec.RecDate);
    Accumulate(rec, number, rec.Volume);
  }

  void Month(const PriceRec& rec, std::int32_t number) {
    const std::uint64_t month = MonthKey(rec.RecDate);
    if (lastMonthSet_ && month > lastMonth_) Flush(rec.RecDate);
    lastMonth_ = month;
    lastMonthSet_ = true;
    // Hundreds, so that a month of a busy share stays within 32 bits.
    Accumulate(rec, number, rec.Volume / 100);
  }

  // The period still open becomes the last bar; `lastRead` is the date of the last record.
  void EndPeriods(const FixedText<8>& lastRead) {
    if (period_.HasData) Flush(lastRead);
  }
  // The volume of the period, as far as it is read, is no 32-bit number.
  bool VolumeLeft() const {
    return period_.Volume < std::numeric_limits<std::int32_t>::min() ||
           period_.Volume > std::numeric_limits<std::int32_t>::max();
  }

  void Finish(ChartBars& out) const {
    out.BarCount = CInt(double(next_ - bars_) - 1);
    out.ChartHigh = chartHigh_;
    out.ChartLow = chartLow_;
    out.VolMax = volMax_;
    out.VolMin = volMin_;
    out.VolAvg = 0;
    out.VolumeShown = volumeOption_ && volumeCount_ > 0;
    if (!volumeOption_) {
      out.VolMax = out.VolMin = 0;
    } else if (out.VolumeShown && volMax_ == volMin_) {
      out.VolMin = 1;
      out.VolMax = CLng(double(volMax_) * 3);
      out.VolAvg = out.VolMax;
    } else if (out.VolumeShown) {
      out.VolAvg = CLng(double(volumeSum_) / volumeCount_);
    }
  }

 private:
  static constexpr float kNoLow = 100000;

  struct OpenPeriod {
    float Open = 0, High = 0, Low = kNoLow, Close = 0;
    float LastGoodClose = 0;
    std::int64_t Volume = 0;
    std::int32_t Source = 0;
    FixedText<8> LastDate{};
    bool HasData = false;
  };

  // Records of the lower types hold no day's range.
  bool HasRange() const { return recType_ > kAdvanceDecline; }

  // Error 5 when the text is no calendar date.
  int WeekdayOf(const FixedText<8>& date) {
    if (MonthBytes(date) != month_.bytes) month_ = MonthOf(date);
    const int tens = date.bytes[6] - '0', ones = date.bytes[7] - '0';
    const int day = tens * 10 + ones;
    if (tens < 0 || ones < 0 || ones > 9 || day < 1 || day > month_.days)
      throw RunTimeError(kBadCall);
    static constexpr std::uint8_t kWeekdays[] = {1, 2, 3, 4, 5, 6, 7, 1, 2, 3, 4, 5, 6,
                                                 7, 1, 2, 3, 4, 5, 6, 7, 1, 2, 3, 4, 5,
                                                 6, 7, 1, 2, 3, 4, 5, 6, 7, 1, 2};
    return kWeekdays[month_.firstWeekday + day - 2];
  }

  // A price that is no number is neither above nor below.
  void RaiseHigh(float high) { chartHigh_ = high > chartHigh_ ? high : chartHigh_; }
  void LowerLow(float low) { chartLow_ = !IsZero(low) && low < chartLow_ ? low : chartLow_; }

  void Accumulate(const PriceRec& rec, std::int32_t number, std::int32_t volume) {
    if (weekday_ == 1 || IsZero(period_.Open)) period_.Open = rec.Open;
    period_.LastDate = rec.RecDate;
    const float high = HasRange() ? rec.High : rec.Close;
    const float low = HasRange() ? rec.Low : rec.Close;
    period_.High = high > period_.High ? high : period_.High;
    period_.Low = !IsZero(low) && low < period_.Low ? low : period_.Low;
    period_.Close = rec.Close;
    period_.LastGoodClose = IsZero(rec.Close) ? period_.LastGoodClose : rec.Close;
    period_.Volume += volume;
    period_.Source = IsZero(rec.AdjFactor) ? 0 : number;
    period_.HasData = true;
  }

  // `justRead` is the date of the record in hand, which belongs to the next period already.
  void Flush(const FixedText<8>& justRead) {
    ChartBar& bar = *next_++;
    const bool closed = period_.Close != 0;
    const FixedText<8>& date = closed && recType_ != kAdvanceDecline ? period_.LastDate : justRead;
    std::memcpy(bar.Date, date.bytes, sizeof bar.Date);
    if (closed && recType_ == kAdvanceDecline) {
      bar.Open = bar.High = bar.Low = bar.Close = period_.Close;
    } else if (closed) {
      bar.Open = period_.Open;
      bar.High = period_.High;
      bar.Low = period_.Low;
      bar.Close = period_.Close;
    } else {
      bar.Open = period_.Open != 0 ? period_.Open : period_.LastGoodClose;
      bar.High = period_.High != 0 ? period_.High : period_.LastGoodClose;
      bar.Low = period_.Low;  // never 0: it starts at kNoLow
      bar.Close = period_.LastGoodClose;
    }
    if (VolumeLeft()) throw RunTimeError(kOverflow);
    bar.Volume = static_cast<std::int32_t>(period_.Volume);
    bar.SourceRec = period_.Source;

    RaiseHigh(bar.High);
    LowerLow(bar.Low);
    CountVolume(bar.Volume);
    // Field by field: a copy of the whole waits for the small writes before it.
    period_.Open = period_.High = period_.Close = period_.LastGoodClose = 0;
    period_.Low = kNoLow;
    period_.Volume = 0;
    period_.Source = 0;
    period_.HasData = false;
  }

  void CountVolume(std::int32_t volume) {
    if (volume == 0) return;
    ++volumeCount_;
    volumeSum_ += volume;
    volMax_ = volume > volMax_ ? volume : volMax_;
    volMin_ = volume < volMin_ ? volume : volMin_;
  }

  ChartBar* next_;
  ChartBar* bars_;
  std::int32_t firstDataRec_;
  bool volumeOption_;
  std::int16_t recType_;

  float chartHigh_ = -100000, chartLow_ = 100000;
  std::int32_t volMax_ = 0, volMin_ = 100000000;
  std::int64_t volumeSum_ = 0;  // exact: 32767 bars of 32 bits are far from 64
  std::int32_t volumeCount_ = 0;

  OpenPeriod period_;
  CalendarMonth month_;
  int weekday_ = 0;  // of the record in hand; stays 0 where periods are months
  std::uint64_t lastMonth_ = 0;
  bool lastMonthSet_ = false;
};

// The loader after it took the run, whose first record has the number `first`. `current` is the
// record in hand, for failures; taking days has none.
Loader TakeDays(Loader loader, std::span<const PriceRec> run, std::int32_t first,
                std::int16_t& current) {
  for (const PriceRec& rec : run) loader.Day(rec, first++);
  current = static_cast<std::int16_t>(first - 1);  // never above LastDataRec
  return loader;
}

template <void (Loader::*kTake)(const PriceRec&, std::int32_t)>
Loader TakePeriods(Loader loader, std::span<const PriceRec> run, std::int32_t first,
                   std::int16_t& current) {
  for (const PriceRec& rec : run) {
    current = static_cast<std::int16_t>(first);
    (loader.*kTake)(rec, first++);
  }
  return loader;
}

// The record at which the volume of a period left 32 bits. A load sees that at the period's end
// alone; so the records are taken once more, one by one, with a new `loader`.
std::int16_t OverflowRecord(const PriceFile& file, Loader loader, decltype(&TakeDays) takeRun,
                            std::int16_t first, std::int16_t last) {
  std::int16_t left = last, current = 0;
  bool out = false;
  try {
    for (std::int32_t number = first; number <= last; ++number) {
      const PriceRec rec = file.Read(number);
      loader = takeRun(loader, {&rec, 1}, number, current);
      if (loader.VolumeLeft() && !out) left = current;
      out = loader.VolumeLeft();
    }
  } catch (const RunTimeError&) {
    // The end of the same period.
  }
  return left;
}

}  // namespace

void LoadChartBars(const PriceFile& file, Period chartPeriod, bool volumeOption,
                   std::int16_t recType, ChartBars& out) {
  out.CurrentDataRec = 0;
  if (out.FirstDataRec < 1 || out.LastDataRec < out.FirstDataRec || out.LastDataRec > file.count())
    throw RunTimeError(kBadRecordNumber);
  out.BarCount = CInt(out.LastDataRec - out.FirstDataRec);
  out.bars.resize(size_t(out.BarCount) + 1);

  Loader loader(out, out.bars.data(), volumeOption, recType);
  const auto takeRun = chartPeriod == Period::kDaily    ? TakeDays
                       : chartPeriod == Period::kWeekly ? TakePeriods<&Loader::Week>
                                                        : TakePeriods<&Loader::Month>;
  std::array<PriceRec, kRecordsPerRead> buffer;
  std::span<PriceRec> run;
  const std::int32_t last = out.LastDataRec;
  try {
    for (std::int32_t first = out.FirstDataRec; first <= last; first += kRecordsPerRead) {
      run = {buffer.data(), size_t(std::min(kRecordsPerRead, last - first + 1))};
      file.ReadRun(first, run);
      loader = takeRun(loader, run, first, out.CurrentDataRec);
    }
    if (chartPeriod != Period::kDaily) loader.EndPeriods(run.back().RecDate);
  } catch (const RunTimeError& e) {
    if (e.number() == kOverflow)
      out.CurrentDataRec = OverflowRecord(file, Loader(out, out.bars.data(), volumeOption, recType),
                                          takeRun, out.FirstDataRec, out.LastDataRec);
    throw;
  }
  loader.Finish(out);
}

void LoadDailyBars(std::span<const PriceRec> records, std::int32_t first, std::int16_t recType,
                   ChartBars& out) {
  if (records.empty()) throw RunTimeError(kBadRecordNumber);
  out.FirstDataRec = CInt(first);
  out.LastDataRec = CInt(double(first) + double(records.size()) - 1);
  out.bars.resize(records.size());
  TakeDays(Loader(out, out.bars.data(), false, recType), records, first, out.CurrentDataRec)
      .Finish(out);
}

}  // namespace kora
