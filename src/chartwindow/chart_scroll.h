#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "chart/chart_state.h"
#include "platform/dialogs.h"
#include "settings/settings.h"
#include "store/name_file.h"

namespace kora {

// What the scroll bar works with. Nothing is owned.
struct ChartScrollServices {
  const Files& files;
  Dialogs& dialogs;
  const Settings& settings;
  const CurrentName& current;
  ChartState& state;
};

// The scroll bar that sets where a chart ends: a place for each record of the price file of the
// chart on show, from 1 to the last. It remembers file and place of its last use.
class ChartScroll {
 public:
  explicit ChartScroll(const ChartScrollServices& services) : services_(services) {}

  // Makes it ready for the file of the chart on show. False, with the message, when that has 100
  // records or fewer, and when it can't be read.
  bool SetScrollBar();

  std::int32_t Maximum() const { return std::int32_t(RecDates_.size()); }  // DataFileRecs
  std::int32_t Value() const { return value_; }
  // Held to 1 and the maximum.
  void SetValue(std::int32_t value);
  // The date at the value, "d/m/yy".
  std::string DateText() const;

  // The chart ends at the date of the value; at the last record the limit goes.
  void Accept();
  // The chart window was closed: the next use begins at the end.
  void Forget();

 private:
  ChartScrollServices services_;
  std::vector<std::int32_t> RecDates_;  // "yyyymmdd" of each record
  std::int32_t value_ = 1;
  std::string ScrollFile_;
  std::int32_t ScrollPos_ = 1;
};

}  // namespace kora
