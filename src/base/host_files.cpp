#include "base/host_files.h"

#include "base/host_file_set.h"
#include "base/runtime_error.h"

namespace kora {
namespace {

// A pipe or a device would be read without end.
void RefuseOddFiles(Io& io, const std::string& path) {
  const HostStatus status = io.Status(path);
  if (status.folder) throw RunTimeError(kPathAccess, "Is a directory");
  if (status.exists && !status.plain) throw RunTimeError(kPathAccess, "Not a plain file");
}

}  // namespace

std::string ReadHostFile(Io& io, const std::string& path, std::uint64_t limit) {
  RefuseOddFiles(io, path);
  const auto file = io.Open(path, OpenMode::kRead);
  const std::uint64_t size = file->Size();
  if (size > limit) throw RunTimeError(kOutOfMemory, "The file is too large");
  std::string bytes(size_t(size), '\0');
  bytes.resize(file->ReadAt(0, bytes.data(), bytes.size()));
  return bytes;
}

void WriteHostFile(Io& io, const std::string& path, std::string_view bytes) {
  HostFileSet set(io);
  set.Write(path, std::string(bytes));
  set.Commit();
}

}  // namespace kora
