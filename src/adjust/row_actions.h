#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

#include "adjust/adjust_list.h"
#include "base/file_set.h"
#include "base/files.h"

// What a row of the adjustment list does to a name file and its price files.

namespace kora {

// Where and how the rows of one run work.
struct ActionPlace {
  const Files& files;
  std::string folder;        // Names.dat and price files
  std::string notesFolder;   // chart notes
  std::string systemFolder;  // WMMAIN.OVS of the download service
  bool wholeMarket = false;  // service 3: prices are in cents, tenths of points for "IDX"
  double volumeFactor = 1;   // of the market in general
  double indexVolumeFactor = 1;
  std::int32_t noteColour = 0;  // that chart notes are written with
  std::function<void(std::string_view)> status = {};
};

// Adds to `changes` what the row does: nothing, and false, where its inputs are missing. No file is
// changed yet. Errors are those of reading, 6 for a result that a file can't hold, and 75 for a
// file that is read-only.
bool AddAction(const ActionPlace& place, const AdjustRow& row, FileSet& changes);

}  // namespace kora
