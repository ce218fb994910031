#include "update/import_history.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstring>
#include <filesystem>
#include <map>
#include <new>
#include <stdexcept>
#include <vector>

#include "base/dates.h"
#include "base/file_set.h"
#include "base/home_lock.h"
#include "base/host_files.h"
#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/chart_list.h"
#include "platform/dialogs.h"
#include "store/name_file.h"
#include "store/price_rec.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Import";
constexpr std::uint64_t kLargestFile = 256u << 20;
constexpr size_t kLongestLine = 4096;
// Rows in memory; what is more goes in several steps, each of which is put in place whole.
constexpr size_t kMostRows = 512u << 20;
constexpr size_t kMostHeld = 64u << 20;  // bytes of new files in memory
constexpr int kMostTold = 20;            // bad rows of a file that are told one by one

// What ends the import of a file, in words for the user.
struct Refused : std::runtime_error {
  using std::runtime_error::runtime_error;
};
// What is wrong with a row.
struct BadRow : std::runtime_error {
  using std::runtime_error::runtime_error;
};

enum Column { kDate, kOpen, kHigh, kLow, kClose, kVolume, kCode, kColumns };
constexpr std::array<const char*, kColumns> kColumnNames{"Date",  "Open",   "High", "Low",
                                                         "Close", "Volume", "Code"};

// Where the columns stand in a row, from 0; -1 for those that it lacks.
struct Layout {
  char separator = ',';
  std::array<int, kColumns> place{};
  size_t fields = 0;   // that a row must have
  bool exact = false;  // and no more
};

// The rows of one security.
struct Group {
  std::int16_t recType = kShare;
  bool isNew = false;
  std::vector<PriceRec> rows;
};

struct Parsed {
  std::map<std::string, Group> groups;
  std::set<std::string> columnCodes;  // codes as the rows have them
  std::int64_t rows = 0;
  std::int64_t bad = 0;
};

// Text of a file as it may be shown.
std::string Shown(std::string_view text) {
  std::string out;
  for (const char c : text.substr(0, 40)) {
    const auto u = static_cast<unsigned char>(c);
    out += u < 0x20 || u >= 0x7F ? '?' : c;
  }
  if (text.size() > 40) out += "...";
  return "\"" + out + "\"";
}

char SeparatorOf(std::string_view line) {
  char best = ',';
  std::ptrdiff_t most = 0;
  for (const char c : {',', ';', '\t'}) {
    const std::ptrdiff_t n = std::count(line.begin(), line.end(), c);
    if (n > most) {
      most = n;
      best = c;
    }
  }
  return best;
}

// Splits a line at its separators. A field may stand in quotes, which are taken off. False
// for a quote that does not end, or has something behind it.
bool SplitFields(std::string_view line, char separator, std::vector<std::string_view>& fields) {
  fields.clear();
  size_t at = 0;
  for (;;) {
    while (at < line.size() && line[at] == ' ') ++at;
    size_t end;
    if (at < line.size() && line[at] == '"') {
      size_t close = line.find('"', at + 1);
      while (close != std::string_view::npos && close + 1 < line.size() && line[close + 1] == '"')
        close = line.find('"', close + 2);
      if (close == std::string_view::npos) return false;
      fields.push_back(Trim(line.substr(at + 1, close - at - 1)));
      end = close + 1;
      while (end < line.size() && line[end] == ' ') ++end;
      if (end < line.size() && line[end] != separator) return false;
    } else {
      end = std::min(line.find(separator, at), line.size());
      fields.push_back(Trim(line.substr(at, end - at)));
    }
    if (end == line.size()) return true;
    at = end + 1;
  }
}

int ColumnOf(std::string_view name) {
  constexpr std::pair<const char*, Column> names[] = {
      {"Date", kDate},   {"Open", kOpen},     {"High", kHigh}, {"Low", kLow},
      {"Close", kClose}, {"Volume", kVolume}, {"Code", kCode}, {"Symbol", kCode},
      {"Ticker", kCode}, {"Rises", kHigh},    {"Falls", kLow}, {"Cum.Total", kClose}};
  for (const auto& [text, column] : names)
    if (EqualNoCase(name, text)) return column;
  return -1;
}

