#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "base/files.h"
#include "platform/progress.h"
#include "settings/settings.h"

// The bulletins that come with a day's prices, and how their lines get onto the adjustment list.

namespace kora {

// Told behind an update that added lines.
inline constexpr std::string_view kAdjustListGrew =
    "There have been maintenance items added to the Adjustment List";
inline constexpr std::string_view kAdjustListGrewTitle = "Adjustment List";

// What decides over a line.
struct BulletinRules {
  std::string baseName;  // stands for the market of shares
  bool OptionsFolderOK = false;
  bool NoWarrants = false;
  bool NoShortNames = false;
  std::int16_t Divs = 3;  // dividends: 1 left out, 2 marked Y, 4 marked D, otherwise as they come
};

// A line of a bulletin as the list takes it, or nothing where it is left out. ANSI.
std::optional<std::string> MergeBulletinLine(std::string_view line, const BulletinRules& rules);

// Takes the bulletins of `baseName` ("15SEP98") that were not taken yet from the download-in
// folder into Adjust.Lst of the folder `path`, and copies each to the download-out folder, which
// marks it as taken. List and copy change together. Adds the number of new lines to `added`. What
// fails is raised, with the bulletin in hand as it was, to be taken the next time.
//
// Its progress is a line kNote, empty again at the end.
void MergeBulletins(const Files& files, const Settings& settings, const std::string& path,
                    const std::string& baseName, Progress& progress, int& added);

// The same behind an update, which goes on without a word where it fails. Returns the number of
// lines added.
int CheckBulletins(const Files& files, const Settings& settings, const std::string& path,
                   const std::string& baseName, Progress& progress);

}  // namespace kora
