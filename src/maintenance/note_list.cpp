#include "maintenance/note_list.h"

#include "base/dates.h"
#include "base/home_lock.h"
#include "base/numbers.h"
#include "base/text.h"
#include "maintenance/failures.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Chart Text";

}  // namespace

std::string NoteListText(const NoteLine& note) {
  if (!note.readable) return FromAnsi(note.line);
  const auto date = ParseFileDate(note.Date);
  return (date ? FormatUserDate(*date) : note.Date) + "   " + Format(note.Price, "#0.00") + "   " +
         note.Text;
}

std::optional<NoteList> OpenNotes(const Files& files, const std::string& ChartMiscPath,
                                  const std::string& code, Dialogs& dialogs) {
  std::optional<NoteList> notes;
  TellFailure(dialogs, kTitle, FromAnsi(code), [&] {
    const std::string path = ChartNotesPath(ChartMiscPath, code);
    const FileStamp stamp = files.Stamp(path);
    if (files.CheckFile(path))
      notes = NoteList{ReadNoteLines(files, path), stamp};
    else
      dialogs.Message("THERE IS NO TEXT FOR " + FromAnsi(code), kTitle);
  });
  return notes;
}

bool SaveNotes(const Files& files, const std::string& ChartMiscPath, const std::string& code,
               NoteList& notes, Dialogs& dialogs) {
  bool saved = false;
  TellFailure(dialogs, kTitle, FromAnsi(code), [&] {
    const auto held = files.lock().Hold();
    const std::string path = ChartNotesPath(ChartMiscPath, code);
    if (files.Stamp(path) != notes.stamp &&
        dialogs.Ask("The texts were changed by another program. Save over these changes ?", kTitle,
                    Buttons::kNoYes) != Answer::kYes)
      return;
    WriteNoteLines(files, path, notes.lines);
    notes.stamp = files.Stamp(path);
    saved = true;
  });
  return saved;
}

bool RemoveAllNotes(const Files& files, const std::string& ChartMiscPath, const std::string& code,
                    Dialogs& dialogs) {
  return TellFailure(dialogs, kTitle, FromAnsi(code), [&] {
    const auto held = files.lock().Hold();
    const std::string path = ChartNotesPath(ChartMiscPath, code);
    if (files.CheckFile(path)) files.Remove(path);
  });
}

}  // namespace kora
