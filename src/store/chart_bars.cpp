#include "store/chart_bars.h"

#include <algorithm>
#include <cstring>
#include <limits>
#include <memory>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "store/name_rec.h"

namespace kora {
namespace {

// Records read from the file at a time: few calls to the host, and a buffer that stays in the
// cache while it is worked through.
constexpr std::int32_t kRecordsPerRead = 1024;

// Weekdays of file dates. Neighbours in a price file share their month, so that the calendar is
// asked once a month.
class WeekdayReader {
 public:
  // 1 Sunday to 7 Saturday. Error 5 when the text is no calendar date.
  int Of(const FixedText<8>& date) {
    if (std::memcmp(date.bytes, month_, sizeof month_) != 0) StartMonth(date);
    const int tens = date.bytes[6] - '0', ones = date.bytes[7] - '0';
    const int day = tens * 10 + ones;
    if (tens < 0 || ones < 0 || ones > 9 || day < 1 || day > days_) throw RunTimeError(kBadCall);
    return (firstWeekday_ + day - 2) % 7 + 1;
  }

 private:
  void StartMonth(const FixedText<8>& date) {
    const auto first = ParseFileDate(std::string(date.bytes, 6) + "01");
    if (!first) throw RunTimeError(kBadCall);
    firstWeekday_ = Weekday(*first);
    days_ = DayNumber(AddMonths(*first, 1)) - DayNumber(*first);
    std::memcpy(month_, date.bytes, sizeof month_);
  }

  char month_[6] = {};
  int firstWeekday_ = 0;
  int days_ = 0;
};

class Loader {
 public:
  Loader(ChartBars& out, bool volumeOption, std::int16_t recType)
      : out_(out), volumeOption_(volumeOption), recType_(recType) {
    out_.ChartHigh = -100000;
    out_.ChartLow = 100000;
    out_.VolMax = 0;
    out_.VolMin = 100000000;
    out_.VolAvg = 0;
    out_.VolumeShown = false;
  }

  void Day(const PriceRec& rec, std::int32_t number) {
    ChartBar& bar = out_.bars[size_t(++index_)];
    bar.SourceRec = rec.AdjFactor != 0 ? number : 0;
    // A bar index is held against a record number here: in a slice that starts late in the
    // file the first days without a close stay as they are.
    if (rec.Close == 0 && index_ > out_.FirstDataRec) {
      std::memset(bar.Date, 0, sizeof bar.Date);
      bar.Open = bar.High = bar.Low = bar.Close = previousClose_;
      bar.Volume = 0;
    } else {
      std::memcpy(bar.Date, rec.RecDate.bytes, sizeof bar.Date);
      bar.Open = rec.Open;
      bar.High = rec.High;
      bar.Low = rec.Low;
      bar.Close = rec.Close;
      bar.Volume = rec.Volume;
    }
    previousClose_ = bar.Close;
    if (bar.High == 0 && HasRange()) bar.Open = bar.High = bar.Low = bar.Close;

    const bool closeOnly = recType_ == kAdvanceDecline;
    const float high = rec.High == 0 || closeOnly ? rec.Close : rec.High;
    if (high > out_.ChartHigh) out_.ChartHigh = high;
    const float low = rec.Low == 0 || closeOnly ? rec.Close : rec.Low;
    if (low != 0 && low < out_.ChartLow) out_.ChartLow = low;
    CountVolume(bar.Volume);
  }

  void Week(const PriceRec& rec, std::int32_t number) {
    weekday_ = weekdays_.Of(rec.RecDate);
    if (weekday_ < previousWeekday_) Flush(rec.RecDate);
    Accumulate(rec, number, rec.Volume);
    previousWeekday_ = weekday_;
  }

  void Month(const PriceRec& rec, std::int32_t number) {
    if (lastMonthSet_ && std::memcmp(rec.RecDate.bytes, lastMonth_, sizeof lastMonth_) > 0)
      Flush(rec.RecDate);
    std::memcpy(lastMonth_, rec.RecDate.bytes, sizeof lastMonth_);
    lastMonthSet_ = true;
    // Hundreds, so that a month of a busy share stays within 32 bits.
    Accumulate(rec, number, rec.Volume / 100);
  }

  // The period still open becomes the last bar; `lastRead` is the date of the last record.
  void EndPeriods(const FixedText<8>& lastRead) {
    if (period_.HasData) Flush(lastRead);
    out_.BarCount = CInt(index_);
  }

  void VolumeVerdict() {
    if (!volumeOption_) {
      out_.VolMax = out_.VolMin = 0;
    } else if (volumeCount_ == 0) {
      // Nothing to show.
    } else if (out_.VolMax == out_.VolMin) {
      out_.VolMin = 1;
      out_.VolMax = CLng(double(out_.VolMax) * 3);
      out_.VolAvg = out_.VolMax;
      out_.VolumeShown = true;
    } else {
      out_.VolAvg = CLng(double(volumeSum_) / volumeCount_);
      out_.VolumeShown = true;
    }
  }

 private:
  // Records of the lower types hold no day's range.
  bool HasRange() const { return recType_ > kAdvanceDecline; }

