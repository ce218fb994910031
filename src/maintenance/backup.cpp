#include "maintenance/backup.h"

#include <algorithm>
#include <utility>

#include "base/file_set.h"
#include "base/home_lock.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "maintenance/failures.h"
#include "maintenance/same_place.h"
#include "platform/dialogs.h"
#include "platform/progress.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Copy Files";
constexpr const char* kAllTitle = "Copy all Files";
// Files are put in place some at a time: a new one takes its room on the disk once, one that
// replaces another twice until then.
constexpr size_t kFilesTogether = 4096;
constexpr std::uint64_t kReplacedTogether = 64u << 20;

std::string WithoutBackslash(std::string folder) {
  while (folder.size() > 3 && folder.back() == '\\') folder.pop_back();
  return folder;
}

// Of a set that was being written when the program died.
bool IsLeftOver(const std::string& name) { return name.ends_with('~'); }

bool IsStore(const std::vector<std::string>& names) {
  return std::any_of(names.begin(), names.end(), [](const std::string& name) {
    const std::string upper = UCase(name);
    return upper == "NAMES.DAT" || upper.ends_with(".WDT");
  });
}

// Copies files beside their destinations and puts them in place in groups.
class Copier {
 public:
  Copier(const Files& files, std::string source, std::string destination, CopyCount& count,
         Dialogs& dialogs)
      : files_(files),
        source_(WithBackslash(source)),
        destination_(WithBackslash(destination)),
        count_(count),
        dialogs_(dialogs),
        set_(files) {}

  // Both: false when the user gave up, or another failure was told.
  bool Copy(const std::string& name) {
    for (;;) {
      try {
        inHand_ = name;
        const CopiedFile copied = set_.AddCopy(source_ + name, destination_ + name);
        bytes_ += copied.bytes;
        replaced_ += copied.replaces;
        names_.push_back(name);
        return names_.size() < kFilesTogether && replaced_ < kReplacedTogether ? true
                                                                               : PutInPlace();
      } catch (const RunTimeError& e) {
        // What was copied before is to be there in any case, and takes less room once it is.
        const bool pending = !names_.empty();
        if (pending && !PutInPlace()) return false;
        if (!(pending && e.number() == kDiskFull) && !Again(e)) return false;
      }
    }
  }

  bool PutInPlace() {
    const auto names = std::exchange(names_, {});
    replaced_ = 0;
    const std::uint64_t bytes = std::exchange(bytes_, 0);
    if (names.empty()) return true;
    try {
      set_.Commit();
    } catch (const RunTimeError& e) {
      // The disk may say only now that it is full; part of a group may fit.
      if (e.number() == kDiskFull && names.size() > 1) return OneByOne(names);
      return Again(e) && OneByOne(names);
    }
    count_.files += std::int32_t(names.size());
    count_.bytes += bytes;
    count_.last = names.back();
    return true;
  }

 private:
  bool OneByOne(const std::vector<std::string>& names) {
    for (const std::string& name : names)
      if (!Copy(name) || !PutInPlace()) return false;
    return true;
  }

  bool Again(const RunTimeError& e) {
    if (e.number() == kDiskFull)
      return dialogs_.Ask("Disk full. Put in next diskette ", kTitle, Buttons::kRetryCancel) ==
             Answer::kRetry;
    if (e.number() == kDiskNotReady)
      return dialogs_.Ask("Disk Not ready. Close drive door", kTitle, Buttons::kRetryCancel) ==
             Answer::kRetry;
    dialogs_.Message("Unexpected Error No. " + Str(std::int32_t(e.number())) +
                         " Cannot continue\n" + inHand_ + ": " + e.what(),
                     kAllTitle);
    return false;
  }

  const Files& files_;
  const std::string source_, destination_;
  CopyCount& count_;
  Dialogs& dialogs_;
  FileSet set_;
  std::vector<std::string> names_;  // copied and not yet in place
  std::uint64_t bytes_ = 0, replaced_ = 0;
  std::string inHand_;
};

