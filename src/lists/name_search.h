#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "base/files.h"

namespace kora {

inline constexpr std::string_view kNoMoreMatches = "No more matches";

struct NameMatch {
  std::string code, name;   // trimmed
  std::int16_t record = 0;  // in Names.dat
};

// Finds the securities with a text in their name, one after the other in file order. The text is
// compared in the case as given. Names.dat is opened for each step.
class NameSearch {
 public:
  NameSearch(const Files& files, std::string dataPath, std::string_view text);

  // From the record behind the last match. Nothing at the end, and then for good. Errors of
  // opening and reading; 6 for more records than 16 bits number.
  std::optional<NameMatch> FindNext();

 private:
  const Files& files_;
  std::string dataPath_;
  std::string text_;  // ANSI
  std::int32_t last_ = 0;
};

}  // namespace kora
