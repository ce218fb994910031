#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "settings/locate.h"
#include "settings/settings.h"
#include "store/market_folders.h"

// Which data service is in use, where its files land and where the prices are to go.

namespace kora {

class Dialogs;

// ---- Folders of the whole market

// Saves the form `WMPath`: `folders` are its boxes 1 to 6 in order (ASX, IDX, SFE, OVS, OPT,
// SUM), `chosen` 0 to 5. Asks before a folder is made; No leaves it out and goes on. False,
// with a message and nothing written, while a folder is empty.
bool SaveWmPaths(const Files& files, const std::string& systemPath,
                 std::span<const std::string, 6> folders, int chosen, Dialogs& dialogs);

// The folders of the form `DLWizard` in the order of its boxes: ASX, IDX, SFE, OVS, OPT and the
// sixth, which shows line 7.
std::array<std::string, 6> WizardFolders(const WmPaths& lines);
// Saves them as the form does: line 7 takes box 0, line 6 stays. As SaveWmPaths otherwise.
bool SaveWizardFolders(const Files& files, const std::string& systemPath,
                       std::span<const std::string, 6> folders, Dialogs& dialogs);
// What the folder chooser is asked for by the box `index`, 0 to 5: its folder of the list, or the
// current one where that is no folder.
LocateCase WizardLocate(const WmPaths& lines, int index, const Paths& paths);
// The six ticks, "000000" to "111111", of the setting "DLWiz".
std::array<bool, 6> WizardTicks(const SettingsFile& ini);
void SaveWizardTicks(SettingsFile& ini, std::span<const bool, 6> ticks);

// ---- The service: form `ModDetails`

struct ServiceEntry {
  std::string_view text;  // in Combo1
  std::int16_t DataService;
};
std::span<const ServiceEntry> ServiceEntries();
// Of Combo1: the entry that stands for the service, the first for one that none has.
int ServiceIndex(std::int16_t DataService);
std::int16_t ServiceOfIndex(int index);  // 1 outside the entries

struct FormatEntry {
  std::string_view text;    // in Combo2
  std::string_view stored;  // InternetDLfmt
};
std::span<const FormatEntry> FormatEntries();
int FormatIndex(std::string_view InternetDLfmt);  // 0 for a text that matches none
// What is kept of a stored value that the user leaves alone: "ddMMMyy.d" of an empty one, else
// that of the entry that shows.
std::string FormatToStore(std::string_view InternetDLfmt);

// The download folder that the form proposes while Text1 is empty. Files of the sibling
// programs, in the program folder, are read for it where they are there.
std::string ProposedDownloadFolder(const Files& files, std::int16_t DataService,
                                   const std::string& systemPath);

inline constexpr std::string_view kBadDivisor =
    "Volume divisor can only be either 1, 10,  100,  1000  or 10000";
// 1, 10, 100, 1000 or 10000 from the text of Text2, else nothing.
std::optional<std::int32_t> VolumeDivisorOf(std::string_view text);

struct ServiceChoice {
  int index = 0;              // of Combo1
  std::string DLPath;         // may be empty, else ends with "\"
  std::string InternetDLfmt;  // of service 4 alone
  std::int32_t VolumeDivisor = 1;
};
// Writes the choice to the settings file and `download`, whose service folders follow. False,
// with a message and nothing written, for a path without its closing backslash.
bool SaveServiceChoice(const ServiceChoice& choice, SettingsFile& ini, DownloadSettings& download,
                       Dialogs& dialogs);

// ---- Which securities an update takes: Update.Lst of the program folder

struct UpdateRow {
  std::string code;  // upper case, UTF-8
  std::int16_t category = 0;
  std::string name;  // UTF-8
};
std::string UpdateListFile(const std::string& systemPath);
// Rows with a code; empty when there is no file. Error 7 beyond 4 MB or 100,000 rows.
std::vector<UpdateRow> ReadUpdateList(const Files& files, const std::string& systemPath);

enum class UpdateChoice { kAll = 0, kListed = 1, kNoWarrants = 2 };  // Option1 of `INUpList`
UpdateChoice UpdateChoiceOf(const DownloadSettings& download);
void SaveUpdateChoice(UpdateChoice choice, SettingsFile& ini, DownloadSettings& download);

// Saves the form `INUpList`: Update.Bak takes the old list, rows with a code are written, and
// the choice goes to the settings. A failure leaves the old list. An empty list with kListed is
// told and `choice` becomes kAll. Returns whether a list was written.
bool SaveUpdateList(const Files& files, const std::string& systemPath,
                    std::span<const UpdateRow> rows, UpdateChoice& choice, SettingsFile& ini,
                    DownloadSettings& download, Dialogs& dialogs);

}  // namespace kora
