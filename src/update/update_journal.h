#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "base/file_edits.h"
#include "base/files.h"
#include "store/name_rec.h"
#include "update/update_report.h"

// A day of the update is planned in memory, written down in a journal, and then made. So a run
// that dies is finished by the next one, in the mode in which it began.

namespace kora {

// A downloaded file, told from another of the same name by what is in it.
struct TakenFile {
  std::string path;
  std::uint64_t size = 0, hash = 0;
  friend bool operator==(const TakenFile&, const TakenFile&) = default;
};
TakenFile IdentityOf(const std::string& path, std::string_view text);

// How far a day has come.
struct DayProgress {
  // What becomes of the entry once all is made.
  enum Leaving : int { kStays, kRenamed, kDeleted, kLeft };

  std::string entry;              // the listed file's path
  Leaving leaving = kStays;       // kLeft: taken in whole, and keeps its name
  std::vector<TakenFile> done;    // files of the day that were taken in whole
  std::optional<TakenFile> part;  // one of which the first lines were
  std::int16_t mode = 0;          // of that file
  int skip = 0;                   // its lines that are left out
  int lines = 0;                  // its lines so far
  std::int32_t names = 0;         // names that its no-trade pass has gone through
  std::optional<NameRec> held;    // the record that stood for the current security
};

class UpdateJournal {
 public:
  UpdateJournal(const Files& files, const std::string& systemPath);

  // As the last run left it, and then as this one goes.
  DayProgress progress;

  // Finishes what a run left that died. The path of the entry that is taken in whole by that; it
  // is off the list. A file that was changed since stays as it is, and is reported. `inHand`
  // becomes the file that is written to.
  std::string Finish(UpdateReport& report, std::string& inHand);

  // Makes the edits after which the day is as far as `after` says. An error leaves the files as
  // they were.
  void Commit(DayProgress after, std::span<const FileEdit> edits, std::string& inHand);

  // The entry leaves the list as `progress` says. An entry that can't stays listed.
  void LeaveList();
  // The day is done.
  void End();

 private:
  void RemoveQuietly();

  const Files& files_;
  const std::string path_;
  bool onDisk_ = false;  // a journal of this day
};

}  // namespace kora
