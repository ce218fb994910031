#include "maintenance/data_checks.h"

#include <algorithm>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <map>
#include <unordered_set>

#include "base/file_set.h"
#include "base/home_lock.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/chart_list.h"
#include "maintenance/failures.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "store/market_walk.h"
#include "store/name_file.h"
#include "store/price_edit.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Checking Data Files";
constexpr const char* kNameTitle = "Name File - Data Files Check";
constexpr const char* kTotalsTitle = "Advance/Decline";
constexpr int kFilesTogether = 64;
constexpr size_t kBytesTogether = 32u << 20;

// The price files of a folder, in upper case.
std::unordered_set<std::string> PriceFilesOf(const Files& files, const std::string& dataPath) {
  std::unordered_set<std::string> out;
  for (const std::string& name : files.io().List(files.HostPath(dataPath)))
    if (std::string upper = UCase(name); upper.ends_with(".WDT")) out.insert(std::move(upper));
  return out;
}

// Holds a bit of kZeroMarks where one of the two is +0 or -0: 1 taken from its other bits reaches the
// highest. Millions are asked, two at a time and without a branch.
constexpr std::uint64_t kZeroMarks = 0x8000000080000000u;
std::uint64_t ZeroMarks(float a, float b) {
  const std::uint64_t bits =
      std::uint64_t(std::bit_cast<std::uint32_t>(a)) << 32 | std::bit_cast<std::uint32_t>(b);
  return (bits & ~kZeroMarks) - 0x0000000100000001u;
}

class PriceCheck {
 public:
  PriceCheck(const Files& files, const std::string& dataPath, const DataCheckPlan& plan,
             Progress& progress, DataCheck& check)
      : files_(files),
        dataPath_(dataPath),
        plan_(plan),
        progress_(progress),
        check_(check),
        set_(files) {}

  void Run(Dialogs& dialogs);
  std::string inHand;

 private:
  bool Wants(const NameRec& name) const {
    return name.RecType >= 1 && name.RecType <= 5 && name.RecType != kAdvanceDecline &&
           plan_.types[size_t(name.RecType)];
  }
  void Visit(const MarketItem& item);
  void List(const MarketItem& item, std::string text);
  bool Repair(std::vector<PriceRec>& records, float first) const;
  void PutInPlace();
  void SaveList() const;

  const Files& files_;
  const std::string& dataPath_;
  const DataCheckPlan& plan_;
  Progress& progress_;
  DataCheck& check_;
  FileSet set_;
  int waiting_ = 0;
  size_t bytes_ = 0;
  std::vector<ListRec> listed_;
};

void PriceCheck::List(const MarketItem& item, std::string text) {
  progress_.Show(ProgressLine::kNote, text);
  check_.messages.push_back(std::move(text));
  check_.codes.emplace_back(item.code);
  if (item.number > kMostNames) return;
  ListRec rec;
  rec.ListRecNo = CInt(item.number);
  rec.ListCode.set(item.name.Code.raw());
  listed_.push_back(rec);
}

// The last close that is not 0 stands in for what is.
bool PriceCheck::Repair(std::vector<PriceRec>& records, float first) const {
  bool changed = false;
  float kept = first;
  for (PriceRec& rec : records) {
    if (rec.Close != 0) kept = rec.Close;
    // By name: the records are packed, and a price that is reached by a pointer may not be aligned.
    const bool any = rec.Open == 0 || rec.High == 0 || rec.Low == 0 || rec.Close == 0;
    if (rec.Open == 0) rec.Open = kept;
    if (rec.High == 0) rec.High = kept;
    if (rec.Low == 0) rec.Low = kept;
    if (rec.Close == 0) rec.Close = kept;
    changed = changed || any;
  }
  return changed;
}

void PriceCheck::Visit(const MarketItem& item) {
  const std::string code(item.code);
  inHand = dataPath_ + code + ".WDT";
  check_.last = code;
  ++check_.checked;
  progress_.Show(ProgressLine::kState, "CHECKING :   " + code);
  std::uint64_t marks = 0;
  for (const PriceRec& rec : item.records)
    marks |= ZeroMarks(rec.High, rec.Open) | ZeroMarks(rec.Close, rec.Low);
  const bool gaps = (marks & kZeroMarks) != 0;
  float first = 0;
  for (size_t i = 0; i < item.records.size() && first == 0; ++i) first = item.records[i].Close;
  if (first == 0) {
    if (!item.records.empty()) List(item, code + " has no price data values");
    return;
  }
  std::vector<PriceRec> repaired;
  std::span<const PriceRec> records = item.records;
  if (gaps) {
    repaired.assign(records.begin(), records.end());
    if (Repair(repaired, first)) {
      StagePrices(set_, inHand, repaired);
      ++waiting_;
      bytes_ += repaired.size() * sizeof(PriceRec);
    }
    records = repaired;
  }
  // A day with volume ends both runs: they are counted from the last day back.
  std::int32_t noVolume = 0, noMovement = 0;
  bool same = true;
  for (size_t i = records.size(); i-- > 0 && records[i].Volume == 0;) {
    ++noVolume;
    same = same && i > 0 && records[i].Close == records[i - 1].Close;
    if (same) ++noMovement;
  }
  if (noVolume >= plan_.StaleDays && noMovement >= plan_.StaleDays)
    List(item, " No volume and price movement for " + code + " " + Str(noVolume) + " days");
}

