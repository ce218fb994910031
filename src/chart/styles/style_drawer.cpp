#include "chart/styles/style_drawer.h"

namespace kora {

const ChartStyle& StyleOf(const ChartRequest& request) {
  static constexpr ChartStyle kBars{.Draw = DrawBars};
  static constexpr ChartStyle kCandles{.Draw = DrawCandles};
  static constexpr ChartStyle kLine{.lineScale = true, .Draw = DrawLine};
  static constexpr ChartStyle kPointFigure{.readsWholeFile = true,
                                           .hasVolumes = false,
                                           .ownScale = true,
                                           .takesOverlays = false,
                                           .Draw = DrawPointFigure};
  static constexpr ChartStyle kSwing{.takesOverlays = false, .Draw = DrawSwing};
  if (request.ChartStyle == Style::kPointFigure) return kPointFigure;
  if (request.ChartStyle == Style::kLine || request.Name.RecType < kShare) return kLine;
  if (ShowsSwing(request)) return kSwing;
  return request.ChartStyle == Style::kCandlestick ? kCandles : kBars;
}

}  // namespace kora
