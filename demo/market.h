#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "base/dates.h"
#include "demo/names.h"
#include "demo/random.h"
#include "store/price_rec.h"

namespace kora::demo {

// The days of the market: the history, then those whose prices wait in download files.
struct Days {
  Days(int years, int waitingDays);

  std::vector<CalendarDate> dates;
  std::vector<std::string> texts;     // "yyyymmdd"
  std::vector<std::int32_t> numbers;  // day numbers
  int history;                        // how many of them are history

  int count() const { return int(dates.size()); }
};

// What moves all shares alike, a return for each day.
struct Factors {
  std::vector<double> market;
  std::array<std::vector<double>, kSectors> sector;
};
Factors MakeFactors(const Days& days, std::uint64_t seed);

// Prices from day `first` on, one record a day without a gap, up to the last day or to where the
// security ends. Adjustments are marked and the records before them rescaled.
struct Series {
  int first = 0;
  std::vector<PriceRec> records;

  int last() const { return first + int(records.size()) - 1; }
};

enum class Tier { kLeader, kMiddle, kSmall, kPenny };

// The first adjustment of a share where one is wanted, beside those that chance brings.
enum class Planned { kNone, kBonus, kSplit, kCash };

struct ShareProfile {
  Tier tier = Tier::kMiddle;
  int sector = 0;
  int first = 0;
  int last = 0;  // last day; before the market's last for a share no longer quoted
  Planned planned = Planned::kNone;
  double startPrice = 1;
  double issued = 1e6;  // shares on issue at the start
};
ShareProfile MakeProfile(int index, int shares, const Days& days, Random& random);
Series SimulateShare(const ShareProfile& share, const Factors& factors, const Days& days,
                     Random& random);

// The market's own sums, from which indices and the advance/decline series are made.
class MarketSums {
 public:
  explicit MarketSums(int days);
  void Add(const ShareProfile& share, const Series& series);

  // Of one sector, or of all shares where `sector` is -1; 1000 points on the first day. The
  // sector must have had a share on every day.
  Series Index(int sector, const Days& days) const;
  Series AdvanceDecline(const Days& days) const;

 private:
  struct Sums {
    std::vector<double> before, open, high, low, close, volume;
  };
  static void AddDay(Sums& sums, int day, double units, const PriceRec& last, const PriceRec& now);
  Series MakeIndex(const Sums& sums, const Days& days) const;

  Sums all_;
  std::array<Sums, kSectors> sectors_;
  std::vector<int> rises_, falls_;
};

// A right to buy or to sell a share at a price, until a day.
struct Right {
  bool call = true;
  double strike = 1;
  std::int32_t expiry = 0;  // day number
  double ratio = 1;         // rights to a share
};
// From day `first` to the expiry or to the last day.
Series SimulateRight(const Right& right, const Series& share, int first, const Days& days,
                     Random& random);

// A managed fund: close with volume, following the index.
Series SimulateFund(const Series& index, const Days& days, Random& random);
// An interest rate: close only.
Series SimulateRate(const Days& days, Random& random);

// The smallest price step: thousandths of a dollar for a price in thousandths.
int TickOf(int thousandths);
// The nearest price of at least one step.
int ToThousandths(double price);
float FromThousandths(int thousandths);

}  // namespace kora::demo
