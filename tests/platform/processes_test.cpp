#include "platform/processes.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <ctime>

#include "platform/clock.h"
#include "tests/support/error_of.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::ErrorOf;
using kora::test::TempHome;

namespace {

int Start(const std::string& program, const std::vector<std::string>& arguments = {},
          const std::function<void()>& idle = {}) {
  return MachineProcesses().RunAndWait(program, arguments, idle);
}

}  // namespace

TEST(ProcessesTest, ReturnsTheExitCode) {
  EXPECT_EQ(Start("/bin/true"), 0);
  EXPECT_EQ(Start("/bin/false"), 1);
  EXPECT_EQ(Start("/bin/sh", {"-c", "exit 42"}), 42);
  EXPECT_EQ(Start("/bin/sh", {"-c", "kill -9 $$"}), 128 + 9);
}

TEST(ProcessesTest, ArgumentsArriveAsTheyAre) {
  TempHome home;
  const std::string out = home.path() + "/out";
  EXPECT_EQ(
      Start("/bin/sh", {"-c", "printf '%s|' \"$@\" > " + out, "sh", "a b", "", "$HOME", "\"q\""}),
      0);
  EXPECT_EQ(home.Get("out"), "a b||$HOME|\"q\"|");
}

TEST(ProcessesTest, ProgramRunsInItsOwnFolder) {
  TempHome home;
  home.Put("programs/sibling", "#!/bin/sh\npwd -P > where\n");
  ASSERT_EQ(::chmod((home.path() + "/programs/sibling").c_str(), 0755), 0);
  EXPECT_EQ(Start(home.path() + "/programs/sibling"), 0);
  EXPECT_EQ(home.Get("programs/where"), home.path() + "/programs\n");
}

TEST(ProcessesTest, WhatCantBeStartedIsError53) {
  TempHome home;
  home.Put("plain.txt", "no program");
  EXPECT_EQ(ErrorOf([] { Start("/nowhere/program"); }), 53);
  EXPECT_EQ(ErrorOf([] { Start(""); }), 53);
  EXPECT_EQ(ErrorOf([&] { Start(home.path()); }), 53);
  EXPECT_EQ(ErrorOf([&] { Start(home.path() + "/plain.txt"); }), 53);
}

TEST(ProcessesTest, IdleRunsWhileTheProgramDoes) {
  // The program ends when idle has made the file that it waits for.
  TempHome home;
  const std::string flag = home.path() + "/flag";
  int calls = 0;
  EXPECT_EQ(Start("/bin/sh", {"-c", "until [ -e " + flag + " ]; do sleep 0.01; done; exit 3"},
                  [&] {
                    if (++calls == 2) home.Put("flag", "");
                  }),
            3);
  EXPECT_GE(calls, 2);
}

TEST(ClockTest, TodayIsTheLocalDate) {
  char before[16], after[16];
  const auto local = [](char* out) {
    const std::time_t now = std::time(nullptr);
    std::strftime(out, 16, "%Y%m%d", std::localtime(&now));
  };
  local(before);
  const std::string today = FormatFileDate(MachineClock().Today());
  local(after);
  EXPECT_TRUE(today == before || today == after) << today;
}
