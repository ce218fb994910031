#include "companies/stock_details.h"

#include <algorithm>
#include <unordered_set>

#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestText = 16u << 20;
constexpr std::uint64_t kLargestStore = 64u << 20;
constexpr size_t kMostLabels = 200;
constexpr std::string_view kDelimiters = "|\t;,~^:";
constexpr std::int32_t kProbed = 50;  // records from which the delimiter is told

std::string SystemFolder(const DownloadSettings& download) {
  return WithBackslash(Trim(download.ServiceSystem));
}

// The store keeps the fields as the service joined them, and does not say by what: the delimiter
// is the one that gives most records as many fields as there are labels, and else the commonest.
char DelimiterOf(const std::vector<DetailsRec>& records, size_t fields) {
  char best = 0;
  std::int64_t bestScore = 0;
  const size_t probed = std::min(records.size(), size_t(kProbed));
  for (const char delimiter : kDelimiters) {
    std::int64_t score = 0;
    for (size_t i = 0; i < probed; ++i) {
      const std::string_view text = records[i].Details.trimmed();
      const auto count = std::count(text.begin(), text.end(), delimiter);
      score += count + (size_t(count) + 1 == fields ? 10'000 : 0);
    }
    if (score > bestScore) {
      best = delimiter;
      bestScore = score;
    }
  }
  return best;
}

}  // namespace

std::vector<std::string> ReadDetailLabels(const Files& files, const DownloadSettings& download) {
  const std::string path = SystemFolder(download) + "STKHeader.txt";
  std::vector<std::string> labels;
  if (!files.CheckFile(path)) return labels;
  const std::string text = files.ReadAll(path, kLargestText);
  LineReader lines(text);
  std::string_view line;
  if (!lines.Next(line)) return labels;  // their number
  while (labels.size() < kMostLabels && lines.Next(line)) labels.push_back(FromAnsi(Trim(line)));
  return labels;
}

CompanyStore::CompanyStore(const Files& files, const DownloadSettings& download) {
  const std::string folder = SystemFolder(download);
  labels_ = ReadDetailLabels(files, download);
  if (!labels_.empty()) labels_.erase(labels_.begin());
  {
    const RecordFile<DetailsRec> file(files, folder + "SecurityDetails.Stx");
    if (std::uint64_t(file.count()) * sizeof(DetailsRec) > kLargestStore)
      throw RunTimeError(kOutOfMemory);
    records_ = file.ReadAll();
  }
  const std::string text = files.ReadAll(folder + "Sdix1.inx", kLargestText);
  std::unordered_set<std::string_view> seen;
  LineReader lines(text);
  for (std::string_view line; lines.Next(line);) {
    const auto fields = Split(line, ',');
    if (fields.size() < 2) continue;
    const std::string_view code = Trim(fields[0]);
    const double record = Val(fields[1]);
    if (code.empty() || record < 1 || record > double(records_.size())) continue;
    if (!seen.insert(code).second) continue;  // the first entry of a code is the one that counts
    index_.emplace_back(code, CLng(record));
    codes_.push_back(FromAnsi(code));
  }
  std::sort(index_.begin(), index_.end());
  delimiter_ = DelimiterOf(records_, labels_.size());
}

std::string_view CompanyStore::Code(std::int32_t record) const {
  return Trim(records_[size_t(record - 1)].Code.trimmed());
}

std::int32_t CompanyStore::Find(std::string_view code) const {
  const std::string wanted = UCase(Trim(code));
  const auto found =
      std::lower_bound(index_.begin(), index_.end(), wanted,
                       [](const auto& entry, const std::string& c) { return entry.first < c; });
  if (found == index_.end() || found->first != wanted) return 0;
  return Code(found->second) == wanted ? found->second : 0;
}

std::int32_t CompanyStore::CountFrom(std::int32_t first) const {
  if (first < 1 || first > std::int32_t(records_.size())) return 0;
  std::int32_t next = first;
  while (next <= std::int32_t(records_.size()) && Code(next) == Code(first)) ++next;
  return next - first;
}

std::vector<std::string> CompanyStore::Fields(std::int32_t record) const {
  std::vector<std::string> out;
  out.reserve(labels_.size());
  if (record >= 1 && record <= std::int32_t(records_.size())) {
    const std::string_view text = records_[size_t(record - 1)].Details.trimmed();
    if (delimiter_ == 0) {
      out.push_back(FromAnsi(Trim(text)));
    } else {
      for (const std::string_view field : Split(text, delimiter_))
        out.push_back(FromAnsi(Trim(field)));
    }
  }
  out.resize(labels_.size());
  return out;
}

std::vector<StockDetail> GetStockDetails(const CompanyStore& store, std::string_view code) {
  std::vector<StockDetail> out;
  const std::int32_t record = store.Find(code);
  if (record == 0) return out;
  std::vector<std::string> fields = store.Fields(record);
  for (size_t i = 0; i < fields.size(); ++i)
    out.push_back({store.labels()[i], std::move(fields[i])});
  return out;
}

Dividends DividendsOf(const CompanyStore& store, std::string_view code) {
  const auto place = [&](std::string_view label) {
    const auto& labels = store.labels();
    return size_t(std::find(labels.begin(), labels.end(), label) - labels.begin());
  };
  const size_t amount = place("Current Div"), type = place("Div. Type");
  Dividends out;
  const std::int32_t first = store.Find(code);
  if (first == 0 || std::max(amount, type) >= store.labels().size()) return out;
  bool hasInterim = false, hasFinal = false;
  const std::int32_t end = first + store.CountFrom(first);
  for (std::int32_t record = first; record < end; ++record) {
    const std::vector<std::string> fields = store.Fields(record);
    const std::string kind = UCase(fields[type]).substr(0, 1);
    const double dividend = Val(fields[amount]);
    if (kind == "I" && !hasInterim) {
      out.interim = dividend;
      hasInterim = true;
    } else if (kind == "F" && !hasFinal) {
      out.final = dividend;
      hasFinal = true;
    }
  }
  return out;
}

std::string TransferQuestion(std::string_view description) {
  return "Transfer data in " + std::string(description) +
         " column to the Other Details column of the Name File";
}

std::string AsOtherDetails(std::string_view value) {
  std::string out = ToAnsi(Trim(value));
  for (char& c : out)
    if (c == ',' || static_cast<unsigned char>(c) < 0x20) c = ' ';
  return std::string(Trim(std::string_view(out).substr(0, 15)));
}

}  // namespace kora
