#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <span>
#include <string>

#include "base/file_edits.h"
#include "base/files.h"
#include "store/price_rec.h"
#include "update/day_line.h"

namespace kora {

// How the records of one downloaded file go into the price files; set once per file.
enum UpdateModeValue : std::int16_t {
  kModeAppend = 0,
  kModeInsert = 1,   // in order of date
  kModeReplace = 2,  // the record with the same date
  kModeAbandon = 5,
};

// What is to be written into one price file; the file itself stays as it is.
struct StagedPrices {
  bool existed = false;
  std::uint64_t before = 0;                     // bytes of the file
  std::int32_t onFile = 0;                      // its records
  std::int32_t count = 0;                       // with those that are to be added
  std::string torn;                             // bytes behind the last record of the file
  std::map<std::int32_t, PriceRec> fresh, old;  // by record; `old` of those that are on file

  // The changes of `path`, a run of records each.
  FileEdit Edit(std::string path) const;
  // About the memory that they take.
  size_t bytes() const { return (fresh.size() + old.size()) * 2 * sizeof(PriceRec); }
};

// A price file with what is staged for it. Errors of reading as of RecordFile.
class PriceView {
 public:
  // A file that is not there is an empty one. A fresh `staged` learns how the file stands; else
  // the file stands as it did then.
  PriceView(const Files& files, std::string_view path, bool exists, StagedPrices& staged);

  std::int32_t count() const { return staged_.count; }
  PriceRec Read(std::int32_t n) const;
  void ReadRun(std::int32_t n, std::span<PriceRec> out) const;
  // Stages records n, n+1, ...; n is count() + 1 at most.
  void WriteRun(std::int32_t n, std::span<const PriceRec> records);

 private:
  void ReadFile(std::int32_t n, std::span<PriceRec> out) const;

  std::unique_ptr<HostFile> file_;  // none where it is not there
  StagedPrices& staged_;
};

// Where a record goes in a file that holds records.
struct RecordPlace {
  std::int32_t position = 0;
  bool overwrite = false;  // the record that stands there; else those from there on move up
};

// Looks backwards from the end of the file, which costs little for a date near it. A date later
// than the only record of a file goes in front of it, as does one that is later than record 1
// and no other.
RecordPlace FindPlace(const PriceView& file, std::string_view date, std::int16_t UpdateMode);

// Stages the line by kind of data. Kind 3 keeps a running total. The late volume of the day before
// goes with it. Empty when that was done; else nothing is staged, and the text says why not: the
// file is full, or the total leaves the range of its field.
std::string WriteDay(PriceView& file, const DayLine& day, std::int16_t RecType,
                     std::int16_t UpdateMode, bool options);

// Why a price file takes no more records; empty where it takes one.
std::string FullText(const PriceView& file);

}  // namespace kora
