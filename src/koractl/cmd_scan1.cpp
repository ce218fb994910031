#include <memory>
#include <optional>

#include "koractl/options.h"
#include "koractl/scan_output.h"
#include "scans/chart_scan1.h"
#include "scans/result_list.h"

namespace kora {
namespace {

struct Scan1Line {
  Scan1Choices choices;
  std::string report;
  bool sort = false;
};

// The chart of a hit comes with the first oscillator that gave it.
std::string OscillatorOf(const Scan1Hit& hit) {
  static constexpr const char* kCodes[] = {"STO", "WMS", "ROC", "MOM", "RSI"};
  for (size_t i = 0; i < kScanOscillators; ++i)
    if (hit.signals[i] != Signal::kNone) return kCodes[i];
  return "";
}

std::vector<Scan1Hit> SortedHits(const std::vector<Scan1Hit>& hits) {
  std::vector<std::string> cells;
  for (const Scan1Hit& hit : hits) cells.push_back(hit.percent);
  std::vector<Scan1Hit> sorted;
  for (const size_t i : SortByPercentage(cells)) sorted.push_back(hits[i]);
  return sorted;
}

int RunScan1Command(const CommandLine& line, Scan1Line o) {
  Run run(line);
  run.Open();
  if (o.choices.Check14) {
    const auto padded = PaddedIndustry(o.choices.Text5);
    if (!padded) run.Abandon(kIndustryNotNumeric, "Chart Scan");
    o.choices.Text5 = *padded;
  }
  Scan1Criteria criteria;
  if (const auto fault = ReadScan1(o.choices, run.session.settings.osc, criteria))
    AbandonFault(run, *fault);
  std::optional<HomeLock::Held> held = HoldHome(run);
  Scan1Result result = Scanned(run, [&](const ScanRun& scan) { return RunScan1(scan, criteria); });
  if (o.sort) result.hits = SortedHits(result.hits);
  const bool any = !result.hits.empty();
  if (any)
    Stored(run, [&] { SaveScan(run.session.files, run.dataPath(), EntriesOf(result.hits)); });

  held.reset();
  std::vector<std::string> columns = Scan1Columns(), oscillators;
  columns.pop_back();  // the record numbers
  for (const Scan1Hit& hit : result.hits) oscillators.push_back(OscillatorOf(hit));
  return LeaveHits(run,
                   {.report = o.report,
                    .title = kScan1Title,
                    .table = "Code Last Percent Stochastic Williams ROC Momentum RSI Rec",
                    .shown = columns.size()},
                   {.title = "Chart Scan 1",
                    .date = LatestText(result.latest),
                    .criteria = CriteriaOf(o.choices),
                    .columns = columns,
                    .rows = {},
                    .right = {false, true, true},
                    .notes = {},
                    .pictures = {}},
                   RowsOf(result.hits), oscillators, Scan1Ending(criteria, any), result.unread);
}

}  // namespace

void AddScan1(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<Scan1Line>();
  Scan1Choices& c = o->choices;
  CLI::App* command =
      app.add_subcommand("scan1", "Scan the market for rises, falls and signals of oscillators");
  const auto text = [command](const char* name, bool& tick, std::string& value, const char* about) {
    return AddTicked(*command, name, tick, value, about);
  };
  const auto flag = [command](const char* name, bool& tick, const char* about) {
    command->add_flag(name, tick, about);
  };
  text("--min", c.Check7, c.Text3, "Lowest closing price (0.50)");
  text("--max", c.Check7, c.Text2, "Highest closing price (5.00)");
  text("--rise", c.Check1, c.Text1, "Percentage rise, 1 to 200");
  text("--fall", c.Check15, c.Text6, "Percentage fall; the value of --rise is checked for it");
  text("--category", c.Check8, c.Text4, "Only this category");
  text("--class", c.Check14, c.Text5, "Only this industry class, or group (120)");
  flag("--no-warrants", c.Check16, "No codes of six characters");
  flag("--stochastic", c.oscillators[kStochastic], "Stochastic");
  flag("--williams", c.oscillators[kWilliams], "Williams %R");
  flag("--roc", c.oscillators[kRoc], "Rate of change");
  flag("--momentum", c.oscillators[kMomentum], "Momentum");
  flag("--rsi", c.oscillators[kRsi], "RSI");
  flag("--ob", c.Check9, "Over bought");
  flag("--cut-ob", c.Check12, "Crossings of the over-bought line");
  flag("--os", c.Check10, "Over sold");
  flag("--cut-os", c.Check11, "Crossings of the over-sold line");
  flag("--sort", o->sort, "Sort by percentage");
  AddReport(*command, o->report);
  command->callback([&line, o] { line.run = [&line, o] { return RunScan1Command(line, *o); }; });
}

}  // namespace kora
