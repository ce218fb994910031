#include "update/download_settings.h"

#include <algorithm>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr const char* kSection = "Download";
constexpr std::uint64_t kLargestList = 1u << 20;
constexpr std::uint64_t kLargestUpdateList = 4u << 20;
constexpr size_t kMostUpdateRows = 100'000;
constexpr size_t kLongestFolder = 255;

constexpr ServiceEntry kServices[] = {
    {"KORA/Tarvo ( Mainfiles Only) ", 1},
    {"KORA/Tarvo ( All ASX or Top500 / 150 ) ", 3},
    {"BOURSE ( Internet )", 2},
    {"Other Internet data (Paritech, ParkLane, Weblink etc) ", 4},
    {"E.I.S / Just Data", 5},
};

constexpr FormatEntry kFormats[] = {
    {"ddMMMyy.d        (eg 15SEP98.d)", "DDMMMYY.D"},
    {"yymmdd.d          (eg 980915.d)", "YYMMDD.D"},
    {"yymmdd.ASX     (eg 980915.ASX)", "YYMMDD.ASX"},
    {"ddmmyy.d          (eg 150998.d)", "DDMMYY.D"},
    {"ddmmyy.ASX     (eg 150998.ASX)", "DDMMYY.ASX"},
    {"ddmmyyyy.d       (eg 15091998.d", "DDMMYYYY.D"},
    {"yyyymmdd.d       (eg 19980915.d", "YYYYMMDD.D"},
};

bool IsControl(char c) { return static_cast<unsigned char>(c) < 0x20; }

// The folder on line `number` of a small text file; empty when none can be had.
std::string FolderOnLine(const Files& files, const std::string& path, int number) {
  try {
    const std::string text = files.ReadAll(path, kLargestList);
    LineReader lines(text);
    std::string_view line;
    while (lines.Next(line)) {
      if (lines.number() != number) continue;
      const std::string_view folder = Trim(line);
      const bool odd =
          folder.size() > kLongestFolder || std::any_of(folder.begin(), folder.end(), IsControl);
      return odd ? std::string() : FromAnsi(folder);
    }
  } catch (const RunTimeError&) {
    // Another program's file: without it there is nothing to propose.
  }
  return {};
}

// Closes the folders and asks for those that are not there. False while one is empty.
bool PrepareFolders(const Files& files, std::array<std::string, 6>& folders, std::string_view title,
                    std::string_view question, Dialogs& dialogs) {
  for (std::string& folder : folders) {
    folder = WithBackslash(Trim(folder));
    if (folder.empty()) {
      dialogs.Message("Paths must be entered for all sections", title);
      return false;
    }
  }
  for (const std::string& folder : folders) {
    // Any of them may become the data folder of the settings.
    if (const std::string why = WhyNotKept(folder); !why.empty()) {
      dialogs.Message(folder + " " + why, title);
      return false;
    }
  }
  for (const std::string& folder : folders) {
    if (files.IsFolder(folder)) continue;
    const std::string text = "Directory " + folder + std::string(question);
    if (dialogs.Ask(text, "Create Directory", Buttons::kYesNo) == Answer::kYes)
      files.MakeFolder(folder);
  }
  return true;
}

// A text of one field of a list: what would end the field or the line becomes a blank.
std::string AsField(std::string_view text, bool last) {
  std::string out = ToAnsi(text);
  for (char& c : out)
    if (IsControl(c) || (c == ',' && !last)) c = ' ';
  return std::string(Trim(out));
}

std::array<std::string, 6> Copied(std::span<const std::string, 6> folders) {
  std::array<std::string, 6> out;
  for (size_t i = 0; i < out.size(); ++i) out[i] = folders[i];
  return out;
}

}  // namespace

bool SaveWmPaths(const Files& files, const std::string& systemPath,
                 std::span<const std::string, 6> folders, int chosen, Dialogs& dialogs) {
  auto boxes = Copied(folders);
  if (!PrepareFolders(files, boxes, "W/M Paths", " does not exist. Create this directory ?",
                      dialogs))
    return false;
  WriteWmPaths(
      files, systemPath,
      {boxes[0], boxes[1], boxes[2], boxes[3], boxes[4], Str(std::int32_t(chosen)), boxes[5]});
  return true;
}

std::array<std::string, 6> WizardFolders(const WmPaths& lines) {
  return {lines[kWmAsx],      lines[kWmIndices], lines[kWmFutures],
          lines[kWmOverseas], lines[kWmOptions], lines[kWmSum]};
}

