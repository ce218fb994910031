#include "lists/chart_list.h"

#include <algorithm>
#include <limits>

#include "base/file_set.h"
#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "platform/settings_file.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr std::string_view kLetters = "ABCDEFGHJKZ";  // no I

char LetterOf(std::int16_t ChartListNo) {
  if (ChartListNo < kFirstChartList || ChartListNo > kResultList) throw RunTimeError(kBadCall);
  return kLetters[size_t(ChartListNo - kFirstChartList)];
}

std::string Key(std::int16_t ChartListNo) { return std::string("SubList") + LetterOf(ChartListNo); }

std::string OwnName(std::int16_t ChartListNo) {
  return std::string("Chart List ") + LetterOf(ChartListNo);
}

std::string Padded(std::string_view code) { return PadRight(UCase(Trim(code)), 6); }

CodeNumbers NumbersOf(const Files& files, const std::string& dataPath) {
  return CodeNumbers(NameFile(files, NameFilePath(dataPath)).ReadAll());
}

std::string_view BytesOf(std::span<const ListRec> records) {
  return {reinterpret_cast<const char*>(records.data()), records.size_bytes()};
}

bool Holds(const ListCodes& list, std::string_view code) {
  return std::find(list.begin(), list.end(), code) != list.end();
}

// In list order, each once, within the list.
std::vector<size_t> InOrder(std::span<const size_t> places, size_t size) {
  std::vector<size_t> out(places.begin(), places.end());
  std::sort(out.begin(), out.end());
  out.erase(std::unique(out.begin(), out.end()), out.end());
  while (!out.empty() && out.back() >= size) out.pop_back();
  return out;
}

}  // namespace

std::string ListFileName(std::int16_t ChartListNo) { return Key(ChartListNo) + ".Dat"; }

std::string ListFilePath(const std::string& dataPath, std::int16_t ChartListNo) {
  return dataPath + ListFileName(ChartListNo);
}

std::string ChartListName(const SettingsFile& user, std::int16_t ChartListNo) {
  if (ChartListNo == kResultList) return "Chart Scan Results";
  const std::string kept = user.GetSetting(kUserSection, Key(ChartListNo));
  return kept == kUnknown ? OwnName(ChartListNo) : kept;
}

UserListNames GetSubLists(const SettingsFile& user) {
  UserListNames names;
  for (size_t i = 0; i < names.size(); ++i)
    names[i] = ChartListName(user, std::int16_t(kFirstChartList + int(i)));
  return names;
}

bool SaveSLNames(SettingsFile& user, const UserListNames& names) {
  bool saved = true;
  SettingsFile::Batch batch(user);
  for (size_t i = 0; i < names.size(); ++i) {
    const auto number = std::int16_t(kFirstChartList + int(i));
    saved = user.PutSetting(kUserSection, Key(number), names[i]) && saved;
  }
  return batch.End() && saved;
}

std::vector<ListRec> ReadList(const Files& files, const std::string& dataPath,
                              std::int16_t ChartListNo) {
  const std::string path = ListFilePath(dataPath, ChartListNo);
  if (!files.CheckFile(path)) return {};
  const RecordFile<ListRec> list(files, path);
  CInt(list.count());
  return list.ReadAll();
}

void WriteList(const Files& files, const std::string& dataPath, std::int16_t ChartListNo,
               std::span<const ListRec> records) {
  CInt(double(records.size()));
  const auto held = files.lock().Hold();
  files.WriteAll(ListFilePath(dataPath, ChartListNo), BytesOf(records));
}

ListCodes CodesOf(std::span<const ListRec> records) {
  ListCodes codes;
  codes.reserve(records.size());
  for (const ListRec& rec : records)
    if (const std::string_view code = Trim(rec.ListCode.trimmed()); !code.empty())
      codes.emplace_back(code);
  return codes;
}

ListCodes SaveSubList(const Files& files, const std::string& dataPath, std::int16_t ChartListNo,
                      std::span<const std::string> codes) {
  const auto held = files.lock().Hold();
  ListCodes dropped;
  WriteList(files, dataPath, ChartListNo, NumbersOf(files, dataPath).Refreshed(codes, dropped));
  return dropped;
}

CodeNumbers::CodeNumbers(std::span<const NameRec> names) {
  CInt(double(names.size()));
  numbers_.reserve(names.size());
  std::int16_t number = 0;
  for (const NameRec& rec : names) numbers_.try_emplace(std::string(rec.Code.raw()), ++number);
}

std::vector<ListRec> CodeNumbers::Refreshed(std::span<const std::string> codes,
                                            ListCodes& dropped) const {
  std::vector<ListRec> out;
  out.reserve(codes.size());
  for (const std::string& code : codes) {
    if (Trim(code).empty()) continue;
    const auto found = Trim(code).size() <= 6 ? numbers_.find(Padded(code)) : numbers_.end();
    if (found == numbers_.end()) {
      dropped.push_back(code);
      continue;
    }
    ListRec rec;
    rec.ListRecNo = found->second;
    rec.ListCode.set(found->first);
    out.push_back(rec);
  }
  return out;
}

