#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "base/files.h"
#include "platform/dialogs.h"
#include "settings/settings.h"
#include "store/name_file.h"
#include "update/download_list.h"

namespace kora {

class Clock;

// What the update shows while it runs. Nothing, unless a form or a command says where.
class UpdateDisplay {
 public:
  virtual ~UpdateDisplay() = default;
  virtual void ShowState(std::string_view) {}   // Label2
  virtual void ShowDate(std::string_view) {}    // Label3
  virtual void ShowTarget(std::string_view) {}  // Label5, the folder that is written to
  virtual void ShowFirst(std::string_view) {}   // the two progress texts
  virtual void ShowSecond(std::string_view) {}
  // Red state, busy pointer, no buttons; and back.
  virtual void SetRunning(bool) {}
  // ProgressBar1; the bar hides when SetRunning(false) comes. False when the user wants to stop.
  virtual bool Step(int, int) { return true; }
};

// Shows the bar alone, as every long pass has it.
class UpdateProgress : public UpdateDisplay {
 public:
  explicit UpdateProgress(Dialogs& dialogs) : dialogs_(dialogs) {}
  void SetRunning(bool running) override {
    if (running) bar_ = dialogs_.StartProgress("Update");
    else bar_.reset();
  }
  bool Step(int done, int total) override { return !bar_ || bar_->Step(done, total); }

 private:
  Dialogs& dialogs_;
  std::unique_ptr<Progress> bar_;
};

// What an update works with.
struct UpdateRun {
  const Files& files;
  Settings& settings;    // a whole-market run leaves CurrentDataPath on the folder chosen
  CurrentName& current;  // Rec drives the write of files whose codes are not looked up
  Dialogs& dialogs;
  const Clock& clock;
  UpdateDisplay& display;
  // Merges the bulletins of services 1 and 3 at the end of a day: the folder of Adjust.Lst and
  // the last 7 characters of the base name, empty in service 1.
  std::function<void(const std::string& path, const std::string& baseName)> CheckBulletins = {};
};

enum class UpdateEnd {
  kUpdated,
  kAbandoned,  // told; some or all of the day's files were not taken
  kNotBegun,   // told; the file is not there, or service 3 lacks a folder: the form stays
  kStopped,    // by the user, or by a failure that was told; what was written stays
};

// Update 1 Day: takes in the entry at `selected` and, unless it was abandoned, takes it off the
// list.
//
// A line that can't be taken refuses its file before anything is written. From then on records
// are written line by line, each file old or new at any moment; when the run dies the
// downloaded file is still there, and taking it in again replaces its date throughout.
UpdateEnd UpdateOneDay(const UpdateRun& run, DownloadEntries& entries, size_t selected);

// Update All: every entry in the order of the list, which stays as it was. A file that is
// abandoned does not end the run. `select` is told each entry's place before it is taken in.
UpdateEnd UpdateAllDays(const UpdateRun& run, const DownloadEntries& entries,
                        const std::function<void(size_t)>& select = {});

}  // namespace kora
