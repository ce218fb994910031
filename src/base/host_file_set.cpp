#include "base/host_file_set.h"

#include <algorithm>
#include <charconv>
#include <optional>
#include <set>

#include "base/host_files.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr int kMostTemporaries = 100;
constexpr int kManyFiles = 16;

// What stands behind a file's name beside it: new bytes, a number and "~" behind it, and what gave way.
constexpr std::string_view kTemporaryEnd = ".tmp", kAsideEnd = ".old~";

std::string AsideOf(const std::string& path) { return path + std::string(kAsideEnd); }

std::string_view NameOf(std::string_view host) { return host.substr(host.rfind('/') + 1); }

// What stands at `host`.
HostStatus RefuseUnlessReplaceable(Io& io, const std::string& host) {
  const HostStatus status = io.Status(host);
  const char* fault = nullptr;
  if (status.folder) {
    fault = ": Is a directory";
  } else if (status.exists && !status.plain) {
    fault = ": Not a plain file";
  } else if (status.exists && status.readOnly) {
    fault = " is read-only";
  }
  if (fault) throw RunTimeError(kPathAccess, std::string(NameOf(host)) + fault);
  return status;
}

bool IsLink(Io& io, const std::string& host) { return io.LinkTarget(host) != host; }

// A living writer has it locked.
bool IsLeftOver(Io& io, const std::string& host) {
  if (!io.Status(host).plain || IsLink(io, host)) return false;
  std::string heldBy;
  return io.TryLock(host, "", heldBy) != nullptr;
}

// Nothing where the name is taken. Its name is looked at only when it can't be made: thousands of
// files are.
std::unique_ptr<HostFile> OpenNew(Io& io, const std::string& host) {
  try {
    return io.Open(host, OpenMode::kNew);
  } catch (const RunTimeError& e) {
    if (e.number() != kPathAccess || !(io.Status(host).exists || IsLink(io, host))) throw;
    return nullptr;
  }
}

std::unique_ptr<HostFile> OpenTemporary(Io& io, const std::string& host, std::string& temporary) {
  for (int n = 0; n <= kMostTemporaries; ++n) {
    temporary = host + std::string(kTemporaryEnd) + (n == 0 ? "" : std::to_string(n)) + "~";
    if (auto file = OpenNew(io, temporary)) return file;
    if (!IsLeftOver(io, temporary)) continue;
    io.Remove(temporary);
    if (auto file = OpenNew(io, temporary)) return file;
  }
  throw RunTimeError(kPathAccess, "Temporary names are used");
}

void CopyHostFile(Io& io, const std::string& from, const std::string& to) {
  const auto source = io.Open(from, OpenMode::kRead);
  const auto copy = io.Open(to, OpenMode::kNew);
  copy->TakeAccess(io.Status(from));
  copy->CopyFrom(*source);
  copy->Flush();
}

// ---- The journal: fields that end in a NUL, a mark first and one last, between them each step.
// A step that moves or removes a file names the file by its stamp, so that what was done already
// is not done to the file that came in its place.

constexpr std::string_view kFirstField = "KORA set 1", kLastField = "whole";
constexpr std::uint64_t kLargestJournal = 64u << 20;

void AppendField(std::string& out, std::string_view field) {
  out += field;
  out += '\0';
}

struct Pending {
  char kind;
  std::string path, to, temporary, aside;
  HostStatus before;  // of `path`
};

// True where the files beside are those that a set makes. What has others is no journal of a set, and
// could name any file of the machine to be taken away.
bool IsOfASet(const Pending& step) {
  const std::string& kept = step.kind == 'R' ? step.to : step.path;
  if (step.aside != AsideOf(kept)) return false;
  if (step.kind != 'W') return step.kind == 'D' || step.kind == 'R';
  std::string_view end = step.temporary;
  if (!end.starts_with(step.path) || !end.ends_with('~')) return false;
  end.remove_prefix(step.path.size());
  return end.starts_with(kTemporaryEnd) &&
         end.find_first_not_of("0123456789", kTemporaryEnd.size()) == end.size() - 1;
}

