#include "lists/grid_rows.h"

#include <algorithm>
#include <numeric>

#include "base/numbers.h"
#include "base/text.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr size_t kLongestSetting = 60;
constexpr int kWidest = 9999;

}  // namespace

RowOrder::RowOrder(int count) : rows_(size_t(std::max(count, 0))) {
  std::iota(rows_.begin(), rows_.end(), 0);
}

void RowOrder::Sort(const std::function<bool(int a, int b)>& before) {
  std::stable_sort(rows_.begin(), rows_.end(), before);
}

void RowOrder::Reverse() { std::reverse(rows_.begin(), rows_.end()); }

void RowOrder::Remove(RowBlock places) { RemoveBlock(rows_, places); }

bool AskDeleteRows(Dialogs& dialogs, int count, std::string_view first, std::string_view last) {
  const std::string text =
      count == 1 ? "Delete row " + std::string(first) + " ?"
                 : "Delete items " + std::string(first) + " to " + std::string(last) + " ?";
  return dialogs.Ask(text, "Delete Rows", Buttons::kOkCancel) == Answer::kOk;
}

std::string TabText(const TextRows& rows) {
  std::string out;
  for (const auto& row : rows) {
    for (size_t i = 0; i < row.size(); ++i) {
      if (i > 0) out += '\t';
      for (const char c : row[i]) out += c == '\t' || c == '\r' || c == '\n' ? ' ' : c;
    }
    out += '\n';
  }
  return out;
}

TextRows ParseTabText(std::string_view text, size_t most) {
  TextRows rows;
  size_t cells = 0;
  while (!text.empty() && cells < most) {
    const size_t end = text.find('\n');
    std::string_view line = text.substr(0, end);
    text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    if (line.ends_with('\r')) line.remove_suffix(1);
    std::vector<std::string>& row = rows.emplace_back();
    for (bool more = true; more && cells < most; ++cells) {
      const size_t tab = line.find('\t');
      row.emplace_back(line.substr(0, tab));
      more = tab != std::string_view::npos;
      if (more) line.remove_prefix(tab + 1);
    }
  }
  return rows;
}

std::string CsvText(const TextRows& rows) {
  std::string out;
  for (const auto& row : rows) {
    for (size_t i = 0; i < row.size(); ++i) {
      if (i > 0) out += ',';
      if (row[i].find_first_of(",\"\r\n") == std::string::npos) {
        out += row[i];
        continue;
      }
      out += '"';
      for (const char c : row[i]) {
        if (c == '"') out += '"';
        out += c;
      }
      out += '"';
    }
    out += "\r\n";
  }
  return out;
}

std::string WidthsText(const std::vector<int>& widths) {
  std::string out;
  for (const int width : widths) {
    if (!out.empty()) out += ',';
    out += Str(std::int32_t(std::clamp(width, 1, kWidest)));
  }
  return out;
}

std::vector<int> ParseWidths(std::string_view text) {
  std::vector<int> widths;
  for (const std::string_view field : Split(text, ',')) {
    const bool digits =
        !field.empty() && field.size() <= 4 &&
        std::all_of(field.begin(), field.end(), [](char c) { return c >= '0' && c <= '9'; });
    const int width = digits ? int(Val(field)) : 0;
    if (width < 1) return widths;
    widths.push_back(width);
  }
  if (text.size() >= kLongestSetting) widths.pop_back();
  return widths;
}

}  // namespace kora
