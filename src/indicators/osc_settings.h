#pragma once

#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "indicators/oscillators.h"
#include "platform/dialogs.h"
#include "platform/settings_file.h"
#include "settings/settings.h"

// What the settings box of an oscillator shows, takes and refuses. Its values hold for this run;
// they are kept beyond it by the chart defaults alone.

namespace kora {

// The periods of all oscillators in section OscDef: read, and written as a new installation has
// them.
void ReadOscPeriods(const SettingsFile& ini, OscSettings& osc);
void WriteDefaultOscPeriods(SettingsFile& ini);

// What the field of the compare file is called; it is the last of a box that has one.
inline constexpr const char* kCompareLabel = "Compare to:";

// The oscillator of a code; null for one that has no settings box.
const Oscillator* FindOscBox(std::string_view oscCode);

// Gives every period that is zero its default, for the chart period on show only: the twin
// stays as it is until a chart of its period is on show.
void FillOscDefaults(OscSettings& osc, Period chartPeriod);

inline constexpr int kMostOscPeriod = 200;
inline constexpr std::string_view kOscPeriodMessage = " Periods must be between 1 - 200 ";
inline constexpr std::string_view kOscPeriodTitle = "Oscillator Values";

// Reads the typed fields, one text each, into the periods of the chart period on show. False,
// with nothing changed and `refused` the number of the field from 0, where one is out of its
// range.
bool ReadOscFields(const Oscillator& box, std::span<const std::string> typed, Period chartPeriod,
                   OscSettings& osc, size_t& refused);

// True when the periods that the oscillator is drawn with are in their ranges.
bool PeriodsInRange(const Oscillator& oscillator, const OscSettings& osc, Period chartPeriod);

// The first test of the compare file that stands in the box.
enum class CompareFileAnswer { kThere, kCorrect, kGiveUp };
// A file that is missing is told with OK, to correct it, and Cancel, to give the box up.
CompareFileAnswer TestCompareFile(const Files& files, Dialogs& dialogs, std::string_view typed);

// The box value of a point-and-figure chart, told with the message where there is none.
inline constexpr std::string_view kBoxValueTitle = "Box Value";
std::optional<float> ReadBoxValue(Dialogs& dialogs, std::string_view typed);

}  // namespace kora
