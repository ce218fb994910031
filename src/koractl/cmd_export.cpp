#include <memory>
#include <optional>

#include "base/text.h"
#include "koractl/command.h"
#include "koractl/run.h"
#include "maintenance/text_exports.h"

namespace kora {
namespace {

ExportForm FormOf(bool columns) { return columns ? ExportForm::kColumns : ExportForm::kCommas; }

int Closes(const CommandLine& line, const std::optional<std::string>& date, bool columns) {
  Run run(line);
  run.Open();
  const auto progress = run.dialogs.StartProgress("Create Text File of Closing Prices");
  return ExportCloses(run.session.files, run.dataPath(), run.session.settings.paths.ChartMiscPath,
                      date, FormOf(columns), *progress, run.dialogs)
             ? kDone
             : kAbandoned;
}

int History(const CommandLine& line, const std::string& code, bool columns) {
  Run run(line);
  run.Open();
  const auto name =
      ExportHistory(run.session.files, run.dataPath(), run.session.settings.paths.ChartMiscPath,
                    ToAnsi(code), FormOf(columns), run.dialogs);
  if (!name) return kAbandoned;
  run.dialogs.Message("Text File " + *name + " created", "Text File");
  return kDone;
}

}  // namespace

void AddExport(CLI::App& app, CommandLine& line) {
  CLI::App* command = app.add_subcommand("export", "Write prices as text");
  command->require_subcommand(1);
  command->fallthrough();

  const auto columns = std::make_shared<bool>(false);
  const auto date = std::make_shared<std::optional<std::string>>();
  CLI::App* closes = command->add_subcommand("closes", "The closes of all securities on one date");
  closes->add_option_function<std::string>(
      "--date", [date](const std::string& text) { *date = text; },
      "The date, d/m/yy (default: the latest)");
  closes->add_flag("--columns", *columns, "In columns, not with commas");
  closes->callback([&line, date, columns] {
    line.run = [&line, date, columns] { return Closes(line, *date, *columns); };
  });

  const auto code = std::make_shared<std::string>();
  CLI::App* history = command->add_subcommand("history", "All days of one security");
  history->add_option("CODE", *code, "Code of the security")->required();
  history->add_flag("--columns", *columns, "In columns, not with commas");
  history->callback([&line, code, columns] {
    line.run = [&line, code, columns] { return History(line, *code, *columns); };
  });
}

}  // namespace kora
