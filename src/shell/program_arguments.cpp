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

std::optional<ProgramArguments> ParseProgramArguments(const std::vector<std::string>& arguments,
                                                      std::string& fault) {
  ProgramArguments out;
  for (size_t i = 0; i < arguments.size(); ++i) {
    std::string_view argument = arguments[i];
    if (argument.substr(0, 2) != "--") {
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