// Nothing for a journal that was cut short, or is none.
std::optional<std::vector<Pending>> ReadJournal(Io& io, const std::string& journal) {
  constexpr size_t kFields = 8;
  const std::string text = ReadHostFile(io, journal, kLargestJournal);
  const auto fields = Split(text, '\0');  // an empty one behind the last NUL
  if (fields.size() < 3 || fields.front() != kFirstField || fields[fields.size() - 2] != kLastField)
    return std::nullopt;
  if ((fields.size() - 3) % kFields != 0) return std::nullopt;
  std::vector<Pending> steps;
  for (size_t i = 1; i + kFields < fields.size(); i += kFields) {
    Pending step;
    step.kind = fields[i].empty() ? ' ' : fields[i].front();
    step.path = fields[i + 1];
    step.to = fields[i + 2];
    step.temporary = fields[i + 3];
    step.aside = fields[i + 4];
    const auto number = [&](size_t at, auto& value) {
      std::from_chars(fields[at].data(), fields[at].data() + fields[at].size(), value);
    };
    number(i + 5, step.before.id);
    number(i + 6, step.before.size);
    number(i + 7, step.before.modified);
    if (!IsOfASet(step)) return std::nullopt;
    steps.push_back(std::move(step));
  }
  return steps;
}

bool IsStill(const HostStatus& now, const HostStatus& before) {
  return now.exists && now.id == before.id && now.size == before.size &&
         now.modified == before.modified;
}

// What has gone meanwhile, with its folder perhaps, is not to be changed any more.
template <typename Action>
void UnlessGone(Action action) {
  try {
    action();
  } catch (const RunTimeError& e) {
    if (e.number() != kFileNotFound && e.number() != kPathNotFound) throw;
  }
}

// For clean-ups: what failed before is the one to tell.
template <typename Action>
bool Quietly(Action action) noexcept {
  try {
    action();
    return true;
  } catch (...) {
    return false;
  }
}

}  // namespace

HostFileSet::~HostFileSet() { Clear(); }

void HostFileSet::Write(std::string path, std::string bytes) {
  AddWrite(std::move(path), std::move(bytes));
}

HostStatus HostFileSet::AddWrite(std::string path, std::string bytes) {
  Step step{.kind = Kind::kWrite, .path = io_.LinkTarget(path), .bytes = std::move(bytes)};
  const HostStatus old = RefuseUnlessReplaceable(io_, step.path);
  step.aside = AsideOf(step.path);
  steps_.push_back(std::move(step));
  return old;
}

void HostFileSet::Remove(std::string path) {
  RefuseUnlessReplaceable(io_, path);
  std::string aside = AsideOf(path);
  steps_.push_back({.kind = Kind::kRemove, .path = std::move(path), .aside = std::move(aside)});
}

void HostFileSet::Rename(std::string from, std::string to) {
  if (from != to) RefuseUnlessReplaceable(io_, to);
  std::string aside = AsideOf(to);
  steps_.push_back({.kind = Kind::kRename,
                    .path = std::move(from),
                    .to = std::move(to),
                    .aside = std::move(aside)});
}

CopiedFile HostFileSet::Copy(HostFile& source, std::string path) {
  return Fill(std::move(path), [&source](HostFile& file) { return file.CopyFrom(source); });
}

CopiedFile HostFileSet::WriteNow(std::string path, std::span<const std::string_view> pieces) {
  return Fill(std::move(path), [pieces](HostFile& file) {
    std::uint64_t size = 0;
    for (const std::string_view piece : pieces) {
      file.WriteAt(size, piece.data(), piece.size());
      size += piece.size();
    }
    return size;
  });
}

