#include "chartwindow/tools/zoom_chart.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/text.h"
#include "chartwindow/tools/read_out.h"

namespace kora {
namespace {

constexpr int kDefaultPeriod = 10;
constexpr double kSmallText = 8.25;
constexpr double kVolumeShare = 0.15;  // of the frame's height, at its foot
constexpr double kMostGridLines = 9;

class Zoom {
 public:
  Zoom(Surface& surface, const Composition& chart, const ChartRequest& request,
       const ChartColours& colours, const FontSettings& fonts, const ZoomBox& box)
      : surface_(surface),
        chart_(chart),
        request_(request),
        colours_(colours),
        fonts_(fonts),
        box_(box) {}

  void Draw();

 private:
  const ChartBar& Bar(std::int32_t column) const { return chart_.Bars[size_t(column)]; }
  Colour colour(int entry) const { return colours_[size_t(entry)]; }
  double X(std::int32_t column) const {
    return left_ + double(column - columns_.first + 1) * columns_.step;
  }
  double Y(double price) const;
  void Line(double x, double y1, double y2, Colour colour) const;
  void Level(double x1, double x2, double y, Colour colour) const;
  void Text(double x, double y, std::string_view text, Colour colour) const;
  void Title() const;
  void PriceAxis() const;
  void DateAxis() const;
  void Volumes() const;
  void Bars() const;
  void Average(std::int16_t period, int entry, int row) const;

