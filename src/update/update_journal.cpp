#include "update/update_journal.h"

#include <algorithm>
#include <charconv>
#include <cstring>

#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

std::string FileText(const TakenFile& file) {
  return std::to_string(file.size) + " " + std::to_string(file.hash) + " " + file.path;
}

std::uint64_t TakeNumber(std::string_view& text) {
  std::uint64_t value = 0;
  const auto end = std::from_chars(text.data(), text.data() + text.size(), value).ptr;
  text.remove_prefix(size_t(end - text.data()));
  text = LTrim(text);
  return value;
}

TakenFile FileOf(std::string_view text) {
  TakenFile file;
  file.size = TakeNumber(text);
  file.hash = TakeNumber(text);
  file.path = text;
  return file;
}

std::string HexOf(const NameRec& rec) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  std::string out;
  const auto* bytes = reinterpret_cast<const unsigned char*>(&rec);
  for (size_t i = 0; i < sizeof(rec); ++i) {
    out += digits[bytes[i] >> 4];
    out += digits[bytes[i] & 15];
  }
  return out;
}

std::optional<NameRec> RecOf(std::string_view hex) {
  NameRec rec;
  if (hex.size() != 2 * sizeof(rec)) return std::nullopt;
  unsigned char bytes[sizeof(rec)];
  for (size_t i = 0; i < sizeof(rec); ++i)
    std::from_chars(hex.data() + 2 * i, hex.data() + 2 * i + 2, bytes[i], 16);
  std::memcpy(&rec, bytes, sizeof(rec));
  return rec;
}

std::string NoteOf(const DayProgress& day) {
  std::string note;
  const auto put = [&note](std::string_view key, std::string_view value) {
    note += std::string(key) + "=" + std::string(value) + "\r\n";
  };
  put("Entry", day.entry);
  put("Leaving", std::to_string(int(day.leaving)));
  for (const TakenFile& file : day.done) put("Done", FileText(file));
  if (day.part) {
    put("Part", FileText(*day.part));
    put("Mode", std::to_string(day.mode));
    put("Skip", std::to_string(day.skip));
    put("Lines", std::to_string(day.lines));
    put("Names", std::to_string(day.names));
  }
  if (day.held) put("Held", HexOf(*day.held));
  return note;
}

DayProgress ReadNote(std::string_view note) {
  DayProgress day;
  LineReader lines(note);
  std::string_view line;
  while (lines.Next(line)) {
    const size_t at = line.find('=');
    if (at == std::string_view::npos) continue;
    const std::string_view key = line.substr(0, at), value = line.substr(at + 1);
    std::string_view number = value;
    if (key == "Entry") day.entry = value;
    if (key == "Leaving") day.leaving = DayProgress::Leaving(TakeNumber(number) & 3);
    if (key == "Done") day.done.push_back(FileOf(value));
    if (key == "Part") day.part = FileOf(value);
    if (key == "Mode") day.mode = std::int16_t(TakeNumber(number) & 3);
    if (key == "Skip") day.skip = int(TakeNumber(number) & 0x7FFFFFFF);
    if (key == "Lines") day.lines = int(TakeNumber(number) & 0x7FFFFFFF);
    if (key == "Names") day.names = std::int32_t(TakeNumber(number) & 0xFFFF);
    if (key == "Held") day.held = RecOf(value);
  }
  return day;
}

// The files that an update changes, whatever their folders. A journal with others is none of an
// update's.
bool IsOfAnUpdate(const EditJournal& journal) {
  return std::all_of(journal.edits.begin(), journal.edits.end(), [](const FileEdit& edit) {
    return EndsNoCase(edit.path, ".WDT") || EqualNoCase(FileNameOf(edit.path), "Names.dat");
  });
}

}  // namespace

TakenFile IdentityOf(const std::string& path, std::string_view text) {
  TakenFile file{path, text.size(), 14695981039346656037u};
  for (const char c : text)
    file.hash = (file.hash ^ static_cast<unsigned char>(c)) * 1099511628211u;
  return file;
}

UpdateJournal::UpdateJournal(const Files& files, const std::string& systemPath)
    : files_(files), path_(systemPath + "Update.Jnl") {}

std::string UpdateJournal::Finish(UpdateReport& report, std::string& inHand) {
  progress = {};
  const auto journal = ReadEditJournal(files_, path_);
  if (!journal || !IsOfAnUpdate(*journal)) return {};
  progress = ReadNote(journal->note);
  onDisk_ = true;
  const bool whole = progress.leaving != DayProgress::kStays;
  // An entry leaves the list after its edits were made.
  if (!whole || files_.CheckFile(progress.entry)) {
    const auto watch = [&inHand](const std::string& path) { inHand = path; };
    for (const std::string& path : MakeEdits(files_, journal->edits, watch))
      report.LeftOut(progress.entry, path + " was changed since the run that was cut off");
    FlushEdits(files_, journal->edits);
  }
  if (whole) {
    // Files that were delivered anew since wait for a run of their own.
    for (const TakenFile& file : progress.done)
      if (files_.CheckFile(file.path) && IdentityOf(file.path, files_.ReadAll(file.path)) != file) {
        End();
        return {};
      }
    LeaveList();
    onDisk_ = false;
    RemoveQuietly();
    return progress.entry;
  }
  // The edits are done with: what is changed from now on is not theirs.
  if (!journal->edits.empty()) WriteEditJournal(files_, path_, journal->note, {});
  return {};
}

void UpdateJournal::Commit(DayProgress after, std::span<const FileEdit> edits,
                           std::string& inHand) {
  inHand = path_;
  WriteEditJournal(files_, path_, NoteOf(after), edits);
  try {
    for (const std::string& path :
         MakeEdits(files_, edits, [&inHand](const std::string& file) { inHand = file; })) {
      inHand = path;
      throw RunTimeError(kPathAccess, "changed by another program");
    }
  } catch (const std::exception&) {
    try {
      UndoEdits(files_, edits);
      if (!onDisk_)
        RemoveQuietly();
      else
        WriteEditJournal(files_, path_, NoteOf(progress), {});
    } catch (const RunTimeError&) {
      // The next run finishes the day.
    }
    throw;
  }
  onDisk_ = true;
  FlushEdits(files_, edits);
  progress = std::move(after);
}

void UpdateJournal::LeaveList() {
  try {
    if (progress.leaving == DayProgress::kRenamed)
      files_.Rename(progress.entry, progress.entry + "X");
    // The entry's own name up to the first point of the whole path.
    if (progress.leaving == DayProgress::kDeleted)
      files_.Remove(progress.entry.substr(0, progress.entry.find('.')) + ".d");
  } catch (const RunTimeError&) {
    // It stays listed, and its data are replaced by themselves then.
  }
}

void UpdateJournal::End() {
  progress = {};
  onDisk_ = false;
  RemoveQuietly();
}

void UpdateJournal::RemoveQuietly() {
  try {
    if (files_.CheckFile(path_)) files_.Remove(path_);
  } catch (const RunTimeError&) {
    // The next run finds that all of it was done.
  }
}

}  // namespace kora
