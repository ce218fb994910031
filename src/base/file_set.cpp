#include "base/file_set.h"

#include <optional>

namespace kora {

// The listing of the folder that Files keeps is told of what the set did, or making thousands of
// files would read it thousands of times.
void FileSet::Note(const std::string& host, bool added) {
  folders_.try_emplace(HostFolderOf(host), -1);
  changes_.push_back({host, added});
}

void FileSet::Add(std::string_view path, std::string bytes) {
  const std::string host = files_.Locate(path, true);
  set_.Write(host, std::move(bytes));
  Note(host, true);
}

CopiedFile FileSet::AddCopy(std::string_view from, std::string_view path) {
  const auto source = files_.Open(from, OpenMode::kRead);
  return AddMade(path, [&](std::string host) { return set_.Copy(*source, std::move(host)); });
}

CopiedFile FileSet::AddNow(std::string_view path, std::span<const std::string_view> pieces) {
  return AddMade(path, [&](std::string host) { return set_.WriteNow(std::move(host), pieces); });
}

template <typename Make>
CopiedFile FileSet::AddMade(std::string_view path, Make make) {
  const std::string host = files_.Locate(path, true);
  const std::string folder = HostFolderOf(host);
  const std::int64_t before = files_.Modified(folder);
  const CopiedFile copied = make(host);
  Note(host, true);
  folders_[folder] = files_.NoteTemporary(folder, before);
  return copied;
}

void FileSet::Remove(std::string_view path) {
  const std::string host = files_.HostPath(path);
  set_.Remove(host);
  Note(host, false);
}

void FileSet::Rename(std::string_view from, std::string_view to) {
  const auto [hostFrom, hostTo] = files_.RenamePaths(from, to);
  set_.Rename(hostFrom, hostTo);
  Note(hostFrom, false);
  Note(hostTo, true);
}

void FileSet::Stage() {
  for (auto& [folder, before] : folders_)
    if (before < 0) before = files_.Modified(folder);
  set_.Stage();
}

void FileSet::Commit() {
  const auto changes = std::move(changes_);
  changes_.clear();
  try {
    std::optional<HomeLock::Held> held;
    if (set_.size() > 1) held.emplace(files_.lock().Hold());
    Stage();
    set_.Commit();
  } catch (...) {
    folders_.clear();
    throw;
  }
  // All is done: a folder has one time now, which is asked for once.
  std::map<std::string, std::int64_t> after;
  for (const Change& change : changes) {
    const std::string folder = HostFolderOf(change.host);
    std::int64_t& before = folders_[folder];
    const auto [now, asked] = after.try_emplace(folder, 0);
    if (asked) now->second = files_.Modified(folder);
    files_.Note(change.host, change.added, before, now->second);
    before = now->second;
  }
  folders_.clear();
}

}  // namespace kora
