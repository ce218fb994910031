#include "update/master_list.h"

#include <algorithm>
#include <map>
#include <stdexcept>

#include "base/file_set.h"
#include "base/home_lock.h"
#include "base/host_files.h"
#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr unsigned char kFirstInTable = 48;
constexpr std::uint64_t kLargestSource = 64u << 20;
constexpr std::uint64_t kLargestMaster = 16u << 20;  // 270,000 codes
constexpr size_t kLongestName = 34;
constexpr size_t kLongestDetails = 14;
constexpr const char* kMakeTitle = "KORA Master List";

std::string IndexFile(const std::string& systemPath) { return systemPath + "KoraName.idx"; }

// Digits and letters go through the table; what lies between them stays.
bool IsScrambled(unsigned char c) {
  return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z');
}

unsigned char Readable(unsigned char c, const MasterTable& table) {
  return IsScrambled(c) ? table[c - kFirstInTable] : c;
}

// Characters of a record, numbered from 1 with the code.
std::string_view Characters(const MasterRec& rec, size_t from, size_t to) {
  return rec.Rest.raw().substr(from - 7, to - from + 1);
}

std::string Field(const MasterRec& rec, size_t from, size_t to) {
  return std::string(Trim(Characters(rec, from, to)));
}

// A number of a record; empty where its characters are none, as those of a foreign file.
std::string Digits(std::string_view text) {
  const bool all = text.find_first_not_of("0123456789") == std::string_view::npos;
  return all ? std::string(text) : std::string();
}

std::string NumberAs(std::string_view text, std::string_view pattern) {
  const std::string digits = Digits(text);
  return digits.empty() ? digits : Format(Val(digits), pattern);
}

// What is wrong with a line of a plain list.
struct BadLine : std::runtime_error {
  using std::runtime_error::runtime_error;
};

void CheckNumber(std::string_view text, size_t digits, const char* what) {
  if (text.size() > digits || text.find_first_not_of("0123456789") != std::string_view::npos)
    throw BadLine(what);
}

std::string Right(std::string_view text, size_t size) {
  return std::string(size - text.size(), ' ') + std::string(text);
}

// The 62 bytes of a line, readable.
MasterRec RecordOf(std::string_view line) {
  const auto fields = Split(line, ',');
  const auto field = [&](size_t i) { return i < fields.size() ? Trim(fields[i]) : ""; };
  if (fields.size() > 6) throw BadLine("more than 6 fields");
  for (const char c : line)
    if (static_cast<unsigned char>(c) < 0x20) throw BadLine("a control character");
  const std::string code = KeptCode(UCase(field(0)));
  if (!IsFileCode(code)) throw BadLine("no code of 1 to 6 letters and digits");
  CheckNumber(field(1), 1, "the type is no digit");
  CheckNumber(field(2), 2, "the category is no number from 0 to 99");
  CheckNumber(field(3), 3, "the class is no number of three digits");
  const std::string name = ToAnsi(field(4)), details = ToAnsi(field(5));
  if (name.size() > kLongestName) throw BadLine("the name has more than 34 characters");
  if (details.size() > kLongestDetails) throw BadLine("the details have more than 14 characters");
  MasterRec rec;
  rec.Code.set(code);
  // Character 47 is the last of the name and the first of the details: it stays blank.
  rec.Rest.set(PadRight(field(1), 1) + Right(field(2), 2) + PadRight(field(3), 3) +
               PadRight(name, kLongestName) + " " + details);
  return rec;
}

void Scramble(MasterRec& rec, const MasterTable& table) {
  for (char& c : rec.Rest.bytes) {
    const auto wanted = static_cast<unsigned char>(c);
    if (!IsScrambled(wanted)) continue;
    unsigned char from = kFirstInTable;
    while (from < kFirstInTable + table.size() &&
           !(IsScrambled(from) && table[from - kFirstInTable] == wanted))
      ++from;
    if (from == kFirstInTable + table.size())
      throw BadLine("a character that KoraName.Tab does not have");
    c = char(from);
  }
}

}  // namespace

