#include <gtest/gtest.h>

#include <set>
#include <thread>

#include "store/name_file.h"
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

TEST_F(TwoWriters, TheWaitIsCheckedWithTheCommandLine) {
  EXPECT_EQ(Run({"--wait", "-1", "names"}).code, 2);
  EXPECT_EQ(Run({"--wait", "soon", "names"}).code, 2);
  EXPECT_EQ(Run({"--wait", "0.5", "names"}).code, 0);
}

}  // namespace
}  // namespace kora::test
