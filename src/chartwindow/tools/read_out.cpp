#include "chartwindow/tools/read_out.h"

#include <algorithm>
#include <cmath>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "store/name_rec.h"

namespace kora {
namespace {

// The mouse asks all the time and gets a 0 for what can't be said.
template <typename Result, typename Work>
Result OrZero(Work&& work) {
  try {
    return work();
  } catch (const RunTimeError&) {
    return Result{};
  }
}

std::string VolumeText(const Composition& chart, std::int32_t volume) {
  if (volume == 0) return "0";
  std::string text = Str(volume);
  // "'000" shows its zeros behind the digits.
  if (chart.VolLabel.size() > 2) text += chart.VolLabel.substr(1);
  return text;
}

}  // namespace

std::int32_t ColumnOf(const Composition& chart, double x) {
  return OrZero<std::int32_t>([&] {
    const std::int32_t column = CLng(Divide(x - chart.ChartLeft, chart.BarSpacing));
    return std::min<std::int32_t>(column, chart.Bars.BarCount);
  });
}

double XOfColumn(const Composition& chart, std::int32_t column) {
  return chart.ChartLeft + 1 + double(column) * chart.BarSpacing;
}

double PixelToPrice(const Composition& chart, double y) {
  return OrZero<double>([&] {
    const double price = chart.Price.Price(y);
    if (!std::isfinite(price)) throw RunTimeError(kOverflow);
    return Val(Format(price, price < 0.3 ? "0.00#" : "0.00"));
  });
}

std::int16_t PriceToPixel(const Composition& chart, double price) {
  return OrZero<std::int16_t>([&] {
    // The composer draws such prices somewhere; the pointer knows no place for them.
    if (chart.Price.Logarithmic && !(price > 0)) throw RunTimeError(kBadCall);
    return chart.Price.Y(price);
  });
}

double PFPixelToPrice(const Composition& chart, const PFBoxes& boxes, double y) {
  return OrZero<double>([&] {
    const std::int16_t row = CInt(Fix(Divide(chart.ChartBottom - y, boxes.PFBoxPixels)));
    return row * double(boxes.PFBoxSize) + double(chart.Scale.ScaleLow);
  });
}

std::int16_t PFPriceToPixel(const Composition& chart, const PFBoxes& boxes, double price) {
  return OrZero<std::int16_t>([&] {
    const std::int16_t row =
        CInt(Divide(price - double(chart.Scale.ScaleLow), double(boxes.PFBoxSize)));
    return CInt(chart.ChartBottom - double(boxes.PFBoxPixels) * row);
  });
}

std::string_view ReadoutFormat(std::int16_t RecType) {
  switch (RecType) {
    case kCloseVolume:
    case kCloseOnly: return "########.0";
    case kAdvanceDecline:
    case kIndex: return "#######0";
    default: return "#######.00";
  }
}

std::optional<ReadoutTexts> BarReadout(const Composition& chart, std::int16_t RecType,
                                       std::int32_t column) {
  const std::int32_t last =
      std::min<std::int32_t>(chart.Bars.BarCount, std::int32_t(chart.Bars.bars.size()) - 1);
  column = std::min(column, last);
  if (column < 0) return std::nullopt;
  const ChartBar& bar = chart.Bars[size_t(column)];
  if (bar.date().empty() || bar.date() == "        ") return std::nullopt;

  const char* format = RecType == kAdvanceDecline || RecType == kIndex ? "###0" : "###.00#";
  const auto price = [format](const char* word, float value) {
    return word + Format(value, format);
  };
  const std::string date = DateToShort(bar.date());
  const std::string volume = "Vol  " + VolumeText(chart, bar.Volume);
  switch (RecType) {
    case kCloseVolume:
    case kCloseOnly: return ReadoutTexts{date, price("Close  ", bar.Close), volume, "", "", ""};
    case kAdvanceDecline:
      return ReadoutTexts{date,
                          price("Rise  ", bar.High),
                          price("Fall  ", bar.Low),
                          price("Total  ", bar.Close),
                          volume,
                          ""};
    default:
      return ReadoutTexts{date,
                          price("Open  ", bar.Open),
                          price("High  ", bar.High),
                          price("Low  ", bar.Low),
                          price("Close  ", bar.Close),
                          volume};
  }
}

}  // namespace kora
