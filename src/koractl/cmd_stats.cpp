#include <memory>
#include <optional>

#include "base/numbers.h"
#include "base/text.h"
#include "koractl/options.h"
#include "koractl/scan_output.h"
#include "koractl/table.h"
#include "scans/market_statistics.h"

namespace kora {
namespace {

struct StatsLine {
  std::string mode = "ALL";
  std::string top;
  std::string report;
};

int RunStats(const CommandLine& line, const StatsLine& o) {
  Run run(line);
  run.Open();
  const Files& files = run.session.files;
  if (!files.CheckFile(NameFilePath(run.dataPath()))) run.Abandon(kNoNameFile, kStatsTitle);
  MarketStats stats;
  std::optional<HomeLock::Held> held = HoldHome(run);
  try {
    const auto progress = run.dialogs.StartProgress("Checking Statistics");
    stats = ShowStats({files, run.dataPath(), *progress}, *StatsModeOf(o.mode), StatsTop(o.top));
    KeepStats(files, run.dataPath(), StatsTexts(stats));
  } catch (const RunTimeError& e) {
    run.Abandon(StatsErrorText(e), "Error");
  }

  held.reset();
  ScanReport report{.title = "Market statistics",
                    .date = {},
                    .criteria = {},
                    .columns = {"Side", "Code", "Name", "Class", "Latest", "Previous", "Percent"},
                    .rows = {},
                    .codeColumn = 1,
                    .right = {false, false, false, false, true, true, true},
                    .notes = {},
                    .pictures = {}};
  for (const StatsModeEntry& entry : StatsModes())
    if (EqualNoCase(entry.word, o.mode)) report.criteria.emplace_back(entry.caption);
  std::vector<ReportedChart> charts;
  Table table("Side Code Name Class Latest Previous Percent");
  const auto side = [&](const char* name, StatsCell StatsRow::*part) {
    for (const StatsRow& row : stats.rows) {
      const StatsCell& cell = row.*part;
      auto& cells = report.rows.emplace_back();
      for (const std::string& text : {std::string(name), cell.code, cell.name, cell.indClass,
                                      cell.latest, cell.previous, cell.percent}) {
        table.Text(text);
        cells.push_back(FromAnsi(text));
      }
      table.EndRow();
      charts.push_back({cell.code, ""});
    }
  };
  side("RISE", &StatsRow::rise);
  side("FALL", &StatsRow::fall);
  const StatsCounts& c = stats.counts;
  table.Note("Rises=" + Str(c.Rises) + " Falls=" + Str(c.Falls) + " Steady=" + Str(c.Steady) +
             " Traded=" + Str(c.Traded) + " Untraded=" + Str(c.Untraded));
  report.notes.push_back("Rises " + Str(c.Rises) + ", falls " + Str(c.Falls) + ", steady " +
                         Str(c.Steady) + ", traded " + Str(c.Traded) + ", untraded " +
                         Str(c.Untraded));
  const std::string unread = UnreadText(stats.unread);
  if (!unread.empty()) report.notes.push_back(unread);
  const bool drawn = WriteReport(run, o.report, std::move(report), charts);
  table.Print();
  if (!unread.empty()) run.dialogs.Message(unread, kStatsTitle);
  return drawn ? kDone : kAbandoned;
}

}  // namespace

void AddStats(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<StatsLine>();
  CLI::App* command = app.add_subcommand("stats", "Show the largest rises and falls of the day");
  AddChoice(*command, "--mode", o->mode, {"ALL", "3", "NW", "WO"},
            "All; codes of three characters; no warrants; warrants only");
  command->add_option("--top", o->top, "How many to show (20)");
  AddReport(*command, o->report);
  command->callback([&line, o] { line.run = [&line, o] { return RunStats(line, *o); }; });
}

}  // namespace kora
