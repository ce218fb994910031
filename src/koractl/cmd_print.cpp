#include <memory>

#include "base/host_files.h"
#include "base/text.h"
#include "chart/chart_printing.h"
#include "koractl/chart_options.h"
#include "koractl/picture_output.h"
#include "koractl/pictures/pictures.h"

namespace kora {
namespace {

struct PrintOptions : ChartOptions {
  std::string code;  // or the name of a saved chart
  std::string out;
};

bool IsSavedChart(const std::string& name) { return LCase(name).ends_with(".cht"); }

int Print(const CommandLine& line, const PrintOptions& o) {
  const PictureSize size = CheckChartOptions(o);
  if (OutputOf(o.out) != Output::kPicture || PictureKindOf(o.out) != PictureKind::kPdf)
    throw UsageError("--out: \"" + o.out + "\" does not end in .pdf");
  Run run(line);
  Session& s = run.session;
  ChartScript script;
  std::string file;
  if (IsSavedChart(o.code)) {
    run.Open(Words(o));
    file = s.files.DosPath(run.HostPathOf(o.code));
  } else {
    OpenCharts(run, o);
    ComposeScript(run, o, FindChart(run, o, o.code), size, script);
  }

  const auto pictures = LoadPictures();
  const auto printer = pictures->PdfPrinter(
      [&](const std::string& bytes) { WriteHostFile(s.files.io(), o.out, bytes); });
  const ChartPrintServices services{s.files,          run.dialogs, *printer,
                                    s.settings.fonts, s.colours,   {}};
  const PrintSetup setup = PrintSetupFrom(s.settings, s.printer);
  const ChartSize chart{size.width, size.height + size.panel};
  const bool printed = file.empty() ? PrintChartScript(services, setup, chart, script.text())
                                    : PrintChart(services, setup, chart, file);
  return printed ? kDone : kAbandoned;
}

}  // namespace

void AddPrint(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<PrintOptions>();
  CLI::App* c = app.add_subcommand("print", "Print a chart");
  c->add_option("CODE", o->code, "Code of the security, or a saved chart, FILE.cht")->required();
  AddChartOptions(*c, *o);
  c->add_option("--out", o->out, "FILE.pdf")->required()->type_name("FILE");
  c->callback([&line, o] { line.run = [&line, o] { return Print(line, *o); }; });
}

}  // namespace kora
