#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "platform/progress.h"

namespace kora {

// kNoYes is Yes and No with No standing: who just goes on has said No.
enum class Buttons { kOk, kOkCancel, kYesNo, kNoYes, kYesNoCancel, kRetryCancel };
enum class Answer { kOk, kCancel, kYes, kNo, kRetry };

// What the program says to the user and asks of him. One place, so that a command without
// windows and the tests can answer. Texts are UTF-8 and show as they are, line ends too.
class Dialogs {
 public:
  virtual ~Dialogs() = default;
  virtual void Message(std::string_view text, std::string_view title) = 0;
  // One of the buttons. A box that is closed without one answers cancel, or no where there is no
  // Cancel.
  virtual Answer Ask(std::string_view text, std::string_view title, Buttons buttons) = 0;
  // Nothing when cancelled; an empty answer counts as cancelled too.
  virtual std::optional<std::string> Prompt(std::string_view text, std::string_view title,
                                            std::string_view standing) = 0;
  // A display of its own, until it is destroyed. Never null.
  virtual std::unique_ptr<Progress> StartProgress(std::string_view title) = 0;
  // The busy pointer. Calls do not nest.
  virtual void SetBusy(bool busy) = 0;
  // Handles what waits in the event queue (paint, mouse, keys).
  virtual void Yield() = 0;
};

}  // namespace kora
