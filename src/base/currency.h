#pragma once

#include <cstdint>

namespace kora {

// An amount with exactly four decimals in 64 bits.
class Currency {
 public:
  constexpr Currency() = default;
  // Rounded half to even to four decimals. Error 6 out of range.
  explicit Currency(double value);
  static constexpr Currency FromWhole(std::int32_t value) {
    return FromUnits(std::int64_t(value) * 10000);
  }
  static constexpr Currency FromUnits(std::int64_t tenThousandths) {
    Currency c;
    c.units_ = tenThousandths;
    return c;
  }

  constexpr std::int64_t units() const { return units_; }
  double ToDouble() const { return double(units_) / 10000.0; }

  // Error 6 when the sum leaves 64 bits.
  Currency& operator+=(Currency other);
  friend constexpr bool operator==(Currency, Currency) = default;

 private:
  std::int64_t units_ = 0;
};

}  // namespace kora
