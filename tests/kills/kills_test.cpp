// Every operation that writes, killed in place of each of its changes on the disk, and failed at
// each of them. A home is then opened again as a user would, and the operation run again.

#include <gtest/gtest.h>

#include <cstdio>

#include "base/runtime_error.h"
#include "koractl/koractl.h"
#include "shell/session.h"
#include "tests/support/killed_runs.h"
#include "tests/support/program.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

using Words = std::vector<std::string>;

// What the rules themselves make of an operation that was cut short.
enum Ends : unsigned {
  kWhole = 0,  // the operation is done or not, all files together
  // A file after the other: each is an old one or a new one.
  kFileByFile = 1,
  // Days go into price files one by one, each file by itself; the journal takes the next run on.
  kDayByDay = 2,
  // The list of adjustments is saved after each row that was carried out; a security may have
  // several.
  kRowByRow = 4,
  // A record is written behind the others. A torn one does not count, and the next write takes its
  // place.
  kAppends = 8,
};

struct Operation {
  const char* name;
  std::vector<Words> before;  // command lines that lay the scene, over a demo market
  Words command;
  unsigned ends = kWhole;
  std::map<std::string, std::string> files = {};  // of the scene, by name below the home
};

void PrintTo(const Operation& operation, std::ostream* out) { *out << operation.name; }

std::string Day(const char* date, const char* const* codes, double price) {
  std::string out;
  char line[120];
  for (; *codes; ++codes) {
    std::snprintf(line, sizeof line, "%s,%s,%.2f,%.2f,%.2f,%.2f,%d,0\r\n", *codes, date, price,
                  price + 0.1, price - 0.1, price + 0.05, 1000);
    out += line;
    price += 1;
  }
  return out;
}

// Codes of the demo market of eight securities.
const char* const kCodes[] = {"CJQ", "CXQ", "FVQ", "NQZ", "TZQ", "VKQ", nullptr};
const char* const kFresh[] = {"CJQ", "NEWA", "NEWB", nullptr};
const std::string kDown = "drive_c/korawin/download/";
const std::string kData = "drive_c/korawin/data/";

