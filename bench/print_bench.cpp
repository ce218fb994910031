// Printing a chart with a panel to PDF. The floor of a row is the row before it in the same
// run: playing the script onto a page out of sight, then painting that page as a picture of 96
// dots to the inch, then as a PDF.
#include <benchmark/benchmark.h>

#include <QImage>
#include <QPainter>

#include "bench/bench_home.h"
#include "chart/chart_printing.h"
#include "chart/composer.h"
#include "indicators/oscillators.h"
#include "platform/headless/console_dialogs.h"
#include "platform/headless/headless_surface.h"
#include "platform/qt/qt_printer.h"

namespace {

using namespace kora;

struct Bench {
  bench::Home home{5000};
  ConsoleDialogs dialogs;
  Settings settings;
  ChartColours colours{};
  ChartScript script;
  ChartSize size;
  size_t pdfBytes = 0;
  QtPrinter printer{[this](const std::string& bytes) { pdfBytes = bytes.size(); }};
  PrintSetup setup;

  explicit Bench(const benchmark::State& state)
      : size{double(state.range(0)), double(state.range(1))} {
    constexpr double kPanel = 144;
    settings.paths.CurrentDataPath = "c:\\korawin\\data\\";
    settings.fonts.TitleSize = 9.75;
    settings.fonts.Font2Size = 8.25;
    for (const OscKey& key : OscKeys()) settings.osc[key] = {key.defaultDaily, key.defaultTwin};
    LoadColours(home.files(), "c:\\korawin\\", "Black", colours);
    HeadlessSurface price(size.width, size.height), panel(size.width, kPanel);
    ChartRequest request;
    request.Name = NewNameRec("BENCH");
    request.Name.Name.set("Bench Holdings");
    request.GridLines = true;
    request.OscName = "MACD";
    Composition chart;
    const ChartServices services{
        home.files(), dialogs, settings.paths, settings.fonts, colours, price, &panel, &script, {}};
    ComposeChart(services, request, chart);
    OscHost host{home.files(), dialogs, settings, colours, request, chart, price, panel, &script};
    host.OscCode = "MACD";
    ShowOscillatorPanel(host);
    size.height += kPanel;
    printer.SetDevice(QtPrinter::kPdfPrinter);
    setup.PrintColourMode = 1;
    SetPageDefaults(printer, size, setup);
  }
  bool Play(QtPaper& paper) {
    std::string refused;
    paper.StartDoc("bench");
    return PlayOnPaper(script.text(), paper, FrameOnPage(printer, setup, size), setup,
                       settings.fonts, colours, refused);
  }
};

void Play(benchmark::State& state) {
  Bench bench(state);
  QtPreview paper(bench.printer);
  for (auto _ : state)
    if (!bench.Play(paper)) state.SkipWithError("nothing was played");
  state.counters["script_bytes"] = double(bench.script.text().size());
}

void Paint(benchmark::State& state) {
  Bench bench(state);
  QtPreview paper(bench.printer);
  const Sheet sheet = paper.Page();
  for (auto _ : state) {
    if (!bench.Play(paper)) state.SkipWithError("nothing was played");
    QImage image(int(sheet.width / 15), int(sheet.height / 15), QImage::Format_RGB32);
    image.fill(Qt::white);
    QPainter painter(&image);
    painter.scale(1 / 15.0, 1 / 15.0);
    paper.PaintPage(painter, 0);
    painter.end();
    benchmark::DoNotOptimize(image.constBits());
  }
}

void Pdf(benchmark::State& state) {
  Bench bench(state);
  for (auto _ : state) {
    if (!bench.Play(bench.printer)) state.SkipWithError("nothing was played");
    bench.printer.EndDoc();
  }
  state.counters["pdf_bytes"] = double(bench.pdfBytes);
}

void Sizes(benchmark::internal::Benchmark* b) {
  b->ArgNames({"w", "h"})->Args({638, 452})->Args({1600, 900})->Unit(benchmark::kMicrosecond);
}

BENCHMARK(Play)->Name("PrintPlay")->Apply(Sizes);
BENCHMARK(Paint)->Name("PrintPicture")->Apply(Sizes);
BENCHMARK(Pdf)->Name("PrintPdf")->Apply(Sizes);

}  // namespace
