// The adjustment list filled and carried out, beside the bare calls of the host on the same files.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include <filesystem>
#include <stdexcept>

#include "adjust/bulletins.h"
#include "adjust/make_adjustments.h"
#include "bench/bench_home.h"
#include "store/name_file.h"

using namespace kora;

namespace {

constexpr int kSecurities = 3000;
constexpr int kRows = 1000;
constexpr int kRecords = 500;
constexpr int kLines = 10000;
const std::string kData = "c:\\korawin\\data\\";

std::string Code(int n) { return "C" + std::to_string(10000 + n); }

// 3,000 shares of 500 days each, all at 5.00.
class Market {
 public:
  Market() {
    settings_.paths.SystemPath = "c:\\korawin\\";
    settings_.paths.CurrentDataPath = kData;
    settings_.paths.ChartMiscPath = "c:\\korawin\\chtmisc\\";
    settings_.download.DataService = 1;
    settings_.download.ServiceIn = "c:\\in\\";
    settings_.download.ServiceOut = "c:\\out\\";
    for (const char* folder : {"c:\\korawin\\data", "c:\\korawin\\chtmisc", "c:\\in", "c:\\out"})
      files_.MakeFolder(folder);
    std::vector<NameRec> names;
    for (int i = 0; i < kSecurities; ++i) names.push_back(NewNameRec(Code(i)));
    NameFile(files_, NameFilePath(kData), OpenMode::kReplace).WriteRun(1, names);
    std::vector<PriceRec> days = bench::TradingDays(1997, kRecords);
    for (PriceRec& day : days) day.Open = day.High = day.Low = day.Close = 5;
    for (int i = 0; i < kSecurities; ++i)
      PriceFile(files_, kData + Code(i) + ".WDT", OpenMode::kReplace).WriteRun(1, days);
  }
  // A bonus issue of every third security.
  void Make() {
    AdjustRows rows;
    for (int i = 0; i < kRows; ++i)
      rows.push_back(ParseAdjustLine("BI," + Code(3 * i) + ",15SEP98,,Y,15SEP98,1,1000"));
    NoProgress progress;
    const AdjustResult result = MakeAdjustments({files_, settings_, 0, progress}, rows, kData);
    if (!result.failures.empty() || !rows.empty()) throw std::runtime_error("not made");
  }
  void PutBulletin() {
    std::string text;
    for (int i = 0; i < kLines; ++i)
      text += "NL," + Code(i % 9000) + ",ASX.STK,,N,GOLD MINES OF AUSTRALIA LIMITED NO " +
              std::to_string(i) + ",011\r\n";
    files_.WriteAll("c:\\in\\15SEP98.Btn", text);
    for (const char* file : {"c:\\out\\15SEP98.Btx", "c:\\korawin\\data\\Adjust.Lst"})
      if (files_.CheckFile(file)) files_.Remove(file);
  }
  void Merge() {
    NoProgress progress;
    if (CheckBulletins(files_, settings_, kData, "15SEP98", progress) != kLines)
      throw std::runtime_error("not merged");
  }
  std::string Bulletin() const { return files_.ReadAll("c:\\in\\15SEP98.Btn"); }
  std::string HostPath(const std::string& path) const { return files_.HostPath(path); }

 private:
  test::TempHome home_;
  const Files& files_ = home_.files();
  Settings settings_;
};

Market& TheMarket() {
  static Market market;
  return market;
}

// Reads the file and writes it anew: beside it, flushed, put in its place.
void Rewrite(const std::string& path) {
  std::string bytes(size_t(kRecords) * sizeof(PriceRec), '\0');
  int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
  bool good = ::read(fd, bytes.data(), bytes.size()) == ssize_t(bytes.size());
  ::close(fd);
  const std::string beside = path + "~";
  fd = ::open(beside.c_str(), O_RDWR | O_CREAT | O_TRUNC | O_CLOEXEC, 0666);
  good &= ::write(fd, bytes.data(), bytes.size()) == ssize_t(bytes.size()) && ::fsync(fd) == 0;
  ::close(fd);
  if (!good || ::rename(beside.c_str(), path.c_str()) != 0) throw std::runtime_error("no file");
}

void AdjustRowsFloor(benchmark::State& state) {
  Market& market = TheMarket();
  std::vector<std::string> paths;
  for (int i = 0; i < kRows; ++i) paths.push_back(market.HostPath(kData + Code(3 * i) + ".WDT"));
  for (auto _ : state)
    for (const std::string& path : paths) Rewrite(path);
  state.SetItemsProcessed(state.iterations() * kRows);
}

void AdjustRowsMade(benchmark::State& state) {
  Market& market = TheMarket();
  for (auto _ : state) market.Make();
  state.SetItemsProcessed(state.iterations() * kRows);
}

void BulletinFloor(benchmark::State& state) {
  Market& market = TheMarket();
  market.PutBulletin();
  for (auto _ : state) benchmark::DoNotOptimize(market.Bulletin());
  state.SetItemsProcessed(state.iterations() * kLines);
}

// The lines alone, without the files that they come from and go to.
void BulletinLines(benchmark::State& state) {
  Market& market = TheMarket();
  market.PutBulletin();
  const std::string text = market.Bulletin();
  const BulletinRules rules{.baseName = "15SEP98"};
  for (auto _ : state) {
    LineReader reader(text);
    std::string_view line;
    std::string list;
    while (reader.Next(line))
      if (const auto merged = MergeBulletinLine(line, rules)) list += *merged + "\r\n";
    benchmark::DoNotOptimize(list);
  }
  state.SetItemsProcessed(state.iterations() * kLines);
}

void BulletinMerged(benchmark::State& state) {
  Market& market = TheMarket();
  for (auto _ : state) {
    state.PauseTiming();
    market.PutBulletin();
    state.ResumeTiming();
    market.Merge();
  }
  state.SetItemsProcessed(state.iterations() * kLines);
}

BENCHMARK(AdjustRowsFloor)->Iterations(3)->Unit(benchmark::kMillisecond);
BENCHMARK(AdjustRowsMade)->Iterations(3)->Unit(benchmark::kMillisecond);
BENCHMARK(BulletinFloor)->Unit(benchmark::kMicrosecond);
BENCHMARK(BulletinLines)->Unit(benchmark::kMicrosecond);
BENCHMARK(BulletinMerged)->Iterations(5)->Unit(benchmark::kMicrosecond);

}  // namespace
