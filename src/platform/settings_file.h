#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"

namespace kora {

// What a missing key reads as; every reader tests for it.
inline constexpr std::string_view kUnknown = "unknown";

// The section of the per-user store.
inline constexpr std::string_view kUserSection = "KORA Charting System";

// The characters of a value that are read: in the settings file, and in the per-user store, which
// keeps lists of names.
inline constexpr size_t kLongestValue = 60;
inline constexpr size_t kLongestUserValue = 255;

// Why a text can't be kept as a value and read back as it is ("is longer than 60 characters"), to
// stand behind the name of what it is; empty where it can. Forms ask before they store what the
// user typed.
std::string WhyNotKept(std::string_view value, size_t longest = kLongestValue);

// A sectioned key file:
//
//   [Section]
//   Key=value
//
// Sections and keys match in any case. Values are text of at most `longestValue`
// characters on reading; what is longer is cut. A file that is missing, or can't be read, has no keys. Lines that are
// neither a section nor a key are kept as they are, byte for byte, when a key is written.
class SettingsFile {
 public:
  // `path` is a DOS path. Nothing is read yet.
  SettingsFile(const Files& files, std::string path, size_t longestValue = kLongestValue);

  const std::string& path() const { return path_; }
  bool Exists() const;
  // What keeps the file that is there from being read, in the host's words; empty when it is read,
  // or there is none. Such a file has no keys, which must not pass for a new installation.
  std::string Fault() const;

  // The value, trimmed, or "unknown" when the key is missing or empty.
  std::string GetSetting(std::string_view section, std::string_view key) const;
  // Writes the value, trimmed, at once; the file is replaced as a whole. A line end within the
  // value becomes a blank. False when it can't be written, which callers pass over unless they
  // say otherwise: the host refuses, the file that is there can't be read (the rest of it would
  // be lost), or the section, key or value would not read back as it is ("a=b", "[x", an empty
  // section, a value for which WhyNotKept has words); the old value stays.
  bool PutSetting(std::string_view section, std::string_view key, std::string_view value);

  // A value for this run only, read in place of the file's. Putting it back, as a save of all
  // settings does, writes nothing; another value is the user's own and is written.
  void Override(std::string_view section, std::string_view key, std::string_view value);

  // While a Batch lives, writes are gathered and the file is replaced once, at its end.
  class Batch {
   public:
    explicit Batch(SettingsFile& file) : file_(file) { ++file_.batch_; }
    ~Batch();
    // Ends it now. False when what was gathered can't be written; the old values stay.
    bool End();
    Batch(const Batch&) = delete;
    Batch& operator=(const Batch&) = delete;

   private:
    SettingsFile& file_;
    bool ended_ = false;
  };

 private:
  void Load() const;
  bool Save();

  const Files& files_;
  std::string path_;
  size_t longest_;
  std::map<std::string, std::string> overrides_;  // "section\nkey" in lower case
  int batch_ = 0;
  bool dirty_ = false;
  mutable bool loaded_ = false;
  mutable bool readable_ = true;
  mutable std::string fault_;               // of a file that is not readable
  mutable bool settled_ = false;            // a further change of the file would show in status_
  mutable HostStatus status_;               // of the file as it was read
  mutable std::vector<std::string> lines_;  // ANSI
  mutable std::map<std::string, size_t> index_;     // "section\nkey" -> line
  mutable std::map<std::string, size_t> sections_;  // section -> its last line
};

}  // namespace kora
