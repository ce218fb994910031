#include "tests/support/memory_disk.h"

#include <algorithm>
#include <cstring>

#include "base/runtime_error.h"

namespace kora::test {
namespace {

const std::shared_ptr<const Disk::Bytes>& NoBytes() {
  static const auto none = std::make_shared<const Disk::Bytes>("");
  return none;
}

std::shared_ptr<const Disk::Bytes> Shared(std::string text) {
  return std::make_shared<const Disk::Bytes>(std::move(text));
}

std::string Changed(const std::string& old, std::uint64_t offset, const void* data, size_t size) {
  std::string text = old;
  if (size > 0 && text.size() < offset + size) text.resize(size_t(offset) + size, '\0');
  if (size > 0) std::memcpy(text.data() + offset, data, size);
  return text;
}

}  // namespace

class MemoryDisk::File : public HostFile {
 public:
  File(MemoryDisk& io, std::string path, std::uint64_t id, bool writes, bool locks)
      : io_(io), path_(std::move(path)), id_(id), writes_(writes), locks_(locks) {
    if (locks_) io_.locked_.insert(id_);
    Node();
  }
  ~File() override {
    if (locks_) io_.locked_.erase(id_);
  }

  size_t ReadAt(std::uint64_t offset, void* data, size_t size) override {
    const std::string& text = Node().bytes->text;
    if (offset >= text.size()) return 0;
    const size_t got = std::min(size, text.size() - size_t(offset));
    std::memcpy(data, text.data() + offset, got);
    return got;
  }
  void WriteAt(std::uint64_t offset, const void* data, size_t size) override {
    RefuseReader();
    io_.Tell("write", path_);
    if (io_.watch && size > 1) {
      // A process that dies within the call leaves a part of it.
      const auto old = Node().bytes;
      for (const size_t part : {size / 2, size - 1}) {
        Node().bytes = Shared(Changed(old->text, offset, data, part));
        io_.Tell(part == size - 1 ? "write all but one byte of" : "write half of", path_);
        Node().bytes = old;
        if (size == 2) break;
      }
    }
    Replace(Changed(Node().bytes->text, offset, data, size));
  }
  std::uint64_t Size() override { return Node().bytes->text.size(); }
  void Truncate(std::uint64_t size) override {
    RefuseReader();
    io_.Tell("cut", path_);
    std::string text = Node().bytes->text;
    text.resize(size_t(size), '\0');
    Replace(std::move(text));
  }
  std::uint64_t CopyFrom(HostFile& source) override { return CopyRest(source, 0); }
  void Flush() override { io_.Tell("flush", path_); }
  void TakeAccess(const HostStatus& like) override {
    io_.Tell("give access to", path_);
    Node().mode = like.mode;
  }

 private:
  // A file that has no name any more is gone from the disk, and serves those that have it open.
  Disk::Node& Node() {
    const auto found = io_.disk.nodes.find(id_);
    if (found != io_.disk.nodes.end()) {
      nameless_ = found->second;
      return found->second;
    }
    return nameless_;
  }
  void RefuseReader() const {
    if (!writes_) throw RunTimeError(kDeviceError);
  }
  void Replace(std::string text) {
    Disk::Node& node = Node();
    node.bytes = Shared(std::move(text));
    node.modified = ++io_.disk.clock;
  }

  MemoryDisk& io_;
  const std::string path_;
  const std::uint64_t id_;
  const bool writes_, locks_;
  Disk::Node nameless_;
};

class MemoryDisk::Lock : public HostLock {
 public:
  Lock(MemoryDisk& io, std::uint64_t id) : io_(io), id_(id) { io_.locked_.insert(id_); }
  ~Lock() override { io_.locked_.erase(id_); }

