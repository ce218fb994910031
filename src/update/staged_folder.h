#pragma once

#include <map>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

#include "base/file_edits.h"
#include "base/files.h"
#include "store/name_rec.h"
#include "update/price_write.h"

namespace kora {

// The names and price files of one data folder, with changes that are planned and not made yet.
class StagedFolder {
 public:
  // Reads the names and which price files there are. Error 6 for more names than 16 bits number,
  // 76 where the folder is not there.
  StagedFolder(const Files& files, std::string path);

  const std::string& path() const { return path_; }

  const std::vector<NameRec>& names() const { return names_; }
  // The place of the first name with these trimmed characters, from 0; names().size() for none.
  size_t PlaceOf(const std::string& code) const;
  void AddName(const NameRec& rec);
  void ChangeName(size_t place, const NameRec& rec);

  // The price file of a code, "ORE.WDT" in any case.
  bool HasPrices(std::string_view name) const;
  // What is staged for it stays until Made().
  PriceView Prices(const std::string& name);

  // Everything that is staged: the names, then the price files.
  std::vector<FileEdit> Edits();
  // About the memory that it takes.
  size_t bytes() const { return bytes_; }
  // Notes what the views have staged since the last call. Called when one is done with.
  void Count(const std::string& name);
  // The edits were made: what is staged is what is on file.
  void Made();

 private:
  const Files& files_;
  const std::string path_;
  std::vector<NameRec> names_;
  std::unordered_map<std::string, size_t> places_;
  std::unordered_set<std::string> priceFiles_;  // upper case
  bool nameFile_ = false;                       // is there
  std::uint64_t nameBytes_ = 0;
  std::string tornName_;  // bytes behind the last name
  size_t namesOnFile_ = 0;
  std::map<size_t, NameRec> oldNames_;          // those on file that are to change, as they are
  std::map<std::string, StagedPrices> prices_;  // by name, upper case
  std::unordered_map<std::string, std::string> shown_;  // a name as it was first given
  size_t bytes_ = 0;
};

}  // namespace kora
