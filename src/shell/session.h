#pragma once

#include <string>
#include <string_view>

#include "base/files.h"
#include "chart/chart_state.h"
#include "looks/colours.h"
#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/processes.h"
#include "platform/settings_file.h"
#include "settings/settings.h"
#include "store/name_file.h"

namespace kora {

// One run of the program: the platform's services and the shared values of every subsystem.
// Two sessions can live in one process. A session is used from the thread that made it.
struct Session {
  // `home` is the host folder of the installation.
  Session(std::string home, Dialogs& dialogs, Io& io = MachineIo(),
          const Clock& clock = MachineClock(), Processes& processes = MachineProcesses());

  Files files;
  SettingsFile ini;   // Kora.ini
  SettingsFile user;  // KoraUser.ini, the per-user store: section "KORA Charting System"
  Dialogs& dialogs;
  const Clock& clock;
  Processes& processes;

  Settings settings;
  ChartColours colours{};
  PrinterColours printer;
  CurrentName current;
  ChartState charts;

  // Per-user values, empty when there is none.
  std::string UserSetting(std::string_view key) const;
  void SaveUserSetting(std::string_view key, std::string_view value);
};

// The folder that holds the installation when the command line names none: the variable
// KORA_HOME, otherwise `kora` under the user's data folder. Host path.
std::string DefaultHome();

// The settings file as it stands now, into the session's settings. False when the user gave up
// finding the program's drive.
bool ReadSettingsAnew(Session& session);

// Start-up, in this order: command-line words, WindowsPath, the folders (asking where they are
// missing), the folders chtmisc and chtsave, oscillator values, colours, printer colours, and
// the keys of Charts and the rest. False when the user gave up, which ends the program.
// `askPrinter`: put the two printer questions when they were not asked yet.
bool ReadAllSettings(Session& session, std::string_view commandLine, bool askPrinter);

}  // namespace kora
