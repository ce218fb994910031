#include "update/download_update.h"

#include <algorithm>
#include <array>
#include <new>
#include <unordered_map>
#include <unordered_set>
#include <vector>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/clock.h"
#include "store/price_rec.h"
#include "update/day_line.h"
#include "update/download_settings.h"
#include "update/price_write.h"
#include "update/security_details.h"

namespace kora {
namespace {

constexpr std::int32_t kMostNames = 32767;
constexpr std::uint64_t kSmallestData = 8;
constexpr std::uint64_t kLargestData = 256u << 20;
constexpr std::int16_t kNoTradeCategory = 89;  // the last that gets flat records

// The user asked to stop.
struct Stopped {};

// The market files of a whole-market run, in their order.
struct FileKind {
  std::string_view extension;
  std::string_view FileTag;
  WmLine target;
  std::int16_t NewRecType;
  char SourceId;
};
constexpr std::array<FileKind, 6> kKinds{{
    {".das", "ASX ", kWmSum, kShare, 'A'},
    {".dix", "INDICES ", kWmIndices, kIndex, 'X'},
    {".dov", "OVERSEAS ", kWmOverseas, kShare, 'V'},
    {".dsu", "EQUITIES ", kWmAsx, kShare, 'S'},
    {".dsf", "FUTURES ", kWmFutures, kShare, 'F'},
    {".dop", "OPTIONS ", kWmOptions, kShare, 'P'},
}};

// A file's own name, for messages.
std::string_view NameOf(std::string_view path) { return path.substr(path.rfind('\\') + 1); }

std::string_view LastOf(std::string_view text, size_t size) {
  return text.size() > size ? text.substr(text.size() - size) : text;
}

std::int16_t CategoryOf(std::string_view FileTag, std::string_view code) {
  if (FileTag != "EQUITIES " || code.size() != 6) return 1;
  switch (code[3]) {
    case 'E': return 86;
    case 'I': return 87;
    case 'W': return 84;
    default: return 88;
  }
}

// One date of the update list.
class DayUpdate {
 public:
  DayUpdate(const UpdateRun& run, const std::string& entry, bool MoreToCome)
      : run_(run),
        download_(run.settings.download),
        MoreToCome_(MoreToCome),
        SelectedDownloadFile_(DownloadFilePath(download_.DLPath, entry)),
        UpdateDate_(UpdateDateOf(entry, run.clock.Today())) {
    // A run before which nothing was read yet.
    if (run_.current.Rec.Code.raw()[0] == '\0') run_.current.Rec = NewNameRec("");
  }

  UpdateEnd UpdateFromDownload();

 private:
  bool WholeMarket(const WmPaths& lines);
  bool UpdateFile();
  void CheckData();
  void RemoveBlankLines();
  bool CheckLines();
  void RefuseCommas(std::string_view line);
  void RefuseLine(std::string_view line, int number, const std::string& fault);
  void ProbeDate();
  void AskMode(std::int16_t mode, std::string_view text);
  void TakeLines();
  bool Wanted(const std::string& code) const;
  void Write(const DayLine& day);
  void AddName(const DayLine& day);
  void NoTradePass();
  bool OptionLives(std::int32_t number, NameRec& rec);
  bool StopAsked(int done, int total);

  bool IsService(int service) const { return download_.DataService == service; }
  std::string_view ShownName() const { return NameOf(SelectedDownloadFile_); }

  const UpdateRun& run_;
  const DownloadSettings& download_;
  const bool MoreToCome_;
  std::string SelectedDownloadFile_;
  const std::string UpdateDate_;
  std::string baseName_;  // of a whole-market run, with its folder
  std::unordered_set<std::string> UpdateCodes_;

