#include "scans/chart_scan1.h"

#include <algorithm>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "scans/kept_choices.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr std::int32_t kRecordsForBars = 261;
constexpr std::int32_t kFewestRecords = 2, kFewestForPercent = 3;
constexpr std::string_view kTitle = "Analysis";
constexpr std::string_view kNoPercentage = "Percentage Not valid - Valid Range 1 to 200 ";

struct OscillatorRow {
  std::string_view column, name;  // in the grid; in the message
  const char* period;             // daily key of the chart defaults
  const char* checked;            // of the one that must not be 0
  const char* box;
  Rows (*rows)(std::span<const ChartBar> bars, int period);
};
constexpr std::array<OscillatorRow, kScanOscillators> kOscillators{{
    {"Stochastic", "STOCHASTIC", "StochK", "StochK", "Check2", StochasticRows},
    {"Williams %R", "WILLIAMS %R", "WmsA", "WmsA", "Check3", WilliamsRows},
    {"ROC", "RATE OF CHANGE", "RocP", "RocA", "Check5", RocRows},
    {"Momentum", "MOMENTUM", "RocP", "MMA", "Check6", MomentumRows},
    {"R.S.I", "R.S.I", "RsiP", "RsiP", "Check13", RsiRows},
}};

std::int16_t Daily(const OscSettings& osc, std::string_view key) {
  const auto found = osc.periods.find(key);
  return found == osc.periods.end() ? std::int16_t(0) : found->second.daily;
}

bool IsPercentage(std::string_view typed) {
  const double value = Val(typed);
  return value > 0 && value <= 200;
}

std::optional<std::string> PercentCell(const Scan1Criteria& criteria, const MarketItem& item) {
  if (item.count < kFewestForPercent) return std::nullopt;
  const float before = item.records[item.records.size() - 2].Close;
  const float last = item.records.back().Close;
  if (before == 0 || last == 0) return std::nullopt;
  if (last > before && criteria.rise)
    return RisesBy(*criteria.rise, before, last) ? std::optional(PercentText(before, last) + "%U")
                                                 : std::nullopt;
  if (criteria.fall && FallsBy(*criteria.fall, before, last))
    return PercentText(before, last) + "%D";
  return std::nullopt;
}

}  // namespace

std::string_view ScanOscillatorName(size_t oscillator) {
  return kOscillators.at(oscillator).column;
}

std::optional<ScanFault> ReadScan1(const Scan1Choices& choices, const OscSettings& osc,
                                   Scan1Criteria& criteria) {
  const auto fault = [](std::string_view text, std::string_view field) {
    return ScanFault{std::string(text), std::string(kTitle), std::string(field)};
  };
  criteria = {};
  if (choices.Check7) {
    const auto min = FloatOf(choices.Text3), max = FloatOf(choices.Text2);
    constexpr std::string_view kBad = "Invalid price range";
    if (Trim(choices.Text3).empty() || !min || *min < 0) return fault(kBad, "Text3");
    if (Trim(choices.Text2).empty() || !max || *max < 0) return fault(kBad, "Text2");
    if (*min > *max) return fault(kBad, "Text3");
    criteria.range = ClosingRange{*min, *max};
  }
  if (choices.Check1) {
    if (!IsPercentage(choices.Text1)) return fault(kNoPercentage, "Text1");
    criteria.rise = WholeOf(choices.Text1);
    criteria.riseText = Trim(choices.Text1);
  }
  if (choices.Check15) {
    // The range is that of the rise field, whatever stands in this one.
    if (Trim(choices.Text6).empty()) return fault(kNoPercentage, "Text6");
    if (!IsPercentage(choices.Text1)) return fault(kNoPercentage, "Text6");
    criteria.fall = WholeOf(choices.Text6);
    if (!criteria.fall) return fault(kNoPercentage, "Text6");
    criteria.fallText = Trim(choices.Text6);
  }
  if (choices.Check8) {
    criteria.filter.category = WholeOf(choices.Text4);
    if (Trim(choices.Text4).empty() || Val(choices.Text4) < 0 || !criteria.filter.category)
      return fault("Category invalid", "Text4");
  }
  if (choices.Check14) {
    if (Trim(choices.Text5).empty()) return fault("Industry Classification invalid", "Text5");
    criteria.filter.industry = Trim(choices.Text5);
  }
  criteria.filter.noWarrants = choices.Check16;
  for (size_t i = 0; i < kScanOscillators; ++i) {
    if (!choices.oscillators[i]) continue;
    const OscillatorRow& row = kOscillators[i];
    if (Daily(osc, row.checked) == 0)
      return fault("Invalid " + std::string(row.name) +
                       " Oscillator Values. Correct the values in the CHART DEFAULTS List",
                   row.box);
    criteria.periods[i] = Daily(osc, row.period);
  }
  criteria.boxes = {choices.Check9, choices.Check12, choices.Check10, choices.Check11};
  return std::nullopt;
}

std::string KeptScan1(const Scan1Choices& c) {
  return JoinKept({Kept(c.Check7), Kept(c.Text3), Kept(c.Text2), Kept(c.Check1), Kept(c.Text1),
                   Kept(c.Check15), Kept(c.Text6), Kept(c.Check8), Kept(c.Text4), Kept(c.Check16),
                   Kept(c.Text4)});
}

