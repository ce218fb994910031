#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "store/price_rec.h"

namespace kora {

// The title over messages of a chart that was not drawn.
inline constexpr std::string_view kChartDisplay = "Chart Display";

// Ends a composition with a message of its own; nothing went wrong with the machine.
struct ChartRefusal {
  std::string text;
  std::string_view title;
};

// What a chart was at when it failed.
struct ChartFailure {
  std::string file = {};  // "ORE.WDT"
  std::int16_t RecType = 0;
  std::int16_t record = 0;  // the record being read; 0 when none was in progress
  std::string date = {};    // of that record, or of the bar being drawn
  std::string font = {};    // that the surface had; empty for none
};

// The date of a record for the message; empty where there is no record (0) or it can't be read.
std::string DateForMessage(const PriceFile& file, std::int16_t record);

// The message for run-time failure `number`, whose own text is `detail`.
std::string ChartFailureText(int number, const std::string& detail, const ChartFailure& at);

}  // namespace kora
