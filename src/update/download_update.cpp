#include "update/download_update.h"

#include <algorithm>
#include <array>
#include <functional>
#include <new>
#include <optional>
#include <unordered_set>
#include <vector>

#include "base/home_lock.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/clock.h"
#include "store/price_rec.h"
#include "update/day_line.h"
#include "update/download_settings.h"
#include "update/price_write.h"
#include "update/security_details.h"
#include "update/staged_folder.h"
#include "update/update_journal.h"
#include "update/update_report.h"

namespace kora {
namespace {

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

// The end of a text, for messages.
std::string_view LastOf(std::string_view text, size_t size) {
  return text.size() > size ? text.substr(text.size() - size) : text;
}

// The first point of the whole path ends the base, even one in a folder's name.
std::string BaseOf(const std::string& path) { return path.substr(0, path.find('.')); }

std::int16_t CategoryOf(std::string_view FileTag, std::string_view code) {
  if (FileTag != "EQUITIES " || code.size() != 6) return 1;
  switch (code[3]) {
    case 'E':
    case 'e': return 86;
    case 'I':
    case 'i': return 87;
    case 'W':
    case 'w': return 84;
    default: return 88;
  }
}

// What lasts from the first day of a run to the last.
struct RunState {
  UpdateJournal journal;
  UpdateReport report;
  std::string finished;  // the entry that was finished for a run that died
  std::string inHand;    // the file that a failure befell
};

// One date of the update list.
class DayUpdate {
 public:
  DayUpdate(const UpdateRun& run, RunState& state, const std::string& entry, bool MoreToCome)
      : run_(run),
        state_(state),
        download_(run.settings.download),
        MoreToCome_(MoreToCome),
        SelectedDownloadFile_(DownloadFilePath(download_.DLPath, entry)),
        UpdateDate_(UpdateDateOf(entry, run.clock.Today())) {
    // A run before which nothing was read yet.
    if (run_.current.Rec.Code.raw()[0] == '\0') run_.current.Rec = NewNameRec("");
    state_.inHand = SelectedDownloadFile_;
    DayProgress& day = state_.journal.progress;
    if (day.entry == SelectedDownloadFile_) return;
    day = {};
    day.entry = SelectedDownloadFile_;
  }

  UpdateEnd UpdateFromDownload();
  // Of an entry that was finished for a run that died.
  void CloseFinished();

 private:
  bool WholeMarket(const WmPaths& lines);
  bool UpdateFile(DayProgress::Leaving leaving);
  void CloseDay();
  void CheckData();
  void Refuse(std::string_view why) { state_.report.Refused(ShownName(), why); }
  void Commit(int lines, std::int32_t names);
  void CommitWhole(DayProgress::Leaving leaving);
  void Commit(DayProgress day);
  void RemoveBlankLines();
  bool CheckLines();
  void RefuseCommas(std::string_view line);
  void RefuseLine(std::string_view line, int number, const std::string& fault);
  void ProbeDate();
  void AskMode(std::int16_t mode, std::string_view text);
  void TakeLines();
  bool Wanted(const std::string& code) const;
  void Write(const DayLine& day);
  bool AddName(const DayLine& day);
  void NoTradePass();
  void AddFlat(const std::string& name, const std::string& code, double date);
  bool OptionLives(size_t place);
  bool StopAsked(int done, int total);

  bool IsService(int service) const { return download_.DataService == service; }
  std::string_view ShownName() const { return FileNameOf(SelectedDownloadFile_); }

