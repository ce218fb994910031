#include "platform/qt/keyboard_back.h"

#include <QApplication>
#include <QDialog>
#include <QEvent>

namespace kora {

KeyboardBack::KeyboardBack() { qApp->installEventFilter(this); }

bool KeyboardBack::eventFilter(QObject* object, QEvent* event) {
  if (event->type() == QEvent::Hide && !event->spontaneous()) {
    const auto* dialog = qobject_cast<QDialog*>(object);
    if (dialog && dialog->isWindow() && dialog->parentWidget()) {
      QWidget* below = QApplication::activeModalWidget();
      if (!below) below = dialog->parentWidget()->window();
      if (below != dialog && below->isVisible() && !below->isMinimized()) below->activateWindow();
    }
  }
  return QObject::eventFilter(object, event);
}

}  // namespace kora
