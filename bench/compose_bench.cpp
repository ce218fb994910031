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
    const ChartServices services{home.files(), dialogs, paths,   fonts, colours,
                                 surface,      nullptr, &script, {}};
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

constexpr Style kStyles[] = {Style::kBar, Style::kCandlestick, Style::kLine};

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

// Point and figure reads the whole file, and twice; its floor is the line chart of the same 5,000
// records, on a plot that is as wide as they are.
void WholeFile(benchmark::State& state) {
  Bench bench;
  const bool line = state.range(0) == 0;
  bench.request.ChartStyle = line ? Style::kLine : Style::kPointFigure;
  bench.request.BarSpacing = line ? 1 : 3;
  if (line) bench.request.BlankSpace = -5000;
  QtRasterSurface surface(638, 452);
  bench.Compose(state, surface);
}

// A swing of a full chart; its floor is the chart of bars.
void Swing(benchmark::State& state) {
  Bench bench;
  constexpr SwingKind kKinds[] = {SwingKind::kNone, SwingKind::kStandard, SwingKind::kDays,
                                  SwingKind::kPoints, SwingKind::kPointsAuto};
  bench.request.BarSpacing = 3;
  bench.request.Swing = kKinds[state.range(0)];
  bench.request.SwingSize = 3;
  QtRasterSurface surface(638, 452);
  bench.Compose(state, surface);
}

BENCHMARK(WholeFile)
    ->Name("ComposeWholeFile")
    ->ArgNames({"boxes"})
    ->Unit(benchmark::kMicrosecond)
    ->Arg(0)
    ->Arg(1);
BENCHMARK(Swing)
    ->Name("ComposeSwing")
    ->ArgNames({"kind"})
    ->Unit(benchmark::kMicrosecond)
    ->DenseRange(0, 4);
BENCHMARK(Script)->Name("ComposeScript")->Apply(Charts);
BENCHMARK(Picture)->Name("ComposeAndDraw")->Apply(Charts);

}  // namespace
