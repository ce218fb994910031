#include "platform/headless/console_dialogs.h"

#include <gtest/gtest.h>

using namespace kora;

TEST(ConsoleDialogsTest, MessageGoesToStandardErrorWithItsTitle) {
  ConsoleDialogs dialogs;
  EXPECT_FALSE(dialogs.said());
  testing::internal::CaptureStderr();
  dialogs.Message("No File For That Name", "Chart");
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "[Chart] No File For That Name\n");
  EXPECT_TRUE(dialogs.said());
}

TEST(ConsoleDialogsTest, QuestionTakesTheStandingAnswerWhereItOffersIt) {
  testing::internal::CaptureStderr();
  for (const Answer a : {Answer::kYes, Answer::kNo, Answer::kCancel}) {
    ConsoleDialogs dialogs(a);
    EXPECT_EQ(dialogs.Ask("q", "t", Buttons::kYesNoCancel), a);
  }
  EXPECT_EQ(ConsoleDialogs(Answer::kNo).Ask("q", "t", Buttons::kYesNo), Answer::kNo);
  EXPECT_EQ(ConsoleDialogs(Answer::kCancel).Ask("q", "t", Buttons::kOkCancel), Answer::kCancel);
  // A box without the word has another for the same.
  EXPECT_EQ(ConsoleDialogs(Answer::kCancel).Ask("q", "t", Buttons::kYesNo), Answer::kNo);
  EXPECT_EQ(ConsoleDialogs(Answer::kNo).Ask("q", "t", Buttons::kOkCancel), Answer::kCancel);
  EXPECT_EQ(ConsoleDialogs(Answer::kNo).Ask("q", "t", Buttons::kRetryCancel), Answer::kCancel);
  EXPECT_EQ(ConsoleDialogs(Answer::kOk).Ask("q", "t", Buttons::kYesNo), Answer::kYes);
  EXPECT_EQ(ConsoleDialogs(Answer::kYes).Ask("q", "t", Buttons::kOkCancel), Answer::kOk);
  EXPECT_EQ(ConsoleDialogs(Answer::kNo).Ask("q", "t", Buttons::kOk), Answer::kOk);
  testing::internal::GetCapturedStderr();
}

TEST(ConsoleDialogsTest, QuestionWithoutAStandingAnswerTakesTheFirstButtonButNeverRetries) {
  testing::internal::CaptureStderr();
  ConsoleDialogs dialogs;
  EXPECT_EQ(dialogs.Ask("q", "t", Buttons::kOk), Answer::kOk);
  EXPECT_EQ(dialogs.Ask("q", "t", Buttons::kOkCancel), Answer::kOk);
  EXPECT_EQ(dialogs.Ask("q", "t", Buttons::kYesNo), Answer::kYes);
  EXPECT_EQ(dialogs.Ask("q", "t", Buttons::kYesNoCancel), Answer::kYes);
  EXPECT_EQ(dialogs.Ask("q", "t", Buttons::kRetryCancel), Answer::kCancel);
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "[t] q\n[t] q\n[t] q\n[t] q\n[t] q\n");
  EXPECT_FALSE(dialogs.said());  // a question is no message
}

TEST(ConsoleDialogsTest, PromptTakesTheStandingTextUnlessDeclined) {
  testing::internal::CaptureStderr();
  EXPECT_EQ(ConsoleDialogs().Prompt("p", "t", "C:"), "C:");
  EXPECT_EQ(ConsoleDialogs(Answer::kYes).Prompt("p", "t", "C:"), "C:");
  EXPECT_EQ(ConsoleDialogs(Answer::kNo).Prompt("p", "t", "C:"), std::nullopt);
  EXPECT_EQ(ConsoleDialogs(Answer::kCancel).Prompt("p", "t", "C:"), std::nullopt);
  EXPECT_EQ(ConsoleDialogs().Prompt("p", "t", ""), std::nullopt);
  testing::internal::GetCapturedStderr();
}

TEST(ConsoleDialogsTest, ProgressIsSilentWhereNobodyLooks) {
  testing::internal::CaptureStderr();  // a file, no terminal
  {
    const auto progress = ConsoleDialogs().StartProgress("Sorting");
    EXPECT_TRUE(progress->Step(0, 0));
    EXPECT_TRUE(progress->Step(5, 10));
    EXPECT_TRUE(progress->Step(2147483647, 1));
    EXPECT_TRUE(progress->Step(-1, 10));
  }
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
}
