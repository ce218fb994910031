#include "tests/support/failing_io.h"

#include <csignal>

namespace kora::test {

class FailingIo::File : public HostFile {
 public:
  File(FailingIo& io, std::unique_ptr<HostFile> base) : io_(io), base_(std::move(base)) {}

  size_t ReadAt(std::uint64_t offset, void* data, size_t size) override {
    io_.ReadCall();
    return base_->ReadAt(offset, data, size);
  }
  void WriteAt(std::uint64_t offset, const void* data, size_t size) override {
    if (io_.Fails()) {
      if (io_.torn && io_.calls == io_.failAt) base_->WriteAt(offset, data, size / 2);
      throw RunTimeError(io_.error);
    }
    base_->WriteAt(offset, data, size);
  }
  std::uint64_t Size() override { return base_->Size(); }
  void Truncate(std::uint64_t size) override {
    io_.Change();
    base_->Truncate(size);
  }
  void Flush() override {
    io_.Change();
    base_->Flush();
  }

 private:
  FailingIo& io_;
  std::unique_ptr<HostFile> base_;
};

bool FailingIo::Fails() {
  ++calls;
  if (kills && calls == failAt) std::raise(SIGKILL);
  return failAt > 0 && (calls == failAt || (lasting && calls > failAt));
}

std::unique_ptr<HostFile> FailingIo::Open(const std::string& path, OpenMode mode) {
  if (mode == OpenMode::kCreate || mode == OpenMode::kReplace) Change();
  if (mode == OpenMode::kRead) ReadCall();
  return std::make_unique<File>(*this, base_.Open(path, mode));
}

void FailingIo::MakeFolder(const std::string& path) {
  Change();
  base_.MakeFolder(path);
}

void FailingIo::Remove(const std::string& path) {
  Change();
  base_.Remove(path);
}

void FailingIo::Rename(const std::string& from, const std::string& to) {
  Change();
  base_.Rename(from, to);
}

}  // namespace kora::test
