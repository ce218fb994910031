#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "base/io.h"

namespace kora::test {

// A file system in memory, in which thousands of homes a second can be made. It begins with the
// folders "home" and "home/drive_c". Errors are those of Io.
//
// A path that climbs by "..", or holds a NUL, is a broken promise of whoever made it and ends the
// process, as does a change outside of "home" while `confined`.
class MemoryIo : public Io {
 public:
  MemoryIo();

  bool confined = true;

  // `path` is a host path, "home/drive_c/korawin/x"; the folders above are made.
  void Put(const std::string& path, std::string_view bytes);
  std::string Get(const std::string& path) const;  // empty when it is not there
  // All files with their bytes, but for the lock's.
  std::map<std::string, std::string> Store() const;

  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override;
  HostStatus Status(const std::string& path) override;
  std::vector<std::string> List(const std::string& folder) override;
  void MakeFolder(const std::string& path) override;
  void Remove(const std::string& path) override;
  void Rename(const std::string& from, const std::string& to) override;
  void Link(const std::string& from, const std::string& to) override;
  std::string LinkTarget(const std::string& path) override { return path; }
  void FlushFolder(const std::string&) override {}
  std::unique_ptr<HostLock> TryLock(const std::string& path, std::string_view holder,
                                    std::string& heldBy) override;

 private:
  struct Node {
    std::string bytes;
    std::int64_t modified = 0;
    std::uint64_t id = 0;
  };
  class File;

  void Changes(const std::string& path) const;
  std::shared_ptr<Node> Find(const std::string& path) const;
  void Touch(const std::string& path);  // the folder of an entry that came or went

  std::int64_t now_ = 0;  // a tick a change; long ago, so that every time is settled
  std::map<std::string, std::shared_ptr<Node>> files_;
  std::map<std::string, std::int64_t> folders_;  // with the time of their last change
};

// Ends the process where it did not hold.
void Promise(bool held, const char* what);

}  // namespace kora::test