std::string MasterFile(const std::string& systemPath) { return systemPath + "KoraName.Mas"; }

MasterTable LoadMasterTable(const Files& files, const std::string& systemPath) {
  MasterTable table;
  for (size_t i = 0; i < table.size(); ++i)
    table[i] = static_cast<unsigned char>(kFirstInTable + i);
  const std::string path = systemPath + "KoraName.Tab";
  if (!files.CheckFile(path)) return table;
  const std::string text = files.ReadAll(path, 1u << 20);
  LineReader lines(text);
  std::string_view line;
  size_t count = 0;
  while (lines.Next(line)) {
    if (Trim(line).empty()) continue;
    if (count == table.size()) throw RunTimeError(kBadCall);
    const double value = Val(line);
    if (const size_t at = count++; IsScrambled(static_cast<unsigned char>(kFirstInTable + at))) {
      if (!(value >= 32 && value <= 255)) throw RunTimeError(kBadCall);
      table[at] = static_cast<unsigned char>(CInt(value));
    }
  }
  if (count != table.size()) throw RunTimeError(kBadCall);
  return table;
}

std::vector<MasterRec> ReadMasterRecords(const Files& files, const std::string& systemPath) {
  if (!files.CheckFile(MasterFile(systemPath))) return {};
  const MasterTable table = LoadMasterTable(files, systemPath);
  const RecordFile<MasterRec> file(files, MasterFile(systemPath));
  if (std::uint64_t(file.count()) * sizeof(MasterRec) > kLargestMaster)
    throw RunTimeError(kOutOfMemory);
  auto records = file.ReadAll();
  if (records.size() < 2) return {};
  for (MasterRec& rec : records)
    for (char& c : rec.Rest.bytes) c = char(Readable(static_cast<unsigned char>(c), table));
  return records;
}

MasterList ReadMasterList(const Files& files, const std::string& systemPath) {
  MasterList list;
  list.Records = ReadMasterRecords(files, systemPath);
  const std::string text = files.ReadAll(IndexFile(systemPath), 1u << 20);
  LineReader lines(text);
  std::string_view line;
  if (!lines.Next(line)) throw RunTimeError(kBadCall);
  const auto numbers = Split(line, ',');
  if (numbers.size() != list.Letters.size()) throw RunTimeError(kBadCall);
  for (size_t i = 0; i < numbers.size(); ++i) list.Letters[i] = CLng(Val(numbers[i]));
  return list;
}

std::int32_t MasterList::StartOf(std::string_view code) const {
  const std::string upper = UCase(Trim(code));
  if (upper.empty() || upper[0] < 'A' || upper[0] > 'Z') return 0;
  return Letters[size_t(upper[0] - 'A')];
}

MasterEntry MasterList::Entry(std::int32_t record) const {
  const MasterRec& rec = Records.at(size_t(record - 1));
  return {std::string(rec.Code.trimmed()),
          Field(rec, 7, 7),
          Field(rec, 8, 9),
          Field(rec, 10, 12),
          FromAnsi(Field(rec, 13, 47)),
          FromAnsi(Field(rec, 47, 61))};
}

MasterEntry FindMaster(const MasterList& list, std::string_view code, std::int32_t startRec) {
  const std::string wanted = PadRight(UCase(Trim(code)), 6);
  if (startRec < 1) return {};
  for (size_t i = size_t(startRec - 1); i < list.Records.size(); ++i) {
    const std::string_view there = list.Records[i].Code.raw();
    if (there == wanted) return list.Entry(std::int32_t(i + 1));
    if (static_cast<unsigned char>(there[0]) > static_cast<unsigned char>(wanted[0])) break;
  }
  return {};
}

std::span<const std::string_view> MasterMissingLines() {
  static constexpr std::string_view lines[] = {"KORA Master list is missing",
                                               "Download from the KORA web page", "or ring KORA "};
  return lines;
}

std::int32_t LookUpStart(std::int32_t place) { return place <= 3 ? 1 : place - 3; }

