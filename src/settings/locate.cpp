#include "settings/locate.h"

#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

bool IsFolder(const Files& files, const std::string& path) {
  try {
    return files.IsFolder(path);
  } catch (const RunTimeError&) {
    return false;
  }
}

}  // namespace

std::optional<LocateCase> LocateFor(std::string_view caller, int index, const Paths& paths) {
  if (caller != "CPath") return std::nullopt;
  if (index == 0) return LocateCase{"Charting Data File Folder", paths.CurrentDataPath};
  if (index == 1) return LocateCase{"Charting Data Backup", paths.ChartBackupPath};
  return std::nullopt;
}

std::vector<std::string> Drives(const Files& files) {
  std::vector<std::string> drives;
  for (char letter = 'A'; letter <= 'Z'; ++letter) {
    const std::string drive{letter, ':'};
    if (!IsFolder(files, drive + "\\")) continue;
    if (letter == 'C')
      drives.insert(drives.begin(), drive);
    else
      drives.push_back(drive);
  }
  return drives;
}

std::vector<std::string> SubFolders(const Files& files, std::string_view folder) {
  const std::string path = WithBackslash(folder);
  std::vector<std::string> names;
  try {
    names = files.List(path);
  } catch (const RunTimeError&) {
    return {};
  }
  std::erase_if(names, [&](const std::string& name) { return !IsFolder(files, path + name); });
  return names;
}

std::string ParentFolder(std::string_view folder) {
  std::string path = WithBackslash(folder);
  if (path.size() <= 3) return path;
  path.pop_back();
  return path.substr(0, path.rfind('\\') + 1);
}

std::string NearestFolder(const Files& files, std::string_view folder) {
  std::string path = WithBackslash(Trim(folder));
  if (path.size() < 3 || path[1] != ':') return {};
  while (path.size() > 3 && !IsFolder(files, path)) {
    const std::string above = ParentFolder(path);
    if (above.size() < 3) return {};
    path = above;
  }
  return path;
}

}  // namespace kora
