#pragma once

#include <optional>
#include <string>
#include <vector>

#include "base/files.h"
#include "store/chart_notes.h"

// The texts on a security's charts, as a list to remove from: what stands behind the form `TxtData`.

namespace kora {

class Dialogs;

struct NoteList {
  std::vector<NoteLine> lines;  // lines that are no texts as well
  FileStamp stamp;              // of the file as it was read
};

// "14/9/98   1.50   A text"; a line that is none as it stands. UTF-8.
std::string NoteListText(const NoteLine& line);

// The lines of a code's file; nothing, and told, where there is no file.
std::optional<NoteList> OpenNotes(const Files& files, const std::string& ChartMiscPath,
                                  const std::string& code, Dialogs& dialogs);

// Rewrites the file with these lines. Where another program changed it since, the user is asked, No
// standing. False, and told, when it fails or is not wanted.
bool SaveNotes(const Files& files, const std::string& ChartMiscPath, const std::string& code,
               NoteList& notes, Dialogs& dialogs);

// Deletes the file. False, and told, when it fails.
bool RemoveAllNotes(const Files& files, const std::string& ChartMiscPath, const std::string& code,
                    Dialogs& dialogs);

}  // namespace kora
