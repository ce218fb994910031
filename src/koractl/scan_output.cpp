#include "koractl/scan_output.h"

#include <filesystem>
#include <set>

#include "base/host_files.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "koractl/chart_options.h"
#include "koractl/pictures/pictures.h"
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

}  // namespace kora
