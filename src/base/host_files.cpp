#include "base/host_files.h"

#include <filesystem>
#include <system_error>

#include "base/runtime_error.h"

namespace kora {
namespace {

// A pipe or a device would be read without end, or replaced by a file.
void RefuseOddFiles(const std::string& path) {
  std::error_code ignored;
  const auto status = std::filesystem::status(path, ignored);
  if (std::filesystem::is_directory(status)) throw RunTimeError(kPathAccess, "Is a directory");
  if (std::filesystem::exists(status) && !std::filesystem::is_regular_file(status))
    throw RunTimeError(kPathAccess, "Not a plain file");
}

}  // namespace

std::string ReadHostFile(Io& io, const std::string& path, std::uint64_t limit) {
  RefuseOddFiles(path);
  const auto file = io.Open(path, OpenMode::kRead);
  const std::uint64_t size = file->Size();
  if (size > limit) throw RunTimeError(kOutOfMemory, "The file is too large");
  std::string bytes(size_t(size), '\0');
  bytes.resize(file->ReadAt(0, bytes.data(), bytes.size()));
  return bytes;
}

void WriteHostFile(Io& io, const std::string& path, std::string_view bytes) {
  RefuseOddFiles(path);
  std::error_code error;
  std::string host = path;
  if (std::filesystem::is_symlink(std::filesystem::symlink_status(path, error)))
    host = std::filesystem::weakly_canonical(path, error).string();
  const std::string temporary = host + ".tmp~";
  try {
    const auto file = io.Open(temporary, OpenMode::kReplace);
    file->WriteAt(0, bytes.data(), bytes.size());
    file->Flush();
    io.Rename(temporary, host);
  } catch (const RunTimeError&) {
    try {
      if (io.Status(temporary).exists) io.Remove(temporary);
    } catch (const RunTimeError&) {
      // The first failure is the one to tell.
    }
    throw;
  }
}

}  // namespace kora
