#include "scans/chart_scan2.h"

#include <algorithm>

#include "base/file_set.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/chart_list.h"
#include "scans/kept_choices.h"
#include "scans/result_list.h"

namespace kora {
namespace {

constexpr std::int32_t kMostRecords = 32767;

}  // namespace

std::optional<ScanFault> ReadScan2(const Scan2Choices& choices, Scan2Criteria& criteria) {
  criteria = {};
  if (choices.Check1)
    if (auto fault = ReadRangeBoxes(choices.Text1, choices.Text2, criteria.range)) return fault;
  if (choices.Check2) {
    const ScanFault bad{"Volume percentage increases invalid", "Volume Percentage Increases",
                        "Text3"};
    criteria.volume = Val(choices.Text3);
    if (!(*criteria.volume > 0)) return bad;
    const auto days = WholeOf(choices.Text5);
    if (!days) return ScanFault{bad.text, bad.title, "Text5"};
    criteria.days = *days;
  }
  if (choices.Check3) {
    criteria.price = Val(choices.Text4);
    if (!(*criteria.price > 0))
      return ScanFault{"Price percentage invalid", "Price Percentage Increases/decreases", "Text4"};
  }
  if (choices.Check4)
    if (auto fault = ReadClassBox(choices.Text6, criteria.filter.industry)) return fault;
  criteria.filter.noWarrants = choices.Check5;
  if (!criteria.range && !criteria.volume && !criteria.price)
    return ScanFault{"No selection made", "Selection criteria", "Check1"};
  return std::nullopt;
}

std::string KeptScan2(const Scan2Choices& c) {
  return JoinKept({Kept(c.Check1), Kept(c.Text1), Kept(c.Text2), Kept(c.Check2), Kept(c.Text3),
                   Kept(c.Text5), Kept(c.Check3), Kept(c.Text4), Kept(c.Check4), Kept(c.Text6),
                   Kept(c.Check5)});
}

void TakeKeptScan2(std::string_view text, Scan2Choices& c) {
  KeptFields kept(text);
  kept.Take(c.Check1);
  kept.Take(c.Text1);
  kept.Take(c.Text2);
  kept.Take(c.Check2);
  kept.Take(c.Text3);
  kept.Take(c.Text5);
  kept.Take(c.Check3);
  kept.Take(c.Text4);
  kept.Take(c.Check4);
  kept.Take(c.Text6);
  kept.Take(c.Check5);
}

std::vector<std::string> CellsOf(const Scan2Hit& hit) {
  return {hit.code, PriceText(hit.last), hit.volume == 0 ? " " : Str(hit.volume), hit.percent};
}

const std::vector<std::string>& Scan2Columns() {
  static const std::vector<std::string> columns{"Code", "L/Price", "Vol +", "% +/-"};
  return columns;
}

double AverageVolume(std::span<const PriceRec> records, std::int32_t count, std::int16_t days) {
  if (days <= 0) return 1;
  const std::int32_t k = count - (std::int32_t(days) + 1) <= 1 ? 1 : days;
  if (count - (k + 1) <= 1) return 0;
  // Behind the last record, k + 1 of them: the file has these, and more.
  std::int64_t sum = 0;
  for (size_t i = 0; i <= size_t(k); ++i) sum += records[records.size() - 2 - i].Volume;
  return RoundHalfEven(double(sum) / k);
}

std::optional<Scan2Hit> TestSecurity(const Scan2Criteria& criteria, const MarketItem& item) {
  const PriceRec& last = item.records.back();
  const float before = item.records[item.records.size() - 2].Close;
  if (criteria.range && !criteria.range->Holds(last.Close)) return std::nullopt;

  Scan2Hit hit;
  bool volume = false;
  const double average =
      criteria.volume ? AverageVolume(item.records, item.count, criteria.days) : 1;
  const double wanted = (criteria.volume.value_or(0) / 100 + 1) * average;
  if (last.Volume != 0 && average != 0 && wanted <= last.Volume) {
    volume = true;
    hit.volume = RoundHalfEven(last.Volume - wanted);
  }
  if (criteria.volume && !volume) return std::nullopt;

  if (criteria.price) {
    if (last.Close == 0 || before == 0) return std::nullopt;
    if (!RisesBy(*criteria.price, before, last.Close) &&
        !FallsBy(*criteria.price, before, last.Close))
      return std::nullopt;
    hit.percent = PercentText(before, last.Close) + "%";
  }
  hit.code = item.code;
  hit.indClass = Trim(item.name.IndClass.trimmed());
  hit.name = Trim(item.name.Name.trimmed());
  hit.last = last.Close;
  hit.record = item.number;
  return hit;
}

Scan2Result RunScan2(const ScanRun& run, const Scan2Criteria& criteria,
                     const std::function<void(const Scan2Hit&)>& found) {
  // The last day, and what the average before it is of.
  const std::int32_t records =
      criteria.volume ? std::min(std::max<std::int32_t>(criteria.days, 0) + 2, kMostRecords) : 2;
  Scan2Result result;
  MarketWalk walk(run.files, run.dataPath);
  result.stopped = !walk.Run(
      {.records = records, .fewest = 2, .soundPrices = true}, run.progress,
      [&](const NameRec& name) { return name.RecType == kShare && criteria.filter.Wants(name); },
      [&](const MarketItem& item) {
        if (auto hit = TestSecurity(criteria, item)) {
          result.hits.push_back(std::move(*hit));
          if (found) found(result.hits.back());
        }
      });
  result.unread = walk.unread();
  return result;
}

void SaveScan2(const Files& files, const std::string& dataPath, const std::vector<Scan2Hit>& hits) {
  std::string lines;
  std::vector<ResultEntry> entries;
  for (const Scan2Hit& hit : hits) {
    lines += hit.code + "," + hit.indClass + "," + PriceText(hit.last) + "," + hit.name + "\r\n";
    entries.push_back({hit.code, hit.record});
  }
  FileSet set(files);
  set.Add(dataPath + "ChtScan2.txt", lines);
  set.Add(ListFilePath(dataPath, kResultList), ResultListBytes(entries));
  set.Commit();
}

TextTable Scan2Print(const std::vector<Scan2Hit>& hits) {
  TextTable table;
  table.layout.heading = "CHART SCAN 2 DATA";
  table.layout.pageLabel = "      Page  ";
  table.layout.columns = {"Code", "L/Price", "Vol+", "% +/-", "Code", "L/Price", "Vol+", "% +/-"};
  table.layout.at = {0.1, 0.18, 0.26, 0.32, 0.5, 0.58, 0.66, 0.74};
  for (size_t i = 0; i < hits.size(); ++i) {
    if (i % 2 == 0) table.rows.emplace_back();
    for (std::string& cell : CellsOf(hits[i])) table.rows.back().push_back(std::move(cell));
  }
  return table;
}

std::string Scan2Ending(bool hits) {
  return hits ? "The codes have been stored in Chart Scan Results list\n"
                " This list can be selected for viewing from the\n Chart Selection Window."
              : "No records for the criteria selected were found";
}

}  // namespace kora
