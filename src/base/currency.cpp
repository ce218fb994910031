#include "base/currency.h"

#include <cmath>
#include <limits>

#include "base/runtime_error.h"

namespace kora {

Currency::Currency(double value) {
  const double scaled = std::nearbyint(value * 10000.0);
  if (!(scaled >= -9223372036854775808.0 && scaled < 9223372036854775808.0))
    throw RunTimeError(kOverflow);
  units_ = static_cast<std::int64_t>(scaled);
}

Currency& Currency::operator+=(Currency other) {
  const std::int64_t b = other.units_;
  const auto max = std::numeric_limits<std::int64_t>::max();
  const auto min = std::numeric_limits<std::int64_t>::min();
  if ((b > 0 && units_ > max - b) || (b < 0 && units_ < min - b)) throw RunTimeError(kOverflow);
  units_ += b;
  return *this;
}

}  // namespace kora
