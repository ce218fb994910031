#pragma once

#include <set>
#include <sstream>
#include <string>

namespace kora::test {

// The first words of the lines that stand under a heading of a help text ("Subcommands:"), with
// two blanks before them, up to an empty line.
inline std::set<std::string> WordsUnder(const std::string& help, const std::string& heading) {
  std::set<std::string> words;
  std::istringstream lines(help);
  bool under = false;
  for (std::string line; std::getline(lines, line);) {
    if (line == heading) under = true;
    if (line.empty()) under = false;
    if (under && line.size() > 2 && line.starts_with("  ") && line[2] != ' ')
      words.insert(line.substr(2, line.find(' ', 2) - 2));
  }
  return words;
}

}  // namespace kora::test
