#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"

namespace kora {

inline constexpr std::string_view kNoMoreMatches = "No more matches";

struct NameMatch {
  std::string code, name;   // trimmed
  std::int16_t record = 0;  // in Names.dat
};

// All securities with a text in their name, in any case of the letters A to Z, in file order.
// Empty when there is no name file. Errors of opening and reading; 6 for more records than 16
// bits number.
std::vector<NameMatch> NamesWith(const Files& files, const std::string& dataPath,
                                 std::string_view text);

}  // namespace kora
