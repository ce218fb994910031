#include "store/industry_classes.h"

#include <algorithm>

#include "base/numbers.h"
#include "base/text.h"

namespace kora {

std::string IndustryClassFile(const std::string& systemPath) { return systemPath + "IndClass.dat"; }

std::vector<IndustryClass> ReadIndustryClasses(const Files& files, const std::string& systemPath) {
  std::vector<IndustryClass> out;
  const std::string path = IndustryClassFile(systemPath);
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

std::optional<std::string> PutClassId(IndustryClass& row, std::string_view text) {
  const std::string_view id = Trim(text);
  if (id.find_first_not_of("0123456789") != std::string_view::npos) return "Id must be numeric";
  if (id.size() > 3) return "Id can have 3 digits";
  row.id = id.empty() ? std::string() : Format(Val(id), "000");
  return std::nullopt;
}

std::optional<std::string> PutClassDescription(IndustryClass& row, std::string_view text) {
  if (text.find(',') != std::string_view::npos) return "Commas cannot be used";
  if (FromAnsi(ToAnsi(text)) != text) return "There are characters that cannot be stored";
  row.description = Trim(text);
  return std::nullopt;
}

void SortIC(std::vector<IndustryClass>& rows) {
  const auto filled = std::stable_partition(
      rows.begin(), rows.end(), [](const IndustryClass& row) { return !row.id.empty(); });
  std::stable_sort(rows.begin(), filled, [](const IndustryClass& a, const IndustryClass& b) {
    return PadRight(a.id, 12) < PadRight(b.id, 12);
  });
}

void WriteIndustryClasses(const Files& files, const std::string& systemPath,
                          const std::vector<IndustryClass>& rows) {
  std::string text;
  for (const IndustryClass& row : rows)
    if (!row.id.empty()) text += ToAnsi(Trim(row.id + "," + row.description)) + "\r\n";
  const auto held = files.lock().Hold();
  files.WriteAll(IndustryClassFile(systemPath), text);
}

bool MatchesIndClass(std::string_view indClass, std::string_view filter) {
  const std::string_view own = Trim(indClass);
  if (own.empty() || filter.empty()) return false;
  if (filter.back() == '0') return own.size() == 3 && own.substr(0, 2) == filter.substr(0, 2);
  return own == filter;
}

}  // namespace kora
