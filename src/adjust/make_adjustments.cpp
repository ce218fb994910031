#include "adjust/make_adjustments.h"

#include <algorithm>
#include <set>

#include "adjust/row_actions.h"
#include "base/file_set.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/chart_list.h"
#include "store/definition_file.h"
#include "store/market_folders.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr size_t kMostFailuresTold = 12;

std::string FolderFor(const AdjustRow& row, const WmPaths& lines) {
  const std::string market = UCase(row.Field(kAdjFile));
  const WmLine line = market == "IDX"   ? kWmIndices
                      : market == "SFE" ? kWmFutures
                      : market == "OVS" ? kWmOverseas
                      : market == "OPT" ? kWmOptions
                                        : kWmAsx;
  return WithBackslash(Trim(lines[line]));
}

bool IsNewName(const AdjustRow& row) { return row.Action() == "NI" || row.Action() == "NL"; }
// The records without a status, as bytes.
std::string Compacted(const std::vector<NameRec>& names) {
  std::string kept;
  for (const NameRec& name : names)
    if (name.NameStatus == 0) kept.append(reinterpret_cast<const char*>(&name), sizeof name);
  return kept;
}

// Whether the run that died had compacted the name file already: once more would put the
// compacted file in the place of its copy.
bool WasCompacted(const Files& files, const std::string& folder) {
  const std::string copy = WithBackslash(folder) + "Names.bak", path = NameFilePath(folder);
  if (!files.CheckFile(copy) || !files.CheckFile(path)) return false;
  return Compacted(NameFile(files, copy).ReadAll()) == files.ReadAll(path);
}

bool DropsNames(const AdjustRow& row) { return row.Action() == "NC" || row.Action() == "DC"; }

}  // namespace

bool CheckMarketFolders(const Files& files, const Settings& settings, Dialogs& dialogs) {
  if (settings.download.DataService != 3 ||
      WmPathsComplete(ReadWmPaths(files, settings.paths.SystemPath)))
    return true;
  dialogs.Message(kNoMarketFolders, kNoMarketFoldersTitle);
  return false;
}

std::string AdjustFolder(const Files& files, const Settings& settings) {
  const std::string& current = settings.paths.CurrentDataPath;
  if (settings.download.DataService != 3 || files.CheckFile(AdjustListPath(current)))
    return current;
  const WmPaths lines = ReadWmPaths(files, settings.paths.SystemPath);
  const std::string shares = WithBackslash(Trim(lines[kWmAsx]));
  return files.CheckFile(AdjustListPath(shares)) ? shares : current;
}

void CompactNames(const Files& files, const std::string& folder) {
  const std::string path = NameFilePath(folder);
  if (!files.CheckFile(path)) return;
  FileSet set(files);
  set.Add(WithBackslash(folder) + "Names.bak", files.ReadAll(path));
  set.Add(path, Compacted(ReadNames(files, folder)));
  set.Commit();
}

std::string FailuresText(const AdjustResult& result) {
  if (result.failures.empty()) return {};
  std::string text = "These items could not be carried out and stay on the list:\n";
  for (size_t i = 0; i < result.failures.size() && i < kMostFailuresTold; ++i)
    text += "\n" + result.failures[i];
  if (result.failures.size() > kMostFailuresTold)
    text += "\nand " + Str(std::int32_t(result.failures.size() - kMostFailuresTold)) + " more";
  return text;
}

AdjustResult MakeAdjustments(const AdjustRun& run, AdjustRows& rows, const std::string& folder) {
  AdjustResult result;
  const Files& files = run.files;
  const std::int16_t service = run.settings.download.DataService;
  if (rows.empty() || (rows.size() == 1 && rows[0].Field(kAdjCode).empty())) return result;
  if (service != 1 && service != 3) return result;
  result.begun = true;
  const auto held = files.lock().Hold();
  const PassOn pass(run.progress);
  WriteAdjustList(files, folder, rows);

  const Settings& settings = run.settings;
  const WmPaths lines = ReadWmPaths(files, settings.paths.SystemPath);
  const auto show = [&](std::string_view text) { run.progress.Show(ProgressLine::kItem, text); };
  ActionPlace place{.files = files,
                    .folder = settings.paths.CurrentDataPath,
                    .notesFolder = settings.paths.ChartMiscPath,
                    .systemFolder = WithBackslash(Trim(settings.download.ServiceSystem)),
                    .wholeMarket = service == 3,
                    .noteColour = run.noteColour,
                    .status = show};
  if (service == 3) {
    const auto [general, index] = ReadMarketVolumeFactors(files, place.systemFolder);
    place.volumeFactor = general;
    place.indexVolumeFactor = index;
  }

  // Of a run that died before its end the names are dropped at the end of this one.
  bool drop = false;
  const bool diedBefore = std::any_of(rows.begin(), rows.end(), [](const AdjustRow& row) {
    return row.IsMarked('D') && DropsNames(row);
  });
  for (size_t i = 0; i < rows.size(); ++i) {
    AdjustRow& row = rows[i];
    if (!run.progress.Step(int(i), int(rows.size()))) {
      result.stopped = true;
      break;
    }
    if (service == 3) place.folder = FolderFor(row, lines);
    show("Checking " + row.Field(kAdjCode));
    if (!row.IsMarked('Y')) continue;
    const AdjustRow asked = row;
    try {
      FileSet changes(files);
      const bool any = AddAction(place, row, changes);
      if (!IsNewName(row)) row.Set(kAdjMark, "D");
      if (any) {
        changes.Add(AdjustListPath(folder), AdjustListText(rows));
        changes.Commit();
      }
    } catch (const RunTimeError& e) {
      row = asked;
      result.failures.push_back(row.Field(kAdjCode) + ": " + e.what());
      if (e.number() == kDiskFull) throw;
      continue;
    }
    drop |= DropsNames(row);
    if (!IsNewName(row) && run.rowDone) run.rowDone(i);
  }

  if (drop || (diedBefore && !WasCompacted(files, place.folder))) CompactNames(files, place.folder);
  RemoveDone(rows);
  WriteAdjustList(files, folder, rows);
  std::set<std::string> folders{settings.paths.CurrentDataPath, place.folder};
  for (const std::string& one : folders)
    if (files.CheckFile(NameFilePath(one))) CheckAllLists(files, one);
  show("");
  return result;
}

}  // namespace kora
