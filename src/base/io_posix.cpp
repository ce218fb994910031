#include <cerrno>
#include <chrono>
#include <cstring>
#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "base/io.h"
#include "base/runtime_error.h"

namespace kora {
namespace {

bool FolderExists(const std::string& path) {
  struct stat st;
  const size_t slash = path.rfind('/');
  const std::string folder = slash == std::string::npos ? "." : path.substr(0, slash + 1);
  return ::stat(folder.c_str(), &st) == 0 && S_ISDIR(st.st_mode);
}

[[noreturn]] void Fail(int error, const std::string& path) {
  int number = kDeviceError;
  switch (error) {
    case ENOENT:
    case ENOTDIR: number = FolderExists(path) ? kFileNotFound : kPathNotFound; break;
    case ENAMETOOLONG:
    case EINVAL: number = kBadFileName; break;
    case EACCES:
    case EPERM:
    case EISDIR:
    case EROFS:
    case EEXIST:
    case ENOTEMPTY:
    case ELOOP:
    case ETXTBSY: number = kPathAccess; break;
    case ENOSPC:
    case EDQUOT:
    case EFBIG: number = kDiskFull; break;
    case EMFILE:
    case ENFILE: number = kTooManyFiles; break;
    case ENOMEM: number = kOutOfMemory; break;
    case ENODEV:
    case ENXIO: number = kDeviceNotAvailable; break;
    default: break;
  }
  throw RunTimeError(number, std::strerror(error));
}

class PosixFile : public HostFile {
 public:
  explicit PosixFile(int fd) : fd_(fd) {}
  ~PosixFile() override { ::close(fd_); }

  size_t ReadAt(std::uint64_t offset, void* data, size_t size) override {
    size_t done = 0;
    while (done < size) {
      const ssize_t n =
          ::pread(fd_, static_cast<char*>(data) + done, size - done, off_t(offset + done));
      if (n < 0 && errno == EINTR) continue;
      if (n < 0) Fail(errno, {});
      if (n == 0) break;
      done += size_t(n);
    }
    return done;
  }

  void WriteAt(std::uint64_t offset, const void* data, size_t size) override {
    size_t done = 0;
    while (done < size) {
      const ssize_t n =
          ::pwrite(fd_, static_cast<const char*>(data) + done, size - done, off_t(offset + done));
      if (n < 0 && errno == EINTR) continue;
      if (n <= 0) Fail(n < 0 ? errno : ENOSPC, {});
      done += size_t(n);
    }
  }

  std::uint64_t Size() override {
    struct stat st;
    if (::fstat(fd_, &st) != 0) Fail(errno, {});
    // A folder, pipe or socket in the place of a file has no bytes to count.
    if (!S_ISREG(st.st_mode) && !S_ISCHR(st.st_mode)) Fail(EISDIR, {});
    return std::uint64_t(st.st_size);
  }

  void Truncate(std::uint64_t size) override {
    if (::ftruncate(fd_, off_t(size)) != 0) Fail(errno, {});
  }

  void Flush() override {
    if (::fsync(fd_) != 0 && errno != EINVAL) Fail(errno, {});
  }

 private:
  int fd_;
};

class PosixIo : public Io {
 public:
  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
    int flags = O_CLOEXEC;
    switch (mode) {
      case OpenMode::kRead: flags |= O_RDONLY; break;
      case OpenMode::kReadWrite: flags |= O_RDWR; break;
      case OpenMode::kCreate: flags |= O_RDWR | O_CREAT; break;
      case OpenMode::kReplace: flags |= O_RDWR | O_CREAT | O_TRUNC; break;
    }
    // A pipe in the place of a file must not hang the open.
    int fd;
    do fd = ::open(path.c_str(), flags | O_NONBLOCK, 0666);
    while (fd < 0 && errno == EINTR);
    if (fd < 0) Fail(errno, path);
    return std::make_unique<PosixFile>(fd);
  }

  HostStatus Status(const std::string& path) override {
    struct stat st;
    HostStatus out;
    if (::stat(path.c_str(), &st) != 0) return out;
    out.exists = true;
    out.folder = S_ISDIR(st.st_mode);
    out.size = std::uint64_t(st.st_size);
#ifdef __APPLE__
    out.modified = std::int64_t(st.st_mtimespec.tv_sec) * 1000000000 + st.st_mtimespec.tv_nsec;
#else
    out.modified = std::int64_t(st.st_mtim.tv_sec) * 1000000000 + st.st_mtim.tv_nsec;
#endif
    return out;
  }

  std::vector<std::string> List(const std::string& folder) override {
    DIR* dir = ::opendir(folder.c_str());
    if (!dir) Fail(errno, folder + "/");
    std::vector<std::string> names;
    while (const dirent* entry = ::readdir(dir)) {
      const std::string name = entry->d_name;
      if (name != "." && name != "..") names.push_back(name);
    }
    ::closedir(dir);
    return names;
  }

  void MakeFolder(const std::string& path) override {
    if (::mkdir(path.c_str(), 0777) != 0) Fail(errno, path);
  }

  void Remove(const std::string& path) override {
    if (::unlink(path.c_str()) != 0) Fail(errno, path);
  }

  void Rename(const std::string& from, const std::string& to) override {
    if (::rename(from.c_str(), to.c_str()) == 0) return;
    const int error = errno;
    struct stat st;
    Fail(error, ::lstat(from.c_str(), &st) == 0 ? to : from);
  }
};

}  // namespace

bool TimeIsSettled(std::int64_t modified) {
  using namespace std::chrono;
  const auto now = duration_cast<nanoseconds>(system_clock::now().time_since_epoch()).count();
  return modified < now - 2500000000;
}

Io& MachineIo() {
  static PosixIo io;
  return io;
}

}  // namespace kora
