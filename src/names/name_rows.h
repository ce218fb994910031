#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "store/name_file.h"

// The rows of the name file editor, and what its menu does to them. A row is a whole record: what
// no cell shows (bands, spare bytes, odd bytes behind a text) stays as the file has it.

namespace kora {

enum class NameColumn : std::uint8_t {
  kCode,
  kType,
  kCategory,
  kClass,
  kName,
  kDetails,
  kBase,
  kTop,
  kPFInc,
  kId,
};
inline constexpr int kNameColumns = 10;

// A row without anything in it: it is not saved.
NameRec EmptyNameRow();
bool IsEmptyNameRow(const NameRec& row);

// The text of a cell, UTF-8: class in the form "000"; a scale, a type or a box of 0 is empty; a
// category of 0 is empty in an empty row alone.
std::string NameCell(const NameRec& row, NameColumn column);

// Puts a typed text into a cell. Nothing changes where it is refused: then the message. The text
// that the cell shows already leaves the record's bytes as they are.
std::optional<std::string> PutNameCell(NameRec& row, NameColumn column, std::string_view text);

// In sorted order, rows with NameStatus 1 dropped, empty rows behind the others.
void SortNameRows(std::vector<NameRec>& rows, NameSort mode);
bool IsSortedByCode(const std::vector<NameRec>& rows);

// A code of exactly six characters in a category from 80 to 89.
bool IsWarrantRow(const NameRec& row);
// Takes the warrants out and returns how many there were. Fewer than 2 rows are left alone.
int RemoveWarrantRows(std::vector<NameRec>& rows);

// Of neighbours with one code the first stays; the number of those taken out.
int RemoveDuplicateRows(std::vector<NameRec>& rows);

// Gives each row with a code of more than 3 characters and no class the class of the first row
// whose code is its first 3. Fewer than 3 rows are left alone. The number of rows changed.
int UpdateIC_from_Stock(std::vector<NameRec>& rows);

// Empties Base, Top and PFInc of all rows; the number of rows changed.
int CleanOptionalCells(std::vector<NameRec>& rows);

// Empties the rows whose trimmed name is "**EXPIRED**"; they are left out by the next save.
int EmptyExpiredRows(std::vector<NameRec>& rows);

// First letters, and letters behind a blank, in upper case, all others in lower.
std::string TitleCase(std::string_view name);
int TitleCaseNames(std::vector<NameRec>& rows);

}  // namespace kora
