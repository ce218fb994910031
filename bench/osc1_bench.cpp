#include <benchmark/benchmark.h>

#include <algorithm>
#include <string>
#include <vector>

#include "bench/bench_home.h"
#include "indicators/oscillators.h"
#include "platform/headless/console_dialogs.h"
#include "platform/headless/headless_surface.h"

// The panels of this half drawn with a script in memory, on 300, 1,000 and 5,000 bars, and beside
// those that every indicator library has a floor: a plain single-pass loop over the same bars
// that draws nothing.

namespace {

using namespace kora;

constexpr const char* kData = "c:\\korawin\\data\\";

struct Panel {
  bench::Home home;
  ConsoleDialogs dialogs;
  Settings settings;
  ChartColours colours{};
  ChartRequest request;
  Composition chart;
  HeadlessSurface price{1280, 400}, panel{1280, 144};

  explicit Panel(int n) : home(n) {
    const PriceFile file(home.files(), std::string(kData) + "BENCH.WDT");
    chart.Bars.FirstDataRec = 1;
    chart.Bars.LastDataRec = static_cast<std::int16_t>(n);
    LoadChartBars(file, "A", true, kShare, chart.Bars);
    chart.ChartRight = 1270;
    chart.DataFile = "BENCH.WDT";
    request.Name = NewNameRec("BENCH");
    for (const OscKey& key : OscKeys())
      settings.osc.*key.value = {key.defaultDaily, key.defaultTwin};
    settings.osc.RFAve = true;
    settings.paths.CurrentDataPath = kData;
    settings.osc.CompFile = std::string(kData) + "INDEX.WDT";
    PutIndex(file);
  }
  // A compare file of the same length: the security's own prices, newest first.
  void PutIndex(const PriceFile& file) {
    const std::vector<PriceRec> records = file.ReadAll();
    std::string bytes;
    for (auto record = records.rbegin(); record != records.rend(); ++record)
      bytes.append(reinterpret_cast<const char*>(&*record), sizeof *record);
    home.files().WriteAll(settings.osc.CompFile, bytes);
  }
  // Draws the panel; the length of its script.
  size_t Draw(const char* code, bool slow) {
    ChartScript script;
    OscHost host{home.files(), dialogs, settings, colours, request, chart, price, panel, &script};
    host.OscCode = code;
    host.SlowStochastic = slow;
    ShowOscillatorPanel(host);
    return script.text().size();
  }
};

void Run(benchmark::State& state, const char* code, bool slow = false,
         PeriodPair OscSettings::*period = nullptr) {
  Panel panel(static_cast<int>(state.range(0)));
  if (period) (panel.settings.osc.*period).daily = 200;
  size_t bytes = 0;
  for (auto _ : state) benchmark::DoNotOptimize(bytes = panel.Draw(code, slow));
  if (bytes < size_t(state.range(0)) * 5) state.SkipWithError("the panel drew no data");
  state.counters["script_bytes"] = double(bytes);
}

void FloorStochastic(benchmark::State& state) {
  const Panel panel(static_cast<int>(state.range(0)));
  const std::vector<ChartBar>& bars = panel.chart.Bars.bars;
  std::vector<double> out(bars.size());
  constexpr size_t K = 10;
  for (auto _ : state) {
    for (size_t i = K; i < bars.size(); ++i) {
      float high = bars[i].High, low = bars[i].Low;
      for (size_t j = i - K; j < i; ++j) {
        high = std::max(high, bars[j].High);
        low = std::min(low, bars[j].Low);
      }
      out[i] = 100.0 * (bars[i].Close - low) / (high - low);
    }
    benchmark::DoNotOptimize(out.data());
    benchmark::ClobberMemory();
  }
}

void FloorWilliams(benchmark::State& state) {
  const Panel panel(static_cast<int>(state.range(0)));
  const std::vector<ChartBar>& bars = panel.chart.Bars.bars;
  std::vector<double> out(bars.size());
  constexpr size_t P = 7;
  for (auto _ : state) {
    for (size_t i = P; i < bars.size(); ++i) {
      float high = bars[i].High, low = bars[i].Low;
      for (size_t j = i - P + 1; j < i; ++j) {
        high = std::max(high, bars[j].High);
        low = std::min(low, bars[j].Low);
      }
      out[i] = 100.0 * (high - bars[i].Close) / (high - low);
    }
    benchmark::DoNotOptimize(out.data());
    benchmark::ClobberMemory();
  }
}

void FloorRoc(benchmark::State& state) {
  const Panel panel(static_cast<int>(state.range(0)));
  const std::vector<ChartBar>& bars = panel.chart.Bars.bars;
  std::vector<double> out(bars.size());
  constexpr size_t P = 21;
  for (auto _ : state) {
    for (size_t i = P; i < bars.size(); ++i)
      out[i] = 100.0 * (bars[i].Close - bars[i - P].Close) / bars[i - P].Close;
    benchmark::DoNotOptimize(out.data());
    benchmark::ClobberMemory();
  }
}

void Sizes(benchmark::internal::Benchmark* b) {
  b->Arg(300)->Arg(1000)->Arg(5000)->Unit(benchmark::kMicrosecond);
}

BENCHMARK_CAPTURE(Run, StochasticFast, "STO")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, StochasticSlow, "STO", true)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, StochasticK200, "STO", false, &OscSettings::StochK)->Arg(5000)
    ->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(Run, StochasticD200, "STO", true, &OscSettings::StochD)->Arg(5000)
    ->Unit(benchmark::kMicrosecond);
BENCHMARK(FloorStochastic)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, FX, "FX")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RocAndFx, "R/F")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, ROC, "ROC")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RocAverage200, "ROC", false, &OscSettings::RocA)->Arg(5000)
    ->Unit(benchmark::kMicrosecond);
BENCHMARK(FloorRoc)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, Momentum, "MOM")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, Williams, "WMS")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, WilliamsP200, "WMS", false, &OscSettings::WmsA)->Arg(5000)
    ->Unit(benchmark::kMicrosecond);
BENCHMARK(FloorWilliams)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RMO, "RMO")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RMX, "RMX")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RmxP200, "RMX", false, &OscSettings::RmxP)->Arg(5000)
    ->Unit(benchmark::kMicrosecond);

}  // namespace
