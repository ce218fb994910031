#include "tests/support/failing_io.h"

#include <csignal>

namespace kora::test {

class FailingIo::File : public ForwardingFile {
 public:
  File(FailingIo& io, std::unique_ptr<HostFile> base) : ForwardingFile(std::move(base)), io_(io) {}

  size_t ReadAt(std::uint64_t offset, void* data, size_t size) override {
    io_.ReadCall();
    return base_->ReadAt(offset, data, size);
  }
  void WriteAt(std::uint64_t offset, const void* data, size_t size) override {
    if (io_.torn && io_.calls + 1 == io_.failAt) base_->WriteAt(offset, data, size / 2);
    if (io_.Fails()) throw RunTimeError(io_.error);
    base_->WriteAt(offset, data, size);
  }
  void Truncate(std::uint64_t size) override {
    io_.Change();
    base_->Truncate(size);
  }
  void Flush() override {
    io_.Change();  // the disk itself is left alone: tests lose no power
  }
  void TakeAccess(const HostStatus& like) override {
    io_.Change();
    base_->TakeAccess(like);
  }

 private:
  FailingIo& io_;
};

bool FailingIo::Fails() {
  ++calls;
  if (kills && calls == failAt) std::raise(SIGKILL);
  return failAt > 0 && (calls == failAt || (lasting && calls > failAt));
}

std::unique_ptr<HostFile> FailingIo::Open(const std::string& path, OpenMode mode) {
  // A new file under a name that is taken is refused, and changes nothing.
  const bool refused = mode == OpenMode::kNew && base_.Status(path).exists;
  if (mode != OpenMode::kRead && mode != OpenMode::kReadWrite && !refused) Change();
  if (mode == OpenMode::kRead) ReadCall();
  return std::make_unique<File>(*this, base_.Open(path, mode));
}

void FailingIo::MakeFolder(const std::string& path) {
  Change();
  base_.MakeFolder(path);
}

void FailingIo::Remove(const std::string& path) {
  if (!path.ends_with('~')) {
    Change();
  } else if (lasting && failAt > 0 && calls >= failAt) {
    throw RunTimeError(error);
  }
  base_.Remove(path);
}

void FailingIo::Rename(const std::string& from, const std::string& to) {
  Change();
  base_.Rename(from, to);
}

void FailingIo::FlushDisk(const std::string&) { Change(); }

void FailingIo::Link(const std::string& from, const std::string& to) {
  if (!base_.Status(to).exists) Change();  // as above
  base_.Link(from, to);
}

void FailingIo::FlushFolder(const std::string&) { Change(); }

}  // namespace kora::test
