#include <cstdio>

#include "kora/program/program.h"
#include "revision/revision.h"

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
  std::string fault;
  const auto arguments = ParseProgramArguments(Words(app.arguments().mid(1)), fault);
  if (!arguments) {
    std::fprintf(stderr, "kora: %s\n\n%s", fault.c_str(), ProgramHelp().c_str());
    return 2;
  }
  Program program(app, *arguments);
  return program.Start() ? app.exec() : 1;
}
