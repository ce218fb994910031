#include "tests/support/reader_bodies.h"

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <map>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/chart_script.h"
#include "platform/settings_file.h"
#include "store/name_rec.h"
#include "store/price_rec.h"

namespace kora::test {
namespace {

void Check(bool held, const char* promise) {
  if (held) return;
  std::fprintf(stderr, "broken: %s\n", promise);
  std::abort();
}

// One file system in memory, so that a reader meets thousands of files a second.
class MemoryIo : public Io {
 public:
  std::map<std::string, std::string> files;

  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
    if (!files.contains(path)) {
      if (mode == OpenMode::kRead || mode == OpenMode::kReadWrite)
        throw RunTimeError(kFileNotFound);
      files[path] = "";
    } else if (mode == OpenMode::kNew) {
      throw RunTimeError(kPathAccess);
    }
    if (mode == OpenMode::kReplace) files[path].clear();
    return std::make_unique<File>(files[path]);
  }
  HostStatus Status(const std::string& path) override {
    HostStatus out;
    const auto it = files.find(path);
    out.folder = path == "home" || path == "home/drive_c";
    out.exists = out.folder || it != files.end();
    out.plain = it != files.end();
    if (it != files.end()) out.size = it->second.size();
    out.modified = 1;
    return out;
  }
  std::vector<std::string> List(const std::string& folder) override {
    std::vector<std::string> names;
    for (const auto& [path, bytes] : files)
      if (path.rfind(folder + "/", 0) == 0) names.push_back(path.substr(folder.size() + 1));
    return names;
  }
  void MakeFolder(const std::string&) override {}
  void Remove(const std::string& path) override { files.erase(path); }
  void Rename(const std::string& from, const std::string& to) override {
    files[to] = files[from];
    files.erase(from);
  }
  void Link(const std::string& from, const std::string& to) override { files[to] = files[from]; }
  std::string LinkTarget(const std::string& path) override { return path; }
  void FlushFolder(const std::string&) override {}
  std::unique_ptr<HostLock> TryLock(const std::string&, std::string_view, std::string&) override {
    return std::make_unique<HostLock>();
  }

 private:
  struct File : HostFile {
    explicit File(std::string& bytesIn) : bytes(bytesIn) {}
    size_t ReadAt(std::uint64_t offset, void* data, size_t size) override {
      if (offset >= bytes.size()) return 0;
      size = std::min(size, bytes.size() - size_t(offset));
      std::memcpy(data, bytes.data() + offset, size);
      return size;
    }
    void WriteAt(std::uint64_t offset, const void* data, size_t size) override {
      if (bytes.size() < offset + size) bytes.resize(offset + size);
      bytes.replace(offset, size, static_cast<const char*>(data), size);
    }
    std::uint64_t Size() override { return bytes.size(); }
    void Truncate(std::uint64_t size) override { bytes.resize(size); }
    void Flush() override {}
    void TakeAccess(const HostStatus&) override {}
    std::string& bytes;
  };
};

template <typename T>
std::vector<T> ReadRecords(std::string_view bytes) {
  MemoryIo io;
  io.files["home/drive_c/r"] = bytes;
  const Files files("home", io);
  RecordFile<T> file(files, "c:\\r", OpenMode::kReadWrite);
  Check(size_t(file.count()) == bytes.size() / sizeof(T), "the count truncates");
  const std::vector<T> all = file.ReadAll();
  Check(all.empty() || std::memcmp(all.data(), bytes.data(), all.size() * sizeof(T)) == 0,
        "records are the file's bytes");
  for (const int n : {0, -1, file.count() + 1}) {
    int error = 0;
    try {
      file.Read(n);
    } catch (const RunTimeError& e) {
      error = e.number();
    }
    Check(error == kBadRecordNumber, "error 63 outside the file");
  }
  file.Append(T{});
  Check(io.files["home/drive_c/r"].size() == (all.size() + 1) * sizeof(T),
        "an append ends the file at a whole record");
  return all;
}

}  // namespace

void ReadScriptLine(std::string_view bytes) {
  ScriptLine line;
  try {
    SplitScriptLine(bytes, line);
  } catch (const RunTimeError& e) {
    Check(e.number() == kIndexOutOfRange || e.number() == kOutOfTextSpace, "error 9 or 14");
    return;
  }
  size_t size = 0;
  for (const std::string& text : line.text) {
    size += text.size();
    Check(text.find(',') == std::string::npos, "no comma within a field");
  }
  Check(size <= bytes.size(), "fields are no longer than their line");
  line.letter();
  for (int field = 1; field <= 6; ++field) {
    Check(!std::isnan(line.number(field)), "a field is a number");
    try {
      line.whole(field);
    } catch (const RunTimeError& e) {
      Check(e.number() == kOverflow, "error 6 where a number leaves 32 bits");
    }
  }
}

void ReadNumber(std::string_view bytes) {
  const double value = Val(bytes);
  Check(!std::isnan(value), "Val gives a number");
  if (std::isfinite(value)) {
    const std::string text = Str(value);
    Check(text.find_first_not_of("-.0123456789") == std::string::npos, "no exponent");
    Check(Val(text) == value, "Str reads back");
  }
  for (const char* pattern : {"0.00", "#.##", "######", "#####0.000", ".00#"}) {
    const std::string text = Format(value, pattern);
    Check(text.size() < 400, "a formatted number has an end");
    if (std::isfinite(value) && std::fabs(value) < 1e9)
      Check(std::fabs(Val(text) - value) <= 0.5000001, "Format is near its value");
  }
  ParseUserDate(bytes);
  if (const auto date = ParseFileDate(bytes))
    Check(FormatFileDate(*date) == bytes, "a date reads back");
  Check(FromAnsi(bytes).size() >= bytes.size(), "ANSI to UTF-8 loses no byte");
  Check(ToAnsi(bytes).size() <= bytes.size(), "UTF-8 to ANSI grows nothing");
}

void ReadSettings(std::string_view bytes) {
  MemoryIo io;
  io.files["home/Kora.ini"] = bytes;
  const Files files("home", io);
  SettingsFile file(files, "C:\\WINDOWS\\Kora.ini");
  const std::string type = file.GetSetting("Charts", "Type");
  Check(!type.empty() && type.size() <= 180, "at most 60 characters");
  const std::string period = file.GetSetting("Charts", "Period");
  Check(file.PutSetting("Charts", "Period", "\r\n[x]\r\nW"), "a key can be written");
  Check(file.GetSetting("Charts", "Type") == type, "other keys stay");
  Check(SettingsFile(files, "C:\\WINDOWS\\Kora.ini").GetSetting("Charts", "Period") == "[x]  W",
        "what was written reads back");
}

void ReadNameRecords(std::string_view bytes) {
  for (const NameRec& rec : ReadRecords<NameRec>(bytes)) {
    const std::string_view code = rec.Code.trimmed();
    if (IsFileCode(code)) {
      const std::string name = CodeFileName(code, ".WDT");
      Check(
          name.find_first_of(std::string_view("/\\:\0", 4)) == std::string::npos && name[0] != '.',
          "a code names a file of the folder");
    }
  }
}

void ReadPriceRecords(std::string_view bytes) {
  for (const PriceRec& rec : ReadRecords<PriceRec>(bytes)) {
    ParseFileDate(rec.RecDate.raw());
    DateToDisplay(rec.RecDate.raw());
    Format(rec.Close, "0.000");
  }
}

}  // namespace kora::test
