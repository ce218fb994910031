#include <dirent.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cstring>
#include <utility>

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
    case EMLINK:
    case EXDEV:
    case EOPNOTSUPP: number = kPathAccess; break;
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
  ~PosixFile() override {
    if (fd_ >= 0) ::close(fd_);
  }
  int Release() { return std::exchange(fd_, -1); }

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

  std::uint64_t CopyFrom(HostFile& source) override {
    std::uint64_t done = 0;
#ifdef __linux__
    // Between two file systems of a kind that can't, and from files that only seem to have no bytes,
    // the kernel copies nothing: then the bytes go through the program.
    if (const auto* from = dynamic_cast<const PosixFile*>(&source)) {
      off_t in = 0, out = 0;
      for (;;) {
        const ssize_t n = ::copy_file_range(from->fd_, &in, fd_, &out, kMostAtOnce, 0);
        if (n < 0 && errno == EINTR) continue;
        if (n < 0 && (errno == ENOSPC || errno == EDQUOT || errno == EFBIG || errno == EIO))
          Fail(errno, {});
        if (n == 0 && done > 0) return done;
        if (n <= 0) break;
        done += std::uint64_t(n);
      }
    }
#endif
    return done + CopyRest(source, done);
  }

  void Truncate(std::uint64_t size) override {
    if (::ftruncate(fd_, off_t(size)) != 0) Fail(errno, {});
  }

  void Flush() override {
    if (::fsync(fd_) != 0 && errno != EINVAL) Fail(errno, {});
  }

  void TakeAccess(const HostStatus& like) override {
    // Who may not give the file away keeps it; its permissions follow all the same. A file system
    // without owners refuses both.
    if (::fchown(fd_, like.owner, like.group) != 0 && errno == EPERM)
      Pass(::fchown(fd_, uid_t(-1), like.group));
    Pass(::fchmod(fd_, mode_t(like.mode)));
  }

 private:
  static void Pass(int result) {
    if (result != 0 && errno != EPERM && errno != EOPNOTSUPP && errno != EINVAL) Fail(errno, {});
  }

  static constexpr size_t kMostAtOnce = 1u << 30;

  int fd_;
};

constexpr size_t kHolderSize = 256;

class PosixLock : public HostLock {
 public:
  explicit PosixLock(int fd) : fd_(fd) {}
  ~PosixLock() override {
    // A holder's name left behind would be told for that of the next one.
    Write({});
    ::close(fd_);
  }
  // Always of one size, so that a disk that filled up meanwhile has room for it. A lock whose
  // holder can't be written is one all the same.
  void Write(std::string_view holder) {
    std::string text(holder.substr(0, kHolderSize - 1));
    text.resize(kHolderSize - 1, ' ');
    text += '\n';
    [[maybe_unused]] const ssize_t done = ::pwrite(fd_, text.data(), text.size(), 0);
  }

 private:
  int fd_;
};

std::int64_t ModifiedOf(const struct stat& st) {
#ifdef __APPLE__
  return std::int64_t(st.st_mtimespec.tv_sec) * 1000000000 + st.st_mtimespec.tv_nsec;
#else
  return std::int64_t(st.st_mtim.tv_sec) * 1000000000 + st.st_mtim.tv_nsec;
#endif
}