// The layout that the first line tells. `header` becomes whether that line is one.
Layout ReadLayout(std::string_view first, bool& header) {
  Layout layout;
  layout.separator = SeparatorOf(first);
  layout.place.fill(-1);
  std::vector<std::string_view> fields;
  if (first.size() > kLongestLine || !SplitFields(first, layout.separator, fields))
    throw Refused("line 1: neither a header nor a row of prices");
  for (size_t i = 0; i < fields.size(); ++i) {
    const int column = ColumnOf(fields[i]);
    if (column < 0 || layout.place[size_t(column)] >= 0) continue;
    layout.place[size_t(column)] = int(i);
    layout.fields = i + 1;
  }
  header = layout.place[kDate] >= 0;
  if (header) {
    if (layout.place[kClose] < 0) throw Refused("line 1: the header names no Close column");
    return layout;
  }
  if (fields.size() != 8)
    throw Refused(
        "line 1: neither a header that names Date and Close nor a row "
        "CODE,yyyymmdd,open,high,low,close,volume,spare");
  layout.place = {1, 2, 3, 4, 5, 6, 0};
  layout.fields = 8;
  layout.exact = true;
  return layout;
}

std::string ReadDate(std::string_view text, ImportDates form) {
  const bool dashed = text.size() == 10 && text[4] == '-' && text[7] == '-';
  std::optional<CalendarDate> date;
  const char* wanted = "";
  switch (form) {
    case ImportDates::kDetect:
      wanted = "yyyymmdd or yyyy-mm-dd";
      form = dashed ? ImportDates::kDashed : ImportDates::kCompact;
      break;
    case ImportDates::kCompact: wanted = "yyyymmdd"; break;
    case ImportDates::kDashed: wanted = "yyyy-mm-dd"; break;
    case ImportDates::kSlashed: wanted = "d/m/yyyy"; break;
  }
  if (form == ImportDates::kCompact) {
    date = ParseFileDate(text);
  } else if (form == ImportDates::kDashed) {
    if (dashed)
      date = ParseFileDate(std::string(text.substr(0, 4)) + std::string(text.substr(5, 2)) +
                           std::string(text.substr(8, 2)));
  } else if (text.rfind('/') + 5 == text.size()) {  // four digits of the year
    date = ParseUserDate(text);
  }
  if (!date) throw BadRow("the Date " + Shown(text) + " is no date in the form " + wanted);
  return FormatFileDate(*date);
}

float ReadPrice(std::string_view text, Column column, bool negative) {
  const auto value = ParseFloat(text);
  if (!value || (*value < 0 && !negative))
    throw BadRow("the " + std::string(kColumnNames[column]) + " " + Shown(text) + " is no price");
  return *value + 0.0f;  // no negative zero
}

std::int32_t ReadVolume(std::string_view text) {
  if (text.empty()) return 0;
  double value = 0;
  const auto r = std::from_chars(text.data(), text.data() + text.size(), value);
  if (r.ec != std::errc() || r.ptr != text.data() + text.size() || !std::isfinite(value) ||
      value < 0)
    throw BadRow("the Volume " + Shown(text) + " is no volume");
  value = RoundHalfEven(value);
  if (value > 2147483647.0) throw BadRow("the Volume " + Shown(text) + " is above 2147483647");
  return CLng(value);
}