bool SaveWizardFolders(const Files& files, const std::string& systemPath,
                       std::span<const std::string, 6> folders, Dialogs& dialogs) {
  auto boxes = Copied(folders);
  if (!PrepareFolders(files, boxes, "Download Package Paths", " does not exist. Create folder?",
                      dialogs))
    return false;
  WmPaths lines = ReadWmPaths(files, systemPath);
  lines[kWmAsx] = boxes[0];
  lines[kWmIndices] = boxes[1];
  lines[kWmFutures] = boxes[2];
  lines[kWmOverseas] = boxes[3];
  lines[kWmOptions] = boxes[4];
  lines[kWmSum] = boxes[0];
  WriteWmPaths(files, systemPath, lines);
  return true;
}

LocateCase WizardLocate(const WmPaths& lines, int index, const Paths& paths) {
  static constexpr const char* kPurposes[] = {"ASX stocks",         "Aust Indices",
                                              "SFE Futures",        "Overseas Data",
                                              "Put / Call Options", "Extra stocks"};
  const auto at = size_t(index);
  const std::string folder = WizardFolders(lines).at(at);
  return {kPurposes[at], folder.size() > 2 ? folder : paths.CurrentDataPath};
}

std::array<bool, 6> WizardTicks(const SettingsFile& ini) {
  std::array<bool, 6> ticks{};
  const std::string text = ini.GetSetting(kSection, "DLWiz");
  for (size_t i = 0; i < ticks.size() && i < text.size(); ++i) ticks[i] = text[i] == '1';
  return ticks;
}

void SaveWizardTicks(SettingsFile& ini, std::span<const bool, 6> ticks) {
  std::string text;
  for (const bool tick : ticks) text += tick ? '1' : '0';
  ini.PutSetting(kSection, "DLWiz", text);
}

std::span<const ServiceEntry> ServiceEntries() { return kServices; }

int ServiceIndex(std::int16_t DataService) {
  for (size_t i = 0; i < std::size(kServices); ++i)
    if (kServices[i].DataService == DataService) return int(i);
  return 0;
}

std::int16_t ServiceOfIndex(int index) {
  return index >= 0 && index < int(std::size(kServices)) ? kServices[index].DataService : 1;
}

std::span<const FormatEntry> FormatEntries() { return kFormats; }

int FormatIndex(std::string_view InternetDLfmt) {
  for (size_t i = 0; i < std::size(kFormats); ++i)
    if (EqualNoCase(kFormats[i].stored, InternetDLfmt)) return int(i);
  return 0;
}

std::string ProposedDownloadFolder(const Files& files, std::int16_t DataService,
                                   const std::string& systemPath) {
  const std::string drive = systemPath.substr(0, 2);
  std::string folder;
  switch (DataService) {
    case 2:
      folder = UCase(FolderOnLine(files, systemPath + "BdaPaths.Dat", 3));
      return folder.empty() ? drive + "\\bda32\\koradata\\" : WithBackslash(folder);
    case 4: return drive + "\\NetData\\";
    case 5:
      folder = FolderOnLine(files, systemPath + "AlSystem.lst", 4);
      return folder.empty() ? drive + "\\NetData\\" : WithBackslash(folder);
    default: return drive + "\\korawin\\download\\Out\\";
  }
}

std::string FormatToStore(std::string_view InternetDLfmt) {
  if (Trim(InternetDLfmt).empty()) return "ddMMMyy.d";
  const std::string_view shown = kFormats[FormatIndex(InternetDLfmt)].stored;
  return std::string(EqualNoCase(shown, InternetDLfmt) ? InternetDLfmt : shown);
}

std::optional<std::int32_t> VolumeDivisorOf(std::string_view text) {
  for (const std::int32_t allowed : {1, 10, 100, 1000, 10000})
    if (text == Str(allowed)) return allowed;
  return std::nullopt;
}

