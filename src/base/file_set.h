#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"

namespace kora {

// Several files that are replaced together or not at all.
//
// Add writes the new bytes to a temporary file beside the old one, so that a full disk shows
// while every file is still as it was. Commit only renames. A crash during Commit leaves each
// file old or new, never half-written, and those added first are the first to be new.
class FileSet {
 public:
  explicit FileSet(const Files& files) : files_(files) {}
  // Removes the temporary files of a set that was not committed.
  ~FileSet();
  FileSet(const FileSet&) = delete;
  FileSet& operator=(const FileSet&) = delete;

  // `path` is a DOS path; a path is added once. Errors of the file system as they come.
  void Add(std::string_view path, std::string_view bytes);

  // Puts the new files in place. A failure brings back the files replaced so far and is
  // raised again.
  void Commit();

 private:
  struct Item {
    std::string host;
    std::string temporary;
    bool existed = false;
    bool placed = false;
    std::string before;  // the old bytes, from just before the rename
  };
  void Discard() noexcept;
  void Restore() noexcept;

  const Files& files_;
  std::vector<Item> items_;
};

}  // namespace kora
