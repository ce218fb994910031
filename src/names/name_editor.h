#pragma once

#include <optional>
#include <span>
#include <string>
#include <vector>

#include "names/name_rows.h"
#include "platform/dialogs.h"
#include "settings/settings.h"
#include "update/master_list.h"

// The name file editor without its window: loading, saving and the menu entries that ask or tell.
// For one thread.

namespace kora {

struct NameEditServices {
  const Files& files;
  const std::string& dataPath;
  const std::string& systemPath;
  Dialogs& dialogs;
  SettingsFile& ini;
  DownloadSettings& download;
};

inline constexpr std::string_view kNameFileTitle = "Name File";
inline constexpr std::string_view kNamesChanged = "File has changed. SAVE Changes?";
// Put before a file is replaced that another program wrote since it was loaded.
inline constexpr std::string_view kNamesChangedOutside =
    "The Name File was changed by another program. Save over these changes ?";

class NameEditor {
 public:
  explicit NameEditor(const NameEditServices& services) : services_(services) {}

  // Reads the whole file, a row a record; no file gives no rows. Errors of reading; 6 beyond
  // 32,767 records.
  void Load();

  const std::vector<NameRec>& rows() const { return rows_; }
  bool changed() const { return changed_; }

  // Edits of the grid; each marks the rows as changed. Rows count from 0.
  std::optional<std::string> Put(size_t row, NameColumn column, std::string_view text);
  void Insert(size_t row);
  void Delete(size_t row, size_t count);
  void Sort(NameSort mode);

  // `SaveNames`: the fault of the first row that can't be saved is told and returned, for the
  // cursor to go there; otherwise names.bak takes the old file, and the file is made anew, in
  // order of category, which the rows then have as well. A file that was changed meanwhile by
  // another program asks first. False in `saved` when nothing was written.
  struct SaveEnd {
    bool saved = false;
    std::optional<RowFault> fault;
  };
  SaveEnd SaveNames();

  // "Remove Warrants from List": asks; takes the warrants out, saves, and keeps warrants out of
  // the next updates (UpdateAll and NoWarrants of section Download). True when some were taken.
  bool DeleteWarrants();
  // "Check for Duplicate Entries": asks for the sort where the rows are not in order of codes.
  void Dupnames();
  void FillClasses();    // UpdateIC_from_Stock
  void CleanOptional();  // asks
  void RemoveExpired();  // empties the rows
  void TitleCase();
  // The rows take what the master list has. False when told that there is no list, or stopped.
  bool UpdateNames(const KeepTicks& keep);

 private:
  std::string Bytes() const;  // of the file as it stands; empty when there is none

  NameEditServices services_;
  std::vector<NameRec> rows_;
  std::string loaded_;  // the file's bytes at the last load or save
  bool changed_ = false;
};

}  // namespace kora
