#pragma once

#include <cstdint>

namespace kora {

// A chart range and its grid. GridStep survives from one chart to the next: a range that no
// row of the step table covers keeps it, and in a fresh run takes what it starts with.
struct ChartScale {
  float ScaleLow = 0, ScaleHigh = 0;
  float GridStep = 0.02f;  // never 0
  std::int16_t GridCount = 0;
  double Range = 0;  // ScaleHigh - ScaleLow to two decimals, as the step was picked by
};

// Automatic scale: rounds `high` and `low` (the highest High and lowest Low) outward to a chart
// range and picks the grid step. Error 6 for a range beyond 32 bits.
void SetChartScaleAutomatic(float high, float low, ChartScale& scale);

// Manual scale from the name record. When either is 0 both become 0, nothing else is set, and
// the composer tells the user.
void SetChartScaleManual(float base, float top, ChartScale& scale);

// The way from a price to a screen y and back.
struct PriceMap {
  bool Logarithmic = false;
  float ScaleLow = 0;
  float PricePerY = 1;  // arithmetic: price per y unit
  float LogBase = 0;    // ln ScaleLow
  float LogFactor = 1;  // y units per log unit, negative
  std::int16_t ChartBottom = 0;

  // y of a price, half to even; under logarithms the floor. Error 6 outside 16 bits.
  //   arithmetic: ChartBottom - (v - ScaleLow) / PricePerY
  //   log:        Int(LogFactor * (ln v - LogBase) + ChartBottom)
  // A 0 under logarithms stands as if ln v were ln 10, a negative v as if it were
  // ln 10 / ln |v| (error 11 for -1).
  std::int16_t Y(double price) const;

  // The price at y, unrounded.
  double Price(double y) const;
};

// The way from a volume to a screen y and back.
struct VolumeMap {
  bool Logarithmic = false;
  double VolBase = 0, VolPeak = 0, VolMean = 0;
  float VolPerY = 1;
  float VolLogBase = 0;  // ln VolBase; set on logarithmic price charts alone and kept otherwise
  float VolLogFactor = 1;
  std::int16_t VolTop = 0, VolBottom = 0;

  // Unrounded y; callers hold it to the panel or convert it.
  double RawY(double volume) const;
  // The volume at y, rounded half to even to 32 bits.
  std::int32_t Volume(double y) const;
};

}  // namespace kora
