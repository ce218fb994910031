#pragma once

#include <functional>

#include "platform/dialogs.h"
#include "settings/settings.h"

namespace kora {

// What the forms of one or two chart values work on.
struct LookServices {
  SettingsFile& ini;
  Settings& settings;
  Dialogs& dialogs;
  std::function<void()> saved;  // after a save, the form closed: the chart is drawn anew

  void Saved() const {
    if (saved) saved();
  }
};

}  // namespace kora