  // Of the file in hand.
  std::int16_t UpdateMode_ = kModeAppend;
  bool NoDataFlag_ = false;
  std::string_view FileTag_;
  bool OptionsRun_ = false;
  std::int16_t NewRecType_ = kShare;
  char SourceId_ = ' ';
  std::string TargetPath_;
  std::string text_;
  int lines_ = 0;
  int skipLines_ = 0;  // that the date probe left behind
  std::string lastDate_;
  // The names of TargetPath, read once a file, and their first places by trimmed code.
  std::vector<NameRec> names_;
  std::unordered_map<std::string, size_t> places_;
  std::unordered_set<std::string> priceFiles_;  // "BHP.WDT" of TargetPath, upper case
};

bool DayUpdate::StopAsked(int done, int total) {
  return !run_.display.Step(done, total) &&
         run_.dialogs.Ask("The update is not finished. Stop it ?", "Update", Buttons::kYesNo) ==
             Answer::kYes;
}

UpdateEnd DayUpdate::UpdateFromDownload() {
  TargetPath_ = run_.settings.paths.CurrentDataPath;
  if (!IsService(1) && !download_.UpdateAll)
    for (const UpdateRow& row : ReadUpdateList(run_.files, run_.settings.paths.SystemPath))
      UpdateCodes_.insert(row.code);
  run_.display.ShowSecond("");

  bool good = false;
  std::string bulletins = run_.settings.paths.CurrentDataPath;
  if (IsService(3)) {
    const WmPaths lines = ReadWmPaths(run_.files, run_.settings.paths.SystemPath);
    if (!WmPathsComplete(lines)) {
      run_.dialogs.Message(
          "Separate destination directories for Whole Market data have not been defined. Select "
          "Paths option and define ALL data directories.",
          "W/M Paths");
      return UpdateEnd::kNotBegun;
    }
    bulletins = WithBackslash(Trim(lines[kWmAsx]));
    good = WholeMarket(lines);
  } else {
    run_.display.ShowState("Updating ");
    if (!run_.files.CheckFile(SelectedDownloadFile_)) {
      run_.dialogs.Message("File does not exist", "Update");
      return UpdateEnd::kNotBegun;
    }
    good = UpdateFile();
  }

  if (!MoreToCome_) run_.display.ShowSecond(" Data files updated with " + SelectedDownloadFile_);
  if (IsService(1) || IsService(3)) {
    if (run_.CheckBulletins) run_.CheckBulletins(bulletins, std::string(LastOf(baseName_, 7)));
    UpdateSecurityDetails(run_.files, download_);
  }
  return good ? UpdateEnd::kUpdated : UpdateEnd::kAbandoned;
}

bool DayUpdate::WholeMarket(const WmPaths& lines) {
  // The first point of the whole path ends the base, even one in a folder's name.
  baseName_ = SelectedDownloadFile_.substr(0, SelectedDownloadFile_.find('.'));
  bool good = true;
  for (const FileKind& kind : kKinds) {
    const std::string path = baseName_ + std::string(kind.extension);
    FileTag_ = kind.FileTag;
    TargetPath_ = WithBackslash(Trim(lines[kind.target]));
    NewRecType_ = kind.NewRecType;
    SourceId_ = kind.SourceId;
    if (!run_.files.CheckFile(path)) continue;
    SelectedDownloadFile_ = path;
    run_.display.ShowState("Updating " + std::string(FileTag_));
    OptionsRun_ = kind.SourceId == 'P';
    good &= UpdateFile();
    OptionsRun_ = false;
  }
  // A file that was refused or cancelled waits for the next run.
  if (good) {
    try {
      run_.files.Remove(baseName_ + ".d");
    } catch (const RunTimeError&) {
      // It is listed once more, and its data are replaced by themselves then.
    }
  }
  if (const std::string chosen = WmChosenFolder(lines); !chosen.empty())
    run_.settings.paths.CurrentDataPath = chosen;
  run_.display.ShowState("Updated");
  return good;
}

// One text file into TargetPath. False when it was refused or cancelled; a file without data
// counts as taken in a whole-market run.
bool DayUpdate::UpdateFile() {
  run_.display.ShowTarget(TargetPath_);
  UpdateMode_ = kModeAppend;
  names_.clear();
  places_.clear();
  priceFiles_.clear();
  names_ = ReadNames(run_.files, TargetPath_);
  places_.reserve(names_.size());
  for (size_t i = 0; i < names_.size(); ++i)
    places_.try_emplace(std::string(Trim(names_[i].Code.trimmed())), i);
  // Not the sorted listing: thousands of names are wanted in no order.
  const auto listed = run_.files.io().List(run_.files.HostPath(TargetPath_));
  priceFiles_.reserve(listed.size());
  for (const std::string& name : listed)
    if (std::string upper = UCase(name); upper.ends_with(".WDT"))
      priceFiles_.insert(std::move(upper));
  run_.current.NameCount = CInt(double(names_.size()));
  run_.display.ShowFirst(" Updating  " + std::string(LastOf(ShownName(), 11)));

  CheckData();
  if (UpdateMode_ == kModeAbandon) {
    const bool empty = NoDataFlag_;
    NoDataFlag_ = false;
    return empty && IsService(3);
  }
  run_.display.ShowSecond(" Data OK - updating");
  TakeLines();
  const bool append = UpdateMode_ == kModeAppend;
  if (IsService(3)) {
    if (append && (SourceId_ == 'S' || SourceId_ == 'F' || SourceId_ == 'P')) NoTradePass();
    return true;
  }
  // A file of the internet that keeps the ending ".ASX" gets neither.
  if (!EqualNoCase(LastOf(SelectedDownloadFile_, 1), "D")) return true;
  try {
    run_.files.Rename(SelectedDownloadFile_, SelectedDownloadFile_ + "X");
  } catch (const RunTimeError&) {
    // It stays listed.
  }
  if (!IsService(1) && append) NoTradePass();
  return true;
}

// Sets UpdateMode and decides whether the file can be used.
void DayUpdate::CheckData() {
  run_.display.ShowSecond(" Checking file format - wait");
  NoDataFlag_ = false;
  skipLines_ = 0;
  text_ = run_.files.ReadAll(SelectedDownloadFile_, kLargestData);
  if (text_.size() < kSmallestData) {
    std::string text = "There is no data in " + std::string(ShownName()) + "\n";
    if (IsService(1) && text_.empty())
      text += "Use Convert Mainfile Data routine in KORA/Tarvo Download to reprocess data";
    if (IsService(3)) text += "Use Update The Lot in KORA/Tarvo Download to reprocess";
    run_.dialogs.Message(text, "Data Update");
    UpdateMode_ = kModeAbandon;
    NoDataFlag_ = true;
    run_.display.ShowSecond("");
    return;
  }
  if (IsService(4)) RemoveBlankLines();
  if (!CheckLines()) {
    UpdateMode_ = kModeAbandon;
    return;
  }
  ProbeDate();
}

void DayUpdate::RemoveBlankLines() {
  std::string kept;
  bool blank = false;
  LineReader lines(text_);
  std::string_view line;
  while (lines.Next(line)) {
    if (Trim(line).empty()) {
      blank = true;
    } else {
      kept += line;
      kept += "\r\n";
    }
  }
  if (!blank) return;
  const std::string work = WithBackslash(Trim(download_.DLPath)) + "IData.tmp";
  run_.files.WriteAll(work, kept);
  run_.files.Rename(work, SelectedDownloadFile_);
  text_ = std::move(kept);
}

// Every line is looked at before the first record is written.
bool DayUpdate::CheckLines() {
  const auto wanted = OptionsRun_ ? kOptionCommas : kDayCommas;
  LineReader lines(text_);
  std::string_view line;
  DayLine day;
  lines_ = 0;
  while (lines.Next(line)) {
    ++lines_;
    if (std::count(line.begin(), line.end(), ',') != wanted) {
      RefuseCommas(line);
      return false;
    }
  }
  LineReader again(text_);
  while (again.Next(line)) {
    const std::string fault = ReadDayLine(line, OptionsRun_, day);
    if (fault.empty()) continue;
    RefuseLine(line, again.number(), fault);
    return false;
  }
  return true;
}

void DayUpdate::RefuseCommas(std::string_view line) {
  run_.dialogs.Message(std::string(ShownName()) + " There is a problem with \n" +
                           " There is an incorrect number of fields in the record\n"
                           " There should be 7 commas seperating 8 fields\n" +
                           (OptionsRun_ ? " code,date,open,high,low,close,vol,days,OptType\n"
                                        : " code,date,open,high,low,close,vol,spare\n") +
                           "MAKE SURE THE DOWNLOADED DATA IS SET UP FOR KORA FORMAT\n"
                           " The first incorrect record found was \n" +
                           ShownLine(line) + "\n\nCorrect and retry\n",
                       "Download Data Update");
}

void DayUpdate::RefuseLine(std::string_view line, int number, const std::string& fault) {
  run_.dialogs.Message(std::string(ShownName()) + " There is a problem with \n line " +
                           Str(std::int32_t(number)) + "\n" + fault + "\n" + ShownLine(line) +
                           "\n\nCorrect and retry\n",
                       "Download Data Update");
}

// Compares the first security that has prices with its line. The last line is not looked at:
// the end of the file is met first.
void DayUpdate::ProbeDate() {
  LineReader lines(text_);
  std::string_view line;
  DayLine day;
  while (lines.Next(line) && lines.number() < lines_) {
    ReadDayLine(line, OptionsRun_, day);
    if (day.code.empty()) {
      // Ends the search, and the lines so far are not taken in.
      skipLines_ = lines.number();
      return;
    }
    const std::string name = CodeFileName(day.code, ".WDT");
    if (!priceFiles_.contains(name)) continue;
    const PriceFile file(run_.files, TargetPath_ + name);
    if (file.count() == 0) continue;

    const double wanted = Val(day.date);
    const double last = Val(file.Read(file.count()).RecDate.raw());
    if (wanted == last)
      AskMode(kModeReplace, " There is already data on file with this date\n"
                            "  New data will replace the old data");
    if (wanted >= last) return;
    const std::vector<PriceRec> records = file.ReadAll();
    for (size_t n = records.size() - 1; n > 0; --n) {
      const double there = Val(records[n - 1].RecDate.raw());
      if (there > wanted) continue;
      if (there == wanted)
        AskMode(kModeReplace, " There is already data on file for this date\n"
                              "  New data will replace the old data");
      else
        AskMode(kModeInsert, " There is already data on file LATER than this date\n"
                             " This procedure will insert the data in the correct position \n"
                             " The update will take a little longer than usual");
      return;
    }
    return;
  }
}

void DayUpdate::AskMode(std::int16_t mode, std::string_view text) {
  const bool go = run_.dialogs.Ask(text, std::string(FileTag_) + TargetPath_,
                                   Buttons::kOkCancel) == Answer::kOk;
  UpdateMode_ = go ? mode : std::int16_t(kModeAbandon);
}

bool DayUpdate::Wanted(const std::string& code) const {
  if (IsService(1)) return true;
  if (!download_.UpdateAll) return UpdateCodes_.contains(code);
  constexpr std::string_view warrants = "WIEX";
  return !(download_.NoWarrants && code.size() == 6 &&
           warrants.find(code[3]) != std::string_view::npos);
}

void DayUpdate::TakeLines() {
  const int total = std::max(lines_, 2);
  LineReader lines(text_);
  std::string_view line;
  DayLine day;
  while (lines.Next(line)) {
    if (lines.number() <= skipLines_) continue;
    if (StopAsked(lines.number(), total)) throw Stopped();
    ReadDayLine(line, OptionsRun_, day);
    if (IsService(4) && download_.VolumeDivisor != 1) day.Volume /= download_.VolumeDivisor;
    if (day.code.empty()) continue;
    run_.display.ShowFirst(" Updating  " + day.code);
    lastDate_ = day.date;
    if (Wanted(day.code)) Write(day);
  }
}

void DayUpdate::Write(const DayLine& day) {
  const auto known = places_.find(day.code);
  const bool look = (IsService(1) && !OptionsRun_) || FileTag_ == "ASX ";
  if (look && known != places_.end()) {
    run_.current.Rec = names_[known->second];
    run_.current.NameRecNo = CInt(double(known->second) + 1);
  }
  const std::string name = CodeFileName(day.code, ".WDT");
  const std::string path = TargetPath_ + name;
  const bool isNew = !priceFiles_.contains(name);
  if (isNew) {
    run_.display.ShowSecond(" Created record for " + day.code);
    AddName(day);
    priceFiles_.insert(name);
  }
  PriceFile file(run_.files, path, isNew ? OpenMode::kCreate : OpenMode::kReadWrite);
  WriteDay(file, day, run_.current.Rec.RecType, UpdateMode_, OptionsRun_);
}

// The name comes before its price file: a run that dies in between is taken up again, while an
// empty price file would never get its name.
void DayUpdate::AddName(const DayLine& day) {
  if (!names_.empty() && names_.back().Code.trimmed() == day.code) {
    run_.current.Rec = names_.back();  // left by such a run
    return;
  }
  if (names_.size() >= size_t(kMostNames)) throw RunTimeError(kOverflow);
  NameRec rec = run_.current.Rec;
  rec.Code.set(day.code);
  rec.Name.set("");
  rec.OtherDetails.set("");
  rec.RecType = IsService(3) && NewRecType_ == kIndex ? std::int16_t(kIndex)
                                                       : std::int16_t(kShare);
  rec.Category = CategoryOf(FileTag_, day.code);
  rec.IndClass.set("");
  rec.Base = rec.Top = rec.PFInc = 0;
  rec.MinMove = 0.05f;
  rec.Id.set(std::string(1, SourceId_));
  if (OptionsRun_) {
    const auto date = ParseFileDate(day.date);
    rec.OtherDetails.set("0" + day.OptType +
                         FormatUserDate(DateOfDayNumber(DayNumber(*date) + day.days)));
  }
  {
    NameFile file(run_.files, NameFilePath(TargetPath_), OpenMode::kCreate);
    file.Append(rec);
  }
  names_.push_back(rec);
  places_.try_emplace(day.code, names_.size() - 1);
  run_.current.Rec = rec;
  run_.current.NameCount = CInt(double(names_.size()));
}

// Whether the option has not expired yet; if not, or if that can't be told, its name says so.
bool DayUpdate::OptionLives(std::int32_t number, NameRec& rec) {
  const std::string_view details = Trim(rec.OtherDetails.trimmed());
  size_t letter = details.find('P');
  if (letter == std::string_view::npos) letter = details.find('C');
  const auto expiry = letter == std::string_view::npos
                          ? std::nullopt
                          : ParseUserDate(Trim(details.substr(letter + 1)));
  const auto today = ParseUserDate(UpdateDate_);
  std::string_view name;
  if (!expiry || !today) name = "DETAILS INCOMPLETE - CHECK";
  else if (DayNumber(*expiry) - DayNumber(*today) < 1) name = "**EXPIRED**";
  else return true;
  rec.Name.set(name);
  NameFile(run_.files, NameFilePath(TargetPath_), OpenMode::kReadWrite).Write(number, rec);
  return false;
}

// Every share that did not trade gets a flat record. The day is off the list by now and has no
// second pass: a run that is to stop does so behind it.
void DayUpdate::NoTradePass() {
  run_.display.ShowFirst("");
  run_.display.ShowSecond(" Checking stocks not traded");
  run_.display.ShowState("Checking no-trades");
  const double date = Val(lastDate_);
  const auto total = std::int32_t(names_.size());
  bool stop = false;
  for (std::int32_t n = 1; n <= total; ++n) {
    if (!stop) stop = StopAsked(n, total);
    NameRec& rec = names_[size_t(n - 1)];
    run_.current.Rec = rec;
    run_.current.NameRecNo = CInt(n);
    if (rec.Category > kNoTradeCategory) continue;
    if (OptionsRun_ && !OptionLives(n, rec)) continue;
    if (rec.RecType != kShare) continue;
    const std::string code = UCase(Trim(rec.Code.trimmed()));
    if (!IsFileCode(code)) continue;
    const std::string name = CodeFileName(code, ".WDT");
    if (!priceFiles_.contains(name)) continue;
    PriceFile file(run_.files, TargetPath_ + name, OpenMode::kReadWrite);
    if (file.count() == 0) continue;
    const PriceRec last = file.Read(file.count());
    if (!(date > Val(last.RecDate.raw()))) continue;
    if (file.count() >= kMostNames) throw RunTimeError(kOverflow);
    run_.display.ShowFirst(" Checking " + code);
    PriceRec flat = NewPriceRec(lastDate_);
    flat.Open = flat.High = flat.Low = flat.Close = last.Close;
    file.Append(flat);
  }
  if (stop) throw Stopped();
}

// Shown from the first record of a run to the last.
class Running {
 public:
  explicit Running(UpdateDisplay& display) : display_(display) { display_.SetRunning(true); }
  ~Running() { display_.SetRunning(false); }
  Running(const Running&) = delete;
  Running& operator=(const Running&) = delete;

