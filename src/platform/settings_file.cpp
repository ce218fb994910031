#include "platform/settings_file.h"

#include <algorithm>
#include <memory>
#include <utility>

#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestFile = 4u << 20;

std::string MapKey(std::string_view section, std::string_view key) {
  return LCase(Trim(section)) + "\n" + LCase(Trim(key));
}

// In the file's own alphabet, and on one line.
std::string OneLine(std::string_view text) {
  std::string out = ToAnsi(Trim(text));
  for (char& c : out)
    if (c == '\r' || c == '\n' || c == '\0') c = ' ';
  return std::string(Trim(out));
}

// Whether a section or key reads back as it is written; `breaks` are the characters that would
// end it or make something else of it.
bool IsName(std::string_view name, std::string_view breaks) {
  return !name.empty() && name.find_first_of(breaks) == std::string_view::npos &&
         name.find_first_of(std::string_view("\r\n\0", 3)) == std::string_view::npos;
}

// Folders are read with a backslash at their end, whether it stands there or not.
bool SameValue(std::string_view a, std::string_view b) {
  const auto bare = [](std::string_view v) {
    return v.ends_with('\\') ? v.substr(0, v.size() - 1) : v;
  };
  return EqualNoCase(bare(a), bare(b));
}

}  // namespace

std::string WhyNotKept(std::string_view value, size_t longest) {
  const std::string kept = OneLine(value);
  if (kept.size() > longest) return "is longer than " + std::to_string(longest) + " characters";
  std::string line(value);
  std::replace_if(
      line.begin(), line.end(), [](char c) { return c == '\r' || c == '\n' || c == '\0'; }, ' ');
  if (FromAnsi(kept) != Trim(line)) return "has characters that the settings can't hold";
  return {};
}

SettingsFile::SettingsFile(const Files& files, std::string path, size_t longestValue)
    : files_(files), path_(std::move(path)), longest_(longestValue) {}

bool SettingsFile::Exists() const { return files_.CheckFile(path_); }

std::string SettingsFile::Fault() const {
  Load();
  return readable_ ? std::string() : fault_;
}

void SettingsFile::Load() const {
  if (dirty_) return;  // a batch goes on with what it gathered
  HostStatus status;
  try {
    status = files_.io().Status(files_.HostPath(path_));
  } catch (const RunTimeError&) {
    // A path that can't be is no file.
  }
  if (loaded_ && settled_ && status.exists == status_.exists && status.folder == status_.folder &&
      status.size == status_.size && status.modified == status_.modified)
    return;
  loaded_ = true;
  status_ = status;
  settled_ = !status.exists || TimeIsSettled(status.modified);
  readable_ = true;
  lines_.clear();
  index_.clear();
  sections_.clear();
  if (!status.exists) return;
  std::string text;
  try {
    text = files_.ReadAll(path_, kLargestFile);
  } catch (const RunTimeError& e) {
    readable_ = false;  // it has no keys, and must not be replaced by the few that are written
    fault_ = status.size > kLargestFile && !status.folder ? "The file is too large" : e.what();
    return;
  }
  LineReader reader(text);
  std::string_view line;
  std::string section;
  while (reader.Next(line)) {
    lines_.emplace_back(line);
    const std::string_view body = Trim(line);
    if (body.size() >= 2 && body.front() == '[' && body.find(']') != std::string_view::npos) {
      section = LCase(Trim(body.substr(1, body.find(']') - 1)));
      sections_.try_emplace(section, lines_.size() - 1);
      continue;
    }
    const size_t equals = body.find('=');
    if (equals == std::string_view::npos || body.front() == ';') continue;
    index_.try_emplace(MapKey(section, body.substr(0, equals)), lines_.size() - 1);
    if (sections_.count(section)) sections_[section] = lines_.size() - 1;
  }
}

std::string SettingsFile::GetSetting(std::string_view section, std::string_view key) const {
  const std::string mapKey = MapKey(ToAnsi(section), ToAnsi(key));
  std::string_view value;
  if (const auto o = overrides_.find(mapKey); o != overrides_.end()) {
    value = o->second;
  } else {
    Load();
    const auto it = index_.find(mapKey);
    if (it == index_.end()) return std::string(kUnknown);
    const std::string_view line = lines_[it->second];
    value = Trim(line.substr(line.find('=') + 1));
  }
  value = Trim(value.substr(0, longest_));
  return value.empty() ? std::string(kUnknown) : FromAnsi(value);
}

bool SettingsFile::PutSetting(std::string_view section, std::string_view key,
                              std::string_view value) {
  const std::string sectionName = ToAnsi(Trim(section)), keyName = ToAnsi(Trim(key));
  if (!IsName(sectionName, "]") || !IsName(keyName, "=") || keyName[0] == '[' || keyName[0] == ';')
    return false;
  Load();
  if (!readable_) return false;
  const std::string mapKey = MapKey(sectionName, keyName);
  if (const auto o = overrides_.find(mapKey);
      o != overrides_.end() && SameValue(o->second, OneLine(value)))
    return true;
  const std::string line = keyName + "=" + OneLine(value);
  if (const auto it = index_.find(mapKey); it != index_.end()) {
    if (lines_[it->second] == line) return true;
    if (!WhyNotKept(value, longest_).empty()) return false;
    lines_[it->second] = line;
  } else {
    if (!WhyNotKept(value, longest_).empty()) return false;
    const std::string name = LCase(sectionName);
    size_t at;
    if (const auto s = sections_.find(name); s != sections_.end()) {
      at = s->second + 1;
    } else {
      if (!lines_.empty() && !lines_.back().empty()) lines_.emplace_back();
      lines_.push_back("[" + sectionName + "]");
      at = lines_.size();
    }
    lines_.insert(lines_.begin() + std::ptrdiff_t(at), line);
    for (auto& [k, n] : index_)
      if (n >= at) ++n;
    for (auto& [k, n] : sections_)
      if (n >= at) ++n;
    index_[mapKey] = at;
    sections_[name] = at;
  }
  dirty_ = true;
  return batch_ > 0 ? true : Save();
}

void SettingsFile::Override(std::string_view section, std::string_view key,
                            std::string_view value) {
  overrides_[MapKey(ToAnsi(section), ToAnsi(key))] = OneLine(value);
}

bool SettingsFile::Save() {
  dirty_ = false;
  loaded_ = false;  // the next look reads what is there, whether this succeeds or not
  std::string text;
  for (const std::string& line : lines_) {
    text += line;
    text += "\r\n";
  }
  try {
    files_.WriteAll(path_, text);
  } catch (const RunTimeError&) {
    return false;
  }
  return true;
}

SettingsFile::Batch::~Batch() { End(); }

bool SettingsFile::Batch::End() {
  if (std::exchange(ended_, true)) return true;
  return --file_.batch_ > 0 || !file_.dirty_ || file_.Save();
}

}  // namespace kora
