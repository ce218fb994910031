// Every operation that writes, killed in place of each of its changes on the disk, and failed at
// each of them. The home is then opened again as a user would, and the operation run again.
//
// An operation runs on a disk in memory, which is kept as it is before each change: that is how the
// end of a process leaves it. What processes that are killed on a real disk leave is compared
// with it.

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/mman.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <unordered_set>

#include "base/runtime_error.h"
#include "base/text.h"
#include "koractl/koractl.h"
#include "shell/session.h"
#include "store/name_rec.h"
#include "store/price_rec.h"
#include "tests/kills/operations.h"
#include "tests/support/disk_view.h"
#include "tests/support/killed_runs.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

const std::string kHome = "/kora";

const std::string kDown = "drive_c/korawin/download/";
const std::string kData = "drive_c/korawin/data/";
const std::string kElsewhere = "elsewhere/";

// Every n-th point only, where each takes long: KORA_KILLS_STEP says how many.
int Stride() {
  if (const char* step = std::getenv("KORA_KILLS_STEP")) return std::max(1, std::atoi(step));
#ifdef __SANITIZE_ADDRESS__
  return 80;
#else
  return 6;
#endif
}

// How the files of a home stand on the disk.
enum class Scene {
  kPlain,
  kOtherCase,  // names as another system wrote them: names.DAT, cjq.wdt
  kLinked,     // name file, settings and price files are links to files elsewhere
};

// Says nothing but on standard error, as the program would in a box.
class TellingDialogs : public ScriptedDialogs {
 public:
  void Message(std::string_view text, std::string_view title) override {
    std::fprintf(stderr, "[%s] %s\n", std::string(title).c_str(), std::string(text).c_str());
  }
  Answer Ask(std::string_view text, std::string_view title, Buttons buttons) override {
    if (buttons == Buttons::kRetryCancel) Message(text, title);
    return ScriptedDialogs::Ask(text, title, buttons);
  }
};

// Takes what is written to standard error meanwhile; standard output goes nowhere.
class Taken {
 public:
  Taken() {
    std::fflush(nullptr);
    ::dup2(Err(), STDERR_FILENO);
    ::dup2(Null(), STDOUT_FILENO);
  }
  ~Taken() { End(); }
  std::string End() {
    if (ended_) return {};
    ended_ = true;
    std::fflush(nullptr);
    ::dup2(OldErr(), STDERR_FILENO);
    ::dup2(OldOut(), STDOUT_FILENO);
    std::string text(size_t(::lseek(Err(), 0, SEEK_CUR)), '\0');
    if (::pread(Err(), text.data(), text.size(), 0) != ssize_t(text.size())) text = "?";
    if (!text.empty() && (::ftruncate(Err(), 0) != 0 || ::lseek(Err(), 0, SEEK_SET) != 0))
      text = "?";
    return text;
  }
  // Made before the first use, while both are still what they were.
  static void Prepare() { OldErr(), OldOut(), Err(), Null(); }

 private:
  static int OldErr() {
    static const int fd = ::dup(STDERR_FILENO);
    return fd;
  }
  static int OldOut() {
    static const int fd = ::dup(STDOUT_FILENO);
    return fd;
  }
  static int Err() {
    static const int fd = ::memfd_create("err", 0);
    return fd;
  }
  static int Null() {
    static const int fd = ::open("/dev/null", O_WRONLY | O_CLOEXEC);
    return fd;
  }
  bool ended_ = false;
};

struct Outcome {
  int code = 0;
  std::string err;
};

int Call(const Words& words, const std::string& home, Io& io) {
  std::vector<std::string> filled{"koractl", "--home", home, "--wait", "0"};
  for (std::string word : words) {
    for (const auto& [mark, text] : {std::pair<std::string, std::string>{"{home}", home},
                                     {"{day}", "1/10/26"},
                                     {"{last}", "30/10/26"}})
      if (const size_t at = word.find(mark); at != std::string::npos)
        word.replace(at, mark.size(), text);
    filled.push_back(word);
  }
  std::vector<const char*> argv;
  for (const std::string& word : filled) argv.push_back(word.c_str());
  return RunKoractl(int(argv.size()), argv.data(), io);
}