const std::vector<Operation> kOperations = {
    {"import of new and old securities",
     {},
     {"import", "{home}/in.csv"},
     kFileByFile,
     {{"in.csv", Day("20261105", kFresh, 3) + Day("20261106", kFresh, 4)}}},
    {"import that replaces days",
     {},
     {"import", "{home}/in.csv"},
     kFileByFile,
     {{"in.csv", Day("20261030", kCodes, 3)}}},
    {"update of service 1", {}, {"update", "02NOV26.d"}, kDayByDay},
    {"update of all days", {}, {"update", "--all"}, kDayByDay},
    {"update of service 2",
     {},
     {"--set", "Download.DataService=2", "update", "02NOV26.d"},
     kDayByDay},
    {"update of service 4",
     {},
     {"--set", "Download.DataService=4", "--set", "Download.InternetDLfmt=DDMMMYY.D", "update",
      "02NOV26.d"},
     kDayByDay},
    {"update of service 5",
     {},
     {"--set", "Download.DataService=5", "update", "02NOV26.d"},
     kDayByDay},
    {"bulletins", {}, {"bulletins", "03NOV26"}},
    {"bonus issue", {}, {"adjust", "bonus", "CJQ", "--date", "{day}", "--new", "1", "--held", "4"}},
    {"share split of a chart with notes",
     {{"notes", "CJQ", "add", "--at", "300,200", "a note"}},
     {"adjust", "split", "CJQ", "--date", "{day}", "--new", "2", "--old", "1"}},
    {"removal of an adjustment",
     {{"adjust", "split", "CJQ", "--date", "{day}", "--new", "2", "--old", "1"}},
     {"adjust", "remove", "CJQ"}},
    {"adjustments made",
     {{"bulletins", "02NOV26"},
      {"bulletins", "03NOV26"},
      {"bulletins", "04NOV26"},
      {"adjustments", "set", "Y"}},
     {"adjustments", "make"},
     kRowByRow},
    {"adjustments sorted",
     {{"bulletins", "02NOV26"}, {"bulletins", "03NOV26"}},
     {"adjustments", "sort"}},
    {"names sorted", {}, {"edit-names", "sort", "class"}},
    {"names in title case", {}, {"edit-names", "title-case"}},
    {"optional fields cleaned", {}, {"edit-names", "clean-optional"}},
    {"a day entered",
     {},
     {"enter", "CJQ", "--date", "5/11/26", "--open", "2.4", "--high", "2.6", "--low", "2.3",
      "--close", "2.5"},
     kAppends},
    {"a code changed", {}, {"change-code", "CJQ", "NEWC"}},
    {"two codes combined", {}, {"change-code", "CJQ", "FVQ"}},
    {"a file moved",
     {},
     {"move", "CJQ", "--from", "c:\\korawin\\data\\", "--to", "c:\\korawin\\other\\"},
     kWhole,
     {{"drive_c/korawin/other/Names.dat", ""}}},
    {"files checked and mended",
     {},
     {"--answer", "yes", "check", "data", "--types", "1,2,4,5"},
     kFileByFile},
    {"names checked",
     {},
     {"--answer", "yes", "check", "names"},
     kFileByFile,
     {{kData + "LOST.WDT", std::string(500, ' ')}}},
    {"backup", {}, {"backup"}, kFileByFile},
    {"restore",
     {{"backup"},
      {"enter", "CJQ", "--date", "5/11/26", "--open", "2.4", "--high", "2.6", "--low", "2.3",
       "--close", "2.5"}},
     {"restore"},
     kFileByFile},
    {"closes exported", {}, {"export", "closes"}},
    {"a history exported", {}, {"export", "history", "CJQ"}},
    {"a date removed", {}, {"remove-date", "{last}"}, kFileByFile},
    {"a trendline drawn", {}, {"lines", "CJQ", "add", "--at", "100,100,300,200"}},
    {"a trendline deleted",
     {{"lines", "CJQ", "add", "--at", "100,100,300,200"},
      {"lines", "CJQ", "add", "--at", "120,100,300,220"}},
     {"lines", "CJQ", "delete", "1"}},
    {"a text written", {}, {"notes", "CJQ", "add", "--at", "300,200", "a note"}},
    {"a text deleted",
     {{"notes", "CJQ", "add", "--at", "300,200", "a note"}},
     {"notes", "CJQ", "delete", "1"}},
    {"a set of oscillators kept",
     {},
     {"multi", "sets", "--set", "1", "--oscs", "MACD,RSI,None,FX"}},
    {"scan 1", {}, {"scan1", "--rise", "1"}},
    {"scan 2", {}, {"scan2", "--price", "1"}},
    {"scan 3", {}, {"scan3", "--up"}},
    {"statistics", {}, {"stats"}},
    {"snapshot list", {}, {"snapshot", "1", "add", "CJQ"}},
};

size_t RecordSize(const std::string& name) {
  if (name.ends_with(".WDT")) return sizeof(PriceRec);
  if (name.ends_with("Names.dat")) return sizeof(NameRec);
  return 1;
}

class Kills : public ::testing::TestWithParam<Operation> {
 protected:
  static void SetUpTestSuite() {
    const TempHome made;
    std::vector<std::string> words{"koractl", "--home", made.path(),    "demo",
                                   "--years", "1",      "--securities", "8"};
    ASSERT_EQ(RunInChild([](FailingIo&) {}, [&](Io& io) { return Call(words, io); }).code, 0);
    market_ = StoreOf(made.path());
  }

  static int Call(const Words& words, Io& io) {
    std::vector<const char*> argv;
    for (const std::string& word : words) argv.push_back(word.c_str());
    return RunKoractl(int(argv.size()), argv.data(), io);
  }

  Words Filled(Words words) const {
    for (std::string& word : words)
      for (const auto& [mark, text] : {std::pair<std::string, std::string>{"{home}", home.path()},
                                       {"{day}", "1/10/26"},
                                       {"{last}", "30/10/26"}})
        if (const size_t at = word.find(mark); at != std::string::npos)
          word.replace(at, mark.size(), text);
    words.insert(words.begin(), {"koractl", "--home", home.path(), "--wait", "0"});
    return words;
  }

