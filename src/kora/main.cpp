#include <QApplication>
#include <QDir>
#include <cstdio>

#include "platform/qt/keyboard_back.h"
#include "platform/qt/qt_dialogs.h"
#include "platform/qt/single_instance.h"
#include "shell/forms/Logo.h"
#include "shell/program_arguments.h"

int main(int argc, char** argv) {
  using namespace kora;
  QApplication app(argc, argv);
  QApplication::setApplicationName("KORA Charting");
  QApplication::setQuitOnLastWindowClosed(false);  // the splash closes before the main window

  std::vector<std::string> words;
  for (const QString& argument : app.arguments().mid(1)) words.push_back(argument.toStdString());
  std::string fault;
  const auto arguments = ParseProgramArguments(words, fault);
  if (!arguments) {
    std::fprintf(stderr, "kora: %s\nusage: kora [--home DIR] [--set SECTION.KEY=VALUE]... "
                 "[RM] [A] [N] [XT] [XS]\n", fault.c_str());
    return 2;
  }
  const std::string home = arguments->home.empty() ? DefaultHome() : arguments->home;
  QDir().mkpath(QString::fromStdString(home));

  const KeyboardBack keyboardBack;
  QtDialogs dialogs;
  const SingleInstance instance(home, "KORA32");
  Session session(home, dialogs);
  for (const auto& o : arguments->overrides) session.ini.Override(o.section, o.key, o.value);
  Logo logo(session, arguments->words);
  if (!logo.Start(instance.Previous())) return 0;
  return app.exec();
}