  struct Period {
    float Open = 0, High = 0, Low = 100000, Close = 0;
    float LastGoodClose = 0;
    std::int64_t Volume = 0;
    std::int32_t Source = 0;
    FixedText<8> LastDate{};
    bool HasData = false;
  };

  void Accumulate(const PriceRec& rec, std::int32_t number, std::int32_t volume) {
    if (weekday_ == 1 || period_.Open == 0) period_.Open = rec.Open;
    period_.LastDate = rec.RecDate;
    const float high = HasRange() ? rec.High : rec.Close;
    const float low = HasRange() ? rec.Low : rec.Close;
    if (high > period_.High) period_.High = high;
    if (low != 0 && low < period_.Low) period_.Low = low;
    period_.Close = rec.Close;
    if (rec.Close != 0) period_.LastGoodClose = rec.Close;
    period_.Volume += volume;
    period_.Source = rec.AdjFactor != 0 ? number : 0;
    period_.HasData = true;
  }

  // `justRead` is the date of the record in hand, which belongs to the next period already.
  void Flush(const FixedText<8>& justRead) {
    ChartBar& bar = out_.bars[size_t(++index_)];
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
      bar.Low = period_.Low;  // never 0: it starts at 100000
      bar.Close = period_.LastGoodClose;
    }
    if (period_.Volume < std::numeric_limits<std::int32_t>::min() ||
        period_.Volume > std::numeric_limits<std::int32_t>::max())
      throw RunTimeError(kOverflow);
    bar.Volume = static_cast<std::int32_t>(period_.Volume);
    bar.SourceRec = period_.Source;

    if (bar.High > out_.ChartHigh) out_.ChartHigh = bar.High;
    if (bar.Low != 0 && bar.Low < out_.ChartLow) out_.ChartLow = bar.Low;
    CountVolume(bar.Volume);
    period_ = Period();
  }

  void CountVolume(std::int32_t volume) {
    if (!volumeOption_ || volume == 0) return;
    ++volumeCount_;
    volumeSum_ += volume;
    if (volume > out_.VolMax) out_.VolMax = volume;
    if (volume < out_.VolMin) out_.VolMin = volume;
  }

  ChartBars& out_;
  const bool volumeOption_;
  const std::int16_t recType_;

  std::int32_t index_ = -1;
  float previousClose_ = 0;
  std::int64_t volumeSum_ = 0;  // exact: 32767 bars of 32 bits are far from 64
  std::int32_t volumeCount_ = 0;

  Period period_;
  WeekdayReader weekdays_;
  int weekday_ = 0;  // stays 0 where periods are months
  int previousWeekday_ = 0;
  char lastMonth_[6] = {};
  bool lastMonthSet_ = false;
};

// Calls `take` with every record of the slice and its number.
template <typename Take>
void ForEachRecord(const PriceFile& file, ChartBars& out, Take take) {
  const auto buffer = std::make_unique_for_overwrite<PriceRec[]>(
      size_t(std::min<std::int32_t>(kRecordsPerRead, out.LastDataRec - out.FirstDataRec + 1)));
  for (std::int32_t first = out.FirstDataRec; first <= out.LastDataRec; first += kRecordsPerRead) {
    const std::int32_t count = std::min(kRecordsPerRead, out.LastDataRec - first + 1);
    file.ReadRun(first, std::span<PriceRec>(buffer.get(), size_t(count)));
    for (std::int32_t i = 0; i < count; ++i) {
      out.CurrentDataRec = static_cast<std::int16_t>(first + i);  // never above LastDataRec
      take(buffer[size_t(i)], first + i);
    }
  }
}

}  // namespace

void LoadChartBars(const PriceFile& file, std::string_view chartPeriod, bool volumeOption,
                   std::int16_t recType, ChartBars& out) {
  if (chartPeriod != "A" && chartPeriod != "W" && chartPeriod != "M") throw RunTimeError(kBadCall);
  out.CurrentDataRec = 0;
  if (out.FirstDataRec < 1 || out.LastDataRec < out.FirstDataRec ||
      out.LastDataRec > file.count())
    throw RunTimeError(kBadRecordNumber);
  out.BarCount = CInt(out.LastDataRec - out.FirstDataRec);
  out.bars.resize(size_t(out.BarCount) + 1);

  Loader loader(out, volumeOption, recType);
  if (chartPeriod == "A") {
    ForEachRecord(file, out, [&](const PriceRec& r, std::int32_t n) { loader.Day(r, n); });
  } else {
    FixedText<8> lastRead{};
    if (chartPeriod == "W") {
      ForEachRecord(file, out, [&](const PriceRec& r, std::int32_t n) {
        loader.Week(r, n);
        lastRead = r.RecDate;
      });
    } else {
      ForEachRecord(file, out, [&](const PriceRec& r, std::int32_t n) {
        loader.Month(r, n);
        lastRead = r.RecDate;
      });
    }
    loader.EndPeriods(lastRead);
  }
  loader.VolumeVerdict();
}

}  // namespace kora
