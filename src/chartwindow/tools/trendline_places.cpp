#include "chartwindow/tools/trendline_places.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "chartwindow/tools/read_out.h"

namespace kora {
namespace {

constexpr double kBeyondRight = 10, kBeyondFrame = 20;

// The column at x, beyond the last bar too.
std::int32_t OpenColumn(const Composition& chart, double x) {
  return CLng(Divide(x - chart.ChartLeft, chart.BarSpacing));
}

std::string_view DateAt(const Composition& chart, std::int32_t column) {
  if (column < 0 || size_t(column) >= chart.Bars.bars.size()) return {};
  const std::string_view date = chart.Bars[size_t(column)].date();
  return date == "        " ? std::string_view() : date;
}

bool IsDigit(char c) { return c >= '0' && c <= '9'; }

// Eight bytes as a number that sorts as they do: bars are many, and saved lines too.
std::uint64_t SortKey(std::string_view date) {
  std::uint64_t key = 0;
  for (size_t i = 0; i < 8; ++i)
    key = key << 8 | (i < date.size() ? static_cast<unsigned char>(date[i]) : 0);
  return key;
}

// The first bar from `first` on with that date or a later one; -1 where there is none.
std::int32_t ColumnOfDate(const Composition& chart, std::int32_t first, std::string_view date) {
  const auto last =
      std::min<std::int32_t>(chart.Bars.BarCount, std::int32_t(chart.Bars.bars.size()) - 1);
  const std::uint64_t wanted = SortKey(date);
  for (std::int32_t column = first; column <= last; ++column)
    if (SortKey(chart.Bars[size_t(column)].date()) >= wanted) return column;
  return -1;
}

double YOfPrice(const Composition& chart, double price) {
  if (chart.Price.Logarithmic) return PriceToPixel(chart, price);
  return chart.ChartBottom -
         Divide(price - double(chart.Scale.ScaleLow), double(chart.Price.PricePerY));
}

bool NearFrame(const Composition& chart, double y) {
  return y > chart.ChartTop - kBeyondFrame && y < chart.ChartBottom + kBeyondFrame;
}

float KeptPrice(const Composition& chart, double y) {
  const double price = chart.Price.Price(y);
  if (!std::isfinite(price)) throw RunTimeError(kOverflow);
  return CSng(price);
}

std::optional<TrendlineRec> MakeRecord(const Composition& chart, const ChartRequest& request,
                                       ScreenLine line) {
  if (line.x2 < line.x1) {
    std::swap(line.x1, line.x2);
    std::swap(line.y1, line.y2);
  }
  TrendlineRec rec = EmptyTrendline();
  rec.TLStartPrice = KeptPrice(chart, line.y1);
  rec.TLEndPrice = KeptPrice(chart, line.y2);
  const std::int32_t from = OpenColumn(chart, line.x1), to = OpenColumn(chart, line.x2);
  if (from > chart.Bars.BarCount || from <= 0) return std::nullopt;
  const std::string_view start = DateAt(chart, from);
  if (start.empty()) return std::nullopt;
  rec.TLStartDate.set(start);
  if (to >= 1 && to <= chart.Bars.BarCount) {
    const std::string_view end = DateAt(chart, to);
    if (end.empty()) return std::nullopt;
    rec.TLEndDate.set(end);
  } else {
    rec.TLEndDate.set(std::string("X") + Str(CLng(Divide(line.x2 - line.x1, chart.BarSpacing))));
  }
  rec.TLSpacing = CInt(chart.BarSpacing + 1.0);
  rec.TLPeriod.set(TextOf(request.ChartPeriod));
  return rec;
}

std::optional<ScreenLine> Place(const Composition& chart, const ChartRequest& request,
                                const TrendlineRec& rec) {
  if (rec.TLPeriod.raw() != TextOf(request.ChartPeriod)) return std::nullopt;
  const std::string_view start = rec.TLStartDate.raw(), end = rec.TLEndDate.raw();
  if (rec.TLStartDate.trimmed().empty() || start < DateAt(chart, 1)) return std::nullopt;
  ScreenLine line;
  const std::int32_t from = ColumnOfDate(chart, 1, start);
  if (from < 0) return std::nullopt;
  line.x1 = XOfColumn(chart, from);
  if (IsDigit(end.front())) {
    // A later date stands on no earlier bar.
    const std::int32_t to = ColumnOfDate(chart, end < start ? 1 : from, end);
    if (to < 0) return std::nullopt;
    line.x2 = XOfColumn(chart, to);
  } else if (end.front() == 'X') {
    line.x2 = line.x1 + chart.BarSpacing * Val(end.substr(1));
  } else {
    return std::nullopt;
  }
  if (rec.TLStartPrice == 0 || rec.TLEndPrice == 0) return std::nullopt;
  line.y1 = YOfPrice(chart, double(rec.TLStartPrice));
  line.y2 = YOfPrice(chart, double(rec.TLEndPrice));
  // What is no number passes none of these.
  if (!(line.x2 < chart.ChartRight + kBeyondRight) || !(line.x1 > chart.ChartLeft))
    return std::nullopt;
  if (!NearFrame(chart, line.y1) || !NearFrame(chart, line.y2)) return std::nullopt;
  return line;
}

}  // namespace

std::optional<TrendlineRec> TrendlineOf(const Composition& chart, const ChartRequest& request,
                                        const ScreenLine& line) {
  try {
    return MakeRecord(chart, request, line);
  } catch (const RunTimeError&) {
    return std::nullopt;
  }
}

std::optional<ScreenLine> PlaceTrendline(const Composition& chart, const ChartRequest& request,
                                         const TrendlineRec& rec) {
  try {
    return Place(chart, request, rec);
  } catch (const RunTimeError&) {
    return std::nullopt;
  }
}

bool HitsLine(const TrendlineRow& row, double x, double y) {
  if (row.x1 == 0 || row.x2 == 0) return false;
  const double x1 = row.x1, y1 = row.y1, x2 = row.x2, y2 = row.y2;
  double slope = y2 - y1, intercept = x2 * y1 - x1 * y2;
  if (x1 != x2) {
    slope /= x2 - x1;
    intercept /= x2 - x1;
  }
  const double at = x * slope + intercept;
  return at - 2 < y && y < at + 2;
}

std::optional<NotePlace> PlaceNote(const Composition& chart, const NoteLine& note) {
  if (!note.readable || note.Price == 0) return std::nullopt;
  NotePlace place;
  try {
    if (note.Date.size() == 8 && std::all_of(note.Date.begin(), note.Date.end(), IsDigit)) {
      if (note.Date < DateAt(chart, 0)) return std::nullopt;
      const std::int32_t column = ColumnOfDate(chart, 0, note.Date);
      place.x = column < 0 ? 0 : XOfColumn(chart, column);
    } else {
      place.x = Val(note.Date);
    }
    place.y = PriceToPixel(chart, note.Price);
  } catch (const RunTimeError&) {
    return std::nullopt;
  }
  if (place.x < chart.ChartLeft || place.x > chart.ChartRight || place.y == 0 ||
      !NearFrame(chart, place.y))
    return std::nullopt;
  return place;
}

}  // namespace kora
