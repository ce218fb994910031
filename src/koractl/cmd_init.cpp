#include "base/runtime_error.h"
#include "indicators/osc_settings.h"
#include "koractl/run.h"

namespace kora {
namespace {

// What a broken-off or hand-made installation left is never emptied.
void MakeFolders(const Files& files, const Paths& paths) {
  for (const std::string& folder :
       {paths.SystemPath, paths.CurrentDataPath, paths.ChartBackupPath, paths.PfmDataPath,
        paths.PfmBackupPath, paths.SystemPath + "download\\"})
    files.MakeFolder(folder);
  files.Open(NameFilePath(paths.CurrentDataPath), OpenMode::kCreate);
  files.Open(paths.SystemPath + "IndClass.dat", OpenMode::kCreate);
  WriteColourVariants(files, paths.SystemPath);
}

int Init(const CommandLine& line) {
  Run run(line);
  Session& session = run.session;
  session.files.MakeFolder("c:\\");  // a home that is not there yet can't be locked
  const auto held = session.files.lock().Hold();
  if (session.ini.Exists()) {
    // The program with windows, started on an empty home, leaves settings alone.
    run.Open();
    if (session.files.CheckFile(NameFilePath(run.dataPath())))
      run.Abandon("There is an installation in " + session.files.home() + " already.", "KORA");
    MakeFolders(session.files, session.settings.paths);
    return kDone;
  }
  Paths paths;
  SetDefaultPaths(paths, "C:");
  MakeFolders(session.files, paths);
  // The settings file last: it is what makes a folder an installation.
  {
    const SettingsFile::Batch batch(session.ini);
    WriteDefaultSettings(session.ini);
    WriteDefaultOscPeriods(session.ini);
  }
  if (!session.ini.Exists())
    throw RunTimeError(kPathAccess, "Kora.ini can't be written in " + session.files.home());
  run.Open();  // makes the folders of saved charts and notes
  return kDone;
}

}  // namespace

void AddInit(CLI::App& app, CommandLine& line) {
  app.add_subcommand("init", "Make an empty installation")->callback([&line] {
    line.run = [&line] { return Init(line); };
  });
}

}  // namespace kora