  const UpdateRun& run_;
  RunState& state_;
  const DownloadSettings& download_;
  const bool MoreToCome_;
  std::string SelectedDownloadFile_;
  const std::string UpdateDate_;
  std::string baseName_;   // of a whole-market run, with its folder
  std::string bulletins_;  // the folder of Adjust.Lst
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
  TakenFile identity_;
  int skipLines_ = 0;           // that the date probe left behind
  int linesDone_ = 0;           // by a run that died
  std::int32_t namesDone_ = 0;  // by its no-trade pass
  std::string lastDate_;
  std::optional<StagedFolder> folder_;  // TargetPath
};

bool DayUpdate::StopAsked(int done, int total) {
  return !run_.display.Step(done, total) &&
         run_.dialogs.Ask("The update is not finished. Stop it ?", "Update", Buttons::kYesNo) ==
             Answer::kYes;
}

UpdateEnd DayUpdate::UpdateFromDownload() {
  TargetPath_ = run_.settings.paths.CurrentDataPath;
  bulletins_ = TargetPath_;
  if (!IsService(1) && !download_.UpdateAll)
    for (const UpdateRow& row : ReadUpdateList(run_.files, run_.settings.paths.SystemPath))
      UpdateCodes_.insert(row.code);
  run_.display.Show(ProgressLine::kNote, "");

  bool good = false;
  if (IsService(3)) {
    const WmPaths lines = ReadWmPaths(run_.files, run_.settings.paths.SystemPath);
    if (!WmPathsComplete(lines)) {
      run_.dialogs.Message(kNoMarketFolders, kNoMarketFoldersTitle);
      return UpdateEnd::kNotBegun;
    }
    bulletins_ = WithBackslash(Trim(lines[kWmAsx]));
    good = WholeMarket(lines);
  } else {
    run_.display.Show(ProgressLine::kState, "Updating ");
    const bool ends = EqualNoCase(LastOf(SelectedDownloadFile_, 1), "D");
    if (state_.finished == SelectedDownloadFile_) {
      good = true;
    } else if (run_.files.CheckFile(SelectedDownloadFile_)) {
      // A file of the internet that keeps the ending ".ASX" is not renamed.
      good = UpdateFile(ends ? DayProgress::kRenamed : DayProgress::kLeft);
    } else {
      run_.dialogs.Message("File does not exist\n" + SelectedDownloadFile_, "Update");
      return UpdateEnd::kNotBegun;
    }
  }

  if (!MoreToCome_)
    run_.display.Show(ProgressLine::kNote, " Data files updated with " + SelectedDownloadFile_);
  CloseDay();
  state_.journal.End();
  return good ? UpdateEnd::kUpdated : UpdateEnd::kAbandoned;
}

void DayUpdate::CloseDay() {
  if (!IsService(1) && !IsService(3)) return;
  state_.inHand = bulletins_;
  if (run_.CheckBulletins) run_.CheckBulletins(bulletins_, std::string(LastOf(baseName_, 7)));
  UpdateSecurityDetails(run_.files, download_);
}

void DayUpdate::CloseFinished() {
  bulletins_ = run_.settings.paths.CurrentDataPath;
  if (IsService(3)) {
    bulletins_ =
        WithBackslash(Trim(ReadWmPaths(run_.files, run_.settings.paths.SystemPath)[kWmAsx]));
    baseName_ = BaseOf(SelectedDownloadFile_);
  }
  CloseDay();
}

bool DayUpdate::WholeMarket(const WmPaths& lines) {
  baseName_ = BaseOf(SelectedDownloadFile_);
  const auto pathOf = [this](const FileKind& kind) {
    return baseName_ + std::string(kind.extension);
  };
  const FileKind* last = nullptr;
  for (const FileKind& kind : kKinds)
    if (run_.files.CheckFile(pathOf(kind))) last = &kind;
  bool good = true;
  for (const FileKind& kind : kKinds) {
    const std::string path = pathOf(kind);
    FileTag_ = kind.FileTag;
    TargetPath_ = WithBackslash(Trim(lines[kind.target]));
    NewRecType_ = kind.NewRecType;
    SourceId_ = kind.SourceId;
    if (!run_.files.CheckFile(path)) continue;
    SelectedDownloadFile_ = state_.inHand = path;
    run_.display.Show(ProgressLine::kState, "Updating " + std::string(FileTag_));
    OptionsRun_ = kind.SourceId == 'P';
    good &= UpdateFile(good && &kind == last ? DayProgress::kDeleted : DayProgress::kStays);
    OptionsRun_ = false;
  }
  // A file that was refused or cancelled waits for the next run.
  if (good) {
    state_.journal.progress.leaving = DayProgress::kDeleted;
    state_.journal.LeaveList();
  }
  if (const std::string chosen = WmChosenFolder(lines); !chosen.empty())
    run_.settings.paths.CurrentDataPath = chosen;
  run_.display.Show(ProgressLine::kState, "Updated");
  return good;
}

// One text file into TargetPath, with which the day's entry leaves the list as told. False when it
// was refused or cancelled; a file without data counts as taken in a whole-market run.
bool DayUpdate::UpdateFile(DayProgress::Leaving leaving) {
  run_.display.Show(ProgressLine::kTarget, TargetPath_);
  UpdateMode_ = kModeAppend;
  state_.inHand = TargetPath_;
  folder_.emplace(run_.files, TargetPath_);
  state_.inHand = SelectedDownloadFile_;
  run_.current.NameCount = CInt(double(folder_->names().size()));
  run_.display.Show(ProgressLine::kItem, " Updating  " + std::string(LastOf(ShownName(), 11)));

  CheckData();
  if (UpdateMode_ == kModeAbandon) {
    const bool empty = NoDataFlag_;
    NoDataFlag_ = false;
    return empty && IsService(3);
  }
  const auto& done = state_.journal.progress.done;
  if (std::find(done.begin(), done.end(), identity_) != done.end()) return true;
  run_.display.Show(ProgressLine::kNote, " Data OK - updating");
  TakeLines();
  const bool pass = IsService(3) ? SourceId_ == 'S' || SourceId_ == 'F' || SourceId_ == 'P'
                                 : !IsService(1) && leaving == DayProgress::kRenamed;
  if (pass && UpdateMode_ == kModeAppend) NoTradePass();
  CommitWhole(leaving);
  if (!IsService(3)) state_.journal.LeaveList();
  return true;
}

// Makes what is held: the file's first lines, and the first names of its no-trade pass.
void DayUpdate::Commit(int lines, std::int32_t names) {
  DayProgress day = state_.journal.progress;
  day.part = identity_;
  day.mode = UpdateMode_;
  day.skip = skipLines_;
  day.lines = lines;
  day.names = names;
  Commit(std::move(day));
}

void DayUpdate::CommitWhole(DayProgress::Leaving leaving) {
  DayProgress day = state_.journal.progress;
  day.part.reset();
  day.done.push_back(identity_);
  day.leaving = leaving;
  Commit(std::move(day));
}

void DayUpdate::Commit(DayProgress day) {
  day.held = run_.current.Rec;
  state_.journal.Commit(std::move(day), folder_->Edits(), state_.inHand);
  folder_->Made();
}

// Sets UpdateMode and decides whether the file can be used.
void DayUpdate::CheckData() {
  run_.display.Show(ProgressLine::kNote, " Checking file format - wait");
  NoDataFlag_ = false;
  skipLines_ = linesDone_ = 0;
  namesDone_ = 0;
  text_ = run_.files.ReadAll(SelectedDownloadFile_, kLargestData);
  if (text_.size() < kSmallestData) {
    std::string text = "There is no data in " + std::string(ShownName()) + "\n";
    if (IsService(1) && text_.empty())
      text += "Use Convert Mainfile Data routine in KORA/Tarvo Download to reprocess data";
    if (IsService(3)) text += "Use Update The Lot in KORA/Tarvo Download to reprocess";
    run_.dialogs.Message(text, "Data Update");
    Refuse("no data");
    UpdateMode_ = kModeAbandon;
    NoDataFlag_ = true;
    run_.display.Show(ProgressLine::kNote, "");
    return;
  }
  if (IsService(4)) RemoveBlankLines();
  identity_ = IdentityOf(SelectedDownloadFile_, text_);
  if (!CheckLines()) {
    UpdateMode_ = kModeAbandon;
    return;
  }
  const DayProgress& day = state_.journal.progress;
  if (std::find(day.done.begin(), day.done.end(), identity_) != day.done.end()) return;
  if (day.part == identity_) {
    UpdateMode_ = day.mode;
    skipLines_ = day.skip;
    linesDone_ = day.lines;
    namesDone_ = day.names;
    if (day.held) run_.current.Rec = *day.held;
    return;
  }
  ProbeDate();
  if (skipLines_ > 0 && UpdateMode_ != kModeAbandon)
    state_.report.Misread(ShownName(), "lines 1 to " + Str(std::int32_t(skipLines_)) +
                                           " passed over: line " + Str(std::int32_t(skipLines_)) +
                                           " has no code");
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
  Refuse("an incorrect number of fields");
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
  Refuse("line " + Str(std::int32_t(number)) + ":" + fault);
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
    if (!folder_->HasPrices(name)) continue;
    state_.inHand = TargetPath_ + name;
    const PriceFile file(run_.files, TargetPath_ + name);
    if (file.count() == 0) continue;

    const double wanted = Val(day.date);
    const double last = Val(file.Read(file.count()).RecDate.raw());
    if (wanted == last)
      AskMode(kModeReplace,
              " There is already data on file with this date\n"
              "  New data will replace the old data");
    if (wanted >= last) return;
    const std::vector<PriceRec> records = file.ReadAll();
    for (size_t n = records.size() - 1; n > 0; --n) {
      const double there = Val(records[n - 1].RecDate.raw());
      if (there > wanted) continue;
      if (there == wanted)
        AskMode(kModeReplace,
                " There is already data on file for this date\n"
                "  New data will replace the old data");
      else
        AskMode(kModeInsert,
                " There is already data on file LATER than this date\n"
                " This procedure will insert the data in the correct position \n"
                " The update will take a little longer than usual");
      return;
    }
    return;
  }
}

void DayUpdate::AskMode(std::int16_t mode, std::string_view text) {
  const bool go = run_.dialogs.Ask(text, std::string(FileTag_) + TargetPath_, Buttons::kOkCancel) ==
                  Answer::kOk;
  UpdateMode_ = go ? mode : std::int16_t(kModeAbandon);
  if (!go) Refuse("cancelled");
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
    const bool done = lines.number() <= linesDone_;
    if (!done && StopAsked(lines.number(), total)) throw Stopped();
    ReadDayLine(line, OptionsRun_, day);
    if (IsService(4) && download_.VolumeDivisor != 1) day.Volume /= download_.VolumeDivisor;
    if (day.code.empty()) {
      if (!done)
        state_.report.Misread(ShownName(),
                              "line " + Str(std::int32_t(lines.number())) + ": no code");
      continue;
    }
    lastDate_ = day.date;
    if (done) continue;
    run_.display.Show(ProgressLine::kItem, " Updating  " + day.code);
    if (!Wanted(day.code)) continue;
    for (const std::string& field : MisreadFields(line, OptionsRun_))
      state_.report.Misread(ShownName(), "line " + Str(std::int32_t(lines.number())) + ", " +
                                             day.code + ": " + field);
    Write(day);
    if (folder_->bytes() >= run_.mostHeld) Commit(lines.number(), 0);
  }
}