class PosixIo : public Io {
 public:
  bool AnyThread() const override { return true; }
  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
    int flags = O_CLOEXEC;
    switch (mode) {
      case OpenMode::kRead: flags |= O_RDONLY; break;
      case OpenMode::kReadWrite: flags |= O_RDWR; break;
      case OpenMode::kCreate: flags |= O_RDWR | O_CREAT; break;
      case OpenMode::kReplace: flags |= O_RDWR | O_CREAT | O_TRUNC; break;
      case OpenMode::kNew: flags |= O_RDWR | O_CREAT | O_EXCL | O_NOFOLLOW; break;
    }
    // A pipe in the place of a file must not hang the open.
    int fd;
    do fd = ::open(path.c_str(), flags | O_NONBLOCK, 0666);
    while (fd < 0 && errno == EINTR);
    if (fd < 0) Fail(errno, path);
    // While it is open others see that it is being made. Where there are no locks, nobody does.
    if (mode == OpenMode::kNew) ::flock(fd, LOCK_EX | LOCK_NB);
    return std::make_unique<PosixFile>(fd);
  }

  HostStatus Status(const std::string& path) override {
    struct stat st;
    HostStatus out;
    if (::stat(path.c_str(), &st) != 0) {
      switch (errno) {
        case ENOENT:
        case ENOTDIR:
        case EACCES:
        case EPERM:
        case ELOOP:
        case EINVAL:
        case ENAMETOOLONG: return out;
        default: Fail(errno, path);
      }
    }
    out.exists = true;
    out.folder = S_ISDIR(st.st_mode);
    out.plain = S_ISREG(st.st_mode);
    out.size = std::uint64_t(st.st_size);
    out.modified = ModifiedOf(st);
    out.id = std::uint64_t(st.st_ino);
    out.mode = std::uint32_t(st.st_mode & 07777);
    out.owner = std::uint32_t(st.st_uid);
    out.group = std::uint32_t(st.st_gid);
    // The super-user may write what everybody has locked, and does not mean to.
    out.readOnly = (st.st_mode & 0222) == 0;
    return out;
  }

  std::vector<std::string> List(const std::string& folder) override {
    DIR* dir = ::opendir(folder.c_str());
    if (!dir) Fail(errno, folder + "/");
    const std::unique_ptr<DIR, int (*)(DIR*)> closing(dir, ::closedir);
    std::vector<std::string> names;
    for (;;) {
      errno = 0;
      const dirent* entry = ::readdir(dir);
      if (!entry && errno != 0) Fail(errno, folder + "/");
      if (!entry) return names;
      const std::string_view name = entry->d_name;
      if (name != "." && name != "..") names.emplace_back(name);
    }
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

  void FlushDisk(const std::string& folder) override {
#ifdef __linux__
    int fd;
    do fd = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    while (fd < 0 && errno == EINTR);
    if (fd < 0 && errno != EACCES) Fail(errno, folder + "/");
    const int error = fd < 0 || ::syncfs(fd) == 0 ? 0 : errno;
    if (fd >= 0) ::close(fd);
    // A folder that may not be read, or a file system that knows no flush of its own.
    if (fd < 0 || error == ENOSYS || error == EINVAL || error == EOPNOTSUPP) {
      ::sync();
    } else if (error != 0) {
      Fail(error, folder + "/");
    }
#else
    (void)folder;
    ::sync();
#endif
  }

  void Link(const std::string& from, const std::string& to) override {
    if (::link(from.c_str(), to.c_str()) != 0) Fail(errno, from);
  }

  std::string LinkTarget(const std::string& path) override {
    constexpr int kLongestChain = 40;
    std::string host = path;
    for (int links = 0; links < kLongestChain; ++links) {
      std::string target(kLongestPath, '\0');
      const ssize_t size = ::readlink(host.c_str(), target.data(), target.size());
      if (size < 0 && (errno == EINVAL || errno == ENOENT || errno == ENOTDIR)) return host;
      if (size < 0) Fail(errno, host);
      target.resize(size_t(size));
      if (target.starts_with('/')) {
        host = std::move(target);
      } else {
        const size_t slash = host.rfind('/');
        host = slash == std::string::npos ? target : host.substr(0, slash + 1) + target;
      }
    }
    Fail(ELOOP, path);
  }

  void FlushFolder(const std::string& folder) override {
    int fd;
    do fd = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    while (fd < 0 && errno == EINTR);
    // One that may be written but not read can't be opened, and some hosts flush no folders.
    if (fd < 0 && errno == EACCES) return;
    if (fd < 0) Fail(errno, folder + "/");
    const int error = ::fsync(fd) != 0 ? errno : 0;
    ::close(fd);
    if (error != 0 && error != EINVAL && error != EOPNOTSUPP && error != EBADF)
      Fail(error, folder + "/");
  }

  std::unique_ptr<HostLock> TryLock(const std::string& path, std::string_view holder,
                                    std::string& heldBy) override {
    heldBy.clear();
    int fd;
    do fd = ::open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK, 0666);
    while (fd < 0 && errno == EINTR);
    if (fd < 0) Fail(errno, path);
    auto lock = std::make_unique<PosixFile>(fd);  // closes it unless the lock takes it over
    int result;
    do result = ::flock(fd, LOCK_EX | LOCK_NB);
    while (result != 0 && errno == EINTR);
    if (result != 0 && errno != EWOULDBLOCK && errno != EACCES) Fail(errno, path);
    if (result != 0) {
      std::string text(kHolderSize, ' ');
      text.resize(lock->ReadAt(0, text.data(), text.size()));
      heldBy = text.substr(0, text.find_last_not_of(" \n") + 1);
      return nullptr;
    }
    auto held = std::make_unique<PosixLock>(lock->Release());
    held->Write(holder);
    return held;
  }

 private:
  static constexpr size_t kLongestPath = 4096;
};

}  // namespace

std::uint64_t HostFile::CopyFrom(HostFile& source) { return CopyRest(source, 0); }

std::uint64_t HostFile::CopyRest(HostFile& source, std::uint64_t at) {
  constexpr size_t kBlock = 1 << 20;
  const std::uint64_t first = at;
  const std::uint64_t size = source.Size();
  std::string block(std::min<std::uint64_t>(kBlock, (size > at ? size - at : 0) + 1), '\0');
  while (const size_t got = source.ReadAt(at, block.data(), block.size())) {
    WriteAt(at, block.data(), got);
    at += got;
    // One that grew meanwhile.
    if (block.size() < kBlock) block.resize(kBlock);
  }
  return at - first;
}

std::string HostFolderOf(const std::string& path) {
  const size_t slash = path.rfind('/');
  if (slash == std::string::npos) return ".";
  return slash == 0 ? "/" : path.substr(0, slash);
}

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
