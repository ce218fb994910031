#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

#include "bench/bench_home.h"
#include "indicators/directional_movement.h"
#include "indicators/holy_grail.h"
#include "indicators/oscillators.h"
#include "indicators/rmx.h"
#include "indicators/roc_momentum.h"
#include "indicators/rsi.h"
#include "indicators/stochastic_fx.h"
#include "indicators/volatility.h"
#include "indicators/williams.h"
#include "platform/headless/console_dialogs.h"
#include "platform/headless/headless_surface.h"

// Panels and trails drawn with a script in memory, on 300, 1,000 and 5,000 bars, and beside those
// that every indicator library has a floor: a plain single-pass loop over the same bars that
// draws nothing.

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
    LoadChartBars(file, Period::kDaily, true, kShare, chart.Bars);
    chart.ChartLeft = chart.FirstBarX = 42;
    chart.ChartRight = 1270;
    chart.DataFile = "BENCH.WDT";
    // The whole range of the bars on 300 units.
    chart.Price.ScaleLow = chart.Bars.ChartLow;
    chart.Price.PricePerY = (chart.Bars.ChartHigh - chart.Bars.ChartLow) / 300;
    chart.Price.ChartBottom = 350;
    for (const ChartBar& bar : chart.Bars.bars) chart.CloseY.push_back(chart.Price.Y(bar.Close));
    request.Name = NewNameRec("BENCH");
    for (const OscKey& key : OscKeys()) settings.osc[key] = {key.defaultDaily, key.defaultTwin};
    settings.osc.FillIn = true;
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
  // The length of the script.
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
         const OscKey* period = nullptr) {
  Panel panel(static_cast<int>(state.range(0)));
  if (period) panel.settings.osc[*period].daily = 200;
  size_t bytes = 0;
  for (auto _ : state) benchmark::DoNotOptimize(bytes = panel.Draw(code, slow));
  if (bytes < size_t(state.range(0)) * 5) state.SkipWithError("the panel drew no data");
  state.counters["script_bytes"] = double(bytes);
}

// Runs `loop` over the bars into a column.
template <typename Loop>
void Floor(benchmark::State& state, Loop loop) {
  const Panel panel(static_cast<int>(state.range(0)));
  std::vector<double> out(panel.chart.Bars.bars.size());
  for (auto _ : state) {
    loop(panel.chart.Bars.bars, out);
    benchmark::DoNotOptimize(out.data());
    benchmark::ClobberMemory();
  }
}

void FloorStochastic(benchmark::State& state) {
  Floor(state, [](const auto& bars, auto& out) {
    constexpr size_t K = 10;
    for (size_t i = K; i < bars.size(); ++i) {
      float high = bars[i].High, low = bars[i].Low;
      for (size_t j = i - K; j < i; ++j) {
        high = std::max(high, bars[j].High);
        low = std::min(low, bars[j].Low);
      }
      out[i] = 100.0 * (bars[i].Close - low) / (high - low);
    }
  });
}

void FloorWilliams(benchmark::State& state) {
  Floor(state, [](const auto& bars, auto& out) {
    constexpr size_t P = 7;
    for (size_t i = P; i < bars.size(); ++i) {
      float high = bars[i].High, low = bars[i].Low;
      for (size_t j = i - P + 1; j < i; ++j) {
        high = std::max(high, bars[j].High);
        low = std::min(low, bars[j].Low);
      }
      out[i] = 100.0 * (high - bars[i].Close) / (high - low);
    }
  });
}

void FloorRoc(benchmark::State& state) {
  Floor(state, [](const auto& bars, auto& out) {
    constexpr size_t P = 21;
    for (size_t i = P; i < bars.size(); ++i)
      out[i] = 100.0 * (bars[i].Close - bars[i - P].Close) / bars[i - P].Close;
  });
}

void FloorRsi(benchmark::State& state) {
  Floor(state, [](const auto& bars, auto& out) {
    constexpr size_t P = 14;
    double up = 0, down = 0;
    for (size_t i = 1; i < bars.size(); ++i) {
      const double move = double(bars[i].Close) - bars[i - 1].Close;
      up += move > 0 ? move : 0;
      down += move < 0 ? -move : 0;
      if (i > P) {
        const double old = double(bars[i - P].Close) - bars[i - P - 1].Close;
        up -= old > 0 ? old : 0;
        down -= old < 0 ? -old : 0;
      }
      out[i] = 100 * up / (up + down + 1e-12);
    }
  });
}

