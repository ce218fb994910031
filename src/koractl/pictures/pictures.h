#pragma once

#include <functional>
#include <memory>
#include <string>

#include "platform/picture.h"
#include "platform/printer.h"

namespace kora {

// What draws pictures and pages. It stands in a module of its own, which brings the toolkit with
// it: that takes many times what a script does to load, and so only pictures load it.
//
// For the thread that loaded it.
class Pictures {
 public:
  virtual ~Pictures() = default;
  // As MakePicture.
  virtual std::string Make(PictureKind kind, const PictureSize& size, const DrawPicture& draw) = 0;
  // A printer that hands each document to `write`, as a PDF.
  virtual std::unique_ptr<Printer> PdfPrinter(
      std::function<void(const std::string& bytes)> write) = 0;
};

// The module's file, beside the program, and what it is entered by. The name changes with the
// class above, so that a module of another build is refused and not misread.
inline constexpr const char* kPicturesFile = "koractl_pictures.so";
inline constexpr const char* kPicturesEntry = "KoraPictures1";

// Loads the module, once a process. Error 53 where it is missing or can't be loaded: the text
// names it and says why.
std::unique_ptr<Pictures> LoadPictures();

}  // namespace kora
