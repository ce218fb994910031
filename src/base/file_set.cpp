#include "base/file_set.h"

#include "base/runtime_error.h"

namespace kora {
namespace {

constexpr const char* kTemporary = ".tmp~";

void WriteFlushed(Io& io, const std::string& host, std::string_view bytes) {
  const auto file = io.Open(host, OpenMode::kReplace);
  file->WriteAt(0, bytes.data(), bytes.size());
  file->Flush();
}

std::string ReadWhole(HostFile& file) {
  std::string bytes(size_t(file.Size()), '\0');
  bytes.resize(file.ReadAt(0, bytes.data(), bytes.size()));
  return bytes;
}

// For clean-ups after a failure, which is the one to tell.
void RemoveQuietly(Io& io, const std::string& host) noexcept {
  try {
    if (io.Status(host).exists) io.Remove(host);
  } catch (const RunTimeError&) {
  }
}

}  // namespace

void FileSet::Add(std::string_view path, std::string bytes) {
  Item item;
  item.host = files_.HostPath(path);
  item.temporary = item.host + kTemporary;
  const HostStatus status = files_.io().Status(item.host);
  if (status.folder) throw RunTimeError(kPathAccess, "Is a directory");
  item.existed = status.exists;
  item.bytes = std::move(bytes);
  items_.push_back(std::move(item));
}

void FileSet::Commit() {
  Io& io = files_.io();
  try {
    for (const Item& item : items_) WriteFlushed(io, item.temporary, item.bytes);
    for (Item& item : items_) {
      item.bytes.clear();
      if (item.existed) item.bytes = ReadWhole(*io.Open(item.host, OpenMode::kRead));
      io.Rename(item.temporary, item.host);
      item.placed = true;
    }
  } catch (const RunTimeError&) {
    Restore();
    items_.clear();
    throw;
  }
  items_.clear();
}

void FileSet::Restore() noexcept {
  Io& io = files_.io();
  for (const Item& item : items_) {
    if (item.placed && item.existed) {
      try {
        WriteFlushed(io, item.temporary, item.bytes);
        io.Rename(item.temporary, item.host);
        continue;
      } catch (const RunTimeError&) {
        // The new file stays: it is whole, and better than none.
      }
    } else if (item.placed) {
      RemoveQuietly(io, item.host);
    }
    RemoveQuietly(io, item.temporary);
  }
}

}  // namespace kora
