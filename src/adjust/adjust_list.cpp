#include "adjust/adjust_list.h"

#include <algorithm>
#include <array>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestList = 64u << 20;

std::string SortKey(const AdjustRow& row) {
  constexpr std::array<std::string_view, 7> kOrder{"NI", "NC", "DC", "SP", "BI", "PC", "DI"};
  const auto at = std::find(kOrder.begin(), kOrder.end(), row.Action()) - kOrder.begin();
  return row.Field(kAdjCode) + char('1' + at);
}

void MarkMarkets(AdjustRows& rows, std::string_view one, std::string_view other) {
  for (AdjustRow& row : rows)
    if (const std::string market = row.Field(kAdjFile); market == one || market == other)
      row.Set(kAdjMark, "D");
}

}  // namespace

std::string AdjustRow::Field(size_t column) const {
  return column <= fields.size() ? std::string(Trim(fields[column - 1])) : std::string();
}

void AdjustRow::Set(size_t column, std::string text) {
  if (fields.size() < column) fields.resize(column);
  fields[column - 1] = std::move(text);
}

std::string AdjustRow::Action() const { return UCase(Field(kAdjAct)); }

bool AdjustRow::IsMarked(char letter) const {
  return UCase(Field(kAdjMark)) == std::string_view(&letter, 1);
}

AdjustRow ParseAdjustLine(std::string_view line) {
  AdjustRow row;
  while (row.fields.size() + 1 < kAdjustColumns) {
    const size_t comma = line.find(',');
    if (comma == std::string_view::npos) break;
    row.fields.emplace_back(line.substr(0, comma));
    line.remove_prefix(comma + 1);
  }
  row.fields.emplace_back(line);
  return row;
}

std::string AdjustLine(const AdjustRow& row) {
  std::string line;
  for (size_t i = 0; i < row.fields.size(); ++i) {
    if (i > 0) line += ',';
    line += row.fields[i];
  }
  return line;
}

std::string AdjustListPath(const std::string& folder) {
  return WithBackslash(folder) + "Adjust.Lst";
}

AdjustRows ReadAdjustList(const Files& files, const std::string& folder) {
  const std::string path = AdjustListPath(folder);
  if (!files.CheckFile(path)) return {};
  const std::string text = files.ReadAll(path, kLargestList);
  AdjustRows rows;
  LineReader lines(text);
  std::string_view line;
  while (lines.Next(line))
    if (!Trim(line).empty()) rows.push_back(ParseAdjustLine(line));
  return rows;
}

std::string AdjustListText(const AdjustRows& rows) {
  std::string text;
  for (const AdjustRow& row : rows) text += AdjustLine(row) + "\r\n";
  return text;
}

void WriteAdjustList(const Files& files, const std::string& folder, const AdjustRows& rows) {
  files.WriteAll(AdjustListPath(folder), AdjustListText(rows));
}

void SortAdjustments(AdjustRows& rows) {
  std::vector<std::pair<std::string, AdjustRow>> keyed;
  keyed.reserve(rows.size());
  for (AdjustRow& row : rows) {
    std::string key = SortKey(row);
    keyed.emplace_back(std::move(key), std::move(row));
  }
  std::stable_sort(keyed.begin(), keyed.end(),
                   [](const auto& a, const auto& b) { return a.first < b.first; });
  for (size_t i = 0; i < rows.size(); ++i) rows[i] = std::move(keyed[i].second);
}

void MarkAll(AdjustRows& rows, char letter) {
  for (AdjustRow& row : rows) row.Set(kAdjMark, std::string(1, letter));
}

void MarkOptions(AdjustRows& rows) { MarkMarkets(rows, "ASX.OPT", "OPT"); }
void MarkWarrants(AdjustRows& rows) { MarkMarkets(rows, "ASX.WNT", "WNT"); }

void RemoveDone(AdjustRows& rows) {
  std::erase_if(rows, [](const AdjustRow& row) { return row.IsMarked('D'); });
}

std::string BulletinDate(std::string_view ddMMMyy) {
  constexpr std::string_view kMonths = "JANFEBMARAPRMAYJUNJULAUGSEPOCTNOVDEC";
  if (ddMMMyy.size() != 7) return {};
  for (const size_t i : {0, 1, 5, 6})
    if (ddMMMyy[i] < '0' || ddMMMyy[i] > '9') return {};
  const size_t at = kMonths.find(UCase(ddMMMyy.substr(2, 3)));
  if (at == std::string_view::npos || at % 3 != 0) return {};
  std::string month = Str(std::int32_t(at / 3 + 1));
  if (month.size() < 2) month.insert(0, "0");
  const std::string_view year = ddMMMyy.substr(5);
  const std::string date =
      (year < "30" ? "20" : "19") + std::string(year) + month + std::string(ddMMMyy.substr(0, 2));
  return ParseFileDate(date) ? date : std::string();
}

}  // namespace kora
