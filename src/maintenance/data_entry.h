#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "base/files.h"
#include "store/name_rec.h"
#include "store/price_rec.h"

// One day's prices typed in, security after security: what stands behind the form `DataEntry`.

namespace kora {

class Dialogs;

struct EntrySecurity {
  std::int16_t number = 0;  // its record in the name file
  NameRec name{};
  std::string code;                  // trimmed
  std::string path;                  // its price file
  std::optional<PriceRec> previous;  // the last record on file
};

// The security at a record of the name file (held to its range), or the one of a code in any case.
// Nothing when there is none, which is told, as is a security without prices.
std::optional<EntrySecurity> OpenEntry(const Files& files, const std::string& dataPath,
                                       std::int32_t number, Dialogs& dialogs);
std::optional<EntrySecurity> FindEntry(const Files& files, const std::string& dataPath,
                                       std::string_view code, Dialogs& dialogs);

// The day that "Auto Date Advance" proposes behind the last one, "d/m/yy": the next day, or for one
// on a weekend the days that the form has always added. Empty behind a date that is none.
std::string NextEntryDate(std::string_view yyyymmdd);

enum class EntryBox { kNone, kDate, kOpen, kHigh, kLow, kClose, kVolume };
// Whether the form shows the box for a kind of data. Of kind 3 High, Low and Close are Rises, Falls
// and Cum.Total.
bool EntryShows(std::int16_t RecType, EntryBox box);

// What stands in the boxes.
struct EntryTexts {
  std::string date;  // d/m/yy
  std::string open, high, low, close, volume;
};

// Writes the day behind the last record of the security's file; a date earlier than the last is
// taken as it is. False, and told, when a text is refused or the write fails: `focus` is the box to
// go back to, or kNone. The security's `previous` becomes what was written.
bool SaveEntry(const Files& files, EntrySecurity& security, const EntryTexts& texts,
               Dialogs& dialogs, EntryBox& focus);

}  // namespace kora