void FloorMacd(benchmark::State& state) {
  Floor(state, [](const auto& bars, auto& out) {
    double fast = bars[0].Close, slow = fast, signal = 0;
    for (size_t i = 1; i < bars.size(); ++i) {
      fast += (bars[i].Close - fast) * 2 / 13;
      slow += (bars[i].Close - slow) * 2 / 27;
      signal += (fast - slow - signal) * 2 / 10;
      out[i] = fast - slow - signal;
    }
  });
}

void FloorObv(benchmark::State& state) {
  Floor(state, [](const auto& bars, auto& out) {
    double total = 0;
    for (size_t i = 1; i < bars.size(); ++i) {
      if (bars[i].Close > bars[i - 1].Close)
        total += bars[i].Volume;
      else if (bars[i].Close < bars[i - 1].Close)
        total -= bars[i].Volume;
      out[i] = total;
    }
  });
}

void FloorParabolic(benchmark::State& state) {
  Floor(state, [](const auto& bars, auto& out) {
    bool up = true;
    double stop = bars[0].Low, extreme = bars[0].High, factor = 0.02;
    for (size_t i = 1; i < bars.size(); ++i) {
      const double far = up ? bars[i].High : bars[i].Low;
      const double near = up ? bars[i].Low : bars[i].High;
      stop += factor * (extreme - stop);
      if (up ? near < stop : near > stop) {
        up = !up;
        stop = extreme;
        extreme = near;
        factor = 0.02;
      } else if (up ? far > extreme : far < extreme) {
        extreme = far;
        factor = std::fmin(factor + 0.02, 0.2);
      }
      out[i] = stop;
    }
  });
}

void Sizes(benchmark::internal::Benchmark* b) {
  b->Arg(300)->Arg(1000)->Arg(5000)->Unit(benchmark::kMicrosecond);
}
void Longest(benchmark::internal::Benchmark* b) { b->Arg(5000)->Unit(benchmark::kMicrosecond); }

BENCHMARK_CAPTURE(Run, StochasticFast, "STO")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, StochasticSlow, "STO", true)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, StochasticK200, "STO", false, &kStochK)->Apply(Longest);
BENCHMARK_CAPTURE(Run, StochasticD200, "STO", true, &kStochD)->Apply(Longest);
BENCHMARK(FloorStochastic)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, FX, "FX")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RocAndFx, "R/F")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, ROC, "ROC")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RocAverage200, "ROC", false, &kRocA)->Apply(Longest);
BENCHMARK(FloorRoc)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, Momentum, "MOM")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, Williams, "WMS")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, WilliamsP200, "WMS", false, &kWmsA)->Apply(Longest);
BENCHMARK(FloorWilliams)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RMO, "RMO")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RMX, "RMX")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RmxP200, "RMX", false, &kRmxP)->Apply(Longest);
BENCHMARK_CAPTURE(Run, RSI, "RSI")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, RsiP200, "RSI", false, &kRsiP)->Apply(Longest);
BENCHMARK(FloorRsi)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, Volatility, "VTY")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, VolatilityP200, "VTY", false, &kVtyD)->Apply(Longest);
BENCHMARK_CAPTURE(Run, MACD, "MACD")->Apply(Sizes);
BENCHMARK(FloorMacd)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, DirectionalMovement, "DM")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, DirectionalMovementN200, "DM", false, &kDMA)->Apply(Longest);
BENCHMARK_CAPTURE(Run, ElderRay, "ERY")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, Coppock, "COP")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, HolyGrail, "JHG")->Apply(Sizes);
BENCHMARK_CAPTURE(Run, HolyGrailP200, "JHG", false, &kHolyD)->Apply(Longest);
BENCHMARK_CAPTURE(Run, OBV, "OBV")->Apply(Sizes);
BENCHMARK(FloorObv)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, Parabolic, "PARA")->Apply(Sizes);
BENCHMARK(FloorParabolic)->Apply(Sizes);
BENCHMARK_CAPTURE(Run, ParabolicOnAverage, "PARAV")->Apply(Sizes);

}  // namespace
