#pragma once

#include <QDialog>

#include "looks/forms/look_services.h"

class QCheckBox;
class QLineEdit;

namespace kora {

// The vertical grid's spacing and the intermediate horizontal grid.
class GLSpaces : public QDialog {
 public:
  GLSpaces(LookServices services, QWidget* parent);

 private:
  void Save();

  LookServices services_;
  QLineEdit* text1_;
  QCheckBox* check1_;
};

}  // namespace kora
