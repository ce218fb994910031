// The program with windows, used at random. The long run is scripts/monkey.sh.

#include <gtest/gtest.h>

#include <cstdio>
#include <fstream>
#include <iterator>

#include "base/runtime_error.h"
#include "tests/monkey/driver/messages.h"
#include "tests/support/places.h"
#include "tests/support/program.h"

namespace {

using kora::test::ProgramResult;

ProgramResult Monkey(const char* events, const char* seed) {
  return kora::test::RunProgram(kora::BinDir() + "/kora_monkey",
                                {"--events", events, "--seed", seed});
}

std::string LineOf(const std::string& text, const std::string& begin) {
  const size_t at = text.find(begin);
  return at == text.npos ? "" : text.substr(at, text.find('\n', at) - at);
}

}  // namespace

TEST(MonkeyTest, AMessageOfAnErrorMustHaveItsNumberInTheGuide) {
  using kora::monkey::FaultOfMessage;
  const std::set<int> numbers = kora::monkey::NumbersOfGuide(
      "<td>9</td><table "
      "id=\"numbers\"><tr><td>6</td></tr><tr><td>53</td></tr></table><tr><td>7</td>");
  EXPECT_EQ(numbers, (std::set<int>{6, 53}));
  EXPECT_EQ(FaultOfMessage("There is an unexpected error No. 53\nFile not found", numbers), "");
  EXPECT_EQ(FaultOfMessage("Code not found", numbers), "");
  EXPECT_NE(FaultOfMessage("There is an unexpected error number 76", numbers), "");
  EXPECT_NE(FaultOfMessage("Unexpected Error No. -1", numbers), "");
  EXPECT_NE(FaultOfMessage("Disk full", numbers), "");
  EXPECT_NE(FaultOfMessage("vector::_M_range_check", numbers), "");
  EXPECT_NE(FaultOfMessage("Application-defined error", numbers), "");
  EXPECT_NE(FaultOfMessage(" ", numbers), "");
}

TEST(MonkeyTest, TheGuideExplainsEveryNumber) {
  std::ifstream in(kora::SourceDir() + "/docs/guide/messages.html");
  const std::string page{std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
  const auto numbers = kora::monkey::NumbersOfGuide(page);
  for (int number = 1; number < 1000; ++number) {
    const std::string text = kora::ErrorText(number);
    EXPECT_EQ(numbers.contains(number), text != kora::ErrorText(0)) << number;
    if (numbers.contains(number)) {
      EXPECT_NE(page.find("<td>" + text + "</td>"), page.npos) << text;
    }
  }
}

TEST(MonkeyTest, AProgramThatIsUsedAtRandomNeitherDiesNorHangsNorLeavesItsHome) {
  const ProgramResult run = Monkey("1500", "7");
  EXPECT_EQ(run.code, 0) << run.err;
  EXPECT_EQ(LineOf(run.out, "failures:"), "failures: 0");
  std::printf("%s", run.out.c_str());
}

TEST(MonkeyTest, TheSameSeedGivesTheSameEvents) {
  const ProgramResult first = Monkey("250", "3"), second = Monkey("250", "3"),
                      other = Monkey("250", "4");
  const std::string digest = LineOf(first.out, "digest");
  EXPECT_NE(digest, "");
  EXPECT_EQ(LineOf(second.out, "digest"), digest);
  EXPECT_NE(LineOf(other.out, "digest"), digest);
}
