// The program with windows, used at random. The long run is scripts/monkey.sh.

#include <gtest/gtest.h>

#include <cstdio>

#include "tests/support/places.h"
#include "tests/support/program.h"

namespace {

using kora::test::ProgramResult;

ProgramResult Monkey(const char* events, const char* seed) {
  return kora::test::RunProgram(kora::BinDir() + "/kora_monkey", {"--events", events, "--seed", seed});
}

std::string LineOf(const std::string& text, const std::string& begin) {
  const size_t at = text.find(begin);
  return at == text.npos ? "" : text.substr(at, text.find('\n', at) - at);
}

}  // namespace

TEST(MonkeyTest, AProgramThatIsUsedAtRandomNeitherDiesNorHangsNorLeavesItsHome) {
  const ProgramResult run = Monkey("1500", "7");
  EXPECT_EQ(run.code, 0) << run.err;
  EXPECT_EQ(LineOf(run.out, "failures:"), "failures: 0");
  std::printf("%s", run.out.c_str());
}

TEST(MonkeyTest, TheSameSeedGivesTheSameEvents) {
  const ProgramResult first = Monkey("250", "3"), second = Monkey("250", "3"), other = Monkey("250", "4");
  const std::string digest = LineOf(first.out, "digest");
  EXPECT_NE(digest, "");
  EXPECT_EQ(LineOf(second.out, "digest"), digest);
  EXPECT_NE(LineOf(other.out, "digest"), digest);
}
