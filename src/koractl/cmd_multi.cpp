#include <memory>
#include <optional>

#include "base/text.h"
#include "indicators/multi_osc.h"
#include "koractl/chart_options.h"
#include "koractl/options.h"
#include "koractl/picture_output.h"
#include "koractl/pictures/pictures.h"
#include "koractl/table.h"
#include "platform/headless/headless_surface.h"
#include "platform/surface_part.h"

namespace kora {
namespace {

constexpr std::string_view kSets = "sets";  // in place of a code

struct MultiOptions : ChartOptions {
  std::string code;
  int set = 0;  // 0: not given
  std::optional<std::string> oscs;
  int scale = 1;
  std::string out;
};

// The names of --oscs, with a comma between them. Usage error for one that is no such name.
MultiOscSet NamesOf(const std::string& text) {
  const std::vector<std::string_view> names = Split(text, ',');
  if (names.size() > kMultiOscSlots)
    throw UsageError("--oscs: there are " + std::to_string(names.size()) + " names, at most " +
                     std::to_string(kMultiOscSlots) + " have room");
  for (const std::string_view name : names) {
    if (Trim(name).empty() || FindMultiOscName(name)) continue;
    std::string offered;
    for (const MultiOscName& each : MultiOscNames())
      offered += (offered.empty() ? "" : ", ") + std::string(each.name);
    throw UsageError("--oscs: \"" + std::string(Trim(name)) + "\" is none of " + offered);
  }
  return MultiOscSetOf(text, ',');
}

int ShowSets(Run& run) {
  Table table("Set Slot Name");
  for (int set = 1; set <= kMultiOscSets; ++set) {
    const MultiOscSet names = ReadMOSet(run.session.user, set);
    for (size_t slot = 0; slot < names.size(); ++slot)
      table.Number(set).Number(std::int32_t(slot + 1)).Text(names[slot]).EndRow();
  }
  table.Print();
  return kDone;
}

int Sets(const CommandLine& line, const MultiOptions& o) {
  if ((o.set != 0) != o.oscs.has_value())
    throw UsageError("A set is kept with both --set and --oscs");
  if (!o.out.empty()) throw UsageError("--out is for a view");
  const MultiOscSet names = NamesOf(o.oscs.value_or(""));
  Run run(line);
  run.Open();
  if (!o.oscs) return ShowSets(run);
  if (!SaveMOSets(run.session.user, o.set, names))
    run.Abandon(run.session.user.path() + " can't be written", "KORA");
  return kDone;
}

void CheckView(const MultiOptions& o) {
  if (o.style == TextOf(Style::kPointFigure))
    throw UsageError("--style P: point and figure has no view of several oscillators");
  if (!o.osc.empty() || o.slow) throw UsageError("--oscs names the oscillators of a view");
  if ((o.set != 0) == o.oscs.has_value())
    throw UsageError("Either --set or --oscs says which oscillators are shown");
  if (o.out.empty()) throw UsageError("--out is required");
}

int Multi(const CommandLine& line, const MultiOptions& o) {
  if (o.code == kSets) return Sets(line, o);
  CheckView(o);
  const Output output = OutputOf(o.out);
  PictureSize size = CheckChartOptions(o, o.scale);
  MultiOscSet names = NamesOf(o.oscs.value_or(""));
  Run run(line);
  OpenCharts(run, o);
  const ChartRequest request = FindChart(run, o, o.code);
  if (o.set != 0) names = ReadMOSet(run.session.user, o.set);
  const int count = PanelCount(names);
  if (count == 0) run.Abandon(kNoMultiOsc, MultiOscCaption(o.code, std::max(o.set, 1)));

  ChartScript script;
  // The panels share as much again below the price picture.
  size.panel = size.height;
  const auto draw = [&](Surface& price, Surface* below) {
    std::vector<SurfacePart> parts;
    const double height = MultiOscPanelHeight(below->Height(), count);
    for (int i = 0; i < count; ++i) parts.emplace_back(*below, i * height, height);
    std::vector<Surface*> panels;
    for (SurfacePart& part : parts) panels.push_back(&part);
    Composition chart;
    if (!DrawMultiOsc(ServicesOf(run, o, script, price, nullptr), run.session.settings, request,
                      chart, names, panels) ||
        run.dialogs.said())
      throw Abandoned();
  };
  std::string bytes;
  if (output == Output::kPicture) {
    bytes = LoadPictures()->Make(PictureKindOf(o.out), size, draw);
  } else {
    HeadlessSurface price(size.width, size.height), below(size.width, size.panel);
    draw(price, &below);
    bytes = script.text();
  }
  WriteOutput(run, o.out, bytes);
  return kDone;
}

}  // namespace

void AddMulti(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<MultiOptions>();
  CLI::App* c = app.add_subcommand("multi", "Draw a chart with several oscillators");
  c->add_option("CODE", o->code,
                "Code of the security, in any case; or the word sets: shows the two sets, or keeps "
                "one (--set and --oscs)")
      ->required();
  AddChartOptions(*c, *o);
  c->add_option("--set", o->set, "The kept set: 1 or 2")->check(CLI::Range(1, kMultiOscSets));
  c->add_option("--oscs", o->oscs, "Up to four names, as \"MACD,RSI,None,FX\"")->type_name("NAMES");
  c->add_option("--scale", o->scale, "Pixels of a PNG to the unit")
      ->capture_default_str()
      ->check(CLI::Range(1, 8));
  c->add_option("--out", o->out, "FILE.cht, .png, .svg or .pdf; - for the script")
      ->type_name("FILE");
  c->callback([&line, o] { line.run = [&line, o] { return Multi(line, *o); }; });
}

}  // namespace kora
