#pragma once

#include <string>
#include <vector>

#include "store/name_rec.h"
#include "tests/support/temp_home.h"

namespace kora::test {

// A small market that never changes, for scripts that are held byte for byte: SHARE (dollars,
// adjustments, halts, days with a close alone), PENNY (under 20 cents), INDEX, ADVDEC (a series
// that goes below zero), FUND (close with volume) and WRAP (whose point-and-figure columns fill
// a narrow frame twice over).
class GoldenMarket {
 public:
  GoldenMarket();
  TempHome& home() { return home_; }
  const NameRec& name(const std::string& code) const;

 private:
  void Add(const char* code, const char* title, std::int16_t type, float start, float step,
           int days, std::uint32_t seed);
  void AddWrap();
  TempHome home_;
  std::vector<NameRec> names_;
};

}  // namespace kora::test
