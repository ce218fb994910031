#pragma once

#include <string>

#include "base/files.h"

// A price file taken from one data folder to another: what stands behind the form `MoveFiles`.

namespace kora {

class Dialogs;
class Progress;

// Copies the price file of a code from one folder to another, with its name record, which is placed
// by code; the source stays as it is. Where the target has the file already the two are joined: the
// one that starts earlier wins up to its end, the other goes on behind it. A target that covers the
// source stays as it is; one that changes is kept as ".OLD". Everything is put in place together.
//
// False, and told, when it fails. `progress` shows the stage as kState.
bool MoveDataFile(const Files& files, const std::string& fromFolder, const std::string& toFolder,
                  const std::string& code, Progress& progress, Dialogs& dialogs);

}  // namespace kora
