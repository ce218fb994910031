// The data store beside the bare calls of the host, on the same files in the same run.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <stdexcept>

#include "base/dates.h"
#include "base/text.h"
#include "store/chart_bars.h"
#include "store/name_file.h"

using namespace kora;

namespace {

constexpr int kPriceFiles = 5000;
constexpr int kNames = 3000;
constexpr int kRecords = 5000;

std::string Code(int n) { return "C" + std::to_string(10000 + n); }

// A home of 5,000 small price files, one of 5,000 records and a name file; gone at the end.
struct Market {
  std::string home;
  std::unique_ptr<Files> files;
  std::string hostFolder;

  Market() {
    home = (std::filesystem::temp_directory_path() / "kora-bench-XXXXXX").string();
    if (!::mkdtemp(home.data())) throw std::runtime_error("no temporary folder");
    files = std::make_unique<Files>(home);
    files->MakeFolder("c:\\korawin\\data");
    hostFolder = files->HostPath("c:\\korawin\\data");

    NameFile names(*files, "c:\\korawin\\data\\Names.dat", OpenMode::kReplace);
    std::vector<NameRec> recs;
    for (int i = 0; i < kNames; ++i) recs.push_back(NewNameRec(Code(i)));
    names.WriteRun(1, recs);

    const PriceRec day = NewPriceRec("19990104");
    for (int i = 0; i < kPriceFiles; ++i)
      PriceFile(*files, "c:\\korawin\\data\\" + Code(i) + ".WDT", OpenMode::kReplace).Append(day);

    std::vector<PriceRec> days;
    for (std::int32_t n = DayNumber({1980, 1, 1}); int(days.size()) < kRecords; ++n) {
      const CalendarDate date = DateOfDayNumber(n);
      if (Weekday(date) == 1 || Weekday(date) == 7) continue;
      PriceRec rec = NewPriceRec(FormatFileDate(date));
      rec.Close = 10 + float(n % 97) / 16;
      rec.Open = rec.Close - 0.25f;
      rec.High = rec.Close + 0.5f;
      rec.Low = rec.Close - 0.5f;
      rec.Volume = 1000 + n % 1013;
      days.push_back(rec);
    }
    PriceFile(*files, "c:\\korawin\\data\\BHP.WDT", OpenMode::kReplace).WriteRun(1, days);
    // A listing of a folder that just changed is not trusted; this one has been still for long.
    const timespec then[2] = {{1'000'000'000, 0}, {1'000'000'000, 0}};
    ::utimensat(AT_FDCWD, hostFolder.c_str(), then, 0);
  }
  ~Market() {
    std::error_code ignored;
    std::filesystem::remove_all(home, ignored);
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
      benchmark::DoNotOptimize(market.files->Open(path, OpenMode::kRead));
  state.SetItemsProcessed(state.iterations() * kPriceFiles);
}

void ReadNamesPlain(benchmark::State& state) {
  const std::string path = TheMarket().hostFolder + "/Names.dat";
  std::vector<char> bytes(kNames * sizeof(NameRec));
  for (auto _ : state) {
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (::pread(fd, bytes.data(), bytes.size(), 0) != ssize_t(bytes.size()))
      state.SkipWithError("short read");
    ::close(fd);
    benchmark::DoNotOptimize(bytes.data());
  }
}

void FindLastCode(benchmark::State& state) {
  Market& market = TheMarket();
  const std::string code = PadRight(Code(kNames - 1), 6);
  for (auto _ : state) {
    const NameFile names(*market.files, "c:\\korawin\\data\\Names.dat");
    NameRec rec;
    if (FindCode(names, code, rec) != kNames) state.SkipWithError("not found");
  }
}

void ReadPricesPlain(benchmark::State& state) {
  const std::string path = TheMarket().hostFolder + "/BHP.WDT";
  std::vector<char> bytes(kRecords * sizeof(PriceRec));
  for (auto _ : state) {
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (::pread(fd, bytes.data(), bytes.size(), 0) != ssize_t(bytes.size()))
      state.SkipWithError("short read");
    ::close(fd);
    benchmark::DoNotOptimize(bytes.data());
  }
}

void LoadBars(benchmark::State& state, const char* period) {
  Market& market = TheMarket();
  ChartBars bars;
  for (auto _ : state) {
    const PriceFile file(*market.files, "c:\\korawin\\data\\BHP.WDT");
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
BENCHMARK_CAPTURE(LoadBars, daily, "A");
BENCHMARK_CAPTURE(LoadBars, weekly, "W");
BENCHMARK_CAPTURE(LoadBars, monthly, "M");

}  // namespace
