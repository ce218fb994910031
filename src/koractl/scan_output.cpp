#include "koractl/scan_output.h"

#include <filesystem>
#include <set>

#include "base/host_files.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "koractl/chart_options.h"
#include "koractl/options.h"
#include "koractl/pictures/pictures.h"
#include "koractl/table.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr int kPictureScale = 2;  // sharp on fine screens

ReportPicture PictureOf(Run& run, Pictures& pictures, const ReportedChart& chart) {
  ReportPicture picture{.code = FromAnsi(chart.code),
                        .name = {},
                        .type = "image/png",
                        .bytes = {},
                        .fault = "No chart could be drawn."};
  ChartOptions options;
  options.osc = chart.oscillator;
  const PictureSize size = CheckChartOptions(options, kPictureScale);
  try {
    const ChartRequest request = FindChart(run, options, chart.code);
    picture.name = FromAnsi(Trim(run.session.current.Rec.Name.trimmed()));
    ChartScript script;
    picture.bytes = pictures.Make(PictureKind::kPng, size, [&](Surface& price, Surface* panel) {
      Compose(run, options, request, script, price, panel);
    });
  } catch (const Abandoned&) {
    // It was told.
  } catch (const RunTimeError& e) {
    picture.fault = e.what();
  }
  return picture;
}

}  // namespace

void AddReport(CLI::App& command, std::string& folder) {
  command
      .add_option("--report", folder,
                  "Write FOLDER/index.html too: criteria, table and a chart of each row")
      ->type_name("FOLDER");
}

CLI::Option* AddTicked(CLI::App& command, const char* name, bool& tick, std::string& value,
                       const char* about) {
  return command.add_option_function<std::string>(
      name,
      [&tick, &value](const std::string& given) {
        tick = true;
        value = given;
      },
      about);
}

void AbandonFault(Run& run, const ScanFault& fault) { run.Abandon(fault.text, fault.title); }

bool WriteReport(Run& run, const std::string& folder, ScanReport report,
                 const std::vector<ReportedChart>& charts) {
  if (folder.empty()) return true;
  bool all = true;
  if (!charts.empty()) {
    const auto pictures = LoadPictures();
    const auto progress = run.dialogs.StartProgress("Charts");
    std::set<std::string> drawn;
    int done = 0;
    for (const ReportedChart& chart : charts) {
      progress->Step(++done, int(charts.size()));
      if (!drawn.insert(chart.code).second) continue;
      report.pictures.push_back(PictureOf(run, *pictures, chart));
      all &= !report.pictures.back().bytes.empty();
    }
  }
  try {
    std::error_code error;
    std::filesystem::create_directories(folder, error);
    if (error) throw RunTimeError(kPathAccess, error.message());
    WriteHostFile(run.session.files.io(), folder + "/index.html", ReportHtml(report));
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = folder + "/index.html"});
  }
  return all;
}

int LeaveHits(Run& run, const HitsOutput& output, ScanReport report,
              const std::vector<std::vector<std::string>>& rows,
              const std::vector<std::string>& oscillators, const std::string& ending,
              const UnreadFiles& unread) {
  Table table(output.table);
  std::vector<ReportedChart> charts;
  for (size_t i = 0; i < rows.size(); ++i) {
    for (const std::string& cell : rows[i]) table.Text(cell);
    table.EndRow();
    charts.push_back({rows[i][0], oscillators[i]});
    auto& cells =
        report.rows.emplace_back(rows[i].begin(), rows[i].begin() + std::ptrdiff_t(output.shown));
    cells[0] = FromAnsi(cells[0]);
  }
  const std::string left = UnreadText(unread);
  if (rows.empty()) report.notes.push_back(ending);
  if (!left.empty()) report.notes.push_back(left);
  const bool drawn = WriteReport(run, output.report, std::move(report), charts);
  table.Print();
  run.dialogs.Message(ending + (left.empty() ? "" : "\n" + left), output.title);
  return drawn ? kDone : kAbandoned;
}

}  // namespace kora
