#include "platform/headless/console_dialogs.h"

#include <unistd.h>

#include <array>
#include <cstdio>

namespace kora {
namespace {

class ConsoleProgress : public Progress {
 public:
  explicit ConsoleProgress(std::string_view title)
      : title_(title), show_(::isatty(::fileno(stderr)) != 0) {}
  ~ConsoleProgress() override { SetRunning(false); }
  // What is said behind the pass has the line to itself.
  void SetRunning(bool) override {
    if (show_ && percent_ >= 0) std::fprintf(stderr, "\r\033[K");
    percent_ = -1;
  }
  bool Step(int done, int total) override {
    const int percent = total > 0 ? int(100.0 * done / total) : 100;
    if (show_ && percent != percent_) {
      const int filled = percent * 40 / 100;
      std::fprintf(stderr, "\r%s [%-40.*s] %3d%%", title_.c_str(), filled,
                   "########################################", percent);
      std::fflush(stderr);
    }
    percent_ = percent;
    return true;
  }

 private:
  std::string title_;
  bool show_;
  int percent_ = -1;
};

}  // namespace

ConsoleDialogs::ConsoleDialogs(std::optional<Answer> standing) : standing_(standing) {}

void ConsoleDialogs::Begin(std::string_view piece) {
  piece_ = piece.empty() ? std::string() : std::string(piece) + ": ";
  said_ = false;
}

void ConsoleDialogs::Say(std::string_view text, std::string_view title) const {
  std::fprintf(stderr, "[%.*s] %s%.*s\n", int(title.size()), title.data(), piece_.c_str(),
               int(text.size()), text.data());
}

void ConsoleDialogs::Message(std::string_view text, std::string_view title) {
  said_ = true;
  Say(text, title);
}

Answer ConsoleDialogs::Ask(std::string_view text, std::string_view title, Buttons buttons) {
  Say(text, title);
  const auto offers = [buttons](Answer a) {
    switch (buttons) {
      case Buttons::kOk: return a == Answer::kOk;
      case Buttons::kOkCancel: return a == Answer::kOk || a == Answer::kCancel;
      case Buttons::kYesNo:
      case Buttons::kNoYes: return a == Answer::kYes || a == Answer::kNo;
      case Buttons::kYesNoCancel:
        return a == Answer::kYes || a == Answer::kNo || a == Answer::kCancel;
      case Buttons::kRetryCancel: return a == Answer::kRetry || a == Answer::kCancel;
    }
    return false;
  };
  if (standing_) {
    if (offers(*standing_)) return *standing_;
    // The word for the same in this box: who declines must not be taken to agree.
    const bool declines = *standing_ == Answer::kNo || *standing_ == Answer::kCancel;
    for (const Answer word : declines ? std::array{Answer::kNo, Answer::kCancel}
                                      : std::array{Answer::kYes, Answer::kOk})
      if (offers(word)) return word;
  }
  switch (buttons) {
    case Buttons::kOk:
    case Buttons::kOkCancel: return Answer::kOk;
    case Buttons::kYesNo:
    case Buttons::kYesNoCancel: return Answer::kYes;
    case Buttons::kNoYes: return Answer::kNo;
    // Nobody is there to mend what failed, and trying again would never end.
    case Buttons::kRetryCancel: return Answer::kCancel;
  }
  return Answer::kCancel;
}

std::optional<std::string> ConsoleDialogs::Prompt(std::string_view text, std::string_view title,
                                                  std::string_view standing) {
  Say(text, title);
  if (standing_ == Answer::kCancel || standing_ == Answer::kNo || standing.empty())
    return std::nullopt;
  return std::string(standing);
}

std::unique_ptr<Progress> ConsoleDialogs::StartProgress(std::string_view title) {
  return std::make_unique<ConsoleProgress>(title);
}

}  // namespace kora
