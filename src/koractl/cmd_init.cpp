#include "koractl/run.h"
#include "shell/new_home.h"

namespace kora {
namespace {

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
    MakeHomeFolders(session.files, session.settings.paths);
    return kDone;
  }
  MakeEmptyHome(session.files, session.ini);
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
