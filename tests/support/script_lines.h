#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "chart/chart_script.h"

namespace kora::test {

// The lines of a script, without line ends.
inline std::vector<std::string> LinesOf(const ChartScript& script) {
  std::vector<std::string> out;
  LineReader reader(script.text());
  std::string_view line;
  while (reader.Next(line)) out.emplace_back(line);
  return out;
}

// Those of them that begin with `letter`.
inline std::vector<std::string> LinesOf(const ChartScript& script, char letter) {
  std::vector<std::string> out = LinesOf(script);
  std::erase_if(out, [letter](const std::string& line) { return !line.starts_with(letter); });
  return out;
}

}  // namespace kora::test
