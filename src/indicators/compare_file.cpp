#include "indicators/compare_file.h"

#include <algorithm>

#include "base/runtime_error.h"
#include "base/text.h"
#include "indicators/osc_series.h"

namespace kora {
namespace {

std::string CompareNameOf(const Files& files, std::string_view path) {
  constexpr std::string_view kExtension = ".WDT";
  if (!files.CheckFile(path) || path.size() < kExtension.size()) return {};
  const std::string_view stem = path.substr(0, path.size() - kExtension.size());
  if (!EqualNoCase(path.substr(stem.size()), kExtension)) return {};
  const size_t backslash = stem.rfind('\\');
  if (backslash == std::string_view::npos) return {};
  return UCase(stem.substr(backslash + 1));
}

}  // namespace

std::string ValidateCompareFile(const Files& files, Dialogs& dialogs, const std::string& compFile) {
  std::string name = CompareNameOf(files, Trim(compFile));
  if (name.empty())
    dialogs.Message(
        "RMX/RMO Compare file path/file details are invalid. Reset details in Chart Defaults "
        "available from the Chart Select window",
        "RMX/RMO Compare file");
  return name;
}

std::optional<PriceFile> OpenCompareFile(const Files& files, const std::string& compFile) {
  try {
    return PriceFile(files, Trim(compFile));
  } catch (const RunTimeError& e) {
    if (e.number() == kFileNotFound || e.number() == kPathNotFound) return std::nullopt;
    throw;
  }
}

std::vector<float> ReadCloses(const PriceFile& file, std::int32_t first, std::int32_t n) {
  std::vector<PriceRec> records(static_cast<size_t>(n));
  file.ReadRun(first, records);
  std::vector<float> closes(records.size());
  std::transform(records.begin(), records.end(), closes.begin(),
                 [](const PriceRec& record) { return record.Close; });
  return closes;
}

float CompareRatio(float compareClose, float close) {
  return close == 0 ? 0.0f : CSng(compareClose / (close * 100.0));
}

}  // namespace kora
