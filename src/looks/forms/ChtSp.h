#pragma once

#include <QDialog>

#include "looks/forms/look_services.h"

class QSpinBox;

namespace kora {

// The space from bar to bar.
class ChtSp : public QDialog {
 public:
  // Candlesticks need more space than the others.
  ChtSp(LookServices services, Style chartStyle, QWidget* parent);

 private:
  void Save();

  LookServices services_;
  QSpinBox* text1_;
};

}  // namespace kora
