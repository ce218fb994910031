#pragma once

#include <cstdint>
#include <vector>

#include "indicators/osc_panel.h"
#include "store/chart_bars.h"

namespace kora {

// Plus and minus directional indicator over N bars, and ADX over M.
//
//   up = High - High before   down = Low before - Low
//   plus = up where up > 0 and up > down, minus = down where down > 0 and down > up, else 0
//   DI = Int(mean of the last N (movement / true range) * 100)
//   DX = |Int((plus DI - minus DI) / (plus DI + minus DI) * 100)|
//   ADX = CInt((1 - k) * DX + (1 - k) * the state before), k = 2 / (M + 1)
//
// - Each bar's ratio is taken on its own and then averaged. Until N ratios are in, DI is 0; an
//   N below 1 takes each bar's ratio as it is.
// - Int rounds down, and before the sign goes: -33.3 becomes a DX of 34.
// - Both terms of ADX carry 1 - k: it is a sum of weight 2 - 2k and no average, settles near
//   (1 - k) / k times DX and has its own scale. Its seed is (1 - k) times the mean of the M DX
//   from bar N + 1 on, and is stored nowhere: the first ADX stands at bar N + M + 1.
// - M below 1 has no ADX.
struct DmSeries {
  struct Row {
    std::int16_t plusDI = 0, minusDI = 0, DX = 0, ADX = 0;
  };
  std::vector<Row> rows;
  std::int16_t diTop = -100;                    // greatest DI of either kind
  std::int16_t adxHigh = -100, adxLow = 10000;  // of the non-zero ADX
};
// Error 6 where a value leaves 16 bits.
DmSeries DirectionalMovement(const ChartBars& bars, int N, int M);

inline constexpr OscKey kDMA{"DMA", "DMW", 14, 14, "Directional Move DX"};
inline constexpr OscKey kDMXA{"DMXA", "DMXW", 14, 14, "Directional Move ADX"};

void ShowDirectionalMovement(OscHost& host);

}  // namespace kora
