#include <memory>
#include <optional>

#include "koractl/options.h"
#include "koractl/scan_output.h"
#include "scans/chart_scan2.h"

namespace kora {
namespace {

struct Scan2Line {
  Scan2Choices choices;
  std::string report;
};

int RunScan2Command(const CommandLine& line, const Scan2Line& o) {
  Run run(line);
  run.Open();
  Scan2Criteria criteria;
  if (const auto fault = ReadScan2(o.choices, criteria)) AbandonFault(run, *fault);
  std::optional<HomeLock::Held> held = HoldHome(run);
  const Scan2Result result =
      Scanned(run, [&](const ScanRun& scan) { return RunScan2(scan, criteria); });
  Stored(run, [&] { SaveScan2(run.session.files, run.dataPath(), result.hits); });

  held.reset();
  const std::vector<std::string> columns = Scan2Columns();
  return LeaveHits(run,
                   {.report = o.report,
                    .title = kScan2Title,
                    .table = "Code Last Volume Percent",
                    .shown = columns.size()},
                   {.title = "Chart Scan 2",
                    .date = {},
                    .criteria = CriteriaOf(o.choices),
                    .columns = columns,
                    .rows = {},
                    .right = {false, true, true, true},
                    .notes = {},
                    .pictures = {}},
                   RowsOf(result.hits), std::vector<std::string>(result.hits.size()),
                   Scan2Ending(!result.hits.empty()), result.unread);
}

}  // namespace

void AddScan2(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<Scan2Line>();
  Scan2Choices& c = o->choices;
  CLI::App* command =
      app.add_subcommand("scan2", "Scan the market for increases in volume and moves of price");
  const auto text = [command](const char* name, bool& tick, std::string& value, const char* about) {
    return AddTicked(*command, name, tick, value, about);
  };
  text("--min", c.Check1, c.Text1, "Lowest closing price (0.005)");
  text("--max", c.Check1, c.Text2, "Highest closing price (1.00)");
  CLI::Option* volume = text("--volume", c.Check2, c.Text3, "Increase in volume, percent");
  command->add_option("--days", c.Text5, "Days of the average volume; none compare with 1")
      ->needs(volume);
  text("--price", c.Check3, c.Text4, "Change of price up or down, percent");
  text("--class", c.Check4, c.Text6, "Only this industry class, or group (120)");
  command->add_flag("--no-warrants", c.Check5, "No codes of six characters");
  AddReport(*command, o->report);
  command->callback([&line, o] { line.run = [&line, o] { return RunScan2Command(line, *o); }; });
}

}  // namespace kora
