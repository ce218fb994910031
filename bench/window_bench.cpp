// Living in the chart window: paging through the demo market, moving the cross hair, playing a
// saved chart beside composing it. The floor of a page is the composition alone (ComposeAndDraw).
#include <benchmark/benchmark.h>

#include <QApplication>
#include <QMouseEvent>

#include "chart/script_player.h"
#include "chartwindow/forms/Chts.h"
#include "chartwindow/tools/saved_marks.h"
#include "chartwindow/tools/zoom_chart.h"
#include "demo/demo_market.h"
#include "indicators/osc_settings.h"
#include "platform/headless/console_dialogs.h"
#include "tests/support/temp_home.h"

namespace {

using namespace kora;

// A home with the demo market.
struct Market {
  test::TempHome home;
  Files& files = home.files();
  SettingsFile ini{files, "C:\\WINDOWS\\Kora.ini"};
  SettingsFile user{files, "C:\\WINDOWS\\KoraUser.ini"};
  ConsoleDialogs dialogs;
  Settings settings;
  ChartColours colours{};
  CurrentName current;
  ChartState state;

  Market() {
    MakeDemo(files, ini, user, dialogs, {});
    settings.paths.WindowsPath = "C:\\WINDOWS\\";
    ReadSettings(ini, files, dialogs, settings);
    ReadOscPeriods(ini, settings.osc);
    LoadUserColours(files, settings.paths.SystemPath, colours);
  }
  ChartWindow Window(QtRasterSurface& price, QtRasterSurface& panel) {
    panel.SetVisible(false);
    return ChartWindow({.files = files,
                        .dialogs = dialogs,
                        .settings = settings,
                        .ini = ini,
                        .user = user,
                        .colours = colours,
                        .current = current,
                        .state = state,
                        .price = price,
                        .panel = panel});
  }
};

void PageForward(benchmark::State& bench) {
  Market market;
  QtRasterSurface price(double(bench.range(0)), double(bench.range(1)));
  QtRasterSurface panel(double(bench.range(0)), 144);
  ChartWindow window = market.Window(price, panel);
  window.Load();
  market.state.ChartDirection = 1;
  for (auto _ : bench)
    if (!window.StepChart()) {
      bench.SkipWithError("not drawn");
      break;
    }
  bench.counters["charts_per_s"] =
      benchmark::Counter(double(bench.iterations()), benchmark::Counter::kIsRate);
}

// A pointer that goes to and fro.
template <typename Move>
void GoAbout(benchmark::State& bench, Move move) {
  double x = 50;
  for (auto _ : bench) {
    move(x);
    x = x > 600 ? 50 : x + 1;
  }
}

// Rules and pixels of one move with a tool that `start` turns on.
void MoveInWindow(benchmark::State& bench, void (*start)(ChartWindow&)) {
  Market market;
  QtRasterSurface price(double(bench.range(0)), double(bench.range(1)));
  QtRasterSurface panel(double(bench.range(0)), 144);
  ChartWindow window = market.Window(price, panel);
  window.Load();
  window.NextChart();
  start(window);
  GoAbout(bench, [&](double x) { window.MouseMove({x, 200}); });
}

// The same through the form: the event, the status bar, and the painting of what changed.
void MoveInForm(benchmark::State& bench, void (*start)(ChartWindow&)) {
  Market market;
  Chts form({.files = market.files,
             .dialogs = market.dialogs,
             .settings = market.settings,
             .ini = market.ini,
             .user = market.user,
             .colours = market.colours,
             .current = market.current,
             .state = market.state});
  form.resize(int(bench.range(0)), int(bench.range(1)));
  form.show();
  QCoreApplication::processEvents();
  form.Start();
  start(form.window());
  auto* picture = form.findChild<QWidget*>("Picture1");
  QCoreApplication::processEvents();
  GoAbout(bench, [&](double x) {
    QMouseEvent move(QEvent::MouseMove, {x, 200}, picture->mapToGlobal(QPointF(x, 200)),
                     Qt::NoButton, Qt::NoButton, Qt::NoModifier);
    QCoreApplication::sendEvent(picture, &move);
    QCoreApplication::processEvents();
  });
}

// The cross hair: both lines taken away, both drawn, the read-out.
void StartCross(ChartWindow& window) { window.ToggleGrid(); }
// The band of a line from a first click.
void StartBand(ChartWindow& window) {
  window.ToggleTrendline();
  window.MouseRelease({60, 300}, MouseButton::kLeft);
}
void CrossMove(benchmark::State& bench) { MoveInWindow(bench, StartCross); }
void CrossMoveForm(benchmark::State& bench) { MoveInForm(bench, StartCross); }
void BandMove(benchmark::State& bench) { MoveInWindow(bench, StartBand); }
void BandMoveForm(benchmark::State& bench) { MoveInForm(bench, StartBand); }

// Gives the security on show `count` saved lines.
void SaveLines(Market& market, const ChartWindow& window, std::int64_t count) {
  const std::string& misc = market.settings.paths.ChartMiscPath;
  const std::string path = TrendlinePath(misc, window.Request.Name.Code.trimmed());
  market.files.MakeFolder(misc);
  RemoveTrendlines(market.files, path);
  for (int i = 0; i < count; ++i) {
    const Composition& chart = window.Chart;
    const double x = chart.ChartLeft + (i % 100 + 1) * double(chart.BarSpacing);
    const auto line = TrendlineOf(chart, window.Request, {x, 150.0 + i, x + 40, 160.0 + i});
    if (line) SaveTrendline(market.files, path, *line);
  }
}

// A composition with 200 saved lines on the chart, and without: the floor.
void ComposeLines(benchmark::State& bench) {
  Market market;
  QtRasterSurface price(1280, 800), panel(1280, 144);
  ChartWindow window = market.Window(price, panel);
  window.Load();
  window.NextChart();
  SaveLines(market, window, bench.range(0));
  for (auto _ : bench) benchmark::DoNotOptimize(window.Recompose());
}

// Reading 200 saved lines and finding their places on that chart, without drawing them.
void PlaceLines(benchmark::State& bench) {
  Market market;
  QtRasterSurface price(1280, 800), panel(1280, 144);
  ChartWindow window = market.Window(price, panel);
  window.Load();
  window.NextChart();
  SaveLines(market, window, 200);
  int placed = 0;
  for (auto _ : bench) {
    placed = 0;
    const SavedMarks marks = ReadSavedMarks(market.files, market.settings.paths.ChartMiscPath,
                                            window.Request.Name.Code.trimmed());
    for (const TrendlineRec& rec : marks.lines)
      placed += PlaceTrendline(window.Chart, window.Request, rec).has_value();
  }
  bench.counters["placed"] = placed;
}

// Forty bars of a candle chart over 1280 x 800, beside the composition of that chart.
void ZoomOf40(benchmark::State& bench, bool zoom) {
  Market market;
  QtRasterSurface price(1280, 800), panel(1280, 144);
  ChartWindow window = market.Window(price, panel);
  window.Load();
  market.state.ChartStyle = Style::kCandlestick;
  window.NextChart();
  const Composition& chart = window.Chart;
  const double left = chart.ChartLeft + 100.0 * chart.BarSpacing;
  const ZoomBox box{left, 100, left + 40.0 * chart.BarSpacing, 600};
  QtRasterSurface picture(1280, 800);
  for (auto _ : bench) {
    if (zoom)
      ZoomChart(picture, chart, window.Request, market.colours, market.settings.fonts, box);
    else
      benchmark::DoNotOptimize(window.Recompose());
  }
}
void Zoom40(benchmark::State& bench) { ZoomOf40(bench, true); }
void ComposeCandles(benchmark::State& bench) { ZoomOf40(bench, false); }

void SavedChart(benchmark::State& bench, bool play) {
  Market market;
  QtRasterSurface price(638, 452), panel(638, 144);
  ChartWindow window = market.Window(price, panel);
  window.Load();
  window.NextChart();
  const std::string script =
      market.files.ReadAll(market.settings.paths.CurrentDataPath + "TCht.Tmp");
  for (auto _ : bench) {
    if (play) {
      price.Cls();
      benchmark::DoNotOptimize(
          PlayChartScript(script, price, market.settings.fonts, market.colours));
    } else {
      benchmark::DoNotOptimize(window.Recompose());
    }
  }
  bench.counters["script_bytes"] = double(script.size());
}
void PlaySaved(benchmark::State& bench) { SavedChart(bench, true); }
void ComposeSaved(benchmark::State& bench) { SavedChart(bench, false); }

void Sizes(benchmark::internal::Benchmark* b) {
  b->ArgNames({"w", "h"})->Args({638, 452})->Args({1600, 900})->Unit(benchmark::kMicrosecond);
}

BENCHMARK(PageForward)->Name("WindowPageForward")->Apply(Sizes);
BENCHMARK(CrossMove)->Name("WindowCrossMove")->Apply(Sizes);
BENCHMARK(CrossMoveForm)->Name("WindowCrossMoveInTheForm")->Apply(Sizes);
BENCHMARK(BandMove)->Name("WindowBandMove")->Apply(Sizes);
BENCHMARK(BandMoveForm)->Name("WindowBandMoveInTheForm")->Apply(Sizes);
BENCHMARK(ComposeLines)
    ->Name("WindowComposeWithSavedLines")
    ->ArgName("lines")
    ->Arg(0)
    ->Arg(200)
    ->Unit(benchmark::kMicrosecond);
BENCHMARK(PlaceLines)->Name("WindowPlaceSavedLines")->Unit(benchmark::kMicrosecond);
BENCHMARK(ComposeCandles)->Name("WindowComposeCandles1280x800")->Unit(benchmark::kMicrosecond);
BENCHMARK(Zoom40)->Name("WindowZoomOf40Bars")->Unit(benchmark::kMicrosecond);
BENCHMARK(ComposeSaved)->Name("WindowComposeChart")->Unit(benchmark::kMicrosecond);
BENCHMARK(PlaySaved)->Name("WindowPlaySavedChart")->Unit(benchmark::kMicrosecond);

}  // namespace