 private:
  UpdateDisplay& display_;
};

UpdateEnd UpdateDay(const UpdateRun& run, const std::string& entry, bool MoreToCome) {
  try {
    run.display.ShowDate(entry);
    return DayUpdate(run, entry, MoreToCome).UpdateFromDownload();
  } catch (const Stopped&) {
  } catch (const RunTimeError& e) {
    run.dialogs.Message(DownloadErrorText(e), "Error");
  } catch (const std::bad_alloc&) {
    run.dialogs.Message(DownloadErrorText(RunTimeError(kOutOfMemory)), "Error");
  }
  return UpdateEnd::kStopped;
}

void ClearTexts(UpdateDisplay& display) {
  display.ShowDate("");
  display.ShowFirst("");
  display.ShowSecond("");
}

}  // namespace

UpdateEnd UpdateOneDay(const UpdateRun& run, DownloadEntries& entries, size_t selected) {
  UpdateEnd end;
  {
    const Running running(run.display);
    end = UpdateDay(run, entries.at(selected), false);
  }
  if (end == UpdateEnd::kUpdated)
    entries.erase(entries.begin() + std::ptrdiff_t(selected));
  ClearTexts(run.display);
  const bool finished = end == UpdateEnd::kUpdated || end == UpdateEnd::kAbandoned;
  run.display.ShowState(finished ? "FINISHED" : "");
  return end;
}

UpdateEnd UpdateAllDays(const UpdateRun& run, const DownloadEntries& entries,
                        const std::function<void(size_t)>& select) {
  UpdateEnd all = UpdateEnd::kUpdated;
  // Events are handled between the days too, and must not find the form at rest there.
  const Running running(run.display);
  for (size_t i = 0; i < entries.size(); ++i) {
    if (select) select(i);
    const UpdateEnd end = UpdateDay(run, entries[i], i + 1 < entries.size());
    if (end == UpdateEnd::kStopped) {
      all = end;
      run.display.ShowState("");
      break;
    }
    if (end != UpdateEnd::kUpdated) all = UpdateEnd::kAbandoned;
    run.dialogs.Yield();
  }
  ClearTexts(run.display);
  return all;
}

}  // namespace kora
