#include "shell/session.h"

#include <cstdlib>

#include "base/runtime_error.h"

namespace kora {
namespace {

constexpr std::string_view kWindowsPath = "C:\\WINDOWS\\";

}  // namespace

Session::Session(std::string home, Dialogs& dialogsIn, Io& io, const Clock& clockIn,
                 Processes& processesIn)
    : files(std::move(home), io),
      ini(files, std::string(kWindowsPath) + "Kora.ini"),
      user(files, std::string(kWindowsPath) + "KoraUser.ini"),
      dialogs(dialogsIn),
      clock(clockIn),
      processes(processesIn) {
  settings.paths.WindowsPath = kWindowsPath;
}

std::string Session::UserSetting(std::string_view key) const {
  std::string value = user.GetSetting(kUserSection, key);
  return value == kUnknown ? std::string() : value;
}

void Session::SaveUserSetting(std::string_view key, std::string_view value) {
  user.PutSetting(kUserSection, key, value);
}

std::string DefaultHome() {
  const auto variable = [](const char* name) {
    const char* value = std::getenv(name);
    return std::string(value ? value : "");
  };
  if (const std::string home = variable("KORA_HOME"); !home.empty()) return home;
#ifdef _WIN32
  return variable("LOCALAPPDATA") + "\\kora";
#else
  if (const std::string data = variable("XDG_DATA_HOME"); !data.empty()) return data + "/kora";
  return variable("HOME") + "/.local/share/kora";
#endif
}

bool ReadAllSettings(Session& session, std::string_view commandLine, bool askPrinter) {
  Settings& settings = session.settings;
  settings.words = ParseCommandWords(commandLine);
  settings.paths.WindowsPath = kWindowsPath;
  if (!ReadPaths(session.ini, session.files, session.dialogs, settings)) return false;
  for (const std::string* folder :
       {&settings.paths.ChartMiscPath, &settings.paths.ChartSavePath}) {
    try {
      if (!session.files.IsFolder(*folder)) session.files.MakeFolder(*folder);
    } catch (const RunTimeError&) {
      // A program folder that can't be written still shows charts.
    }
  }
  LoadUserColours(session.files, settings.paths.SystemPath, session.colours);
  session.printer = ReadPrinterColours(session.files, settings.paths.SystemPath);
  if (!session.printer.asked && askPrinter)
    AskPrinterColours(session.files, settings.paths.SystemPath, session.dialogs, session.printer);
  return true;
}

}  // namespace kora
