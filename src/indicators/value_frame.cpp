#include "indicators/value_frame.h"

#include <cmath>

#include "base/runtime_error.h"
#include "indicators/osc_series.h"

namespace kora {

ValueFrame::ValueFrame(const OscPanel& panel, double highest, double lowest) : lowest_(lowest) {
  const double margin = ((panel.PanelBottom - panel.PanelTop) / 100.0) * 10.0;
  base_ = panel.PanelBottom - margin;
  const std::int16_t height = CInt(base_ - (panel.PanelTop + margin));
  const double range = lowest < 0 ? highest - lowest : highest;
  if (!std::isfinite(range)) throw RunTimeError(kOverflow);
  scale_ = ScaleOf(range, height);
}

std::int16_t ValueFrame::Y(double value) const { return CInt(base_ - (value - lowest_) / scale_); }

void ValueFrame::DrawLines(OscPanel& panel, std::string_view highest,
                           std::string_view lowest) const {
  panel.Guide(panel.PanelTop + 20, highest);
  panel.Guide(panel.PanelBottom - 20, lowest);
  panel.Guide(Y(0), "0");
}

}  // namespace kora
