#pragma once

#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "platform/dialogs.h"
#include "settings/settings.h"

// What the settings box of an oscillator shows, takes and refuses. Its values hold for this run;
// they are kept beyond it by the chart defaults alone.

namespace kora {

struct OscField {
  const char* label;
  PeriodPair OscSettings::*value;
  bool average;  // may be 0, which draws no average
};

// The box of one oscillator.
struct OscBox {
  const char* code;
  const char* caption;
  std::span<const OscField> fields;
  bool compares;  // the compare file is asked for too, as the last field
};
inline constexpr const char* kCompareLabel = "Compare to:";

// The box of an oscillator code; null for one that has no settings.
const OscBox* FindOscBox(std::string_view oscCode);

// Gives every period that is zero its default, for the chart period on show only: the twin
// stays as it is until a chart of its period is on show.
void FillOscDefaults(OscSettings& osc, const std::string& chartPeriod);

inline constexpr int kMostOscPeriod = 200;
inline constexpr std::string_view kOscPeriodMessage = " Periods must be between 1 - 200 ";
inline constexpr std::string_view kOscPeriodTitle = "Oscillator Values";

// Reads the typed fields, one text each, into the periods of the chart period on show. False,
// with nothing changed and `refused` the number of the field from 0, where one is not within 1
// to 200, an average not within 0 to 200.
bool ReadOscFields(const OscBox& box, std::span<const std::string> typed,
                   const std::string& chartPeriod, OscSettings& osc, size_t& refused);

// The first test of the compare file that stands in the box.
enum class CompareFileAnswer { kThere, kCorrect, kGiveUp };
// A file that is missing is told with OK, to correct it, and Cancel, to give the box up.
CompareFileAnswer TestCompareFile(const Files& files, Dialogs& dialogs, std::string_view typed);

// The box value of a point-and-figure chart, told with the message where there is none.
inline constexpr std::string_view kBoxValueTitle = "Box Value";
std::optional<float> ReadBoxValue(Dialogs& dialogs, std::string_view typed);

}  // namespace kora
