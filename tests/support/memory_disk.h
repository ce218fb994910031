#pragma once

#include <functional>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "base/io.h"

namespace kora::test {

// What stands on a disk: a value, cheap to copy, since files share their bytes until they change.
struct Disk {
  struct Bytes {
    explicit Bytes(std::string all) : text(std::move(all)), hash(std::hash<std::string>{}(text)) {}
    const std::string text;
    const size_t hash;
  };
  struct Node {
    bool folder = false;
    std::string link;  // of a link: where it leads
    std::shared_ptr<const Bytes> bytes;
    std::int64_t modified = 0;
    std::uint32_t mode = 0666;
  };
  std::map<std::string, std::uint64_t> names;  // by absolute path; two may be one node
  std::map<std::uint64_t, Node> nodes;
  std::uint64_t last = 0;  // id given last
  std::int64_t clock = 1;  // time of the last change: far back, so that each one shows
};

// A disk in memory, with links and permissions. Before each change it tells what is about to be done, so that one run
// of an operation shows every state in which the end of a process could leave the disk: that is
// how a disk looks to whoever comes next.
class MemoryDisk : public Io {
 public:
  Disk disk;
  // Told with the disk as it is before the change, and, for a write, as it is with a part of the
  // bytes written.
  std::function<void(const std::string& what, const Disk& disk)> watch;

  MemoryDisk() { MakeRoot(); }
  explicit MemoryDisk(const Disk& start) : disk(start) {}

  // For scenes: a file with its folders, without a word to `watch`.
  void Put(const std::string& path, std::string bytes);
  void PutLink(const std::string& path, const std::string& target);

  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override;
  HostStatus Status(const std::string& path) override;
  std::vector<std::string> List(const std::string& folder) override;
  void MakeFolder(const std::string& path) override;
  void Remove(const std::string& path) override;
  void Rename(const std::string& from, const std::string& to) override;
  void Link(const std::string& from, const std::string& to) override;
  std::string LinkTarget(const std::string& path) override;
  void FlushFolder(const std::string& folder) override;
  void FlushDisk(const std::string& folder) override;
  std::unique_ptr<HostLock> TryLock(const std::string& path, std::string_view holder,
                                    std::string& heldBy) override;

 private:
  class File;
  class Lock;
  void MakeRoot();
  void Tell(const char* verb, const std::string& path, const std::string& to = {});
  std::uint64_t Find(const std::string& path) const;  // of a name, links not followed; 0: none
  std::uint64_t Add(const std::string& path, Disk::Node node);
  void Touch(const std::string& path);  // the folder that holds it changed
  void Drop(std::uint64_t id);          // unless it has another name
  [[noreturn]] void FailMissing(const std::string& path) const;
  void RefuseReadOnlyFolder(const std::string& path) const;
  std::set<std::uint64_t> locked_;  // nodes
};

}  // namespace kora::test
