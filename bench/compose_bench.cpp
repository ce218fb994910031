// Composing and drawing whole charts. The floor of a row is the row before it in the same run:
// loading the bars, then composing with a script and no picture, then with the picture.
#include <benchmark/benchmark.h>

#include <memory>

#include "bench/bench_home.h"
#include "chart/composer.h"
#include "platform/headless/console_dialogs.h"
#include "platform/headless/headless_surface.h"
#include "platform/qt/qt_surface.h"

namespace {

using namespace kora;

struct Bench {
  bench::Home home{5000};
  ConsoleDialogs dialogs;
  Paths paths;
  FontSettings fonts;
  ChartColours colours{};
  ChartScript script;
  ChartRequest request;
  Composition chart;

  Bench() {
    paths.SystemPath = "c:\\korawin\\";
    paths.CurrentDataPath = "c:\\korawin\\data\\";
    fonts.TitleSize = 9.75;
    fonts.Font2Size = 8.25;
    LoadColours(home.files(), paths.SystemPath, "Black", colours);
    request.Name = NewNameRec("BENCH");
    request.Name.Name.set("Bench Holdings");
    request.GridLines = true;
    request.VolHeight = 2;
  }
  void Compose(benchmark::State& state, Surface& surface) {
    const ChartServices services{home.files(), dialogs,  paths,   fonts, colours,
                                 surface,      nullptr,  &script, {}};
    for (auto _ : state) {
      if (!ComposeChart(services, request, chart)) {
        state.SkipWithError("not composed");
        break;
      }
    }
    state.counters["bars"] = chart.Bars.BarCount + 1;
    state.counters["script_bytes"] = double(script.text().size());
  }
};

constexpr char kStyles[] = {'B', 'C', 'L'};

// width, height, spacing, style
void Script(benchmark::State& state) {
  Bench bench;
  bench.request.BarSpacing = std::int16_t(state.range(2));
  bench.request.ChartStyle = kStyles[state.range(3)];
  HeadlessSurface surface(double(state.range(0)), double(state.range(1)));
  bench.Compose(state, surface);
}

void Picture(benchmark::State& state) {
  Bench bench;
  bench.request.BarSpacing = std::int16_t(state.range(2));
  bench.request.ChartStyle = kStyles[state.range(3)];
  QtRasterSurface surface(double(state.range(0)), double(state.range(1)));
  bench.Compose(state, surface);
}

void Charts(benchmark::internal::Benchmark* b) {
  b->ArgNames({"w", "h", "spacing", "style"})->Unit(benchmark::kMicrosecond);
  for (const auto& [w, h] : {std::pair{638, 452}, {1600, 900}})
    for (const int spacing : {2, 10})
      for (const int style : {0, 1, 2}) b->Args({w, h, spacing, style});
}

BENCHMARK(Script)->Name("ComposeScript")->Apply(Charts);
BENCHMARK(Picture)->Name("ComposeAndDraw")->Apply(Charts);

}  // namespace
