#include "update/download_list.h"

#include <array>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr std::array<std::string_view, 12> kMonths{"JAN", "FEB", "MAR", "APR", "MAY", "JUN",
                                                   "JUL", "AUG", "SEP", "OCT", "NOV", "DEC"};

std::string_view Part(std::string_view text, size_t from, size_t size) {  // from 1
  return from > text.size() ? std::string_view() : text.substr(from - 1, size);
}

std::vector<std::string> FilesEndingIn(const Files& files, const std::string& folder,
                                       std::string_view ending) {
  std::vector<std::string> out;
  for (const std::string& name : files.List(folder))
    // A host's name may hold what parts the folders of a path: it would name another file.
    if (EndsNoCase(name, ending) && name.find('\\') == std::string::npos &&
        !files.IsFolder(folder + name))
      out.push_back(name);
  return out;
}

// Where the parts of a date stand in a name, from 1.
struct NameForm {
  size_t length, year, yearDigits, month, day;
};
constexpr std::array<NameForm, 6> kForms{{
    {8, 1, 2, 3, 5},   // YYMMDD.D
    {10, 1, 2, 3, 5},  // YYMMDD.ASX
    {8, 5, 2, 3, 1},   // DDMMYY.D
    {10, 5, 2, 3, 1},  // DDMMYY.ASX
    {10, 5, 4, 3, 1},  // DDMMYYYY.D: the year keeps its four digits
    {10, 3, 2, 5, 7},  // YYYYMMDD.D
}};

bool MayStandInName(char c) {
  return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '.';
}

// The last character alone decides: the look at each overwrites that before.
bool NameAccepted(std::string_view name) {
  bool good = true;
  for (const char c : name) good = MayStandInName(c);
  return good;
}

// The name in the list's form; empty where there is none.
std::string ListName(std::string_view name, const NameForm& form) {
  if (name.size() != form.length) return {};
  const int month = int(Val(Part(name, form.month, 2)));
  if (month < 1 || month > 12) return {};
  return std::string(Part(name, form.day, 2)) + std::string(MonthName(month)) +
         std::string(Part(name, form.year, form.yearDigits)) + ".d";
}

// "19980915.D" of "15SEP98.D".
std::string EntryKey(std::string_view name) {
  const double year = Val(Part(name, 6, 2));
  std::string key = year > -1 && year < 30 ? "20" : "19";
  key += Part(name, 6, 2);
  const int month = MonthOfName(Part(name, 3, 3));
  if (month > 0)
    key += Format(double(month), "00");
  else
    key += Part(name, 3, 3);
  key += Part(name, 1, 2);
  key += Part(name, 8, 4);
  return key;
}

std::string EntryOfKey(std::string_view key) {
  std::string entry(Part(key, 7, 2));
  const int month = int(Val(Part(key, 5, 2)));
  entry += month >= 1 && month <= 12 ? MonthName(month) : Part(key, 5, 2);
  entry += Part(key, 3, 2);
  entry += Part(key, 9, 4);
  return entry;
}

}  // namespace

std::string_view MonthName(int month) { return kMonths.at(size_t(month - 1)); }

int MonthOfName(std::string_view name) {
  for (size_t i = 0; i < kMonths.size(); ++i)
    if (EqualNoCase(kMonths[i], name)) return int(i + 1);
  return 0;
}

std::string DownloadErrorText(const RunTimeError& error) {
  if (dynamic_cast<const HomeIsHeld*>(&error)) return error.what();
  switch (error.number()) {
    case kOutOfMemory:
    case kOutOfTextSpace:
    case kOutOfStack: return "There is a memory problem. Try closing windows and restarting";
    case kBadFileName:
    case kFileNotFound:
    case 55:
    case kBadRecordNumber:
    case 64:
    case kPathAccess:
    case kPathNotFound: return "There is a file access problem. Check directory paths option.";
    case kDeviceError:
    case kTooManyFiles:
    case kDeviceNotAvailable:
    case 70:
    case kDiskNotReady: return "There is a device problem. Check and retry";
    default: return std::string("There is an unexpected error - ") + ErrorText(error.number());
  }
}

std::string DownloadFilePath(std::string_view DLPath, std::string_view entry) {
  return WithBackslash(Trim(DLPath)) + std::string(Trim(entry));
}

