#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

// The host's file system, as few calls as the program needs. Every call raises RunTimeError
// with the number that fits the host's own failure: 53 no such file, 76 no such folder, 75 no
// access (or a folder where a file should be), 61 disk full, 67 too many files, 57 any other.
// Tests put a failing layer in its place.

namespace kora {

struct HostStatus {
  bool exists = false;
  bool folder = false;
  bool plain = false;     // a file of bytes: no folder, device, pipe or socket
  bool readOnly = false;  // nobody may write it, the super-user included
  std::uint64_t size = 0;
  std::int64_t modified = 0;  // nanoseconds since 1970, clock of the file system
  std::uint64_t id = 0;       // of the file itself: another one under its name has another
  std::uint32_t mode = 0;     // permissions
  std::uint32_t owner = 0;
  std::uint32_t group = 0;
};

class HostFile {
 public:
  virtual ~HostFile() = default;
  // Reads up to `size` bytes; fewer only at the end of the file.
  virtual size_t ReadAt(std::uint64_t offset, void* data, size_t size) = 0;
  // Writes all or raises.
  virtual void WriteAt(std::uint64_t offset, const void* data, size_t size) = 0;
  virtual std::uint64_t Size() = 0;  // bytes
  // Cuts the file to `size` bytes, or fills it up with zeros.
  virtual void Truncate(std::uint64_t size) = 0;
  // Writes all that `source` has into this file, from its start on, which is empty before. How many
  // bytes that were. A host that can copies them without handing them to the program.
  virtual std::uint64_t CopyFrom(HostFile& source);
  // Returns once the bytes are on the disk.
  virtual void Flush() = 0;
  // Gives it the permissions, owner and group of `like`, as far as the host lets this user.
  virtual void TakeAccess(const HostStatus& like) = 0;

 protected:
  // What `source` has behind the first `at` bytes, to the same place here; how many.
  std::uint64_t CopyRest(HostFile& source, std::uint64_t at);
};

enum class OpenMode {
  kRead,       // must exist
  kReadWrite,  // must exist
  kCreate,     // made when missing, kept when there; read and write
  kReplace,    // made when missing, emptied when there; read and write
  kNew,        // error 75 when anything is there, a link too; read and write
};

// Held until it is destroyed, or the process ends, however that happens.
class HostLock {
 public:
  virtual ~HostLock() = default;
};

class Io {
 public:
  virtual ~Io() = default;
  virtual std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) = 0;
  // Of what a link leads to. What may not be looked at does not exist.
  virtual HostStatus Status(const std::string& path) = 0;
  // Names of files and folders in it, in no order, without "." and "..".
  virtual std::vector<std::string> List(const std::string& folder) = 0;
  virtual void MakeFolder(const std::string& path) = 0;
  virtual void Remove(const std::string& path) = 0;
  // Whether several threads may call at once, each with files of its own. Who reads ahead on a
  // thread of his own does so only then.
  virtual bool AnyThread() const { return false; }
  // Replaces `to` in one step where it exists.
  virtual void Rename(const std::string& from, const std::string& to) = 0;
  // Returns once all that was written to the disk that holds `folder` is on it: one wait, where
  // HostFile::Flush would wait for each of thousands of files. A layer without a disk of its own
  // has nothing to wait for.
  virtual void FlushDisk(const std::string& /*folder*/) {}
  // Gives the file a second name, `to`, which must not be there.
  virtual void Link(const std::string& from, const std::string& to) = 0;
  // Where a link leads at last, there or not; a path that is no link is its own target.
  virtual std::string LinkTarget(const std::string& path) = 0;
  // Returns once the names in the folder are on the disk.
  virtual void FlushFolder(const std::string& folder) = 0;
  // A lock on the file, made when missing, that one process of all machines has at a time, and
  // one HostLock within it. `holder`, at most 255 bytes, is written into the file. Nothing where
  // another has it: `heldBy` is then the text that the other wrote, or empty.
  virtual std::unique_ptr<HostLock> TryLock(const std::string& path, std::string_view holder,
                                            std::string& heldBy) = 0;
};

// The folder of a host path: "/a" of "/a/b", "." of "b".
std::string HostFolderOf(const std::string& path);

// False while `modified` lies so little back that a further change might carry the same time:
// clocks of file systems tick in up to two seconds.
bool TimeIsSettled(std::int64_t modified);

// The machine's own file system.
Io& MachineIo();

}  // namespace kora
