#include "scans/chart_scan3.h"

#include <algorithm>
#include <array>

#include "base/numbers.h"
#include "base/text.h"
#include "scans/kept_choices.h"

namespace kora {
namespace {

constexpr std::int32_t kRecords = 101;
constexpr float kNoHigh = 0, kNoLow = 100000;
constexpr size_t kNotes = 3;

struct Start {
  Break side = Break::kNone;
  size_t record = 0;  // in the span
};

Start FindStart(std::span<const PriceRec> records, std::int32_t first) {
  float high = kNoHigh, low = kNoLow;
  int ups = 0, downs = 0;
  size_t highRecord = 0, lowRecord = 0;
  for (size_t i = 0; i < records.size(); ++i) {
    Break mark = Break::kNone;
    if (records[i].High > high) {
      high = records[i].High;
      ++ups;
      highRecord = i;
      mark = Break::kUp;
    }
    if (records[i].Low < low) {
      low = records[i].Low;
      ++downs;
      lowRecord = i;
      mark = Break::kDown;
    }
    if (first + std::int32_t(i) == 1) continue;
    if (mark == Break::kUp) {
      if (ups > 1) downs = 0;
      if (ups > 3) return {Break::kUp, lowRecord};
    } else if (mark == Break::kDown) {
      if (downs > 1) ups = 0;
      if (downs > 3) return {Break::kDown, highRecord};
    }
  }
  return {};
}

// The stop as it goes from record to record.
class Stop {
 public:
  Stop(Break side, float at) : side_(side), sar_(at), previous_(at), high_(at), low_(at) {}

  Break side() const { return side_; }
  float at() const { return sar_; }

  // False where the record's own move turned the stop.
  bool Next(const PriceRec& rec, const PriceRec& before) {
    const bool stands = side_ == Break::kUp ? Up(rec, before) : Down(rec, before);
    previous_ = sar_;
    return stands;
  }

 private:
  bool Up(const PriceRec& rec, const PriceRec& before) {
    if (rec.High < sar_) {
      TurnDown();
      return true;
    }
    high_ = std::max(high_, float(rec.High));
    Grow();
    MoveTo(rec.High);
    bool turned = sar_ > rec.High;
    if (!turned && sar_ > rec.Low) {
      MoveTo(std::min(float(rec.Low), float(before.Low)));
      turned = sar_ < previous_;
    }
    if (!turned) return true;
    TurnDown();
    high_ = kNoHigh;
    return false;
  }

  bool Down(const PriceRec& rec, const PriceRec& before) {
    if (rec.Low > sar_) {
      TurnUp();
      return true;
    }
    low_ = std::min(low_, float(rec.Low));
    Grow();
    MoveTo(rec.Low);
    bool turned = sar_ < rec.Low;
    if (!turned && sar_ < rec.High) {
      MoveTo(std::max(float(rec.High), float(before.High)));
      turned = sar_ > previous_;
    }
    if (!turned) return true;
    TurnUp();
    low_ = kNoLow;
    return false;
  }

  void TurnDown() {
    side_ = Break::kDown;
    sar_ = low_ = high_;
    factor_ = 0;
  }
  void TurnUp() {
    side_ = Break::kUp;
    sar_ = high_ = low_;
    factor_ = 0;
  }
  void Grow() {
    if (factor_ < 0.18f) factor_ = CSng(double(factor_) + 0.02);
  }
  // Never beyond the target, and so never beyond all floats.
  void MoveTo(float target) {
    sar_ = CSng((double(target) - double(sar_)) * double(factor_) + double(sar_));
  }

