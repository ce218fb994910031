// What shells offer behind koractl.

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>

#include "tests/support/help_text.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

using Words = std::vector<std::string>;

std::string Koractl() { return BinDir() + "/koractl"; }

std::set<std::string> Commands() {
  return WordsUnder(RunProgram(Koractl(), {"--help"}).out, "Subcommands:");
}

// Each line up to its tab.
std::set<std::string> FirstColumn(const std::string& text) {
  std::set<std::string> out;
  std::istringstream lines(text);
  for (std::string line; std::getline(lines, line);) out.insert(line.substr(0, line.find('\t')));
  return out;
}

std::set<std::string> Offered(Words words) {
  words.insert(words.begin(), "--complete");
  const ProgramResult result = RunProgram(Koractl(), words);
  EXPECT_EQ(result.code, 0);
  EXPECT_EQ(result.err, "");
  return FirstColumn(result.out);
}

std::string Script(const char* name) { return SourceDir() + "/packaging/completions/" + name; }

// A shell's program, or nothing where it is not installed.
std::string Shell(const char* name) {
  for (const char* folder : {"/bin/", "/usr/bin/", "/usr/local/bin/"})
    if (const std::string path = std::string(folder) + name; std::filesystem::exists(path))
      return path;
  return {};
}

// Before a shell's script: it shall find the program that was built.
std::string WithPath(const std::string& script) {
  return "export PATH='" + BinDir() + "':/usr/local/bin:/usr/bin:/bin\n" + script;
}

TEST(Completion, OffersEveryCommandAndNothingHidden) {
  const auto commands = Commands();
  EXPECT_GT(commands.size(), 30u);
  EXPECT_EQ(Offered({""}), commands);
  EXPECT_EQ(Offered({"scan"}), (std::set<std::string>{"scan1", "scan2", "scan3"}));
  EXPECT_EQ(Offered({"--home", "/x y", "--wait", "3", ""}), commands) << "values are no command";
  EXPECT_EQ(Offered({"nosuch"}), std::set<std::string>());
  EXPECT_EQ(Offered({}), std::set<std::string>());
}

TEST(Completion, OffersTheOptionsOfTheCommandAndThoseBeforeIt) {
  const auto of = Offered({"scan1", "--"});
  for (const char* option : {"--rsi", "--report", "--home", "--answer", "--help"})
    EXPECT_TRUE(of.contains(option)) << option;
  EXPECT_FALSE(of.contains("--osc"));
  EXPECT_EQ(Offered({"scan1", "--cut"}), (std::set<std::string>{"--cut-ob", "--cut-os"}));
}

TEST(Completion, OffersTheChoicesOfAnOptionInAnyCase) {
  EXPECT_EQ(Offered({"chart", "--style", ""}), (std::set<std::string>{"B", "C", "L", "P"}));
  EXPECT_EQ(Offered({"chart", "AAA", "--osc", "ma"}), std::set<std::string>{"MACD"});
  EXPECT_TRUE(Offered({"chart", "--list", ""}).contains("names"));
  EXPECT_TRUE(Offered({"edit-names", ""}).contains("title-case"));
  EXPECT_TRUE(Offered({"--answer", "y"}).contains("yes"));
}

TEST(Completion, OffersCodesOfTheHomeAndNeverWritesThere) {
  TempHome home;
  ASSERT_EQ(RunProgram(Koractl(), {"--home", home.path(), "init"}).code, 0);
  home.Put("ore.csv", "Date,Close\n20240102,1\n");
  home.Put("orb.csv", "Date,Close\n20240102,1\n");
  for (const char* file : {"/ore.csv", "/orb.csv"})
    ASSERT_EQ(RunProgram(Koractl(), {"--home", home.path(), "import", home.path() + file, "--name",
                                     "Good Ore"})
                  .code,
              0);
  const std::set<std::string> both{"ORB", "ORE"};
  EXPECT_EQ(Offered({"--home", home.path(), "find", ""}), both);
  EXPECT_EQ(Offered({"find", "--home=" + home.path(), "or"}), both);
  EXPECT_EQ(Offered({"chart", "--home", home.path(), "XXX", "ore"}), std::set<std::string>{"ORE"})
      << "a chart takes many codes";
  EXPECT_EQ(Offered({"find", "--home", home.path(), "ORE", ""}), std::set<std::string>());
  EXPECT_EQ(RunProgram(Koractl(), {"--complete", "--home", home.path(), "find", "ORE"}).out,
            "ORE\tGood Ore\n");
  const std::string bare = home.path() + "/bare";
  EXPECT_EQ(Offered({"--home", bare, "find", ""}), std::set<std::string>());
  EXPECT_FALSE(home.Exists("bare"));
  home.Put("bare/Kora.ini", "[KoraPaths]\r\nChtData=c:\\none\\\r\n");
  EXPECT_EQ(Offered({"--home", bare, "find", ""}), std::set<std::string>());
  EXPECT_FALSE(home.Exists("bare/drive_c"));
}

