// The data store beside the bare calls of the host, on the same files in the same run.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "base/text.h"
#include "bench/bench_home.h"
#include "store/chart_bars.h"
#include "store/name_file.h"

using namespace kora;

namespace {

constexpr int kPriceFiles = 5000;
constexpr int kNames = 3000;
constexpr int kRecords = 5000;

std::string Code(int n) { return "C" + std::to_string(10000 + n); }

// A home of 5,000 small price files, one of 5,000 records and a name file.
struct Market {
  test::TempHome home;
  const Files& files = home.files();
  std::string hostFolder;

  Market() {
    files.MakeFolder("c:\\korawin\\data");
    hostFolder = files.HostPath("c:\\korawin\\data");

    NameFile names(files, "c:\\korawin\\data\\Names.dat", OpenMode::kReplace);
    std::vector<NameRec> recs;
    for (int i = 0; i < kNames; ++i) recs.push_back(NewNameRec(Code(i)));
    names.WriteRun(1, recs);

    const PriceRec day = NewPriceRec("19990104");
    for (int i = 0; i < kPriceFiles; ++i)
      PriceFile(files, "c:\\korawin\\data\\" + Code(i) + ".WDT", OpenMode::kReplace).Append(day);

    std::vector<PriceRec> days = bench::TradingDays(1980, kRecords);
    int n = 0;
    for (PriceRec& rec : days) {
      ++n;
      rec.Close = 10 + float(n % 97) / 16;
      rec.Open = rec.Close - 0.25f;
      rec.High = rec.Close + 0.5f;
      rec.Low = rec.Close - 0.5f;
      rec.Volume = 1000 + n % 1013;
    }
    PriceFile(files, "c:\\korawin\\data\\BHP.WDT", OpenMode::kReplace).WriteRun(1, days);
    // A listing of a folder that just changed is not trusted; this one has been still for long.
    const timespec then[2] = {{1'000'000'000, 0}, {1'000'000'000, 0}};
    ::utimensat(AT_FDCWD, hostFolder.c_str(), then, 0);
  }
};

Market& TheMarket() {
  static Market market;
  return market;
}

void OpenFilesPlain(benchmark::State& state) {
  Market& market = TheMarket();
  std::vector<std::string> paths;
  for (int i = 0; i < kPriceFiles; ++i) paths.push_back(market.hostFolder + "/" + Code(i) + ".WDT");
  for (auto _ : state) {
    for (const std::string& path : paths) {
      const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
      if (fd < 0) state.SkipWithError("missing file");
      ::close(fd);
    }
  }
  state.SetItemsProcessed(state.iterations() * kPriceFiles);
}

void OpenFiles(benchmark::State& state, const std::string& folder, bool lower) {
  Market& market = TheMarket();
  std::vector<std::string> paths;
  for (int i = 0; i < kPriceFiles; ++i) {
    const std::string name = Code(i) + ".WDT";
    paths.push_back(folder + (lower ? LCase(name) : name));
  }
  for (auto _ : state)
    for (const std::string& path : paths)
      benchmark::DoNotOptimize(market.files.Open(path, OpenMode::kRead));
  state.SetItemsProcessed(state.iterations() * kPriceFiles);
}

// A whole file into memory with the bare calls of the host.
void ReadPlain(benchmark::State& state, const char* name, size_t size) {
  const std::string path = TheMarket().hostFolder + name;
  std::vector<char> bytes(size);
  for (auto _ : state) {
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (::pread(fd, bytes.data(), bytes.size(), 0) != ssize_t(bytes.size()))
      state.SkipWithError("short read");
    ::close(fd);
    benchmark::DoNotOptimize(bytes.data());
  }
}
void ReadNamesPlain(benchmark::State& state) {
  ReadPlain(state, "/Names.dat", kNames * sizeof(NameRec));
}
void ReadPricesPlain(benchmark::State& state) {
  ReadPlain(state, "/BHP.WDT", kRecords * sizeof(PriceRec));
}

void FindLastCode(benchmark::State& state) {
  Market& market = TheMarket();
  const std::string code = PadRight(Code(kNames - 1), 6);
  for (auto _ : state) {
    const NameFile names(market.files, "c:\\korawin\\data\\Names.dat");
    NameRec rec;
    if (FindCode(names, code, rec) != kNames) state.SkipWithError("not found");
  }
}

void LoadBars(benchmark::State& state, Period period) {
  Market& market = TheMarket();
  ChartBars bars;
  for (auto _ : state) {
    const PriceFile file(market.files, "c:\\korawin\\data\\BHP.WDT");
    bars.FirstDataRec = 1;
    bars.LastDataRec = kRecords;
    LoadChartBars(file, period, true, kShare, bars);
    benchmark::DoNotOptimize(bars.bars.data());
  }
  state.SetItemsProcessed(state.iterations() * kRecords);
}

BENCHMARK(OpenFilesPlain);
BENCHMARK_CAPTURE(OpenFiles, exact_name, "c:\\korawin\\data\\", false);
BENCHMARK_CAPTURE(OpenFiles, folder_in_other_case, "C:\\KORAWIN\\DATA\\", false);
BENCHMARK_CAPTURE(OpenFiles, name_in_other_case, "C:\\KORAWIN\\DATA\\", true);
BENCHMARK(ReadNamesPlain);
BENCHMARK(FindLastCode);
BENCHMARK(ReadPricesPlain);
BENCHMARK_CAPTURE(LoadBars, daily, Period::kDaily);
BENCHMARK_CAPTURE(LoadBars, weekly, Period::kWeekly);
BENCHMARK_CAPTURE(LoadBars, monthly, Period::kMonthly);

}  // namespace
