#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/settings_file.h"

namespace kora {

// The command line of the desktop program:
//   kora [--home DIR] [--set SECTION.KEY=VALUE]... [WORD]...
struct ProgramArguments {
  std::string home;  // host folder, empty for the standing one
  struct Override {
    std::string section, key, value;
  };
  std::vector<Override> overrides;
  std::string words;  // the command-line words, blanks between
};

// Without the program's own name. Nothing, and a text in `fault`, for an option that is not
// known or lacks its value.
std::optional<ProgramArguments> ParseProgramArguments(const std::vector<std::string>& arguments,
                                                      std::string& fault);

// "Charts.Av1D=30". The key is what stands between the first point and the first "=" after it.
std::optional<ProgramArguments::Override> ParseOverride(std::string_view text);

}  // namespace kora
