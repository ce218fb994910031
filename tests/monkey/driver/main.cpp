// kora_monkey [--events N] [--seed S] [--hangs SECONDS] [--log FILE] [--messages yes]: uses the program with windows
// at random, and tells what should not be. Ends with 0 where nothing was found.
//
// The work is done by a second process, so that a crash of any kind is told with the events
// before it.

#include <fcntl.h>
#include <signal.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QDesktopServices>
#include <QLineEdit>
#include <QUrl>
#include <cstring>
#include <deque>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>

#include "demo/demo_market.h"
#include "kora/program/program.h"
#include "platform/headless/console_dialogs.h"
#include "shell/forms/help_pages.h"
#include "shell/main_menu.h"
#include "store/name_file.h"
#include "tests/monkey/driver/confined.h"
#include "tests/monkey/driver/messages.h"
#include "tests/monkey/driver/monkey.h"
#include "tests/support/places.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_place.h"

namespace fs = std::filesystem;

namespace kora::monkey {
namespace {

struct Arguments {
  long events = 2000;
  std::uint64_t seed = 1;
  double hangs = 60;
  bool messages = false;  // all that were told are listed
  std::string log;        // empty: in the folder of the run
  std::string work;       // the folder of the run; named for the second process alone
};

std::string Bytes(const fs::path& path) {
  std::ifstream in(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

// What stands beside the homes must be there afterwards as it was.
std::map<std::string, std::string> Tree(const fs::path& root) {
  std::map<std::string, std::string> out;
  for (const auto& entry : fs::recursive_directory_iterator(root))
    out[entry.path().string()] = entry.is_regular_file() ? Bytes(entry.path()) : "/";
  return out;
}

void LaySentinels(const fs::path& outside) {
  for (const char* name : {"Names.dat", "data/AAA.WDT", "Kora.ini", "notes.txt", "sub/sub/x.cht"}) {
    fs::create_directories((outside / name).parent_path());
    std::ofstream(outside / name) << "stays " << name;
  }
}

class WatchedApplication : public Application {
 public:
  using Application::Application;
  Monkey* monkey = nullptr;

 protected:
  void Caught(const char* what) override {
    if (monkey) monkey->Fail(std::string("no form caught: ") + what);
    Application::Caught(what);
  }
};

// Nothing is opened outside of the program.
class NoBrowser : public QObject {
  Q_OBJECT
 public:
  NoBrowser() {
    for (const char* scheme : kSchemes) QDesktopServices::setUrlHandler(scheme, this, "Take");
  }
  ~NoBrowser() override {
    for (const char* scheme : kSchemes) QDesktopServices::unsetUrlHandler(scheme);
  }
  Q_INVOKABLE void Take(const QUrl&) { ++asked; }
  int asked = 0;

 private:
  static constexpr const char* kSchemes[] = {"file", "http", "https", "mailto"};
};

// What the toolkit warns of, but for what the platform without a screen can't do and for scripts
// that the fonts of this machine lack.
std::map<std::string, long>& Warnings() {
  static std::map<std::string, long> warnings;
  return warnings;
}

void TakeWarning(QtMsgType, const QMessageLogContext&, const QString& text) {
  if (!text.startsWith("This plugin does not support") &&
      !text.contains("OpenType support missing"))
    ++Warnings()[text.toStdString()];
}

// A home that the runs begin with: a small invented market, and stand-ins for the programs that
// the menu starts, which are never started.
void LayMarket(const std::string& home, ConfinedIo& io) {
  Files files(home, io);
  SettingsFile ini(files, "C:\\WINDOWS\\Kora.ini");
  SettingsFile user(files, "C:\\WINDOWS\\KoraUser.ini", kLongestUserValue);
  test::ScriptedDialogs dialogs;
  if (!MakeDemo(files, ini, user, dialogs, {.securities = 24, .years = 3}))
    throw std::runtime_error("no market");
  for (const char* name : {"Dlmain32.EXE", "Dlbourse32.exe", "Dleis32.EXE", "Mmascan.EXE"})
    std::ofstream(home + "/drive_c/korawin/" + name) << "stub";
  fs::create_directories(home + "/drive_c/korawin/chtsave");
  std::ofstream(home + "/drive_c/korawin/chtsave/broken.cht") << "V,1\r\nL,x,y\r\n";
}

std::vector<std::string> CodesOf(const std::string& home, ConfinedIo& io) {
  const Files files(home, io);
  const NameFile names(files, NameFilePath("C:\\korawin\\data\\"));
  std::vector<std::string> codes;
  for (int i = 1; i <= names.count(); ++i) codes.emplace_back(names.Read(i).Code.trimmed());
  return codes;
}

ProgramArguments SomeArguments(Generator& generator, const std::string& home) {
  ProgramArguments arguments;
  arguments.home = home;
  static constexpr const char* kServices[] = {"", "1", "2", "3", "5"};
  const char* service = kServices[Below(generator, 5)];
  if (*service) arguments.overrides.push_back({"Download", "DataService", service});
  for (const char* word : {"RM", "N", "XT", "XS"})
    if (Chance(generator, 0.4))
      arguments.words += (arguments.words.empty() ? "" : " ") + std::string(word);
  if (Chance(generator, 0.1)) arguments.words += " A";
  if (Chance(generator, 0.15)) arguments.file = home + "/drive_c/korawin/chtsave/broken.cht";
  return arguments;
}

// A user may choose the drive that is the host's root, in a form or for good: he is refused there.
bool NamesOtherDrive(const Paths& paths) {
  const auto names = [](const QString& text) { return text.contains("Z:", Qt::CaseInsensitive); };
  for (const std::string& path : {paths.SystemPath, paths.CurrentDataPath})
    if (names(QString::fromStdString(path))) return true;
  for (const QWidget* widget : QApplication::allWidgets())
    if (const auto* box = qobject_cast<const QLineEdit*>(widget); box && names(box->text()))
      return true;
  return false;
}

void TellCounts(const Monkey& monkey, int runs, int started, int browser, bool messages) {
  const auto reached = [](const auto& counts) {
    return std::count_if(counts.begin(), counts.end(), [](const auto& c) { return c.second > 0; });
  };
  std::printf("events: %ld in %d runs of the program\n", monkey.number(), runs);
  std::printf("menu entries reached: %ld of %zu, chosen %ld times\n", long(reached(monkey.entries)),
              monkey.entries.size(), monkey.actions);
  for (const auto& [name, count] : monkey.entries)
    if (count == 0) std::printf("  not reached: %s\n", name.c_str());
  size_t known = 0, open = 0;
  for (const QString& form : FormsOfTheGuide()) {
    ++known;
    if (monkey.forms.contains(form.toStdString()))
      ++open;
    else
      std::printf("  form not opened: %s\n", qPrintable(form));
  }
  long shown = 0;
  for (const auto& [name, count] : monkey.forms) shown += count;
  std::printf("forms opened: %zu of %zu, %zu with the system's own, %ld times\n", open, known,
              monkey.forms.size(), shown);
  std::printf("controls used: %zu\n", monkey.used.size());
  if (messages)
    for (const auto& [text, count] : monkey.messages)
      std::printf("  told %ld times: %.300s\n", count, text.c_str());
  long told = 0;
  for (const auto& [text, count] : monkey.messages) told += count;
  std::printf("messages told: %ld, %zu different\n", told, monkey.messages.size());
  for (const auto& [text, count] : Warnings())
    std::printf("  the toolkit warns %ld times: %s\n", count, text.c_str());
  std::printf("programs asked for: %d, pages of a browser: %d, started: 0\n", started, browser);
  std::printf("digest of the events: %016llx\n", static_cast<unsigned long long>(monkey.digest()));
  std::printf("failures: %zu\n", monkey.failures());
}

int Use(const Arguments& a, int argc, char** argv) {
  qInstallMessageHandler(TakeWarning);
  WatchedApplication app(argc, argv);
  const NoBrowser browser;
  const StandingClock clock;
  NoProcesses processes;
  ConfinedIo io;
  const std::string homes = a.work + "/homes";
  io.root = homes;
  LayMarket(homes + "/market", io);
  const std::set<int> numbers = NumbersOfGuide(Bytes(SourceDir() + "/docs/guide/messages.html"));
  if (numbers.empty()) throw std::runtime_error("the guide has no numbers of errors");
  Monkey monkey({.seed = a.seed,
                 .events = a.events,
                 .hangs = a.hangs,
                 .numbers = numbers,
                 .codes = CodesOf(homes + "/market", io),
                 .log = a.log});
  app.monkey = &monkey;
  Program* running = nullptr;
  long wished = 0;
  io.refused = [&](const std::string& what) {
    if (running && NamesOtherDrive(running->session().settings.paths))
      ++wished;
    else
      monkey.Fail("would leave the home: " + what);
  };
  int runs = 0;
  std::string home;
  while (!monkey.Done()) {
    Generator& generator = monkey.generator();
    if (home.empty() || !Chance(generator, 0.25)) {
      fs::remove_all(homes + "/home");
      home = homes + "/home";
      if (Chance(generator, 0.12))
        fs::create_directories(home);  // a first start
      else
        fs::copy(homes + "/market", home, fs::copy_options::recursive);
    }
    io.root = home;
    ++runs;
    {
      Program program(app, SomeArguments(generator, home), {io, clock, processes});
      running = &program;
      monkey.BeginRun(home, [&program]() -> QWidget* { return program.main(); });
      if (program.Start()) app.exec();
      monkey.EndRun();
      running = nullptr;
    }
    monkey.CheckNothingIsLeft();
  }
  std::printf("writes refused where a user chose the drive of the host: %ld\n", wished);
  TellCounts(monkey, runs, processes.started, browser.asked, a.messages);
  app.monkey = nullptr;
  return monkey.failures() == 0 ? 0 : 1;
}

// ---- The process that looks after the other

std::string Number(double n) { return std::to_string(long(n)); }

void TellLast(const std::string& log) {
  std::ifstream in(log);
  std::deque<std::string> last;
  for (std::string line; std::getline(in, line);) {
    last.push_back(line);
    if (last.size() > 30) last.pop_front();
  }
  std::fprintf(stderr, "The last events:\n");
  for (const std::string& line : last) std::fprintf(stderr, "    %s\n", line.c_str());
}

int LookAfter(Arguments a, const char* self) {
  const std::string work = test::MakeTempFolder("kora-monkey");
  if (a.log.empty()) a.log = work + "/events.log";
  for (const char* folder :
       {"homes", "user/tmp", "user/config", "user/cache", "user/data", "user/run"})
    fs::create_directories(work + "/" + folder);
  fs::permissions(work + "/user/run", fs::perms::owner_all);
  LaySentinels(work + "/outside");
  LaySentinels(work + "/homes/beside");
  const auto outside = Tree(work + "/outside"), beside = Tree(work + "/homes/beside");
  const std::map<const char*, std::string> environment{{"HOME", work + "/user"},
                                                       {"TMPDIR", work + "/user/tmp"},
                                                       {"XDG_CONFIG_HOME", work + "/user/config"},
                                                       {"XDG_CACHE_HOME", work + "/user/cache"},
                                                       {"XDG_DATA_HOME", work + "/user/data"},
                                                       {"XDG_RUNTIME_DIR", work + "/user/run"},
                                                       {"CUPS_SERVER", work + "/no-printers"},
                                                       {"QT_QPA_PLATFORM", "offscreen"},
                                                       {"QT_HASH_SEED", "0"}};
  const pid_t child = fork();
  if (child == 0) {
    for (const auto& [name, value] : environment) setenv(name, value.c_str(), 1);
    unsetenv("DISPLAY");
    unsetenv("WAYLAND_DISPLAY");
    if (chdir((work + "/user").c_str()) != 0) _exit(127);
    const std::string words[] = {
        "--events",   Number(double(a.events)),  "--seed", std::to_string(a.seed),
        "--hangs",    Number(a.hangs),           "--log",  a.log,
        "--messages", a.messages ? "yes" : "no", "--work", work};
    std::vector<char*> argv{const_cast<char*>(self)};
    for (const std::string& word : words) argv.push_back(const_cast<char*>(word.c_str()));
    argv.push_back(nullptr);
    execv("/proc/self/exe", argv.data());
    _exit(127);
  }
  int status = 0;
  waitpid(child, &status, 0);
  int code = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
  if (code > 1) {
    std::fprintf(stderr, "DIED with %d, seed %llu\n", code,
                 static_cast<unsigned long long>(a.seed));
    TellLast(a.log);
  }
  if (Tree(work + "/outside") != outside || Tree(work + "/homes/beside") != beside) {
    std::fprintf(stderr, "FAILURE: something outside of the home was changed\n");
    code = code ? code : 1;
  }
  fs::remove_all(work);
  return code;
}

}  // namespace
}  // namespace kora::monkey

int main(int argc, char** argv) {
  kora::monkey::Arguments a;
  for (int i = 1; i + 1 < argc; i += 2) {
    const std::string name = argv[i], value = argv[i + 1];
    if (name == "--events")
      a.events = std::stol(value);
    else if (name == "--seed")
      a.seed = std::stoull(value);
    else if (name == "--hangs")
      a.hangs = std::stod(value);
    else if (name == "--log")
      a.log = value;
    else if (name == "--messages")
      a.messages = value == "yes";
    else if (name == "--work")
      a.work = value;
    else {
      std::fprintf(
          stderr,
          "kora_monkey [--events N] [--seed S] [--hangs SECONDS] [--log FILE] [--messages yes]\n");
      return 2;
    }
  }
  if (a.work.empty()) return kora::monkey::LookAfter(a, argv[0]);
  int one = 1;
  return kora::monkey::Use(a, one, argv);
}

#include "main.moc"
