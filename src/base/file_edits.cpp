#include "base/file_edits.h"

#include <algorithm>
#include <limits>
#include <set>

#include "base/runtime_error.h"

namespace kora {
namespace {

constexpr std::string_view kMagic = "KORA journal 1\r\n";
constexpr std::uint64_t kLargestJournal = 1u << 30;

std::uint64_t HashOf(std::string_view bytes) {
  std::uint64_t hash = 14695981039346656037u;
  for (const char c : bytes) hash = (hash ^ static_cast<unsigned char>(c)) * 1099511628211u;
  return hash;
}

void PutNumber(std::string& out, std::uint64_t value) {
  for (int i = 0; i < 8; ++i) out += char(value >> (8 * i) & 0xFF);
}

void PutText(std::string& out, std::string_view text) {
  PutNumber(out, text.size());
  out += text;
}

// Takes a journal's bytes apart; `good` goes when they end too soon.
class Taker {
 public:
  explicit Taker(std::string_view rest) : rest_(rest) {}
  bool good = true;

  std::uint64_t Number() {
    const std::string_view bytes = Take(8);
    std::uint64_t value = 0;
    for (size_t i = bytes.size(); i-- > 0;)
      value = value << 8 | static_cast<unsigned char>(bytes[i]);
    return value;
  }
  std::string Text() { return std::string(Take(Number())); }
  size_t left() const { return rest_.size(); }

 private:
  std::string_view Take(std::uint64_t size) {
    if (size > rest_.size()) {
      good = false;
      rest_ = {};
      return {};
    }
    const std::string_view out = rest_.substr(0, size_t(size));
    rest_.remove_prefix(size_t(size));
    return out;
  }
  std::string_view rest_;
};

std::string ReadBytes(HostFile& file, std::uint64_t offset, size_t size) {
  std::string bytes(size, '\0');
  bytes.resize(file.ReadAt(offset, bytes.data(), size));
  return bytes;
}

std::uint64_t EndOf(const ByteChange& change) { return change.offset + change.fresh.size(); }

// Whether the bytes there can be what an edit that was cut off left.
bool IsBetween(std::string_view there, const ByteChange& change) {
  for (size_t i = 0; i < there.size(); ++i) {
    const char c = there[i];
    if (c != change.fresh[i] && c != 0 && !(i < change.old.size() && c == change.old[i]))
      return false;
  }
  return true;
}

// Whether the file is as the edit expects it; `done` when nothing is left to do.
bool Expected(HostFile& file, const FileEdit& edit, bool& done) {
  const std::uint64_t size = file.Size();
  if (size < edit.before || size > edit.After()) return false;
  done = size == edit.After();
  for (const ByteChange& change : edit.changes) {
    const std::string there = ReadBytes(file, change.offset, change.fresh.size());
    if (there == change.fresh) continue;
    done = false;
    if (!IsBetween(there, change)) return false;
  }
  return true;
}

}  // namespace

std::uint64_t FileEdit::After() const {
  std::uint64_t after = before;
  for (const ByteChange& change : changes) after = std::max(after, EndOf(change));
  return after;
}

std::vector<std::string> MakeEdits(const Files& files, std::span<const FileEdit> edits,
                                   const EditWatcher& watch) {
  std::vector<std::string> foreign;
  for (const FileEdit& edit : edits) {
    if (watch) watch(edit.path);
    std::unique_ptr<HostFile> file;
    try {
      file = files.Open(edit.path, edit.existed ? OpenMode::kReadWrite : OpenMode::kCreate);
    } catch (const RunTimeError& e) {
      if (e.number() != kFileNotFound && e.number() != kPathNotFound) throw;
      foreign.push_back(edit.path);  // taken away
      continue;
    }
    bool done = false;
    if (!Expected(*file, edit, done)) {
      foreign.push_back(edit.path);
      continue;
    }
    if (done) continue;
    for (const ByteChange& change : edit.changes)
      file->WriteAt(change.offset, change.fresh.data(), change.fresh.size());
  }
  return foreign;
}

void UndoEdits(const Files& files, std::span<const FileEdit> edits) {
  for (const FileEdit& edit : edits) {
    if (!files.CheckFile(edit.path)) continue;
    {
      const auto file = files.Open(edit.path, OpenMode::kReadWrite);
      bool done = false;
      if (!Expected(*file, edit, done)) continue;
      for (const ByteChange& change : edit.changes)
        if (ReadBytes(*file, change.offset, change.old.size()) != change.old)
          file->WriteAt(change.offset, change.old.data(), change.old.size());
      if (file->Size() != edit.before) file->Truncate(edit.before);
    }
    if (!edit.existed) files.Remove(edit.path);
  }
}

void FlushEdits(const Files& files, std::span<const FileEdit> edits) {
  std::set<std::string> folders;
  for (const FileEdit& edit : edits) folders.insert(edit.path.substr(0, edit.path.rfind('\\') + 1));
  for (const std::string& folder : folders) files.io().FlushDisk(files.HostPath(folder));
}

std::optional<EditJournal> ReadEditJournal(const Files& files, const std::string& path) {
  if (!files.CheckFile(path)) return std::nullopt;
  const std::string bytes = files.ReadAll(path, kLargestJournal);
  if (!bytes.starts_with(kMagic) || bytes.size() < kMagic.size() + 8) return std::nullopt;
  const std::string_view body = std::string_view(bytes).substr(0, bytes.size() - 8);
  if (Taker(std::string_view(bytes).substr(body.size())).Number() != HashOf(body))
    return std::nullopt;
  EditJournal journal;
  Taker taker(body.substr(kMagic.size()));
  journal.note = taker.Text();
  while (taker.good && taker.left() > 0) {
    FileEdit& edit = journal.edits.emplace_back();
    edit.path = taker.Text();
    edit.existed = taker.Number() != 0;
    edit.before = taker.Number();
    const std::uint64_t changes = taker.Number();
    for (std::uint64_t i = 0; i < changes && taker.good; ++i) {
      ByteChange& change = edit.changes.emplace_back();
      change.offset = taker.Number();
      change.old = taker.Text();
      change.fresh = taker.Text();
      taker.good &= change.old.size() <= change.fresh.size() && change.offset <= edit.before;
    }
  }
  if (!taker.good) return std::nullopt;
  return journal;
}

void WriteEditJournal(const Files& files, const std::string& path, std::string_view note,
                      std::span<const FileEdit> edits) {
  std::string bytes(kMagic);
  PutText(bytes, note);
  for (const FileEdit& edit : edits) {
    PutText(bytes, edit.path);
    PutNumber(bytes, edit.existed ? 1 : 0);
    PutNumber(bytes, edit.before);
    PutNumber(bytes, edit.changes.size());
    for (const ByteChange& change : edit.changes) {
      PutNumber(bytes, change.offset);
      PutText(bytes, change.old);
      PutText(bytes, change.fresh);
    }
  }
  PutNumber(bytes, HashOf(bytes));
  files.WriteAll(path, bytes);
}

}  // namespace kora
