// Passes over a whole store, beside the bare calls of the host on the same files.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <stdexcept>

#include "base/dates.h"
#include "bench/bench_home.h"
#include "maintenance/backup.h"
#include "maintenance/data_checks.h"
#include "maintenance/remove_date.h"
#include "platform/progress.h"
#include "store/name_file.h"
#include "tests/support/scripted_dialogs.h"

using namespace kora;

namespace {

constexpr int kFiles = 3000;
constexpr int kDays = 2500;
constexpr int kRuns = 3, kReadings = 20;
const std::string kData = "c:\\korawin\\data\\";

std::string Code(int n) { return "C" + std::to_string(10000 + n); }

// 3,000 price files of 2,500 days without gaps.
struct Store {
  test::TempHome home;
  Files& files = home.files();
  Settings settings;
  test::ScriptedDialogs dialogs;
  NoProgress progress;
  std::vector<PriceRec> days = bench::TradingDays(1990, kDays);
  std::string folder;

  Store() {
    files.MakeFolder(kData);
    folder = files.HostPath(kData);
    std::vector<NameRec> names;
    for (int i = 0; i < kFiles; ++i) names.push_back(NewNameRec(Code(i)));
    NameFile(files, NameFilePath(kData), OpenMode::kReplace).WriteRun(1, names);
    float close = 1;
    for (PriceRec& rec : days) {
      close += 0.01f;
      rec.Open = rec.High = rec.Low = rec.Close = close;
      rec.Volume = 1000;
    }
    Lay();
  }
  void Lay() {
    for (int i = 0; i < kFiles; ++i)
      PriceFile(files, Path(i), OpenMode::kReplace).WriteRun(1, days);
    Flush();
  }
  std::string Path(int i) const { return kData + Code(i) + ".WDT"; }
  std::string HostPath(int i) const { return folder + "/" + Code(i) + ".WDT"; }
  void Flush() const {
    const int fd = ::open(folder.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0 || ::syncfs(fd) != 0) throw std::runtime_error("not flushed");
    ::close(fd);
  }
};

Store& TheStore() {
  static Store store;
  return store;
}

// Each run has folders of its own, and no file goes before the end: ext4 passes over the inodes of
// files that were deleted in the last minutes one by one, which costs more than what is measured.
std::string NextFolder(const std::string& name) {
  static int n = 0;
  return name + std::to_string(++n);
}

// The days laid anew, with second names for the files that the run will replace.
void LayToReplace(Store& store) {
  store.Lay();
  const std::string folder = store.home.path() + "/drive_c/" + NextFolder("kept");
  std::filesystem::create_directory(folder);
  for (int i = 0; i < kFiles; ++i)
    std::filesystem::create_hard_link(store.HostPath(i), folder + "/" + Code(i));
  store.Flush();
}

// Read the last record of each; read and write anew beside it those that hold the date, flush them in
// the groups of the removal, rename.
void RemoveDateFloor(benchmark::State& state) {
  Store& store = TheStore();
  constexpr int kTogether = 64;
  const size_t size = kDays * sizeof(PriceRec);
  std::vector<PriceRec> records(kDays);
  for (auto _ : state) {
    state.PauseTiming();
    LayToReplace(store);
    state.ResumeTiming();
    for (int first = 0; first < kFiles; first += kTogether) {
      const int end = std::min(first + kTogether, kFiles);
      for (int i = first; i < end; ++i) {
        PriceRec last;
        int fd = ::open(store.HostPath(i).c_str(), O_RDONLY | O_CLOEXEC);
        if (::pread(fd, &last, sizeof(last), off_t(size - sizeof(last))) != ssize_t(sizeof(last)) ||
            last.RecDate.raw() != store.days.back().RecDate.raw() ||
            ::pread(fd, records.data(), size, 0) != ssize_t(size))
          state.SkipWithError("not read");
        ::close(fd);
        fd = ::open((store.HostPath(i) + ".new").c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC,
                    0666);
        if (::pwrite(fd, records.data(), size - sizeof(last), 0) != ssize_t(size - sizeof(last)))
          state.SkipWithError("not written");
        ::close(fd);
      }
      store.Flush();
      for (int i = first; i < end; ++i)
        if (::rename((store.HostPath(i) + ".new").c_str(), store.HostPath(i).c_str()) != 0)
          state.SkipWithError("not renamed");
    }
    store.Flush();
  }
  state.SetItemsProcessed(state.iterations() * kFiles);
}

void RemoveDateAll(benchmark::State& state) {
  Store& store = TheStore();
  const auto date = ParseFileDate(store.days.back().RecDate.raw());
  for (auto _ : state) {
    state.PauseTiming();
    LayToReplace(store);
    state.ResumeTiming();
    RemoveDateBox focus;
    if (RemoveDate(store.files, store.settings, kData, FormatUserDate(*date), false, store.progress,
                   store.dialogs, focus)
            .files != kFiles)
      state.SkipWithError("not removed");
  }
  store.Lay();
  state.SetItemsProcessed(state.iterations() * kFiles);
}

void CheckDataFloor(benchmark::State& state) {
  Store& store = TheStore();
  const size_t size = kDays * sizeof(PriceRec);
  std::vector<PriceRec> records(kDays);
  for (auto _ : state)
    for (int i = 0; i < kFiles; ++i) {
      const int fd = ::open(store.HostPath(i).c_str(), O_RDONLY | O_CLOEXEC);
      if (::pread(fd, records.data(), size, 0) != ssize_t(size)) state.SkipWithError("not read");
      ::close(fd);
    }
  state.SetItemsProcessed(state.iterations() * kFiles);
}

void CheckDataAll(benchmark::State& state) {
  Store& store = TheStore();
  DataCheckPlan plan;
  plan.types[4] = true;
  for (auto _ : state)
    if (CheckDataFiles(store.files, kData, plan, store.progress, store.dialogs).checked != kFiles)
      state.SkipWithError("not checked");
  state.SetItemsProcessed(state.iterations() * kFiles);
}

// `cp -r`, and until its copy is on the disk.
void BackupFloor(benchmark::State& state) {
  Store& store = TheStore();
  store.Flush();
  for (auto _ : state) {
    const std::string to = store.home.path() + "/drive_c/korawin/" + NextFolder("backup");
    if (std::system(("cp -r '" + store.folder + "' '" + to + "'").c_str()) != 0)
      state.SkipWithError("not copied");
    store.Flush();
  }
  state.SetItemsProcessed(state.iterations() * kFiles);
}

void BackupAll(benchmark::State& state) {
  Store& store = TheStore();
  store.Flush();
  for (auto _ : state)
    if (!BackupAllFiles(store.files, kData, "c:\\korawin\\" + NextFolder("backup") + "\\",
                        store.progress, store.dialogs)
             .done)
      state.SkipWithError("not copied");
  state.SetItemsProcessed(state.iterations() * kFiles);
}

BENCHMARK(CheckDataFloor)->Iterations(kReadings)->Unit(benchmark::kMillisecond);
BENCHMARK(CheckDataAll)->Iterations(kReadings)->Unit(benchmark::kMillisecond);
BENCHMARK(BackupFloor)->Iterations(kRuns)->Unit(benchmark::kMillisecond);
BENCHMARK(BackupAll)->Iterations(kRuns)->Unit(benchmark::kMillisecond);
BENCHMARK(RemoveDateFloor)->Iterations(kRuns)->Unit(benchmark::kMillisecond);
BENCHMARK(RemoveDateAll)->Iterations(kRuns)->Unit(benchmark::kMillisecond);

}  // namespace
