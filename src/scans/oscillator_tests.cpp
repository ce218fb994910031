#include "scans/oscillator_tests.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "base/numbers.h"

namespace kora {
namespace {

// Panels 144 units high, with a frame of 2 percent above and below.
constexpr double kBottom = 141;

// A row, if it is one of 32 bits.
bool ToRow(double value, std::int32_t& row) {
  const double rounded = RoundHalfEven(value);
  if (!(rounded >= -2147483648.0 && rounded <= 2147483647.0)) return false;
  row = CLng(rounded);
  return true;
}

Rows RowsOf(double y, double p, double oblin, double oslin) {
  OscRows rows;
  if (ToRow(y, rows.y) && ToRow(p, rows.p) && ToRow(oblin, rows.oblin) && ToRow(oslin, rows.oslin))
    return rows;
  return std::nullopt;
}

// Row of the Stochastic at bar i, over bars i - K to i.
double StochasticRow(std::span<const ChartBar> bars, size_t i, size_t K) {
  constexpr double kFoot = kBottom - 20, kUnit = 100.0 / (kFoot - 2 - 20);
  float high = bars[i].High, low = bars[i].Low;
  for (size_t j = i - K; j < i; ++j) {
    high = std::max(high, bars[j].High);
    low = std::min(low, bars[j].Low);
  }
  const float above = bars[i].Close - low, range = high - low;
  const double k = range != 0 ? RoundHalfEven(double(above) / range * 100) : double(above) * 100;
  return kFoot - k / kUnit;
}

template <typename Value>
Rows ChangeRows(std::span<const ChartBar> bars, int P, Value value) {
  constexpr double kFloor = kBottom - 10, kHeight = kFloor - 13, kMostLine = 32766;
  if (P < 1 || bars.size() < size_t(P) + 3) return std::nullopt;
  double max = -100, min = 10000, v = 0, previous = 0;
  for (size_t i = size_t(P) + 1; i < bars.size(); ++i) {
    const float close = bars[i].Close, before = bars[i - size_t(P)].Close;
    previous = v;
    if (close != 0 && before != 0) v = value(close, before);
    max = std::max(max, v);
    min = std::min(min, v);
  }
  if (-max > min)
    max = -min;
  else
    min = -max;
  const double unit = (max - min) / kHeight;
  if (unit == 0 || !(max * 0.8 <= kMostLine) || !(min * 0.8 >= -kMostLine)) return std::nullopt;
  const auto row = [&](double at) { return kFloor - (at - min) / unit; };
  return RowsOf(row(v), row(previous), row(RoundHalfEven(max * 0.8)),
                row(RoundHalfEven(min * 0.8)));
}

double RsiAt(std::span<const ChartBar> bars, size_t i, int P) {
  double rises = 0, falls = 0;
  for (size_t j = i + 1 - size_t(P); j < i; ++j) {
    const double a = bars[j].Close, b = bars[j + 1].Close;
    if (a == 0) continue;
    if (b > a)
      rises += b - a;
    else
      falls += a - b;
  }
  const double up = rises / P;
  double down = falls / P;
  if (down == 0) down = 1;
  return 100 - 100 / (1 + up / down);
}

}  // namespace

Rows StochasticRows(std::span<const ChartBar> bars, int K) {
  if (K < 1 || bars.size() < size_t(K) + 3) return std::nullopt;
  constexpr double kFoot = kBottom - 20, kUnit = 100.0 / (kFoot - 2 - 20);
  const size_t last = bars.size() - 1;
  return RowsOf(StochasticRow(bars, last, size_t(K)), StochasticRow(bars, last - 1, size_t(K)),
                kFoot - 75 / kUnit, kFoot - 25 / kUnit);
}

Rows WilliamsRows(std::span<const ChartBar> bars, int P) {
  constexpr double kHeight = 118, kBase = 13, kUnit = 1.18;
  if (P < 1) return std::nullopt;
  // The last rows, latest first: two means need four.
  std::array<std::int32_t, 4> rows;
  size_t found = 0;
  for (size_t i = bars.size(); i-- > size_t(P) && found < rows.size();) {
    float high = 0, low = 0;
    bool any = false;
    for (size_t j = i + 1 - size_t(P); j <= i; ++j) {
      const float close = bars[j].Close;
      if (close == 0) continue;
      high = any ? std::max(high, close) : close;
      low = any ? std::min(low, close) : close;
      any = true;
    }
    const float range = high - low;
    if (high == 0 || range == 0) continue;
    const double r = double(high - bars[i].Close) / range * 100;
    if (!ToRow(r * kUnit + kBase, rows[found++])) return std::nullopt;
  }
  if (found < rows.size()) return std::nullopt;
  const auto mean = [&](size_t first) {
    return (double(rows[first]) + rows[first + 1] + rows[first + 2]) / 3;
  };
  return RowsOf(mean(0), mean(1), kHeight * 0.1 + kBase, kHeight * 0.9 + kBase);
}

Rows RocRows(std::span<const ChartBar> bars, int P) {
  return ChangeRows(bars, P,
                    [](float close, float before) { return double(close - before) / close * 100; });
}

Rows MomentumRows(std::span<const ChartBar> bars, int P) {
  return ChangeRows(bars, P,
                    [](float close, float before) { return double(close - before) * 100; });
}

Rows RsiRows(std::span<const ChartBar> bars, int P) {
  constexpr double kHeight = 119, kBase = 12, kUnit = 1.19, kFloor = kBottom - 10;
  constexpr int kStandingPeriod = 21;
  if (P == 0) P = kStandingPeriod;
  if (P < 1 || bars.size() < size_t(P) + 1) return std::nullopt;
  const size_t last = bars.size() - 1;
  const auto row = [&](size_t i) { return kFloor - RsiAt(bars, i, P) * kUnit; };
  return RowsOf(row(last), row(last - 1), kHeight * 0.3 + kBase, kHeight * 0.7 + kBase);
}

Signal SignalOf(const OscRows& rows) {
  if (rows.y <= rows.oblin) return rows.p > rows.oblin ? Signal::kCutObUp : Signal::kOb;
  if (rows.y >= rows.oslin) return rows.p < rows.oslin ? Signal::kCutOsDown : Signal::kOs;
  if (rows.p <= rows.oblin) return Signal::kCutObDown;
  if (rows.p >= rows.oslin) return Signal::kCutOsUp;
  return Signal::kNone;
}

std::string_view SignalText(Signal signal) {
  switch (signal) {
    case Signal::kNone: break;
    case Signal::kOb: return "OB";
    case Signal::kCutObUp: return "Cut OB UP";
    case Signal::kCutObDown: return "Cut OB DN";
    case Signal::kOs: return "OS";
    case Signal::kCutOsUp: return "Cut OS UP";
    case Signal::kCutOsDown: return "Cut OS DN";
  }
  return "";
}

bool SignalBoxes::Report(Signal signal) const {
  switch (signal) {
    case Signal::kNone: break;
    case Signal::kOb: return ob;
    case Signal::kCutObUp: return ob || cutOb;
    case Signal::kCutObDown: return cutOb;
    case Signal::kOs: return os;
    case Signal::kCutOsUp: return cutOs;
    case Signal::kCutOsDown: return os || cutOs;
  }
  return false;
}

}  // namespace kora
