#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "store/price_rec.h"

namespace kora {

// The records around a wanted date, for choosing the last one in old terms.
struct AdjustmentDates {
  std::vector<std::string> Lines;  // "15/09/1998             5.00", one a record
  std::int16_t AdjListFirst = 0;   // record number of the first line
  std::int16_t Found = 0;          // the last record not later than the date; 0: none
  size_t Selected = 0;             // the line chosen of itself, from 0

  bool empty() const { return Lines.empty(); }
  // The record of a line.
  std::int16_t AdjRecNo(size_t line) const { return std::int16_t(AdjListFirst + int(line)); }
};

// Looks for the last record not later than `AdjWantedDate`, "yyyymmdd", from record 2 on: a date
// before the second record gives no lines. The list holds that record and 20 to each side, clipped
// to the file. Line 20 is selected, whether it is the record's or, near the file's start, another
// one's; a list that ends before it has its last line selected.
AdjustmentDates FindAdjustmentDate(std::span<const PriceRec> records,
                                   std::string_view AdjWantedDate);

// What is told where the record found has another date than the one wanted: the date as `typed`,
// its date and its close. Empty where it has that date, or nothing was found.
std::string OtherDateText(std::span<const PriceRec> records, const AdjustmentDates& dates,
                          std::string_view AdjWantedDate, std::string_view typed);

}  // namespace kora
