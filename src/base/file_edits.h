#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "base/files.h"

namespace kora {

// Changes within files, thousands of them perhaps, that are all made or none: each file is changed
// in its place, and a journal holds what was there and what is to be, so that neither a program
// that dies nor a machine that loses its power leaves some of them behind.

// Bytes of a file from `offset` on, as they are and as they are to be. `old` ends where the file
// ends, if that comes first.
struct ByteChange {
  std::uint64_t offset = 0;
  std::string old;
  std::string fresh;
};

struct FileEdit {
  std::string path;          // DOS path
  bool existed = true;       // else it is made
  std::uint64_t before = 0;  // bytes that it had
  std::vector<ByteChange> changes;

  // Bytes that it has at the end: a file grows by an edit, or stays.
  std::uint64_t After() const;
};

// Told before a file is touched.
using EditWatcher = std::function<void(const std::string& path)>;

// Makes the edits. A file whose bytes are neither the old ones, nor the new ones, nor what a loss
// of power leaves between the two (each byte of the one or the other, or 0), was changed by
// someone else since: it is left as it is, and its path is returned.
//
// Nothing is flushed yet. On an error the edits made so far stay.
std::vector<std::string> MakeEdits(const Files& files, std::span<const FileEdit> edits,
                                   const EditWatcher& watch = {});

// Takes edits back, those that were made, in part or whole.
void UndoEdits(const Files& files, std::span<const FileEdit> edits);

// Returns once the edits made are on their disks.
void FlushEdits(const Files& files, std::span<const FileEdit> edits);

// A journal is a text of its owner's and the edits that follow from it.
struct EditJournal {
  std::string note;
  std::vector<FileEdit> edits;
};

// Nothing where there is no file, or one that is no whole journal: it was being written, and what
// it tells has not begun.
std::optional<EditJournal> ReadEditJournal(const Files& files, const std::string& path);
// On the disk when this returns. Replaces the journal that was there.
void WriteEditJournal(const Files& files, const std::string& path, std::string_view note,
                      std::span<const FileEdit> edits);

}  // namespace kora
