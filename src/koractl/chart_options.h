#pragma once

#include <CLI/CLI.hpp>
#include <string>
#include <vector>

#include "chart/chart_request.h"
#include "chart/chart_script.h"
#include "chart/composer.h"
#include "koractl/run.h"
#include "platform/picture.h"

// The chart that a command asks for, with the options that `chart` and `print` share.

namespace kora {

struct ChartOptions {
  std::string style = "B";
  std::string period = "A";
  std::int16_t spacing = 2;
  std::string size = "638x452";
  std::string osc;
  bool slow = false;
  int panel = 144;
  std::string volume = "on";
  std::int16_t bands = 0;
  bool ma1 = false, ma2 = false, exp = false;
  bool mma = false;
  bool marks = false, outside = false;
  bool manual = false;
  std::string finish;
  std::string box;
  std::string swing;
  std::string fib;
  std::vector<std::string> switches;
};

// The options, less the code.
void AddChartOptions(CLI::App& command, ChartOptions& options);

// Size of the chart, at `scale` pixels to the unit, with the panel where the oscillator has one.
// Usage errors for options that make no sense.
PictureSize CheckChartOptions(const ChartOptions& options, int scale = 1);

// The command-line words of the program that `--switch` gave.
std::string Words(const ChartOptions& options);

// Opens the home for charts; to be called once. Whatever ends the operation was told.
void OpenCharts(Run& run, const ChartOptions& options);
// Finds the security and gives what to draw its chart with. Whatever ends the operation was told.
ChartRequest FindChart(Run& run, const ChartOptions& options, const std::string& code);

// What a chart of these options is composed with.
ChartServices ServicesOf(Run& run, const ChartOptions& options, ChartScript& script, Surface& price,
                         Surface* panel);

// Composes the price chart with the marks that are kept with the security and, below it or over
// it, the oscillator. `composed` takes what stands on the chart.
void Compose(Run& run, const ChartOptions& options, const ChartRequest& request,
             ChartScript& script, Surface& price, Surface* panel, Composition* composed = nullptr);
// The same without a picture: the script alone.
void ComposeScript(Run& run, const ChartOptions& options, const ChartRequest& request,
                   const PictureSize& size, ChartScript& script);

}  // namespace kora
