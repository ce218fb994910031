#pragma once

#include <vector>

#include "base/dates.h"

namespace kora::demo {

// True on weekdays that are no holiday of the invented exchange: New Year's Day and 26 January
// (moved to Monday from a weekend), Good Friday and Easter Monday, 25 April, the second Monday
// of June, Christmas and Boxing Day (moved behind a weekend).
bool IsTradingDay(const CalendarDate& date);

// The trading days later than `after`, up to `last`.
std::vector<CalendarDate> TradingDays(const CalendarDate& after, const CalendarDate& last);

// The `count` trading days after `date`.
std::vector<CalendarDate> NextTradingDays(const CalendarDate& date, int count);

}  // namespace kora::demo
