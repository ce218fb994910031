#pragma once

#include "chart/chart_request.h"
#include "fuzz/small_home.h"
#include "settings/settings.h"

namespace kora::test {

// Composes the chart of the request, its oscillator too, on a surface on which everything has a
// place. A chart that fails is told. `plays`: what was drawn can be played from its script.
void DrawChart(SmallHome& home, const Settings& settings, const ChartRequest& request, bool slow,
               bool plays);

}  // namespace kora::test