// The fields of a row as the kind of data has them.
PriceRec ReadRow(const Layout& layout, const std::vector<std::string_view>& fields,
                 ImportDates dates, std::int16_t recType) {
  const auto has = [&](Column c) { return layout.place[c] >= 0; };
  const auto field = [&](Column c) { return fields[size_t(layout.place[c])]; };
  PriceRec rec = NewPriceRec(ReadDate(field(kDate), dates));
  const bool total = recType == kAdvanceDecline;
  rec.Close = ReadPrice(field(kClose), kClose, total);
  const auto price = [&](Column c, float missing) {
    return has(c) ? ReadPrice(field(c), c, false) : missing;
  };
  if (recType == kCloseVolume || recType == kCloseOnly) {
    rec.Open = rec.High = rec.Low = rec.Close;
  } else if (total) {
    rec.High = price(kHigh, 0);
    rec.Low = price(kLow, 0);
  } else {
    rec.Open = price(kOpen, rec.Close);
    rec.High = price(kHigh, std::max(float(rec.Open), float(rec.Close)));
    rec.Low = price(kLow, std::min(float(rec.Open), float(rec.Close)));
  }
  if (has(kVolume) && recType != kCloseOnly) rec.Volume = ReadVolume(field(kVolume));
  return rec;
}

// The rows of one file by security.
class Reader {
 public:
  Reader(const std::string& hostFile, const ImportOptions& options,
         const std::map<std::string, std::int16_t>& known, Dialogs& dialogs)
      : hostFile_(hostFile), options_(options), known_(known), dialogs_(dialogs) {}

  Parsed Read(std::string_view text) {
    if (text.substr(0, 3) == "\xEF\xBB\xBF") text.remove_prefix(3);
    if (text.find('\0') != std::string_view::npos || text.substr(0, 2) == "\xFF\xFE" ||
        text.substr(0, 2) == "\xFE\xFF")
      throw Refused("no plain text file");
    LineReader lines(text);
    std::string_view line;
    bool first = true;
    while (lines.Next(line)) {
      if (Trim(line).empty()) continue;
      if (first) {
        first = false;
        bool header = false;
        layout_ = ReadLayout(line, header);
        if (header) continue;
      }
      ++parsed_.rows;
      try {
        Take(line);
      } catch (const BadRow& bad) {
        Tell(lines.number(), bad.what());
      }
    }
    if (parsed_.bad > kMostTold)
      dialogs_.Message(hostFile_ + ": and " + std::to_string(parsed_.bad - kMostTold) +
                           " more rows that can't be read",
                       kTitle);
    return std::move(parsed_);
  }

 private:
  void Take(std::string_view line) {
    if (line.size() > kLongestLine)
      throw BadRow("longer than " + std::to_string(kLongestLine) + " characters");
    if (!SplitFields(line, layout_.separator, fields_)) throw BadRow("a quote does not end");
    if (fields_.size() < layout_.fields || (layout_.exact && fields_.size() != layout_.fields))
      throw BadRow(std::to_string(fields_.size()) + " fields where " +
                   std::to_string(layout_.fields) + " are wanted");
    Group& group = GroupFor(layout_.place[kCode] >= 0 ? fields_[size_t(layout_.place[kCode])]
                                                      : std::string_view());
    group.rows.push_back(ReadRow(layout_, fields_, options_.Dates, group.recType));
  }

  Group& GroupFor(std::string_view written) {
    if (group_ && written == written_) return *group_;
    std::string code = KeptCode(UCase(written));
    if (layout_.place[kCode] >= 0) {
      if (!IsFileCode(code)) throw BadRow(Shown(written) + " is no code");
      parsed_.columnCodes.insert(code);
    }
    if (!options_.Code.empty()) {
      code = KeptCode(UCase(Trim(options_.Code)));
    } else if (layout_.place[kCode] < 0) {
      code = KeptCode(UCase(std::filesystem::path(hostFile_).stem().string()));
    }
    // No row of the file could be taken then.
    if (!IsFileCode(code))
      throw Refused(Shown(code) + " is no code; a code has 1 to 6 letters and digits");
    written_ = written;
    const auto [it, added] = parsed_.groups.try_emplace(code);
    group_ = &it->second;
    if (added) {
      const auto old = known_.find(code);
      group_->isNew = old == known_.end();
      group_->recType = group_->isNew ? options_.Type.value_or(std::int16_t(kShare)) : old->second;
      if (options_.Type && *options_.Type != group_->recType)
        throw Refused(code + " is of type " + std::to_string(group_->recType) +
                      " in the name file, not " + std::to_string(*options_.Type));
    }
    return *group_;
  }

