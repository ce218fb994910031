#include "koractl/picture_app.h"

#include <QGuiApplication>

namespace kora {

PictureApp::PictureApp() {
  // A picture needs no display, and must not fail for one that is not there.
  if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
  static int argc = 1;
  static char name[] = "koractl";
  static char* argv[] = {name, nullptr};
  app_ = std::make_unique<QGuiApplication>(argc, argv);
}

PictureApp::~PictureApp() = default;

}  // namespace kora
