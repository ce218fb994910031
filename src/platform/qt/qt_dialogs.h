#pragma once

#include <string>

#include "platform/dialogs.h"

namespace kora {

// The program's dialogs as windows. They open over the active window, or over none.
class QtDialogs : public Dialogs {
 public:
  ~QtDialogs() override;

  void Message(std::string_view text, std::string_view title) override;
  Answer Ask(std::string_view text, std::string_view title, Buttons buttons) override;
  std::optional<std::string> Prompt(std::string_view text, std::string_view title,
                                    std::string_view standing) override;
  std::unique_ptr<Progress> StartProgress(std::string_view title) override;
  void SetBusy(bool busy) override;
  void Yield() override;

 private:
  bool busy_ = false;
};

// While a box was answered and the routine that asked has not gone on yet: keys and clicks do nothing.
bool InputIsHeldBack();

}  // namespace kora
