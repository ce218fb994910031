#pragma once

#include <QString>
#include <functional>
#include <string>

#include "platform/dialogs.h"
#include "settings/settings.h"

namespace kora {

// What the forms of the download settings work with.
struct UpdateFormServices {
  SettingsFile& ini;
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  std::function<void()> serviceSaved = {};  // the main menu follows the service
  std::function<void()> pathChosen = {};    // CurrentDataPath changed: title, field of CPath
};

inline QString Shown(std::string_view text) {
  return QString::fromUtf8(text.data(), qsizetype(text.size()));
}

// Runs the saving of a form; a failure of the host is told. False then, and when `save` says so.
bool SaveOrTell(Dialogs& dialogs, const QString& title, const std::function<bool()>& save);

}  // namespace kora
