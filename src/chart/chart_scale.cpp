#include "chart/chart_scale.h"

#include <cmath>

#include "base/numbers.h"
#include "base/runtime_error.h"

namespace kora {
namespace {

float Through(double value, const char* pattern) { return CSng(Val(Format(value, pattern))); }

// Near par a small range keeps its own ends: bank bills and the like stay legible.
bool NearPar(float value, float high, float low) {
  return value > 85 && value < 100 && double(high) - double(low) < 4;
}

// The highest High goes up to a round figure, with a margin.
float RoundTop(float h) {
  const double f = h > 0.19 ? 1.02 : h > 0 ? 1.2 : 0.99;
  const double raised = double(h) * f;
  if (!(raised > 0.99)) return Through(raised, "#######.###");
  if (raised > 100) {
    double n = RoundHalfEven(raised / 10);
    if (h >= 10 * n) n += 1;
    return CSng(10 * n);
  }
  if (raised >= 1) {
    double n = RoundHalfEven(raised / 0.1);
    if (0.1 * n <= h) n += 1;
    h = CSng(0.1 * n);
    return Through(double(h) * f, "#######.#");  // the factor acts twice: the top's margin
  }
  return h;
}

// The lowest Low goes down. `high` is the top as rounded by now.
float RoundBottom(float l, float high) {
  const double f = NearPar(l, high, l) ? 1 : l > 0.19 ? 0.99 : l > 0 ? 0.9 : 1.01;
  const double lowered = double(l) * f;
  if (!(lowered > 1)) return Through(lowered, "#######.###");
  if (lowered > 100) {
    double n = RoundHalfEven(lowered / 10);
    if (l <= 10 * n) n -= 1;
    return CSng(10 * n);
  }
  double n = RoundHalfEven(lowered / 0.1);
  if (0.1 * n >= l) n -= 1;
  l = CSng(0.1 * n);
  return Through(double(l) * f, "#######.#");
}

// Outside 0 to 600 both ends go to round figures.
void RoundOutward(float& low, float& high) {
  if (low >= 0 && low <= 600) return;
  if (low <= -100 || low > 600)
    low = CSng(Int(low / 100.0) * 100);
  else if (low < -10)
    low = CSng(Int(low / 10.0) * 10);

  if ((high > -100 && high < 0) || (high > 0.5 && high < 100)) {
    high = CSng(Int(high / 10.0) * 10);
  } else if (high == 0 || high <= -100 || high >= 100) {
    high = CSng((Int(high / 100.0) + 1) * 100);
  }
}

// The step of the grid by the range. 0 where no row has the range: between 0.11 and 0.1101,
// and for a range of nothing or less.
double StepFor(double r) {
  struct Row {
    double from, to, step;
  };
  if (r > 0 && r < 0.11) return 0.005;
  static constexpr Row rows[] = {
      {0.1101, 0.5, 0.02}, {0.5001, 1, 0.05}, {1.0001, 2, 0.1},   {2.0001, 3, 0.2},
      {3.0001, 4, 0.3},    {4.0001, 5, 0.4},  {5.0001, 10, 0.5},  {10.0001, 20, 1},
      {20.0001, 50, 5},    {50.0001, 80, 10}, {80.0001, 100, 15},
  };
  for (const Row& row : rows)
    if (r >= row.from && r <= row.to) return row.step;
  if (r >= 100.0001 && r <= 1000) return Fix(Fix(r / 10) * 10 / 10);
  if (r >= 1000.0001) return Fix(Fix(r / 100) * 100 / 10);
  return 0;
}

void PickStep(ChartScale& scale) {
  scale.Range = Val(Format(double(scale.ScaleHigh) - double(scale.ScaleLow), "#####0.00"));
  if (const double step = StepFor(scale.Range); step != 0) scale.GridStep = CSng(step);
  scale.GridCount = CInt(Int(Divide(scale.Range, scale.GridStep)));
}

double LogOf(double value) {
  if (!(value > 0)) throw RunTimeError(kBadCall);
  return std::log(value);
}

// ln v, with the stand-ins for values that have none.
double PriceLog(double v) {
  if (v > 0) return std::log(v);
  if (v == 0) return std::log(10.0);
  return Divide(std::log(10.0), LogOf(-v));
}

}  // namespace

void SetChartScaleAutomatic(float high, float low, ChartScale& scale) {
  if (!std::isfinite(high) || !std::isfinite(low)) throw RunTimeError(kOverflow);
  float h = high, l = low;
  if (!NearPar(h, h, l)) {
    if (double(h) - double(l) < 0.15) {
      if (h < 0.01) h = 0.05f;
      h = CSng(h * 1.05);
      l = CSng(l * 0.95);
    }
    h = RoundTop(h);
  }
  l = RoundBottom(l, h);
  if (l == 0) l = 0.005f;
  RoundOutward(l, h);
  if (l < 2) {
    l = CSng(RoundHalfEven(l / 0.005) * 0.005);
    if (l == 0) l = 0.001f;
  }
  scale.ScaleLow = l;
  scale.ScaleHigh = h;
  PickStep(scale);
}

void SetChartScaleManual(float base, float top, ChartScale& scale) {
  scale.ScaleLow = base;
  scale.ScaleHigh = top;
  if (base == 0 || top == 0) {
    scale.ScaleLow = scale.ScaleHigh = 0;
    return;
  }
  PickStep(scale);
}

std::int16_t PriceMap::Y(double price) const {
  if (Logarithmic)
    return CInt(Int(double(LogFactor) * (PriceLog(price) - double(LogBase)) + ChartBottom));
  return CInt(ChartBottom - Divide(price - double(ScaleLow), double(PricePerY)));
}

double PriceMap::Price(double y) const {
  if (Logarithmic) return double(ScaleLow) * std::exp(Divide(y - ChartBottom, double(LogFactor)));
  return (ChartBottom - y) * double(PricePerY) + double(ScaleLow);
}

double VolumeMap::RawY(double volume) const {
  if (Logarithmic) {
    return Int(double(VolLogFactor) * (LogOf(volume) - double(VolLogBase)) + VolBottom);
  }
  return VolBottom - Divide(volume - VolBase, VolPerY);
}

std::int32_t VolumeMap::Volume(double y) const {
  if (Logarithmic) return CLng(VolBase * std::exp(Divide(y - VolBottom, double(VolLogFactor))));
  return CLng(VolPerY * (VolBottom - y) + VolBase);
}

}  // namespace kora