CopiedFile HostFileSet::Fill(std::string path,
                             const std::function<std::uint64_t(HostFile&)>& write) {
  const HostStatus old = AddWrite(std::move(path), {});
  Step& step = steps_.back();
  try {
    CopiedFile copied;
    copied.replaces = old.exists ? old.size : 0;
    OpenStaged(step, old);
    copied.bytes = write(*step.making);
    step.flushed = false;
    step.making.reset();
    return copied;
  } catch (...) {
    if (step.staged) Quietly([&] { io_.Remove(step.temporary); });
    steps_.pop_back();
    throw;
  }
}

void HostFileSet::OpenStaged(Step& step, const HostStatus& old) {
  step.making = OpenTemporary(io_, step.path, step.temporary);
  step.staged = true;
  if (old.exists) step.making->TakeAccess(old);
}

void HostFileSet::StageOne(Step& step, bool flush) {
  OpenStaged(step, io_.Status(step.path));
  step.making->WriteAt(0, step.bytes.data(), step.bytes.size());
  if (flush) step.making->Flush();
  step.bytes = {};
  if (steps_.size() > 1) step.making.reset();  // thousands can't be open at once
}

void HostFileSet::Stage() {
  const auto waits = [](const Step& step) {
    return step.kind == Kind::kWrite && !(step.staged && step.flushed);
  };
  try {
    // One wait for the disk costs less than one for each of many files.
    const bool many = std::count_if(steps_.begin(), steps_.end(), waits) >= kManyFiles;
    std::set<std::string> folders;
    for (Step& step : steps_) {
      if (!waits(step)) continue;
      if (!step.staged)
        StageOne(step, !many);
      else if (!many)
        io_.Open(step.temporary, OpenMode::kReadWrite)->Flush();
      step.flushed = true;
      if (many) folders.insert(HostFolderOf(step.path));
    }
    for (const std::string& folder : folders) io_.FlushDisk(folder);
  } catch (...) {
    Clear();
    throw;
  }
}

// A second name keeps the file at no cost; where the file system has none, a copy does.
void HostFileSet::KeepAside(Step& step, const std::string& path) {
  try {
    try {
      io_.Link(path, step.aside);
    } catch (const RunTimeError& e) {
      if (e.number() != kPathAccess || !io_.Status(step.aside).exists) throw;
      io_.Remove(step.aside);  // a crash left it
      io_.Link(path, step.aside);
    }
  } catch (const RunTimeError& e) {
    if (e.number() == kDiskFull) throw;
    step.kept = true;  // a copy that fails half-way is to be cleared away
    CopyHostFile(io_, path, step.aside);
  }
  step.kept = true;
}

void HostFileSet::Perform(Step& step) {
  switch (step.kind) {
    case Kind::kWrite:
      if (io_.Status(step.path).exists)
        KeepAside(step, step.path);
      else if (io_.Status(step.aside).exists)
        Quietly([&] { io_.Remove(step.aside); });  // a crash left it, of a file that went since
      io_.Rename(step.temporary, step.path);
      step.staged = false;
      step.making.reset();
      break;
    case Kind::kRemove:
      if (!io_.Status(step.path).exists) return;
      io_.Rename(step.path, step.aside);
      step.kept = true;
      break;
    case Kind::kRename:
      if (step.path != step.to && io_.Status(step.to).exists) KeepAside(step, step.to);
      io_.Rename(step.path, step.to);
      break;
  }
  step.done = true;
}

void HostFileSet::FlushFolders() {
  std::set<std::string> folders;
  for (const Step& step : steps_) {
    if (!step.done) continue;
    folders.insert(HostFolderOf(step.path));
    if (step.kind == Kind::kRename) folders.insert(HostFolderOf(step.to));
  }
  for (const std::string& folder : folders) io_.FlushFolder(folder);
}

