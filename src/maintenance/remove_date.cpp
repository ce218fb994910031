#include "maintenance/remove_date.h"

#include <algorithm>
#include <span>
#include <string_view>
#include <unordered_set>
#include <vector>

#include "base/dates.h"
#include "base/file_set.h"
#include "base/home_lock.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "maintenance/failures.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "store/market_walk.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Remove Selected Data";
constexpr int kFilesTogether = 64;  // are put in place

// Dates are compared by value; eight digits have that of no other eight.
bool HasDate(const PriceRec& rec, std::string_view yyyymmdd) {
  const std::string_view date = rec.RecDate.raw();
  if (date == yyyymmdd) return true;
  bool digits = true;
  for (const char c : date) digits &= c >= '0' && c <= '9';
  return !digits && Val(date) == Val(yyyymmdd);
}

// The records with the date; of them the last one alone where only that is to go.
std::vector<size_t> WithDate(std::span<const PriceRec> records, std::string_view date,
                             bool latestOnly) {
  std::vector<size_t> found;
  for (size_t i = records.size(); i-- > 0 && !(latestOnly && !found.empty());)
    if (HasDate(records[i], date)) found.push_back(i);
  std::reverse(found.begin(), found.end());
  return found;
}

// The bytes between the records that go.
std::vector<std::string_view> Without(std::span<const PriceRec> records,
                                      const std::vector<size_t>& gone) {
  std::vector<std::string_view> pieces;
  size_t from = 0;
  const auto take = [&](size_t to) {
    if (to > from)
      pieces.emplace_back(reinterpret_cast<const char*>(records.data() + from),
                          (to - from) * sizeof(PriceRec));
    from = to + 1;
  };
  for (const size_t i : gone) take(i);
  take(records.size());
  return pieces;
}

class DateRemoval {
 public:
  DateRemoval(const Files& files, std::string folder, std::string date, bool latestOnly)
      : files_(files),
        folder_(std::move(folder)),
        date_(std::move(date)),
        latestOnly_(latestOnly),
        set_(files) {}

  void Run(Progress& progress, Dialogs& dialogs, RemovedDate& removed);

  std::string inHand;

 private:
  void Visit(const MarketItem& item, Progress& progress);
  void PutInPlace(RemovedDate& removed);

  const Files& files_;
  const std::string folder_;
  const std::string date_;  // "yyyymmdd"
  const bool latestOnly_;
  FileSet set_;
  int waiting_ = 0;
  std::int32_t records_ = 0;
  std::unordered_set<std::string> seen_;  // files of two names are gone through once
};

void DateRemoval::Visit(const MarketItem& item, Progress& progress) {
  const std::string code(item.code);
  if (!seen_.insert(UCase(code)).second) return;
  progress.Show(ProgressLine::kState, "Removing " + DateToDisplay(date_) + " from " + code);
  const auto gone = WithDate(item.records, date_, latestOnly_);
  if (gone.empty()) return;
  set_.AddNow(folder_ + CodeFileName(code, ".WDT"), Without(item.records, gone));
  ++waiting_;
  records_ += std::int32_t(gone.size());
}

void DateRemoval::PutInPlace(RemovedDate& removed) {
  if (waiting_ == 0) return;
  set_.Commit();
  removed.files += waiting_;
  removed.records += records_;
  waiting_ = 0;
  records_ = 0;
}

void DateRemoval::Run(Progress& progress, Dialogs& dialogs, RemovedDate& removed) {
  const auto held = files_.lock().Hold();
  MarketWalk walk(files_, folder_);
  const WalkPlan plan{.records = kWholeFile, .fewest = 1};
  std::string code;
  removed.stopped = !walk.Run(plan, progress, {}, [&](const MarketItem& item) {
    inHand = folder_ + std::string(item.code) + ".WDT";
    Visit(item, progress);
    code = item.code;
    if (waiting_ >= kFilesTogether) {
      PutInPlace(removed);
      removed.last = code;
    }
  });
  inHand = folder_;
  PutInPlace(removed);
  removed.last = code;
  removed.done = true;
  if (removed.stopped) {
    progress.Show(ProgressLine::kState, "");
    dialogs.Message("Stopped behind " + FromAnsi(removed.last) + ": " + Str(removed.files) +
                        " files were changed, those behind it were not",
                    kTitle);
  } else {
    progress.Show(ProgressLine::kState, " COMPLETED " + folder_);
  }
  // A file of no records has nothing to remove.
  UnreadFiles unread = walk.unread();
  unread.missing = unread.tooShort = 0;
  if (unread.total() > 0) dialogs.Message(UnreadText(unread), kTitle);
}

}  // namespace

RemovedDate RemoveDate(const Files& files, Settings& settings, const std::string& folder,
                       const std::string& date, bool latestOnly, Progress& progress,
                       Dialogs& dialogs, RemoveDateBox& focus) {
  RemovedDate removed;
  focus = RemoveDateBox::kNone;
  const std::string path = WithBackslash(Trim(folder));
  if (path.empty()) {
    focus = RemoveDateBox::kFolder;
    return removed;
  }
  if (!files.IsFolder(path)) {
    focus = RemoveDateBox::kFolder;
    dialogs.Message("Cannot find " + path, kTitle);
    return removed;
  }
  settings.paths.CurrentDataPath = path;
  if (Trim(date).empty()) {
    focus = RemoveDateBox::kDate;
    dialogs.Message("Date to remove must be entered.", kTitle);
    return removed;
  }
  const auto wanted = ParseUserDate(Trim(date));
  if (!wanted) {
    focus = RemoveDateBox::kDate;
    dialogs.Message("The date is not a date d/m/yy", kTitle);
    return removed;
  }
  DateRemoval removal(files, path, FormatFileDate(*wanted), latestOnly);
  if (!TellFailure(dialogs, kTitle, path, [&] { removal.Run(progress, dialogs, removed); }) &&
      !removed.last.empty())
    dialogs.Message("Done up to " + FromAnsi(removed.last), kTitle);
  return removed;
}

}  // namespace kora
