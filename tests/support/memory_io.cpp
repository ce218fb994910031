#include "tests/support/memory_io.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "base/runtime_error.h"

namespace kora::test {
namespace {

constexpr size_t kLongestName = 255, kLongestPath = 4095;

// What the host's own calls would see of the path must be all of it.
void CheckPath(const std::string& path) {
  Promise(path.find('\0') == std::string::npos, "no path with a NUL reaches the host");
  Promise(("/" + path + "/").find("/../") == std::string::npos, "no path climbs");
  if (path.empty()) throw RunTimeError(kFileNotFound);
  if (path.size() > kLongestPath) throw RunTimeError(kBadFileName);
  for (size_t at = 0; at < path.size();) {
    const size_t end = std::min(path.find('/', at), path.size());
    if (end - at > kLongestName) throw RunTimeError(kBadFileName);
    at = end + 1;
  }
}

}  // namespace

void Promise(bool held, const char* what) {
  if (held) return;
  std::fprintf(stderr, "broken: %s\n", what);
  std::abort();
}

class MemoryIo::File : public HostFile {
 public:
  File(MemoryIo& io, std::shared_ptr<Node> node) : io_(io), node_(std::move(node)) {}

  size_t ReadAt(std::uint64_t offset, void* data, size_t size) override {
    const std::string& bytes = node_->bytes;
    if (offset >= bytes.size()) return 0;
    size = std::min(size, bytes.size() - size_t(offset));
    std::memcpy(data, bytes.data() + offset, size);
    return size;
  }
  void WriteAt(std::uint64_t offset, const void* data, size_t size) override {
    if (size == 0) return;
    if (offset + size > kLargest) throw RunTimeError(kDiskFull);
    node_->modified = ++io_.now_;
    std::string& bytes = node_->bytes;
    if (bytes.size() < offset + size) bytes.resize(size_t(offset) + size);
    std::memcpy(bytes.data() + offset, data, size);
  }
  std::uint64_t Size() override { return node_->bytes.size(); }
  void Truncate(std::uint64_t size) override {
    if (size > kLargest) throw RunTimeError(kDiskFull);
    node_->modified = ++io_.now_;
    node_->bytes.resize(size_t(size));
  }
  void Flush() override {}
  void TakeAccess(const HostStatus&) override {}

 private:
  static constexpr std::uint64_t kLargest = 1u << 30;
  MemoryIo& io_;
  std::shared_ptr<Node> node_;
};

MemoryIo::MemoryIo() : folders_{{"home", 0}, {"home/drive_c", 0}} {}

void MemoryIo::Put(const std::string& path, std::string_view bytes) {
  for (size_t at = path.find('/'); at != std::string::npos; at = path.find('/', at + 1))
    folders_.try_emplace(path.substr(0, at), ++now_);
  auto& node = files_[path];
  node = std::make_shared<Node>();
  node->bytes = bytes;
  node->modified = node->id = std::uint64_t(++now_);
}

std::string MemoryIo::Get(const std::string& path) const {
  const auto node = Find(path);
  return node ? node->bytes : std::string();
}

std::map<std::string, std::string> MemoryIo::Store() const {
  std::map<std::string, std::string> out;
  for (const auto& [path, node] : files_)
    if (path != "home/Kora.lock") out[path] = node->bytes;
  return out;
}

void MemoryIo::Changes(const std::string& path) const {
  CheckPath(path);
  Promise(!confined || path.rfind("home/", 0) == 0, "nothing is written outside the home");
}

std::shared_ptr<MemoryIo::Node> MemoryIo::Find(const std::string& path) const {
  const auto it = files_.find(path);
  return it == files_.end() ? nullptr : it->second;
}

void MemoryIo::Touch(const std::string& path) { folders_[HostFolderOf(path)] = ++now_; }

std::unique_ptr<HostFile> MemoryIo::Open(const std::string& path, OpenMode mode) {
  if (mode == OpenMode::kRead)
    CheckPath(path);
  else
    Changes(path);
  if (folders_.contains(path)) throw RunTimeError(kPathAccess);
  if (!folders_.contains(HostFolderOf(path))) throw RunTimeError(kPathNotFound);
  auto node = Find(path);
  const bool makes = mode != OpenMode::kRead && mode != OpenMode::kReadWrite;
  if (!node && !makes) throw RunTimeError(kFileNotFound);
  if (node && mode == OpenMode::kNew) throw RunTimeError(kPathAccess);
  if (!node) {
    Touch(path);
    node = files_[path] = std::make_shared<Node>();
    node->modified = node->id = std::uint64_t(++now_);
  } else if (mode == OpenMode::kReplace) {
    node->bytes.clear();
    node->modified = ++now_;
  }
  return std::make_unique<File>(*this, std::move(node));
}

HostStatus MemoryIo::Status(const std::string& path) {
  HostStatus out;
  try {
    CheckPath(path);
  } catch (const RunTimeError&) {
    return out;
  }
  if (const auto it = folders_.find(path); it != folders_.end()) {
    out.exists = out.folder = true;
    out.modified = it->second;
  } else if (const auto node = Find(path)) {
    out.exists = out.plain = true;
    out.size = node->bytes.size();
    out.modified = node->modified;
    out.id = node->id;
  }
  return out;
}

std::vector<std::string> MemoryIo::List(const std::string& folder) {
  CheckPath(folder);
  if (!folders_.contains(folder)) throw RunTimeError(kPathNotFound);
  std::vector<std::string> names;
  const auto take = [&](const std::string& path) {
    if (path.size() > folder.size() + 1 && path.rfind(folder + "/", 0) == 0 &&
        path.find('/', folder.size() + 1) == std::string::npos)
      names.push_back(path.substr(folder.size() + 1));
  };
  for (const auto& [path, node] : files_) take(path);
  for (const auto& [path, time] : folders_) take(path);
  return names;
}

void MemoryIo::MakeFolder(const std::string& path) {
  Changes(path);
  if (files_.contains(path) || folders_.contains(path)) throw RunTimeError(kPathAccess);
  if (!folders_.contains(HostFolderOf(path))) throw RunTimeError(kPathNotFound);
  Touch(path);
  folders_[path] = ++now_;
}

void MemoryIo::Remove(const std::string& path) {
  Changes(path);
  if (folders_.contains(path)) throw RunTimeError(kPathAccess);
  if (files_.erase(path) == 0) throw RunTimeError(kFileNotFound);
  Touch(path);
}

void MemoryIo::Rename(const std::string& from, const std::string& to) {
  Changes(from);
  Changes(to);
  if (folders_.contains(from) || folders_.contains(to)) throw RunTimeError(kPathAccess);
  const auto node = Find(from);
  if (!node) throw RunTimeError(kFileNotFound);
  if (!folders_.contains(HostFolderOf(to))) throw RunTimeError(kPathNotFound);
  files_.erase(from);
  files_[to] = node;
  Touch(from);
  Touch(to);
}

void MemoryIo::Link(const std::string& from, const std::string& to) {
  Changes(to);
  const auto node = Find(from);
  if (!node) throw RunTimeError(kFileNotFound);
  if (files_.contains(to) || folders_.contains(to)) throw RunTimeError(kPathAccess);
  files_[to] = node;
  Touch(to);
}

std::unique_ptr<HostLock> MemoryIo::TryLock(const std::string& path, std::string_view,
                                            std::string&) {
  Changes(path);
  if (!files_.contains(path)) Open(path, OpenMode::kCreate);
  return std::make_unique<HostLock>();
}

}  // namespace kora::test
