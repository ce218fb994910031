#include "chart/scale_drawing.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <vector>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr double kLabelGap = 5;  // between a right-aligned label and the frame
constexpr double kWordX = 14;    // the middle of "VOL"
constexpr double kDateGap = 2;   // the least between two texts of the date axis
constexpr double kTitleGap = 2;  // by which the title may reach into the line below it

double LnAbove0(double value) {
  if (!(value > 0)) throw RunTimeError(kBadCall);
  return std::log(value);
}

// Large volumes show to the hundred, smaller ones to the ten.
std::int32_t RoundedVolume(std::int32_t v) {
  if (v >= 1000) return CLng(RoundHalfEven(v / 100.0) * 100);
  if (v >= 100) return CLng(RoundHalfEven(v / 10.0) * 10);
  return v;
}

// A tick of the price scale and its label, empty where steps are too many for all to have one.
struct ScaleTick {
  int step;
  double y;
  std::string label;
};

std::vector<ScaleTick> ScaleTicks(const ChartCanvas& canvas) {
  const Composition& chart = canvas.chart;
  const char* format = canvas.request.Name.RecType != kShare ? "######"
                       : chart.Scale.Range > 0.1             ? "###.00"
                                                             : "###.00#";
  const double low = chart.Scale.ScaleLow, step = chart.Scale.GridStep;
  const bool fromZero = chart.Scale.ScaleLow == 0.001f;
  std::vector<ScaleTick> ticks;
  for (int i = 0; i <= chart.Scale.GridCount; ++i) {
    const auto v = static_cast<float>(fromZero && i > 0 ? step * i : step * i + low);
    const double y = chart.Price.Y(v);
    if (y < chart.ChartTop) break;
    const bool labelled = chart.Scale.GridCount <= 12 || i <= 6 || i % 2 == 0;
    ticks.push_back({i, y, labelled ? Format(v, v > 0 && v < 0.2 ? ".00#" : format) : ""});
  }
  return ticks;
}

std::string ModeLine(const ChartCanvas& canvas, bool lineChart, std::string_view classText) {
  const ChartRequest& request = canvas.request;
  std::string text = request.ChartPeriod == Period::kWeekly    ? "WEEKLY"
                     : request.ChartPeriod == Period::kMonthly ? "MONTHLY"
                                                               : "DAILY";
  if (!canvas.chart.Price.Logarithmic)
    text += " - ARITHMETIC -";
  else
    text += lineChart ? " - LOGARITHMIC - " : " - LOGARITHMIC -";
  if (request.BandKind == 1) {
    const auto width = [](std::int16_t w) { return Str(std::int32_t(w >= 1 && w <= 100 ? w : 5)); };
    text += "      Percentage Bands  &" + width(request.Name.BandUp) + "%    -" +
            width(request.Name.BandDown) + "%";
  } else if (classText != kUnknown) {
    text += "      ";
    text += classText;
  }
  return text;
}

}  // namespace

std::string ShortVolume(std::int32_t volume) {
  constexpr const char* kUnits[] = {"K", "M", "B"};
  if (volume < 1000) return Str(volume);
  double value = volume;
  for (const char* unit : kUnits) {
    value /= 1000;
    // Two figures below ten, whole ones above; what rounds to a thousand takes the next unit.
    const double shown = value < 9.95 ? RoundHalfEven(value * 10) / 10 : RoundHalfEven(value);
    if (shown < 1000) return Str(shown) + unit;
  }
  return Str(volume);
}

void SetVolumeLabel(Composition& chart, std::string unit) {
  chart.Volume.VolBase = chart.Bars.VolMin;
  chart.Volume.VolPeak = chart.Bars.VolMax;
  chart.Volume.VolMean = chart.Bars.VolAvg;
  chart.VolLabel = std::move(unit);
}

void SetVolumeMap(const ChartRequest& request, bool lineChart, bool logarithmicPrices,
                  Composition& chart) {
  VolumeMap& map = chart.Volume;
  map.Logarithmic = request.LogVolume;
  map.VolTop = chart.VolTop;
  map.VolBottom = chart.VolBottom;
  map.VolBase = chart.Bars.VolMin;
  map.VolPeak = chart.Bars.VolMax;
  map.VolMean = chart.Bars.VolAvg;
  if (map.Logarithmic) {
    if (logarithmicPrices) map.VolLogBase = static_cast<float>(LnAbove0(map.VolBase));
    map.VolLogFactor = static_cast<float>(
        Divide(double(map.VolTop) - map.VolBottom, LnAbove0(map.VolPeak) - map.VolLogBase));
    return;
  }
  map.VolMean *= lineChart ? 3 : request.VolHeight;
  if (map.VolMean <= 10) map.VolMean = 10;
  const double height = RoundHalfEven(map.VolBottom - map.VolTop * 1.03);
  map.VolPerY = CSng(Divide(map.VolMean - map.VolBase, height));
  // A mean that is no larger than the least volume gives no scale; the largest then stands at
  // the top.
  if (!(map.VolPerY > 0)) map.VolPerY = CSng(Divide(map.VolPeak - map.VolBase, height));
}

