#pragma once

#include <QGroupBox>
#include <functional>

#include "platform/dialogs.h"
#include "platform/printer.h"

class QRadioButton;

namespace kora {

// The two buttons of the page's orientation, Option1(0) portrait and Option1(1) landscape. They
// turn the printer's page at once; without a printer they say that they can't.
class OrientationChoice : public QGroupBox {
 public:
  OrientationChoice(QWidget* form, Printer& printer, Dialogs& dialogs,
                    std::function<void()> changed);

 private:
  void Pressed(std::int16_t orientation);
  void Show();

  Printer& printer_;
  Dialogs& dialogs_;
  std::function<void()> changed_;
  QRadioButton *portrait_, *landscape_;
};

}  // namespace kora
