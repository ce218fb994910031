#pragma once

#include <functional>
#include <string>

#include "lists/text_print_out.h"
#include "platform/dialogs.h"
#include "platform/qt/to_qt.h"
#include "settings/locate.h"
#include "settings/settings.h"

class QLineEdit;
class QToolButton;
class QWidget;

namespace kora {

// What the forms of the download settings work with.
struct UpdateFormServices {
  SettingsFile& ini;
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  std::function<void()> serviceSaved = {};  // the main menu follows the service
  std::function<void()> pathChosen = {};    // CurrentDataPath changed: title, field of CPath
  // Asks how to print a list and prints it; what fails is told. Without it the entry is greyed.
  std::function<void(const TextTable&, QWidget* over)> print = {};
};

// The button beside `box` that opens `Locate` on what `what` says at that time; the folder goes
// into the box.
QToolButton* NewLocateButton(const UpdateFormServices& services, const QString& name,
                             QLineEdit* box, std::function<LocateCase()> what, QWidget* form);

// The same for the box of the folder `index`, 0 to 5, of the whole market; "Picture1(index)".
QToolButton* NewDestinationButton(const UpdateFormServices& services, int index, QLineEdit* box,
                                  QWidget* form);

// Runs the saving of a form; a failure of the host is told. False then, and when `save` says so.
bool SaveOrTell(Dialogs& dialogs, const QString& title, const std::function<bool()>& save);

}  // namespace kora