void PriceCheck::PutInPlace() {
  if (waiting_ == 0) return;
  set_.Commit();
  check_.repaired += waiting_;
  waiting_ = 0;
  bytes_ = 0;
}

// An empty list that is empty already is not written again.
void PriceCheck::SaveList() const {
  const std::string path = ListFilePath(dataPath_, kResultList);
  if (listed_.empty() && files_.CheckFile(path) && files_.Stamp(path).size == 0) return;
  WriteList(files_, dataPath_, kResultList, listed_);
}

void PriceCheck::Run(Dialogs& dialogs) {
  const auto held = files_.lock().Hold();
  inHand = dataPath_;
  MarketWalk walk(files_, dataPath_);
  if (walk.count() == 0) {
    dialogs.Message("Cannot check - No Records in Name File", kTitle);
    return;
  }
  SaveList();
  const auto there = PriceFilesOf(files_, dataPath_);
  // Missing files are listed where the walk passes their names: in front of the next one visited.
  WalkPlan names;
  names.records = 0;
  std::vector<std::pair<std::int32_t, NameRec>> missing;
  MarketWalk(files_, dataPath_)
      .Run(
          names, *std::make_unique<NoProgress>(), [this](const NameRec& n) { return Wants(n); },
          [&](const MarketItem& item) {
            if (!IsFileCode(item.code) || !there.contains(UCase(item.code) + ".WDT"))
              missing.emplace_back(item.number, item.name);
          });
  size_t next = 0;
  const auto listMissing = [&](std::int32_t before) {
    for (; next < missing.size() && missing[next].first < before; ++next) {
      const auto& [number, name] = missing[next];
      const std::string_view code = Trim(name.Code.trimmed());
      List({number, name, code, 0, {}}, std::string(code) + " has no data file");
    }
  };
  WalkPlan plan;
  plan.records = kWholeFile;
  plan.ahead = false;  // a visit takes less than handing the records to another thread
  check_.stopped = !walk.Run(
      plan, progress_, [this](const NameRec& name) { return Wants(name); },
      [&](const MarketItem& item) {
        listMissing(item.number);
        Visit(item);
        if (waiting_ >= kFilesTogether || bytes_ >= kBytesTogether) PutInPlace();
      });
  if (!check_.stopped) listMissing(walk.count() + 1);
  inHand = dataPath_;
  PutInPlace();
  SaveList();
  check_.done = true;
  progress_.Show(ProgressLine::kState,
                 check_.stopped ? "STOPPED BEHIND " + check_.last : "RECORDS CHECKED");
  UnreadFiles unread = walk.unread();
  unread.missing = unread.tooShort = 0;  // listed; a file of no records has nothing to check
  if (unread.total() > 0) dialogs.Message(UnreadText(unread), kTitle);
}

// What the price files of the folder are the codes of.
std::map<std::string, std::string> CodesOfFiles(const Files& files, const std::string& dataPath) {
  std::map<std::string, std::string> codes;
  for (const std::string& name : files.List(dataPath)) {
    const std::string upper = UCase(name);
    if (!upper.ends_with(".WDT")) continue;
    const std::string code = upper.substr(0, upper.size() - 4);
    if (IsFileCode(code)) codes.try_emplace(code, name);
  }
  return codes;
}

}  // namespace

DataCheck CheckDataFiles(const Files& files, const std::string& dataPath, const DataCheckPlan& plan,
                         Progress& progress, Dialogs& dialogs) {
  DataCheck check;
  if (!plan.types[1] && !plan.types[2] && !plan.types[4] && !plan.types[5]) {
    dialogs.Message("No Record Types selected", "Record Types");
    return check;
  }
  PriceCheck work(files, dataPath, plan, progress, check);
  TellFailure(dialogs, kTitle, dataPath, [&] { work.Run(dialogs); });
  return check;
}

bool RemoveListed(const Files& files, const std::string& dataPath,
                  const std::vector<std::string>& codes, Dialogs& dialogs) {
  if (dialogs.Ask("Data files and their Name File entries will be erased for all files in list\n"
                  "Click YES to proceed with clearance\nClick NO to exit",
                  "Erase Data Files", Buttons::kYesNo) != Answer::kYes)
    return false;
  return TellFailure(dialogs, "Erase Data Files", dataPath, [&] {
    const auto held = files.lock().Hold();
    std::unordered_set<std::string> listed;
    for (const std::string& code : codes) listed.insert(UCase(Trim(code)));
    FileSet set(files);
    std::vector<NameRec> names = ReadNames(files, dataPath);
    // The names first: one without its file would fail to chart.
    if (std::erase_if(names, [&](const NameRec& rec) {
          return listed.contains(UCase(Trim(rec.Code.trimmed())));
        }) > 0)
      StageNames(set, NameFilePath(dataPath), names);
    const auto there = PriceFilesOf(files, dataPath);
    for (const std::string& code : listed) {
      if (!IsFileCode(code) || !there.contains(code + ".WDT")) continue;
      set.Rename(dataPath + code + ".WDT", dataPath + code + ".old");
    }
    set.Commit();
  });
}

