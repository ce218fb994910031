#include <memory>

#include "base/text.h"
#include "koractl/command.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "maintenance/data_checks.h"

namespace kora {
namespace {

// "1,2,4,5"
std::array<bool, 6> TypesOf(const std::string& text) {
  std::array<bool, 6> types{};
  for (const std::string_view part : Split(text, ',')) {
    const std::string_view type = Trim(part);
    if (type.size() != 1 || std::string_view("1245").find(type[0]) == std::string_view::npos)
      throw UsageError("--types: kinds of data to check, of 1, 2, 4 and 5, with commas between");
    types[size_t(type[0] - '0')] = true;
  }
  return types;
}

int CheckData(const CommandLine& line, const std::string& types, int staleDays) {
  const DataCheckPlan plan{TypesOf(types), staleDays};
  Run run(line);
  run.Open();
  const auto progress = run.dialogs.StartProgress("Checking Data Files");
  const DataCheck check =
      CheckDataFiles(run.session.files, run.dataPath(), plan, *progress, run.dialogs);
  if (!check.done) return kAbandoned;
  std::string text;
  for (const std::string& message : check.messages) text += FromAnsi(message) + "\n";
  WriteOut(text + "# Checked=" + std::to_string(check.checked) +
           " Repaired=" + std::to_string(check.repaired) +
           " Listed=" + std::to_string(check.messages.size()) + "\n");
  return kDone;
}

int CheckNames(const CommandLine& line) {
  Run run(line);
  run.Open();
  const auto progress = run.dialogs.StartProgress("Name File - Data Files Check");
  const NameCheck check = CheckNameData(run.session.files, run.dataPath(), *progress, run.dialogs);
  if (!check.done) return kAbandoned;
  WriteOut("Names.DAT  has " + std::to_string(check.count) + " Records\n");
  return kDone;
}

int Totals(const CommandLine& line, const std::string& code, const std::string& base) {
  Run run(line);
  run.Open();
  const auto text = CheckTotals(run.session.files, run.dataPath(), ToAnsi(code), base, run.dialogs);
  if (!text) return kAbandoned;
  WriteOut(*text + "\n");
  return kDone;
}

}  // namespace

void AddCheck(CLI::App& app, CommandLine& line) {
  CLI::App* check = app.add_subcommand("check", "Check the price files, the names or totals");
  check->require_subcommand(1);
  check->fallthrough();

  const auto types = std::make_shared<std::string>();
  const auto days = std::make_shared<int>(kStaleDays);
  CLI::App* data = check->add_subcommand(
      "data", "Close gaps in the price files, list those without data or movement");
  data->add_option("--types", *types, "Kinds of data: 1, 2, 4, 5 with commas between")->required();
  data->add_option("--stale-days", *days, "Days without volume and movement that are listed")
      ->check(CLI::Range(1, 32767));
  data->callback([&line, types, days] {
    line.run = [&line, types, days] { return CheckData(line, *types, *days); };
  });

  check->add_subcommand("names", "Names without price files, and price files without names")
      ->callback([&line] { line.run = [&line] { return CheckNames(line); }; });

  const auto code = std::make_shared<std::string>();
  const auto base = std::make_shared<std::string>("0");
  CLI::App* totals = check->add_subcommand("totals", "Work advance/decline totals out anew");
  totals->add_option("CODE", *code, "Code of the advance/decline series")->required();
  totals->add_option("--base", *base, "Total in front of the first day (default: 0)");
  totals->callback([&line, code, base] {
    line.run = [&line, code, base] { return Totals(line, *code, *base); };
  });
}

}  // namespace kora
