#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "base/files.h"

// Prices written as text into the miscellaneous folder: what stands behind the forms `TextData` and
// `TextFull`.

namespace kora {

class Dialogs;
class Progress;

enum class ExportForm {
  kCommas,   // "Code,Date,Close"
  kColumns,  // "Code        Date        Close"
};

// The closes of all securities on one date (d/m/yy), or on the latest date that any file ends with,
// one a line: code, yyyymmdd, close. The file is the date's name, "20NOV96.TXT", in `ChartMiscPath`,
// and is returned; nothing, and told, where it was not made. Securities without that date are left
// out. Told when it is done.
std::optional<std::string> ExportCloses(const Files& files, const std::string& dataPath,
                                        const std::string& ChartMiscPath,
                                        const std::optional<std::string>& date, ExportForm form,
                                        Progress& progress, Dialogs& dialogs);

// Every record of one security, one a line: code, d/m/yy, open, high, low, close, volume. The file is
// code + ".txt" in `ChartMiscPath`: where the texts of the security's charts stand there the user is
// asked, No standing. The file's name; nothing, and told, where it was not made.
std::optional<std::string> ExportHistory(const Files& files, const std::string& dataPath,
                                         const std::string& ChartMiscPath, std::string_view code,
                                         ExportForm form, Dialogs& dialogs);

}  // namespace kora
