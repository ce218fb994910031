#include "koractl/run.h"

#include <filesystem>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "shell/program_arguments.h"

namespace kora {
namespace {

std::string HomeOf(const CommandLine& line) {
  if (line.home && line.home->empty()) throw UsageError("--home: an empty name is no folder");
  const std::string home = line.home.value_or(DefaultHome());
  std::error_code error;
  const auto path = std::filesystem::absolute(home, error);
  return error ? home : path.lexically_normal().string();
}

}  // namespace

Run::Run(const CommandLine& line) : dialogs(line.answer), session(HomeOf(line), dialogs, *line.io) {
  HomeLock& lock = session.files.lock();
  lock.program = "koractl";
  lock.wait = std::chrono::milliseconds(CLng(line.wait * 1000));
  for (const std::string& text : line.sets) {
    const auto setting = ParseOverride(text);
    if (!setting) throw UsageError("--set: \"" + text + "\" is no SECTION.KEY=VALUE");
    if (const std::string why = WhyNotKept(setting->value); !why.empty())
      throw UsageError("--set: the value of \"" + text + "\" " + why);
    session.ini.Override(setting->section, setting->key, setting->value);
  }
}

void Run::Abandon(std::string_view text, std::string_view title) {
  dialogs.Message(text, title);
  throw Abandoned();
}

void Run::Open(const std::string& words) {
  const Files& files = session.files;
  if (!files.CheckFile(session.ini.path()) || files.IsFolder(session.ini.path()))
    Abandon("There is no Kora.ini in " + files.home() +
                ". Make an installation there with the command init or demo.",
            "KORA");
  if (!ReadAllSettings(session, words, false)) throw Abandoned();
}

std::string Run::HostPathOf(const std::string& file) {
  if (file.empty()) throw UsageError("An empty name is no file");
  std::error_code error;
  const auto path = std::filesystem::absolute(file, error);
  if (error) Abandon(file + ": the working folder is gone", "KORA");
  return path.string();
}

void Run::Locate(const std::string& code) {
  session.current.CurrentCode = Trim(code);
  try {
    if (!LocateCurrentCode(session.files, dataPath(), dialogs, session.current)) throw Abandoned();
  } catch (const RunTimeError& e) {
    AbandonFile(e, {.file = "Names.dat"});
  }
}

void Run::AbandonFile(const RunTimeError& error, const ChartFailure& at, std::string_view title) {
  Abandon(ChartFailureText(error.number(), error.what(), at), title);
}

}  // namespace kora
