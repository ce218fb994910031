#include "update/price_write.h"

#include <algorithm>
#include <span>
#include <vector>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "store/name_rec.h"

namespace kora {
namespace {

constexpr std::int32_t kRecordsPerRead = 32;
constexpr std::int32_t kMostDays = 32767;

// Walks a file from its end.
class Backwards {
 public:
  explicit Backwards(const PriceFile& file) : file_(file) {}
  const PriceRec& At(std::int32_t n) {
    if (n < first_ || n >= first_ + std::int32_t(run_.size())) {
      first_ = std::max(1, n - kRecordsPerRead + 1);
      run_.resize(size_t(n - first_ + 1));
      file_.ReadRun(first_, run_);
    }
    return run_[size_t(n - first_)];
  }

 private:
  const PriceFile& file_;
  std::int32_t first_ = 0;
  std::vector<PriceRec> run_;
};

float TotalAfter(const PriceRec& rec, float before) {
  return CSng(double(rec.High) + double(before) - double(rec.Low));
}

// The fields that the kind takes from the line; the rest stays as it is in `rec`.
void SetFields(PriceRec& rec, const DayLine& day, std::int16_t RecType, float total) {
  rec.RecDate.set(day.date);
  rec.High = day.High;
  rec.Low = day.Low;
  if (RecType == kAdvanceDecline) {
    rec.Close = TotalAfter(rec, total);
  } else {
    rec.Open = day.Open;
    rec.Close = day.Close;
  }
  if (RecType != kCloseOnly) rec.Volume = day.Volume;
  rec.AdjFactor = 0;
  rec.AdjDesc.set("");
  rec.RecSpare.set("");
}

// After a write that failed half-way, as on a full disk: what was written over needs no new room.
void PutBack(PriceFile& file, std::int32_t position, std::span<const PriceRec> old,
             std::int32_t count) {
  try {
    if (!old.empty()) file.WriteRun(position, old);
    file.Truncate(count);
  } catch (const RunTimeError&) {
    // The first failure is the one to tell.
  }
}

}  // namespace

RecordPlace FindPlace(const PriceFile& file, std::string_view date, std::int16_t UpdateMode) {
  const double wanted = Val(date);
  const std::int32_t count = file.count();
  Backwards records(file);
  bool PassedLater = false;
  for (std::int32_t n = count; n >= 1; --n) {
    const double there = Val(records.At(n).RecDate.raw());
    if (wanted == there && UpdateMode == kModeReplace) return {n, true};
    if (n == 1) break;
    if (wanted <= there) {
      PassedLater = true;
    } else if (n == count) {
      return {count + 1, false};
    } else if (PassedLater) {
      return {n + 1, false};
    }
  }
  return {1, false};
}

void WriteDay(PriceFile& file, const DayLine& day, std::int16_t RecType, std::int16_t UpdateMode,
              bool options) {
  const std::int32_t count = file.count();
  const bool totals = RecType == kAdvanceDecline;
  const bool ordered = UpdateMode == kModeInsert || UpdateMode == kModeReplace;

  RecordPlace place{count + 1, false};
  if (count > 0 && ordered) place = FindPlace(file, day.date, UpdateMode);
  const std::int32_t position = place.position;
  if (!place.overwrite && count >= kMostDays) throw RunTimeError(kOverflow);

  // The records from the place on, as they are and as they are to be.
  std::vector<PriceRec> old;
  std::vector<PriceRec> tail(1, NewPriceRec(""));
  if (position <= count) {
    const bool rest = !place.overwrite || totals;
    old.resize(rest ? size_t(count - position + 1) : 1);
    file.ReadRun(position, old);
    if (place.overwrite) tail[0] = old[0];  // keeps what its kind does not take from the line
    tail.insert(tail.end(), old.begin() + (place.overwrite ? 1 : 0), old.end());
  }
  float total = 0;
  if (totals && position > 1) total = file.Read(position - 1).Close;
  SetFields(tail[0], day, RecType, total);
  if (totals) {
    for (PriceRec& rec : tail) {
      rec.Close = TotalAfter(rec, total);
      total = rec.Close;
    }
  }
  try {
    file.WriteRun(position, tail);
  } catch (const RunTimeError&) {
    PutBack(file, position, old, count);
    throw;
  }

  // The final volume of a day comes a day late.
  if (options || !day.hasSpare || position <= 1) return;
  PriceRec before = file.Read(position - 1);
  before.Volume = day.spare;
  file.Write(position - 1, before);
}

}  // namespace kora
