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

// Chart Scan 2: shares whose last day meets up to three criteria at once: closing price, increase
// in volume, change of price.

namespace kora {

// The selections as they stand in the form `ChtScan2`.
struct Scan2Choices {
  bool Check1 = false;  // by closing price range
  std::string Text1 = "0.005", Text2 = "1.00";
  bool Check2 = false;  // by increases in volume
  std::string Text3 = "600", Text5;
  bool Check3 = false;  // by +/- in price %
  std::string Text4;
  bool Check4 = false;  // industry class
  std::string Text6;
  bool Check5 = false;  // no warrants
};

struct Scan2Criteria {
  std::optional<ClosingRange> range;  // "A"
  std::optional<double> volume;       // "B", percent
  std::int16_t days = 0;              // of the average volume
  std::optional<double> price;        // "C", percent
  SecurityFilter filter;
};
// Reads the choices; what stands against them otherwise, the first of them.
std::optional<ScanFault> ReadScan2(const Scan2Choices& choices, Scan2Criteria& criteria);

// The choices as the per-user store keeps them: "Scan2_Other".
std::string KeptScan2(const Scan2Choices& choices);
void TakeKeptScan2(std::string_view text, Scan2Choices& choices);

struct Scan2Hit {
  std::string code, indClass, name;  // trimmed; ANSI
  float last = 0;
  double volume = 0;    // Vol+: the last volume above what was asked for; 0 none
  std::string percent;  // "12%"; empty where the price was not asked for
  std::int32_t record = 0;
};
// Code, price, Vol+ (a blank for 0), percent.
std::vector<std::string> CellsOf(const Scan2Hit& hit);
const std::vector<std::string>& Scan2Columns();

// The mean volume of the k days before the last, `volumes` being those of a file's end, the last
// day's at the back, `count` the records of the file: the sum of k + 1 days divided by k, rounded half
// to even. k is `days`, 1 where the file is too short for that; 0 where it is too short for 1 as well.
// 1 for 0 days.
double AverageVolume(std::span<const PriceRec> records, std::int32_t count, std::int16_t days);

std::optional<Scan2Hit> TestSecurity(const Scan2Criteria& criteria, const MarketItem& item);

struct Scan2Result {
  std::vector<Scan2Hit> hits;
  UnreadFiles unread;
  bool stopped = false;
};
Scan2Result RunScan2(const ScanRun& run, const Scan2Criteria& criteria,
                     const std::function<void(const Scan2Hit&)>& found = {});

// Stores the hits: the list of results and ChtScan2.txt in the data folder, "code,class,price,name"
// a line, both replaced together. A failure leaves both as they were.
void SaveScan2(const Files& files, const std::string& dataPath, const std::vector<Scan2Hit>& hits);

inline constexpr std::string_view kScan2Title = " Chart Scan 2";
std::string Scan2Ending(bool hits);

// The hits on paper, two on a line.
TextTable Scan2Print(const std::vector<Scan2Hit>& hits);

}  // namespace kora
