#pragma once

#include <deque>
#include <optional>
#include <string>
#include <vector>

#include "platform/dialogs.h"

namespace kora::test {

// Dialogs that answer as the test says and keep what was said.
class ScriptedDialogs : public Dialogs {
 public:
  struct Said {
    std::string title, text;
  };
  std::vector<Said> said;                          // messages, questions and prompts in order
  std::deque<Answer> answers;                      // to questions; the first button's when empty
  std::deque<std::optional<std::string>> replies;  // to prompts; cancel when empty
  int busyCalls = 0;
  bool busy = false;

  void Message(std::string_view text, std::string_view title) override {
    said.push_back({std::string(title), std::string(text)});
  }
  Answer Ask(std::string_view text, std::string_view title, Buttons buttons) override {
    said.push_back({std::string(title), std::string(text)});
    if (!answers.empty()) {
      const Answer a = answers.front();
      answers.pop_front();
      return a;
    }
    if (buttons == Buttons::kYesNo || buttons == Buttons::kYesNoCancel) return Answer::kYes;
    if (buttons == Buttons::kNoYes) return Answer::kNo;
    return buttons == Buttons::kRetryCancel ? Answer::kCancel : Answer::kOk;
  }
  std::optional<std::string> Prompt(std::string_view text, std::string_view title,
                                    std::string_view) override {
    said.push_back({std::string(title), std::string(text)});
    if (replies.empty()) return std::nullopt;
    auto reply = replies.front();
    replies.pop_front();
    return reply;
  }
  std::unique_ptr<Progress> StartProgress(std::string_view) override {
    return std::make_unique<NoProgress>();
  }
  void SetBusy(bool value) override {
    busy = value;
    ++busyCalls;
  }
  void Yield() override {}
};

}  // namespace kora::test
