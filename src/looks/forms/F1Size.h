#pragma once

#include <QDialog>

#include "looks/forms/look_services.h"

class QSpinBox;

namespace kora {

// The size of the forms with tables.
class F1Size : public QDialog {
 public:
  F1Size(LookServices services, QWidget* parent);

 private:
  void Save();

  LookServices services_;
  QSpinBox* text1_;
};

}  // namespace kora
