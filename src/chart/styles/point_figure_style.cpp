#include <algorithm>
#include <optional>
#include <vector>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "chart/scale_drawing.h"
#include "chart/styles/point_figure.h"
#include "chart/styles/price_plot.h"

namespace kora {
namespace {

using Way = PFMove::Way;

class PointFigure {
 public:
  explicit PointFigure(const StyleWork& work)
      : work_(work), canvas_(work.canvas), chart_(canvas_.chart), pen_(canvas_.pen) {}

  void Run();

 private:
  float ChooseBoxValue() const;
  void DrawFrame();
  void DrawScale();
  std::string ScaleLabel(int i) const;
  void MakeLabelRoom();
  std::int32_t FirstBar(std::int16_t reversal) const;
  void DrawMove(const PFMove& move);
  void DrawBox(double level, Way way);
  void NextColumn();
  void WrapIfFull();

  const StyleWork& work_;
  const ChartCanvas& canvas_;
  Composition& chart_;
  ChartPen& pen_;
  std::int16_t rows_ = 0;
  float BoxValue_ = 0;
  size_t plotMark_ = 0;  // of the script, where the plot begins
  std::int16_t x_ = 0;
  bool yearMark_ = false;  // the next box is the first one of a year
  std::optional<DateAxis> axis_;
};

float PointFigure::ChooseBoxValue() const {
  const ChartRequest& request = canvas_.request;
  const float computed = ComputedBoxValue(chart_.Scale.ScaleLow, chart_.Scale.ScaleHigh, rows_);
  if (request.PFAutoBox) return computed;
  if (request.PFBoxSize != 0) return request.PFBoxSize;
  if (!request.AutoScale) return request.Name.PFInc != 0 ? request.Name.PFInc : computed;
  return work_.AskBoxValue ? work_.AskBoxValue(computed) : computed;
}

void PointFigure::Run() {
  SetUpRange(canvas_, true);
  rows_ = CInt((chart_.VolBottom - chart_.ChartTop) / double(kBoxPitch));
  BoxValue_ = std::max(ChooseBoxValue(), kLeastBoxValue);
  chart_.Boxes = {BoxValue_, kBoxPitch};
  chart_.Price.Logarithmic = false;
  chart_.Price.ScaleLow = chart_.Scale.ScaleLow;
  chart_.Price.PricePerY = CSng(double(BoxValue_) / kBoxPitch);
  chart_.Price.ChartBottom = chart_.ChartBottom;

  MakeLabelRoom();
  plotMark_ = pen_.ScriptMark();
  DrawScale();
  DrawFrame();
  const std::int16_t reversal = ReversalOf(canvas_.request.BarSpacing);
  PFColumns columns(BoxValue_, reversal);
  x_ = CInt(chart_.ChartLeft + kBoxPitch + 1.0);
  axis_.emplace(canvas_, true);
  for (std::int32_t i = FirstBar(reversal); i <= chart_.Bars.BarCount; ++i) {
    const ChartBar& bar = chart_.Bars[static_cast<size_t>(i)];
    work_.barDate = bar.date();
    if (bar.Close == 0) continue;
    WrapIfFull();
    if (axis_->Bar(bar.date(), x_)) yearMark_ = true;
    if (const auto move = columns.Add(bar.Close)) DrawMove(*move);
  }
  chart_.LastBarX = x_;
}

// A dry run over the whole file finds the bar from which on the columns have room.
std::int32_t PointFigure::FirstBar(std::int16_t reversal) const {
  std::vector<float> closes;
  closes.reserve(size_t(chart_.Bars.BarCount) + 1);
  for (int i = 0; i <= chart_.Bars.BarCount; ++i)
    closes.push_back(chart_.Bars[static_cast<size_t>(i)].Close);
  std::int32_t at = 0;
  std::vector<PFColumn> columns;
  try {
    columns = ColumnsOf(closes, BoxValue_, reversal, &at);
  } catch (const RunTimeError&) {
    work_.barDate = chart_.Bars[size_t(at)].date();
    throw;
  }
  if (columns.empty()) return 0;
  const std::int16_t fit =
      CInt((double(chart_.ChartRight) - chart_.ChartLeft - canvas_.request.BlankSpace) / kBoxPitch);
  return columns[size_t(FirstColumnShown(std::int32_t(columns.size()), fit)) - 1].start;
}

void PointFigure::DrawFrame() {
  pen_.Box('B', {double(chart_.ChartLeft), double(chart_.ChartTop), double(chart_.ChartRight),
                 double(chart_.ChartBottom), canvas_.colour(kBorder)});
}

std::string PointFigure::ScaleLabel(int i) const {
  const double v = double(BoxValue_) * i * (rows_ / 12) + double(chart_.Scale.ScaleLow);
  const char* format = canvas_.request.Name.RecType == kShare ? "####.00" : "######";
  return Format(v, v > 0 && v < 0.1 ? ".00#" : format);
}

void PointFigure::MakeLabelRoom() {
  if (!canvas_.request.Legible || IsSuperimposed(canvas_.request.Place)) return;
  const SurfaceFont font = canvas_.Font1(ChartCanvas::kSmallText);
  double widest = 0;
  for (int i = 0; i <= 12; ++i) widest = std::max(widest, canvas_.TextWidth(font, ScaleLabel(i)));
  chart_.ChartLeft = chart_.FirstBarX = LeftOfLabel(canvas_, widest);
  chart_.PlotWidth = double(chart_.ChartRight) - chart_.ChartLeft - canvas_.request.BlankSpace;
}

void PointFigure::DrawScale() {
  const ChartRequest& request = canvas_.request;
  const Colour border = canvas_.colour(kBorder), text = canvas_.colour(kScalesText);
  const double left = chart_.ChartLeft, right = chart_.ChartRight;
  const SurfaceFont font = canvas_.Font1(ChartCanvas::kSmallText);
  for (int i = 0; i <= 12; ++i) {
    const double y = chart_.ChartBottom - double(rows_ / 12) * kBoxPitch * i;
    pen_.Line('L', {left, y, left - 5, y, border});
    if (request.GridLines && i > 0 && y > chart_.ChartTop)
      pen_.Line('V', {left, y, right, y, canvas_.colour(kFixedGrid)});
    const std::string label = ScaleLabel(i);
    const double x = left - 5 - canvas_.TextWidth(font, label);
    const double small = ChartCanvas::kSmallText;
    const double size = request.ScriptPrintMode ? canvas_.fonts.TitleSize : small;
    pen_.Text('T', font, {small, x, y - 6, label, text}, {size, x, y - 6, label, text});
  }
  // Paper has the period and mode of other charts there, and room further right.
  const std::string value = "Box Value = " + Str(BoxValue_);
  const double y = chart_.ChartTop - 16.0, size = ChartCanvas::kSmallText;
  pen_.Text('T', font, {size, 250, y, value, border}, {size, 300, y, value, border});
}

void PointFigure::DrawMove(const PFMove& move) {
  if (move.newColumn && move.way != Way::kFirst) NextColumn();
  if (move.way == Way::kFirst) {
    DrawBox(move.Level, move.way);
    return;
  }
  for (std::int32_t n = 1; n <= move.boxes; ++n) DrawBox(move.LevelOf(n, BoxValue_), move.way);
}

void PointFigure::DrawBox(double level, Way way) {
  const std::int16_t row = CInt((level - double(chart_.Scale.ScaleLow)) / double(BoxValue_));
  const std::int16_t y = CInt(chart_.ChartBottom - double(kBoxPitch) * row);
  Segment box{double(x_) - kBoxHalf, double(y) - kBoxHalf, double(x_) + kBoxHalf,
              double(y) + kBoxHalf, canvas_.LineColour()};
  if (way == Way::kFirst) {
    pen_.FilledBox('B', box, box);
  } else if (yearMark_) {
    box.colour = canvas_.colour(kScalesText);
    pen_.FilledBox('B', box, box);
    yearMark_ = false;
  } else if (way == Way::kDown) {
    box.colour = canvas_.colour(kCandleDown);
    pen_.Box('X', box);
  } else {
    pen_.Box('B', box);
  }
}

void PointFigure::NextColumn() {
  x_ = CInt(double(x_) + kBoxPitch);
  WrapIfFull();
}

// With the frame full, columns go on from its left edge. What was drawn is painted over, and
// leaves the script with it: paper shows what the screen shows.
void PointFigure::WrapIfFull() {
  const std::int16_t first = CInt(chart_.ChartLeft + kBoxPitch + 1.0);
  if (x_ <= chart_.ChartRight - 8 || x_ == first) return;
  chart_.FirstBarX = CInt(chart_.ChartLeft + double(kBoxPitch));
  x_ = first;
  Surface& surface = pen_.surface();
  surface.FilledBox(chart_.ChartLeft + 1.0, chart_.ChartTop + 1.0, chart_.ChartRight + 1.0,
                    surface.ScaleHeight() - 2, canvas_.colour(kBackground));
  pen_.CutScript(plotMark_);
  DrawFrame();
  DrawScale();
  axis_.emplace(canvas_, true);
}

}  // namespace

void DrawPointFigure(const StyleWork& work) { PointFigure(work).Run(); }

}  // namespace kora