void DayUpdate::Write(const DayLine& day) {
  const auto leaveOut = [&](const std::string& why) {
    state_.report.LeftOut(ShownName(), day.code + ": " + why);
  };
  const bool look = (IsService(1) && !OptionsRun_) || FileTag_ == "ASX ";
  const size_t known = folder_->PlaceOf(day.code);
  if (look && known < folder_->names().size()) {
    run_.current.Rec = folder_->names()[known];
    run_.current.NameRecNo = CInt(double(known) + 1);
  }
  const std::string name = CodeFileName(day.code, ".WDT");
  state_.inHand = TargetPath_ + name;
  if (!folder_->HasPrices(name) && !AddName(day)) {
    leaveOut("the name file is full, with " + Str(kMostNames) + " names");
    return;
  }
  PriceView file = folder_->Prices(name);
  try {
    const std::string why = WriteDay(file, day, run_.current.Rec.RecType, UpdateMode_, OptionsRun_);
    if (!why.empty()) leaveOut(why);
  } catch (const RunTimeError& e) {
    if (e.number() != kOverflow) throw;
    leaveOut("its total leaves the range of its field");
  }
  folder_->Count(name);
}

// False where the name file is full. The name goes in front of its price file: an empty price
// file would never get one.
bool DayUpdate::AddName(const DayLine& day) {
  if (folder_->names().size() >= size_t(kMostNames)) return false;
  run_.display.Show(ProgressLine::kNote, " Created record for " + day.code);
  NameRec rec = run_.current.Rec;
  rec.Code.set(day.code);
  rec.Name.set("");
  rec.OtherDetails.set("");
  rec.RecType = IsService(3) && NewRecType_ == kIndex ? std::int16_t(kIndex) : std::int16_t(kShare);
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
  folder_->AddName(rec);
  run_.current.Rec = rec;
  run_.current.NameCount = CInt(double(folder_->names().size()));
  return true;
}

