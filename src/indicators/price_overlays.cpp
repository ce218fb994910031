#include "indicators/price_overlays.h"

#include <algorithm>
#include <cmath>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/price_averages.h"

namespace kora {
namespace {

constexpr std::int16_t kLongestMma = 500;  // drawn; the form takes up to 600

// The last N closes as they come.
template <size_t N>
class CloseWindow {
 public:
  // True once the window is full.
  bool Add(double close) {
    slots_[count_ % N] = close;
    ++count_;
    return count_ >= N;
  }
  bool JustFull() const { return count_ == N; }
  double Mean() const {
    double sum = 0;
    for (const double v : slots_) sum += v;
    return sum / double(N);
  }
  // Square root of the mean squared distance from `mean`.
  double Deviation(double mean) const {
    double sum = 0;
    for (const double v : slots_) sum += (mean - v) * (mean - v);
    return std::sqrt(sum / double(N));
  }

 private:
  std::array<double, N> slots_{};
  size_t count_ = 0;
};

// One band as a line from point to point. A value of 0 has no place on the chart and breaks it.
class BandLine {
 public:
  explicit BandLine(const ChartCanvas& canvas) : canvas_(canvas) {}
  void To(double x, double price) {
    if (price == 0) {
      started_ = false;
      return;
    }
    const double y = canvas_.chart.Price.Y(price);
    if (started_) canvas_.pen.Line('L', {x_, y_, x, y, canvas_.colour(kBands)});
    started_ = true;
    x_ = x;
    y_ = y;
  }

