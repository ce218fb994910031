#include "adjust/adjustment.h"

#include "base/currency.h"
#include "base/numbers.h"
#include "base/runtime_error.h"

namespace kora {
namespace {

constexpr size_t kMostStamps = 20;

void ScaleRecord(PriceRec& rec, double factor) {
  rec.Open = ScaledPrice(rec.Open, factor);
  rec.High = ScaledPrice(rec.High, factor);
  rec.Low = ScaledPrice(rec.Low, factor);
  rec.Close = ScaledPrice(rec.Close, factor);
}

}  // namespace

float ScaledPrice(float price, double factor) {
  return CSng(Currency(double(price) * factor).ToDouble());
}

void AdjustRecords(std::span<PriceRec> records, std::int16_t AdjRecNo,
                   const Adjustment& adjustment) {
  if (AdjRecNo < 1 || size_t(AdjRecNo) > records.size()) throw RunTimeError(kBadRecordNumber);
  bool stamped = false;
  for (int n = AdjRecNo; n >= 1; --n) {
    PriceRec& rec = records[size_t(n - 1)];
    if (rec.Close == 0) continue;
    ScaleRecord(rec, adjustment.AdjFactorValue);
    if (stamped) continue;
    rec.AdjFactor = adjustment.AdjFactorValue;
    rec.AdjDesc.set(adjustment.AdjDescText);
    stamped = true;
  }
}

void AdjustNotes(std::vector<ChartNote>& notes, std::string_view date, float factor,
                 std::int32_t colour) {
  for (ChartNote& note : notes) {
    note.Colour = Str(colour);
    if (Val(date) < Val(note.Date)) continue;
    try {
      note.Price = Format(Currency(Val(note.Price) * double(factor)).ToDouble(), "#.00");
    } catch (const RunTimeError&) {
      // No price that a chart could show.
    }
  }
}

void StageAdjustment(FileSet& set, const AdjustedSecurity& security, PriceEdit& edit,
                     std::int16_t AdjRecNo, const Adjustment& adjustment) {
  AdjustRecords(edit.records(), AdjRecNo, adjustment);
  const std::string_view date = edit.records()[size_t(AdjRecNo - 1)].RecDate.raw();
  auto notes = ReadChartNotes(security.files, security.notesFile);
  AdjustNotes(notes, date, adjustment.AdjFactorValue, security.NoteColour);
  if (!notes.empty()) set.Add(security.notesFile, ChartNotesText(notes));
  edit.Save(set);
}

void ApplyAdjustment(const AdjustedSecurity& security, PriceEdit& edit, std::int16_t AdjRecNo,
                     const Adjustment& adjustment) {
  const auto held = security.files.lock().Hold();
  if (edit.Changed()) throw RunTimeError(kPermissionDenied, std::string(kFileChanged));
  FileSet set(security.files);
  StageAdjustment(set, security, edit, AdjRecNo, adjustment);
  set.Commit();
}

std::vector<std::int16_t> StampedRecords(std::span<const PriceRec> records) {
  std::vector<std::int16_t> stamped;
  for (size_t i = 1; i < records.size(); ++i) {
    if (records[i].AdjFactor == 0) continue;
    if (stamped.size() == kMostStamps) throw RunTimeError(kIndexOutOfRange);
    stamped.push_back(CInt(double(i + 1)));
  }
  return stamped;
}

int RemoveLatestAdjustment(std::span<PriceRec> records) {
  const auto stamped = StampedRecords(records);
  if (stamped.empty()) return 0;
  PriceRec& latest = records[size_t(stamped.back() - 1)];
  const double F = latest.AdjFactor;
  const double M = (1 - F) / F + 1;
  for (int n = stamped.back(); n >= 1; --n) ScaleRecord(records[size_t(n - 1)], M);
  latest.AdjFactor = 0;
  latest.AdjDesc.set("");
  return int(stamped.size());
}

int RemoveAdjustment(const Files& files, const std::string& priceFile) {
  const auto held = files.lock().Hold();
  PriceEdit edit(files, priceFile);
  const int stamps = RemoveLatestAdjustment(edit.records());
  if (stamps == 0) return 0;
  FileSet set(files);
  edit.Save(set);
  set.Commit();
  return stamps;
}

}  // namespace kora
