#pragma once

#include <cstdint>
#include <span>
#include <string_view>
#include <type_traits>
#include <vector>

#include "base/files.h"
#include "base/runtime_error.h"

namespace kora {

// A headerless file of fixed records, numbered from 1. The count is the file's length divided
// by the record size, truncated: a torn record at the end does not count, and the next append
// writes over it.
template <typename T>
class RecordFile {
  static_assert(std::is_trivially_copyable_v<T> && alignof(T) == 1, "records are packed structs");

 public:
  RecordFile(const Files& files, std::string_view path, OpenMode mode = OpenMode::kRead)
      : file_(files.Open(path, mode)) {
    Refresh();
  }

  std::int32_t count() const { return count_; }

  // Reads the file's length again, for a file that another process may have changed.
  void Refresh() {
    const std::uint64_t n = file_->Size() / sizeof(T);
    if (n > 0x7FFFFFFF) throw RunTimeError(kOverflow);
    count_ = static_cast<std::int32_t>(n);
  }

  // Error 63 when n is below 1 or above count(), or when the file ends within the record.
  T Read(std::int32_t n) const {
    T record;
    ReadRun(n, std::span<T>(&record, 1));
    return record;
  }

  // Records n, n+1, ... in one call to the host. Errors as Read.
  void ReadRun(std::int32_t n, std::span<T> out) const {
    if (out.empty()) return;
    if (n < 1 || std::int64_t(n) + std::int64_t(out.size()) - 1 > count_)
      throw RunTimeError(kBadRecordNumber);
    if (file_->ReadAt(Offset(n), out.data(), out.size_bytes()) != out.size_bytes())
      throw RunTimeError(kBadRecordNumber);
  }

  // Error 7 when the file is larger than any that the program writes.
  std::vector<T> ReadAll() const {
    if (std::uint64_t(count_) * sizeof(T) > kLargestRead) throw RunTimeError(kOutOfMemory);
    std::vector<T> out(static_cast<size_t>(count_));
    ReadRun(1, out);
    return out;
  }

  // Writes record n; n = count() + 1 appends. Error 63 beyond that.
  void Write(std::int32_t n, const T& record) { WriteRun(n, std::span<const T>(&record, 1)); }

  void WriteRun(std::int32_t n, std::span<const T> records) {
    if (n < 1 || n > count_ + 1) throw RunTimeError(kBadRecordNumber);
    file_->WriteAt(Offset(n), records.data(), records.size_bytes());
    const std::int64_t last = std::int64_t(n) + std::int64_t(records.size()) - 1;
    if (last > count_) count_ = static_cast<std::int32_t>(last);
  }

  // What a failing write leaves of the record is taken back.
  void Append(const T& record) {
    try {
      Write(count_ + 1, record);
    } catch (const RunTimeError&) {
      try {
        file_->Truncate(std::uint64_t(count_) * sizeof(T));
      } catch (const RunTimeError&) {
        // It does not count.
      }
      throw;
    }
  }

  // Cuts the file behind record n.
  void Truncate(std::int32_t n) {
    if (n < 0 || n > count_) throw RunTimeError(kBadRecordNumber);
    file_->Truncate(std::uint64_t(n) * sizeof(T));
    count_ = n;
  }

  void Flush() { file_->Flush(); }

 private:
  static constexpr std::uint64_t kLargestRead = 256u << 20;
  static std::uint64_t Offset(std::int32_t n) { return std::uint64_t(n - 1) * sizeof(T); }

  std::unique_ptr<HostFile> file_;
  std::int32_t count_ = 0;
};

}  // namespace kora
