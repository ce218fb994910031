#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"
#include "store/name_file.h"
#include "store/price_edit.h"

namespace kora {
namespace {

constexpr std::string_view kSaveTitle = "Saving Data";

template <size_t N>
bool IsBlank(const FixedText<N>& text) {
  return Trim(text.trimmed()).empty();
}

// As the grid's empty rows come: no text and no number in any column.
bool IsBlankRow(const NameRec& row) {
  return IsBlank(row.Code) && IsBlank(row.Name) && IsBlank(row.OtherDetails) && IsBlank(row.Id) &&
         IsBlank(row.IndClass) && row.RecType == 0 && row.Category == 0 && row.Base == 0 &&
         row.Top == 0 && row.PFInc == 0;
}

// The message of a failure: memory has its own, the rest that of the step.
std::string FailureText(int number, std::string_view otherwise) {
  if (number == kOutOfMemory || number == kOutOfTextSpace || number == kOutOfStack)
    return "There is a memory problem. Try closing windows and restarting";
  return std::string(otherwise);
}

// False when the backup can't be had and the save is off. A first save has nothing to keep.
bool TakeBackup(const Files& files, const std::string& dataPath, Dialogs& dialogs) {
  const std::string path = NameFilePath(dataPath);
  for (;;) {
    try {
      if (files.CheckFile(path)) files.WriteAll(dataPath + "names.bak", files.ReadAll(path));
      return true;
    } catch (const RunTimeError& e) {
      // Only a drive can mend itself while the user looks; the others would ask for ever.
      if (e.number() == kDeviceNotAvailable || e.number() == kDiskNotReady) {
        const char* text = e.number() == kDeviceNotAvailable ? "Device not available. Try again"
                                                             : "Drive door open";
        if (dialogs.Ask(text, kSaveTitle, Buttons::kRetryCancel) == Answer::kRetry) continue;
      } else {
        dialogs.Message(FailureText(e.number(), Str(std::int32_t(e.number())) + " Cannot continue"),
                        kSaveTitle);
      }
      return false;
    }
  }
}

}  // namespace

std::optional<RowFault> CheckRows(std::span<NameRec> rows) {
  for (size_t i = 0; i < rows.size(); ++i) {
    NameRec& row = rows[i];
    if (IsBlankRow(row)) continue;
    if (row.Category < 0 || row.Category > 99) row.Category = 0;
    if (IsBlank(row.Code)) return RowFault{i, "Code must be entered"};
    if (row.RecType < 1 || row.RecType > 5) return RowFault{i, "Record Type must be entered"};
  }
  return std::nullopt;
}

bool SaveNames(const Files& files, const std::string& dataPath, std::span<const NameRec> rows,
               Dialogs& dialogs, const StageBesideNames& beside) {
  try {
    const auto held = files.lock().Hold();
    if (!TakeBackup(files, dataPath, dialogs)) return false;
    std::vector<NameRec> records;
    records.reserve(rows.size());
    for (const NameRec& row : rows) {
      if (IsBlank(row.Code)) continue;
      records.push_back(row);
      records.back().NameStatus = 0;
      records.back().MinMove = 0.05f;
    }
    CInt(double(records.size()));  // record numbers are 16 bits
    // The rows are put in order before they are written, once, beside the old file: until the
    // new one is whole the old one is in its place, and a failure has nothing to bring back.
    const std::vector<NameRec> sorted = SortedNames(records, NameSort::kCategory);
    FileSet set(files);
    StageNames(set, NameFilePath(dataPath), sorted);
    if (beside) beside(set, sorted);
    set.Commit();
    return true;
  } catch (const HomeIsHeld& e) {
    dialogs.Message(e.what(), kSaveTitle);
    return false;
  } catch (const RunTimeError& e) {
    dialogs.Message(FailureText(e.number(), "Unable to save data"), kSaveTitle);
    return false;
  }
}

}  // namespace kora
