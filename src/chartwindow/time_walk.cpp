#include "chartwindow/time_walk.h"

#include <algorithm>
#include <string>

#include "base/dates.h"
#include "base/numbers.h"

namespace kora {
namespace {

std::optional<CalendarDate> DateOf(std::int32_t yyyymmdd) {
  return ParseFileDate(Format(double(yyyymmdd), "00000000"));
}

// Records of one bar have the same key. Weeks begin on Sunday.
std::int32_t BarKey(std::int32_t yyyymmdd, Period period) {
  if (period == Period::kMonthly) return yyyymmdd / 100;
  const auto date = DateOf(yyyymmdd);
  return date ? DayNumber(*date) - Weekday(*date) : 0;
}

// From the last record of a bar to that of the next one, or of the one before.
std::int32_t NextBar(std::span<const std::int32_t> dates, Period period, std::int32_t at,
                     bool later) {
  const auto count = std::int32_t(dates.size());
  const auto key = [&](std::int32_t record) { return BarKey(dates[size_t(record) - 1], period); };
  const auto toEnd = [&](std::int32_t record) {
    const std::int32_t bar = key(record);
    while (record < count && key(record + 1) == bar) ++record;
    return record;
  };
  if (later) return toEnd(std::min(toEnd(at) + 1, count));
  const std::int32_t bar = key(at);
  while (at > 1 && key(at) == bar) --at;
  return at;
}

}  // namespace

std::int32_t MovedEnd(std::span<const std::int32_t> dates, Period period, std::int32_t last,
                      std::int32_t wanted, TimeStep step, int by) {
  const auto count = std::int32_t(dates.size());
  if (count == 0) return 0;
  last = std::clamp(last, 1, count);
  const std::int32_t oldest = std::min({last, count, wanted + 1});
  std::int64_t end = last;
  switch (step) {
    case TimeStep::kEnd: end = by < 0 ? 1 : count; break;
    case TimeStep::kWindow: end += std::int64_t(by) * std::max(wanted, 1); break;
    case TimeStep::kBar:
      if (period == Period::kDaily)
        end += by;
      else
        for (int i = 0; i < std::abs(by); ++i)
          end = NextBar(dates, period, std::int32_t(end), by > 0);
      break;
    case TimeStep::kMonth: {
      const auto date = DateOf(dates[size_t(last) - 1]);
      if (!date) return last;
      const std::int32_t target = CLng(Val(FormatFileDate(AddMonths(*date, by))));
      end = std::upper_bound(dates.begin(), dates.end(), target) - dates.begin();
      // A month without a record is a record.
      end = by < 0 ? std::min<std::int64_t>(end, last - 1) : std::max<std::int64_t>(end, last + 1);
      break;
    }
  }
  return std::int32_t(std::clamp<std::int64_t>(end, oldest, count));
}

}  // namespace kora
