#pragma once

#include <CLI/CLI.hpp>
#include <functional>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "base/io.h"
#include "koractl/koractl.h"
#include "platform/dialogs.h"

namespace kora {

// What stands before the command, and the command chosen.
struct CommandLine {
  std::optional<std::string> home;  // host folder
  std::vector<std::string> sets;    // SECTION.KEY=VALUE
  std::optional<Answer> answer;
  Io* io = &MachineIo();     // through which the installation is reached
  double wait = 5;           // seconds for another program that writes the store
  std::function<int()> run;  // gives the exit code
};

// A command line that can be read but makes no sense: exit code 2.
struct UsageError : std::runtime_error {
  using std::runtime_error::runtime_error;
};
// The operation ended and its message was shown: exit code 1.
struct Abandoned {};

// Each adds its command to the parser, which sets `line.run` when the command is named.
void AddInit(CLI::App& app, CommandLine& line);
void AddDemo(CLI::App& app, CommandLine& line);
void AddNames(CLI::App& app, CommandLine& line);
void AddFind(CLI::App& app, CommandLine& line);
void AddPrices(CLI::App& app, CommandLine& line);
void AddBars(CLI::App& app, CommandLine& line);
void AddScale(CLI::App& app, CommandLine& line);
void AddChart(CLI::App& app, CommandLine& line);
void AddMulti(CLI::App& app, CommandLine& line);
void AddPlay(CLI::App& app, CommandLine& line);
void AddPrint(CLI::App& app, CommandLine& line);
void AddImport(CLI::App& app, CommandLine& line);
void AddDownloads(CLI::App& app, CommandLine& line);
void AddLines(CLI::App& app, CommandLine& line);
void AddNotes(CLI::App& app, CommandLine& line);
void AddZoom(CLI::App& app, CommandLine& line);
void AddUpdate(CLI::App& app, CommandLine& line);
void AddMaster(CLI::App& app, CommandLine& line);
void AddAdjust(CLI::App& app, CommandLine& line);
void AddEditNames(CLI::App& app, CommandLine& line);
void AddBulletins(CLI::App& app, CommandLine& line);
void AddAdjustments(CLI::App& app, CommandLine& line);
void AddCheck(CLI::App& app, CommandLine& line);
void AddChangeCode(CLI::App& app, CommandLine& line);
void AddMove(CLI::App& app, CommandLine& line);
void AddBackup(CLI::App& app, CommandLine& line);
void AddRestore(CLI::App& app, CommandLine& line);
void AddExport(CLI::App& app, CommandLine& line);
void AddRemoveDate(CLI::App& app, CommandLine& line);
void AddEdit(CLI::App& app, CommandLine& line);
void AddList(CLI::App& app, CommandLine& line);
void AddEnter(CLI::App& app, CommandLine& line);
void AddCompany(CLI::App& app, CommandLine& line);
void AddSnapshot(CLI::App& app, CommandLine& line);
void AddScan1(CLI::App& app, CommandLine& line);
void AddScan2(CLI::App& app, CommandLine& line);
void AddScan3(CLI::App& app, CommandLine& line);
void AddStats(CLI::App& app, CommandLine& line);

}  // namespace kora
