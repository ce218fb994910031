#pragma once

#include <QDialog>

#include "looks/forms/look_services.h"

class QButtonGroup;

namespace kora {

// The height of volumes.
class VHeight : public QDialog {
 public:
  VHeight(LookServices services, QWidget* parent);

 private:
  void Save();

  LookServices services_;
  QButtonGroup* option1_;
};

}  // namespace kora