// Whether the option has not expired yet; if not, or if that can't be told, its name says so.
bool DayUpdate::OptionLives(size_t place) {
  NameRec rec = folder_->names()[place];
  const std::string_view details = Trim(rec.OtherDetails.trimmed());
  size_t letter = details.find('P');
  if (letter == std::string_view::npos) letter = details.find('C');
  const auto expiry = letter == std::string_view::npos
                          ? std::nullopt
                          : ParseUserDate(Trim(details.substr(letter + 1)));
  const auto today = ParseUserDate(UpdateDate_);
  std::string_view name;
  if (!expiry || !today)
    name = "DETAILS INCOMPLETE - CHECK";
  else if (DayNumber(*expiry) - DayNumber(*today) < 1)
    name = "**EXPIRED**";
  else
    return true;
  rec.Name.set(name);
  folder_->ChangeName(place, rec);
  return false;
}

// Every share that did not trade gets a flat record.
void DayUpdate::NoTradePass() {
  run_.display.Show(ProgressLine::kItem, "");
  run_.display.Show(ProgressLine::kNote, " Checking stocks not traded");
  run_.display.Show(ProgressLine::kState, "Checking no-trades");
  const double date = Val(lastDate_);
  const auto total = std::int32_t(folder_->names().size());
  for (std::int32_t n = namesDone_ + 1; n <= total; ++n) {
    if (StopAsked(n, total)) throw Stopped();
    const NameRec& rec = folder_->names()[size_t(n - 1)];
    run_.current.Rec = rec;
    run_.current.NameRecNo = CInt(n);
    if (rec.Category > kNoTradeCategory) continue;
    if (OptionsRun_ && !OptionLives(size_t(n - 1))) continue;
    if (rec.RecType != kShare) continue;
    const std::string code(Trim(rec.Code.trimmed()));
    if (!IsFileCode(code)) continue;
    const std::string name = CodeFileName(code, ".WDT");
    if (!folder_->HasPrices(name)) continue;
    state_.inHand = TargetPath_ + name;
    AddFlat(name, code, date);
    folder_->Count(name);
    if (folder_->bytes() >= run_.mostHeld) Commit(lines_, n);
  }
}

