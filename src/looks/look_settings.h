#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "settings/settings.h"
#include "store/name_file.h"

// The small values of the look of charts: what each of their forms takes, refuses and keeps.
//
// A save writes the key and sets the value that this run goes by. A key that can't be written
// is passed over: the value then holds for this run. Saves that take what was typed return
// false, with nothing changed, where it is refused; the form then shows the message.

namespace kora {

// Printed weight of lines: 1 to 10; 2 stands in for any other.
inline constexpr std::int16_t kLeastLineWidth = 1, kMostLineWidth = 10;
std::int16_t PrintedLineWidth(const Settings& settings);
void SaveLineWidth(SettingsFile& ini, Settings& settings, std::int16_t width);

// Volume height, held to 1 to 3.
void SaveVHeight(SettingsFile& ini, Settings& settings, std::int16_t height);

// Bars between vertical grid lines, 0 to 100; at 0 the lines move with the dates. And the
// intermediate horizontal lines.
inline constexpr std::string_view kGridSpaceMessage = "Value must be between 0 and 100";
inline constexpr std::string_view kGridSpaceTitle = "Grid Line Spacing";
bool SaveGridSpacing(SettingsFile& ini, Settings& settings, std::string_view space, bool midGrid);

// Chart units kept free behind the last bar, 1 to 150; and days to a week, by the step of a
// slider: 4 at step 1, 5.25 at step 26. The last step is kept, though the next start takes a
// week of more than 5.2 days for a wrong one.
inline constexpr std::string_view kBlankSpaceMessage = "Value must be between 1 and 150";
inline constexpr std::string_view kBlankSpaceTitle = "Blank Spaces";
inline constexpr int kWeekSteps = 26;
double WeekFactorOfStep(int step);
int StepOfWeekFactor(double weekFactor);  // the nearest step
bool SaveBlankSpace(SettingsFile& ini, Settings& settings, std::string_view space, int weekStep);

// Units from bar to bar, 1 to 20; candlesticks need 3.
inline constexpr std::int16_t kMostSpacing = 20;
std::int16_t LeastSpacing(Style chartStyle);
void SaveSpacing(SettingsFile& ini, Settings& settings, std::int16_t spacing);

// The standard face for both, at these sizes.
void SaveNoFonts(SettingsFile& ini, Settings& settings, double titlePoints, double labelPoints);

struct FontChoice {
  std::string name;  // empty: none chosen
  double points = 0;
};
inline constexpr std::string_view kFontsMessage = "Both fonts must be selected.";
bool SaveFonts(SettingsFile& ini, Settings& settings, const FontChoice& first,
               const FontChoice& second);

// Size of forms with tables, percent.
inline constexpr std::int16_t kLeastZoom = 50, kMostZoom = 200;
void SaveZoom(SettingsFile& ini, Settings& settings, std::int16_t percent);

// A date as a user types it, "9/4/95", as "yyyymmdd".
inline constexpr std::string_view kDateMessage =
    "Date must be entered as d/m/yy eg. 9/4/95 or 29/9/95";
inline constexpr std::string_view kDateTitle = "Date";
std::optional<std::string> ReadFinishDate(std::string_view typed);
// The same back: "d/m/yy", or "dd/mm/yyyy" for a year that two digits do not tell. Empty for
// what is no date.
std::string FinishDateText(std::string_view yyyymmdd);

// Manual scale and point-and-figure box of the current security, written into its record at
// once. Texts are numbers by their leading part; a blank one is 0, for none. Error 6 for one that
// no price can be, otherwise those of RewriteCurrentName; nothing is changed then.
void SaveScales(const Files& files, const std::string& dataPath, CurrentName& current,
                std::string_view base, std::string_view top, std::string_view pfInc);
// What stands in such a box: empty for 0.
std::string ScaleText(float value);

// Told where a name record can't be written.
inline constexpr std::string_view kNotSavedMessage = "Unable to save data";
inline constexpr std::string_view kNotSavedTitle = "Saving Data";
// What is told of a failure: kNotSavedMessage, or who else writes the store.
std::string NotSavedText(const RunTimeError& error);

}  // namespace kora
