#include "shell/new_home.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "indicators/osc_settings.h"
#include "looks/colours.h"
#include "store/name_file.h"

namespace kora {
namespace {

void MakeFolders(const Files& files, const Paths& paths) {
  for (const std::string& folder : {paths.SystemPath, paths.ChartBackupPath, paths.PfmDataPath,
                                    paths.PfmBackupPath, paths.SystemPath + "download\\"})
    files.MakeFolder(folder);
  files.Open(paths.SystemPath + "IndClass.dat", OpenMode::kCreate);
  WriteColourVariants(files, paths.SystemPath);
}

void WriteSettings(const Files& files, SettingsFile& ini, const Paths& paths) {
  {
    const SettingsFile::Batch batch(ini);
    WriteDefaultSettings(ini);
    ini.PutSetting("KoraPaths", "ChtData", paths.CurrentDataPath);
    WriteDefaultOscPeriods(ini);
  }
  if (!ini.Exists())
    throw RunTimeError(kPathAccess, "Kora.ini can't be written in " + files.home());
}

}  // namespace

void MakeHomeFolders(const Files& files, const Paths& paths) {
  files.MakeFolder("c:\\");  // a home that is not there yet can't be locked
  const auto held = files.lock().Hold();
  MakeFolders(files, paths);
  files.MakeFolder(paths.CurrentDataPath);
  files.Open(NameFilePath(paths.CurrentDataPath), OpenMode::kCreate);
}

void MakeEmptyHome(const Files& files, SettingsFile& ini) {
  files.MakeFolder("c:\\");
  const auto held = files.lock().Hold();
  Paths paths;
  SetDefaultPaths(paths, "c:");
  MakeHomeFolders(files, paths);
  WriteSettings(files, ini, paths);
}

std::string WhyNoDataFolder(const Files& files, const std::string& folder) {
  if (!files.IsFolder(folder)) return "There is no folder " + folder + ".";
  if (!files.CheckFile(NameFilePath(folder)))
    return "There is no name file (Names.dat) in " + folder + ".";
  if (const std::string why = WhyNotKept(folder); !why.empty())
    return "The path " + folder + " " + why + ".";
  return {};
}

void MakeHomeOver(const Files& files, SettingsFile& ini, const std::string& folder) {
  files.MakeFolder("c:\\");
  const auto held = files.lock().Hold();
  Paths paths;
  SetDefaultPaths(paths, "c:");
  paths.CurrentDataPath = folder;
  MakeFolders(files, paths);
  WriteSettings(files, ini, paths);
}

}  // namespace kora