bool UpdateFromMaster(const Files& files, const std::string& systemPath, std::span<EditorRow> rows,
                      const KeepTicks& keep, Dialogs& dialogs) {
  if (!files.CheckFile(MasterFile(systemPath))) {
    dialogs.Message("There is no master list (KoraName.Mas) in folder " + systemPath +
                        "Either download a current file from the KORA web page or ring KORA ",
                    "KORA Master List");
    return false;
  }
  MasterList list;
  try {
    list = ReadMasterList(files, systemPath);
  } catch (const RunTimeError&) {
    dialogs.Message("There is a problem with the Master list", "Master List");
    return false;
  }
  std::vector<EditorRow> fresh(rows.begin(), rows.end());
  const auto progress = dialogs.StartProgress("Update Name File from KORA Master List");
  int done = 0;
  for (EditorRow& row : fresh) {
    if (!progress->Step(++done, int(fresh.size()))) return false;
    if (Trim(row.code).empty()) continue;
    const MasterEntry entry = FindMaster(list, row.code, list.StartOf(row.code));
    if (entry.code.empty()) continue;
    const std::pair<std::string*, std::string> items[] = {
        {&row.name, entry.name},
        {&row.details, entry.details},
        {&row.type, Digits(entry.type)},
        {&row.category, NumberAs(entry.category, "#0")},
        {&row.IndClass, NumberAs(entry.IndClass, "000")}};
    for (size_t i = 0; i < keep.size(); ++i) {
      const auto& [item, master] = items[i];
      if (!master.empty() && !(keep[i] && !Trim(*item).empty())) *item = master;
    }
  }
  std::copy(fresh.begin(), fresh.end(), rows.begin());
  return true;
}

std::optional<std::int32_t> MakeMasterList(const Files& files, const std::string& systemPath,
                                           const std::string& hostFile, Dialogs& dialogs) {
  int number = 0;
  std::string atFault = hostFile;
  try {
    const MasterTable table = LoadMasterTable(files, systemPath);
    const std::string text = ReadHostFile(files.io(), hostFile, kLargestSource);
    LineReader lines(text.starts_with("\xEF\xBB\xBF") ? std::string_view(text).substr(3) : text);
    std::map<std::string, MasterRec> records;  // by code
    std::string_view line;
    while (lines.Next(line)) {
      number = lines.number();
      if (Trim(line).empty()) continue;
      if (number == 1 && EqualNoCase(Trim(Split(line, ',')[0]), "Code")) continue;
      MasterRec rec = RecordOf(line);
      Scramble(rec, table);
      records[std::string(rec.Code.raw())] = rec;
    }
    if (records.size() < 2) {
      dialogs.Message(hostFile + ": a master list has 2 codes at least", kMakeTitle);
      return std::nullopt;
    }
    std::string bytes, index;
    std::array<std::int32_t, 26> letters{};
    std::int32_t count = 0;
    for (const auto& [code, rec] : records) {
      bytes.append(reinterpret_cast<const char*>(&rec), sizeof(rec));
      ++count;
      if (code[0] < 'A' || code[0] > 'Z') continue;
      std::int32_t& first = letters[size_t(code[0] - 'A')];
      if (first == 0) first = count;
    }
    for (const std::int32_t first : letters) index += (index.empty() ? "" : ",") + Str(first);
    // From here on a failure is the list's, not the input's.
    atFault = MasterFile(systemPath);
    const auto held = files.lock().Hold();
    FileSet set(files);
    set.Add(MasterFile(systemPath), std::move(bytes));
    set.Add(IndexFile(systemPath), index + "\r\n");
    set.Commit();
    return count;
  } catch (const BadLine& e) {
    dialogs.Message(hostFile + " line " + Str(std::int32_t(number)) + ": " + e.what(), kMakeTitle);
  } catch (const RunTimeError& e) {
    dialogs.Message(atFault + ": " + e.what(), kMakeTitle);
  }
  return std::nullopt;
}

}  // namespace kora