bool SaveServiceChoice(const ServiceChoice& choice, SettingsFile& ini, DownloadSettings& download,
                       Dialogs& dialogs) {
  const std::string path(Trim(choice.DLPath));
  if (!path.empty() && path.back() != '\\') {
    dialogs.Message("Path must end with a backslash \\ ", "Download");
    return false;
  }
  if (const std::string why = WhyNotKept(path); !why.empty()) {
    dialogs.Message(path + " " + why, "Download");
    return false;
  }
  download.DataService = ServiceOfIndex(choice.index);
  download.DLPath = path;
  download.InternetDLfmt = download.DataService == 4 ? choice.InternetDLfmt : "";
  download.VolumeDivisor = choice.VolumeDivisor;
  ReadServiceFolders(ini, download);
  const SettingsFile::Batch batch(ini);
  ini.PutSetting(kSection, "DataService", Str(std::int32_t(download.DataService)));
  ini.PutSetting(kSection, "DLPath", download.DLPath);
  ini.PutSetting(kSection, "InternetDLfmt", download.InternetDLfmt);
  ini.PutSetting(kSection, "Volume divisor", Str(download.VolumeDivisor));
  return true;
}

std::string UpdateListFile(const std::string& systemPath) { return systemPath + "Update.Lst"; }

std::vector<UpdateRow> ReadUpdateList(const Files& files, const std::string& systemPath) {
  std::vector<UpdateRow> rows;
  if (!files.CheckFile(UpdateListFile(systemPath))) return rows;
  const std::string text = files.ReadAll(UpdateListFile(systemPath), kLargestUpdateList);
  LineReader lines(text);
  std::string_view line;
  while (lines.Next(line)) {
    const auto fields = Split(line, ',');
    UpdateRow row;
    row.code = FromAnsi(UCase(Trim(fields[0])));
    if (row.code.empty()) continue;
    if (rows.size() == kMostUpdateRows) throw RunTimeError(kOutOfMemory);
    if (fields.size() > 1) {
      const double category = Val(fields[1]);
      row.category = category >= 0 && category <= 99 ? CInt(category) : std::int16_t(0);
    }
    // The name is the last field, and may have commas of its own.
    if (fields.size() > 2)
      row.name = FromAnsi(Trim(line.substr(size_t(fields[2].data() - line.data()))));
    rows.push_back(std::move(row));
  }
  return rows;
}

UpdateChoice UpdateChoiceOf(const DownloadSettings& download) {
  if (!download.UpdateAll) return UpdateChoice::kListed;
  return download.NoWarrants ? UpdateChoice::kNoWarrants : UpdateChoice::kAll;
}

void SaveUpdateChoice(UpdateChoice choice, SettingsFile& ini, DownloadSettings& download) {
  download.UpdateAll = choice != UpdateChoice::kListed;
  download.NoWarrants = choice == UpdateChoice::kNoWarrants;
  const SettingsFile::Batch batch(ini);
  ini.PutSetting(kSection, "UpdateAll ", download.UpdateAll ? "True" : "False");
  ini.PutSetting(kSection, "NoWarrants", download.NoWarrants ? "True" : "False");
}

bool SaveUpdateList(const Files& files, const std::string& systemPath,
                    std::span<const UpdateRow> rows, UpdateChoice& choice, SettingsFile& ini,
                    DownloadSettings& download, Dialogs& dialogs) {
  std::string text;
  for (const UpdateRow& row : rows) {
    const std::string code = UCase(AsField(row.code, false));
    if (code.empty()) continue;
    const bool inRange = row.category >= 0 && row.category <= 99;
    text += code + "," + Str(std::int32_t(inRange ? row.category : 0)) + "," +
            AsField(row.name, true) + "\r\n";
  }
  const auto held = files.lock().Hold();
  const std::string path = UpdateListFile(systemPath), backup = systemPath + "Update.Bak";
  if (text.empty() && choice == UpdateChoice::kListed) {
    dialogs.Message(
        "You have selected the option to update only stocks the stocks listed, but THERE ARE NO "
        "STOCKS LISTED. Your option will be reset to update All Stocks.",
        "Update List");
    choice = UpdateChoice::kAll;
  }
  // First, so that nothing is left to do once the new list is in its place.
  const UpdateChoice before = UpdateChoiceOf(download);
  SaveUpdateChoice(choice, ini, download);
  try {
    // The old list stays in its place until the new one replaces it.
    if (text.empty())
      files.Rename(path, backup);
    else
      files.WriteAll(backup, files.ReadAll(path));
  } catch (const RunTimeError&) {
    // There was no list yet, or its copy has to wait for the next save.
  }
  try {
    if (!text.empty()) files.WriteAll(path, text);
  } catch (...) {
    SaveUpdateChoice(before, ini, download);
    throw;
  }
  return !text.empty();
}

}  // namespace kora
