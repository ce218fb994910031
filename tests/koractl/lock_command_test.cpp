#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <set>
#include <thread>

#include "store/name_file.h"
#include "tests/support/killed_runs.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/temp_home.h"

// Programs that write one store at the same time.

namespace kora::test {
namespace {

class TwoWriters : public testing::Test {
 protected:
  TwoWriters() { EXPECT_EQ(Run({"init"}).code, 0); }

  ProgramResult Run(std::vector<std::string> words) {
    words.insert(words.begin(), {"--home", home.path()});
    return RunProgram(BinDir() + "/koractl", words);
  }
  // A text file of one new security.
  std::string Source(const std::string& code) {
    home.Put(code + ".csv", "Date,Close\n20240102,1\n");
    return home.path() + "/" + code + ".csv";
  }
  std::set<std::string> Codes() {
    std::set<std::string> codes;
    for (const NameRec& rec : ReadNames(home.files(), "c:\\korawin\\data\\"))
      codes.emplace(rec.Code.trimmed());
    return codes;
  }

  TempHome home;
};

TEST_F(TwoWriters, AtOnceAHundredTimesLoseNothing) {
  constexpr int kTimes = 100;
  std::set<std::string> wanted;
  for (const std::string side : {"A", "B"})
    for (int i = 0; i < kTimes; ++i) {
      const std::string code = side + std::to_string(100 + i);
      Source(code);
      wanted.insert(code);
    }
  const auto writer = [&](const std::string& side, int& failures) {
    for (int i = 0; i < kTimes; ++i) {
      const std::string source = home.path() + "/" + side + std::to_string(100 + i) + ".csv";
      if (Run({"--wait", "60", "import", source}).code != 0) ++failures;
    }
  };
  int failures[2] = {0, 0};
  std::thread other([&] { writer("B", failures[1]); });
  writer("A", failures[0]);
  other.join();
  EXPECT_EQ(failures[0], 0);
  EXPECT_EQ(failures[1], 0);
  EXPECT_EQ(Codes(), wanted);
  for (const std::string& code : wanted)
    EXPECT_EQ(home.Get("drive_c/korawin/data/" + code + ".WDT").size(), 50u) << code;
}

TEST_F(TwoWriters, TheSecondIsRefusedByTheNameOfTheFirstAndWritesNothing) {
  const std::string source = Source("ORE");
  home.files().lock().program = "kora";
  const auto held = home.files().lock().Hold();
  for (const std::vector<std::string>& words :
       {std::vector<std::string>{"import", source}, {"edit-names", "title-case"}}) {
    std::vector<std::string> command = words;
    command.insert(command.begin(), {"--wait", "0"});
    const ProgramResult result = Run(command);
    EXPECT_EQ(result.code, 1) << words[0];
    EXPECT_NE(result.err.find("The data is being written by kora (process " +
                              std::to_string(::getpid()) + " on "),
              std::string::npos)
        << result.err;
  }
  EXPECT_TRUE(Codes().empty());
  EXPECT_FALSE(home.Exists("drive_c/korawin/data/ORE.WDT"));
  EXPECT_EQ(Run({"names"}).code, 0) << "readers are let in";
}

TEST_F(TwoWriters, SnapshotListsTakeWhatBothAdd) {
  constexpr int kEach = 7;  // fifteen are the most
  const auto writer = [&](const std::string& side, int& failures) {
    for (int i = 0; i < kEach; ++i)
      if (Run({"--wait", "60", "snapshot", "1", "add", side + std::to_string(i)}).code != 0)
        ++failures;
  };
  int failures[2] = {0, 0};
  std::thread other([&] { writer("B", failures[1]); });
  writer("A", failures[0]);
  other.join();
  EXPECT_EQ(failures[0] + failures[1], 0);
  const std::string list = home.Get("drive_c/korawin/Snapshot.Dat");
  EXPECT_EQ(std::count(list.begin(), list.end(), '\n'), 2 * kEach) << list;
}

// Homes with an invented market each.
class TwoOnAMarket : public testing::Test {
 protected:
  ProgramResult Run(const std::string& name, std::vector<std::string> words) {
    words.insert(words.begin(), {"--home", home.path() + "/" + name, "--wait", "60"});
    return RunProgram(BinDir() + "/koractl", words);
  }
  void Make(const std::string& name) {
    ASSERT_EQ(Run(name, {"demo", "--years", "1", "--securities", "12"}).code, 0);
  }
  Store FilesOf(const std::string& name) { return StoreOf(home.path() + "/" + name); }
  TempHome home;
};

TEST_F(TwoOnAMarket, TwoUpdatesAtOnceTakeEachDayInOnce) {
  Make("one");
  Make("two");
  ASSERT_EQ(Run("one", {"update", "--all"}).code, 0);
  ProgramResult second;
  std::thread other([&] { second = Run("two", {"update", "--all"}); });
  const ProgramResult first = Run("two", {"update", "--all"});
  other.join();
  // The second finds the days that the first left, or is told that nothing waits.
  EXPECT_TRUE(first.code == 0 || second.code == 0) << first.err << second.err;
  EXPECT_TRUE(FilesOf("one") == FilesOf("two"));
}

TEST_F(TwoOnAMarket, ScansBesideImportsSeeWholeFiles) {
  Make("one");
  std::string day;
  for (const NameRec& rec : ReadNames(Files(home.path() + "/one"), "c:\\korawin\\data\\"))
    day += std::string(rec.Code.trimmed()) + ",20261030,3,4,2,3,100,0\r\n";
  home.Put("day.csv", day);
  std::atomic<bool> over = false;
  int imports = 0, failed = 0;
  std::thread writer([&] {
    while (!over) {
      ++imports;
      if (Run("one", {"import", home.path() + "/day.csv"}).code != 0) ++failed;
    }
  });
  const auto passed = [&] { return Run("one", {"stats"}); };
  for (int i = 0; i < 12; ++i) {
    const ProgramResult stats = passed();
    EXPECT_EQ(stats.code, 0) << stats.err;
    EXPECT_EQ(stats.err.find("could not be read"), std::string::npos) << stats.err;
  }
  over = true;
  writer.join();
  EXPECT_EQ(failed, 0);
  EXPECT_GT(imports, 2);
}

TEST_F(TwoWriters, TheWaitIsCheckedWithTheCommandLine) {
  EXPECT_EQ(Run({"--wait", "-1", "names"}).code, 2);
  EXPECT_EQ(Run({"--wait", "soon", "names"}).code, 2);
  EXPECT_EQ(Run({"--wait", "0.5", "names"}).code, 0);
}

}  // namespace
}  // namespace kora::test
