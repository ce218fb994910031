#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "chart/composition.h"
#include "platform/surface.h"

// What the pointer reads from a chart: the one mapping between chart units and data, the texts
// of the status bar, and the cross hair. All of it works on what the composition left; a mouse
// move composes nothing and reads no script.

namespace kora {

// ---- The mapping

// The column nearest to `x`, half to even, never beyond the last bar; below 0 left of the chart.
std::int32_t ColumnOf(const Composition& chart, double x);
// Where column `c` stands.
double XOfColumn(const Composition& chart, std::int32_t column);

// The price at `y` of a bar, candle or line chart, to two decimals, below 0.30 to three. 0 for
// what can't be computed.
double PixelToPrice(const Composition& chart, double y);
// The y of a price there; 0 for what can't be computed, such as a price of 0 on a logarithmic
// scale or a y beyond 16 bits.
std::int16_t PriceToPixel(const Composition& chart, double price);

// The boxes of a point-and-figure chart.
struct PFBoxes {
  float PFBoxSize = 0;           // price
  std::int16_t PFBoxPixels = 0;  // chart units
};
// The price of the row at `y`, and the y of the row nearest to a price; 0 for what can't be
// computed.
double PFPixelToPrice(const Composition& chart, const PFBoxes& boxes, double y);
std::int16_t PFPriceToPixel(const Composition& chart, const PFBoxes& boxes, double price);

// ---- The status bar

// The format of a price read from a point-and-figure chart.
std::string_view ReadoutFormat(std::int16_t RecType);

// Texts of the status panels 3 to 8.
using ReadoutTexts = std::array<std::string, 6>;
// What the panels show for a column. Nothing where its bar has no date, or is not there: the
// panels keep what they have.
std::optional<ReadoutTexts> BarReadout(const Composition& chart, std::int16_t RecType,
                                       std::int32_t column);

// ---- The cross hair

// Where a cross hair may stand, and how far its lines reach.
struct CrossLimits {
  std::int16_t Left = 0, Right = 0, Top = 0, Bottom = 0;
  bool Columns = true;  // false on point-and-figure charts: no vertical lines
  std::int16_t PanelTop = 0, PanelBottom = 0;

  bool Holds(double x, double y) const {
    return x >= Left && x <= Right && y >= Top && y <= Bottom;
  }
};
// The limits of a chart. The lower one is VolBottom, the lowest y of the whole plot with its
// volume panel. Two charts in one picture begin at `panelTop`; that is also where the lines of
// an oscillator picture begin.
CrossLimits LimitsOf(const Composition& chart, char ChartStyle, bool SplitShown = false,
                     std::int16_t panelTop = 0, std::int16_t panelBottom = 0);

// A line from the left edge to the pointer, one from there down, and one over the whole height
// of the oscillator picture, drawn by XOR, so that drawing them again brings the picture back.
// What was drawn is remembered line by line, so that it goes even after a recomposition has
// moved the limits.
class CrossHair {
 public:
  // `panel` is null where no oscillator shows. Neither is owned.
  CrossHair(Surface& price, Surface* panel, Colour colour)
      : price_(price), panel_(panel), colour_(colour) {}

  // Takes the cross hair from where it stands to (x, y). Outside the limits there is none;
  // false then.
  bool Move(double x, double y, const CrossLimits& limits);
  void Erase();
  // The pictures were painted afresh: there is nothing to erase.
  void Forget() { lines_.clear(); }

  bool Drawn() const { return !lines_.empty(); }
  // Called for each line as it is drawn or taken away, so that only there a picture is shown
  // anew. May be empty.
  std::function<void(const Surface&, double x1, double y1, double x2, double y2)> Touched;

  double GridX() const { return x_; }
  double GridY() const { return y_; }

 private:
  struct DrawnLine {
    Surface* surface;
    double x1, y1, x2, y2;
  };
  void Flip() const;

  Surface& price_;
  Surface* panel_;
  Colour colour_;
  std::vector<DrawnLine> lines_;
  double x_ = 0, y_ = 0;  // 0: none drawn
};

}  // namespace kora