int Work(const std::function<bool(Session&)>& work, const std::string& home, Io& io) {
  TellingDialogs dialogs;
  Session session(home, dialogs, io);
  session.files.lock().wait = std::chrono::milliseconds(0);
  if (!ReadAllSettings(session, "", false)) return 1;
  try {
    return work(session) ? 0 : 1;
  } catch (const RunTimeError& e) {
    dialogs.Message(e.what(), "KORA");  // as the program does with what no form took
    return 1;
  }
}

int Do(const Step& step, const std::string& home, Io& io) {
  return step.work ? Work(step.work, home, io) : Call(step.words, home, io);
}

Outcome Perform(const Step& step, Io& io, const std::string& home = kHome) {
  Taken taken;
  Outcome outcome;
  outcome.code = Do(step, home, io);
  outcome.err = taken.End();
  return outcome;
}

// What the next start of any program does first.
void OpenAgain(Io& io) {
  ScriptedDialogs dialogs;
  Session session(kHome, dialogs, io);
  EXPECT_TRUE(ReadAllSettings(session, "", false));
}

size_t RecordSize(const std::string& name) {
  if (EndsNoCase(name, ".WDT")) return sizeof(PriceRec);
  if (EndsNoCase(name, "Names.dat")) return sizeof(NameRec);
  if (EndsNoCase(name, "Names.bak")) return sizeof(NameRec);
  return 1;
}

// A disk as the end of a process leaves it.
struct Moment {
  std::string what;  // was about to be done
  Disk disk;
};
using Moments = std::vector<Moment>;

void Keep(MemoryDisk& io, Moments& moments) {
  io.watch = [&moments](const std::string& what, const Disk& disk) {
    moments.push_back({what, disk});
  };
}

struct Tally {
  int kills = 0, states = 0, second = 0, failures = 0, readFailures = 0, readOnly = 0, real = 0;
  int operations = 0;
  ~Tally() {
    std::printf(
        "%d operations in three scenes: %d kills, %d of them within the recovery from another, "
        "which left %d different disks; %d failed changes, %d failed reads, %d read-only files; "
        "%d processes killed on a real disk\n",
        operations, kills, second, states, failures, readFailures, readOnly, real);
  }
} tally;

class Kills : public ::testing::TestWithParam<Operation> {
 protected:
  static void SetUpTestSuite() {
    Taken::Prepare();
    MemoryDisk io;
    io.Put(kHome + "/Kora.lock", "");
    const Outcome made = Perform(Cmd("demo", "--years", "1", "--securities", "24"), io);
    ASSERT_EQ(made.code, 0) << made.err;
    market_ = io.disk;
  }

  // A home as the scene has it.
  static Disk Market(Scene scene) {
    MemoryDisk io(market_);
    if (scene == Scene::kPlain) return io.disk;
    for (const auto& [path, id] : Disk(io.disk).names) {
      if (path.size() <= kHome.size() || io.disk.nodes[id].folder || path.ends_with("Kora.lock"))
        continue;
      const std::string name(path.substr(path.rfind('/') + 1));
      if (scene == Scene::kOtherCase) {
        std::string other = name;
        for (char& c : other) c = char(std::islower(c) ? std::toupper(c) : std::tolower(c));
        io.Rename(path, HostFolderOf(path) + "/" + other);
      } else if (name == "Names.dat" || name == "Kora.ini" || name == "SubListA.Dat" ||
                 name == "IndClass.dat" || name == "CXQ.WDT" || name == "TZQ.WDT") {
        io.Put(kHome + "/" + kElsewhere + name, io.disk.nodes[id].bytes->text);
        io.PutLink(path, kHome + "/" + kElsewhere + name);
      }
    }
    return io.disk;
  }

  // What the operation starts from and what it gives undisturbed.
  void LayScene(Scene scene) {
    MemoryDisk io(Market(scene));
    for (const auto& [name, bytes] : GetParam().files) io.Put(kHome + "/" + name, bytes);
    // Makes the folders that every start makes.
    ASSERT_EQ(Perform(Cmd("names"), io).code, 0);
    for (const Step& step : GetParam().before) {
      const Outcome run = Perform(step, io);
      ASSERT_EQ(run.code, 0) << run.err;
    }
    start = io.disk;
    before = ViewOf(start, kHome);
    Keep(io, moments);
    const Outcome run = Perform(GetParam().step, io);
    ASSERT_EQ(run.code, 0) << run.err;
    whole = ViewOf(io.disk, kHome);
    ASSERT_FALSE(SameView(before, whole)) << "the operation writes nothing";
    ASSERT_TRUE(TemporariesOn(io.disk, kHome).empty()) << TemporariesOn(io.disk, kHome)[0];
    // How many changes and reads there are to fail.
    MemoryDisk again(start);
    FailingIo counting(again);
    Perform(GetParam().step, counting);
    changes = counting.calls;
    reads = counting.reads;
  }

