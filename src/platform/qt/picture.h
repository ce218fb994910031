#pragma once

#include <string>

#include "platform/picture.h"

namespace kora {

// The bytes of a picture that `draw` draws. A PDF is one page of the picture's own size. Needs a
// QGuiApplication. Error 5 for a size outside 1 to 20,000 units, 7 where memory gives out.
std::string MakePicture(PictureKind kind, const PictureSize& size, const DrawPicture& draw);

}  // namespace kora
