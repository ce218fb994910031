#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "base/runtime_error.h"
#include "store/name_rec.h"
#include "store/price_rec.h"
#include "tests/support/error_of.h"

namespace kora::test {

inline PriceRec Day(std::string_view date, float open, float high, float low, float close,
                    std::int32_t volume = 0, float adjFactor = 0) {
  PriceRec rec = NewPriceRec(date);
  rec.Open = open;
  rec.High = high;
  rec.Low = low;
  rec.Close = close;
  rec.Volume = volume;
  rec.AdjFactor = adjFactor;
  return rec;
}

inline NameRec Security(std::string_view code, std::int16_t category = 1,
                        std::int16_t recType = kShare, std::string_view indClass = "") {
  NameRec rec = NewNameRec(code);
  rec.Category = category;
  rec.RecType = recType;
  rec.IndClass.set(indClass);
  return rec;
}

template <typename T>
std::string Bytes(const std::vector<T>& records) {
  return std::string(reinterpret_cast<const char*>(records.data()), records.size() * sizeof(T));
}

}  // namespace kora::test
