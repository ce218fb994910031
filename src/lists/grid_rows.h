#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

// What grids of rows do without a window: order, blocks of rows, text that leaves and enters.

namespace kora {

class Dialogs;

// Rows `first` to `last`, both within, numbered from 0.
struct RowBlock {
  int first = 0;
  int last = -1;
  int count() const { return last - first + 1; }
  friend bool operator==(const RowBlock&, const RowBlock&) = default;
};

// Which row of a source stands at which place of a grid. In the beginning each stands at its own.
class RowOrder {
 public:
  explicit RowOrder(int count = 0);

  int count() const { return int(rows_.size()); }
  int operator[](int place) const { return rows_[size_t(place)]; }
  // Sorts by the rule; rows that it holds for equal stay as they stand.
  void Sort(const std::function<bool(int a, int b)>& before);
  void Reverse();
  // Takes the rows at these places out; what of the block lies outside is passed over.
  void Remove(RowBlock places);

 private:
  std::vector<std::int32_t> rows_;
};

// Takes a block of rows out of any vector of rows; what of it lies outside is passed over.
template <typename Row>
void RemoveBlock(std::vector<Row>& rows, RowBlock block) {
  const int first = block.first < 0 ? 0 : block.first;
  const int last = block.last >= int(rows.size()) ? int(rows.size()) - 1 : block.last;
  if (first <= last) rows.erase(rows.begin() + first, rows.begin() + last + 1);
}

// Asks under "Delete Rows", OK or Cancel, whether rows may go: "Delete row ORE ?" for one,
// "Delete items 3 to 7 ?" for several.
bool AskDeleteRows(Dialogs& dialogs, int count, std::string_view first, std::string_view last);

using TextRows = std::vector<std::vector<std::string>>;  // UTF-8

// For the clipboard: cells separated by tabs, each row ended by a line feed. A tab or a line end
// within a cell becomes a blank.
std::string TabText(const TextRows& rows);
// The same back, with any line ends, the last one optional; at most `most` cells in all.
TextRows ParseTabText(std::string_view text, size_t most = 1'000'000);
// For a spreadsheet: cells separated by commas, rows ended by CR LF; a cell with a comma, a quote
// or a line end stands in quotes, quotes within it doubled.
std::string CsvText(const TextRows& rows);

// Column widths as one value of a settings file: whole numbers with commas between.
std::string WidthsText(const std::vector<int>& widths);
// The same back, up to the first text that is no width (1 to 9999). A value of 60 characters was
// cut by the settings file, so that its last number does not count.
std::vector<int> ParseWidths(std::string_view text);

}  // namespace kora