  // Done or not, all files together.
  bool Together() const {
    return !(GetParam().ends &
             (kFileByFile | kDayByDay | kRowByRow | kInPlace | kKeyByKey | kScript));
  }

  static void ExpectSame(const DiskView& are, const DiskView& wanted) {
    for (const auto& [name, bytes] : wanted) {
      const auto found = are.find(name);
      if (found == are.end() || !SameBytes(found->second, bytes))
        ADD_FAILURE() << name << " is not made";
    }
    for (const auto& [name, bytes] : are)
      if (!wanted.contains(name)) ADD_FAILURE() << name << " is left over";
  }

  // The copy of the name file is made before the name file is saved, by rule; until then they are
  // the same.
  static DiskView WithoutCopy(DiskView view) {
    std::erase_if(view, [](const auto& file) { return EndsNoCase(file.first, "names.bak"); });
    return view;
  }

  // Whether the user would run the operation again. A day that left the list of those that wait is
  // in; its journal goes with the next update.
  bool IsToRunAgain(const DiskView& opened) {
    if (!(GetParam().ends & kDayByDay)) return !SameView(opened, whole);
    for (const auto& [name, bytes] : before)
      if (name.starts_with(kDown) && !whole.contains(name) && opened.contains(name)) return true;
    return false;
  }

  // Nothing that was there is missing, records are whole, and each file is an old or a new one.
  void ExpectSound(const DiskView& after) {
    for (const auto& [name, bytes] : before)
      if (whole.contains(name)) {
        EXPECT_TRUE(after.contains(name)) << name << " is missing";
      }
    for (const auto& [name, bytes] : after) {
      const auto old = before.find(name), fresh = whole.find(name);
      const bool known = (old != before.end() && SameBytes(old->second, bytes)) ||
                         (fresh != whole.end() && SameBytes(fresh->second, bytes));
      if (known) continue;
      if (!(GetParam().ends & (kDayByDay | kInPlace))) {
        EXPECT_EQ(bytes->text.size() % RecordSize(name), 0u) << name;
      }
      if (!OnTheWay(name, bytes->text)) ADD_FAILURE() << name << " is neither old nor new";
    }
  }

  // What only stands on the disk while an operation is under way.
  bool OnTheWay(const std::string& name, const std::string& bytes) {
    if (EndsNoCase(name, "Update.Jnl")) return true;
    if (GetParam().ends & kScript) return EndsNoCase(name, "TCht.Tmp");
    if (GetParam().ends & kKeyByKey) return EndsNoCase(name, "Kora.ini");
    if (GetParam().ends & kRowByRow) return name.starts_with(kData) || name.starts_with(kElsewhere);
    if (!(GetParam().ends & (kDayByDay | kInPlace))) return false;
    // Some of a day's records, all of them old or new ones.
    const size_t size = RecordSize(name);
    if (size == 1) return name.starts_with(kDown);
    std::string known;
    for (const DiskView* view : {&before, &whole})
      if (const auto it = view->find(name); it != view->end()) known += it->second->text;
    for (size_t at = 0; at + size <= bytes.size(); at += size) {
      bool found = false;
      for (size_t from = 0; !found && from < known.size(); from += size)
        found = known.compare(from, size, bytes, at, size) == 0;
      if (!found) return false;
    }
    return true;
  }

