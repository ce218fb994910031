#include <memory>

#include "koractl/chart_options.h"
#include "koractl/options.h"
#include "koractl/picture_app.h"
#include "koractl/picture_output.h"

namespace kora {
namespace {

struct PictureOptions : ChartOptions {
  int scale = 1;
  std::string out;
};

int Chart(const CommandLine& line, const PictureOptions& o) {
  const PictureSize size = CheckChartOptions(o, o.scale);
  const Output output = OutputOf(o.out);
  Run run(line);
  const ChartRequest request = OpenChart(run, o);
  ChartScript script;
  std::string bytes;
  if (output == Output::kPicture) {
    const PictureApp app;
    bytes = MakePicture(PictureKindOf(o.out), size, [&](Surface& price, Surface* panel) {
      Compose(run, o, request, script, price, panel);
    });
  } else {
    ComposeScript(run, o, request, size, script);
    bytes = script.text();
  }
  WriteOutput(run, o.out, bytes);
  return kDone;
}

}  // namespace

void AddChart(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<PictureOptions>();
  CLI::App* c = app.add_subcommand("chart", "Draw a chart");
  c->add_option("CODE", o->code, "Code of the security, in any case")->required();
  AddChartOptions(*c, *o);
  c->add_option("--scale", o->scale, "Pixels of a PNG to the unit")
      ->capture_default_str()
      ->check(CLI::Range(1, 8));
  c->add_option("--out", o->out, "FILE.cht, .png, .svg or .pdf; - for the script")
      ->required()
      ->type_name("FILE");
  c->callback([&line, o] { line.run = [&line, o] { return Chart(line, *o); }; });
}

}  // namespace kora
