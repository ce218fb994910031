#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "base/dates.h"
#include "base/files.h"
#include "settings/settings.h"

namespace kora {

class Dialogs;
class RunTimeError;

// The files that wait in the download folder, oldest first, by their names without the folder:
// "15SEP98.d".
using DownloadEntries = std::vector<std::string>;

enum class ListResult {
  kFilled,
  kNothingWaits,  // told; the form closes
  kStopped,       // told; the form stays, with an empty list
};

// Lists what waits. Files of service 4 whose names have another form are renamed first. Failures
// are told by number and end the listing.
ListResult BuildDownloadList(const Files& files, const DownloadSettings& download, Dialogs& dialogs,
                             DownloadEntries& entries);

// Renames the files of service 4 to the form "15SEP98.d". `form` is 1 to 6: "YYMMDD.D",
// "YYMMDD.ASX", "DDMMYY.D", "DDMMYY.ASX", "DDMMYYYY.D", "YYYYMMDD.D". What can't be renamed
// stays; another form is told.
void RenameInternetFiles(const Files& files, const std::string& folder, int form, Dialogs& dialogs);

// Sorts names of the list's form by date. Years 0 to 29 are of the 2000s. A name whose month
// is none is kept as it stands.
DownloadEntries SortedEntries(const std::vector<std::string>& names);

// The date of an entry as "d/m/yy". An entry that is not 9 characters long, or names no date,
// has today's.
std::string UpdateDateOf(std::string_view entry, const CalendarDate& today);

// Asks, then deletes the file of `entry` where it is there and takes the first entry, whichever
// was named, off the list. False when the user says No.
bool RemoveDownload(const Files& files, const std::string& DLPath, std::string_view entry,
                    Dialogs& dialogs, DownloadEntries& entries);

// DLPath + entry, both trimmed.
std::string DownloadFilePath(std::string_view DLPath, std::string_view entry);

// "JAN" to "DEC" for 1 to 12.
std::string_view MonthName(int month);
// 1 to 12 for a month's name in any case, else 0.
int MonthOfName(std::string_view name);

// What a failure of the list or of an update is told as, under the title "Error".
std::string DownloadErrorText(const RunTimeError& error);

}  // namespace kora