  // Goes on from what a kill left: opens the home, runs the operation again where the user would,
  // and compares. With `twice`, what is done to recover is killed in turn.
  void GoOn(const Moment& moment, bool twice) {
    ++tally.kills;
    if (!seen.insert(KeyOf(moment.disk)).second) return;  // went on from there already
    ++tally.states;
    SCOPED_TRACE("killed before: " + moment.what);
    ExpectSound(ViewOf(moment.disk, kHome));
    MemoryDisk io(moment.disk);
    Moments recovering;
    if (twice) Keep(io, recovering);
    OpenAgain(io);
    const DiskView opened = ViewOf(io.disk, kHome);
    ExpectSound(opened);
    if (Together()) {
      EXPECT_TRUE(SameView(WithoutCopy(opened), WithoutCopy(before)) || SameView(opened, whole))
          << "opened, it is neither old nor new";
    }
    DiskView end = opened;
    // Where the start found nothing to finish, the operation itself begins with that.
    bool journal = false;
    for (const auto& [name, bytes] : opened) journal = journal || EndsNoCase(name, "Update.Jnl");
    if (!journal) io.watch = {};
    if (IsToRunAgain(opened)) {
      const Outcome again = Perform(GetParam().step, io);
      EXPECT_EQ(again.code, 0) << again.err;
      end = ViewOf(io.disk, kHome);
      // The journal of an update may have gone since, and what stands beside it goes with the next.
      for (const std::string& name : TemporariesOn(io.disk, kHome))
        if (!EndsNoCase(name, "/Update.Jnl.old~")) ADD_FAILURE() << name << " is left over";
    } else {
      // What a kill left to be swept goes with the next write of that file or update.
      std::erase_if(end, [](const auto& file) { return EndsNoCase(file.first, "Update.Jnl"); });
    }
    ExpectSame(end, whole);
    for (const Moment& second : recovering) {
      if (HasFailure()) return;
      ++tally.second;
      GoOn(second, false);
    }
  }

  // What ended with a failure told it, and took everything back.
  void ExpectTold(const Outcome& run, const DiskView& after) {
    EXPECT_EQ(run.code, 1) << run.err;
    if (!(GetParam().ends & kQuiet)) {
      EXPECT_NE(run.err, "");
    }
    if (Together()) {
      EXPECT_TRUE(SameView(WithoutCopy(after), WithoutCopy(before))) << run.err;
    }
  }

  // All that a failed run may leave.
  void ExpectFailed(const Outcome& run, const Disk& disk) {
    const DiskView after = ViewOf(disk, kHome);
    ExpectSound(after);
    if (run.code == 0) {
      // What fails without harm, as the flush of a folder where there is none.
      if (Together() && !(GetParam().ends & kPassedOver)) ExpectSame(after, whole);
    } else {
      ExpectTold(run, after);
    }
    for (const std::string& name : TemporariesOn(disk, kHome))
      ADD_FAILURE() << name << " is left over";
  }

  Disk start;
  DiskView before, whole;
  Moments moments;
  int changes = 0, reads = 0;
  std::unordered_set<size_t> seen;
  static Disk market_;
};

Disk Kills::market_;

std::string NameOf(const Operation& operation) {
  std::string name;
  bool capital = true;
  for (const char c : std::string(operation.name)) {
    if (!std::isalnum(c)) {
      capital = true;
    } else {
      name += capital ? char(std::toupper(c)) : c;
      capital = false;
    }
  }
  return name;
}

TEST_P(Kills, AreOldOrNewAndTheNextRunEndsIt) {
  ++tally.operations;
  for (const Scene scene : {Scene::kPlain, Scene::kOtherCase, Scene::kLinked}) {
    SCOPED_TRACE("scene " + std::to_string(int(scene)));
    moments.clear();
    seen.clear();
    LayScene(scene);
    if (HasFailure()) return;
    for (size_t at = 0; at < moments.size(); at += size_t(Stride())) {
      SCOPED_TRACE("change " + std::to_string(at + 1));
      GoOn(moments[at], true);
      if (HasFailure()) return;
    }
  }
}

// A failure is told, and all is as it was.
TEST_P(Kills, FailuresAreToldAndChangeNothing) {
  LayScene(Scene::kPlain);
  if (HasFailure()) return;
  for (const int error : {kDiskFull, kPathAccess, kDeviceError, kTooManyFiles})
    for (int at = 1; at <= changes; at += Stride()) {
      SCOPED_TRACE("error " + std::to_string(error) + " at change " + std::to_string(at));
      MemoryDisk disk(start);
      FailingIo io(disk);
      io.failAt = at;
      io.error = error;
      io.torn = error == kDiskFull;  // a disk fills up in the middle of a write
      const Outcome run = Perform(GetParam().step, io);
      ++tally.failures;
      ExpectFailed(run, disk.disk);
      if (HasFailure()) return;
    }
}

