#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "base/currency.h"
#include "base/runtime_error.h"
#include "lists/text_print_out.h"
#include "scans/scan_filter.h"
#include "store/market_walk.h"

// Market statistics: the last two closes of each security, the largest rises and falls, and the
// counts of the day.

namespace kora {

enum class StatsMode { kAll, kThree, kNoWarrants, kWarrantsOnly };  // Option1 of `Statistics`
struct StatsModeEntry {
  StatsMode mode;
  std::string_view word;     // "ALL", "3", "NW", "WO"
  std::string_view caption;  // "Check ALL stocks"
};
std::span<const StatsModeEntry> StatsModes();
std::optional<StatsMode> StatsModeOf(std::string_view word);
// All; codes of exactly 3 characters; of less than 6; of exactly 6.
bool StatsWants(StatsMode mode, std::string_view code);

// How many to show: 20 for an empty text; none below 1.
std::int32_t StatsTop(std::string_view typed);

struct Mover {
  std::string code;  // trimmed; ANSI
  float latest = 0, previous = 0;
  Currency change;  // a fraction of `previous`: 0.1234 is 12.34 percent
};

struct StatsCounts {
  std::int32_t Rises = 0, Falls = 0, Steady = 0, Traded = 0, Untraded = 0;
};

// Counts one security with the last two records of its file; the mover where it moved. The change
// is a 32-bit float held in four decimals; one that is 0 there, that has no price before it or
// leaves its range makes no mover.
std::optional<Mover> CountSecurity(std::string_view code, const PriceRec& before,
                                   const PriceRec& last, StatsCounts& counts);

// SortStats: the largest rise first, the largest fall last. Equal changes may change places.
void SortStats(std::vector<Mover>& movers);

// One side of a row.
struct StatsCell {
  std::string code, name, indClass, latest, previous, percent;  // ANSI

  friend bool operator==(const StatsCell&, const StatsCell&) = default;
};
struct StatsRow {
  StatsCell rise, fall;

  friend bool operator==(const StatsRow&, const StatsRow&) = default;
};
struct MarketStats {
  std::vector<StatsRow> rows;
  StatsCounts counts;
  UnreadFiles unread;
  bool stopped = false;
};

// ShowStats: walks the market and fills `top` rows, as far as there are movers: rises from the top of
// the one sorted table, falls from its bottom. On a day without enough of one kind its rows go on
// with the other. Names and classes are those of the first record of a code. A run that was
// stopped has counts and no rows. Progress is shown what is done: "Checking Statistics",
// "SORTING STATISTICS", "COMPLETED". Errors of MarketWalk; 53 where there is no name file.
MarketStats ShowStats(const ScanRun& run, StatsMode mode, std::int32_t top);

// Title of what is told; kNoNameFile where there is none.
inline constexpr std::string_view kStatsTitle = "Statistics";
inline constexpr std::string_view kNoNameFile = "There is no Name File ";
// By the number of the error, under "Error".
std::string StatsErrorText(const RunTimeError& error);

// ---- The grid: twelve columns, the rows, a blank one and the counts below them

const std::vector<std::string>& StatsColumns();
std::vector<std::vector<std::string>> StatsTexts(const MarketStats& statistics);

// Stats.dat in the data folder: those texts as the last update left them, a line a row, its
// cells between tabs.
void KeepStats(const Files& files, const std::string& dataPath,
               const std::vector<std::vector<std::string>>& texts);
// Empty where there are none. A file of more than 4 MB, or one that can't be read, has none.
std::vector<std::vector<std::string>> KeptStats(const Files& files, const std::string& dataPath);

// On paper; `date` is today's.
TextTable StatsPrint(const std::vector<std::vector<std::string>>& texts, std::string_view date);

}  // namespace kora