  void Tell(int line, const char* what) {
    if (++parsed_.bad <= kMostTold)
      dialogs_.Message(hostFile_ + " line " + std::to_string(line) + ": " + what, kTitle);
  }

  const std::string& hostFile_;
  const ImportOptions& options_;
  const std::map<std::string, std::int16_t>& known_;
  Dialogs& dialogs_;
  Layout layout_;
  Parsed parsed_;
  std::vector<std::string_view> fields_;
  std::string_view written_;  // the code of the row before, whose group is group_
  Group* group_ = nullptr;
};

bool Earlier(const PriceRec& a, const PriceRec& b) { return a.RecDate.raw() < b.RecDate.raw(); }

// Merges `rows` into `old` by date. A later row of the file stands in place of an earlier one
// with its date.
std::vector<PriceRec> Merge(const std::vector<PriceRec>& old, std::vector<PriceRec> rows,
                            ImportCounts& counts) {
  std::stable_sort(rows.begin(), rows.end(), Earlier);
  std::vector<PriceRec> out;
  out.reserve(old.size() + rows.size());
  auto next = old.begin();
  for (const PriceRec& row : rows) {
    while (next != old.end() && Earlier(*next, row)) out.push_back(*next++);
    PriceRec rec = row;
    bool replaced = false;
    for (; next != old.end() && !Earlier(row, *next); ++next) {
      // What was done to the prices before this date stays told on the chart.
      rec.AdjFactor = next->AdjFactor;
      rec.AdjDesc = next->AdjDesc;
      replaced = true;
    }
    if (!out.empty() && out.back().RecDate == rec.RecDate) {
      rec.AdjFactor = out.back().AdjFactor;
      rec.AdjDesc = out.back().AdjDesc;
      out.back() = rec;
      replaced = true;
    } else {
      out.push_back(rec);
    }
    ++(replaced ? counts.Replaced : counts.Added);
  }
  out.insert(out.end(), next, old.end());
  return out;
}

template <typename T>
std::string_view BytesOf(const std::vector<T>& records) {
  return {reinterpret_cast<const char*>(records.data()), records.size() * sizeof(T)};
}

// The file's own name, for messages.
// Failures of the store's files are told with the file they befell.
template <typename Work>
auto Told(const std::string& path, Work work) {
  try {
    return work();
  } catch (const RunTimeError& e) {
    throw Refused(std::string(FileNameOf(path)) + ": " + e.what());
  }
}

template <typename T>
std::vector<T> ReadRecords(const Files& files, const std::string& path) {
  return Told(path, [&] {
    if (!files.CheckFile(path)) return std::vector<T>();
    const RecordFile<T> file(files, path);
    if (file.count() > kMostRecords)
      throw Refused(std::string(FileNameOf(path)) + ": more than " + std::to_string(kMostRecords) +
                    " records");
    return file.ReadAll();
  });
}

// What a command's text files come to.
class Importer {
 public:
  Importer(const Files& files, const std::string& dataPath, const ImportOptions& options,
           Dialogs& dialogs)
      : files_(files),
        dataPath_(dataPath),
        options_(options),
        dialogs_(dialogs),
        names_(ReadRecords<NameRec>(files, NameFilePath(dataPath))),
        set_(files) {
    for (const NameRec& rec : names_)
      if (rec.NameStatus != 1) {
        known_.try_emplace(std::string(rec.Code.trimmed()), rec.RecType);
        ++living_;
      }
  }

