#include "indicators/williams.h"

#include <cmath>
#include <string>

#include "base/numbers.h"
#include "indicators/osc_series.h"
#include "indicators/sliding_range.h"

namespace kora {
namespace {

// CInt that leaves `place` as it was where the value does not fit 16 bits or is no number.
void SetPlace(std::int16_t& place, double value) {
  const double rounded = RoundHalfEven(value);
  if (rounded >= -32768 && rounded <= 32767) place = CInt(rounded);
}

void Draw(OscHost& host, int P) {
  OscPanel panel(host);
  panel.Frame();
  panel.Title("Williams %R Oscillator (" + Str(std::int32_t(P)) + " Period)");

  const double height = panel.PanelBottom - panel.PanelTop - 20;
  const double top = panel.PanelTop + 10;
  const double unit = height / 100.0;
  panel.Guide(CInt(height * 0.1 + top), "O/B");
  panel.Guide(CInt(height * 0.9 + top), "O/S");

  const std::vector<WilliamsPoint> series =
      WilliamsSeries(host.chart.Bars, host.request.Name.RecType, P);
  if (!series.empty()) host.LastValues = {series.back().W};
  float slots[3];
  RollingWindow<float, float> window(slots, 3);
  std::int16_t x = panel.PanelLeft, y = 0, meanY = 0;
  double previousX = 0, previousY = 0;
  int points = 0;
  for (const WilliamsPoint& point : series) {
    SetPlace(x, panel.PanelLeft + double(point.Bar) * host.chart.BarSpacing);
    SetPlace(y, point.W * unit + top);
    if (!window.Add(y)) continue;
    SetPlace(meanY, window.Total() / 3.0);
    if (points >= 3) panel.Line('H', previousX, previousY, x, meanY, kOscLine1);
    ++points;
    previousX = x;
    previousY = meanY;
  }
}

}  // namespace

std::vector<WilliamsPoint> WilliamsSeries(const ChartBars& bars, std::int16_t recType, int P) {
  std::vector<WilliamsPoint> series;
  const int last = LastBar(bars);
  series.reserve(size_t(last + 1));
  const bool closes = recType >= kCloseVolume && recType <= kAdvanceDecline;
  float w = 0;
  SlidingRange window(last + 1);
  for (int i = 0; i <= last; ++i) {
    const ChartBar& bar = bars[size_t(i)];
    window.Add(i, closes ? bar.Close : bar.High, closes ? bar.Close : bar.Low);
    if (i < P) continue;
    const auto [highest, lowest] = window.Since(i - P + 1, {-100000.0f, 100000.0f});
    const float range = highest - lowest;
    if (highest == 0 || range == 0) continue;
    const double value = double(highest - bar.Close) / range * 100.0;
    const float kept = static_cast<float>(value);
    if (std::isfinite(kept)) w = kept;
    series.push_back({i, w});
  }
  return series;
}

void ShowWilliams(OscHost& host) {
  RunOscillator(host, "Chart Display", false, [&] {
    const std::int16_t P = host.Period(kWmsA);
    if (P != 0) Draw(host, P);
  });
}

}  // namespace kora
