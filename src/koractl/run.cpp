#include "koractl/run.h"

#include <filesystem>

#include "base/runtime_error.h"
#include "base/text.h"
#include "shell/program_arguments.h"

namespace kora {
namespace {

std::string HomeOf(const CommandLine& line) {
  const std::string home = line.home.empty() ? DefaultHome() : line.home;
  std::error_code error;
  const auto path = std::filesystem::absolute(home, error);
  return error ? home : path.lexically_normal().string();
}

}  // namespace

Run::Run(const CommandLine& line) : dialogs(line.answer), session(HomeOf(line), dialogs) {
  for (const std::string& text : line.sets) {
    const auto setting = ParseOverride(text);
    if (!setting) throw UsageError("--set: \"" + text + "\" is no SECTION.KEY=VALUE");
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

void Run::Locate(const std::string& code) {
  session.current.CurrentCode = Trim(code);
  try {
    if (!LocateCurrentCode(session.files, dataPath(), dialogs, session.current)) throw Abandoned();
  } catch (const RunTimeError& e) {
    AbandonFile(e, {.file = "Names.dat"});
  }
}

std::string Run::DataFileName() const {
  return CodeFileName(session.current.Rec.Code.trimmed(), ".WDT");
}

void Run::AbandonFile(const RunTimeError& error, const ChartFailure& at,
                      std::string_view title) {
  Abandon(ChartFailureText(error.number(), error.what(), at), title);
}

}  // namespace kora
