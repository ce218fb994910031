#pragma once

#include <CLI/CLI.hpp>
#include <functional>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "platform/dialogs.h"

namespace kora {

// Exit codes.
inline constexpr int kDone = 0;
inline constexpr int kAbandoned = 1;  // the message says why; nothing half-written
inline constexpr int kUsage = 2;      // the command line is wrong

// What stands before the command, and the command chosen.
struct CommandLine {
  std::string home;                // host folder
  std::vector<std::string> sets;   // SECTION.KEY=VALUE
  std::optional<Answer> answer;
  std::function<int()> run;        // gives the exit code
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
void AddPlay(CLI::App& app, CommandLine& line);
void AddPrint(CLI::App& app, CommandLine& line);
void AddImport(CLI::App& app, CommandLine& line);
void AddDownloads(CLI::App& app, CommandLine& line);
void AddUpdate(CLI::App& app, CommandLine& line);
void AddMaster(CLI::App& app, CommandLine& line);

}  // namespace kora