  Surface& surface_;
  const Composition& chart_;
  const ChartRequest& request_;
  const ChartColours& colours_;
  const FontSettings& fonts_;
  const ZoomBox& box_;
  ZoomColumns columns_;
  double left_ = 0, right_ = 0, top_ = 0, bottom_ = 0;
};

// The chart's own y of a price, unrounded, and from there to the frame.
double Zoom::Y(double price) const {
  const PriceMap& map = chart_.Price;
  const double y =
      map.Logarithmic
          ? double(map.LogFactor) * (std::log(price) - double(map.LogBase)) + chart_.ChartBottom
          : chart_.ChartBottom - (price - double(map.ScaleLow)) / double(map.PricePerY);
  return top_ + (y - box_.y1) / (box_.y2 - box_.y1) * (bottom_ - top_);
}

// Down the frame, as far as it reaches; nothing of a line outside it.
void Zoom::Line(double x, double y1, double y2, Colour c) const {
  const double from = std::max(std::min(y1, y2), top_), to = std::min(std::max(y1, y2), bottom_);
  if (from <= to) surface_.Line(x, from, x, to, c);
}

void Zoom::Level(double x1, double x2, double y, Colour c) const {
  if (y >= top_ && y <= bottom_) surface_.Line(x1, y, x2, y, c);
}

void Zoom::Text(double x, double y, std::string_view text, Colour c) const {
  surface_.SetForeColour(c);
  surface_.SetCurrent(x, y);
  surface_.Print(text);
}

void Zoom::Title() const {
  const NameRec& name = request_.Name;
  const char* period = request_.ChartPeriod == Period::kWeekly    ? "  WEEKLY"
                       : request_.ChartPeriod == Period::kMonthly ? "  MONTHLY"
                                                                  : "  DAILY";
  surface_.SetFont({fonts_.Font1Name, fonts_.TitleSize, fonts_.Font1Bold, false});
  const auto date = [&](std::int32_t column) {
    return FormatUserDate(ParseFileDate(Bar(column).date()).value_or(CalendarDate{}));
  };
  Text(0, 2,
       "    " + FromAnsi(name.Code.trimmed()) + "    " + FromAnsi(name.Name.trimmed()) + period +
           "  " + date(columns_.first) + " to " + date(columns_.last),
       colour(kScalesText));
}

void Zoom::PriceAxis() const {
  const double high = chart_.Price.Price(box_.y1), low = chart_.Price.Price(box_.y2);
  const double range = high - low;
  if (!(range > 0) || !std::isfinite(range)) return;
  double step = std::pow(10.0, std::floor(std::log10(range)) - 1);
  for (const double factor : {2.0, 2.5, 2.0, 2.0, 2.5})
    if (range / step > kMostGridLines) step *= factor;
  const char* format = step < 0.01 ? "###.00#" : "###.00";
  for (double k = std::ceil(low / step); k * step <= high; ++k) {
    const double y = std::round(Y(k * step));
    if (request_.GridLines) {
      surface_.SetDrawStyle(DrawStyle::kDot);
      Level(left_, right_, y, colour(kFixedGrid));
      surface_.SetDrawStyle(DrawStyle::kSolid);
    }
    if (y < top_ || y > bottom_) continue;
    Level(right_, right_ + 5, y, colour(kBorder));
    Text(right_ + 8, y - surface_.TextHeight() / 2, Format(k * step, format), colour(kScalesText));
  }
}

void Zoom::DateAxis() const {
  double free = 0;  // where the last text ended
  for (std::int32_t c = columns_.first; c <= columns_.last; ++c) {
    const std::string_view date = Bar(c).date();
    const double x = X(c);
    if (c > columns_.first && Bar(c - 1).date().substr(0, 4) != date.substr(0, 4)) {
      surface_.SetDrawStyle(DrawStyle::kDot);
      Line(x, top_, bottom_, colour(kEndOfYear));
      surface_.SetDrawStyle(DrawStyle::kSolid);
    }
    if ((c - columns_.first) % columns_.markEvery != 0) continue;
    surface_.Line(x, bottom_, x, bottom_ + 5, colour(kBorder));
    const std::string text = FormatUserDate(ParseFileDate(date).value_or(CalendarDate{}));
    const double width = surface_.TextWidth(text), at = std::max(2.0, x - width / 2);
    if (at < free) continue;
    Text(at, bottom_ + 8, text, colour(kScalesText));
    free = at + width + 6;
  }
}

void Zoom::Volumes() const {
  if (!chart_.Bars.VolumeShown) return;
  std::int32_t most = 0;
  for (std::int32_t c = columns_.first; c <= columns_.last; ++c)
    most = std::max(most, std::int32_t(Bar(c).Volume));
  if (most <= 0) return;
  const double high = (bottom_ - top_) * kVolumeShare;
  surface_.SetDrawWidth(columns_.lineWidth);
  for (std::int32_t c = columns_.first; c <= columns_.last; ++c)
    if (Bar(c).Volume > 0)
      Line(X(c), bottom_, bottom_ - std::round(high * Bar(c).Volume / most), colour(kVolumeBars));
  surface_.SetDrawWidth(1);
  const double y = bottom_ - high;
  Level(right_, right_ + 5, y, colour(kVolumeBars));
  Text(right_ + 8, y - surface_.TextHeight() / 2, Format(double(most), "######"),
       colour(kVolumeBars));
}

void Zoom::Bars() const {
  const double width = columns_.lineWidth;
  // As far as bars do not touch.
  const double arm = std::max(2.0, std::min(width * 1.5, columns_.step / 2.0 - 1));
  for (std::int32_t c = columns_.first; c <= columns_.last; ++c) {
    const ChartBar& bar = Bar(c);
    if (bar.High == 0) continue;
    const double x = X(c), high = std::round(Y(double(bar.High))),
                 low = std::round(Y(double(bar.Low))), open = std::round(Y(double(bar.Open))),
                 close = std::round(Y(double(bar.Close)));
    const Colour lines = colour(kChartLines);
    if (request_.ChartStyle == Style::kCandlestick) {
      surface_.SetDrawWidth(std::max(1.0, width / 4));
      Line(x, high, low, lines);
      surface_.SetDrawWidth(1);
      const double from = std::max(std::min(open, close), top_),
                   to = std::min(std::max(open, close), bottom_);
      if (from <= to)
        surface_.FilledBox(x - arm, from, x + arm, to, close > open ? colour(kCandleDown) : lines);
      continue;
    }
    surface_.SetDrawWidth(width);
    Line(x, high, low, lines);
    surface_.SetDrawWidth(std::max(1.0, width / 2));
    Level(x - arm, x, open, lines);
    Level(x, x + arm, close, lines);
    surface_.SetDrawWidth(1);
  }
}

// Over the closes of the chart, as far back as it has them, so that the line stands in the zoom
// where it stands on the chart.
void Zoom::Average(std::int16_t period, int entry, int row) const {
  if (period < 1) period = kDefaultPeriod;
  const Colour c = colour(entry);
  Text(left_ + 8, top_ + 4 + row * (surface_.TextHeight() + 2),
       Str(std::int32_t(period)) + " Period Average", c);
  double sum = 0, mean = 0, before = 0;
  for (std::int32_t i = 0; i <= columns_.last; ++i) {
    const double close = double(Bar(i).Close);
    if (i < period) {
      sum += close;
      mean = sum / period;
    } else if (request_.MaExp) {
      const double factor = 2.0 / (period + 1);
      mean = close * factor + mean * (1 - factor);
    } else {
      sum += close - double(Bar(i - period).Close);
      mean = sum / period;
    }
    if (i < period - 1) continue;
    const double y = Y(mean);
    if (i > std::max<std::int32_t>(columns_.first, period - 1) && y >= top_ && y <= bottom_ &&
        before >= top_ && before <= bottom_)
      surface_.Line(X(i - 1), before, X(i), y, c);
    before = y;
  }
}

void Zoom::Draw() {
  const double width = surface_.Width(), height = surface_.Height();
  surface_.SetScale(0, 0, width, height);
  surface_.SetDrawMode(DrawMode::kCopy);
  surface_.SetDrawStyle(DrawStyle::kSolid);
  surface_.SetDrawWidth(1);
  surface_.SetBackColour(colour(kBackground));
  surface_.Cls();
  left_ = std::round(0.02 * width);
  right_ = std::round(0.92 * width);
  top_ = std::round(0.1 * height);
  bottom_ = std::round(0.9 * height);
  columns_ = ZoomColumnsOf(chart_, box_, right_ - left_);
  const auto last = std::int32_t(chart_.Bars.bars.size()) - 1;
  if (columns_.first > columns_.last || columns_.last > last) return;
  Title();
  surface_.SetFont({fonts_.Font1Name, kSmallText, false, false});
  Volumes();
  PriceAxis();
  DateAxis();
  Bars();
  const bool daily = request_.ChartPeriod == Period::kDaily;
  if (request_.Ma1On) Average(daily ? request_.Ma1Days : request_.Ma1Weeks, kAverage2, 0);
  if (request_.Ma2On) Average(daily ? request_.Ma2Days : request_.Ma2Weeks, kAverage3, 1);
  surface_.Box(left_, top_, right_, bottom_, colour(kBorder));
}

}  // namespace

ZoomColumns ZoomColumnsOf(const Composition& chart, const ZoomBox& box, double plotWidth) {
  ZoomColumns columns;
  const std::int32_t bars = chart.Bars.BarCount;
  columns.first = std::max<std::int32_t>(1, ColumnOf(chart, box.x1));
  columns.last = std::min<std::int32_t>(bars, ColumnOf(chart, box.x2));
  // A box left of the first column or in the blank space shows the bar that is nearest.
  columns.first = std::min(columns.first, std::max<std::int32_t>(bars, 0));
  columns.last = std::max(columns.last, columns.first);
  const std::int32_t n = columns.last - columns.first;
  columns.step = std::max<std::int32_t>(1, std::int32_t(plotWidth) / (n + 2));
  columns.markEvery = n <= 10 ? 1 : n <= 20 ? 3 : n <= 40 ? 5 : 10;
  columns.lineWidth = n <= 10 ? 8 : n <= 20 ? 6 : n <= 40 ? 4 : 3;
  return columns;
}

void ZoomChart(Surface& surface, const Composition& chart, const ChartRequest& request,
               const ChartColours& colours, const FontSettings& fonts, const ZoomBox& box) {
  Zoom(surface, chart, request, colours, fonts, box).Draw();
}

}  // namespace kora
