// A downloaded day taken in, beside the bare calls of the host on the same files.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <stdexcept>

#include "base/dates.h"
#include "base/numbers.h"
#include "platform/clock.h"
#include "store/price_rec.h"
#include "tests/support/temp_home.h"
#include "update/download_update.h"
#include "update/import_history.h"

using namespace kora;

namespace {

constexpr int kSecurities = 5000;
constexpr int kDays = 60;
constexpr int kRuns = 5;
const std::string kData = "c:\\korawin\\data\\";
const std::string kDown = "c:\\korawin\\download\\";

std::string Code(int n) { return "C" + std::to_string(10000 + n); }
// Every second calendar day, so that there are dates between them.
std::string Date(double day) { return FormatFileDate(DateOfDayNumber(CLng(10400 + 2 * day))); }

// Answers OK to the question about data on file, and says nothing.
struct Quiet : Dialogs {
  void Message(std::string_view text, std::string_view) override {
    throw std::runtime_error(std::string(text));
  }
  Answer Ask(std::string_view, std::string_view, Buttons) override { return Answer::kOk; }
  std::optional<std::string> Prompt(std::string_view, std::string_view, std::string_view) override {
    return std::nullopt;
  }
  std::unique_ptr<Progress> StartProgress(std::string_view) override {
    return std::make_unique<NoProgress>();
  }
  void SetBusy(bool) override {}
  void Yield() override {}
};

// A market of 5,000 shares with 60 days each, which a run can be repeated on.
class Market {
 public:
  Market() {
    files_.MakeFolder(kData);
    files_.MakeFolder(kDown);
    settings_.paths.SystemPath = "c:\\korawin\\";
    settings_.paths.CurrentDataPath = kData;
    settings_.download.DLPath = kDown;
    std::vector<NameRec> names;
    for (int i = 0; i < kSecurities; ++i) names.push_back(NewNameRec(Code(i)));
    NameFile(files_, NameFilePath(kData), OpenMode::kReplace).WriteRun(1, names);
    for (int d = 0; d < kDays; ++d) {
      days_.push_back(NewPriceRec(Date(d)));
      days_.back().Close = float(d);
    }
    Reset();
  }

  // Every price file as it was at first.
  void Reset() {
    for (int i = 0; i < kSecurities; ++i) {
      PriceFile file(files_, kData + Code(i) + ".WDT", OpenMode::kCreate);
      file.WriteRun(1, days_);
      file.Truncate(kDays);
    }
  }
  // Waits for the run: `lines` securities on one date.
  void PutDay(const std::string& date, int lines) {
    std::string text;
    for (int i = 0; i < lines; ++i)
      text += Code(i) + "," + date + ",1.25,1.5,1.125,1.375,12345,0\r\n";
    files_.WriteAll(kDown + "15SEP98.d", text);
  }
  void Update(std::int16_t service) {
    settings_.download.DataService = service;
    NoProgress display;
    CurrentName current;
    DownloadEntries entries{"15SEP98.d"};
    if (UpdateOneDay({files_, settings_, current, dialogs_, MachineClock(), display}, entries, 0) !=
        UpdateEnd::kUpdated)
      throw std::runtime_error("not updated");
  }
  std::string HostData() const { return files_.HostPath(kData); }