 private:
  const ChartCanvas& canvas_;
  bool started_ = false;
  double x_ = 0, y_ = 0;
};

// The bars that were drawn.
size_t DrawnBars(const Composition& chart) {
  return std::min(chart.CloseY.size(), chart.Bars.bars.size());
}

double XOfBar(const Composition& chart, size_t i) {
  return chart.FirstBarX + double(i) * chart.BarSpacing;
}

double Percent(std::int16_t value) { return value >= 1 && value <= 100 ? value : 5.0; }

// An error ends the work and nothing else: the chart under the bands stands.
template <typename Work>
void ClearErrors(Work&& work) {
  try {
    work();
  } catch (const RunTimeError&) {
  }
}

void DrawPercentBands(const ChartCanvas& canvas) {
  Composition& chart = canvas.chart;
  const double up = Percent(canvas.request.Name.BandUp);
  const double down = Percent(canvas.request.Name.BandDown);
  CloseWindow<10> window;
  BandLine upper(canvas), lower(canvas);
  for (size_t i = 0; i < DrawnBars(chart); ++i) {
    ChartBar& bar = chart.Bars[i];
    if (bar.Close == 0 && i > 0) bar.Close = chart.Bars[i - 1].Close;
    if (!window.Add(bar.Close)) continue;
    const double mean = window.Mean(), x = XOfBar(chart, i);
    upper.To(x, (up / 100.0 + 1.0) * mean);
    lower.To(x, (100.0 - down) * mean / 100.0);
  }
}

void DrawBollinger(const ChartCanvas& canvas) {
  const Composition& chart = canvas.chart;
  CloseWindow<21> window;
  BandLine upper(canvas), lower(canvas);
  double close = 0;
  for (size_t i = 0; i < DrawnBars(chart); ++i) {
    if (chart.Bars[i].Close != 0) close = chart.Bars[i].Close;
    if (!window.Add(close)) continue;
    const double mean = window.Mean(), width = window.Deviation(mean) * 2.0;
    const double x = XOfBar(chart, i) - (window.JustFull() ? chart.BarSpacing : 0);
    upper.To(x, mean + width);
    lower.To(x, mean - width);
  }
}

// The number of a text that is one altogether.
std::optional<double> Number(std::string_view text) {
  text = Trim(text);
  std::string_view rest = text;
  if (!rest.empty() && (rest.front() == '-' || rest.front() == '+')) rest.remove_prefix(1);
  const auto digits =
      std::count_if(rest.begin(), rest.end(), [](char c) { return c >= '0' && c <= '9'; });
  const auto points = std::count(rest.begin(), rest.end(), '.');
  if (digits == 0 || points > 1 || size_t(digits + points) != rest.size()) return std::nullopt;
  return Val(text);
}

}  // namespace

void AddMMA(const ChartCanvas& canvas, const MmaPeriods& MMASet) {
  const Composition& chart = canvas.chart;
  const auto draw = canvas.request.MaExp ? ExpAverageLine : SimpleAverageLine;
  for (size_t i = 0; i < MMASet.size(); ++i) {
    if (MMASet[i] < 1 || MMASet[i] > kLongestMma) continue;
    draw(canvas.pen, MMASet[i], chart.CloseY, canvas.colour(i < 6 ? kMmaShort : kMmaLong),
         chart.FirstBarX, chart.BarSpacing, 1);
  }
}

void ShowPercentBands(const ChartCanvas& canvas) {
  ClearErrors([&] { DrawPercentBands(canvas); });
}

void ShowBollinger(const ChartCanvas& canvas) {
  ClearErrors([&] { DrawBollinger(canvas); });
}

void ShowBands(const ChartCanvas& canvas) {
  if (canvas.request.BandKind == 1) ShowPercentBands(canvas);
  if (canvas.request.BandKind == 2) ShowBollinger(canvas);
}

std::vector<std::function<void(const ChartCanvas&)>> PriceOverlays(bool MMAOn,
                                                                   const MmaPeriods& MMASet) {
  std::vector<std::function<void(const ChartCanvas&)>> overlays{ShowBands};
  if (MMAOn) overlays.emplace_back([MMASet](const ChartCanvas& canvas) { AddMMA(canvas, MMASet); });
  return overlays;
}

void DrawReversalLegend(Surface& surface, const FontSettings& fonts, const ChartColours& colours) {
  constexpr const char* kTexts[] = {" Reversal", " Key Reversal", " Hook Reversal",
                                    " Open-Close Rev.", " Pivot Point"};
  surface.SetBackColour(colours[kBackground]);
  surface.SetDrawMode(DrawMode::kCopy);
  surface.SetDrawStyle(DrawStyle::kSolid);
  surface.SetDrawWidth(1);
  surface.Cls();
  surface.Box(0, 0, 112, 70, colours[kBorder]);
  surface.SetFont({fonts.Font1Name, ChartCanvas::kSmallText, false, false});
  surface.SetForeColour(colours[kScalesText]);
  for (int row = 0; row < 5; ++row) {
    const double top = 1 + 14.0 * row;
    surface.SetCurrent(2, top);
    surface.Print(kTexts[row]);
    surface.Line(105, top + 2, 105, top + 11, colours[size_t(kReversal + row)]);
  }
}

std::optional<MmaPeriods> ReadMMABoxes(std::span<const std::string, 12> boxes, size_t& refused) {
  MmaPeriods periods{};
  for (size_t i = 0; i < boxes.size(); ++i) {
    const double value = Val(boxes[i]);
    if (value < 0 || value > 600) {
      refused = i;
      return std::nullopt;
    }
    periods[i] = CInt(value);
  }
  return periods;
}

std::string MMASetText(const MmaPeriods& periods) {
  std::string out;
  for (const std::int16_t period : periods) {
    if (!out.empty()) out += ',';
    AppendStr(out, std::int32_t(period));
  }
  return out;
}

std::optional<BandValues> ReadBandBoxes(std::string_view first, std::string_view second) {
  // An empty box is 0, which draws the width that bands have by themselves.
  const auto value = [](std::string_view text) {
    return Trim(text).empty() ? std::optional(0.0) : Number(text);
  };
  const auto a = value(first), b = value(second);
  if (!a || !b || *a < 0 || *a > 100 || *b < 0 || *b > 100) return std::nullopt;
  return BandValues{CInt(*a), CInt(*b)};
}

std::optional<float> ReadStopLossPercent(std::string_view text) {
  const std::optional<double> value = Number(text);
  if (!value || *value < 0 || *value > 100) return std::nullopt;
  return static_cast<float>(*value);
}

}  // namespace kora
