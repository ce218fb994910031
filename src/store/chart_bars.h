#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "settings/style_period.h"
#include "store/price_rec.h"

namespace kora {

struct ChartBar {
  char Date[8];  // "yyyymmdd", NULs where a bar has none
  float Open, High, Low, Close;
  std::int32_t Volume;     // of monthly bars in hundreds
  std::int32_t SourceRec;  // record with an adjustment, 0 none

  std::string_view date() const { return Date[0] ? std::string_view(Date, 8) : std::string_view(); }
};

// The bars of the chart on show and the figures that its scales are set from.
struct ChartBars {
  std::vector<ChartBar> bars;     // 0 to BarCount; a late flush may leave spare bars behind
  std::int16_t FirstDataRec = 0;  // first record to load, at least 1
  std::int16_t LastDataRec = 0;   // last record to load
  std::int16_t BarCount = 0;      // highest index in use
  float ChartHigh = 0;            // -100000 when nothing counted
  float ChartLow = 0;             // lowest non-zero Low; 100000 when nothing counted
  std::int32_t VolMax = 0, VolMin = 0, VolAvg = 0;  // of the non-zero volumes
  bool VolumeShown = false;
  std::int16_t CurrentDataRec = 0;  // the record being read, for messages; 0 none

  const ChartBar& operator[](size_t i) const { return bars[i]; }
  ChartBar& operator[](size_t i) { return bars[i]; }
};

// Loads records FirstDataRec to LastDataRec of `file` as days, weeks or months. `volumeOption` is the user's request for volume, `recType` that of the name record.
//
// Weekly and monthly: a week ends where the weekday falls, a month where the month key grows.
//
// Errors: 63 for an empty slice or one outside the file, 5 for a weekly record whose date is no
// calendar date (CurrentDataRec tells which), 6 where a volume leaves 32 bits
// (CurrentDataRec tells at which record of the week or month).
// After an error `out` holds bars 0 to BarCount of no use, CurrentDataRec the record in hand.
void LoadChartBars(const PriceFile& file, Period chartPeriod, bool volumeOption,
                   std::int16_t recType, ChartBars& out);

// Daily bars without volumes of records that are read already: records[0] has the number `first`.
// `out` gets FirstDataRec and LastDataRec of them. Errors: 63 for no records, 6 for a number
// beyond 16 bits.
void LoadDailyBars(std::span<const PriceRec> records, std::int32_t first, std::int16_t recType,
                   ChartBars& out);

}  // namespace kora
