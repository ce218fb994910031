#include "koractl/mouse_tools.h"

#include <cmath>
#include <cstdio>

#include "base/numbers.h"
#include "base/text.h"
#include "chart/chart_script.h"
#include "chartwindow/tools/fibonacci.h"

namespace kora {

std::vector<double> ReadPlaces(const std::string& option, const std::string& text, size_t count) {
  std::vector<double> places;
  for (const std::string_view field : Split(text, ',')) {
    const auto value = ParseFloat(Trim(field));
    if (!value || std::abs(*value) > 32000) break;
    places.push_back(double(*value));
  }
  if (places.size() != count || Split(text, ',').size() != count)
    throw UsageError(option + ": \"" + text + "\" is not " + std::to_string(count) +
                     " numbers with commas between");
  return places;
}

ToolStage::ToolStage(Run& run, const Composition& chart, const ChartRequest& request,
                     Surface& price, ChartScript& script)
    : view_{.chart = chart,
            .request = request,
            .arrangement = arrangement_,
            .boxes = chart.Boxes,
            .panelFrame = panelFrame_,
            .chartFromFile = fromFile_,
            .price = price,
            .panel = price,
            .colours = run.session.colours,
            .settings = run.session.settings,
            .dialogs = run.dialogs,
            .files = run.session.files,
            .panels = panels_,
            .title = title_,
            .SwingOn = swing_,
            .rows = rows_,
            .Touched = [](const Surface&, double, double, double, double) {},
            .Keep =
                [&script](const DrawnMark& mark) {
                  script.Open(true);
                  script.buffer() += LineOf(mark);
                  script.Close();
                }} {}

void AddLevels(Run& run, const Composition& chart, const ChartRequest& request, Surface& price,
               ChartScript& script, const std::vector<double>& places) {
  ToolStage stage(run, chart, request, price, script);
  FibonacciTool tool(stage.view());
  tool.Press({places[0], places[1]}, MouseButton::kLeft);
  tool.Press({places[2], places[3]}, MouseButton::kLeft);
  for (const std::string& text : stage.panels())
    if (!text.empty()) std::fprintf(stderr, "%s\n", text.c_str());
}

}  // namespace kora
