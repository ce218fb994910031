// The multi-oscillator view with four panels at 1280x800, drawn with its script. Its floor is the
// row beside it: the same price chart and the same four panels, each drawn by itself.
#include <benchmark/benchmark.h>

#include <memory>
#include <vector>

#include "bench/bench_home.h"
#include "indicators/multi_osc.h"
#include "platform/headless/console_dialogs.h"
#include "platform/qt/qt_surface.h"

namespace {

using namespace kora;

constexpr double kWidth = 1280, kHeight = 800;  // of the price picture

struct Bench {
  bench::Home home{5000};
  ConsoleDialogs dialogs;
  Settings settings;
  ChartColours colours{};
  ChartRequest request;
  Composition chart;
  ChartScript script;
  MultiOscSet names{"MACD", "RSI", "Stochastic (Slow)", "OBV"};
  QtRasterSurface price{kWidth, kHeight};
  std::vector<std::unique_ptr<QtRasterSurface>> panels;
  std::vector<Surface*> surfaces;

  Bench() {
    settings.paths.SystemPath = "c:\\korawin\\";
    settings.paths.CurrentDataPath = "c:\\korawin\\data\\";
    settings.fonts.TitleSize = 9.75;
    settings.fonts.Font2Size = 8.25;
    for (const OscKey& key : OscKeys()) settings.osc[key] = {key.defaultDaily, key.defaultTwin};
    LoadColours(home.files(), settings.paths.SystemPath, "Black", colours);
    request.Name = NewNameRec("BENCH");
    request.GridLines = true;
    for (int i = 0; i < PanelCount(names); ++i) {
      panels.push_back(std::make_unique<QtRasterSurface>(kWidth, kHeight / PanelCount(names)));
      surfaces.push_back(panels.back().get());
    }
  }
  ChartServices Services() {
    return {.files = home.files(),
            .dialogs = dialogs,
            .paths = settings.paths,
            .fonts = settings.fonts,
            .colours = colours,
            .price = price,
            .script = &script};
  }
};

void View(benchmark::State& state) {
  Bench bench;
  for (auto _ : state) {
    if (!DrawMultiOsc(bench.Services(), bench.settings, bench.request, bench.chart, bench.names,
                      bench.surfaces))
      state.SkipWithError("not drawn");
  }
  state.counters["script_bytes"] = double(bench.script.text().size());
}

void Parts(benchmark::State& state) {
  Bench bench;
  for (auto _ : state) {
    ChartServices services = bench.Services();
    services.panel = bench.surfaces[0];
    if (!ComposeChart(services, bench.request, bench.chart)) state.SkipWithError("not composed");
    size_t place = 0;
    for (const std::string& slot : bench.names) {
      const MultiOscName* name = FindMultiOscName(slot);
      OscHost host{.files = services.files,
                   .dialogs = bench.dialogs,
                   .settings = bench.settings,
                   .colours = bench.colours,
                   .request = bench.request,
                   .chart = bench.chart,
                   .price = bench.price,
                   .panel = *bench.surfaces[place++],
                   .script = &bench.script,
                   .OscCode = std::string(name->oscillator->code),
                   .SlowStochastic = name->slow};
      ShowOscillatorPanel(host);
    }
  }
  state.counters["script_bytes"] = double(bench.script.text().size());
}

BENCHMARK(View)->Name("ViewOfFourPanels")->Unit(benchmark::kMicrosecond);
BENCHMARK(Parts)->Name("PriceChartAndFourPanels")->Unit(benchmark::kMicrosecond);

}  // namespace