// False where the folder is not there and can't be made.
bool HaveFolder(const Files& files, const std::string& folder, Dialogs& dialogs) {
  if (files.IsFolder(folder)) return true;
  dialogs.Message("Directory not found - creating " + folder, kTitle);
  return TellFailure(dialogs, kTitle, folder + " Cannot continue",
                     [&] { files.MakeFolder(folder); });
}

}  // namespace

std::string BackupCaption(const Files& files, const std::string& source,
                          const std::string& dataPath) {
  return IsSamePlace(files, source, dataPath) ? " Now COPYING Charting Data Files"
                                              : " Now RESTORING Charting Data Files";
}

std::vector<std::string> FilesToCopy(const Files& files, const std::string& folder,
                                     Dialogs& dialogs) {
  const std::string source = WithBackslash(folder);
  std::vector<std::string> names;
  try {
    if (!files.IsFolder(source)) throw RunTimeError(kPathNotFound);
    const std::string host = files.HostPath(source);
    for (const std::string& name : files.List(source)) {
      // A host's name may hold what parts the folders of a path.
      if (name.find('\\') != std::string::npos || IsLeftOver(name)) continue;
      if (files.io().Status(host + "/" + name).plain) names.push_back(name);
    }
  } catch (const RunTimeError& e) {
    names.clear();
    const bool away = e.number() == kDiskNotReady || e.number() == kDeviceNotAvailable;
    dialogs.Message(away ? source + " Not Ready" : "Path not found", kTitle);
  }
  return names;
}

CopyCount CopyAllFiles(const Files& files, const std::string& from, const std::string& to,
                       const std::vector<std::string>& names, Progress& progress,
                       Dialogs& dialogs) {
  CopyCount count;
  const std::string source = WithoutBackslash(from), destination = WithoutBackslash(to);
  if (IsSamePlace(files, source, destination)) {
    dialogs.Message("Source and Destination are one folder: " + source, kAllTitle);
    return count;
  }
  TellFailure(dialogs, kAllTitle, destination, [&] {
    if (!HaveFolder(files, source, dialogs) || !HaveFolder(files, destination, dialogs)) return;
    const auto held = files.lock().Hold();
    Copier copier(files, source, destination, count, dialogs);
    const auto step = [&](size_t i) { return progress.Step(int(i), int(names.size())); };
    for (size_t i = 0; i < names.size() && !count.stopped; ++i) {
      progress.Show(ProgressLine::kItem, "From: " + UCase(WithBackslash(source) + names[i]));
      progress.Show(ProgressLine::kNote, "To  : " + UCase(WithBackslash(destination) + names[i]));
      count.stopped = !step(i);
      if (!count.stopped && !copier.Copy(names[i])) return;
    }
    if (!copier.PutInPlace()) return;
    if (count.stopped) {
      dialogs.Message("Stopped behind " + Str(count.files) + " files", kAllTitle);
      return;
    }
    step(names.size());
    count.done = true;
  });
  return count;
}

CopyCount BackupAllFiles(const Files& files, const std::string& dataPath, const std::string& backup,
                         Progress& progress, Dialogs& dialogs) {
  const auto names = FilesToCopy(files, dataPath, dialogs);
  if (names.empty()) return {};
  return CopyAllFiles(files, dataPath, backup, names, progress, dialogs);
}

CopyCount RestoreAllFiles(const Files& files, const std::string& dataPath,
                          const std::string& backup, Progress& progress, Dialogs& dialogs) {
  const auto names = FilesToCopy(files, backup, dialogs);
  if (names.empty() && !files.IsFolder(backup)) return {};
  if (!IsStore(names)) {
    dialogs.Message("There is no backup in " + backup, kTitle);
    return {};
  }
  return CopyAllFiles(files, backup, dataPath, names, progress, dialogs);
}

bool CopySelectedFile(const Files& files, const std::string& source, const std::string& destination,
                      const std::string& name, Progress& progress, Dialogs& dialogs) {
  if (!files.CheckFile(WithBackslash(source) + name)) {
    dialogs.Message("File not found", kTitle);
    return false;
  }
  if (!CopyAllFiles(files, source, destination, {name}, progress, dialogs).done) return false;
  dialogs.Message("File " + name + " copied", "Backup Charting Data");
  return true;
}

}  // namespace kora
