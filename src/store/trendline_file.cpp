#include "store/trendline_file.h"

#include <cstring>

#include "base/runtime_error.h"

namespace kora {
namespace {

void WriteWhole(const Files& files, const std::string& path,
                const std::vector<TrendlineRec>& records) {
  files.WriteAll(
      path, {reinterpret_cast<const char*>(records.data()), records.size() * sizeof(TrendlineRec)});
}

}  // namespace

TrendlineRec EmptyTrendline() {
  TrendlineRec rec{};
  rec.TLPeriod.set("");
  rec.TLStartDate.set("");
  rec.TLEndDate.set("");
  return rec;
}

std::string TrendlinePath(std::string_view miscPath, std::string_view code) {
  return std::string(miscPath) + CodeFileName(code, ".TND");
}

std::vector<TrendlineRec> ReadTrendlines(const Files& files, const std::string& path) {
  if (!files.CheckFile(path)) return {};
  const std::string bytes = files.ReadAll(path);
  std::vector<TrendlineRec> records(bytes.size() / sizeof(TrendlineRec));
  if (!records.empty())
    std::memcpy(records.data(), bytes.data(), records.size() * sizeof(TrendlineRec));
  return records;
}

std::int32_t SaveTrendline(const Files& files, const std::string& path, const TrendlineRec& line) {
  const auto held = files.lock().Hold();
  std::vector<TrendlineRec> records = ReadTrendlines(files, path);
  size_t slot = 0;
  while (slot < records.size() && !records[slot].Empty()) ++slot;
  if (slot == records.size()) records.push_back(line);
  records[slot] = line;
  WriteWhole(files, path, records);
  return static_cast<std::int32_t>(slot + 1);
}

void DeleteTrendline(const Files& files, const std::string& path, std::int32_t n) {
  const auto held = files.lock().Hold();
  std::vector<TrendlineRec> records = ReadTrendlines(files, path);
  if (n < 1 || size_t(n) > records.size()) throw RunTimeError(kBadRecordNumber);
  records[size_t(n) - 1] = EmptyTrendline();
  WriteWhole(files, path, records);
}

void CompactTrendlines(const Files& files, const std::string& path) {
  const auto held = files.lock().Hold();
  if (!files.CheckFile(path)) return;
  std::vector<TrendlineRec> kept;
  for (const TrendlineRec& rec : ReadTrendlines(files, path))
    if (!rec.TLStartDate.trimmed().empty() && rec.TLStartPrice != 0) kept.push_back(rec);
  WriteWhole(files, path, kept);
}

void RemoveTrendlines(const Files& files, const std::string& path) {
  const auto held = files.lock().Hold();
  if (files.CheckFile(path)) files.Remove(path);
}

}  // namespace kora