void DrawVolumePanel(const ChartCanvas& canvas) {
  const Composition& chart = canvas.chart;
  ChartPen& pen = canvas.pen;
  const Colour text = canvas.colour(kScalesText);
  const SurfaceFont font = canvas.Font2();
  pen.Box('B', {double(chart.ChartLeft), double(chart.VolTop), double(chart.ChartRight),
                double(chart.VolBottom), canvas.colour(kBorder)});
  const int step = CInt((chart.VolBottom - chart.VolTop) / 4.0);
  constexpr const char* kWord[] = {"", "L", "O", "V"};  // from the bottom up
  struct Row {
    double y;
    std::string letter, value;
  };
  std::array<Row, 4> rows;
  bool fit = true;
  for (int i = 0; i <= 3; ++i) {
    Row& row = rows[size_t(i)];
    row.y = chart.VolBottom - step * i;
    row.letter = i == 0 ? chart.VolLabel : kWord[i];
    row.value = Str(RoundedVolume(chart.Volume.Volume(row.y)));
    if (canvas.request.Legible)
      fit = fit && chart.ChartLeft - kLabelGap - canvas.TextWidth(font, row.value) >
                       (row.letter.empty() ? 0 : kWordX + canvas.TextWidth(font, row.letter) / 2);
  }
  for (Row& row : rows) {
    if (!fit) row.value = ShortVolume(RoundedVolume(chart.Volume.Volume(row.y)));
    if (row.y < chart.VolBottom)
      pen.Line('V', {double(chart.ChartLeft - 2), row.y, double(chart.ChartRight), row.y,
                     canvas.colour(kAdjustments)});
    const double middle = kWordX - canvas.TextWidth(font, row.letter) / 2;
    pen.Text('S', font, {font.size, middle, row.y - 4, row.letter, text});
    const double x = chart.ChartLeft - kLabelGap - canvas.TextWidth(font, row.value);
    pen.Text('S', font, {font.size, x, row.y - 4, row.value, text});
  }
}

void DrawScale(const ChartCanvas& canvas, bool lineChart, std::string_view classText) {
  const Composition& chart = canvas.chart;
  const ChartRequest& request = canvas.request;
  ChartPen& pen = canvas.pen;
  const Colour border = canvas.colour(kBorder);
  const Colour grid = canvas.colour(kFixedGrid);
  const Colour text = canvas.colour(kScalesText);
  const double left = chart.ChartLeft, right = chart.ChartRight;
  constexpr double size = ChartCanvas::kSmallText;

  pen.Box('B', {left, double(chart.ChartTop), right, double(chart.ChartBottom), border});

  if (!IsSplit(request.Place) && !IsSuperimposed(request.Place)) {
    // On a low chart its place is that of the title.
    const double y = chart.ChartTop - 18.0;
    if (const std::string mode = ModeLine(canvas, lineChart, classText);
        !request.Legible || y >= chart.TitleBottom - kTitleGap)
      pen.Text('S', canvas.Font1(size), {size, left + 2, y, mode, text},
               {size, left + 2, chart.ChartTop - 12.0, mode, text});
  }
  if (IsSuperimposed(request.Place)) return;

  const SurfaceFont font = canvas.Font1Bold(size);
  const double low = chart.Scale.ScaleLow, step = chart.Scale.GridStep;
  for (const auto& [i, y, label] : ScaleTicks(canvas)) {
    pen.Line('L', {left, y, left - 5, y, border}, {left, y, left - 7, y, border});
    if (!label.empty()) {
      const double width = canvas.TextWidth(font, label);
      const TextAt at{size, left - kLabelGap - width, y - 6, label, text};
      if (request.ScriptPrintMode)
        pen.Text('S', font, at, {size, left - 20 - width, y - 12, label, text});
      else
        pen.Text('S', font, at);
    }
    if (request.GridLines && i > 0) {
      pen.Line('V', {left, y, right, y, grid});
      if (request.HalfGrid) {
        const double half = chart.Price.Y(low + step * (i - 0.5));
        pen.Line('V', {left, half, right, half, grid});
      }
    }
  }
}

