#include "shell/program_arguments.h"

#include "platform/settings_file.h"

namespace kora {

std::optional<ProgramArguments::Override> ParseOverride(std::string_view text) {
  const size_t point = text.find('.');
  if (point == 0 || point == text.npos) return std::nullopt;
  const size_t equals = text.find('=', point);
  if (equals == text.npos || equals == point + 1) return std::nullopt;
  return ProgramArguments::Override{std::string(text.substr(0, point)),
                                    std::string(text.substr(point + 1, equals - point - 1)),
                                    std::string(text.substr(equals + 1))};
}

std::string ProgramHelp() {
  return "KORA Charting\n"
         "Usage: kora [--home DIR] [--set SECTION.KEY=VALUE]... [WORD]... [FILE.cht]\n"
         "\n"
         "FILE.cht is a saved chart, which is shown.\n"
         "\n"
         "Options:\n"
         "  -h,--help                Print this help message and exit\n"
         "  --version                Print the version and the revision, and exit\n"
         "  --home DIR               Folder of the installation (default: KORA_HOME, else kora\n"
         "                           under the user's data folder)\n"
         "  --set SECTION.KEY=VALUE  A setting for this run only\n"
         "\n"
         "Words:\n"
         "  RM                       Marks of the signals of the Stochastic\n"
         "  A                        No downloads and no market snapshot\n"
         "  N                        Scripts for print: the user's sizes of fonts\n"
         "  XT                       Further menu entries, and RM\n"
         "  XS                       Further menu entries of the chart window\n";
}

std::optional<ProgramArguments> ParseProgramArguments(const std::vector<std::string>& arguments,
                                                      std::string& fault) {
  ProgramArguments out;
  for (size_t i = 0; i < arguments.size(); ++i) {
    std::string_view argument = arguments[i];
    if (argument == "--help" || argument == "-h" || argument == "--version") {
      (argument == "--version" ? out.version : out.help) = true;
      continue;
    }
    if (argument.substr(0, 2) != "--") {
      if (argument.find_first_of("./") != argument.npos) {
        if (!out.file.empty()) {
          fault = "one file at a time: " + out.file + ", " + std::string(argument);
          return std::nullopt;
        }
        out.file = argument;
        continue;
      }
      if (!out.words.empty()) out.words += ' ';
      out.words += argument;
      continue;
    }
    const size_t equals = argument.find('=');
    const std::string_view name = argument.substr(0, equals);
    if (name != "--home" && name != "--set") {
      fault = "unknown option " + std::string(name);
      return std::nullopt;
    }
    std::string value;
    if (equals != argument.npos)
      value = argument.substr(equals + 1);
    else if (i + 1 < arguments.size())
      value = arguments[++i];
    if (name == "--home") {
      out.home = value;
      if (value.empty()) fault = "--home needs a folder";
    } else if (auto override = ParseOverride(value)) {
      const std::string why = WhyNotKept(override->value);
      if (!why.empty()) fault = "--set: the value of \"" + value + "\" " + why;
      out.overrides.push_back(*override);
    } else {
      fault = "--set needs SECTION.KEY=VALUE";
    }
    if (!fault.empty()) return std::nullopt;
  }
  return out;
}

}  // namespace kora
