// The name file of 20,000 securities in its editor, and the yields of 3,000 companies, beside the
// bare calls of the host on the same files.

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "companies/company_grid.h"
#include "demo/demo_market.h"
#include "names/name_editor.h"
#include "platform/progress.h"
#include "shell/session.h"
#include "store/price_rec.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace {

using namespace kora;

constexpr int kNames = 20000;
const std::string kData = "c:\\korawin\\data\\";
const std::string kSystem = "c:\\korawin\\";

struct ManyNames {
  test::TempHome home;
  std::string hostFile;

  ManyNames() {
    home.files().MakeFolder(kData);
    std::vector<NameRec> names;
    for (int i = 0; i < kNames; ++i) {
      names.push_back(NewNameRec("C" + std::to_string(10000 + i)));
      names.back().Category = std::int16_t(1 + i % 99);
    }
    NameFile(home.files(), NameFilePath(kData), OpenMode::kReplace).WriteRun(1, names);
    hostFile = home.files().HostPath(NameFilePath(kData));
  }
};

struct Editing {
  test::ScriptedDialogs dialogs;
  SettingsFile ini;
  DownloadSettings download;
  NameEditor editor;

  explicit Editing(Files& files)
      : ini(files, "C:\\WINDOWS\\Kora.ini"),
        editor({files, kData, kSystem, dialogs, ini, download}) {}
};

std::vector<char> ReadPlain(const std::string& file) {
  const int fd = ::open(file.c_str(), O_RDONLY | O_CLOEXEC);
  struct stat st;
  ::fstat(fd, &st);
  std::vector<char> bytes(size_t(st.st_size));
  if (::pread(fd, bytes.data(), bytes.size(), 0) != ssize_t(bytes.size())) bytes.clear();
  ::close(fd);
  return bytes;
}

void WritePlain(const std::string& file, const std::vector<char>& bytes) {
  const int fd = ::open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
  if (::write(fd, bytes.data(), bytes.size()) != ssize_t(bytes.size())) std::abort();
  ::fsync(fd);
  ::close(fd);
}

void LoadPlain(benchmark::State& state) {
  const ManyNames names;
  for (auto _ : state) benchmark::DoNotOptimize(ReadPlain(names.hostFile).data());
}

void Load(benchmark::State& state) {
  ManyNames names;
  Editing editing(names.home.files());
  for (auto _ : state) {
    editing.editor.Load();
    benchmark::DoNotOptimize(editing.editor.rows().data());
  }
}

// The file and its copy, which a save makes first.
void SavePlain(benchmark::State& state) {
  const ManyNames names;
  const std::vector<char> bytes = ReadPlain(names.hostFile);
  for (auto _ : state)
    for (const char* end : {".bak1", ".new1"}) WritePlain(names.hostFile + end, bytes);
}

void Save(benchmark::State& state) {
  ManyNames names;
  Editing editing(names.home.files());
  editing.editor.Load();
  int turn = 0;
  for (auto _ : state) {
    editing.editor.Put(0, NameColumn::kName, "Name " + std::to_string(++turn));
    if (!editing.editor.SaveNames().saved) state.SkipWithError("not saved");
  }
}

struct Companies {
  test::TempHome home;
  test::ScriptedDialogs dialogs;
  Session session{home.path(), dialogs};
  std::vector<std::string> hostFiles;

  Companies() {
    MakeDemo(session.files, session.ini, session.user, dialogs, {.securities = 3000, .years = 1});
    ReadAllSettings(session, "", false);
    for (const NameRec& name : ReadNames(session.files, kData))
      hostFiles.push_back(
          session.files.HostPath(kData + std::string(name.Code.trimmed()) + ".WDT"));
  }
};

Companies& TheCompanies() {
  static Companies companies;
  return companies;
}

void YieldsPlain(benchmark::State& state) {
  Companies& market = TheCompanies();
  char record[sizeof(PriceRec)];
  for (auto _ : state)
    for (const std::string& file : market.hostFiles) {
      const int fd = ::open(file.c_str(), O_RDONLY | O_CLOEXEC);
      struct stat st;
      ::fstat(fd, &st);
      if (::pread(fd, record, sizeof record, st.st_size - off_t(sizeof record)) < 0)
        state.SkipWithError("not read");
      ::close(fd);
      benchmark::DoNotOptimize(record);
    }
}

void Yields(benchmark::State& state) {
  Companies& market = TheCompanies();
  const Files& files = market.session.files;
  const CompanyStore store(files, market.session.settings.download);
  std::vector<CompanyRow> rows = LoadCompanies(store, files, kData);
  NoProgress quiet;
  for (auto _ : state) {
    CalculateYields(store, files, kData, quiet, rows);
    benchmark::DoNotOptimize(rows.data());
  }
  state.counters["companies"] = double(rows.size());
}

BENCHMARK(LoadPlain)->Name("NamesReadPlain")->Unit(benchmark::kMillisecond);
BENCHMARK(Load)->Name("NamesLoad")->Unit(benchmark::kMillisecond);
BENCHMARK(SavePlain)->Name("NamesWritePlain")->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(Save)->Name("NamesSave")->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(YieldsPlain)->Name("YieldsReadPlain")->Unit(benchmark::kMillisecond);
BENCHMARK(Yields)->Name("YieldsCalculate")->Unit(benchmark::kMillisecond);

}  // namespace
