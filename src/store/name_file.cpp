#include "store/name_file.h"

#include <algorithm>
#include <array>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr std::int32_t kRecordsPerRead = 512;

// The busy pointer for as long as a scan lasts, whatever ends it.
class Busy {
 public:
  explicit Busy(Dialogs& dialogs) : dialogs_(dialogs) { dialogs_.SetBusy(true); }
  ~Busy() { dialogs_.SetBusy(false); }
  Busy(const Busy&) = delete;
  Busy& operator=(const Busy&) = delete;

 private:
  Dialogs& dialogs_;
};

// The count as the 16-bit value that every handle of a record is. Error 6 beyond.
std::int16_t CountOf(const NameFile& names) {
  if (names.count() > kMostNames)
    throw RunTimeError(kOverflow,
                       Str(names.count()) + " names, and " + Str(kMostNames) + " at most");
  return CInt(names.count());
}

}  // namespace

std::string NameFilePath(const std::string& dataPath) { return dataPath + "Names.dat"; }

std::vector<NameRec> ReadNames(const Files& files, const std::string& dataPath) {
  const std::string path = NameFilePath(dataPath);
  if (!files.CheckFile(path)) return {};
  const NameFile names(files, path);
  CountOf(names);
  return names.ReadAll();
}

std::int16_t FindCode(const NameFile& names, std::string_view paddedCode, NameRec& found) {
  const std::int32_t count = CountOf(names);
  std::array<NameRec, kRecordsPerRead> buffer;
  for (std::int32_t first = 1; first <= count; first += kRecordsPerRead) {
    const std::span<NameRec> run(buffer.data(),
                                 size_t(std::min(kRecordsPerRead, count - first + 1)));
    names.ReadRun(first, run);
    for (size_t i = 0; i < run.size(); ++i) {
      if (run[i].Code.raw() != paddedCode) continue;
      found = run[i];
      return CInt(first + double(i));
    }
  }
  return 0;
}

NameAndClass FindNameByCode(const Files& files, const std::string& dataPath, std::string_view code,
                            NameRec& record) {
  const std::string path = NameFilePath(dataPath);
  if (!files.CheckFile(path)) return {};
  const NameFile names(files, path);
  if (FindCode(names, code, record) == 0) return {};
  return {FromAnsi(Trim(record.Name.trimmed())), FromAnsi(Trim(record.IndClass.trimmed()))};
}

bool LocateCurrentCode(const Files& files, const std::string& dataPath, Dialogs& dialogs,
                       CurrentName& current) {
  if (current.CurrentCode.size() < 6) current.CurrentCode = PadRight(current.CurrentCode, 6);
  current.CurrentCode = UCase(current.CurrentCode);
  current.PriceFileName.clear();
  std::int16_t number = 0;
  {
    const Busy busy(dialogs);
    const NameFile names(files, NameFilePath(dataPath));
    current.NameCount = CountOf(names);
    // A code that can name no file of its own has none, whatever the name file holds.
    if (IsFileCode(current.CurrentCode)) number = FindCode(names, current.CurrentCode, current.Rec);
  }
  if (number == 0) {
    dialogs.Message("No File For That Name", "Name File");
    return false;
  }
  current.NameRecNo = number;
  current.PriceFileName = CodeFileName(current.CurrentCode, ".WDT");
  return true;
}

void RewriteCurrentName(const Files& files, const std::string& dataPath, CurrentName& current,
                        const std::function<void(NameRec&)>& change) {
  if (current.NameRecNo < 1) throw RunTimeError(kBadRecordNumber);
  const auto held = files.lock().Hold();
  NameFile names(files, NameFilePath(dataPath), OpenMode::kReadWrite);
  std::int16_t number = current.NameRecNo;
  NameRec record{};
  if (number <= names.count()) record = names.Read(number);
  if (record.Code != current.Rec.Code) {
    number = FindCode(names, current.Rec.Code.raw(), record);
    if (number == 0) throw RunTimeError(kBadRecordNumber);
  }
  change(record);
  names.Write(number, record);
  current.NameRecNo = number;
  current.Rec = record;
}

}  // namespace kora
