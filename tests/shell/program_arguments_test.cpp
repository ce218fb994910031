#include "shell/program_arguments.h"

#include <gtest/gtest.h>

namespace kora {
namespace {

TEST(ProgramArguments, HomeOverridesAndWords) {
  std::string fault;
  const auto a = ParseProgramArguments(
      {"XT", "--home", "/h", "--set", "Charts.Av1D=30", "--set=Chart Fonts.CFont=A=b.c", "RM"},
      fault);
  ASSERT_TRUE(a);
  EXPECT_EQ(a->home, "/h");
  EXPECT_EQ(a->words, "XT RM");
  ASSERT_EQ(a->overrides.size(), 2u);
  EXPECT_EQ(a->overrides[0].section, "Charts");
  EXPECT_EQ(a->overrides[0].key, "Av1D");
  EXPECT_EQ(a->overrides[0].value, "30");
  EXPECT_EQ(a->overrides[1].section, "Chart Fonts");
  EXPECT_EQ(a->overrides[1].key, "CFont");
  EXPECT_EQ(a->overrides[1].value, "A=b.c");
}

TEST(ProgramArguments, NoneAreFine) {
  std::string fault;
  const auto a = ParseProgramArguments({}, fault);
  ASSERT_TRUE(a);
  EXPECT_EQ(a->home, "");
  EXPECT_EQ(a->words, "");
}

TEST(ProgramArguments, WrongOnesAreTold) {
  for (const std::vector<std::string>& wrong : {std::vector<std::string>{"--hom", "/h"},
                                                {"--home"},
                                                {"--home="},
                                                {"--set"},
                                                {"--set", "Charts"},
                                                {"--set", ".Key=1"},
                                                {"--set", "Charts.=1"},
                                                {"--set", "A=b.c"},
                                                {"--"}}) {
    std::string fault;
    EXPECT_FALSE(ParseProgramArguments(wrong, fault)) << wrong[0];
    EXPECT_NE(fault, "") << wrong[0];
  }
}

}  // namespace
}  // namespace kora
