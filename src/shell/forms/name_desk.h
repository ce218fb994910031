#pragma once

#include <QPointer>
#include <functional>

#include "lists/text_print_out.h"
#include "shell/session.h"

class QDialog;
class QWidget;

namespace kora {

// What the forms of the name file need of the main window.
struct NameDeskHooks {
  std::function<void(const TextTable&, QWidget* over)> printTable;
  std::function<void(QWidget* over)> pageSetup;
  // Asks for the size of forms with tables; percent.
  std::function<int(QWidget* over)> changeSize;
  // The name file is another one: charts and selections read it again.
  std::function<void()> namesChanged;
};

// The editors of the name file and of the industry classes. It lives as long as the main window.
class NameDesk {
 public:
  NameDesk(Session& session, QWidget* over, NameDeskHooks hooks);

  void OpenNames();    // NameForm
  void OpenClasses();  // IndClass

 private:
  void Show(QPointer<QDialog>& place, QDialog* form);

  Session& session_;
  QWidget* over_;
  NameDeskHooks hooks_;
  QPointer<QDialog> names_, classes_;
};

}  // namespace kora
