#pragma once

#include <string>
#include <string_view>

#include "chart/chart_pen.h"
#include "chart/chart_request.h"
#include "chart/composition.h"
#include "looks/colours.h"
#include "settings/settings.h"

namespace kora {

// What every drawing step of a composition works with.
struct ChartCanvas {
  ChartPen& pen;
  const ChartRequest& request;
  const FontSettings& fonts;
  const ChartColours& colours;
  Composition& chart;

  Colour colour(int entry) const { return colours[static_cast<size_t>(entry)]; }

  // Of the prices.
  Colour LineColour() const {
    return request.Legible && request.Place == ChartPlace::kOver ? CodeColour()
                                                                 : colour(kChartLines);
  }
  // Of the codes of two charts in one frame.
  Colour CodeColour() const {
    return colour(kAverage3 + (request.Place == ChartPlace::kOver ? 1 : 0));
  }

  SurfaceFont Font1(double size) const { return {fonts.Font1Name, size, fonts.Font1Bold, false}; }
  SurfaceFont Font1Bold(double size) const { return {fonts.Font1Name, size, true, false}; }
  SurfaceFont Font2() const { return {fonts.Font2Name, fonts.Font2Points(), false, false}; }

  double TextWidth(const SurfaceFont& font, std::string_view text) const {
    pen.surface().SetFont(font);
    return pen.surface().TextWidth(text);
  }

  // Text of size 8.25 in Font 1, the plain text of a chart.
  void SmallText(double x, double y, std::string_view text, Colour textColour) const {
    pen.Text('T', Font1(kSmallText), {kSmallText, x, y, text, textColour});
  }

  static constexpr double kSmallText = 8.25;
};

}  // namespace kora
