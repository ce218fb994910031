#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/settings_file.h"

namespace kora {

// The command line of the desktop program:
//   kora [--home DIR] [--set SECTION.KEY=VALUE]... [WORD]... [FILE.cht]
// What has a point or a slash in it names a file: no word has.
struct ProgramArguments {
  std::string home;  // host folder, empty for the standing one
  struct Override {
    std::string section, key, value;
  };
  std::vector<Override> overrides;
  std::string words;  // the command-line words, blanks between
  std::string file;   // a saved chart to show, as it was named
  bool help = false, version = false;
};

// What `--help` prints: usage, options and words.
std::string ProgramHelp();

// Without the program's own name. Nothing, and a text in `fault`, for an option that is not
// known or lacks its value, and for a second file.
std::optional<ProgramArguments> ParseProgramArguments(const std::vector<std::string>& arguments,
                                                      std::string& fault);

// "Charts.Av1D=30". The key is what stands between the first point and the first "=" after it.
std::optional<ProgramArguments::Override> ParseOverride(std::string_view text);

}  // namespace kora
