#include "scans/market_statistics.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <unordered_map>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "scans/kept_choices.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr std::int32_t kStandingTop = 20;
constexpr size_t kColumns = 12;
constexpr std::uint64_t kLargestKept = 4u << 20;
constexpr std::array<StatsModeEntry, 4> kModes{{
    {StatsMode::kAll, "ALL", "Check ALL stocks"},
    {StatsMode::kThree, "3", "Check only FP shares"},
    {StatsMode::kNoWarrants, "NW", "Do NOT check Warrants"},
    {StatsMode::kWarrantsOnly, "WO", "Check Warrants only"},
}};

std::string StatsFile(const std::string& dataPath) { return dataPath + "Stats.dat"; }

// Twelve characters that order as texts from the largest rise to the largest fall.
std::string KeyOf(Currency change) {
  constexpr std::int64_t kMost = 499999999999, kZero = 500000000000;
  const std::string digits = std::to_string(kZero - std::clamp(change.units(), -kMost, kMost));
  return std::string(12 - std::min<size_t>(12, digits.size()), '0') + digits;
}

StatsCell CellOf(const Mover& mover) {
  return {.code = mover.code,
          .name = {},
          .indClass = {},
          .latest = Format(mover.latest, "0.00#"),
          .previous = Format(mover.previous, "0.00#"),
          .percent = Format(mover.change.ToDouble() * 100, "0.00") + " %"};
}

// Names and classes of the movers on show, in one pass over the name file.
void LookUpNames(const ScanRun& run, std::vector<StatsRow>& rows) {
  std::unordered_map<std::string, std::vector<StatsCell*>> wanted;
  for (StatsRow& row : rows)
    for (StatsCell* cell : {&row.rise, &row.fall}) wanted[cell->code].push_back(cell);
  NoProgress quiet;
  MarketWalk(run.files, run.dataPath).Run({}, quiet, {}, [&](const MarketItem& item) {
    const auto found = wanted.find(std::string(item.code));
    if (found == wanted.end()) return;
    for (StatsCell* cell : found->second) {
      cell->name = Trim(item.name.Name.trimmed());
      cell->indClass = Trim(item.name.IndClass.trimmed());
    }
    wanted.erase(found);  // the first record of a code counts
  });
}

}  // namespace

std::span<const StatsModeEntry> StatsModes() { return kModes; }

std::optional<StatsMode> StatsModeOf(std::string_view word) {
  for (const StatsModeEntry& entry : kModes)
    if (EqualNoCase(entry.word, word)) return entry.mode;
  return std::nullopt;
}

bool StatsWants(StatsMode mode, std::string_view code) {
  switch (mode) {
    case StatsMode::kAll: return true;
    case StatsMode::kThree: return code.size() == 3;
    case StatsMode::kNoWarrants: return code.size() < 6;
    case StatsMode::kWarrantsOnly: return code.size() == 6;
  }
  return false;
}

std::int32_t StatsTop(std::string_view typed) {
  if (Trim(typed).empty()) return kStandingTop;
  const double top = RoundHalfEven(Val(typed));
  return CLng(std::clamp(top, 0.0, 1e9));
}

std::optional<Mover> CountSecurity(std::string_view code, const PriceRec& before,
                                   const PriceRec& last, StatsCounts& counts) {
  if (last.Volume <= 1) {
    ++counts.Untraded;
    return std::nullopt;
  }
  ++counts.Traded;
  const float latest = last.Close, previous = before.Close;
  if (latest == previous) {
    ++counts.Steady;
    return std::nullopt;
  }
  const bool rise = latest > previous;
  ++(rise ? counts.Rises : counts.Falls);
  const float difference = latest - previous;
  if (difference == 0 || previous == 0) return std::nullopt;
  const float fraction = difference / previous;
  constexpr double kMostCurrency = 9e14;
  if (!(std::fabs(double(fraction)) < kMostCurrency)) return std::nullopt;
  const Currency change{double(fraction)};
  if (rise ? change.units() <= 0 : change.units() >= 0) return std::nullopt;
  return Mover{std::string(code), latest, previous, change};
}

void SortStats(std::vector<Mover>& movers) {
  if (movers.size() < 2) return;
  std::vector<SortEntry> items;
  for (const Mover& mover : movers)
    items.push_back({CLng(double(items.size())), KeyOf(mover.change)});
  ShellSort(items);
  std::vector<Mover> sorted;
  for (const SortEntry& item : items) sorted.push_back(std::move(movers[size_t(item.RecNo)]));
  movers = std::move(sorted);
}

