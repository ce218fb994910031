#include "platform/picture.h"

#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {

PictureKind PictureKindOf(std::string_view fileName) {
  if (EndsNoCase(fileName, ".png")) return PictureKind::kPng;
  if (EndsNoCase(fileName, ".svg")) return PictureKind::kSvg;
  if (EndsNoCase(fileName, ".pdf")) return PictureKind::kPdf;
  throw RunTimeError(kBadFileName);
}

}  // namespace kora
