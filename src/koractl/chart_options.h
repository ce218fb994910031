#pragma once

#include <CLI/CLI.hpp>
#include <string>
#include <vector>

#include "chart/chart_request.h"
#include "chart/chart_script.h"
#include "koractl/run.h"
#include "platform/qt/picture.h"

// The chart that a command asks for, with the options that `chart` and `print` share.

namespace kora {

struct ChartOptions {
  std::string code;  // not an option: the command says what stands there
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
  std::vector<std::string> switches;
};

// The options, less the code.
void AddChartOptions(CLI::App& command, ChartOptions& options);

// Size of the chart, at `scale` pixels to the unit, with the panel where the oscillator has one.
// Usage errors for options that make no sense.
PictureSize CheckChartOptions(const ChartOptions& options, int scale = 1);

// The command-line words of the program that `--switch` gave.
std::string Words(const ChartOptions& options);

// Opens the home, finds the security and gives what to draw the chart with; to be called once.
// Whatever ends the operation was told.
ChartRequest OpenChart(Run& run, const ChartOptions& options);

// Composes the price chart and, below it or over it, the oscillator.
void Compose(Run& run, const ChartOptions& options, const ChartRequest& request,
             ChartScript& script, Surface& price, Surface* panel);
// The same without a picture: the script alone.
void ComposeScript(Run& run, const ChartOptions& options, const ChartRequest& request,
                   const PictureSize& size, ChartScript& script);

}  // namespace kora
