#pragma once

#include <cstddef>
#include <cstdint>

#include "base/record_file.h"
#include "base/text.h"

namespace kora {

#pragma pack(push, 1)
// One trading day of a .WDT price file, 50 bytes, little-endian; oldest first.
struct PriceRec {
  FixedText<8> RecDate;  // "yyyymmdd"
  float Open;
  float High;   // RecType 3: Rises
  float Low;    // RecType 3: Falls
  float Close;  // RecType 3: Cum.Total
  std::int32_t Volume;
  float AdjFactor;        // not 0: an adjustment was applied at this date
  FixedText<14> AdjDesc;  // its text, printed on the chart
  FixedText<4> RecSpare;  // always blank
};
#pragma pack(pop)

static_assert(sizeof(PriceRec) == 50);
static_assert(offsetof(PriceRec, Open) == 8 && offsetof(PriceRec, High) == 12 &&
              offsetof(PriceRec, Low) == 16 && offsetof(PriceRec, Close) == 20 &&
              offsetof(PriceRec, Volume) == 24 && offsetof(PriceRec, AdjFactor) == 28 &&
              offsetof(PriceRec, AdjDesc) == 32 && offsetof(PriceRec, RecSpare) == 46);

using PriceFile = RecordFile<PriceRec>;

// A record with blank texts and no prices.
PriceRec NewPriceRec(std::string_view yyyymmdd);

}  // namespace kora
