#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "adjust/issue_figures.h"
#include "base/file_set.h"
#include "store/chart_notes.h"
#include "store/price_edit.h"
#include "store/price_rec.h"

// An adjustment rescales all prices up to a date by one factor, so that they compare with those
// behind it, marks the date by a stamp (AdjFactor and AdjDesc of a record), and moves the texts on
// the security's charts with the prices. The stamp marks the last date in old terms.

namespace kora {

// A price times a factor, in 64 bits, rounded half to even to 4 decimals. Error 6 where it leaves
// the range of money.
float ScaledPrice(float price, double factor);

// Rescales record `AdjRecNo` (from 1) and all earlier ones and stamps it. A record without a close
// is passed over; the stamp then goes to the next earlier one that has a close. Volumes, and the
// stamps of earlier adjustments, stay. Error 63 for a record that is not there, 6 as ScaledPrice;
// the records are then half done.
void AdjustRecords(std::span<PriceRec> records, std::int16_t AdjRecNo,
                   const Adjustment& adjustment);

// Moves the notes up to `date` ("yyyymmdd") with the prices, to 2 decimals, and gives all the
// colour, as the number that stands in the file. A price that leaves the range of money stays.
void AdjustNotes(std::vector<ChartNote>& notes, std::string_view date, float factor,
                 std::int32_t colour);

// Where a security's data are.
struct AdjustedSecurity {
  const Files& files;
  std::string priceFile;    // DOS path of the .WDT
  std::string notesFile;    // of its chart notes, there or not
  std::int32_t NoteColour;  // ChartColours(26)
};

// Adds the adjusted price file, and the notes where there are any, to a set that the caller
// commits, with what else is to change with them; the price file, whose stamp tells that it was
// done, comes behind the notes. The home's lock is to be held. Errors of PriceEdit, AdjustRecords
// and ReadChartNotes; nothing was changed.
void StageAdjustment(FileSet& set, const AdjustedSecurity& security, PriceEdit& edit,
                     std::int16_t AdjRecNo, const Adjustment& adjustment);

// The whole of it, under the home's lock: a security is adjusted, notes and all, or not. `edit` is
// the price file as the record was chosen from; error 70 where it was changed since.
void ApplyAdjustment(const AdjustedSecurity& security, PriceEdit& edit, std::int16_t AdjRecNo,
                     const Adjustment& adjustment);
inline constexpr std::string_view kFileChanged =
    "The price file was changed by another program. Check the date again.";

// ---- Taking an adjustment out again

// The numbers of the records with a stamp, from record 2 on, in order. Error 9 for more than 20.
std::vector<std::int16_t> StampedRecords(std::span<const PriceRec> records);

// Takes the latest stamp's factor F out of its record and all earlier ones, by (1 - F) / F + 1, to
// 4 decimals, and clears the stamp. No record is passed over, and volumes stay. Returns how many
// stamps there were before, 0 where nothing was done. Error 9 as above, 6 as ScaledPrice.
int RemoveLatestAdjustment(std::span<PriceRec> records);

// The same for a price file, under the home's lock: done as a whole or not at all.
int RemoveAdjustment(const Files& files, const std::string& priceFile);

}  // namespace kora
