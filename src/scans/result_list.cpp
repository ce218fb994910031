#include "scans/result_list.h"

#include "base/numbers.h"
#include "base/text.h"
#include "lists/chart_list.h"

namespace kora {

std::string ResultListBytes(const std::vector<ResultEntry>& entries) {
  CInt(double(entries.size()));
  std::string bytes;
  for (const ResultEntry& entry : entries) {
    ListRec rec{};
    rec.ListRecNo = CInt(entry.record);
    rec.ListCode.set(UCase(Trim(entry.code)));
    bytes.append(reinterpret_cast<const char*>(&rec), sizeof rec);
  }
  return bytes;
}

void SaveScan(const Files& files, const std::string& dataPath,
              const std::vector<ResultEntry>& entries) {
  const std::string bytes = ResultListBytes(entries);
  const auto held = files.lock().Hold();
  files.WriteAll(ListFilePath(dataPath, kResultList), bytes);
}

}  // namespace kora
