#include "koractl/chart_options.h"

#include "base/dates.h"
#include "chart/composer.h"
#include "chartwindow/tools/saved_marks.h"
#include "indicators/osc_settings.h"
#include "indicators/oscillators.h"
#include "indicators/price_overlays.h"
#include "indicators/swing_settings.h"
#include "koractl/mouse_tools.h"
#include "koractl/options.h"
#include "koractl/picture_output.h"
#include "platform/headless/headless_surface.h"
#include "store/volume_unit.h"

namespace kora {
namespace {

// Options that have no place on the chart that is asked for.
void CheckStyle(const ChartOptions& o) {
  if (o.style != "P" && o.spacing < 1) throw UsageError("--spacing: bars need 1 at least");
  if (o.style == "P" && !o.osc.empty())
    throw UsageError("a point and figure chart has no oscillator: --osc " + o.osc);
  if (o.style != "P" && !o.box.empty()) throw UsageError("--box goes with --style P");
  if (o.swing.empty()) return;
  if (o.style != "B") throw UsageError("--swing goes with --style B");
  const auto colon = o.swing.find(':');
  const auto kind = SwingKindOf(o.swing.substr(0, colon));
  if (!kind) throw UsageError("--swing: " + o.swing + " is no kind of swing");
  const bool sized = kind == SwingKind::kDays || kind == SwingKind::kPoints;
  if (!sized && colon != std::string::npos)
    throw UsageError("--swing: " + std::string(SwingWord(*kind)) + " takes no size");
}

// The kind with its size, which is the form's own where none is given.
SwingChoice SwingOf(Run& run, const ChartOptions& o) {
  const auto colon = o.swing.find(':');
  SwingChoice swing{SwingKindOf(o.swing.substr(0, colon)).value_or(SwingKind::kNone), 0};
  if (swing.kind == SwingKind::kDays) swing.size = kSwingDays;
  if (swing.kind == SwingKind::kPoints) swing.size = kSwingPoints;
  if (colon == std::string::npos) return swing;
  const auto size = ReadSwingSize(o.swing.substr(colon + 1));
  if (!size) run.Abandon(kSwingMessage, kSwingTitle);
  swing.size = *size;
  return swing;
}

ChartRequest RequestOf(Run& run, const ChartOptions& o) {
  ChartRequest request = RequestFromSettings(run.session.settings);
  request.Name = run.session.current.Rec;
  request.ChartStyle = ParseStyle(o.style).value_or(request.ChartStyle);
  request.ChartPeriod = ParsePeriod(o.period).value_or(request.ChartPeriod);
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
  if (!o.box.empty()) {
    const auto value = ReadBoxValue(run.dialogs, o.box);
    if (!value) throw Abandoned();
    request.PFAutoBox = false;
    request.PFBoxSize = *value;
  }
  const SwingChoice swing = SwingOf(run, o);
  request.Swing = swing.kind;
  request.SwingSize = swing.size;
  return request;
}

void ShowOscillator(Run& run, const ChartOptions& o, const ChartRequest& request,
                    Composition& chart, ChartScript& script, Surface& price, Surface* panel) {
  Session& s = run.session;
  OscHost host{s.files, run.dialogs, s.settings, s.colours,
               request, chart,       price,      panel ? *panel : price,
               &script};
  host.OscCode = o.osc;
  host.SlowStochastic = o.slow;
  ShowOscillatorPanel(host);
  if (run.dialogs.said()) throw Abandoned();
}

}  // namespace

ChartServices ServicesOf(Run& run, const ChartOptions& o, ChartScript& script, Surface& price,
                         Surface* panel) {
  Session& s = run.session;
  ChartServices services{s.files,
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
  services.overlays.push_back(SavedMarksOverlay(s.files, s.settings.paths.ChartMiscPath));
  return services;
}

void Compose(Run& run, const ChartOptions& o, const ChartRequest& request, ChartScript& script,
             Surface& price, Surface* panel, Composition* composed) {
  Composition own;
  Composition& chart = composed ? *composed : own;
  if (!ComposeChart(ServicesOf(run, o, script, price, panel), request, chart)) throw Abandoned();
  if (!o.osc.empty()) ShowOscillator(run, o, request, chart, script, price, panel);
  if (!o.fib.empty()) AddLevels(run, chart, request, price, script, ReadPlaces("--fib", o.fib, 4));
}

void ComposeScript(Run& run, const ChartOptions& o, const ChartRequest& request,
                   const PictureSize& size, ChartScript& script) {
  HeadlessSurface price(size.width, size.height);
  HeadlessSurface panel(size.width, size.panel);
  Compose(run, o, request, script, price, size.panel > 0 ? &panel : nullptr);
}

PictureSize CheckChartOptions(const ChartOptions& o, int scale) {
  CheckStyle(o);
  PictureSize size = ReadSize(o.size, scale);
  if (HasPanel(o.osc)) size.panel = o.panel;
  if (!o.fib.empty()) ReadPlaces("--fib", o.fib, 4);
  if (!o.finish.empty() && !ParseFileDate(o.finish))
    throw UsageError("--finish: \"" + o.finish + "\" is no date in the form yyyymmdd");
  return size;
}

std::string Words(const ChartOptions& o) {
  std::string words;
  for (const std::string& word : o.switches) words += word + " ";
  return words;
}

void OpenCharts(Run& run, const ChartOptions& o) {
  run.Open(Words(o));
  const Oscillator* oscillator = FindOscillator(o.osc);
  if (oscillator && oscillator->dailyOnly && o.period != TextOf(Period::kDaily))
    run.Abandon(o.osc + " only available on Daily Charts", o.osc);
}

ChartRequest FindChart(Run& run, const ChartOptions& o, const std::string& code) {
  run.Locate(code);
  return RequestOf(run, o);
}

void AddChartOptions(CLI::App& c, ChartOptions& o) {
  AddChoice(c, "--style", o.style, {"B", "C", "L", "P"},
            "Bar, candlestick, line, point and figure");
  AddPeriod(c, o.period);
  c.add_option("--spacing", o.spacing, "Bar spacing; for P the reversal")
      ->capture_default_str()
      ->check(CLI::Range(0, 1000));
  c.add_option("--size", o.size, "Width and height of the price picture")
      ->type_name("WxH")
      ->capture_default_str();
  std::vector<std::string> oscillators;
  for (const Oscillator& row : Oscillators()) oscillators.emplace_back(row.code);
  AddChoice(c, "--osc", o.osc, oscillators, "Oscillator");
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
  c.add_option("--fib", o.fib, "Fibonacci levels between two points of the chart")
      ->type_name("X1,Y1,X2,Y2");
  c.add_option("--switch", o.switches, "A command-line word of the program")
      ->type_name("RM|A|N|XT|XS")
      ->expected(1)
      ->take_all()
      ->transform(
          CLI::IsMember(std::vector<std::string>{"RM", "A", "N", "XT", "XS"}, CLI::ignore_case)
              .description(""));
}

}  // namespace kora
