#pragma once

#include <memory>
#include <string>
#include <vector>

#include "base/io.h"
#include "base/runtime_error.h"

namespace kora::test {

// The machine's file system, with one failure where the test wants it. Calls that change
// something on the disk are counted from 1 (opening for kCreate or kReplace, WriteAt, Truncate,
// Flush, MakeFolder, Remove, Rename); call number `failAt` raises `error`. A test that runs an
// operation for failAt = 1, 2, ... until it ends with calls < failAt has seen every way in which
// it can be cut off.
class FailingIo : public Io {
 public:
  explicit FailingIo(Io& base = MachineIo()) : base_(base) {}

  int failAt = 0;          // 0: never
  int error = kDiskFull;   // raised at the failing call
  bool lasting = false;    // every later change fails too, as after a kill
  bool torn = false;       // a failing WriteAt leaves the first half of its bytes
  bool kills = false;      // the process dies in place of the failing call
  int failReadAt = 0;      // the same for ReadAt and opening for reading; 0: never
  int readError = kDeviceError;

  int calls = 0;           // changes so far, the failed one counted
  int reads = 0;           // ReadAt and kRead opens so far

  void Reset(int at = 0) {
    failAt = at;
    calls = reads = 0;
  }

  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override;
  HostStatus Status(const std::string& path) override { return base_.Status(path); }
  std::vector<std::string> List(const std::string& folder) override { return base_.List(folder); }
  void MakeFolder(const std::string& path) override;
  void Remove(const std::string& path) override;
  void Rename(const std::string& from, const std::string& to) override;

 private:
  class File;
  bool Fails();  // counts the call
  void Change() {
    if (Fails()) throw RunTimeError(error);
  }
  void ReadCall() {
    if (++reads == failReadAt) throw RunTimeError(readError);
  }

  Io& base_;
};

}  // namespace kora::test
