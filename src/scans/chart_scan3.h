#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "lists/text_print_out.h"
#include "scans/scan_filter.h"
#include "store/market_walk.h"

// Chart Scan 3: shares whose parabolic stop changed side in their last three records.

namespace kora {

// The selections as they stand in the form `ChtScan3`.
struct Scan3Choices {
  bool Check1 = false;  // by closing price range
  std::string Text1 = "0.005", Text2 = "1.00";
  bool Check2 = false;  // category
  std::string Text3;
  bool Check4 = false;  // industry class
  std::string Text6;
  bool Check3 = false;  // look for break UP
  bool Check5 = false;  // look for break DOWN
  bool Check6 = false;  // no warrants
};

struct Scan3Criteria {
  std::optional<ClosingRange> range;
  SecurityFilter filter;
  bool up = false, down = false;
};
std::optional<ScanFault> ReadScan3(const Scan3Choices& choices, Scan3Criteria& criteria);

// The choices as the per-user store keeps them: "Scan3_Other".
std::string KeptScan3(const Scan3Choices& choices);
void TakeKeptScan3(std::string_view text, Scan3Choices& choices);

enum class Break { kNone, kUp, kDown };
std::string_view BreakText(Break side);  // "UP", "DOWN", empty

// FindBreak: the side that the parabolic stop came to within the last three records, if it changed.
//
//   stop = (target - stop) * factor + stop
//
// - `records` are the last 101 of the file, or all of them; the first has the number `first`.
//   Prices are numbers.
// - The first side is found as four new highs, or lows, without more than one of the other kind.
//   A record that makes both is a low; record 1 of the file counts and decides nothing.
// - The stop starts at the last extreme of the other side. It follows the High of each record while
//   below the price, the Low while above, by a factor that grows by 0.02 from 0 while it is below 0.18;
//   all of it in 32-bit floats.
// - Of the last three records those note their side whose stop is above 0 and was not turned by its
//   own move. No note, or three of one side, is no break; otherwise the last note is the side.
Break FindBreak(std::span<const PriceRec> records, std::int32_t first);

struct Scan3Hit {
  std::string code;
  float last = 0;
  Break side = Break::kNone;
  std::int32_t record = 0;
};
std::vector<std::string> CellsOf(const Scan3Hit& hit);  // code, price, "UP" or "DOWN"
const std::vector<std::string>& Scan3Columns();

struct Scan3Result {
  std::vector<Scan3Hit> hits;
  UnreadFiles unread;
  bool stopped = false;
};
Scan3Result RunScan3(const ScanRun& run, const Scan3Criteria& criteria,
                     const std::function<void(const Scan3Hit&)>& found = {});

inline constexpr std::string_view kScan3Title = " Chart Scan 3";
std::string Scan3Ending(bool hits);

// The hits on paper, two on a line.
TextTable Scan3Print(const std::vector<Scan3Hit>& hits);

}  // namespace kora
