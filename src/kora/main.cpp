#include <QApplication>
#include <QDir>
#include <QFileInfo>
#include <QThread>
#include <cstdio>
#include <exception>
#include <new>

#include "base/runtime_error.h"
#include "base/version.h"
#include "demo/demo_market.h"
#include "platform/qt/accessible_names.h"
#include "platform/qt/focus_mark.h"
#include "platform/qt/form_style.h"
#include "platform/qt/keyboard_back.h"
#include "platform/qt/qt_dialogs.h"
#include "platform/qt/single_instance.h"
#include "revision/revision.h"
#include "shell/forms/FirstStart.h"
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

namespace {

std::vector<std::string> Words(const QStringList& arguments) {
  std::vector<std::string> words;
  for (const QString& argument : arguments) words.push_back(argument.toStdString());
  return words;
}

// What is only printed needs no display. Options of the toolkit are still among the words, so that
// what can't be read here may yet be.
bool PrintOnly(int argc, char** argv) {
  std::string fault;
  const auto arguments =
      kora::ParseProgramArguments(std::vector<std::string>(argv + 1, argv + argc), fault);
  if (!arguments || !(arguments->help || arguments->version)) return false;
  const std::string text = arguments->help ? kora::ProgramHelp() : kora::VersionLine("kora") + "\n";
  std::fputs(text.c_str(), stdout);
  return true;
}

}  // namespace

int main(int argc, char** argv) {
  using namespace kora;
  if (argc > 0 && PrintOnly(argc, argv)) return 0;
  Application app(argc, argv);
  QApplication::setApplicationName("KORA Charting");
  QApplication::setDesktopFileName("org.koracharting.kora");
  QApplication::setQuitOnLastWindowClosed(false);  // the splash closes before the main window

  std::string fault;
  const auto arguments = ParseProgramArguments(Words(app.arguments().mid(1)), fault);
  if (!arguments) {
    std::fprintf(stderr, "kora: %s\n\n%s", fault.c_str(), ProgramHelp().c_str());
    return 2;
  }
  const std::string home = arguments->home.empty() ? DefaultHome() : arguments->home;
  // The working folder is where the shell left it only now.
  const QString chart =
      arguments->file.empty()
          ? QString()
          : QFileInfo(QString::fromStdString(arguments->file)).absoluteFilePath();
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
  if (!chart.isEmpty())
    logo.Opened = [&chart](Main& main) { main.OpenSavedChart(chart.toStdString()); };
  if (!instance.Previous() && NeedsFirstStart(session)) {
    FirstStart question(
        {.session = session, .makeDemo = [&] {
           return MakeDemo(session.files, session.ini, session.user, dialogs, DemoOptions());
         }});
    if (question.exec() != QDialog::Accepted) return 1;
  }
  if (!logo.Start(instance.Previous())) return 1;
  return app.exec();
}
