#include "kora/program/application.h"

#include <exception>
#include <new>

#include "base/runtime_error.h"
#include "base/version.h"
#include "platform/qt/accessible_names.h"
#include "platform/qt/form_style.h"

namespace kora {

Application::Application(int& argc, char** argv) : QApplication(argc, argv) {
  setApplicationName("KORA Charting");
  setDesktopFileName("org.koracharting.kora");
  setQuitOnLastWindowClosed(false);  // the splash closes before the main window
  InstallAccessibleNames();
  InstallFormStyle();
}

bool Application::notify(QObject* receiver, QEvent* event) {
  try {
    return QApplication::notify(receiver, event);
  } catch (const std::bad_alloc&) {
    Caught(ErrorText(kOutOfMemory));
  } catch (const std::exception& e) {
    Caught(e.what());
  }
  return true;
}

void Application::Caught(const char* what) {
  if (!dialogs) return;
  dialogs->SetBusy(false);
  dialogs->Message(what, kProgramTitle);
}

}  // namespace kora
