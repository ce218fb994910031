#pragma once

#include <QDialog>

#include "looks/forms/look_services.h"

class QSpinBox;

namespace kora {

// The weight of lines on printed charts.
class PLW : public QDialog {
 public:
  PLW(LookServices services, QWidget* parent);

 private:
  void Save();

  LookServices services_;
  QSpinBox* text1_;
};

}  // namespace kora
