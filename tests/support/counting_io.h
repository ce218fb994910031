#pragma once

#include "tests/support/forwarding_io.h"

namespace kora::test {

// The machine's file system, counting what is asked of it.
class CountingIo : public ForwardingIo {
 public:
  int opens = 0, stats = 0, lists = 0, renames = 0;
  bool refuseLists = false;  // as a folder does that may be entered but not read

  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
    ++opens;
    return MachineIo().Open(path, mode);
  }
  HostStatus Status(const std::string& path) override {
    ++stats;
    return MachineIo().Status(path);
  }
  std::vector<std::string> List(const std::string& folder) override;
  void Rename(const std::string& from, const std::string& to) override {
    ++renames;
    MachineIo().Rename(from, to);
  }
};

}  // namespace kora::test
