#include "kora/program/program.h"

#include <QDir>
#include <QFileInfo>
#include <QThread>

#include "demo/demo_market.h"
#include "shell/forms/FirstStart.h"

namespace kora {
namespace {

std::string MadeHome(const std::string& named) {
  std::string home = named.empty() ? DefaultHome() : named;
  QDir().mkpath(QString::fromStdString(home));
  return home;
}

}  // namespace

Program::Program(Application& app, const ProgramArguments& arguments, const Machine& machine)
    : app_(app),
      home_(MadeHome(arguments.home)),
      instance_(home_, "KORA32"),
      session_(home_, dialogs_, machine.io, machine.clock, machine.processes),
      logo_(session_, arguments.words) {
  app_.dialogs = &dialogs_;
  session_.files.lock().program = "kora";
  session_.files.lock().idle = [] {
    QApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
    QThread::msleep(20);
  };
  for (const auto& o : arguments.overrides) session_.ini.Override(o.section, o.key, o.value);
  if (arguments.file.empty()) return;
  // The working folder is where the shell left it only now.
  logo_.Opened =
      [chart = QFileInfo(QString::fromStdString(arguments.file)).absoluteFilePath().toStdString()](
          Main& main) { main.OpenSavedChart(chart); };
}

Program::~Program() { app_.dialogs = nullptr; }

bool Program::Start() {
  if (!instance_.Previous() && NeedsFirstStart(session_)) {
    FirstStart question({.session = session_, .makeDemo = [this] {
                           return MakeDemo(session_.files, session_.ini, session_.user, dialogs_,
                                           DemoOptions());
                         }});
    if (question.exec() != QDialog::Accepted) return false;
  }
  return logo_.Start(instance_.Previous());
}

}  // namespace kora
