#include "shell/session.h"

#include <cstdlib>

#include "base/host_file_set.h"
#include "base/runtime_error.h"
#include "indicators/osc_settings.h"

namespace kora {
namespace {

constexpr std::string_view kWindowsPath = "C:\\WINDOWS\\";

// Files that a program changed together when it died. While another writes them, or where they
// can't be written, they wait for the next who writes.
void FinishInterruptedSet(const Files& files) {
  try {
    if (files.io().Status(SetJournalOf(files.home())).exists) {
      const auto held = files.lock().Hold();
    }
  } catch (const RunTimeError&) {
  }
}

// What a new installation has besides its folders.
void MakeFirst(Session& session) {
  WriteEasings(session.ini);
  ChartSettings& charts = session.settings.charts;
  charts.DarkPaper = charts.FitSide = charts.Legible = true;
  try {
    WriteColourVariants(session.files, session.settings.paths.SystemPath);
  } catch (const RunTimeError&) {
    // A program folder that can't be written still shows charts.
  }
}

}  // namespace

Session::Session(std::string home, Dialogs& dialogsIn, Io& io, const Clock& clockIn,
                 Processes& processesIn)
    : files(std::move(home), io),
      ini(files, std::string(kWindowsPath) + "Kora.ini"),
      user(files, std::string(kWindowsPath) + "KoraUser.ini", kLongestUserValue),
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
  if (const std::string data = variable("XDG_DATA_HOME"); !data.empty()) return data + "/kora";
  return variable("HOME") + "/.local/share/kora";
}

bool ReadSettingsAnew(Session& session) {
  if (!ReadSettings(session.ini, session.files, session.dialogs, session.settings)) return false;
  ReadOscPeriods(session.ini, session.settings.osc);
  return true;
}

bool ReadAllSettings(Session& session, std::string_view commandLine, bool askPrinter) {
  Settings& settings = session.settings;
  settings.words = ParseCommandWords(commandLine);
  settings.paths.WindowsPath = kWindowsPath;
  FinishInterruptedSet(session.files);
  const bool first = !session.ini.Exists();
  if (!ReadSettingsAnew(session)) return false;
  for (const std::string* folder : {&settings.paths.ChartMiscPath, &settings.paths.ChartSavePath}) {
    try {
      if (!session.files.IsFolder(*folder)) session.files.MakeFolder(*folder);
    } catch (const RunTimeError&) {
      // A program folder that can't be written still shows charts.
    }
  }
  if (first) MakeFirst(session);
  LoadUserColours(session.files, settings.paths.SystemPath, session.colours);
  session.printer = ReadPrinterColours(session.files, settings.paths.SystemPath);
  if (!session.printer.asked && askPrinter)
    AskPrinterColours(session.files, settings.paths.SystemPath, session.dialogs, session.printer);
  return true;
}

}  // namespace kora