NameCheck CheckNameData(const Files& files, const std::string& dataPath, Progress& progress,
                        Dialogs& dialogs) {
  NameCheck check;
  TellFailure(dialogs, kNameTitle, dataPath, [&] {
    const auto held = files.lock().Hold();
    progress.Show(ProgressLine::kState, "Checking Files - WAIT");
    const std::vector<NameRec> old = ReadNames(files, dataPath);
    const auto there = CodesOfFiles(files, dataPath);
    const int total = int(old.size() + there.size());
    int done = 0;
    std::vector<NameRec> names;
    std::unordered_set<std::string> known;
    for (const NameRec& rec : old) {
      if (!progress.Step(++done, total)) return;
      const std::string code(Trim(rec.Code.trimmed()));
      known.insert(UCase(code));
      if (!there.contains(UCase(code)) &&
          dialogs.Ask(
              "Name File Entry exists for " + FromAnsi(code) + " but NO Data file.\nRemove entry ?",
              "No Data File", Buttons::kYesNo) == Answer::kYes) {
        ++check.removed;
        continue;
      }
      names.push_back(rec);
    }
    progress.Show(ProgressLine::kState, "Checking Data Files - WAIT");
    for (const auto& [code, file] : there) {
      if (!progress.Step(++done, total)) return;
      if (known.contains(code)) continue;
      if (dialogs.Ask("Data file exists for " + code + " but NO Name file entry.\nAdd entry ?",
                      "No Name File Entry", Buttons::kYesNo) != Answer::kYes)
        continue;
      if (names.size() >= size_t(kMostNames))
        throw RunTimeError(kOverflow, "the name file is full, with " + Str(kMostNames) + " names");
      names.push_back(NewNameRec(code));
      ++check.added;
    }
    progress.Show(ProgressLine::kState, " Checking complete ");
    if (check.removed + check.added > 0) {
      progress.Show(ProgressLine::kNote, "NOW SORTING NAME FILE  -  WAIT");
      names = SortedNames(names, NameSort::kCode);
      FileSet set(files);
      if (files.CheckFile(NameFilePath(dataPath)))
        set.Add(dataPath + "Names.Bak", files.ReadAll(NameFilePath(dataPath)));
      StageNames(set, NameFilePath(dataPath), names);
      set.Commit();
    }
    check.count = std::int32_t(names.size());
    check.done = true;
  });
  return check;
}

std::vector<std::string> AdvanceDeclines(const Files& files, const std::string& dataPath,
                                         Dialogs& dialogs) {
  std::vector<std::string> codes;
  TellFailure(dialogs, kTotalsTitle, dataPath, [&] {
    for (const NameRec& rec : ReadNames(files, dataPath))
      if (rec.RecType == kAdvanceDecline) codes.emplace_back(Trim(rec.Code.trimmed()));
    if (codes.empty()) dialogs.Message("There are no Advance/Declines", kTotalsTitle);
  });
  return codes;
}

std::optional<std::string> CheckTotals(const Files& files, const std::string& dataPath,
                                       std::string_view typed, std::string_view base,
                                       Dialogs& dialogs) {
  const std::string_view number = Trim(base);
  double total = 0;
  const auto end = std::from_chars(number.data(), number.data() + number.size(), total);
  if (end.ec != std::errc() || end.ptr != number.data() + number.size() || !std::isfinite(total)) {
    dialogs.Message("Base Value must be numeric", "Base Value");
    return std::nullopt;
  }
  const std::string code = UCase(Trim(typed));
  std::optional<std::string> text;
  TellFailure(dialogs, kTotalsTitle, code, [&] {
    const auto held = files.lock().Hold();
    const std::string path = dataPath + CodeFileName(code, ".WDT");
    if (!files.CheckFile(path) || PriceFile(files, path).count() == 0) {
      dialogs.Message("There are no records for " + FromAnsi(code), kTotalsTitle);
      return;
    }
    PriceEdit edit(files, path);
    for (PriceRec& rec : edit.records()) {
      total = RoundHalfEven(double(rec.High) + total - double(rec.Low));
      rec.Close = CSng(total);
      rec.Open = 0;
    }
    FileSet set(files);
    edit.Save(set);
    set.Commit();
    text = " Checked " + FromAnsi(code) + "\nCumulative Total at end is " + Str(total);
  });
  return text;
}

}  // namespace kora
