#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "lists/grid_rows.h"

// Where a grid takes its rows from.

namespace kora {

// What is told where a text is not taken. Without a text nothing is, and the cell goes back to what
// it was.
struct Refusal {
  std::string text, title;
};

// How a row or a cell stands out. Which colour that is follows the palette of the screen.
enum class GridShade {
  kNone,
  kDone,    // carried out: green behind the text
  kMarked,  // something to look at: yellow behind it
  kFaint,   // left out: the text of disabled things
  kFall,    // a fall: red text
};

struct GridColumn {
  std::string heading;  // UTF-8; "\n" between its lines
  int chars = 10;       // width at first, in characters of average width
  bool right = false;   // numbers stand to the right
  bool hidden = false;  // neither shown nor copied, saved or printed
  bool editable = true;
  int limit = 0;            // characters that can be typed, 0 for any number
  std::string typing = {};  // a regular expression: what can be typed; empty for anything
};

// The rows of a grid, numbered from 0. A grid asks for the cells that it shows and for no others,
// so that a source can read them from a file as they are wanted. Texts are UTF-8.
//
// A source is used by one thread. What its calls throw goes to the one who called the grid; for
// what the user does in the grid that is the grid itself, which tells a RunTimeError by its text.
class GridSource {
 public:
  virtual ~GridSource() = default;

  virtual int RowCount() const = 0;
  virtual std::string Text(int row, int column) const = 0;
  virtual GridShade Shade(int /*row*/, int /*column*/) const { return GridShade::kNone; }
  // What questions call the row: its number from 1 unless the source knows a better name.
  virtual std::string RowName(int row) const { return std::to_string(row + 1); }

  // Takes what was typed or pasted, or says why not; nothing has changed then.
  virtual std::optional<Refusal> SetText(int /*row*/, int /*column*/, const std::string& /*text*/) {
    return Refusal{};
  }
  // Why these rows can't be deleted, or nothing. The user has not been asked yet.
  virtual std::optional<Refusal> MayDelete(RowBlock) const { return std::nullopt; }
  virtual void DeleteRows(RowBlock) {}
  // Sorts by a column, as asked by a click on its heading. False: it has no order of that column.
  virtual bool Sort(int /*column*/, bool /*descending*/) { return false; }
};

// Rows that are there as texts, for a grid of no more than some ten thousands.
class TextGrid : public GridSource {
 public:
  struct Row {
    std::vector<std::string> cells;  // those that are missing are empty
    GridShade shade = GridShade::kNone;
  };
  std::vector<Row> rows;
  // Looks at a text before it is taken, and may change it: "ore" to "ORE".
  std::function<std::optional<Refusal>(int row, int column, std::string& text)> check = {};
  std::function<GridShade(int row, int column)> shade = {};  // in place of the row's own
  std::function<std::string(int row)> rowName = {};

  int RowCount() const override { return int(rows.size()); }
  std::string Text(int row, int column) const override {
    const auto& cells = rows[size_t(row)].cells;
    return size_t(column) < cells.size() ? cells[size_t(column)] : std::string();
  }
  GridShade Shade(int row, int column) const override {
    return shade ? shade(row, column) : rows[size_t(row)].shade;
  }
  std::string RowName(int row) const override {
    return rowName ? rowName(row) : GridSource::RowName(row);
  }
  std::optional<Refusal> SetText(int row, int column, const std::string& text) override {
    std::string taken = text;
    if (check)
      if (auto refusal = check(row, column, taken)) return refusal;
    Set(row, column, std::move(taken));
    return std::nullopt;
  }
  void DeleteRows(RowBlock block) override { RemoveBlock(rows, block); }

  // Without a check.
  void Set(int row, int column, std::string text) {
    auto& cells = rows[size_t(row)].cells;
    if (cells.size() <= size_t(column)) cells.resize(size_t(column) + 1);
    cells[size_t(column)] = std::move(text);
  }
};

}  // namespace kora
