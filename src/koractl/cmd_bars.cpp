#include <memory>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "koractl/options.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "store/chart_bars.h"

namespace kora {
namespace {

struct BarsOptions {
  std::string code;
  std::string period = "A";
  std::string volume = "on";
  std::optional<std::int32_t> first, last;
};

constexpr std::string_view kTitle = "Chart Display";

void CheckSlice(Run& run, const BarsOptions& options, std::int32_t count, ChartBars& bars) {
  const std::string name = run.session.current.PriceFileName;
  if (count == 0) run.Abandon("No Data for " + name, kTitle);
  const std::int32_t first = options.first.value_or(1);
  const std::int32_t last = options.last.value_or(count);
  if (first < 1 || first > last || last > count)
    run.Abandon("There are no records " + Str(first) + " to " + Str(last) + " in " + name +
                    ", which has " + Str(count),
                kTitle);
  bars.FirstDataRec = CInt(first);
  bars.LastDataRec = CInt(last);
}

void LoadSlice(Run& run, const BarsOptions& options, ChartBars& bars) {
  const std::int16_t kind = run.session.current.Rec.RecType;
  ChartFailure at{.file = run.session.current.PriceFileName, .RecType = kind};
  try {
    const PriceFile file(run.session.files, run.PriceFilePath());
    CheckSlice(run, options, file.count(), bars);
    try {
      LoadChartBars(file, ParsePeriod(options.period).value_or(Period::kDaily),
                    options.volume == "on", kind, bars);
    } catch (const RunTimeError&) {
      at.record = bars.CurrentDataRec;
      at.date = DateForMessage(file, at.record);
      throw;
    }
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, at, kTitle);
  }
}
int Bars(const CommandLine& line, const BarsOptions& options) {
  Run run(line);
  run.Open();
  run.Locate(options.code);
  ChartBars bars;
  LoadSlice(run, options, bars);
  Table table("Bar Date Open High Low Close Volume SourceRec");
  for (std::int32_t i = 0; i <= bars.BarCount; ++i) {
    const ChartBar& bar = bars[size_t(i)];
    table.Number(i).Text(bar.date()).Number(bar.Open).Number(bar.High).Number(bar.Low);
    table.Number(bar.Close).Number(bar.Volume).Number(bar.SourceRec).EndRow();
  }
  const auto figure = [](const char* name, auto value) {
    return std::string(" ") + name + "=" + Str(value);
  };
  table.Note((figure("BarCount", std::int32_t(bars.BarCount)) +
              figure("FirstDataRec", std::int32_t(bars.FirstDataRec)) +
              figure("LastDataRec", std::int32_t(bars.LastDataRec)) +
              figure("ChartHigh", bars.ChartHigh) + figure("ChartLow", bars.ChartLow) +
              figure("VolMax", bars.VolMax) + figure("VolMin", bars.VolMin) +
              figure("VolAvg", bars.VolAvg) +
              " VolumeShown=" + (bars.VolumeShown ? "True" : "False"))
                 .substr(1));
  table.Print();
  return kDone;
}

}  // namespace

void AddBars(CLI::App& app, CommandLine& line) {
  const auto options = std::make_shared<BarsOptions>();
  CLI::App* command = app.add_subcommand("bars", "Show the bars of a slice of a price file");
  command->add_option("CODE", options->code, "Code of the security, in any case")->required();
  AddPeriod(*command, options->period);
  command->add_option("--first", options->first, "First record (default: 1)");
  command->add_option("--last", options->last, "Last record (default: the last of the file)");
  AddVolume(*command, options->volume);
  command->callback(
      [&line, options] { line.run = [&line, options] { return Bars(line, *options); }; });
}

}  // namespace kora
