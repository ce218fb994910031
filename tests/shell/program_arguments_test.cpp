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

TEST(ProgramArguments, WhatHasAPointOrASlashIsAFileAndStandsAnywhere) {
  std::string fault;
  const auto a = ParseProgramArguments({"RM", "charts/BHP.cht", "--home", "/h.cht", "A"}, fault);
  ASSERT_TRUE(a);
  EXPECT_EQ(a->file, "charts/BHP.cht");
  EXPECT_EQ(a->words, "RM A");
  EXPECT_EQ(a->home, "/h.cht");
  EXPECT_FALSE(ParseProgramArguments({"a.cht", "b.cht"}, fault));
  EXPECT_EQ(fault, "one file at a time: a.cht, b.cht");
}

TEST(ProgramArguments, HelpAndVersionAreAskedFor) {
  std::string fault;
  EXPECT_TRUE(ParseProgramArguments({"--help"}, fault)->help);
  EXPECT_TRUE(ParseProgramArguments({"-h"}, fault)->help);
  EXPECT_TRUE(ParseProgramArguments({"XT", "--version"}, fault)->version);
  EXPECT_FALSE(ParseProgramArguments({"--home", "--version"}, fault)->version) << "a value";
}

TEST(ProgramArguments, TheHelpNamesEveryOptionAndWord) {
  for (const char* part : {"--home DIR", "--set SECTION.KEY=VALUE", "--version", "-h,--help",
                           "FILE.cht", "\n  RM ", "\n  A ", "\n  N ", "\n  XT ", "\n  XS "})
    EXPECT_NE(ProgramHelp().find(part), std::string::npos) << part;
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
