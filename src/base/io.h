#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

// The host's file system, as few calls as the program needs. Every call raises RunTimeError
// with the number that fits the host's own failure: 53 no such file, 76 no such folder, 75 no
// access (or a folder where a file should be), 61 disk full, 67 too many files, 57 any other.
// Tests put a failing layer in its place.

namespace kora {

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
  // Returns once the bytes are on the disk.
  virtual void Flush() = 0;
};

enum class OpenMode {
  kRead,       // must exist
  kReadWrite,  // must exist
  kCreate,     // made when missing, kept when there; read and write
  kReplace,    // made when missing, emptied when there; read and write
};

struct HostStatus {
  bool exists = false;
  bool folder = false;
  std::uint64_t size = 0;
  std::int64_t modified = 0;  // nanoseconds since 1970, clock of the file system
};

class Io {
 public:
  virtual ~Io() = default;
  virtual std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) = 0;
  // Never raises: what can't be looked at does not exist.
  virtual HostStatus Status(const std::string& path) = 0;
  // Names of files and folders in it, in no order, without "." and "..".
  virtual std::vector<std::string> List(const std::string& folder) = 0;
  virtual void MakeFolder(const std::string& path) = 0;
  virtual void Remove(const std::string& path) = 0;
  // Replaces `to` in one step where it exists.
  virtual void Rename(const std::string& from, const std::string& to) = 0;
};

// False while `modified` lies so little back that a further change might carry the same time:
// clocks of file systems tick in up to two seconds.
bool TimeIsSettled(std::int64_t modified);

// The machine's own file system.
Io& MachineIo();

}  // namespace kora
