#include "lists/name_search.h"

#include "base/text.h"
#include "store/name_file.h"

namespace kora {

std::vector<NameMatch> NamesWith(const Files& files, const std::string& dataPath,
                                 std::string_view text) {
  const std::string wanted = UCase(ToAnsi(text));
  std::vector<NameMatch> matches;
  std::int16_t record = 0;
  for (const NameRec& rec : ReadNames(files, dataPath)) {
    ++record;
    if (UCase(rec.Name.raw()).find(wanted) == std::string::npos) continue;
    matches.push_back({FromAnsi(rec.Code.trimmed()), FromAnsi(rec.Name.trimmed()), record});
  }
  return matches;
}

}  // namespace kora
