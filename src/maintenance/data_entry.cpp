#include "maintenance/data_entry.h"

#include <algorithm>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "maintenance/failures.h"
#include "maintenance/typed_number.h"
#include "platform/dialogs.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Data Entry";
constexpr std::int32_t kMostDays = 32767;

// What is wrong with a box.
struct Refused {
  EntryBox box;
  std::string text;
  const char* title = kTitle;
};

double ReadNumber(EntryBox box, std::string_view text) {
  if (Trim(text).empty()) return 0;
  const auto value = TypedNumber(text);
  if (!value) throw Refused{box, std::string(kDataMustBeNumeric)};
  return *value;
}

float ReadPrice(EntryBox box, std::string_view text) {
  const double value = ReadNumber(box, text);
  try {
    return CSng(value);
  } catch (const RunTimeError&) {
    throw Refused{box, std::string(kNumberTooLarge)};
  }
}

std::int32_t ReadVolume(std::string_view text) {
  const double value = ReadNumber(EntryBox::kVolume, text);
  try {
    return CLng(value);
  } catch (const RunTimeError&) {
    throw Refused{EntryBox::kVolume, std::string(kNumberTooLarge)};
  }
}

// The text decides: a price typed "0.00" passes.
bool IsNothing(std::string_view text) { return Trim(text).empty() || Trim(text) == "0"; }

PriceRec ReadEntry(std::int16_t RecType, const EntryTexts& texts,
                   const std::optional<PriceRec>& previous) {
  if (RecType == kCloseVolume || RecType == kCloseOnly) {
    if (IsNothing(texts.close))
      throw Refused{EntryBox::kClose, "Use previous close \n Close should not be 0"};
  } else if (RecType != kAdvanceDecline) {
    for (const auto& [box, text] :
         {std::pair{EntryBox::kOpen, &texts.open}, std::pair{EntryBox::kHigh, &texts.high},
          std::pair{EntryBox::kLow, &texts.low}, std::pair{EntryBox::kClose, &texts.close}})
      if (IsNothing(*text)) throw Refused{box, "Use previous close \nData should not be 0"};
  }
  const auto date = ParseUserDate(Trim(texts.date));
  if (!date) throw Refused{EntryBox::kDate, "The date is not a date d/m/yy"};

  PriceRec rec = NewPriceRec(FormatFileDate(*date));
  rec.Close = ReadPrice(EntryBox::kClose, texts.close);
  if (RecType == kCloseVolume || RecType == kCloseOnly) {
    rec.Open = rec.High = rec.Low = rec.Close;
  } else {
    rec.High = ReadPrice(EntryBox::kHigh, texts.high);
    rec.Low = ReadPrice(EntryBox::kLow, texts.low);
    if (RecType != kAdvanceDecline) rec.Open = ReadPrice(EntryBox::kOpen, texts.open);
  }
  if (RecType != kCloseOnly) rec.Volume = ReadVolume(texts.volume);
  if (RecType == kAdvanceDecline) {
    const double before = previous ? double(previous->Close) : 0;
    const double total = before + double(rec.High) - double(rec.Low);
    if (float(rec.Close) != static_cast<float>(total))
      throw Refused{EntryBox::kClose, "Cumulative total must equal\nPrevious total + Rises - Falls",
                    "Advance/Decline Edit"};
  }
  return rec;
}

std::optional<PriceRec> LastOf(const PriceFile& file) {
  if (file.count() == 0) return std::nullopt;
  return file.Read(file.count());
}

EntrySecurity SecurityOf(const Files& files, const std::string& dataPath, std::int16_t number,
                         const NameRec& name, Dialogs& dialogs) {
  EntrySecurity security{number, name, std::string(Trim(name.Code.trimmed())), {}, {}};
  security.path = dataPath + CodeFileName(security.code, ".WDT");
  if (files.CheckFile(security.path)) security.previous = LastOf(PriceFile(files, security.path));
  if (!security.previous)
    dialogs.Message("No previous data for " + FromAnsi(security.code), kTitle);
  return security;
}

}  // namespace

std::optional<EntrySecurity> OpenEntry(const Files& files, const std::string& dataPath,
                                       std::int32_t number, Dialogs& dialogs) {
  std::optional<EntrySecurity> out;
  TellFailure(dialogs, kTitle, "Names.dat", [&] {
    const auto names = ReadNames(files, dataPath);
    if (names.empty()) {
      dialogs.Message("No Records in Name File", kTitle);
      return;
    }
    const std::int32_t held = std::clamp(number, 1, std::int32_t(names.size()));
    out = SecurityOf(files, dataPath, CInt(held), names[size_t(held - 1)], dialogs);
  });
  return out;
}

std::optional<EntrySecurity> FindEntry(const Files& files, const std::string& dataPath,
                                       std::string_view code, Dialogs& dialogs) {
  std::optional<EntrySecurity> out;
  TellFailure(dialogs, kTitle, "Names.dat", [&] {
    CurrentName current;
    current.CurrentCode = Trim(code);
    if (LocateCurrentCode(files, dataPath, dialogs, current))
      out = SecurityOf(files, dataPath, current.NameRecNo, current.Rec, dialogs);
  });
  return out;
}

std::string NextEntryDate(std::string_view yyyymmdd) {
  const auto last = ParseFileDate(yyyymmdd);
  if (!last) return {};
  const std::int32_t day = DayNumber(*last);
  switch (Weekday(DateOfDayNumber(day + 1))) {
    case 1: return FormatUserDate(DateOfDayNumber(day + 2));  // Sunday
    case 7: return FormatUserDate(DateOfDayNumber(day + 3));  // Saturday
    default: return FormatUserDate(DateOfDayNumber(day + 1));
  }
}

bool EntryShows(std::int16_t RecType, EntryBox box) {
  switch (box) {
    case EntryBox::kOpen: return RecType == kShare || RecType == kIndex;
    case EntryBox::kHigh:
    case EntryBox::kLow: return RecType >= kAdvanceDecline;
    case EntryBox::kVolume: return RecType != kCloseOnly;
    case EntryBox::kDate:
    case EntryBox::kClose: return true;
    case EntryBox::kNone: break;
  }
  return false;
}

bool SaveEntry(const Files& files, EntrySecurity& security, const EntryTexts& texts,
               Dialogs& dialogs, EntryBox& focus) {
  focus = EntryBox::kNone;
  return TellFailure(dialogs, kTitle, security.path,
                     [&] {
                       try {
                         const auto held = files.lock().Hold();
                         const bool there = files.CheckFile(security.path);
                         if (there) security.previous = LastOf(PriceFile(files, security.path));
                         const PriceRec rec =
                             ReadEntry(security.name.RecType, texts, security.previous);
                         PriceFile file(files, security.path, OpenMode::kCreate);
                         if (file.count() >= kMostDays)
                           throw RunTimeError(
                               kOverflow, "the file is full, with " + Str(file.count()) + " days");
                         // A record at the end of a file that was not written whole does not count.
                         const std::int32_t days = file.count();
                         file.Append(rec);
                         try {
                           file.Flush();
                         } catch (const RunTimeError&) {
                           file.Truncate(days);  // told as not saved: it is entered again
                           throw;
                         }
                         security.previous = rec;
                       } catch (const Refused& refused) {
                         focus = refused.box;
                         dialogs.Message(refused.text, refused.title);
                       }
                     }) &&
         focus == EntryBox::kNone;
}

}  // namespace kora
