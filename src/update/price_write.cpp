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
  explicit Backwards(const PriceView& file) : file_(file) {}
  const PriceRec& At(std::int32_t n) {
    if (n < first_ || n >= first_ + std::int32_t(run_.size())) {
      first_ = std::max(1, n - kRecordsPerRead + 1);
      run_.resize(size_t(n - first_ + 1));
      file_.ReadRun(first_, run_);
    }
    return run_[size_t(n - first_)];
  }

 private:
  const PriceView& file_;
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

}  // namespace

FileEdit StagedPrices::Edit(std::string path) const {
  FileEdit edit{std::move(path), existed, before, {}};
  std::int32_t next = 0;
  for (const auto& [n, rec] : fresh) {
    if (n != next) {
      ByteChange& change = edit.changes.emplace_back();
      change.offset = std::uint64_t(n - 1) * sizeof(PriceRec);
    }
    next = n + 1;
    ByteChange& change = edit.changes.back();
    change.fresh.append(reinterpret_cast<const char*>(&rec), sizeof(rec));
    if (const auto was = old.find(n); was != old.end())
      change.old.append(reinterpret_cast<const char*>(&was->second), sizeof(PriceRec));
    else if (n == onFile + 1)
      change.old += torn;
  }
  return edit;
}

PriceView::PriceView(const Files& files, std::string_view path, bool exists, StagedPrices& staged)
    : staged_(staged) {
  const bool fresh = !staged.existed && staged.count == 0;
  if (!exists || (!fresh && !staged.existed)) return;
  file_ = files.Open(path, OpenMode::kReadWrite);  // what can't be written to shows here
  if (!fresh) return;
  staged.existed = true;
  staged.before = file_->Size();
  if (staged.before / sizeof(PriceRec) > 0x7FFFFFFF) throw RunTimeError(kOverflow);
  staged.onFile = staged.count = std::int32_t(staged.before / sizeof(PriceRec));
  staged.torn.resize(size_t(staged.before % sizeof(PriceRec)));
  if (staged.torn.empty()) return;
  const std::uint64_t at = staged.before - staged.torn.size();
  if (file_->ReadAt(at, staged.torn.data(), staged.torn.size()) != staged.torn.size())
    throw RunTimeError(kBadRecordNumber);
}

void PriceView::ReadFile(std::int32_t n, std::span<PriceRec> out) const {
  if (out.empty()) return;
  if (!file_ || file_->ReadAt(std::uint64_t(n - 1) * sizeof(PriceRec), out.data(),
                              out.size_bytes()) != out.size_bytes())
    throw RunTimeError(kBadRecordNumber);
}

PriceRec PriceView::Read(std::int32_t n) const {
  PriceRec rec;
  ReadRun(n, std::span(&rec, 1));
  return rec;
}

void PriceView::ReadRun(std::int32_t n, std::span<PriceRec> out) const {
  const std::int64_t end = std::int64_t(n) + std::int64_t(out.size());
  if (n < 1 || end - 1 > staged_.count) throw RunTimeError(kBadRecordNumber);
  const std::int64_t filed = std::min<std::int64_t>(end, staged_.onFile + 1) - n;
  // One record is often staged itself.
  if (filed > 0 && !(out.size() == 1 && staged_.fresh.contains(n)))
    ReadFile(n, out.first(size_t(filed)));
  for (auto at = staged_.fresh.lower_bound(n); at != staged_.fresh.end() && at->first < end; ++at)
    out[size_t(at->first - n)] = at->second;
}

void PriceView::WriteRun(std::int32_t n, std::span<const PriceRec> records) {
  if (n < 1 || n > staged_.count + 1) throw RunTimeError(kBadRecordNumber);
  const std::int64_t end = std::int64_t(n) + std::int64_t(records.size());
  const std::int64_t filed = std::min<std::int64_t>(end, staged_.onFile + 1) - n;
  if (filed > 0) {
    std::vector<PriceRec> there(static_cast<size_t>(filed));
    ReadFile(n, there);
    for (size_t i = 0; i < there.size(); ++i)
      staged_.old.try_emplace(n + std::int32_t(i), there[i]);
  }
  for (size_t i = 0; i < records.size(); ++i) {
    // Behind all others, mostly.
    staged_.fresh.insert_or_assign(staged_.fresh.end(), n + std::int32_t(i), records[i]);
  }
  staged_.count = std::max(staged_.count, std::int32_t(end - 1));
}

std::string FullText(const PriceView& file) {
  if (file.count() < kMostDays) return {};
  return "its price file is full, with " + Str(file.count()) + " days";
}

RecordPlace FindPlace(const PriceView& file, std::string_view date, std::int16_t UpdateMode) {
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

std::string WriteDay(PriceView& file, const DayLine& day, std::int16_t RecType,
                     std::int16_t UpdateMode, bool options) {
  const std::int32_t count = file.count();
  const bool totals = RecType == kAdvanceDecline;
  const bool ordered = UpdateMode == kModeInsert || UpdateMode == kModeReplace;

  RecordPlace place{count + 1, false};
  if (count > 0 && ordered) place = FindPlace(file, day.date, UpdateMode);
  const std::int32_t position = place.position;
  if (!place.overwrite)
    if (std::string full = FullText(file); !full.empty()) return full;

  // The records from the place on, as they are to be.
  std::vector<PriceRec> tail(1, NewPriceRec(""));
  if (position <= count) {
    const bool rest = !place.overwrite || totals;
    std::vector<PriceRec> old(rest ? size_t(count - position + 1) : 1);
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
  file.WriteRun(position, tail);

  // The final volume of a day comes a day late.
  if (!options && day.hasSpare && position > 1) {
    PriceRec before = file.Read(position - 1);
    before.Volume = day.spare;
    file.WriteRun(position - 1, std::span(&before, 1));
  }
  return {};
}

}  // namespace kora
