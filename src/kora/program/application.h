#pragma once

#include <QApplication>

#include "platform/dialogs.h"

namespace kora {

// What no form caught is told, and the program goes on: an exception must not end it with what is
// open in its forms.
class Application : public QApplication {
 public:
  Application(int& argc, char** argv);

  Dialogs* dialogs = nullptr;  // null: nothing is told

  bool notify(QObject* receiver, QEvent* event) override;

 protected:
  virtual void Caught(const char* what);
};

}  // namespace kora
