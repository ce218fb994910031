#pragma once

#include <vector>

#include "store/price_rec.h"
#include "tests/support/temp_home.h"

namespace kora::bench {

// `count` records without prices, dated the trading days from 1 January of `year` on.
std::vector<PriceRec> TradingDays(int year, int count);

// A home in the temporary folder with one security, BENCH, of `records` trading days.
struct Home : test::TempHome {
  explicit Home(int records);
};

}  // namespace kora::bench
