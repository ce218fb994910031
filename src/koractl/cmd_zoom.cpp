#include <memory>

#include "base/runtime_error.h"
#include "chartwindow/tools/zoom_chart.h"
#include "koractl/chart_options.h"
#include "koractl/mouse_tools.h"
#include "koractl/options.h"
#include "koractl/picture_output.h"
#include "koractl/pictures/pictures.h"
#include "platform/headless/headless_surface.h"

namespace kora {
namespace {

struct ZoomOptions : ChartOptions {
  std::string code;
  int scale = 1;
  std::string rectangle, out;
};

int ZoomPicture(const CommandLine& line, const ZoomOptions& o) {
  const std::vector<double> places = ReadPlaces("--box", o.rectangle, 4);
  const PictureSize size = CheckChartOptions(o, o.scale);
  if (OutputOf(o.out) != Output::kPicture)
    throw UsageError("--out: \"" + o.out + "\" ends in none of .png, .svg, .pdf");
  if (o.style != "B" && o.style != "C")
    throw UsageError("--style: only bars and candlesticks are enlarged");
  const auto box = ZoomBoxOf(places[0], places[1], places[2], places[3]);
  if (!box) throw UsageError("--box: a box has a width and a height");
  Run run(line);
  OpenCharts(run, o);
  const ChartRequest request = FindChart(run, o, o.code);
  HeadlessSurface price(size.width, size.height), panel(size.width, size.panel);
  ChartScript script;
  Composition chart;
  Compose(run, o, request, script, price, size.panel > 0 ? &panel : nullptr, &chart);
  PictureSize whole = size;
  whole.panel = 0;
  const std::string bytes =
      LoadPictures()->Make(PictureKindOf(o.out), whole, [&](Surface& surface, Surface*) {
        ZoomChart(surface, chart, request, run.session.colours, run.session.settings.fonts, *box);
      });
  WriteOutput(run, o.out, bytes);
  return kDone;
}

}  // namespace

void AddZoom(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<ZoomOptions>();
  CLI::App* c = app.add_subcommand("zoom", "Draw a part of a chart enlarged");
  c->add_option("CODE", o->code, "Code of the security, in any case")->required();
  AddChartOptions(*c, *o);
  // Point and figure charts, whose boxes that one sizes, are not enlarged.
  c->remove_option(c->get_option("--box"));
  c->add_option("--scale", o->scale, "Pixels of a PNG to the unit")
      ->capture_default_str()
      ->check(CLI::Range(1, 8));
  c->add_option("--box", o->rectangle, "Two corners of the part on that chart")
      ->required()
      ->type_name("X1,Y1,X2,Y2");
  c->add_option("--out", o->out, "FILE.png, .svg or .pdf")->required()->type_name("FILE");
  c->callback([&line, o] { line.run = [&line, o] { return ZoomPicture(line, *o); }; });
}

}  // namespace kora