  ChildRun Run(
      const Words& words, const std::function<void(FailingIo&)>& prepare = [](auto&) {}) {
    const Words filled = Filled(words);
    return RunInChild(prepare, [&](Io& io) { return Call(filled, io); });
  }

  // What the operation starts from and what it gives undisturbed.
  void LayScene() {
    LayStore(home.path(), market_);
    for (const auto& [name, bytes] : GetParam().files) home.Put(name, bytes);
    ASSERT_EQ(Run({"names"}).code, 0);  // makes the folders that every start makes
    for (const Words& words : GetParam().before) {
      const ChildRun run = Run(words);
      ASSERT_EQ(run.code, 0) << words[0] << ": " << run.err;
    }
    before = StoreOf(home.path());
    const ChildRun run = Run(GetParam().command);
    ASSERT_EQ(run.code, 0) << run.err;
    whole = StoreOf(home.path());
    ASSERT_TRUE(before != whole) << "the operation writes nothing";
    changes = run.calls;
    reads = run.reads;
  }

  static void ExpectSame(const Store& are, const Store& wanted) {
    for (const auto& [name, bytes] : wanted)
      if (!are.contains(name) || are.at(name) != bytes) ADD_FAILURE() << name << " is not made";
    for (const auto& [name, bytes] : are)
      if (!wanted.contains(name)) ADD_FAILURE() << name << " is left over";
  }

  // The copy of the name file is made before the name file is saved, by rule; until then they are
  // the same.
  static Store WithoutCopy(Store store) {
    store.erase(kData + "names.bak");
    return store;
  }

  // What the next start of any program does first.
  void OpenAgain() {
    ScriptedDialogs dialogs;
    Session session(home.path(), dialogs);
    EXPECT_TRUE(ReadAllSettings(session, "", false));
  }

  // Whether the user would run the operation again. A day that left the list of those that wait is
  // in; its journal goes with the next update.
  bool IsToRunAgain(const Store& opened) {
    if (!(GetParam().ends & kDayByDay)) return opened != whole;
    for (const auto& [name, bytes] : before)
      if (name.starts_with(kDown) && !whole.contains(name) && opened.contains(name)) return true;
    return false;
  }

  // Nothing that was there is missing, records are whole, and each file is an old or a new one.
  void ExpectSound(const Store& after) {
    for (const auto& [name, bytes] : before)
      if (whole.contains(name)) {
        EXPECT_TRUE(after.contains(name)) << name << " is missing";
      }
    for (const auto& [name, bytes] : after) {
      if (!(GetParam().ends & (kDayByDay | kAppends))) {
        EXPECT_EQ(bytes.size() % RecordSize(name), 0u) << name;
      }
      const auto old = before.find(name), fresh = whole.find(name);
      const bool known = (old != before.end() && old->second == bytes) ||
                         (fresh != whole.end() && fresh->second == bytes);
      if (!known && !OnTheWay(name, bytes)) ADD_FAILURE() << name << " is neither old nor new";
    }
  }

  // What only stands on the disk while an operation is under way.
  bool OnTheWay(const std::string& name, const std::string& bytes) {
    if (name.ends_with("Update.Jnl")) return true;
    if (GetParam().ends & kRowByRow) return name.starts_with(kData);
    if (!(GetParam().ends & (kDayByDay | kAppends))) return false;
    // Some of a day's records, all of them old or new ones.
    const size_t size = RecordSize(name);
    if (size == 1) return name.starts_with(kDown);
    std::string known;
    for (const Store* store : {&before, &whole})
      if (const auto it = store->find(name); it != store->end()) known += it->second;
    for (size_t at = 0; at + size <= bytes.size(); at += size) {
      bool found = false;
      for (size_t from = 0; !found && from < known.size(); from += size)
        found = known.compare(from, size, bytes, at, size) == 0;
      if (!found) return false;
    }
    return true;
  }

