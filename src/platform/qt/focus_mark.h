#pragma once

#include <QObject>
#include <QPointer>

class QWidget;

namespace kora {

// Shows where the keyboard is on controls whose style does not: a frame in the colour of selections
// around lists, tables, scroll bars, tool buttons and pictures that the user has come to by keys.
// Works from its making to its end, for all windows of the application.
class FocusMark : public QObject {
 public:
  FocusMark();
  ~FocusMark() override;

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  QPointer<QWidget> frame_;  // a child of the control that it marks
};

}  // namespace kora
