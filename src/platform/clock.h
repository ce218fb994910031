#pragma once

#include "base/dates.h"

namespace kora {

class Clock {
 public:
  virtual ~Clock() = default;
  virtual CalendarDate Today() const = 0;
};

// The machine's clock, local time.
const Clock& MachineClock();

}  // namespace kora
