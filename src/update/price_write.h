#pragma once

#include <cstdint>

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

// Where a record goes in a file that holds records.
struct RecordPlace {
  std::int32_t position = 0;
  bool overwrite = false;  // the record that stands there; else those from there on move up
};

// Looks backwards from the end of the file, which costs little for a date near it. A date later
// than the only record of a file goes in front of it, as does one that is later than record 1
// and no other.
RecordPlace FindPlace(const PriceFile& file, std::string_view date, std::int16_t UpdateMode);

// Writes the line into the price file by kind of data. Kind 3 keeps a running total. All
// that changes from the record's place on is written in one go, so that a file is old or new,
// and is put back when that fails half-way; the late volume of the day before follows. Error 6
// for a file of 32,767 records that would grow.
void WriteDay(PriceFile& file, const DayLine& day, std::int16_t RecType, std::int16_t UpdateMode,
              bool options);

}  // namespace kora
