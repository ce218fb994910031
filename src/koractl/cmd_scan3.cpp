#include <memory>
#include <optional>

#include "koractl/options.h"
#include "koractl/scan_output.h"
#include "scans/chart_scan3.h"
#include "scans/result_list.h"

namespace kora {
namespace {

struct Scan3Line {
  Scan3Choices choices;
  std::string report;
};

int RunScan3Command(const CommandLine& line, const Scan3Line& o) {
  Run run(line);
  run.Open();
  Scan3Criteria criteria;
  if (const auto fault = ReadScan3(o.choices, criteria)) AbandonFault(run, *fault);
  std::optional<HomeLock::Held> held = HoldHome(run);
  const Scan3Result result =
      Scanned(run, [&](const ScanRun& scan) { return RunScan3(scan, criteria); });
  Stored(run, [&] { SaveScan(run.session.files, run.dataPath(), EntriesOf(result.hits)); });

  held.reset();
  const std::vector<std::string> columns = Scan3Columns();
  return LeaveHits(run,
                   {.report = o.report,
                    .title = kScan3Title,
                    .table = "Code Last Break",
                    .shown = columns.size()},
                   {.title = "Chart Scan 3",
                    .date = {},
                    .criteria = CriteriaOf(o.choices),
                    .columns = columns,
                    .rows = {},
                    .right = {false, true},
                    .notes = {},
                    .pictures = {}},
                   RowsOf(result.hits), std::vector<std::string>(result.hits.size(), "PARA"),
                   Scan3Ending(!result.hits.empty()), result.unread);
}

}  // namespace

void AddScan3(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<Scan3Line>();
  Scan3Choices& c = o->choices;
  CLI::App* command =
      app.add_subcommand("scan3", "Scan the market for breaks of the parabolic stop");
  const auto text = [command](const char* name, bool& tick, std::string& value, const char* about) {
    return AddTicked(*command, name, tick, value, about);
  };
  text("--min", c.Check1, c.Text1, "Lowest closing price (0.005)");
  text("--max", c.Check1, c.Text2, "Highest closing price (1.00)");
  text("--category", c.Check2, c.Text3, "Only this category");
  text("--class", c.Check4, c.Text6, "Only this industry class, or group (120)");
  command->add_flag("--no-warrants", c.Check6, "No codes of six characters");
  command->add_flag("--up", c.Check3, "Look for breaks up");
  command->add_flag("--down", c.Check5, "Look for breaks down");
  AddReport(*command, o->report);
  command->callback([&line, o] { line.run = [&line, o] { return RunScan3Command(line, *o); }; });
}

}  // namespace kora
