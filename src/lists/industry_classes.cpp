#include "lists/industry_classes.h"

#include <algorithm>

#include "base/text.h"

namespace kora {

std::vector<IndustryClass> ReadIndustryClasses(const Files& files, const std::string& systemPath) {
  std::vector<IndustryClass> out;
  const std::string path = systemPath + "IndClass.dat";
  if (!files.CheckFile(path)) return out;
  const std::string text = files.ReadAll(path, 1u << 20);
  LineReader lines(text);
  for (std::string_view line; lines.Next(line);) {
    const size_t comma = std::min(line.find(','), line.size());
    const std::string_view id = Trim(line.substr(0, comma));
    if (id.empty()) continue;
    const std::string_view rest = comma < line.size() ? line.substr(comma + 1) : "";
    out.push_back({FromAnsi(id), FromAnsi(Trim(rest))});
  }
  return out;
}

}  // namespace kora
