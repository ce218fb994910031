#include "names/name_rows.h"

#include <algorithm>
#include <cmath>
#include <unordered_map>

#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr std::string_view kExpired = "**EXPIRED**";

std::string NumberCell(float value) { return value == 0 ? std::string() : Str(value); }

// A whole number between the two; an empty text is `empty`.
std::optional<std::int16_t> WholeBetween(std::string_view text, int low, int high,
                                         std::int16_t empty) {
  if (text.empty()) return empty;
  const std::optional<float> value = ParseFloat(text);
  if (!value || *value != std::floor(*value) || *value < float(low) || *value > float(high))
    return std::nullopt;
  return CInt(*value);
}

// What is wrong with a text for a field of `size` bytes.
std::optional<std::string> TextFault(std::string_view text, size_t size, std::string_view what) {
  const std::string ansi = ToAnsi(text);
  const bool control = std::any_of(text.begin(), text.end(),
                                   [](char c) { return static_cast<unsigned char>(c) < 0x20; });
  if (control || FromAnsi(ansi) != text)
    return "There are characters in the " + std::string(what) + " that cannot be stored";
  if (ansi.size() > size)
    return "The " + std::string(what) + " can have " + Str(std::int32_t(size)) + " characters";
  return std::nullopt;
}

template <size_t N>
std::optional<std::string> PutText(FixedText<N>& field, std::string_view text,
                                   std::string_view what) {
  if (text.find(',') != std::string_view::npos)
    return "Commas NOT to be used in Name or Other Details columns";
  if (auto fault = TextFault(text, N, what)) return fault;
  field.set(ToAnsi(text));
  return std::nullopt;
}

std::string CodeOf(const NameRec& row) { return std::string(Trim(row.Code.trimmed())); }

}  // namespace

NameRec EmptyNameRow() {
  NameRec row{};
  row.Code.set("");
  row.Name.set("");
  row.OtherDetails.set("");
  row.Id.set("");
  row.IndClass.set("");
  row.NameSpare.set("");
  return row;
}

bool IsEmptyNameRow(const NameRec& row) {
  for (int i = 0; i < kNameColumns; ++i)
    if (NameColumn(i) != NameColumn::kCategory && !NameCell(row, NameColumn(i)).empty())
      return false;
  return row.Category == 0;
}

std::string NameCell(const NameRec& row, NameColumn column) {
  switch (column) {
    case NameColumn::kCode: return FromAnsi(Trim(row.Code.trimmed()));
    case NameColumn::kType:
      return row.RecType == 0 ? std::string() : Str(std::int32_t(row.RecType));
    case NameColumn::kCategory:
      if (row.Category == 0 && IsEmptyNameRow(row)) return {};
      return Str(std::int32_t(row.Category));
    case NameColumn::kClass: {
      const std::string_view text = Trim(row.IndClass.trimmed());
      return text.empty() ? std::string() : Format(Val(text), "000");
    }
    case NameColumn::kName: return FromAnsi(Trim(row.Name.trimmed()));
    case NameColumn::kDetails: return FromAnsi(Trim(row.OtherDetails.trimmed()));
    case NameColumn::kBase: return NumberCell(row.Base);
    case NameColumn::kTop: return NumberCell(row.Top);
    case NameColumn::kPFInc: return NumberCell(row.PFInc);
    case NameColumn::kId: return FromAnsi(Trim(row.Id.trimmed()));
  }
  return {};
}

std::optional<std::string> PutNameCell(NameRec& row, NameColumn column, std::string_view typed) {
  const std::string_view text = Trim(typed);
  if (text == NameCell(row, column)) return std::nullopt;
  switch (column) {
    case NameColumn::kCode: {
      const std::string code = KeptCode(UCase(text));
      if (!code.empty() && !IsFileCode(code)) return "Code cannot be used for a data file";
      row.Code.set(code);
      return std::nullopt;
    }
    case NameColumn::kType: {
      const auto type = WholeBetween(text, kCloseVolume, kIndex, 0);
      if (!type) return "Record Type must be either 1,2,3,4 or 5";
      row.RecType = *type;
      return std::nullopt;
    }
    case NameColumn::kCategory: {
      const auto category = WholeBetween(text, 0, 99, 0);
      if (!category) return "Category range 0 - 99";
      row.Category = *category;
      return std::nullopt;
    }
    case NameColumn::kClass: {
      const auto id = WholeBetween(text, 0, 999, -1);
      if (!id) return "Industry Classification range 0  to 999";
      row.IndClass.set(*id < 0 ? std::string() : Format(double(*id), "000"));
      return std::nullopt;
    }
    case NameColumn::kName: return PutText(row.Name, text, "name");
    case NameColumn::kDetails: return PutText(row.OtherDetails, text, "details");
    case NameColumn::kBase:
    case NameColumn::kTop:
    case NameColumn::kPFInc: {
      const std::optional<float> value = text.empty() ? 0.0f : ParseFloat(text);
      if (!value) return "Must be numeric";
      if (column == NameColumn::kBase)
        row.Base = *value;
      else if (column == NameColumn::kTop)
        row.Top = *value;
      else
        row.PFInc = *value;
      return std::nullopt;
    }
    case NameColumn::kId: {
      const std::string id = UCase(text);
      if (auto fault = TextFault(id, 1, "Id")) return fault;
      row.Id.set(ToAnsi(id));
      return std::nullopt;
    }
  }
  return std::nullopt;
}

