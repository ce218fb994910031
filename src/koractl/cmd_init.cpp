#include "base/runtime_error.h"
#include "koractl/run.h"

namespace kora {
namespace {

int Init(const CommandLine& line) {
  Run run(line);
  Session& session = run.session;
  if (session.ini.Exists())
    run.Abandon("There is an installation in " + session.files.home() + " already.", "KORA");
  Paths paths;
  SetDefaultPaths(paths, "C:");
  for (const std::string& folder :
       {paths.SystemPath, paths.CurrentDataPath, paths.ChartBackupPath, paths.PfmDataPath,
        paths.PfmBackupPath, paths.SystemPath + "download\\"})
    session.files.MakeFolder(folder);
  // What a broken-off or hand-made installation left is never emptied.
  session.files.Open(NameFilePath(paths.CurrentDataPath), OpenMode::kCreate);
  session.files.Open(paths.SystemPath + "IndClass.dat", OpenMode::kCreate);
  // The settings file last: it is what makes a folder an installation.
  WriteDefaultSettings(session.ini);
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
