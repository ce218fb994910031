#pragma once

#include <array>
#include <cstddef>
#include <string>
#include <string_view>

#include "base/files.h"

// The folders that the files of the whole market go to, a kind of security a folder:
// WMPaths.lst of the program folder, a value a line.

namespace kora {

enum WmLine : size_t {
  kWmAsx = 0,  // all ASX, or Top 500 and 150
  kWmIndices = 1,
  kWmFutures = 2,
  kWmOverseas = 3,
  kWmOptions = 4,
  kWmChosen = 5,  // no path: 0 to 5, which folder to view charts from
  kWmSum = 6,     // extra stocks
};
using WmPaths = std::array<std::string, 7>;

std::string WmPathsFile(const std::string& systemPath);
// Lines that are not there, or a file that can't be read, are empty.
WmPaths ReadWmPaths(const Files& files, const std::string& systemPath);
void WriteWmPaths(const Files& files, const std::string& systemPath, const WmPaths& lines);
// True when all six folders are there, trimmed.
bool WmPathsComplete(const WmPaths& lines);
// Told where they are not.
inline constexpr std::string_view kNoMarketFolders =
    "Separate destination directories for Whole Market data have not been defined. Select Paths "
    "option and define ALL data directories.";
inline constexpr std::string_view kNoMarketFoldersTitle = "W/M Paths";
// The folder that line 6 chooses; empty when it is no number from 0 to 5.
std::string WmChosenFolder(const WmPaths& lines);

}  // namespace kora