void SortNameRows(std::vector<NameRec>& rows, NameSort mode) {
  const auto filled = std::stable_partition(
      rows.begin(), rows.end(), [](const NameRec& row) { return !IsEmptyNameRow(row); });
  std::vector<NameRec> sorted =
      SortedNames(std::span(rows.data(), size_t(filled - rows.begin())), mode);
  sorted.insert(sorted.end(), filled, rows.end());
  rows = std::move(sorted);
}

bool IsSortedByCode(const std::vector<NameRec>& rows) {
  std::string last;
  for (const NameRec& row : rows) {
    if (IsEmptyNameRow(row)) continue;
    std::string key = SortKey(row, NameSort::kCode);
    if (key < last) return false;
    last = std::move(key);
  }
  return true;
}

bool IsWarrantRow(const NameRec& row) {
  return CodeOf(row).size() == 6 && row.Category >= 80 && row.Category <= 89;
}

int RemoveWarrantRows(std::vector<NameRec>& rows) {
  return rows.size() < 2 ? 0 : int(std::erase_if(rows, IsWarrantRow));
}

int RemoveDuplicateRows(std::vector<NameRec>& rows) {
  const size_t before = rows.size();
  rows.erase(std::unique(rows.begin(), rows.end(),
                         [](const NameRec& a, const NameRec& b) {
                           const std::string code = CodeOf(a);
                           return !code.empty() && code == CodeOf(b);
                         }),
             rows.end());
  return int(before - rows.size());
}

int UpdateIC_from_Stock(std::vector<NameRec>& rows) {
  if (rows.size() < 3) return 0;
  std::unordered_map<std::string, size_t> first;
  for (size_t i = 0; i < rows.size(); ++i) first.try_emplace(CodeOf(rows[i]), i);
  int changed = 0;
  for (NameRec& row : rows) {
    const std::string code = CodeOf(row);
    if (code.size() <= 3 || !Trim(row.IndClass.trimmed()).empty()) continue;
    const auto stock = first.find(code.substr(0, 3));
    if (stock == first.end() || Trim(rows[stock->second].IndClass.trimmed()).empty()) continue;
    row.IndClass = rows[stock->second].IndClass;
    ++changed;
  }
  return changed;
}

int CleanOptionalCells(std::vector<NameRec>& rows) {
  int changed = 0;
  for (NameRec& row : rows) {
    if (row.Base == 0 && row.Top == 0 && row.PFInc == 0) continue;
    row.Base = row.Top = row.PFInc = 0;
    ++changed;
  }
  return changed;
}

int EmptyExpiredRows(std::vector<NameRec>& rows) {
  int changed = 0;
  for (NameRec& row : rows) {
    if (Trim(row.Name.trimmed()) != kExpired) continue;
    row = EmptyNameRow();
    ++changed;
  }
  return changed;
}

std::string TitleCase(std::string_view name) {
  const std::string_view text = Trim(name);
  std::string out = LCase(text);
  const std::string upper = UCase(text);
  for (size_t i = 0; i < out.size(); ++i)
    if (i == 0 || out[i - 1] == ' ') out[i] = upper[i];
  return out;
}

int TitleCaseNames(std::vector<NameRec>& rows) {
  int changed = 0;
  for (NameRec& row : rows) {
    const std::string_view name = Trim(row.Name.trimmed());
    const std::string cased = TitleCase(name);
    if (name.empty() || name == cased) continue;
    row.Name.set(cased);
    ++changed;
  }
  return changed;
}

}  // namespace kora