void RenameInternetFiles(const Files& files, const std::string& folder, int form,
                         Dialogs& dialogs) {
  if (form < 1 || form > int(kForms.size())) {
    dialogs.Message("File name format not set\nSet format in Modify Download Details, and retry",
                    "Download");
    return;
  }
  const auto names = FilesEndingIn(files, folder, form == 2 || form == 4 ? ".ASX" : ".D");
  for (size_t i = 0; i < names.size(); ++i) {
    if (i > 0 && !NameAccepted(names[i])) continue;  // the first is taken as it is
    const std::string fresh = ListName(names[i], kForms[size_t(form - 1)]);
    if (fresh.empty()) continue;
    try {
      files.Rename(folder + names[i], folder + fresh);
    } catch (const RunTimeError&) {
      // It waits under its old name for the next listing.
    }
  }
}

DownloadEntries SortedEntries(const std::vector<std::string>& names) {
  std::vector<SortEntry> keys;
  for (size_t i = 0; i < names.size(); ++i) keys.push_back({std::int32_t(i), EntryKey(names[i])});
  ShellSort(keys);
  DownloadEntries out;
  for (const SortEntry& item : keys) {
    const std::string& name = names[size_t(item.RecNo)];
    std::string entry = EntryOfKey(item.Key);
    // A name that is no date can't be made from its key again.
    out.push_back(EqualNoCase(entry, name) ? std::move(entry) : name);
  }
  return out;
}

ListResult BuildDownloadList(const Files& files, const DownloadSettings& download, Dialogs& dialogs,
                             DownloadEntries& entries) {
  entries.clear();
  try {
    const std::string folder = WithBackslash(Trim(download.DLPath));
    if (download.DataService == 4) {
      constexpr std::array<std::string_view, 7> formats{"DDMMMYY.D", "YYMMDD.D",   "YYMMDD.ASX",
                                                        "DDMMYY.D",  "DDMMYY.ASX", "DDMMYYYY.D",
                                                        "YYYYMMDD.D"};
      const std::string wanted = UCase(Trim(download.InternetDLfmt));
      size_t form = 0;
      while (form < formats.size() && formats[form] != wanted) ++form;
      if (form == formats.size()) {
        dialogs.Message(
            "The internet data FILE NAMES are not in the correct format. Select Modify Download "
            "Details and select the correct file name format",
            "Downloaded Data");
        return ListResult::kStopped;
      }
      if (form > 0) RenameInternetFiles(files, folder, int(form), dialogs);
    }
    const auto names = FilesEndingIn(files, folder, ".D");
    if (names.empty()) {
      dialogs.Message(" There are no downloaded files to update. ", "Downloaded Data ");
      return ListResult::kNothingWaits;
    }
    entries = SortedEntries(names);
    return ListResult::kFilled;
  } catch (const RunTimeError& e) {
    entries.clear();
    dialogs.Message(DownloadErrorText(e), "Error");
    return ListResult::kStopped;
  }
}

std::string UpdateDateOf(std::string_view entry, const CalendarDate& today) {
  const std::string_view name = Trim(entry);
  if (name.size() == 9) {
    const double year = Val(Part(name, 6, 2));
    const CalendarDate date{int(year) + (year < 20 ? 2000 : 1900), MonthOfName(Part(name, 3, 3)),
                            int(Val(Part(name, 1, 2)))};
    if (ParseFileDate(FormatFileDate(date)) == date) return FormatUserDate(date);
  }
  return FormatUserDate(today);
}

bool RemoveDownload(const Files& files, const std::string& DLPath, std::string_view entry,
                    Dialogs& dialogs, DownloadEntries& entries) {
  if (dialogs.Ask("Remove " + std::string(entry), "Remove Date", Buttons::kYesNo) != Answer::kYes)
    return false;
  try {
    const std::string path = DownloadFilePath(DLPath, entry);
    if (files.CheckFile(path)) files.Remove(path);
  } catch (const RunTimeError& e) {
    dialogs.Message(DownloadErrorText(e), "Error");
    return false;
  }
  if (!entries.empty()) entries.erase(entries.begin());
  return true;
}

}  // namespace kora
