#pragma once

#include <memory>
#include <string>
#include <vector>

#include "base/runtime_error.h"
#include "tests/support/forwarding_io.h"

namespace kora::test {

// The machine's file system, with one failure where the test wants it. Calls that change
// something on the disk are counted from 1 (opening for kCreate, kReplace or kNew, WriteAt,
// Truncate, Flush, TakeAccess, MakeFolder, Remove, Rename, Link, FlushFolder, FlushDisk); call
// number `failAt` raises `error`. Clearing away a file that a commit had beside another ("~" at its end) is not
// counted, since nothing hangs on it, and fails where everything does. A test that runs an
// operation for failAt = 1, 2, ... until it ends with calls < failAt has seen every way in which
// it can be cut off.
class FailingIo : public ForwardingIo {
 public:
  explicit FailingIo(Io& base = MachineIo()) : ForwardingIo(base) {}

  int failAt = 0;         // 0: never
  int error = kDiskFull;  // raised at the failing call
  bool lasting = false;   // every later change fails too, as after a kill
  bool torn = false;      // a failing WriteAt leaves the first half of its bytes
  bool kills = false;     // the process dies in place of the failing call
  int failReadAt = 0;     // the same for ReadAt and opening for reading; 0: never
  int readError = kDeviceError;

  int calls = 0;  // changes so far, the failed one counted
  int reads = 0;  // ReadAt and kRead opens so far

  void Reset(int at = 0) {
    failAt = at;
    calls = reads = 0;
  }

  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override;
  void MakeFolder(const std::string& path) override;
  void Remove(const std::string& path) override;
  void Rename(const std::string& from, const std::string& to) override;
  void FlushDisk(const std::string& folder) override;
  void Link(const std::string& from, const std::string& to) override;
  void FlushFolder(const std::string& folder) override;

 private:
  class File;
  bool Fails();  // counts the call
  void Change() {
    if (Fails()) throw RunTimeError(error);
  }
  void ReadCall() {
    if (++reads == failReadAt) throw RunTimeError(readError);
  }
};

}  // namespace kora::test
