#include "update/update_report.h"

#include <algorithm>

namespace kora {
namespace {

constexpr size_t kMostLines = 20;  // of a file
constexpr size_t kMostFiles = 40;

}  // namespace

void UpdateReport::Refused(std::string_view file, std::string_view why) {
  refused_ = true;
  Add(file, " not taken in: " + std::string(why));
}

void UpdateReport::LeftOut(std::string_view file, std::string text) {
  leftOut_ = true;
  Add(file, " left out: " + std::move(text));
}

void UpdateReport::Misread(std::string_view file, std::string text) {
  misread_ = true;
  Add(file, " " + std::move(text));
}

void UpdateReport::Add(std::string_view file, std::string line) {
  if (files_.empty() || files_.back().name != file) files_.push_back({std::string(file), {}, 0});
  OfFile& of = files_.back();
  // A share that can't take the day can't take a flat record either.
  if (std::find(of.lines.begin(), of.lines.end(), line) != of.lines.end()) return;
  if (of.lines.size() < kMostLines)
    of.lines.push_back(std::move(line));
  else
    ++of.more;
}

std::string UpdateReport::Text() const {
  std::string text;
  size_t shown = 0;
  for (const OfFile& of : files_) {
    if (!text.empty()) text += "\n";
    if (shown++ == kMostFiles) {
      text += "and " + std::to_string(files_.size() - kMostFiles) + " more files";
      break;
    }
    text += of.name;
    for (const std::string& line : of.lines) text += "\n" + line;
    if (of.more > 0) text += "\n and " + std::to_string(of.more) + " more";
  }
  return text;
}

}  // namespace kora
