#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "scans/oscillator_tests.h"
#include "scans/scan_filter.h"
#include "settings/settings.h"
#include "store/market_walk.h"

// Chart Scan 1: securities that moved by a percentage on their last day, or whose oscillators gave
// a signal on it. It works on daily data.

namespace kora {

// The oscillators in the order of their columns.
enum ScanOscillator : size_t { kStochastic, kWilliams, kRoc, kMomentum, kRsi, kScanOscillators };
std::string_view ScanOscillatorName(size_t oscillator);  // "Stochastic", "Williams %R", ...

// The selections as they stand in the form `chtScan1`.
struct Scan1Choices {
  bool Check7 = false;  // by closing price range
  std::string Text3 = "0.50", Text2 = "5.00";
  bool Check1 = false;  // percentage rise
  std::string Text1;
  bool Check15 = false;  // percentage fall
  std::string Text6;
  bool Check8 = false;  // category
  std::string Text4;
  bool Check14 = false;  // industry class
  std::string Text5;
  bool Check16 = false;                              // no warrants
  std::array<bool, kScanOscillators> oscillators{};  // Check2, 3, 5, 6, 13
  bool Check9 = false, Check12 = false;              // OB, cut OB
  bool Check10 = false, Check11 = false;             // OS, cut OS
};

// What a scan looks for.
struct Scan1Criteria {
  std::optional<ClosingRange> range;
  std::optional<std::int16_t> rise, fall;  // percent
  std::string riseText, fallText;          // as given
  SecurityFilter filter;
  std::array<std::int16_t, kScanOscillators> periods{};  // 0: not ticked
  SignalBoxes boxes;
};
// Reads the choices; what stands against them otherwise, the first of them. Periods are the
// daily ones of the chart defaults; Momentum is worked over that of ROC.
std::optional<ScanFault> ReadScan1(const Scan1Choices& choices, const OscSettings& osc,
                                   Scan1Criteria& criteria);

// The choices as the per-user store keeps them: "Scan1_Other". Reading leaves what the text lacks.
std::string KeptScan1(const Scan1Choices& choices);
void TakeKeptScan1(std::string_view text, Scan1Choices& choices);

struct Scan1Hit {
  std::string code;
  float last = 0;
  std::string percent;  // "12%U", "-3%D"; empty for no hit
  std::array<Signal, kScanOscillators> signals{};
  std::int32_t record = 0;  // in the name file

  bool fell() const { return !percent.empty() && percent.back() == 'D'; }
};
// The cells of a hit: code, price, percent, a signal each, record number.
std::vector<std::string> CellsOf(const Scan1Hit& hit);
// Titles of those columns.
const std::vector<std::string>& Scan1Columns();

// What one security gives, or nothing. `bars` are its last daily bars where an oscillator is
// wanted; `records` the last two of its file, whose `count` records there are.
std::optional<Scan1Hit> TestSecurity(const Scan1Criteria& criteria, const MarketItem& item,
                                     ChartBars& bars);

struct Scan1Result {
  std::vector<Scan1Hit> hits;  // in the order of the name file
  std::string latest;          // latest date of all that was looked at, "yyyymmdd", or empty
  UnreadFiles unread;
  bool stopped = false;
};
// Walks the market. `found` sees each hit as it comes. A stop keeps the hits so far. Errors of
// MarketWalk.
Scan1Result RunScan1(const ScanRun& run, const Scan1Criteria& criteria,
                     const std::function<void(const Scan1Hit&)>& found = {});

// "30/10/2026", "05/9/1998" of a file date; empty for none.
std::string LatestText(std::string_view yyyymmdd);

// The closing message, under kScan1Title.
inline constexpr std::string_view kScan1Title = " Chart Scan";
std::string Scan1Ending(const Scan1Criteria& criteria, bool hits);

// SortByPercentage: the order of rows by the text of their percent cells, ascending: places from
// 0. Equal cells may change places.
std::vector<size_t> SortByPercentage(const std::vector<std::string>& percents);

}  // namespace kora
