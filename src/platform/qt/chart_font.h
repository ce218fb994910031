#pragma once

#include <QFont>

#include "platform/surface.h"

namespace kora {

// False for a name that can't be a face's (over 200 bytes, control characters) and for a size
// outside 1 to 2,048 points.
bool CanBeFace(const SurfaceFont& font);

// A chart's font as Qt has it, in points. A face that the machine lacks is set in the standard
// one, and then `standard` is true: its texts measure by the standard metrics.
struct ChartFont {
  QFont font;
  bool standard = true;
};
ChartFont MakeChartFont(const SurfaceFont& font);

}  // namespace kora
