#pragma once

#include <QTimer>
#include <QWidget>
#include <functional>
#include <memory>

#include "shell/forms/Main.h"
#include "shell/session.h"

namespace kora {

// The splash form, which starts the program: settings first, then by its one-shot timer the
// main window and the look for waiting downloads.
class Logo : public QWidget {
 public:
  Logo(Session& session, std::string commandLine);

  // False when the program ends: another instance runs (`previous`), or the user gave up.
  bool Start(bool previous);

  // Called with the main window before it shows.
  std::function<void(Main&)> Prepare;
  // Called once the main window stands and the splash is gone.
  std::function<void(Main&)> Opened;

  Main* main() const { return main_.get(); }

 private:
  void ScaleToScreen();
  void Timer();

  Session& session_;
  std::string commandLine_;
  QTimer* timer2_;
  std::unique_ptr<Main> main_;
};

}  // namespace kora
