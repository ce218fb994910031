#pragma once

#include <new>
#include <string>
#include <string_view>

#include "base/runtime_error.h"
#include "platform/dialogs.h"

namespace kora {

// Tells what `work` fails with, and the file that it befell: `about` as it stands by then, where
// there is one. False then.
template <typename Work>
bool TellFailure(Dialogs& dialogs, std::string_view title, const std::string& about, Work work) {
  std::string text;
  try {
    work();
    return true;
  } catch (const RunTimeError& e) {
    text = e.what();
  } catch (const std::bad_alloc&) {
    text = ErrorText(kOutOfMemory);
  }
  if (!about.empty()) text = about + ": " + text;
  dialogs.Message(text, title);
  return false;
}

}  // namespace kora