  // Takes a text file, or refuses it and leaves everything as it was.
  void Take(const std::string& hostFile, ImportCounts& counts);
  // Puts what was taken in place. The user can stop it as long as it lasts.
  void Finish(Progress& progress, int done, ImportCounts& counts);
  size_t bytes() const { return bytes_; }  // of rows that are held

 private:
  void Check(const std::string& code, const Group& group);
  std::vector<PriceRec> OldRecords(const std::string& code) const;

  const Files& files_;
  const std::string& dataPath_;
  const ImportOptions& options_;
  Dialogs& dialogs_;
  std::vector<NameRec> names_;
  std::map<std::string, std::int16_t> known_;  // kinds by code
  size_t living_ = 0;                          // names that are not deleted
  bool added_ = false;
  std::map<std::string, std::vector<PriceRec>> rows_;  // by code, as the files have them
  std::map<std::string, size_t> onFile_;               // records of the price files of those
  size_t bytes_ = 0;
  FileSet set_;
};

std::vector<PriceRec> Importer::OldRecords(const std::string& code) const {
  const std::string path = dataPath_ + CodeFileName(code, ".WDT");
  auto old = ReadRecords<PriceRec>(files_, path);
  if (!std::is_sorted(old.begin(), old.end(), Earlier))
    throw Refused(std::string(FileNameOf(path)) + ": the dates in the file are not in order");
  return old;
}

// Whether the security can take the rows.
void Importer::Check(const std::string& code, const Group& group) {
  const auto [known, first] = onFile_.try_emplace(code, 0);
  if (first) known->second = OldRecords(code).size();
  const auto held = rows_.find(code);
  const size_t before = held == rows_.end() ? 0 : held->second.size();
  if (known->second + before + group.rows.size() <= size_t(kMostRecords)) return;
  // Some of them may have one date.
  ImportCounts ignored;
  std::vector<PriceRec> all = before > 0 ? held->second : std::vector<PriceRec>();
  all.insert(all.end(), group.rows.begin(), group.rows.end());
  if (Merge(OldRecords(code), std::move(all), ignored).size() > size_t(kMostRecords))
    throw Refused(CodeFileName(code, ".WDT") + ": more than " + std::to_string(kMostRecords) +
                  " records");
}

void Importer::Take(const std::string& hostFile, ImportCounts& counts) {
  Parsed parsed;
  try {
    const std::string text = ReadHostFile(files_.io(), hostFile, kLargestFile);
    parsed = Reader(hostFile, options_, known_, dialogs_).Read(text);
    if (parsed.rows == 0) throw Refused("no rows of prices");
    if (parsed.bad > 0 && !options_.SkipBad)
      throw Refused("not imported, " + std::to_string(parsed.bad) +
                    (parsed.bad == 1 ? " row" : " rows") + " can't be read");
    if (parsed.bad == parsed.rows) throw Refused("no row can be read");
    if (!options_.Code.empty() && parsed.columnCodes.size() > 1)
      throw Refused("holds more than one security, and so can't be taken under the one code " +
                    UCase(options_.Code));
    if (!options_.Name.empty() && parsed.groups.size() > 1)
      throw Refused("holds more than one security, and so can't be taken under the one name " +
                    options_.Name);
    size_t fresh = 0;
    for (const auto& [code, group] : parsed.groups) {
      if (group.rows.empty()) continue;
      Check(code, group);
      fresh += group.isNew;
    }
    if (fresh > 0 && living_ + fresh > size_t(kMostRecords))
      throw Refused("the name file would have more than " + std::to_string(kMostRecords) +
                    " records");
  } catch (...) {
    counts.Refused += parsed.rows;
    throw;
  }
  for (auto& [code, group] : parsed.groups) {
    if (group.rows.empty()) continue;
    auto& rows = rows_[code];
    bytes_ += group.rows.size() * sizeof(PriceRec);
    if (rows.empty())
      rows = std::move(group.rows);
    else
      rows.insert(rows.end(), group.rows.begin(), group.rows.end());
    if (!group.isNew) continue;
    NameRec rec = NewNameRec(code);
    rec.RecType = group.recType;
    rec.Name.set(ToAnsi(options_.Name));
    names_.push_back(rec);
    known_.emplace(code, rec.RecType);
    ++living_;
    added_ = true;
  }
  counts.Refused += parsed.bad;
}