namespace {

void StageRefreshed(FileSet& set, const std::string& path, std::span<const ListRec> old,
                    const CodeNumbers& numbers) {
  ListCodes dropped;
  const auto fresh = numbers.Refreshed(CodesOf(old), dropped);
  if (BytesOf(fresh) != BytesOf(old)) set.Add(path, std::string(BytesOf(fresh)));
}

}  // namespace

void StageList(FileSet& set, const Files& files, const std::string& dataPath,
               std::int16_t ChartListNo, const CodeNumbers& numbers) {
  StageRefreshed(set, ListFilePath(dataPath, ChartListNo), ReadList(files, dataPath, ChartListNo),
                 numbers);
}

void StageLists(FileSet& set, const Files& files, const std::string& dataPath,
                const CodeNumbers& numbers) {
  for (std::int16_t number = kFirstChartList; number <= kResultList; ++number) {
    std::vector<ListRec> old;
    try {
      old = ReadList(files, dataPath, number);
    } catch (const RunTimeError& e) {
      if (e.number() == kOverflow || e.number() == kPathAccess) continue;  // nor can it be shown
      throw;
    }
    StageRefreshed(set, ListFilePath(dataPath, number), old, numbers);
  }
}

ListCheck CheckAllLists(const Files& files, const std::string& dataPath, std::int16_t last) {
  const auto held = files.lock().Hold();
  const CodeNumbers index = NumbersOf(files, dataPath);
  ListCheck check;
  for (std::int16_t number = kFirstChartList; number <= last; ++number) {
    if (!files.CheckFile(ListFilePath(dataPath, number))) continue;
    ListCodes dropped;
    const auto codes = CodesOf(ReadList(files, dataPath, number));
    WriteList(files, dataPath, number, index.Refreshed(codes, dropped));
    ++check.lists;
    check.removed += int(dropped.size());
  }
  return check;
}

bool AddCode(ListCodes& list, std::string_view code) {
  std::string added = UCase(Trim(code));
  if (added.empty() || Holds(list, added)) return false;
  list.push_back(std::move(added));
  return true;
}

std::optional<size_t> FindTypedCode(std::span<const std::string> nameCodes,
                                    std::string_view typed) {
  const std::string code = UCase(Trim(typed));
  if (code.empty()) return std::nullopt;
  for (size_t i = 0; i < nameCodes.size(); ++i)
    if (Trim(nameCodes[i]) == code) return i;
  return std::nullopt;
}

void DeleteItems(ListCodes& list, std::span<const size_t> places) {
  const std::vector<size_t> order = InOrder(places, list.size());
  for (auto place = order.rbegin(); place != order.rend(); ++place)
    list.erase(list.begin() + std::ptrdiff_t(*place));
}

std::string DeleteQuestion(std::string_view code) { return "Delete " + std::string(code) + "  ?"; }

std::string DeleteAllFromQuestion(std::string_view listName) {
  return "Delete all items from " + std::string(listName);
}

std::string ChangedQuestion(std::string_view listName) {
  return (listName.empty() ? "List" : std::string(listName)) + " has changed. SAVE Changes?";
}

std::string_view CheckSides(const ListSide& a, const ListSide& b) {
  if (a.ChartListNo == 0 || b.ChartListNo == 0) return "Both lists must be displayed";
  if (a.ChartListNo == b.ChartListNo) return "Lists cannot be same";
  return {};
}

std::string_view CopyItems(const ListSide& from, ListSide& to, std::span<const size_t> places) {
  if (const std::string_view fault = CheckSides(from, to); !fault.empty()) return fault;
  for (const size_t place : InOrder(places, from.Codes.size()))
    if (AddCode(to.Codes, from.Codes[place])) to.Changed = true;
  return {};
}

ListCodes SaveSides(const Files& files, const std::string& dataPath,
                    std::span<const ListSide> sides) {
  const auto held = files.lock().Hold();
  const CodeNumbers index = NumbersOf(files, dataPath);
  ListCodes dropped;
  FileSet set(files);
  for (const ListSide& side : sides) {
    if (!side.Changed) continue;
    const std::vector<ListRec> records = index.Refreshed(side.Codes, dropped);
    CInt(double(records.size()));
    set.Add(ListFilePath(dataPath, side.ChartListNo), std::string(BytesOf(records)));
  }
  set.Commit();
  return dropped;
}

std::string_view MoveItems(ListSide& from, ListSide& to, std::span<const size_t> places) {
  if (const std::string_view fault = CopyItems(from, to, places); !fault.empty()) return fault;
  const size_t before = from.Codes.size();
  DeleteItems(from.Codes, places);
  if (from.Codes.size() != before) from.Changed = true;
  return {};
}

}  // namespace kora
