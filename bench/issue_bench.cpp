// An adjustment of a price file beside reading and writing its bytes by plain calls, with the same
// flushes: of the new file, and of the folder once it is in place.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include "adjust/adjustment.h"
#include "bench/bench_home.h"

using namespace kora;

namespace {

constexpr int kRecords = 10000;
const std::string kPrices = "c:\\data\\ORE.WDT", kNotes = "c:\\misc\\ORE.Txt";

struct Security {
  test::TempHome home;
  std::string host;

  Security() {
    std::vector<PriceRec> days = bench::TradingDays(1980, kRecords);
    for (size_t i = 0; i < days.size(); ++i) {
      const float close = 10 + float(i % 97) / 16;
      days[i].Open = days[i].High = days[i].Low = days[i].Close = close;
    }
    home.Put("drive_c/data/ORE.WDT",
             {reinterpret_cast<const char*>(days.data()), days.size() * sizeof(PriceRec)});
    host = home.path() + "/drive_c/data/ORE.WDT";
  }
};

void AdjustPlain(benchmark::State& state) {
  Security security;
  const std::string fresh = security.host + ".new";
  const std::string folder = security.home.path() + "/drive_c/data";
  std::string bytes(size_t(kRecords) * sizeof(PriceRec), '\0');
  for (auto _ : state) {
    const int in = ::open(security.host.c_str(), O_RDONLY);
    if (::read(in, bytes.data(), bytes.size()) != ssize_t(bytes.size()))
      state.SkipWithError("short read");
    ::close(in);
    const int out = ::open(fresh.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0666);
    if (::write(out, bytes.data(), bytes.size()) != ssize_t(bytes.size()))
      state.SkipWithError("short write");
    ::fsync(out);
    ::close(out);
    ::rename(fresh.c_str(), security.host.c_str());
    const int dir = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY);
    ::fsync(dir);
    ::close(dir);
  }
}

// A call and its removal in turn, so that prices stay what they are.
void AdjustFile(benchmark::State& state) {
  Security security;
  const Files& files = security.home.files();
  bool remove = false;
  for (auto _ : state) {
    if (remove) {
      RemoveAdjustment(files, kPrices);
    } else {
      PriceEdit edit(files, kPrices);
      ApplyAdjustment({files, kPrices, kNotes, 0}, edit, kRecords, ShareSplit(2, 1));
    }
    remove = !remove;
  }
}

BENCHMARK(AdjustPlain)->Unit(benchmark::kMicrosecond);
BENCHMARK(AdjustFile)->Unit(benchmark::kMicrosecond);

}  // namespace
