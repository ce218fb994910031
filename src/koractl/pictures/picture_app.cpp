#include "koractl/pictures/picture_app.h"

#include <QGuiApplication>
#include <cstdio>
#include <cstdlib>

namespace kora {

namespace {

// Standard error is for what the program says; the toolkit's advice is none of it.
void OnlyFailures(QtMsgType type, const QMessageLogContext&, const QString& text) {
  if (type == QtCriticalMsg || type == QtFatalMsg)
    std::fprintf(stderr, "[KORA] %s\n", qUtf8Printable(text));
  // The toolkit would end with a core file; nothing is half done while a picture is drawn.
  if (type == QtFatalMsg) std::_Exit(1);
}

}  // namespace

PictureApp::PictureApp() {
  qInstallMessageHandler(OnlyFailures);
  // A picture needs no display, and must not fail for one that is not there.
  if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
  static int argc = 1;
  static char name[] = "koractl";
  static char* argv[] = {name, nullptr};
  app_ = std::make_unique<QGuiApplication>(argc, argv);
}

PictureApp::~PictureApp() = default;

}  // namespace kora
