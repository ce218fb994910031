#include "platform/clock.h"

#include <ctime>

namespace kora {
namespace {

class LocalClock : public Clock {
 public:
  CalendarDate Today() const override {
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    return {local.tm_year + 1900, local.tm_mon + 1, local.tm_mday};
  }
};

}  // namespace

const Clock& MachineClock() {
  static const LocalClock clock;
  return clock;
}

}  // namespace kora
