#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "base/file_set.h"
#include "store/name_file.h"
#include "store/price_rec.h"

namespace kora {

// A price file that is changed as a whole: read, changed in memory, and put in place together
// with what changes with it (chart notes, name records, other price files) as one FileSet, so
// that a failure or a kill leaves all of it as it was, or all of it done.
//
//   const auto held = files.lock().Hold();
//   PriceEdit edit(files, path);
//   ... edit.records() ...
//   FileSet set(files);
//   edit.KeepOld(set);  // where the old file is to stay beside
//   edit.Save(set);
//   set.Commit();
//
// A torn record at the end of the file does not count and is gone after a save.
class PriceEdit {
 public:
  // Reads all records. Error 53 when the file is not there, 6 for more records than 16 bits
  // number; others as Files::Open.
  PriceEdit(const Files& files, std::string path);

  const std::string& path() const { return path_; }
  std::vector<PriceRec>& records() { return records_; }
  const std::vector<PriceRec>& records() const { return records_; }

  // True when another program changed the file since it was read. Asked under the home's lock
  // before a save of what the user had in hand.
  bool Changed() const;

  // Adds the old file, as it is on the disk, to the set under the extension ".OLD"; an older one
  // is replaced. The price file itself stays where it is, so that a kill in between leaves it.
  void KeepOld(FileSet& set) const;
  // Adds the records to the set. Error 6 for more than 16 bits number; 75 for a read-only file,
  // by its name.
  void Save(FileSet& set) const;

 private:
  const Files& files_;
  std::string path_;
  FileStamp stamp_;
  std::vector<PriceRec> records_;
};

// Adds a whole price file to the set, new or in place of an old one. Errors of PriceEdit::Save.
void StagePrices(FileSet& set, const std::string& path, std::span<const PriceRec> records);
// The same for a name file.
void StageNames(FileSet& set, const std::string& path, std::span<const NameRec> records);

// "c:\data\ORE.OLD" of "c:\data\ORE.WDT".
std::string OldFilePath(std::string_view path);

}  // namespace kora
