#pragma once

#include <functional>
#include <string>

#include "platform/surface.h"

namespace kora {

enum class PictureKind { kPng, kSvg, kPdf };

// The kind that a file's name ends in, in any case. Error 52 for another ending.
PictureKind PictureKindOf(std::string_view fileName);

struct PictureSize {
  double width = 638, height = 452;  // of the price picture, units
  double panel = 0;                  // height of the oscillator picture below it; 0 none
  double dpr = 1;                    // pixels to the unit, PNG alone
};

// The bytes of a picture: `draw` draws on the price surface and, when the size has one, on the
// panel below it (null otherwise). A PDF is one page of the picture's own size. Needs a
// QGuiApplication. Error 5 for a size outside 1 to 20,000 units.
std::string MakePicture(PictureKind kind, const PictureSize& size,
                        const std::function<void(Surface& price, Surface* panel)>& draw);

}  // namespace kora
