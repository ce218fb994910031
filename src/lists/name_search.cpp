#include "lists/name_search.h"

#include <algorithm>
#include <vector>

#include "base/numbers.h"
#include "base/text.h"
#include "store/name_file.h"

namespace kora {

NameSearch::NameSearch(const Files& files, std::string dataPath, std::string_view text)
    : files_(files), dataPath_(std::move(dataPath)), text_(ToAnsi(text)) {}

std::optional<NameMatch> NameSearch::FindNext() {
  constexpr std::int32_t kRun = 512;
  const NameFile names(files_, NameFilePath(dataPath_));
  CInt(names.count());
  std::vector<NameRec> run;
  for (std::int32_t first = last_ + 1; first <= names.count(); first += kRun) {
    run.resize(size_t(std::min(kRun, names.count() - first + 1)));
    names.ReadRun(first, run);
    for (size_t i = 0; i < run.size(); ++i) {
      if (run[i].Name.raw().find(text_) == std::string_view::npos) continue;
      last_ = first + std::int32_t(i);
      return NameMatch{FromAnsi(run[i].Code.trimmed()), FromAnsi(run[i].Name.trimmed()),
                       CInt(last_)};
    }
  }
  last_ = std::max(last_, names.count());
  return std::nullopt;
}

}  // namespace kora
