#pragma once

#include <string>
#include <vector>

#include "store/name_rec.h"
#include "tests/support/temp_home.h"

namespace kora::test {

// A small market that never changes, for scripts that are held byte for byte: SHARE (dollars,
// adjustments, halts, days with a close alone), PENNY (under 20 cents), INDEX, ADVDEC (a series
// that goes below zero), FUND (close with volume), WRAP (whose point-and-figure columns fill
// a narrow frame twice over), BLUE (700 dollars, millions a day), HEIGHT (an index of 24,000) and AGES
// (more than twenty years).
class GoldenMarket {
 public:
  GoldenMarket();
  TempHome& home() { return home_; }
  const NameRec& name(const std::string& code) const;

 private:
  void Add(const char* code, const char* title, std::int16_t type, float start, float step,
           int days, std::uint32_t seed, int firstYear = 2021, std::int32_t lot = 1);
  void AddWrap();
  TempHome home_;
  std::vector<NameRec> names_;
};

}  // namespace kora::test
