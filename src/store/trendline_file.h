#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "base/record_file.h"
#include "base/text.h"

namespace kora {

#pragma pack(push, 1)
// One saved trendline of a .TND file, 27 bytes, little-endian. It is kept by dates and prices, so
// that it follows them when the chart changes.
struct TrendlineRec {
  std::int16_t TLSpacing;    // bar spacing then + 1; 0 in an empty slot
  FixedText<1> TLPeriod;     // A, W or M: only charts of that period show it
  FixedText<8> TLStartDate;  // "yyyymmdd" of the left end
  float TLStartPrice;
  FixedText<8> TLEndDate;  // of the right end; beyond the last bar "X" and the columns from the
                           // left end, as "X35"
  float TLEndPrice;

  // A slot that a deletion has left: the next line saved takes it.
  bool Empty() const {
    return TLSpacing == 0 && TLPeriod.trimmed().empty() && TLStartDate.trimmed().empty();
  }
};
#pragma pack(pop)

static_assert(sizeof(TrendlineRec) == 27);
static_assert(offsetof(TrendlineRec, TLPeriod) == 2 && offsetof(TrendlineRec, TLStartDate) == 3 &&
              offsetof(TrendlineRec, TLStartPrice) == 11 &&
              offsetof(TrendlineRec, TLEndDate) == 15 && offsetof(TrendlineRec, TLEndPrice) == 23);

using TrendlineFile = RecordFile<TrendlineRec>;

// An empty slot: no spacing, blank texts, no prices.
TrendlineRec EmptyTrendline();

// The file of a security's lines in the folder for such files: code + ".TND". Error 52 for a code
// that can't name a file.
std::string TrendlinePath(std::string_view miscPath, std::string_view code);

// The records, empty slots too; none where there is no file. What is left of a record at the end
// does not count. Errors of Files::ReadAll.
std::vector<TrendlineRec> ReadTrendlines(const Files& files, const std::string& path);

// Each of these puts the file in place whole: a failure leaves it as it was. Errors of
// Files::WriteAll.

// Puts the line into the first empty slot, or behind the last record. Returns its record, from 1.
std::int32_t SaveTrendline(const Files& files, const std::string& path, const TrendlineRec& line);
// Empties the slot of record `n`. Error 63 where there is none.
void DeleteTrendline(const Files& files, const std::string& path, std::int32_t n);
// Keeps the records that have a start date and a start price, and no others.
void CompactTrendlines(const Files& files, const std::string& path);
// Removes the file; nothing where there is none.
void RemoveTrendlines(const Files& files, const std::string& path);

}  // namespace kora
