#pragma once

#include <QDialog>

#include "chart/forms/print_services.h"

class QComboBox;
class QRadioButton;

namespace kora {

// Which printer, paper and orientation are in use.
class PrinterSetup : public QDialog {
 public:
  PrinterSetup(const PrintServices& services, QWidget* parent);

 private:
  void Save();

  PrintServices services_;
  QComboBox *combo1_, *combo2_;
  QRadioButton* landscape_;
};

}  // namespace kora
