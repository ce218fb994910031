#include "chart/styles/point_figure.h"

#include <algorithm>
#include <cmath>

#include "base/numbers.h"
#include "base/runtime_error.h"

namespace kora {

std::int16_t ReversalOf(std::int16_t spacing) {
  return spacing >= 2 && spacing <= 6 ? spacing : std::int16_t{2};
}

float ComputedBoxValue(float scaleLow, float scaleHigh, std::int16_t rows) {
  const double value = Divide(double(scaleHigh) - double(scaleLow), rows);
  return CSng(RoundHalfEven(value * 1000) / 1000);
}

// The most boxes whose last one is not beyond the close.
std::int32_t PFColumns::BoxesTo(double Close) const {
  const double box = BoxValue_, move = std::abs(Close - Level_);
  double n = std::floor(move / box);
  // A column that long is refused by whoever counts it; a quotient at the edge of a box is put
  // right by the comparison that a box-by-box walk makes.
  if (!(n <= kMostBoxes)) throw RunTimeError(kOverflow);
  const auto reaches = [&](double boxes) {
    return Close < Level_ ? Close <= Level_ - boxes * box : Close >= Level_ + boxes * box;
  };
  while (n > 0 && !reaches(n)) --n;
  while (reaches(n + 1)) ++n;
  return static_cast<std::int32_t>(n);
}

std::optional<PFMove> PFColumns::Add(float Close) {
  using Way = PFMove::Way;
  if (Close == 0) return std::nullopt;
  if (!Direction_) {
    Direction_ = Way::kFirst;
    Level_ = Close;
    return PFMove{Way::kFirst, true, Level_, 1};
  }
  if (!(Close < Level_) && !(Close > Level_)) return std::nullopt;
  const Way way = Close < Level_ ? Way::kDown : Way::kUp;
  const std::int32_t boxes = BoxesTo(Close);
  if (boxes == 0) return std::nullopt;
  PFMove move{way, false, Level_, boxes};
  if (*Direction_ != Way::kFirst && *Direction_ != way) {
    if (boxes < Reversal_) return std::nullopt;
    if (ColumnFill_ != 2) {
      move.newColumn = true;
      ColumnFill_ = 1;
    }
  }
  ColumnFill_ += boxes;
  if (ColumnFill_ > kMostBoxes) throw RunTimeError(kOverflow);
  Level_ = move.LevelOf(boxes, BoxValue_);
  Direction_ = way;
  return move;
}

std::vector<PFColumn> ColumnsOf(std::span<const float> closes, float boxValue,
                                std::int16_t reversal, std::int32_t* at) {
  std::vector<PFColumn> columns;
  PFColumns builder(boxValue, reversal);
  for (size_t i = 0; i < closes.size(); ++i) {
    const auto index = static_cast<std::int32_t>(i);
    if (at) *at = index;
    const auto move = builder.Add(closes[i]);
    if (!move) continue;
    if (move->newColumn) columns.push_back({index, {}});
    columns.back().moves.push_back(*move);
  }
  return columns;
}

std::int32_t FirstColumnShown(std::int32_t columns, std::int32_t fit) {
  constexpr std::int32_t kSpare = 10;
  return std::clamp(columns - (fit - kSpare), 1, std::max(columns, 1));
}

}  // namespace kora