void DayUpdate::AddFlat(const std::string& name, const std::string& code, double date) {
  PriceView file = folder_->Prices(name);
  if (file.count() == 0) return;
  const PriceRec last = file.Read(file.count());
  if (!(date > Val(last.RecDate.raw()))) return;
  if (const std::string full = FullText(file); !full.empty()) {
    state_.report.LeftOut(ShownName(), code + ": " + full);
    return;
  }
  run_.display.Show(ProgressLine::kItem, " Checking " + code);
  PriceRec flat = NewPriceRec(lastDate_);
  flat.Open = flat.High = flat.Low = flat.Close = last.Close;
  file.WriteRun(file.count() + 1, std::span(&flat, 1));
}

// Tells what `work` fails with, and the file that it befell.
UpdateEnd Guarded(const UpdateRun& run, RunState& state, const std::function<UpdateEnd()>& work) {
  std::string text;
  try {
    return work();
  } catch (const Stopped&) {
    return UpdateEnd::kStopped;
  } catch (const RunTimeError& e) {
    text = DownloadErrorText(e) + "\n" + state.inHand + ": " + e.what();
  } catch (const std::bad_alloc&) {
    text = DownloadErrorText(RunTimeError(kOutOfMemory)) + "\n" + state.inHand;
  }
  run.dialogs.Message(text, "Error");
  return UpdateEnd::kStopped;
}

