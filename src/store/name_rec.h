#pragma once

#include <cstddef>
#include <cstdint>

#include "base/text.h"

namespace kora {

// Kinds of data a price file holds.
enum RecTypeValue : std::int16_t {
  kCloseVolume = 1,  // close with volume
  kCloseOnly = 2,
  kAdvanceDecline = 3,  // High is Rises, Low is Falls, Close the cumulative total
  kShare = 4,           // dollars
  kIndex = 5,           // points
};

#pragma pack(push, 1)
// One record of Names.dat, 96 bytes, little-endian, texts ANSI and blank padded.
struct NameRec {
  std::int16_t NameStatus;  // 0 normal, 1 deleted, 9 marked by the adjustment list
  FixedText<6> Code;        // upper case
  std::int16_t RecType;     // 1 to 5
  FixedText<35> Name;       // title on the chart
  FixedText<15> OtherDetails;
  float Base;  // manual scale; 0 none set
  float Top;
  float PFInc;          // point-and-figure box; 0 compute one
  float MinMove;        // always written as 0.05
  std::int16_t BandUp;  // percent; outside 1 to 100 means 5
  std::int16_t BandDown;
  std::int16_t BollPeriods;
  std::int16_t BollWidth;
  std::int16_t Category;   // 0 to 99
  FixedText<1> Id;         // source letter
  FixedText<3> IndClass;   // three digits
  FixedText<6> NameSpare;  // copied unchanged
};
#pragma pack(pop)

static_assert(sizeof(NameRec) == 96);
static_assert(offsetof(NameRec, Code) == 2 && offsetof(NameRec, RecType) == 8 &&
              offsetof(NameRec, Name) == 10 && offsetof(NameRec, OtherDetails) == 45 &&
              offsetof(NameRec, Base) == 60 && offsetof(NameRec, Top) == 64 &&
              offsetof(NameRec, PFInc) == 68 && offsetof(NameRec, MinMove) == 72 &&
              offsetof(NameRec, BandUp) == 76 && offsetof(NameRec, BandDown) == 78 &&
              offsetof(NameRec, BollPeriods) == 80 && offsetof(NameRec, BollWidth) == 82 &&
              offsetof(NameRec, Category) == 84 && offsetof(NameRec, Id) == 86 &&
              offsetof(NameRec, IndClass) == 87 && offsetof(NameRec, NameSpare) == 90);

// A record with the defaults of a new security: RecType 4, Category 1, MinMove 0.05, texts
// blank, numbers 0. The code is padded and upper-cased.
NameRec NewNameRec(std::string_view code);

}  // namespace kora
