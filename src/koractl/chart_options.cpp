#include "koractl/chart_options.h"

#include "base/dates.h"
#include "chart/composer.h"
#include "indicators/oscillators.h"
#include "indicators/price_overlays.h"
#include "koractl/options.h"
#include "koractl/picture_output.h"
#include "platform/headless/headless_surface.h"
#include "update/volume_unit.h"

namespace kora {
namespace {

// What charts can't show yet. An option leaves this list when its chart is there.
void RefuseWhatIsMissing(const ChartOptions& o) {
  const auto refuse = [](const std::string& what) {
    throw UsageError(what + " can't be charted yet");
  };
  if (o.style == "P") refuse("--style P");
  if (!o.box.empty()) refuse("--box");
  if (!o.swing.empty()) refuse("--swing");
}

ChartRequest RequestOf(const ChartOptions& o, const Settings& settings, const NameRec& name) {
  ChartRequest request = RequestFromSettings(settings);
  request.Name = name;
  request.ChartStyle = o.style[0];
  request.ChartPeriod = o.period;
  request.BarSpacing = o.spacing;
  request.VolumeOption = o.volume == "on";
  request.BandKind = o.bands;
  request.Ma1On = o.ma1;
  request.Ma2On = o.ma2;
  request.MaExp = o.exp;
  request.ColourMarks = o.marks;
  request.OutsideMarks = o.outside;
  request.AutoScale = !o.manual;
  request.FinishDateOn = !o.finish.empty();
  request.FinishDate = o.finish;
  request.OscName = o.osc;
  return request;
}

}  // namespace

void Compose(Run& run, const ChartOptions& o, const ChartRequest& request, ChartScript& script,
             Surface& price, Surface* panel) {
  Session& s = run.session;
  Composition chart;
  const ChartServices services{s.files,
                               run.dialogs,
                               s.settings.paths,
                               s.settings.fonts,
                               s.colours,
                               price,
                               panel,
                               &script,
                               PriceOverlays(o.mma, s.settings.osc.MMASet),
                               [&s](const NameRec& name) {
                                 return VolumeUnitText(s.files, s.settings, name.Code.trimmed());
                               }};
  if (!ComposeChart(services, request, chart)) throw Abandoned();
  if (o.osc.empty()) return;
  OscHost host{s.files, run.dialogs, s.settings,          s.colours, request,
               chart,   price,       panel ? *panel : price, &script};
  host.OscCode = o.osc;
  host.SlowStochastic = o.slow;
  ShowOscillatorPanel(host);
  if (run.dialogs.said()) throw Abandoned();
}

void ComposeScript(Run& run, const ChartOptions& o, const ChartRequest& request,
                   const PictureSize& size, ChartScript& script) {
  HeadlessSurface price(size.width, size.height);
  HeadlessSurface panel(size.width, size.panel);
  Compose(run, o, request, script, price, size.panel > 0 ? &panel : nullptr);
}

PictureSize CheckChartOptions(const ChartOptions& o, int scale) {
  RefuseWhatIsMissing(o);
  PictureSize size = ReadSize(o.size, scale);
  if (HasPanel(o.osc)) size.panel = o.panel;
  if (!o.finish.empty() && !ParseFileDate(o.finish))
    throw UsageError("--finish: \"" + o.finish + "\" is no date in the form yyyymmdd");
  return size;
}

std::string Words(const ChartOptions& o) {
  std::string words;
  for (const std::string& word : o.switches) words += word + " ";
  return words;
}

ChartRequest OpenChart(Run& run, const ChartOptions& o) {
  run.Open(Words(o));
  run.Locate(o.code);
  if (o.osc == "RMO" && o.period != "A") run.Abandon("RMO only available on Daily Charts", "RMO");
  return RequestOf(o, run.session.settings, run.session.current.Rec);
}

void AddChartOptions(CLI::App& c, ChartOptions& o) {
  AddChoice(c, "--style", o.style, {"B", "C", "L", "P"},
            "Bar, candlestick, line, point and figure");
  AddPeriod(c, o.period);
  c.add_option("--spacing", o.spacing, "Bar spacing; for P the reversal")
      ->capture_default_str()
      ->check(CLI::Range(1, 1000));
  c.add_option("--size", o.size, "Width and height of the price picture")
      ->type_name("WxH")
      ->capture_default_str();
  AddChoice(c, "--osc", o.osc,
            {"STO", "FX", "R/F", "ROC", "MOM", "WMS", "RMO", "RMX", "RSI", "VTY", "MACD", "DM",
             "ERY", "COP", "JHG", "OBV", "PARA", "PARAV"},
            "Oscillator");
  c.add_flag("--slow", o.slow, "The slow form of STO");
  c.add_option("--panel", o.panel, "Height of the oscillator picture")
      ->capture_default_str()
      ->check(CLI::Range(kSmallestSide, kLargestSide));
  AddVolume(c, o.volume);
  c.add_option("--bands", o.bands, "0 none, 1 percentage, 2 Bollinger")
      ->capture_default_str()
      ->check(CLI::Range(0, 2));
  c.add_flag("--ma1", o.ma1, "First moving average");
  c.add_flag("--ma2", o.ma2, "Second moving average");
  c.add_flag("--exp", o.exp, "Exponential averages");
  c.add_flag("--mma", o.mma, "Multiple moving averages");
  c.add_flag("--marks", o.marks, "Reversal marks");
  c.add_flag("--outside", o.outside, "Outside-bar marks, and the stop loss of the settings");
  c.add_flag("--manual", o.manual, "Manual scale from the name record");
  c.add_option("--finish", o.finish, "The chart ends at this date")->type_name("YYYYMMDD");
  c.add_option("--box", o.box, "Point and figure box value")->type_name("VALUE");
  c.add_option("--swing", o.swing, "NORM, XDay, XPoint, XPointAuto")->type_name("KIND[:SIZE]");
  c.add_option("--switch", o.switches, "A command-line word of the program")
      ->type_name("RM|A|N|XT|XS")
      ->expected(1)
      ->take_all()
      ->transform(CLI::IsMember(std::vector<std::string>{"RM", "A", "N", "XT", "XS"},
                                CLI::ignore_case)
                      .description(""));
}

}  // namespace kora