void TakeKeptScan1(std::string_view text, Scan1Choices& c) {
  KeptFields kept(text);
  kept.Take(c.Check7);
  kept.Take(c.Text3);
  kept.Take(c.Text2);
  kept.Take(c.Check1);
  kept.Take(c.Text1);
  kept.Take(c.Check15);
  kept.Take(c.Text6);
  kept.Take(c.Check8);
  kept.Take(c.Text4);
  kept.Take(c.Check16);
}

std::vector<std::string> CellsOf(const Scan1Hit& hit) {
  std::vector<std::string> cells{hit.code, hit.last == 0 ? "" : PriceText(hit.last), hit.percent};
  for (const Signal signal : hit.signals) cells.emplace_back(SignalText(signal));
  cells.push_back(Str(hit.record));
  return cells;
}

const std::vector<std::string>& Scan1Columns() {
  static const std::vector<std::string> columns{
      "Code", "Last $", "% +/ -", "Stochastic", "Williams %R", "ROC", "Momentum", "R.S.I", "Rec"};
  return columns;
}

std::optional<Scan1Hit> TestSecurity(const Scan1Criteria& criteria, const MarketItem& item,
                                     ChartBars& bars) {
  Scan1Hit hit;
  bool any = false;
  if (const auto percent = PercentCell(criteria, item)) {
    hit.percent = *percent;
    any = true;
  }
  const bool wanted = std::any_of(criteria.periods.begin(), criteria.periods.end(),
                                  [](std::int16_t period) { return period != 0; });
  if (wanted && criteria.boxes.any()) {
    LoadDailyBars(item.records, item.first(), item.name.RecType, bars);
    for (size_t i = 0; i < kScanOscillators; ++i) {
      if (criteria.periods[i] == 0) continue;
      const Rows rows = kOscillators[i].rows(bars.bars, criteria.periods[i]);
      if (!rows) continue;
      const Signal signal = SignalOf(*rows);
      if (!criteria.boxes.Report(signal)) continue;
      hit.signals[i] = signal;
      any = true;
    }
  }
  if (!any) return std::nullopt;
  hit.code = item.code;
  hit.last = item.records.back().Close;
  hit.record = item.number;
  return hit;
}

Scan1Result RunScan1(const ScanRun& run, const Scan1Criteria& criteria,
                     const std::function<void(const Scan1Hit&)>& found) {
  const bool bars =
      criteria.boxes.any() && std::any_of(criteria.periods.begin(), criteria.periods.end(),
                                          [](std::int16_t period) { return period != 0; });
  const WalkPlan plan{.records = bars ? kRecordsForBars : kFewestRecords,
                      .fewest = kFewestRecords,
                      .soundPrices = true};
  Scan1Result result;
  ChartBars room;
  MarketWalk walk(run.files, run.dataPath);
  result.stopped = !walk.Run(
      plan, run.progress,
      [&](const NameRec& name) {
        return criteria.filter.Wants(name) && name.RecType != kAdvanceDecline;
      },
      [&](const MarketItem& item) {
        const PriceRec& last = item.records.back();
        if (last.RecDate.raw() > result.latest) result.latest = last.RecDate.raw();
        if (criteria.range && !criteria.range->Holds(last.Close)) return;
        if (auto hit = TestSecurity(criteria, item, room)) {
          result.hits.push_back(std::move(*hit));
          if (found) found(result.hits.back());
        }
      });
  result.unread = walk.unread();
  return result;
}

std::string LatestText(std::string_view date) {
  const bool digits = date.size() == 8 && std::all_of(date.begin(), date.end(),
                                                      [](char c) { return c >= '0' && c <= '9'; });
  if (!digits) return "";
  const std::string_view month = date.substr(4, 2);
  return std::string(date.substr(6)) + "/" +
         std::string(month[0] == '0' ? month.substr(1) : month) + "/" +
         std::string(date.substr(0, 4));
}

std::string Scan1Ending(const Scan1Criteria& criteria, bool hits) {
  if (hits)
    return "The codes have been stored in list Chart Scan Results List\n"
           " This list can be selected to view charts from the\n Chart Selection form.";
  const std::string signals = "\n or Buy/Sell Indications ";
  if (criteria.rise && criteria.fall)
    return "There were no rises of " + criteria.riseText + "% or falls of " + criteria.fallText +
           "%" + signals;
  if (criteria.rise) return "There were no rises of " + criteria.riseText + "%" + signals;
  if (criteria.fall) return "There were no falls of " + criteria.fallText + "%" + signals;
  return "There were no Buy/Sell Indications ";
}

std::vector<size_t> SortByPercentage(const std::vector<std::string>& percents) {
  constexpr size_t kKey = 12;
  std::vector<SortEntry> items;
  for (const std::string& text : percents)
    items.push_back({CLng(double(items.size())), PadRight(text, kKey)});
  ShellSort(items);
  std::vector<size_t> order;
  for (const SortEntry& item : items) order.push_back(size_t(item.RecNo));
  return order;
}

}  // namespace kora
