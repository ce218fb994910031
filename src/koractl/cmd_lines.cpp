#include <memory>

#include "base/runtime_error.h"
#include "chartwindow/tools/trendline.h"
#include "koractl/chart_options.h"
#include "koractl/mouse_tools.h"
#include "koractl/options.h"
#include "koractl/table.h"
#include "platform/headless/headless_surface.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Trendline";

struct LineOptions : ChartOptions {
  std::string code;
  std::string action;
  std::int32_t record = 0;
  std::string at;
};

std::string PathOf(Run& run) {
  return TrendlinePath(run.session.settings.paths.ChartMiscPath,
                       run.session.current.Rec.Code.trimmed());
}

void PrintLines(Run& run) {
  Table table("Rec Spacing Period StartDate StartPrice EndDate EndPrice");
  std::int32_t number = 0;
  for (const TrendlineRec& rec : ReadTrendlines(run.session.files, PathOf(run))) {
    table.Number(++number).Number(std::int32_t(rec.TLSpacing)).Text(rec.TLPeriod.trimmed());
    table.Text(rec.TLStartDate.trimmed()).Number(float(rec.TLStartPrice));
    table.Text(rec.TLEndDate.trimmed()).Number(float(rec.TLEndPrice)).EndRow();
  }
  table.Print();
}

void Add(Run& run, const LineOptions& o, const ChartRequest& request, const PictureSize& size,
         const std::vector<double>& at) {
  HeadlessSurface price(size.width, size.height), panel(size.width, size.panel);
  ChartScript script;
  Composition chart;
  Compose(run, o, request, script, price, size.panel > 0 ? &panel : nullptr, &chart);
  ToolStage stage(run, chart, request, price, script);
  TrendlineTool tool(stage.view());
  tool.Click({at[0], at[1]});
  tool.Click({at[2], at[3]});
  if (stage.view().rows.empty() && !run.dialogs.said())
    run.Abandon("The line was not saved: it needs two places on the chart, the left one on a bar",
                kTitle);
}

int Lines(const CommandLine& line, const LineOptions& o) {
  const bool add = o.action == "add";
  if (add != !o.at.empty()) throw UsageError("lines CODE add --at X1,Y1,X2,Y2");
  if ((o.action == "delete") != (o.record != 0)) throw UsageError("lines CODE delete N");
  const std::vector<double> at = add ? ReadPlaces("--at", o.at, 4) : std::vector<double>();
  const PictureSize size = CheckChartOptions(o);
  Run run(line);
  OpenCharts(run, o);
  const ChartRequest request = FindChart(run, o, o.code);
  const Files& files = run.session.files;
  try {
    if (o.action.empty()) PrintLines(run);
    if (add) Add(run, o, request, size, at);
    if (o.action == "delete") DeleteTrendline(files, PathOf(run), o.record);
    if (o.action == "clear") RemoveTrendlines(files, PathOf(run));
    if (o.action == "compact") CompactTrendlines(files, PathOf(run));
  } catch (const RunTimeError& e) {
    run.Abandon(e.what(), kTitle);
  }
  // What was told kept it from being saved.
  return run.dialogs.said() ? kAbandoned : kDone;
}

}  // namespace

void AddLines(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<LineOptions>();
  CLI::App* c = app.add_subcommand("lines", "Show, draw and delete the trendlines of a security");
  c->add_option("CODE", o->code, "Code of the security, in any case")->required();
  AddChoice(*c, "ACTION", o->action, {"add", "delete", "clear", "compact"},
            "Without one the lines are shown");
  c->add_option("N", o->record, "The record to delete")->check(CLI::Range(1, 32767));
  AddChartOptions(*c, *o);
  c->add_option("--at", o->at, "Where the line begins and ends on that chart")
      ->type_name("X1,Y1,X2,Y2");
  c->callback([&line, o] { line.run = [&line, o] { return Lines(line, *o); }; });
}

}  // namespace kora
