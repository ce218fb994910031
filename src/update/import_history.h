#pragma once

#include <cstdint>
#include <optional>
#include <set>
#include <span>
#include <string>

#include "base/files.h"

namespace kora {

class Dialogs;

// Takes price history from text files into the store, since nobody starts from nothing.

enum class ImportDates {
  kDetect,   // yyyymmdd or yyyy-mm-dd, told by their shape
  kCompact,  // yyyymmdd
  kDashed,   // yyyy-mm-dd
  kSlashed,  // d/m/yyyy
};

struct ImportOptions {
  ImportDates Dates = ImportDates::kDetect;
  std::string Code;                  // for the file's one security; empty: as the file has it
  std::string Name;                  // of the file's one security when it is new
  std::optional<std::int16_t> Type;  // RecType of new securities, 4 when not told
  bool SkipBad = false;              // leave out the rows that can't be read
};

struct ImportCounts {
  std::set<std::string> Codes;  // securities that took rows
  std::int64_t Added = 0;
  std::int64_t Replaced = 0;  // rows in place of one with the same date
  std::int64_t Refused = 0;   // rows that were not taken, all those of a refused file too
};

// Rows that a price file, and records that the name file, can number.
inline constexpr std::int32_t kMostRecords = 32767;

// Takes text files, named by their paths on the machine, into the data folder `dataPath`.
//
// A file holds lines "CODE,yyyymmdd,open,high,low,close,volume,spare", or a header that names
// its columns in any order and case (Date and Close; Open, High, Low, Volume; Code, Symbol or
// Ticker; others are passed over) and rows under it. Fields stand between commas, semicolons
// or tabs, as the first line has them, and may be quoted.
//
// The code is that of the row, else Code, else the file's name. Rows are merged by date into
// the price file, in place of a row with the same date, whose adjustment mark stays; those of a
// later file in place of those of an earlier one. A code that is new to the name file gets a
// record; the file is then sorted as after a save. Every import gives each chart list the record
// numbers that its codes have, and takes those out that left the name file.
//
// A text file is taken whole or not at all: a row that can't be read leaves it out unless
// SkipBad. What the others hold changes together at the end, price files before the name file,
// and that before the lists; a failure, as a full disk, and a user who stops it leave every file
// as it was. Every failure is told by a message titled "Import", rows with file and line number.
// Returns whether all rows were taken, but for those that SkipBad leaves out.
bool ImportHistory(const Files& files, const std::string& dataPath,
                   std::span<const std::string> hostFiles, const ImportOptions& options,
                   Dialogs& dialogs, ImportCounts& counts);

}  // namespace kora
