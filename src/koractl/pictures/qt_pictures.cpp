#include "koractl/pictures/picture_app.h"
#include "koractl/pictures/pictures.h"
#include "platform/qt/picture.h"
#include "platform/qt/qt_printer.h"

namespace kora {
namespace {

class QtPictures : public Pictures {
 public:
  std::string Make(PictureKind kind, const PictureSize& size, const DrawPicture& draw) override {
    return MakePicture(kind, size, draw);
  }
  std::unique_ptr<Printer> PdfPrinter(
      std::function<void(const std::string& bytes)> write) override {
    auto printer = std::make_unique<QtPrinter>(std::move(write));
    printer->SetDevice(QtPrinter::kPdfPrinter);
    return printer;
  }

 private:
  PictureApp app_;
};

}  // namespace
}  // namespace kora

// The caller deletes what it is given.
extern "C" __attribute__((visibility("default"))) kora::Pictures* KoraPictures1() {
  return new kora::QtPictures;
}
