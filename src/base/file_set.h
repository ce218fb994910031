#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"

namespace kora {

// Several files that are replaced together or not at all.
//
// Commit first writes all new bytes to temporary files beside the old ones, so that a full disk
// shows while every file is still as it was, and then only renames. A crash in between leaves
// each file old or new, never half-written, and those added first are the first to be new.
class FileSet {
 public:
  explicit FileSet(const Files& files) : files_(files) {}

  // `path` is a DOS path; a path is added once. Nothing is written yet. Error 75 for a folder.
  void Add(std::string_view path, std::string bytes);

  // Puts the new files in place, and the set is empty again. A failure brings back what was
  // there, removes the temporary files and is raised again.
  void Commit();

 private:
  struct Item {
    std::string host;
    std::string temporary;
    std::string bytes;   // the new ones; from the rename on the old ones
    bool existed = false;
    bool placed = false;
  };
  void Restore() noexcept;

  const Files& files_;
  std::vector<Item> items_;
};

}  // namespace kora
