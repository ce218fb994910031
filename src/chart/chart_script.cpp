#include "chart/chart_script.h"

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr size_t kLongestLine = 4096;

}  // namespace

ChartScript::ChartScript(const Files& files, std::string path)
    : files_(&files), path_(std::move(path)) {}

void ChartScript::Open(bool append) {
  // A script in memory goes on behind its own text; one in a file behind the file's.
  if (!append || files_) buffer_.clear();
  append_ = append;
  open_ = true;
  opened_ = buffer_.size();
}

void ChartScript::Abandon() {
  if (open_) buffer_.resize(opened_);
  open_ = false;
}

void ChartScript::Close() {
  if (!open_) return;
  open_ = false;
  if (!files_) return;
  // Written over and cut, not emptied first: file systems write a file that was emptied to the
  // disk as it closes, which costs more than the whole chart.
  const auto file = files_->Open(path_, OpenMode::kCreate);
  const std::uint64_t at = append_ ? file->Size() : 0;
  file->WriteAt(at, buffer_.data(), buffer_.size());
  if (file->Size() > at + buffer_.size()) file->Truncate(at + buffer_.size());
}

char ScriptLine::letter() const {
  const char c = text[0].size() == 1 ? text[0][0] : '\0';
  return c >= 'a' && c <= 'z' ? char(c - 'a' + 'A') : c;
}

double ScriptLine::number(int field) const { return Val(text[size_t(field - 1)]); }

std::int32_t ScriptLine::whole(int field) const { return CLng(number(field)); }

void SplitScriptLine(std::string_view line, ScriptLine& out) {
  for (std::string& slot : out.text) slot.clear();
  if (line.size() > kLongestLine) throw RunTimeError(kOutOfTextSpace);
  // The rule for blanks looks at the line's first character as it stands.
  const bool textKeepsBlanks = !line.empty() && line.front() == 'T';
  size_t slot = 0;
  for (const char c : line) {
    if (c == ',') {
      if (++slot == out.text.size()) throw RunTimeError(kIndexOutOfRange);
    } else if (c != ' ' || (textKeepsBlanks && slot == 4)) {
      out.text[slot] += c;
    }
  }
}

}  // namespace kora