  TempHome home;
  Store before, whole;
  int changes = 0, reads = 0;
  static Store market_;
};

Store Kills::market_;

std::string NameOf(const Operation& operation) {
  std::string name;
  bool capital = true;
  for (const char c : std::string(operation.name)) {
    if (c == ' ') {
      capital = true;
    } else {
      name += capital ? char(std::toupper(c)) : c;
      capital = false;
    }
  }
  return name;
}

// Every n-th point only, where each takes long.
int Stride() {
#ifdef __SANITIZE_ADDRESS__
  return 10;
#else
  return 1;
#endif
}

struct Tally {
  int kills = 0, failures = 0, operations = 0;
  ~Tally() {
    std::printf("%d kills and %d failures in %d operations\n", kills, failures, operations);
  }
} tally;

TEST_P(Kills, AreOldOrNewAndTheNextRunEndsIt) {
  LayScene();
  if (HasFatalFailure()) return;
  ++tally.operations;
  // A torn write shows where records are written in place; elsewhere it is of a file that is not in
  // place yet.
  for (const bool torn : {false, true}) {
    if (torn && !(GetParam().ends & (kDayByDay | kAppends))) break;
    for (int at = 1; at <= changes; at += Stride()) {
      SCOPED_TRACE("killed at change " + std::to_string(at) + (torn ? ", torn" : ""));
      LayStore(home.path(), before);
      const ChildRun run = Run(GetParam().command, [&](FailingIo& io) {
        io.failAt = at;
        io.kills = true;
        io.torn = torn;
      });
      ASSERT_TRUE(run.killed) << run.code << " " << run.err;
      ++tally.kills;
      ExpectSound(StoreOf(home.path()));
      OpenAgain();
      const Store opened = StoreOf(home.path());
      ExpectSound(opened);
      if (GetParam().ends == kWhole) {
        EXPECT_TRUE(WithoutCopy(opened) == WithoutCopy(before) || opened == whole);
      }
      Store end = opened;
      if (IsToRunAgain(opened)) {
        const ChildRun again = Run(GetParam().command);
        EXPECT_EQ(again.code, 0) << again.err;
        end = StoreOf(home.path());
        for (const std::string& name : TemporariesOf(home.path()))
          ADD_FAILURE() << name << " is left over";
      } else {
        // What a kill left to be swept goes with the next write of that file or update.
        end.erase("drive_c/korawin/Update.Jnl");
      }
      ExpectSame(end, whole);
      if (HasFailure()) return;
    }
  }
}

// A failure is told, and all is as it was.
TEST_P(Kills, FailuresAreToldAndChangeNothing) {
  LayScene();
  if (HasFatalFailure()) return;
  // Each change fails with two of them.
  const int errors[] = {kDiskFull, kPathAccess, kDeviceError, kTooManyFiles};
  for (const int turn : {0, 1})
    for (int at = 1; at <= changes; at += Stride()) {
      const int error = errors[(2 * turn + at) % 4];
      SCOPED_TRACE("error " + std::to_string(error) + " at change " + std::to_string(at));
      LayStore(home.path(), before);
      const ChildRun run = Run(GetParam().command, [&](FailingIo& io) {
        io.failAt = at;
        io.error = error;
      });
      ++tally.failures;
      const Store after = StoreOf(home.path());
      ExpectSound(after);
      if (run.code == 0) {
        // What fails without harm, as the flush of a folder where there is none.
        if (GetParam().ends == kWhole) ExpectSame(after, whole);
      } else {
        EXPECT_EQ(run.code, 1) << run.err;
        EXPECT_NE(run.err, "");
        if (GetParam().ends == kWhole) {
          EXPECT_TRUE(WithoutCopy(after) == WithoutCopy(before));
        }
      }
      for (const std::string& name : TemporariesOf(home.path()))
        ADD_FAILURE() << name << " is left over";
      if (HasFailure()) return;
    }
}

INSTANTIATE_TEST_SUITE_P(Of, Kills, ::testing::ValuesIn(kOperations),
                         [](const auto& test) { return NameOf(test.param); });

}  // namespace
}  // namespace kora::test
