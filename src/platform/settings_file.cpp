#include "platform/settings_file.h"

#include <memory>

#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr size_t kLongestValue = 60;
constexpr std::uint64_t kLargestFile = 4u << 20;

std::string MapKey(std::string_view section, std::string_view key) {
  return LCase(Trim(section)) + "\n" + LCase(Trim(key));
}

// A value must stay on its line.
std::string OneLine(std::string_view value) {
  std::string out(Trim(value));
  for (char& c : out)
    if (c == '\r' || c == '\n' || c == '\0') c = ' ';
  return std::string(Trim(out));
}

}  // namespace

SettingsFile::SettingsFile(const Files& files, std::string path)
    : files_(files), path_(std::move(path)) {}

bool SettingsFile::Exists() const { return files_.CheckFile(path_); }

void SettingsFile::Load() const {
  if (batch_ > 0 && loaded_) return;
  std::int64_t stamp = -1;
  try {
    const HostStatus status = files_.io().Status(files_.HostPath(path_));
    if (status.exists && !status.folder) stamp = status.modified ^ std::int64_t(status.size << 40);
  } catch (const RunTimeError&) {
    stamp = -1;
  }
  if (loaded_ && stamp == stamp_) return;
  loaded_ = true;
  stamp_ = stamp;
  lines_.clear();
  index_.clear();
  sections_.clear();
  if (stamp == -1) return;
  std::string text;
  try {
    text = FromAnsi(files_.ReadAll(path_, kLargestFile));
  } catch (const RunTimeError&) {
    return;  // what can't be read has no keys
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
  const std::string mapKey = MapKey(section, key);
  std::string_view value;
  if (const auto o = overrides_.find(mapKey); o != overrides_.end()) {
    value = o->second;
  } else {
    Load();
    const auto it = index_.find(mapKey);
    if (it == index_.end()) return std::string(kUnknown);
    const std::string& line = lines_[it->second];
    value = Trim(std::string_view(line).substr(line.find('=') + 1));
  }
  // Cut by characters, never within one.
  size_t bytes = 0;
  for (size_t n = 0; bytes < value.size() && n < kLongestValue; ++n) {
    ++bytes;
    while (bytes < value.size() && (static_cast<unsigned char>(value[bytes]) & 0xC0) == 0x80)
      ++bytes;
  }
  value = Trim(value.substr(0, bytes));
  return value.empty() ? std::string(kUnknown) : std::string(value);
}

bool SettingsFile::PutSetting(std::string_view section, std::string_view key,
                              std::string_view value) {
  Load();
  const std::string mapKey = MapKey(section, key);
  const std::string line = std::string(Trim(key)) + "=" + OneLine(value);
  if (const auto it = index_.find(mapKey); it != index_.end()) {
    if (lines_[it->second] == line) return true;
    lines_[it->second] = line;
  } else {
    const std::string name = LCase(Trim(section));
    size_t at;
    if (const auto s = sections_.find(name); s != sections_.end()) {
      at = s->second + 1;
    } else {
      if (!lines_.empty() && !lines_.back().empty()) lines_.emplace_back();
      lines_.push_back("[" + std::string(Trim(section)) + "]");
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
  overrides_[MapKey(section, key)] = OneLine(value);
}

bool SettingsFile::Save() {
  dirty_ = false;
  std::string text;
  for (const std::string& line : lines_) {
    text += line;
    text += "\r\n";
  }
  try {
    files_.WriteAll(path_, ToAnsi(text));
  } catch (const RunTimeError&) {
    loaded_ = false;  // the file is as it was, and so are the values
    return false;
  }
  stamp_ = -2;  // read anew at the next look
  loaded_ = false;
  return true;
}

SettingsFile::Batch::~Batch() {
  if (--file_.batch_ == 0 && file_.dirty_) file_.Save();
}

}  // namespace kora
