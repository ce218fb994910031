#include "chartwindow/tools/trendline.h"

#include "base/numbers.h"
#include "base/runtime_error.h"

namespace kora {

TrendlineTool::TrendlineTool(ToolView& view)
    : view_(view), band_(DrawStyle::kSolid, view.colours[kTrendlines]) {
  band_.Touched = view.Touched;
}

bool TrendlineTool::Inside(const ToolPoint& at) const {
  if (at.pane == Pane::kPrice) {
    const Composition& c = view_.chart;
    return at.x >= c.ChartLeft && at.x <= c.ChartRight && at.y >= c.ChartTop &&
           at.y <= c.ChartBottom;
  }
  const PanelFrame& f = view_.panelFrame;
  return at.x >= f.Left && at.x <= f.Right && at.y >= f.Top && at.y <= f.Bottom;
}

// Outside the frame the band stands still.
ToolState TrendlineTool::Move(const ToolPoint& at) {
  if (AwaitFirstPoint_ || at.pane != first_.pane || !Inside(at)) return ToolState::kOn;
  second_ = at;
  band_.Draw({{&surface(), first_.x, first_.y, at.x, at.y}});
  return ToolState::kOn;
}

ToolState TrendlineTool::Release(const ToolPoint& at, MouseButton button) {
  if (button != MouseButton::kLeft || !view_.Readable()) return ToolState::kOn;
  if (AwaitFirstPoint_) {
    first_ = at;
    AwaitFirstPoint_ = false;
    return ToolState::kOn;
  }
  Move(at);
  if (!band_.Drawn()) return ToolState::kOn;  // nothing was drawn yet
  band_.Erase();
  AwaitFirstPoint_ = true;
  if (first_.pane == Pane::kPrice) {
    FinishTrendline(view_, {first_.x, first_.y, second_.x, second_.y});
    return ToolState::kDone;
  }
  const Colour colour = view_.colours[kTrendlines];
  view_.panel.Line(first_.x, first_.y, second_.x, second_.y, colour);
  view_.Touched(view_.panel, first_.x, first_.y, second_.x, second_.y);
  const double below = view_.price.ScaleHeight();
  view_.Keep({'M', first_.x, first_.y + below, second_.x, second_.y + below, colour});
  return ToolState::kOn;
}

void TrendlineTool::Recomposed() {
  band_.Erase();
  AwaitFirstPoint_ = true;
}

void FinishTrendline(ToolView& view, const ScreenLine& line) {
  const Colour colour = view.colours[kTrendlines];
  view.price.Line(line.x1, line.y1, line.x2, line.y2, colour);
  view.Touched(view.price, line.x1, line.y1, line.x2, line.y2);
  view.Keep({'H', line.x1, line.y1, line.x2, line.y2, colour});
  if (!view.SwingOn) OfferTrendline(view, line);
}

void OfferTrendline(ToolView& view, const ScreenLine& line) {
  constexpr std::string_view kTitle = "Trendline";
  if (view.request.ChartStyle == Style::kPointFigure) return;
  if (view.dialogs.Ask("Save Trendline", kTitle, Buttons::kYesNo) != Answer::kYes) return;
  const auto rec = TrendlineOf(view.chart, view.request, line);
  if (!rec) return;
  try {
    const std::int32_t n = SaveTrendline(
        view.files,
        TrendlinePath(view.settings.paths.ChartMiscPath, view.request.Name.Code.trimmed()), *rec);
    if (view.rows.size() < size_t(n)) view.rows.resize(size_t(n));
    const bool turned = line.x2 < line.x1;
    TrendlineRow& row = view.rows[size_t(n) - 1];
    row = {CInt(line.x1), CInt(line.y1), CInt(line.x2), CInt(line.y2)};
    if (turned) row = {row.x2, row.y2, row.x1, row.y1};
  } catch (const RunTimeError& e) {
    view.dialogs.Message(e.what(), kTitle);
  }
}

}  // namespace kora
