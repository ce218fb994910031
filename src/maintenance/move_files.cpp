#include "maintenance/move_files.h"

#include <algorithm>
#include <vector>

#include "base/file_set.h"
#include "base/home_lock.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "maintenance/same_place.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "store/name_file.h"
#include "store/price_edit.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Move KORA Data Files";

std::string CopyErrorText(int number) {
  switch (number) {
    case kDiskFull: return "Cannot copy - destination disk is full";
    case kDiskNotReady: return "Cannot copy - disk not ready";
    case kPermissionDenied: return "Cannot copy - your disk may be write protected";
    case kDeviceNotAvailable: return "Cannot copy - the disk is not available";
    case kTooManyFiles: return "Cannot copy - there are too many files";
    case kBadFileName:
    case kFileNotFound: return "Cannot copy - reselect file and try again";
    case kPathAccess:
    case kPathNotFound:
      return "Cannot copy - there is a path or file access error. Reselect file and try again";
    default:
      return "Cannot copy - there is an unexpected error number " + Str(std::int32_t(number));
  }
}

double DateOf(const PriceRec& rec) { return Val(rec.RecDate.raw()); }

// `first` as it is, then what `second` has behind its end.
std::vector<PriceRec> Joined(const std::vector<PriceRec>& first,
                             const std::vector<PriceRec>& second) {
  std::vector<PriceRec> out = first;
  const double end = DateOf(first.back());
  for (const PriceRec& rec : second)
    if (DateOf(rec) > end) out.push_back(rec);
  return out;
}

// What the target is to hold; nothing where it stays.
std::vector<PriceRec> Merged(const std::vector<PriceRec>& source,
                             const std::vector<PriceRec>& target) {
  if (source.empty()) return {};
  if (target.empty()) return source;
  const bool earlier = DateOf(source.front()) < DateOf(target.front());
  const bool endsEarlier = DateOf(source.back()) < DateOf(target.back());
  const bool endsLater = DateOf(source.back()) > DateOf(target.back());
  if (earlier) return endsEarlier ? Joined(source, target) : source;
  return endsLater ? Joined(target, source) : std::vector<PriceRec>();
}

// The name record of a code, or one of a new security.
NameRec NameOf(const std::vector<NameRec>& names, const std::string& code) {
  for (const NameRec& rec : names)
    if (EqualNoCase(Trim(rec.Code.trimmed()), code)) return rec;
  return NewNameRec(code);
}

// Adds the record in front of the first whose code is greater. False when the code is there.
bool AddByCode(std::vector<NameRec>& names, const NameRec& rec) {
  const std::string code = UCase(Trim(rec.Code.trimmed()));
  for (const NameRec& name : names)
    if (EqualNoCase(Trim(name.Code.trimmed()), code)) return false;
  const auto place = std::find_if(names.begin(), names.end(), [&](const NameRec& name) {
    return UCase(Trim(name.Code.trimmed())) > code;
  });
  names.insert(place, rec);
  return true;
}

void Move(const Files& files, const std::string& from, const std::string& to,
          const std::string& code, Progress& progress) {
  const std::string name = CodeFileName(code, ".WDT");
  const PriceEdit source(files, from + name);
  const auto held = files.lock().Hold();
  FileSet set(files);
  const std::string target = to + name;
  if (files.CheckFile(target)) {
    progress.Show(ProgressLine::kState, "Merging Files");
    PriceEdit edit(files, target);
    std::vector<PriceRec> merged = Merged(source.records(), edit.records());
    if (!merged.empty()) {
      edit.KeepOld(set);
      edit.records() = std::move(merged);
      edit.Save(set);
    }
  } else {
    StagePrices(set, target, source.records());
  }
  // Behind the prices: a name without its file would fail to chart.
  std::vector<NameRec> names = ReadNames(files, to);
  if (AddByCode(names, NameOf(ReadNames(files, from), code)))
    StageNames(set, NameFilePath(to), names);
  set.Commit();
  progress.Show(ProgressLine::kState, "COMPLETED");
}

}  // namespace

bool MoveDataFile(const Files& files, const std::string& fromFolder, const std::string& toFolder,
                  const std::string& typed, Progress& progress, Dialogs& dialogs) {
  const std::string from = WithBackslash(Trim(fromFolder)), to = WithBackslash(Trim(toFolder));
  const std::string code = UCase(Trim(ToAnsi(typed)));
  try {
    if (IsSamePlace(files, from, to)) {
      dialogs.Message("You have the same folder selected for both Source and Destination", kTitle);
      return false;
    }
    if (!files.IsFolder(to)) throw RunTimeError(kPathNotFound);
    Move(files, from, to, code, progress);
    return true;
  } catch (const HomeIsHeld& e) {
    dialogs.Message(e.what(), kTitle);
  } catch (const RunTimeError& e) {
    dialogs.Message(CopyErrorText(e.number()), "Copy Error");
  } catch (const std::bad_alloc&) {
    dialogs.Message(CopyErrorText(kOutOfMemory), "Copy Error");
  }
  return false;
}

}  // namespace kora