std::int16_t LeftOfLabel(const ChartCanvas& canvas, double width) {
  const double needed = width + kLabelGap;
  if (needed <= canvas.chart.ChartLeft) return canvas.chart.ChartLeft;
  return CInt(std::ceil(needed) + 1);
}

std::int16_t LeftOfLabels(const ChartCanvas& canvas) {
  const SurfaceFont font = canvas.Font1Bold(ChartCanvas::kSmallText);
  double widest = 0;
  for (const ScaleTick& tick : ScaleTicks(canvas))
    widest = std::max(widest, canvas.TextWidth(font, tick.label));
  return LeftOfLabel(canvas, widest);
}

void DrawFixedGrid(const ChartCanvas& canvas) {
  const Composition& chart = canvas.chart;
  const ChartRequest& request = canvas.request;
  if (!request.GridLines || request.MovingGrid || request.GridSpace <= 0) return;
  const int step = request.GridSpace * chart.BarSpacing;
  for (int x = chart.ChartLeft + step; x <= chart.ChartRight; x += step)
    canvas.pen.Line('V', {double(x), double(chart.ChartTop), double(x), double(chart.ChartBottom),
                          canvas.colour(kFixedGrid)});
}

bool DateAxis::Bar(std::string_view yyyymmdd, double x) {
  // A chart laid over another stands on the other's axis.
  return canvas_.request.Place != ChartPlace::kOver && yyyymmdd.substr(0, 6) > lastMonth_ &&
         NewMonth(yyyymmdd, x);
}

// Whether a text at x is clear of the one before; it is the one before then.
bool DateAxis::HasRoom(double x, std::string_view text) {
  if (!canvas_.request.Legible) return true;
  if (x < textEnd_ + kDateGap) return false;
  textEnd_ = x + canvas_.TextWidth(canvas_.Font1(ChartCanvas::kSmallText), text);
  return true;
}

bool DateAxis::NewMonth(std::string_view yyyymmdd, double x) {
  const Composition& chart = canvas_.chart;
  const ChartRequest& request = canvas_.request;
  ChartPen& pen = canvas_.pen;
  const std::string_view year = yyyymmdd.substr(0, 4);
  const std::string_view month = yyyymmdd.substr(4, 2);
  const double bottom = chart.VolBottom;
  const Colour text = canvas_.colour(kScalesText);
  const bool daily = request.ChartPeriod == Period::kDaily;

  const int mark = CInt(x / 8);
  const bool yearChanged = year != lastYear_;
  if (mark >= lastMark_ + 4 || yearChanged) {
    if (!request.GridLines || !daily || yearChanged || ticksAlone_) {
      pen.Line('L', {x, bottom, x, bottom + 5, text});
      lastMark_ = mark;
    } else if (request.MovingGrid) {
      const Colour grid = canvas_.colour(kFixedGrid);
      pen.Line('V', {x, chart.ChartTop + 5.0, x, bottom, grid},
               {x, double(chart.ChartTop), x, bottom + 5, grid});
    }
  } else {
    monthSkipped_ = true;
  }

  const bool yearMark = year > lastYear_ && month == "01" && x > 64;
  if (yearMark) {
    pen.Line('D', {x, bottom + 2, x, double(chart.ChartTop), canvas_.colour(kEndOfYear)},
             {x, bottom + 2, x, double(chart.ChartTop), text});
    if (HasRoom(x, year)) canvas_.SmallText(x, bottom + 2, year, text);
  } else if (daily && !monthSkipped_) {
    const double number = Val(month);
    const std::string_view letter =
        number >= 1 && number <= 12 ? std::string_view("JFMAMJJASOND").substr(size_t(number) - 1, 1)
                                    : std::string_view();
    if (!letter.empty() && HasRoom(x, letter)) {
      const double size =
          request.ScriptPrintMode ? canvas_.fonts.Font2Points() : ChartCanvas::kSmallText;
      pen.Text('T', canvas_.Font1(ChartCanvas::kSmallText),
               {ChartCanvas::kSmallText, x, bottom + 2, letter, text},
               {size, x, bottom + 2, letter, text});
    }
  }
  lastMonth_ = yyyymmdd.substr(0, 6);
  lastYear_ = year;
  monthSkipped_ = false;
  return yearMark;
}

}  // namespace kora
