#include <string>

#include "koractl/command.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "maintenance/backup.h"

namespace kora {
namespace {

using Copying = CopyCount (*)(const Files&, const std::string&, const std::string&, Progress&,
                              Dialogs&);

int CopyAll(const CommandLine& line, Copying copy) {
  Run run(line);
  run.Open();
  const auto progress = run.dialogs.StartProgress("Copy all Files");
  const CopyCount count = copy(run.session.files, run.dataPath(),
                               run.session.settings.paths.ChartBackupPath, *progress, run.dialogs);
  if (!count.done) return kAbandoned;
  WriteOut(std::to_string(count.files) + " files copied\n");
  return kDone;
}

}  // namespace

void AddBackup(CLI::App& app, CommandLine& line) {
  app.add_subcommand("backup", "Copy the data folder to the backup folder")->callback([&line] {
    line.run = [&line] { return CopyAll(line, BackupAllFiles); };
  });
}

void AddRestore(CLI::App& app, CommandLine& line) {
  app.add_subcommand("restore", "Copy the backup folder to the data folder")->callback([&line] {
    line.run = [&line] { return CopyAll(line, RestoreAllFiles); };
  });
}

}  // namespace kora