// Before anything else: what a run that died has left.
UpdateEnd FinishLast(const UpdateRun& run, RunState& state) {
  return Guarded(run, state, [&] {
    state.finished = state.journal.Finish(state.report, state.inHand);
    if (state.journal.progress.held) run.current.Rec = *state.journal.progress.held;
    if (!state.finished.empty())
      DayUpdate(run, state, std::string(FileNameOf(state.finished)), false).CloseFinished();
    return UpdateEnd::kUpdated;
  });
}

UpdateEnd UpdateDay(const UpdateRun& run, RunState& state, const std::string& entry,
                    bool MoreToCome) {
  return Guarded(run, state, [&] {
    run.display.Show(ProgressLine::kDate, entry);
    return DayUpdate(run, state, entry, MoreToCome).UpdateFromDownload();
  });
}

// One message for all that was not taken as it stood. A file that was refused alone was told.
void TellReport(const UpdateRun& run, const UpdateReport& report, bool severalFiles) {
  if (report.leftOut() || report.misread() || (report.refused() && severalFiles))
    run.dialogs.Message("Not everything was taken in as it stands:\n" + report.Text(),
                        "Data Update");
}

void ClearTexts(Progress& display) {
  display.Show(ProgressLine::kDate, "");
  display.Show(ProgressLine::kItem, "");
  display.Show(ProgressLine::kNote, "");
}

}  // namespace

// Nothing after a message, where another program writes the store.
std::optional<HomeLock::Held> HoldHome(const UpdateRun& run) {
  try {
    return run.files.lock().Hold();
  } catch (const RunTimeError& e) {
    run.dialogs.Message(DownloadErrorText(e), "Error");
    return std::nullopt;
  }
}

UpdateEnd UpdateOneDay(const UpdateRun& run, DownloadEntries& entries, size_t selected) {
  const auto held = HoldHome(run);
  if (!held) return UpdateEnd::kNotBegun;
  RunState state{UpdateJournal(run.files, run.settings.paths.SystemPath), {}, {}, {}};
  UpdateEnd end;
  {
    const PassOn running(run.display);
    end = FinishLast(run, state);
    if (end != UpdateEnd::kStopped) end = UpdateDay(run, state, entries.at(selected), false);
  }
  if (end == UpdateEnd::kUpdated && state.report.leftOut()) end = UpdateEnd::kUpdatedInPart;
  if (IsTaken(end)) entries.erase(entries.begin() + std::ptrdiff_t(selected));
  ClearTexts(run.display);
  const bool finished = IsTaken(end) || end == UpdateEnd::kAbandoned;
  run.display.Show(ProgressLine::kState, finished ? "FINISHED" : "");
  TellReport(run, state.report, run.settings.download.DataService == 3);
  return end;
}

UpdateEnd UpdateAllDays(const UpdateRun& run, const DownloadEntries& entries,
                        const std::function<void(size_t)>& select) {
  const auto held = HoldHome(run);
  if (!held) return UpdateEnd::kNotBegun;
  RunState state{UpdateJournal(run.files, run.settings.paths.SystemPath), {}, {}, {}};
  UpdateEnd all = UpdateEnd::kUpdated;
  {
    // Events are handled between the days too, and must not find the form at rest there.
    const PassOn running(run.display);
    all = FinishLast(run, state);
    for (size_t i = 0; i < entries.size() && all != UpdateEnd::kStopped; ++i) {
      if (select) select(i);
      const UpdateEnd end = UpdateDay(run, state, entries[i], i + 1 < entries.size());
      if (end == UpdateEnd::kStopped) {
        all = end;
        run.display.Show(ProgressLine::kState, "");
        break;
      }
      if (end != UpdateEnd::kUpdated) all = UpdateEnd::kAbandoned;
      run.dialogs.Yield();
    }
  }
  if (all == UpdateEnd::kUpdated && state.report.leftOut()) all = UpdateEnd::kUpdatedInPart;
  ClearTexts(run.display);
  TellReport(run, state.report, true);
  return all;
}

}  // namespace kora