TEST(Completion, FilesAndFoldersAreTheShells) {
  EXPECT_EQ(RunProgram(Koractl(), {"--complete", "play", ""}).out, "\tfiles\n");
  EXPECT_EQ(RunProgram(Koractl(), {"--complete", "chart", "AAA", "--out", ""}).out, "\tfiles\n");
  EXPECT_EQ(RunProgram(Koractl(), {"--complete", "--home", ""}).out, "\tfolders\n");
}

TEST(Completion, BashListsEveryCommand) {
  const std::string run = WithPath("source '" + Script("koractl.bash") +
                                   "'; COMP_WORDS=(koractl \"$@\"); COMP_CWORD=$#; _koractl; "
                                   "printf '%s\\n' \"${COMPREPLY[@]}\"");
  const std::string bash = Shell("bash");
  if (bash.empty()) GTEST_SKIP() << "bash is not installed";
  const ProgramResult all = RunProgram(bash, {"--norc", "-c", run, "bash", ""});
  EXPECT_EQ(all.err, "");
  EXPECT_EQ(FirstColumn(all.out), Commands());
  TempHome home;
  home.Put("my chart.cht", "");
  const ProgramResult file =
      RunProgram(bash, {"--norc", "-c", "cd '" + home.path() + "'; " + run, "bash", "play", "my"});
  EXPECT_EQ(file.out, "my chart.cht\n");
}

TEST(Completion, ZshListsEveryCommand) {
  const std::string zsh = Shell("zsh");
  if (zsh.empty()) GTEST_SKIP() << "zsh is not installed";
  // What the shell's own functions are given.
  const std::string run = WithPath(
      "_describe() { local c; for c in ${(P)2}; do print -r -- \"${c%%:*}\"; done }; "
      "_files() { print files \"$@\" }; "
      "words=(koractl \"$@\"); CURRENT=$#words; source '" +
      Script("_koractl") + "'");
  const ProgramResult all = RunProgram(zsh, {"-f", "-c", run, "zsh", ""});
  EXPECT_EQ(all.err, "");
  EXPECT_EQ(FirstColumn(all.out), Commands());
  EXPECT_EQ(RunProgram(zsh, {"-f", "-c", run, "zsh", "--home", ""}).out, "files -/\n");
}

TEST(Completion, FishListsEveryCommand) {
  const std::string fish = Shell("fish");
  if (fish.empty()) GTEST_SKIP() << "fish is not installed";
  TempHome home;
  const auto offered = [&](const std::string& typed) {
    return FirstColumn(RunProgram(fish,
                                  {"--no-config", "-c",
                                   "set -x PATH '" + BinDir() + "' $PATH; source '" +
                                       Script("koractl.fish") + "'; complete -C '" + typed + "'"},
                                  {"HOME=" + home.path()})
                           .out);
  };
  EXPECT_EQ(offered("koractl "), Commands());
  EXPECT_EQ(offered("koractl chart --style "), (std::set<std::string>{"B", "C", "L", "P"}));
}

TEST(Completion, OfKoraHasItsOptionsWordsAndCharts) {
  const std::string help = RunProgram(BinDir() + "/kora", {"--help"}).out;
  const auto words = WordsUnder(help, "Words:");
  EXPECT_EQ(words.size(), 5u);
  for (const char* name : {"kora.bash", "_kora", "kora.fish"}) {
    std::ifstream in(Script(name));
    const std::string script{std::istreambuf_iterator<char>(in), {}};
    for (std::string option : {"home", "set", "help", "version"})
      EXPECT_NE(script.find(option), script.npos) << name << " " << option;
    EXPECT_NE(script.find("RM A N XT XS"), script.npos) << name;
  }
  const std::string bash = Shell("bash");
  if (bash.empty()) GTEST_SKIP() << "bash is not installed";
  TempHome home;
  for (const char* file : {"a.cht", "b.png", "folder/c.cht"}) home.Put(file, "");
  const auto offered = [&](const std::string& typed) {
    return FirstColumn(
        RunProgram(bash, {"--norc", "-c",
                          "cd '" + home.path() + "'; source '" + Script("kora.bash") +
                              "'; COMP_WORDS=(kora \"$1\"); COMP_CWORD=1; _kora; "
                              "printf '%s\\n' \"${COMPREPLY[@]}\"",
                          "bash", typed})
            .out);
  };
  auto all = words;
  all.insert({"a.cht", "folder", "drive_c"});
  EXPECT_EQ(offered(""), all);
  EXPECT_EQ(offered("--h"), (std::set<std::string>{"--help", "--home"}));
}

}  // namespace
}  // namespace kora::test
