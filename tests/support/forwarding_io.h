#pragma once

#include "base/io.h"

namespace kora::test {

// Hands every call on; a test takes those that it wants to see.
class ForwardingIo : public Io {
 public:
  explicit ForwardingIo(Io& base = MachineIo()) : base_(base) {}

  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
    return base_.Open(path, mode);
  }
  HostStatus Status(const std::string& path) override { return base_.Status(path); }
  std::vector<std::string> List(const std::string& folder) override { return base_.List(folder); }
  void MakeFolder(const std::string& path) override { base_.MakeFolder(path); }
  void Remove(const std::string& path) override { base_.Remove(path); }
  void Rename(const std::string& from, const std::string& to) override { base_.Rename(from, to); }
  void Link(const std::string& from, const std::string& to) override { base_.Link(from, to); }
  std::string LinkTarget(const std::string& path) override { return base_.LinkTarget(path); }
  void FlushFolder(const std::string& folder) override { base_.FlushFolder(folder); }
  void FlushDisk(const std::string& folder) override { base_.FlushDisk(folder); }
  std::unique_ptr<HostLock> TryLock(const std::string& path, std::string_view holder,
                                    std::string& heldBy) override {
    return base_.TryLock(path, holder, heldBy);
  }

 protected:
  Io& base_;
};

class ForwardingFile : public HostFile {
 public:
  explicit ForwardingFile(std::unique_ptr<HostFile> base) : base_(std::move(base)) {}

  size_t ReadAt(std::uint64_t offset, void* data, size_t size) override {
    return base_->ReadAt(offset, data, size);
  }
  void WriteAt(std::uint64_t offset, const void* data, size_t size) override {
    base_->WriteAt(offset, data, size);
  }
  std::uint64_t Size() override { return base_->Size(); }
  void Truncate(std::uint64_t size) override { base_->Truncate(size); }
  void Flush() override { base_->Flush(); }
  void TakeAccess(const HostStatus& like) override { base_->TakeAccess(like); }

 protected:
  std::unique_ptr<HostFile> base_;
};

}  // namespace kora::test
