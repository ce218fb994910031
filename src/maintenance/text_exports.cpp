#include "maintenance/text_exports.h"

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "maintenance/failures.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "store/chart_notes.h"
#include "store/market_walk.h"
#include "store/name_file.h"
#include "store/price_rec.h"

namespace kora {
namespace {

constexpr const char* kDateTitle = "Text Data";
constexpr const char* kTitle = "Text File";
constexpr const char* kMakeTitle = "Create Text File";

// "20NOV96.TXT"
std::string NameOfDate(const CalendarDate& date) {
  constexpr std::string_view months = "JANFEBMARAPRMAYJUNJULAUGSEPOCTNOVDEC";
  return Format(double(date.day), "00") +
         std::string(months.substr(size_t(date.month - 1) * 3, 3)) +
         Format(double(date.year % 100), "00") + ".TXT";
}

std::string Padded(std::string_view text, size_t size) {
  return text.size() < size ? PadRight(text, size) : std::string(text) + " ";
}

// "d/m/yy" of a record; what is no date stands as it is.
std::string UserDateOf(const PriceRec& rec) {
  const auto date = ParseFileDate(rec.RecDate.raw());
  return date ? FormatUserDate(*date) : std::string(rec.RecDate.trimmed());
}

// The latest date that a price file ends with.
std::optional<CalendarDate> LatestDate(MarketWalk& walk) {
  std::string latest;
  WalkPlan plan;
  plan.records = 1;
  NoProgress silent;
  walk.Run(plan, silent, {}, [&](const MarketItem& item) {
    const std::string_view date = item.records.back().RecDate.raw();
    if (ParseFileDate(date) && date > latest) latest = date;
  });
  return latest.empty() ? std::nullopt : ParseFileDate(latest);
}

// The file holds texts of charts, not prices that were written there before.
bool HoldsNotes(const Files& files, const std::string& path) {
  for (const ChartNote& note : ReadChartNotes(files, path))
    return note.Kind == "T" && note.Size.find('/') == std::string::npos;
  return false;
}

}  // namespace

std::optional<std::string> ExportCloses(const Files& files, const std::string& dataPath,
                                        const std::string& ChartMiscPath,
                                        const std::optional<std::string>& typed, ExportForm form,
                                        Progress& progress, Dialogs& dialogs) {
  std::optional<std::string> made;
  if (typed && Trim(*typed).empty()) {
    dialogs.Message("A particular date has not been entered", kDateTitle);
    return made;
  }
  std::optional<CalendarDate> date;
  if (typed) {
    date = ParseUserDate(Trim(*typed));
    if (!date) {
      dialogs.Message("The date is not a date d/m/yy", kDateTitle);
      return made;
    }
  }
  TellFailure(dialogs, kDateTitle, ChartMiscPath, [&] {
    MarketWalk walk(files, dataPath);
    if (!date) date = LatestDate(walk);
    if (!date) {
      dialogs.Message("No data on file", kDateTitle);
      return;
    }
    const std::string wanted = FormatFileDate(*date);
    std::string text;
    WalkPlan plan;
    plan.records = kWholeFile;
    const bool all = walk.Run(plan, progress, {}, [&](const MarketItem& item) {
      for (auto rec = item.records.rbegin(); rec != item.records.rend(); ++rec) {
        if (rec->RecDate.raw() != wanted) continue;
        if (form == ExportForm::kCommas)
          text += std::string(item.code) + "," + wanted + "," + Str(float(rec->Close));
        else
          text += Padded(item.code, 12) + Padded(wanted, 12) + Str(float(rec->Close));
        text += "\r\n";
        return;
      }
    });
    if (!all) {
      dialogs.Message("Stopped; no text file was made", kTitle);
      return;
    }
    const auto held = files.lock().Hold();
    const std::string name = NameOfDate(*date);
    files.MakeFolder(ChartMiscPath);
    files.WriteAll(ChartMiscPath + name, text);
    UnreadFiles unread = walk.unread();
    unread.missing = unread.tooShort = 0;
    if (unread.total() > 0) dialogs.Message(UnreadText(unread), kTitle);
    dialogs.Message("Text File " + name + " created", kTitle);
    made = name;
  });
  return made;
}

std::optional<std::string> ExportHistory(const Files& files, const std::string& dataPath,
                                         const std::string& ChartMiscPath, std::string_view typed,
                                         ExportForm form, Dialogs& dialogs) {
  const std::string code = UCase(Trim(typed));
  std::optional<std::string> made;
  TellFailure(dialogs, kMakeTitle, code, [&] {
    NameRec rec;
    const NameFile names(files, NameFilePath(dataPath));
    if (!IsFileCode(code) || FindCode(names, PadRight(code, 6), rec) == 0) {
      dialogs.Message(" File not found", "Data Entry");
      return;
    }
    const std::string source = dataPath + CodeFileName(code, ".WDT");
    std::vector<PriceRec> records;
    if (files.CheckFile(source)) records = PriceFile(files, source).ReadAll();
    if (records.empty()) {
      dialogs.Message("No data for " + FromAnsi(code), kMakeTitle);
      return;
    }
    const std::string name = code + ".txt";
    const std::string path = ChartMiscPath + name;
    const auto held = files.lock().Hold();
    if (HoldsNotes(files, path) && dialogs.Ask(path + " holds the texts of the charts of " +
                                                   FromAnsi(code) + ". Replace it by the prices ?",
                                               kMakeTitle, Buttons::kNoYes) != Answer::kYes)
      return;
    std::string text;
    for (const PriceRec& day : records) {
      const std::string figures[] = {code,
                                     UserDateOf(day),
                                     Str(float(day.Open)),
                                     Str(float(day.High)),
                                     Str(float(day.Low)),
                                     Str(float(day.Close)),
                                     Str(std::int32_t(day.Volume))};
      constexpr size_t widths[] = {8, 10, 10, 10, 10, 10, 0};
      for (size_t i = 0; i < std::size(figures); ++i) {
        const bool last = i + 1 == std::size(figures);
        text += form == ExportForm::kColumns && !last ? Padded(figures[i], widths[i]) : figures[i];
        if (form == ExportForm::kCommas && !last) text += ',';
      }
      text += "\r\n";
    }
    files.MakeFolder(ChartMiscPath);
    files.WriteAll(path, text);
    made = name;
  });
  return made;
}

}  // namespace kora
