#pragma once

#include <QObject>

namespace kora {

// Gives the keyboard to what stands below a dialog when that closes. Window managers do so
// themselves, but several lose it where a form closes in the moment in which a question over it
// was answered: the form that they had in mind is gone, and the keyboard is nobody's.
// Works from its making to its end, for all dialogs of the application that have a parent.
class KeyboardBack : public QObject {
 public:
  KeyboardBack();

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;
};

}  // namespace kora
