#include <algorithm>
#include <charconv>
#include <memory>

#include "base/dates.h"
#include "base/host_files.h"
#include "base/numbers.h"
#include "base/text.h"
#include "chart/composer.h"
#include "koractl/options.h"
#include "koractl/picture_app.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "platform/headless/headless_surface.h"
#include "platform/qt/picture.h"

namespace kora {
namespace {

constexpr int kSmallestSide = 100, kLargestSide = 10000;  // chart units
constexpr double kMostPixels = 100e6;                      // of a picture

struct ChartOptions {
  std::string code;
  std::string style = "B";
  std::string period = "A";
  std::int16_t spacing = 2;
  std::string size = "638x452";
  std::string osc;
  bool slow = false;
  int panel = 144;
  std::string volume = "on";
  std::int16_t bands = 0;
  bool ma1 = false, ma2 = false, exp = false;
  bool mma = false;
  bool marks = false, outside = false;
  bool manual = false;
  std::string finish;
  std::string box;
  std::string swing;
  std::vector<std::string> switches;
  int scale = 1;
  std::string out;
};

// What charts can't show yet. An option leaves this list when its chart is there.
void RefuseWhatIsMissing(const ChartOptions& o) {
  const auto refuse = [](const std::string& what) {
    throw UsageError(what + " can't be charted yet");
  };
  if (o.style == "P") refuse("--style P");
  if (!o.osc.empty() || o.slow) refuse("--osc");
  if (o.bands != 0) refuse("--bands");
  if (o.mma) refuse("--mma");
  if (!o.box.empty()) refuse("--box");
  if (!o.swing.empty()) refuse("--swing");
}

PictureSize ReadSize(const ChartOptions& o) {
  int width = 0, height = 0;
  const char* end = o.size.data() + o.size.size();
  auto r = std::from_chars(o.size.data(), end, width);
  const bool two = r.ec == std::errc() && r.ptr != end && (*r.ptr == 'x' || *r.ptr == 'X');
  if (two) r = std::from_chars(r.ptr + 1, end, height);
  if (!two || r.ec != std::errc() || r.ptr != end || std::min(width, height) < kSmallestSide ||
      std::max(width, height) > kLargestSide)
    throw UsageError("--size: \"" + o.size + "\" is no WIDTHxHEIGHT from 100x100 to 10000x10000");
  PictureSize size;
  size.width = width;
  size.height = height;
  size.dpr = o.scale;
  if (size.width * size.height * size.dpr * size.dpr > kMostPixels)
    throw UsageError("--scale: a picture of " + o.size + " at scale " + std::to_string(o.scale) +
                     " is too large");
  return size;
}

enum class Output { kStandardOutput, kScript, kPicture };

Output OutputOf(const std::string& out) {
  if (out == "-") return Output::kStandardOutput;
  const std::string name = LCase(out);
  const auto ends = [&name](std::string_view ending) {
    return name.size() > ending.size() && name.ends_with(ending);
  };
  if (ends(".cht")) return Output::kScript;
  if (ends(".png") || ends(".svg") || ends(".pdf")) return Output::kPicture;
  throw UsageError("--out: \"" + out + "\" ends in none of .cht, .png, .svg, .pdf");
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
  return request;
}

int Chart(const CommandLine& line, const ChartOptions& o) {
  RefuseWhatIsMissing(o);
  const PictureSize size = ReadSize(o);
  const Output output = OutputOf(o.out);
  if (!o.finish.empty() && !ParseFileDate(o.finish))
    throw UsageError("--finish: \"" + o.finish + "\" is no date in the form yyyymmdd");

  Run run(line);
  std::string words;
  for (const std::string& word : o.switches) words += word + " ";
  run.Open(words);
  run.Locate(o.code);
  Session& s = run.session;
  const ChartRequest request = RequestOf(o, s.settings, s.current.Rec);
  ChartScript script;
  const auto compose = [&](Surface& price, Surface* panel) {
    Composition chart;
    const ChartServices services{s.files,    run.dialogs, s.settings.paths, s.settings.fonts,
                                 s.colours, price,       panel,            &script};
    if (!ComposeChart(services, request, chart)) throw Abandoned();
  };
  std::string bytes;
  if (output == Output::kPicture) {
    const PictureApp app;
    bytes = MakePicture(PictureKindOf(o.out), size, compose);
  } else {
    HeadlessSurface price(size.width, size.height);
    compose(price, nullptr);
    bytes = script.text();
  }
  if (output == Output::kStandardOutput) {
    WriteOut(bytes);
    return kDone;
  }
  try {
    WriteHostFile(s.files.io(), o.out, bytes);
  } catch (const RunTimeError& e) {
    run.Abandon(o.out + ": " + e.what(), "KORA");
  }
  return kDone;
}

}  // namespace

void AddChart(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<ChartOptions>();
  CLI::App* c = app.add_subcommand("chart", "Draw a chart");
  c->add_option("CODE", o->code, "Code of the security, in any case")->required();
  AddChoice(*c, "--style", o->style, {"B", "C", "L", "P"},
            "Bar, candlestick, line, point and figure");
  AddPeriod(*c, o->period);
  c->add_option("--spacing", o->spacing, "Bar spacing; for P the reversal")
      ->capture_default_str()
      ->check(CLI::Range(1, 1000));
  c->add_option("--size", o->size, "Width and height of the price picture")
      ->type_name("WxH")
      ->capture_default_str();
  AddChoice(*c, "--osc", o->osc,
            {"STO", "FX", "R/F", "ROC", "MOM", "WMS", "RMO", "RMX", "RSI", "VTY", "MACD", "DM",
             "ERY", "COP", "JHG", "OBV", "PARA", "PARAV"},
            "Oscillator");
  c->add_flag("--slow", o->slow, "The slow form of STO");
  c->add_option("--panel", o->panel, "Height of the oscillator picture")
      ->capture_default_str()
      ->check(CLI::Range(kSmallestSide, kLargestSide));
  AddVolume(*c, o->volume);
  c->add_option("--bands", o->bands, "0 none, 1 percentage, 2 Bollinger")
      ->capture_default_str()
      ->check(CLI::Range(0, 2));
  c->add_flag("--ma1", o->ma1, "First moving average");
  c->add_flag("--ma2", o->ma2, "Second moving average");
  c->add_flag("--exp", o->exp, "Exponential averages");
  c->add_flag("--mma", o->mma, "Multiple moving averages");
  c->add_flag("--marks", o->marks, "Reversal marks");
  c->add_flag("--outside", o->outside, "Outside-bar marks, and the stop loss of the settings");
  c->add_flag("--manual", o->manual, "Manual scale from the name record");
  c->add_option("--finish", o->finish, "The chart ends at this date")->type_name("YYYYMMDD");
  c->add_option("--box", o->box, "Point and figure box value")->type_name("VALUE");
  c->add_option("--swing", o->swing, "NORM, XDay, XPoint, XPointAuto")->type_name("KIND[:SIZE]");
  c->add_option("--switch", o->switches, "A command-line word of the program")
      ->type_name("RM|A|N|XT|XS")
      ->expected(1)
      ->take_all()
      ->transform(CLI::IsMember(std::vector<std::string>{"RM", "A", "N", "XT", "XS"},
                                CLI::ignore_case)
                      .description(""));
  c->add_option("--scale", o->scale, "Pixels of a PNG to the unit")
      ->capture_default_str()
      ->check(CLI::Range(1, 8));
  c->add_option("--out", o->out, "FILE.cht, .png, .svg or .pdf; - for the script")
      ->required()
      ->type_name("FILE");
  c->callback([&line, o] { line.run = [&line, o] { return Chart(line, *o); }; });
}

}  // namespace kora
