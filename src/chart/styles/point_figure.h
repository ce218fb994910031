#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

// The columns of a point-and-figure chart, as figures: what is drawn stands on them.

namespace kora {

inline constexpr std::int16_t kBoxHalf = 2;                  // chart units from a box's middle
inline constexpr std::int16_t kBoxPitch = 2 * kBoxHalf + 2;  // from box to box, both ways
inline constexpr float kLeastBoxValue = 0.003f;
inline constexpr std::int32_t kMostBoxes = 32767;  // of a column, the first not counted

// Boxes that make a reversal: 2 for a figure outside 2 to 6.
std::int16_t ReversalOf(std::int16_t spacing);

// The box value that puts a range on `rows` rows, to three decimals. Error 11 for no rows.
float ComputedBoxValue(float scaleLow, float scaleHigh, std::int16_t rows);

// What one close adds: boxes one above the other, or below.
struct PFMove {
  enum class Way { kFirst, kUp, kDown };
  Way way;             // kFirst: the one box at the first close, which has no way
  bool newColumn;      // they stand beside the boxes before
  double Level;        // price of the box before the first of them; of the box itself for kFirst
  std::int32_t boxes;  // 1 and above

  // Price of the box `n`, from 1.
  double LevelOf(std::int32_t n, float BoxValue) const {
    return way == Way::kUp     ? Level + n * double(BoxValue)
           : way == Way::kDown ? Level - n * double(BoxValue)
                               : Level;
  }
};

// Takes closes one by one. A close of 0 is none. A move against the column needs `reversal`
// boxes and goes into a new column; but beside a single box it goes in its column.
class PFColumns {
 public:
  PFColumns(float boxValue, std::int16_t reversal) : BoxValue_(boxValue), Reversal_(reversal) {}

  // What the close adds; nothing where it moved by less than a box, or than a reversal.
  // Error 6 where a column has more than 32,767 boxes.
  std::optional<PFMove> Add(float Close);

 private:
  std::int32_t BoxesTo(double Close) const;

  float BoxValue_;
  std::int16_t Reversal_;
  double Level_ = 0;
  std::optional<PFMove::Way> Direction_;  // kFirst until a column has run
  std::int32_t ColumnFill_ = 1;
};

// A column: what its closes added, in order.
struct PFColumn {
  std::int32_t start;  // index of the close at which it began
  std::vector<PFMove> moves;
};
// The columns of closes. `at`, where given, follows the close in hand, for the message where one
// fails.
std::vector<PFColumn> ColumnsOf(std::span<const float> closes, float boxValue,
                                std::int16_t reversal, std::int32_t* at = nullptr);

// Which of `columns` columns, from 1, a chart begins with on which `fit` would have room: so
// that the latest ones show and ten stay free.
std::int32_t FirstColumnShown(std::int32_t columns, std::int32_t fit);

}  // namespace kora
