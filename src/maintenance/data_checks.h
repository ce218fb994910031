#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"

// The checks of the store: prices (`DataStat`, `RTypeCk`), names against files (`NameData`) and
// advance/decline totals (`ADTotals`).

namespace kora {

class Dialogs;
class Progress;

// ---- Prices

inline constexpr int kStaleDays = 30;  // where nobody says otherwise

struct DataCheckPlan {
  // Kinds to check, by RecType; 3 can't be.
  std::array<bool, 6> types{};
  int StaleDays = kStaleDays;
};

struct DataCheck {
  bool done = false;  // all of it, or until the user stopped it
  bool stopped = false;
  std::vector<std::string> messages;  // one a line, in the order of the name file
  std::vector<std::string> codes;     // listed, each once; they stand in SubListZ.Dat
  std::int32_t checked = 0;           // price files gone through
  std::int32_t repaired = 0;          // of them, put in place with their gaps closed
  std::string last;                   // the code that was gone through last
};

// Goes through the price files of the chosen kinds. A price of 0 takes the last close that was not
// (the record's own, where it has one); a first close of 0 takes the first that is not. Repaired
// files are put in place whole, some tens at a time. Listed are files that are missing, files
// without any close, and those that neither traded nor moved for StaleDays at their end. SubListZ.Dat
// receives the codes listed.
//
// Each message shows as kNote of `progress` too, the security in hand as kState. What can't be done
// is told.
DataCheck CheckDataFiles(const Files& files, const std::string& dataPath, const DataCheckPlan& plan,
                         Progress& progress, Dialogs& dialogs);

// Asks, then takes the listed securities out of the name file and renames each price file to ".old"
// in place of an older one, all together. True when it was done.
bool RemoveListed(const Files& files, const std::string& dataPath,
                  const std::vector<std::string>& codes, Dialogs& dialogs);

// ---- Names and files

struct NameCheck {
  bool done = false;
  std::int32_t removed = 0, added = 0;  // name records
  std::int32_t count = 0;               // names in the file now
};

// Asks about each name without a price file whether to remove it, and about each price file without
// a name whether to add one. A changed name file is sorted by code, in place of the old one, which is
// kept as Names.Bak; where the user stops it nothing is changed.
NameCheck CheckNameData(const Files& files, const std::string& dataPath, Progress& progress,
                        Dialogs& dialogs);

// ---- Advance/decline totals

// The codes of the name records of kind 3; none is told.
std::vector<std::string> AdvanceDeclines(const Files& files, const std::string& dataPath,
                                         Dialogs& dialogs);

// Works the running totals of a file out anew from `base`: Close is High + total before - Low, a
// whole number, Open 0. The text that tells the total at the end; nothing, and told, where the base
// is no number, the file has no records or the work fails.
std::optional<std::string> CheckTotals(const Files& files, const std::string& dataPath,
                                       std::string_view code, std::string_view base,
                                       Dialogs& dialogs);

}  // namespace kora
