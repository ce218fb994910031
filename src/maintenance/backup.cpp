#include "maintenance/backup.h"

#include <algorithm>
#include <span>

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
// Files are put in place some at a time: what is held in memory stays small.
constexpr size_t kFilesTogether = 256;
constexpr size_t kBytesTogether = 64u << 20;
constexpr std::uint64_t kLargestFile = 1u << 30;

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

// Puts a group of files in place. False when the user gave up, or another failure was told.
class Copier {
 public:
  Copier(const Files& files, std::string source, std::string destination, Dialogs& dialogs)
      : files_(files),
        source_(WithBackslash(source)),
        destination_(WithBackslash(destination)),
        dialogs_(dialogs) {}

  bool Copy(std::span<const std::string> names, CopyCount& count) {
    for (;;) {
      try {
        FileSet set(files_);
        std::uint64_t bytes = 0;
        for (const std::string& name : names) {
          inHand_ = name;
          std::string text = files_.ReadAll(source_ + name, kLargestFile);
          bytes += text.size();
          set.Add(destination_ + name, std::move(text));
        }
        set.Commit();
        count.files += std::int32_t(names.size());
        count.bytes += bytes;
        if (!names.empty()) count.last = names.back();
        return true;
      } catch (const RunTimeError& e) {
        // A group that does not fit may fit in part.
        if (names.size() > 1 && e.number() == kDiskFull) return CopyOneByOne(names, count);
        if (!Again(e)) return false;
      }
    }
  }

 private:
  bool CopyOneByOne(std::span<const std::string> names, CopyCount& count) {
    for (size_t i = 0; i < names.size(); ++i)
      if (!Copy(names.subspan(i, 1), count)) return false;
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
  Dialogs& dialogs_;
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
    for (const std::string& name : files.List(source)) {
      // A host's name may hold what parts the folders of a path.
      if (name.find('\\') != std::string::npos || IsLeftOver(name)) continue;
      if (files.io().Status(files.HostPath(source + name)).plain) names.push_back(name);
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
    Copier copier(files, source, destination, dialogs);
    const std::span<const std::string> all(names);
    size_t first = 0;
    std::uint64_t bytes = 0;
    for (size_t i = 0; i < all.size(); ++i) {
      progress.Show(ProgressLine::kItem, "From: " + UCase(WithBackslash(source) + all[i]));
      progress.Show(ProgressLine::kNote, "To  : " + UCase(WithBackslash(destination) + all[i]));
      if (!progress.Step(int(i), int(all.size()))) {
        count.stopped = true;
        break;
      }
      bytes += files.io().Status(files.HostPath(WithBackslash(source) + all[i])).size;
      if (i + 1 - first < kFilesTogether && bytes < kBytesTogether && i + 1 < all.size()) continue;
      if (!copier.Copy(all.subspan(first, i + 1 - first), count)) return;
      first = i + 1;
      bytes = 0;
    }
    if (count.stopped) {
      dialogs.Message("Stopped behind " + Str(count.files) + " files", kAllTitle);
      return;
    }
    progress.Step(int(all.size()), int(all.size()));
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