 private:
  MemoryDisk& io_;
  const std::uint64_t id_;
};

void MemoryDisk::MakeRoot() {
  disk.nodes[++disk.last] = {
      .folder = true, .link = {}, .bytes = NoBytes(), .modified = 1, .mode = 0777};
  disk.names["/"] = disk.last;
}

void MemoryDisk::Put(const std::string& path, std::string bytes) {
  for (size_t at = path.find('/', 1); at != std::string::npos; at = path.find('/', at + 1)) {
    const std::string folder = path.substr(0, at);
    if (Find(folder) == 0)
      Add(folder, {.folder = true, .link = {}, .bytes = NoBytes(), .mode = 0777});
  }
  if (const std::uint64_t id = Find(path)) {
    disk.nodes[id].bytes = Shared(std::move(bytes));
    disk.nodes[id].modified = ++disk.clock;
  } else {
    Add(path, {.folder = false, .link = {}, .bytes = Shared(std::move(bytes))});
  }
}

void MemoryDisk::PutLink(const std::string& path, const std::string& target) {
  if (const std::uint64_t id = Find(path)) {
    disk.names.erase(path);
    Drop(id);
  }
  Add(path, {.folder = false, .link = target, .bytes = NoBytes()});
}

void MemoryDisk::Tell(const char* verb, const std::string& path, const std::string& to) {
  if (watch) watch(std::string(verb) + " " + path + (to.empty() ? "" : " to " + to), disk);
}

std::uint64_t MemoryDisk::Find(const std::string& path) const {
  const auto found = disk.names.find(
      path.size() > 1 && path.back() == '/' ? path.substr(0, path.size() - 1) : path);
  return found == disk.names.end() ? 0 : found->second;
}

std::uint64_t MemoryDisk::Add(const std::string& path, Disk::Node node) {
  node.modified = ++disk.clock;
  disk.nodes[++disk.last] = std::move(node);
  disk.names[path] = disk.last;
  Touch(path);
  return disk.last;
}

void MemoryDisk::Touch(const std::string& path) {
  if (const std::uint64_t folder = Find(HostFolderOf(path)))
    disk.nodes[folder].modified = ++disk.clock;
}

void MemoryDisk::Drop(std::uint64_t id) {
  for (const auto& [name, node] : disk.names)
    if (node == id) return;
  disk.nodes.erase(id);
}

void MemoryDisk::FailMissing(const std::string& path) const {
  const std::uint64_t folder = Find(HostFolderOf(path));
  const bool there = folder != 0 && disk.nodes.at(folder).folder;
  throw RunTimeError(there ? kFileNotFound : kPathNotFound, "No such file or directory");
}

void MemoryDisk::RefuseReadOnlyFolder(const std::string& path) const {
  const std::uint64_t folder = Find(HostFolderOf(path));
  if (folder == 0) FailMissing(path);
  if ((disk.nodes.at(folder).mode & 0222) == 0)
    throw RunTimeError(kPathAccess, "Permission denied");
}

std::unique_ptr<HostFile> MemoryDisk::Open(const std::string& named, OpenMode mode) {
  const bool fresh = mode == OpenMode::kNew;
  const std::string path = fresh ? named : LinkTarget(named);
  std::uint64_t id = Find(path);
  const bool writes = mode != OpenMode::kRead;
  if (id != 0 && fresh) throw RunTimeError(kPathAccess, "File exists");
  if (id != 0 && disk.nodes[id].folder) throw RunTimeError(kPathAccess, "Is a directory");
  if (id != 0 && writes && (disk.nodes[id].mode & 0222) == 0)
    throw RunTimeError(kPathAccess, "Permission denied");
  if (id == 0 && !(fresh || mode == OpenMode::kCreate || mode == OpenMode::kReplace))
    FailMissing(path);
  if (id == 0) {
    RefuseReadOnlyFolder(path);
    Tell("make", path);
    id = Add(path, {.folder = false, .link = {}, .bytes = NoBytes()});
  } else if (mode == OpenMode::kReplace) {
    Tell("empty", path);
    disk.nodes[id].bytes = NoBytes();
    disk.nodes[id].modified = ++disk.clock;
  }
  return std::make_unique<File>(*this, path, id, writes, fresh);
}

HostStatus MemoryDisk::Status(const std::string& path) {
  HostStatus out;
  const std::uint64_t id = Find(LinkTarget(path));
  if (id == 0) return out;
  const Disk::Node& node = disk.nodes[id];
  out.exists = true;
  out.folder = node.folder;
  out.plain = !node.folder;
  out.readOnly = (node.mode & 0222) == 0;
  out.size = node.bytes->text.size();
  out.modified = node.modified;
  out.id = id;
  out.mode = node.mode;
  return out;
}

std::vector<std::string> MemoryDisk::List(const std::string& folder) {
  const std::uint64_t id = Find(folder);
  if (id == 0) FailMissing(folder + "/");
  if (!disk.nodes[id].folder) throw RunTimeError(kFileNotFound, "Not a directory");
  std::vector<std::string> names;
  const std::string head = folder.ends_with('/') ? folder : folder + "/";
  for (auto at = disk.names.lower_bound(head);
       at != disk.names.end() && at->first.starts_with(head); ++at) {
    const std::string name = at->first.substr(head.size());
    if (!name.empty() && name.find('/') == std::string::npos) names.push_back(name);
  }
  return names;
}

void MemoryDisk::MakeFolder(const std::string& path) {
  if (Find(path) != 0) throw RunTimeError(kPathAccess, "File exists");
  RefuseReadOnlyFolder(path);
  Tell("make the folder", path);
  Add(path, {.folder = true, .link = {}, .bytes = NoBytes(), .mode = 0777});
}

void MemoryDisk::Remove(const std::string& path) {
  const std::uint64_t id = Find(path);
  if (id == 0) FailMissing(path);
  if (disk.nodes[id].folder) throw RunTimeError(kPathAccess, "Is a directory");
  RefuseReadOnlyFolder(path);
  Tell("remove", path);
  disk.names.erase(path);
  Drop(id);
  Touch(path);
}

void MemoryDisk::Rename(const std::string& from, const std::string& to) {
  const std::uint64_t id = Find(from), gone = Find(to);
  if (id == 0) FailMissing(from);
  if (disk.nodes[id].folder) throw RunTimeError(kDeviceError, "Folders are not renamed here");
  if (gone != 0 && disk.nodes[gone].folder) throw RunTimeError(kPathAccess, "Is a directory");
  RefuseReadOnlyFolder(from);
  RefuseReadOnlyFolder(to);
  Tell("rename", from, to);
  if (id == gone) return;  // two names of one file: both stay
  disk.names.erase(from);
  disk.names[to] = id;
  if (gone != 0) Drop(gone);
  Touch(from);
  Touch(to);
}

void MemoryDisk::Link(const std::string& from, const std::string& to) {
  const std::uint64_t id = Find(from);
  if (id == 0) FailMissing(from);
  if (Find(to) != 0) throw RunTimeError(kPathAccess, "File exists");
  RefuseReadOnlyFolder(to);
  Tell("link", from, to);
  disk.names[to] = id;
  Touch(to);
}

std::string MemoryDisk::LinkTarget(const std::string& path) {
  std::string host = path;
  for (int links = 0; links < 40; ++links) {
    const std::uint64_t id = Find(host);
    if (id == 0 || disk.nodes[id].link.empty()) return host;
    const std::string& target = disk.nodes[id].link;
    host = target.starts_with('/') ? target : HostFolderOf(host) + "/" + target;
  }
  throw RunTimeError(kPathAccess, "Too many levels of symbolic links");
}

void MemoryDisk::FlushFolder(const std::string& folder) { Tell("flush the folder", folder); }
void MemoryDisk::FlushDisk(const std::string& folder) { Tell("flush the disk of", folder); }

std::unique_ptr<HostLock> MemoryDisk::TryLock(const std::string& path, std::string_view holder,
                                              std::string& heldBy) {
  heldBy.clear();
  std::uint64_t id = Find(path);
  if (id == 0) {
    RefuseReadOnlyFolder(path);
    Tell("make", path);
    id = Add(path, {.folder = false, .link = {}, .bytes = NoBytes()});
  }
  if (locked_.contains(id)) {
    heldBy = disk.nodes[id].bytes->text;
    return nullptr;
  }
  if (!holder.empty()) disk.nodes[id].bytes = Shared(std::string(holder));
  return std::make_unique<Lock>(*this, id);
}

}  // namespace kora::test
