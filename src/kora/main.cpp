#include <QApplication>
#include <QDir>
#include <QThread>
#include <cstdio>
#include <exception>
#include <new>

#include "base/runtime_error.h"
#include "base/version.h"
#include "platform/qt/accessible_names.h"
#include "platform/qt/focus_mark.h"
#include "platform/qt/form_style.h"
#include "platform/qt/keyboard_back.h"
#include "platform/qt/qt_dialogs.h"
#include "platform/qt/single_instance.h"
#include "shell/forms/Logo.h"
#include "shell/program_arguments.h"

namespace {

// What no form caught is told, and the program goes on: an exception must not end it with what is
// open in its forms.
class Application : public QApplication {
 public:
  using QApplication::QApplication;
  kora::Dialogs* dialogs = nullptr;

  bool notify(QObject* receiver, QEvent* event) override {
    try {
      return QApplication::notify(receiver, event);
    } catch (const std::bad_alloc&) {
      Tell(kora::ErrorText(kora::kOutOfMemory));
    } catch (const std::exception& e) {
      Tell(e.what());
    }
    return true;
  }

 private:
  void Tell(const char* what) {
    if (!dialogs) return;
    dialogs->SetBusy(false);
    dialogs->Message(what, kora::kProgramTitle);
  }
};

}  // namespace

int main(int argc, char** argv) {
  using namespace kora;
  Application app(argc, argv);
  QApplication::setApplicationName("KORA Charting");
  QApplication::setQuitOnLastWindowClosed(false);  // the splash closes before the main window

  std::vector<std::string> words;
  for (const QString& argument : app.arguments().mid(1)) words.push_back(argument.toStdString());
  std::string fault;
  const auto arguments = ParseProgramArguments(words, fault);
  if (!arguments) {
    std::fprintf(stderr,
                 "kora: %s\nusage: kora [--home DIR] [--set SECTION.KEY=VALUE]... "
                 "[RM] [A] [N] [XT] [XS]\n",
                 fault.c_str());
    return 2;
  }
  const std::string home = arguments->home.empty() ? DefaultHome() : arguments->home;
  QDir().mkpath(QString::fromStdString(home));

  const KeyboardBack keyboardBack;
  const FocusMark focusMark;
  QtDialogs dialogs;
  app.dialogs = &dialogs;
  InstallAccessibleNames();
  InstallFormStyle();
  const SingleInstance instance(home, "KORA32");
  Session session(home, dialogs);
  session.files.lock().program = "kora";
  session.files.lock().idle = [] {
    QApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
    QThread::msleep(20);
  };
  for (const auto& o : arguments->overrides) session.ini.Override(o.section, o.key, o.value);
  Logo logo(session, arguments->words);
  if (!logo.Start(instance.Previous())) return 1;
  return app.exec();
}