void HostFileSet::Commit() {
  Stage();
  try {
    if (steps_.size() > 1 && !journal_.empty()) WriteJournal();
    for (Step& step : steps_) Perform(step);
    FlushFolders();
  } catch (...) {
    if (RemoveJournal()) {
      Undo();
      Clear();
    } else {
      steps_.clear();
    }
    throw;
  }
  // What gave way is no longer wanted. Until it is gone the journal stands, so that the next writer
  // sweeps what a kill leaves; without a journal the next write of the file does.
  for (Step& step : steps_) {
    if (step.kept) Quietly([&] { io_.Remove(step.aside); });
    step.kept = false;
  }
  RemoveJournal();
  Clear();
}

void HostFileSet::WriteJournal() {
  std::string text;
  AppendField(text, kFirstField);
  for (const Step& step : steps_) {
    // What a file that is written replaces does not matter to who goes on.
    const HostStatus before = step.kind == Kind::kWrite ? HostStatus{} : io_.Status(step.path);
    const char kind[] = {step.kind == Kind::kWrite ? 'W' : step.kind == Kind::kRemove ? 'D' : 'R'};
    AppendField(text, {kind, 1});
    for (const std::string* path : {&step.path, &step.to, &step.temporary, &step.aside})
      AppendField(text, *path);
    AppendField(text, std::to_string(before.id));
    AppendField(text, std::to_string(before.size));
    AppendField(text, std::to_string(before.modified));
  }
  AppendField(text, kLastField);
  const auto file = io_.Open(journal_, OpenMode::kNew);
  written_ = true;
  file->WriteAt(0, text.data(), text.size());
  file->Flush();
}

bool HostFileSet::RemoveJournal() noexcept {
  if (written_ && !Quietly([&] { io_.Remove(journal_); })) return false;
  written_ = false;
  return true;
}

std::string SetJournalOf(const std::string& home) { return home + "/Kora.set~"; }

void FinishSet(Io& io, const std::string& journal) {
  if (!io.Status(journal).exists) return;
  const auto steps = ReadJournal(io, journal);
  std::set<std::string> folders;
  for (const Pending& step : steps.value_or(std::vector<Pending>())) {
    UnlessGone([&] {
      if (step.kind == 'W') {
        if (io.Status(step.temporary).exists) io.Rename(step.temporary, step.path);
      } else if (IsStill(io.Status(step.path), step.before)) {
        if (step.kind == 'D') io.Remove(step.path);
        if (step.kind == 'R') io.Rename(step.path, step.to);
      }
    });
    folders.insert(HostFolderOf(step.path));
    if (step.kind == 'R') folders.insert(HostFolderOf(step.to));
    if (io.Status(step.aside).exists) Quietly([&] { io.Remove(step.aside); });
  }
  for (const std::string& folder : folders) UnlessGone([&] { io.FlushFolder(folder); });
  io.Remove(journal);
}

void HostFileSet::Undo() noexcept {
  for (auto step = steps_.rbegin(); step != steps_.rend(); ++step) {
    if (!step->done) continue;
    const auto bringBack = [&](const std::string& path) {
      // A file that can't be brought back stays where it is kept.
      if (step->kept) Quietly([&] { io_.Rename(step->aside, path); });
      step->kept = false;
    };
    switch (step->kind) {
      case Kind::kWrite:
        if (step->kept) {
          bringBack(step->path);
        } else {
          Quietly([&] { io_.Remove(step->path); });
        }
        break;
      case Kind::kRemove: bringBack(step->path); break;
      case Kind::kRename:
        if (Quietly([&] { io_.Rename(step->to, step->path); })) bringBack(step->to);
        break;
    }
  }
}

void HostFileSet::Clear() noexcept {
  for (const Step& step : steps_) {
    if (step.staged) Quietly([&] { io_.Remove(step.temporary); });
    if (step.kept) Quietly([&] { io_.Remove(step.aside); });
  }
  steps_.clear();
}

}  // namespace kora
