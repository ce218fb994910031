#pragma once

#include <functional>
#include <string_view>

#include "platform/surface.h"

// What a picture of a chart is, whoever draws it.

namespace kora {

enum class PictureKind { kPng, kSvg, kPdf };

// The kind that a file's name ends in, in any case. Error 52 for another ending.
PictureKind PictureKindOf(std::string_view fileName);

struct PictureSize {
  double width = 638, height = 452;  // of the price picture, units
  double panel = 0;                  // height of the oscillator picture below it; 0 none
  double dpr = 1;                    // pixels to the unit, PNG alone
};

// Draws on the price surface and, when the size has one, on the panel below it (null otherwise).
using DrawPicture = std::function<void(Surface& price, Surface* panel)>;

}  // namespace kora
