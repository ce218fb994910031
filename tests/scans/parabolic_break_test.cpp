#include <gtest/gtest.h>

#include "scans/chart_scan3.h"
#include "tests/support/records.h"

using namespace kora;
using kora::test::Day;

namespace {

struct Range {
  float high, low;
};

std::vector<PriceRec> Records(const std::vector<Range>& ranges) {
  std::vector<PriceRec> out;
  for (const Range& r : ranges) out.push_back(Day("20000103", r.low, r.high, r.low, r.low));
  return out;
}
Break Of(const std::vector<Range>& ranges, std::int32_t first = 1) {
  return FindBreak(Records(ranges), first);
}
// The same upside down, about 10.
std::vector<Range> Mirror(std::vector<Range> ranges) {
  for (Range& r : ranges) r = {20 - r.low, 20 - r.high};
  return ranges;
}

// Four rising highs make the side "U"; the stop starts at the first low, 9, and goes 9.04,
// 9.1584, 9.3889. The fifth record pulls it back from 9.5978 to 9.5660, and at the sixth the
// whole record lies below it: the stop turns to the highest high, 13.
const std::vector<Range> kUpToFifth{{10, 9}, {11, 9.5f}, {12, 10.5f}, {13, 11}, {12, 9.2f}};
const Range kBreak{9, 8}, kAfter{8.5f, 7.5f}, kLater{8.2f, 7};

std::vector<Range> Join(std::vector<Range> a, const std::vector<Range>& b) {
  a.insert(a.end(), b.begin(), b.end());
  return a;
}

}  // namespace

TEST(ParabolicBreakTest, ABreakOnTheLastRecord) {
  EXPECT_EQ(Of(Join(kUpToFifth, {kBreak})), Break::kDown);
  EXPECT_EQ(Of(Mirror(Join(kUpToFifth, {kBreak}))), Break::kUp);
}

TEST(ParabolicBreakTest, ABreakOnTheLastButOneRecord) {
  EXPECT_EQ(Of(Join(kUpToFifth, {kBreak, kAfter})), Break::kDown);
  EXPECT_EQ(Of(Mirror(Join(kUpToFifth, {kBreak, kAfter}))), Break::kUp);
}

// Three notes of one side are none: the third-last record notes the side that it came to.
TEST(ParabolicBreakTest, ABreakOnTheThirdLastRecordIsNoneAndNorIsOneBefore) {
  EXPECT_EQ(Of(Join(kUpToFifth, {kBreak, kAfter, kLater})), Break::kNone);
  EXPECT_EQ(Of(Join(kUpToFifth, {kBreak, kAfter, kLater, {8, 6.5f}})), Break::kNone);
}

TEST(ParabolicBreakTest, AStandingSideIsNoBreak) {
  EXPECT_EQ(Of(kUpToFifth), Break::kNone);
  EXPECT_EQ(Of(Mirror(kUpToFifth)), Break::kNone);
}

// A stop that its own move turns makes no note, and two notes are not three of one side: what was
// noted before decides.
TEST(ParabolicBreakTest, AStopTurnedByItsOwnMoveMakesNoNote) {
  // At the fifth record 9.3978 is above the low 5 and falls to 9.0460, below the stop before it.
  std::vector<Range> ranges(kUpToFifth.begin(), kUpToFifth.begin() + 4);
  ranges.push_back({9.5f, 5});
  EXPECT_EQ(Of(ranges), Break::kUp);
  EXPECT_EQ(Of(Mirror(ranges)), Break::kDown);
}

TEST(ParabolicBreakTest, WithoutFourExtremesOfOneKindThereIsNoSide) {
  EXPECT_EQ(Of({{10, 9}, {11, 9.5f}, {12, 10.5f}}), Break::kNone);
  EXPECT_EQ(Of({{10, 9}, {11, 9.5f}, {12, 10.5f}, {11, 10}}), Break::kNone);
  EXPECT_EQ(Of({{10, 9}, {10, 9}, {10, 9}, {10, 9}, {5, 4}}), Break::kNone);
}

// The first record of the file counts as a high and as a low and decides nothing; the first of a
// later part counts as both, and as a low alone it clears no highs.
TEST(ParabolicBreakTest, TheFirstRecordAddsToTheCounts) {
  // Highs 1 to 4 at records 1 to 4.
  const std::vector<Range> four{{10, 9}, {11, 9.5f}, {12, 10.5f}, {13, 11}, {9, 8}};
  EXPECT_EQ(Of(four), Break::kDown);
  EXPECT_EQ(Of(four, 50), Break::kDown);
}

// A record that makes both a new high and a new low is a low.
TEST(ParabolicBreakTest, ARecordThatDoesBothIsALow) {
  // Four records beyond both ends of the one before make the side "D" with the stop at 13; it goes
  // to 12.30, and the last record lies above it. As highs they would have made the side "U", far
  // below.
  EXPECT_EQ(Of({{10, 9}, {11, 8}, {12, 7}, {13, 6}, {9, 6.5f}, {9, 7}, {9, 7}, {14, 13.5f}}),
            Break::kUp);
}

TEST(ParabolicBreakTest, AStopAtOrBelowZeroNotesNothing) {
  // Down to lows below 0; the stop starts at the first high, -1, and never is above 0.
  EXPECT_EQ(Of({{-1, -2}, {-2, -3}, {-3, -4}, {-4, -5}, {-5, -6}, {-1, -1}}), Break::kNone);
}

// The factor grows while it is below 0.18 and so ends at 0.2: ten steps of 0.02 in 32-bit floats.
TEST(ParabolicBreakTest, TheFactorEndsAtTwoTenths) {
  // Highs stand at 100, and the stop comes nearer by the factor at each record. A record between
  // where 0.2 and where 0.18 bring the stop lies below the one and above the other.
  std::vector<Range> ranges{{10, 9}, {20, 19}, {30, 29}, {40, 39}};
  while (ranges.size() < 31) ranges.push_back({100, 99.9f});
  double fast = 9, slow = 9, factorFast = 0, factorSlow = 0;
  for (size_t i = 1; i < ranges.size(); ++i) {
    factorFast = std::min(factorFast + 0.02, 0.20);
    factorSlow = std::min(factorSlow + 0.02, 0.18);
    fast += (ranges[i].high - fast) * factorFast;
    slow += (ranges[i].high - slow) * factorSlow;
  }
  ASSERT_GT(fast, slow + 0.1);
  const float between = float((fast + slow) / 2);
  ranges.push_back({between, between - 0.01f});
  EXPECT_EQ(Of(ranges), Break::kDown);
}
