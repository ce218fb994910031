#include "indicators/ema_column.h"

#include "base/numbers.h"
#include "indicators/osc_series.h"

namespace kora {

void EmaColumn(int period, int offset, int seedFrom, std::span<const float> source,
               std::span<float> out) {
  const int count = static_cast<int>(source.size());
  const int first = period + offset;
  if (period < 1 || first >= count) return;
  double sum = 0;
  for (int i = seedFrom; i <= first; ++i) sum += At(source, i);
  At(out, first) = CSng(sum / period);
  const double k = 2.0 / (period + 1);
  for (int i = first + 1; i < count; ++i)
    At(out, i) = CSng(At(source, i) * k + (1 - k) * At(out, i - 1));
}

std::vector<float> CloseColumn(const ChartBars& bars) {
  std::vector<float> closes(static_cast<size_t>(bars.BarCount) + 1);
  for (int i = 0; i <= bars.BarCount; ++i) At(closes, i) = At(bars, i).Close;
  return closes;
}

}  // namespace kora
