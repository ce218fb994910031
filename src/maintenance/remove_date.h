#pragma once

#include <cstdint>
#include <string>

#include "base/files.h"
#include "settings/settings.h"

// One date taken out of every price file of a folder: what stands behind the form `RemDate`.

namespace kora {

class Dialogs;
class Progress;

enum class RemoveDateBox { kNone, kFolder, kDate };

struct RemovedDate {
  bool done = false;  // the folder was gone through, or stopped by the user
  bool stopped = false;
  std::int32_t files = 0;    // that were changed
  std::int32_t records = 0;  // that were removed
  std::string last;          // the code that was gone through last
};

// Takes the date (d/m/yy) out of the price files of all names of the folder, every record of it or
// the latest of each file alone. A folder that is there becomes the data folder of the whole
// program, even when the date is refused then. An empty folder or date leads back to its box.
//
// Files are put in place whole, some tens at a time; where the user stops it, or a failure does,
// those in front of the place told are done and the others as they were. A file without the date
// stays as it is. `progress` shows the security in hand as kState.
RemovedDate RemoveDate(const Files& files, Settings& settings, const std::string& folder,
                       const std::string& date, bool latestOnly, Progress& progress,
                       Dialogs& dialogs, RemoveDateBox& focus);

}  // namespace kora
