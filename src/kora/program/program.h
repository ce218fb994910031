#pragma once

#include "base/io.h"
#include "kora/program/application.h"
#include "platform/clock.h"
#include "platform/processes.h"
#include "platform/qt/focus_mark.h"
#include "platform/qt/keyboard_back.h"
#include "platform/qt/qt_dialogs.h"
#include "platform/qt/single_instance.h"
#include "shell/forms/Logo.h"
#include "shell/program_arguments.h"
#include "shell/session.h"

namespace kora {

// What a run of the program stands on.
struct Machine {
  Io& io = MachineIo();
  const Clock& clock = MachineClock();
  Processes& processes = MachineProcesses();
};

// One run of the program with windows, all of it but the loop of events. One after another may
// live in one process.
class Program {
 public:
  Program(Application& app, const ProgramArguments& arguments, const Machine& machine = {});
  ~Program();
  Program(const Program&) = delete;
  Program& operator=(const Program&) = delete;

  // From the question of a first start to the splash. False where it ends at once.
  bool Start();

  Session& session() { return session_; }
  Main* main() const { return logo_.main(); }  // null before it stands

 private:
  Application& app_;
  const std::string home_;
  const KeyboardBack keyboardBack_;
  const FocusMark focusMark_;
  QtDialogs dialogs_;
  const SingleInstance instance_;
  Session session_;
  Logo logo_;
};

}  // namespace kora