void Importer::Finish(Progress& progress, int done, ImportCounts& counts) {
  if (rows_.empty()) return;
  ImportCounts mine;
  std::int64_t rows = 0;
  try {
    const int total = done + int(rows_.size());
    size_t held = 0;  // bytes that wait for their temporary files
    for (auto& [code, fresh] : rows_) {
      rows += std::int64_t(fresh.size());
      if (!progress.Step(done++, total)) throw Refused("stopped; every file is as it was");
      const std::string path = dataPath_ + CodeFileName(code, ".WDT");
      const auto merged = Merge(OldRecords(code), std::move(fresh), mine);
      fresh = {};
      Told(path, [&] { set_.Add(path, std::string(BytesOf(merged))); });
      mine.Codes.insert(code);
      held += merged.size() * sizeof(PriceRec);
      if (held < kMostHeld) continue;
      set_.Stage();
      held = 0;
    }
    // Names behind prices: a name without a price file would fail to chart.
    if (added_) {
      const std::string path = NameFilePath(dataPath_);
      names_ = SortedNames(names_, NameSort::kCategory);
      Told(path, [&] { set_.Add(path, std::string(BytesOf(names_))); });
    }
    // Record numbers go stale by the sort, and a list shows what stands at its numbers.
    const CodeNumbers numbers(names_);
    for (std::int16_t list = kFirstChartList; list <= kResultList; ++list)
      Told(ListFilePath(dataPath_, list),
           [&] { StageList(set_, files_, dataPath_, list, numbers); });
    set_.Commit();
    progress.Step(total, total);
  } catch (...) {
    for (const auto& [code, fresh] : rows_) rows += std::int64_t(fresh.size());
    counts.Refused += rows;
    throw;
  }
  rows_.clear();
  onFile_.clear();
  bytes_ = 0;
  added_ = false;
  counts.Codes.merge(mine.Codes);
  counts.Added += mine.Added;
  counts.Replaced += mine.Replaced;
}

// False, and told, where `work` fails.
template <typename Work>
bool TellFailure(Dialogs& dialogs, const std::string& about, Work work) {
  const std::string prefix = about.empty() ? about : about + ": ";
  try {
    work();
    return true;
  } catch (const Refused& e) {
    dialogs.Message(prefix + e.what(), kTitle);
  } catch (const RunTimeError& e) {
    dialogs.Message(prefix + e.what(), kTitle);
  } catch (const std::bad_alloc&) {
    dialogs.Message(prefix + ErrorText(kOutOfMemory), kTitle);
  }
  return false;
}

}  // namespace

bool ImportHistory(const Files& files, const std::string& dataPath,
                   std::span<const std::string> hostFiles, const ImportOptions& options,
                   Dialogs& dialogs, ImportCounts& counts) {
  bool all = true;
  return TellFailure(dialogs, {},
                     [&] {
                       const auto held = files.lock().Hold();
                       const auto progress = dialogs.StartProgress(kTitle);
                       Importer importer(files, dataPath, options, dialogs);
                       int done = 0;
                       for (const std::string& file : hostFiles) {
                         // The securities count as much as the files.
                         if (!progress->Step(done++, 2 * int(hostFiles.size())))
                           throw Refused("stopped; every file is as it was");
                         all &= TellFailure(dialogs, file, [&] { importer.Take(file, counts); });
                         if (importer.bytes() >= kMostRows)
                           importer.Finish(*progress, done, counts);
                       }
                       importer.Finish(*progress, done, counts);
                     }) &&
         all;
}

}  // namespace kora
