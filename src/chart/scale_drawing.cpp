#include "chart/scale_drawing.h"

#include <cmath>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr double kLabelGap = 5;  // between a right-aligned label and the frame

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
  for (int i = 0; i <= 3; ++i) {
    const double y = chart.VolBottom - step * i;
    if (i > 0)
      pen.Line('V', {double(chart.ChartLeft - 2), y, double(chart.ChartRight), y,
                     canvas.colour(kAdjustments)});
    const std::string letter = i == 0 ? chart.VolLabel : kWord[i];
    pen.Text('S', font, {font.size, 14 - canvas.TextWidth(font, letter) / 2, y - 4, letter, text});
    const std::string value = Str(RoundedVolume(chart.Volume.Volume(y)));
    const double x = chart.ChartLeft - kLabelGap - canvas.TextWidth(font, value);
    pen.Text('S', font, {font.size, x, y - 4, value, text});
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
    const std::string mode = ModeLine(canvas, lineChart, classText);
    pen.Text('S', canvas.Font1(size), {size, left + 2, chart.ChartTop - 18.0, mode, text},
             {size, left + 2, chart.ChartTop - 12.0, mode, text});
  }
  if (IsSuperimposed(request.Place)) return;

  const char* format = request.Name.RecType != kShare ? "######"
                       : chart.Scale.Range > 0.1      ? "###.00"
                                                      : "###.00#";
  const SurfaceFont font = canvas.Font1Bold(size);
  const double low = chart.Scale.ScaleLow, step = chart.Scale.GridStep;
  const bool fromZero = chart.Scale.ScaleLow == 0.001f;
  for (int i = 0; i <= chart.Scale.GridCount; ++i) {
    const auto v = static_cast<float>(fromZero && i > 0 ? step * i : step * i + low);
    const double y = chart.Price.Y(v);
    if (y < chart.ChartTop) break;
    pen.Line('L', {left, y, left - 5, y, border}, {left, y, left - 7, y, border});
    if (chart.Scale.GridCount <= 12 || i <= 6 || i % 2 == 0) {
      const std::string label = Format(v, v > 0 && v < 0.2 ? ".00#" : format);
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
    canvas_.SmallText(x, bottom + 2, year, text);
  } else if (daily && !monthSkipped_) {
    const double number = Val(month);
    if (number >= 1 && number <= 12) {
      const std::string_view letter =
          std::string_view("JFMAMJJASOND").substr(size_t(number) - 1, 1);
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