  Break side_;
  float sar_, previous_, high_, low_;
  float factor_ = 0;
};

}  // namespace

std::optional<ScanFault> ReadScan3(const Scan3Choices& choices, Scan3Criteria& criteria) {
  criteria = {};
  if (choices.Check1)
    if (auto fault = ReadRangeBoxes(choices.Text1, choices.Text2, criteria.range)) return fault;
  if (choices.Check2) {
    criteria.filter.category = WholeOf(choices.Text3);
    if (Trim(choices.Text3).empty() || Val(choices.Text3) < 0 || !criteria.filter.category)
      return ScanFault{"Invalid Category", "Category Selected", "Text3"};
  }
  if (choices.Check4)
    if (auto fault = ReadClassBox(choices.Text6, criteria.filter.industry)) return fault;
  criteria.filter.noWarrants = choices.Check6;
  criteria.up = choices.Check3;
  criteria.down = choices.Check5;
  if (!criteria.up && !criteria.down)
    return ScanFault{"Either Look for break UP  or Look for break DOWN need to be selected",
                     "Break Parabolic", "Check3"};
  return std::nullopt;
}

std::string KeptScan3(const Scan3Choices& c) {
  return JoinKept({Kept(c.Check1), Kept(c.Text1), Kept(c.Text2), Kept(c.Check2), Kept(c.Text3),
                   Kept(c.Check4), Kept(c.Text6), Kept(c.Check3), Kept(c.Check5), Kept(c.Check6)});
}

void TakeKeptScan3(std::string_view text, Scan3Choices& c) {
  KeptFields kept(text);
  kept.Take(c.Check1);
  kept.Take(c.Text1);
  kept.Take(c.Text2);
  kept.Take(c.Check2);
  kept.Take(c.Text3);
  kept.Take(c.Check4);
  kept.Take(c.Text6);
  kept.Take(c.Check3);
  kept.Take(c.Check5);
  kept.Take(c.Check6);
}

std::string_view BreakText(Break side) {
  return side == Break::kUp ? "UP" : side == Break::kDown ? "DOWN" : "";
}

Break FindBreak(std::span<const PriceRec> records, std::int32_t first) {
  const Start start = FindStart(records, first);
  if (start.side == Break::kNone) return Break::kNone;
  const PriceRec& from = records[start.record];
  Stop stop(start.side, start.side == Break::kUp ? from.Low : from.High);
  std::array<Break, kNotes> notes{};
  size_t noted = 0;
  for (size_t i = start.record + 1; i < records.size(); ++i) {
    if (!stop.Next(records[i], records[i - 1])) continue;
    if (stop.at() > 0 && i + kNotes >= records.size() && noted < kNotes)
      notes[noted++] = stop.side();
  }
  if (noted == 0) return Break::kNone;
  if (notes[1] == notes[0] && notes[2] == notes[0]) return Break::kNone;
  return notes[noted - 1];
}

std::vector<std::string> CellsOf(const Scan3Hit& hit) {
  return {hit.code, PriceText(hit.last), std::string(BreakText(hit.side))};
}

const std::vector<std::string>& Scan3Columns() {
  static const std::vector<std::string> columns{"Code", "L/ Price", "Up/Down"};
  return columns;
}

Scan3Result RunScan3(const ScanRun& run, const Scan3Criteria& criteria,
                     const std::function<void(const Scan3Hit&)>& found) {
  Scan3Result result;
  MarketWalk walk(run.files, run.dataPath);
  result.stopped = !walk.Run(
      {.records = kRecords, .fewest = 2, .soundPrices = true}, run.progress,
      [&](const NameRec& name) { return name.RecType == kShare && criteria.filter.Wants(name); },
      [&](const MarketItem& item) {
        const float last = item.records.back().Close;
        if (criteria.range && !criteria.range->Holds(last)) return;
        const Break side = FindBreak(item.records, item.first());
        if (!(side == Break::kUp && criteria.up) && !(side == Break::kDown && criteria.down))
          return;
        result.hits.push_back({std::string(item.code), last, side, item.number});
        if (found) found(result.hits.back());
      });
  result.unread = walk.unread();
  return result;
}

std::string Scan3Ending(bool hits) {
  return hits ? "The codes have been stored in Chart Scan list Z\n"
                " The list can be selected for viewing from the\n Chart Selection Window."
              : "No records for the criteria selected were found";
}

TextTable Scan3Print(const std::vector<Scan3Hit>& hits) {
  TextTable table;
  table.layout.heading = "CHART SCAN 3 DATA";
  table.layout.pageLabel = "      Page  ";
  table.layout.columns = {"Code", "L/ Price", "Up/Down", "Code", "L/ Price", "Up/Down"};
  table.layout.at = {0.1, 0.18, 0.26, 0.5, 0.58, 0.66};
  for (size_t i = 0; i < hits.size(); ++i) {
    if (i % 2 == 0) table.rows.emplace_back();
    for (std::string& cell : CellsOf(hits[i])) table.rows.back().push_back(std::move(cell));
  }
  return table;
}

}  // namespace kora
