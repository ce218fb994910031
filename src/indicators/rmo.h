#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "indicators/osc_panel.h"

namespace kora {

// RMO: how a security does against the compare file.
//
//   ratio = close of compare / (close of security * 100)
//   value = mean of the last P ratios - ratio
//
// so that it rises when the security does better.
//
// - It is taken over the whole of the security's file, its last 30,000 records at most, whatever
//   is on show: what lies before the chart only warms up windows and scale. It is drawn on
//   daily charts alone.
// - The files are paired from their ends. Pairs that one of them lacks, and a zero close, give a
//   ratio of 0, which is passed over.
// - The scale is a running one: each bar is drawn in the range of the values seen up to it, so
//   that early points lie on another scale than late ones. This is the look of RMO; the range is
//   never taken over the whole series first.
// - A bar at which the highest, the lowest or the range is 0 is left, and counts twice in what
//   is held against FirstDataRec, so that the plot starts a bar earlier for each.
// - Bars that are passed over take no room: the next one follows one spacing behind.
// - The guides are fixed in the panel and have no regard to the data.
//
// Sums are 64-bit, so that the mean of equal ratios is that ratio; ratio and value are 32-bit.

// A bar of the working array.
struct RelRec {
  float Ratio = 0;
  float Value = 0;  // 0 where there is none
};

// Pairs the closes from their ends: one element for each of the security's, oldest first.
std::vector<RelRec> PairFromEnd(std::span<const float> security, std::span<const float> compare);

// Sets the values. Error 9 when P is below 1.
void SetRmoValues(std::vector<RelRec>& series, int P);

inline constexpr OscKey kRmoP{"RmoP", "RmoPW", 30, 30, "RMO periods"};
inline constexpr OscKey kRmoA{"RmoA", "RmoAW", 10, 10, "RMO average"};

void ShowRMO(OscHost& host);

}  // namespace kora
