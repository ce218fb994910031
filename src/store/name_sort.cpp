#include "base/numbers.h"
#include "base/text.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr size_t kKeySize = 12;

void SortFile(const Files& files, const std::string& path, NameSort mode) {
  std::vector<NameRec> records;
  {
    const NameFile names(files, path);
    if (CInt(names.count()) < 2) return;
    records = names.ReadAll();
  }
  WriteNames(files, path, SortedNames(records, mode));
}

}  // namespace

std::string SortKey(const NameRec& record, NameSort mode) {
  const std::string_view code = Trim(record.Code.trimmed());
  std::string key;
  switch (mode) {
    case NameSort::kCode: key = code; break;
    case NameSort::kIndClass: key = Trim(record.IndClass.trimmed()); break;
    case NameSort::kCategory:
      key = Format(double(record.Category), "000") + Str(std::int32_t(record.RecType));
      break;
  }
  if (mode != NameSort::kCode) key += code;
  return PadRight(key, kKeySize);
}

void ShellSort(std::vector<SortEntry>& items) {
  const auto count = static_cast<std::ptrdiff_t>(items.size());
  std::ptrdiff_t gap = 4;
  while (gap < count) gap *= 2;
  --gap;
  for (gap /= 2; gap >= 1; gap /= 2) {
    for (std::ptrdiff_t i = 0; i + gap < count; ++i) {
      for (std::ptrdiff_t j = i; j >= 0; j -= gap) {
        SortEntry& low = items[size_t(j)];
        SortEntry& high = items[size_t(j + gap)];
        if (high.Key > low.Key) break;
        std::swap(low, high);  // equal keys too
      }
    }
  }
}

std::vector<NameRec> SortedNames(std::span<const NameRec> records, NameSort mode) {
  std::vector<SortEntry> items;
  items.reserve(records.size());
  for (size_t i = 0; i < records.size(); ++i) {
    if (records[i].NameStatus == 1) continue;
    items.push_back({static_cast<std::int32_t>(i) + 1, SortKey(records[i], mode)});
  }
  ShellSort(items);
  std::vector<NameRec> out;
  out.reserve(items.size());
  for (const SortEntry& item : items) out.push_back(records[size_t(item.RecNo - 1)]);
  return out;
}

void WriteNames(const Files& files, const std::string& path, std::span<const NameRec> records) {
  CInt(double(records.size()));
  files.WriteAll(path, {reinterpret_cast<const char*>(records.data()), records.size_bytes()});
}

void SortNameFile(const Files& files, const std::string& dataPath, NameSort mode) {
  const auto held = files.lock().Hold();
  SortFile(files, NameFilePath(dataPath), mode);
}

void SortEditorCopy(const Files& files, const std::string& dataPath, NameSort mode) {
  SortFile(files, dataPath + "Temp.Wk2", mode);
}

}  // namespace kora
