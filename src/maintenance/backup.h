#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "base/files.h"

// Copies of the price store, to the backup folder and back: what stands behind the form `ChartBak`.

namespace kora {

class Dialogs;
class Progress;

// " Now COPYING Charting Data Files" from the data folder, " Now RESTORING Charting Data Files" from
// another.
std::string BackupCaption(const Files& files, const std::string& source,
                          const std::string& dataPath);

// The files of a folder, without those of its subfolders. Nothing, and told, where it is not there.
std::vector<std::string> FilesToCopy(const Files& files, const std::string& source,
                                     Dialogs& dialogs);

struct CopyCount {
  bool done = false;       // all of them
  bool stopped = false;    // by the user
  std::int32_t files = 0;  // copied
  std::uint64_t bytes = 0;
  std::string last;  // the file that was copied last
};

// Copies the files of one folder to another, which is made where it is missing. Each file is put in
// place whole, and all are on the disk at the end; a kill leaves those copied so far. A full disk, or
// one that is not ready, is asked about and the file tried again; other failures stop it. `progress`
// shows "From: " as kItem and "To  : " as kNote.
CopyCount CopyAllFiles(const Files& files, const std::string& source,
                       const std::string& destination, const std::vector<std::string>& names,
                       Progress& progress, Dialogs& dialogs);

// The whole data folder to the backup folder, or back. A backup folder that holds neither a name
// file nor a price file is refused.
CopyCount BackupAllFiles(const Files& files, const std::string& dataPath, const std::string& backup,
                         Progress& progress, Dialogs& dialogs);
CopyCount RestoreAllFiles(const Files& files, const std::string& dataPath,
                          const std::string& backup, Progress& progress, Dialogs& dialogs);

// One of them; told when it is done.
bool CopySelectedFile(const Files& files, const std::string& source, const std::string& destination,
                      const std::string& name, Progress& progress, Dialogs& dialogs);

}  // namespace kora
