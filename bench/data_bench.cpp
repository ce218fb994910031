// A price file in its grid, from the choice of the security to the first paint. The floor of a row is
// the one before it: the file read into memory.
#include <benchmark/benchmark.h>

#include <QApplication>
#include <QTableView>

#include "bench/bench_home.h"
#include "maintenance/forms/DataForm.h"
#include "tests/support/scripted_dialogs.h"

namespace {

using namespace kora;

const std::string kPath = "c:\\korawin\\data\\BENCH.WDT";

void ReadRecords(benchmark::State& bench) {
  bench::Home home(int(bench.range(0)));
  for (auto _ : bench) benchmark::DoNotOptimize(PriceFile(home.files(), kPath).ReadAll());
}

struct PaintSeen : QObject {
  bool seen = false;
  bool eventFilter(QObject*, QEvent* event) override {
    seen = seen || event->type() == QEvent::Paint;
    return false;
  }
};

void FirstPaint(benchmark::State& bench) {
  bench::Home home(int(bench.range(0)));
  test::ScriptedDialogs dialogs;
  Settings settings;
  SettingsFile user(home.files(), "C:\\WINDOWS\\KoraUser.ini");
  for (auto _ : bench) {
    DataForm form({.files = home.files(), .settings = settings, .user = user, .dialogs = dialogs},
                  {.code = "BENCH", .name = "Bench", .path = kPath}, nullptr);
    if (!form.Fill()) {
      bench.SkipWithError("not shown");
      break;
    }
    PaintSeen paint;
    form.findChild<QTableView*>("SS1")->viewport()->installEventFilter(&paint);
    form.show();
    while (!paint.seen) QCoreApplication::processEvents();
  }
}

BENCHMARK(ReadRecords)
    ->Name("DataFileRead")
    ->ArgName("records")
    ->Arg(5000)
    ->Arg(1'000'000)
    ->Unit(benchmark::kMillisecond);
BENCHMARK(FirstPaint)
    ->Name("DataFileFirstPaint")
    ->ArgName("records")
    ->Arg(5000)
    ->Arg(1'000'000)
    ->Unit(benchmark::kMillisecond);

}  // namespace