// What can't be read is told too, and what is not done leaves all as it was.
TEST_P(Kills, FailedReadsAreTold) {
  LayScene(Scene::kPlain);
  if (HasFailure()) return;
  for (int at = 1; at <= reads; at += 3 * Stride()) {
    const int error = at % 2 == 0 ? kDeviceError : kTooManyFiles;
    SCOPED_TRACE("error " + std::to_string(error) + " at read " + std::to_string(at));
    MemoryDisk disk(start);
    FailingIo io(disk);
    io.failReadAt = at;
    io.readError = error;
    const Outcome run = Perform(GetParam().step, io);
    ++tally.readFailures;
    const DiskView after = ViewOf(disk.disk, kHome);
    if (run.code == 0) {
      // Passed over and counted, as securities in a walk through the market, or not needed.
      if (!SameView(after, whole)) {
        EXPECT_NE(run.err, "");
      }
    } else {
      ExpectTold(run, after);
    }
    for (const std::string& name : TemporariesOn(disk.disk, kHome))
      ADD_FAILURE() << name << " is left over";
    if (HasFailure()) return;
  }
}

// A file that nobody may write stays as it is, and that is told.
TEST_P(Kills, ReadOnlyFilesStayAndAreTold) {
  LayScene(Scene::kPlain);
  if (HasFailure()) return;
  for (const auto& [name, bytes] : before) {
    const auto fresh = whole.find(name);
    if (name.ends_with('/') || (fresh != whole.end() && SameBytes(fresh->second, bytes))) continue;
    SCOPED_TRACE(name);
    MemoryDisk io(start);
    io.disk.nodes[io.disk.names[kHome + "/" + name]].mode = 0444;
    const Outcome run = Perform(GetParam().step, io);
    ++tally.readOnly;
    const DiskView after = ViewOf(io.disk, kHome);
    const bool stays = after.contains(name) && SameBytes(after.at(name), bytes);
    // It may have another name.
    if (!stays && fresh == whole.end()) {
      EXPECT_TRUE(std::any_of(after.begin(), after.end(), [&, &was = bytes](const auto& file) {
        return !before.contains(file.first) && SameBytes(file.second, was);
      }));
      continue;
    }
    EXPECT_TRUE(stays);
    // A day that was taken in and can't leave the list is taken in again.
    const bool listed = (GetParam().ends & kDayByDay) && name.starts_with(kDown);
    if (!(GetParam().ends & (kQuiet | kPassedOver)) && !listed) {
      EXPECT_NE(run.err, "");
      if (Together()) {
        EXPECT_EQ(run.code, 1);
        EXPECT_TRUE(SameView(WithoutCopy(after), WithoutCopy(before)));
      }
    }
    for (const std::string& temporary : TemporariesOn(io.disk, kHome))
      ADD_FAILURE() << temporary << " is left over";
  }
}

// Processes that are killed on a real disk leave there what the disk in memory says.
TEST_P(Kills, OfRealProcessesLeaveTheSame) {
  LayScene(Scene::kPlain);
  if (HasFailure()) return;
  constexpr int kOfEach = 4;
  const TempHome home;
  Store store;
  for (const auto& [name, bytes] : before) store[name] = bytes->text;
  const auto comparable = [](Store found) {
    std::erase_if(found, [](const auto& file) { return EndsNoCase(file.first, "Update.Jnl"); });
    return found;
  };
  for (int n = 0; n < std::min(changes, kOfEach); ++n) {
    const int at = 1 + n * changes / kOfEach;
    SCOPED_TRACE("change " + std::to_string(at));
    MemoryDisk disk(start);
    FailingIo frozen(disk);
    frozen.failAt = at;
    frozen.lasting = true;  // nothing changes any more, whatever the program does
    Perform(GetParam().step, frozen);
    Store left;
    for (const auto& [name, bytes] : ViewOf(disk.disk, kHome)) left[name] = bytes->text;
    LayStore(home.path(), store);
    const ChildRun run = RunInChild(
        [&](FailingIo& io) {
          io.failAt = at;
          io.kills = true;
        },
        [&](Io& io) { return Do(GetParam().step, home.path(), io); });
    ASSERT_TRUE(run.killed) << run.code << " " << run.err;
    ++tally.real;
    EXPECT_TRUE(comparable(StoreOf(home.path())) == comparable(left));
  }
}

INSTANTIATE_TEST_SUITE_P(Forms, Kills, ::testing::ValuesIn(FormOperations()),
                         [](const auto& test) { return NameOf(test.param); });
INSTANTIATE_TEST_SUITE_P(Commands, Kills, ::testing::ValuesIn(CommandOperations()),
                         [](const auto& test) { return NameOf(test.param); });

}  // namespace
}  // namespace kora::test
