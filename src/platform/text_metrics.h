#pragma once

#include <string_view>

#include "platform/surface.h"

namespace kora {

// Widths of the plain sans serif that every chart surface falls back on (the metrics that
// Helvetica, Arial and Liberation Sans share), so that a chart composed without a window has
// its texts at the very places where the window puts them.

// True when `font` is set in those metrics: no name, or one of the faces that share them.
bool HasStandardMetrics(const SurfaceFont& font);

// Width of UTF-8 text in chart units (96 to the inch), unrounded.
double StandardTextWidth(std::string_view text, const SurfaceFont& font);
// Height of a line, whole chart units.
double StandardTextHeight(const SurfaceFont& font);
// Distance from the top of a line to its base line, chart units.
double StandardAscent(const SurfaceFont& font);

}  // namespace kora
