// Scans of a market of 5,000 securities with 2,500 records each, beside opening the same files and
// reading the same records with the bare calls of the host. All files are in the host's cache.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "bench/bench_home.h"
#include "scans/chart_scan1.h"
#include "scans/chart_scan2.h"
#include "scans/chart_scan3.h"
#include "scans/market_statistics.h"
#include "store/name_file.h"
#include "tests/support/counting_io.h"

using namespace kora;

namespace {

constexpr int kSecurities = 5000;
constexpr int kDays = 2500;
constexpr int kScan2Days = 20;
const std::string kData = "c:\\korawin\\data\\";
const std::string kManyData = "c:\\korawin\\many\\";  // ten names a price file

std::string Code(int n) { return "C" + std::to_string(10000 + n); }

// Shares that go up and down, each in its own way.
struct Market {
  test::TempHome home;
  Files& files = home.files();
  test::CountingIo oneThread;  // a host that is for the calling thread alone
  Files oneThreadFiles{home.path(), oneThread};
  std::vector<std::string> hostPaths;

  Market() {
    files.MakeFolder(kData);
    const std::string folder = files.HostPath("c:\\korawin\\data");
    std::vector<PriceRec> days = bench::TradingDays(1995, kDays);
    std::vector<NameRec> names;
    std::uint32_t seed = 1;
    for (int n = 0; n < kSecurities; ++n) {
      int price = 400 + n % 1000;
      for (PriceRec& day : days) {
        seed = seed * 1664525u + 1013904223u;
        price = std::max(50, price + int(seed >> 16) % 21 - 10);
        day.Close = float(price) / 100;
        day.Open = day.Close - 0.01f;
        day.High = day.Close + 0.03f;
        day.Low = day.Close - 0.02f;
        day.Volume = 1000 + int(seed >> 20);
      }
      PriceFile(files, kData + Code(n) + ".WDT", OpenMode::kReplace).WriteRun(1, days);
      hostPaths.push_back(folder + "/" + Code(n) + ".WDT");
      names.push_back(NewNameRec(Code(n)));
    }
    NameFile(files, kData + "Names.dat", OpenMode::kReplace).WriteRun(1, names);
    // The same files under ten times as many names.
    files.MakeFolder(kManyData);
    for (const std::string& path : hostPaths)
      if (::link(path.c_str(),
                 (files.HostPath("c:\\korawin\\many") + path.substr(path.rfind('/'))).c_str()) != 0)
        throw std::runtime_error("no link");
    NameFile many(files, kManyData + "Names.dat", OpenMode::kReplace);
    for (int i = 0; i < 10; ++i) many.WriteRun(many.count() + 1, names);
    const timespec then[2] = {{1'000'000'000, 0}, {1'000'000'000, 0}};
    ::utimensat(AT_FDCWD, folder.c_str(), then, 0);
  }
};

Market& TheMarket() {
  static Market market;
  return market;
}

// The floor: open, length, last records, close.
void ReadLastPlain(benchmark::State& state) {
  Market& market = TheMarket();
  std::vector<char> bytes(size_t(state.range(0)) * sizeof(PriceRec));
  for (auto _ : state) {
    for (const std::string& path : market.hostPaths) {
      const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
      struct stat st;
      ::fstat(fd, &st);
      if (::pread(fd, bytes.data(), bytes.size(), st.st_size - off_t(bytes.size())) !=
          ssize_t(bytes.size()))
        state.SkipWithError("short read");
      ::close(fd);
      benchmark::DoNotOptimize(bytes.data());
    }
  }
  state.SetItemsProcessed(state.iterations() * kSecurities);
}

// `work` on a run whose reading is done by the calling thread, or ahead of it.
template <typename Work>
void Run(benchmark::State& state, bool ahead, const std::string& data, int securities, Work work) {
  Market& market = TheMarket();
  NoProgress quiet;
  const ScanRun run{ahead ? market.files : market.oneThreadFiles, data, quiet};
  for (auto _ : state) work(run);
  state.SetItemsProcessed(state.iterations() * securities);
}

void Walk(benchmark::State& state, bool ahead) {
  const auto records = std::int32_t(state.range(0));
  Run(state, ahead, kData, kSecurities, [&](const ScanRun& run) {
    MarketWalk walk(run.files, run.dataPath);
    walk.Run({.records = records}, run.progress, {},
             [](const MarketItem& item) { benchmark::DoNotOptimize(item.records.data()); });
    if (walk.unread().total() != 0) state.SkipWithError("unread");
  });
}

Scan1Criteria AllOscillators() {
  Scan1Criteria criteria;
  criteria.rise = 3;
  criteria.fall = 3;
  criteria.periods = {10, 7, 10, 10, 14};
  criteria.boxes = {true, true, true, true};
  return criteria;
}

void Scan1(benchmark::State& state, bool ahead) {
  const Scan1Criteria criteria = AllOscillators();
  Run(state, ahead, kData, kSecurities,
      [&](const ScanRun& run) { benchmark::DoNotOptimize(RunScan1(run, criteria).hits.size()); });
}

// Ten times the names: the time should be ten times that of Scan1.
void Scan1OfFiftyThousand(benchmark::State& state) {
  const Scan1Criteria criteria = AllOscillators();
  Run(state, true, kManyData, 10 * kSecurities,
      [&](const ScanRun& run) { benchmark::DoNotOptimize(RunScan1(run, criteria).hits.size()); });
}

void Scan2(benchmark::State& state, bool ahead) {
  Scan2Criteria criteria;
  criteria.volume = 50;
  criteria.days = kScan2Days;
  criteria.price = 2;
  Run(state, ahead, kData, kSecurities,
      [&](const ScanRun& run) { benchmark::DoNotOptimize(RunScan2(run, criteria).hits.size()); });
}

void Scan3(benchmark::State& state, bool ahead) {
  Scan3Criteria criteria;
  criteria.up = criteria.down = true;
  Run(state, ahead, kData, kSecurities,
      [&](const ScanRun& run) { benchmark::DoNotOptimize(RunScan3(run, criteria).hits.size()); });
}

void Stats(benchmark::State& state, bool ahead) {
  Run(state, ahead, kData, kSecurities, [&](const ScanRun& run) {
    benchmark::DoNotOptimize(ShowStats(run, StatsMode::kAll, 20).rows.size());
  });
}

// Records that scan 1, scan 2, scan 3 and the statistics read.
BENCHMARK(ReadLastPlain)->Arg(261)->Arg(kScan2Days + 2)->Arg(101)->Arg(2)->UseRealTime();
BENCHMARK_CAPTURE(Walk, one_thread, false)->Arg(261)->Arg(2)->UseRealTime();
BENCHMARK_CAPTURE(Walk, reading_ahead, true)->Arg(261)->Arg(2)->UseRealTime();
BENCHMARK_CAPTURE(Scan1, one_thread, false)->UseRealTime();
BENCHMARK_CAPTURE(Scan1, reading_ahead, true)->UseRealTime();
BENCHMARK(Scan1OfFiftyThousand)->UseRealTime();
BENCHMARK_CAPTURE(Scan2, one_thread, false)->UseRealTime();
BENCHMARK_CAPTURE(Scan2, reading_ahead, true)->UseRealTime();
BENCHMARK_CAPTURE(Scan3, one_thread, false)->UseRealTime();
BENCHMARK_CAPTURE(Scan3, reading_ahead, true)->UseRealTime();
BENCHMARK_CAPTURE(Stats, one_thread, false)->UseRealTime();
BENCHMARK_CAPTURE(Stats, reading_ahead, true)->UseRealTime();

}  // namespace
