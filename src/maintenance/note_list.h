#pragma once

#include <optional>
#include <string>
#include <vector>

#include "base/files.h"
#include "store/chart_notes.h"

// The texts on a security's charts, as a list to remove from: what stands behind the form `TxtData`.

namespace kora {

class Dialogs;

// The notes of a code; nothing, and told, where there is no file.
std::optional<std::vector<ChartNote>> OpenNotes(const Files& files,
                                                const std::string& ChartMiscPath,
                                                const std::string& code, Dialogs& dialogs);

// Rewrites the file with these notes. False, and told, when it fails.
bool SaveNotes(const Files& files, const std::string& ChartMiscPath, const std::string& code,
               const std::vector<ChartNote>& notes, Dialogs& dialogs);

// Deletes the file. False, and told, when it fails.
bool RemoveAllNotes(const Files& files, const std::string& ChartMiscPath, const std::string& code,
                    Dialogs& dialogs);

}  // namespace kora
