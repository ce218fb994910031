#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include "base/home_lock.h"
#include "base/io.h"

namespace kora {

// What a file was when it was looked at: equal stamps, same bytes. A file that is missing has the
// empty one.
struct FileStamp {
  std::uint64_t id = 0;
  std::uint64_t size = 0;
  std::int64_t modified = 0;
  friend bool operator==(const FileStamp&, const FileStamp&) = default;
};

// DOS paths and the host files behind them. Paths are UTF-8 with "\" between the names and a
// drive in front ("c:\korawin\data\Names.dat"); names match whatever their case. Drive C: is
// the folder drive_c of the home, X: drive_x, and Z: the root of the host's file system; the
// home itself stands for the Windows folder, "C:\WINDOWS\". A path can't climb above its
// drive with "..".
//
// Opening asks the host for the exact name first and looks through the folder only when that
// fails; folders are read once and read again only when they may have changed.
//
// For one thread: const calls too note what they found. A second thread has Files of its own over
// the same home.
//
// Errors of every call that takes a path: 52 for one that HostPath refuses, and those of Io.
class Files {
 public:
  // `home` is a host folder; it need not exist yet.
  explicit Files(std::string home, Io& io = MachineIo());
  ~Files();
  Files(const Files&) = delete;
  Files& operator=(const Files&) = delete;

  const std::string& home() const { return home_; }
  Io& io() const { return io_; }
  // Whoever writes the store holds it: `const auto held = files.lock().Hold();`.
  HomeLock& lock() const { return lock_; }

  // The host path of a DOS path: of the entry that is there in any case, or else where it
  // would be made. A path with no drive is of drive C:. Error 52 for a path with an empty
  // name, a NUL or a drive that is no letter.
  std::string HostPath(std::string_view path) const { return Locate(path, false); }
  // The DOS path that names an absolute host path: on C: within the home's drive, else on Z:.
  std::string DosPath(std::string_view hostPath) const;

  // True when the path exists, file or folder. What is no path does not exist.
  bool CheckFile(std::string_view path) const;
  bool IsFolder(std::string_view path) const;
  // Error 53 when the file is not there and the mode does not make it, 76 when its folder is not.
  std::unique_ptr<HostFile> Open(std::string_view path, OpenMode mode) const;
  // Names in a folder, sorted without regard to case. Error 76 when it is not there.
  std::vector<std::string> List(std::string_view folder) const;
  // Makes the folder and those above it; nothing when it is there.
  void MakeFolder(std::string_view path) const;
  // Error 75 for a read-only file.
  void Remove(std::string_view path) const;
  // Replaces `to` where it exists; a name that differs in case alone changes its case.
  void Rename(std::string_view from, std::string_view to) const;

  // The whole file. Error 7 when larger than `limit` bytes.
  std::string ReadAll(std::string_view path, std::uint64_t limit = 256u << 20) const;
  // Replaces the file as a whole: a FileSet of one. A failure or a crash at any point leaves the
  // old file or the new one.
  void WriteAll(std::string_view path, std::string_view bytes) const;

  // Tells whether a file that was read is still the one: it costs one question to the host.
  FileStamp Stamp(std::string_view path) const;

 private:
  friend class FileSet;
  struct Folder;
  // Finds by text without making a string of it.
  struct TextHash : std::hash<std::string_view> {
    using is_transparent = void;
  };

  struct Known {
    std::string host;
    bool otherCase = false;  // the file last opened there is in another case than asked for
  };

  std::string Locate(std::string_view path, bool making) const;
  // Host paths of a rename; a name that differs in case alone stays in the case asked for.
  std::pair<std::string, std::string> RenamePaths(std::string_view from, std::string_view to) const;
  std::unique_ptr<HostFile> OpenInKnown(Known& known, std::string_view name, OpenMode mode) const;
  Folder* ReadFolder(const std::string& host, std::int64_t modified) const;
  Folder* FolderFor(const std::string& host, std::int64_t modified) const;
  // `modified` is the folder's time, just asked for.
  const std::string* FindEntry(const std::string& hostFolder, std::string_view name, bool making,
                               std::int64_t modified) const;
  std::string ResolveFolder(std::string_view dosFolder) const;
  // `before` and `after` are the folder's times around the change.
  void Note(const std::string& host, bool added, std::int64_t before, std::int64_t after) const;
  void Note(const std::string& host, bool added, std::int64_t before) const;
  // The folder changed by temporary files alone: a listing that was true before holds still.
  // Returns the folder's time now.
  std::int64_t NoteTemporary(const std::string& hostFolder, std::int64_t before) const;
  std::int64_t Modified(const std::string& host) const;

  std::string home_;
  Io& io_;
  mutable HomeLock lock_;
  // DOS folder -> host folder, of folders that were there when they were looked for.
  mutable std::unordered_map<std::string, Known, TextHash, std::equal_to<>> folders_;
  mutable std::unordered_map<std::string, std::unique_ptr<Folder>> listings_;
};

// The name behind the last "\" of a DOS path.
std::string_view FileNameOf(std::string_view path);

// "c:\korawin\data" and "c:\korawin\data\" both to "c:\korawin\data\"; empty stays empty.
std::string WithBackslash(std::string_view folder);

// True where `code` can name a file of its own in a folder: 1 to 6 bytes after trimming,
// no path or wildcard character, no control byte, no device name ("NUL", "COM1"), no dots
// at its end. Codes become file names only after this test.
bool IsFileCode(std::string_view code);
// The code under which a security is kept whose own can't be a file name: "PRNX" for "PRN",
// "1AUX" for "AUX"; any other as it is. `code` is trimmed and in upper case.
std::string KeptCode(std::string code);
// Trimmed code + extension, as "ORE" and ".WDT" give "ORE.WDT". Error 52 unless IsFileCode.
std::string CodeFileName(std::string_view code, std::string_view extension);

// Reads lines that end in CR LF or LF. The last needs no end.
class LineReader {
 public:
  explicit LineReader(std::string_view text) : rest_(text) {}
  bool Next(std::string_view& line);
  int number() const { return number_; }  // of the line last read, from 1

 private:
  std::string_view rest_;
  int number_ = 0;
};

}  // namespace kora
