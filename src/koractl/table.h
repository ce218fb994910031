#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace kora {

// A table for standard output: a header line, then lines of cells with tabs between. It is
// gathered whole, so that a failure half-way leaves no half table.
class Table {
 public:
  // Column names with blanks between.
  explicit Table(std::string_view columns);
  // Names that have blanks themselves.
  explicit Table(const std::vector<std::string>& columns);

  // ANSI text of a file: right blanks cut, what would break the line made a blank.
  Table& Text(std::string_view ansi);
  Table& Number(std::int32_t value);
  Table& Number(float value);
  void EndRow();
  // A line "# ..." of figures about the table.
  void Note(std::string_view text);

  // Writes the table. Error 61 or 57 when standard output does not take it.
  void Print() const;

 private:
  void Separate();

  std::string text_;
  bool first_ = true;
};

// Writes bytes to standard output as they are. Errors as Table::Print.
void WriteOut(std::string_view bytes);

}  // namespace kora
