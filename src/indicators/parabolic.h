#pragma once

#include <span>
#include <vector>

#include "indicators/osc_panel.h"

namespace kora {

// A stop-and-reverse trail.
//
// The start: the fourth new high with no two new lows between, or the other way round, makes
// the trend. Bar 0 counts for both sides. With trend "U" the trail starts at the bar of the
// last new low, with its low as the stop; with "D" at the last new high.
//
// The step, for trend "U" ("D" is its mirror):
// - A high below the stop reverses at once, and the new stop is a point of the trail.
// - The factor grows by 0.02 a bar while it is under 0.18. In 32 bits the ninth sum falls just
//   under 0.18, so that it goes on to 0.20.
// - The stop moves by the factor towards the bar's high, not towards the extreme.
// - A stop above the bar's low is moved back by the factor towards the lower of this low and
//   the one before.
// - A stop that is then below the stop of the bar before, or that passed the bar's high,
//   reverses with no point. The new stop is the extreme, as in the first case, but the extreme
//   of the trend that ended begins anew.
struct HighLow {
  float high, low;
};
struct ParabolicStep {
  float stop = 0;
  char trend = 'N';    // 'U' or 'D' after the bar
  bool point = false;  // the stop is a point of the trail
};
struct ParabolicTrail {
  char trend = 'N';  // at the start; 'N': the data ended before a trend
  int startBar = 0;
  float startStop = 0;
  std::vector<ParabolicStep> steps;  // by bar; from startBar + 1 on they count
};
// Error 6 where a stop leaves 32-bit floats.
ParabolicTrail Parabolic(std::span<const HighLow> bars);

void ShowParabolic(OscHost& host);
void ShowParabolicOnAverage(OscHost& host);

}  // namespace kora
