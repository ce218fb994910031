#pragma once

#include <string>

#include "base/files.h"

// A security whose code has changed: what stands behind the form `ASXChg`.

namespace kora {

class Dialogs;
class Progress;

enum class CodeChange {
  kChanged,
  kDeclined,  // the user did not want the file renamed
  kRefused,   // told; nothing was changed
};
// Which box to go back to.
enum class CodeBox { kNone, kOld, kNew };

// Renames the old code's price file and its name record to the new code, or, where the new code has
// a price file already, puts the records of that behind those of the old one: dates are not
// compared. Codes are taken in upper case. Price files and name file are put in place together;
// the stages show as kState of `progress`.
//
// A file of the new code that begins with all records of the old one is what a run that was killed
// has left: it is not joined again.
CodeChange ChangeCode(const Files& files, const std::string& dataPath, const std::string& oldCode,
                      const std::string& newCode, Progress& progress, Dialogs& dialogs,
                      CodeBox& focus);

}  // namespace kora
