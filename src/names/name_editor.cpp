#include "names/name_editor.h"

#include <algorithm>
#include <cstring>
#include <tuple>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/chart_list.h"
#include "update/download_settings.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestNames = 16u << 20;

EditorRow RowFor(const NameRec& rec) {
  return {NameCell(rec, NameColumn::kCode),     NameCell(rec, NameColumn::kName),
          NameCell(rec, NameColumn::kDetails),  NameCell(rec, NameColumn::kType),
          NameCell(rec, NameColumn::kCategory), NameCell(rec, NameColumn::kClass)};
}

// What the master list gives goes in as if it had been typed; what no cell takes is left out.
bool TakeRow(NameRec& rec, const EditorRow& row) {
  const EditorRow before = RowFor(rec);
  const std::tuple<NameColumn, const std::string&, const std::string&> cells[] = {
      {NameColumn::kName, row.name, before.name},
      {NameColumn::kDetails, row.details, before.details},
      {NameColumn::kType, row.type, before.type},
      {NameColumn::kCategory, row.category, before.category},
      {NameColumn::kClass, row.IndClass, before.IndClass}};
  bool changed = false;
  for (const auto& [column, text, old] : cells)
    if (text != old && !PutNameCell(rec, column, text)) changed = true;
  return changed;
}

}  // namespace

std::string NameEditor::Bytes() const {
  const std::string path = NameFilePath(services_.dataPath);
  return services_.files.CheckFile(path) ? services_.files.ReadAll(path, kLargestNames)
                                         : std::string();
}

void NameEditor::Load() {
  std::string bytes = Bytes();
  std::vector<NameRec> rows = ReadNames(services_.files, services_.dataPath);
  rows_ = std::move(rows);
  loaded_ = std::move(bytes);
  changed_ = false;
}

std::optional<std::string> NameEditor::Put(size_t row, NameColumn column, std::string_view text) {
  NameRec& rec = rows_.at(row);
  const NameRec before = rec;
  if (auto fault = PutNameCell(rec, column, text)) return fault;
  if (std::memcmp(&before, &rec, sizeof rec) != 0) changed_ = true;
  return std::nullopt;
}

void NameEditor::Insert(size_t row) {
  rows_.insert(rows_.begin() + std::ptrdiff_t(std::min(row, rows_.size())), EmptyNameRow());
  changed_ = true;
}

void NameEditor::Delete(size_t row, size_t count) {
  if (row >= rows_.size() || count == 0) return;
  const auto first = rows_.begin() + std::ptrdiff_t(row);
  rows_.erase(first, first + std::ptrdiff_t(std::min(count, rows_.size() - row)));
  changed_ = true;
}

void NameEditor::Sort(NameSort mode) {
  SortNameRows(rows_, mode);
  changed_ = true;
}

NameEditor::SaveEnd NameEditor::SaveNames() {
  if (auto fault = CheckRows(rows_)) {
    services_.dialogs.Message(fault->message, kNameFileTitle);
    return {false, fault};
  }
  try {
    const auto held = services_.files.lock().Hold();
    if (Bytes() != loaded_ && services_.dialogs.Ask(kNamesChangedOutside, kNameFileTitle,
                                                    Buttons::kYesNo) != Answer::kYes)
      return {};
    const auto lists = [&](FileSet& set, std::span<const NameRec> names) {
      StageLists(set, services_.files, services_.dataPath, CodeNumbers(names));
    };
    if (!kora::SaveNames(services_.files, services_.dataPath, rows_, services_.dialogs, lists))
      return {};
    changed_ = false;
    try {
      Load();
    } catch (const RunTimeError& e) {
      services_.dialogs.Message(e.what(), kNameFileTitle);  // it is saved all the same
    }
    return {true, {}};
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kNameFileTitle);
    return {};
  }
}

bool NameEditor::DeleteWarrants() {
  const Answer answer = services_.dialogs.Ask(
      "Warrants will be deleted from the Name File.\nDo you want to continue ?", "Warrants",
      Buttons::kYesNo);
  if (answer != Answer::kYes) return false;
  std::vector<NameRec> before = rows_;
  if (RemoveWarrantRows(rows_) == 0) return false;
  // First: where the program ends between the two, a second try still finds warrants to remove.
  const UpdateChoice choice = UpdateChoiceOf(services_.download);
  SaveUpdateChoice(UpdateChoice::kNoWarrants, services_.ini, services_.download);
  if (!SaveNames().saved) {
    rows_ = std::move(before);  // a removal that can't be saved has not been made
    SaveUpdateChoice(choice, services_.ini, services_.download);
    return false;
  }
  services_.dialogs.Message(" Warrants removed", kNameFileTitle);
  return true;
}

void NameEditor::Dupnames() {
  constexpr std::string_view title = "Duplicate codes";
  if (!IsSortedByCode(rows_)) {
    const Answer answer =
        services_.dialogs.Ask("Name file needs to be sorted by code to proceed. OK to sort list ?",
                              title, Buttons::kOkCancel);
    if (answer != Answer::kOk) return;
    Sort(NameSort::kCode);
  }
  const int removed = RemoveDuplicateRows(rows_);
  if (removed > 0) changed_ = true;
  services_.dialogs.Message(Str(std::int32_t(removed)) + " duplicate entries removed", title);
}

void NameEditor::FillClasses() {
  if (UpdateIC_from_Stock(rows_) > 0) changed_ = true;
}

void NameEditor::CleanOptional() {
  const Answer answer = services_.dialogs.Ask(
      "Select OK to remove all settings from optional Base, Top and PFIncrement columns",
      kNameFileTitle, Buttons::kOkCancel);
  if (answer == Answer::kOk && CleanOptionalCells(rows_) > 0) changed_ = true;
}

void NameEditor::RemoveExpired() {
  EmptyExpiredRows(rows_);
  changed_ = true;  // whether or not there were any
}

void NameEditor::TitleCase() {
  if (TitleCaseNames(rows_) > 0) changed_ = true;
}

bool NameEditor::UpdateNames(const KeepTicks& keep) {
  std::vector<EditorRow> taken;
  taken.reserve(rows_.size());
  for (const NameRec& row : rows_) taken.push_back(RowFor(row));
  if (!UpdateFromMaster(services_.files, services_.systemPath, taken, keep, services_.dialogs))
    return false;
  for (size_t i = 0; i < rows_.size(); ++i)
    if (TakeRow(rows_[i], taken[i])) changed_ = true;
  return true;
}

}  // namespace kora
