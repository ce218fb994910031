#include "tests/monkey/driver/confined.h"

#include <filesystem>

#include "base/runtime_error.h"

namespace kora::monkey {

void ConfinedIo::Inside(const char* what, const std::string& path) const {
  const std::string plain = std::filesystem::path(path).lexically_normal().string();
  if (plain == root || plain.starts_with(root + "/")) return;
  if (refused) refused(std::string(what) + " " + path);
  throw RunTimeError(kPathAccess);
}

std::unique_ptr<HostFile> ConfinedIo::Open(const std::string& path, OpenMode mode) {
  if (mode != OpenMode::kRead) Inside("open", path);
  return ForwardingIo::Open(path, mode);
}

void ConfinedIo::MakeFolder(const std::string& path) {
  Inside("make folder", path);
  ForwardingIo::MakeFolder(path);
}

void ConfinedIo::Remove(const std::string& path) {
  Inside("remove", path);
  ForwardingIo::Remove(path);
}

void ConfinedIo::Rename(const std::string& from, const std::string& to) {
  Inside("rename", from);
  Inside("rename to", to);
  ForwardingIo::Rename(from, to);
}

void ConfinedIo::Link(const std::string& from, const std::string& to) {
  Inside("link", to);
  ForwardingIo::Link(from, to);
}

std::unique_ptr<HostLock> ConfinedIo::TryLock(const std::string& path, std::string_view holder,
                                              std::string& heldBy) {
  Inside("lock", path);
  return ForwardingIo::TryLock(path, holder, heldBy);
}

int NoProcesses::RunAndWait(const std::string&, const std::vector<std::string>&,
                            const std::function<void()>& idle) {
  const int turn = started++ % 4;
  for (int i = 0; i < turn; ++i)
    if (idle) idle();
  if (turn == 3) throw RunTimeError(kFileNotFound);
  return turn == 2 ? 1 : 0;
}

}  // namespace kora::monkey
