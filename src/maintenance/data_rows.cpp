#include "maintenance/data_rows.h"

#include <algorithm>
#include <cmath>
#include <new>

#include "base/dates.h"
#include "base/file_set.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "maintenance/failures.h"
#include "maintenance/typed_number.h"
#include "platform/dialogs.h"
#include "platform/progress.h"

namespace kora {
namespace {

constexpr std::int32_t kRunLength = 16384;
// Beyond any file that the program writes.
constexpr std::uint64_t kMostBytes = 256u << 20;

constexpr std::string_view kItemNames[] = {"OPEN", "HIGH", "LOW", "CLOSE", "VOLUME"};
constexpr size_t kVolumeItem = 4;

float PriceAt(const PriceRec& rec, int column) {
  switch (column) {
    case kDataOpen: return rec.Open;
    case kDataHigh: return rec.High;
    case kDataLow: return rec.Low;
    default: return rec.Close;
  }
}

void PutPrice(PriceRec& rec, int column, float price) {
  switch (column) {
    case kDataOpen: rec.Open = price; break;
    case kDataHigh: rec.High = price; break;
    case kDataLow: rec.Low = price; break;
    default: rec.Close = price; break;
  }
}

Refusal Refused(std::string_view text) { return {std::string(text), std::string(kDataTitle)}; }

double Scaled(double value, ScaleBy by) {
  const double factor = by == ScaleBy::kTimes100 || by == ScaleBy::kOver100 ? 100 : 10;
  return by == ScaleBy::kTimes10 || by == ScaleBy::kTimes100 ? value * factor : value / factor;
}

void ScaleRecord(PriceRec& rec, const ScaleItems& items, ScaleBy by) {
  for (int column = kDataOpen; column <= kDataClose; ++column) {
    if (!items[size_t(column - kDataOpen)]) continue;
    const float price = PriceAt(rec, column);
    if (!std::isfinite(price)) throw RunTimeError(kBadCall);
    // Worked on the number that the cell shows.
    const std::string text = Format(Scaled(Val(Str(price)), by), "####.0###");
    PutPrice(rec, column, CSng(Val(text)));
  }
  if (items[kVolumeItem] && rec.Volume != 0) rec.Volume = CLng(Fix(Scaled(double(rec.Volume), by)));
}

// False when the file can't be kept and the save is off; a set whose staging failed is empty again.
bool KeepCopy(FileSet& set, const Files& files, const std::string& path, Dialogs& dialogs) {
  const std::string copy = path.substr(0, path.find_last_of("\\/:") + 1) + "Temp.WRK";
  for (;;) {
    try {
      if (files.CheckFile(path)) set.Add(copy, files.ReadAll(path));
      set.Stage();
      return true;
    } catch (const RunTimeError& e) {
      // Only a device can mend itself while the user looks.
      if (e.number() == kDeviceNotAvailable) {
        if (dialogs.Ask("Device not available. Try again", kSaveDataTitle, Buttons::kRetryCancel) ==
            Answer::kRetry)
          continue;
      } else {
        dialogs.Message(Str(std::int32_t(e.number())) + " Cannot continue", kSaveDataTitle);
      }
      return false;
    }
  }
}

}  // namespace

std::string DataHeading(DataColumn column, std::int16_t RecType) {
  constexpr const char* kHeadings[] = {"Rec",   "Date",   "Open",       "High",     "Low",
                                       "Close", "Volume", "Adj.Factor", "Adj.Desc."};
  if (RecType == 3) {
    if (column == kDataHigh) return "Rises";
    if (column == kDataLow) return "Falls";
    if (column == kDataClose) return "Cum.Total";
  }
  return kHeadings[column];
}

std::string ScaleCaption(RowBlock rows) {
  if (rows.count() < 1) return "There are no records selected";
  const std::string first = Str(std::int32_t(rows.first + 1));
  return rows.count() == 1 ? "Modify record " + first
                           : "Modify records " + first + " to " + Str(std::int32_t(rows.last + 1));
}

std::string ScaleText(const ScaleItems& items) {
  std::string names;
  for (size_t i = 0; i < items.size(); ++i)
    if (items[i]) names += (names.empty() ? "" : ", ") + std::string(kItemNames[i]);
  if (names.empty()) return {};
  return "This procedure multiplies or divides the " + names +
         " of the highlighted record/s, by the factor selected. ";
}

std::optional<Refusal> CheckScale(const ScaleItems& items, std::optional<ScaleBy> by) {
  const std::string title(kScaleTitle);
  if (std::find(items.begin(), items.end(), true) == items.end())
    return Refusal{"No data item to Adjust", title};
  if (!by) return Refusal{"Multiply or Divide option must be selected", title};
  return std::nullopt;
}

bool DataRows::ShowData(std::string_view code, Progress& progress, Dialogs& dialogs) {
  records_.clear();
  changed_ = false;
  bool shown = false;
  const bool read = TellFailure(dialogs, kDataFileTitle, path_, [&] {
    if (!files_.CheckFile(path_)) {
      dialogs.Message(std::string(code) + " NOT FOUND", kDataFileTitle);
      return;
    }
    stamp_ = files_.Stamp(path_);  // before the bytes: a change while they are read shows as one
    const PriceFile file(files_, path_);
    const std::int32_t count = file.count();
    if (count == 0) {
      dialogs.Message("No data on file for " + path_, kDataFileTitle);
      return;
    }
    if (std::uint64_t(count) * sizeof(PriceRec) > kMostBytes) throw RunTimeError(kOutOfMemory);
    std::vector<PriceRec> records;
    records.resize(size_t(count));
    for (std::int32_t done = 0; done < count;) {
      const std::int32_t run = std::min(kRunLength, count - done);
      file.ReadRun(done + 1, std::span(records).subspan(size_t(done), size_t(run)));
      done += run;
      if (!progress.Step(done, count)) return;
    }
    records_ = std::move(records);
    shown = true;
  });
  return read && shown;
}

bool DataRows::SaveData(Progress& progress, Dialogs& dialogs) {
  try {
    const auto held = files_.lock().Hold();
    if (files_.Stamp(path_) != stamp_ &&
        dialogs.Ask(kDataChangedOutside, kSaveDataTitle, Buttons::kYesNo) != Answer::kYes)
      return false;
    FileSet set(files_);
    if (!progress.Step(0, 2) || !KeepCopy(set, files_, path_, dialogs) || !progress.Step(1, 2))
      return false;
    set.Add(path_, std::string(reinterpret_cast<const char*>(records_.data()),
                               records_.size() * sizeof(PriceRec)));
    set.Commit();
    stamp_ = files_.Stamp(path_);
    changed_ = false;
    progress.Step(2, 2);
    return true;
  } catch (const HomeIsHeld& e) {
    dialogs.Message(e.what(), kSaveDataTitle);
  } catch (const RunTimeError&) {
    dialogs.Message("Unable to save data", kSaveDataTitle);
  } catch (const std::bad_alloc&) {
    dialogs.Message("Unable to save data", kSaveDataTitle);
  }
  return false;
}

void DataRows::SortByDate() {
  const auto before = [](const PriceRec& a, const PriceRec& b) {
    return a.RecDate.raw() < b.RecDate.raw();
  };
  if (std::is_sorted(records_.begin(), records_.end(), before)) return;
  std::stable_sort(records_.begin(), records_.end(), before);
  changed_ = true;
}

std::optional<Refusal> DataRows::Scale(RowBlock rows, const ScaleItems& items, ScaleBy by) {
  if (rows.count() < 1 || rows.first < 0 || rows.last >= RowCount())
    return Refusal{ScaleCaption({}), std::string(kScaleTitle)};
  std::vector<PriceRec> block(records_.begin() + rows.first, records_.begin() + rows.last + 1);
  for (size_t i = 0; i < block.size(); ++i) {
    try {
      ScaleRecord(block[i], items, by);
    } catch (const RunTimeError& e) {
      return Refusal{
          "Record " + Str(std::int32_t(rows.first) + std::int32_t(i) + 1) + ": " +
              std::string(e.number() == kOverflow ? kNumberTooLarge : kDataMustBeNumeric),
          std::string(kScaleTitle)};
    }
  }
  std::copy(block.begin(), block.end(), records_.begin() + rows.first);
  changed_ = true;
  return std::nullopt;
}

std::string DataRows::Text(int row, int column) const {
  const PriceRec& rec = records_[size_t(row)];
  switch (column) {
    case kDataRec: return Str(std::int32_t(row + 1));
    case kDataDate: return FromAnsi(rec.RecDate.trimmed());
    case kDataVolume: return Str(std::int32_t(rec.Volume));
    case kDataAdjFactor: return Str(float(rec.AdjFactor));
    case kDataAdjDesc: return FromAnsi(rec.AdjDesc.trimmed());
    default: return Str(PriceAt(rec, column));
  }
}

GridShade DataRows::Shade(int row, int) const {
  return ParseFileDate(records_[size_t(row)].RecDate.raw()) ? GridShade::kNone : GridShade::kMarked;
}

std::optional<Refusal> DataRows::SetText(int row, int column, const std::string& text) {
  PriceRec& rec = records_[size_t(row)];
  switch (column) {
    case kDataRec:
    case kDataAdjFactor: return Refused("Cannot edit this column");
    case kDataDate:
    case kDataAdjDesc: {
      const std::string ansi = ToAnsi(text);
      if (FromAnsi(ansi) != text)
        return Refused("\"" + text + "\" has letters that the file can't keep");
      if (column == kDataDate)
        rec.RecDate.set(ansi);
      else
        rec.AdjDesc.set(ansi);
      break;
    }
    default: {
      const auto number = TypedNumber(text);
      if (!number) return Refused(kDataMustBeNumeric);
      try {
        if (column == kDataVolume)
          rec.Volume = CLng(*number);
        else
          PutPrice(rec, column, CSng(*number));
      } catch (const RunTimeError&) {
        return Refused(kNumberTooLarge);
      }
    }
  }
  changed_ = true;
  return std::nullopt;
}

std::optional<Refusal> DataRows::MayDelete(RowBlock rows) const {
  for (int row = std::max(0, rows.first); row <= rows.last && row < RowCount(); ++row)
    if (Trim(records_[size_t(row)].RecDate.trimmed()).empty())
      return Refusal{"Only transactions can be deleted", "Delete Transaction"};
  return std::nullopt;
}

void DataRows::DeleteRows(RowBlock rows) {
  RemoveBlock(records_, rows);
  changed_ = true;
}

}  // namespace kora
