#pragma once

#include <functional>
#include <string>
#include <string_view>

#include "base/files.h"
#include "platform/dialogs.h"
#include "settings/settings.h"
#include "store/name_file.h"
#include "update/download_list.h"

namespace kora {

class Clock;

// What an update works with.
struct UpdateRun {
  const Files& files;
  Settings& settings;    // a whole-market run leaves CurrentDataPath on the folder chosen
  CurrentName& current;  // Rec drives the write of files whose codes are not looked up
  Dialogs& dialogs;
  const Clock& clock;
  Progress& display;  // gets all five lines
  // Merges the bulletins of services 1 and 3 at the end of a day: the folder of Adjust.Lst and
  // the last 7 characters of the base name, empty in service 1.
  std::function<void(const std::string& path, const std::string& baseName)> CheckBulletins = {};
  // Changes of about so many bytes are held in memory before they are made, as one.
  size_t mostHeld = 32u << 20;
};

enum class UpdateEnd {
  kUpdated,
  kUpdatedInPart,  // off the list; told what was left out of it
  kAbandoned,      // told; some or all of the day's files were not taken
  kNotBegun,       // told; the file is not there, service 3 lacks a folder, or another program
                   // writes the store: the form stays
  kStopped,        // by the user, or by a failure that was told: the file in hand waits as before
};
// Whether the entry is off the list.
inline bool IsTaken(UpdateEnd end) {
  return end == UpdateEnd::kUpdated || end == UpdateEnd::kUpdatedInPart;
}

// Update 1 Day: takes in the entry at `selected` and, unless it was abandoned, takes it off the
// list.
//
// A line that can't be taken refuses its file before anything is written. The day is worked out
// in memory, written to a journal (Update.Jnl of the program folder) and then made; it is on the
// disk before the downloaded file leaves the list. A run that is stopped or fails leaves a file
// as it was; one that dies is finished by the next run, whatever that takes in, in the mode in
// which it began.
//
// Securities that can't take the day (a full price file, a full name file) are left out, and the
// rest is taken. What was refused, left out or misread is told in one message at the end.
UpdateEnd UpdateOneDay(const UpdateRun& run, DownloadEntries& entries, size_t selected);

// Update All: every entry in the order of the list, which stays as it was. A file that is
// abandoned does not end the run. `select` is told each entry's place before it is taken in.
UpdateEnd UpdateAllDays(const UpdateRun& run, const DownloadEntries& entries,
                        const std::function<void(size_t)>& select = {});

}  // namespace kora
