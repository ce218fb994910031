#pragma once

#include <algorithm>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/dialogs.h"

namespace kora {

// Passes everything on to `dialogs`, and remembers what was told. While a deed is repeated that
// the user did not ask for again, what the last try told is not told again: a message is left
// out, a question has the answer that goes no further.
class ToldOnce : public Dialogs {
 public:
  explicit ToldOnce(Dialogs& dialogs) : dialogs_(dialogs) {}

  // The user asks: whatever comes of it is told. Without effect within `Repeat`.
  void Forget() {
    if (!repeats_) told_.clear();
  }
  // Does it as a repetition.
  template <typename Deed>
  bool Repeat(Deed deed) {
    known_ = std::exchange(told_, {});
    repeats_ = true;
    struct End {
      bool& repeats;
      ~End() { repeats = false; }
    } end{repeats_};
    return deed();
  }

  void Message(std::string_view text, std::string_view title) override {
    if (News(text, title)) dialogs_.Message(text, title);
  }
  Answer Ask(std::string_view text, std::string_view title, Buttons buttons) override {
    if (News(text, title)) return dialogs_.Ask(text, title, buttons);
    return buttons == Buttons::kYesNo ? Answer::kNo : Answer::kCancel;
  }
  std::optional<std::string> Prompt(std::string_view text, std::string_view title,
                                    std::string_view standing) override {
    return dialogs_.Prompt(text, title, standing);
  }
  std::unique_ptr<Progress> StartProgress(std::string_view title) override {
    return dialogs_.StartProgress(title);
  }
  void SetBusy(bool busy) override { dialogs_.SetBusy(busy); }
  void Yield() override { dialogs_.Yield(); }

 private:
  bool News(std::string_view text, std::string_view title) {
    const std::pair said{std::string(text), std::string(title)};
    told_.push_back(said);
    return !repeats_ || std::find(known_.begin(), known_.end(), said) == known_.end();
  }

  using Texts = std::vector<std::pair<std::string, std::string>>;
  Dialogs& dialogs_;
  Texts told_;   // by this try, left out or not
  Texts known_;  // by the one before
  bool repeats_ = false;
};

}  // namespace kora
