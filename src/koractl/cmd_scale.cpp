#include <memory>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "chart/chart_scale.h"
#include "koractl/run.h"
#include "koractl/table.h"

namespace kora {
namespace {

struct ScaleOptions {
  std::string high, low, base, top;
};

float Price(const char* option, const std::string& text) {
  const auto value = ParseFloat(text);
  if (!value) throw UsageError(std::string(option) + ": \"" + text + "\" is no price");
  return *value;
}

int Scale(const CommandLine& line, const ScaleOptions& options) {
  Run(line).Open();
  const float high = Price("--high", options.high);
  const float low = Price("--low", options.low);
  ChartScale scale;
  if (options.base.empty()) {
    SetChartScaleAutomatic(high, low, scale);
  } else {
    const float base = Price("--base", options.base);
    const float top = Price("--top", options.top);
    if (base == 0 || top == 0) throw UsageError("Do not use 0(zero) as chart base or ceiling");
    SetChartScaleManual(base, top, scale);
  }
  Table table("ScaleLow ScaleHigh GridStep GridCount");
  table.Number(scale.ScaleLow).Number(scale.ScaleHigh).Number(scale.GridStep);
  table.Number(std::int32_t(scale.GridCount)).EndRow();
  table.Print();
  return kDone;
}

}  // namespace

void AddScale(CLI::App& app, CommandLine& line) {
  const auto options = std::make_shared<ScaleOptions>();
  CLI::App* command = app.add_subcommand("scale", "Show the chart range of prices");
  command->add_option("--high", options->high, "Highest price")->required()->type_name("H");
  command->add_option("--low", options->low, "Lowest price")->required()->type_name("L");
  auto* base = command->add_option("--base", options->base, "Manual scale bottom")->type_name("B");
  auto* top = command->add_option("--top", options->top, "Manual scale top")->type_name("T");
  base->needs(top);
  top->needs(base);
  command->callback(
      [&line, options] { line.run = [&line, options] { return Scale(line, *options); }; });
}

}  // namespace kora
