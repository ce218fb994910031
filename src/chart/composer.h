#pragma once

#include <functional>
#include <string>
#include <vector>

#include "chart/chart_request.h"
#include "chart/chart_script.h"
#include "chart/composition.h"
#include "looks/colours.h"
#include "platform/dialogs.h"
#include "platform/surface.h"
#include "settings/settings.h"

namespace kora {

struct ChartCanvas;

// The services and standing values that every chart is made with.
struct ChartServices {
  const Files& files;
  Dialogs& dialogs;
  const Paths& paths;
  const FontSettings& fonts;
  const ChartColours& colours;
  Surface& price;            // the price picture
  Surface* panel = nullptr;  // the oscillator picture below it; may be hidden
  ChartScript* script = nullptr;
  // Drawn over the finished price chart, in this order: bands, multiple averages, trendlines.
  std::vector<std::function<void(const ChartCanvas&)>> overlays = {};
  // The unit of a security's volumes, "'00", which those above the chart know; empty for none.
  std::function<std::string(const NameRec&)> VolumeUnitText = {};
  // Asks for the box value of a point-and-figure chart, proposing the computed one, where boxes
  // are not automatic; empty takes the computed one.
  std::function<float(float computed)> AskBoxValue = {};
};

// Turns one security and the chart options into a chart on `services.price` and, unless the
// request suppresses it, a script. Fills `chart`.
//
// Returns true when the chart stands. Every failure is told in a message box titled
// "Chart Display" (or as the failure has it), and what was drawn stays on the surface.
bool ComposeChart(const ChartServices& services, const ChartRequest& request, Composition& chart);

// The text of an industry class: IndClass.dat of the program folder, one "id,description" a
// line; "unknown" when there is none. `indClass` is formatted "000" first.
std::string IndustryClassText(const Files& files, const std::string& systemPath,
                              std::string_view indClass);

}  // namespace kora
