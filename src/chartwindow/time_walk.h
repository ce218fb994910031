#pragma once

#include <cstdint>
#include <span>

#include "settings/style_period.h"

namespace kora {

// How far a window of records moves: a bar of its period, a month of the calendar, its own length,
// or to the end of the data.
enum class TimeStep { kBar, kMonth, kWindow, kEnd };

// The record, from 1, at which a window ends that ended at `last`, moved by so many steps; below 0 to
// earlier ones. It stops where the window shows the first record, and at the last one.
//   dates: "yyyymmdd" of each record; wanted: records that a window spans
std::int32_t MovedEnd(std::span<const std::int32_t> dates, Period period, std::int32_t last,
                      std::int32_t wanted, TimeStep step, int by);

}  // namespace kora
