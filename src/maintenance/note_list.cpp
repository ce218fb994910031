#include "maintenance/note_list.h"

#include "base/home_lock.h"
#include "base/text.h"
#include "maintenance/failures.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Chart Text";

}  // namespace

std::optional<std::vector<ChartNote>> OpenNotes(const Files& files,
                                                const std::string& ChartMiscPath,
                                                const std::string& code, Dialogs& dialogs) {
  std::optional<std::vector<ChartNote>> notes;
  TellFailure(dialogs, kTitle, FromAnsi(code), [&] {
    const std::string path = ChartNotesPath(ChartMiscPath, code);
    if (files.CheckFile(path))
      notes = ReadChartNotes(files, path);
    else
      dialogs.Message("THERE IS NO TEXT FOR " + FromAnsi(code), kTitle);
  });
  return notes;
}

bool SaveNotes(const Files& files, const std::string& ChartMiscPath, const std::string& code,
               const std::vector<ChartNote>& notes, Dialogs& dialogs) {
  return TellFailure(dialogs, kTitle, FromAnsi(code), [&] {
    const auto held = files.lock().Hold();
    files.WriteAll(ChartNotesPath(ChartMiscPath, code), ChartNotesText(notes));
  });
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
