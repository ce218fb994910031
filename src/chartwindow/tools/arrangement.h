#pragma once

#include "chart/chart_request.h"

namespace kora {

// How the charts of the window stand. The window alone changes it: by what the user starts, and
// by what became of a composition.
enum class Arrangement {
  kOne,
  kUpper,         // the upper of two charts stands: the next goes below it
  kSplit,         // both stand
  kUnder,         // the first of two in one frame stands: the next goes over it
  kSuperimposed,  // both stand
  kMulti,         // the multi-oscillator view owns the chart
};

constexpr bool AwaitsSecond(Arrangement a) {
  return a == Arrangement::kUpper || a == Arrangement::kUnder;
}
constexpr bool IsSplit(Arrangement a) {
  return a == Arrangement::kUpper || a == Arrangement::kSplit;
}
// Two charts share the picture, or will.
constexpr bool IsPair(Arrangement a) { return a != Arrangement::kOne && a != Arrangement::kMulti; }

// Where the next chart goes.
constexpr ChartPlace PlaceOfNext(Arrangement a) {
  switch (a) {
    case Arrangement::kUpper: return ChartPlace::kLower;
    case Arrangement::kUnder: return ChartPlace::kOver;
    case Arrangement::kMulti: return ChartPlace::kWide;
    default: return ChartPlace::kAlone;
  }
}
// What stands after a composition at `place`. Of a pair whose second failed the first still
// stands; a first that failed leaves no pair.
constexpr Arrangement ArrangementAfter(ChartPlace place, bool drawn) {
  switch (place) {
    case ChartPlace::kUpper: return drawn ? Arrangement::kUpper : Arrangement::kOne;
    case ChartPlace::kUnder: return drawn ? Arrangement::kUnder : Arrangement::kOne;
    case ChartPlace::kLower: return Arrangement::kSplit;
    case ChartPlace::kOver: return Arrangement::kSuperimposed;
    case ChartPlace::kWide: return drawn ? Arrangement::kMulti : Arrangement::kOne;
    default: return Arrangement::kOne;
  }
}

}  // namespace kora
