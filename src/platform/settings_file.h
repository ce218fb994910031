#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"

namespace kora {

// What a missing key reads as; every reader tests for it.
inline constexpr std::string_view kUnknown = "unknown";

// A sectioned key file:
//
//   [Section]
//   Key=value
//
// Sections and keys match in any case. Values are text of at most 60 characters on reading;
// what is longer is cut. A file that is missing, or is no text, has no keys. Lines that are
// neither a section nor a key are kept as they are when a key is written.
class SettingsFile {
 public:
  // `path` is a DOS path. Nothing is read yet.
  SettingsFile(const Files& files, std::string path);

  const std::string& path() const { return path_; }
  bool Exists() const;

  // The value, trimmed, or "unknown" when the key is missing or empty.
  std::string GetSetting(std::string_view section, std::string_view key) const;
  // Writes the value, trimmed, at once; the file is replaced as a whole. False when it can't
  // be written, which callers pass over unless they say otherwise.
  bool PutSetting(std::string_view section, std::string_view key, std::string_view value);

  // A value for this run only: read in place of the file's, never written.
  void Override(std::string_view section, std::string_view key, std::string_view value);

  // While a Batch lives, writes are gathered and the file is replaced once, at its end.
  class Batch {
   public:
    explicit Batch(SettingsFile& file) : file_(file) { ++file_.batch_; }
    ~Batch();
    Batch(const Batch&) = delete;
    Batch& operator=(const Batch&) = delete;

   private:
    SettingsFile& file_;
  };

 private:
  void Load() const;
  bool Save();

  const Files& files_;
  std::string path_;
  std::map<std::string, std::string> overrides_;  // "section\nkey" in lower case
  int batch_ = 0;
  bool dirty_ = false;
  mutable bool loaded_ = false;
  mutable std::int64_t stamp_ = -2;
  mutable std::vector<std::string> lines_;
  mutable std::map<std::string, size_t> index_;    // "section\nkey" -> line
  mutable std::map<std::string, size_t> sections_;  // section -> its last line
};

}  // namespace kora