MarketStats ShowStats(const ScanRun& run, StatsMode mode, std::int32_t top) {
  if (!run.files.CheckFile(NameFilePath(run.dataPath))) throw RunTimeError(kFileNotFound);
  MarketStats out;
  std::vector<Mover> movers;
  run.progress.Show(ProgressLine::kState, "Checking Statistics");
  MarketWalk walk(run.files, run.dataPath);
  out.stopped = !walk.Run(
      {.records = 2, .fewest = 2, .soundPrices = true}, run.progress,
      [&](const NameRec& name) { return StatsWants(mode, Trim(name.Code.trimmed())); },
      [&](const MarketItem& item) {
        if (auto mover = CountSecurity(item.code, item.records[0], item.records[1], out.counts))
          movers.push_back(std::move(*mover));
      });
  out.unread = walk.unread();
  if (out.stopped) return out;

  run.progress.Show(ProgressLine::kState, "SORTING STATISTICS");
  SortStats(movers);
  const size_t shown = std::min(size_t(std::max(top, 0)), movers.size());
  for (size_t i = 0; i < shown; ++i)
    out.rows.push_back({CellOf(movers[i]), CellOf(movers[movers.size() - 1 - i])});
  LookUpNames(run, out.rows);
  run.progress.Show(ProgressLine::kState, "COMPLETED");
  return out;
}

std::string StatsErrorText(const RunTimeError& error) {
  switch (error.number()) {
    case kDeviceError:
    case kDeviceNotAvailable:
    case kDiskNotReady: return "There is a device problem. Check and retry";
    case kBadFileName:
    case kFileNotFound:
    case kBadRecordNumber:
    case kPathAccess:
    case kPathNotFound: return "There is a file access problem. Check directory paths option.";
    case kOutOfMemory:
    case kOutOfTextSpace:
    case kOutOfStack: return "There is a memory problem. Try closing windows and restarting";
    default: return "There is an unexpected error - " + std::string(error.what());
  }
}

const std::vector<std::string>& StatsColumns() {
  static const std::vector<std::string> columns{"Code",     "Name",   "Class",    "Latest",
                                                "Previous", "+%",     "Code",     "Name",
                                                "Class",    "Latest", "Previous", "-%"};
  return columns;
}

std::vector<std::vector<std::string>> StatsTexts(const MarketStats& statistics) {
  std::vector<std::vector<std::string>> texts;
  for (const StatsRow& row : statistics.rows) {
    texts.emplace_back();
    for (const StatsCell* cell : {&row.rise, &row.fall})
      for (const std::string* text : {&cell->code, &cell->name, &cell->indClass, &cell->latest,
                                      &cell->previous, &cell->percent})
        texts.back().push_back(*text);
  }
  texts.emplace_back();
  const StatsCounts& counts = statistics.counts;
  for (const auto& [name, count] :
       {std::pair("Rises", counts.Rises), std::pair("Falls", counts.Falls),
        std::pair("Steady", counts.Steady), std::pair("Traded", counts.Traded),
        std::pair("Untraded", counts.Untraded)})
    texts.push_back({name, Str(count)});
  return texts;
}

void KeepStats(const Files& files, const std::string& dataPath,
               const std::vector<std::vector<std::string>>& texts) {
  std::string out;
  for (const std::vector<std::string>& row : texts) {
    for (size_t i = 0; i < row.size(); ++i) {
      if (i > 0) out += '\t';
      // A cell that a foreign name file fills with anything stays one cell.
      for (const char c : row[i]) out += static_cast<unsigned char>(c) < 0x20 ? ' ' : c;
    }
    out += "\r\n";
  }
  const auto held = files.lock().Hold();
  files.WriteAll(StatsFile(dataPath), out);
}

std::vector<std::vector<std::string>> KeptStats(const Files& files, const std::string& dataPath) {
  std::string text;
  try {
    text = files.ReadAll(StatsFile(dataPath), kLargestKept);
  } catch (const RunTimeError&) {
    return {};
  }
  std::vector<std::vector<std::string>> texts;
  LineReader lines(text);
  std::string_view line;
  while (lines.Next(line)) {
    texts.emplace_back();
    for (const std::string_view cell : Split(line, '\t')) {
      if (texts.back().size() == kColumns) break;
      texts.back().emplace_back(cell);
    }
  }
  return texts;
}

TextTable StatsPrint(const std::vector<std::vector<std::string>>& texts, std::string_view date) {
  TextTable table;
  table.layout.heading = "STATISTICS";
  if (!date.empty()) table.layout.heading += "  " + std::string(date);
  table.layout.columns = StatsColumns();
  table.layout.at = {0, 0.07, 0.24, 0.30, 0.37, 0.44, 0.52, 0.59, 0.76, 0.82, 0.89, 0.95};
  table.layout.lineHeight = 1.15;
  for (const std::vector<std::string>& row : texts) {
    table.rows.emplace_back();
    for (const std::string& cell : row) table.rows.back().push_back(FromAnsi(cell));
  }
  return table;
}

}  // namespace kora