 private:
  test::TempHome home_;
  const Files& files_ = home_.files();
  Settings settings_;
  Quiet dialogs_;
  std::vector<PriceRec> days_;
};

Market& TheMarket() {
  static Market market;
  return market;
}

// One wait until all that was written is on the disk.
void FlushDisk(const std::string& folder) {
  const int fd = ::open(folder.c_str(), O_RDONLY | O_CLOEXEC);
  if (fd < 0 || ::syncfs(fd) != 0) throw std::runtime_error("not flushed");
  ::close(fd);
}

// The bare calls: open, read the last `back` records (the last one at least), write so many and
// `more`, close. `flushes` then waits for the disk as often as a day's update does: for its journal,
// for the files.
void UpdateFloor(benchmark::State& state, int back, int more, int flushes) {
  Market& market = TheMarket();
  std::vector<std::string> paths;
  for (int i = 0; i < kSecurities; ++i) paths.push_back(market.HostData() + "/" + Code(i) + ".WDT");
  std::vector<PriceRec> recs(size_t(back + more));
  const size_t reading = size_t(std::max(back, 1)) * sizeof(PriceRec);
  const size_t writing = recs.size() * sizeof(PriceRec);
  for (auto _ : state) {
    state.PauseTiming();
    market.Reset();
    state.ResumeTiming();
    for (const std::string& path : paths) {
      const int fd = ::open(path.c_str(), O_RDWR | O_CLOEXEC);
      const off_t end = ::lseek(fd, 0, SEEK_END);
      if (::pread(fd, recs.data(), reading, end - off_t(reading)) != ssize_t(reading) ||
          ::pwrite(fd, recs.data(), writing, end - back * off_t(sizeof(PriceRec))) !=
              ssize_t(writing))
        state.SkipWithError("no record");
      ::close(fd);
    }
    for (int i = 0; i < flushes; ++i) FlushDisk(market.HostData());
  }
  state.SetItemsProcessed(state.iterations() * kSecurities);
}

// `lines` of the day's file; the rest of the market has the no-trade pass of service 5.
void UpdateDay(benchmark::State& state, double day, int lines, std::int16_t service) {
  Market& market = TheMarket();
  for (auto _ : state) {
    state.PauseTiming();
    market.Reset();
    market.PutDay(Date(day), lines);
    state.ResumeTiming();
    market.Update(service);
  }
  state.SetItemsProcessed(state.iterations() * kSecurities);
}

// A market whose folder is emptied, so that `lines` securities are new.
void EmptyMarket(Market& market, int lines) {
  std::filesystem::remove_all(market.HostData());
  std::filesystem::create_directory(market.HostData());
  market.PutDay(Date(0), lines);
}

// Open the name file, append, close; make the price file, write, close. Then the same flushes.
void NewFloor(benchmark::State& state) {
  for (auto _ : state) {
    state.PauseTiming();
    {
      Market market;
      EmptyMarket(market, 1);
      state.ResumeTiming();
      const NameRec name = NewNameRec("");
      const PriceRec rec = NewPriceRec("");
      for (int i = 0; i < state.range(0); ++i) {
        int fd =
            ::open((market.HostData() + "/Names.dat").c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0666);
        if (::pwrite(fd, &name, sizeof(name), ::lseek(fd, 0, SEEK_END)) != ssize_t(sizeof(name)))
          state.SkipWithError("no name");
        ::close(fd);
        fd = ::open((market.HostData() + "/" + Code(i) + ".WDT").c_str(),
                    O_RDWR | O_CREAT | O_CLOEXEC, 0666);
        if (::pwrite(fd, &rec, sizeof(rec), 0) != ssize_t(sizeof(rec)))
          state.SkipWithError("no record");
        ::close(fd);
      }
      for (int i = 0; i < 2; ++i) FlushDisk(market.HostData());
      state.PauseTiming();
    }
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

// Names of the market that no price file stands for yet.
void UpdateNew(benchmark::State& state) {
  for (auto _ : state) {
    state.PauseTiming();
    {
      Market market;
      EmptyMarket(market, int(state.range(0)));
      state.ResumeTiming();
      market.Update(1);
      state.PauseTiming();
    }
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK_CAPTURE(UpdateFloor, append, 0, 1, 0)->Iterations(kRuns)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(UpdateFloor, append_flushed, 0, 1, 2)
    ->Iterations(kRuns)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(UpdateDay, append, kDays, kSecurities, 1)
    ->Iterations(kRuns)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(UpdateDay, no_trades, kDays, 1, 5)
    ->Iterations(kRuns)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(UpdateFloor, replace_flushed, 1, 0, 2)
    ->Iterations(kRuns)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(UpdateDay, replace, kDays - 1, kSecurities, 1)
    ->Iterations(kRuns)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(UpdateFloor, insert_10_back_flushed, 10, 1, 2)
    ->Iterations(kRuns)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(UpdateDay, insert_10_back, kDays - 10.5, kSecurities, 1)
    ->Iterations(kRuns)
    ->Unit(benchmark::kMillisecond);
// ---- Import

constexpr int kRows = 250;

// Text files of one new security each, and the bytes of the price files that they come to.
struct Sources {
  explicit Sources(int count) {
    std::string text = "Date,Open,High,Low,Close,Volume\n";
    for (int d = 0; d < kRows; ++d) {
      text += Date(d) + ",1.25,1.5,1.125,1.375,12345\n";
      PriceRec rec = NewPriceRec(Date(d));
      rec.Open = 1.25f;
      rec.High = 1.5f;
      rec.Low = 1.125f;
      rec.Close = 1.375f;
      rec.Volume = 12345;
      days.push_back(rec);
    }
    for (int i = 0; i < count; ++i) {
      home.Put("in/" + Code(i) + ".csv", text);
      names.push_back(home.path() + "/in/" + Code(i) + ".csv");
    }
    home.files().MakeFolder(kData);
    folder = home.files().HostPath(kData);
  }
  test::TempHome home;
  std::vector<std::string> names;
  std::vector<PriceRec> days;
  std::string folder;
};

// The same new files by bare calls: each written beside its place, all flushed at once, renamed; the
// names of the folder flushed.
void ImportFloor(benchmark::State& state) {
  for (auto _ : state) {
    state.PauseTiming();
    {
      Sources sources(int(state.range(0)));
      const size_t size = sources.days.size() * sizeof(PriceRec);
      state.ResumeTiming();
      for (int i = 0; i < state.range(0); ++i) {
        const std::string path = sources.folder + "/" + Code(i) + ".WDT.new";
        const int fd = ::open(path.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
        if (::pwrite(fd, sources.days.data(), size, 0) != ssize_t(size))
          state.SkipWithError("no prices");
        ::close(fd);
      }
      FlushDisk(sources.folder);
      for (int i = 0; i < state.range(0); ++i) {
        const std::string path = sources.folder + "/" + Code(i) + ".WDT";
        if (::rename((path + ".new").c_str(), path.c_str()) != 0) state.SkipWithError("no name");
      }
      FlushDisk(sources.folder);
      state.PauseTiming();
    }
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

void ImportNew(benchmark::State& state) {
  for (auto _ : state) {
    state.PauseTiming();
    {
      Sources sources(int(state.range(0)));
      Quiet dialogs;
      ImportCounts counts;
      state.ResumeTiming();
      if (!ImportHistory(sources.home.files(), kData, sources.names, {}, dialogs, counts))
        state.SkipWithError("not imported");
      state.PauseTiming();
    }
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK(ImportFloor)
    ->Arg(500)
    ->Arg(1000)
    ->Arg(2000)
    ->Iterations(2)
    ->Unit(benchmark::kMillisecond);
BENCHMARK(ImportNew)->Arg(500)->Arg(1000)->Arg(2000)->Iterations(2)->Unit(benchmark::kMillisecond);

BENCHMARK(NewFloor)->Arg(1250)->Arg(2500)->Arg(5000)->Iterations(2)->Unit(benchmark::kMillisecond);
BENCHMARK(UpdateNew)->Arg(1250)->Arg(2500)->Arg(5000)->Iterations(2)->Unit(benchmark::kMillisecond);

}  // namespace
