#pragma once

#include <optional>
#include <string>

#include "platform/dialogs.h"

namespace kora {

// Messages go to standard error as "[title] text". A question takes the standing answer; where
// it has none of that name, or none stands, the first affirmative button.
class ConsoleDialogs : public Dialogs {
 public:
  explicit ConsoleDialogs(std::optional<Answer> standing = std::nullopt);

  void Message(std::string_view text, std::string_view title) override;
  Answer Ask(std::string_view text, std::string_view title, Buttons buttons) override;
  // Takes the standing text unless the standing answer is cancel or no.
  std::optional<std::string> Prompt(std::string_view text, std::string_view title,
                                    std::string_view standing) override;
  // A bar on standard error when that is a terminal.
  std::unique_ptr<Progress> StartProgress(std::string_view title) override;
  void SetBusy(bool) override {}
  void Yield() override {}

  // Begins a piece of the work: messages name it ("[title] ABC: text") until the next one, and
  // said() starts anew. Empty: the work as a whole.
  void Begin(std::string_view piece);
  // Whether any message was shown since then: the operation was abandoned.
  bool said() const { return said_; }

 private:
  void Say(std::string_view text, std::string_view title) const;

  std::string piece_;
  std::optional<Answer> standing_;
  bool said_ = false;
};

}  // namespace kora
