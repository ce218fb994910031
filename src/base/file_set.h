#pragma once

#include <cstdint>
#include <map>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "base/host_file_set.h"

namespace kora {

// Files of the home that change together or not at all: a HostFileSet by DOS paths, whose rules
// and errors it has. A set of several changes is committed under the home's lock, and finished by
// the next who takes it where its process dies: all of the files are old then, or all new. The changes are made in the order in which they were added, and each path is
// that of the file as it is when it is added: a file that the set itself makes or moves is named
// in the case in which the set made it.
class FileSet {
 public:
  explicit FileSet(const Files& files)
      : files_(files), set_(files.io(), SetJournalOf(files.home())) {}

  // New bytes for a file, which is made when missing.
  void Add(std::string_view path, std::string bytes);
  // The bytes of another file, copied beside the path at once. A failure leaves what the set has so
  // far. Called under the home's lock.
  CopiedFile AddCopy(std::string_view from, std::string_view path);
  // The same with bytes that the program has, in pieces that follow one another: what is added for
  // thousands of files takes no memory.
  CopiedFile AddNow(std::string_view path, std::span<const std::string_view> pieces);
  // Nothing where it is not there by then.
  void Remove(std::string_view path);
  // Replaces `to`. Error 53 in Commit where `from` is not there by then.
  void Rename(std::string_view from, std::string_view to);

  // Writes what was added so far to temporary files and frees its memory.
  void Stage();
  // Puts everything in place, and the set is empty again.
  void Commit();

 private:
  struct Change {
    std::string host;
    bool added;
  };
  template <typename Make>
  CopiedFile AddMade(std::string_view path, Make make);
  void Note(const std::string& host, bool added);

  const Files& files_;
  HostFileSet set_;
  std::vector<Change> changes_;
  // Times of the folders before the set changed anything in them.
  std::map<std::string, std::int64_t> folders_;
};

}  // namespace kora
