#pragma once

#include <QDialog>

#include "looks/forms/look_services.h"

class QLineEdit;
class QRadioButton;

namespace kora {

// "Stop Loss": on or off, and the percent below the low.
class StpLs : public QDialog {
 public:
  StpLs(LookServices services, QWidget* parent);

 private:
  void Save();

  LookServices services_;
  QRadioButton* on_;
  QLineEdit* text1_;
};

}  // namespace kora
